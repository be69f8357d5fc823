#ifndef _VESPERA_MemoryDiagnosticTest_Provider_h
#define _VESPERA_MemoryDiagnosticTest_Provider_h

#include "Provider.h"
#include "VESPERA_MemoryDiagnosticTest.h"
#include "CIM_ConcreteJob.h"
#include "CIM_DiagnosticResult.h"
#include "CIM_DiagnosticSetting.h"
#include "CIM_JobSettingData.h"
#include "CIM_ManagedElement.h"
#include "CIM_ManagedSystemElement.h"

namespace OLMA
{

// Serves VESPERA_MemoryDiagnosticTest. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_MemoryDiagnosticTest_Provider
{
public:

    VESPERA_MemoryDiagnosticTest_Provider();

    ~VESPERA_MemoryDiagnosticTest_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_MemoryDiagnosticTest* model, VESPERA_MemoryDiagnosticTest*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_MemoryDiagnosticTest* model, Enum_Instances_Handler<VESPERA_MemoryDiagnosticTest>* handler);

    Create_Instance_Status create_instance(VESPERA_MemoryDiagnosticTest* instance);

    Delete_Instance_Status delete_instance(const VESPERA_MemoryDiagnosticTest* instance);

    Modify_Instance_Status modify_instance(const VESPERA_MemoryDiagnosticTest* model, const VESPERA_MemoryDiagnosticTest* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_MemoryDiagnosticTest* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status StartService(
        const VESPERA_MemoryDiagnosticTest* self,
        Property<uint32>& return_value);

    Invoke_Method_Status StopService(
        const VESPERA_MemoryDiagnosticTest* self,
        Property<uint32>& return_value);

    Invoke_Method_Status ChangeAffectedElementsAssignedSequence(
        const VESPERA_MemoryDiagnosticTest* self,
        const Property<Array<CIM_ManagedElement*> >& ManagedElements,
        const Property<Array<uint16> >& AssignedSequence,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);

    Invoke_Method_Status RunDiagnostic(
        const VESPERA_MemoryDiagnosticTest* self,
        const CIM_ManagedElement* ManagedElement,
        const CIM_DiagnosticSetting* DiagSetting,
        const CIM_JobSettingData* JobSetting,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);

    Invoke_Method_Status RunDiagnosticService(
        const VESPERA_MemoryDiagnosticTest* self,
        const CIM_ManagedElement* ManagedElement,
        const Property<String>& DiagnosticSettings,
        const Property<String>& JobSettings,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);

    Invoke_Method_Status RunTest(
        const VESPERA_MemoryDiagnosticTest* self,
        const CIM_ManagedSystemElement* SystemElement,
        const CIM_DiagnosticSetting* Setting,
        CIM_DiagnosticResult*& Result,
        Property<uint32>& return_value);

    Invoke_Method_Status ClearResults(
        const VESPERA_MemoryDiagnosticTest* self,
        const CIM_ManagedSystemElement* SystemElement,
        Property<Array<String> >& ResultsNotCleared,
        Property<uint32>& return_value);

    Invoke_Method_Status DiscontinueTest(
        const VESPERA_MemoryDiagnosticTest* self,
        const CIM_ManagedSystemElement* SystemElement,
        const CIM_DiagnosticResult* Result,
        Property<bool>& TestingStopped,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_MemoryDiagnosticTest_Provider_h
