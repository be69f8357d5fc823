#ifndef _VESPERA_EthernetPortRealizes_Provider_h
#define _VESPERA_EthernetPortRealizes_Provider_h

#include "Provider.h"
#include "VESPERA_EthernetPortRealizes.h"

namespace OLMA
{

// Serves VESPERA_EthernetPortRealizes: each connector with the Ethernet port at its
// adapter and place. Enumeration only; the bridge walks the associations.
class VESPERA_EthernetPortRealizes_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_EthernetPortRealizes* model, Enum_Instances_Handler<VESPERA_EthernetPortRealizes>* handler);
};

} // namespace OLMA

#endif // _VESPERA_EthernetPortRealizes_Provider_h
