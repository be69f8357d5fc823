// The method catalogue: every name, what each method of the common form
// sends the library, the count check and the reading of each type.

#include <set>

#include "RpcSupport.h"

using namespace rpc_test;

namespace
{

const char* const allMethods[] = {
    "discovery.getHost", "discovery.getGlobalInfo", "discovery.getHbaByWwn",
    "discovery.getAllHbasByHost", "discovery.getAllPortsByHba", "discovery.getPortByWwn",
    "discovery.getFcByFcWwn", "discovery.getAllFcByPort", "discovery.getPortAuthentication",
    "discovery.getAllRemotePorts", "discovery.getCompleteRemotePort",
    "discovery.getAllLunsByRemotePort", "discovery.getAllVPorts", "discovery.getVPort",
    "discovery.getServerTime", "discovery.getBootOverSanByPort", "discovery.getAdvPortDataByPort",
    "discovery.getFcoeByPort", "discovery.getFcoeByFcoeWwn", "discovery.getAllFcoeByPort",
    "discovery.getCompleteEthByPort", "discovery.getCompleteEthByEthMac",
    "discovery.getAllEthByPort", "discovery.getLldp", "discovery.getCee",
    "discovery.getDriverUpdateStatusLog", "discovery.getLunMaskDataByPort",
    "discovery.getAdvAdapterData", "discovery.getAllPCIFunctions", "discovery.getAdvancedIoProfile",
    "discovery.getPortStatistics", "discovery.getDynamicQosStatistics",
    "discovery.getDynamicPortStatistics", "discovery.getDynamicRemotePortStatistics",
    "discovery.getDynamicVportStatistics", "discovery.getDynamicLogicalPortStatistics",
    "discovery.getDynamicFcpimIOPStatistics", "discovery.getDynamicFcpimStatistics",
    "discovery.getDynamicFabricStatistics", "discovery.getDynamicPortAuthenticationStatistics",
    "discovery.getDynamicIocStatistics", "discovery.getDynamicFcoeStatistics",
    "discovery.getDynamicFcpimModStatistics", "discovery.getDynamicFirmwareStatistics",
    "discovery.getDynamicTrunkingStatistics", "discovery.getDynamicEthernetPortStatistics",
    "discovery.getDynamicIOCEthernetStatistics", "discovery.getDynamicvHBAStatistics",
    "discovery.getDynamicvNICStatistics", "discovery.getDynamicvNICStatisticsForGraph",
    "discovery.getDynamicLldpStatistics", "discovery.getDynamicAdvancedIoDataAtPPort",
    "discovery.getDynamicAdvancedIoDataAtLPort", "discovery.getDynamicAdvancedIoDataAtRPort",
    "discovery.getDynamicAdvancedIoDataAtLun",
    "configuration.createVPort", "configuration.deleteVPort", "configuration.setAlias",
    "configuration.setAliases", "configuration.setPortByWwn", "configuration.setPortAuthentication",
    "configuration.setFcByFcWwn", "configuration.setHbaStatus", "configuration.setFCTrunkingState",
    "configuration.setFcoeByFcoeWwn", "configuration.setFcoePort", "configuration.setEthPort",
    "configuration.clearLogsForPort", "configuration.setAdapterMode",
    "configuration.setLunMaskDataForPort", "configuration.setAdvancedIoProfile",
    "configuration.clearAdvancedIoProfilesAtPort", "configuration.clearAdvancedIoProfilesAtLogicalPort",
    "configuration.clearAdvancedIoProfilesAtRemotePort", "configuration.clearAdvancedIoProfileOfLun",
    "configuration.resetDataForAdvancedIoAtPPort", "configuration.resetDataForAdvancedIoAtLPort",
    "configuration.resetDataForAdvancedIoAtRPort", "configuration.resetDataForAdvancedIoAtLun",
    "configuration.resetDataForAdvancedIoForLunRange", "configuration.createVnic",
    "configuration.deleteVnics", "configuration.modifyVnic", "configuration.resetPortAuthentication",
    "configuration.resetStatisticsForPortAuthentication", "configuration.resetStatisticsForPorts",
    "configuration.resetStatisticsForPort", "configuration.resetStatisticsForLPort",
    "configuration.resetStatisticsForVPort", "configuration.resetStatisticsForRPort",
    "configuration.resetStatisticsForFcpim", "configuration.resetStatisticsForIoc",
    "configuration.resetStatisticsForFabric", "configuration.resetStatisticsForQos",
    "configuration.resetFirmwareStatistics", "configuration.resetTrunkingStatistics",
    "configuration.resetLldpStatistics", "configuration.resetIOCEthernetStatistics",
    "configuration.resetEthernetPortStatistics", "configuration.resetvNICStatistics",
    "configuration.resetFcoeStatistics", "configuration.resetvHBAStatistics",
    "configuration.resetStatisticsForFcpimMod",
    "diagnostics.startTests", "diagnostics.cancelTests", "diagnostics.doQuickTest",
    "diagnostics.doPOSTest", "diagnostics.doEchoTest", "diagnostics.doMemoryTest",
    "diagnostics.doPCILoopbackTest", "diagnostics.doLoopbackTest", "diagnostics.doLEDTest",
    "diagnostics.doFCPingTest", "diagnostics.doFCTraceRoute", "diagnostics.doEthLoopbackTest",
    "diagnostics.doQueueTest", "diagnostics.getOpticsPOM", "diagnostics.getOpticsSFP",
    "diagnostics.getRequestID", "diagnostics.getDiagnosticsResults", "diagnostics.dPortEnable",
    "diagnostics.doDportTest", "diagnostics.getDPortTestResults",
};

// What a method of the common form hands its library entry.
struct Sent
{
    const char* method;
    const char* params;
    const char* entry;
    const char* request;
};

const Sent discoveryAndStatistics[] = {
    {"discovery.getFcByFcWwn", "[\"w\"]", "getFcByFcWwn", "{\"wwn\":\"w\"}"},
    {"discovery.getPortAuthentication", "[\"w\"]", "getPortAuthentication", "{\"wwn\":\"w\"}"},
    {"discovery.getAllRemotePorts", "[\"p\",\"l\"]", "getAllRemotePorts",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\"}"},
    {"discovery.getCompleteRemotePort", "[\"p\",\"l\",\"r\"]", "getCompleteRemotePort",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\"}"},
    {"discovery.getAllLunsByRemotePort", "[\"p\",\"l\",\"r\"]", "getAllLunsByRemotePort",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\"}"},
    {"discovery.getAllVPorts", "[\"w\"]", "getAllVPorts", "{\"wwn\":\"w\"}"},
    {"discovery.getVPort", "[\"p\",\"l\"]", "getVPort", "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\"}"},
    {"discovery.getBootOverSanByPort", "[\"i\"]", "getBootOverSanByPort", "{\"indexStr\":\"i\"}"},
    {"discovery.getAdvPortDataByPort", "[\"i\"]", "getAdvPortDataByPort", "{\"indexStr\":\"i\"}"},
    {"discovery.getFcoeByPort", "[\"i\"]", "getFcoeByPort", "{\"indexStr\":\"i\"}"},
    {"discovery.getFcoeByFcoeWwn", "[\"i\"]", "getFcoeByPort", "{\"indexStr\":\"i\"}"},
    {"discovery.getCompleteEthByPort", "[\"m\"]", "getEthPortByEthMac", "{\"mac\":\"m\"}"},
    {"discovery.getCompleteEthByEthMac", "[\"m\"]", "getEthPortByEthMac", "{\"mac\":\"m\"}"},
    {"discovery.getAllEthByPort", "[\"m\"]", "getAllEthPortByEthMac", "{\"mac\":\"m\"}"},
    {"discovery.getLldp", "[\"m\"]", "getLldp", "{\"mac\":\"m\"}"},
    {"discovery.getCee", "[\"m\"]", "getCee", "{\"mac\":\"m\"}"},
    {"discovery.getLunMaskDataByPort", "[\"i\"]", "getLunMaskData", "{\"indexStr\":\"i\"}"},
    {"discovery.getAdvAdapterData", "[\"i\"]", "getAdvAdapterData", "{\"indexStr\":\"i\"}"},
    {"discovery.getAllPCIFunctions", "[\"i\"]", "getAdapterPciFnData", "{\"indexStr\":\"i\"}"},
    {"discovery.getAdvancedIoProfile", "[\"i\"]", "getAdvIoProfile", "{\"indexStr\":\"i\"}"},
    {"discovery.getPortStatistics", "[\"i\"]", "getPortStatistics", "{\"indexStr\":\"i\"}"},
    {"discovery.getDynamicQosStatistics", "[\"p\"]", "getDynamicQosStatistics",
     "{\"pPortWwn\":\"p\"}"},
    {"discovery.getDynamicPortStatistics", "[\"i\"]", "getDynamicPortStatistics",
     "{\"indexStr\":\"i\"}"},
    {"discovery.getDynamicRemotePortStatistics", "[\"p\",\"l\",\"r\"]", "getDynamicRPortStatistics",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\",\"vfId\":0}"},
    {"discovery.getDynamicVportStatistics", "[\"p\",\"l\"]", "getDynamicVPortStatistics",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"vfId\":0}"},
    {"discovery.getDynamicLogicalPortStatistics", "[\"p\",\"l\"]", "getDynamicLogicalPortStatistics",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"vfId\":0}"},
    {"discovery.getDynamicFcpimIOPStatistics", "[\"p\",\"l\",\"r\"]", "getDynamicFcpimIopStatistics",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\",\"vfId\":0}"},
    {"discovery.getDynamicFcpimStatistics", "[\"p\",\"l\",\"r\"]", "getDynamicFcpimStatistics",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\"}"},
    {"discovery.getDynamicFabricStatistics", "[\"w\"]", "getDynamicFabricStatistics",
     "{\"wwn\":\"w\",\"vfID\":0}"},
    {"discovery.getDynamicPortAuthenticationStatistics", "[\"p\"]", "getDynamicPortAuthStatistics",
     "{\"pPortWwn\":\"p\"}"},
    {"discovery.getDynamicIocStatistics", "[\"w\"]", "getDynamicIocStatistics", "{\"pwwn\":\"w\"}"},
    {"discovery.getDynamicFcoeStatistics", "[\"i\"]", "getDynamicFcoeStatistics",
     "{\"indexStr\":\"i\"}"},
    {"discovery.getDynamicFcpimModStatistics", "[\"i\"]", "getDynamicFcpimModStatistics",
     "{\"indexStr\":\"i\"}"},
    {"discovery.getDynamicFirmwareStatistics", "[\"i\"]", "getDynamicFirmwareStatistics",
     "{\"indexStr\":\"i\"}"},
    {"discovery.getDynamicTrunkingStatistics", "[\"i\"]", "getDynamicTrunkingStatistics",
     "{\"indexStr\":\"i\"}"},
    {"discovery.getDynamicEthernetPortStatistics", "[\"m\"]", "getDynamicEthernetPortStatistics",
     "{\"mac\":\"m\"}"},
    {"discovery.getDynamicIOCEthernetStatistics", "[\"m\"]", "getDynamicIOCEthernetStatistics",
     "{\"mac\":\"m\"}"},
    {"discovery.getDynamicvHBAStatistics", "[\"w\"]", "getDynamicvHBAStatistics", "{\"wwn\":\"w\"}"},
    {"discovery.getDynamicvNICStatistics", "[\"m\"]", "getDynamicvNICStatistics", "{\"mac\":\"m\"}"},
    {"discovery.getDynamicvNICStatisticsForGraph", "[\"m\"]", "getDynamicvNICStatisticsForGraph",
     "{\"mac\":\"m\"}"},
    {"discovery.getDynamicLldpStatistics", "[\"m\"]", "getDynamicLldpStatistics", "{\"mac\":\"m\"}"},
    {"discovery.getDynamicAdvancedIoDataAtPPort", "[\"p\"]", "getDynamicAdvancedIoDataAtPPort",
     "{\"pPortWwn\":\"p\",\"vfId\":0}"},
    {"discovery.getDynamicAdvancedIoDataAtLPort", "[\"p\",\"l\"]", "getDynamicAdvancedIoDataAtLPort",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"vfId\":0}"},
    {"discovery.getDynamicAdvancedIoDataAtRPort", "[\"p\",\"l\",\"r\"]",
     "getDynamicAdvancedIoDataAtRPort",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\",\"vfId\":0}"},
    {"discovery.getDynamicAdvancedIoDataAtLun", "[\"p\",\"l\",\"r\",\"7\"]",
     "getDynamicAdvancedIoDataAtLun",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\",\"lunId\":\"7\",\"vfId\":0}"},
    {"configuration.resetStatisticsForPortAuthentication", "[\"w\"]", "resetStatisticsForPortAuth",
     "{\"wwn\":\"w\"}"},
    {"configuration.resetStatisticsForPort", "[\"i\"]", "resetStatisticsForPort",
     "{\"indexStr\":\"i\"}"},
    {"configuration.resetStatisticsForLPort", "[\"p\",\"l\"]", "resetStatisticsForLPort",
     "{\"pwwn\":\"p\",\"lwwn\":\"l\",\"vfId\":0}"},
    {"configuration.resetStatisticsForVPort", "[\"p\",\"v\"]", "resetStatisticsForVPort",
     "{\"pwwn\":\"p\",\"vwwn\":\"v\",\"vfId\":0}"},
    {"configuration.resetStatisticsForRPort", "[\"p\",\"l\",\"r\"]", "resetStatisticsForRPort",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\",\"vfId\":0}"},
    {"configuration.resetStatisticsForFcpim", "[\"p\",\"l\",\"r\"]", "resetStatisticsForFcpim",
     "{\"pPortWwn\":\"p\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\",\"vfId\":0}"},
    {"configuration.resetStatisticsForIoc", "[\"w\"]", "resetStatisticsForIoc", "{\"pwwn\":\"w\"}"},
    {"configuration.resetStatisticsForFabric", "[\"w\"]", "resetStatisticsForFabric",
     "{\"pwwn\":\"w\",\"vfId\":0}"},
    {"configuration.resetStatisticsForQos", "[\"p\"]", "resetStatisticsForQos", "{\"pPortWwn\":\"p\"}"},
    {"configuration.resetFirmwareStatistics", "[\"i\"]", "resetFirmwareStatistics",
     "{\"indexStr\":\"i\"}"},
    {"configuration.resetTrunkingStatistics", "[\"i\"]", "resetTrunkingStatistics",
     "{\"indexStr\":\"i\"}"},
    {"configuration.resetLldpStatistics", "[\"m\"]", "resetLldpStatistics", "{\"mac\":\"m\"}"},
    {"configuration.resetIOCEthernetStatistics", "[\"m\"]", "resetIOCEthernetStatistics",
     "{\"mac\":\"m\"}"},
    {"configuration.resetEthernetPortStatistics", "[\"m\"]", "resetEthernetPortStatistics",
     "{\"mac\":\"m\"}"},
    {"configuration.resetvNICStatistics", "[\"m\"]", "resetvNICStatistics", "{\"mac\":\"m\"}"},
    {"configuration.resetFcoeStatistics", "[\"i\"]", "resetFcoeStatistics", "{\"indexStr\":\"i\"}"},
    {"configuration.resetvHBAStatistics", "[\"w\"]", "resetvHBAStatistics", "{\"wwn\":\"w\"}"},
    {"configuration.resetStatisticsForFcpimMod", "[\"i\"]", "resetStatisticsForFcpimMod",
     "{\"indexStr\":\"i\"}"},
};

class Catalogue : public RpcTest
{
protected:
    void expectSent(const Sent* rows, size_t n)
    {
        for (size_t i = 0; i < n; i++)
            EXPECT_EQ(json(rows[i].request), sent(rows[i].method, rows[i].params, rows[i].entry))
                << rows[i].method;
    }
};

} // namespace

