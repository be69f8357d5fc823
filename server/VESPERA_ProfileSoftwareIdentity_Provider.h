#ifndef _OLMA_VESPERA_ProfileSoftwareIdentity_Provider_h
#define _OLMA_VESPERA_ProfileSoftwareIdentity_Provider_h

#include "Provider.h"
#include "VESPERA_ProfileSoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_ProfileSoftwareIdentity, the provider's own software.
// Read-only: instances come from ServerManager, and no method does anything.
class VESPERA_ProfileSoftwareIdentity_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ProfileSoftwareIdentity* model, Enum_Instances_Handler<VESPERA_ProfileSoftwareIdentity>* handler);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_ProfileSoftwareIdentity_Provider_h
