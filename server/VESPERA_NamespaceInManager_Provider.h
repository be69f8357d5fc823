#ifndef _VESPERA_NamespaceInManager_Provider_h
#define _VESPERA_NamespaceInManager_Provider_h

#include "Provider.h"
#include "VESPERA_NamespaceInManager.h"

namespace OLMA
{

// Serves VESPERA_NamespaceInManager: the object manager with the namespace it serves.
// Enumeration only; the bridge walks the associations.
class VESPERA_NamespaceInManager_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_NamespaceInManager* model, Enum_Instances_Handler<VESPERA_NamespaceInManager>* handler);
};

} // namespace OLMA

#endif // _VESPERA_NamespaceInManager_Provider_h
