// bench_associations: how the association walks grow with the number of
// logical units, through the stand-in CIM server.
//
//   bench_associations [--seconds S]
//
// On generated hosts of some 1,000, 8,000 and 32,000 LUNs (20 LUNs per disk
// target, one target in four a tape with two units), grown two ways: deeper
// ports (4 adapters of 2 FC ports, 8, 64 and 256 remote ports per port) and
// more ports (4, 32 and 128 adapters of 2 FC ports, 8 remote ports each), it
// times:
//
//   - ai of one initiator endpoint to its logical units, through
//     VESPERA_SCSIInitiatorTargetLogicalUnitPath (result role LogicalUnit);
//   - gi of the last storage extent of those units: what a client pays to
//     fetch one unit by its path (associators of the path class come
//     whole from its provider, not unit by unit through the server);
//   - ai of one FC port to its adapter, through VESPERA_ControlledBy;
//   - ein of VESPERA_SCSIInitiatorTargetLogicalUnitPath.
//
// Each runs at least once and until S seconds (default 1) have passed; the
// table gives the mean time of one and, for the walks, that time per 1,000
// LUNs of the host, which stays flat where the cost grows linearly. The
// module's log is off.

#include <dlfcn.h>
#include <stdlib.h>
#include <sys/resource.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstring>
#include <functional>
#include <string>
#include <vector>

#include "cimhost.h"

namespace ch = OLMA::cimhost;

namespace
{

struct Shape
{
    const char* growth;
    int adapters;
    int rports;
};

const Shape shapes[] = {
    { "deeper", 4, 8 }, { "deeper", 4, 64 }, { "deeper", 4, 256 },
    { "wider", 4, 8 }, { "wider", 32, 8 }, { "wider", 128, 8 },
};

std::string generateHost(const std::string& dir, const Shape& shape)
{
    std::string file = dir + "/host-" + std::to_string(shape.adapters) + "-" +
        std::to_string(shape.rports) + ".json";
    std::string cmd = std::string("python3 '") + VSPR_SOURCE_DIR + "/tools/gen_host.py'" +
        " --adapters " + std::to_string(shape.adapters) + " --ports 2 --luns 20 --cna-every 0" +
        " --rports " + std::to_string(shape.rports) + " -o '" + file + "'";
    return system(cmd.c_str()) == 0 ? file : "";
}

ch::Object_Path classPath(const char* cls)
{
    ch::Object_Path path;
    path.name_space = "root/vespera";
    path.class_name = cls;
    return path;
}

struct Timing
{
    double ms;
    size_t results;
    bool ok;
};

Timing timeIt(double minSeconds, const std::function<ch::Result()>& op)
{
    Timing t = { 0, 0, true };
    int runs = 0;
    double seconds = 0;
    auto start = std::chrono::steady_clock::now();
    do
    {
        ch::Result r = op();
        if (!r.ok())
        {
            fprintf(stderr, "bench_associations: %s %s\n", ch::rc_name(r.rc).c_str(),
                r.message.c_str());
            t.ok = false;
            return t;
        }
        t.results = r.instances.size() + r.paths.size();
        runs++;
        seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    }
    while (seconds < minSeconds);
    t.ms = seconds / runs * 1000;
    return t;
}

} // namespace

