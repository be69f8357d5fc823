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

    VESPERA_Namespace_Provider();

    ~VESPERA_Namespace_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_Namespace* model, VESPERA_Namespace*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_Namespace* model, Enum_Instances_Handler<VESPERA_Namespace>* handler);

    Create_Instance_Status create_instance(VESPERA_Namespace* instance);

    Delete_Instance_Status delete_instance(const VESPERA_Namespace* instance);

    Modify_Instance_Status modify_instance(const VESPERA_Namespace* model, const VESPERA_Namespace* instance);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_Namespace_Provider_h
