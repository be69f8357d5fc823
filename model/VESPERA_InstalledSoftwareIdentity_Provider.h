#ifndef _VESPERA_InstalledSoftwareIdentity_Provider_h
#define _VESPERA_InstalledSoftwareIdentity_Provider_h

namespace OLMA
{

// Serves VESPERA_InstalledSoftwareIdentity. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_InstalledSoftwareIdentity_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_InstalledSoftwareIdentity_Provider_h
