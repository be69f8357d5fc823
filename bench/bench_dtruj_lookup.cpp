// bench_dtruj_lookup: what one look-up of the simulated adapter library
// costs on a small host and on a large one. A console polls a host port by
// port, so a look-up that walks the host makes a poll grow with its square.
//
//   bench_dtruj_lookup [--lib PATH] [--seconds S]
//
// Writes two hosts with tools/gen_host.py: 1 adapter with 2 FC ports and 4
// remote ports each, and 64 adapters with 8 FC ports and 64 remote ports
// each (512 FC ports, 32,768 remote ports). On each it asks, for at least S
// seconds (default 0.5) each, for the last adapter, the last FC port, and
// the last remote port of the last FC port, and prints microseconds a call.
// --lib names another build of libdtruj.so, to compare.

#include <dlfcn.h>
#include <stdlib.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstring>
#include <string>

#include <json/json.h>

namespace
{

typedef Json::Value (*Entry)(const Json::Value&);

struct Lib
{
    void* handle = nullptr;
    Entry get(const char* name) const { return reinterpret_cast<Entry>(dlsym(handle, name)); }
};

std::string addr(std::initializer_list<int> parts)
{
    std::string s;
    char b[4];
    for (int p : parts)
    {
        snprintf(b, sizeof(b), "%02x", p & 0xFF);
        s += (s.empty() ? "" : ":") + std::string(b);
    }
    return s;
}

double perCall(Entry e, const Json::Value& request, double minSeconds)
{
    using Clock = std::chrono::steady_clock;
    Clock::time_point start = Clock::now();
    long calls = 0;
    double elapsed = 0;
    do
    {
        for (int i = 0; i < 100; i++)
            if (e(request).isMember("error"))
            {
                fprintf(stderr, "bench_dtruj_lookup: %s\n", request.toStyledString().c_str());
                exit(1);
            }
        calls += 100;
        elapsed = std::chrono::duration<double>(Clock::now() - start).count();
    } while (elapsed < minSeconds);
    return elapsed / calls * 1e6;
}

} // namespace

int main(int argc, char** argv)
{
    std::string libPath = VSPR_DTRUJ_PATH;
    double minSeconds = 0.5;

    for (int i = 1; i < argc; i++)
    {
        if (!strcmp(argv[i], "--lib") && i + 1 < argc)
            libPath = argv[++i];
        else if (!strcmp(argv[i], "--seconds") && i + 1 < argc)
            minSeconds = atof(argv[++i]);
        else
        {
            fprintf(stderr, "usage: %s [--lib PATH] [--seconds S]\n", argv[0]);
            return 2;
        }
    }

    Lib lib;
    lib.handle = dlopen(libPath.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (!lib.handle)
    {
        fprintf(stderr, "bench_dtruj_lookup: %s\n", dlerror());
        return 1;
    }
    auto reset = reinterpret_cast<int (*)()>(dlsym(lib.handle, "dtruj_sim_reset"));
    Entry init = lib.get("init_hba_lib");
    if (!reset || !init)
    {
        fprintf(stderr, "bench_dtruj_lookup: %s is no simulated library\n", libPath.c_str());
        return 1;
    }

    char dir[] = "/tmp/vspr-bench-XXXXXX";
    if (!mkdtemp(dir))
    {
        perror("bench_dtruj_lookup: mkdtemp");
        return 1;
    }

    struct Size { int adapters, ports, rports; };
    const Size sizes[] = { { 1, 2, 4 }, { 64, 8, 64 } };

    printf("%-28s %12s %12s %12s\n", "host", "getHbaByWwn", "getPortByWwn",
        "remote port");
    for (const Size& z : sizes)
    {
        std::string file = std::string(dir) + "/host.json";
        std::string cmd = std::string("python3 '") + VSPR_SOURCE_DIR + "/tools/gen_host.py'" +
            " --adapters " + std::to_string(z.adapters) + " --ports " + std::to_string(z.ports) +
            " --rports " + std::to_string(z.rports) + " --luns 1 --cna-every 0 -o '" + file + "'";
        if (system(cmd.c_str()) != 0)
        {
            fprintf(stderr, "bench_dtruj_lookup: tools/gen_host.py failed\n");
            return 1;
        }
        setenv("DTRUJ_HOST", file.c_str(), 1);
        Json::Value appId(Json::objectValue);
        appId["appId"] = 2;
        if (reset() != 0 || init(appId)["result"].asInt() != 0)
        {
            fprintf(stderr, "bench_dtruj_lookup: the host can't be loaded\n");
            return 1;
        }
        unlink(file.c_str());

        // The last of each, as tools/gen_host.py names them.
        int a = z.adapters, hi = (a >> 8) & 0xFF, lo = a & 0xFF;
        int j = z.ports - 1, k = z.rports - 1;
        Json::Value hba(Json::objectValue), port(Json::objectValue), remote(Json::objectValue);
        hba["wwn"] = addr({ 0x20, 0, 0, 0x05, 0x1E, hi, lo, 0 });
        port["wwn"] = addr({ 0x10, 0, 0, 0x05, 0x1E, hi, lo, j + 1 });
        remote["pPortWwn"] = port["wwn"];
        remote["lPortWwn"] = port["wwn"];
        remote["rPortWwn"] = addr({ 0x50, 0x06, a >> 8, a, j, k >> 8, k, 0x01 });

        char label[64];
        snprintf(label, sizeof(label), "%d x %d ports x %d remote", z.adapters, z.ports, z.rports);
        printf("%-28s %10.2f us %10.2f us %10.2f us\n", label,
            perCall(lib.get("getHbaByWwn"), hba, minSeconds),
            perCall(lib.get("getPortByWwn"), port, minSeconds),
            perCall(lib.get("getCompleteRemotePort"), remote, minSeconds));
    }

    rmdir(dir);
    return 0;
}
