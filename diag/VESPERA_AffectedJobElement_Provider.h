#ifndef _VESPERA_AffectedJobElement_Provider_h
#define _VESPERA_AffectedJobElement_Provider_h

#include "Provider.h"
#include "VESPERA_AffectedJobElement.h"

namespace OLMA
{

// Serves VESPERA_AffectedJobElement: the latest diagnostic job with the adapter or port
// it tests. Enumeration only; the bridge walks the associations.
class VESPERA_AffectedJobElement_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_AffectedJobElement* model, Enum_Instances_Handler<VESPERA_AffectedJobElement>* handler);
};

} // namespace OLMA

#endif // _VESPERA_AffectedJobElement_Provider_h
