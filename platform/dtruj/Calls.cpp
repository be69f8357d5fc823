// The calls the library got, in order: entry and request. Tests and users
// read it to see what a caller asked, and in what order (a port disabled
// before its test and enabled after, a test never started).
#include "Sim.h"

#include <cstring>

namespace OLMA {
namespace Sim {

namespace {

// The latest calls only: an inventory walk of a large host makes thousands.
const size_t MAX_CALLS = 4096;

struct CallLog {
    std::mutex mtx;
    std::deque<Json::Value> calls;
};

CallLog& callLog()
{
    static CallLog* log = new CallLog;   // outlives callers at exit
    return *log;
}

} // namespace

void recordCall(const char* entry, const Json::Value& req)
{
    Json::Value c(Json::objectValue);
    c["entry"] = entry;
    c["request"] = req;
    CallLog& log = callLog();
    std::lock_guard<std::mutex> g(log.mtx);
    log.calls.push_back(c);
    if (log.calls.size() > MAX_CALLS)
        log.calls.pop_front();
}

void clearCalls()
{
    CallLog& log = callLog();
    std::lock_guard<std::mutex> g(log.mtx);
    log.calls.clear();
}

} // namespace Sim
} // namespace OLMA

using namespace OLMA::Sim;

// The calls since the last reset or clear, oldest first, as a JSON array of
// {"entry", "request"}; the caller frees it.
DTRUJ_API char* dtruj_sim_calls()
{
    Json::Value all(Json::arrayValue);
    {
        CallLog& log = callLog();
        std::lock_guard<std::mutex> g(log.mtx);
        for (const Json::Value& c : log.calls)
            all.append(c);
    }
    Json::FastWriter w;
    return strdup(w.write(all).c_str());
}

DTRUJ_API void dtruj_sim_clear_calls()
{
    clearCalls();
}
