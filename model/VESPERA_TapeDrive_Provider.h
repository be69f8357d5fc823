#ifndef _VESPERA_TapeDrive_Provider_h
#define _VESPERA_TapeDrive_Provider_h

#include "Provider.h"
#include "VESPERA_TapeDrive.h"

namespace OLMA
{

// Serves VESPERA_TapeDrive: enumeration only, from HDRManager.
class VESPERA_TapeDrive_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_TapeDrive* model, Enum_Instances_Handler<VESPERA_TapeDrive>* handler);
};

} // namespace OLMA

#endif // _VESPERA_TapeDrive_Provider_h
