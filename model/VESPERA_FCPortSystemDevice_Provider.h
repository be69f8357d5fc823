#ifndef _VESPERA_FCPortSystemDevice_Provider_h
#define _VESPERA_FCPortSystemDevice_Provider_h

#include "Provider.h"
#include "VESPERA_FCPortSystemDevice.h"

namespace OLMA
{

// Serves VESPERA_FCPortSystemDevice: the host with each of its FC ports. Enumeration
// only; the bridge walks the associations.
class VESPERA_FCPortSystemDevice_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_FCPortSystemDevice* model, Enum_Instances_Handler<VESPERA_FCPortSystemDevice>* handler);
};

} // namespace OLMA

#endif // _VESPERA_FCPortSystemDevice_Provider_h
