#include "VESPERA_HBASoftwareInstallationServiceCapabilities_Provider.h"

#include "SingleInstance.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_HBASoftwareInstallationServiceCapabilities_Provider::enum_instances(
    const VESPERA_HBASoftwareInstallationServiceCapabilities*,
    Enum_Instances_Handler<VESPERA_HBASoftwareInstallationServiceCapabilities>* handler)
{
    return enumSingleInstance(ID_VESPERA_HBASoftwareInstallationServiceCapabilities, handler);
}

} // namespace OLMA
