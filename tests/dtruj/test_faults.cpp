// Injected faults: each kind, chosen at run time or by the host description.
#include "Lib.h"

#include <chrono>
#include <fstream>
#include <stdexcept>
#include <thread>
#include <unistd.h>

using namespace dtrujtest;

extern "C" int dtruj_catch(const char* entry, int* code, char* message, size_t size);

namespace {

class DtrujFaults : public ::testing::Test {
protected:
    Lib lib;
    void SetUp() override
    {
        unsetenv("DTRUJ_HOST");
        lib.reset();
    }
};

TEST_F(DtrujFaults, AnswerKinds)
{
    Json::Value req = obj({{"wwn", FC_HBA}});
    ASSERT_EQ(0, lib.setFault("getHbaByWwn", "null"));
    EXPECT_TRUE(lib.call("getHbaByWwn", req).isNull());
    ASSERT_EQ(0, lib.setFault("getHbaByWwn", "{\"kind\":\"error\",\"code\":17,\"message\":\"busy\"}"));
    Json::Value r = lib.call("getHbaByWwn", req);
    EXPECT_EQ(17, r["error"]["code"].asInt());
    EXPECT_EQ("busy", r["error"]["message"].asString());
    // Other entries are untouched, and clearing brings the entry back.
    EXPECT_FALSE(isError(lib.call("getHbaByMac", obj({{"mac", CNA}}))));
    ASSERT_EQ(0, lib.setFault("getHbaByWwn", "none"));
    EXPECT_FALSE(isError(lib.call("getHbaByWwn", req)));

    EXPECT_EQ(-1, lib.setFault("getHbaByWwn", "explode"));
    EXPECT_EQ(-1, lib.setFault("getHbaByWwn", "{not json"));
}

TEST_F(DtrujFaults, ThrownKindsAreCaughtByTypeInAnotherObject)
{
    int code = 0;
    char msg[64] = "";
    ASSERT_EQ(0, lib.setFault("getHost", "{\"kind\":\"hba\",\"code\":42,\"message\":\"adapter gone\"}"));
    EXPECT_EQ(1, dtruj_catch("getHost", &code, msg, sizeof(msg)));
    EXPECT_EQ(42, code);
    EXPECT_STREQ("adapter gone", msg);
    ASSERT_EQ(0, lib.setFault("getHost", "std"));
    EXPECT_EQ(2, dtruj_catch("getHost", &code, msg, sizeof(msg)));
    ASSERT_EQ(0, lib.setFault("getHost", "unknown"));
    EXPECT_EQ(3, dtruj_catch("getHost", &code, msg, sizeof(msg)));
    ASSERT_EQ(0, lib.setFault("getHost", "none"));
    EXPECT_EQ(0, dtruj_catch("getHost", &code, msg, sizeof(msg)));

    // The plain entries throw too.
    ASSERT_EQ(0, lib.setFault("getNumberOfAdapters", "hba"));
    EXPECT_THROW(lib.sym<OLMA::voidRetUIntFP>("getNumberOfAdapters")(), OLMA::HbaAgentError);
    ASSERT_EQ(0, lib.setFault("getNumberOfAdapters", "null"));
    EXPECT_EQ(65535u, lib.sym<OLMA::voidRetUIntFP>("getNumberOfAdapters")());
    ASSERT_EQ(0, lib.setFault("get_agt_version", "null"));
    EXPECT_EQ(nullptr, lib.sym<OLMA::voidRetStrFP>("get_agt_version")());
}

TEST_F(DtrujFaults, DelayAndCount)
{
    ASSERT_EQ(0, lib.setFault("getGlobalInfo", "{\"kind\":\"delay\",\"delayMs\":150,\"count\":1}"));
    auto t0 = std::chrono::steady_clock::now();
    Json::Value r = lib.call("getGlobalInfo");
    auto ms = std::chrono::duration_cast<std::chrono::milliseconds>(std::chrono::steady_clock::now() - t0).count();
    EXPECT_GE(ms, 150);
    EXPECT_EQ(2, r["numOfAdapters"].asInt());   // a delay still answers

    // A count of 2 fails two calls, then the entry works again.
    ASSERT_EQ(0, lib.setFault("getAllAdaptersIndexString", "{\"kind\":\"null\",\"count\":2}"));
    EXPECT_TRUE(lib.call("getAllAdaptersIndexString").isNull());
    EXPECT_TRUE(lib.call("getAllAdaptersIndexString").isNull());
    EXPECT_FALSE(lib.call("getAllAdaptersIndexString").isNull());

    // A delay while another thread is inside the library doesn't hold it up:
    // the delay is spent outside the host's lock.
    ASSERT_EQ(0, lib.setFault("getHost", "delay:300"));
    std::thread slow([&] { lib.call("getHost"); });
    usleep(50000);
    t0 = std::chrono::steady_clock::now();
    lib.call("getGlobalInfo");
    ms = std::chrono::duration_cast<std::chrono::milliseconds>(std::chrono::steady_clock::now() - t0).count();
    EXPECT_LT(ms, 200);
    slow.join();
}

TEST_F(DtrujFaults, FromTheHostDescriptionAndResetClears)
{
    std::string path = testing::TempDir() + "dtruj_faults_host.json";
    {
        std::ofstream out(path);
        out << R"({ "faults": { "getPortByWwn": "hba", "getHbaByWwn": {"kind": "error", "code": 9} },
                   "adapters": [ { "hbaData": { "wwn": "20:00:00:00:00:00:00:01" },
                                   "fcPorts": [ { "wwn": "10:00:00:00:00:00:00:01" } ] } ] })";
    }
    setenv("DTRUJ_HOST", path.c_str(), 1);
    lib.reset();
    EXPECT_THROW(lib.call("getPortByWwn", obj({{"wwn", "10:00:00:00:00:00:00:01"}})), OLMA::HbaAgentError);
    EXPECT_EQ(9, lib.call("getHbaByWwn", obj({{"wwn", "20:00:00:00:00:00:00:01"}}))["error"]["code"].asInt());
    // A fault cleared at run time stays cleared until the next reset.
    lib.setFault("getPortByWwn", "");
    EXPECT_FALSE(isError(lib.call("getPortByWwn", obj({{"wwn", "10:00:00:00:00:00:00:01"}}))));
    unsetenv("DTRUJ_HOST");
    lib.reset();
    EXPECT_FALSE(isError(lib.call("getHbaByWwn", obj({{"wwn", FC_HBA}}))));
    remove(path.c_str());
}

