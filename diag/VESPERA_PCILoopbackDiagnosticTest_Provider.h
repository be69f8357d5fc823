#ifndef _VESPERA_PCILoopbackDiagnosticTest_Provider_h
#define _VESPERA_PCILoopbackDiagnosticTest_Provider_h

#include "Provider.h"
#include "VESPERA_PCILoopbackDiagnosticTest.h"

namespace OLMA
{

// Serves VESPERA_PCILoopbackDiagnosticTest: the PCI loopback test, and
// RunDiagnostic on a VESPERA_FCPort or a VESPERA_EthernetPort.
class VESPERA_PCILoopbackDiagnosticTest_Provider
{
public:

    Load_Status load();
    Unload_Status unload();

    Enum_Instances_Status enum_instances(
        const VESPERA_PCILoopbackDiagnosticTest* model, Enum_Instances_Handler<VESPERA_PCILoopbackDiagnosticTest>* handler);

    Invoke_Method_Status RunDiagnostic(
        const VESPERA_PCILoopbackDiagnosticTest* self,
        const CIM_ManagedElement* ManagedElement,
        const CIM_DiagnosticSetting* DiagSetting,
        const CIM_JobSettingData* JobSetting,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_PCILoopbackDiagnosticTest_Provider_h
