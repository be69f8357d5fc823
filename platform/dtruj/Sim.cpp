// The simulated host: loading its description, looking things up in it,
// counters, events and faults.
#include "Sim.h"

#include <cerrno>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <fstream>
#include <poll.h>
#include <sstream>
#include <strings.h>
#include <sys/stat.h>
#include <sys/time.h>
#include <unistd.h>

namespace OLMA {
namespace Sim {

State::~State()
{
    stopEvents(*this);
}

State& state()
{
    static State s;
    return s;
}

double now()
{
    struct timeval tv;
    gettimeofday(&tv, nullptr);
    return tv.tv_sec + tv.tv_usec / 1e6;
}

std::atomic<EventProcessCB>& eventCallback()
{
    static std::atomic<EventProcessCB> cb{nullptr};
    return cb;
}

std::atomic<LogMsgCB>& logCallback()
{
    static std::atomic<LogMsgCB> cb{nullptr};
    return cb;
}

void simLog(int level, const char* file, int line, const char* fmt, ...)
{
    LogMsgCB cb = logCallback().load();
    bool toStderr = getenv("DTRUJ_VERBOSE") != nullptr;
    if (!cb && !toStderr)
        return;
    char buf[1024];
    va_list ap;
    va_start(ap, fmt);
    vsnprintf(buf, sizeof(buf), fmt, ap);
    va_end(ap);
    const char* base = strrchr(file, '/');
    base = base ? base + 1 : file;
    if (cb)
        cb(level, base, line, buf);
    if (toStderr)
        fprintf(stderr, "dtruj[%d] %s:%d %s\n", level, base, line, buf);
}

Json::Value errorReply(int code, const std::string& message)
{
    Json::Value r(Json::objectValue);
    r["error"]["code"] = code;
    r["error"]["message"] = message;
    SIMLOG(SL_WARN, "reply error %d: %s", code, message.c_str());
    return r;
}

Json::Value okReply(const std::string& message)
{
    Json::Value r(Json::objectValue);
    r["status"] = 0;
    r["message"] = message;
    return r;
}

bool sameAddr(const std::string& a, const std::string& b)
{
    return !a.empty() && strcasecmp(a.c_str(), b.c_str()) == 0;
}

std::string plainAddr(const std::string& colon)
{
    std::string out;
    for (char c : colon)
        if (c != ':')
            out += c;
    return out;
}

// A member as text; anything that isn't a string reads as empty, so that a
// request of the wrong shape simply finds nothing.
std::string str(const Json::Value& v, const char* member)
{
    if (!v.isObject() || !v.isMember(member) || !v[member].isString())
        return std::string();
    return v[member].asString();
}

// ---------------------------------------------------------------- host

bool parseHost(const std::string& text, Json::Value& host, std::string& err)
{
    Json::Reader reader;
    Json::Value v;
    if (!reader.parse(text, v, false)) {
        err = reader.getFormattedErrorMessages();
        return false;
    }
    if (!v.isObject()) {
        err = "the host description is not a JSON object";
        return false;
    }
    if (v.isMember("adapters") && !v["adapters"].isArray()) {
        err = "\"adapters\" is not an array";
        return false;
    }
    const Json::Value& ads = v["adapters"];
    for (Json::ArrayIndex i = 0; i < ads.size(); ++i) {
        const Json::Value& a = ads[i];
        std::string where = "adapter " + std::to_string(i + 1);
        if (!a.isObject() || !a["hbaData"].isObject()) {
            err = where + " has no object \"hbaData\"";
            return false;
        }
        if (str(a["hbaData"], "wwn").empty() && str(a["hbaData"], "hbaMAC").empty()) {
            err = where + " has neither \"wwn\" nor \"hbaMAC\" in \"hbaData\"";
            return false;
        }
        for (const char* list : {"fcPorts", "ethPorts"}) {
            if (a.isMember(list) && !a[list].isArray()) {
                err = where + ": \"" + list + "\" is not an array";
                return false;
            }
            for (const Json::Value& p : a[list]) {
                const char* key = strcmp(list, "fcPorts") == 0 ? "wwn" : "mac";
                if (!p.isObject() || str(p, key).empty()) {
                    err = where + ": a member of \"" + list + "\" has no \"" + key + "\"";
                    return false;
                }
            }
        }
    }
    host = v;
    normaliseHost(host);
    return true;
}

static void def(Json::Value& obj, const char* member, const Json::Value& value)
{
    if (!obj.isMember(member))
        obj[member] = value;
}

// Fills what a hand-written description leaves out, so that every reply
// carries the members the module reads.
void normaliseHost(Json::Value& host)
{
    def(host, "host", Json::Value(Json::objectValue));
    def(host, "adapters", Json::Value(Json::arrayValue));
    def(host, "diagnostics", Json::Value(Json::objectValue));
    Json::Value& d = host["diagnostics"];
    def(d, "requireOffline", true);
    const char* tests[] = {"loopback", "ethLoopback", "pciLoopback", "memory"};
    for (const char* t : tests) {
        def(d, t, Json::Value(Json::objectValue));
        def(d[t], "durationMs", 100);
        def(d[t], "failed", false);
        def(d[t], "output", std::string(t) + " test passed");
    }
    def(d, "posted", Json::Value(Json::objectValue));

    for (Json::Value& a : host["adapters"]) {
        Json::Value& h = a["hbaData"];
        bool cna = h.isMember("hbaMAC");
        def(h, "wwn", "");
        def(h, "model", cna ? "Vespera-1860" : "Vespera-1020");
        def(h, "serialNumber", "");
        def(h, "oem", "VSPR");
        def(h, "partNum", "");
        def(h, "oemSerialNum", "");
        def(h, "uuid", "");
        def(h, "hbaStatus", true);
        def(h, "isMezz", false);
        def(h, "alias", "");
        def(h, "mode", cna ? "CNA" : "HBA");
        def(a, "driver", Json::Value(Json::objectValue));
        def(a, "firmware", Json::Value(Json::objectValue));
        def(a["firmware"], "version", "3.2.1.0");
        def(a["firmware"], "biosVersion", "3.2.1.0");
        def(a, "flash", Json::Value(Json::objectValue));
        def(a["flash"], "flashStatus", true);
        def(a, "fcPorts", Json::Value(Json::arrayValue));
        def(a, "ethPorts", Json::Value(Json::arrayValue));
        def(a, "advData", Json::Value(Json::objectValue));
        def(a["advData"], "pciLocation", h.get("pciLocation", "0000:00:00.0"));
        def(a["advData"], "pciGeneration", 2);
        def(a["advData"], "pciLanes", 8);
        def(a["advData"], "chipRevision", "Rev-C2");
        def(a["advData"], "temperatureC", 47);
        int n = 0;
        for (Json::Value& p : a["fcPorts"]) {
            def(p, "nodeWwn", h["wwn"]);
            def(p, "PortSymbolicName", h["model"].asString() + " port" + std::to_string(n));
            def(p, "operatingSpeed", 8);
            def(p, "supportedPortSpeeds", Json::Value(Json::arrayValue));
            if (p["supportedPortSpeeds"].empty())
                p["supportedPortSpeeds"].append(p["operatingSpeed"]);
            def(p, "portTypeMOFValue", 10);
            def(p, "maxFrameSize", 2112);
            def(p, "portStatusValue", 11);
            def(p, "isFCoE", false);
            def(p, "beaconState", false);
            def(p, "portStatus", true);
            def(p, "linkUp", true);
            def(p, "alias", "");
            def(p, "remotePorts", Json::Value(Json::arrayValue));
            def(p, "vports", Json::Value(Json::arrayValue));
            def(p, "lunMask", Json::Value(Json::objectValue));
            def(p["lunMask"], "enabled", false);
            def(p["lunMask"], "entries", Json::Value(Json::arrayValue));
            def(p, "ioProfiles", Json::Value(Json::arrayValue));
            def(p, "auth", Json::Value(Json::objectValue));
            def(p["auth"], "authEnabled", false);
            def(p["auth"], "algorithm", "MD5");
            def(p["auth"], "hashGroup", "DH-NULL");
            def(p, "trunking", Json::Value(Json::objectValue));
            def(p["trunking"], "enabled", false);
            def(p, "bootOverSan", Json::Value(Json::objectValue));
            def(p["bootOverSan"], "enabled", false);
            def(p["bootOverSan"], "bootLuns", Json::Value(Json::arrayValue));
            def(p, "fcData", Json::Value(Json::objectValue));
            def(p["fcData"], "topology", "P2P");
            def(p["fcData"], "configuredSpeed", "auto");
            def(p["fcData"], "maxFrameSize", p["maxFrameSize"]);
            def(p["fcData"], "bbCredit", 16);
            def(p["fcData"], "pathTov", 30);
            def(p["fcData"], "qosEnabled", false);
            def(p["fcData"], "targetRateLimit", false);
            def(p, "advData", Json::Value(Json::objectValue));
            def(p["advData"], "pid", "0x0" + std::to_string(10100 + n * 100));
            def(p["advData"], "fabricName", "10:00:00:05:33:00:00:01");
            def(p["advData"], "topology", "P2P");
            def(p["advData"], "bbCredit", 16);
            def(p, "dport", Json::Value(Json::objectValue));
            def(p["dport"], "enabled", false);
            def(p, "logs", Json::Value(Json::arrayValue));
            def(p, "diag", Json::Value(Json::objectValue));
            if (p["isFCoE"].asBool()) {
                def(p, "fcoe", Json::Value(Json::objectValue));
                def(p["fcoe"], "fcoeMac", p.get("fcoeMac", ""));
                def(p["fcoe"], "vlanId", 1002);
                def(p["fcoe"], "fipMode", "auto");
            }
            for (Json::Value& r : p["remotePorts"]) {
                def(r, "remoteNodeWwn", r.get("remotePortWwn", ""));
                def(r, "deviceData", Json::Value(Json::objectValue));
                def(r["deviceData"], "isTarget", true);
                def(r["deviceData"], "type", "Disk");
                def(r["deviceData"], "stateMofValue", 2);
                def(r, "lunList", Json::Value(Json::arrayValue));
            }
            for (Json::Value& v : p["vports"]) {
                def(v, "nodeWwn", p["nodeWwn"]);
                def(v, "symbolicName", "");
                def(v, "vfId", 0);
                def(v, "remotePorts", Json::Value(Json::arrayValue));
            }
            ++n;
        }
        int e = 0;
        for (Json::Value& p : a["ethPorts"]) {
            def(p, "ethDev", "eth" + std::to_string(e));
            def(p, "ethPortStateMOFValue", 11);
            def(p, "mtu", 1500);
            def(p, "portStatus", true);
            def(p, "linkUp", true);
            def(p, "alias", "");
            def(p, "operatingSpeed", 10);
            def(p, "vnics", Json::Value(Json::arrayValue));
            if (p["vnics"].empty()) {
                Json::Value v;
                v["pciFunctionIndex"] = 0;
                v["mac"] = p["mac"];
                v["minBandwidth"] = 0;
                v["maxBandwidth"] = 100;
                p["vnics"].append(v);
            }
            ++e;
        }
    }
}

static bool readFile(const std::string& path, std::string& text, std::string& err)
{
    std::ifstream in(path.c_str(), std::ios::binary);
    if (!in) {
        err = "cannot open " + path + ": " + strerror(errno);
        return false;
    }
    std::ostringstream ss;
    ss << in.rdbuf();
    text = ss.str();
    return true;
}

bool loadHost(State& s, std::string& err)
{
    const char* path = getenv("DTRUJ_HOST");
    std::string text;
    std::string source;
    if (path && *path) {
        if (!readFile(path, text, err))
            return false;
        source = path;
    } else {
        text = builtinHostText();
        source = "built-in default host";
    }
    Json::Value host;
    if (!parseHost(text, host, err)) {
        err = source + ": " + err;
        return false;
    }
    s.host = host;
    s.source = source;
    s.loaded = true;
    s.faults.clear();
    s.resets.clear();
    s.runs.clear();
    s.updateLog.clear();
    if (s.startTime == 0)
        s.startTime = now();
    for (const std::string& name : host["faults"].getMemberNames()) {
        Fault f;
        std::string ferr;
        if (parseFault(host["faults"][name], f, ferr))
            s.faults[name] = f;
        else
            SIMLOG(SL_WARN, "fault for %s ignored: %s", name.c_str(), ferr.c_str());
    }
    SIMLOG(SL_INFO, "host loaded from %s: %u adapter(s)", source.c_str(),
           host["adapters"].size());
    return true;
}

// ---------------------------------------------------------------- look-ups

bool adapterIsCNA(const Json::Value& adapter)
{
    return adapter["hbaData"].isMember("hbaMAC");
}

std::string adapterIndex(const Json::Value& adapter)
{
    const Json::Value& h = adapter["hbaData"];
    return adapterIsCNA(adapter) ? h["hbaMAC"].asString() : h["wwn"].asString();
}

Json::Value* findAdapter(State& s, const std::string& addr, int* id)
{
    Json::Value& ads = s.host["adapters"];
    for (Json::ArrayIndex i = 0; i < ads.size(); ++i) {
        const Json::Value& h = ads[i]["hbaData"];
        if (sameAddr(addr, str(h, "hbaMAC")) || sameAddr(addr, str(h, "wwn"))
            || sameAddr(addr, plainAddr(str(h, "hbaMAC"))) || sameAddr(addr, plainAddr(str(h, "wwn")))) {
            if (id)
                *id = int(i) + 1;
            return &ads[i];
        }
    }
    return nullptr;
}

Json::Value* findFcPort(State& s, const std::string& wwn, Json::Value** adapter)
{
    for (Json::Value& a : s.host["adapters"])
        for (Json::Value& p : a["fcPorts"])
            if (sameAddr(wwn, str(p, "wwn")) || sameAddr(wwn, str(p, "fcoeMac"))
                || sameAddr(wwn, plainAddr(str(p, "wwn")))) {
                if (adapter)
                    *adapter = &a;
                return &p;
            }
    return nullptr;
}

Json::Value* findEthPort(State& s, const std::string& mac, Json::Value** adapter)
{
    for (Json::Value& a : s.host["adapters"])
        for (Json::Value& p : a["ethPorts"])
            if (sameAddr(mac, str(p, "mac")) || sameAddr(mac, plainAddr(str(p, "mac")))) {
                if (adapter)
                    *adapter = &a;
                return &p;
            }
    return nullptr;
}

Json::Value* findVport(Json::Value& port, const std::string& vwwn)
{
    for (Json::Value& v : port["vports"])
        if (sameAddr(vwwn, str(v, "vwwn")))
            return &v;
    return nullptr;
}

// The remote ports seen through a logical port: the physical port itself or
// one of its virtual ports.
Json::Value* findRemotePort(Json::Value& port, const std::string& lwwn, const std::string& rwwn)
{
    Json::Value* owner = &port;
    if (!lwwn.empty() && !sameAddr(lwwn, str(port, "wwn"))) {
        owner = findVport(port, lwwn);
        if (!owner)
            return nullptr;
    }
    for (Json::Value& r : (*owner)["remotePorts"])
        if (sameAddr(rwwn, str(r, "remotePortWwn")))
            return &r;
    return nullptr;
}

// ---------------------------------------------------------------- replies

Json::Value hbaReply(State&, Json::Value& a, int id)
{
    Json::Value r(Json::objectValue);
    Json::Value h = a["hbaData"];
    h["portCount"] = Json::UInt(a["fcPorts"].size() + a["ethPorts"].size());
    h["numOfFcPorts"] = Json::UInt(a["fcPorts"].size());
    h["numOfEthPorts"] = Json::UInt(a["ethPorts"].size());
    h["isCNA"] = adapterIsCNA(a);
    h["hasEthPort"] = !a["ethPorts"].empty();
    h["adapterId"] = id;
    h["indexStr"] = adapterIndex(a);
    h["manufacturer"] = "VSPR";
    r["hbaData"] = h;
    r["driver"] = a["driver"];
    r["firmware"] = a["firmware"];
    return r;
}

// Sub-objects of a port that other entries answer; getPortByWwn leaves them out.
static const char* const portNested[] = {
    "sfp", "pom", "remotePorts", "vports", "auth", "bootOverSan", "advData", "fcoe",
    "lunMask", "ioProfiles", "dport", "fcData", "diag", "logs", "trunking", "lldp",
    "cee", "vnics", "linkUp", nullptr};

static Json::Value portCopy(const Json::Value& port)
{
    Json::Value r(Json::objectValue);
    for (const std::string& m : port.getMemberNames()) {
        bool nested = false;
        for (const char* const* n = portNested; *n; ++n)
            if (m == *n)
                nested = true;
        if (!nested)
            r[m] = port[m];
    }
    return r;
}

Json::Value fcPortReply(const Json::Value& a, const Json::Value& p)
{
    Json::Value r = portCopy(p);
    bool up = a["hbaData"]["hbaStatus"].asBool() && p["portStatus"].asBool();
    if (!up)
        r["portStatusValue"] = 10;
    else if (!p["linkUp"].asBool())
        r["portStatusValue"] = 13;
    // No speed is negotiated while the link is down.
    if (!up || !p["linkUp"].asBool())
        r["operatingSpeed"] = 99999;
    if (!r.isMember("isMezz"))
        r["isMezz"] = a["hbaData"]["isMezz"];
    r["hbaIndexStr"] = adapterIndex(a);
    r["trunkingEnabled"] = p["trunking"]["enabled"];
    r["numOfVports"] = Json::UInt(p["vports"].size());
    r["numOfRemotePorts"] = Json::UInt(p["remotePorts"].size());
    return r;
}

Json::Value ethPortReply(const Json::Value& a, const Json::Value& p)
{
    Json::Value r = portCopy(p);
    bool up = a["hbaData"]["hbaStatus"].asBool() && p["portStatus"].asBool();
    if (!up)
        r["ethPortStateMOFValue"] = 10;
    else if (!p["linkUp"].asBool())
        r["ethPortStateMOFValue"] = 13;
    if (!up || !p["linkUp"].asBool())
        r["operatingSpeed"] = 99999;
    r["isMezz"] = a["hbaData"]["isMezz"];
    r["hbaIndexStr"] = adapterIndex(a);
    r["numOfvNICs"] = Json::UInt(p["vnics"].size());
    return r;
}

bool lunVisible(const Json::Value& port, const std::string& rwwn, unsigned number)
{
    const Json::Value& m = port["lunMask"];
    if (!m["enabled"].asBool())
        return true;
    for (const Json::Value& e : m["entries"])
        if (sameAddr(rwwn, str(e, "rPortWwn")) && e["lunId"].asString() == std::to_string(number))
            return true;
    return false;
}

// ---------------------------------------------------------------- counters

static uint64_t hashOf(const std::string& s)
{
    uint64_t h = 1469598103934665603ULL;
    for (unsigned char c : s) {
        h ^= c;
        h *= 1099511628211ULL;
    }
    return h;
}

// Error counters grow slowly, traffic counters fast; both are deterministic
// in the key and the name, so two readings differ only by elapsed time.
uint64_t counterValue(State& s, const std::string& key, const std::string& name)
{
    double epoch = s.startTime - 3600;
    for (const auto& r : s.resets)
        if (key.compare(0, r.first.size(), r.first) == 0 && r.second > epoch)
            epoch = r.second;
    double elapsed = now() - epoch;
    if (elapsed < 0)
        elapsed = 0;
    uint64_t h = hashOf(key + "/" + name);
    std::string lower;
    for (char c : name)
        lower += char(tolower((unsigned char)c));
    double rate;
    if (lower.find("err") != std::string::npos || lower.find("fail") != std::string::npos
        || lower.find("loss") != std::string::npos || lower.find("crc") != std::string::npos
        || lower.find("invalid") != std::string::npos || lower.find("drop") != std::string::npos
        || lower.find("dump") != std::string::npos || lower.find("timeout") != std::string::npos)
        rate = (h % 5) / 100.0;
    else if (lower.find("word") != std::string::npos || lower.find("byte") != std::string::npos)
        rate = 500000.0 + double(h % 4000000);
    else
        rate = 1000.0 + double(h % 20000);
    return uint64_t(rate * elapsed);
}

Json::Value counters(State& s, const std::string& key, const char* const* names)
{
    Json::Value r(Json::objectValue);
    for (const char* const* n = names; *n; ++n)
        r[*n] = Json::UInt64(counterValue(s, key, *n));
    double epoch = s.startTime - 3600;
    for (const auto& rs : s.resets)
        if (key.compare(0, rs.first.size(), rs.first) == 0 && rs.second > epoch)
            epoch = rs.second;
    r["secondsSinceReset"] = Json::UInt64(now() - epoch);
    return r;
}

void resetCounters(State& s, const std::string& keyPrefix)
{
    s.resets[keyPrefix] = now();
}

// ---------------------------------------------------------------- events

void queueEvent(State& s, const std::string& json)
{
    std::lock_guard<std::mutex> g(s.evMtx);
    if (!s.evRegistered)
        return;
    s.evQueue.push_back(json);
    s.evCv.notify_one();
}

void portEvent(State& s, int category, int id, const std::string& portAddr,
               const char* idValue, int severity, const char* msg)
{
    Json::Value e(Json::objectValue);
    e["eventCategory"] = category;
    e["eventId"] = id;
    e["portIndexString"] = plainAddr(portAddr);
    e["basePortWWN"] = portAddr;
    e["eventIdValue"] = idValue;
    e["eventSeverity"] = severity;
    e["eventMsg"] = msg;
    e["timeStamp"] = Json::UInt64(now());
    Json::FastWriter w;
    std::string text = w.write(e);
    if (!text.empty() && text.back() == '\n')
        text.pop_back();
    queueEvent(s, text);
}

// Lines written by a user to the file or FIFO named by DTRUJ_EVENTS. A FIFO
// is also opened for writing by us, so that it never reads as ended while no
// writer is connected.
struct EventSource {
    int fd = -1;
    int keepWriter = -1;
    bool fifo = false;
    std::string partial;

