#ifndef _VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider_h
#define _VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider_h

namespace OLMA
{

// Serves VESPERA_HBASoftwareInstallationServiceElementCapabilities. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider_h
