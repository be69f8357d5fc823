// vspr-inventory: the host's adapters, ports and what the ports reach, as a
// WBEM client sees them through the provider module.
//
// The module is loaded into the stand-in CIM server, every inventory class
// is enumerated once, and the elements are put together by what their keys
// and properties share, since a client without associations has nothing
// else to go by:
//
// - an FC port belongs to the adapter whose DeviceID is its node WWN (the
//   first half of its Name), or, for a CNA named by MAC, whose MAC is the
//   low six bytes of that node WWN;
// - an Ethernet port belongs to the CNA with the nearest MAC at or below its
//   own, within one block of 256 addresses;
// - a target endpoint is named "<port>_<remote port>", and a logical unit's
//   DeviceID starts with that name;
// - a connector's Tag ends in "_<adapter>_<port place>", the adapter counted
//   from 1 in the order of the enumeration.

#include <dlfcn.h>
#include <stdlib.h>

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
        ch::Object_Path path;
        path.name_space = "root/vespera";
        path.class_name = cls;
        ch::Result r = host.ei(path);
        if (!r.ok())
            failures.push_back(cls + ": " + ch::rc_name(r.rc) +
                (r.message.empty() ? "" : " (" + r.message + ")"));
        return r.instances;
    }
};

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

std::string lower(std::string s)
{
    for (char& c : s)
        if (c >= 'A' && c <= 'Z')
            c = c - 'A' + 'a';
    return s;
}