    void open(const char* path, off_t offset)
    {
        struct stat st;
        if (stat(path, &st) != 0)
            return;
        fifo = S_ISFIFO(st.st_mode);
        fd = ::open(path, O_RDONLY | O_NONBLOCK | O_CLOEXEC);
        if (fd < 0)
            return;
        if (fifo)
            keepWriter = ::open(path, O_WRONLY | O_NONBLOCK | O_CLOEXEC);
        else
            lseek(fd, offset, SEEK_SET);
    }
    void close()
    {
        if (fd >= 0)
            ::close(fd);
        if (keepWriter >= 0)
            ::close(keepWriter);
        fd = keepWriter = -1;
    }
    // Reads what is there, returns complete lines.
    void readLines(std::vector<std::string>& lines, off_t& offset)
    {
        if (fd < 0)
            return;
        if (fifo) {
            struct pollfd p = {fd, POLLIN, 0};
            if (poll(&p, 1, 0) <= 0 || !(p.revents & POLLIN))
                return;
        }
        char buf[4096];
        ssize_t n;
        while ((n = ::read(fd, buf, sizeof(buf))) > 0) {
            if (!fifo)
                offset += n;
            partial.append(buf, size_t(n));
        }
        size_t pos;
        while ((pos = partial.find('\n')) != std::string::npos) {
            std::string line = partial.substr(0, pos);
            partial.erase(0, pos + 1);
            if (!line.empty() && line.back() == '\r')
                line.pop_back();
            if (line.find_first_not_of(" \t") != std::string::npos)
                lines.push_back(line);
        }
    }
};

static void eventThread(State* s, std::string path, unsigned generation)
{
    EventSource src;
    off_t offset;
    {
        std::lock_guard<std::mutex> g(s->evMtx);
        offset = s->evFileOffset;
    }
    if (!path.empty())
        src.open(path.c_str(), offset);
    for (;;) {
        std::vector<std::string> lines;
        src.readLines(lines, offset);
        std::deque<std::string> batch;
        {
            std::unique_lock<std::mutex> g(s->evMtx);
            if (s->evGeneration != generation)
                break;
            s->evFileOffset = offset;
            for (auto& l : lines)
                s->evQueue.push_back(l);
            if (s->evQueue.empty() && !s->evStop)
                s->evCv.wait_for(g, std::chrono::milliseconds(50));
            if (s->evStop || s->evGeneration != generation)
                break;
            batch.swap(s->evQueue);
        }
        // The callback runs without our locks: the module may call back
        // into the library from it.
        for (const std::string& e : batch) {
            EventProcessCB cb = eventCallback().load();
            if (cb)
                cb(e.c_str());
        }
    }
    src.close();
}

bool startEvents(State& s, bool dropOld)
{
    std::lock_guard<std::mutex> g(s.evMtx);
    if (dropOld)
        s.evQueue.clear();
    if (s.evRegistered)
        return true;
    s.evRegistered = true;
    s.evStop = false;
    ++s.evGeneration;
    const char* path = getenv("DTRUJ_EVENTS");
    s.evThread = std::thread(eventThread, &s, std::string(path ? path : ""), s.evGeneration);
    return true;
}

void stopEvents(State& s)
{
    std::thread t;
    {
        std::lock_guard<std::mutex> g(s.evMtx);
        if (!s.evRegistered)
            return;
        s.evRegistered = false;
        s.evStop = true;
        s.evQueue.clear();
        s.evCv.notify_all();
        t.swap(s.evThread);
    }
    if (!t.joinable())
        return;
    // Called from the event callback itself: the thread can't join itself,
    // so it is let go and ends at its next look at the stop flag.
    if (t.get_id() == std::this_thread::get_id())
        t.detach();
    else
        t.join();
}

// ---------------------------------------------------------------- faults

bool parseFault(const Json::Value& v, Fault& f, std::string& err)
{
    f = Fault();
    if (v.isString()) {
        f.kind = v.asString();
    } else if (v.isObject()) {
        f.kind = v.get("kind", "").asString();
        f.code = v.get("code", 1).asInt();
        f.message = v.get("message", "injected fault").asString();
        f.delayMs = v.get("delayMs", 0).asInt();
        f.remaining = v.get("count", -1).asInt();
    } else {
        err = "a fault is a kind text or an object";
        return false;
    }
    // "delay:250" is short for a delay of 250 ms.
    if (f.kind.compare(0, 6, "delay:") == 0) {
        f.delayMs = atoi(f.kind.c_str() + 6);
        f.kind = "delay";
    }
    static const char* const kinds[] = {"null", "error", "hba", "std", "unknown", "delay", nullptr};
    for (const char* const* k = kinds; *k; ++k)
        if (f.kind == *k)
            return true;
    err = "unknown fault kind \"" + f.kind + "\"";
    return false;
}

bool takeFault(State& s, const char* entry, Fault& f)
{
    auto it = s.faults.find(entry);
    if (it == s.faults.end())
        return false;
    f = it->second;
    if (it->second.remaining > 0 && --it->second.remaining == 0)
        s.faults.erase(it);
    return true;
}

} // namespace Sim
} // namespace OLMA
