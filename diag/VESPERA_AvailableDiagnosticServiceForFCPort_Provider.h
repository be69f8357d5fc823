#ifndef _VESPERA_AvailableDiagnosticServiceForFCPort_Provider_h
#define _VESPERA_AvailableDiagnosticServiceForFCPort_Provider_h

#include "Provider.h"
#include "VESPERA_AvailableDiagnosticServiceForFCPort.h"

namespace OLMA
{

// Serves VESPERA_AvailableDiagnosticServiceForFCPort: each FC port test with each FC port
// that can run it. Enumeration only; the bridge walks the associations.
class VESPERA_AvailableDiagnosticServiceForFCPort_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_AvailableDiagnosticServiceForFCPort* model, Enum_Instances_Handler<VESPERA_AvailableDiagnosticServiceForFCPort>* handler);
};

} // namespace OLMA

#endif // _VESPERA_AvailableDiagnosticServiceForFCPort_Provider_h
