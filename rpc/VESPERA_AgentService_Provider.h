#ifndef _VESPERA_AgentService_Provider_h
#define _VESPERA_AgentService_Provider_h

#include "Provider.h"
#include "VESPERA_AgentService.h"

namespace OLMA
{

// Serves VESPERA_AgentService. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_AgentService_Provider
{
public:

    VESPERA_AgentService_Provider();

    ~VESPERA_AgentService_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_AgentService* model, VESPERA_AgentService*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_AgentService* model, Enum_Instances_Handler<VESPERA_AgentService>* handler);

    Create_Instance_Status create_instance(VESPERA_AgentService* instance);

    Delete_Instance_Status delete_instance(const VESPERA_AgentService* instance);

    Modify_Instance_Status modify_instance(const VESPERA_AgentService* model, const VESPERA_AgentService* instance);

    Invoke_Method_Status executeMethod(
        const VESPERA_AgentService* self,
        Property<String>& response,
        const Property<String>& request,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_AgentService_Provider_h
