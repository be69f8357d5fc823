#ifndef _VESPERA_PortControllerSystemDevice_Provider_h
#define _VESPERA_PortControllerSystemDevice_Provider_h

#include "Provider.h"
#include "VESPERA_PortControllerSystemDevice.h"

namespace OLMA
{

// Serves VESPERA_PortControllerSystemDevice: the host with each of its adapters.
// Enumeration only; the bridge walks the associations.
class VESPERA_PortControllerSystemDevice_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_PortControllerSystemDevice* model, Enum_Instances_Handler<VESPERA_PortControllerSystemDevice>* handler);
};

} // namespace OLMA

#endif // _VESPERA_PortControllerSystemDevice_Provider_h
