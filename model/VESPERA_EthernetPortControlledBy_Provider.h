#ifndef _VESPERA_EthernetPortControlledBy_Provider_h
#define _VESPERA_EthernetPortControlledBy_Provider_h

#include "Provider.h"
#include "VESPERA_EthernetPortControlledBy.h"

namespace OLMA
{

// Serves VESPERA_EthernetPortControlledBy: each converged adapter with its Ethernet
// ports. Enumeration only; the bridge walks the associations.
class VESPERA_EthernetPortControlledBy_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_EthernetPortControlledBy* model, Enum_Instances_Handler<VESPERA_EthernetPortControlledBy>* handler);
};

} // namespace OLMA

#endif // _VESPERA_EthernetPortControlledBy_Provider_h
