// The echo and its journal, the controls that set them, and the other
// help for the console's methods.
#include "Console.h"

#include <cstdlib>
#include <cstring>
#include <deque>
#include <mutex>
#include <set>
#include <string>

#include "Sim.h"

namespace OLMA {
namespace Sim {

namespace {

// The JSON request entries: only they have a request to echo.
#define ECHO_NAME_JSON(name) #name,
#define ECHO_NAME_INT(name)
#define ECHO_NAME_UINT(name)
#define ECHO_NAME_TEXT(name)
#define ECHO_NAME_EVTCB(name)
#define ECHO_NAME_LOGCB(name)
#define ECHO_NAME(name, cls) ECHO_NAME_##cls(name)
const char* const jsonEntries[] = {DTRUJ_ENTRIES(ECHO_NAME) nullptr};

// Enough for any one test or session; older calls go first.
const size_t JOURNAL_LIMIT = 10000;

struct Echo {
    std::mutex mtx;
    bool configured = false;        // DTRUJ_ECHO read, or a control called
    bool all = false;
    std::set<std::string> entries;
    std::deque<Json::Value> journal;
};

Echo& echo()
{
    static Echo e;
    return e;
}

bool isJsonEntry(const std::string& name)
{
    for (const char* const* e = jsonEntries; *e; ++e)
        if (name == *e)
            return true;
    return false;
}

// "*" for every JSON entry, or names separated by commas; null, "" or
// "none" for none. False, with nothing changed, for a name the library
// doesn't have.
bool configure(Echo& e, const char* entries)
{
    bool all = false;
    std::set<std::string> names;
    std::string text = entries ? entries : "";
    if (text == "*") {
        all = true;
    } else if (!text.empty() && text != "none") {
        size_t pos = 0;
        while (pos <= text.size()) {
            size_t comma = text.find(',', pos);
            if (comma == std::string::npos)
                comma = text.size();
            std::string name = text.substr(pos, comma - pos);
            size_t b = name.find_first_not_of(" \t");
            size_t l = name.find_last_not_of(" \t");
            name = b == std::string::npos ? std::string() : name.substr(b, l - b + 1);
            if (!name.empty()) {
                if (!isJsonEntry(name)) {
                    SIMLOG(SL_WARN, "echo: no JSON entry named %s", name.c_str());
                    return false;
                }
                names.insert(name);
            }
            pos = comma + 1;
        }
    }
    e.all = all;
    e.entries.swap(names);
    e.journal.clear();
    e.configured = true;
    return true;
}

void configureFromEnvironment(Echo& e)
{
    if (!configure(e, getenv("DTRUJ_ECHO")))
        configure(e, nullptr);
}

} // namespace

bool echoReply(const char* entry, const Json::Value& request, Json::Value& reply)
{
    Echo& e = echo();
    std::lock_guard<std::mutex> g(e.mtx);
    if (!e.configured)
        configureFromEnvironment(e);
    if (!e.all && e.entries.find(entry) == e.entries.end())
        return false;
    reply = Json::Value(Json::objectValue);
    reply["entry"] = entry;
    reply["request"] = request;
    if (e.journal.size() >= JOURNAL_LIMIT)
        e.journal.pop_front();
    e.journal.push_back(reply);
    SIMLOG(SL_DEBUG, "%s: echoed", entry);
    return true;
}

void resetEcho()
{
    Echo& e = echo();
    std::lock_guard<std::mutex> g(e.mtx);
    configureFromEnvironment(e);
}

bool takesAnyRequest(const char* entry)
{
    static const char* const any[] = {"getHost", "getServerTime", "getGlobalInfo",
                                      "getDriverUpdateStatus", "getAllAdaptersIndexString",
                                      nullptr};
    for (const char* const* a = any; *a; ++a)
        if (strcmp(entry, *a) == 0)
            return true;
    return false;
}

void overlayGlobalInfo(Json::Value& target, const Json::Value& described)
{
    if (!described.isObject() || !target.isObject())
        return;
    const Json::Value& over = described["globalInfo"];
    if (!over.isObject())
        return;
    for (const std::string& m : over.getMemberNames())
        target[m] = over[m];
}

void appendPortLog(Json::Value& port, const std::string& message)
{
    Json::Value& logs = port["logs"];
    if (!logs.isArray())
        logs = Json::Value(Json::arrayValue);
    Json::Value record(Json::objectValue);
    record["time"] = Json::UInt64(now());
    record["message"] = message;
    logs.append(record);
    while (logs.size() > 100) {
        Json::Value removed;
        logs.removeIndex(0, &removed);
    }
}

} // namespace Sim
} // namespace OLMA

using namespace OLMA::Sim;

// Which entries echo: "*", a list of entry names separated by commas, or
// null / "" / "none" to stop. The journal starts afresh. -1, with nothing
// changed, for a name that isn't a JSON entry of the library.
DTRUJ_API int dtruj_sim_set_echo(const char* entries)
{
    Echo& e = echo();
    std::lock_guard<std::mutex> g(e.mtx);
    return configure(e, entries) ? 0 : -1;
}

// The echoed calls since the echo was last set, oldest first, as a JSON
// array text of {"entry", "request"}. The caller frees it.
DTRUJ_API char* dtruj_sim_journal(void)
{
    Echo& e = echo();
    std::lock_guard<std::mutex> g(e.mtx);
    Json::Value all(Json::arrayValue);
    for (const Json::Value& call : e.journal)
        all.append(call);
    Json::FastWriter w;
    return strdup(w.write(all).c_str());
}
