#include "VESPERA_RegisteredProfile_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

VESPERA_RegisteredProfile_Provider::VESPERA_RegisteredProfile_Provider()
{
}

VESPERA_RegisteredProfile_Provider::~VESPERA_RegisteredProfile_Provider()
{
}

Load_Status VESPERA_RegisteredProfile_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_RegisteredProfile_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_RegisteredProfile_Provider::get_instance(const VESPERA_RegisteredProfile*, VESPERA_RegisteredProfile*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_RegisteredProfile_Provider::enum_instances(
    const VESPERA_RegisteredProfile*, Enum_Instances_Handler<VESPERA_RegisteredProfile>* handler)
{
    return enumServerInstances(ID_VESPERA_RegisteredProfile, handler);
}

Create_Instance_Status VESPERA_RegisteredProfile_Provider::create_instance(VESPERA_RegisteredProfile*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_RegisteredProfile_Provider::delete_instance(const VESPERA_RegisteredProfile*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_RegisteredProfile_Provider::modify_instance(const VESPERA_RegisteredProfile*, const VESPERA_RegisteredProfile*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_RegisteredProfile_Provider::CloseConformantInstances(
    const VESPERA_RegisteredProfile*,
    const Property<String>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_RegisteredProfile_Provider::OpenConformantInstances(
    const VESPERA_RegisteredProfile*,
    const Property<String>&,
    const Property<Array<String> >&,
    const Property<uint32>&,
    const Property<bool>&,
    const Property<uint32>&,
    Property<String>&,
    Property<bool>&,
    Property<Array<uint16> >&,
    Property<Array<String> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_RegisteredProfile_Provider::PullConformantInstances(
    const VESPERA_RegisteredProfile*,
    Property<String>&,
    const Property<uint32>&,
    Property<bool>&,
    Property<Array<uint16> >&,
    Property<Array<String> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
