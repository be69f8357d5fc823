#ifndef _VESPERA_CommMechHostedAccessPoint_Provider_h
#define _VESPERA_CommMechHostedAccessPoint_Provider_h

#include "Provider.h"
#include "VESPERA_CommMechHostedAccessPoint.h"

namespace OLMA
{

// Serves VESPERA_CommMechHostedAccessPoint: the host with the CIM-XML communication
// mechanism. Enumeration only; the bridge walks the associations.
class VESPERA_CommMechHostedAccessPoint_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_CommMechHostedAccessPoint* model, Enum_Instances_Handler<VESPERA_CommMechHostedAccessPoint>* handler);
};

} // namespace OLMA

#endif // _VESPERA_CommMechHostedAccessPoint_Provider_h
