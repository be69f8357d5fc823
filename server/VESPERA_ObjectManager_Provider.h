#ifndef _OLMA_VESPERA_ObjectManager_Provider_h
#define _OLMA_VESPERA_ObjectManager_Provider_h

#include "Provider.h"
#include "VESPERA_ObjectManager.h"

namespace OLMA
{

// Serves VESPERA_ObjectManager, the CIM server that hosts the module.
// Read-only: instances come from ServerManager, and no method does anything.
class VESPERA_ObjectManager_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ObjectManager* model, Enum_Instances_Handler<VESPERA_ObjectManager>* handler);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_ObjectManager_Provider_h
