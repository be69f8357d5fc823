#ifndef _VESPERA_HBASoftwareInstallationServiceCapabilities_Provider_h
#define _VESPERA_HBASoftwareInstallationServiceCapabilities_Provider_h

#include "Provider.h"
#include "VESPERA_HBASoftwareInstallationServiceCapabilities.h"

namespace OLMA
{

// Serves VESPERA_HBASoftwareInstallationServiceCapabilities. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_HBASoftwareInstallationServiceCapabilities_Provider
{
public:

    VESPERA_HBASoftwareInstallationServiceCapabilities_Provider();

    ~VESPERA_HBASoftwareInstallationServiceCapabilities_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_HBASoftwareInstallationServiceCapabilities* model, VESPERA_HBASoftwareInstallationServiceCapabilities*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_HBASoftwareInstallationServiceCapabilities* model, Enum_Instances_Handler<VESPERA_HBASoftwareInstallationServiceCapabilities>* handler);

    Create_Instance_Status create_instance(VESPERA_HBASoftwareInstallationServiceCapabilities* instance);

    Delete_Instance_Status delete_instance(const VESPERA_HBASoftwareInstallationServiceCapabilities* instance);

    Modify_Instance_Status modify_instance(const VESPERA_HBASoftwareInstallationServiceCapabilities* model, const VESPERA_HBASoftwareInstallationServiceCapabilities* instance);

    Invoke_Method_Status CreateGoalSettings(
        const VESPERA_HBASoftwareInstallationServiceCapabilities* self,
        const Property<Array<String> >& TemplateGoalSettings,
        Property<Array<String> >& SupportedGoalSettings,
        Property<uint16>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_HBASoftwareInstallationServiceCapabilities_Provider_h
