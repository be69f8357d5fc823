// The associations of a port with what belongs to it, paired by the names
// that the port's instances share, and the paths from an initiator through
// a target to a logical unit.

#include <cstdio>

#include "Associations.h"
#include "Provider_Handle.h"

#include "VESPERA_AlarmDevice.h"
#include "VESPERA_FCPort.h"
#include "VESPERA_LANEndpoint.h"
#include "VESPERA_LogicalPortGroup.h"
#include "VESPERA_SCSIProtocolEndpoint.h"

#include "VESPERA_AssociatedAlarm_Provider.h"
#include "VESPERA_DeviceSAPImplementation_Provider.h"
#include "VESPERA_ElementStatisticalData_Provider.h"
#include "VESPERA_LANEndpointDeviceSAPImplementation_Provider.h"
#include "VESPERA_MemberOfCollection_Provider.h"
#include "VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_AssociatedAlarm_Provider::enum_instances(
    const VESPERA_AssociatedAlarm*, Enum_Instances_Handler<VESPERA_AssociatedAlarm>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List ports(fetchInstances(ID_VESPERA_FCPort));

        if (!present(ports, LL_WARN, "No FC Ports Found!"))
            return ENUM_INSTANCES_OK;

        Instance_List alarms(fetchInstances(ID_VESPERA_AlarmDevice));

        if (!present(alarms, LL_WARN, "Invalid number of Instances!"))
            return ENUM_INSTANCES_OK;

        sendMatches(out, ports, &CIM_LogicalDevice::DeviceID, alarms, &CIM_LogicalDevice::DeviceID,
            true, false);
        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_DeviceSAPImplementation_Provider::enum_instances(
    const VESPERA_DeviceSAPImplementation*,
    Enum_Instances_Handler<VESPERA_DeviceSAPImplementation>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        // A port's first endpoint of its own name is its initiator; the
        // targets behind it carry the remote port's name as well.
        Instance_List endpoints(fetchInstances(ID_VESPERA_SCSIProtocolEndpoint));

        if (!present(endpoints, LL_ERR, "Error: Invalid number of instances returned"))
            return ENUM_INSTANCES_OK;

        Instance_List ports(fetchInstances(ID_VESPERA_FCPort));

        if (!present(ports, LL_ERR, "Error: No FCPort found!"))
            return ENUM_INSTANCES_OK;

        sendMatches(out, ports, &CIM_LogicalDevice::DeviceID,
            endpoints, &CIM_ManagedSystemElement::Name, false, true);
        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_ElementStatisticalData_Provider::enum_instances(
    const VESPERA_ElementStatisticalData*,
    Enum_Instances_Handler<VESPERA_ElementStatisticalData>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List ports(fetchInstances(ID_VESPERA_FCPort));

        if (!present(ports, LL_WARN, "No FC Ports Found"))
            return ENUM_INSTANCES_OK;

        Instance_List statistics(fetchInstances(ID_VESPERA_FCPortStatistics));

        if (!present(statistics, LL_WARN, "Invalid number of Port Statistice Instances!"))
            return ENUM_INSTANCES_OK;

        sendMatches(out, ports, &CIM_LogicalDevice::DeviceID,
            statistics, &CIM_ManagedElement::InstanceID, true, true);
        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_LANEndpointDeviceSAPImplementation_Provider::enum_instances(
    const VESPERA_LANEndpointDeviceSAPImplementation*,
    Enum_Instances_Handler<VESPERA_LANEndpointDeviceSAPImplementation>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List ports(fetchInstances(ID_VESPERA_EthernetPort));

        if (!present(ports, LL_WARN, "No Ethernet Port Found"))
            return ENUM_INSTANCES_OK;

        Instance_List endpoints(fetchInstances(ID_VESPERA_LANEndpoint));

        if (!present(endpoints, LL_WARN, "Invalid number of EndPoint instances "))
            return ENUM_INSTANCES_OK;

        // Each port has its one endpoint; other counts mean the two walks
        // saw different hosts.
        if (ports.size() != endpoints.size())
        {
            TLOG(LL_ERR, "Error: Invalid mapping information!");
            return ENUM_INSTANCES_FAILED;
        }

        sendMatches(out, ports, &CIM_LogicalDevice::DeviceID,
            endpoints, &CIM_LANEndpoint::MACAddress, false, true);
        return ENUM_INSTANCES_OK;
    });
}

