#include "VESPERA_FCPortStatistics_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_FCPortStatistics_Provider::VESPERA_FCPortStatistics_Provider()
{
}

VESPERA_FCPortStatistics_Provider::~VESPERA_FCPortStatistics_Provider()
{
}

Load_Status VESPERA_FCPortStatistics_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_FCPortStatistics_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_FCPortStatistics_Provider::get_instance(const VESPERA_FCPortStatistics*, VESPERA_FCPortStatistics*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_FCPortStatistics_Provider::enum_instances(
    const VESPERA_FCPortStatistics*, Enum_Instances_Handler<VESPERA_FCPortStatistics>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_FCPortStatistics);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "No FC Ports Found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_FCPortStatistics_Provider::create_instance(VESPERA_FCPortStatistics*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_FCPortStatistics_Provider::delete_instance(const VESPERA_FCPortStatistics*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_FCPortStatistics_Provider::modify_instance(const VESPERA_FCPortStatistics*, const VESPERA_FCPortStatistics*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_FCPortStatistics_Provider::ResetSelectedStats(
    const VESPERA_FCPortStatistics*,
    const Property<Array<String> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
