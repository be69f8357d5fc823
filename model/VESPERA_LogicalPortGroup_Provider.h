#ifndef _VESPERA_LogicalPortGroup_Provider_h
#define _VESPERA_LogicalPortGroup_Provider_h

#include "Provider.h"
#include "VESPERA_LogicalPortGroup.h"

namespace OLMA
{

// Serves VESPERA_LogicalPortGroup: enumeration only, from FCHBAManager.
class VESPERA_LogicalPortGroup_Provider
{
public:

    VESPERA_LogicalPortGroup_Provider();

    ~VESPERA_LogicalPortGroup_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_LogicalPortGroup* model, VESPERA_LogicalPortGroup*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_LogicalPortGroup* model, Enum_Instances_Handler<VESPERA_LogicalPortGroup>* handler);

    Create_Instance_Status create_instance(VESPERA_LogicalPortGroup* instance);

    Delete_Instance_Status delete_instance(const VESPERA_LogicalPortGroup* instance);

    Modify_Instance_Status modify_instance(const VESPERA_LogicalPortGroup* model, const VESPERA_LogicalPortGroup* instance);
};

} // namespace OLMA

#endif // _VESPERA_LogicalPortGroup_Provider_h
