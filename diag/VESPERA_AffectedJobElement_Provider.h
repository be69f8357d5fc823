#ifndef _VESPERA_AffectedJobElement_Provider_h
#define _VESPERA_AffectedJobElement_Provider_h

namespace OLMA
{

// Serves VESPERA_AffectedJobElement. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_AffectedJobElement_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_AffectedJobElement_Provider_h
