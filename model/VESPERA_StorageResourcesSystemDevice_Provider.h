#ifndef _VESPERA_StorageResourcesSystemDevice_Provider_h
#define _VESPERA_StorageResourcesSystemDevice_Provider_h

#include "Provider.h"
#include "VESPERA_StorageResourcesSystemDevice.h"

namespace OLMA
{

// Serves VESPERA_StorageResourcesSystemDevice: the host with each storage extent and tape
// drive that its ports reach. Enumeration only; the bridge walks the associations.
class VESPERA_StorageResourcesSystemDevice_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_StorageResourcesSystemDevice* model, Enum_Instances_Handler<VESPERA_StorageResourcesSystemDevice>* handler);
};

} // namespace OLMA

#endif // _VESPERA_StorageResourcesSystemDevice_Provider_h
