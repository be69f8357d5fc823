// vspr-inventory: the host's adapters, ports and what the ports reach, as a
// WBEM client sees them through the provider module.
//
// The module is loaded into the stand-in CIM server. Every class shown is
// enumerated once, and every association that ties them together once, by
// name: the host's adapters, each adapter's card, software and ports, each
// port's beacon and initiator, and the paths from an initiator through its
// targets to their logical units. An element is then found by the object
// path that an association names, as a client would follow a reference;
// only the connector of a port is told by the end of its Tag, which carries
// the port's place, among the connectors that the card holds.

#include <dlfcn.h>
#include <stdlib.h>

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <iostream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include "cimhost.h"

namespace ch = OLMA::cimhost;

namespace
{

typedef std::vector<ch::Instance> Instances;

struct Inventory
{
    ch::Host& host;
    std::vector<std::string> failures;

    explicit Inventory(ch::Host& h) : host(h) { }

    Instances ei(const std::string& cls)
    {
        return call(cls, false).instances;
    }

    // The associations of a class, as paths whose keys are their ends.
    std::vector<ch::Object_Path> ein(const std::string& cls)
    {
        return call(cls, true).paths;
    }

private:

    ch::Result call(const std::string& cls, bool names)
    {
        ch::Object_Path path;
        path.name_space = "root/vespera";
        path.class_name = cls;
        ch::Result r = names ? host.ein(path) : host.ei(path);
        if (!r.ok())
            failures.push_back(cls + ": " + ch::rc_name(r.rc) +
                (r.message.empty() ? "" : " (" + r.message + ")"));
        return r;
    }
};

std::string lower(std::string s)
{
    for (char& c : s)
        if (c >= 'A' && c <= 'Z')
            c = c - 'A' + 'a';
    return s;
}

// An object path as one text, whatever the order of its keys: the same
// element gives the same text wherever a path names it.
std::string pathKey(const ch::Object_Path& path)
{
    std::vector<std::string> keys;
    for (const ch::Property& k : path.keys)
        keys.push_back(lower(k.name) + "=" + k.value.text());
    std::sort(keys.begin(), keys.end());
    std::string text = lower(path.class_name);
    for (const std::string& k : keys)
        text += "\n" + k;
    return text;
}

// The enumerated elements by their paths.
class Elements
{
public:
    void add(const Instances& instances)
    {
        for (const ch::Instance& i : instances)
            _byPath[pathKey(i.path)] = &i;
    }

    const ch::Instance* find(const ch::Object_Path& path) const
    {
        auto at = _byPath.find(pathKey(path));
        return at == _byPath.end() ? 0 : at->second;
    }

private:
    std::map<std::string, const ch::Instance*> _byPath;
};

// What one association class ties to each element: for the end named
// `from`, the ends named `to`, in the order of the associations.
class Links
{
public:
    Links(const std::vector<ch::Object_Path>& associations, const char* from, const char* to)
    {
        for (const ch::Object_Path& a : associations)
        {
            const ch::Value* f = a.key(from);
            const ch::Value* t = a.key(to);
            if (f && f->ref && t && t->ref)
                _ends[pathKey(*f->ref)].push_back(*t->ref);
        }
    }

