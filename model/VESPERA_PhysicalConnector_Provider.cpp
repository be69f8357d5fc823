#include "VESPERA_PhysicalConnector_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

Get_Instance_Status VESPERA_PhysicalConnector_Provider::get_instance(const VESPERA_PhysicalConnector* model,
    VESPERA_PhysicalConnector*& instance)
{
    TLOG(LL_DBG, "Entering: %s", "get_instance");
    Get_Instance_Status status = deliverInstance(
        FCHBAManager::getFCHBAManager()->getInstance(ID_VESPERA_PhysicalConnector, model), instance);
    TLOG(LL_DBG, "Returning: %s", "get_instance");
    return status;
}

Enum_Instances_Status VESPERA_PhysicalConnector_Provider::enum_instances(
    const VESPERA_PhysicalConnector*, Enum_Instances_Handler<VESPERA_PhysicalConnector>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_PhysicalConnector);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "No Connector Found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

} // namespace OLMA
