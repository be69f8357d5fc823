#include "VESPERA_RegisteredSubProfile_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

VESPERA_RegisteredSubProfile_Provider::VESPERA_RegisteredSubProfile_Provider()
{
}

VESPERA_RegisteredSubProfile_Provider::~VESPERA_RegisteredSubProfile_Provider()
{
}

Load_Status VESPERA_RegisteredSubProfile_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_RegisteredSubProfile_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_RegisteredSubProfile_Provider::get_instance(const VESPERA_RegisteredSubProfile*, VESPERA_RegisteredSubProfile*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_RegisteredSubProfile_Provider::enum_instances(
    const VESPERA_RegisteredSubProfile*, Enum_Instances_Handler<VESPERA_RegisteredSubProfile>* handler)
{
    return enumServerInstances(ID_VESPERA_RegisteredSubProfile, handler);
}

Create_Instance_Status VESPERA_RegisteredSubProfile_Provider::create_instance(VESPERA_RegisteredSubProfile*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_RegisteredSubProfile_Provider::delete_instance(const VESPERA_RegisteredSubProfile*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_RegisteredSubProfile_Provider::modify_instance(const VESPERA_RegisteredSubProfile*, const VESPERA_RegisteredSubProfile*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_RegisteredSubProfile_Provider::CloseConformantInstances(
    const VESPERA_RegisteredSubProfile*,
    const Property<String>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_RegisteredSubProfile_Provider::OpenConformantInstances(
    const VESPERA_RegisteredSubProfile*,
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

Invoke_Method_Status VESPERA_RegisteredSubProfile_Provider::PullConformantInstances(
    const VESPERA_RegisteredSubProfile*,
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
