// bench_inventory: how fast the inventory classes enumerate on a large host,
// through the stand-in CIM server, and how much memory the run takes at
// its peak.
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
    if (!dlopen(VSPR_DTRUJ_PATH, RTLD_NOW | RTLD_GLOBAL))
    {
        fprintf(stderr, "bench_inventory: %s\n", dlerror());
        return 1;
    }

    int status = 0;
    {
        ch::Host host;
        if (!host.ok())
        {
            fprintf(stderr, "bench_inventory: %s\n", host.error().c_str());
            return 1;
        }

        printf("host: %s\n", hostFile.c_str());
        printf("%-34s %10s %6s %12s %14s\n", "class", "instances", "runs", "ms/run",
            "instances/s");

        for (const char* cls : classes)
        {
            ch::Object_Path path;
            path.name_space = "root/vespera";
            path.class_name = cls;

            size_t count = 0;
            int runs = 0;
            double seconds = 0;
            auto start = std::chrono::steady_clock::now();
            do
            {
                ch::Result r = host.ei(path);
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
            printf("%-34s %10zu %6d %12.2f %14.0f\n", cls, count, runs, perRun * 1000,
                perRun > 0 ? count / perRun : 0);
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
