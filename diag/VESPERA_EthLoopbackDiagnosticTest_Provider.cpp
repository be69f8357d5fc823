#include "VESPERA_EthLoopbackDiagnosticTest_Provider.h"

#include "DiagnosticProviders.h"

namespace OLMA
{

Load_Status VESPERA_EthLoopbackDiagnosticTest_Provider::load()
{
    return diagnosticTestLoad();
}

Unload_Status VESPERA_EthLoopbackDiagnosticTest_Provider::unload()
{
    return diagnosticTestUnload();
}

Enum_Instances_Status VESPERA_EthLoopbackDiagnosticTest_Provider::enum_instances(
    const VESPERA_EthLoopbackDiagnosticTest*,
    Enum_Instances_Handler<VESPERA_EthLoopbackDiagnosticTest>* handler)
{
    return enumDiagnosticInstances(ID_VESPERA_EthLoopbackDiagnosticTest, handler,
        DIAG_ANY_NUMBER, LL_WARN, "No ethloopback diagnostic test is available", false);
}

// Starts the Ethernet loopback test that the instance names (external or
// serdes) on an Ethernet port.
Invoke_Method_Status VESPERA_EthLoopbackDiagnosticTest_Provider::RunDiagnostic(
    const VESPERA_EthLoopbackDiagnosticTest* self,
    const CIM_ManagedElement* ManagedElement,
    const CIM_DiagnosticSetting*,
    const CIM_JobSettingData*,
    CIM_ConcreteJob*& Job,
    Property<uint32>& return_value)
{
    TLOG(LL_DBG, "Entering: %s", "RunDiagnostic");

    String deviceId;

    if (!diagnosticElement(ManagedElement, "VESPERA_EthernetPort", deviceId))
    {
        TLOG(LL_ERR, "Error: Invalid input object path!");
        diagnosticRefusal(Job, return_value, RUN_DIAG_RETURN_INVALID);
        return INVOKE_METHOD_OK;
    }

    String name = self && !self->Name.null ? self->Name.value : String();

    diagnosticOutcome(
        FCHBAManager::getFCHBAManager()->diagnosticHelper->runEthLoopbackTest(deviceId, name),
        Job, return_value);
    return INVOKE_METHOD_OK;
}

} // namespace OLMA
