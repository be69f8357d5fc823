#ifndef _VESPERA_HostedLANEndpoint_Provider_h
#define _VESPERA_HostedLANEndpoint_Provider_h

namespace OLMA
{

// Serves VESPERA_HostedLANEndpoint. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_HostedLANEndpoint_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_HostedLANEndpoint_Provider_h
