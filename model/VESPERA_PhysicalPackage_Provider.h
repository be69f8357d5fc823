#ifndef _VESPERA_PhysicalPackage_Provider_h
#define _VESPERA_PhysicalPackage_Provider_h

#include "Provider.h"
#include "VESPERA_PhysicalPackage.h"

namespace OLMA
{

// Serves VESPERA_PhysicalPackage: enumeration only, from FCHBAManager.
class VESPERA_PhysicalPackage_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_PhysicalPackage* model, Enum_Instances_Handler<VESPERA_PhysicalPackage>* handler);
};

} // namespace OLMA

#endif // _VESPERA_PhysicalPackage_Provider_h
