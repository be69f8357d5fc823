#ifndef _VESPERA_SubProfileRequiresProfile_Provider_h
#define _VESPERA_SubProfileRequiresProfile_Provider_h

#include "Provider.h"
#include "VESPERA_SubProfileRequiresProfile.h"

namespace OLMA
{

// Serves VESPERA_SubProfileRequiresProfile. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_SubProfileRequiresProfile_Provider
{
public:

    VESPERA_SubProfileRequiresProfile_Provider();

    ~VESPERA_SubProfileRequiresProfile_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_SubProfileRequiresProfile* model, VESPERA_SubProfileRequiresProfile*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_SubProfileRequiresProfile* model, Enum_Instances_Handler<VESPERA_SubProfileRequiresProfile>* handler);

    Create_Instance_Status create_instance(VESPERA_SubProfileRequiresProfile* instance);

    Delete_Instance_Status delete_instance(const VESPERA_SubProfileRequiresProfile* instance);

    Modify_Instance_Status modify_instance(const VESPERA_SubProfileRequiresProfile* model, const VESPERA_SubProfileRequiresProfile* instance);

    Enum_Associator_Names_Status enum_associator_names(const Instance* instance,
        const String& result_class, const String& role, const String& result_role,
        Enum_Associator_Names_Handler<Instance>* handler);

    Enum_Associators_Status enum_associators(const Instance* instance,
        const String& result_class, const String& role, const String& result_role,
        Enum_Associators_Handler<Instance>* handler);

    Enum_References_Status enum_references(const Instance* instance,
        const VESPERA_SubProfileRequiresProfile* model, const String& role, Enum_References_Handler<VESPERA_SubProfileRequiresProfile>* handler);
};

} // namespace OLMA

#endif // _VESPERA_SubProfileRequiresProfile_Provider_h