    const std::vector<ch::Object_Path>& of(const ch::Object_Path& element) const
    {
        static const std::vector<ch::Object_Path> none;
        auto at = _ends.find(pathKey(element));
        return at == _ends.end() ? none : at->second;
    }

private:
    std::map<std::string, std::vector<ch::Object_Path> > _ends;
};

// The instances that the paths name, of those enumerated, in order.
std::vector<const ch::Instance*> found(const Elements& elements,
    const std::vector<ch::Object_Path>& paths)
{
    std::vector<const ch::Instance*> out;
    for (const ch::Object_Path& p : paths)
        if (const ch::Instance* i = elements.find(p))
            out.push_back(i);
    return out;
}

std::string text(const ch::Instance& i, const char* property)
{
    const ch::Value* v = i.get(property);
    if (!v || v->null)
        return "";
    return v->text();
}

uint64_t number(const ch::Instance& i, const char* property)
{
    const ch::Value* v = i.get(property);
    if (!v || v->null || v->is_array())
        return 0;
    return strtoull(v->text().c_str(), 0, 10);
}

// "0x..." digits of a plain address, 0 if it isn't one.
uint64_t addressValue(const std::string& plain)
{
    if (plain.empty() || plain.size() > 16)
        return 0;
    for (char c : plain)
        if (!isxdigit((unsigned char)c))
            return 0;
    return strtoull(plain.c_str(), 0, 16);
}

std::string colon(const std::string& plain)
{
    if (plain.size() % 2 || addressValue(plain) == 0)
        return plain;
    std::string out;
    for (size_t i = 0; i < plain.size(); i += 2)
    {
        if (i)
            out += ':';
        out += plain.substr(i, 2);
    }
    return out;
}

std::string speedText(uint64_t bits)
{
    if (bits == 0)
        return "no link";
    std::ostringstream s;
    if (bits % 1000000000 == 0)
        s << bits / 1000000000 << " Gbit/s";
    else
        s << bits / 1000000 << " Mbit/s";
    return s.str();
}

std::string enabledText(uint64_t state)
{
    switch (state)
    {
        case 2: return "enabled";
        case 3: return "disabled";
        case 5: return "not applicable";
        case 6: return "enabled but offline";
        default: return "state " + std::to_string(state);
    }
}

// A target endpoint ("<port>_<remote port>") and its units on the paths.
struct Target
{
    std::string name;
    std::vector<const ch::Instance*> disks;
    std::vector<const ch::Instance*> tapes;
};

void printUnit(const ch::Instance& i, bool tape)
{
    std::string device = text(i, "DeviceID");
    // "<port>_<remote>_<vendor>_<product>_LUN_<n>": the middle names the unit.
    std::string what;
    size_t a = device.find('_');
    size_t b = a == std::string::npos ? a : device.find('_', a + 1);
    size_t c = device.rfind("_LUN_");
    if (b != std::string::npos && c != std::string::npos && c > b)
        what = device.substr(b + 1, c - b - 1);
    for (char& ch : what)
        if (ch == '_')
            ch = ' ';

    printf("        %-4s %-7s %-24s %s\n", tape ? "tape" : "disk",
        text(i, "ElementName").c_str(), what.c_str(), text(i, "Name").c_str());
}

int usage(const char* argv0)
{
    fprintf(stderr,
        "usage: %s [--host FILE]\n\n"
        "Prints the inventory that the provider module shows: the host, each\n"
        "adapter with its ports, and the remote ports and logical units each FC\n"
        "port reaches. --host runs the simulated adapter library on FILE (a\n"
        "host description) instead of its default host.\n", argv0);
    return 2;
}

} // namespace

