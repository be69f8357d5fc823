#ifndef _VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider_h
#define _VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider_h

#include "Provider.h"
#include "VESPERA_HBASoftwareInstallationServiceElementCapabilities.h"

namespace OLMA
{

// Serves VESPERA_HBASoftwareInstallationServiceElementCapabilities: the software
// installation service with its capabilities. Enumeration only; the bridge walks the
// associations.
class VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_HBASoftwareInstallationServiceElementCapabilities* model, Enum_Instances_Handler<VESPERA_HBASoftwareInstallationServiceElementCapabilities>* handler);
};

} // namespace OLMA

#endif // _VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider_h
