#ifndef _VESPERA_InstalledSoftwareIdentity_Provider_h
#define _VESPERA_InstalledSoftwareIdentity_Provider_h

#include "Provider.h"
#include "VESPERA_InstalledSoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_InstalledSoftwareIdentity: the host with each adapter software identity.
// Enumeration only; the bridge walks the associations.
class VESPERA_InstalledSoftwareIdentity_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_InstalledSoftwareIdentity* model, Enum_Instances_Handler<VESPERA_InstalledSoftwareIdentity>* handler);
};

} // namespace OLMA

#endif // _VESPERA_InstalledSoftwareIdentity_Provider_h