TEST_F(Catalogue, EveryNameIsServed)
{
    std::set<std::string> names(std::begin(allMethods), std::end(allMethods));
    ASSERT_EQ(123u, names.size());

    // The echo keeps every call from acting on the host.
    ASSERT_EQ(0, dtruj_sim_set_echo("*"));
    for (const char* name : allMethods)
        EXPECT_NE(105, call(name)["error"]["code"].asInt()) << name;
}

TEST_F(Catalogue, DiscoveryAndStatisticsSendTheirRows)
{
    expectSent(discoveryAndStatistics, sizeof(discoveryAndStatistics) / sizeof(discoveryAndStatistics[0]));

    // The methods that hand their params over unread, whatever they are.
    for (const char* params : {"[]", "[1,\"a\"]", "{\"x\":true}", "\"text\""})
    {
        EXPECT_EQ(json(params), sent("discovery.getHost", params, "getHost")) << params;
        EXPECT_EQ(json(params), sent("discovery.getGlobalInfo", params, "getGlobalInfo"));
        EXPECT_EQ(json(params), sent("discovery.getServerTime", params, "getServerTime"));
        EXPECT_EQ(json(params), sent("discovery.getDriverUpdateStatusLog", params,
            "getDriverUpdateStatus"));
    }
    ASSERT_EQ(0, dtruj_sim_set_echo("getHost"));
    EXPECT_TRUE(result("discovery.getHost")["request"].isNull());
}

