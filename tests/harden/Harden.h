// What the hardening tools share: one process driving the built module
// through the strict stand-in CIM server, on the simulated library, with the
// catalogue of every operation a client can make of the module.
#ifndef _VSPR_harden_Harden_h
#define _VSPR_harden_Harden_h

#include <json/json.h>

#include <chrono>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include "cimhost.h"

extern "C" {
int dtruj_sim_reset(void);
int dtruj_sim_set_fault(const char* entry, const char* kind);
char* dtruj_sim_calls(void);
void dtruj_sim_clear_calls(void);
char* dtruj_sim_dump(void);
}

namespace harden
{

namespace ch = OLMA::cimhost;

// The world of this process, made on the first call, before anything of the
// module runs: a private HOME whose log is on at `logLevel` (gone at exit;
// HARDEN_LOG=DBG in the environment sets another level, HARDEN_KEEP=1 keeps
// the directory),
// the default host with short test, flash and settle times in its own
// description, and one stand-in server with the module loaded.
// `releasedKept` as in cimhost's Options.
ch::Host& host(const char* logLevel = "ERR", size_t releasedKept = 100000);
const std::string& workDir();

// The simulated library back to the quick host: faults, calls and changes
// forgotten.
void resetSimulator();

// The distinct library entries called since the log was cleared, in the
// order of their first call; `full` tells whether the log overflowed.
std::vector<std::string> calledEntries(bool* full = nullptr);

enum OpKind
{
    OP_EI,
    OP_EIN,
    OP_GI,
    OP_AI,
    OP_AN,
    OP_RI,
    OP_RN,
    OP_METHOD,      // an extrinsic CIM method other than executeMethod
    OP_RPC,         // executeMethod with a console's request
    OP_SUBSCRIBE,   // a subscription to the alerts, and its end
};

struct Op
{
    OpKind kind = OP_EI;
    std::string name;             // "ei VESPERA_FCPort", "rpc discovery.getCee"...
    ch::Object_Path path;         // class, instance, source object or method target
    std::string assocClass;       // ai/an/ri/rn
    bool association = false;     // an operation of an association class
    std::string method;           // OP_METHOD
    std::vector<ch::Property> in; // OP_METHOD
    std::string request;          // OP_RPC: the request text
};

// The module's operations on the quick host, found as a client finds them:
// the classes of the registration file, their instances, the association
// instances' ends, the methods that act, the console's 123 methods, and
// the alert subscription. Mutating operations come with arguments that
// work on the quick host; resetSimulator() undoes what they change.
std::vector<Op> operations();

// The console's requests, one for each method, as text.
const std::vector<std::string>& consoleRequests();

// What one operation gave.
struct Outcome
{
    CMPIrc rc = CMPI_RC_OK;
    size_t count = 0;         // instances or paths
    uint32_t value = 0;       // a method's return value
    Json::Value reply;        // a console's reply
    // The class of the answer: "ok", "rc:CMPI_RC_ERR_FAILED", "rv:4096",
    // "result", "error:JSONRPCError:200", "lib-error" (the library's own
    // "error"), "text" (not JSON), "job-stuck" (a test that never ended).
    std::string answer;
    std::string detail;       // a line for a message
};

// A fault of the simulated library that an operation runs under.
struct Fault
{
    const char* entry = nullptr;
    const char* kind = nullptr;   // as dtruj_sim_set_fault takes it
};

// Runs one operation; a diagnostic test started by it is waited for, at
// most `jobTimeoutMs`. The job list the wait reads comes from the library
// too, so `fault`, which the operation runs under, is lifted for each look.
// `started`, if given, is called once the operation itself has returned,
// before any waiting.
Outcome run(const Op& op, int jobTimeoutMs = 20000, Fault fault = Fault(),
            const std::function<void()>& started = nullptr);

// The CMPI objects left in the global scope once the threads that the last
// operation started have let theirs go (a test's thread ends a moment after
// its job), waiting at most `waitMs` for them.
size_t objectsLeft(int waitMs = 2000);

// One executeMethod, the response text.
std::string console(const std::string& request, CMPIrc* rc = nullptr);

// Fails the process, with the work under way and every thread's stack, when
// a piece of work doesn't end in time: a hang ends a run instead of holding
// it up.
class Watchdog
{
public:
    explicit Watchdog(int seconds);
    ~Watchdog();
    void start(const std::string& what);
    void done();

private:
    void watch();

    int _seconds;
    std::mutex _mutex;
    std::condition_variable _cv;
    bool _stop = false;
    bool _busy = false;
    std::string _what;
    std::chrono::steady_clock::time_point _since;
    std::thread _thread;
};

// Every thread's stack, from gdb if it is there, on standard error.
void dumpThreads();

// The share `group` (from 0) of `groups` of items of these costs: the
// costliest first, each to the share with the least so far, so that the
// shares take about as long. The places of its items, in their order.
std::vector<size_t> shareOf(const std::vector<size_t>& costs, int group, int groups);

} // namespace harden

#endif
