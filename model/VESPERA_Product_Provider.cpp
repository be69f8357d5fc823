#include "VESPERA_Product_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_Product_Provider::enum_instances(
    const VESPERA_Product*, Enum_Instances_Handler<VESPERA_Product>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_Product);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "No Adapter Found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

} // namespace OLMA
