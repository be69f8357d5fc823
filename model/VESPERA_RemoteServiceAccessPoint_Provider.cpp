#include "VESPERA_RemoteServiceAccessPoint_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_RemoteServiceAccessPoint_Provider::enum_instances(
    const VESPERA_RemoteServiceAccessPoint*, Enum_Instances_Handler<VESPERA_RemoteServiceAccessPoint>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_RemoteServiceAccessPoint);

    // The console agent is optional, but there is never more than one.
    if (instances.size() == 0)
    {
        TLOG(LL_WARN, "Warning: No service is available");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    if (instances.size() > 1)
    {
        TLOG(LL_ERR, "Error: Invalid mapping information");
        destroyInstances(instances);
        return ENUM_INSTANCES_FAILED;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

} // namespace OLMA
