#include "VESPERA_AlarmDevice_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_AlarmDevice_Provider::VESPERA_AlarmDevice_Provider()
{
}

VESPERA_AlarmDevice_Provider::~VESPERA_AlarmDevice_Provider()
{
}

Load_Status VESPERA_AlarmDevice_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_AlarmDevice_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_AlarmDevice_Provider::get_instance(const VESPERA_AlarmDevice*, VESPERA_AlarmDevice*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_AlarmDevice_Provider::enum_instances(
    const VESPERA_AlarmDevice*, Enum_Instances_Handler<VESPERA_AlarmDevice>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_AlarmDevice);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "Invalid number of Instances returned");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_AlarmDevice_Provider::create_instance(VESPERA_AlarmDevice*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_AlarmDevice_Provider::delete_instance(const VESPERA_AlarmDevice*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_AlarmDevice_Provider::modify_instance(const VESPERA_AlarmDevice*, const VESPERA_AlarmDevice*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::RequestStateChange(
    const VESPERA_AlarmDevice*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::SetPowerState(
    const VESPERA_AlarmDevice*,
    const Property<uint16>&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::Reset(
    const VESPERA_AlarmDevice*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::EnableDevice(
    const VESPERA_AlarmDevice*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::OnlineDevice(
    const VESPERA_AlarmDevice*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::QuiesceDevice(
    const VESPERA_AlarmDevice*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::SaveProperties(
    const VESPERA_AlarmDevice*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::RestoreProperties(
    const VESPERA_AlarmDevice*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::SetAlarmState(
    const VESPERA_AlarmDevice*,
    const Property<uint16>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::SetAlarmIndicator(
    const VESPERA_AlarmDevice*,
    const Property<uint16>&,
    const Property<uint16>&,
    const Property<uint16>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AlarmDevice_Provider::SetUrgency(
    const VESPERA_AlarmDevice*,
    const Property<uint16>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