// A group stands for a node, named by its WWN; its members are the node's
// ports, which carry that WWN before the colon of their Name.
Enum_Instances_Status VESPERA_MemberOfCollection_Provider::enum_instances(
    const VESPERA_MemberOfCollection*, Enum_Instances_Handler<VESPERA_MemberOfCollection>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List ports(fetchInstances(ID_VESPERA_FCPort));

        if (!present(ports, LL_WARN, "No FC Ports Found!"))
            return ENUM_INSTANCES_OK;

        Instance_List groups(fetchInstances(ID_VESPERA_LogicalPortGroup));

        if (groups.empty())
        {
            TLOG(LL_ERR, "Error: Invalid number of instances returned!\n");
            return ENUM_INSTANCES_FAILED;
        }

        Text_Index byNode;

        for (size_t g = 0; g < groups.size(); g++)
        {
            if (const CIM_ManagedElement* group = groups.get<CIM_ManagedElement>(g))
                byNode.add(textOf(group->InstanceID), g);
        }

        for (size_t p = 0; p < ports.size() && out.open(); p++)
        {
            const VESPERA_FCPort* port = ports.get<VESPERA_FCPort>(p);

            if (!port)
                continue;

            String name = textOf(port->Name);
            size_t colon = name.find(':');
            String node = colon == (size_t)-1 ? String() : name.substr(0, colon);
            const std::vector<size_t>* group = node.size() ? &byNode.find(node) : 0;

            if (!group || group->empty())
            {
                TLOG(LL_WARN, "FC port %s: no group of its node \"%s\", so it is in none",
                    textOf(port->DeviceID).c_str(), node.c_str());
                continue;
            }

            out.send(groups[(*group)[0]], ports[p]);
        }

        return ENUM_INSTANCES_OK;
    });
}

//------------------------------------------------------------------------------
// Paths. Every name involved starts with the local port's WWN: an initiator
// is named by it, a target by it and the remote port's WWN joined by "_", and
// a logical unit's DeviceID by the two and more. The units are indexed by
// their two ports, so a host of many units is walked once, not once per
// initiator and target; the order is that of the nested walk over
// initiators, targets, storage extents, then tape drives.
//------------------------------------------------------------------------------

namespace
{

// The text before the first "_", and in rest the text after it: all of it,
// or only up to the next "_" if toNext; false if there is no "_".
bool cutAtUnderscore(const String& text, String& first, String& rest, bool toNext)
{
    size_t a = text.find('_');

    if (a == (size_t)-1)
        return false;

    first = text.substr(0, a);
    size_t b = toNext ? text.find('_', a + 1) : (size_t)-1;
    rest = text.substr(a + 1, b == (size_t)-1 ? (size_t)-1 : b - a - 1);
    return true;
}

std::string portPair(const String& local, const String& remote)
{
    return lowerText(local) + '\n' + lowerText(remote);
}

} // namespace

