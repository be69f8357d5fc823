#include "VESPERA_LogicalDisk_Provider.h"

#include "HDRManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_LogicalDisk_Provider::VESPERA_LogicalDisk_Provider()
{
}

VESPERA_LogicalDisk_Provider::~VESPERA_LogicalDisk_Provider()
{
}

Load_Status VESPERA_LogicalDisk_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_LogicalDisk_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_LogicalDisk_Provider::get_instance(const VESPERA_LogicalDisk*, VESPERA_LogicalDisk*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_LogicalDisk_Provider::enum_instances(
    const VESPERA_LogicalDisk*, Enum_Instances_Handler<VESPERA_LogicalDisk>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        HDRManager::getHDRManager()->getInstances(ID_VESPERA_LogicalDisk);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "No LogicalDisks Found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_LogicalDisk_Provider::create_instance(VESPERA_LogicalDisk*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_LogicalDisk_Provider::delete_instance(const VESPERA_LogicalDisk*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_LogicalDisk_Provider::modify_instance(const VESPERA_LogicalDisk*, const VESPERA_LogicalDisk*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LogicalDisk_Provider::RequestStateChange(
    const VESPERA_LogicalDisk*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LogicalDisk_Provider::SetPowerState(
    const VESPERA_LogicalDisk*,
    const Property<uint16>&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LogicalDisk_Provider::Reset(
    const VESPERA_LogicalDisk*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LogicalDisk_Provider::EnableDevice(
    const VESPERA_LogicalDisk*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LogicalDisk_Provider::OnlineDevice(
    const VESPERA_LogicalDisk*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LogicalDisk_Provider::QuiesceDevice(
    const VESPERA_LogicalDisk*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LogicalDisk_Provider::SaveProperties(
    const VESPERA_LogicalDisk*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LogicalDisk_Provider::RestoreProperties(
    const VESPERA_LogicalDisk*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
