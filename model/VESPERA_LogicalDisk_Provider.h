#ifndef _VESPERA_LogicalDisk_Provider_h
#define _VESPERA_LogicalDisk_Provider_h

#include "Provider.h"
#include "VESPERA_LogicalDisk.h"

namespace OLMA
{

// Serves VESPERA_LogicalDisk from HDRManager: enumeration, and getInstance by
// looking up the one instance that the keys name.
class VESPERA_LogicalDisk_Provider
{
public:

    Get_Instance_Status get_instance(const VESPERA_LogicalDisk* model, VESPERA_LogicalDisk*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_LogicalDisk* model, Enum_Instances_Handler<VESPERA_LogicalDisk>* handler);
};

} // namespace OLMA

#endif // _VESPERA_LogicalDisk_Provider_h
