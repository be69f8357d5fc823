#ifndef _VESPERA_MemoryDiagnosticTest_Provider_h
#define _VESPERA_MemoryDiagnosticTest_Provider_h

#include "Provider.h"
#include "VESPERA_MemoryDiagnosticTest.h"

namespace OLMA
{

// Serves VESPERA_MemoryDiagnosticTest: the memory test of an adapter, and
// RunDiagnostic on a VESPERA_PortController.
class VESPERA_MemoryDiagnosticTest_Provider
{
public:

    Load_Status load();
    Unload_Status unload();

    Enum_Instances_Status enum_instances(
        const VESPERA_MemoryDiagnosticTest* model, Enum_Instances_Handler<VESPERA_MemoryDiagnosticTest>* handler);

    Invoke_Method_Status RunDiagnostic(
        const VESPERA_MemoryDiagnosticTest* self,
        const CIM_ManagedElement* ManagedElement,
        const CIM_DiagnosticSetting* DiagSetting,
        const CIM_JobSettingData* JobSetting,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_MemoryDiagnosticTest_Provider_h
