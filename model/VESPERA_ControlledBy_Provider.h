#ifndef _VESPERA_ControlledBy_Provider_h
#define _VESPERA_ControlledBy_Provider_h

#include "Provider.h"
#include "VESPERA_ControlledBy.h"

namespace OLMA
{

// Serves VESPERA_ControlledBy: each adapter with its FC ports. Enumeration only; the
// bridge walks the associations.
class VESPERA_ControlledBy_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ControlledBy* model, Enum_Instances_Handler<VESPERA_ControlledBy>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ControlledBy_Provider_h
