#ifndef _VESPERA_HBASoftwareInstallationServiceHostedService_Provider_h
#define _VESPERA_HBASoftwareInstallationServiceHostedService_Provider_h

#include "Provider.h"
#include "VESPERA_HBASoftwareInstallationServiceHostedService.h"

namespace OLMA
{

// Serves VESPERA_HBASoftwareInstallationServiceHostedService: the host with the software
// installation service. Enumeration only; the bridge walks the associations.
class VESPERA_HBASoftwareInstallationServiceHostedService_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_HBASoftwareInstallationServiceHostedService* model, Enum_Instances_Handler<VESPERA_HBASoftwareInstallationServiceHostedService>* handler);
};

} // namespace OLMA

#endif // _VESPERA_HBASoftwareInstallationServiceHostedService_Provider_h
