#include "VESPERA_Namespace_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

VESPERA_Namespace_Provider::VESPERA_Namespace_Provider()
{
}

VESPERA_Namespace_Provider::~VESPERA_Namespace_Provider()
{
}

Load_Status VESPERA_Namespace_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_Namespace_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_Namespace_Provider::get_instance(const VESPERA_Namespace*, VESPERA_Namespace*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_Namespace_Provider::enum_instances(
    const VESPERA_Namespace*, Enum_Instances_Handler<VESPERA_Namespace>* handler)
{
    return enumServerInstances(ID_VESPERA_Namespace, handler);
}

Create_Instance_Status VESPERA_Namespace_Provider::create_instance(VESPERA_Namespace*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_Namespace_Provider::delete_instance(const VESPERA_Namespace*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_Namespace_Provider::modify_instance(const VESPERA_Namespace*, const VESPERA_Namespace*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

} // namespace OLMA