Enum_Instances_Status VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider::enum_instances(
    const VESPERA_SCSIInitiatorTargetLogicalUnitPath*,
    Enum_Instances_Handler<VESPERA_SCSIInitiatorTargetLogicalUnitPath>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List extents(fetchTargetInstances(ID_VESPERA_StorageExtent));
        Instance_List tapes(fetchTargetInstances(ID_VESPERA_TapeDrive));

        if (extents.empty() && tapes.empty())
        {
            TLOG(LL_ERR, "Error: Invalid number of instances returned!\n");
            return ENUM_INSTANCES_OK;
        }

        Instance_List endpoints(fetchInstances(ID_VESPERA_SCSIProtocolEndpoint));

        if (endpoints.empty())
        {
            TLOG(LL_ERR, "Error: Invalid number of instances returned!\n");
            return ENUM_INSTANCES_OK;
        }

        TLOG(LL_DBG, "Number of SCSIPROTOCOLENDPOINT(Initiator and Target)= %d",
            (int)endpoints.size());

        std::vector<size_t> initiators;
        std::unordered_map<std::string, std::vector<size_t> > targetsOfPort;
        size_t targetCount = 0;

        for (size_t e = 0; e < endpoints.size(); e++)
        {
            const CIM_SCSIProtocolEndpoint* endpoint = endpoints.get<CIM_SCSIProtocolEndpoint>(e);

            if (!endpoint)
                continue;

            if (!endpoint->Role.null && endpoint->Role.value == 2)
            {
                initiators.push_back(e);
                continue;
            }

            targetCount++;
            String local, remote;
            String name = textOf(endpoint->ElementName);

            if (cutAtUnderscore(name, local, remote, false))
                targetsOfPort[lowerText(local)].push_back(e);
        }

        char line[256];
        snprintf(line, sizeof(line), "Number of SCSIPROTOCOLENDPOINT(Initiator)= %d; "
            "SCSIPROTOCOLENDPOINT(Target)= %d; STORAGEEXTENT= %d; TAPEDRIVE= %d ",
            (int)initiators.size(), (int)targetCount, (int)extents.size(), (int)tapes.size());
        TLOG(LL_DBG, "%s", line);

        // The units on each pair of local and remote port, extents first.
        std::unordered_map<std::string, std::vector<const Instance*> > unitsOn;

        for (const Instance_List* units : { &extents, &tapes })
        {
            for (size_t u = 0; u < units->size(); u++)
            {
                const CIM_LogicalDevice* unit = units->get<CIM_LogicalDevice>(u);
                String local, remote;

                if (unit && cutAtUnderscore(textOf(unit->DeviceID), local, remote, true))
                    unitsOn[portPair(local, remote)].push_back((*units)[u]);
            }
        }

        for (size_t i = 0; i < initiators.size() && out.open(); i++)
        {
            const Instance* initiator = endpoints[initiators[i]];
            String port = textOf(checked_cast<CIM_ManagedElement>(initiator)->ElementName);
            auto targets = targetsOfPort.find(lowerText(port));

            if (targets == targetsOfPort.end())
                continue;

            for (size_t t = 0; t < targets->second.size() && out.open(); t++)
            {
                const Instance* target = endpoints[targets->second[t]];
                String local, remote;
                cutAtUnderscore(textOf(checked_cast<CIM_ManagedElement>(target)->ElementName),
                    local, remote, false);
                auto units = unitsOn.find(portPair(local, remote));

                if (units == unitsOn.end())
                    continue;

                for (size_t u = 0; u < units->second.size() && out.open(); u++)
                    out.send(initiator, target, units->second[u]);
            }
        }

        return ENUM_INSTANCES_OK;
    });
}

namespace
{

// What the associators' walk needs of one request, and what it has sent.
struct Path_Associators
{
    const Instance* source;
    const char* result_class;
    const char* role;
    const char* result_role;
    Enum_Associators_Handler<Instance>* handler;
    bool open;
};

// Each path that holds the source gives its other ends, as the bridge's own
// walk would pair them; the handler takes a reference of each.
bool sendOtherEnds(Instance* path, Enum_Instances_Status, void* client_data)
{
    Path_Associators* walk = (Path_Associators*)client_data;

    if (!path)
        return false;

    if (walk->open)
    {
        Array<const Instance*> ends;
        ssize_t n = get_associators(walk->source, path, walk->result_class, walk->role,
            walk->result_role, ends);

        for (ssize_t i = 0; i < n && walk->open; i++)
        {
            Instance* end = (Instance*)ends[i];
            ref(end);
            walk->open = walk->handler->handle(end);
        }
    }

    destroy(path);
    return walk->open;
}

} // namespace

Enum_Associators_Status VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider::enum_associators(
    const Instance* instance, const String& result_class, const String& role,
    const String& result_role, Enum_Associators_Handler<Instance>* handler)
{
    if (!instance || !handler)
        return ENUM_ASSOCIATORS_FAILED;

    Path_Associators walk = { instance, result_class.c_str(), role.c_str(),
        result_role.c_str(), handler, true };
    Enum_Instances_Handler<VESPERA_SCSIInitiatorTargetLogicalUnitPath> paths(
        &sendOtherEnds, &walk);

    switch (enum_instances(0, &paths))
    {
        case ENUM_INSTANCES_OK:
            return ENUM_ASSOCIATORS_OK;
        case ENUM_INSTANCES_ACCESS_DENIED:
            return ENUM_ASSOCIATORS_ACCESS_DENIED;
        default:
            return ENUM_ASSOCIATORS_FAILED;
    }
}

} // namespace OLMA
