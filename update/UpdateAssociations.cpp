// The software installation service's associations: the host that offers
// it, and its capabilities.

#include "Associations.h"

#include "VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider.h"
#include "VESPERA_HBASoftwareInstallationServiceHostedService_Provider.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_HBASoftwareInstallationServiceHostedService_Provider::enum_instances(
    const VESPERA_HBASoftwareInstallationServiceHostedService*,
    Enum_Instances_Handler<VESPERA_HBASoftwareInstallationServiceHostedService>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        return sendFirstSystemWithEach(out, ID_VESPERA_HBASoftwareInstallationService,
            "Error: Invalid mapping information");
    });
}

Enum_Instances_Status
VESPERA_HBASoftwareInstallationServiceElementCapabilities_Provider::enum_instances(
    const VESPERA_HBASoftwareInstallationServiceElementCapabilities*,
    Enum_Instances_Handler<VESPERA_HBASoftwareInstallationServiceElementCapabilities>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List services(fetchInstances(ID_VESPERA_HBASoftwareInstallationService));

        if (!exactlyOne(services, "Error: Invalid mapping information for service"))
            return ENUM_INSTANCES_OK;

        Instance_List capabilities(
            fetchInstances(ID_VESPERA_HBASoftwareInstallationServiceCapabilities));

        if (!exactlyOne(capabilities, "Error: Invalid mapping information for capabilities"))
            return ENUM_INSTANCES_OK;

        out.send(services[0], capabilities[0]);
        return ENUM_INSTANCES_OK;
    });
}

} // namespace OLMA
