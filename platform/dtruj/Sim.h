// Internal state of the simulated adapter library. Nothing here is exported.
#ifndef DTRUJ_SIM_H
#define DTRUJ_SIM_H

#include <atomic>
#include <condition_variable>
#include <cstdarg>
#include <deque>
#include <map>
#include <mutex>
#include <set>
#include <string>
#include <thread>
#include <unordered_map>
#include <vector>

#include "dtruj.h"

#define DTRUJ_API extern "C" __attribute__((visibility("default")))

namespace OLMA {
namespace Sim {

// What an injected fault does to the next call(s) of one entry.
struct Fault {
    std::string kind;       // null, error, hba, std, unknown, delay
    int code = 1;
    std::string message = "injected fault";
    int delayMs = 0;
    int remaining = -1;     // calls left; -1 means until cleared
};

// A diagnostic run posted through postDiagnostics and driven by startTests.
// Its progress is computed from the clock when asked, so no thread is needed.
struct DiagRun {
    std::vector<Json::Value> tests;
    bool started = false;
    bool stopOnError = false;
    bool cancelled = false;
    double startTime = 0;
    double cancelTime = 0;
};

// Where an FC or Ethernet port lies: its adapter's place and its own.
struct PortPlace {
    Json::ArrayIndex adapter = 0;
    Json::ArrayIndex port = 0;
};

// The look-ups below one FC port.
struct FcPortIndex {
    std::unordered_map<std::string, Json::ArrayIndex> vports;   // place in "vports"
    // A remote port by its logical port and its WWN: "" (the physical port
    // itself) or the virtual port's key, "|", the remote key -> its place in
    // that logical port's "remotePorts".
    std::unordered_map<std::string, Json::ArrayIndex> remotePorts;
};

// Addresses to places, so that a look-up never walks the host: a console
// polls large hosts port by port. Keys are addresses without colons, in
// lower case (addrKey). Built whenever the host is loaded; the entries that
// add or remove virtual ports mend what they touch.
struct HostIndex {
    std::unordered_map<std::string, Json::ArrayIndex> adapters;  // "wwn" and "hbaMAC"
    std::unordered_map<std::string, PortPlace> fcPorts;          // "wwn" and "fcoeMac"
    std::unordered_map<std::string, PortPlace> ethPorts;
    std::unordered_map<std::string, PortPlace> vports;           // their physical port
    std::vector<std::vector<FcPortIndex>> below;                 // [adapter][FC port]
};

struct State {
    ~State();                       // joins the event thread a caller left running

    std::mutex mtx;                 // guards everything below but the event queue
    bool loaded = false;
    bool initialised = false;
    std::string source;             // where the host description came from
    Json::Value host;               // the simulated host; setters change it
    HostIndex index;                // of host
    std::map<std::string, Fault> faults;
    std::map<std::string, double> resets;   // statistics key prefix -> time of reset
    std::map<std::string, DiagRun> runs;
    int lastRequestId = 0;
    double startTime = 0;
    std::vector<std::string> updateLog;
    std::set<std::string> flashing;     // adapters whose flash is being written

