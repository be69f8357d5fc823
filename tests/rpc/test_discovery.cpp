// The discovery and statistics methods that do more than one call: the
// walks over the global information, the address that picks its key, the
// wrapped replies and the reset of several ports.

#include "RpcSupport.h"

using namespace rpc_test;

namespace
{

class Discovery : public RpcTest
{
protected:
    // The default host, with its global information overridden per adapter.
    static void useGlobalInfo(const char* adapter0, const char* adapter1 = "{}",
        const char* host = "{}")
    {
        Json::Value h = defaultHost();
        h["adapters"][0]["globalInfo"] = json(adapter0);
        h["adapters"][1]["globalInfo"] = json(adapter1);
        h["globalInfo"] = json(host);
        useHost(h);
    }

    static std::vector<std::string> members(const Json::Value& replies, const char* outer,
        const char* inner)
    {
        std::vector<std::string> out;
        for (const Json::Value& r : replies)
            out.push_back(r[outer][inner].asString());
        return out;
    }
};

} // namespace

TEST_F(Discovery, AddressLengthPicksTheKey)
{
    for (const char* method : {"discovery.getHbaByWwn", "discovery.getPortByWwn"})
    {
        const char* entry = std::string(method) == "discovery.getHbaByWwn" ? "getHbaByWwn" : "getPortByWwn";
        EXPECT_EQ(json("{\"wwn\":\"20:00:00:05:1e:8a:10:00\"}"),
            sent(method, "[\"20:00:00:05:1e:8a:10:00\"]", entry));
        EXPECT_EQ(json("{\"mac\":\"00:05:1e:8b:20:00\"}"), sent(method, "[\"00:05:1e:8b:20:00\"]", entry));
        for (const char* other : {"\"00051e8b2000\"", "\"00:05:1e:8b:20:0\"", "null"})
            EXPECT_TRUE(sent(method, (std::string("[") + other + "]").c_str(), entry).isMember("wwn"))
                << other;
    }

    // Both find the real thing by either key.
    EXPECT_EQ(CNA, result("discovery.getHbaByWwn", "[\"00:05:1e:8b:20:00\"]")["hbaData"]["indexStr"].asString());
    EXPECT_EQ(FC_PORT1, result("discovery.getPortByWwn", "[\"10:00:00:05:1e:8a:10:02\"]")["wwn"].asString());
}

TEST_F(Discovery, AllHbasOfTheHost)
{
    Json::Value all = result("discovery.getAllHbasByHost", "[]");
    ASSERT_EQ(2u, all.size());
    EXPECT_EQ((std::vector<std::string>{FC_HBA, CNA}), members(all, "hbaData", "indexStr"));
    EXPECT_EQ(all, result("discovery.getAllHbasByHost"));

    // The params go to the global information as they are.
    ASSERT_EQ(0, dtruj_sim_set_echo("getGlobalInfo"));
    result("discovery.getAllHbasByHost", "[1, {\"a\": 2}]");
    EXPECT_EQ(json("[{\"entry\":\"getGlobalInfo\",\"request\":[1,{\"a\":2}]}]"), journal());
}

TEST_F(Discovery, AdapterFlagsPickTheEntry)
{
    // CNA before FC; FC or FCoE by WWN; an Ethernet-only adapter by MAC;
    // no flag at all by WWN.
    struct Case
    {
        const char* flags;
        const char* entry;
        const char* request;
    };
    const Case cases[] = {
        {"{\"cna\":true,\"fc\":true,\"fcoe\":true,\"ethPort\":true}", "getHbaByMac", "{\"mac\":\"M\"}"},
        {"{\"cna\":false,\"fc\":true,\"fcoe\":false,\"ethPort\":true}", "getHbaByWwn", "{\"wwn\":\"W\"}"},
        {"{\"cna\":false,\"fc\":false,\"fcoe\":true,\"ethPort\":true}", "getHbaByWwn", "{\"wwn\":\"W\"}"},
        {"{\"cna\":false,\"fc\":false,\"fcoe\":false,\"ethPort\":true}", "getHbaByMac", "{\"mac\":\"M\"}"},
        {"{\"cna\":false,\"fc\":false,\"fcoe\":false,\"ethPort\":false}", "getHbaByWwn", "{\"wwn\":\"W\"}"},
        {"{\"cna\":null,\"fc\":null,\"fcoe\":null,\"ethPort\":null,\"wwn\":null}", "getHbaByWwn", "{\"wwn\":null}"},
    };
    for (const Case& c : cases)
    {
        Json::Value flags = json(c.flags);
        if (!flags.isMember("wwn"))
            flags["wwn"] = "W";
        flags["mac"] = "M";
        useGlobalInfo(Json::FastWriter().write(flags).c_str());
        ASSERT_EQ(0, dtruj_sim_set_echo("getHbaByWwn,getHbaByMac"));
        Json::Value all = result("discovery.getAllHbasByHost", "[]");
        ASSERT_EQ(2u, all.size()) << c.flags;
        EXPECT_EQ(c.entry, all[0]["entry"].asString()) << c.flags;
        EXPECT_EQ(json(c.request), all[0]["request"]) << c.flags;
        EXPECT_EQ("getHbaByMac", all[1]["entry"].asString()) << "the CNA of the default host";
    }
}

