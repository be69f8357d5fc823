#ifndef _VESPERA_HostedDependency_Provider_h
#define _VESPERA_HostedDependency_Provider_h

namespace OLMA
{

// Serves VESPERA_HostedDependency. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_HostedDependency_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_HostedDependency_Provider_h
