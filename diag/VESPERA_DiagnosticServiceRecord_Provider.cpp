#include "VESPERA_DiagnosticServiceRecord_Provider.h"

#include "DiagnosticProviders.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_DiagnosticServiceRecord_Provider::enum_instances(
    const VESPERA_DiagnosticServiceRecord*, Enum_Instances_Handler<VESPERA_DiagnosticServiceRecord>* handler)
{
    return enumDiagnosticInstances(ID_VESPERA_DiagnosticServiceRecord, handler, DIAG_ANY_NUMBER, LL_INFO,
        "No diagnostic service records are available.", true);
}

} // namespace OLMA
