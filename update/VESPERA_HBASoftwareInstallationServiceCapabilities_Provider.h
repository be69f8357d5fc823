#ifndef _VESPERA_HBASoftwareInstallationServiceCapabilities_Provider_h
#define _VESPERA_HBASoftwareInstallationServiceCapabilities_Provider_h

#include "Provider.h"
#include "VESPERA_HBASoftwareInstallationServiceCapabilities.h"

namespace OLMA
{

// Serves VESPERA_HBASoftwareInstallationServiceCapabilities: what the
// software installation service can do, one instance for the host.
class VESPERA_HBASoftwareInstallationServiceCapabilities_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_HBASoftwareInstallationServiceCapabilities* model,
        Enum_Instances_Handler<VESPERA_HBASoftwareInstallationServiceCapabilities>* handler);
};

} // namespace OLMA

#endif // _VESPERA_HBASoftwareInstallationServiceCapabilities_Provider_h
