// bench_inventory: how fast the inventory classes enumerate on a large host,
// through the stand-in CIM server, and how much memory the run takes at
// its peak. Beside the time of one enumeration it shows the adapter
// library's calls and time in it (the simulator's counters), what the
// module and the stand-in took per instance beyond that, and the time of a
// getInstance of the instance in the middle. bench_model shows the module's
// own share without the stand-in.
//
//   bench_inventory [--host FILE] [--seconds S]
//
// Without --host it writes a host of 8 adapters with 4 FC ports each, 16
// remote ports per FC port and 21 LUNs per disk target (32 FC ports, 8,320
// logical units) with tools/gen_host.py. Each class is enumerated at least
// once and until S seconds (default 1) have passed. The module's log is off.

#include <dlfcn.h>
#include <stdlib.h>
#include <sys/resource.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstring>
#include <string>

#include "cimhost.h"

namespace ch = OLMA::cimhost;

namespace
{

const char* const classes[] = {
    "VESPERA_ComputerSystem", "VESPERA_PortController", "VESPERA_FCPort",
    "VESPERA_SCSIProtocolEndpoint", "VESPERA_FCPortStatistics",
    "VESPERA_PhysicalPackage", "VESPERA_Product", "VESPERA_AdapterSoftwareIdentity",
    "VESPERA_StorageExtent", "VESPERA_TapeDrive", "VESPERA_RemoteServiceAccessPoint",
    "VESPERA_EthernetPort", "VESPERA_LogicalPortGroup", "VESPERA_LANEndpoint",
    "VESPERA_PhysicalConnector", "VESPERA_AlarmDevice", "VESPERA_LogicalDisk",
};

std::string generateHost(const std::string& dir)
{
    std::string file = dir + "/host.json";
    std::string cmd = std::string("python3 '") + VSPR_SOURCE_DIR + "/tools/gen_host.py'"
        " --adapters 8 --ports 4 --rports 16 --luns 21 -o '" + file + "'";
    if (system(cmd.c_str()) != 0)
        return "";
    return file;
}

} // namespace

int main(int argc, char** argv)
{
    std::string hostFile;
    double minSeconds = 1.0;

    for (int i = 1; i < argc; i++)
    {
        if (!strcmp(argv[i], "--host") && i + 1 < argc)
            hostFile = argv[++i];
        else if (!strcmp(argv[i], "--seconds") && i + 1 < argc)
            minSeconds = atof(argv[++i]);
        else
        {
            fprintf(stderr, "usage: %s [--host FILE] [--seconds S]\n", argv[0]);
            return 2;
        }
    }

    char name[] = "/tmp/vspr-bench-XXXXXX";
    if (!mkdtemp(name))
    {
        perror("bench_inventory: mkdtemp");
        return 1;
    }
    std::string tmpDir = name;
    bool generated = hostFile.empty();
    if (generated)
    {
        hostFile = generateHost(tmpDir);
        if (hostFile.empty())
        {
            fprintf(stderr, "bench_inventory: tools/gen_host.py failed\n");
            return 1;
        }
    }
    setenv("DTRUJ_HOST", hostFile.c_str(), 1);
    // A HOME without a .tesselrc, so that the module's log stays off and the
    // figures are the inventory's own.
    setenv("HOME", tmpDir.c_str(), 1);

    // The module opens the library by its bare name; once loaded, that name
    // finds this copy.
    void* dtruj = dlopen(VSPR_DTRUJ_PATH, RTLD_NOW | RTLD_GLOBAL);
    if (!dtruj)
    {
        fprintf(stderr, "bench_inventory: %s\n", dlerror());
        return 1;
    }
    typedef char* (*Counters)(int);
    Counters counters = (Counters)dlsym(dtruj, "dtruj_sim_counters");
    // Calls and seconds spent in the library since the last look.
    auto library = [counters](double& seconds) {
        unsigned long long calls = 0;
        seconds = 0;
        char* text = counters ? counters(1) : nullptr;
        for (const char* p = text; p && (p = strstr(p, "\"calls\":")); )
        {
            unsigned long long c = 0, ns = 0;
            if (sscanf(p, "\"calls\":%llu,\"ns\":%llu", &c, &ns) == 2)
            {
                calls += c;
                seconds += ns / 1e9;
            }
            p += 8;
        }
        free(text);
        return calls;
    };

    int status = 0;
    {
        ch::Host host;
        if (!host.ok())
        {
            fprintf(stderr, "bench_inventory: %s\n", host.error().c_str());
            return 1;
        }

        printf("host: %s\n", hostFile.c_str());
        printf("%-34s %9s %5s %10s %10s %9s %12s %9s\n", "class", "instances", "runs",
            "ms/run", "lib calls", "lib ms", "rest us/i", "gi ms");

        for (const char* cls : classes)
        {
            ch::Object_Path path;
            path.name_space = "root/vespera";
            path.class_name = cls;

            size_t count = 0;
            int runs = 0;
            double seconds = 0;
            double libSeconds = 0;
            unsigned long long libCalls = 0;
            ch::Object_Path middle;
            library(libSeconds);
            auto start = std::chrono::steady_clock::now();
            do
            {
                ch::Result r = host.ei(path);
                if (r.ok() && !r.instances.empty())
                    middle = r.instances[r.instances.size() / 2].path;
                if (!r.ok())
                {
                    fprintf(stderr, "%s: %s\n", cls, ch::rc_name(r.rc).c_str());
                    status = 1;
                    break;
                }
                count = r.instances.size();
                runs++;
                seconds = std::chrono::duration<double>(
                    std::chrono::steady_clock::now() - start).count();
            }
            while (seconds < minSeconds);

            double perRun = runs ? seconds / runs : 0;
            libCalls = library(libSeconds);
            double libPerRun = runs ? libSeconds / runs : 0;

            char gi[32] = "-";
            if (count)
            {
                int n = 0;
                auto t0 = std::chrono::steady_clock::now();
                double spent = 0;
                do
                {
                    if (!host.gi(middle).ok())
                        break;
                    n++;
                    spent = std::chrono::duration<double>(
                        std::chrono::steady_clock::now() - t0).count();
                }
                while (spent < minSeconds / 4);
                if (n)
                    snprintf(gi, sizeof(gi), "%.3f", spent / n * 1000);
            }

            printf("%-34s %9zu %5d %10.2f %10.0f %9.2f %12.2f %9s\n", cls, count, runs,
                perRun * 1000, runs ? (double)libCalls / runs : 0, libPerRun * 1000,
                count ? (perRun - libPerRun) / count * 1e6 : 0, gi);
            fflush(stdout);
        }
    }

    struct rusage usage;
    getrusage(RUSAGE_SELF, &usage);
    printf("peak memory (ru_maxrss): %.1f MiB\n", usage.ru_maxrss / 1024.0);

    if (generated)
        unlink(hostFile.c_str());
    rmdir(tmpDir.c_str());
    return status;
}
