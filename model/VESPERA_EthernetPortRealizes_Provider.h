#ifndef _VESPERA_EthernetPortRealizes_Provider_h
#define _VESPERA_EthernetPortRealizes_Provider_h

namespace OLMA
{

// Serves VESPERA_EthernetPortRealizes. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_EthernetPortRealizes_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_EthernetPortRealizes_Provider_h
