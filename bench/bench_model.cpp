// bench_model: what the module itself costs per instance of each inventory
// class, with the adapter library's time measured and taken away.
//
//   bench_model [--host FILE] [--seconds S] [--scale] [--class NAME]
//
// The module's adapter code and inventory run in this process, as in the
// provider module, on the simulated library; the library's own time comes
// from its per-entry counters (dtruj_sim_counters). For each class: the
// instances, the library calls and milliseconds of one enumeration, the
// module's own microseconds per instance, and for the classes that are
// looked up by their keys the time of one look-up (the instance in the
// middle of the enumeration) and its library calls. Then the time to look up
// every logical disk one by one, and the peak memory. Without --host it
// writes the host of bench_inventory (8 adapters, 32 FC ports, 8,064
// logical disks). --scale instead enumerates the logical disks and FC ports
// of generated hosts from 1,000 to 32,000 LUNs and from 8 to 128 ports.
// The module's log is off.

#include <stdlib.h>
#include <sys/resource.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

#include <json/json.h>

#include "FCHBAManager.h"
#include "HDRManager.h"
#include "InstanceDelivery.h"
#include "ProviderUtil.h"

using namespace OLMA;

extern "C" int dtruj_sim_reset(void);
extern "C" char* dtruj_sim_counters(int reset);

