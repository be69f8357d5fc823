#ifndef _VESPERA_ObjectManagerHostedService_Provider_h
#define _VESPERA_ObjectManagerHostedService_Provider_h

#include "Provider.h"
#include "VESPERA_ObjectManagerHostedService.h"

namespace OLMA
{

// Serves VESPERA_ObjectManagerHostedService. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ObjectManagerHostedService_Provider
{
public:

    VESPERA_ObjectManagerHostedService_Provider();

    ~VESPERA_ObjectManagerHostedService_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_ObjectManagerHostedService* model, VESPERA_ObjectManagerHostedService*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_ObjectManagerHostedService* model, Enum_Instances_Handler<VESPERA_ObjectManagerHostedService>* handler);

    Create_Instance_Status create_instance(VESPERA_ObjectManagerHostedService* instance);

    Delete_Instance_Status delete_instance(const VESPERA_ObjectManagerHostedService* instance);

    Modify_Instance_Status modify_instance(const VESPERA_ObjectManagerHostedService* model, const VESPERA_ObjectManagerHostedService* instance);

    Enum_Associator_Names_Status enum_associator_names(const Instance* instance,
        const String& result_class, const String& role, const String& result_role,
        Enum_Associator_Names_Handler<Instance>* handler);

    Enum_Associators_Status enum_associators(const Instance* instance,
        const String& result_class, const String& role, const String& result_role,
        Enum_Associators_Handler<Instance>* handler);

    Enum_References_Status enum_references(const Instance* instance,
        const VESPERA_ObjectManagerHostedService* model, const String& role, Enum_References_Handler<VESPERA_ObjectManagerHostedService>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ObjectManagerHostedService_Provider_h
