#ifndef _VESPERA_EthernetPortRealizes_Provider_h
#define _VESPERA_EthernetPortRealizes_Provider_h

#include "Provider.h"
#include "VESPERA_EthernetPortRealizes.h"

namespace OLMA
{

// Serves VESPERA_EthernetPortRealizes. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_EthernetPortRealizes_Provider
{
public:

    VESPERA_EthernetPortRealizes_Provider();

    ~VESPERA_EthernetPortRealizes_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_EthernetPortRealizes* model, VESPERA_EthernetPortRealizes*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_EthernetPortRealizes* model, Enum_Instances_Handler<VESPERA_EthernetPortRealizes>* handler);

    Create_Instance_Status create_instance(VESPERA_EthernetPortRealizes* instance);

    Delete_Instance_Status delete_instance(const VESPERA_EthernetPortRealizes* instance);

    Modify_Instance_Status modify_instance(const VESPERA_EthernetPortRealizes* model, const VESPERA_EthernetPortRealizes* instance);

    Enum_Associator_Names_Status enum_associator_names(const Instance* instance,
        const String& result_class, const String& role, const String& result_role,
        Enum_Associator_Names_Handler<Instance>* handler);

    Enum_Associators_Status enum_associators(const Instance* instance,
        const String& result_class, const String& role, const String& result_role,
        Enum_Associators_Handler<Instance>* handler);

    Enum_References_Status enum_references(const Instance* instance,
        const VESPERA_EthernetPortRealizes* model, const String& role, Enum_References_Handler<VESPERA_EthernetPortRealizes>* handler);
};

} // namespace OLMA

#endif // _VESPERA_EthernetPortRealizes_Provider_h