namespace
{

struct Class_Row
{
    const char* name;
    classId_t id;
    bool hdr;
    bool lookedUp;
};

const Class_Row rows[] = {
    { "VESPERA_ComputerSystem", ID_VESPERA_ComputerSystem, false, false },
    { "VESPERA_PortController", ID_VESPERA_PortController, false, false },
    { "VESPERA_FCPort", ID_VESPERA_FCPort, false, true },
    { "VESPERA_SCSIProtocolEndpoint", ID_VESPERA_SCSIProtocolEndpoint, false, true },
    { "VESPERA_FCPortStatistics", ID_VESPERA_FCPortStatistics, false, true },
    { "VESPERA_PhysicalPackage", ID_VESPERA_PhysicalPackage, false, false },
    { "VESPERA_Product", ID_VESPERA_Product, false, false },
    { "VESPERA_AdapterSoftwareIdentity", ID_VESPERA_AdapterSoftwareIdentity, false, false },
    { "VESPERA_StorageExtent", ID_VESPERA_StorageExtent, true, true },
    { "VESPERA_TapeDrive", ID_VESPERA_TapeDrive, true, true },
    { "VESPERA_RemoteServiceAccessPoint", ID_VESPERA_RemoteServiceAccessPoint, false, false },
    { "VESPERA_EthernetPort", ID_VESPERA_EthernetPort, false, false },
    { "VESPERA_LogicalPortGroup", ID_VESPERA_LogicalPortGroup, false, false },
    { "VESPERA_LANEndpoint", ID_VESPERA_LANEndpoint, false, false },
    { "VESPERA_PhysicalConnector", ID_VESPERA_PhysicalConnector, false, true },
    { "VESPERA_AlarmDevice", ID_VESPERA_AlarmDevice, false, true },
    { "VESPERA_LogicalDisk", ID_VESPERA_LogicalDisk, true, true },
};

double now()
{
    return std::chrono::duration<double>(
        std::chrono::steady_clock::now().time_since_epoch()).count();
}

// Calls and seconds spent in the library since the last look; resets them.
struct Library_Time
{
    unsigned long long calls;
    double seconds;
};

Library_Time takeLibraryTime()
{
    Library_Time t = { 0, 0 };
    char* text = dtruj_sim_counters(1);
    Json::Value all;
    if (text && Json::Reader().parse(text, all))
        for (const std::string& entry : all.getMemberNames())
        {
            t.calls += all[entry]["calls"].asUInt64();
            t.seconds += all[entry]["ns"].asUInt64() / 1e9;
        }
    free(text);
    return t;
}

Array<Instance*> enumerate(const Class_Row& row)
{
    return row.hdr ? HDRManager::getHDRManager()->getInstances(row.id)
                   : FCHBAManager::getFCHBAManager()->getInstances(row.id);
}

Instance* lookUp(const Class_Row& row, const Instance* model)
{
    return row.hdr ? HDRManager::getHDRManager()->getInstance(row.id, model)
                   : FCHBAManager::getFCHBAManager()->getInstance(row.id, model);
}

bool useHost(const std::string& file)
{
    setenv("DTRUJ_HOST", file.c_str(), 1);
    return dtruj_sim_reset() == 0;
}

std::string generateHost(const std::string& dir, int adapters, int ports, int rports,
    int luns)
{
    std::string file = dir + "/host-" + std::to_string(adapters) + "-" +
        std::to_string(ports) + "-" + std::to_string(rports) + "-" + std::to_string(luns) +
        ".json";
    std::string cmd = std::string("python3 '") + VSPR_SOURCE_DIR + "/tools/gen_host.py'" +
        " --adapters " + std::to_string(adapters) + " --ports " + std::to_string(ports) +
        " --rports " + std::to_string(rports) + " --luns " + std::to_string(luns) +
        " -o '" + file + "'";
    return system(cmd.c_str()) == 0 ? file : "";
}

// One enumeration: seconds in all, and what the library took of them.
struct Run
{
    size_t instances;
    double seconds;
    Library_Time library;
};

Run enumerateOnce(const Class_Row& row)
{
    takeLibraryTime();
    double start = now();
    Array<Instance*> all = enumerate(row);
    Run r;
    r.instances = all.size();
    destroyInstances(all);
    r.seconds = now() - start;
    r.library = takeLibraryTime();
    return r;
}

void classes(double minSeconds, const std::string& only)
{
    printf("%-34s %9s %6s %10s %10s %10s %11s %10s %9s\n", "class", "instances",
        "runs", "lib calls", "ms/enum", "lib ms", "module us/i", "gi ms", "gi calls");

    for (const Class_Row& row : rows)
    {
        if (!only.empty() && only != row.name)
            continue;
        Run sum = { 0, 0, { 0, 0 } };
        int runs = 0;
        double start = now();
        do
        {
            Run r = enumerateOnce(row);
            sum.instances = r.instances;
            sum.seconds += r.seconds;
            sum.library.calls += r.library.calls;
            sum.library.seconds += r.library.seconds;
            runs++;
        }
        while (now() - start < minSeconds);

        double perRun = sum.seconds / runs;
        double libPerRun = sum.library.seconds / runs;
        double modulePerInstance = sum.instances ?
            (perRun - libPerRun) / sum.instances * 1e6 : 0;

        char giMs[32] = "-";
        char giCalls[32] = "-";

        if (row.lookedUp && sum.instances)
        {
            Array<Instance*> all = enumerate(row);
            Instance* model = all[all.size() / 2];
            int n = 0;
            takeLibraryTime();
            double t0 = now();
            do
            {
                Instance* found = lookUp(row, model);
                if (!found)
                {
                    fprintf(stderr, "%s: the look-up found nothing\n", row.name);
                    break;
                }
                destroy(found);
                n++;
            }
            while (now() - t0 < minSeconds / 4);
            double each = (now() - t0) / n;
            Library_Time lib = takeLibraryTime();
            snprintf(giMs, sizeof(giMs), "%.3f", each * 1000);
            snprintf(giCalls, sizeof(giCalls), "%.0f", (double)lib.calls / n);
            destroyInstances(all);
        }

        printf("%-34s %9zu %6d %10.0f %10.2f %10.2f %11.2f %10s %9s\n", row.name,
            sum.instances, runs, (double)sum.library.calls / runs, perRun * 1000,
            libPerRun * 1000, modulePerInstance, giMs, giCalls);
        fflush(stdout);
    }

    // Every logical disk by its keys, one after the other, as a client or
    // an association that walks them would.
    const Class_Row& disks = rows[sizeof(rows) / sizeof(rows[0]) - 1];
    if (!only.empty() && only != disks.name)
        return;
    Array<Instance*> all = enumerate(disks);
    takeLibraryTime();
    double t0 = now();
    size_t found = 0;
    for (size_t i = 0; i < all.size(); i++)
    {
        Instance* one = lookUp(disks, all[i]);
        if (one)
        {
            found++;
            destroy(one);
        }
    }
    double t = now() - t0;
    Library_Time lib = takeLibraryTime();
    printf("every VESPERA_LogicalDisk one by one: %zu of %zu found in %.2f s "
        "(library %.2f s, %llu calls)\n", found, all.size(), t, lib.seconds, lib.calls);
    destroyInstances(all);
}

void scale(const std::string& dir)
{
    struct Shape { int adapters, ports, rports, luns; };
    // LUNs at 32 ports (one remote port in four is a tape), then ports at
    // 21 LUNs per disk remote port.
    const Shape shapes[] = {
        { 8, 4, 4, 11 }, { 8, 4, 8, 11 }, { 8, 4, 16, 11 }, { 8, 4, 16, 21 },
        { 8, 4, 16, 43 }, { 8, 4, 16, 89 },
        { 2, 4, 4, 21 }, { 4, 4, 4, 21 }, { 8, 4, 4, 21 }, { 16, 4, 4, 21 }, { 32, 4, 4, 21 },
    };

    printf("%8s %6s %8s %12s %12s %12s %10s %12s\n", "adapters", "ports", "LUNs",
        "disk ms", "lib ms", "module us/i", "port ms", "port us/port");
    for (const Shape& s : shapes)
    {
        std::string file = generateHost(dir, s.adapters, s.ports, s.rports, s.luns);
        if (file.empty() || !useHost(file))
        {
            fprintf(stderr, "bench_model: no host %s\n", file.c_str());
            continue;
        }

        Run disks = enumerateOnce(rows[16]);
        Run best = disks;
        for (int i = 0; i < 2; i++)
        {
            Run r = enumerateOnce(rows[16]);
            if (r.seconds < best.seconds)
                best = r;
        }
        Run ports = enumerateOnce(rows[2]);
        for (int i = 0; i < 4; i++)
        {
            Run r = enumerateOnce(rows[2]);
            if (r.seconds < ports.seconds)
                ports = r;
        }
        printf("%8d %6d %8zu %12.2f %12.2f %12.2f %10.3f %12.2f\n", s.adapters,
            s.adapters * s.ports, best.instances, best.seconds * 1000,
            best.library.seconds * 1000,
            (best.seconds - best.library.seconds) / best.instances * 1e6,
            ports.seconds * 1000, ports.seconds / ports.instances * 1e6);
        fflush(stdout);
        unlink(file.c_str());
    }
}

} // namespace

