#ifndef _VESPERA_LogicalDisk_Provider_h
#define _VESPERA_LogicalDisk_Provider_h

#include "Provider.h"
#include "VESPERA_LogicalDisk.h"

namespace OLMA
{

// Serves VESPERA_LogicalDisk: enumeration only, from HDRManager.
class VESPERA_LogicalDisk_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_LogicalDisk* model, Enum_Instances_Handler<VESPERA_LogicalDisk>* handler);
};

} // namespace OLMA

#endif // _VESPERA_LogicalDisk_Provider_h
