#ifndef _VESPERA_LoopbackDiagnosticTest_Provider_h
#define _VESPERA_LoopbackDiagnosticTest_Provider_h

#include "Provider.h"
#include "VESPERA_LoopbackDiagnosticTest.h"

namespace OLMA
{

// Serves VESPERA_LoopbackDiagnosticTest: the internal, external and serdes
// loopback tests, and RunDiagnostic on a VESPERA_FCPort.
class VESPERA_LoopbackDiagnosticTest_Provider
{
public:

    Load_Status load();
    Unload_Status unload();

    Enum_Instances_Status enum_instances(
        const VESPERA_LoopbackDiagnosticTest* model, Enum_Instances_Handler<VESPERA_LoopbackDiagnosticTest>* handler);

    Invoke_Method_Status RunDiagnostic(
        const VESPERA_LoopbackDiagnosticTest* self,
        const CIM_ManagedElement* ManagedElement,
        const CIM_DiagnosticSetting* DiagSetting,
        const CIM_JobSettingData* JobSetting,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_LoopbackDiagnosticTest_Provider_h
