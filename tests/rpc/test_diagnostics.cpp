// The diagnostic methods: what each posts or sends, the tests over pairs of
// ports, and a run's whole life in the library, by its request id.

#include <chrono>
#include <thread>

#include "RpcSupport.h"

using namespace rpc_test;

namespace
{

struct Sent
{
    const char* method;
    const char* params;
    const char* entry;
    const char* request;
};

const Sent diagnostics[] = {
    {"diagnostics.startTests", "[\"4\",true]", "startTests", "{\"requestID\":\"4\",\"stopOnError\":true}"},
    {"diagnostics.cancelTests", "[\"4\"]", "cancelTests", "{\"requestID\":\"4\"}"},
    {"diagnostics.getDiagnosticsResults", "[\"4\"]", "getDiagnosticsResults", "{\"requestID\":\"4\"}"},
    {"diagnostics.doQuickTest", "[\"4\",\"h\"]", "postDiagnostics",
     "{\"function\":\"QuickTest\",\"requestID\":\"4\",\"hbaWwn\":\"h\"}"},
    {"diagnostics.doMemoryTest", "[\"4\",\"h\"]", "postDiagnostics",
     "{\"function\":\"MemoryTest\",\"requestID\":\"4\",\"hbaWwn\":\"h\"}"},
    {"diagnostics.doQueueTest", "[\"4\",\"h\",\"p\"]", "postDiagnostics",
     "{\"function\":\"QueueTest\",\"requestID\":\"4\",\"hbaWwn\":\"h\",\"portWwn\":\"p\"}"},
    {"diagnostics.doLEDTest", "[\"4\",\"h\",\"p\",15,1,2,3]", "postDiagnostics",
     "{\"function\":\"LEDTest\",\"requestID\":\"4\",\"hbaWwn\":\"h\",\"portWwn\":\"p\",\"ledBitmap\":15,"
     "\"command\":1,\"color\":2,\"frequency\":3}"},
    {"diagnostics.doPCILoopbackTest", "[\"4\",\"h\",\"p\",\"100\",\"a5\",2]", "postDiagnostics",
     "{\"function\":\"PCILoopbackTest\",\"requestID\":\"4\",\"hbaWwn\":\"h\",\"portWwn\":\"p\","
     "\"frameCount\":\"100\",\"dataPattern\":\"a5\",\"numCycles\":2}"},
    {"diagnostics.doDportTest", "[\"4\",\"h\",\"p\",\"100\",\"a5\",2]", "postDiagnostics",
     "{\"function\":\"DPortTest\",\"requestID\":\"4\",\"hbaWwn\":\"h\",\"portWwn\":\"p\","
     "\"frameCount\":\"100\",\"dataPattern\":\"a5\",\"numCycles\":2}"},
    {"diagnostics.doLoopbackTest", "[\"4\",\"h\",\"p\",1,8,3,\"100\",\"a5\"]", "postDiagnostics",
     "{\"function\":\"LoopbackTest\",\"requestID\":\"4\",\"portWwn\":\"p\",\"mode\":1,\"speed\":8,"
     "\"numCycles\":3,\"frameCount\":\"100\",\"dataPattern\":\"a5\"}"},
    {"diagnostics.doEthLoopbackTest", "[\"4\",\"h\",\"p\",1,8,3,\"100\",\"a5\"]", "postDiagnostics",
     "{\"function\":\"EthLoopbackTest\",\"requestID\":\"4\",\"portWwn\":\"p\",\"mode\":1,\"speed\":8,"
     "\"numCycles\":3,\"frameCount\":\"100\",\"dataPattern\":\"a5\"}"},
    {"diagnostics.dPortEnable", "[\"4\",\"p\",true]", "setDport",
     "{\"requestID\":\"4\",\"portWwn\":\"p\",\"state\":true}"},
    {"diagnostics.doPOSTest", "[\"4\",\"p\",0]", "setDport",
     "{\"requestID\":\"4\",\"portWwn\":\"p\",\"state\":false}"},
    {"diagnostics.getDPortTestResults", "[\"p\"]", "getDPortTestResult", "{\"portWwn\":\"p\"}"},
    {"diagnostics.getOpticsPOM", "[\"p\"]", "getOpticsPOM", "{\"portWwn\":\"p\"}"},
    {"diagnostics.getOpticsSFP", "[\"p\"]", "getOpticsSFP", "{\"indexStr\":\"p\"}"},
};

class Diagnostics : public RpcTest
{
protected:
    // A fresh request id, as the text a console hands back.
    static std::string requestId()
    {
        Json::Value id = result("diagnostics.getRequestID");
        EXPECT_TRUE(id.isInt());
        return std::to_string(id.asInt());
    }

