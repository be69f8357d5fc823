#ifndef _VESPERA_CompletionRecordAppliesToElement_Provider_h
#define _VESPERA_CompletionRecordAppliesToElement_Provider_h

#include "Provider.h"
#include "VESPERA_CompletionRecordAppliesToElement.h"

namespace OLMA
{

// Serves VESPERA_CompletionRecordAppliesToElement: each diagnostic completion record with
// the element it speaks of. Enumeration only; the bridge walks the associations.
class VESPERA_CompletionRecordAppliesToElement_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_CompletionRecordAppliesToElement* model, Enum_Instances_Handler<VESPERA_CompletionRecordAppliesToElement>* handler);
};

} // namespace OLMA

#endif // _VESPERA_CompletionRecordAppliesToElement_Provider_h