TEST_F(Catalogue, CountCheck)
{
    Json::Value mismatch = errorObject("USERDEFINEDError", 51, "Mismatch in number of parameters.");
    struct Case
    {
        const char* method;
        const char* params;     // null: no "params" member
        const char* line;
    };
    const Case cases[] = {
        {"discovery.getCee", nullptr, "Expected : 1, Actual : 0, function : getCee "},
        {"discovery.getCee", "\"00:05:1e:8b:20:02\"", "Expected : 1, Actual : 0, function : getCee "},
        {"discovery.getCee", "[\"a\",\"b\"]", "Expected : 1, Actual : 2, function : getCee "},
        {"configuration.setFcoeByFcoeWwn", "[\"a\",{}]", "Expected : 3, Actual : 2, function : setFcByFcWwn "},
        {"discovery.getDynamicRemotePortStatistics", "[]",
         "Expected : 3, Actual : 0, function : getDynamicRPortStatistics "},
        {"diagnostics.getDPortTestResults", "[1,2]",
         "Expected : 1, Actual : 2, function : getDPortTestResult "},
        {"diagnostics.doLoopbackTest", "[\"1\",null,\"p\",1,1,1,\"f\"]",
         "Expected : 8, Actual : 7, function : doLoopbackTest "},
        {"discovery.getAllPortsByHba", "{}", "Expected : 1, Actual : 0, function : getAllPortsByHba "},
    };
    ASSERT_EQ(0, dtruj_sim_set_echo("*"));
    for (const Case& c : cases)
    {
        LogMark mark;
        Json::Value e = c.params ? error(c.method, c.params) : error(c.method);
        EXPECT_EQ(mismatch, e) << c.method;
        EXPECT_EQ(1u, countLines(mark.text(), {"WARN", std::string("No. of Params - ") + c.line}))
            << c.method << "\n" << mark.text();
    }
    EXPECT_EQ(0u, journal().size()) << "nothing reaches the library";

    // Position 1 of a loopback test is counted, not read.
    EXPECT_FALSE(sent("diagnostics.doLoopbackTest", "[\"1\",{\"any\":[]},\"p\",1,2,3,\"f\",\"d\"]",
        "postDiagnostics").isMember("hbaWwn"));
}

