#include "VESPERA_LogicalDisk_Provider.h"

#include "HDRManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

Get_Instance_Status VESPERA_LogicalDisk_Provider::get_instance(const VESPERA_LogicalDisk* model,
    VESPERA_LogicalDisk*& instance)
{
    TLOG(LL_DBG, "Entering: %s", "get_instance");
    Get_Instance_Status status = deliverInstance(
        HDRManager::getHDRManager()->getInstance(ID_VESPERA_LogicalDisk, model), instance);
    TLOG(LL_DBG, "Returning: %s", "get_instance");
    return status;
}

Enum_Instances_Status VESPERA_LogicalDisk_Provider::enum_instances(
    const VESPERA_LogicalDisk*, Enum_Instances_Handler<VESPERA_LogicalDisk>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        HDRManager::getHDRManager()->getInstances(ID_VESPERA_LogicalDisk);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "No LogicalDisks Found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

} // namespace OLMA
