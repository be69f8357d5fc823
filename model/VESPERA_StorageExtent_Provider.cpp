#include "VESPERA_StorageExtent_Provider.h"

#include "HDRManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_StorageExtent_Provider::VESPERA_StorageExtent_Provider()
{
}

VESPERA_StorageExtent_Provider::~VESPERA_StorageExtent_Provider()
{
}

Load_Status VESPERA_StorageExtent_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_StorageExtent_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_StorageExtent_Provider::get_instance(const VESPERA_StorageExtent*, VESPERA_StorageExtent*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_StorageExtent_Provider::enum_instances(
    const VESPERA_StorageExtent*, Enum_Instances_Handler<VESPERA_StorageExtent>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        HDRManager::getHDRManager()->getInstances(ID_VESPERA_StorageExtent);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "No StorageExtents Found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_StorageExtent_Provider::create_instance(VESPERA_StorageExtent*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_StorageExtent_Provider::delete_instance(const VESPERA_StorageExtent*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_StorageExtent_Provider::modify_instance(const VESPERA_StorageExtent*, const VESPERA_StorageExtent*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_StorageExtent_Provider::RequestStateChange(
    const VESPERA_StorageExtent*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_StorageExtent_Provider::SetPowerState(
    const VESPERA_StorageExtent*,
    const Property<uint16>&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_StorageExtent_Provider::Reset(
    const VESPERA_StorageExtent*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_StorageExtent_Provider::EnableDevice(
    const VESPERA_StorageExtent*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_StorageExtent_Provider::OnlineDevice(
    const VESPERA_StorageExtent*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_StorageExtent_Provider::QuiesceDevice(
    const VESPERA_StorageExtent*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_StorageExtent_Provider::SaveProperties(
    const VESPERA_StorageExtent*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_StorageExtent_Provider::RestoreProperties(
    const VESPERA_StorageExtent*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
