// The configuration methods: what each sends the library, the handlers
// that pick members or entries, and the changes as discovery and the CIM
// classes show them afterwards.

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

const Sent configuration[] = {
    {"configuration.createVPort", "[\"p\",\"n\",\"v\",\"s\"]", "createVport",
     "{\"pwwn\":\"p\",\"nwwn\":\"n\",\"vwwn\":\"v\",\"symbolicName\":\"s\",\"vfId\":0}"},
    {"configuration.deleteVPort", "[\"p\",[\"v\",{\"vwwn\":\"w\"}]]", "deleteVport",
     "{\"pwwn\":\"p\",\"vportArray\":[\"v\",{\"vwwn\":\"w\"}],\"vfId\":0}"},
    {"configuration.setPortByWwn", "[\"i\",{\"alias\":\"a\"},[\"alias\"]]", "setPortByWwn",
     "{\"indexStr\":\"i\",\"port\":{\"alias\":\"a\"},\"propArray\":[\"alias\"]}"},
    {"configuration.setPortAuthentication", "[\"p\",{\"authEnabled\":true,\"secret\":\"s\"}]",
     "setPortAuthentication", "{\"pPortWwn\":\"p\",\"portAuth\":{\"authEnabled\":true,\"secret\":\"s\"}}"},
    {"configuration.setFcByFcWwn", "[\"w\",{\"bbCredit\":8},[\"bbCredit\"]]", "setFcByFcWwn",
     "{\"portWwn\":\"w\",\"fcPortData\":{\"bbCredit\":8},\"paramsConfigured\":[\"bbCredit\"]}"},
    {"configuration.setFcoeByFcoeWwn", "[\"w\",{\"bbCredit\":8},[\"bbCredit\"]]", "setFcByFcWwn",
     "{\"portWwn\":\"w\",\"fcPortData\":{\"bbCredit\":8},\"paramsConfigured\":[\"bbCredit\"]}"},
    {"configuration.setHbaStatus", "[\"i\",false]", "setAdapterState",
     "{\"indexStr\":\"i\",\"enableState\":false}"},
    {"configuration.setFCTrunkingState", "[\"i\",1]", "setFcTrunkingState",
     "{\"indexStr\":\"i\",\"enableState\":true}"},
    {"configuration.setFcoePort", "[\"i\",{\"vlanId\":5},[\"vlanId\"]]", "setFcoeByPort",
     "{\"indexStr\":\"i\",\"fcoePort\":{\"vlanId\":5},\"propArray\":[\"vlanId\"]}"},
    {"configuration.setEthPort", "[\"m\",{\"mtu\":9000},[\"mtu\"]]", "setEthPort",
     "{\"mac\":\"m\",\"ethPort\":{\"mtu\":9000},\"propArray\":[\"mtu\"]}"},
    {"configuration.clearLogsForPort", "[[\"a\",\"b\"]]", "clearLogsForPort", "{\"propArray\":[\"a\",\"b\"]}"},
    {"configuration.setAdapterMode", "[\"i\",\"NIC\"]", "setAdapterMode",
     "{\"indexStr\":\"i\",\"adapterMode\":\"NIC\"}"},
    {"configuration.clearAdvancedIoProfilesAtPort", "[\"i\"]", "clearAdvIoProfile", "{\"indexStr\":\"i\"}"},
    {"configuration.clearAdvancedIoProfilesAtLogicalPort", "[\"i\",\"l\"]", "clearAdvIoProfile",
     "{\"indexStr\":\"i\",\"lPortWwn\":\"l\"}"},
    {"configuration.clearAdvancedIoProfilesAtRemotePort", "[\"i\",\"l\",\"r\"]", "clearAdvIoProfile",
     "{\"indexStr\":\"i\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\"}"},
    {"configuration.clearAdvancedIoProfileOfLun", "[\"i\",\"l\",\"r\",\"3\"]", "clearAdvIoProfile",
     "{\"indexStr\":\"i\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\",\"lunId\":\"3\"}"},
    {"configuration.resetDataForAdvancedIoAtPPort", "[\"i\"]", "resetDataForAdvIoProf",
     "{\"indexStr\":\"i\"}"},
    {"configuration.resetDataForAdvancedIoAtLPort", "[\"i\",\"l\"]", "resetDataForAdvIoProf",
     "{\"indexStr\":\"i\",\"lPortWwn\":\"l\"}"},
    {"configuration.resetDataForAdvancedIoAtRPort", "[\"i\",\"l\",\"r\"]", "resetDataForAdvIoProf",
     "{\"indexStr\":\"i\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\"}"},
    {"configuration.resetDataForAdvancedIoAtLun", "[\"i\",\"l\",\"r\",\"3\"]", "resetDataForAdvIoProf",
     "{\"indexStr\":\"i\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\",\"lunId\":\"3\"}"},
    {"configuration.resetDataForAdvancedIoForLunRange", "[\"i\",\"l\",\"r\",\"3\",\"9\"]",
     "resetDataForAdvIoProf",
     "{\"indexStr\":\"i\",\"lPortWwn\":\"l\",\"rPortWwn\":\"r\",\"lunId\":\"3\",\"endLunRange\":\"9\"}"},
    {"configuration.createVnic", "[\"m\",10,50.5]", "createvNIC",
     "{\"mac\":\"m\",\"minBandwidth\":10,\"maxBandwidth\":50}"},
    {"configuration.deleteVnics", "[\"m\",[1,2]]", "deletevNICs", "{\"mac\":\"m\",\"pciFunctionIndices\":[1,2]}"},
    {"configuration.modifyVnic", "[\"m\",[{\"pciFunctionIndex\":1,\"maxBandwidth\":40}]]", "modifyvNIC",
     "{\"mac\":\"m\",\"vNICs\":[{\"pciFunctionIndex\":1,\"maxBandwidth\":40}]}"},
    {"configuration.resetPortAuthentication", "[\"p\"]", "resetPortAuthentication", "{\"pPortWwn\":\"p\"}"},
    // Handlers of their own.
    {"configuration.setAlias", "[{\"type\":\"Node\",\"wwn\":\"w\",\"alias\":\"a\"}]", "setAdapterAlias",
     "{\"type\":\"Node\",\"wwn\":\"w\",\"alias\":\"a\"}"},
    {"configuration.setAlias", "[{\"type\":\"CNA\",\"mac\":\"m\"}]", "setAdapterAlias",
     "{\"type\":\"CNA\",\"mac\":\"m\"}"},
    {"configuration.setAlias", "[{\"type\":\"node\",\"wwn\":\"w\"}]", "setPortAlias",
     "{\"type\":\"node\",\"wwn\":\"w\"}"},
    {"configuration.setAlias", "[{\"wwn\":\"w\"}]", "setPortAlias", "{\"wwn\":\"w\"}"},
    {"configuration.setAlias", "[null]", "setPortAlias", "null"},
    {"configuration.setAdvancedIoProfile", "[\"i\",{\"removedAdvancedIoProfiles\":[{\"lunId\":\"1\"}],\"x\":1}]",
     "setAdvIoProfile", "{\"indexStr\":\"i\",\"removedAdvancedIoProfiles\":[{\"lunId\":\"1\"}]}"},
    {"configuration.setAdvancedIoProfile", "[\"i\",{\"addedAdvancedIoProfiles\":null,\"removedAdvancedIoProfiles\":[]}]",
     "setAdvIoProfile", "{\"indexStr\":\"i\",\"addedAdvancedIoProfiles\":null,\"removedAdvancedIoProfiles\":[]}"},
    {"configuration.setLunMaskDataForPort", "[\"i\",{}]", "setLunMaskData",
     "{\"indexStr\":\"i\",\"removedLunMaskData\":null,\"addedLunMaskData\":null,\"clearLunMaskData\":false}"},
    {"configuration.setLunMaskDataForPort", "[\"i\",null]", "setLunMaskData",
     "{\"indexStr\":\"i\",\"removedLunMaskData\":null,\"addedLunMaskData\":null,\"clearLunMaskData\":false}"},
    {"configuration.setLunMaskDataForPort",
     "[\"i\",{\"addedLunMaskData\":[{\"lunId\":\"1\"}],\"clearLunMaskData\":\"yes\",\"other\":2}]", "setLunMaskData",
     "{\"indexStr\":\"i\",\"removedLunMaskData\":null,\"addedLunMaskData\":[{\"lunId\":\"1\"}],\"clearLunMaskData\":true}"},
};

