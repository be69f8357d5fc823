// The simulated host: loading its description, looking things up in it,
// counters and faults. The events are in Events.cpp.
#include "Sim.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <sstream>
#include <strings.h>
#include <sys/time.h>

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

uint64_t& callbackNs()
{
    thread_local uint64_t spent = 0;
    return spent;
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
    if (cb) {
        auto start = std::chrono::steady_clock::now();
        cb(level, base, line, buf);
        callbackNs() += uint64_t(std::chrono::duration_cast<std::chrono::nanoseconds>(
            std::chrono::steady_clock::now() - start).count());
    }
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
    if (!checkHostTypes(v, err))
        return false;
    // What names the adapters and ports can't be left out.
    const Json::Value& ads = v["adapters"];
    for (Json::ArrayIndex i = 0; i < ads.size(); ++i) {
        const Json::Value& a = ads[i];
        std::string where = "adapters[" + std::to_string(i) + "]";
        if (!a.isMember("hbaData")) {
            err = where + ": has no object \"hbaData\"";
            return false;
        }
        if (str(a["hbaData"], "wwn").empty() && str(a["hbaData"], "hbaMAC").empty()) {
            err = where + ".hbaData: has neither \"wwn\" nor \"hbaMAC\"";
            return false;
        }
        for (const char* list : {"fcPorts", "ethPorts"}) {
            const char* key = strcmp(list, "fcPorts") == 0 ? "wwn" : "mac";
            for (Json::ArrayIndex j = 0; j < a[list].size(); ++j)
                if (str(a[list][j], key).empty()) {
                    err = where + "." + list + "[" + std::to_string(j) + "]: has no \"" + key + "\"";
                    return false;
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

// Fills in what the library always answers whatever a description says:
// states, and the parts that setters change or other entries answer from.
// Every other member a description leaves out stays out of the replies.
void normaliseHost(Json::Value& host)
{
    const Json::Value object(Json::objectValue);
    const Json::Value array(Json::arrayValue);
    def(host, "host", object);
    def(host, "adapters", array);
    def(host, "diagnostics", object);
    Json::Value& d = host["diagnostics"];
    def(d, "requireOffline", true);
    const char* tests[] = {"loopback", "ethLoopback", "pciLoopback", "memory"};
    for (const char* t : tests) {
        def(d, t, object);
        def(d[t], "durationMs", 100);
        def(d[t], "failed", false);
        def(d[t], "output", std::string(t) + " test passed");
    }
    def(d, "posted", object);

    for (Json::Value& a : host["adapters"]) {
        Json::Value& h = a["hbaData"];
        bool cna = h.isMember("hbaMAC");
        def(h, "hbaStatus", true);
        def(h, "mode", cna ? "CNA" : "HBA");
        def(a, "driver", object);
        def(a, "firmware", object);
        def(a, "flash", object);
        def(a["flash"], "flashStatus", true);
        def(a, "advData", object);
        if (h.isMember("pciLocation"))
            def(a["advData"], "pciLocation", h["pciLocation"]);
        def(a, "fcPorts", array);
        def(a, "ethPorts", array);
        for (Json::Value& p : a["fcPorts"]) {
            // A port's node is its adapter's unless it says otherwise.
            if (h.isMember("wwn"))
                def(p, "nodeWwn", h["wwn"]);
            def(p, "portStatusValue", 11);
            def(p, "portStatus", true);
            def(p, "linkUp", true);
            def(p, "remotePorts", array);
            def(p, "vports", array);
            def(p, "lunMask", object);
            def(p["lunMask"], "enabled", false);
            def(p["lunMask"], "entries", array);
            def(p, "ioProfiles", array);
            def(p, "auth", object);
            def(p["auth"], "authEnabled", false);
            def(p, "trunking", object);
            def(p["trunking"], "enabled", false);
            def(p, "bootOverSan", object);
            def(p["bootOverSan"], "enabled", false);
            def(p, "fcData", object);
            if (p.isMember("maxFrameSize"))
                def(p["fcData"], "maxFrameSize", p["maxFrameSize"]);
            def(p, "advData", object);
            def(p, "dport", object);
            def(p["dport"], "enabled", false);
            def(p, "logs", array);
            if (p.isMember("isFCoE") && p["isFCoE"].asBool()) {
                def(p, "fcoe", object);
                if (p.isMember("fcoeMac"))
                    def(p["fcoe"], "fcoeMac", p["fcoeMac"]);
            }
            // A remote port that the library can read is logged in.
            for (Json::Value& r : p["remotePorts"])
                if (r.isMember("deviceData"))
                    def(r["deviceData"], "stateMofValue", 2);
            for (Json::Value& v : p["vports"]) {
                if (p.isMember("nodeWwn"))
                    def(v, "nodeWwn", p["nodeWwn"]);
                def(v, "remotePorts", array);
                for (Json::Value& r : v["remotePorts"])
                    if (r.isMember("deviceData"))
                        def(r["deviceData"], "stateMofValue", 2);
            }
        }
        for (Json::Value& p : a["ethPorts"]) {
            def(p, "ethPortStateMOFValue", 11);
            def(p, "portStatus", true);
            def(p, "linkUp", true);
            // Every port has its base PCI function.
            def(p, "vnics", array);
            if (p["vnics"].empty()) {
                Json::Value v;
                v["pciFunctionIndex"] = 0;
                v["mac"] = p["mac"];
                v["minBandwidth"] = 0;
                v["maxBandwidth"] = 100;
                p["vnics"].append(v);
            }
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
    indexHost(s);
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

std::string addrKey(const std::string& addr)
{
    std::string key;
    key.reserve(addr.size());
    for (char c : addr)
        if (c != ':')
            key += char(tolower((unsigned char)c));
    return key;
}

// The first of two parts with one address keeps it, as a walk would find it.
template <class Map, class Place>
static void note(Map& map, const std::string& addr, const Place& place)
{
    std::string key = addrKey(addr);
    if (!key.empty())
        map.emplace(key, place);
}

void indexFcPort(State& s, PortPlace where)
{
    HostIndex& ix = s.index;
    FcPortIndex& below = ix.below[where.adapter][where.port];
    for (const auto& v : below.vports) {
        auto it = ix.vports.find(v.first);
        if (it != ix.vports.end() && it->second.adapter == where.adapter
            && it->second.port == where.port)
            ix.vports.erase(it);
    }
    below = FcPortIndex();

    const Json::Value& host = s.host;
    const Json::Value& port = host["adapters"][where.adapter]["fcPorts"][where.port];
    auto remotes = [&below](const std::string& owner, const Json::Value& list) {
        for (Json::ArrayIndex r = 0; r < list.size(); ++r) {
            std::string key = addrKey(str(list[r], "remotePortWwn"));
            if (!key.empty())
                below.remotePorts.emplace(owner + "|" + key, r);
        }
    };
    remotes("", port["remotePorts"]);
    const Json::Value& vports = port["vports"];
    for (Json::ArrayIndex v = 0; v < vports.size(); ++v) {
        std::string key = addrKey(str(vports[v], "vwwn"));
        if (key.empty())
            continue;
        below.vports.emplace(key, v);
        ix.vports.emplace(key, where);
        remotes(key, vports[v]["remotePorts"]);
    }
}

void indexHost(State& s)
{
    s.index = HostIndex();
    HostIndex& ix = s.index;
    const Json::Value& ads = static_cast<const Json::Value&>(s.host)["adapters"];
    ix.below.resize(ads.size());
    for (Json::ArrayIndex a = 0; a < ads.size(); ++a) {
        const Json::Value& h = ads[a]["hbaData"];
        note(ix.adapters, str(h, "hbaMAC"), a);
        note(ix.adapters, str(h, "wwn"), a);
        const Json::Value& fc = ads[a]["fcPorts"];
        ix.below[a].resize(fc.size());
        for (Json::ArrayIndex p = 0; p < fc.size(); ++p) {
            PortPlace where;
            where.adapter = a;
            where.port = p;
            note(ix.fcPorts, str(fc[p], "wwn"), where);
            note(ix.fcPorts, str(fc[p], "fcoeMac"), where);
        }
        const Json::Value& eth = ads[a]["ethPorts"];
        for (Json::ArrayIndex p = 0; p < eth.size(); ++p) {
            PortPlace where;
            where.adapter = a;
            where.port = p;
            note(ix.ethPorts, str(eth[p], "mac"), where);
        }
    }
    for (Json::ArrayIndex a = 0; a < ads.size(); ++a)
        for (Json::ArrayIndex p = 0; p < ix.below[a].size(); ++p) {
            PortPlace where;
            where.adapter = a;
            where.port = p;
            indexFcPort(s, where);
        }
}

Json::Value* findAdapter(State& s, const std::string& addr, int* id)
{
    auto it = s.index.adapters.find(addrKey(addr));
    if (it == s.index.adapters.end())
        return nullptr;
    if (id)
        *id = int(it->second) + 1;
    return &s.host["adapters"][it->second];
}

static Json::Value* portAt(State& s, const std::unordered_map<std::string, PortPlace>& map,
                           const char* list, const std::string& addr, Json::Value** adapter,
                           PortPlace* where)
{
    auto it = map.find(addrKey(addr));
    if (it == map.end())
        return nullptr;
    Json::Value& a = s.host["adapters"][it->second.adapter];
    if (adapter)
        *adapter = &a;
    if (where)
        *where = it->second;
    return &a[list][it->second.port];
}

Json::Value* findFcPort(State& s, const std::string& wwn, Json::Value** adapter, PortPlace* where)
{
    return portAt(s, s.index.fcPorts, "fcPorts", wwn, adapter, where);
}

Json::Value* findEthPort(State& s, const std::string& mac, Json::Value** adapter, PortPlace* where)
{
    return portAt(s, s.index.ethPorts, "ethPorts", mac, adapter, where);
}

static Json::Value& fcPortAt(State& s, PortPlace where)
{
    return s.host["adapters"][where.adapter]["fcPorts"][where.port];
}

Json::Value* findVport(State& s, PortPlace where, const std::string& vwwn)
{
    const FcPortIndex& below = s.index.below[where.adapter][where.port];
    auto it = below.vports.find(addrKey(vwwn));
    if (it == below.vports.end())
        return nullptr;
    return &fcPortAt(s, where)["vports"][it->second];
}

// The remote ports seen through a logical port: the physical port itself or
// one of its virtual ports.
Json::Value* findRemotePort(State& s, PortPlace where, const std::string& lwwn,
                            const std::string& rwwn)
{
    Json::Value& port = fcPortAt(s, where);
    std::string owner;
    Json::Value* ownerPort = &port;
    if (!lwwn.empty() && addrKey(lwwn) != addrKey(str(port, "wwn"))) {
        ownerPort = findVport(s, where, lwwn);
        if (!ownerPort)
            return nullptr;
        owner = addrKey(lwwn);
    }
    const FcPortIndex& below = s.index.below[where.adapter][where.port];
    auto it = below.remotePorts.find(owner + "|" + addrKey(rwwn));
    if (it == below.remotePorts.end())
        return nullptr;
    return &(*ownerPort)["remotePorts"][it->second];
}

bool wwnTaken(State& s, const std::string& wwn)
{
    std::string key = addrKey(wwn);
    return s.index.fcPorts.count(key) || s.index.vports.count(key);
}

// ---------------------------------------------------------------- replies

void overlayUnchecked(Json::Value& reply, const Json::Value& source)
{
    if (!source.isObject() || !source.isMember("unchecked"))
        return;
    const Json::Value& u = source["unchecked"];
    for (const std::string& m : u.getMemberNames())
        reply[m] = u[m];
}

Json::Value replyOf(const Json::Value& part)
{
    Json::Value r = part;
    if (r.isObject())
        r.removeMember("unchecked");
    overlayUnchecked(r, part);
    return r;
}

Json::Value hbaReply(State&, const Json::Value& a, int id)
{
    Json::Value r(Json::objectValue);
    Json::Value h = a["hbaData"];
    h.removeMember("unchecked");
    h["portCount"] = Json::UInt(a["fcPorts"].size() + a["ethPorts"].size());
    h["numOfFcPorts"] = Json::UInt(a["fcPorts"].size());
    h["numOfEthPorts"] = Json::UInt(a["ethPorts"].size());
    h["isCNA"] = adapterIsCNA(a);
    h["hasEthPort"] = !a["ethPorts"].empty();
    h["adapterId"] = id;
    h["indexStr"] = adapterIndex(a);
    h["manufacturer"] = "VSPR";
    overlayUnchecked(h, a["hbaData"]);
    r["hbaData"] = h;
    r["driver"] = a["driver"];
    r["firmware"] = a["firmware"];
    overlayUnchecked(r, a);
    return r;
}

// Sub-objects of a port that other entries answer; getPortByWwn leaves them out.
static const char* const portNested[] = {
    "sfp", "pom", "remotePorts", "vports", "auth", "bootOverSan", "advData", "fcoe",
    "lunMask", "ioProfiles", "dport", "fcData", "diag", "logs", "trunking", "lldp",
    "cee", "vnics", "linkUp", "unchecked", nullptr};

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

// A mezzanine card's ports say so; a port may also say it of itself.
static void copyMezz(Json::Value& r, const Json::Value& a)
{
    if (!r.isMember("isMezz") && a["hbaData"].isMember("isMezz"))
        r["isMezz"] = a["hbaData"]["isMezz"];
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
    copyMezz(r, a);
    r["hbaIndexStr"] = adapterIndex(a);
    r["trunkingEnabled"] = p["trunking"]["enabled"];
    r["numOfVports"] = Json::UInt(p["vports"].size());
    r["numOfRemotePorts"] = Json::UInt(p["remotePorts"].size());
    // Only a converged adapter's FC ports (FCoE) say what they are; an FC
    // HBA's port has no such member, whatever its description says.
    if (!adapterIsCNA(a))
        r.removeMember("isFCoE");
    overlayUnchecked(r, p);
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
    copyMezz(r, a);
    r["hbaIndexStr"] = adapterIndex(a);
    r["numOfvNICs"] = Json::UInt(p["vnics"].size());
    overlayUnchecked(r, p);
    return r;
}

bool lunVisible(const Json::Value& port, const std::string& rwwn, const Json::Value& number)
{
    const Json::Value& m = port["lunMask"];
    if (!m["enabled"].asBool())
        return true;
    if (!number.isUInt())
        return false;
    std::string n = std::to_string(number.asUInt());
    for (const Json::Value& e : m["entries"]) {
        const Json::Value& id = e["lunId"];
        std::string lun = id.isString() ? id.asString() : id.isUInt() ? std::to_string(id.asUInt()) : "";
        if (addrKey(rwwn) == addrKey(str(e, "rPortWwn")) && !addrKey(rwwn).empty() && lun == n)
            return true;
    }
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
