#ifndef _VESPERA_DiagnosticSoftwareIdentity_Provider_h
#define _VESPERA_DiagnosticSoftwareIdentity_Provider_h

#include "Provider.h"
#include "VESPERA_DiagnosticSoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_DiagnosticSoftwareIdentity: the diagnostic software. Enumeration only.
class VESPERA_DiagnosticSoftwareIdentity_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_DiagnosticSoftwareIdentity* model, Enum_Instances_Handler<VESPERA_DiagnosticSoftwareIdentity>* handler);
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticSoftwareIdentity_Provider_h
