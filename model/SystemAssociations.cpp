// The associations that tie the host to what it holds: one computer system
// with every instance of a class.

#include "Associations.h"

#include "VESPERA_EthernetPortSystemDevice_Provider.h"
#include "VESPERA_FCPortSystemDevice_Provider.h"
#include "VESPERA_HostedAccessPoint_Provider.h"
#include "VESPERA_HostedCollection_Provider.h"
#include "VESPERA_HostedLANEndpoint_Provider.h"
#include "VESPERA_InstalledSoftwareIdentity_Provider.h"
#include "VESPERA_PortControllerSystemDevice_Provider.h"
#include "VESPERA_RemoteServiceHostedAccessPoint_Provider.h"
#include "VESPERA_StorageResourcesSystemDevice_Provider.h"

namespace OLMA
{

namespace
{

// The host with every part, where there must be exactly one host and the
// absence of parts is a message, not a failure.
Enum_Instances_Status oneSystemWithEach(Association_Sender& out, classId_t partId,
    const char* notOneSystem, Log_Level noPartLevel, const char* noPart)
{
    Instance_List systems(fetchInstances(ID_VESPERA_ComputerSystem));

    if (!exactlyOne(systems, notOneSystem))
        return ENUM_INSTANCES_FAILED;

    Instance_List parts(fetchInstances(partId));

    if (present(parts, noPartLevel, noPart))
        sendOneWithEach(out, systems[0], parts);

    return ENUM_INSTANCES_OK;
}

} // namespace

Enum_Instances_Status VESPERA_PortControllerSystemDevice_Provider::enum_instances(
    const VESPERA_PortControllerSystemDevice*,
    Enum_Instances_Handler<VESPERA_PortControllerSystemDevice>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        return oneSystemWithEach(out, ID_VESPERA_PortController,
            "Error: Returned instances for ComputerSystem is not 1",
            LL_ERR, "Error: Invalid mapping information");
    });
}

Enum_Instances_Status VESPERA_HostedAccessPoint_Provider::enum_instances(
    const VESPERA_HostedAccessPoint*, Enum_Instances_Handler<VESPERA_HostedAccessPoint>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        return oneSystemWithEach(out, ID_VESPERA_SCSIProtocolEndpoint,
            "Error: Invalid mapping information",
            LL_WARN, "Invalid number of SCSIProtocolEndPoint instances returned.");
    });
}

Enum_Instances_Status VESPERA_HostedCollection_Provider::enum_instances(
    const VESPERA_HostedCollection*, Enum_Instances_Handler<VESPERA_HostedCollection>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        return oneSystemWithEach(out, ID_VESPERA_LogicalPortGroup,
            "Error: Invalid mapping information", LL_WARN, "No Logical Port Groups found!");
    });
}

Enum_Instances_Status VESPERA_HostedLANEndpoint_Provider::enum_instances(
    const VESPERA_HostedLANEndpoint*, Enum_Instances_Handler<VESPERA_HostedLANEndpoint>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        return oneSystemWithEach(out, ID_VESPERA_LANEndpoint,
            "Error: Invalid number of ComputerSystem instances",
            LL_WARN, "No Ethernet Port Found");
    });
}

Enum_Instances_Status VESPERA_InstalledSoftwareIdentity_Provider::enum_instances(
    const VESPERA_InstalledSoftwareIdentity*,
    Enum_Instances_Handler<VESPERA_InstalledSoftwareIdentity>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        return oneSystemWithEach(out, ID_VESPERA_AdapterSoftwareIdentity,
            "Error: count of computersystem instance is not 1",
            LL_ERR, "Error: Invalid mapping information");
    });
}

Enum_Instances_Status VESPERA_FCPortSystemDevice_Provider::enum_instances(
    const VESPERA_FCPortSystemDevice*, Enum_Instances_Handler<VESPERA_FCPortSystemDevice>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        return sendFirstSystemWithEach(out, ID_VESPERA_FCPort,
            "Error: Invalid mapping information");
    });
}

Enum_Instances_Status VESPERA_EthernetPortSystemDevice_Provider::enum_instances(
    const VESPERA_EthernetPortSystemDevice*,
    Enum_Instances_Handler<VESPERA_EthernetPortSystemDevice>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        return sendFirstSystemWithEach(out, ID_VESPERA_EthernetPort, "Invalid mapping information");
    });
}

//------------------------------------------------------------------------------

Enum_Instances_Status VESPERA_RemoteServiceHostedAccessPoint_Provider::enum_instances(
    const VESPERA_RemoteServiceHostedAccessPoint*,
    Enum_Instances_Handler<VESPERA_RemoteServiceHostedAccessPoint>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        // No agent, no access point: the usual case, and no failure.
        Instance_List points(fetchInstances(ID_VESPERA_RemoteServiceAccessPoint));

        if (!present(points, LL_WARN, "Warning: No service is available"))
            return ENUM_INSTANCES_OK;

        Instance_List systems(fetchInstances(ID_VESPERA_ComputerSystem));

        if (systems.size() != 1 || points.size() != 1)
        {
            TLOG(LL_ERR, "Error: Invalid mapping information");
            return ENUM_INSTANCES_FAILED;
        }

        out.send(systems[0], points[0]);
        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_StorageResourcesSystemDevice_Provider::enum_instances(
    const VESPERA_StorageResourcesSystemDevice*,
    Enum_Instances_Handler<VESPERA_StorageResourcesSystemDevice>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List systems(fetchInstances(ID_VESPERA_ComputerSystem));
        Instance_List units(fetchTargetInstances(ID_VESPERA_StorageExtent));
        units.take(fetchTargetInstances(ID_VESPERA_TapeDrive));

        for (size_t s = 0; s < systems.size(); s++)
            sendOneWithEach(out, systems[s], units);

        return ENUM_INSTANCES_OK;
    });
}

} // namespace OLMA
