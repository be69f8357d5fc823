#ifndef _VESPERA_ServiceRecordAppliesToElement_Provider_h
#define _VESPERA_ServiceRecordAppliesToElement_Provider_h

#include "Provider.h"
#include "VESPERA_ServiceRecordAppliesToElement.h"

namespace OLMA
{

// Serves VESPERA_ServiceRecordAppliesToElement: each diagnostic service record with the
// element it speaks of. Enumeration only; the bridge walks the associations.
class VESPERA_ServiceRecordAppliesToElement_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ServiceRecordAppliesToElement* model, Enum_Instances_Handler<VESPERA_ServiceRecordAppliesToElement>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ServiceRecordAppliesToElement_Provider_h
