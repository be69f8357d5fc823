#ifndef _VESPERA_AgentService_Provider_h
#define _VESPERA_AgentService_Provider_h

#include "Provider.h"
#include "VESPERA_AgentService.h"

namespace OLMA
{

// Serves VESPERA_AgentService: its instance comes from ServerManager. Until the
// JSON-RPC engine is wired, executeMethod isn't served.
class VESPERA_AgentService_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_AgentService* model, Enum_Instances_Handler<VESPERA_AgentService>* handler);
};

} // namespace OLMA

#endif // _VESPERA_AgentService_Provider_h
