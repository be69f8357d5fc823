#ifndef _VESPERA_OwningJobElement_Provider_h
#define _VESPERA_OwningJobElement_Provider_h

#include "Provider.h"
#include "VESPERA_OwningJobElement.h"

namespace OLMA
{

// Serves VESPERA_OwningJobElement: the latest diagnostic job's test with the job.
// Enumeration only; the bridge walks the associations.
class VESPERA_OwningJobElement_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_OwningJobElement* model, Enum_Instances_Handler<VESPERA_OwningJobElement>* handler);
};

} // namespace OLMA

#endif // _VESPERA_OwningJobElement_Provider_h
