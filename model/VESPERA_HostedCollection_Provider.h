#ifndef _VESPERA_HostedCollection_Provider_h
#define _VESPERA_HostedCollection_Provider_h

#include "Provider.h"
#include "VESPERA_HostedCollection.h"

namespace OLMA
{

// Serves VESPERA_HostedCollection: the host with each logical port group. Enumeration
// only; the bridge walks the associations.
class VESPERA_HostedCollection_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_HostedCollection* model, Enum_Instances_Handler<VESPERA_HostedCollection>* handler);
};

} // namespace OLMA

#endif // _VESPERA_HostedCollection_Provider_h