class Configuration : public RpcTest
{
protected:
    static const ch::Instance* find(const std::vector<ch::Instance>& all, const std::string& id)
    {
        for (const ch::Instance& i : all)
            if (i.get_text("DeviceID") == id)
                return &i;
        return nullptr;
    }

    // A property of the instance of a class with this DeviceID.
    static std::string property(const char* cls, const std::string& id, const char* name)
    {
        std::vector<ch::Instance> all = served(cls);
        const ch::Instance* i = find(all, id);
        return i ? i->get_text(name) : "missing";
    }

    static std::string fcPortState(const std::string& id)
    {
        return property("VESPERA_FCPort", id, "EnabledState") + " " +
            property("VESPERA_FCPort", id, "OperationalStatus");
    }
};

} // namespace

TEST_F(Configuration, EachMethodSendsItsRequest)
{
    for (const Sent& s : configuration)
        EXPECT_EQ(json(s.request), sent(s.method, s.params, s.entry)) << s.method << " " << s.params;
}

TEST_F(Configuration, ShapesThatAreRefused)
{
    Json::Value notArray = errorObject("USERDEFINEDError", 54, "Not a JSON array format.");
    Json::Value notObject = errorObject("USERDEFINEDError", 55, "Not a JSON Object format.");
    struct Case
    {
        const char* method;
        const char* params;
        Json::Value error;
    };
    const Case cases[] = {
        {"configuration.setAlias", "[[]]", notObject},
        {"configuration.setAlias", "[{\"type\":5}]",
         errorObject("JSONRPCError", 200, "Type is not convertible to string")},
        {"configuration.setAliases", "[{}]", notArray},
        {"configuration.setAliases", "[[{\"type\":\"Node\"},\"x\"]]", notObject},
        {"configuration.setAdvancedIoProfile", "[\"i\",{}]", notObject},
        {"configuration.setAdvancedIoProfile", "[\"i\",null]", notObject},
        {"configuration.setAdvancedIoProfile", "[\"i\",[]]", notObject},
        {"configuration.setAdvancedIoProfile", "[\"i\",{\"addedAdvancedIoProfiles\":{}}]", notArray},
        {"configuration.setAdvancedIoProfile", "[\"i\",{\"removedAdvancedIoProfiles\":\"x\"}]", notArray},
        {"configuration.setLunMaskDataForPort", "[\"i\",{\"removedLunMaskData\":{}}]", notArray},
        {"configuration.setLunMaskDataForPort", "[\"i\",{\"addedLunMaskData\":5}]", notArray},
        {"configuration.setLunMaskDataForPort", "[\"i\",[]]", notObject},
        {"configuration.deleteVPort", "[\"p\",\"v\"]", notArray},
        {"configuration.clearLogsForPort", "[\"10:00:00:05:1e:8a:10:01\"]", notArray},
        {"configuration.setPortAuthentication", "[\"p\",\"secret\"]", notObject},
    };
    ASSERT_EQ(0, dtruj_sim_set_echo("*"));
    for (const Case& c : cases)
        EXPECT_EQ(c.error, error(c.method, c.params)) << c.method << " " << c.params;
    // A setAliases that fails reading its second element has set the first.
    EXPECT_EQ(1u, journal().size());
}

