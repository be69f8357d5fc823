#ifndef _VESPERA_StorageExtent_Provider_h
#define _VESPERA_StorageExtent_Provider_h

#include "Provider.h"
#include "VESPERA_StorageExtent.h"

namespace OLMA
{

// Serves VESPERA_StorageExtent: enumeration only, from HDRManager.
class VESPERA_StorageExtent_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_StorageExtent* model, Enum_Instances_Handler<VESPERA_StorageExtent>* handler);
};

} // namespace OLMA

#endif // _VESPERA_StorageExtent_Provider_h
