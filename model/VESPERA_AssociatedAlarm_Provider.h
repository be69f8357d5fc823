#ifndef _VESPERA_AssociatedAlarm_Provider_h
#define _VESPERA_AssociatedAlarm_Provider_h

namespace OLMA
{

// Serves VESPERA_AssociatedAlarm. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_AssociatedAlarm_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_AssociatedAlarm_Provider_h