TEST_F(Configuration, AliasesOneByOne)
{
    Json::Value params(Json::arrayValue);
    params.append(json("[{\"type\":\"Node\",\"wwn\":\"20:00:00:05:1e:8a:10:00\",\"alias\":\"db-hba\"},"
        "{\"type\":\"Port\",\"wwn\":\"10:00:00:05:1e:8a:10:02\",\"alias\":\"fabric-b\"},"
        "{\"type\":\"Port\",\"wwn\":\"10:00:00:05:1e:ff:ff:ff\",\"alias\":\"nowhere\"}]"));

    // One reply per alias; the library's "error" for the third stays in it.
    Json::Value all = result("configuration.setAliases", params);
    ASSERT_EQ(3u, all.size());
    EXPECT_EQ(0, all[0]["status"].asInt());
    EXPECT_EQ(0, all[1]["status"].asInt());
    EXPECT_TRUE(all[2].isMember("error"));
    EXPECT_EQ("db-hba", result("discovery.getHbaByWwn", "[\"20:00:00:05:1e:8a:10:00\"]")["hbaData"]["alias"].asString());
    EXPECT_EQ("fabric-b", result("discovery.getPortByWwn", "[\"10:00:00:05:1e:8a:10:02\"]")["alias"].asString());
    EXPECT_TRUE(result("configuration.setAliases", "[[]]").isNull());

    // A library exception ends the loop: the reply has only the error, and
    // the alias before it stays set.
    params[0][0]["alias"] = "db-hba-2";
    params[0][1]["alias"] = "fabric-b-2";
    ASSERT_EQ(0, dtruj_sim_set_fault("setPortAlias", "{\"kind\":\"hba\",\"code\":9,\"message\":\"busy\"}"));
    EXPECT_EQ(errorObject("USERDEFINEDError", 9, "busy"), error("configuration.setAliases", params));
    ASSERT_EQ(0, dtruj_sim_set_fault("setPortAlias", nullptr));
    EXPECT_EQ("db-hba-2", result("discovery.getHbaByWwn", "[\"20:00:00:05:1e:8a:10:00\"]")["hbaData"]["alias"].asString());
    EXPECT_EQ("fabric-b", result("discovery.getPortByWwn", "[\"10:00:00:05:1e:8a:10:02\"]")["alias"].asString());
}

