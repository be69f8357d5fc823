#include "VESPERA_PCILoopbackDiagnosticTest_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_PCILoopbackDiagnosticTest_Provider::VESPERA_PCILoopbackDiagnosticTest_Provider()
{
}

VESPERA_PCILoopbackDiagnosticTest_Provider::~VESPERA_PCILoopbackDiagnosticTest_Provider()
{
}

Load_Status VESPERA_PCILoopbackDiagnosticTest_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_PCILoopbackDiagnosticTest_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_PCILoopbackDiagnosticTest_Provider::get_instance(const VESPERA_PCILoopbackDiagnosticTest*, VESPERA_PCILoopbackDiagnosticTest*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_PCILoopbackDiagnosticTest_Provider::enum_instances(
    const VESPERA_PCILoopbackDiagnosticTest*, Enum_Instances_Handler<VESPERA_PCILoopbackDiagnosticTest>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_PCILoopbackDiagnosticTest_Provider::create_instance(VESPERA_PCILoopbackDiagnosticTest*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_PCILoopbackDiagnosticTest_Provider::delete_instance(const VESPERA_PCILoopbackDiagnosticTest*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_PCILoopbackDiagnosticTest_Provider::modify_instance(const VESPERA_PCILoopbackDiagnosticTest*, const VESPERA_PCILoopbackDiagnosticTest*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PCILoopbackDiagnosticTest_Provider::RequestStateChange(
    const VESPERA_PCILoopbackDiagnosticTest*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PCILoopbackDiagnosticTest_Provider::StartService(
    const VESPERA_PCILoopbackDiagnosticTest*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PCILoopbackDiagnosticTest_Provider::StopService(
    const VESPERA_PCILoopbackDiagnosticTest*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PCILoopbackDiagnosticTest_Provider::ChangeAffectedElementsAssignedSequence(
    const VESPERA_PCILoopbackDiagnosticTest*,
    const Property<Array<CIM_ManagedElement*> >&,
    const Property<Array<uint16> >&,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PCILoopbackDiagnosticTest_Provider::RunDiagnostic(
    const VESPERA_PCILoopbackDiagnosticTest*,
    const CIM_ManagedElement*,
    const CIM_DiagnosticSetting*,
    const CIM_JobSettingData*,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PCILoopbackDiagnosticTest_Provider::RunDiagnosticService(
    const VESPERA_PCILoopbackDiagnosticTest*,
    const CIM_ManagedElement*,
    const Property<String>&,
    const Property<String>&,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PCILoopbackDiagnosticTest_Provider::RunTest(
    const VESPERA_PCILoopbackDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    const CIM_DiagnosticSetting*,
    CIM_DiagnosticResult*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PCILoopbackDiagnosticTest_Provider::ClearResults(
    const VESPERA_PCILoopbackDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    Property<Array<String> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PCILoopbackDiagnosticTest_Provider::DiscontinueTest(
    const VESPERA_PCILoopbackDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    const CIM_DiagnosticResult*,
    Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
