#ifndef _VESPERA_ProfileElementSoftwareIdentity_Provider_h
#define _VESPERA_ProfileElementSoftwareIdentity_Provider_h

#include "Provider.h"
#include "VESPERA_ProfileElementSoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_ProfileElementSoftwareIdentity: the provider's software with each
// profile and subprofile. Enumeration only; the bridge walks the associations.
class VESPERA_ProfileElementSoftwareIdentity_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ProfileElementSoftwareIdentity* model, Enum_Instances_Handler<VESPERA_ProfileElementSoftwareIdentity>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ProfileElementSoftwareIdentity_Provider_h
