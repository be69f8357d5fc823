#ifndef _VESPERA_LANEndpointDeviceSAPImplementation_Provider_h
#define _VESPERA_LANEndpointDeviceSAPImplementation_Provider_h

#include "Provider.h"
#include "VESPERA_LANEndpointDeviceSAPImplementation.h"

namespace OLMA
{

// Serves VESPERA_LANEndpointDeviceSAPImplementation: each Ethernet port with its LAN
// endpoint. Enumeration only; the bridge walks the associations.
class VESPERA_LANEndpointDeviceSAPImplementation_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_LANEndpointDeviceSAPImplementation* model, Enum_Instances_Handler<VESPERA_LANEndpointDeviceSAPImplementation>* handler);
};

} // namespace OLMA

#endif // _VESPERA_LANEndpointDeviceSAPImplementation_Provider_h
