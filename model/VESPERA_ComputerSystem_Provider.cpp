#include "VESPERA_ComputerSystem_Provider.h"
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
    const VESPERA_ComputerSystem*, Enum_Instances_Handler<VESPERA_ComputerSystem>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
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
