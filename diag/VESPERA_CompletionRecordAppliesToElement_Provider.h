#ifndef _VESPERA_CompletionRecordAppliesToElement_Provider_h
#define _VESPERA_CompletionRecordAppliesToElement_Provider_h

namespace OLMA
{

// Serves VESPERA_CompletionRecordAppliesToElement. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_CompletionRecordAppliesToElement_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_CompletionRecordAppliesToElement_Provider_h
