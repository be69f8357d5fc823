#ifndef _VESPERA_StorageExtent_Provider_h
#define _VESPERA_StorageExtent_Provider_h

#include "Provider.h"
#include "VESPERA_StorageExtent.h"

namespace OLMA
{

// Serves VESPERA_StorageExtent from HDRManager: enumeration, and getInstance by
// looking up the one instance that the keys name.
class VESPERA_StorageExtent_Provider
{
public:

    Get_Instance_Status get_instance(const VESPERA_StorageExtent* model, VESPERA_StorageExtent*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_StorageExtent* model, Enum_Instances_Handler<VESPERA_StorageExtent>* handler);
};

} // namespace OLMA

#endif // _VESPERA_StorageExtent_Provider_h
