#ifndef _VESPERA_ElementConformsToProfile_Provider_h
#define _VESPERA_ElementConformsToProfile_Provider_h

#include "Provider.h"
#include "VESPERA_ElementConformsToProfile.h"

namespace OLMA
{

// Serves VESPERA_ElementConformsToProfile: each profile with what implements it, and the
// SMI-S standard with each profile and subprofile. Enumeration only; the bridge walks the
// associations.
class VESPERA_ElementConformsToProfile_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ElementConformsToProfile* model, Enum_Instances_Handler<VESPERA_ElementConformsToProfile>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ElementConformsToProfile_Provider_h
