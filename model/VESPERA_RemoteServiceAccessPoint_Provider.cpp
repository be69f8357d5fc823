#include "VESPERA_RemoteServiceAccessPoint_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_RemoteServiceAccessPoint_Provider::VESPERA_RemoteServiceAccessPoint_Provider()
{
}

VESPERA_RemoteServiceAccessPoint_Provider::~VESPERA_RemoteServiceAccessPoint_Provider()
{
}

Load_Status VESPERA_RemoteServiceAccessPoint_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_RemoteServiceAccessPoint_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_RemoteServiceAccessPoint_Provider::get_instance(const VESPERA_RemoteServiceAccessPoint*, VESPERA_RemoteServiceAccessPoint*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

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

Create_Instance_Status VESPERA_RemoteServiceAccessPoint_Provider::create_instance(VESPERA_RemoteServiceAccessPoint*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_RemoteServiceAccessPoint_Provider::delete_instance(const VESPERA_RemoteServiceAccessPoint*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_RemoteServiceAccessPoint_Provider::modify_instance(const VESPERA_RemoteServiceAccessPoint*, const VESPERA_RemoteServiceAccessPoint*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_RemoteServiceAccessPoint_Provider::RequestStateChange(
    const VESPERA_RemoteServiceAccessPoint*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
