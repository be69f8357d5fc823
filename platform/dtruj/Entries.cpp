// The 117 exported entries of the simulated adapter library, and the few
// extra exports that tests and users drive it with.
#include "Sim.h"
#include "Console.h"

#include <atomic>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <fstream>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>

using namespace OLMA;
using namespace OLMA::Sim;

namespace {

typedef Json::Value (*Handler)(State&, const Json::Value&);

void sleepMs(int ms)
{
    if (ms > 0)
        std::this_thread::sleep_for(std::chrono::milliseconds(ms));
}

// Decides whether this call of `entry` is taken over by an injected fault.
// Throws for the kinds that throw; returns true with the reply set for the
// kinds that answer.
bool applyFault(const char* entry, Json::Value& reply)
{
    State& s = state();
    Fault f;
    {
        std::lock_guard<std::mutex> g(s.mtx);
        if (!takeFault(s, entry, f))
            return false;
    }
    SIMLOG(SL_INFO, "%s: injected fault %s", entry, f.kind.c_str());
    sleepMs(f.delayMs);
    if (f.kind == "null") {
        reply = Json::Value();
        return true;
    }
    if (f.kind == "error") {
        reply = errorReply(f.code, f.message);
        return true;
    }
    if (f.kind == "hba")
        throw HbaAgentError(f.code, f.message);
    if (f.kind == "std")
        throw std::runtime_error(f.message);
    if (f.kind == "unknown")
        throw f.code;
    return false;  // a plain delay
}

// What each entry has cost since its counters were last read and reset:
// calls, and the time spent in the library without the module's log
// callback. bench/ reads them to tell the module's own time from the
// library's.
struct EntryCounter {
    explicit EntryCounter(const char* n) : name(n), next(head())
    {
        head() = this;
    }
    static EntryCounter*& head()
    {
        static EntryCounter* first = nullptr;
        return first;
    }
    const char* name;
    std::atomic<uint64_t> calls{0};
    std::atomic<uint64_t> ns{0};
    EntryCounter* next;
};

uint64_t monotonicNs()
{
    return uint64_t(std::chrono::duration_cast<std::chrono::nanoseconds>(
        std::chrono::steady_clock::now().time_since_epoch()).count());
}

class Counting {
public:
    explicit Counting(EntryCounter& c)
        : counter(c), start(monotonicNs()), callbacks(callbackNs()) {}
    ~Counting()
    {
        uint64_t spent = monotonicNs() - start - (callbackNs() - callbacks);
        counter.calls.fetch_add(1, std::memory_order_relaxed);
        counter.ns.fetch_add(spent, std::memory_order_relaxed);
    }

private:
    EntryCounter& counter;
    uint64_t start;
    uint64_t callbacks;
};

Json::Value call(const char* entry, const Json::Value& req, Handler h, EntryCounter& counter)
{
    Counting counting(counter);
    recordCall(entry, req);
    Json::Value reply;
    if (applyFault(entry, reply) || echoReply(entry, req, reply))
        return reply;
    State& s = state();
    std::lock_guard<std::mutex> g(s.mtx);
    if (!s.initialised)
        return errorReply(1, std::string(entry) + ": the adapter library is not initialised");
    SIMLOG(SL_DEBUG, "enter %s", entry);
    if (!req.isNull() && !req.isObject() && !takesAnyRequest(entry))
        return errorReply(3, std::string(entry) + ": the request is not a JSON object");
    // A member of an unexpected type, in the request or in a hand-written
    // host description, makes JsonCpp throw; the caller gets an error reply
    // naming the entry instead.
    try {
        return h(s, req);
    } catch (const Json::Exception& e) {
        return errorReply(3, std::string(entry) + ": malformed value: " + e.what());
    }
}

Json::Value notFound(const char* what, const std::string& addr)
{
    return errorReply(2, std::string("No such ") + what + ": " + (addr.empty() ? "(none given)" : addr));
}

// The first of `keys` that the request carries as a non-empty text.
std::string firstOf(const Json::Value& req, std::initializer_list<const char*> keys)
{
    for (const char* k : keys) {
        std::string v = str(req, k);
        if (!v.empty())
            return v;
    }
    return std::string();
}

bool sameType(const Json::Value& a, const Json::Value& b)
{
    if (a.isNumeric() && b.isNumeric())
        return !a.isBool() && !b.isBool() ? true : a.isBool() == b.isBool();
    return a.type() == b.type();
}

// Applies the members named in `names` from `src` to `target`, a `part` of
// the host (see checkMemberType), all or none. Identity members can't be
// changed, and a value must keep its type, also where the host had none yet.
bool applyProps(Json::Value& target, const char* part, const Json::Value& src,
                const Json::Value& names, std::vector<std::string>& changed, std::string& err)
{
    static const char* const readOnly[] = {"wwn", "mac", "nodeWwn", "hbaMAC", "fcoeMac",
                                           "remotePorts", "vports", "vnics", nullptr};
    if (!names.isArray() || names.empty()) {
        err = "no property named in the property array";
        return false;
    }
    if (!src.isObject()) {
        err = "the property values are not an object";
        return false;
    }
    for (const Json::Value& n : names) {
        if (!n.isString()) {
            err = "a property name is not a text";
            return false;
        }
        std::string name = n.asString();
        for (const char* const* r = readOnly; *r; ++r)
            if (name == *r) {
                err = "property " + name + " is read-only";
                return false;
            }
        if (!src.isMember(name)) {
            err = "property " + name + " has no value";
            return false;
        }
        std::string why;
        if ((target.isMember(name) && !sameType(target[name], src[name]))
            || !checkMemberType(part, name, src[name], why)) {
            err = "property " + name + " has the wrong type";
            return false;
        }
    }
    for (const Json::Value& n : names) {
        std::string name = n.asString();
        if (target[name] != src[name])
            changed.push_back(name);
        target[name] = src[name];
    }
    return true;
}

bool contains(const std::vector<std::string>& v, const char* s)
{
    for (const auto& x : v)
        if (x == s)
            return true;
    return false;
}

int asIntLoose(const Json::Value& v, int dflt)
{
    if (v.isInt() || v.isUInt())
        return v.asInt();
    if (v.isString() && !v.asString().empty())
        return atoi(v.asString().c_str());
    return dflt;
}

// Ports by whichever key member the request uses.
struct PortRef {
    Json::Value* adapter = nullptr;
    Json::Value* fc = nullptr;
    Json::Value* eth = nullptr;
    PortPlace place;
    std::string addr;
};

PortRef findPort(State& s, const std::string& addr)
{
    PortRef r;
    r.addr = addr;
    if (addr.empty())
        return r;
    r.fc = findFcPort(s, addr, &r.adapter, &r.place);
    if (!r.fc)
        r.eth = findEthPort(s, addr, &r.adapter, &r.place);
    return r;
}

// Reads a part of the host without adding the members it lacks, as the
// non-const operator[] of JsonCpp would.
const Json::Value& ro(const Json::Value& v)
{
    return v;
}

// Copies a member into a reply if the part has it.
void copyIfAny(Json::Value& reply, const char* name, const Json::Value& part, const char* from = nullptr)
{
    if (part.isObject() && part.isMember(from ? from : name))
        reply[name] = part[from ? from : name];
}

// ---------------------------------------------------------------- statistics

const char* const portStatNames[] = {
    "txFrames", "txWords", "rxFrames", "rxWords", "lipCount", "nosCount", "crcErrors",
    "errorFrames", "dumpedFrames", "linkFailures", "lossOfSync", "lossOfSignal",
    "primitiveSeqErrors", "invalidTxWords", "badEofFrames", "frameTooLongErrors", nullptr};

struct StatId { int id; const char* name; };

// The ids that a caller of getDynamicPortStatistics reads, by port kind.
const StatId fcStatIds[] = {
    {1402, "txFrames"}, {1403, "txWords"}, {1404, "txLip"}, {1405, "txNos"},
    {1409, "rxFrames"}, {1410, "rxWords"}, {1411, "lipCount"}, {1412, "nosCount"},
    {1413, "olsCount"}, {1414, "lrCount"}, {1416, "crcErrors"}, {1417, "badEofFrames"},
    {1419, "frameTooLongErrors"}, {1420, "frameTooShortErrors"}, {1421, "errorFrames"},
    {1422, "dumpedFrames"}, {1423, "linkFailures"}, {1424, "lossOfSync"},
    {1425, "lossOfSignal"}, {1426, "primitiveSeqErrors"}, {1427, "badRxCharErrors"},
    {1428, "invalidTxWords"}, {0, nullptr}};

// FCoE traffic is counted by unicast, multicast and broadcast frames and bytes.
const StatId fcoeStatIds[] = {
    {1603, "txUcastFrames"}, {1604, "txMcastFrames"}, {1605, "txBcastFrames"},
    {1606, "txUcastBytes"}, {1607, "txMcastBytes"}, {1608, "txBcastBytes"},
    {1609, "rxUcastFrames"}, {1610, "rxMcastFrames"}, {1611, "rxBcastFrames"},
    {1612, "rxUcastBytes"}, {1613, "rxMcastBytes"}, {1614, "rxBcastBytes"},
    {1615, "rxTooLongError"}, {1616, "fcsError"}, {1624, "dumpedFrames"},
    {1625, "rxDropError"}, {1626, "crcError"}, {1627, "txUnderrunError"},
    {1628, "rxOverrunError"}, {0, nullptr}};

const char* const qosNames[] = {"highPriorityFrames", "mediumPriorityFrames", "lowPriorityFrames",
                                "qosNegotiationFailures", nullptr};
const char* const lportNames[] = {"txFrames", "rxFrames", "loginCount", "logoutCount",
                                  "loginErrors", "rscnCount", nullptr};
const char* const rportNames[] = {"plogiSent", "plogiAccepts", "plogiRejects", "logoCount",
                                  "prliCount", "abtsCount", "timeoutCount", nullptr};
const char* const fcpimNames[] = {"readRequests", "writeRequests", "readBytes", "writeBytes",
                                  "ioAborts", "ioTimeouts", "ioErrors", nullptr};
const char* const iopNames[] = {"iosStarted", "iosCompleted", "iosOutstanding", "iosFailed",
                                "latencyMicros", nullptr};
const char* const fabricNames[] = {"flogiSent", "flogiAccepts", "flogiRejects", "fdiscSent",
                                   "fdiscAccepts", "fdiscErrors", "rscnReceived", nullptr};
const char* const authNames[] = {"authSuccess", "authFailures", "authRejects",
                                 "authNegotiationTimeouts", nullptr};
const char* const iocNames[] = {"mailboxCommands", "interrupts", "heartbeatFailures",
                                "firmwareErrors", "ioRequests", nullptr};
const char* const fcoeNames[] = {"fipDiscoverySent", "fipAdvertisementsReceived", "vlanRequests",
                                 "fcfLost", "fcsErrors", "rxFrames", "txFrames", nullptr};
const char* const fcpimModNames[] = {"lunResets", "targetResets", "taskAborts", "ioRedirects",
                                     "pathFailovers", nullptr};
const char* const fwNames[] = {"heartbeatCount", "firmwareResets", "firmwareErrors",
                               "traceEntries", nullptr};
const char* const trunkNames[] = {"trunkFrames", "trunkWords", "deskewErrors", "linkDrops", nullptr};
const char* const ethNames[] = {"txPackets", "rxPackets", "txBytes", "rxBytes", "txErrors",
                                "rxErrors", "rxCrcErrors", "rxDropped", "pauseFrames", nullptr};
const char* const iocEthNames[] = {"txQueuePackets", "rxQueuePackets", "mailboxInterrupts",
                                   "rxBufferErrors", "txTimeouts", nullptr};
const char* const vhbaNames[] = {"txFrames", "rxFrames", "ioRequests", "ioErrors", nullptr};
const char* const vnicNames[] = {"txPackets", "rxPackets", "txBytes", "rxBytes", "txDropped",
                                 "rxDropped", nullptr};
const char* const lldpNames[] = {"framesTransmitted", "framesReceived", "framesDiscarded",
                                 "tlvsDiscarded", "ageouts", "frameErrors", nullptr};
const char* const advIoNames[] = {"ioCount", "readCount", "writeCount", "readBytes", "writeBytes",
                                  "ioLatencyMicros", "ioErrors", nullptr};

// A statistics reading: the key names the object; an unknown port answers an
// error as a real adapter would.
Json::Value statsOf(State& s, const std::string& family, const std::string& port,
                    const std::string& extra, const char* const* names, bool ethPort = false)
{
    PortRef p = findPort(s, port);
    if (!p.fc && !p.eth && !findAdapter(s, port))
        return notFound(ethPort ? "Ethernet port" : "port", port);
    std::string key = family + "|" + plainAddr(port);
    if (!extra.empty())
        key += "|" + extra;
    return counters(s, key, names);
}

Json::Value resetOf(State& s, const std::string& family, const std::string& port,
                    const std::string& extra = std::string())
{
    PortRef p = findPort(s, port);
    if (!p.fc && !p.eth && !findAdapter(s, port))
        return notFound("port", port);
    std::string key = family + "|" + plainAddr(port);
    if (!extra.empty())
        key += "|" + extra;
    resetCounters(s, key);
    SIMLOG(SL_INFO, "statistics %s reset", key.c_str());
    return okReply("Statistics reset");
}

std::string scopeKey(const Json::Value& req)
{
    std::string k;
    for (const char* m : {"lPortWwn", "rPortWwn", "lunId"}) {
        std::string v = str(req, m);
        if (v.empty())
            break;
        k += (k.empty() ? "" : "|") + plainAddr(v);
    }
    return k;
}

// ---------------------------------------------------------------- diagnostics

// The configuration of a test, the host's default overlaid by the port's own.
Json::Value testConfig(State& s, const char* test, const Json::Value* port)
{
    Json::Value c = ro(s.host)["diagnostics"][test];
    if (port && (*port)["diag"].isObject() && (*port)["diag"][test].isObject())
        for (const std::string& m : (*port)["diag"][test].getMemberNames())
            c[m] = (*port)["diag"][test][m];
    return c;
}

Json::Value runResults(State& s, const std::string& id, DiagRun& run)
{
    Json::Value r(Json::objectValue);
    r["requestID"] = id;
    r["stopOnError"] = run.stopOnError;
    Json::Value results(Json::arrayValue);
    double t = run.startTime;
    double nowT = now();
    bool stopped = false;
    bool running = false;
    for (const Json::Value& test : run.tests) {
        Json::Value cfg = ro(s.host)["diagnostics"]["posted"][test["function"].asString()];
        double dur = cfg.get("durationMs", 100).asDouble() / 1000.0;
        Json::Value e(Json::objectValue);
        e["function"] = test["function"];
        for (const char* m : {"hbaWwn", "portWwn", "localPortWwn", "remotePortWwn"})
            if (test.isMember(m))
                e[m] = test[m];
        if (!run.started) {
            e["status"] = "Queued";
        } else if (stopped) {
            e["status"] = "Skipped";
        } else if (run.cancelled && run.cancelTime < t + dur) {
            e["status"] = "Cancelled";
            stopped = true;
        } else if (nowT < t + dur) {
            e["status"] = "Running";
            running = true;
            stopped = true;     // the later ones haven't started yet
        } else {
            e["status"] = cfg.get("status", "Passed");
            e["output"] = cfg.get("output", "");
            e["durationMs"] = cfg.get("durationMs", 100);
            if (run.stopOnError && e["status"].asString() != "Passed")
                stopped = true;
        }
        if (running && e["status"].asString() == "Skipped")
            e["status"] = "Queued";
        t += dur;
        results.append(e);
    }
    if (!run.started)
        r["state"] = "NotStarted";
    else if (running)
        r["state"] = "Running";
    else if (run.cancelled && run.cancelTime < t)
        r["state"] = "Cancelled";
    else
        r["state"] = "Completed";
    r["results"] = results;
    return r;
}

bool knownRequestId(State& s, const std::string& id)
{
    char* end = nullptr;
    long v = strtol(id.c_str(), &end, 10);
    return !id.empty() && end && *end == '\0' && v >= 1 && v <= s.lastRequestId;
}

std::string nextVersion(const std::string& v)
{
    size_t pos = v.find_last_of("0123456789");
    if (pos == std::string::npos)
        return v.empty() ? "1" : v + ".1";
    size_t start = pos;
    while (start > 0 && isdigit((unsigned char)v[start - 1]))
        --start;
    long n = atol(v.substr(start, pos - start + 1).c_str());
    return v.substr(0, start) + std::to_string(n + 1) + v.substr(pos + 1);
}

std::string colonMacPlus(const std::string& mac, int add)
{
    unsigned b[6];
    if (sscanf(mac.c_str(), "%x:%x:%x:%x:%x:%x", &b[0], &b[1], &b[2], &b[3], &b[4], &b[5]) != 6)
        return mac;
    unsigned long v = 0;
    for (unsigned x : b)
        v = (v << 8) | (x & 0xff);
    v += unsigned(add);
    char buf[18];
    snprintf(buf, sizeof(buf), "%02lx:%02lx:%02lx:%02lx:%02lx:%02lx", (v >> 40) & 0xff,
             (v >> 32) & 0xff, (v >> 24) & 0xff, (v >> 16) & 0xff, (v >> 8) & 0xff, v & 0xff);
    return buf;
}

} // namespace

