// bench_rpc: how fast a console's requests go through executeMethod of
// VESPERA_AgentService in the stand-in CIM server, and whether memory stays
// flat over many of them.
//
//   bench_rpc [--host FILE] [--seconds S] [--requests N]
//
// Without --host it writes the large host of bench_inventory with
// tools/gen_host.py (8 adapters, 32 FC ports, 8,320 logical units). For each
// method it sends requests for at least S seconds (default 2) and prints the
// rate; then it sends N requests (default 100,000) of each method and prints
// the resident set size before and after. The module's log is off.

#include <dlfcn.h>
#include <stdlib.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <string>

#include "cimhost.h"

namespace ch = OLMA::cimhost;

namespace
{

struct Method
{
    const char* label;
    const char* request;
};

const Method methods[] = {
    {"discovery.getServerTime", "{\"method\":\"discovery.getServerTime\",\"params\":[],\"id\":1}"},
    {"discovery.getAllHbasByHost",
     "{\"method\":\"discovery.getAllHbasByHost\",\"params\":[],\"id\":2}"},
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

// The resident set now, in KiB (not the peak: growth is what matters).
long rssKiB()
{
    std::ifstream statm("/proc/self/statm");
    long size = 0, resident = 0;
    statm >> size >> resident;
    return resident * (sysconf(_SC_PAGESIZE) / 1024);
}

class Console
{
public:
    explicit Console(ch::Host& host) : _host(host)
    {
        _path.name_space = "root/vespera";
        _path.class_name = "VESPERA_AgentService";
        _path.keys.push_back({"Name", ch::Value::of_string("Vespera Agent Service Provider")});
        _in.resize(1);
        _in[0].name = "request";
    }

    // The response's length, or -1 if the call failed.
    long send(const char* request)
    {
        _in[0].value = ch::Value::of_string(request);
        ch::Result r = _host.cm(_path, "executeMethod", _in);
        if (!r.ok() || r.out.empty())
            return -1;
        for (const ch::Property& p : r.out)
            if (p.name == "response")
            {
                if (p.value.str.find("\"error\"") != std::string::npos && p.value.str.size() < 400)
                    fprintf(stderr, "bench_rpc: %s\n", p.value.str.c_str());
                return long(p.value.str.size());
            }
        return -1;
    }

private:
    ch::Host& _host;
    ch::Object_Path _path;
    std::vector<ch::Property> _in;
};

} // namespace

int main(int argc, char** argv)
{
    std::string hostFile;
    double minSeconds = 2.0;
    long requests = 100000;

    for (int i = 1; i < argc; i++)
    {
        if (!strcmp(argv[i], "--host") && i + 1 < argc)
            hostFile = argv[++i];
        else if (!strcmp(argv[i], "--seconds") && i + 1 < argc)
            minSeconds = atof(argv[++i]);
        else if (!strcmp(argv[i], "--requests") && i + 1 < argc)
            requests = atol(argv[++i]);
        else
        {
            fprintf(stderr, "usage: %s [--host FILE] [--seconds S] [--requests N]\n", argv[0]);
            return 2;
        }
    }

    char name[] = "/tmp/vspr-bench-XXXXXX";
    if (!mkdtemp(name))
    {
        perror("bench_rpc: mkdtemp");
        return 1;
    }
    std::string tmpDir = name;
    bool generated = hostFile.empty();
    if (generated)
    {
        hostFile = generateHost(tmpDir);
        if (hostFile.empty())
        {
            fprintf(stderr, "bench_rpc: tools/gen_host.py failed\n");
            return 1;
        }
    }
    setenv("DTRUJ_HOST", hostFile.c_str(), 1);
    // No .tesselrc in this HOME: the log stays off.
    setenv("HOME", tmpDir.c_str(), 1);

    // The module opens the library by its bare name; once loaded, that name
    // finds this copy.
    if (!dlopen(VSPR_DTRUJ_PATH, RTLD_NOW | RTLD_GLOBAL))
    {
        fprintf(stderr, "bench_rpc: %s\n", dlerror());
        return 1;
    }

    int status = 0;
    {
        ch::Host host;
        if (!host.ok())
        {
            fprintf(stderr, "bench_rpc: %s\n", host.error().c_str());
            return 1;
        }
        Console console(host);

        printf("host: %s\n", hostFile.c_str());
        printf("%-30s %10s %10s %14s %12s\n", "method", "requests", "seconds", "requests/s",
            "reply bytes");
        for (const Method& m : methods)
        {
            long length = 0;
            long runs = 0;
            double seconds = 0;
            auto start = std::chrono::steady_clock::now();
            do
            {
                length = console.send(m.request);
                if (length < 0)
                {
                    fprintf(stderr, "bench_rpc: %s failed\n", m.label);
                    status = 1;
                    break;
                }
                runs++;
                seconds = std::chrono::duration<double>(
                    std::chrono::steady_clock::now() - start).count();
            }
            while (seconds < minSeconds);
            printf("%-30s %10ld %10.2f %14.0f %12ld\n", m.label, runs, seconds,
                seconds > 0 ? runs / seconds : 0, length);
            fflush(stdout);
        }

        for (const Method& m : methods)
        {
            long before = rssKiB();
            for (long i = 0; i < requests && status == 0; i++)
                if (console.send(m.request) < 0)
                    status = 1;
            long after = rssKiB();
            printf("%-30s RSS before %ld KiB, after %ld requests %ld KiB (%+ld KiB)\n", m.label,
                before, requests, after, after - before);
            fflush(stdout);
        }
    }

    if (generated)
        unlink(hostFile.c_str());
    rmdir(tmpDir.c_str());
    return status;
}
