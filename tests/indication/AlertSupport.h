// Alerts through the stand-in CIM server: subscribing as a client does,
// feeding the simulated library's event thread, and reading what arrived.
#ifndef _VSPR_indication_AlertSupport_h
#define _VSPR_indication_AlertSupport_h

#include <dirent.h>
#include <dlfcn.h>

#include <algorithm>
#include <chrono>
#include <set>

#include "ProvidersSupport.h"
#include "dtruj.h"

extern "C" int dtruj_sim_inject_event(const char* json);
extern "C" int dtruj_sim_inject_copies(const char* json, int count);
extern "C" int dtruj_sim_inject_list(const char* jsonArray);
extern "C" unsigned long dtruj_sim_events_delivered(void);
extern "C" OLMA::EventProcessCB dtruj_sim_event_callback(void);

namespace alerts_test
{

using namespace providers_test;

const char FC_PORT0[] = "100000051e8a1001";          // plain forms, as events carry them
const char FC_PORT0_COLON[] = "10:00:00:05:1e:8a:10:01";
const char FC_PORT1[] = "100000051e8a1002";
const char ETH_PORT[] = "00051e8b2002";
const char ETH_PORT_COLON[] = "00:05:1e:8b:20:02";

inline Json::Value event(int category, int id, const std::string& msg = "")
{
    Json::Value e(Json::objectValue);
    e["eventCategory"] = category;
    e["eventId"] = id;
    e["eventMsg"] = msg;
    e["eventIdValue"] = "TRU_TEST_EVENT";
    e["eventSeverity"] = 4;
    e["portIndexString"] = category == 10 ? ETH_PORT : FC_PORT0;
    e["basePortWWN"] = FC_PORT0_COLON;
    return e;
}

inline Json::Value listOf(std::initializer_list<Json::Value> events)
{
    Json::Value list(Json::arrayValue);
    for (const Json::Value& e : events)
        list.append(e);
    return list;
}

inline std::string compact(const Json::Value& v)
{
    std::string text = Json::FastWriter().write(v);
    if (!text.empty() && text.back() == '\n')
        text.pop_back();
    return text;
}

inline const ch::Value* prop(const ch::Instance& i, const char* name)
{
    return i.get(name);
}

inline bool isNull(const ch::Instance& i, const char* name)
{
    const ch::Value* v = i.get(name);
    return !v || v->null;
}

inline std::vector<std::string> strings(const ch::Instance& i, const char* name)
{
    std::vector<std::string> r;
    if (const ch::Value* v = i.get(name))
        for (const ch::Value& e : v->elements)
            r.push_back(e.str);
    return r;
}

inline int64_t sequence(const ch::Instance& i)
{
    const ch::Value* v = i.get("SequenceNumber");
    return v && !v->null ? v->num.sint64 : -1;
}

// The threads of this process.
inline size_t threadCount()
{
    size_t n = 0;
    if (DIR* d = opendir("/proc/self/task"))
    {
        while (dirent* e = readdir(d))
            n += e->d_name[0] != '.';
        closedir(d);
    }
    return n;
}

// A JSON entry of the simulated library, called as any management tool of
// the host would.
inline Json::Value library(const char* entry, const Json::Value& request)
{
    OLMA::JsonReqFP f = (OLMA::JsonReqFP)dlsym(RTLD_DEFAULT, entry);
    EXPECT_TRUE(f != nullptr) << entry;
    return f ? f(request) : Json::Value();
}

class AlertTest : public ProvidersTest
{
protected:
    std::vector<int> subs;
    unsigned sentinels = 0;

    void SetUp() override
    {
        ProvidersTest::SetUp();
        host->clear_indications();
    }

    void TearDown() override
    {
        for (int id : subs)
            host->unsubscribe(id);
        subs.clear();
        host->clear_indications();
        ProvidersTest::TearDown();
    }

    int subscribe()
    {
        int id = 0;
        ch::Result r = host->subscribe("root/vespera", "VESPERA_AlertIndication", id);
        EXPECT_TRUE(r.ok()) << ch::rc_name(r.rc) << " " << r.message;
        if (id)
            subs.push_back(id);
        return id;
    }

    ch::Result unsubscribe(int id)
    {
        subs.erase(std::remove(subs.begin(), subs.end(), id), subs.end());
        return host->unsubscribe(id);
    }

    static std::vector<ch::Instance> alerts()
    {
        std::vector<ch::Instance> r;
        for (const ch::Indication_Record& rec : host->indications())
            r.push_back(rec.instance);
        return r;
    }

    // Waits until count alerts arrived in all; false on time-out.
    static bool waitAlerts(size_t count, int timeoutMs)
    {
        return host->wait_indications(count, timeoutMs) >= count;
    }

    // Sends the events as one burst with a sentinel event behind them, and
    // returns the alerts that arrived before the sentinel's: the library
    // hands events over in order, so the others were all processed by then.
    std::vector<ch::Instance> alertsOf(const Json::Value& events, int timeoutMs = 30000)
    {
        std::string tag = "sentinel-" + std::to_string(++sentinels);
        Json::Value list = events;
        list.append(event(99, 0, tag));
        size_t before = host->indications().size();
        EXPECT_EQ(int(list.size()), dtruj_sim_inject_list(compact(list).c_str()));

        auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeoutMs);
        for (size_t seen = before; std::chrono::steady_clock::now() < end;)
        {
            host->wait_indications(seen + 1, 100);
            std::vector<ch::Instance> all = alerts();
            for (; seen < all.size(); seen++)
                if (all[seen].get_text("Message") == tag)
                    return std::vector<ch::Instance>(all.begin() + before, all.begin() + seen);
        }
        ADD_FAILURE() << "the sentinel event " << tag << " didn't arrive";
        return std::vector<ch::Instance>();
    }

    // The path of the instance of a class whose DeviceID is given.
    static ch::Object_Path devicePath(const char* cls, const std::string& deviceId)
    {
        for (const ch::Instance& i : served(cls))
            if (i.get_text("DeviceID") == deviceId)
                return i.path;
        ADD_FAILURE() << "no " << cls << " " << deviceId;
        return ch::Object_Path();
    }

    // The path that a text of an alert names, typed as a client types it.
    static ch::Object_Path parsedPath(const std::string& text)
    {
        ch::Object_Path p;
        std::string err;
        EXPECT_TRUE(host->parse_object_path(text, p, err)) << text << ": " << err;
        return p;
    }
};

} // namespace alerts_test

#endif