int main(int argc, char** argv)
{
    for (int i = 1; i < argc; i++)
    {
        if (!strcmp(argv[i], "--host") && i + 1 < argc)
            setenv("DTRUJ_HOST", argv[++i], 1);
        else
            return usage(argv[0]);
    }

#ifdef VSPR_DTRUJ_PATH
    // The module opens the library by its bare name; once loaded, that name
    // finds this copy, so no search path needs setting.
    if (!getenv("LD_LIBRARY_PATH") || !*getenv("LD_LIBRARY_PATH"))
        dlopen(VSPR_DTRUJ_PATH, RTLD_NOW | RTLD_GLOBAL);
#endif

    ch::Host host;
    if (!host.ok())
    {
        fprintf(stderr, "vspr-inventory: %s\n", host.error().c_str());
        return 1;
    }

    Inventory inv(host);
    Instances systems = inv.ei("VESPERA_ComputerSystem");
    Instances access = inv.ei("VESPERA_RemoteServiceAccessPoint");
    Instances controllers = inv.ei("VESPERA_PortController");
    Instances packages = inv.ei("VESPERA_PhysicalPackage");
    Instances software = inv.ei("VESPERA_AdapterSoftwareIdentity");
    Instances fcPorts = inv.ei("VESPERA_FCPort");
    Instances alarms = inv.ei("VESPERA_AlarmDevice");
    Instances extents = inv.ei("VESPERA_StorageExtent");
    Instances tapes = inv.ei("VESPERA_TapeDrive");
    Instances ethPorts = inv.ei("VESPERA_EthernetPort");
    Instances connectors = inv.ei("VESPERA_PhysicalConnector");

    Elements elements;
    for (const Instances* list : { &systems, &access, &controllers, &packages, &software,
        &fcPorts, &alarms, &extents, &tapes, &ethPorts, &connectors })
        elements.add(*list);

    Links hostAdapters(inv.ein("VESPERA_PortControllerSystemDevice"),
        "GroupComponent", "PartComponent");
    Links hostAccess(inv.ein("VESPERA_RemoteServiceHostedAccessPoint"), "Antecedent", "Dependent");
    Links hostSoftware(inv.ein("VESPERA_InstalledSoftwareIdentity"), "System", "InstalledSoftware");
    Links hostFCPorts(inv.ein("VESPERA_FCPortSystemDevice"), "GroupComponent", "PartComponent");
    Links hostEthPorts(inv.ein("VESPERA_EthernetPortSystemDevice"),
        "GroupComponent", "PartComponent");
    Links cards(inv.ein("VESPERA_Realizes"), "Dependent", "Antecedent");
    Links adapterSoftware(inv.ein("VESPERA_AdapterElementSoftwareIdentity"),
        "Dependent", "Antecedent");
    Links adapterFCPorts(inv.ein("VESPERA_ControlledBy"), "Antecedent", "Dependent");
    Links adapterEthPorts(inv.ein("VESPERA_EthernetPortControlledBy"), "Antecedent", "Dependent");
    Links cardConnectors(inv.ein("VESPERA_PhysicalConnectorContainer"),
        "GroupComponent", "PartComponent");
    Links beacons(inv.ein("VESPERA_AssociatedAlarm"), "Dependent", "Antecedent");
    Links initiators(inv.ein("VESPERA_DeviceSAPImplementation"), "Antecedent", "Dependent");
    std::vector<ch::Object_Path> paths = inv.ein("VESPERA_SCSIInitiatorTargetLogicalUnitPath");

    auto isDriver = [](const ch::Instance& sw) {
        const ch::Value* cl = sw.get("Classifications");
        return cl && !cl->null && !cl->elements.empty() && cl->elements[0].num.uint16 == 2;
    };

    // The host.
    const ch::Instance* host0 = systems.empty() ? 0 : &systems[0];
    if (systems.empty())
        printf("Host: (none answered)\n");
    for (const ch::Instance& s : systems)
    {
        std::string how;
        const ch::Value* d = s.get("IdentifyingDescriptions");
        if (d && !d->null && !d->elements.empty())
            how = " (" + d->elements[0].str + ")";
        printf("Host %s%s\n", text(s, "Name").c_str(), how.c_str());
    }
    std::vector<const ch::Instance*> agents, drivers, adapters, hostPorts, hostEth;
    if (host0)
    {
        agents = found(elements, hostAccess.of(host0->path));
        drivers = found(elements, hostSoftware.of(host0->path));
        adapters = found(elements, hostAdapters.of(host0->path));
        hostPorts = found(elements, hostFCPorts.of(host0->path));
        hostEth = found(elements, hostEthPorts.of(host0->path));
    }
    if (agents.empty())
        printf("  Console agent: not running\n");
    for (const ch::Instance* a : agents)
        printf("  Console agent: %s\n", text(*a, "AccessInfo").c_str());
    for (const ch::Instance* sw : drivers)
        if (isDriver(*sw))
            printf("  Driver %s %s\n", text(*sw, "InstanceID").c_str(),
                text(*sw, "VersionString").c_str());

    // The targets of each initiator, and each target's units, in the order
    // of the paths: a target is on as many paths as it has units.
    std::map<std::string, std::vector<Target> > targetsOf;
    for (const ch::Object_Path& p : paths)
    {
        const ch::Value* i = p.key("Initiator");
        const ch::Value* t = p.key("Target");
        const ch::Value* u = p.key("LogicalUnit");
        if (!i || !i->ref || !t || !t->ref || !u || !u->ref)
            continue;
        const ch::Instance* unit = elements.find(*u->ref);
        if (!unit)
            continue;
        const ch::Value* name = t->ref->key("Name");
        std::string target = name ? lower(name->str) : "";
        std::vector<Target>& targets = targetsOf[pathKey(*i->ref)];
        if (targets.empty() || targets.back().name != target)
        {
            targets.push_back(Target());
            targets.back().name = target;
        }
        bool tape = lower(unit->class_name) == "vespera_tapedrive";
        (tape ? targets.back().tapes : targets.back().disks).push_back(unit);
    }

    std::vector<std::string> shown;

    auto printFCPort = [&](const ch::Instance& i, const std::vector<const ch::Instance*>& optics) {
        shown.push_back(pathKey(i.path));
        std::string wwn = lower(text(i, "DeviceID"));
        std::string beacon = "no beacon";
        for (const ch::Instance* a : found(elements, beacons.of(i.path)))
            beacon = number(*a, "AlarmState") == 3 ? "beacon on" : "beacon off";

        printf("  FC port %s  %s, %s (max %s), %s, %s\n",
            text(i, "PortNumber").c_str(), colon(wwn).c_str(),
            speedText(number(i, "Speed")).c_str(), speedText(number(i, "MaxSpeed")).c_str(),
            enabledText(number(i, "EnabledState")).c_str(), beacon.c_str());

        // A connector's Tag ends in "_<port place>".
        std::string place = "_" + text(i, "PortNumber");
        for (const ch::Instance* c : optics)
        {
            std::string tag = text(*c, "Tag");
            if (tag.size() > place.size() &&
                tag.compare(tag.size() - place.size(), place.size(), place) == 0)
                printf("      optics: %s %s, %s, serial %s\n", text(*c, "Manufacturer").c_str(),
                    text(*c, "PartNumber").c_str(), text(*c, "Description").c_str(),
                    text(*c, "SerialNumber").c_str());
        }

        std::vector<Target> targets;
        for (const ch::Object_Path& initiator : initiators.of(i.path))
        {
            auto at = targetsOf.find(pathKey(initiator));
            if (at != targetsOf.end())
                targets.insert(targets.end(), at->second.begin(), at->second.end());
        }
        if (targets.empty())
            printf("      reaches no target\n");
        for (const Target& t : targets)
        {
            size_t cut = t.name.find('_');
            std::string remote = cut == std::string::npos ? t.name : t.name.substr(cut + 1);
            size_t nd = t.disks.size(), nt = t.tapes.size();
            printf("      target %s: %zu disk%s, %zu tape%s\n", colon(remote).c_str(),
                nd, nd == 1 ? "" : "s", nt, nt == 1 ? "" : "s");
            for (const ch::Instance* u : t.disks)
                printUnit(*u, false);
            for (const ch::Instance* u : t.tapes)
                printUnit(*u, true);
        }
    };

    auto printEthPort = [&](const ch::Instance& e, bool placed) {
        shown.push_back(pathKey(e.path));
        if (placed)
            printf("  Ethernet port %s  %s, %s\n", text(e, "PortNumber").c_str(),
                colon(text(e, "DeviceID")).c_str(), text(e, "ElementName").c_str());
        else
            printf("  Ethernet port %s, %s\n", colon(text(e, "DeviceID")).c_str(),
                text(e, "ElementName").c_str());
    };

    // Adapters, in the order the host holds them.
    for (size_t n = 0; n < adapters.size(); n++)
    {
        const ch::Instance& c = *adapters[n];
        std::string id = lower(text(c, "DeviceID"));
        std::vector<const ch::Instance*> card = found(elements, cards.of(c.path));
        std::vector<const ch::Instance*> optics;
        if (!card.empty())
            optics = found(elements, cardConnectors.of(card[0]->path));

        printf("\nAdapter %zu: %s %s, serial %s, %s\n", n + 1,
            text(c, "Caption").c_str(),
            card.empty() ? "" : text(*card[0], "Model").c_str(),
            text(c, "Name").c_str(), colon(id).c_str());

        // Its own software: firmware and BIOS, named "<adapter>_<kind>".
        std::string versions;
        for (const ch::Instance* sw : found(elements, adapterSoftware.of(c.path)))
        {
            std::string swId = lower(text(*sw, "InstanceID"));
            size_t cut = swId.find('_');
            if (isDriver(*sw) || cut == std::string::npos)
                continue;
            versions += (versions.empty() ? "" : ", ") + swId.substr(cut + 1) +
                " " + text(*sw, "VersionString");
        }
        const ch::Value* st = c.get("StatusDescriptions");
        std::string status = st && !st->null && !st->elements.empty() ? st->elements[0].str : "";
        printf("  %s%s%s\n", status.c_str(), versions.empty() ? "" : "; ", versions.c_str());

        std::vector<const ch::Instance*> fc = found(elements, adapterFCPorts.of(c.path));
        std::vector<const ch::Instance*> eth = found(elements, adapterEthPorts.of(c.path));
        for (const ch::Instance* p : fc)
            printFCPort(*p, optics);
        for (const ch::Instance* e : eth)
            printEthPort(*e, true);
        if (fc.empty() && eth.empty())
            printf("  no ports\n");
    }

    // Ports that the host has and no adapter claims.
    auto unshown = [&](const std::vector<const ch::Instance*>& ports) {
        std::vector<const ch::Instance*> out;
        for (const ch::Instance* p : ports)
            if (std::find(shown.begin(), shown.end(), pathKey(p->path)) == shown.end())
                out.push_back(p);
        return out;
    };
    std::vector<const ch::Instance*> looseFC = unshown(hostPorts);
    std::vector<const ch::Instance*> looseEth = unshown(hostEth);
    if (!looseFC.empty() || !looseEth.empty())
        printf("\nPorts of no adapter shown above:\n");
    for (const ch::Instance* p : looseFC)
        printFCPort(*p, std::vector<const ch::Instance*>());
    for (const ch::Instance* e : looseEth)
        printEthPort(*e, false);

    if (adapters.empty())
        printf("\nNo adapters.\n");

    for (const std::string& f : inv.failures)
        fprintf(stderr, "vspr-inventory: %s\n", f.c_str());

    return inv.failures.empty() ? 0 : 1;
}
