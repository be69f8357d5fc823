// Diagnostics: the direct tests take their configured time and answer their
// configured result; posted tests keep a queue per request id.
#include "Lib.h"

#include <chrono>
#include <fstream>
#include <unistd.h>

using namespace dtrujtest;

namespace {

class DtrujDiag : public ::testing::Test {
protected:
    Lib lib;
    void SetUp() override
    {
        unsetenv("DTRUJ_HOST");
        lib.reset();
    }
    void portState(const char* addr, bool on)
    {
        ASSERT_FALSE(isError(lib.call("setPortByWwn", obj({{"indexStr", addr}, {"port", obj({{"portStatus", on}})},
                                                           {"propArray", strArray({"portStatus"})}}))));
    }
    long timed(const char* entry, const Json::Value& req, Json::Value& reply)
    {
        auto t0 = std::chrono::steady_clock::now();
        reply = lib.call(entry, req);
        return std::chrono::duration_cast<std::chrono::milliseconds>(std::chrono::steady_clock::now() - t0).count();
    }
};

TEST_F(DtrujDiag, LoopbackNeedsTheDisabledPort)
{
    Json::Value req = obj({{"portWwn", FC_PORT0}, {"mode", 1}, {"speed", 4}, {"dataPattern", 0xB5B5B5B5u},
                           {"frameCount", 131072}});
    Json::Value r;
    timed("diagLoopbackTest", req, r);
    EXPECT_TRUE(r["failed"].asBool());
    EXPECT_TRUE(r["output"].isString());

    portState(FC_PORT0, false);
    long ms = timed("diagLoopbackTest", req, r);
    EXPECT_GE(ms, 300);   // the default host's duration
    EXPECT_FALSE(r["failed"].asBool());
    EXPECT_EQ(131072u, r["transmitFrames"].asUInt());
    EXPECT_EQ(131072u, r["GoodFrameRcv"].asUInt());
    for (const char* m : {"outstandingFrames", "BadFrameNo", "BadFrameInfo"})
        EXPECT_TRUE(r[m].isUInt()) << m;
    EXPECT_EQ("Loopback test passed", r["output"].asString());

    // Ethernet loopback by MAC, the same rule.
    Json::Value eth = obj({{"portWwn", ETH_PORT}, {"mode", 8}, {"frameCount", 65536}, {"dataPattern", 0xB5B5B5B5u}});
    EXPECT_TRUE(lib.call("diagEthLoopbackTest", eth)["failed"].asBool());
    portState(ETH_PORT, false);
    EXPECT_FALSE(lib.call("diagEthLoopbackTest", eth)["failed"].asBool());
    EXPECT_TRUE(isError(lib.call("diagEthLoopbackTest", obj({{"portWwn", FC_PORT0}}))));

    // PCI loopback runs on a live port, WWN or MAC.
    EXPECT_FALSE(lib.call("diagPCILoopbackTest", obj({{"portWwn", FC_PORT1}}))["failed"].asBool());
    EXPECT_FALSE(lib.call("diagPCILoopbackTest", obj({{"portWwn", ETH_PORT}}))["failed"].asBool());
}

TEST_F(DtrujDiag, MemoryTestOnTheDisabledAdapter)
{
    Json::Value r = lib.call("diagMemoryTest", obj({{"hbaWwn", FC_HBA}}));
    EXPECT_TRUE(r["failed"].asBool());
    lib.call("setAdapterState", obj({{"indexStr", FC_HBA}, {"enableState", false}}));
    long ms = timed("diagMemoryTest", obj({{"hbaWwn", FC_HBA}}), r);
    EXPECT_GE(ms, 400);
    EXPECT_FALSE(r["failed"].asBool());
    EXPECT_TRUE(r["status"].isInt());
    EXPECT_EQ(0, r["status"].asInt());
    for (const char* m : {"address", "expected value", "actual value", "error status", "error address"})
        EXPECT_TRUE(r[m].isUInt()) << m;
    EXPECT_TRUE(r["type"].isString());
    EXPECT_TRUE(r["output"].isString());
}

TEST_F(DtrujDiag, ConfiguredFailuresPerPort)
{
    std::string path = testing::TempDir() + "dtruj_diag_host.json";
    {
        std::ofstream out(path);
        out << R"({ "diagnostics": { "requireOffline": false,
                                      "memory": { "durationMs": 10, "failed": true, "status": 3, "output": "ECC error" } },
                   "adapters": [ { "hbaData": { "wwn": "20:00:00:00:00:00:00:01" },
                                   "fcPorts": [ { "wwn": "10:00:00:00:00:00:00:01",
                                                  "diag": { "loopback": { "durationMs": 10, "failed": true,
                                                                          "BadFrameNo": 7, "output": "CRC mismatch" } } },
                                                { "wwn": "10:00:00:00:00:00:00:02" } ] } ] })";
    }
    setenv("DTRUJ_HOST", path.c_str(), 1);
    lib.reset();
    Json::Value req = obj({{"portWwn", "10:00:00:00:00:00:00:01"}, {"frameCount", 1000}});
    Json::Value r = lib.call("diagLoopbackTest", req);
    EXPECT_TRUE(r["failed"].asBool());
    EXPECT_EQ(7u, r["BadFrameNo"].asUInt());
    EXPECT_LT(r["GoodFrameRcv"].asUInt(), 1000u);
    EXPECT_EQ("CRC mismatch", r["output"].asString());
    req["portWwn"] = "10:00:00:00:00:00:00:02";
    EXPECT_FALSE(lib.call("diagLoopbackTest", req)["failed"].asBool());
    r = lib.call("diagMemoryTest", obj({{"hbaWwn", "20:00:00:00:00:00:00:01"}}));
    EXPECT_TRUE(r["failed"].asBool());
    EXPECT_EQ(3, r["status"].asInt());
    EXPECT_EQ("ECC error", r["output"].asString());
    unsetenv("DTRUJ_HOST");
    remove(path.c_str());
}

