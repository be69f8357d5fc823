// Loads libdtruj.so the way the module does and gives the tests typed
// access to its entries.
#ifndef DTRUJ_TEST_LIB_H
#define DTRUJ_TEST_LIB_H

#include <dlfcn.h>
#include <gtest/gtest.h>
#include <cstdlib>
#include <string>

#include "dtruj.h"

namespace dtrujtest {

// The default host, as the tests know it.
const char* const FC_HBA = "20:00:00:05:1e:8a:10:00";
const char* const FC_PORT0 = "10:00:00:05:1e:8a:10:01";
const char* const FC_PORT1 = "10:00:00:05:1e:8a:10:02";
const char* const CNA = "00:05:1e:8b:20:00";
const char* const CNA_WWN = "20:00:00:05:1e:8b:20:00";
const char* const FCOE_PORT = "10:00:00:05:1e:8b:20:01";
const char* const ETH_PORT = "00:05:1e:8b:20:02";
const char* const DISK_RPORT = "50:06:01:60:3b:20:1a:01";
const char* const TAPE_RPORT = "50:01:10:a0:00:8c:12:34";
const char* const CHANGER_RPORT = "50:01:10:a0:00:8c:12:35";
const char* const INIT_RPORT = "21:00:00:24:ff:4c:aa:01";
const char* const VPORT = "2f:00:00:05:1e:8a:10:01";

struct Lib {
    void* handle = nullptr;

    Lib()
    {
        handle = dlopen("libdtruj.so", RTLD_NOW);
        if (!handle)
            ADD_FAILURE() << "dlopen: " << dlerror();
    }

    template <class F>
    F sym(const char* name)
    {
        if (!handle)
            return nullptr;
        dlerror();
        void* p = dlsym(handle, name);
        const char* err = dlerror();
        if (err || !p) {
            ADD_FAILURE() << name << " not found: " << (err ? err : "null");
            return nullptr;
        }
        return reinterpret_cast<F>(p);
    }

    Json::Value call(const char* entry, const Json::Value& req = Json::Value())
    {
        OLMA::JsonReqFP f = handle ? sym<OLMA::JsonReqFP>(entry) : nullptr;
        return f ? f(req) : Json::Value();
    }

    // A fresh default host (or the one DTRUJ_HOST names), initialised.
    void reset()
    {
        auto r = sym<int (*)()>("dtruj_sim_reset");
        ASSERT_NE(nullptr, r);
        ASSERT_EQ(0, r());
        Json::Value req;
        req["appId"] = 2;
        ASSERT_EQ(0, call("init_hba_lib", req)["result"].asInt());
    }

    int setFault(const char* entry, const char* kind)
    {
        auto f = sym<int (*)(const char*, const char*)>("dtruj_sim_set_fault");
        return f ? f(entry, kind) : -2;
    }

    int inject(const char* json)
    {
        auto f = sym<int (*)(const char*)>("dtruj_sim_inject_event");
        return f ? f(json) : -2;
    }

    int injectCopies(const char* json, int count)
    {
        auto f = sym<int (*)(const char*, int)>("dtruj_sim_inject_copies");
        return f ? f(json, count) : -2;
    }

    int injectList(const char* jsonArray)
    {
        auto f = sym<int (*)(const char*)>("dtruj_sim_inject_list");
        return f ? f(jsonArray) : -2;
    }

    unsigned long eventsDelivered()
    {
        auto f = sym<unsigned long (*)()>("dtruj_sim_events_delivered");
        return f ? f() : 0;
    }
};

inline Json::Value obj(std::initializer_list<std::pair<const char*, Json::Value>> members)
{
    Json::Value v(Json::objectValue);
    for (auto& m : members)
        v[m.first] = m.second;
    return v;
}

inline Json::Value arr(std::initializer_list<Json::Value> items)
{
    Json::Value v(Json::arrayValue);
    for (auto& i : items)
        v.append(i);
    return v;
}

inline bool isError(const Json::Value& v)
{
    return v.isObject() && v.isMember("error");
}

inline Json::Value strArray(std::initializer_list<const char*> items)
{
    Json::Value v(Json::arrayValue);
    for (auto i : items)
        v.append(i);
    return v;
}

} // namespace dtrujtest

#endif
