#include "VESPERA_ComputerSystem_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_ComputerSystem_Provider::enum_instances(
    const VESPERA_ComputerSystem*, Enum_Instances_Handler<VESPERA_ComputerSystem>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_ComputerSystem);

    // Everything else hangs off the one host; two or none means the
    // mapping of the host is broken, not that there is nothing to show.
    if (instances.size() != 1)
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
