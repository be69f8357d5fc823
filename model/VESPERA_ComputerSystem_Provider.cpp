#include "VESPERA_ComputerSystem_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_ComputerSystem_Provider::VESPERA_ComputerSystem_Provider()
{
}

VESPERA_ComputerSystem_Provider::~VESPERA_ComputerSystem_Provider()
{
}

Load_Status VESPERA_ComputerSystem_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_ComputerSystem_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_ComputerSystem_Provider::get_instance(const VESPERA_ComputerSystem*, VESPERA_ComputerSystem*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_ComputerSystem_Provider::enum_instances(
    const VESPERA_ComputerSystem*, Enum_Instances_Handler<VESPERA_ComputerSystem>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_ComputerSystem);

    // Everything else hangs off the one host; two or none means the
    // mapping of the host is broken, not that there is nothing to show.
    if (instances.size() != 1)
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

Create_Instance_Status VESPERA_ComputerSystem_Provider::create_instance(VESPERA_ComputerSystem*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_ComputerSystem_Provider::delete_instance(const VESPERA_ComputerSystem*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_ComputerSystem_Provider::modify_instance(const VESPERA_ComputerSystem*, const VESPERA_ComputerSystem*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_ComputerSystem_Provider::RequestStateChange(
    const VESPERA_ComputerSystem*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_ComputerSystem_Provider::SetPowerState(
    const VESPERA_ComputerSystem*,
    const Property<uint32>&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
