#ifndef _VESPERA_AssociatedAlarm_Provider_h
#define _VESPERA_AssociatedAlarm_Provider_h

#include "Provider.h"
#include "VESPERA_AssociatedAlarm.h"

namespace OLMA
{

// Serves VESPERA_AssociatedAlarm: each FC port's beacon with its port. Enumeration only;
// the bridge walks the associations.
class VESPERA_AssociatedAlarm_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_AssociatedAlarm* model, Enum_Instances_Handler<VESPERA_AssociatedAlarm>* handler);
};

} // namespace OLMA

#endif // _VESPERA_AssociatedAlarm_Provider_h
