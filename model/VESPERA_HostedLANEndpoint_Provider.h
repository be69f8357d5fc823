#ifndef _VESPERA_HostedLANEndpoint_Provider_h
#define _VESPERA_HostedLANEndpoint_Provider_h

#include "Provider.h"
#include "VESPERA_HostedLANEndpoint.h"

namespace OLMA
{

// Serves VESPERA_HostedLANEndpoint: the host with each LAN endpoint. Enumeration only;
// the bridge walks the associations.
class VESPERA_HostedLANEndpoint_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_HostedLANEndpoint* model, Enum_Instances_Handler<VESPERA_HostedLANEndpoint>* handler);
};

} // namespace OLMA

#endif // _VESPERA_HostedLANEndpoint_Provider_h
