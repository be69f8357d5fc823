#ifndef _VESPERA_MemberOfCollection_Provider_h
#define _VESPERA_MemberOfCollection_Provider_h

namespace OLMA
{

// Serves VESPERA_MemberOfCollection. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_MemberOfCollection_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_MemberOfCollection_Provider_h
