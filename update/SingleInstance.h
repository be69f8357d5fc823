#ifndef _VSPR_SingleInstance_h
#define _VSPR_SingleInstance_h

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "Provider.h"
#include "log.h"

namespace OLMA
{

// The enumeration of a class that has exactly one instance on a host. Any
// other number means the facade and the class disagree, and nothing is
// sent rather than a guess; the enumeration itself still succeeds.
template<class T>
Enum_Instances_Status enumSingleInstance(classId_t id, Enum_Instances_Handler<T>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances = FCHBAManager::getFCHBAManager()->getInstances(id);

    if (instances.size() == 1)
    {
        TLOG(LL_DBG, "Returning instances");
        deliverInstances(instances, handler);
    }
    else
    {
        TLOG(LL_ERR, "Error: Invalid mapping information");
        destroyInstances(instances);
    }

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

} // namespace OLMA

#endif
