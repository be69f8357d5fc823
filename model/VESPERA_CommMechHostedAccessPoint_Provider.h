#ifndef _VESPERA_CommMechHostedAccessPoint_Provider_h
#define _VESPERA_CommMechHostedAccessPoint_Provider_h

namespace OLMA
{

// Serves VESPERA_CommMechHostedAccessPoint. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_CommMechHostedAccessPoint_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_CommMechHostedAccessPoint_Provider_h
