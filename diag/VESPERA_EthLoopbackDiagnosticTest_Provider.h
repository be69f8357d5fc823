#ifndef _VESPERA_EthLoopbackDiagnosticTest_Provider_h
#define _VESPERA_EthLoopbackDiagnosticTest_Provider_h

#include "Provider.h"
#include "VESPERA_EthLoopbackDiagnosticTest.h"

namespace OLMA
{

// Serves VESPERA_EthLoopbackDiagnosticTest: the external and serdes
// loopback tests of an Ethernet port, and RunDiagnostic on a VESPERA_EthernetPort.
class VESPERA_EthLoopbackDiagnosticTest_Provider
{
public:

    Load_Status load();
    Unload_Status unload();

    Enum_Instances_Status enum_instances(
        const VESPERA_EthLoopbackDiagnosticTest* model, Enum_Instances_Handler<VESPERA_EthLoopbackDiagnosticTest>* handler);

    Invoke_Method_Status RunDiagnostic(
        const VESPERA_EthLoopbackDiagnosticTest* self,
        const CIM_ManagedElement* ManagedElement,
        const CIM_DiagnosticSetting* DiagSetting,
        const CIM_JobSettingData* JobSetting,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_EthLoopbackDiagnosticTest_Provider_h
