#ifndef _VESPERA_EthernetPortSystemDevice_Provider_h
#define _VESPERA_EthernetPortSystemDevice_Provider_h

namespace OLMA
{

// Serves VESPERA_EthernetPortSystemDevice. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_EthernetPortSystemDevice_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_EthernetPortSystemDevice_Provider_h
