#include "VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider()
{
}

VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::~VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider()
{
}

Load_Status VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::get_instance(const VESPERA_HBASoftwareInstallationServiceElementCapabilities*, VESPERA_HBASoftwareInstallationServiceElementCapabilities*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::enum_instances(
    const VESPERA_HBASoftwareInstallationServiceElementCapabilities*, Enum_Instances_Handler<VESPERA_HBASoftwareInstallationServiceElementCapabilities>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::create_instance(VESPERA_HBASoftwareInstallationServiceElementCapabilities*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::delete_instance(const VESPERA_HBASoftwareInstallationServiceElementCapabilities*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::modify_instance(const VESPERA_HBASoftwareInstallationServiceElementCapabilities*, const VESPERA_HBASoftwareInstallationServiceElementCapabilities*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Enum_Associator_Names_Status VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::enum_associator_names(const Instance*,
    const String&, const String&, const String&, Enum_Associator_Names_Handler<Instance>*)
{
    return ENUM_ASSOCIATOR_NAMES_UNSUPPORTED;
}

Enum_Associators_Status VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::enum_associators(const Instance*,
    const String&, const String&, const String&, Enum_Associators_Handler<Instance>*)
{
    return ENUM_ASSOCIATORS_UNSUPPORTED;
}

Enum_References_Status VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::enum_references(const Instance*,
    const VESPERA_HBASoftwareInstallationServiceElementCapabilities*, const String&, Enum_References_Handler<VESPERA_HBASoftwareInstallationServiceElementCapabilities>*)
{
    return ENUM_REFERENCES_UNSUPPORTED;
}

} // namespace OLMA