    static Json::Value params(std::initializer_list<Json::Value> values)
    {
        Json::Value p(Json::arrayValue);
        for (const Json::Value& v : values)
            p.append(v);
        return p;
    }

    // Polls the run until it has left "Running", for at most 10 s.
    static Json::Value finished(const std::string& id)
    {
        Json::Value r;
        for (int i = 0; i < 1000; i++)
        {
            r = result("diagnostics.getDiagnosticsResults", params({id}));
            if (r["state"].asString() != "Running")
                break;
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
        return r;
    }

    static std::vector<std::string> statuses(const Json::Value& run)
    {
        std::vector<std::string> s;
        for (const Json::Value& t : run["results"])
            s.push_back(t["function"].asString() + ":" + t["status"].asString());
        return s;
    }
};

} // namespace

TEST_F(Diagnostics, EachMethodSendsItsRequest)
{
    for (const Sent& s : diagnostics)
        EXPECT_EQ(json(s.request), sent(s.method, s.params, s.entry)) << s.method;
}

TEST_F(Diagnostics, PairsArePostedOneByOne)
{
    struct Test
    {
        const char* method;
        const char* function;
    };
    for (const Test& t : {Test{"diagnostics.doEchoTest", "EchoTest"}, Test{"diagnostics.doFCPingTest", "FCPingTest"},
                          Test{"diagnostics.doFCTraceRoute", "FCTraceTest"}})
    {
        ASSERT_EQ(0, dtruj_sim_set_echo("postDiagnostics"));
        Json::Value reply = result(t.method, "[\"4\",\"h\",[{\"vfID\":5,\"portWwn\":\"p1\",\"localPortWwn\":\"l1\","
            "\"remotePortWwn\":\"r1\"},{\"vfID\":-1,\"portWwn\":\"p2\"},{\"remotePortWwn\":\"r3\",\"other\":1}],7]");
        Json::Value calls = journal();
        ASSERT_EQ(3u, calls.size()) << t.method;
        const char* const expected[] = {
            "{\"vfID\":5,\"portWwn\":\"p1\",\"localPortWwn\":\"l1\",\"remotePortWwn\":\"r1\"}",
            "{\"vfID\":0,\"portWwn\":\"p2\",\"localPortWwn\":\"\",\"remotePortWwn\":\"\"}",
            "{\"vfID\":0,\"portWwn\":\"\",\"localPortWwn\":\"\",\"remotePortWwn\":\"r3\"}",
        };
        for (Json::ArrayIndex i = 0; i < 3; i++)
        {
            Json::Value want = json(expected[i]);
            want["function"] = t.function;
            want["requestID"] = "4";
            want["hbaWwn"] = "h";
            want["numCycles"] = 7;
            EXPECT_EQ(want, calls[i]["request"]) << t.method << " pair " << i;
        }
        // The last pair's reply is the result.
        EXPECT_EQ(calls[2], reply) << t.method;
    }
}

TEST_F(Diagnostics, PairsThatCantBePosted)
{
    ASSERT_EQ(0, dtruj_sim_set_echo("postDiagnostics"));
    EXPECT_TRUE(result("diagnostics.doEchoTest", "[\"4\",\"h\",[],1]").isNull());
    EXPECT_TRUE(result("diagnostics.doEchoTest", "[\"4\",\"h\",null,1]").isNull());
    // The cycles are read before the pairs are looked at.
    EXPECT_EQ(errorObject("JSONRPCError", 200, "Type is not convertible to int"),
        error("diagnostics.doFCPingTest", "[\"4\",\"h\",{},\"7\"]"));
    EXPECT_EQ(errorObject("USERDEFINEDError", 54, "Not a JSON array format."),
        error("diagnostics.doFCPingTest", "[\"4\",\"h\",{},7]"));
    EXPECT_EQ(errorObject("USERDEFINEDError", 55, "Not a JSON Object format."),
        error("diagnostics.doFCTraceRoute", "[\"4\",\"h\",[{\"portWwn\":\"p\"},\"p2\"],7]"));
    EXPECT_EQ(errorObject("JSONRPCError", 200, "Type is not convertible to int"),
        error("diagnostics.doFCTraceRoute", "[\"4\",\"h\",[{\"vfID\":\"2\"}],7]"));
    EXPECT_EQ(1u, journal().size()) << "only the pair before the bad one was posted";
    EXPECT_EQ(51, error("diagnostics.doEchoTest", "[\"4\",\"h\",[]]")["code"].asInt());

    // A library exception ends the loop at once.
    ASSERT_EQ(0, dtruj_sim_set_echo("postDiagnostics"));
    ASSERT_EQ(0, dtruj_sim_set_fault("postDiagnostics", "{\"kind\":\"hba\",\"code\":10,\"message\":\"busy\",\"count\":1}"));
    EXPECT_EQ(errorObject("USERDEFINEDError", 10, "busy"),
        error("diagnostics.doEchoTest", "[\"4\",\"h\",[{},{},{}],1]"));
    EXPECT_EQ(0u, journal().size());
}

TEST_F(Diagnostics, ARunFromPostToResults)
{
    std::string id = requestId();
    result("diagnostics.doQuickTest", params({id, FC_HBA}));
    Json::Value pairs = json("[{\"portWwn\":\"10:00:00:05:1e:8a:10:01\",\"localPortWwn\":\"10:00:00:05:1e:8a:10:01\","
        "\"remotePortWwn\":\"50:06:01:60:3b:20:1a:01\"}]");
    result("diagnostics.doFCTraceRoute", params({id, FC_HBA, pairs, 1}));
    result("diagnostics.doQueueTest", params({id, FC_HBA, FC_PORT1}));

    Json::Value run = result("diagnostics.getDiagnosticsResults", params({id}));
    EXPECT_EQ("NotStarted", run["state"].asString());
    EXPECT_EQ((std::vector<std::string>{"QuickTest:Queued", "FCTraceTest:Queued", "QueueTest:Queued"}), statuses(run));

    // Without stopOnError every test runs; the trace route of the default
    // host fails.
    result("diagnostics.startTests", params({id, false}));
    run = finished(id);
    EXPECT_EQ("Completed", run["state"].asString());
    EXPECT_EQ((std::vector<std::string>{"QuickTest:Passed", "FCTraceTest:Failed", "QueueTest:Passed"}), statuses(run));
    EXPECT_EQ("Trace route timed out at hop 2", run["results"][1]["output"].asString());

    // Started tests take no more; an id the library never gave is refused.
    EXPECT_TRUE(call("diagnostics.doQuickTest", params({id, FC_HBA})).isMember("error"));
    EXPECT_TRUE(call("diagnostics.getDiagnosticsResults", "[\"999999\"]").isMember("error"));
    // So is a test of a port that isn't there.
    EXPECT_TRUE(call("diagnostics.doQueueTest", params({requestId(), FC_HBA, "10:00:00:05:1e:ff:ff:ff"})).isMember("error"));

    // With stopOnError the tests after a failure are skipped.
    id = requestId();
    result("diagnostics.doFCTraceRoute", params({id, FC_HBA, pairs, 1}));
    result("diagnostics.doQuickTest", params({id, FC_HBA}));
    result("diagnostics.startTests", params({id, "yes"}));
    EXPECT_EQ((std::vector<std::string>{"FCTraceTest:Failed", "QuickTest:Skipped"}), statuses(finished(id)));
}

TEST_F(Diagnostics, ACancelledRun)
{
    Json::Value host = defaultHost();
    host["diagnostics"]["posted"]["MemoryTest"]["durationMs"] = 20000;
    useHost(host);

    std::string id = requestId();
    result("diagnostics.doMemoryTest", params({id, CNA}));
    result("diagnostics.doQuickTest", params({id, CNA}));
    result("diagnostics.startTests", params({id, false}));
    Json::Value run = result("diagnostics.getDiagnosticsResults", params({id}));
    EXPECT_EQ("Running", run["state"].asString());
    EXPECT_EQ((std::vector<std::string>{"MemoryTest:Running", "QuickTest:Queued"}), statuses(run));

    result("diagnostics.cancelTests", params({id}));
    run = finished(id);
    EXPECT_EQ("Cancelled", run["state"].asString());
    EXPECT_EQ((std::vector<std::string>{"MemoryTest:Cancelled", "QuickTest:Skipped"}), statuses(run));
}

TEST_F(Diagnostics, DportAndOptics)
{
    std::string id = requestId();
    EXPECT_TRUE(call("diagnostics.getDPortTestResults", params({FC_PORT1})).isMember("error"));
    result("diagnostics.dPortEnable", params({id, FC_PORT1, true}));
    EXPECT_TRUE(result("discovery.getAdvPortDataByPort", params({FC_PORT1}))["dportEnabled"].asBool());
    Json::Value r;
    for (int i = 0; i < 500; i++)
    {
        r = result("diagnostics.getDPortTestResults", params({FC_PORT1}));
        if (r["status"].asString() != "InProgress")
            break;
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
    EXPECT_EQ("Passed", r["status"].asString());
    // The second name does the same, here to leave D-port mode.
    result("diagnostics.doPOSTest", params({id, FC_PORT1, false}));
    EXPECT_FALSE(result("discovery.getAdvPortDataByPort", params({FC_PORT1}))["dportEnabled"].asBool());

    EXPECT_EQ("VSPR OPTICS", result("diagnostics.getOpticsSFP", params({FC_PORT0}))["vendorName"].asString());
    EXPECT_TRUE(result("diagnostics.getOpticsPOM", params({FC_PORT0})).isMember("temperature"));
}
