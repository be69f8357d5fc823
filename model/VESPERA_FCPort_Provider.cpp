#include "VESPERA_FCPort_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_FCPort_Provider::VESPERA_FCPort_Provider()
{
}

VESPERA_FCPort_Provider::~VESPERA_FCPort_Provider()
{
}

Load_Status VESPERA_FCPort_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_FCPort_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_FCPort_Provider::get_instance(const VESPERA_FCPort*, VESPERA_FCPort*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_FCPort_Provider::enum_instances(
    const VESPERA_FCPort*, Enum_Instances_Handler<VESPERA_FCPort>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_FCPort);

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

Create_Instance_Status VESPERA_FCPort_Provider::create_instance(VESPERA_FCPort*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_FCPort_Provider::delete_instance(const VESPERA_FCPort*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_FCPort_Provider::modify_instance(const VESPERA_FCPort*, const VESPERA_FCPort*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_FCPort_Provider::RequestStateChange(
    const VESPERA_FCPort*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_FCPort_Provider::SetPowerState(
    const VESPERA_FCPort*,
    const Property<uint16>&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_FCPort_Provider::Reset(
    const VESPERA_FCPort*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_FCPort_Provider::EnableDevice(
    const VESPERA_FCPort*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_FCPort_Provider::OnlineDevice(
    const VESPERA_FCPort*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_FCPort_Provider::QuiesceDevice(
    const VESPERA_FCPort*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_FCPort_Provider::SaveProperties(
    const VESPERA_FCPort*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_FCPort_Provider::RestoreProperties(
    const VESPERA_FCPort*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
