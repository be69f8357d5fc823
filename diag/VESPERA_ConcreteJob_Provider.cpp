#include "VESPERA_ConcreteJob_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_ConcreteJob_Provider::VESPERA_ConcreteJob_Provider()
{
}

VESPERA_ConcreteJob_Provider::~VESPERA_ConcreteJob_Provider()
{
}

Load_Status VESPERA_ConcreteJob_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_ConcreteJob_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_ConcreteJob_Provider::get_instance(const VESPERA_ConcreteJob*, VESPERA_ConcreteJob*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_ConcreteJob_Provider::enum_instances(
    const VESPERA_ConcreteJob*, Enum_Instances_Handler<VESPERA_ConcreteJob>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_ConcreteJob_Provider::create_instance(VESPERA_ConcreteJob*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_ConcreteJob_Provider::delete_instance(const VESPERA_ConcreteJob*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_ConcreteJob_Provider::modify_instance(const VESPERA_ConcreteJob*, const VESPERA_ConcreteJob*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_ConcreteJob_Provider::KillJob(
    const VESPERA_ConcreteJob*,
    const Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_ConcreteJob_Provider::RequestStateChange(
    const VESPERA_ConcreteJob*,
    const Property<uint16>&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_ConcreteJob_Provider::GetError(
    const VESPERA_ConcreteJob*,
    Property<String>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_ConcreteJob_Provider::GetErrors(
    const VESPERA_ConcreteJob*,
    Property<Array<String> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
