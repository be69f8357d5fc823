#ifndef _VESPERA_RemoteServiceHostedAccessPoint_Provider_h
#define _VESPERA_RemoteServiceHostedAccessPoint_Provider_h

namespace OLMA
{

// Serves VESPERA_RemoteServiceHostedAccessPoint. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_RemoteServiceHostedAccessPoint_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_RemoteServiceHostedAccessPoint_Provider_h
