#include "VESPERA_AgentService_Provider.h"

#include "ServerEnum.h"
#include "log.h"

namespace OLMA
{

VESPERA_AgentService_Provider::VESPERA_AgentService_Provider()
{
}

VESPERA_AgentService_Provider::~VESPERA_AgentService_Provider()
{
}

Load_Status VESPERA_AgentService_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_AgentService_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_AgentService_Provider::get_instance(const VESPERA_AgentService*, VESPERA_AgentService*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_AgentService_Provider::enum_instances(
    const VESPERA_AgentService*, Enum_Instances_Handler<VESPERA_AgentService>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    size_t n = 0;
    sendServerInstances(ID_VESPERA_AgentService, handler, &n);
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_AgentService_Provider::create_instance(VESPERA_AgentService*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_AgentService_Provider::delete_instance(const VESPERA_AgentService*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_AgentService_Provider::modify_instance(const VESPERA_AgentService*, const VESPERA_AgentService*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_AgentService_Provider::executeMethod(
    const VESPERA_AgentService*,
    Property<String>&,
    const Property<String>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
