#include "VESPERA_PortController_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_PortController_Provider::VESPERA_PortController_Provider()
{
}

VESPERA_PortController_Provider::~VESPERA_PortController_Provider()
{
}

Load_Status VESPERA_PortController_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_PortController_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_PortController_Provider::get_instance(const VESPERA_PortController*, VESPERA_PortController*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_PortController_Provider::enum_instances(
    const VESPERA_PortController*, Enum_Instances_Handler<VESPERA_PortController>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_PortController);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "No Adapter Found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_PortController_Provider::create_instance(VESPERA_PortController*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_PortController_Provider::delete_instance(const VESPERA_PortController*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_PortController_Provider::modify_instance(const VESPERA_PortController*, const VESPERA_PortController*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PortController_Provider::RequestStateChange(
    const VESPERA_PortController*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PortController_Provider::SetPowerState(
    const VESPERA_PortController*,
    const Property<uint16>&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PortController_Provider::Reset(
    const VESPERA_PortController*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PortController_Provider::EnableDevice(
    const VESPERA_PortController*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PortController_Provider::OnlineDevice(
    const VESPERA_PortController*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PortController_Provider::QuiesceDevice(
    const VESPERA_PortController*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PortController_Provider::SaveProperties(
    const VESPERA_PortController*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PortController_Provider::RestoreProperties(
    const VESPERA_PortController*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
