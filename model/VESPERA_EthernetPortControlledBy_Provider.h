#ifndef _VESPERA_EthernetPortControlledBy_Provider_h
#define _VESPERA_EthernetPortControlledBy_Provider_h

namespace OLMA
{

// Serves VESPERA_EthernetPortControlledBy. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_EthernetPortControlledBy_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_EthernetPortControlledBy_Provider_h
