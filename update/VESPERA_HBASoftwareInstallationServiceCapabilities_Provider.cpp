#include "VESPERA_HBASoftwareInstallationServiceCapabilities_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::VESPERA_HBASoftwareInstallationServiceCapabilities_Provider()
{
}

VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::~VESPERA_HBASoftwareInstallationServiceCapabilities_Provider()
{
}

Load_Status VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::get_instance(const VESPERA_HBASoftwareInstallationServiceCapabilities*, VESPERA_HBASoftwareInstallationServiceCapabilities*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::enum_instances(
    const VESPERA_HBASoftwareInstallationServiceCapabilities*, Enum_Instances_Handler<VESPERA_HBASoftwareInstallationServiceCapabilities>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::create_instance(VESPERA_HBASoftwareInstallationServiceCapabilities*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::delete_instance(const VESPERA_HBASoftwareInstallationServiceCapabilities*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::modify_instance(const VESPERA_HBASoftwareInstallationServiceCapabilities*, const VESPERA_HBASoftwareInstallationServiceCapabilities*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::CreateGoalSettings(
    const VESPERA_HBASoftwareInstallationServiceCapabilities*,
    const Property<Array<String> >&,
    Property<Array<String> >&,
    Property<uint16>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
