// A long run: many mixed requests through the stand-in server, one after
// the other as a monitoring station polls, with alerts and a diagnostic
// test now and then, and the resident memory of the process sampled as it
// goes. A module that keeps something of each request grows; this one must
// stay flat once it has warmed up.
//
//   harden_long_run [--requests N] [--every M] [--tolerance PERCENT] [--warmup W]
//
// (defaults 100000, 10000, 1 and 20000): W requests first, which fill what
// is bounded but not empty at the start (the records of the diagnostic
// runs, the simulator's call log, the released objects the stand-in keeps
// poisoned); then a first sample, and one after every M of the N requests.
// The run fails if a sample lies more than PERCENT away from the first.

#include <malloc.h>
#include <stdio.h>
#include <stdlib.h>
#include <unistd.h>

#include <cmath>
#include <fstream>

#include "Harden.h"

extern "C" int dtruj_sim_inject_event(const char* json);

using namespace harden;

namespace
{

// Resident memory in KiB.
long residentKiB()
{
    long pages = 0, resident = 0;
    std::ifstream("/proc/self/statm") >> pages >> resident;
    return resident * (sysconf(_SC_PAGESIZE) / 1024);
}

// What malloc has handed out and not had back, in KiB, over all arenas.
long heapInUseKiB()
{
    struct mallinfo2 m = mallinfo2();
    return long((m.uordblks + m.hblkhd) / 1024);
}

} // namespace

int main(int argc, char** argv)
{
    size_t requests = 100000, every = 10000, warmup = 20000;
    double tolerance = 1.0;
    for (int i = 1; i < argc; i++)
    {
        std::string a = argv[i];
        if (a == "--requests" && i + 1 < argc)
            requests = strtoul(argv[++i], nullptr, 10);
        else if (a == "--every" && i + 1 < argc)
            every = strtoul(argv[++i], nullptr, 10);
        else if (a == "--warmup" && i + 1 < argc)
            warmup = strtoul(argv[++i], nullptr, 10);
        else if (a == "--tolerance" && i + 1 < argc)
            tolerance = atof(argv[++i]);
        else
        {
            fprintf(stderr, "usage: %s [--requests N] [--every M] [--tolerance PERCENT] [--warmup W]\n",
                    argv[0]);
            return 2;
        }
    }
    if (!every)
        every = 1;
    setvbuf(stdout, nullptr, _IOLBF, 0);
    // The stand-in keeps released objects to catch their use; what it
    // keeps of the delivery thread's is bounded low, so that it is all
    // there after the warm-up and the samples show the module alone.
    ch::Host& h = host("ERR", 50);

    // Reads, the methods that act without changing what the reads see, and
    // the console's read methods; a diagnostic test and an alert every
    // hundred requests, so that the module's lists of records are full
    // before the first sample.
    std::vector<Op> ops, tests;
    for (const Op& op : operations())
    {
        if (op.kind == OP_METHOD && op.method == "RunDiagnostic")
            tests.push_back(op);
        else if (op.kind == OP_RPC ? op.name.compare(0, 14, "rpc discovery.") == 0
                                   : op.kind != OP_SUBSCRIBE)
            ops.push_back(op);
    }
    resetSimulator();
    int sub = 0;
    if (!h.subscribe("root/vespera", "VESPERA_AlertIndication", sub).ok())
    {
        fprintf(stderr, "can't subscribe to the alerts\n");
        return 1;
    }

    auto t0 = std::chrono::steady_clock::now();
    std::vector<long> samples;
    size_t failed = 0, events = 0;
    printf("%10s %12s %10s %14s\n", "requests", "RSS KiB", "change", "heap used KiB");
    for (size_t n = 1; n <= warmup + requests; n++)
    {
        Outcome o = n % 100 == 50 && !tests.empty() ? run(tests[(n / 100) % tests.size()])
                                                    : run(ops[(n * 31) % ops.size()]);
        failed += o.rc != CMPI_RC_OK || o.answer == "text" || o.answer == "job-stuck";
        if (n % 100 == 0)
        {
            std::string e = "{\"eventCategory\":2,\"eventId\":1,\"portIndexString\":"
                            "\"100000051e8a1001\",\"eventSeverity\":4,\"eventMsg\":\"long run\"}";
            events += dtruj_sim_inject_event(e.c_str()) >= 0;
        }
        // Alerts that nobody reads would pile up in this process, not the
        // module's.
        if (n % 5000 == 0)
            h.clear_indications();
        if (n >= warmup && (n - warmup) % every == 0)
        {
            if (n == warmup)
                t0 = std::chrono::steady_clock::now();
            samples.push_back(residentKiB());
            double change = 100.0 * double(samples.back() - samples[0]) / double(samples[0]);
            printf("%10zu %12ld %+9.2f%% %14ld\n", n - warmup, samples.back(), change,
                   heapInUseKiB());
        }
    }
    h.unsubscribe(sub);

    long lo = samples.empty() ? 0 : samples[0], hi = lo;
    for (long s : samples)
    {
        lo = std::min(lo, s);
        hi = std::max(hi, s);
    }
    double spread = samples.empty() ? 0 : 100.0 * double(hi - lo) / double(samples[0]);
    double seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - t0).count();
    printf("\n%zu requests in %.1f s (%.0f/s), %zu events, %zu failed; RSS from %ld to %ld KiB "
           "after the first sample, a spread of %.2f%% (at most %.2f%%)\n",
           requests, seconds, double(requests) / seconds, events, failed, lo, hi, spread,
           tolerance);
    size_t left = objectsLeft();
    if (left)
        printf("%zu CMPI objects left\n", left);
    return failed == 0 && left == 0 && spread <= tolerance ? 0 : 1;
}