int main(int argc, char** argv)
{
    double minSeconds = 1.0;

    for (int i = 1; i < argc; i++)
    {
        if (!strcmp(argv[i], "--seconds") && i + 1 < argc)
            minSeconds = atof(argv[++i]);
        else
        {
            fprintf(stderr, "usage: %s [--seconds S]\n", argv[0]);
            return 2;
        }
    }

    char name[] = "/tmp/vspr-bench-XXXXXX";
    if (!mkdtemp(name))
    {
        perror("bench_associations: mkdtemp");
        return 1;
    }
    std::string dir = name;
    // A HOME without a .tesselrc: the module's log stays off.
    setenv("HOME", dir.c_str(), 1);

    void* dtruj = dlopen(VSPR_DTRUJ_PATH, RTLD_NOW | RTLD_GLOBAL);
    typedef int (*Reset)(void);
    Reset reset = dtruj ? (Reset)dlsym(dtruj, "dtruj_sim_reset") : 0;
    if (!reset)
    {
        fprintf(stderr, "bench_associations: %s\n", dtruj ? "no dtruj_sim_reset" : dlerror());
        return 1;
    }

    int status = 0;
    {
        ch::Host host;
        if (!host.ok())
        {
            fprintf(stderr, "bench_associations: %s\n", host.error().c_str());
            return 1;
        }

        printf("%-7s %7s %6s | %-27s %9s | %-18s | %-27s\n", "", "", "",
            "ai initiator -> its LUNs", "gi extent", "ai port -> adapter", "ein paths");
        printf("%-7s %7s %6s | %7s %9s %9s %9s | %8s %9s | %7s %9s %9s\n", "growth", "LUNs",
            "ports", "results", "ms", "ms/1000", "ms", "results", "ms", "results", "ms",
            "ms/1000");

        for (const Shape& shape : shapes)
        {
            std::string file = generateHost(dir, shape);
            setenv("DTRUJ_HOST", file.c_str(), 1);
            if (file.empty() || reset() != 0)
            {
                fprintf(stderr, "bench_associations: no host of %d adapters, %d remote ports\n",
                    shape.adapters, shape.rports);
                status = 1;
                continue;
            }

            size_t luns = host.ein(classPath("VESPERA_StorageExtent")).paths.size() +
                host.ein(classPath("VESPERA_TapeDrive")).paths.size();
            std::vector<ch::Object_Path> ports = host.ein(classPath("VESPERA_FCPort")).paths;
            ch::Object_Path initiator;
            ch::Result endpoints = host.ei(classPath("VESPERA_SCSIProtocolEndpoint"));
            for (const ch::Instance& e : endpoints.instances)
                if (e.get_text("Role") == "2")
                {
                    initiator = e.path;
                    break;
                }
            std::vector<ch::Object_Path> units = host.an(initiator,
                "VESPERA_SCSIInitiatorTargetLogicalUnitPath", "", "", "LogicalUnit").paths;
            if (ports.empty() || units.empty())
            {
                fprintf(stderr, "bench_associations: no port or unit\n");
                status = 1;
                continue;
            }

            Timing toUnits = timeIt(minSeconds, [&]() {
                return host.ai(initiator, "VESPERA_SCSIInitiatorTargetLogicalUnitPath", "", "",
                    "LogicalUnit");
            });
            ch::Object_Path lastExtent = units.back();
            for (const ch::Object_Path& u : units)
                if (u.class_name == "VESPERA_StorageExtent")
                    lastExtent = u;
            Timing oneUnit = timeIt(minSeconds / 4, [&]() { return host.gi(lastExtent); });
            Timing toAdapter = timeIt(minSeconds, [&]() {
                return host.ai(ports[0], "VESPERA_ControlledBy");
            });
            Timing paths = timeIt(minSeconds, [&]() {
                return host.ein(classPath("VESPERA_SCSIInitiatorTargetLogicalUnitPath"));
            });
            status |= !(toUnits.ok && oneUnit.ok && toAdapter.ok && paths.ok);

            double k = luns / 1000.0;
            printf("%-7s %7zu %6zu | %7zu %9.2f %9.3f %9.3f | %8zu %9.2f | %7zu %9.2f %9.3f\n",
                shape.growth, luns, ports.size(), toUnits.results, toUnits.ms, toUnits.ms / k,
                oneUnit.ms, toAdapter.results, toAdapter.ms, paths.results, paths.ms,
                paths.ms / k);
            fflush(stdout);
            unlink(file.c_str());
        }
    }

    struct rusage usage;
    getrusage(RUSAGE_SELF, &usage);
    printf("peak memory (ru_maxrss): %.1f MiB\n", usage.ru_maxrss / 1024.0);
    rmdir(dir.c_str());
    return status;
}
