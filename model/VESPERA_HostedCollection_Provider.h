#ifndef _VESPERA_HostedCollection_Provider_h
#define _VESPERA_HostedCollection_Provider_h

namespace OLMA
{

// Serves VESPERA_HostedCollection. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_HostedCollection_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_HostedCollection_Provider_h
