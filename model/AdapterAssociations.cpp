// The associations of an adapter: its ports, its card, its product, its
// software and the connectors of its card.

#include <cstdlib>
#include <map>
#include <memory>

#include "Associations.h"
#include "EthernetPortHelper.h"
#include "ProviderUtil.h"

#include "VESPERA_AdapterSoftwareIdentity.h"
#include "VESPERA_PhysicalConnector.h"
#include "VESPERA_PhysicalPackage.h"
#include "VESPERA_PortController.h"
#include "VESPERA_Product.h"

#include "VESPERA_AdapterElementSoftwareIdentity_Provider.h"
#include "VESPERA_ControlledBy_Provider.h"
#include "VESPERA_EthernetPortControlledBy_Provider.h"
#include "VESPERA_EthernetPortRealizes_Provider.h"
#include "VESPERA_HostedDependency_Provider.h"
#include "VESPERA_PhysicalConnectorContainer_Provider.h"
#include "VESPERA_ProductElementComponent_Provider.h"
#include "VESPERA_ProductPhysicalComponent_Provider.h"
#include "VESPERA_Realizes_Provider.h"

namespace OLMA
{

namespace
{

// ControllerType of an FC HBA; a converged adapter is 1.
const uint16 FC_HBA = 4;

bool isFCHBA(const VESPERA_PortController* adapter)
{
    return !adapter->ControllerType.null && adapter->ControllerType.value == FC_HBA;
}

// The Ethernet ports of an adapter named by its own address (its DeviceID).
// The facade's look-up by adapter wants the address of a port, not of an
// adapter, so the adapter's id is asked for here.
Array<Instance*> ethernetPortsOfAdapter(const String& address)
{
    unsigned id = ProviderUtil::getProviderUtil()->getAdapterId(address);

    if (id == 0 || id == (unsigned)-1)
    {
        TLOG(LL_WARN, "Adapter %s not found in the system.", address.c_str());
        return Array<Instance*>();
    }

    return EthernetPortHelper::getEthernetPortHelperObject()->getInstancesByAdapterId(
        (int)id, ID_VESPERA_EthernetPort);
}

} // namespace

Enum_Instances_Status VESPERA_ControlledBy_Provider::enum_instances(
    const VESPERA_ControlledBy*, Enum_Instances_Handler<VESPERA_ControlledBy>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List adapters(fetchInstances(ID_VESPERA_PortController));

        for (size_t a = 0; a < adapters.size() && out.open(); a++)
        {
            const VESPERA_PortController* adapter = adapters.get<VESPERA_PortController>(a);

            if (!adapter)
                continue;

            Instance_List ports(FCHBAManager::getFCHBAManager()->getFCPortInstancesByAdapter(
                textOf(adapter->DeviceID)));
            sendOneWithEach(out, adapters[a], ports);
        }

        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_EthernetPortControlledBy_Provider::enum_instances(
    const VESPERA_EthernetPortControlledBy*,
    Enum_Instances_Handler<VESPERA_EthernetPortControlledBy>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List adapters(fetchInstances(ID_VESPERA_PortController));

        for (size_t a = 0; a < adapters.size() && out.open(); a++)
        {
            const VESPERA_PortController* adapter = adapters.get<VESPERA_PortController>(a);

            // Only a converged adapter has Ethernet ports.
            if (!adapter || isFCHBA(adapter))
                continue;

            Instance_List ports(ethernetPortsOfAdapter(textOf(adapter->DeviceID)));
            sendOneWithEach(out, adapters[a], ports);
        }

        return ENUM_INSTANCES_OK;
    });
}

// An FCoE port of a converged adapter runs over the Ethernet port at the
// same place.
Enum_Instances_Status VESPERA_HostedDependency_Provider::enum_instances(
    const VESPERA_HostedDependency*, Enum_Instances_Handler<VESPERA_HostedDependency>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List adapters(fetchInstances(ID_VESPERA_PortController));

        for (size_t a = 0; a < adapters.size() && out.open(); a++)
        {
            const VESPERA_PortController* adapter = adapters.get<VESPERA_PortController>(a);

            if (!adapter || isFCHBA(adapter))
                continue;

            String address = textOf(adapter->DeviceID);
            Instance_List fcPorts(
                FCHBAManager::getFCHBAManager()->getFCPortInstancesByAdapter(address));

            if (!present(fcPorts, LL_INFO, "There are no FCPORT instances returned"))
                continue;

            Instance_List ethPorts(ethernetPortsOfAdapter(address));

            if (!present(ethPorts, LL_INFO, "There are no ETHPORT instances returned"))
                continue;

            for (size_t f = 0; f < fcPorts.size() && out.open(); f++)
            {
                const CIM_NetworkPort* fc = fcPorts.get<CIM_NetworkPort>(f);

                for (size_t e = 0; fc && e < ethPorts.size(); e++)
                {
                    const CIM_NetworkPort* eth = ethPorts.get<CIM_NetworkPort>(e);

                    if (eth && !eth->PortNumber.null && !fc->PortNumber.null &&
                        eth->PortNumber.value == fc->PortNumber.value)
                    {
                        out.send(ethPorts[e], fcPorts[f]);
                        break;
                    }
                }
            }
        }

        return ENUM_INSTANCES_OK;
    });
}