TEST_F(Configuration, PortStateThroughDiscoveryAndCim)
{
    EXPECT_EQ("2 {11}", fcPortState("100000051e8a1001"));
    result("configuration.setPortByWwn",
        "[\"10:00:00:05:1e:8a:10:01\",{\"portStatus\":false},[\"portStatus\"]]");
    EXPECT_EQ(10, result("discovery.getPortByWwn", "[\"10:00:00:05:1e:8a:10:01\"]")["portStatusValue"].asInt());
    EXPECT_EQ("3 {10}", fcPortState("100000051e8a1001"));
    EXPECT_EQ("2 {11}", fcPortState("100000051e8a1002"));

    // The port's log tells of it, until it is cleared.
    Json::Value logs = result("discovery.getAdvPortDataByPort", "[\"10:00:00:05:1e:8a:10:01\"]")["logs"];
    ASSERT_EQ(1u, logs.size());
    EXPECT_EQ("Port disabled", logs[0]["message"].asString());
    result("configuration.clearLogsForPort", "[[\"10:00:00:05:1e:8a:10:01\"]]");
    EXPECT_EQ(0u, result("discovery.getAdvPortDataByPort", "[\"10:00:00:05:1e:8a:10:01\"]")["logs"].size());

    // A whole adapter, and the frame size of the other port.
    result("configuration.setHbaStatus", "[\"20:00:00:05:1e:8a:10:00\",false]");
    EXPECT_EQ("3 {10}", fcPortState("100000051e8a1002"));
    result("configuration.setFcByFcWwn",
        "[\"10:00:00:05:1e:8a:10:02\",{\"maxFrameSize\":1024},[\"maxFrameSize\"]]");
    EXPECT_EQ(1024, result("discovery.getFcByFcWwn", "[\"10:00:00:05:1e:8a:10:02\"]")["maxFrameSize"].asInt());
    EXPECT_EQ("1024", property("VESPERA_FCPort", "100000051e8a1002", "SupportedMaximumTransmissionUnit"));

    // The library refuses what it can't apply, and nothing changes.
    EXPECT_TRUE(call("configuration.setPortByWwn",
        "[\"10:00:00:05:1e:8a:10:02\",{\"wwn\":\"x\"},[\"wwn\"]]").isMember("error"));
}

