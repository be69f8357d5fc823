#include "VESPERA_ObjectManager_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

VESPERA_ObjectManager_Provider::VESPERA_ObjectManager_Provider()
{
}

VESPERA_ObjectManager_Provider::~VESPERA_ObjectManager_Provider()
{
}

Load_Status VESPERA_ObjectManager_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_ObjectManager_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_ObjectManager_Provider::get_instance(const VESPERA_ObjectManager*, VESPERA_ObjectManager*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_ObjectManager_Provider::enum_instances(
    const VESPERA_ObjectManager*, Enum_Instances_Handler<VESPERA_ObjectManager>* handler)
{
    return enumServerInstances(ID_VESPERA_ObjectManager, handler);
}

Create_Instance_Status VESPERA_ObjectManager_Provider::create_instance(VESPERA_ObjectManager*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_ObjectManager_Provider::delete_instance(const VESPERA_ObjectManager*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_ObjectManager_Provider::modify_instance(const VESPERA_ObjectManager*, const VESPERA_ObjectManager*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_ObjectManager_Provider::RequestStateChange(
    const VESPERA_ObjectManager*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_ObjectManager_Provider::StartService(
    const VESPERA_ObjectManager*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_ObjectManager_Provider::StopService(
    const VESPERA_ObjectManager*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_ObjectManager_Provider::ChangeAffectedElementsAssignedSequence(
    const VESPERA_ObjectManager*,
    const Property<Array<CIM_ManagedElement*> >&,
    const Property<Array<uint16> >&,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
