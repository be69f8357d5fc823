#ifndef _VESPERA_AvailableDiagnosticServiceForEthernetPort_Provider_h
#define _VESPERA_AvailableDiagnosticServiceForEthernetPort_Provider_h

#include "Provider.h"
#include "VESPERA_AvailableDiagnosticServiceForEthernetPort.h"

namespace OLMA
{

// Serves VESPERA_AvailableDiagnosticServiceForEthernetPort: each Ethernet port test with
// each Ethernet port. Enumeration only; the bridge walks the associations.
class VESPERA_AvailableDiagnosticServiceForEthernetPort_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_AvailableDiagnosticServiceForEthernetPort* model, Enum_Instances_Handler<VESPERA_AvailableDiagnosticServiceForEthernetPort>* handler);
};

} // namespace OLMA

#endif // _VESPERA_AvailableDiagnosticServiceForEthernetPort_Provider_h
