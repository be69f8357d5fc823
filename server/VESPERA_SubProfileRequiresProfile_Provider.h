#ifndef _VESPERA_SubProfileRequiresProfile_Provider_h
#define _VESPERA_SubProfileRequiresProfile_Provider_h

#include "Provider.h"
#include "VESPERA_SubProfileRequiresProfile.h"

namespace OLMA
{

// Serves VESPERA_SubProfileRequiresProfile: each profile with the subprofiles it
// requires. Enumeration only; the bridge walks the associations.
class VESPERA_SubProfileRequiresProfile_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_SubProfileRequiresProfile* model, Enum_Instances_Handler<VESPERA_SubProfileRequiresProfile>* handler);
};

} // namespace OLMA

#endif // _VESPERA_SubProfileRequiresProfile_Provider_h