TEST_F(Discovery, AllHbasOnAnOddGlobalInformation)
{
    // No adapters, or none that the library will tell of: a null result.
    useGlobalInfo("{}", "{}", "{\"numOfAdapters\":0}");
    EXPECT_TRUE(result("discovery.getAllHbasByHost", "[]").isNull());
    for (const char* kind : {"null", "error"})
    {
        useDefaultHost();
        ASSERT_EQ(0, dtruj_sim_set_fault("getGlobalInfo", kind));
        EXPECT_TRUE(result("discovery.getAllHbasByHost", "[]").isNull()) << kind;
        EXPECT_TRUE(result("discovery.getAllPortsByHba", "[\"20:00:00:05:1e:8a:10:00\"]").isNull()) << kind;
    }

    // A count beyond the adapters listed walks the listed ones.
    useGlobalInfo("{}", "{}", "{\"numOfAdapters\":4000000000}");
    EXPECT_EQ(2u, result("discovery.getAllHbasByHost", "[]").size());
    useGlobalInfo("{}", "{}", "{\"numOfAdapters\":1}");
    EXPECT_EQ(1u, result("discovery.getAllHbasByHost", "[]").size());
    for (const char* odd : {"{\"numOfAdapters\":\"2\"}", "{\"numOfAdapters\":2,\"adapter\":{\"0\":1}}",
                            "{\"numOfAdapters\":-2}", "{\"adapter\":null}"})
    {
        useGlobalInfo("{}", "{}", odd);
        EXPECT_TRUE(result("discovery.getAllHbasByHost", "[]").isNull()) << odd;
    }

    // A failing adapter's "error" stays an element.
    useDefaultHost();
    ASSERT_EQ(0, dtruj_sim_set_fault("getHbaByWwn", "error"));
    Json::Value all = result("discovery.getAllHbasByHost", "[]");
    ASSERT_EQ(2u, all.size());
    EXPECT_TRUE(all[0].isMember("error"));
    EXPECT_EQ(CNA, all[1]["hbaData"]["indexStr"].asString());
}

TEST_F(Discovery, AllPortsOfAnAdapter)
{
    Json::Value ports = result("discovery.getAllPortsByHba", "[\"20:00:00:05:1E:8A:10:00\"]");
    std::vector<std::string> wwns;
    for (const Json::Value& p : ports)
        wwns.push_back(p["wwn"].asString());
    EXPECT_EQ((std::vector<std::string>{FC_PORT0, FC_PORT1}), wwns);

    // A CNA by its MAC: the FCoE port by its WWN, the Ethernet port by MAC.
    ASSERT_EQ(0, dtruj_sim_set_echo("getPortByWwn"));
    ports = result("discovery.getAllPortsByHba", "[\"00:05:1E:8B:20:00\"]");
    ASSERT_EQ(2u, ports.size());
    EXPECT_EQ(json("{\"wwn\":\"10:00:00:05:1e:8b:20:01\"}"), ports[0]["request"]);
    EXPECT_EQ(json("{\"mac\":\"00:05:1e:8b:20:02\"}"), ports[1]["request"]);
    // The global information was asked with the console's params.
    ASSERT_EQ(0, dtruj_sim_set_echo("getGlobalInfo"));
    result("discovery.getAllPortsByHba", "[\"00:05:1e:8b:20:00\"]");
    EXPECT_EQ(json("[\"00:05:1e:8b:20:00\"]"), journal()[0]["request"]);

    // No adapter has the key (an empty key names none): a null result.
    for (const char* key : {"\"20:00:00:05:1e:8a:99:99\"", "\"\"", "null"})
        EXPECT_TRUE(result("discovery.getAllPortsByHba", (std::string("[") + key + "]").c_str()).isNull())
            << key;
}

