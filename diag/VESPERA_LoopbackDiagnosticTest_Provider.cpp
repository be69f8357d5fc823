#include "VESPERA_LoopbackDiagnosticTest_Provider.h"

#include "DiagnosticProviders.h"

namespace OLMA
{

Load_Status VESPERA_LoopbackDiagnosticTest_Provider::load()
{
    return diagnosticTestLoad();
}

Unload_Status VESPERA_LoopbackDiagnosticTest_Provider::unload()
{
    return diagnosticTestUnload();
}

Enum_Instances_Status VESPERA_LoopbackDiagnosticTest_Provider::enum_instances(
    const VESPERA_LoopbackDiagnosticTest*,
    Enum_Instances_Handler<VESPERA_LoopbackDiagnosticTest>* handler)
{
    return enumDiagnosticInstances(ID_VESPERA_LoopbackDiagnosticTest, handler, DIAG_ANY_NUMBER,
        LL_WARN, "No loopback diagnostic test is available", false);
}

// Starts the loopback test that the instance names (internal, external or
// serdes) on an FC port.
Invoke_Method_Status VESPERA_LoopbackDiagnosticTest_Provider::RunDiagnostic(
    const VESPERA_LoopbackDiagnosticTest* self,
    const CIM_ManagedElement* ManagedElement,
    const CIM_DiagnosticSetting*,
    const CIM_JobSettingData*,
    CIM_ConcreteJob*& Job,
    Property<uint32>& return_value)
{
    TLOG(LL_DBG, "Entering: %s", "RunDiagnostic");

    String deviceId;

    if (!diagnosticElement(ManagedElement, "VESPERA_FCPort", deviceId))
    {
        TLOG(LL_ERR, "Error: Invalid input object path!");
        diagnosticRefusal(Job, return_value, RUN_DIAG_RETURN_INVALID);
        return INVOKE_METHOD_OK;
    }

    String name = self && !self->Name.null ? self->Name.value : String();

    diagnosticOutcome(
        FCHBAManager::getFCHBAManager()->diagnosticHelper->runLoopbackTest(deviceId, name),
        Job, return_value);
    return INVOKE_METHOD_OK;
}

} // namespace OLMA
