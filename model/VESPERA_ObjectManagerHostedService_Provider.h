#ifndef _VESPERA_ObjectManagerHostedService_Provider_h
#define _VESPERA_ObjectManagerHostedService_Provider_h

namespace OLMA
{

// Serves VESPERA_ObjectManagerHostedService. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ObjectManagerHostedService_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_ObjectManagerHostedService_Provider_h
