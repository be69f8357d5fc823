#include "VESPERA_SCSIProtocolEndpoint_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_SCSIProtocolEndpoint_Provider::VESPERA_SCSIProtocolEndpoint_Provider()
{
}

VESPERA_SCSIProtocolEndpoint_Provider::~VESPERA_SCSIProtocolEndpoint_Provider()
{
}

Load_Status VESPERA_SCSIProtocolEndpoint_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_SCSIProtocolEndpoint_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_SCSIProtocolEndpoint_Provider::get_instance(const VESPERA_SCSIProtocolEndpoint*, VESPERA_SCSIProtocolEndpoint*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_SCSIProtocolEndpoint_Provider::enum_instances(
    const VESPERA_SCSIProtocolEndpoint*, Enum_Instances_Handler<VESPERA_SCSIProtocolEndpoint>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_SCSIProtocolEndpoint);

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

Create_Instance_Status VESPERA_SCSIProtocolEndpoint_Provider::create_instance(VESPERA_SCSIProtocolEndpoint*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_SCSIProtocolEndpoint_Provider::delete_instance(const VESPERA_SCSIProtocolEndpoint*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_SCSIProtocolEndpoint_Provider::modify_instance(const VESPERA_SCSIProtocolEndpoint*, const VESPERA_SCSIProtocolEndpoint*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_SCSIProtocolEndpoint_Provider::RequestStateChange(
    const VESPERA_SCSIProtocolEndpoint*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_SCSIProtocolEndpoint_Provider::BroadcastReset(
    const VESPERA_SCSIProtocolEndpoint*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
