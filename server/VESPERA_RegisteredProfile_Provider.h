#ifndef _OLMA_VESPERA_RegisteredProfile_Provider_h
#define _OLMA_VESPERA_RegisteredProfile_Provider_h

#include "Provider.h"
#include "VESPERA_RegisteredProfile.h"

namespace OLMA
{

// Serves VESPERA_RegisteredProfile, the profiles that the module registers.
// Read-only: instances come from ServerManager, and no method does anything.
class VESPERA_RegisteredProfile_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_RegisteredProfile* model, Enum_Instances_Handler<VESPERA_RegisteredProfile>* handler);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_RegisteredProfile_Provider_h
