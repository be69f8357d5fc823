#include "VESPERA_DiagnosticCompletionRecord_Provider.h"

#include "DiagnosticProviders.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_DiagnosticCompletionRecord_Provider::enum_instances(
    const VESPERA_DiagnosticCompletionRecord*, Enum_Instances_Handler<VESPERA_DiagnosticCompletionRecord>* handler)
{
    return enumDiagnosticInstances(ID_VESPERA_DiagnosticCompletionRecord, handler, DIAG_ANY_NUMBER, LL_INFO,
        "No completion records are available.", true);
}

} // namespace OLMA
