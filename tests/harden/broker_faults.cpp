// Broker faults: one enumeration of each class, each method that acts, a
// console's request and an alert subscription, each run again and again
// with the n-th call it makes of the CIM server failing, for every n, as a
// server short of memory fails them. Nothing may crash, hang or leak, no
// CMPI object may be left behind, and the next healthy run must answer as
// the first did.
//
//   harden_broker_faults               every operation
//   harden_broker_faults --group 2/4   the second of four shares
//   harden_broker_faults --only NAME   operations whose name holds NAME
//   harden_broker_faults --stuck       also with every call from the n-th on failing
//
// Exit status 0 when all went well, 1 otherwise.

#include <stdio.h>
#include <string.h>

#include "Harden.h"

using namespace harden;

namespace
{

std::vector<std::string> failures;

void fail(const std::string& line)
{
    failures.push_back(line);
    fprintf(stderr, "FAIL %s\n", line.c_str());
}

} // namespace

int main(int argc, char** argv)
{
    int group = 0, groups = 1;
    std::string only;
    bool stuck = false;
    for (int i = 1; i < argc; i++)
    {
        std::string a = argv[i];
        if (a == "--group" && i + 1 < argc &&
            sscanf(argv[++i], "%d/%d", &group, &groups) == 2 && group >= 1 && group <= groups)
            group--;
        else if (a == "--only" && i + 1 < argc)
            only = argv[++i];
        else if (a == "--stuck")
            stuck = true;
        else
        {
            fprintf(stderr, "usage: %s [--group I/N] [--only NAME] [--stuck]\n", argv[0]);
            return 2;
        }
    }
    setvbuf(stdout, nullptr, _IOLBF, 0);
    auto t0 = std::chrono::steady_clock::now();
    ch::Host& h = host();
    Watchdog watchdog(120);

    // One enumeration of each class, the methods, one console request (one
    // that writes a long reply) and the subscription.
    std::vector<Op> ops;
    for (const Op& op : operations())
        if (op.kind == OP_EI || op.kind == OP_METHOD || op.kind == OP_SUBSCRIBE ||
            (op.kind == OP_RPC && op.name == "rpc discovery.getAllHbasByHost"))
            if (only.empty() || op.name.find(only) != std::string::npos)
                ops.push_back(op);

    // How many broker calls each makes when nothing fails.
    std::vector<Outcome> healthy(ops.size());
    std::vector<uint64_t> calls(ops.size());
    std::vector<size_t> costs(ops.size());
    for (size_t i = 0; i < ops.size(); i++)
    {
        resetSimulator();
        h.clear_broker_faults();
        // The calls of the operation itself, not of the wait for its test.
        calls[i] = 0;
        healthy[i] = run(ops[i], 20000, Fault(), [&] { calls[i] = h.broker_calls(); });
        if (!calls[i])
            calls[i] = h.broker_calls();
        costs[i] = size_t(calls[i]) + 1;
    }

    size_t runs = 0;
    printf("%-60s %8s %8s %8s\n", "operation", "calls", "ok", "failed");
    for (size_t i : shareOf(costs, group, groups))
    {
        const Op& op = ops[i];
        size_t ok = 0, failed = 0;
        // What the module keeps (jobs, records) may have changed the
        // answer since the first run.
        resetSimulator();
        Outcome before = run(op);
        for (int mode = 0; mode < (stuck ? 2 : 1); mode++)
            for (uint64_t n = 1; n <= calls[i]; n++)
            {
                resetSimulator();
                std::string what = op.name + ", broker call " + std::to_string(n) +
                                   (mode ? " and all after it" : "") + " failing";
                watchdog.start(what);
                h.fail_broker_calls(n, mode ? 0 : 1);
                Outcome o = run(op, 20000, Fault(), [&] { h.clear_broker_faults(); });
                h.clear_broker_faults();
                watchdog.done();
                runs++;
                (o.answer == before.answer && o.count == before.count ? ok : failed)++;
                if (o.answer == "job-stuck")
                    fail(what + ": the test's job never ended");
                if (objectsLeft() != 0)
                {
                    std::string left;
                    for (const std::string& d : h.left_objects())
                        left += (left.empty() ? "" : ", ") + d;
                    fail(what + ": " + std::to_string(h.live_objects()) +
                         " CMPI objects left: " + left);
                }
            }
        // No lasting harm: the module answers as it did before.
        resetSimulator();
        watchdog.start(op.name + " after its broker faults");
        Outcome after = run(op);
        watchdog.done();
        if (after.answer != before.answer || after.count != before.count)
            fail(op.name + " after its broker faults: " + after.answer + " (" +
                 std::to_string(after.count) + "), before them " + before.answer + " (" +
                 std::to_string(before.count) + ")");
        printf("%-60s %8llu %8zu %8zu\n", op.name.c_str(), (unsigned long long)calls[i], ok,
               failed);
    }
    double seconds =
        std::chrono::duration<double>(std::chrono::steady_clock::now() - t0).count();
    printf("\n%zu faulted runs, %zu failures, %.1f s\n", runs, failures.size(), seconds);
    return failures.empty() ? 0 : 1;
}