TEST_F(Configuration, EthernetPortThroughDiscoveryAndCim)
{
    const char* eth = "[\"00:05:1e:8b:20:02\"]";
    std::string before = property("VESPERA_EthernetPort", "00051e8b2002", "OperationalStatus");
    result("configuration.setEthPort", "[\"00:05:1e:8b:20:02\",{\"portStatus\":false,\"mtu\":4000},"
        "[\"portStatus\",\"mtu\"]]");
    Json::Value port = result("discovery.getCompleteEthByEthMac", eth)["ethData"];
    EXPECT_EQ(10, port["ethPortStateMOFValue"].asInt());
    EXPECT_EQ(4000, port["mtu"].asInt());
    EXPECT_EQ("{11}", before);
    EXPECT_EQ("{10}", property("VESPERA_EthernetPort", "00051e8b2002", "OperationalStatus"));
}

TEST_F(Configuration, VirtualPortsAndVnics)
{
    const char* port = "[\"10:00:00:05:1e:8a:10:02\"]";
    EXPECT_EQ(0u, result("discovery.getAllVPorts", port).size());
    Json::Value created = result("configuration.createVPort",
        "[\"10:00:00:05:1e:8a:10:02\",\"\",\"2f:00:00:05:1e:8a:10:22\",\"vm-web-01\"]");
    EXPECT_EQ("2f:00:00:05:1e:8a:10:22", created["vwwn"].asString());
    Json::Value vports = result("discovery.getAllVPorts", port);
    ASSERT_EQ(1u, vports.size());
    EXPECT_EQ("vm-web-01", vports[0]["symbolicName"].asString());
    result("configuration.deleteVPort", "[\"10:00:00:05:1e:8a:10:02\",[\"2f:00:00:05:1e:8a:10:22\"]]");
    EXPECT_EQ(0u, result("discovery.getAllVPorts", port).size());

    const char* cna = "[\"00:05:1e:8b:20:00\"]";
    size_t functions = result("discovery.getAllPCIFunctions", cna).size();
    int index = result("configuration.createVnic", "[\"00:05:1e:8b:20:02\",20,60]")["pciFunctionIndex"].asInt();
    Json::Value all = result("discovery.getAllPCIFunctions", cna);
    ASSERT_EQ(functions + 1, all.size());
    EXPECT_EQ(60, all[Json::ArrayIndex(functions)]["maxBandwidth"].asInt());
    Json::Value change = json("[\"00:05:1e:8b:20:02\",[{\"pciFunctionIndex\":0,\"maxBandwidth\":30}]]");
    change[1][0]["pciFunctionIndex"] = index;
    result("configuration.modifyVnic", change);
    EXPECT_EQ(30, result("discovery.getAllPCIFunctions", cna)[Json::ArrayIndex(functions)]["maxBandwidth"].asInt());
    Json::Value remove = json("[\"00:05:1e:8b:20:02\",[0]]");
    remove[1][0] = index;
    result("configuration.deleteVnics", remove);
    EXPECT_EQ(functions, result("discovery.getAllPCIFunctions", cna).size());
    // Beyond the port's bandwidth: the library's error.
    EXPECT_TRUE(call("configuration.createVnic", "[\"00:05:1e:8b:20:02\",101,100]").isMember("error"));
}