TEST_F(Catalogue, StringParameters)
{
    struct Case
    {
        const char* value;
        const char* read;
    };
    for (const Case& c : {Case{"\"00:05\"", "00:05"}, Case{"\"\"", ""}, Case{"null", ""},
                          Case{"true", "true"}, Case{"false", "false"},
                          Case{"\"caf\xc3\xa9\"", "caf\xc3\xa9"}})
        EXPECT_EQ(c.read, sent("discovery.getCee", (std::string("[") + c.value + "]").c_str(),
            "getCee")["mac"].asString()) << c.value;

    Json::Value notText = errorObject("JSONRPCError", 200, "Type is not convertible to string");
    ASSERT_EQ(0, dtruj_sim_set_echo("*"));
    for (const char* value : {"5", "-1", "2.5", "[]", "[\"a\"]", "{}", "{\"mac\":\"m\"}"})
        EXPECT_EQ(notText, error("discovery.getCee", (std::string("[") + value + "]").c_str())) << value;
    // A request id handed back as the number it was given out as.
    Json::Value id(Json::arrayValue);
    id.append(result("diagnostics.getRequestID"));
    EXPECT_TRUE(id[0].isInt());
    EXPECT_EQ(notText, error("diagnostics.getDiagnosticsResults", id));
    EXPECT_EQ(0u, journal().size());
}

