#include "VESPERA_DiagnosticSoftwareIdentity_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_DiagnosticSoftwareIdentity_Provider::VESPERA_DiagnosticSoftwareIdentity_Provider()
{
}

VESPERA_DiagnosticSoftwareIdentity_Provider::~VESPERA_DiagnosticSoftwareIdentity_Provider()
{
}

Load_Status VESPERA_DiagnosticSoftwareIdentity_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_DiagnosticSoftwareIdentity_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_DiagnosticSoftwareIdentity_Provider::get_instance(const VESPERA_DiagnosticSoftwareIdentity*, VESPERA_DiagnosticSoftwareIdentity*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_DiagnosticSoftwareIdentity_Provider::enum_instances(
    const VESPERA_DiagnosticSoftwareIdentity*, Enum_Instances_Handler<VESPERA_DiagnosticSoftwareIdentity>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_DiagnosticSoftwareIdentity_Provider::create_instance(VESPERA_DiagnosticSoftwareIdentity*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_DiagnosticSoftwareIdentity_Provider::delete_instance(const VESPERA_DiagnosticSoftwareIdentity*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_DiagnosticSoftwareIdentity_Provider::modify_instance(const VESPERA_DiagnosticSoftwareIdentity*, const VESPERA_DiagnosticSoftwareIdentity*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

} // namespace OLMA
