#ifndef _VESPERA_LANEndpointDeviceSAPImplementation_Provider_h
#define _VESPERA_LANEndpointDeviceSAPImplementation_Provider_h

namespace OLMA
{

// Serves VESPERA_LANEndpointDeviceSAPImplementation. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_LANEndpointDeviceSAPImplementation_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_LANEndpointDeviceSAPImplementation_Provider_h