//------------------------------------------------------------------------------
// Software. A software identity's InstanceID starts with the address of the
// adapter it belongs to, "_" and its kind; a driver's is its bare name, and
// a driver belongs to every adapter that can use it.
//------------------------------------------------------------------------------

namespace
{

// The InstanceID up to its first "_", leading ones skipped; empty if
// nothing is left.
String ownerOf(const String& id)
{
    size_t start = 0;

    while (start < id.size() && id[start] == '_')
        start++;

    size_t end = id.find('_', start);
    return id.substr(start, end == (size_t)-1 ? (size_t)-1 : end - start);
}

bool holds(const Property<Array<uint16> >& values, uint16 value)
{
    if (values.null)
        return false;

    for (size_t i = 0; i < values.value.size(); i++)
    {
        if (values.value[i] == value)
            return true;
    }

    return false;
}

const uint16 SOFTWARE_DRIVER = 2;

// The network driver: "wxd" by name, or by what it is called here.
bool isNetworkDriver(const CIM_SoftwareIdentity* software, const String& owner)
{
    return owner.equali("wxd") || textOf(software->ElementName).equali("Network driver");
}

} // namespace

Enum_Instances_Status VESPERA_AdapterElementSoftwareIdentity_Provider::enum_instances(
    const VESPERA_AdapterElementSoftwareIdentity*,
    Enum_Instances_Handler<VESPERA_AdapterElementSoftwareIdentity>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List adapters(fetchInstances(ID_VESPERA_PortController));
        Instance_List software(fetchInstances(ID_VESPERA_AdapterSoftwareIdentity));

        for (size_t a = 0; a < adapters.size() && out.open(); a++)
        {
            const VESPERA_PortController* adapter = adapters.get<VESPERA_PortController>(a);

            for (size_t s = 0; adapter && s < software.size() && out.open(); s++)
            {
                const CIM_SoftwareIdentity* sw = software.get<CIM_SoftwareIdentity>(s);

                if (!sw)
                    continue;

                String owner = ownerOf(textOf(sw->InstanceID));

                if (owner.size() == 0)
                {
                    TLOG(LL_INFO, "No MAC or NWWN returned from strtok function");
                    continue;
                }

                bool driver = holds(sw->Classifications, SOFTWARE_DRIVER);

                if (!driver && !owner.equali(textOf(adapter->DeviceID)))
                    continue;

                if (driver && isFCHBA(adapter) && isNetworkDriver(sw, owner))
                    continue;

                out.send(software[s], adapters[a]);
            }
        }

        return ENUM_INSTANCES_OK;
    });
}

//------------------------------------------------------------------------------
// Card and product. All three are built from one adapter's reply, so an
// adapter, its card and its product share the serial number.
//------------------------------------------------------------------------------

Enum_Instances_Status VESPERA_ProductElementComponent_Provider::enum_instances(
    const VESPERA_ProductElementComponent*,
    Enum_Instances_Handler<VESPERA_ProductElementComponent>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List adapters(fetchInstances(ID_VESPERA_PortController));
        Instance_List products(fetchInstances(ID_VESPERA_Product));

        if (adapters.size() != products.size())
        {
            TLOG(LL_ERR, "Invalid mapping information.");
            return ENUM_INSTANCES_FAILED;
        }

        sendMatches(out, adapters, &CIM_ManagedSystemElement::Name,
            products, &CIM_Product::IdentifyingNumber, false, false);
        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_ProductPhysicalComponent_Provider::enum_instances(
    const VESPERA_ProductPhysicalComponent*,
    Enum_Instances_Handler<VESPERA_ProductPhysicalComponent>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List packages(fetchInstances(ID_VESPERA_PhysicalPackage));
        Instance_List products(fetchInstances(ID_VESPERA_Product));

        if (packages.size() != products.size())
        {
            TLOG(LL_ERR, "Error: Improper Product Information!\n");
            return ENUM_INSTANCES_FAILED;
        }

        sendMatches(out, packages, &CIM_PhysicalElement::SerialNumber,
            products, &CIM_Product::IdentifyingNumber, false, false);
        return ENUM_INSTANCES_OK;
    });
}

// Adapters and cards come from the same walk, one of each per adapter, so
// they are paired by position; a position where they disagree pairs
// nothing.
Enum_Instances_Status VESPERA_Realizes_Provider::enum_instances(
    const VESPERA_Realizes*, Enum_Instances_Handler<VESPERA_Realizes>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List adapters(fetchInstances(ID_VESPERA_PortController));
        Instance_List packages(fetchInstances(ID_VESPERA_PhysicalPackage));

        if (adapters.size() != packages.size())
        {
            TLOG(LL_ERR, "Error: Invalid number of instances returned!\n");
            return ENUM_INSTANCES_FAILED;
        }

        for (size_t i = 0; i < adapters.size() && out.open(); i++)
        {
            const VESPERA_PortController* adapter = adapters.get<VESPERA_PortController>(i);
            const VESPERA_PhysicalPackage* package = packages.get<VESPERA_PhysicalPackage>(i);

            if (adapter && package &&
                textOf(adapter->ElementName).equali(textOf(package->SerialNumber)))
                out.send(packages[i], adapters[i]);
        }

        return ENUM_INSTANCES_OK;
    });
}

