#ifndef _VESPERA_AdapterElementSoftwareIdentity_Provider_h
#define _VESPERA_AdapterElementSoftwareIdentity_Provider_h

namespace OLMA
{

// Serves VESPERA_AdapterElementSoftwareIdentity. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_AdapterElementSoftwareIdentity_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_AdapterElementSoftwareIdentity_Provider_h
