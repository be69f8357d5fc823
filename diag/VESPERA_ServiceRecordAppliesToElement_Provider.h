#ifndef _VESPERA_ServiceRecordAppliesToElement_Provider_h
#define _VESPERA_ServiceRecordAppliesToElement_Provider_h

namespace OLMA
{

// Serves VESPERA_ServiceRecordAppliesToElement. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ServiceRecordAppliesToElement_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_ServiceRecordAppliesToElement_Provider_h