TEST_F(Catalogue, IntParameters)
{
    struct Case
    {
        const char* value;
        int read;
    };
    const Case good[] = {{"null", 0}, {"true", 1}, {"false", 0}, {"7", 7}, {"-7", -7},
                         {"2.9", 2}, {"-2.9", -2}, {"2147483647", 2147483647},
                         {"-2147483648", -2147483647 - 1}, {"2147483647.0", 2147483647}};
    for (const Case& c : good)
    {
        Json::Value r = sent("configuration.createVnic",
            (std::string("[\"m\",") + c.value + ",50]").c_str(), "createvNIC");
        EXPECT_TRUE(r["minBandwidth"].isInt()) << c.value;
        EXPECT_EQ(c.read, r["minBandwidth"].asInt()) << c.value;
    }

    struct Bad
    {
        const char* value;
        const char* message;
    };
    const Bad bad[] = {
        {"2147483648", "integer out of signed integer range"},
        {"18446744073709551615", "integer out of signed integer range"},
        {"-2147483649", "integer out of signed integer range"},
        {"3e10", "Real out of signed integer range"},
        {"-2147483649.5", "Real out of signed integer range"},
        {"\"5\"", "Type is not convertible to int"},
        {"[]", "Type is not convertible to int"},
        {"{}", "Type is not convertible to int"},
    };
    ASSERT_EQ(0, dtruj_sim_set_echo("*"));
    for (const Bad& b : bad)
        EXPECT_EQ(errorObject("JSONRPCError", 200, b.message),
            error("configuration.createVnic", (std::string("[\"m\",10,") + b.value + "]").c_str()))
            << b.value;
    EXPECT_EQ(0u, journal().size());
}