#define UNUSED __attribute__((unused))
#define JSON_ENTRY(name)                                                          \
    static Json::Value do_##name(State& s UNUSED, const Json::Value& req UNUSED); \
    static EntryCounter counter_##name(#name);                                    \
    DTRUJ_API Json::Value name(const Json::Value& req)                            \
    {                                                                             \
        return call(#name, req, do_##name, counter_##name);                       \
    }                                                                             \
    static Json::Value do_##name(State& s UNUSED, const Json::Value& req UNUSED)

// Every entry below answers from the simulated host under the one mutex.

// ---------------------------------------------------------------- library

// The version is fixed for the life of the process: the module keeps the
// pointer. DTRUJ_VERSION lets a test play an older library.
static const char* agentVersion()
{
    static const std::string version = [] {
        const char* v = getenv("DTRUJ_VERSION");
        return std::string(v && *v ? v : "3.2.1");
    }();
    return version.c_str();
}

DTRUJ_API const char* get_agt_version()
{
    Json::Value dummy;
    if (applyFault("get_agt_version", dummy))
        return nullptr;
    return agentVersion();
}

DTRUJ_API void registerLogMsgCb(LogMsgCB cb)
{
    Json::Value dummy;
    applyFault("registerLogMsgCb", dummy);
    logCallback().store(cb);
}

DTRUJ_API void registerEventProcessingCb(EventProcessCB cb)
{
    Json::Value dummy;
    applyFault("registerEventProcessingCb", dummy);
    eventCallback().store(cb);
    notifyEvents(state());
}

DTRUJ_API Json::Value init_hba_lib(const Json::Value& req)
{
    Json::Value reply;
    if (applyFault("init_hba_lib", reply))
        return reply;
    State& s = state();
    std::lock_guard<std::mutex> g(s.mtx);
    Json::Value r(Json::objectValue);
    if (!s.loaded) {
        std::string err;
        if (!loadHost(s, err)) {
            SIMLOG(SL_ERROR, "%s", err.c_str());
            fprintf(stderr, "dtruj: %s\n", err.c_str());
            r["result"] = 3;
            r["message"] = err;
            return r;
        }
    }
    if (s.host["host"].isMember("initResult") && s.host["host"]["initResult"].asInt() != 0) {
        r["result"] = s.host["host"]["initResult"].asInt();
        r["message"] = "initialisation refused by the host description";
        return r;
    }
    s.initialised = true;
    SIMLOG(SL_INFO, "initialised for application %d", req.isObject() && req["appId"].isInt() ? req["appId"].asInt() : 0);
    r["result"] = 0;
    r["message"] = "Success";
    return r;
}

DTRUJ_API int free_hba_lib()
{
    Json::Value dummy;
    if (applyFault("free_hba_lib", dummy))
        return -1;
    State& s = state();
    stopEvents(s);
    std::lock_guard<std::mutex> g(s.mtx);
    s.initialised = false;
    return 0;
}

DTRUJ_API unsigned int getNumberOfAdapters()
{
    Json::Value dummy;
    if (applyFault("getNumberOfAdapters", dummy))
        return 65535;
    State& s = state();
    std::lock_guard<std::mutex> g(s.mtx);
    return s.initialised ? s.host["adapters"].size() : 0;
}

DTRUJ_API int getRequestID()
{
    Json::Value dummy;
    if (applyFault("getRequestID", dummy))
        return -1;
    State& s = state();
    std::lock_guard<std::mutex> g(s.mtx);
    if (!s.initialised)
        return -1;
    return ++s.lastRequestId;
}

JSON_ENTRY(register_for_events)
{
    bool drop = req.isObject() && req.get("dropOldEvents", false).asBool();
    startEvents(s, drop);
    return okReply("Registered for events");
}

JSON_ENTRY(unregister_for_events)
{
    // The event thread may itself be waiting for the host mutex in a
    // callback; joining it under that mutex could deadlock, so let go first.
    s.mtx.unlock();
    stopEvents(s);
    s.mtx.lock();
    return okReply("Unregistered from events");
}

// ---------------------------------------------------------------- host, adapters

JSON_ENTRY(getHost)
{
    Json::Value r = s.host["host"];
    r.removeMember("initResult");
    if (str(r, "hostName").empty()) {
        char name[256] = "";
        gethostname(name, sizeof(name) - 1);
        r["hostName"] = name;
    }
    r["numOfAdapters"] = Json::UInt(s.host["adapters"].size());
    r["libraryVersion"] = agentVersion();
    return r;
}

JSON_ENTRY(getServerTime)
{
    Json::Value r(Json::objectValue);
    time_t t = time(nullptr);
    struct tm tmv;
    gmtime_r(&t, &tmv);
    char buf[32];
    strftime(buf, sizeof(buf), "%Y-%m-%dT%H:%M:%SZ", &tmv);
    r["serverTime"] = Json::UInt64(t);
    r["utcTime"] = buf;
    return r;
}

JSON_ENTRY(getGlobalInfo)
{
    Json::Value r(Json::objectValue);
    Json::Value& ads = s.host["adapters"];
    r["numOfAdapters"] = Json::UInt(ads.size());
    r["adapter"] = Json::Value(Json::arrayValue);
    for (const Json::Value& a : ro(ads)) {
        Json::Value e(Json::objectValue);
        bool cna = adapterIsCNA(a);
        bool fcoe = false;
        for (const Json::Value& p : a["fcPorts"])
            fcoe = fcoe || p["isFCoE"].asBool();
        e["cna"] = cna;
        e["fc"] = !cna && !a["fcPorts"].empty();
        e["fcoe"] = fcoe;
        e["ethPort"] = !a["ethPorts"].empty();
        e["mac"] = a["hbaData"].get("hbaMAC", "");
        copyIfAny(e, "wwn", a["hbaData"]);
        copyIfAny(e, "model", a["hbaData"]);
        Json::Value hasFc(Json::arrayValue), hasEth(Json::arrayValue), hasFcoe(Json::arrayValue);
        Json::Value pw(Json::arrayValue), pm(Json::arrayValue), fm(Json::arrayValue);
        for (const Json::Value& p : a["fcPorts"]) {
            hasFc.append(true);
            hasEth.append(false);
            hasFcoe.append(p["isFCoE"].asBool());
            pw.append(p["wwn"]);
            pm.append("");
            fm.append(p.get("fcoeMac", ""));
        }
        for (const Json::Value& p : a["ethPorts"]) {
            hasFc.append(false);
            hasEth.append(true);
            hasFcoe.append(false);
            pw.append("");
            pm.append(p["mac"]);
            fm.append("");
        }
        e["numOfPorts"] = Json::UInt(hasFc.size());
        e["portHasFc"] = hasFc;
        e["portHasEth"] = hasEth;
        e["portHasFcoe"] = hasFcoe;
        e["portWwn"] = pw;
        e["portMac"] = pm;
        e["fcoeMac"] = fm;
        overlayGlobalInfo(e, a);
        r["adapter"].append(e);
    }
    overlayGlobalInfo(r, s.host);
    return r;
}

JSON_ENTRY(getAllAdaptersIndexString)
{
    Json::Value r(Json::objectValue);
    r["indexStrings"] = Json::Value(Json::arrayValue);
    for (const Json::Value& a : s.host["adapters"])
        r["indexStrings"].append(adapterIndex(a));
    return r;
}

static Json::Value hbaBy(State& s, const std::string& addr)
{
    int id = 0;
    Json::Value* a = findAdapter(s, addr, &id);
    if (!a)
        return notFound("adapter", addr);
    return hbaReply(s, *a, id);
}

JSON_ENTRY(getHbaByWwn) { return hbaBy(s, firstOf(req, {"wwn", "mac", "indexStr"})); }
JSON_ENTRY(getHbaByMac) { return hbaBy(s, firstOf(req, {"mac", "wwn", "indexStr"})); }

JSON_ENTRY(getAdapterId)
{
    std::string addr = firstOf(req, {"indexStr", "wwn", "mac"});
    int id = 0;     // 0: no adapter has this address
    findAdapter(s, addr, &id);
    Json::Value r(Json::objectValue);
    r["adapterId"] = id;
    return r;
}

JSON_ENTRY(getAdapterIdByPort)
{
    std::string addr = firstOf(req, {"indexStr", "wwn", "mac"});
    PortRef p = findPort(s, addr);
    Json::Value r(Json::objectValue);
    r["adapterId"] = p.adapter ? int(p.place.adapter) + 1 : 0;     // 0: no adapter has this port
    return r;
}

JSON_ENTRY(setAdapterState)
{
    std::string addr = firstOf(req, {"indexStr", "wwn", "mac"});
    Json::Value* a = findAdapter(s, addr);
    if (!a)
        return notFound("adapter", addr);
    if (!req.isMember("enableState") || !req["enableState"].isBool())
        return errorReply(3, "enableState must be a boolean");
    bool on = req["enableState"].asBool();
    if ((*a)["hbaData"]["hbaStatus"].asBool() != on) {
        (*a)["hbaData"]["hbaStatus"] = on;
        adapterStateEvents(s, *a, on);
    }
    SIMLOG(SL_INFO, "adapter %s %s", addr.c_str(), on ? "enabled" : "disabled");
    return okReply(on ? "Adapter enabled" : "Adapter disabled");
}

JSON_ENTRY(setAdapterMode)
{
    std::string addr = firstOf(req, {"indexStr", "wwn", "mac"});
    Json::Value* a = findAdapter(s, addr);
    if (!a)
        return notFound("adapter", addr);
    std::string mode = str(req, "adapterMode");
    bool ok = mode == "HBA" || (adapterIsCNA(*a) && (mode == "CNA" || mode == "NIC"));
    if (!ok)
        return errorReply(3, "Unsupported adapter mode: " + mode);
    (*a)["hbaData"]["mode"] = mode;
    Json::Value r = okReply("Adapter mode set; it takes effect after a reboot");
    r["rebootRequired"] = true;
    return r;
}

JSON_ENTRY(setAdapterAlias)
{
    std::string addr = firstOf(req, {"indexStr", "wwn", "mac", "hbaWwn"});
    Json::Value* a = findAdapter(s, addr);
    if (!a)
        return notFound("adapter", addr);
    if (!req.isMember("alias") || !req["alias"].isString())
        return errorReply(3, "alias must be a text");
    (*a)["hbaData"]["alias"] = req["alias"];
    return okReply("Adapter alias set");
}

JSON_ENTRY(setPortAlias)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn", "mac", "portWwn"}));
    Json::Value* port = p.fc ? p.fc : p.eth;
    if (!port)
        return notFound("port", p.addr);
    if (!req.isMember("alias") || !req["alias"].isString())
        return errorReply(3, "alias must be a text");
    (*port)["alias"] = req["alias"];
    return okReply("Port alias set");
}

