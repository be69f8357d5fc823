#include "VESPERA_AgentService_Provider.h"

#include "ServerEnum.h"
#include "log.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_AgentService_Provider::enum_instances(
    const VESPERA_AgentService*, Enum_Instances_Handler<VESPERA_AgentService>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    size_t n = 0;
    sendServerInstances(ID_VESPERA_AgentService, handler, &n);
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

} // namespace OLMA
