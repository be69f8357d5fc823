// Association classes as a client walks them through the stand-in CIM
// server: each class's ends, the pairs it must hold on a host (worked out
// from the host's description and the ends' own enumerations, not from the
// pairing code), and the four association operations checked against
// those pairs with their filters.
#ifndef _VSPR_model_AssociationSupport_h
#define _VSPR_model_AssociationSupport_h

#include <algorithm>
#include <functional>
#include <map>
#include <set>

#include "ProvidersSupport.h"

namespace assoc_test
{

using namespace providers_test;

typedef std::vector<std::string> Labels;

// An association class and the names of its references, in their order.
struct Association_Row
{
    const char* cls;
    std::vector<std::string> roles;
};

inline const std::vector<Association_Row>& associationRows()
{
    static const std::vector<std::string> AD = {"Antecedent", "Dependent"};
    static const std::vector<std::string> GP = {"GroupComponent", "PartComponent"};
    static const std::vector<std::string> SU = {"ServiceProvided", "UserOfService"};
    static const std::vector<Association_Row> rows =
    {
        {"VESPERA_PortControllerSystemDevice", GP},
        {"VESPERA_FCPortSystemDevice", GP},
        {"VESPERA_EthernetPortSystemDevice", GP},
        {"VESPERA_StorageResourcesSystemDevice", GP},
        {"VESPERA_HostedAccessPoint", AD},
        {"VESPERA_HostedCollection", AD},
        {"VESPERA_HostedLANEndpoint", AD},
        {"VESPERA_InstalledSoftwareIdentity", {"System", "InstalledSoftware"}},
        {"VESPERA_RemoteServiceHostedAccessPoint", AD},
        {"VESPERA_HBASoftwareInstallationServiceHostedService", AD},
        {"VESPERA_HBASoftwareInstallationServiceElementCapabilities",
            {"ManagedElement", "Capabilities"}},
        {"VESPERA_ObjectManagerHostedService", AD},
        {"VESPERA_CommMechHostedAccessPoint", AD},
        {"VESPERA_CommMechanismForManager", AD},
        {"VESPERA_NamespaceInManager", AD},
        {"VESPERA_ProfileElementSoftwareIdentity", AD},
        {"VESPERA_ElementConformsToProfile", {"ConformantStandard", "ManagedElement"}},
        {"VESPERA_SubProfileRequiresProfile", AD},
        {"VESPERA_AssociatedAlarm", AD},
        {"VESPERA_DeviceSAPImplementation", AD},
        {"VESPERA_ElementStatisticalData", {"ManagedElement", "Stats"}},
        {"VESPERA_LANEndpointDeviceSAPImplementation", AD},
        {"VESPERA_MemberOfCollection", {"Collection", "Member"}},
        {"VESPERA_ControlledBy", AD},
        {"VESPERA_EthernetPortControlledBy", AD},
        {"VESPERA_HostedDependency", AD},
        {"VESPERA_AdapterElementSoftwareIdentity", AD},
        {"VESPERA_Realizes", AD},
        {"VESPERA_ProductElementComponent", GP},
        {"VESPERA_ProductPhysicalComponent", GP},
        {"VESPERA_PhysicalConnectorContainer", GP},
        {"VESPERA_EthernetPortRealizes", AD},
        {"VESPERA_SCSIInitiatorTargetLogicalUnitPath", {"Initiator", "Target", "LogicalUnit"}},
        {"VESPERA_DiagnosticElementSoftwareIdentity", AD},
        {"VESPERA_AvailableDiagnosticServiceForAdapter", SU},
        {"VESPERA_AvailableDiagnosticServiceForFCPort", SU},
        {"VESPERA_AvailableDiagnosticServiceForEthernetPort", SU},
        {"VESPERA_OwningJobElement", {"OwningElement", "OwnedElement"}},
        {"VESPERA_AffectedJobElement", {"AffectedElement", "AffectingElement"}},
        {"VESPERA_ServiceRecordAppliesToElement", AD},
        {"VESPERA_CompletionRecordAppliesToElement", AD},
    };
    return rows;
}

inline std::string lower(std::string s)
{
    for (char& c : s)
        c = (char)tolower((unsigned char)c);
    return s;
}

// "10:00:00:05:..." to "10000005...".
inline std::string plain(const std::string& colon)
{
    std::string s;
    for (char c : colon)
        if (c != ':')
            s += (char)tolower((unsigned char)c);
    return s;
}

// An element as the tests name it: its class without the prefix and the
// key that tells it apart from the others of its class.
inline std::string label(const ch::Object_Path& p)
{
    std::string kind = p.class_name.compare(0, 8, "VESPERA_") == 0 ?
        p.class_name.substr(8) : p.class_name;
    for (const char* k : {"DeviceID", "InstanceID", "Tag", "IdentifyingNumber", "Name"})
        if (const ch::Value* v = p.key(k))
            return kind + ":" + lower(v->text());
    return kind;
}

// One association as its ends, in the order of the row's roles.
struct Pair
{
    std::vector<ch::Object_Path> ends;