JSON_ENTRY(getAdvAdapterData)
{
    std::string addr = firstOf(req, {"indexStr", "wwn", "mac"});
    Json::Value* a = findAdapter(s, addr);
    if (!a)
        return notFound("adapter", addr);
    const Json::Value& ad = *a;
    Json::Value r = ad["advData"];
    r["indexStr"] = adapterIndex(ad);
    r["mode"] = ad["hbaData"]["mode"];
    copyIfAny(r, "alias", ad["hbaData"]);
    r["numPciFunctions"] = Json::UInt(ad["fcPorts"].size());
    return r;
}

JSON_ENTRY(getAdapterPciFnData)
{
    std::string addr = firstOf(req, {"indexStr", "wwn", "mac"});
    Json::Value* a = findAdapter(s, addr);
    if (!a)
        return notFound("adapter", addr);
    Json::Value r(Json::arrayValue);
    int fn = 0;
    for (const Json::Value& p : (*a)["fcPorts"]) {
        Json::Value e(Json::objectValue);
        e["pciFunction"] = fn++;
        e["type"] = p["isFCoE"].asBool() ? "FCoE" : "FC";
        e["wwn"] = p["wwn"];
        r.append(e);
    }
    for (const Json::Value& p : (*a)["ethPorts"])
        for (const Json::Value& v : p["vnics"]) {
            Json::Value e = v;
            e["pciFunction"] = fn++;
            e["type"] = "NIC";
            e["portMac"] = p["mac"];
            r.append(e);
        }
    return r;
}

// The index strings of one kind of physical port of the adapter a request names.
static Json::Value portIndices(State& s, const Json::Value& req, const char* ports,
                               const char* address)
{
    std::string addr = firstOf(req, {"indexStr", "wwn", "mac"});
    Json::Value* a = findAdapter(s, addr);
    if (!a)
        return notFound("adapter", addr);
    Json::Value r(Json::objectValue);
    r["indexStrings"] = Json::Value(Json::arrayValue);
    for (const Json::Value& p : (*a)[ports])
        r["indexStrings"].append(p[address]);
    return r;
}

JSON_ENTRY(getFcPhyPortIndicesByAdapter)
{
    return portIndices(s, req, "fcPorts", "wwn");
}

JSON_ENTRY(getEthPhyPortIndicesByAdapter)
{
    return portIndices(s, req, "ethPorts", "mac");
}

// ---------------------------------------------------------------- flash

JSON_ENTRY(getFlashInfo)
{
    std::string addr = firstOf(req, {"indexStr", "wwn", "mac"});
    Json::Value* a = findAdapter(s, addr);
    if (!a)
        return notFound("adapter", addr);
    Json::Value r = (*a)["flash"];
    r.removeMember("updateStatus");
    r.removeMember("updateMessage");
    r.removeMember("durationMs");
    copyIfAny(r, "firmwareVersion", ro(*a)["firmware"], "version");
    copyIfAny(r, "biosVersion", ro(*a)["firmware"]);
    return r;
}

// ---------------------------------------------------------------- flash update
//
// A flash takes its "durationMs" outside the host lock, as a real one keeps
// the adapter busy but not the library: the inventory goes on answering,
// with the old version until the new one is written.

