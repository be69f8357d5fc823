#include "VESPERA_MemoryDiagnosticTest_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_MemoryDiagnosticTest_Provider::VESPERA_MemoryDiagnosticTest_Provider()
{
}

VESPERA_MemoryDiagnosticTest_Provider::~VESPERA_MemoryDiagnosticTest_Provider()
{
}

Load_Status VESPERA_MemoryDiagnosticTest_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_MemoryDiagnosticTest_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_MemoryDiagnosticTest_Provider::get_instance(const VESPERA_MemoryDiagnosticTest*, VESPERA_MemoryDiagnosticTest*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_MemoryDiagnosticTest_Provider::enum_instances(
    const VESPERA_MemoryDiagnosticTest*, Enum_Instances_Handler<VESPERA_MemoryDiagnosticTest>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_MemoryDiagnosticTest_Provider::create_instance(VESPERA_MemoryDiagnosticTest*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_MemoryDiagnosticTest_Provider::delete_instance(const VESPERA_MemoryDiagnosticTest*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_MemoryDiagnosticTest_Provider::modify_instance(const VESPERA_MemoryDiagnosticTest*, const VESPERA_MemoryDiagnosticTest*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_MemoryDiagnosticTest_Provider::RequestStateChange(
    const VESPERA_MemoryDiagnosticTest*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_MemoryDiagnosticTest_Provider::StartService(
    const VESPERA_MemoryDiagnosticTest*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_MemoryDiagnosticTest_Provider::StopService(
    const VESPERA_MemoryDiagnosticTest*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_MemoryDiagnosticTest_Provider::ChangeAffectedElementsAssignedSequence(
    const VESPERA_MemoryDiagnosticTest*,
    const Property<Array<CIM_ManagedElement*> >&,
    const Property<Array<uint16> >&,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_MemoryDiagnosticTest_Provider::RunDiagnostic(
    const VESPERA_MemoryDiagnosticTest*,
    const CIM_ManagedElement*,
    const CIM_DiagnosticSetting*,
    const CIM_JobSettingData*,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_MemoryDiagnosticTest_Provider::RunDiagnosticService(
    const VESPERA_MemoryDiagnosticTest*,
    const CIM_ManagedElement*,
    const Property<String>&,
    const Property<String>&,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_MemoryDiagnosticTest_Provider::RunTest(
    const VESPERA_MemoryDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    const CIM_DiagnosticSetting*,
    CIM_DiagnosticResult*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_MemoryDiagnosticTest_Provider::ClearResults(
    const VESPERA_MemoryDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    Property<Array<String> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_MemoryDiagnosticTest_Provider::DiscontinueTest(
    const VESPERA_MemoryDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    const CIM_DiagnosticResult*,
    Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