int main(int argc, char** argv)
{
    std::string hostFile;
    double minSeconds = 1.0;
    bool scaling = false;
    std::string only;

    for (int i = 1; i < argc; i++)
    {
        if (!strcmp(argv[i], "--host") && i + 1 < argc)
            hostFile = argv[++i];
        else if (!strcmp(argv[i], "--seconds") && i + 1 < argc)
            minSeconds = atof(argv[++i]);
        else if (!strcmp(argv[i], "--scale"))
            scaling = true;
        else if (!strcmp(argv[i], "--class") && i + 1 < argc)
            only = argv[++i];
        else
        {
            fprintf(stderr, "usage: %s [--host FILE] [--seconds S] [--scale] [--class NAME]\n",
                argv[0]);
            return 2;
        }
    }

    char name[] = "/tmp/vspr-bench-XXXXXX";
    if (!mkdtemp(name))
    {
        perror("bench_model: mkdtemp");
        return 1;
    }
    std::string dir = name;

    if (scaling)
        scale(dir);
    else
    {
        bool generated = hostFile.empty();
        if (generated)
            hostFile = generateHost(dir, 8, 4, 16, 21);
        if (hostFile.empty() || !useHost(hostFile))
        {
            fprintf(stderr, "bench_model: no host\n");
            return 1;
        }
        printf("host: %s\n", hostFile.c_str());
        classes(minSeconds, only);
        if (generated)
            unlink(hostFile.c_str());
    }

    struct rusage usage;
    getrusage(RUSAGE_SELF, &usage);
    printf("peak memory (ru_maxrss): %.1f MiB\n", usage.ru_maxrss / 1024.0);
    rmdir(dir.c_str());
    return 0;
}
