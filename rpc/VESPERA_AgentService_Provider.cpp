#include "VESPERA_AgentService_Provider.h"

#include <string>

#include "JsonRpcManager.h"
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
    if (n == 0)
        TLOG(LL_ERR, "No AgentService Found!");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Invoke_Method_Status VESPERA_AgentService_Provider::executeMethod(
    const VESPERA_AgentService*,
    Property<String>& response,
    const Property<String>& request,
    Property<uint32>& return_value)
{
    TLOG(LL_DBG, "Entering: %s", "executeMethod");

    std::string text;
    if (!request.null)
        text.assign(request.value.c_str(), request.value.size());

    // Authentication settings (the secret among them) stay out of the log.
    if (text.find("setPortAuthentication") != std::string::npos)
        TLOG(LL_DBG, "%s", "request: port authentication settings, not logged");
    else
        TLOG(LL_DBG, "%s", text.c_str());

    JsonRpcManager::response reply;
    reply.status = 0;
    JsonRpcManager::instance()->process(text, reply);
    TLOG(LL_DBG, "rpcResponse : %s", reply.text.c_str());

    response.set(String(reply.text.data(), reply.text.size()));
    TLOG(LL_DBG, "%s", reply.text.c_str());

    return_value.set(0);
    TLOG(LL_DBG, "Returning: %s", "executeMethod");
    return INVOKE_METHOD_OK;
}

} // namespace OLMA
