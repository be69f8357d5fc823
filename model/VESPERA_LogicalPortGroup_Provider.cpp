#include "VESPERA_LogicalPortGroup_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_LogicalPortGroup_Provider::VESPERA_LogicalPortGroup_Provider()
{
}

VESPERA_LogicalPortGroup_Provider::~VESPERA_LogicalPortGroup_Provider()
{
}

Load_Status VESPERA_LogicalPortGroup_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_LogicalPortGroup_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_LogicalPortGroup_Provider::get_instance(const VESPERA_LogicalPortGroup*, VESPERA_LogicalPortGroup*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_LogicalPortGroup_Provider::enum_instances(
    const VESPERA_LogicalPortGroup*, Enum_Instances_Handler<VESPERA_LogicalPortGroup>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_LogicalPortGroup);

    if (instances.size() == 0)
    {
        TLOG(LL_WARN, "No Logical Port Groups found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_LogicalPortGroup_Provider::create_instance(VESPERA_LogicalPortGroup*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_LogicalPortGroup_Provider::delete_instance(const VESPERA_LogicalPortGroup*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_LogicalPortGroup_Provider::modify_instance(const VESPERA_LogicalPortGroup*, const VESPERA_LogicalPortGroup*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

} // namespace OLMA