TEST_F(Catalogue, BoolParameters)
{
    struct Case
    {
        const char* value;
        bool read;
    };
    const Case cases[] = {{"null", false}, {"false", false}, {"true", true}, {"0", false},
                          {"-3", true}, {"0.0", false}, {"0.25", true}, {"\"\"", false},
                          {"\"false\"", true}, {"[]", false}, {"[0]", true}, {"{}", false},
                          {"{\"a\":null}", true}};
    for (const Case& c : cases)
    {
        Json::Value r = sent("diagnostics.startTests", (std::string("[\"1\",") + c.value + "]").c_str(),
            "startTests");
        EXPECT_TRUE(r["stopOnError"].isBool()) << c.value;
        EXPECT_EQ(c.read, r["stopOnError"].asBool()) << c.value;
    }
}

TEST_F(Catalogue, ArrayAndObjectParameters)
{
    // Null passes both tests and reaches the library as null.
    Json::Value r = sent("configuration.setPortByWwn", "[\"i\",null,null]", "setPortByWwn");
    EXPECT_TRUE(r.isMember("port") && r["port"].isNull());
    EXPECT_TRUE(r.isMember("propArray") && r["propArray"].isNull());
    r = sent("configuration.setPortByWwn", "[\"i\",{\"portStatus\":false},[\"portStatus\"]]",
        "setPortByWwn");
    EXPECT_EQ(json("{\"indexStr\":\"i\",\"port\":{\"portStatus\":false},\"propArray\":[\"portStatus\"]}"), r);

    Json::Value notArray = errorObject("USERDEFINEDError", 54, "Not a JSON array format.");
    Json::Value notObject = errorObject("USERDEFINEDError", 55, "Not a JSON Object format.");
    ASSERT_EQ(0, dtruj_sim_set_echo("*"));
    for (const char* value : {"{}", "\"a\"", "0", "true"})
        EXPECT_EQ(notArray, error("configuration.setPortByWwn",
            (std::string("[\"i\",{},") + value + "]").c_str())) << value;
    for (const char* value : {"[]", "\"a\"", "0", "false"})
        EXPECT_EQ(notObject, error("configuration.setPortByWwn",
            (std::string("[\"i\",") + value + ",[]]").c_str())) << value;
    // Position order: the object fails before the array is looked at.
    EXPECT_EQ(notObject, error("configuration.setPortByWwn", "[\"i\",1,2]"));
    EXPECT_EQ(0u, journal().size());
}