    // Events: a queue filled by injections, setters and the event source
    // file, emptied by the library's own thread.
    std::mutex evMtx;
    std::condition_variable evCv;
    std::deque<std::string> evQueue;
    bool evRegistered = false;
    bool evStop = false;
    unsigned evGeneration = 0;      // a thread let go by stopEvents ends when this moves on
    std::thread evThread;
    off_t evFileOffset = 0;
    std::atomic<unsigned long> evDelivered{0};  // texts handed to a callback
};

State& state();
double now();

std::atomic<EventProcessCB>& eventCallback();
std::atomic<LogMsgCB>& logCallback();

// The time this thread has spent in the module's log callback, in ns: the
// module's time, not the library's.
uint64_t& callbackNs();

// Library log lines go through the module's callback if it registered one.
void simLog(int level, const char* file, int line, const char* fmt, ...)
    __attribute__((format(printf, 4, 5)));
#define SIMLOG(level, ...) ::OLMA::Sim::simLog(level, __FILE__, __LINE__, __VA_ARGS__)
enum { SL_DEBUG = 1, SL_INFO = 2, SL_WARN = 3, SL_ERROR = 4 };

// Host description.
bool loadHost(State& s, std::string& err);       // caller holds s.mtx
bool parseHost(const std::string& text, Json::Value& host, std::string& err);
// Refuses a member of a type other than its own, naming it by its path
// ("adapters[0].ethPorts[1].mtu: expected a number").
bool checkHostTypes(const Json::Value& host, std::string& err);
// The same for one member of a part ("fcPort", "ethPort", "fcData", "fcoe",
// "auth") that a setter is about to write; a member of no known type passes.
bool checkMemberType(const char* part, const std::string& name, const Json::Value& value,
                     std::string& err);
void normaliseHost(Json::Value& host);
const char* builtinHostText();

// Errors as the library answers them: an object with "error".
Json::Value errorReply(int code, const std::string& message);
Json::Value okReply(const std::string& message);

std::string plainAddr(const std::string& colon);
std::string str(const Json::Value& v, const char* member);

// The index. indexFcPort builds the part below one FC port again, after
// its virtual ports changed.
std::string addrKey(const std::string& addr);
void indexHost(State& s);
void indexFcPort(State& s, PortPlace where);

// Look-ups in the host, by either text form and without regard to case.
// Each returns null when nothing matches.
Json::Value* findAdapter(State& s, const std::string& addr, int* id = nullptr);
Json::Value* findFcPort(State& s, const std::string& wwn, Json::Value** adapter = nullptr,
                        PortPlace* where = nullptr);
Json::Value* findEthPort(State& s, const std::string& mac, Json::Value** adapter = nullptr,
                         PortPlace* where = nullptr);
Json::Value* findVport(State& s, PortPlace where, const std::string& vwwn);
// lwwn empty or the port's own WWN: the physical port's remote ports.
Json::Value* findRemotePort(State& s, PortPlace where, const std::string& lwwn,
                            const std::string& rwwn);
// True if an FC port or a virtual port has the WWN.
bool wwnTaken(State& s, const std::string& wwn);
std::string adapterIndex(const Json::Value& adapter);
bool adapterIsCNA(const Json::Value& adapter);

// Replies built from the host.
Json::Value hbaReply(State& s, const Json::Value& adapter, int id);
Json::Value fcPortReply(const Json::Value& adapter, const Json::Value& port);
Json::Value ethPortReply(const Json::Value& adapter, const Json::Value& port);
bool lunVisible(const Json::Value& port, const std::string& rwwn, const Json::Value& number);
// The members under "unchecked" of a part of the host replace those of the
// reply built from it, whatever their type.
void overlayUnchecked(Json::Value& reply, const Json::Value& source);
// A copy of a part of the host as a reply: without "unchecked", overlaid.
Json::Value replyOf(const Json::Value& part);

// Counters that grow with time since their last reset.
uint64_t counterValue(State& s, const std::string& key, const std::string& name);
Json::Value counters(State& s, const std::string& key, const char* const* names);
void resetCounters(State& s, const std::string& keyPrefix);

// Events.
void queueEvent(State& s, const std::string& json);
void portEvent(State& s, int category, int id, const std::string& portAddr,
               const char* idValue, int severity, const char* msg);
bool startEvents(State& s, bool dropOld);
void stopEvents(State& s);
// Wakes the event thread, for events that waited for a callback.
void notifyEvents(State& s);
// The events that a change of the host raises, as the adapter would:
// enabling or disabling an adapter (its ports that are enabled themselves),
// the members "portStatus" and "linkUp" that a setter changed on a port,
// and a port's authentication going on or off.
void adapterStateEvents(State& s, const Json::Value& adapter, bool on);
void portChangeEvents(State& s, const Json::Value& port, bool fc,
                      const std::vector<std::string>& changed);
void authEvent(State& s, const Json::Value& port, bool on);

// The call log (Calls.cpp): every JSON entry records its request.
void recordCall(const char* entry, const Json::Value& req);
void clearCalls();

// Faults. takeFault picks the fault of an entry for this call, if any.
bool takeFault(State& s, const char* entry, Fault& f);
bool parseFault(const Json::Value& v, Fault& f, std::string& err);

} // namespace Sim
} // namespace OLMA

#endif
