#ifndef _VESPERA_TapeDrive_Provider_h
#define _VESPERA_TapeDrive_Provider_h

#include "Provider.h"
#include "VESPERA_TapeDrive.h"

namespace OLMA
{

// Serves VESPERA_TapeDrive from HDRManager: enumeration, and getInstance by
// looking up the one instance that the keys name.
class VESPERA_TapeDrive_Provider
{
public:

    Get_Instance_Status get_instance(const VESPERA_TapeDrive* model, VESPERA_TapeDrive*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_TapeDrive* model, Enum_Instances_Handler<VESPERA_TapeDrive>* handler);
};

} // namespace OLMA

#endif // _VESPERA_TapeDrive_Provider_h
