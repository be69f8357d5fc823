#ifndef _VESPERA_AvailableDiagnosticServiceForAdapter_Provider_h
#define _VESPERA_AvailableDiagnosticServiceForAdapter_Provider_h

#include "Provider.h"
#include "VESPERA_AvailableDiagnosticServiceForAdapter.h"

namespace OLMA
{

// Serves VESPERA_AvailableDiagnosticServiceForAdapter: each adapter test with each
// adapter. Enumeration only; the bridge walks the associations.
class VESPERA_AvailableDiagnosticServiceForAdapter_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_AvailableDiagnosticServiceForAdapter* model, Enum_Instances_Handler<VESPERA_AvailableDiagnosticServiceForAdapter>* handler);
};

} // namespace OLMA

#endif // _VESPERA_AvailableDiagnosticServiceForAdapter_Provider_h
