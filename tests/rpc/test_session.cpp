// A console's typical session on one host, as the README shows it:
// discovery, configuration and diagnostics mixed, each call seeing what the
// ones before it changed.

#include <chrono>
#include <thread>

#include "RpcSupport.h"

using namespace rpc_test;

namespace
{

class Session : public RpcTest
{
protected:
    int _id = 0;

    // One request as a console writes it, with the next id; the reply
    // must carry that id and a result.
    Json::Value step(const std::string& method, const std::string& params)
    {
        _id++;
        std::string request = "{\"method\":\"" + method + "\",\"params\":" + params +
            ",\"id\":" + std::to_string(_id) + "}";
        Json::Value reply = json(send(request));
        EXPECT_EQ(_id, reply["id"].asInt()) << request;
        EXPECT_EQ("1.1", reply["version"].asString());
        EXPECT_FALSE(reply.isMember("error")) << request << "\n" << reply.toStyledString();
        return reply["result"];
    }
};

} // namespace

TEST_F(Session, DiscoverConfigureAndTest)
{
    const std::string hba = "\"20:00:00:05:1e:8a:10:00\"";
    const std::string port0 = "\"10:00:00:05:1e:8a:10:01\"";
    const std::string port1 = "\"10:00:00:05:1e:8a:10:02\"";
    const std::string disks = "\"50:06:01:60:3b:20:1a:01\"";
    size_t logicalDisks = served("VESPERA_LogicalDisk").size();

    // What is there.
    EXPECT_EQ(2, step("discovery.getHost", "[]")["numOfAdapters"].asInt());
    EXPECT_EQ(2u, step("discovery.getAllHbasByHost", "[]").size());
    EXPECT_EQ(2u, step("discovery.getAllPortsByHba", "[" + hba + "]").size());
    EXPECT_EQ(11, step("discovery.getPortByWwn", "[" + port0 + "]")["portStatusValue"].asInt());
    EXPECT_EQ(4u, step("discovery.getAllRemotePorts", "[" + port0 + ",\"\"]").size());
    EXPECT_EQ(3u, step("discovery.getAllLunsByRemotePort", "[" + port0 + ",\"\"," + disks + "]").size());

    // A name, a virtual port for a guest, and only LUN 0 of the array.
    step("configuration.setAlias", "[{\"type\":\"Port\",\"wwn\":" + port0 + ",\"alias\":\"backup-a\"}]");
    std::string vwwn = step("configuration.createVPort", "[" + port0 + ",\"\",\"\",\"vm-backup\"]")["vwwn"].asString();
    EXPECT_EQ(23u, vwwn.size());
    EXPECT_EQ(2u, step("discovery.getAllVPorts", "[" + port0 + "]").size());
    step("configuration.setLunMaskDataForPort",
        "[" + port0 + ",{\"addedLunMaskData\":[{\"rPortWwn\":" + disks + ",\"lunId\":\"0\"}]}]");
    EXPECT_EQ(1u, step("discovery.getAllLunsByRemotePort", "[" + port0 + ",\"\"," + disks + "]").size());
    EXPECT_EQ(22u, step("discovery.getDynamicPortStatistics", "[" + port0 + "]").size());
    EXPECT_EQ(2u, step("configuration.resetStatisticsForPorts", "[[" + port0 + "," + port1 + "]]").size());

    // A run of two tests; the loopback wants its port offline.
    std::string id = "\"" + std::to_string(step("diagnostics.getRequestID", "[]").asInt()) + "\"";
    step("configuration.setPortByWwn", "[" + port1 + ",{\"portStatus\":false},[\"portStatus\"]]");
    step("diagnostics.doLoopbackTest", "[" + id + ",null," + port1 + ",0,0,1,\"256\",\"a5a5a5a5\"]");
    step("diagnostics.doEchoTest", "[" + id + "," + hba + ",[{\"portWwn\":" + port0 + ",\"localPortWwn\":" +
        port0 + ",\"remotePortWwn\":" + disks + "}],2]");
    step("diagnostics.startTests", "[" + id + ",true]");
    Json::Value run;
    for (int i = 0; i < 500; i++)
    {
        run = step("diagnostics.getDiagnosticsResults", "[" + id + "]");
        if (run["state"].asString() != "Running")
            break;
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
    }
    EXPECT_EQ("Completed", run["state"].asString());
    ASSERT_EQ(2u, run["results"].size());
    EXPECT_EQ("Passed", run["results"][0]["status"].asString());
    EXPECT_EQ("Passed", run["results"][1]["status"].asString());
    step("configuration.setPortByWwn", "[" + port1 + ",{\"portStatus\":true},[\"portStatus\"]]");

    // The alias, the virtual port and the mask stay; then the mask goes.
    Json::Value port = step("discovery.getPortByWwn", "[" + port0 + "]");
    EXPECT_EQ("backup-a", port["alias"].asString());
    EXPECT_EQ(2, port["numOfVports"].asInt());
    EXPECT_EQ(logicalDisks - 2, served("VESPERA_LogicalDisk").size());
    step("configuration.setLunMaskDataForPort", "[" + port0 + ",{\"clearLunMaskData\":true}]");
    EXPECT_EQ(logicalDisks, served("VESPERA_LogicalDisk").size());
    EXPECT_EQ(11, step("discovery.getPortByWwn", "[" + port1 + "]")["portStatusValue"].asInt());
    EXPECT_GE(_id, 20);
}
