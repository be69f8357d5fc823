#ifndef _VESPERA_HBASoftwareInstallationServiceHostedService_Provider_h
#define _VESPERA_HBASoftwareInstallationServiceHostedService_Provider_h

namespace OLMA
{

// Serves VESPERA_HBASoftwareInstallationServiceHostedService. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_HBASoftwareInstallationServiceHostedService_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_HBASoftwareInstallationServiceHostedService_Provider_h
