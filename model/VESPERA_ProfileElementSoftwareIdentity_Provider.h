#ifndef _VESPERA_ProfileElementSoftwareIdentity_Provider_h
#define _VESPERA_ProfileElementSoftwareIdentity_Provider_h

namespace OLMA
{

// Serves VESPERA_ProfileElementSoftwareIdentity. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ProfileElementSoftwareIdentity_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_ProfileElementSoftwareIdentity_Provider_h
