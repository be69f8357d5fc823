#ifndef _VESPERA_RemoteServiceHostedAccessPoint_Provider_h
#define _VESPERA_RemoteServiceHostedAccessPoint_Provider_h

#include "Provider.h"
#include "VESPERA_RemoteServiceHostedAccessPoint.h"

namespace OLMA
{

// Serves VESPERA_RemoteServiceHostedAccessPoint: the host with the console agent's access
// point, while the agent runs. Enumeration only; the bridge walks the associations.
class VESPERA_RemoteServiceHostedAccessPoint_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_RemoteServiceHostedAccessPoint* model, Enum_Instances_Handler<VESPERA_RemoteServiceHostedAccessPoint>* handler);
};

} // namespace OLMA

#endif // _VESPERA_RemoteServiceHostedAccessPoint_Provider_h
