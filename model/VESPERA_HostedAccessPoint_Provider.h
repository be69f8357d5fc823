#ifndef _VESPERA_HostedAccessPoint_Provider_h
#define _VESPERA_HostedAccessPoint_Provider_h

#include "Provider.h"
#include "VESPERA_HostedAccessPoint.h"

namespace OLMA
{

// Serves VESPERA_HostedAccessPoint: the host with each SCSI protocol endpoint.
// Enumeration only; the bridge walks the associations.
class VESPERA_HostedAccessPoint_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_HostedAccessPoint* model, Enum_Instances_Handler<VESPERA_HostedAccessPoint>* handler);
};

} // namespace OLMA

#endif // _VESPERA_HostedAccessPoint_Provider_h