    std::string text() const
    {
        std::string t;
        for (const ch::Object_Path& e : ends)
            t += (t.empty() ? "" : " | ") + label(e);
        return t;
    }
};

inline Labels sorted(Labels l)
{
    std::sort(l.begin(), l.end());
    return l;
}

inline Labels labelsOf(const std::vector<ch::Object_Path>& paths)
{
    Labels out;
    for (const ch::Object_Path& p : paths)
        out.push_back(label(p));
    return sorted(out);
}

inline Labels labelsOf(const std::vector<ch::Instance>& instances)
{
    Labels out;
    for (const ch::Instance& i : instances)
        out.push_back(label(i.path));
    return sorted(out);
}

// The pairs of an association path list: every role must be a reference.
inline std::vector<Pair> pairsOf(const Association_Row& row,
    const std::vector<ch::Object_Path>& paths)
{
    std::vector<Pair> pairs;
    for (const ch::Object_Path& a : paths)
    {
        Pair p;
        for (const std::string& role : row.roles)
        {
            const ch::Value* v = a.key(role);
            EXPECT_TRUE(v && v->ref) << row.cls << " has no " << role << ": " << a.to_string();
            p.ends.push_back(v && v->ref ? *v->ref : ch::Object_Path());
        }
        pairs.push_back(p);
    }
    return pairs;
}

inline Labels pairTexts(const std::vector<Pair>& pairs)
{
    Labels out;
    for (const Pair& p : pairs)
        out.push_back(p.text());
    return sorted(out);
}

//------------------------------------------------------------------------------
// What a host must show: its description read as the tests understand it,
// and the enumerations of the end classes.
//------------------------------------------------------------------------------

struct Described_Port
{
    std::string wwn, node, sfpSerial;
    std::vector<std::string> targets;   // remote ports that are targets
};

struct Described_Eth
{
    std::string mac, dev;
};

struct Described_Adapter
{
    int id = 0;
    bool cna = false;
    std::string address, serial, networkDriver;
    std::vector<Described_Port> fc;
    std::vector<Described_Eth> eth;
};

class World
{
public:
    explicit World(ch::Host* host, const Json::Value& description) : _host(host)
    {
        int id = 0;
        for (const Json::Value& a : description["adapters"])
        {
            const Json::Value& hba = a["hbaData"];
            Described_Adapter d;
            d.id = ++id;
            d.cna = hba.isMember("hbaMAC");
            d.address = plain(hba.get(d.cna ? "hbaMAC" : "wwn", "").asString());
            d.serial = hba.get("serialNumber", "").asString();
            std::string oem = hba.get("oemSerialNum", "").asString();
            std::string part = hba.get("partNum", "").asString();
            if (!oem.empty())
                d.serial = oem.compare(0, part.size(), part) == 0 ? oem.substr(part.size()) : oem;
            d.networkDriver = a["driver"].get("networkDriverName", "").asString();
            for (const Json::Value& p : a["fcPorts"])
            {
                Described_Port port;
                port.wwn = plain(p["wwn"].asString());
                port.node = plain(p.get("nodeWwn", hba.get("wwn", "")).asString());
                if (p.isMember("sfp"))
                    port.sfpSerial = p["sfp"].get("serialNo", "").asString();
                for (const Json::Value& r : p["remotePorts"])
                    if (r["deviceData"].get("isTarget", false).asBool())
                        port.targets.push_back(plain(r["remotePortWwn"].asString()));
                d.fc.push_back(port);
            }
            for (const Json::Value& e : a["ethPorts"])
                d.eth.push_back({plain(e["mac"].asString()), e.get("ethDev", "").asString()});
            adapters.push_back(d);
        }
    }

