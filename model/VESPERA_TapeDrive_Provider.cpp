#include "VESPERA_TapeDrive_Provider.h"

#include "HDRManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_TapeDrive_Provider::VESPERA_TapeDrive_Provider()
{
}

VESPERA_TapeDrive_Provider::~VESPERA_TapeDrive_Provider()
{
}

Load_Status VESPERA_TapeDrive_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_TapeDrive_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_TapeDrive_Provider::get_instance(const VESPERA_TapeDrive*, VESPERA_TapeDrive*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_TapeDrive_Provider::enum_instances(
    const VESPERA_TapeDrive*, Enum_Instances_Handler<VESPERA_TapeDrive>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        HDRManager::getHDRManager()->getInstances(ID_VESPERA_TapeDrive);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "No TapeDrives Found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_TapeDrive_Provider::create_instance(VESPERA_TapeDrive*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_TapeDrive_Provider::delete_instance(const VESPERA_TapeDrive*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_TapeDrive_Provider::modify_instance(const VESPERA_TapeDrive*, const VESPERA_TapeDrive*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_TapeDrive_Provider::RequestStateChange(
    const VESPERA_TapeDrive*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_TapeDrive_Provider::SetPowerState(
    const VESPERA_TapeDrive*,
    const Property<uint16>&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_TapeDrive_Provider::Reset(
    const VESPERA_TapeDrive*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_TapeDrive_Provider::EnableDevice(
    const VESPERA_TapeDrive*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_TapeDrive_Provider::OnlineDevice(
    const VESPERA_TapeDrive*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_TapeDrive_Provider::QuiesceDevice(
    const VESPERA_TapeDrive*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_TapeDrive_Provider::SaveProperties(
    const VESPERA_TapeDrive*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_TapeDrive_Provider::RestoreProperties(
    const VESPERA_TapeDrive*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_TapeDrive_Provider::LockMedia(
    const VESPERA_TapeDrive*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
