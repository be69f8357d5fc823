#ifndef _VESPERA_HostedAccessPoint_Provider_h
#define _VESPERA_HostedAccessPoint_Provider_h

namespace OLMA
{

// Serves VESPERA_HostedAccessPoint. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_HostedAccessPoint_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_HostedAccessPoint_Provider_h