TEST_F(Configuration, LunMaskThroughDiscoveryAndCim)
{
    size_t disks = served("VESPERA_LogicalDisk").size();
    const char* luns = "[\"10:00:00:05:1e:8a:10:01\",\"\",\"50:06:01:60:3b:20:1a:01\"]";
    EXPECT_EQ(3u, result("discovery.getAllLunsByRemotePort", luns).size());

    result("configuration.setLunMaskDataForPort", "[\"10:00:00:05:1e:8a:10:01\","
        "{\"addedLunMaskData\":[{\"rPortWwn\":\"50:06:01:60:3b:20:1a:01\",\"lunId\":\"1\"}]}]");
    Json::Value mask = result("discovery.getLunMaskDataByPort", "[\"10:00:00:05:1e:8a:10:01\"]");
    EXPECT_TRUE(mask["lunMaskEnabled"].asBool());
    EXPECT_EQ(1u, mask["lunMaskData"].size());
    Json::Value seen = result("discovery.getAllLunsByRemotePort", luns);
    ASSERT_EQ(1u, seen.size());
    EXPECT_EQ(1, seen[0]["number"].asInt());
    EXPECT_EQ(disks - 2, served("VESPERA_LogicalDisk").size());

    result("configuration.setLunMaskDataForPort", "[\"10:00:00:05:1e:8a:10:01\",{\"clearLunMaskData\":true}]");
    EXPECT_FALSE(result("discovery.getLunMaskDataByPort", "[\"10:00:00:05:1e:8a:10:01\"]")["lunMaskEnabled"].asBool());
    EXPECT_EQ(disks, served("VESPERA_LogicalDisk").size());
}

TEST_F(Configuration, ProfilesModeAuthenticationAndTrunking)
{
    const char* port = "[\"10:00:00:05:1e:8a:10:01\"]";
    result("configuration.setAdvancedIoProfile", "[\"10:00:00:05:1e:8a:10:01\",{\"addedAdvancedIoProfiles\":"
        "[{\"lPortWwn\":\"10:00:00:05:1e:8a:10:01\",\"rPortWwn\":\"50:06:01:60:3b:20:1a:01\",\"lunId\":\"1\","
        "\"profile\":\"latency\"}]}]");
    EXPECT_EQ(1u, result("discovery.getAdvancedIoProfile", port)["advancedIoProfiles"].size());
    result("configuration.clearAdvancedIoProfilesAtPort", port);
    EXPECT_EQ(0u, result("discovery.getAdvancedIoProfile", port)["advancedIoProfiles"].size());

    result("configuration.setAdapterMode", "[\"00:05:1e:8b:20:00\",\"NIC\"]");
    EXPECT_EQ("NIC", result("discovery.getAdvAdapterData", "[\"00:05:1e:8b:20:00\"]")["mode"].asString());
    EXPECT_TRUE(call("configuration.setAdapterMode", "[\"20:00:00:05:1e:8a:10:00\",\"NIC\"]").isMember("error"));

    result("configuration.setPortAuthentication", "[\"10:00:00:05:1e:8a:10:01\",{\"authEnabled\":true}]");
    EXPECT_EQ("Enabled", result("discovery.getPortAuthentication", port)["status"].asString());
    result("configuration.resetPortAuthentication", port);
    EXPECT_EQ("Disabled", result("discovery.getPortAuthentication", port)["status"].asString());

    result("configuration.setFCTrunkingState", "[\"10:00:00:05:1e:8a:10:01\",true]");
    EXPECT_TRUE(result("discovery.getAdvPortDataByPort", port)["trunkingEnabled"].asBool());
    result("configuration.setFcoePort", "[\"10:00:00:05:1e:8b:20:01\",{\"vlanId\":1003},[\"vlanId\"]]");
    EXPECT_EQ(1003, result("discovery.getFcoeByPort", "[\"10:00:00:05:1e:8b:20:01\"]")["vlanId"].asInt());
}

TEST_F(Configuration, AuthenticationSettingsStayOutOfTheLog)
{
    LogMark mark;
    call("configuration.setPortAuthentication",
        "[\"10:00:00:05:1e:8a:10:01\",{\"authEnabled\":true,\"secret\":\"hunter2-secret\"}]");
    EXPECT_EQ(std::string::npos, mark.text().find("hunter2-secret"));
    EXPECT_NE(std::string::npos, mark.text().find("Entering: executeMethod"));
}