bool startsWith(const std::string& s, const std::string& prefix)
{
    return s.size() >= prefix.size() && s.compare(0, prefix.size(), prefix) == 0;
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

struct Lun
{
    const ch::Instance* instance;
    bool tape;
};

struct Target
{
    std::string remote;
    std::vector<Lun> luns;
};

struct FCPort
{
    const ch::Instance* port;
    std::string wwn;
    std::string node;
    std::vector<Target> targets;
};

struct Adapter
{
    const ch::Instance* controller;
    const ch::Instance* package;
    std::string id;
    std::vector<FCPort*> fcPorts;
    std::vector<const ch::Instance*> ethPorts;
};

void printUnit(const Lun& lun)
{
    const ch::Instance& i = *lun.instance;
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

    printf("        %-4s %-7s %-24s %s\n", lun.tape ? "tape" : "disk",
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
    Instances endpoints = inv.ei("VESPERA_SCSIProtocolEndpoint");
    Instances disks = inv.ei("VESPERA_LogicalDisk");
    Instances tapes = inv.ei("VESPERA_TapeDrive");
    Instances ethPorts = inv.ei("VESPERA_EthernetPort");
    Instances connectors = inv.ei("VESPERA_PhysicalConnector");

    // The host.
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
    if (access.empty())
        printf("  Console agent: not running\n");
    for (const ch::Instance& a : access)
        printf("  Console agent: %s\n", text(a, "AccessInfo").c_str());
    for (const ch::Instance& sw : software)
    {
        const ch::Value* cl = sw.get("Classifications");
        bool driver = cl && !cl->null && !cl->elements.empty() && cl->elements[0].num.uint16 == 2;
        if (driver)
            printf("  Driver %s %s\n", text(sw, "InstanceID").c_str(),
                text(sw, "VersionString").c_str());
    }

    // Adapters, in the order of the enumeration.
    std::vector<Adapter> adapters(controllers.size());
    std::map<std::string, size_t> byId;
    for (size_t i = 0; i < controllers.size(); i++)
    {
        adapters[i].controller = &controllers[i];
        adapters[i].package = 0;
        adapters[i].id = lower(text(controllers[i], "DeviceID"));
        byId[adapters[i].id] = i;
        for (const ch::Instance& p : packages)
            if (text(p, "SerialNumber") == text(controllers[i], "Name"))
                adapters[i].package = &p;
    }

    // FC ports to adapters, targets to ports, units to targets.
    std::vector<FCPort> ports(fcPorts.size());
    std::vector<FCPort*> unattached;
    std::map<std::string, FCPort*> portByWwn;
    for (size_t i = 0; i < fcPorts.size(); i++)
    {
        FCPort& p = ports[i];
        p.port = &fcPorts[i];
        p.wwn = lower(text(fcPorts[i], "DeviceID"));
        std::string name = text(fcPorts[i], "Name");
        p.node = lower(name.substr(0, name.find(':')));
        portByWwn[p.wwn] = &p;

        auto a = byId.find(p.node);
        if (a == byId.end() && p.node.size() == 16)
            a = byId.find(p.node.substr(4));
        if (a != byId.end())
            adapters[a->second].fcPorts.push_back(&p);
        else
            unattached.push_back(&p);
    }

    for (const ch::Instance& e : endpoints)
    {
        std::string name = lower(text(e, "Name"));
        size_t cut = name.find('_');
        if (number(e, "Role") != 3 || cut == std::string::npos)
            continue;
        auto p = portByWwn.find(name.substr(0, cut));
        if (p == portByWwn.end())
            continue;
        Target t;
        t.remote = name.substr(cut + 1);
        p->second->targets.push_back(t);
    }

    auto placeUnits = [&](const Instances& units, bool tape) {
        for (const ch::Instance& u : units)
        {
            std::string device = lower(text(u, "DeviceID"));
            size_t a = device.find('_');
            size_t b = a == std::string::npos ? a : device.find('_', a + 1);
            if (b == std::string::npos)
                continue;
            auto p = portByWwn.find(device.substr(0, a));
            if (p == portByWwn.end())
                continue;
            std::string remote = device.substr(a + 1, b - a - 1);
            Target* target = 0;
            for (Target& t : p->second->targets)
                if (t.remote == remote)
                    target = &t;
            if (!target)
            {
                p->second->targets.push_back(Target());
                target = &p->second->targets.back();
                target->remote = remote;
            }
            target->luns.push_back(Lun{&u, tape});
        }
    };
    placeUnits(disks, false);
    placeUnits(tapes, true);

    // Ethernet ports to CNAs.
    std::vector<const ch::Instance*> looseEth;
    for (const ch::Instance& e : ethPorts)
    {
        uint64_t mac = addressValue(lower(text(e, "DeviceID")));
        Adapter* best = 0;
        uint64_t bestMac = 0;
        for (Adapter& a : adapters)
        {
            uint64_t am = a.id.size() == 12 ? addressValue(a.id) : 0;
            if (am && am <= mac && mac - am < 256 && am >= bestMac)
            {
                best = &a;
                bestMac = am;
            }
        }
        if (best)
            best->ethPorts.push_back(&e);
        else
            looseEth.push_back(&e);
    }

    auto printFCPort = [&](const FCPort& p, size_t adapterNo) {
        const ch::Instance& i = *p.port;
        std::string beacon = "no beacon";
        for (const ch::Instance& a : alarms)
            if (lower(text(a, "DeviceID")) == p.wwn)
                beacon = number(a, "AlarmState") == 3 ? "beacon on" : "beacon off";

        printf("  FC port %s  %s, %s (max %s), %s, %s\n",
            text(i, "PortNumber").c_str(), colon(p.wwn).c_str(),
            speedText(number(i, "Speed")).c_str(), speedText(number(i, "MaxSpeed")).c_str(),
            enabledText(number(i, "EnabledState")).c_str(), beacon.c_str());

        std::string suffix = "_" + std::to_string(adapterNo) + "_" + text(i, "PortNumber");
        for (const ch::Instance& c : connectors)
        {
            std::string tag = text(c, "Tag");
            if (adapterNo && tag.size() > suffix.size() &&
                tag.compare(tag.size() - suffix.size(), suffix.size(), suffix) == 0)
                printf("      optics: %s %s, %s, serial %s\n", text(c, "Manufacturer").c_str(),
                    text(c, "PartNumber").c_str(), text(c, "Description").c_str(),
                    text(c, "SerialNumber").c_str());
        }

        if (p.targets.empty())
            printf("      reaches no target\n");
        for (const Target& t : p.targets)
        {
            size_t nd = 0, nt = 0;
            for (const Lun& l : t.luns)
                (l.tape ? nt : nd)++;
            printf("      target %s: %zu disk%s, %zu tape%s\n", colon(t.remote).c_str(),
                nd, nd == 1 ? "" : "s", nt, nt == 1 ? "" : "s");
            for (const Lun& l : t.luns)
                printUnit(l);
        }
    };

    for (size_t n = 0; n < adapters.size(); n++)
    {
        const Adapter& a = adapters[n];
        const ch::Instance& c = *a.controller;
        printf("\nAdapter %zu: %s %s, serial %s, %s\n", n + 1,
            text(c, "Caption").c_str(),
            a.package ? text(*a.package, "Model").c_str() : "",
            text(c, "Name").c_str(), colon(a.id).c_str());

        std::string versions;
        for (const ch::Instance& sw : software)
        {
            std::string id = lower(text(sw, "InstanceID"));
            if (startsWith(id, a.id + "_"))
                versions += (versions.empty() ? "" : ", ") + id.substr(a.id.size() + 1) +
                    " " + text(sw, "VersionString");
        }
        const ch::Value* st = c.get("StatusDescriptions");
        std::string status = st && !st->null && !st->elements.empty() ? st->elements[0].str : "";
        printf("  %s%s%s\n", status.c_str(), versions.empty() ? "" : "; ", versions.c_str());

        for (const FCPort* p : a.fcPorts)
            printFCPort(*p, n + 1);
        for (const ch::Instance* e : a.ethPorts)
            printf("  Ethernet port %s  %s, %s\n", text(*e, "PortNumber").c_str(),
                colon(text(*e, "DeviceID")).c_str(), text(*e, "ElementName").c_str());
        if (a.fcPorts.empty() && a.ethPorts.empty())
            printf("  no ports\n");
    }

    if (!unattached.empty() || !looseEth.empty())
        printf("\nPorts of no adapter shown above:\n");
    for (const FCPort* p : unattached)
        printFCPort(*p, 0);
    for (const ch::Instance* e : looseEth)
        printf("  Ethernet port %s, %s\n", colon(text(*e, "DeviceID")).c_str(),
            text(*e, "ElementName").c_str());

    if (adapters.empty())
        printf("\nNo adapters.\n");

    for (const std::string& f : inv.failures)
        fprintf(stderr, "vspr-inventory: %s\n", f.c_str());

    return inv.failures.empty() ? 0 : 1;
}
