#ifndef _VESPERA_HBASoftwareInstallationService_Provider_h
#define _VESPERA_HBASoftwareInstallationService_Provider_h

namespace OLMA
{

// Serves VESPERA_HBASoftwareInstallationService. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_HBASoftwareInstallationService_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_HBASoftwareInstallationService_Provider_h