//------------------------------------------------------------------------------
// Connectors. A connector's Tag ends in "_<adapter id>_<port place>", both in
// decimal; what comes before (the transceiver's serial number) may hold "_"
// itself, so the Tag is read from its end.
//------------------------------------------------------------------------------

namespace
{

bool readDecimal(const String& text, long& value)
{
    if (text.size() == 0 || text.size() > 9)
        return false;

    char* end = 0;
    value = strtol(text.c_str(), &end, 10);
    return end && *end == '\0' && text[0] >= '0' && text[0] <= '9';
}

bool connectorPlace(const VESPERA_PhysicalConnector* connector, int& adapterId, int& place)
{
    String tag = textOf(connector->Tag);
    size_t last = tag.size() ? tag.size() - 1 : 0;

    while (last > 0 && tag[last] != '_')
        last--;

    size_t before = last;

    while (before > 0 && tag[before - 1] != '_')
        before--;

    long id = 0, port = 0;

    if (last == 0 || before == 0 || !readDecimal(tag.substr(before, last - before), id) ||
        !readDecimal(tag.substr(last + 1), port))
    {
        TLOG(LL_WARN, "Connector tag %s names no adapter and port", tag.c_str());
        return false;
    }

    adapterId = (int)id;
    place = (int)port;
    return true;
}

} // namespace

Enum_Instances_Status VESPERA_EthernetPortRealizes_Provider::enum_instances(
    const VESPERA_EthernetPortRealizes*,
    Enum_Instances_Handler<VESPERA_EthernetPortRealizes>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List connectors(fetchInstances(ID_VESPERA_PhysicalConnector));

        if (!present(connectors, LL_WARN, "No Connector Found"))
            return ENUM_INSTANCES_OK;

        // The Ethernet ports of each adapter, asked for once.
        std::map<int, std::unique_ptr<Instance_List> > portsOf;

        for (size_t c = 0; c < connectors.size() && out.open(); c++)
        {
            const VESPERA_PhysicalConnector* connector =
                connectors.get<VESPERA_PhysicalConnector>(c);
            int adapterId = 0, place = 0;

            if (!connector || !connectorPlace(connector, adapterId, place))
                continue;

            std::unique_ptr<Instance_List>& ports = portsOf[adapterId];

            if (!ports)
                ports.reset(new Instance_List(EthernetPortHelper::getEthernetPortHelperObject()->
                    getInstancesByAdapterId(adapterId, ID_VESPERA_EthernetPort)));

            for (size_t p = 0; p < ports->size(); p++)
            {
                const CIM_NetworkPort* port = ports->get<CIM_NetworkPort>(p);

                if (port && !port->PortNumber.null && port->PortNumber.value == place)
                {
                    out.send(connectors[c], (*ports)[p]);
                    break;
                }
            }
        }

        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_PhysicalConnectorContainer_Provider::enum_instances(
    const VESPERA_PhysicalConnectorContainer*,
    Enum_Instances_Handler<VESPERA_PhysicalConnectorContainer>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List connectors(fetchInstances(ID_VESPERA_PhysicalConnector));

        if (!present(connectors, LL_WARN, "No Connectors retrieved\n"))
            return ENUM_INSTANCES_OK;

        Instance_List packages(fetchInstances(ID_VESPERA_PhysicalPackage));

        if (!present(packages, LL_WARN, "No PhysicalPackage retrieved\n"))
            return ENUM_INSTANCES_OK;

        // The serial number of the adapter of each connector, asked for once
        // per adapter; a card holds the connectors of its adapter.
        ProviderUtil* util = ProviderUtil::getProviderUtil();
        std::map<int, String> serialOf;
        std::vector<String> owners(connectors.size());

        for (size_t c = 0; c < connectors.size(); c++)
        {
            const VESPERA_PhysicalConnector* connector =
                connectors.get<VESPERA_PhysicalConnector>(c);
            int adapterId = 0, place = 0;

            if (!connector || !connectorPlace(connector, adapterId, place))
                continue;

            auto at = serialOf.find(adapterId);

            if (at == serialOf.end())
            {
                String address = util->getAddrByAdapterId(adapterId);
                String serial = address.size() ? util->getAdapterSerialNumber(address) : String();
                at = serialOf.emplace(adapterId, serial).first;
            }

            owners[c] = at->second;
        }

        for (size_t p = 0; p < packages.size() && out.open(); p++)
        {
            const CIM_PhysicalElement* package = packages.get<CIM_PhysicalElement>(p);

            if (!package)
                continue;

            String serial = textOf(package->SerialNumber);

            for (size_t c = 0; c < connectors.size() && out.open(); c++)
            {
                if (owners[c].size() && owners[c].equal(serial))
                    out.send(packages[p], connectors[c]);
            }
        }

        return ENUM_INSTANCES_OK;
    });
}

} // namespace OLMA