TEST_F(DtrujDiag, PostedTestsRunInOrderPerRequestId)
{
    std::string id = std::to_string(lib.sym<OLMA::voidRetIntFP>("getRequestID")());
    std::string other = std::to_string(lib.sym<OLMA::voidRetIntFP>("getRequestID")());
    auto post = [&](const std::string& rid, const char* fn) {
        return lib.call("postDiagnostics", obj({{"function", fn}, {"requestID", rid}, {"hbaWwn", FC_HBA}}));
    };
    EXPECT_TRUE(isError(post("999", "QuickTest")));       // never handed out
    EXPECT_TRUE(isError(post(id, "NoSuchTest")));
    EXPECT_TRUE(isError(lib.call("startTests", obj({{"requestID", id}}))));   // nothing posted
    ASSERT_FALSE(isError(post(id, "QuickTest")));
    ASSERT_FALSE(isError(post(id, "FCTraceTest")));       // fails in the default host
    ASSERT_FALSE(isError(post(id, "MemoryTest")));
    ASSERT_FALSE(isError(post(other, "LEDTest")));

    Json::Value r = lib.call("getDiagnosticsResults", obj({{"requestID", id}}));
    EXPECT_EQ("NotStarted", r["state"].asString());
    ASSERT_EQ(3u, r["results"].size());
    EXPECT_EQ("Queued", r["results"][0]["status"].asString());

    ASSERT_FALSE(isError(lib.call("startTests", obj({{"requestID", id}, {"stopOnError", true}}))));
    EXPECT_TRUE(isError(post(id, "QueueTest")));          // too late
    r = lib.call("getDiagnosticsResults", obj({{"requestID", id}}));
    EXPECT_EQ("Running", r["state"].asString());
    EXPECT_EQ("Running", r["results"][0]["status"].asString());
    usleep(250000);
    r = lib.call("getDiagnosticsResults", obj({{"requestID", id}}));
    EXPECT_EQ("Completed", r["state"].asString());
    EXPECT_EQ("Passed", r["results"][0]["status"].asString());
    EXPECT_EQ("Failed", r["results"][1]["status"].asString());
    EXPECT_EQ("Skipped", r["results"][2]["status"].asString());   // stop on error
    // The other run was never started.
    EXPECT_EQ("NotStarted", lib.call("getDiagnosticsResults", obj({{"requestID", other}}))["state"].asString());
}

TEST_F(DtrujDiag, CancelStopsTheRestOfARun)
{
    std::string id = std::to_string(lib.sym<OLMA::voidRetIntFP>("getRequestID")());
    for (const char* fn : {"DPortTest", "QuickTest"})
        lib.call("postDiagnostics", obj({{"function", fn}, {"requestID", id}, {"portWwn", FC_PORT0}}));
    lib.call("startTests", obj({{"requestID", id}, {"stopOnError", false}}));
    usleep(50000);
    ASSERT_FALSE(isError(lib.call("cancelTests", obj({{"requestID", id}}))));
    usleep(400000);
    Json::Value r = lib.call("getDiagnosticsResults", obj({{"requestID", id}}));
    EXPECT_EQ("Cancelled", r["state"].asString());
    EXPECT_EQ("Cancelled", r["results"][0]["status"].asString());
    EXPECT_EQ("Skipped", r["results"][1]["status"].asString());
    EXPECT_TRUE(isError(lib.call("cancelTests", obj({{"requestID", "12345"}}))));
}

TEST_F(DtrujDiag, DPortResultOnlyInDPortMode)
{
    EXPECT_TRUE(isError(lib.call("getDPortTestResult", obj({{"portWwn", FC_PORT1}}))));
    lib.call("setDport", obj({{"requestID", "1"}, {"portWwn", FC_PORT1}, {"state", true}}));
    EXPECT_EQ("InProgress", lib.call("getDPortTestResult", obj({{"portWwn", FC_PORT1}}))["status"].asString());
    EXPECT_TRUE(isError(lib.call("setDport", obj({{"portWwn", FCOE_PORT}, {"state", true}}))));
}

} // namespace
