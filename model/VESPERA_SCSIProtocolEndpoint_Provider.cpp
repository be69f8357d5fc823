#include "VESPERA_SCSIProtocolEndpoint_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

Get_Instance_Status VESPERA_SCSIProtocolEndpoint_Provider::get_instance(const VESPERA_SCSIProtocolEndpoint* model,
    VESPERA_SCSIProtocolEndpoint*& instance)
{
    TLOG(LL_DBG, "Entering: %s", "get_instance");
    Get_Instance_Status status = deliverInstance(
        FCHBAManager::getFCHBAManager()->getInstance(ID_VESPERA_SCSIProtocolEndpoint, model), instance);
    TLOG(LL_DBG, "Returning: %s", "get_instance");
    return status;
}

Enum_Instances_Status VESPERA_SCSIProtocolEndpoint_Provider::enum_instances(
    const VESPERA_SCSIProtocolEndpoint*, Enum_Instances_Handler<VESPERA_SCSIProtocolEndpoint>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_SCSIProtocolEndpoint);

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

} // namespace OLMA
