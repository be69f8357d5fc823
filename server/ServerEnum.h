#ifndef _OLMA_ServerEnum_h
#define _OLMA_ServerEnum_h

// The one enumeration that every provider of the interop classes performs:
// ask ServerManager for the class's instances and hand them on.

#include "Provider.h"
#include "ServerManager.h"
#include "log.h"

namespace OLMA
{

// Hands a clone of each instance of class id to the handler and destroys
// the original. Elements of another class are dropped, and so is whatever
// is left once the handler asks to stop. count, if given, receives the
// number of instances that ServerManager had.
template<class T>
void sendServerInstances(classId_t id, Enum_Instances_Handler<T>* handler, size_t* count = 0)
{
    Array<Instance*> instances = ServerManager::getServerManager()->getInstances(id);
    if (count)
        *count = instances.size();
    if (instances.size())
        TLOG(LL_DBG, "Returning instances");

    bool sending = handler != 0;
    for (size_t i = 0; i < instances.size(); i++)
    {
        T* instance = checked_cast<T>(instances[i]);
        if (sending && instance)
            sending = handler->handle(clone(instance));
        destroyer(instances[i]);
    }
}

// The usual enumeration: an empty result is logged, but is no failure.
template<class T>
Enum_Instances_Status enumServerInstances(classId_t id, Enum_Instances_Handler<T>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    size_t count = 0;
    sendServerInstances(id, handler, &count);
    if (count == 0)
        TLOG(LL_ERR, "No %s instances found!", T::static_meta_class.name);
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

} // namespace OLMA

#endif // _OLMA_ServerEnum_h
