// Concurrency: client threads mixing enumerations, gets, association walks,
// console requests and the methods that act, against the module in the
// stand-in server, as a busy CIM server serves them (a thread for each
// request, providers called side by side), while the adapter library
// delivers events that become alerts and diagnostic tests run on their own
// thread. Every answer must be the one the same request gets alone, every
// event must arrive as an alert, nothing may be left behind, and a hang
// fails the run with the threads' stacks instead of holding it up.
//
//   harden_stress [--seconds S] [--clients N]     (defaults 3 and 8)
//
// Under ThreadSanitizer (./check --tsan) any data race or lock inversion
// the run provokes ends it with a report.

#include <stdio.h>
#include <stdlib.h>

#include <atomic>
#include <map>

#include "Harden.h"

extern "C" int dtruj_sim_inject_event(const char* json);

using namespace harden;

namespace
{

std::mutex failMutex;
std::vector<std::string> failures;
std::map<std::string, size_t> failuresOf;   // by operation

// The first failure of each operation is printed, the others counted.
void fail(const std::string& what, const std::string& line)
{
    std::lock_guard<std::mutex> g(failMutex);
    if (failuresOf[what]++ == 0)
        fprintf(stderr, "FAIL %s\n", line.c_str());
    failures.push_back(line);
}

void fail(const std::string& line)
{
    fail(line, line);
}

// The requests of the clients: what reads, and the methods that act but
// leave the host as it was. Diagnostic tests run on a thread of their own.
bool forClients(const Op& op)
{
    switch (op.kind)
    {
    case OP_RPC:
        return op.name.compare(0, 14, "rpc discovery.") == 0 ||
               op.name == "rpc diagnostics.getOpticsSFP" ||
               op.name == "rpc diagnostics.getOpticsPOM" ||
               op.name == "rpc configuration.setAlias" ||
               op.name == "rpc configuration.resetStatisticsForPorts";
    case OP_METHOD:
        return op.method != "RunDiagnostic";
    case OP_SUBSCRIBE:
        return false;
    default:
        return true;
    }
}

// Whether an answer under load is the one the request gets alone. What the
// diagnostic tests take out of service for a moment may answer the
// library's error instead; a list may be longer or shorter while jobs and
// records come and go.
bool same(const Outcome& alone, const Outcome& loaded)
{
    if (alone.answer == loaded.answer)
        return true;
    if (alone.answer == "result" && loaded.answer == "lib-error")
        return true;
    return alone.answer.compare(0, 3, "rv:") == 0 && loaded.answer.compare(0, 3, "rv:") == 0;
}

} // namespace

int main(int argc, char** argv)
{
    int seconds = 3, clients = 8;
    for (int i = 1; i < argc; i++)
    {
        std::string a = argv[i];
        if (a == "--seconds" && i + 1 < argc)
            seconds = atoi(argv[++i]);
        else if (a == "--clients" && i + 1 < argc)
            clients = atoi(argv[++i]);
        else
        {
            fprintf(stderr, "usage: %s [--seconds S] [--clients N]\n", argv[0]);
            return 2;
        }
    }
    setvbuf(stdout, nullptr, _IOLBF, 0);
    ch::Host& h = host("WARN");
    Watchdog watchdog(seconds + 120);
    watchdog.start("the stress run");

    std::vector<Op> all = operations(), ops, tests;
    for (const Op& op : all)
    {
        if (forClients(op))
            ops.push_back(op);
        else if (op.kind == OP_METHOD)
            tests.push_back(op);
    }
    resetSimulator();
    std::vector<Outcome> alone;
    for (const Op& op : ops)
        alone.push_back(run(op));

    int sub = 0;
    ch::Result r = h.subscribe("root/vespera", "VESPERA_AlertIndication", sub);
    if (!r.ok())
    {
        fprintf(stderr, "can't subscribe to the alerts: %s\n", r.message.c_str());
        return 1;
    }
    h.clear_indications();

    auto start = std::chrono::steady_clock::now();
    auto end = start + std::chrono::seconds(seconds);
    std::atomic<bool> stop {false};
    std::atomic<size_t> requests {0}, events {0}, runs {0};

    std::vector<std::thread> threads;
    for (int c = 0; c < clients; c++)
        threads.emplace_back([&, c] {
            // Each client its own walk through the requests.
            for (size_t i = size_t(c) * 7919; !stop; i += 31)
            {
                size_t k = i % ops.size();
                Outcome o = run(ops[k]);
                requests++;
                if (!same(alone[k], o))
                    fail(ops[k].name, ops[k].name + ": " + o.answer + " " + o.detail + ", alone " +
                         alone[k].answer);
            }
        });
    // The adapter library's events, as a storm of link changes.
    threads.emplace_back([&] {
        while (!stop)
        {
            std::string e = "{\"eventCategory\":2,\"eventId\":11,\"portIndexString\":"
                            "\"100000051e8a1001\",\"eventSeverity\":2,\"eventIdValue\":"
                            "\"TRU_PORT_LINKDOWN\",\"eventMsg\":\"stress " +
                            std::to_string(events.load()) + "\"}";
            if (dtruj_sim_inject_event(e.c_str()) >= 0)
                events++;
            std::this_thread::sleep_for(std::chrono::milliseconds(3));
        }
    });
    // One diagnostic test after the other.
    threads.emplace_back([&] {
        for (size_t i = 0; !stop && !tests.empty(); i++)
        {
            Outcome o = run(tests[i % tests.size()]);
            runs++;
            // The tests are this thread's alone: none is ever busy.
            if (o.answer != "rv:4096")
                fail(tests[i % tests.size()].name,
                     tests[i % tests.size()].name + ": " + o.answer + " " + o.detail);
        }
    });

    std::this_thread::sleep_until(end);
    stop = true;
    for (std::thread& t : threads)
        t.join();

    // Every event arrives as an alert, also those still queued.
    size_t delivered = 0;
    for (int waited = 0; waited < 30000; waited += 100)
    {
        delivered = 0;
        for (const ch::Indication_Record& rec : h.indications())
            delivered += rec.instance.get_text("Message").compare(0, 7, "stress ") == 0;
        if (delivered >= events)
            break;
        std::this_thread::sleep_for(std::chrono::milliseconds(100));
    }
    if (delivered < events)
        fail(std::to_string(events.load()) + " events, " + std::to_string(delivered) +
             " alerts of them delivered");
    r = h.unsubscribe(sub);
    if (!r.ok())
        fail("unsubscribe: " + r.message);
    size_t left = objectsLeft();
    if (left)
        fail(std::to_string(left) + " CMPI objects left");
    watchdog.done();

    for (const auto& f : failuresOf)
        if (f.second > 1)
            fprintf(stderr, "%zu failures of %s\n", f.second, f.first.c_str());
    double s = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    printf("%d clients, %.1f s: %zu requests (%.0f/s), %zu diagnostic tests, %zu events, "
           "%zu alerts delivered; %zu failures\n",
           clients, s, requests.load(), double(requests.load()) / seconds, runs.load(),
           events.load(), delivered, failures.size());
    return failures.empty() ? 0 : 1;
}
