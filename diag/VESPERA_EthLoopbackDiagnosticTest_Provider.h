#ifndef _VESPERA_EthLoopbackDiagnosticTest_Provider_h
#define _VESPERA_EthLoopbackDiagnosticTest_Provider_h

#include "Provider.h"
#include "VESPERA_EthLoopbackDiagnosticTest.h"
#include "CIM_ConcreteJob.h"
#include "CIM_DiagnosticResult.h"
#include "CIM_DiagnosticSetting.h"
#include "CIM_JobSettingData.h"
#include "CIM_ManagedElement.h"
#include "CIM_ManagedSystemElement.h"

namespace OLMA
{

// Serves VESPERA_EthLoopbackDiagnosticTest. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_EthLoopbackDiagnosticTest_Provider
{
public:

    VESPERA_EthLoopbackDiagnosticTest_Provider();

    ~VESPERA_EthLoopbackDiagnosticTest_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_EthLoopbackDiagnosticTest* model, VESPERA_EthLoopbackDiagnosticTest*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_EthLoopbackDiagnosticTest* model, Enum_Instances_Handler<VESPERA_EthLoopbackDiagnosticTest>* handler);

    Create_Instance_Status create_instance(VESPERA_EthLoopbackDiagnosticTest* instance);

    Delete_Instance_Status delete_instance(const VESPERA_EthLoopbackDiagnosticTest* instance);

    Modify_Instance_Status modify_instance(const VESPERA_EthLoopbackDiagnosticTest* model, const VESPERA_EthLoopbackDiagnosticTest* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_EthLoopbackDiagnosticTest* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status StartService(
        const VESPERA_EthLoopbackDiagnosticTest* self,
        Property<uint32>& return_value);

    Invoke_Method_Status StopService(
        const VESPERA_EthLoopbackDiagnosticTest* self,
        Property<uint32>& return_value);

    Invoke_Method_Status ChangeAffectedElementsAssignedSequence(
        const VESPERA_EthLoopbackDiagnosticTest* self,
        const Property<Array<CIM_ManagedElement*> >& ManagedElements,
        const Property<Array<uint16> >& AssignedSequence,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);

    Invoke_Method_Status RunDiagnostic(
        const VESPERA_EthLoopbackDiagnosticTest* self,
        const CIM_ManagedElement* ManagedElement,
        const CIM_DiagnosticSetting* DiagSetting,
        const CIM_JobSettingData* JobSetting,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);

    Invoke_Method_Status RunDiagnosticService(
        const VESPERA_EthLoopbackDiagnosticTest* self,
        const CIM_ManagedElement* ManagedElement,
        const Property<String>& DiagnosticSettings,
        const Property<String>& JobSettings,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);

    Invoke_Method_Status RunTest(
        const VESPERA_EthLoopbackDiagnosticTest* self,
        const CIM_ManagedSystemElement* SystemElement,
        const CIM_DiagnosticSetting* Setting,
        CIM_DiagnosticResult*& Result,
        Property<uint32>& return_value);

    Invoke_Method_Status ClearResults(
        const VESPERA_EthLoopbackDiagnosticTest* self,
        const CIM_ManagedSystemElement* SystemElement,
        Property<Array<String> >& ResultsNotCleared,
        Property<uint32>& return_value);

    Invoke_Method_Status DiscontinueTest(
        const VESPERA_EthLoopbackDiagnosticTest* self,
        const CIM_ManagedSystemElement* SystemElement,
        const CIM_DiagnosticResult* Result,
        Property<bool>& TestingStopped,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_EthLoopbackDiagnosticTest_Provider_h
