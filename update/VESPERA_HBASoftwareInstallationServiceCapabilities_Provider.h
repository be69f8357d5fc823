#ifndef _VESPERA_HBASoftwareInstallationServiceCapabilities_Provider_h
#define _VESPERA_HBASoftwareInstallationServiceCapabilities_Provider_h

namespace OLMA
{

// Serves VESPERA_HBASoftwareInstallationServiceCapabilities. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_HBASoftwareInstallationServiceCapabilities_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_HBASoftwareInstallationServiceCapabilities_Provider_h