TEST_F(DtrujFaults, NotInitialisedAnswersError)
{
    lib.sym<OLMA::voidRetIntFP>("free_hba_lib")();
    EXPECT_TRUE(isError(lib.call("getHost")));
    EXPECT_EQ(-1, lib.sym<OLMA::voidRetIntFP>("getRequestID")());
}

// A reply of the wrong shape: the top level of the other kind, or every
// value inside of another type; the entry still acts as it would.
TEST_F(DtrujFaults, BentReplies)
{
    Json::Value req = obj({{"wwn", FC_HBA}});
    Json::Value healthy = lib.call("getHbaByWwn", req);
    ASSERT_EQ(0, lib.setFault("getHbaByWwn", "shape"));
    Json::Value r = lib.call("getHbaByWwn", req);
    ASSERT_TRUE(r.isArray());
    ASSERT_EQ(1u, r.size());
    EXPECT_EQ(healthy, r[0]);

    Json::Value lrq = obj({{"pPortWwn", FC_PORT0}});
    Json::Value list = lib.call("getAllRemotePorts", lrq);
    ASSERT_TRUE(list.isArray() && list.size() > 1);
    ASSERT_EQ(0, lib.setFault("getAllRemotePorts", "shape"));
    r = lib.call("getAllRemotePorts", lrq);
    ASSERT_TRUE(r.isObject());
    EXPECT_EQ(list[1], r["1"]);

    ASSERT_EQ(0, lib.setFault("getHbaByWwn", "mistyped"));
    r = lib.call("getHbaByWwn", req);
    ASSERT_TRUE(r.isObject());
    ASSERT_TRUE(r["hbaData"].isObject());
    EXPECT_TRUE(r["hbaData"]["wwn"].isNumeric());
    EXPECT_EQ(23u, r["hbaData"]["wwn"].asUInt());
    EXPECT_TRUE(r["hbaData"]["isCNA"].isString());
    EXPECT_TRUE(r["hbaData"]["adapterId"].isString());

    // The plain entries answer values no real library gives.
    ASSERT_EQ(0, lib.setFault("get_agt_version", "shape"));
    EXPECT_STREQ("3", lib.sym<OLMA::voidRetStrFP>("get_agt_version")());
    ASSERT_EQ(0, lib.setFault("getNumberOfAdapters", "mistyped"));
    EXPECT_EQ(4294967294u, lib.sym<OLMA::voidRetUIntFP>("getNumberOfAdapters")());
    ASSERT_EQ(0, lib.setFault("getRequestID", "shape"));
    EXPECT_GT(0, lib.sym<OLMA::voidRetIntFP>("getRequestID")());
}

// Every entry, plain ones too, leaves its call in the log.
TEST_F(DtrujFaults, CallLogHoldsEveryEntry)
{
    auto calls = lib.sym<char* (*)()>("dtruj_sim_calls");
    lib.sym<void (*)()>("dtruj_sim_clear_calls")();
    lib.sym<OLMA::voidRetIntFP>("getRequestID")();
    lib.call("getHost");
    char* text = calls();
    Json::Value log;
    ASSERT_TRUE(Json::Reader().parse(text, log));
    free(text);
    ASSERT_EQ(2u, log.size());
    EXPECT_EQ("getRequestID", log[0]["entry"].asString());
    EXPECT_TRUE(log[0]["request"].isNull());
    EXPECT_EQ("getHost", log[1]["entry"].asString());
}

} // namespace
