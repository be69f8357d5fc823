#include "VESPERA_LoopbackDiagnosticTest_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_LoopbackDiagnosticTest_Provider::VESPERA_LoopbackDiagnosticTest_Provider()
{
}

VESPERA_LoopbackDiagnosticTest_Provider::~VESPERA_LoopbackDiagnosticTest_Provider()
{
}

Load_Status VESPERA_LoopbackDiagnosticTest_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_LoopbackDiagnosticTest_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_LoopbackDiagnosticTest_Provider::get_instance(const VESPERA_LoopbackDiagnosticTest*, VESPERA_LoopbackDiagnosticTest*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_LoopbackDiagnosticTest_Provider::enum_instances(
    const VESPERA_LoopbackDiagnosticTest*, Enum_Instances_Handler<VESPERA_LoopbackDiagnosticTest>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_LoopbackDiagnosticTest_Provider::create_instance(VESPERA_LoopbackDiagnosticTest*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_LoopbackDiagnosticTest_Provider::delete_instance(const VESPERA_LoopbackDiagnosticTest*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_LoopbackDiagnosticTest_Provider::modify_instance(const VESPERA_LoopbackDiagnosticTest*, const VESPERA_LoopbackDiagnosticTest*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LoopbackDiagnosticTest_Provider::RequestStateChange(
    const VESPERA_LoopbackDiagnosticTest*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LoopbackDiagnosticTest_Provider::StartService(
    const VESPERA_LoopbackDiagnosticTest*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LoopbackDiagnosticTest_Provider::StopService(
    const VESPERA_LoopbackDiagnosticTest*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LoopbackDiagnosticTest_Provider::ChangeAffectedElementsAssignedSequence(
    const VESPERA_LoopbackDiagnosticTest*,
    const Property<Array<CIM_ManagedElement*> >&,
    const Property<Array<uint16> >&,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LoopbackDiagnosticTest_Provider::RunDiagnostic(
    const VESPERA_LoopbackDiagnosticTest*,
    const CIM_ManagedElement*,
    const CIM_DiagnosticSetting*,
    const CIM_JobSettingData*,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LoopbackDiagnosticTest_Provider::RunDiagnosticService(
    const VESPERA_LoopbackDiagnosticTest*,
    const CIM_ManagedElement*,
    const Property<String>&,
    const Property<String>&,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LoopbackDiagnosticTest_Provider::RunTest(
    const VESPERA_LoopbackDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    const CIM_DiagnosticSetting*,
    CIM_DiagnosticResult*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LoopbackDiagnosticTest_Provider::ClearResults(
    const VESPERA_LoopbackDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    Property<Array<String> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_LoopbackDiagnosticTest_Provider::DiscontinueTest(
    const VESPERA_LoopbackDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    const CIM_DiagnosticResult*,
    Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
