#ifndef _VESPERA_DiagnosticElementSoftwareIdentity_Provider_h
#define _VESPERA_DiagnosticElementSoftwareIdentity_Provider_h

#include "Provider.h"
#include "VESPERA_DiagnosticElementSoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_DiagnosticElementSoftwareIdentity: the diagnostic software with each
// test. Enumeration only; the bridge walks the associations.
class VESPERA_DiagnosticElementSoftwareIdentity_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_DiagnosticElementSoftwareIdentity* model, Enum_Instances_Handler<VESPERA_DiagnosticElementSoftwareIdentity>* handler);
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticElementSoftwareIdentity_Provider_h
