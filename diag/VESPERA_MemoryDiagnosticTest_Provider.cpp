#include "VESPERA_MemoryDiagnosticTest_Provider.h"

#include "DiagnosticProviders.h"

namespace OLMA
{

Load_Status VESPERA_MemoryDiagnosticTest_Provider::load()
{
    return diagnosticTestLoad();
}

Unload_Status VESPERA_MemoryDiagnosticTest_Provider::unload()
{
    return diagnosticTestUnload();
}

Enum_Instances_Status VESPERA_MemoryDiagnosticTest_Provider::enum_instances(
    const VESPERA_MemoryDiagnosticTest*,
    Enum_Instances_Handler<VESPERA_MemoryDiagnosticTest>* handler)
{
    return enumDiagnosticInstances(ID_VESPERA_MemoryDiagnosticTest, handler, DIAG_EXACTLY_ONE,
        LL_WARN, "No memory diagnostic test is available", false);
}

// Starts the memory test of an adapter. The outcome of the request is in
// return_value; that of the test comes later, in the records.
Invoke_Method_Status VESPERA_MemoryDiagnosticTest_Provider::RunDiagnostic(
    const VESPERA_MemoryDiagnosticTest*,
    const CIM_ManagedElement* ManagedElement,
    const CIM_DiagnosticSetting*,
    const CIM_JobSettingData*,
    CIM_ConcreteJob*& Job,
    Property<uint32>& return_value)
{
    TLOG(LL_DBG, "Entering: %s", "RunDiagnostic");

    String deviceId;

    if (!diagnosticElement(ManagedElement, "VESPERA_PortController", deviceId))
    {
        TLOG(LL_ERR, "Error: Invalid input object path!");
        diagnosticRefusal(Job, return_value, RUN_DIAG_RETURN_INVALID);
        return INVOKE_METHOD_OK;
    }

    diagnosticOutcome(FCHBAManager::getFCHBAManager()->diagnosticHelper->runMemoryTest(deviceId),
        Job, return_value);
    return INVOKE_METHOD_OK;
}

} // namespace OLMA
