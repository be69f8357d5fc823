#include "VESPERA_FCPort_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_FCPort_Provider::enum_instances(
    const VESPERA_FCPort*, Enum_Instances_Handler<VESPERA_FCPort>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_FCPort);

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
