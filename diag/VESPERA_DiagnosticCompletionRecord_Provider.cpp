#include "VESPERA_DiagnosticCompletionRecord_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_DiagnosticCompletionRecord_Provider::VESPERA_DiagnosticCompletionRecord_Provider()
{
}

VESPERA_DiagnosticCompletionRecord_Provider::~VESPERA_DiagnosticCompletionRecord_Provider()
{
}

Load_Status VESPERA_DiagnosticCompletionRecord_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_DiagnosticCompletionRecord_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_DiagnosticCompletionRecord_Provider::get_instance(const VESPERA_DiagnosticCompletionRecord*, VESPERA_DiagnosticCompletionRecord*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_DiagnosticCompletionRecord_Provider::enum_instances(
    const VESPERA_DiagnosticCompletionRecord*, Enum_Instances_Handler<VESPERA_DiagnosticCompletionRecord>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_DiagnosticCompletionRecord_Provider::create_instance(VESPERA_DiagnosticCompletionRecord*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_DiagnosticCompletionRecord_Provider::delete_instance(const VESPERA_DiagnosticCompletionRecord*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_DiagnosticCompletionRecord_Provider::modify_instance(const VESPERA_DiagnosticCompletionRecord*, const VESPERA_DiagnosticCompletionRecord*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

} // namespace OLMA
