#ifndef _VSPR_InstanceDelivery_h
#define _VSPR_InstanceDelivery_h

#include "Array.h"
#include "Instance.h"
#include "Provider.h"

namespace OLMA
{

// Hands what a facade returned to an enumeration's handler, in order. The
// array's elements are consumed: each is cloned into the handler (which owns
// the clone) and then destroyed. A null element or one of another class is
// skipped. Once the handler asks to stop, the rest are only destroyed, so
// nothing leaks whatever the handler says.
template<class T>
void deliverInstances(Array<Instance*>& instances, Enum_Instances_Handler<T>* handler)
{
    bool sending = handler != 0;

    for (size_t i = 0; i < instances.size(); i++)
    {
        Instance* element = instances[i];
        T* typed = checked_cast<T>(element);

        if (sending && typed)
            sending = handler->handle(clone(typed));

        if (element)
            destroy(element);
    }

    instances.clear();
}

// Hands the one instance that a look-up found to getInstance's
// out-parameter, which passes it to the runtime. Nothing, or an instance of
// another class, is not found.
template<class T>
Get_Instance_Status deliverInstance(Instance* found, T*& instance)
{
    instance = checked_cast<T>(found);

    if (instance)
        return GET_INSTANCE_OK;

    if (found)
        destroy(found);

    return GET_INSTANCE_NOT_FOUND;
}

// Releases every element of an array that won't be delivered.
inline void destroyInstances(Array<Instance*>& instances)
{
    for (size_t i = 0; i < instances.size(); i++)
    {
        if (instances[i])
            destroy(instances[i]);
    }

    instances.clear();
}

} // namespace OLMA

#endif
