#include "VESPERA_EthernetPort_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_EthernetPort_Provider::enum_instances(
    const VESPERA_EthernetPort*, Enum_Instances_Handler<VESPERA_EthernetPort>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_EthernetPort);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "Error: Invalid mapping information");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

} // namespace OLMA
