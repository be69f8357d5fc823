#include "VESPERA_DiagnosticSoftwareIdentity_Provider.h"

#include "DiagnosticProviders.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_DiagnosticSoftwareIdentity_Provider::enum_instances(
    const VESPERA_DiagnosticSoftwareIdentity*, Enum_Instances_Handler<VESPERA_DiagnosticSoftwareIdentity>* handler)
{
    return enumDiagnosticInstances(ID_VESPERA_DiagnosticSoftwareIdentity, handler, DIAG_EXACTLY_ONE, LL_WARN,
        "No diagnostic software is installed", false);
}

} // namespace OLMA
