#ifndef _VESPERA_CommMechanismForManager_Provider_h
#define _VESPERA_CommMechanismForManager_Provider_h

#include "Provider.h"
#include "VESPERA_CommMechanismForManager.h"

namespace OLMA
{

// Serves VESPERA_CommMechanismForManager: the object manager with its communication
// mechanism. Enumeration only; the bridge walks the associations.
class VESPERA_CommMechanismForManager_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_CommMechanismForManager* model, Enum_Instances_Handler<VESPERA_CommMechanismForManager>* handler);
};

} // namespace OLMA

#endif // _VESPERA_CommMechanismForManager_Provider_h
