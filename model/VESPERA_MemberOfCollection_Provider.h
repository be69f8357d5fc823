#ifndef _VESPERA_MemberOfCollection_Provider_h
#define _VESPERA_MemberOfCollection_Provider_h

#include "Provider.h"
#include "VESPERA_MemberOfCollection.h"

namespace OLMA
{

// Serves VESPERA_MemberOfCollection: each FC port's node group with the port. Enumeration
// only; the bridge walks the associations.
class VESPERA_MemberOfCollection_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_MemberOfCollection* model, Enum_Instances_Handler<VESPERA_MemberOfCollection>* handler);
};

} // namespace OLMA

#endif // _VESPERA_MemberOfCollection_Provider_h
