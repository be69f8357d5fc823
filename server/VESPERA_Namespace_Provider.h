#ifndef _OLMA_VESPERA_Namespace_Provider_h
#define _OLMA_VESPERA_Namespace_Provider_h

#include "Provider.h"
#include "VESPERA_Namespace.h"

namespace OLMA
{

// Serves VESPERA_Namespace, the namespace that the module serves. Read-only:
// instances come from ServerManager, and no method does anything.
class VESPERA_Namespace_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_Namespace* model, Enum_Instances_Handler<VESPERA_Namespace>* handler);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_Namespace_Provider_h
