#include "VESPERA_DiagnosticServiceRecord_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_DiagnosticServiceRecord_Provider::VESPERA_DiagnosticServiceRecord_Provider()
{
}

VESPERA_DiagnosticServiceRecord_Provider::~VESPERA_DiagnosticServiceRecord_Provider()
{
}

Load_Status VESPERA_DiagnosticServiceRecord_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_DiagnosticServiceRecord_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_DiagnosticServiceRecord_Provider::get_instance(const VESPERA_DiagnosticServiceRecord*, VESPERA_DiagnosticServiceRecord*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_DiagnosticServiceRecord_Provider::enum_instances(
    const VESPERA_DiagnosticServiceRecord*, Enum_Instances_Handler<VESPERA_DiagnosticServiceRecord>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_DiagnosticServiceRecord_Provider::create_instance(VESPERA_DiagnosticServiceRecord*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_DiagnosticServiceRecord_Provider::delete_instance(const VESPERA_DiagnosticServiceRecord*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_DiagnosticServiceRecord_Provider::modify_instance(const VESPERA_DiagnosticServiceRecord*, const VESPERA_DiagnosticServiceRecord*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

} // namespace OLMA