namespace {

const int FLASH_DEFAULT_MS = 1000;

// The version an image names in a line "version=<text>" near its start, or
// "" if none. Only the start is read: an image is large and mostly binary.
std::string imageVersion(std::ifstream& in)
{
    std::string head(64 * 1024, '\0');
    in.read(&head[0], (std::streamsize)head.size());
    head.resize((size_t)in.gcount());
    size_t pos = 0;
    for (int i = 0; i < 64 && pos < head.size(); ++i) {
        size_t end = head.find('\n', pos);
        if (end == std::string::npos)
            end = head.size();
        if (head.compare(pos, 8, "version=") == 0) {
            std::string v = head.substr(pos + 8, end - pos - 8);
            while (!v.empty() && isspace((unsigned char)v.back()))
                v.pop_back();
            return v;
        }
        pos = end + 1;
    }
    return std::string();
}

struct FlashJob {
    std::string adapter;    // index string; empty when nothing is to be written
    std::string version;    // the new version on success
    int delay = 0;
};

Json::Value prepFlash(State& s, const Json::Value& req, FlashJob& job)
{
    std::string addr = firstOf(req, {"indexStr", "wwn", "mac"});
    Json::Value* a = findAdapter(s, addr);
    if (!a)
        return notFound("adapter", addr);
    std::string index = adapterIndex(*a);
    std::string file = str(req, "file");
    Json::Value r(Json::objectValue);
    std::ifstream in(file.c_str(), std::ios::binary);
    struct stat st;
    if (file.empty() || !in || stat(file.c_str(), &st) != 0 || !S_ISREG(st.st_mode)) {
        r["status"] = 2;
        r["message"] = "Cannot open image file " + file;
        s.updateLog.push_back(index + ": " + r["message"].asString());
        return r;
    }
    if (s.flashing.count(index)) {
        r["status"] = 3;
        r["message"] = "A flash update of this adapter is already running";
        s.updateLog.push_back(index + ": " + r["message"].asString());
        return r;
    }
    const Json::Value& fl = ro(*a)["flash"];
    job.adapter = index;
    job.delay = fl.isMember("durationMs") ? fl["durationMs"].asInt() : FLASH_DEFAULT_MS;
    s.flashing.insert(index);
    if (fl.isMember("updateStatus") && fl["updateStatus"].asInt() != 0) {
        r["status"] = fl["updateStatus"].asInt();
        r["message"] = fl.get("updateMessage", "Flash write failed").asString();
        return r;
    }
    job.version = imageVersion(in);
    if (job.version.empty())
        job.version = nextVersion(str(ro(*a)["firmware"], "version"));
    r["status"] = 0;
    r["message"] = "Flash updated to firmware version " + job.version + " (" +
                   std::to_string((long long)st.st_size) + " bytes)";
    return r;
}

} // namespace

DTRUJ_API Json::Value adapterUpdateFlash(const Json::Value& req)
{
    Json::Value reply;
    if (applyFault("adapterUpdateFlash", reply))
        return reply;
    State& s = state();
    FlashJob job;
    {
        std::lock_guard<std::mutex> g(s.mtx);
        if (!s.initialised)
            return errorReply(1, "adapterUpdateFlash: the adapter library is not initialised");
        if (!req.isNull() && !req.isObject())
            return errorReply(3, "adapterUpdateFlash: the request is not a JSON object");
        try {
            reply = prepFlash(s, req, job);
        } catch (const Json::Exception& e) {
            return errorReply(3, std::string("adapterUpdateFlash: malformed value: ") + e.what());
        }
        if (job.adapter.empty())
            return reply;
        SIMLOG(SL_INFO, "%s: writing the flash (%d ms)", job.adapter.c_str(), job.delay);
    }
    sleepMs(job.delay);
    std::lock_guard<std::mutex> g(s.mtx);
    s.flashing.erase(job.adapter);
    // The host may have been reloaded meanwhile; the adapter is found again.
    Json::Value* a = findAdapter(s, job.adapter);
    if (a && !job.version.empty())
        (*a)["firmware"]["version"] = job.version;
    s.updateLog.push_back(job.adapter + ": " + reply["message"].asString());
    SIMLOG(SL_INFO, "%s: %s", job.adapter.c_str(), reply["message"].asString().c_str());
    return reply;
}

JSON_ENTRY(getDriverUpdateStatus)
{
    Json::Value r(Json::objectValue);
    r["status"] = s.flashing.empty() ? "Idle" : "Updating";
    r["log"] = Json::Value(Json::arrayValue);
    for (const std::string& l : s.updateLog)
        r["log"].append(l);
    return r;
}

// ---------------------------------------------------------------- FC ports

JSON_ENTRY(getPortByWwn)
{
    PortRef p = findPort(s, firstOf(req, {"wwn", "mac", "indexStr"}));
    if (p.fc)
        return fcPortReply(*p.adapter, *p.fc);
    if (p.eth)
        return ethPortReply(*p.adapter, *p.eth);
    return notFound("port", p.addr);
}

JSON_ENTRY(setPortByWwn)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn", "mac"}));
    Json::Value* port = p.fc ? p.fc : p.eth;
    if (!port)
        return notFound("port", p.addr);
    const Json::Value& names = req["propArray"];
    const Json::Value& mezz = ro(*port).isMember("isMezz") ? ro(*port)["isMezz"] : ro(*p.adapter)["hbaData"]["isMezz"];
    if (p.fc && names.isArray())
        for (const Json::Value& n : names)
            if (n.isString() && n.asString() == "beaconState" && mezz.asBool())
                return errorReply(4, "Beacon is not supported on a mezzanine card");
    std::vector<std::string> changed;
    std::string err;
    if (!applyProps(*port, p.fc ? "fcPort" : "ethPort", req["port"], names, changed, err))
        return errorReply(3, err);
    if (contains(changed, "portStatus"))
        appendPortLog(*port, (*port)["portStatus"].asBool() ? "Port enabled" : "Port disabled");
    portChangeEvents(s, *port, p.fc != nullptr, changed);
    SIMLOG(SL_INFO, "port %s: %zu propert(ies) changed", p.addr.c_str(), changed.size());
    return okReply("Port updated");
}

JSON_ENTRY(getFcByFcWwn)
{
    PortRef p = findPort(s, firstOf(req, {"wwn", "portWwn", "indexStr"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    const Json::Value& port = *p.fc;
    Json::Value r = port["fcData"];
    r["portWwn"] = port["wwn"];
    copyIfAny(r, "nodeWwn", port);
    copyIfAny(r, "isFCoE", port);
    return r;
}

JSON_ENTRY(setFcByFcWwn)
{
    PortRef p = findPort(s, firstOf(req, {"portWwn", "wwn", "indexStr"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    std::vector<std::string> changed;
    std::string err;
    if (!applyProps((*p.fc)["fcData"], "fcData", req["fcPortData"], req["paramsConfigured"], changed, err))
        return errorReply(3, err);
    if (contains(changed, "maxFrameSize"))
        (*p.fc)["maxFrameSize"] = (*p.fc)["fcData"]["maxFrameSize"];
    return okReply("FC port settings updated");
}

JSON_ENTRY(getFcoeByPort)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn", "mac"}));
    if (!p.fc)
        return notFound("FCoE port", p.addr);
    const Json::Value& port = *p.fc;
    if (!port["isFCoE"].asBool())
        return errorReply(5, "Port " + p.addr + " is not an FCoE port");
    Json::Value r = port["fcoe"];
    r["portWwn"] = port["wwn"];
    copyIfAny(r, "nodeWwn", port);
    return r;
}

JSON_ENTRY(setFcoeByPort)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn", "mac"}));
    if (!p.fc)
        return notFound("FCoE port", p.addr);
    if (!ro(*p.fc)["isFCoE"].asBool())
        return errorReply(5, "Port " + p.addr + " is not an FCoE port");
    std::vector<std::string> changed;
    std::string err;
    if (!applyProps((*p.fc)["fcoe"], "fcoe", req["fcoePort"], req["propArray"], changed, err))
        return errorReply(3, err);
    return okReply("FCoE port settings updated");
}

JSON_ENTRY(getBootOverSanByPort)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    return (*p.fc)["bootOverSan"];
}

JSON_ENTRY(getAdvPortDataByPort)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    const Json::Value& port = *p.fc;
    Json::Value r = port["advData"];
    r["portWwn"] = port["wwn"];
    copyIfAny(r, "alias", port);
    r["trunkingEnabled"] = port["trunking"]["enabled"];
    r["dportEnabled"] = port["dport"]["enabled"];
    copyIfAny(r, "logs", port);
    return r;
}

JSON_ENTRY(setFcTrunkingState)
{
    std::string addr = firstOf(req, {"indexStr", "wwn"});
    if (!req.isMember("enableState") || !req["enableState"].isBool())
        return errorReply(3, "enableState must be a boolean");
    bool on = req["enableState"].asBool();
    PortRef p = findPort(s, addr);
    if (p.fc) {
        (*p.fc)["trunking"]["enabled"] = on;
        return okReply("Trunking state set");
    }
    // An adapter address sets trunking on all its FC ports.
    Json::Value* a = findAdapter(s, addr);
    if (!a)
        return notFound("port", addr);
    for (Json::Value& port : (*a)["fcPorts"])
        port["trunking"]["enabled"] = on;
    return okReply("Trunking state set");
}

JSON_ENTRY(clearLogsForPort)
{
    const Json::Value& ports = req["propArray"];
    if (!ports.isArray())
        return errorReply(3, "propArray must be an array of port addresses");
    std::vector<Json::Value*> found;
    for (const Json::Value& e : ports) {
        std::string addr = e.isString() ? e.asString() : str(e, "indexStr");
        PortRef p = findPort(s, addr);
        if (!p.fc)
            return notFound("FC port", addr);
        found.push_back(p.fc);
    }
    for (Json::Value* p : found)
        (*p)["logs"] = Json::Value(Json::arrayValue);
    Json::Value r = okReply("Port logs cleared");
    r["cleared"] = Json::UInt(found.size());
    return r;
}

// ---------------------------------------------------------------- optics

JSON_ENTRY(getOpticsSFP)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "portWwn", "wwn", "mac"}));
    Json::Value* port = p.fc ? p.fc : p.eth;
    if (!port)
        return notFound("port", p.addr);
    if (!ro(*port)["sfp"].isObject())
        return errorReply(6, "No SFP present on port " + p.addr);
    return replyOf(ro(*port)["sfp"]);
}

JSON_ENTRY(getOpticsPOM)
{
    PortRef p = findPort(s, firstOf(req, {"portWwn", "indexStr", "wwn", "mac"}));
    Json::Value* port = p.fc ? p.fc : p.eth;
    if (!port)
        return notFound("port", p.addr);
    if (!ro(*port)["sfp"].isObject())
        return errorReply(6, "No SFP present on port " + p.addr);
    // Readings wander a little around their nominal values.
    double t = now();
    Json::Value nominal = (*port).get("pom", Json::Value(Json::objectValue));
    struct { const char* name; double value; const char* unit; double swing; } items[] = {
        {"temperature", nominal.get("temperature", 41.5).asDouble(), "C", 1.5},
        {"voltage", nominal.get("voltage", 3.3).asDouble(), "V", 0.02},
        {"current", nominal.get("current", 7.4).asDouble(), "mA", 0.2},
        {"txPower", nominal.get("txPower", 560.0).asDouble(), "uW", 12.0},
        {"rxPower", nominal.get("rxPower", 480.0).asDouble(), "uW", 15.0}};
    Json::Value r(Json::objectValue);
    int i = 0;
    for (auto& it : items) {
        double v = it.value + it.swing * sin(t / 7.0 + i++);
        Json::Value e(Json::objectValue);
        e["value"] = double(long(v * 100)) / 100;
        e["unit"] = it.unit;
        e["status"] = nominal.get("level", "Normal").asString();
        r[it.name] = e;
    }
    r["pomLevel"] = nominal.get("level", "Normal");
    return r;
}