    std::vector<Described_Adapter> adapters;

    // The enumerated elements of a class, in their order.
    const std::vector<ch::Instance>& of(const std::string& cls)
    {
        auto at = _instances.find(cls);
        if (at == _instances.end())
        {
            ch::Object_Path path;
            path.name_space = "root/vespera";
            path.class_name = cls;
            ch::Result r = _host->ei(path);
            EXPECT_EQ(CMPI_RC_OK, r.rc) << cls << ": " << r.message;
            at = _instances.emplace(cls, r.instances).first;
        }
        return at->second;
    }

    Labels labels(const std::string& cls)
    {
        Labels out;
        for (const ch::Instance& i : of(cls))
            out.push_back(label(i.path));
        return out;
    }

    // The one element of a class.
    std::string one(const std::string& cls)
    {
        Labels l = labels(cls);
        EXPECT_EQ(1u, l.size()) << cls;
        return l.empty() ? "?" : l[0];
    }

    // The labels of the tests that ports of FC, Ethernet and adapters run.
    Labels tests(std::initializer_list<const char*> classes)
    {
        Labels out;
        for (const char* c : classes)
            for (const std::string& l : labels(c))
                out.push_back(l);
        return out;
    }

private:
    ch::Host* _host;
    std::map<std::string, std::vector<ch::Instance> > _instances;
};

inline std::string join(std::initializer_list<std::string> parts)
{
    std::string t;
    for (const std::string& p : parts)
        t += (t.empty() ? "" : " | ") + p;
    return t;
}

inline void allWithAll(Labels& out, const Labels& left, const Labels& right)
{
    for (const std::string& l : left)
        for (const std::string& r : right)
            out.push_back(join({l, r}));
}

// The pairs a class must hold, by what it means. The diagnostic job's
// associations are left to the tests that run a job.
inline Labels expectedPairs(World& w, const std::string& cls)
{
    Labels out;
    auto adapterLabel = [](const Described_Adapter& a) { return "PortController:" + a.address; };
    auto fcLabel = [](const Described_Port& p) { return "FCPort:" + p.wwn; };
    auto ethLabel = [](const Described_Eth& e) { return "EthernetPort:" + e.mac; };
    auto connectorLabel = [](const Described_Adapter& a, size_t place) {
        return "PhysicalConnector:" + lower(a.fc[place].sfpSerial) + "_" +
            std::to_string(a.id) + "_" + std::to_string(place);
    };
    auto packageOf = [&](const Described_Adapter& a) {
        for (const ch::Instance& p : w.of("VESPERA_PhysicalPackage"))
            if (p.get_text("SerialNumber") == a.serial)
                return label(p.path);
        return std::string("PhysicalPackage:?");
    };
    auto system = [&]() { return Labels{w.one("VESPERA_ComputerSystem")}; };
    auto withSystem = [&](const char* partClass) {
        allWithAll(out, system(), w.labels(partClass));
    };

    if (cls == "VESPERA_PortControllerSystemDevice")
        withSystem("VESPERA_PortController");
    else if (cls == "VESPERA_FCPortSystemDevice")
        withSystem("VESPERA_FCPort");
    else if (cls == "VESPERA_EthernetPortSystemDevice")
        withSystem("VESPERA_EthernetPort");
    else if (cls == "VESPERA_StorageResourcesSystemDevice")
    {
        withSystem("VESPERA_StorageExtent");
        withSystem("VESPERA_TapeDrive");
    }
    else if (cls == "VESPERA_HostedAccessPoint")
        withSystem("VESPERA_SCSIProtocolEndpoint");
    else if (cls == "VESPERA_HostedCollection")
        withSystem("VESPERA_LogicalPortGroup");
    else if (cls == "VESPERA_HostedLANEndpoint")
        withSystem("VESPERA_LANEndpoint");
    else if (cls == "VESPERA_InstalledSoftwareIdentity")
        withSystem("VESPERA_AdapterSoftwareIdentity");
    else if (cls == "VESPERA_RemoteServiceHostedAccessPoint")
        withSystem("VESPERA_RemoteServiceAccessPoint");
    else if (cls == "VESPERA_HBASoftwareInstallationServiceHostedService")
        withSystem("VESPERA_HBASoftwareInstallationService");
    else if (cls == "VESPERA_HBASoftwareInstallationServiceElementCapabilities")
        allWithAll(out, w.labels("VESPERA_HBASoftwareInstallationService"),
            w.labels("VESPERA_HBASoftwareInstallationServiceCapabilities"));
    else if (cls == "VESPERA_ObjectManagerHostedService")
        withSystem("VESPERA_ObjectManager");
    else if (cls == "VESPERA_CommMechHostedAccessPoint")
        withSystem("VESPERA_CIMXMLCommunicationMechanism");
    else if (cls == "VESPERA_CommMechanismForManager")
        allWithAll(out, w.labels("VESPERA_ObjectManager"),
            w.labels("VESPERA_CIMXMLCommunicationMechanism"));
    else if (cls == "VESPERA_NamespaceInManager")
        allWithAll(out, w.labels("VESPERA_ObjectManager"), w.labels("VESPERA_Namespace"));
    else if (cls == "VESPERA_ProfileElementSoftwareIdentity")
    {
        allWithAll(out, w.labels("VESPERA_ProfileSoftwareIdentity"),
            w.labels("VESPERA_RegisteredProfile"));
        allWithAll(out, w.labels("VESPERA_ProfileSoftwareIdentity"),
            w.labels("VESPERA_RegisteredSubProfile"));
    }
    else if (cls == "VESPERA_ElementConformsToProfile")
    {
        for (const char* p : {"fc hba", "host discovered resources", "storage hba"})
            out.push_back(join({std::string("RegisteredProfile:") + p, system()[0]}));
        out.push_back(join({"RegisteredProfile:server", w.one("VESPERA_ObjectManager")}));
        for (const char* list : {"VESPERA_RegisteredProfile", "VESPERA_RegisteredSubProfile"})
            for (const std::string& p : w.labels(list))
                if (p != "RegisteredProfile:smi-s")
                    out.push_back(join({"RegisteredProfile:smi-s", p}));
    }
    else if (cls == "VESPERA_SubProfileRequiresProfile")
    {
        for (const char* s : {"fc initiator ports", "software update", "software inventory",
                 "access points", "physical asset", "ethernet port", "diagnostics profile",
                 "host lan network port"})
            out.push_back(join({"RegisteredProfile:fc hba",
                std::string("RegisteredSubProfile:") + s}));
        out.push_back(join({"RegisteredProfile:server",
            "RegisteredSubProfile:profile registration"}));
        out.push_back(join({"RegisteredProfile:storage hba",
            "RegisteredSubProfile:fcoe initiator ports"}));
    }
    else if (cls == "VESPERA_AssociatedAlarm")
    {
        for (const std::string& a : w.labels("VESPERA_AlarmDevice"))
            out.push_back(join({a, "FCPort:" + a.substr(a.find(':') + 1)}));
    }
    else if (cls == "VESPERA_ElementStatisticalData")
    {
        for (const std::string& s : w.labels("VESPERA_FCPortStatistics"))
            out.push_back(join({"FCPort:" + s.substr(s.find(':') + 1), s}));
    }
    else if (cls == "VESPERA_DeviceSAPImplementation")
    {
        for (const Described_Adapter& a : w.adapters)
            for (const Described_Port& p : a.fc)
                out.push_back(join({fcLabel(p), "SCSIProtocolEndpoint:" + p.wwn}));
    }
    else if (cls == "VESPERA_LANEndpointDeviceSAPImplementation")
    {
        for (const Described_Adapter& a : w.adapters)
            for (const Described_Eth& e : a.eth)
                out.push_back(join({ethLabel(e), "LANEndpoint:" + lower(e.dev)}));
    }
    else if (cls == "VESPERA_MemberOfCollection")
    {
        // A port whose node has no WWN is in no group.
        for (const Described_Adapter& a : w.adapters)
            for (const Described_Port& p : a.fc)
                if (!p.node.empty())
                    out.push_back(join({"LogicalPortGroup:" + p.node, fcLabel(p)}));
    }
    else if (cls == "VESPERA_ControlledBy" || cls == "VESPERA_EthernetPortControlledBy")
    {
        for (const Described_Adapter& a : w.adapters)
        {
            if (cls == "VESPERA_ControlledBy")
                for (const Described_Port& p : a.fc)
                    out.push_back(join({adapterLabel(a), fcLabel(p)}));
            else
                for (const Described_Eth& e : a.eth)
                    out.push_back(join({adapterLabel(a), ethLabel(e)}));
        }
    }
    else if (cls == "VESPERA_HostedDependency")
    {
        for (const Described_Adapter& a : w.adapters)
            for (size_t i = 0; a.cna && i < a.fc.size() && i < a.eth.size(); i++)
                out.push_back(join({ethLabel(a.eth[i]), fcLabel(a.fc[i])}));
    }
    else if (cls == "VESPERA_AdapterElementSoftwareIdentity")
    {
        // Firmware and BIOS are "<adapter>_<kind>"; drivers belong to all
        // but the network driver, which an FC HBA doesn't use.
        std::set<std::string> networkDrivers;
        for (const Described_Adapter& a : w.adapters)
            if (!a.networkDriver.empty())
                networkDrivers.insert("AdapterSoftwareIdentity:" + lower(a.networkDriver));
        for (const Described_Adapter& a : w.adapters)
            for (const std::string& s : w.labels("VESPERA_AdapterSoftwareIdentity"))
            {
                size_t cut = s.find('_');
                bool own = cut != std::string::npos &&
                    s.substr(s.find(':') + 1, cut - s.find(':') - 1) == a.address;
                bool driver = cut == std::string::npos &&
                    (a.cna || !networkDrivers.count(s));
                if (own || driver)
                    out.push_back(join({s, adapterLabel(a)}));
            }
    }
    else if (cls == "VESPERA_Realizes")
    {
        for (const Described_Adapter& a : w.adapters)
            out.push_back(join({packageOf(a), adapterLabel(a)}));
    }
    else if (cls == "VESPERA_ProductElementComponent")
    {
        for (const Described_Adapter& a : w.adapters)
            out.push_back(join({"Product:" + lower(a.serial), adapterLabel(a)}));
    }
    else if (cls == "VESPERA_ProductPhysicalComponent")
    {
        for (const Described_Adapter& a : w.adapters)
            out.push_back(join({"Product:" + lower(a.serial), packageOf(a)}));
    }
    else if (cls == "VESPERA_PhysicalConnectorContainer")
    {
        for (const Described_Adapter& a : w.adapters)
            for (size_t i = 0; i < a.fc.size(); i++)
                if (!a.fc[i].sfpSerial.empty())
                    out.push_back(join({packageOf(a), connectorLabel(a, i)}));
    }
    else if (cls == "VESPERA_EthernetPortRealizes")
    {
        // The connector at an FC port's place realizes the Ethernet port of
        // that place, where the adapter has one.
        for (const Described_Adapter& a : w.adapters)
            for (size_t i = 0; i < a.fc.size() && i < a.eth.size(); i++)
                if (!a.fc[i].sfpSerial.empty())
                    out.push_back(join({connectorLabel(a, i), ethLabel(a.eth[i])}));
    }
    else if (cls == "VESPERA_SCSIInitiatorTargetLogicalUnitPath")
    {
        Labels units = w.labels("VESPERA_StorageExtent");
        for (const std::string& t : w.labels("VESPERA_TapeDrive"))
            units.push_back(t);
        for (const Described_Adapter& a : w.adapters)
            for (const Described_Port& p : a.fc)
                for (const std::string& r : p.targets)
                    for (const std::string& u : units)
                        if (u.find(":" + p.wwn + "_" + r + "_") != std::string::npos)
                            out.push_back(join({"SCSIProtocolEndpoint:" + p.wwn,
                                "SCSIProtocolEndpoint:" + p.wwn + "_" + r, u}));
    }
    else if (cls == "VESPERA_DiagnosticElementSoftwareIdentity")
        allWithAll(out, w.labels("VESPERA_DiagnosticSoftwareIdentity"),
            w.tests({"VESPERA_MemoryDiagnosticTest", "VESPERA_LoopbackDiagnosticTest",
                "VESPERA_PCILoopbackDiagnosticTest", "VESPERA_EthLoopbackDiagnosticTest"}));
    else if (cls == "VESPERA_AvailableDiagnosticServiceForAdapter")
        allWithAll(out, w.tests({"VESPERA_MemoryDiagnosticTest"}),
            w.labels("VESPERA_PortController"));
    else if (cls == "VESPERA_AvailableDiagnosticServiceForEthernetPort")
        allWithAll(out, w.tests({"VESPERA_EthLoopbackDiagnosticTest",
            "VESPERA_PCILoopbackDiagnosticTest"}), w.labels("VESPERA_EthernetPort"));
    else if (cls == "VESPERA_AvailableDiagnosticServiceForFCPort")
    {
        // A CNA's ports don't loop back inside the adapter.
        Labels tests = w.tests({"VESPERA_LoopbackDiagnosticTest",
            "VESPERA_PCILoopbackDiagnosticTest"});
        for (const Described_Adapter& a : w.adapters)
            for (const Described_Port& p : a.fc)
                for (const std::string& t : tests)
                    if (!a.cna || t != "LoopbackDiagnosticTest:vespera:internalloopbacktest")
                        out.push_back(join({t, fcLabel(p)}));
    }
    return sorted(out);
}

//------------------------------------------------------------------------------
// The operations from one end, against what the pairs say.
//------------------------------------------------------------------------------

struct Filters
{
    std::string role, resultRole, resultClass;
};

// Where an end stands in the pairs, with the filters of associators and
// references: the other ends, and the associations.
inline Labels expectedAssociators(ch::Host* host, const Association_Row& row,
    const std::vector<Pair>& pairs, const std::string& end, const Filters& f)
{
    Labels out;
    for (const Pair& p : pairs)
    {
        bool source = false;
        for (size_t i = 0; i < p.ends.size(); i++)
            source = source || (label(p.ends[i]) == end &&
                (f.role.empty() || lower(f.role) == lower(row.roles[i])));
        if (!source)
            continue;
        for (size_t j = 0; j < p.ends.size(); j++)
        {
            if (label(p.ends[j]) == end)
                continue;
            if (!f.resultRole.empty() && lower(f.resultRole) != lower(row.roles[j]))
                continue;
            if (!f.resultClass.empty() && !host->class_is_a(p.ends[j].class_name, f.resultClass))
                continue;
            out.push_back(label(p.ends[j]));
        }
    }
    return sorted(out);
}

inline Labels expectedReferences(const Association_Row& row, const std::vector<Pair>& pairs,
    const std::string& end, const std::string& role)
{
    Labels out;
    for (const Pair& p : pairs)
        for (size_t i = 0; i < p.ends.size(); i++)
            if (label(p.ends[i]) == end && (role.empty() || lower(role) == lower(row.roles[i])))
            {
                out.push_back(p.text());
                break;
            }
    return sorted(out);
}

inline Labels referenceTexts(const Association_Row& row, const ch::Result& r)
{
    std::vector<ch::Object_Path> paths = r.paths;
    for (const ch::Instance& i : r.instances)
        paths.push_back(i.path);
    return pairTexts(pairsOf(row, paths));
}

inline std::string rcText(const ch::Result& r)
{
    return ch::rc_name(r.rc) + " " + r.message;
}

// The ends at one role, each once, in the order of the pairs.
inline std::vector<ch::Object_Path> endsAt(const std::vector<Pair>& pairs, size_t role)
{
    std::vector<ch::Object_Path> out;
    std::set<std::string> seen;
    for (const Pair& p : pairs)
        if (seen.insert(label(p.ends[role])).second)
            out.push_back(p.ends[role]);
    return out;
}

// associatorNames and referenceNames from an end, without filters.
inline void checkNames(ch::Host* host, const Association_Row& row, const std::vector<Pair>& pairs,
    const ch::Object_Path& end)
{
    std::string e = label(end);
    ch::Result r = host->an(end, row.cls);
    ASSERT_TRUE(r.ok()) << row.cls << " an " << e << ": " << rcText(r);
    EXPECT_EQ(expectedAssociators(host, row, pairs, e, Filters()), labelsOf(r.paths))
        << row.cls << " an " << e;

    r = host->rn(end, row.cls);
    ASSERT_TRUE(r.ok()) << row.cls << " rn " << e << ": " << rcText(r);
    EXPECT_EQ(expectedReferences(row, pairs, e, ""), referenceTexts(row, r))
        << row.cls << " rn " << e;
}

// Every filter of the four operations from one end: each role and result
// role (one in other case), each class the other ends have, a parent of
// them all and a class none has; references by role; and whole instances
// with a property list.
inline void checkFilters(ch::Host* host, const Association_Row& row, const std::vector<Pair>& pairs,
    const ch::Object_Path& end)
{
    std::string e = label(end);
    std::vector<std::string> roles = row.roles;
    roles.push_back(lower(row.roles[0]));

    for (const std::string& role : roles)
    {
        Filters byRole = {role, "", ""};
        ch::Result r = host->an(end, row.cls, "", role);
        EXPECT_EQ(expectedAssociators(host, row, pairs, e, byRole), labelsOf(r.paths))
            << row.cls << " an " << e << " role " << role << ": " << rcText(r);

        Filters byResultRole = {"", role, ""};
        r = host->an(end, row.cls, "", "", role);
        EXPECT_EQ(expectedAssociators(host, row, pairs, e, byResultRole), labelsOf(r.paths))
            << row.cls << " an " << e << " result role " << role << ": " << rcText(r);

        r = host->rn(end, row.cls, role);
        EXPECT_EQ(expectedReferences(row, pairs, e, role), referenceTexts(row, r))
            << row.cls << " rn " << e << " role " << role << ": " << rcText(r);
    }

    std::set<std::string> classes = {"CIM_ManagedElement", "CIM_AlertIndication"};
    for (const Pair& p : pairs)
        for (const ch::Object_Path& other : p.ends)
            classes.insert(other.class_name);
    for (const std::string& cls : classes)
    {
        Filters byClass = {"", "", cls};
        ch::Result r = host->an(end, row.cls, cls);
        EXPECT_EQ(expectedAssociators(host, row, pairs, e, byClass), labelsOf(r.paths))
            << row.cls << " an " << e << " result class " << cls << ": " << rcText(r);
    }

    // References whole, with the property list that names one reference.
    std::vector<std::string> refProps = {row.roles[0]};
    ch::Result r = host->ri(end, row.cls, "", &refProps);
    ASSERT_TRUE(r.ok()) << row.cls << " ri " << e << ": " << rcText(r);
    EXPECT_EQ(expectedReferences(row, pairs, e, ""), referenceTexts(row, r))
        << row.cls << " ri " << e;

    // The other ends whole, as the server has them, with only the keys and
    // the properties asked for.
    std::vector<std::string> props = {"ElementName"};
    r = host->ai(end, row.cls, "", "", "", &props);
    ASSERT_TRUE(r.ok()) << row.cls << " ai " << e << ": " << rcText(r);
    EXPECT_EQ(expectedAssociators(host, row, pairs, e, Filters()), labelsOf(r.instances))
        << row.cls << " ai " << e;
    for (const ch::Instance& i : r.instances)
        for (const ch::Property& prop : i.properties)
            EXPECT_TRUE(prop.name == "ElementName" || i.path.key(prop.name))
                << row.cls << " ai " << e << ": " << i.class_name << "." << prop.name;
}

// An element that no association of the class touches: one of another
// class, and one of an end's class that isn't on the host.
inline void checkUnrelated(ch::Host* host, const Association_Row& row, const ch::Object_Path& end)
{
    ch::Object_Path agent;
    agent.name_space = "root/vespera";
    agent.class_name = "VESPERA_AgentService";
    agent.keys.push_back({"Name", ch::Value::of_string("Vespera Agent Service Provider")});

    ch::Object_Path gone = end;
    for (ch::Property& k : gone.keys)
        if (k.name == "DeviceID" || k.name == "InstanceID" || k.name == "Tag" || k.name == "Name")
            k.value = ch::Value::of_string("not-on-this-host");

    for (const ch::Object_Path& source : {agent, gone})
    {
        ch::Result r = host->an(source, row.cls);
        EXPECT_TRUE(r.ok() && r.paths.empty()) << row.cls << " an " << source.to_string()
            << ": " << rcText(r) << ", " << r.paths.size();
        r = host->rn(source, row.cls);
        EXPECT_TRUE(r.ok() && r.paths.empty()) << row.cls << " rn " << source.to_string()
            << ": " << rcText(r) << ", " << r.paths.size();
    }
}

// The whole check of one class: its pairs are expected (unless null, for a
// class whose pairs the caller has checked), and the operations from a few
// ends of each role agree with them.
inline void checkAssociation(ch::Host* host, const Association_Row& row, const Labels* expected)
{
    ch::Object_Path cls;
    cls.name_space = "root/vespera";
    cls.class_name = row.cls;
    ch::Result all = host->ein(cls);
    ASSERT_TRUE(all.ok()) << row.cls << ": " << rcText(all);
    std::vector<Pair> pairs = pairsOf(row, all.paths);
    if (expected)
    {
        EXPECT_EQ(*expected, pairTexts(pairs)) << row.cls;
    }

    for (size_t role = 0; role < row.roles.size(); role++)
    {
        std::vector<ch::Object_Path> ends = endsAt(pairs, role);
        if (ends.empty())
            continue;
        // The first, one in the middle and the last.
        std::set<size_t> some = {0, ends.size() / 2, ends.size() - 1};
        for (size_t i : some)
            checkNames(host, row, pairs, ends[i]);
        checkFilters(host, row, pairs, ends[0]);
        checkUnrelated(host, row, ends[0]);
    }
}

} // namespace assoc_test

#endif
