#include "VESPERA_EthLoopbackDiagnosticTest_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_EthLoopbackDiagnosticTest_Provider::VESPERA_EthLoopbackDiagnosticTest_Provider()
{
}

VESPERA_EthLoopbackDiagnosticTest_Provider::~VESPERA_EthLoopbackDiagnosticTest_Provider()
{
}

Load_Status VESPERA_EthLoopbackDiagnosticTest_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_EthLoopbackDiagnosticTest_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_EthLoopbackDiagnosticTest_Provider::get_instance(const VESPERA_EthLoopbackDiagnosticTest*, VESPERA_EthLoopbackDiagnosticTest*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_EthLoopbackDiagnosticTest_Provider::enum_instances(
    const VESPERA_EthLoopbackDiagnosticTest*, Enum_Instances_Handler<VESPERA_EthLoopbackDiagnosticTest>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_EthLoopbackDiagnosticTest_Provider::create_instance(VESPERA_EthLoopbackDiagnosticTest*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_EthLoopbackDiagnosticTest_Provider::delete_instance(const VESPERA_EthLoopbackDiagnosticTest*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_EthLoopbackDiagnosticTest_Provider::modify_instance(const VESPERA_EthLoopbackDiagnosticTest*, const VESPERA_EthLoopbackDiagnosticTest*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthLoopbackDiagnosticTest_Provider::RequestStateChange(
    const VESPERA_EthLoopbackDiagnosticTest*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthLoopbackDiagnosticTest_Provider::StartService(
    const VESPERA_EthLoopbackDiagnosticTest*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthLoopbackDiagnosticTest_Provider::StopService(
    const VESPERA_EthLoopbackDiagnosticTest*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthLoopbackDiagnosticTest_Provider::ChangeAffectedElementsAssignedSequence(
    const VESPERA_EthLoopbackDiagnosticTest*,
    const Property<Array<CIM_ManagedElement*> >&,
    const Property<Array<uint16> >&,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthLoopbackDiagnosticTest_Provider::RunDiagnostic(
    const VESPERA_EthLoopbackDiagnosticTest*,
    const CIM_ManagedElement*,
    const CIM_DiagnosticSetting*,
    const CIM_JobSettingData*,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthLoopbackDiagnosticTest_Provider::RunDiagnosticService(
    const VESPERA_EthLoopbackDiagnosticTest*,
    const CIM_ManagedElement*,
    const Property<String>&,
    const Property<String>&,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthLoopbackDiagnosticTest_Provider::RunTest(
    const VESPERA_EthLoopbackDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    const CIM_DiagnosticSetting*,
    CIM_DiagnosticResult*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthLoopbackDiagnosticTest_Provider::ClearResults(
    const VESPERA_EthLoopbackDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    Property<Array<String> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_EthLoopbackDiagnosticTest_Provider::DiscontinueTest(
    const VESPERA_EthLoopbackDiagnosticTest*,
    const CIM_ManagedSystemElement*,
    const CIM_DiagnosticResult*,
    Property<bool>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
