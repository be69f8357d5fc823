#ifndef _VESPERA_AdapterElementSoftwareIdentity_Provider_h
#define _VESPERA_AdapterElementSoftwareIdentity_Provider_h

#include "Provider.h"
#include "VESPERA_AdapterElementSoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_AdapterElementSoftwareIdentity: each adapter with the drivers it uses
// and its own firmware and BIOS. Enumeration only; the bridge walks the associations.
class VESPERA_AdapterElementSoftwareIdentity_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_AdapterElementSoftwareIdentity* model, Enum_Instances_Handler<VESPERA_AdapterElementSoftwareIdentity>* handler);
};

} // namespace OLMA

#endif // _VESPERA_AdapterElementSoftwareIdentity_Provider_h