TEST_F(Discovery, PortFlagsPickTheRequest)
{
    // An FCoE-only port by its FCoE MAC; a port with no flag still costs a
    // call, with a null request; the first adapter matching by MAC or WWN.
    useGlobalInfo("{\"numOfPorts\":3,\"portHasFc\":[false,false,false],\"portHasEth\":[false,true,false],"
        "\"portHasFcoe\":[true,true,false],\"portWwn\":[\"a\",\"b\",\"c\"],\"portMac\":[\"d\",\"e\",\"f\"],"
        "\"fcoeMac\":[\"g\",\"h\",\"i\"],\"mac\":\"00:05:1e:8b:20:00\"}");
    ASSERT_EQ(0, dtruj_sim_set_echo("getPortByWwn"));
    Json::Value ports = result("discovery.getAllPortsByHba", "[\"00:05:1e:8b:20:00\"]");
    ASSERT_EQ(3u, ports.size());
    EXPECT_EQ(json("{\"mac\":\"g\"}"), ports[0]["request"]);
    EXPECT_EQ(json("{\"mac\":\"e\"}"), ports[1]["request"]);
    EXPECT_TRUE(ports[2]["request"].isNull());

    // A port count beyond the per-port lists walks the lists.
    useGlobalInfo("{\"numOfPorts\":100000}");
    ASSERT_EQ(0, dtruj_sim_set_echo("getPortByWwn"));
    EXPECT_EQ(2u, result("discovery.getAllPortsByHba", "[\"20:00:00:05:1e:8a:10:00\"]").size());
}

TEST_F(Discovery, PortsThatFailAreLeftOut)
{
    const char* hba = "[\"20:00:00:05:1e:8a:10:00\"]";
    ASSERT_EQ(0, dtruj_sim_set_fault("getPortByWwn", "{\"kind\":\"hba\",\"count\":1}"));
    Json::Value ports = result("discovery.getAllPortsByHba", hba);
    ASSERT_EQ(1u, ports.size());
    EXPECT_EQ(FC_PORT1, ports[0]["wwn"].asString());

    // An "error" reply isn't a failure here; an exception of another kind
    // isn't caught.
    ASSERT_EQ(0, dtruj_sim_set_fault("getPortByWwn", "{\"kind\":\"error\",\"count\":1}"));
    EXPECT_TRUE(result("discovery.getAllPortsByHba", hba)[0].isMember("error"));
    ASSERT_EQ(0, dtruj_sim_set_fault("getPortByWwn", "{\"kind\":\"std\",\"message\":\"driver gone\"}"));
    EXPECT_EQ(errorObject("JSONRPCError", 200, "driver gone"), error("discovery.getAllPortsByHba", hba));

    Json::Value none = errorObject("JSONRPCError", 200, "Unable to find any Port attributes");
    ASSERT_EQ(0, dtruj_sim_set_fault("getPortByWwn", "hba"));
    EXPECT_EQ(none, error("discovery.getAllPortsByHba", hba));
    ASSERT_EQ(0, dtruj_sim_set_fault("getPortByWwn", nullptr));

    // An adapter without ports has none to find either.
    useGlobalInfo("{\"numOfPorts\":0}");
    EXPECT_EQ(none, error("discovery.getAllPortsByHba", hba));
}

TEST_F(Discovery, WrappedReplies)
{
    Json::Value bare = result("discovery.getFcoeByPort", "[\"10:00:00:05:1e:8b:20:01\"]");
    Json::Value wrapped = result("discovery.getAllFcoeByPort", "[\"10:00:00:05:1e:8b:20:01\"]");
    ASSERT_TRUE(wrapped.isArray());
    ASSERT_EQ(1u, wrapped.size());
    EXPECT_EQ(bare, wrapped[0]);
    EXPECT_EQ(1u, result("discovery.getAllFcByPort", "[\"10:00:00:05:1e:8a:10:01\"]").size());

    // The library's "error" stays inside the array.
    wrapped = result("discovery.getAllFcoeByPort", "[\"10:00:00:05:1e:8a:10:01\"]");
    ASSERT_EQ(1u, wrapped.size());
    EXPECT_TRUE(wrapped[0].isMember("error")) << "not an FCoE port";
    EXPECT_TRUE(call("discovery.getFcoeByPort", "[\"10:00:00:05:1e:8a:10:01\"]").isMember("error"));
}

