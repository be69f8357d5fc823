#ifndef _VESPERA_EthernetPortSystemDevice_Provider_h
#define _VESPERA_EthernetPortSystemDevice_Provider_h

#include "Provider.h"
#include "VESPERA_EthernetPortSystemDevice.h"

namespace OLMA
{

// Serves VESPERA_EthernetPortSystemDevice: the host with each of its Ethernet ports.
// Enumeration only; the bridge walks the associations.
class VESPERA_EthernetPortSystemDevice_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_EthernetPortSystemDevice* model, Enum_Instances_Handler<VESPERA_EthernetPortSystemDevice>* handler);
};

} // namespace OLMA

#endif // _VESPERA_EthernetPortSystemDevice_Provider_h