// ---------------------------------------------------------------- authentication

JSON_ENTRY(getPortAuthentication)
{
    PortRef p = findPort(s, firstOf(req, {"wwn", "pPortWwn", "indexStr"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    Json::Value r = (*p.fc)["auth"];
    r.removeMember("secret");   // never leaves the adapter
    r["status"] = r["authEnabled"].asBool() ? "Enabled" : "Disabled";
    return r;
}

JSON_ENTRY(setPortAuthentication)
{
    PortRef p = findPort(s, firstOf(req, {"pPortWwn", "wwn", "indexStr"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    const Json::Value& a = req["portAuth"];
    if (!a.isObject())
        return errorReply(3, "portAuth must be an object");
    Json::Value& auth = (*p.fc)["auth"];
    bool was = auth["authEnabled"].asBool();
    for (const std::string& m : a.getMemberNames()) {
        std::string why;
        if ((auth.isMember(m) && !sameType(auth[m], a[m])) || !checkMemberType("auth", m, a[m], why))
            return errorReply(3, "portAuth member " + m + " has the wrong type");
    }
    for (const std::string& m : a.getMemberNames())
        auth[m] = a[m];
    bool is = auth["authEnabled"].asBool();
    if (was != is)
        authEvent(s, *p.fc, is);
    return okReply("Port authentication set");
}

JSON_ENTRY(resetPortAuthentication)
{
    PortRef p = findPort(s, firstOf(req, {"pPortWwn", "wwn", "indexStr"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    bool was = (*p.fc)["auth"]["authEnabled"].asBool();
    Json::Value& auth = (*p.fc)["auth"];
    auth = Json::Value(Json::objectValue);
    auth["authEnabled"] = false;
    auth["algorithm"] = "MD5";
    auth["hashGroup"] = "DH-NULL";
    if (was)
        authEvent(s, *p.fc, false);
    return okReply("Port authentication reset");
}

// ---------------------------------------------------------------- virtual and remote ports

JSON_ENTRY(getAllVPorts)
{
    PortRef p = findPort(s, firstOf(req, {"wwn", "pPortWwn", "pwwn", "indexStr"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    Json::Value r(Json::arrayValue);
    for (const Json::Value& v : (*p.fc)["vports"]) {
        Json::Value e = v;
        e.removeMember("remotePorts");
        e["pPortWwn"] = (*p.fc)["wwn"];
        e["state"] = (*p.fc)["portStatus"].asBool() ? "Online" : "Offline";
        r.append(e);
    }
    return r;
}

JSON_ENTRY(getVPort)
{
    PortRef p = findPort(s, firstOf(req, {"pPortWwn", "pwwn", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    std::string vw = firstOf(req, {"lPortWwn", "vwwn"});
    Json::Value* v = findVport(s, p.place, vw);
    if (!v)
        return notFound("virtual port", vw);
    Json::Value r = *v;
    r.removeMember("remotePorts");
    r["pPortWwn"] = (*p.fc)["wwn"];
    r["state"] = (*p.fc)["portStatus"].asBool() ? "Online" : "Offline";
    r["numOfRemotePorts"] = Json::UInt((*v)["remotePorts"].size());
    return r;
}

JSON_ENTRY(createVport)
{
    PortRef p = findPort(s, firstOf(req, {"pwwn", "pPortWwn", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    if ((*p.fc)["vports"].size() >= 16)
        return errorReply(7, "No more virtual ports can be created on " + p.addr);
    std::string vw = str(req, "vwwn");
    if (vw.empty()) {
        // The adapter picks a free WWN of its own range.
        std::string base = (*p.fc)["wwn"].asString();
        for (int i = 1; i < 256 && vw.empty(); ++i) {
            char buf[16];
            snprintf(buf, sizeof(buf), "%02x", i);
            std::string cand = "2f:" + std::string(buf) + base.substr(5);
            if (!wwnTaken(s, cand))
                vw = cand;
        }
    } else if (vw.size() != 23 || vw[2] != ':') {
        return errorReply(3, "Invalid virtual port WWN: " + vw);
    } else if (wwnTaken(s, vw)) {
        return errorReply(8, "WWN already in use: " + vw);
    }
    Json::Value v(Json::objectValue);
    v["vwwn"] = vw;
    if (!str(req, "nwwn").empty())
        v["nodeWwn"] = req["nwwn"];
    else
        copyIfAny(v, "nodeWwn", ro(*p.fc));
    v["symbolicName"] = str(req, "symbolicName");
    v["vfId"] = req.get("vfId", 0).isInt() ? req.get("vfId", 0).asInt() : 0;
    v["remotePorts"] = Json::Value(Json::arrayValue);
    (*p.fc)["vports"].append(v);
    indexFcPort(s, p.place);
    Json::Value r = okReply("Virtual port created");
    r["vwwn"] = vw;
    return r;
}

JSON_ENTRY(deleteVport)
{
    PortRef p = findPort(s, firstOf(req, {"pwwn", "pPortWwn", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    const Json::Value& list = req["vportArray"];
    if (!list.isArray() || list.empty())
        return errorReply(3, "vportArray must name at least one virtual port");
    std::vector<std::string> names;
    for (const Json::Value& e : list) {
        std::string vw = e.isString() ? e.asString() : str(e, "vwwn");
        if (!findVport(s, p.place, vw))
            return notFound("virtual port", vw);
        names.push_back(addrKey(vw));
    }
    Json::Value kept(Json::arrayValue);
    for (const Json::Value& v : ro(*p.fc)["vports"]) {
        bool gone = false;
        for (const auto& n : names)
            gone = gone || n == addrKey(str(v, "vwwn"));
        if (!gone)
            kept.append(v);
    }
    (*p.fc)["vports"] = kept;
    indexFcPort(s, p.place);
    return okReply("Virtual port(s) deleted");
}

// The logical port a request names: the physical port itself, or one of its
// virtual ports.
static Json::Value* logicalPort(State& s, const PortRef& p, const std::string& lwwn)
{
    if (lwwn.empty() || addrKey(lwwn) == addrKey(str(*p.fc, "wwn")))
        return p.fc;
    return findVport(s, p.place, lwwn);
}

static Json::UInt countVisibleLuns(const Json::Value& port, const Json::Value& rport)
{
    const Json::Value& list = rport["lunList"];
    if (!port["lunMask"]["enabled"].asBool())
        return list.size();
    std::string rw = str(rport, "remotePortWwn");
    Json::UInt n = 0;
    for (const Json::Value& l : list)
        n += lunVisible(port, rw, l["number"]);
    return n;
}

static Json::Value visibleLuns(const Json::Value& port, const Json::Value& rport)
{
    Json::Value luns(Json::arrayValue);
    std::string rw = str(rport, "remotePortWwn");
    for (const Json::Value& l : rport["lunList"])
        if (lunVisible(port, rw, l["number"]))
            luns.append(replyOf(l));
    return luns;
}

JSON_ENTRY(getAllRemotePorts)
{
    PortRef p = findPort(s, firstOf(req, {"pPortWwn", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    const Json::Value* owner = logicalPort(s, p, str(req, "lPortWwn"));
    if (!owner)
        return notFound("logical port", str(req, "lPortWwn"));
    Json::Value r(Json::arrayValue);
    for (const Json::Value& rp : (*owner)["remotePorts"]) {
        Json::Value e = rp;
        e.removeMember("lunList");
        e.removeMember("unchecked");
        e["numOfLuns"] = countVisibleLuns(*p.fc, rp);
        copyIfAny(e, "isTarget", rp["deviceData"]);
        overlayUnchecked(e, rp);
        r.append(e);
    }
    return r;
}

JSON_ENTRY(getCompleteRemotePort)
{
    PortRef p = findPort(s, firstOf(req, {"pPortWwn", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    std::string rw = str(req, "rPortWwn");
    const Json::Value* rp = findRemotePort(s, p.place, str(req, "lPortWwn"), rw);
    if (!rp)
        return notFound("remote port", rw);
    Json::Value r = *rp;
    r.removeMember("unchecked");
    if (rp->isMember("lunList"))
        r["lunList"] = visibleLuns(*p.fc, *rp);
    r["pPortWwn"] = ro(*p.fc)["wwn"];
    overlayUnchecked(r, *rp);
    return r;
}

JSON_ENTRY(getAllLunsByRemotePort)
{
    PortRef p = findPort(s, firstOf(req, {"pPortWwn", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    std::string rw = str(req, "rPortWwn");
    const Json::Value* rp = findRemotePort(s, p.place, str(req, "lPortWwn"), rw);
    if (!rp)
        return notFound("remote port", rw);
    return visibleLuns(*p.fc, *rp);
}

// ---------------------------------------------------------------- LUN masking

JSON_ENTRY(getLunMaskData)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    Json::Value r(Json::objectValue);
    r["lunMaskEnabled"] = (*p.fc)["lunMask"]["enabled"];
    r["lunMaskData"] = (*p.fc)["lunMask"]["entries"];
    return r;
}

JSON_ENTRY(setLunMaskData)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    const Json::Value& added = req["addedLunMaskData"];
    const Json::Value& removed = req["removedLunMaskData"];
    for (const Json::Value* list : {&added, &removed}) {
        if (!list->isNull() && !list->isArray())
            return errorReply(3, "LUN mask lists must be arrays");
        for (const Json::Value& e : *list)
            if (str(e, "rPortWwn").empty() || !e.isMember("lunId"))
                return errorReply(3, "a LUN mask entry needs rPortWwn and lunId");
    }
    Json::Value& m = (*p.fc)["lunMask"];
    auto key = [](const Json::Value& e) {
        return plainAddr(str(e, "rPortWwn")) + "/" + (e["lunId"].isString() ? e["lunId"].asString() : std::to_string(e["lunId"].asUInt()));
    };
    if (req.get("clearLunMaskData", false).asBool()) {
        m["entries"] = Json::Value(Json::arrayValue);
        m["enabled"] = false;
    }
    Json::Value kept(Json::arrayValue);
    for (const Json::Value& e : m["entries"]) {
        bool gone = false;
        for (const Json::Value& r : removed)
            gone = gone || strcasecmp(key(r).c_str(), key(e).c_str()) == 0;
        if (!gone)
            kept.append(e);
    }
    for (const Json::Value& a : added) {
        bool dup = false;
        for (const Json::Value& e : kept)
            dup = dup || strcasecmp(key(a).c_str(), key(e).c_str()) == 0;
        if (!dup) {
            Json::Value e(Json::objectValue);
            e["rPortWwn"] = a["rPortWwn"];
            e["lunId"] = a["lunId"].isString() ? a["lunId"].asString() : std::to_string(a["lunId"].asUInt());
            kept.append(e);
        }
    }
    m["entries"] = kept;
    if (!added.empty())
        m["enabled"] = true;
    if (kept.empty() && !removed.empty())
        m["enabled"] = false;
    return okReply("LUN mask updated");
}

// ---------------------------------------------------------------- advanced I/O profiles

static bool inScope(const Json::Value& profile, const Json::Value& req)
{
    for (const char* m : {"lPortWwn", "rPortWwn", "lunId"}) {
        std::string want = str(req, m);
        if (want.empty())
            return true;
        std::string have = profile[m].isString() ? profile[m].asString()
                           : profile[m].isNumeric() ? std::to_string(profile[m].asUInt()) : std::string();
        if (strcasecmp(want.c_str(), have.c_str()) != 0)
            return false;
    }
    return true;
}

JSON_ENTRY(getAdvIoProfile)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    Json::Value r(Json::objectValue);
    r["portWwn"] = (*p.fc)["wwn"];
    r["advancedIoProfiles"] = (*p.fc)["ioProfiles"];
    return r;
}

JSON_ENTRY(setAdvIoProfile)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    const Json::Value& added = req["addedAdvancedIoProfiles"];
    const Json::Value& removed = req["removedAdvancedIoProfiles"];
    for (const Json::Value* l : {&added, &removed}) {
        if (!l->isNull() && !l->isArray())
            return errorReply(3, "profile lists must be arrays");
        for (const Json::Value& e : *l)
            if (!e.isObject())
                return errorReply(3, "a profile must be an object");
    }
    Json::Value& prof = (*p.fc)["ioProfiles"];
    Json::Value kept(Json::arrayValue);
    for (const Json::Value& e : prof) {
        bool gone = false;
        for (const Json::Value& r : removed)
            gone = gone || (inScope(e, r) && inScope(r, e));
        for (const Json::Value& a : added)   // a new profile of the same scope replaces the old
            gone = gone || (inScope(e, a) && inScope(a, e));
        if (!gone)
            kept.append(e);
    }
    for (const Json::Value& a : added)
        kept.append(a);
    prof = kept;
    return okReply("Advanced I/O profiles updated");
}

JSON_ENTRY(clearAdvIoProfile)
{
    PortRef p = findPort(s, firstOf(req, {"indexStr", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    Json::Value kept(Json::arrayValue);
    unsigned cleared = 0;
    for (const Json::Value& e : (*p.fc)["ioProfiles"]) {
        if (inScope(e, req))
            ++cleared;
        else
            kept.append(e);
    }
    (*p.fc)["ioProfiles"] = kept;
    Json::Value r = okReply("Advanced I/O profiles cleared");
    r["cleared"] = cleared;
    return r;
}

JSON_ENTRY(resetDataForAdvIoProf)
{
    std::string port = firstOf(req, {"indexStr", "pPortWwn", "wwn"});
    std::string end = str(req, "endLunRange");
    if (!end.empty()) {
        // A range of LUNs: each LUN's data from lunId to endLunRange.
        int from = atoi(str(req, "lunId").c_str()), to = atoi(end.c_str());
        if (to < from)
            return errorReply(3, "endLunRange is below lunId");
        PortRef p = findPort(s, port);
        if (!p.fc)
            return notFound("FC port", port);
        for (int l = from; l <= to; ++l) {
            Json::Value sub = req;
            sub["lunId"] = std::to_string(l);
            resetCounters(s, "advio|" + plainAddr(port) + "|" + scopeKey(sub));
        }
        return okReply("Advanced I/O data reset");
    }
    std::string scope = scopeKey(req);
    return resetOf(s, "advio", port, scope);
}

// ---------------------------------------------------------------- Ethernet

JSON_ENTRY(getEthPortByEthMac)
{
    PortRef p = findPort(s, firstOf(req, {"mac", "indexStr"}));
    if (!p.eth)
        return notFound("Ethernet port", p.addr);
    Json::Value r(Json::objectValue);
    r["ethData"] = ethPortReply(*p.adapter, *p.eth);
    return r;
}

JSON_ENTRY(getAllEthPortByEthMac)
{
    std::string mac = firstOf(req, {"mac", "indexStr"});
    Json::Value* a = findAdapter(s, mac);
    if (!a) {
        PortRef p = findPort(s, mac);
        a = p.eth ? p.adapter : nullptr;
    }
    if (!a)
        return notFound("Ethernet adapter or port", mac);
    Json::Value r(Json::arrayValue);
    for (const Json::Value& p : (*a)["ethPorts"]) {
        Json::Value e(Json::objectValue);
        e["ethData"] = ethPortReply(*a, p);
        r.append(e);
    }
    return r;
}

JSON_ENTRY(setEthPort)
{
    PortRef p = findPort(s, firstOf(req, {"mac", "indexStr"}));
    if (!p.eth)
        return notFound("Ethernet port", p.addr);
    std::vector<std::string> changed;
    std::string err;
    const Json::Value& v = req["ethPort"];
    if (v.isObject() && v.isMember("mtu") && v["mtu"].isNumeric()
        && (v["mtu"].asInt() < 576 || v["mtu"].asInt() > 9600))
        return errorReply(3, "mtu out of range 576..9600");
    if (!applyProps(*p.eth, "ethPort", v, req["propArray"], changed, err))
        return errorReply(3, err);
    portChangeEvents(s, *p.eth, false, changed);
    return okReply("Ethernet port updated");
}

static Json::Value ethObject(State& s, const Json::Value& req, const char* member, const char* what)
{
    PortRef p = findPort(s, firstOf(req, {"mac", "indexStr"}));
    if (!p.eth)
        return notFound("Ethernet port", p.addr);
    if (!ro(*p.eth)[member].isObject())
        return errorReply(9, std::string(what) + " is not available on port " + p.addr);
    return ro(*p.eth)[member];
}

#ifndef DTRUJ_WITHOUT_GETLLDP
JSON_ENTRY(getLldp) { return ethObject(s, req, "lldp", "LLDP"); }
#endif
JSON_ENTRY(getCee) { return ethObject(s, req, "cee", "CEE"); }

// vNICs: bandwidth in percent of the port; the guaranteed minimums of all
// vNICs of a port can't exceed the whole.
static bool bandwidthOk(const Json::Value& vnics, std::string& err)
{
    int sum = 0;
    for (const Json::Value& v : vnics) {
        int mn = v["minBandwidth"].asInt(), mx = v["maxBandwidth"].asInt();
        if (mn < 0 || mx < 1 || mx > 100 || mn > mx) {
            err = "bandwidth must satisfy 0 <= min <= max <= 100";
            return false;
        }
        sum += mn;
    }
    if (sum > 100) {
        err = "the minimum bandwidths add up to more than 100";
        return false;
    }
    return true;
}

JSON_ENTRY(createvNIC)
{
    PortRef p = findPort(s, firstOf(req, {"mac", "indexStr"}));
    if (!p.eth)
        return notFound("Ethernet port", p.addr);
    Json::Value& vnics = (*p.eth)["vnics"];
    if (vnics.size() >= 8)
        return errorReply(7, "No more vNICs can be created on " + p.addr);
    int idx = 0;
    for (const Json::Value& v : vnics)
        idx = std::max(idx, v["pciFunctionIndex"].asInt() + 1);
    Json::Value v(Json::objectValue);
    v["pciFunctionIndex"] = idx;
    v["mac"] = colonMacPlus((*p.eth)["mac"].asString(), 0x10 * idx);
    v["minBandwidth"] = req.get("minBandwidth", 0).isNumeric() ? req.get("minBandwidth", 0).asInt() : -1;
    v["maxBandwidth"] = req.get("maxBandwidth", 100).isNumeric() ? req.get("maxBandwidth", 100).asInt() : -1;
    Json::Value all = vnics;
    all.append(v);
    std::string err;
    if (!bandwidthOk(all, err))
        return errorReply(3, err);
    vnics = all;
    Json::Value r = okReply("vNIC created");
    r["pciFunctionIndex"] = idx;
    r["mac"] = v["mac"];
    return r;
}

JSON_ENTRY(deletevNICs)
{
    PortRef p = findPort(s, firstOf(req, {"mac", "indexStr"}));
    if (!p.eth)
        return notFound("Ethernet port", p.addr);
    const Json::Value& list = req["pciFunctionIndices"];
    if (!list.isArray() || list.empty())
        return errorReply(3, "pciFunctionIndices must name at least one vNIC");
    std::vector<int> idx;
    for (const Json::Value& e : list) {
        int i = asIntLoose(e, -1);
        if (i == 0)
            return errorReply(3, "the base function of a port can't be deleted");
        bool found = false;
        for (const Json::Value& v : (*p.eth)["vnics"])
            found = found || v["pciFunctionIndex"].asInt() == i;
        if (!found)
            return errorReply(2, "No such vNIC: " + std::to_string(i));
        idx.push_back(i);
    }
    Json::Value kept(Json::arrayValue);
    for (const Json::Value& v : (*p.eth)["vnics"]) {
        bool gone = false;
        for (int i : idx)
            gone = gone || v["pciFunctionIndex"].asInt() == i;
        if (!gone)
            kept.append(v);
    }
    (*p.eth)["vnics"] = kept;
    return okReply("vNIC(s) deleted");
}

JSON_ENTRY(modifyvNIC)
{
    PortRef p = findPort(s, firstOf(req, {"mac", "indexStr"}));
    if (!p.eth)
        return notFound("Ethernet port", p.addr);
    const Json::Value& list = req["vNICs"];
    if (!list.isArray() || list.empty())
        return errorReply(3, "vNICs must hold at least one vNIC");
    Json::Value all = (*p.eth)["vnics"];
    for (const Json::Value& e : list) {
        if (!e.isObject())
            return errorReply(3, "a vNIC must be an object");
        int i = asIntLoose(e["pciFunctionIndex"], -1);
        bool found = false;
        for (Json::Value& v : all)
            if (v["pciFunctionIndex"].asInt() == i) {
                found = true;
                for (const char* m : {"minBandwidth", "maxBandwidth"})
                    if (e.isMember(m))
                        v[m] = e[m].isNumeric() ? e[m].asInt() : -1;
            }
        if (!found)
            return errorReply(2, "No such vNIC: " + std::to_string(i));
    }
    std::string err;
    if (!bandwidthOk(all, err))
        return errorReply(3, err);
    (*p.eth)["vnics"] = all;
    return okReply("vNIC(s) modified");
}

// ---------------------------------------------------------------- statistics

JSON_ENTRY(getPortStatistics)
{
    return statsOf(s, "port", firstOf(req, {"indexStr", "wwn"}), "", portStatNames);
}

JSON_ENTRY(getDynamicPortStatistics)
{
    std::string addr = firstOf(req, {"indexStr", "wwn"});
    PortRef p = findPort(s, addr);
    if (!p.fc)
        return notFound("FC port", addr);
    bool fcoe = ro(*p.fc)["isFCoE"].asBool();
    std::string key = "port|" + plainAddr(ro(*p.fc)["wwn"].asString());
    Json::Value r(Json::arrayValue);
    for (const StatId* e = fcoe ? fcoeStatIds : fcStatIds; e->name; ++e) {
        Json::Value el(Json::objectValue);
        el["id"] = e->id;
        el["name"] = e->name;
        el["value"] = std::to_string(counterValue(s, key, e->name));
        r.append(el);
    }
    return r;
}

JSON_ENTRY(getDynamicQosStatistics) { return statsOf(s, "qos", str(req, "pPortWwn"), "", qosNames); }
JSON_ENTRY(getDynamicRPortStatistics)
{
    return statsOf(s, "rport", str(req, "pPortWwn"), scopeKey(req), rportNames);
}
JSON_ENTRY(getDynamicVPortStatistics)
{
    return statsOf(s, "vport", str(req, "pPortWwn"), plainAddr(str(req, "lPortWwn")), lportNames);
}
JSON_ENTRY(getDynamicLogicalPortStatistics)
{
    return statsOf(s, "lport", str(req, "pPortWwn"), plainAddr(str(req, "lPortWwn")), lportNames);
}
JSON_ENTRY(getDynamicPortAuthStatistics) { return statsOf(s, "auth", str(req, "pPortWwn"), "", authNames); }
JSON_ENTRY(getDynamicTrunkingStatistics) { return statsOf(s, "trunk", str(req, "indexStr"), "", trunkNames); }
JSON_ENTRY(getDynamicvHBAStatistics) { return statsOf(s, "vhba", str(req, "wwn"), "", vhbaNames); }
JSON_ENTRY(getDynamicvNICStatistics) { return statsOf(s, "vnic", str(req, "mac"), "", vnicNames, true); }
JSON_ENTRY(getDynamicvNICStatisticsForGraph)
{
    Json::Value r = statsOf(s, "vnic", str(req, "mac"), "", vnicNames, true);
    if (r.isMember("error"))
        return r;
    // The graph wants one sample per vNIC of the port.
    PortRef p = findPort(s, str(req, "mac"));
    Json::Value out(Json::objectValue);
    out["timestamp"] = Json::UInt64(now());
    out["samples"] = Json::Value(Json::arrayValue);
    if (p.eth)
        for (const Json::Value& v : (*p.eth)["vnics"]) {
            Json::Value e = counters(s, "vnic|" + plainAddr(str(req, "mac")) + "|" + v["pciFunctionIndex"].asString(), vnicNames);
            e["pciFunctionIndex"] = v["pciFunctionIndex"];
            out["samples"].append(e);
        }
    return out;
}
JSON_ENTRY(getDynamicLldpStatistics) { return statsOf(s, "lldp", str(req, "mac"), "", lldpNames, true); }
JSON_ENTRY(getDynamicAdvancedIoDataAtPPort) { return statsOf(s, "advio", str(req, "pPortWwn"), "", advIoNames); }
JSON_ENTRY(getDynamicAdvancedIoDataAtLPort)
{
    return statsOf(s, "advio", str(req, "pPortWwn"), scopeKey(req), advIoNames);
}
JSON_ENTRY(getDynamicAdvancedIoDataAtRPort)
{
    return statsOf(s, "advio", str(req, "pPortWwn"), scopeKey(req), advIoNames);
}
JSON_ENTRY(getDynamicAdvancedIoDataAtLun)
{
    return statsOf(s, "advio", str(req, "pPortWwn"), scopeKey(req), advIoNames);
}
JSON_ENTRY(getDynamicFcoeStatistics) { return statsOf(s, "fcoe", str(req, "indexStr"), "", fcoeNames); }
JSON_ENTRY(getDynamicFcpimModStatistics) { return statsOf(s, "fcpimmod", str(req, "indexStr"), "", fcpimModNames); }
JSON_ENTRY(getDynamicEthernetPortStatistics) { return statsOf(s, "eth", str(req, "mac"), "", ethNames, true); }
JSON_ENTRY(getDynamicIOCEthernetStatistics) { return statsOf(s, "ioceth", str(req, "mac"), "", iocEthNames, true); }
JSON_ENTRY(getDynamicFcpimIopStatistics)
{
    return statsOf(s, "fcpim", str(req, "pPortWwn"), scopeKey(req), iopNames);
}
JSON_ENTRY(getDynamicFcpimStatistics)
{
    return statsOf(s, "fcpim", str(req, "pPortWwn"), scopeKey(req), fcpimNames);
}
JSON_ENTRY(getDynamicFabricStatistics) { return statsOf(s, "fabric", str(req, "wwn"), "", fabricNames); }
JSON_ENTRY(getDynamicIocStatistics) { return statsOf(s, "ioc", str(req, "pwwn"), "", iocNames); }
JSON_ENTRY(getDynamicFirmwareStatistics) { return statsOf(s, "fw", str(req, "indexStr"), "", fwNames); }

JSON_ENTRY(resetStatisticsForPort) { return resetOf(s, "port", str(req, "indexStr")); }
JSON_ENTRY(resetStatisticsForPortAuth) { return resetOf(s, "auth", str(req, "wwn")); }
JSON_ENTRY(resetStatisticsForLPort) { return resetOf(s, "lport", str(req, "pwwn"), plainAddr(str(req, "lwwn"))); }
JSON_ENTRY(resetStatisticsForVPort) { return resetOf(s, "vport", str(req, "pwwn"), plainAddr(str(req, "vwwn"))); }
JSON_ENTRY(resetStatisticsForRPort) { return resetOf(s, "rport", str(req, "pPortWwn"), scopeKey(req)); }
JSON_ENTRY(resetStatisticsForFcpim) { return resetOf(s, "fcpim", str(req, "pPortWwn"), scopeKey(req)); }
JSON_ENTRY(resetStatisticsForIoc) { return resetOf(s, "ioc", str(req, "pwwn")); }
JSON_ENTRY(resetStatisticsForFabric) { return resetOf(s, "fabric", str(req, "pwwn")); }
JSON_ENTRY(resetStatisticsForQos) { return resetOf(s, "qos", str(req, "pPortWwn")); }
JSON_ENTRY(resetFirmwareStatistics) { return resetOf(s, "fw", str(req, "indexStr")); }
JSON_ENTRY(resetTrunkingStatistics) { return resetOf(s, "trunk", str(req, "indexStr")); }
JSON_ENTRY(resetLldpStatistics) { return resetOf(s, "lldp", str(req, "mac")); }
JSON_ENTRY(resetIOCEthernetStatistics) { return resetOf(s, "ioceth", str(req, "mac")); }
JSON_ENTRY(resetEthernetPortStatistics) { return resetOf(s, "eth", str(req, "mac")); }
JSON_ENTRY(resetvNICStatistics) { return resetOf(s, "vnic", str(req, "mac")); }
JSON_ENTRY(resetvHBAStatistics) { return resetOf(s, "vhba", str(req, "wwn")); }
JSON_ENTRY(resetFcoeStatistics) { return resetOf(s, "fcoe", str(req, "indexStr")); }
JSON_ENTRY(resetStatisticsForFcpimMod) { return resetOf(s, "fcpimmod", str(req, "indexStr")); }

// ---------------------------------------------------------------- posted diagnostics

static const char* const postedFunctions[] = {
    "QuickTest", "MemoryTest", "QueueTest", "LEDTest", "PCILoopbackTest", "DPortTest",
    "LoopbackTest", "EthLoopbackTest", "EchoTest", "FCPingTest", "FCTraceTest", nullptr};

JSON_ENTRY(postDiagnostics)
{
    std::string id = str(req, "requestID");
    if (!knownRequestId(s, id))
        return errorReply(10, "Unknown request ID: " + id);
    std::string fn = str(req, "function");
    bool known = false;
    for (const char* const* f = postedFunctions; *f; ++f)
        known = known || fn == *f;
    if (!known)
        return errorReply(11, "Unknown test function: " + fn);
    // A test of an adapter or port that isn't there is refused at once.
    std::string hba = str(req, "hbaWwn"), port = str(req, "portWwn");
    if (!hba.empty() && !findAdapter(s, hba))
        return notFound("adapter", hba);
    if (!port.empty() && !findPort(s, port).fc && !findPort(s, port).eth)
        return notFound("port", port);
    DiagRun& run = s.runs[id];
    if (run.started)
        return errorReply(12, "Tests of request " + id + " have already started");
    run.tests.push_back(req);
    Json::Value r = okReply("Test queued");
    r["requestID"] = id;
    r["position"] = Json::UInt(run.tests.size());
    return r;
}

JSON_ENTRY(startTests)
{
    std::string id = str(req, "requestID");
    auto it = s.runs.find(id);
    if (it == s.runs.end() || it->second.tests.empty())
        return errorReply(10, "No tests posted for request ID: " + id);
    if (it->second.started)
        return errorReply(12, "Tests of request " + id + " have already started");
    it->second.started = true;
    it->second.stopOnError = req.get("stopOnError", false).asBool();
    it->second.startTime = now();
    Json::Value r = okReply("Tests started");
    r["requestID"] = id;
    return r;
}

JSON_ENTRY(cancelTests)
{
    std::string id = str(req, "requestID");
    auto it = s.runs.find(id);
    if (it == s.runs.end())
        return errorReply(10, "No tests posted for request ID: " + id);
    if (!it->second.cancelled) {
        it->second.cancelled = true;
        it->second.cancelTime = it->second.started ? now() : 0;
        if (!it->second.started) {
            it->second.started = true;
            it->second.startTime = 0;
        }
    }
    Json::Value r = okReply("Tests cancelled");
    r["requestID"] = id;
    return r;
}

JSON_ENTRY(getDiagnosticsResults)
{
    std::string id = str(req, "requestID");
    auto it = s.runs.find(id);
    if (it == s.runs.end())
        return errorReply(10, "No tests posted for request ID: " + id);
    return runResults(s, id, it->second);
}

JSON_ENTRY(setDport)
{
    PortRef p = findPort(s, firstOf(req, {"portWwn", "indexStr", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    if (!req.isMember("state") || !req["state"].isBool())
        return errorReply(3, "state must be a boolean");
    bool on = req["state"].asBool();
    if (on && ro(*p.fc)["isFCoE"].asBool())
        return errorReply(5, "D-Port mode is not supported on an FCoE port");
    (*p.fc)["dport"]["enabled"] = on;
    (*p.fc)["dport"]["enabledAt"] = now();
    return okReply(on ? "D-Port mode enabled" : "D-Port mode disabled");
}

JSON_ENTRY(getDPortTestResult)
{
    PortRef p = findPort(s, firstOf(req, {"portWwn", "indexStr", "wwn"}));
    if (!p.fc)
        return notFound("FC port", p.addr);
    const Json::Value& d = (*p.fc)["dport"];
    if (!d["enabled"].asBool())
        return errorReply(13, "D-Port mode is not enabled on " + p.addr);
    Json::Value r(Json::objectValue);
    r["portWwn"] = (*p.fc)["wwn"];
    Json::Value cfg = testConfig(s, "dport", p.fc);
    bool done = now() - d["enabledAt"].asDouble() >= cfg.get("durationMs", 300).asDouble() / 1000.0;
    r["status"] = done ? cfg.get("status", "Passed") : Json::Value("InProgress");
    r["roundTripLatencyNs"] = cfg.get("roundTripLatencyNs", 1120);
    r["cableLengthMeters"] = cfg.get("cableLengthMeters", 5);
    r["electricalLoopback"] = done ? "Passed" : "InProgress";
    r["opticalLoopback"] = done ? "Passed" : "InProgress";
    return r;
}

// ---------------------------------------------------------------- direct diagnostics
//
// These take their configured time outside the host lock, as a real test
// keeps the adapter busy but not the library.

namespace {

Json::Value runDirect(const char* entry, const Json::Value& req,
                      Json::Value (*prepare)(State&, const Json::Value&, int&))
{
    recordCall(entry, req);
    Json::Value reply;
    if (applyFault(entry, reply) || echoReply(entry, req, reply))
        return reply;
    State& s = state();
    int delay = 0;
    {
        std::lock_guard<std::mutex> g(s.mtx);
        if (!s.initialised)
            return errorReply(1, std::string(entry) + ": the adapter library is not initialised");
        if (!req.isNull() && !req.isObject())
            return errorReply(3, std::string(entry) + ": the request is not a JSON object");
        try {
            reply = prepare(s, req, delay);
        } catch (const Json::Exception& e) {
            return errorReply(3, std::string(entry) + ": malformed value: " + e.what());
        }
    }
    sleepMs(delay);
    return reply;
}

Json::Value loopbackResult(const Json::Value& cfg, const Json::Value& req, bool offlineViolation)
{
    Json::Value r(Json::objectValue);
    unsigned frames = req.get("frameCount", 0).isNumeric() ? req["frameCount"].asUInt() : 0;
    bool failed = offlineViolation || cfg.get("failed", false).asBool();
    unsigned bad = failed ? cfg.get("badFrames", frames / 64).asUInt() : 0;
    r["failed"] = failed;
    r["transmitFrames"] = frames;
    r["GoodFrameRcv"] = frames - std::min(bad, frames);
    r["outstandingFrames"] = failed ? cfg.get("outstandingFrames", 3).asUInt() : 0u;
    r["BadFrameNo"] = failed ? cfg.get("BadFrameNo", 0).asUInt() : 0u;
    r["BadFrameInfo"] = failed ? cfg.get("BadFrameInfo", 0).asUInt() : 0u;
    r["output"] = offlineViolation ? "Port is online; disable it before a loopback test"
                                   : cfg.get("output", "").asString();
    return r;
}

Json::Value prepLoopback(State& s, const Json::Value& req, int& delay)
{
    PortRef p = findPort(s, str(req, "portWwn"));
    if (!p.fc)
        return notFound("FC port", p.addr);
    Json::Value cfg = testConfig(s, "loopback", p.fc);
    bool online = (*p.fc)["portStatus"].asBool() && (*p.adapter)["hbaData"]["hbaStatus"].asBool();
    bool violation = online && s.host["diagnostics"]["requireOffline"].asBool();
    delay = violation ? 0 : cfg["durationMs"].asInt();
    return loopbackResult(cfg, req, violation);
}

Json::Value prepEthLoopback(State& s, const Json::Value& req, int& delay)
{
    PortRef p = findPort(s, firstOf(req, {"portWwn", "mac"}));
    if (!p.eth)
        return notFound("Ethernet port", p.addr);
    Json::Value cfg = testConfig(s, "ethLoopback", p.eth);
    bool online = (*p.eth)["portStatus"].asBool() && (*p.adapter)["hbaData"]["hbaStatus"].asBool();
    bool violation = online && s.host["diagnostics"]["requireOffline"].asBool();
    delay = violation ? 0 : cfg["durationMs"].asInt();
    return loopbackResult(cfg, req, violation);
}

Json::Value prepPciLoopback(State& s, const Json::Value& req, int& delay)
{
    PortRef p = findPort(s, firstOf(req, {"portWwn", "mac"}));
    Json::Value* port = p.fc ? p.fc : p.eth;
    if (!port)
        return notFound("port", p.addr);
    Json::Value cfg = testConfig(s, "pciLoopback", port);
    delay = cfg["durationMs"].asInt();
    Json::Value r(Json::objectValue);
    r["failed"] = cfg["failed"].asBool();
    r["output"] = cfg["output"];
    return r;
}

Json::Value prepMemory(State& s, const Json::Value& req, int& delay)
{
    std::string addr = firstOf(req, {"hbaWwn", "wwn", "mac"});
    Json::Value* a = findAdapter(s, addr);
    if (!a)
        return notFound("adapter", addr);
    Json::Value cfg = s.host["diagnostics"]["memory"];
    const Json::Value& own = ro(*a)["diag"]["memory"];
    if (own.isObject())
        for (const std::string& m : own.getMemberNames())
            cfg[m] = own[m];
    bool violation = (*a)["hbaData"]["hbaStatus"].asBool() && s.host["diagnostics"]["requireOffline"].asBool();
    bool failed = violation || cfg["failed"].asBool();
    delay = violation ? 0 : cfg["durationMs"].asInt();
    Json::Value r(Json::objectValue);
    r["failed"] = failed;
    r["status"] = failed ? cfg.get("status", violation ? 16 : 1).asInt() : 0;
    r["address"] = failed ? cfg.get("address", 0x1000).asUInt() : 0u;
    r["expected value"] = failed ? cfg.get("expected value", 0xA5A5A5A5u).asUInt() : 0u;
    r["actual value"] = failed ? cfg.get("actual value", 0xA5A4A5A5u).asUInt() : 0u;
    r["error status"] = failed ? cfg.get("error status", 1).asUInt() : 0u;
    r["error address"] = failed ? cfg.get("error address", 0x1000).asUInt() : 0u;
    r["type"] = cfg.get("type", "March C").asString();
    r["output"] = violation ? "Adapter is enabled; disable it before the memory test" : cfg["output"].asString();
    return r;
}

} // namespace

DTRUJ_API Json::Value diagLoopbackTest(const Json::Value& req)
{
    return runDirect("diagLoopbackTest", req, prepLoopback);
}
DTRUJ_API Json::Value diagEthLoopbackTest(const Json::Value& req)
{
    return runDirect("diagEthLoopbackTest", req, prepEthLoopback);
}
DTRUJ_API Json::Value diagPCILoopbackTest(const Json::Value& req)
{
    return runDirect("diagPCILoopbackTest", req, prepPciLoopback);
}
DTRUJ_API Json::Value diagMemoryTest(const Json::Value& req)
{
    return runDirect("diagMemoryTest", req, prepMemory);
}

// ---------------------------------------------------------------- simulator controls

// Sets the fault of one entry: a kind ("null", "error", "hba", "std",
// "unknown", "delay:<ms>"), a JSON object text with "kind", "code",
// "message", "delayMs" and "count", or null / "" / "none" to clear it.
DTRUJ_API int dtruj_sim_set_fault(const char* entry, const char* kind)
{
    if (!entry || !*entry)
        return -1;
    State& s = state();
    std::lock_guard<std::mutex> g(s.mtx);
    if (!kind || !*kind || strcmp(kind, "none") == 0) {
        s.faults.erase(entry);
        return 0;
    }
    Json::Value v;
    if (kind[0] == '{') {
        Json::Reader reader;
        if (!reader.parse(kind, v, false))
            return -1;
    } else {
        v = kind;
    }
    Fault f;
    std::string err;
    if (!parseFault(v, f, err)) {
        SIMLOG(SL_WARN, "dtruj_sim_set_fault(%s): %s", entry, err.c_str());
        return -1;
    }
    s.faults[entry] = f;
    return 0;
}

// Reloads the host description and forgets faults, runs, resets and the
// calls it got. The library stays initialised if it was.
DTRUJ_API int dtruj_sim_reset()
{
    State& s = state();
    std::lock_guard<std::mutex> g(s.mtx);
    std::string err;
    s.loaded = false;
    if (!loadHost(s, err)) {
        SIMLOG(SL_ERROR, "%s", err.c_str());
        return -1;
    }
    s.lastRequestId = 0;
    resetEcho();
    clearCalls();
    return 0;
}

// The current state of the simulated host as a JSON text, for tests and
// for users who want to see what their setters did. The caller frees it.
DTRUJ_API char* dtruj_sim_counters(int reset)
{
    Json::Value all(Json::objectValue);
    for (EntryCounter* c = EntryCounter::head(); c; c = c->next) {
        uint64_t calls = reset ? c->calls.exchange(0) : c->calls.load();
        uint64_t ns = reset ? c->ns.exchange(0) : c->ns.load();
        if (!calls)
            continue;
        all[c->name]["calls"] = Json::UInt64(calls);
        all[c->name]["ns"] = Json::UInt64(ns);
    }
    Json::FastWriter w;
    return strdup(w.write(all).c_str());
}

DTRUJ_API char* dtruj_sim_dump()
{
    State& s = state();
    std::lock_guard<std::mutex> g(s.mtx);
    Json::StyledWriter w;
    return strdup(w.write(s.host).c_str());
}
