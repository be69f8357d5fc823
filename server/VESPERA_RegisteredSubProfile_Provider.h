#ifndef _OLMA_VESPERA_RegisteredSubProfile_Provider_h
#define _OLMA_VESPERA_RegisteredSubProfile_Provider_h

#include "Provider.h"
#include "VESPERA_RegisteredSubProfile.h"

namespace OLMA
{

// Serves VESPERA_RegisteredSubProfile, the subprofiles of the registered
// profiles. Read-only: instances come from ServerManager, and no method does
// anything.
class VESPERA_RegisteredSubProfile_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_RegisteredSubProfile* model, Enum_Instances_Handler<VESPERA_RegisteredSubProfile>* handler);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_RegisteredSubProfile_Provider_h