TEST_F(Discovery, RequestIds)
{
    Json::Value first = result("diagnostics.getRequestID", "[\"ignored\", 5]");
    ASSERT_TRUE(first.isInt());
    EXPECT_EQ(first.asInt() + 1, result("diagnostics.getRequestID", "{\"any\":1}").asInt());
    EXPECT_EQ(first.asInt() + 2, result("diagnostics.getRequestID").asInt());

    // What the default stub answers, as a plain result.
    ASSERT_EQ(0, dtruj_sim_set_fault("getRequestID", "null"));
    EXPECT_EQ(-1, result("diagnostics.getRequestID").asInt());
}

TEST_F(Discovery, ResetOfSeveralPorts)
{
    const char* two = "[[\"10:00:00:05:1e:8a:10:01\",\"10:00:00:05:1e:8a:10:02\"]]";
    Json::Value all = result("configuration.resetStatisticsForPorts", two);
    ASSERT_EQ(2u, all.size());
    EXPECT_EQ(0, all[0]["status"].asInt());

    ASSERT_EQ(0, dtruj_sim_set_echo("resetStatisticsForPort"));
    all = result("configuration.resetStatisticsForPorts", two);
    EXPECT_EQ(json("{\"indexStr\":\"10:00:00:05:1e:8a:10:02\"}"), all[1]["request"]);
    dtruj_sim_set_echo(nullptr);

    // A port that throws is left out; an "error" reply is kept.
    ASSERT_EQ(0, dtruj_sim_set_fault("resetStatisticsForPort", "{\"kind\":\"hba\",\"count\":1}"));
    all = result("configuration.resetStatisticsForPorts", two);
    ASSERT_EQ(1u, all.size());
    EXPECT_TRUE(all[0].isMember("status"));
    EXPECT_EQ(2u, result("configuration.resetStatisticsForPorts", "[[\"nowhere\",\"10:00:00:05:1e:8a:10:02\"]]").size());

    Json::Value none = errorObject("JSONRPCError", 200, "Couldnt reset any of the port statistics");
    ASSERT_EQ(0, dtruj_sim_set_fault("resetStatisticsForPort", "hba"));
    EXPECT_EQ(none, error("configuration.resetStatisticsForPorts", two));
    ASSERT_EQ(0, dtruj_sim_set_fault("resetStatisticsForPort", nullptr));
    EXPECT_EQ(none, error("configuration.resetStatisticsForPorts", "[[]]"));
    EXPECT_EQ(none, error("configuration.resetStatisticsForPorts", "[null]"));
    EXPECT_EQ(errorObject("USERDEFINEDError", 54, "Not a JSON array format."),
        error("configuration.resetStatisticsForPorts", "[\"10:00:00:05:1e:8a:10:01\"]"));

    // With no library behind the entry: one null per port.
    ASSERT_EQ(0, dtruj_sim_set_fault("resetStatisticsForPort", "null"));
    EXPECT_EQ(json("[null,null]"), result("configuration.resetStatisticsForPorts", two));
    ASSERT_EQ(0, dtruj_sim_set_fault("resetStatisticsForPort", nullptr));

    // An element that isn't text ends the call; the ports before it stay reset.
    ASSERT_EQ(0, dtruj_sim_set_echo("resetStatisticsForPort"));
    EXPECT_EQ(errorObject("JSONRPCError", 200, "Type is not convertible to string"),
        error("configuration.resetStatisticsForPorts", "[[\"10:00:00:05:1e:8a:10:01\", 7, \"x\"]]"));
    EXPECT_EQ(1u, journal().size());
}

TEST_F(Discovery, ResetStatisticsShowInTheCounters)
{
    const char* port = "[\"10:00:00:05:1e:8a:10:01\"]";
    EXPECT_GE(result("discovery.getPortStatistics", port)["secondsSinceReset"].asUInt(), 3600u);
    result("configuration.resetStatisticsForPort", port);
    EXPECT_LE(result("discovery.getPortStatistics", port)["secondsSinceReset"].asUInt(), 1u);
    // The fabric's reading and resetting keys differ, and both reach it.
    EXPECT_TRUE(result("discovery.getDynamicFabricStatistics", port).isMember("flogiSent"));
    EXPECT_EQ(0, result("configuration.resetStatisticsForFabric", port)["status"].asInt());
}
