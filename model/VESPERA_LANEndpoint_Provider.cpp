#include "VESPERA_LANEndpoint_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_LANEndpoint_Provider::VESPERA_LANEndpoint_Provider()
{
}

VESPERA_LANEndpoint_Provider::~VESPERA_LANEndpoint_Provider()
{
}

Load_Status VESPERA_LANEndpoint_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_LANEndpoint_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_LANEndpoint_Provider::get_instance(const VESPERA_LANEndpoint*, VESPERA_LANEndpoint*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_LANEndpoint_Provider::enum_instances(
    const VESPERA_LANEndpoint*, Enum_Instances_Handler<VESPERA_LANEndpoint>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_LANEndpoint);

    if (instances.size() == 0)
    {
        TLOG(LL_WARN, "No Ethernet Port Found");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_LANEndpoint_Provider::create_instance(VESPERA_LANEndpoint*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_LANEndpoint_Provider::delete_instance(const VESPERA_LANEndpoint*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_LANEndpoint_Provider::modify_instance(const VESPERA_LANEndpoint*, const VESPERA_LANEndpoint*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LANEndpoint_Provider::RequestStateChange(
    const VESPERA_LANEndpoint*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LANEndpoint_Provider::BroadcastReset(
    const VESPERA_LANEndpoint*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
