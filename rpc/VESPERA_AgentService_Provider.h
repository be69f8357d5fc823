#ifndef _VESPERA_AgentService_Provider_h
#define _VESPERA_AgentService_Provider_h

#include "Provider.h"
#include "VESPERA_AgentService.h"

namespace OLMA
{

// Serves VESPERA_AgentService: its instance comes from ServerManager, and
// executeMethod carries a console's JSON-RPC request to JsonRpcManager.
class VESPERA_AgentService_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_AgentService* model, Enum_Instances_Handler<VESPERA_AgentService>* handler);

    // The CIM call always succeeds: every failure of the protocol is in
    // the response text, and return_value is 0.
    Invoke_Method_Status executeMethod(
        const VESPERA_AgentService* self,
        Property<String>& response,
        const Property<String>& request,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_AgentService_Provider_h
