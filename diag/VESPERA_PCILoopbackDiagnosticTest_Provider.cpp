#include "VESPERA_PCILoopbackDiagnosticTest_Provider.h"

#include "DiagnosticProviders.h"

namespace OLMA
{

Load_Status VESPERA_PCILoopbackDiagnosticTest_Provider::load()
{
    return diagnosticTestLoad();
}

Unload_Status VESPERA_PCILoopbackDiagnosticTest_Provider::unload()
{
    return diagnosticTestUnload();
}

Enum_Instances_Status VESPERA_PCILoopbackDiagnosticTest_Provider::enum_instances(
    const VESPERA_PCILoopbackDiagnosticTest*,
    Enum_Instances_Handler<VESPERA_PCILoopbackDiagnosticTest>* handler)
{
    return enumDiagnosticInstances(ID_VESPERA_PCILoopbackDiagnosticTest, handler,
        DIAG_EXACTLY_ONE, LL_WARN, "No PCI loopback diagnostic test is available", false);
}

// Starts the PCI loopback test of an FC or an Ethernet port; the port stays
// in service.
Invoke_Method_Status VESPERA_PCILoopbackDiagnosticTest_Provider::RunDiagnostic(
    const VESPERA_PCILoopbackDiagnosticTest*,
    const CIM_ManagedElement* ManagedElement,
    const CIM_DiagnosticSetting*,
    const CIM_JobSettingData*,
    CIM_ConcreteJob*& Job,
    Property<uint32>& return_value)
{
    TLOG(LL_DBG, "Entering: %s", "RunDiagnostic");

    String deviceId;

    if (diagnosticElement(ManagedElement, "VESPERA_FCPort", deviceId))
    {
        TLOG(LL_INFO, "PCI Loopback Test is requested for FC Port");
    }
    else if (diagnosticElement(ManagedElement, "VESPERA_EthernetPort", deviceId))
    {
        TLOG(LL_INFO, "PCI Loopback Test is requested for Ethernet Port");
    }
    else
    {
        TLOG(LL_ERR, "Error: Invalid input object path!");
        diagnosticRefusal(Job, return_value, RUN_DIAG_RETURN_INVALID);
        return INVOKE_METHOD_OK;
    }

    diagnosticOutcome(
        FCHBAManager::getFCHBAManager()->diagnosticHelper->runPCILoopbackTest(deviceId),
        Job, return_value);
    return INVOKE_METHOD_OK;
}

} // namespace OLMA
