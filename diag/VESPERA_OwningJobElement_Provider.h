#ifndef _VESPERA_OwningJobElement_Provider_h
#define _VESPERA_OwningJobElement_Provider_h

namespace OLMA
{

// Serves VESPERA_OwningJobElement. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_OwningJobElement_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_OwningJobElement_Provider_h
