#include "VESPERA_EthernetPort_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_EthernetPort_Provider::VESPERA_EthernetPort_Provider()
{
}

VESPERA_EthernetPort_Provider::~VESPERA_EthernetPort_Provider()
{
}

Load_Status VESPERA_EthernetPort_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_EthernetPort_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_EthernetPort_Provider::get_instance(const VESPERA_EthernetPort*, VESPERA_EthernetPort*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

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

Create_Instance_Status VESPERA_EthernetPort_Provider::create_instance(VESPERA_EthernetPort*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_EthernetPort_Provider::delete_instance(const VESPERA_EthernetPort*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_EthernetPort_Provider::modify_instance(const VESPERA_EthernetPort*, const VESPERA_EthernetPort*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthernetPort_Provider::RequestStateChange(
    const VESPERA_EthernetPort*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthernetPort_Provider::SetPowerState(
    const VESPERA_EthernetPort*,
    const Property<uint16>&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthernetPort_Provider::Reset(
    const VESPERA_EthernetPort*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthernetPort_Provider::EnableDevice(
    const VESPERA_EthernetPort*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthernetPort_Provider::OnlineDevice(
    const VESPERA_EthernetPort*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthernetPort_Provider::QuiesceDevice(
    const VESPERA_EthernetPort*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthernetPort_Provider::SaveProperties(
    const VESPERA_EthernetPort*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthernetPort_Provider::RestoreProperties(
    const VESPERA_EthernetPort*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
