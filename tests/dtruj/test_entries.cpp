// Every entry of the library on the default host, with the reply members
// that the module reads.
#include "Lib.h"

#include <cstring>
#include <map>
#include <vector>
#include <set>
#include <unistd.h>

using namespace dtrujtest;

namespace {

class DtrujEntries : public ::testing::Test {
protected:
    Lib lib;
    void SetUp() override
    {
        unsetenv("DTRUJ_HOST");
        lib.reset();
    }
};

#define DTRUJ_NAME(name, cls) #name,
const char* const entryNames[] = {DTRUJ_ENTRIES(DTRUJ_NAME)};

TEST_F(DtrujEntries, AllEntriesExportedAndNothingElse)
{
    EXPECT_EQ(117u, sizeof(entryNames) / sizeof(entryNames[0]));
    for (const char* e : entryNames) {
        dlerror();
        EXPECT_NE(nullptr, dlsym(lib.handle, e)) << e;
    }
    // Internals stay hidden, so they can't clash with the module's symbols.
    EXPECT_EQ(nullptr, dlsym(lib.handle, "_ZN4OLMA3Sim5stateEv"));
}

std::vector<std::string> gLogLines;
void onLog(int level, const char* file, int line, const char* text)
{
    gLogLines.push_back(std::to_string(level) + " " + file + ":" + std::to_string(line) + " " + text);
    EXPECT_GE(level, 1);
    EXPECT_LE(level, 4);
}

TEST_F(DtrujEntries, PlainEntriesAndLifecycle)
{
    lib.sym<OLMA::log4cxxMsgRetVoidFP>("registerLogMsgCb")(onLog);
    lib.reset();
    lib.call("getHbaByWwn", obj({{"wwn", "20:00:00:00:00:00:00:99"}}));
    lib.sym<OLMA::log4cxxMsgRetVoidFP>("registerLogMsgCb")(nullptr);
    ASSERT_GE(gLogLines.size(), 2u);
    EXPECT_NE(std::string::npos, gLogLines.back().find("No such adapter")) << gLogLines.back();
    EXPECT_NE(std::string::npos, gLogLines.back().find(".cpp:")) << gLogLines.back();

    auto version = lib.sym<OLMA::voidRetStrFP>("get_agt_version");
    ASSERT_NE(nullptr, version());
    EXPECT_STREQ("3.2.1", version());
    EXPECT_EQ(2u, lib.sym<OLMA::voidRetUIntFP>("getNumberOfAdapters")());
    auto reqId = lib.sym<OLMA::voidRetIntFP>("getRequestID");
    int a = reqId(), b = reqId();
    EXPECT_GT(a, 0);
    EXPECT_EQ(a + 1, b);

    Json::Value init = lib.call("init_hba_lib", obj({{"appId", 2}}));
    ASSERT_TRUE(init["result"].isInt());
    EXPECT_EQ(0, init["result"].asInt());

    // After free_hba_lib the library answers errors until it is initialised again.
    EXPECT_EQ(0, lib.sym<OLMA::voidRetIntFP>("free_hba_lib")());
    EXPECT_TRUE(isError(lib.call("getAllAdaptersIndexString")));
    EXPECT_EQ(0u, lib.sym<OLMA::voidRetUIntFP>("getNumberOfAdapters")());
    EXPECT_EQ(0, lib.call("init_hba_lib", obj({{"appId", 2}}))["result"].asInt());
    EXPECT_FALSE(isError(lib.call("getAllAdaptersIndexString")));
}

TEST_F(DtrujEntries, AdaptersAndTheirDetails)
{
    Json::Value idx = lib.call("getAllAdaptersIndexString");
    ASSERT_TRUE(idx["indexStrings"].isArray());
    ASSERT_EQ(2u, idx["indexStrings"].size());
    EXPECT_EQ(FC_HBA, idx["indexStrings"][0].asString());
    EXPECT_EQ(CNA, idx["indexStrings"][1].asString());

    Json::Value fc = lib.call("getHbaByWwn", obj({{"wwn", FC_HBA}}));
    const Json::Value& h = fc["hbaData"];
    EXPECT_FALSE(h.isMember("hbaMAC"));
    EXPECT_EQ(FC_HBA, h["wwn"].asString());
    EXPECT_TRUE(h["portCount"].isUInt());
    EXPECT_EQ(2u, h["portCount"].asUInt());
    EXPECT_TRUE(h["hbaStatus"].isBool());
    EXPECT_FALSE(h["isCNA"].asBool());
    EXPECT_FALSE(h["hasEthPort"].asBool());
    for (const char* m : {"serialNumber", "model", "oem", "fruNum", "partNum", "oemSerialNum", "uuid"})
        EXPECT_TRUE(h[m].isString()) << m;
    EXPECT_TRUE(fc["driver"]["storageDriverName"].isString());
    EXPECT_FALSE(fc["driver"].isMember("networkDriverName"));
    EXPECT_TRUE(fc["firmware"]["version"].isString());
    EXPECT_TRUE(fc["firmware"]["biosVersion"].isString());

    // The CNA is found by its MAC through either entry, and by its WWN.
    Json::Value cna = lib.call("getHbaByWwn", obj({{"mac", CNA}}));
    EXPECT_EQ(CNA, cna["hbaData"]["hbaMAC"].asString());
    EXPECT_TRUE(cna["hbaData"]["isCNA"].asBool());
    EXPECT_TRUE(cna["hbaData"]["hasEthPort"].asBool());
    EXPECT_FALSE(cna["hbaData"].isMember("fruNum"));   // an HP card carries no FRU
    EXPECT_EQ("HP", cna["hbaData"]["oem"].asString());
    EXPECT_EQ(32u, cna["hbaData"]["uuid"].asString().size());
    EXPECT_TRUE(cna["driver"]["networkDriverName"].isString());
    EXPECT_EQ(cna, lib.call("getHbaByMac", obj({{"mac", CNA}})));
    EXPECT_EQ(CNA, lib.call("getHbaByWwn", obj({{"wwn", CNA_WWN}}))["hbaData"]["hbaMAC"].asString());
    EXPECT_TRUE(isError(lib.call("getHbaByWwn", obj({{"wwn", "20:00:00:00:00:00:00:99"}}))));

    EXPECT_EQ(2, lib.call("getAdapterId", obj({{"indexStr", CNA}}))["adapterId"].asInt());
    EXPECT_EQ(0, lib.call("getAdapterId", obj({{"indexStr", "20:00:00:00:00:00:00:99"}}))["adapterId"].asInt());
    EXPECT_EQ(1, lib.call("getAdapterIdByPort", obj({{"indexStr", FC_PORT1}}))["adapterId"].asInt());
    EXPECT_EQ(2, lib.call("getAdapterIdByPort", obj({{"indexStr", ETH_PORT}}))["adapterId"].asInt());
    EXPECT_EQ(0, lib.call("getAdapterIdByPort", obj({{"indexStr", "00:00:00:00:00:01"}}))["adapterId"].asInt());

    Json::Value flash = lib.call("getFlashInfo", obj({{"indexStr", FC_HBA}}));
    EXPECT_TRUE(flash["flashStatus"].isBool());
    EXPECT_TRUE(flash["flashStatus"].asBool());
}

TEST_F(DtrujEntries, GlobalInfoDescribesEveryPort)
{
    Json::Value g = lib.call("getGlobalInfo");
    ASSERT_EQ(2, g["numOfAdapters"].asInt());
    const Json::Value& fc = g["adapter"][0];
    EXPECT_TRUE(fc["fc"].asBool());
    EXPECT_FALSE(fc["cna"].asBool());
    EXPECT_EQ(FC_HBA, fc["wwn"].asString());
    EXPECT_EQ(2, fc["numOfPorts"].asInt());
    EXPECT_EQ(FC_PORT1, fc["portWwn"][1].asString());
    const Json::Value& cna = g["adapter"][1];
    EXPECT_TRUE(cna["cna"].asBool());
    EXPECT_TRUE(cna["fcoe"].asBool());
    EXPECT_TRUE(cna["ethPort"].asBool());
    EXPECT_EQ(CNA, cna["mac"].asString());
    ASSERT_EQ(2, cna["numOfPorts"].asInt());
    for (const char* m : {"portHasFc", "portHasEth", "portHasFcoe", "portWwn", "portMac", "fcoeMac"})
        EXPECT_EQ(2u, cna[m].size()) << m;
    EXPECT_TRUE(cna["portHasEth"][1].asBool());
    EXPECT_EQ(ETH_PORT, cna["portMac"][1].asString());
}

TEST_F(DtrujEntries, FcPortMembersAndSpeeds)
{
    Json::Value ports = lib.call("getFcPhyPortIndicesByAdapter", obj({{"indexStr", FC_HBA}}));
    ASSERT_EQ(2u, ports["indexStrings"].size());
    EXPECT_EQ(FC_PORT0, ports["indexStrings"][0].asString());

    Json::Value p = lib.call("getPortByWwn", obj({{"wwn", FC_PORT0}}));
    EXPECT_EQ(FC_PORT0, p["wwn"].asString());
    EXPECT_EQ(FC_HBA, p["nodeWwn"].asString());
    EXPECT_EQ(23u, p["nodeWwn"].asString().size());
    EXPECT_TRUE(p["PortSymbolicName"].isString());
    EXPECT_TRUE(p["operatingSpeed"].isInt());
    EXPECT_EQ(8, p["operatingSpeed"].asInt());
    ASSERT_TRUE(p["supportedPortSpeeds"].isArray());
    EXPECT_EQ(16, p["supportedPortSpeeds"][0].asInt());
    for (const char* m : {"portTypeMOFValue", "maxFrameSize", "portStatusValue"})
        EXPECT_TRUE(p[m].isInt()) << m;
    EXPECT_EQ(11, p["portStatusValue"].asInt());
    for (const char* m : {"isMezz", "beaconState", "portStatus"})
        EXPECT_TRUE(p[m].isBool()) << m;
    // Only a CNA's FC ports say whether they are FCoE, even where an HBA's
    // port description has the member.
    EXPECT_FALSE(p.isMember("isFCoE"));
    EXPECT_FALSE(p.isMember("remotePorts"));   // served by their own entries

    EXPECT_TRUE(lib.call("getPortByWwn", obj({{"wwn", FCOE_PORT}}))["isFCoE"].asBool());
    // An Ethernet port answers by MAC through the same entry.
    Json::Value e = lib.call("getPortByWwn", obj({{"mac", ETH_PORT}}));
    EXPECT_TRUE(e["portStatus"].asBool());

    // A disabled port has no speed: the no-value 99999.
    Json::Value set = obj({{"indexStr", FC_PORT0}, {"port", obj({{"portStatus", false}})},
                           {"propArray", strArray({"portStatus"})}});
    ASSERT_FALSE(isError(lib.call("setPortByWwn", set)));
    p = lib.call("getPortByWwn", obj({{"wwn", FC_PORT0}}));
    EXPECT_EQ(99999, p["operatingSpeed"].asInt());
    EXPECT_EQ(10, p["portStatusValue"].asInt());
    EXPECT_FALSE(p["portStatus"].asBool());
}

TEST_F(DtrujEntries, RemotePortsAndLuns)
{
    Json::Value req = obj({{"pPortWwn", FC_PORT0}, {"lPortWwn", FC_PORT0}});
    Json::Value all = lib.call("getAllRemotePorts", req);
    ASSERT_TRUE(all.isArray());
    ASSERT_EQ(4u, all.size());
    std::set<std::string> types;
    for (const Json::Value& r : all) {
        ASSERT_TRUE(r["remotePortWwn"].isString());
        req["rPortWwn"] = r["remotePortWwn"];
        Json::Value c = lib.call("getCompleteRemotePort", req);
        ASSERT_TRUE(c["deviceData"]["isTarget"].isBool());
        ASSERT_TRUE(c["deviceData"]["type"].isString());
        EXPECT_TRUE(c["deviceData"]["stateMofValue"].isInt());
        ASSERT_TRUE(c["lunList"].isArray());
        types.insert(c["deviceData"]["type"].asString());
        EXPECT_EQ(c["lunList"], lib.call("getAllLunsByRemotePort", req));
        for (const Json::Value& l : c["lunList"]) {
            EXPECT_TRUE(l["number"].isUInt());
            EXPECT_EQ(8u, l["vendor"].asString().size());
            EXPECT_EQ(16u, l["productID"].asString().size());
            EXPECT_TRUE(l["lunDescIdType"].isUInt());
        }
    }
    EXPECT_EQ((std::set<std::string>{"Disk", "Tape", "Media Changer", "Initiator"}), types);
    // The tape unit has no description: the module names it by its serial.
    req["rPortWwn"] = TAPE_RPORT;
    Json::Value tape = lib.call("getCompleteRemotePort", req)["lunList"][0];
    EXPECT_FALSE(tape.isMember("lunDescription"));
    EXPECT_TRUE(tape["productSerialNumber"].isString());

    // Remote ports seen through a virtual port are its own.
    EXPECT_EQ(0u, lib.call("getAllRemotePorts", obj({{"pPortWwn", FC_PORT0}, {"lPortWwn", VPORT}})).size());
    EXPECT_TRUE(isError(lib.call("getAllRemotePorts", obj({{"pPortWwn", "10:00:00:00:00:00:00:99"}}))));
}

TEST_F(DtrujEntries, PortStatisticsByIdGrowOverTime)
{
    auto read = [&](const char* port) {
        std::map<int, unsigned long long> m;
        Json::Value r = lib.call("getDynamicPortStatistics", obj({{"indexStr", port}}));
        EXPECT_TRUE(r.isArray());
        for (const Json::Value& e : r) {
            EXPECT_TRUE(e["id"].isInt());
            EXPECT_TRUE(e["value"].isString());
            m[e["id"].asInt()] = strtoull(e["value"].asCString(), nullptr, 10);
        }
        return m;
    };
    auto a = read(FC_PORT0);
    for (int id : {1402, 1403, 1409, 1410, 1411, 1412, 1416, 1421, 1422, 1423, 1424, 1425, 1426, 1428})
        EXPECT_TRUE(a.count(id)) << id;
    EXPECT_GT(a[1402], 0u);
    usleep(20000);
    auto b = read(FC_PORT0);
    EXPECT_GT(b[1402], a[1402]);
    auto f = read(FCOE_PORT);
    for (int id : {1615, 1616, 1624, 1625, 1626, 1627, 1628})
        EXPECT_TRUE(f.count(id)) << id;
    EXPECT_FALSE(f.count(1402));

    ASSERT_FALSE(isError(lib.call("resetStatisticsForPort", obj({{"indexStr", FC_PORT0}}))));
    auto c = read(FC_PORT0);
    EXPECT_LT(c[1402], b[1402]);
}

TEST_F(DtrujEntries, EthernetPortAndOptics)
{
    Json::Value idx = lib.call("getEthPhyPortIndicesByAdapter", obj({{"indexStr", CNA}}));
    ASSERT_EQ(1u, idx["indexStrings"].size());
    EXPECT_EQ(ETH_PORT, idx["indexStrings"][0].asString());
    EXPECT_EQ(0u, lib.call("getEthPhyPortIndicesByAdapter", obj({{"indexStr", FC_HBA}}))["indexStrings"].size());

    Json::Value e = lib.call("getEthPortByEthMac", obj({{"mac", ETH_PORT}}));
    ASSERT_TRUE(e["ethData"].isObject());
    EXPECT_EQ("eth2", e["ethData"]["ethDev"].asString());
    EXPECT_TRUE(e["ethData"]["ethPortStateMOFValue"].isUInt());
    EXPECT_EQ(11u, e["ethData"]["ethPortStateMOFValue"].asUInt());
    EXPECT_EQ(9000u, e["ethData"]["mtu"].asUInt());

    Json::Value sfp = lib.call("getOpticsSFP", obj({{"indexStr", ETH_PORT}}));
    EXPECT_EQ("10G_BASE-SR", sfp["transceiver"].asString());
    sfp = lib.call("getOpticsSFP", obj({{"indexStr", FC_PORT0}}));
    for (const char* m : {"vendorName", "serialNo", "vendorPart", "revision", "speed", "extendedID"})
        EXPECT_TRUE(sfp[m].isString()) << m;
    // The FCoE port of the CNA has no transceiver of its own.
    EXPECT_TRUE(isError(lib.call("getOpticsSFP", obj({{"indexStr", FCOE_PORT}}))));
    Json::Value pom = lib.call("getOpticsPOM", obj({{"portWwn", FC_PORT0}}));
    EXPECT_TRUE(pom["temperature"]["value"].isDouble());

    EXPECT_EQ("dcb-switch-01", lib.call("getLldp", obj({{"mac", ETH_PORT}}))["systemName"].asString());
    EXPECT_TRUE(lib.call("getCee", obj({{"mac", ETH_PORT}}))["pfcEnabled"].asBool());
    EXPECT_EQ(1u, lib.call("getAllEthPortByEthMac", obj({{"mac", CNA}})).size());
}

// Each JSON entry answers a well-formed request on the default host with a
// good reply (not null, no "error").
TEST_F(DtrujEntries, EveryJsonEntryAnswers)
{
    Json::Value rid = std::to_string(lib.sym<OLMA::voidRetIntFP>("getRequestID")());
    Json::Value pp = obj({{"pPortWwn", FC_PORT0}, {"lPortWwn", FC_PORT0}, {"rPortWwn", DISK_RPORT},
                          {"vfId", 0}});
    Json::Value lun = pp;
    lun["lunId"] = "0";
    struct Case { const char* entry; Json::Value req; };
    std::vector<Case> cases = {
        {"getHost", Json::Value()},
        {"getServerTime", Json::Value()},
        {"getGlobalInfo", Json::Value()},
        {"getAllAdaptersIndexString", Json::Value()},
        {"getHbaByWwn", obj({{"wwn", FC_HBA}})},
        {"getHbaByMac", obj({{"mac", CNA}})},
        {"getAdapterId", obj({{"indexStr", FC_HBA}})},
        {"getAdapterIdByPort", obj({{"indexStr", FC_PORT0}})},
        {"getFcPhyPortIndicesByAdapter", obj({{"indexStr", FC_HBA}})},
        {"getEthPhyPortIndicesByAdapter", obj({{"indexStr", CNA}})},
        {"getFlashInfo", obj({{"indexStr", CNA}})},
        {"getDriverUpdateStatus", Json::Value()},
        {"getAdvAdapterData", obj({{"indexStr", FC_HBA}})},
        {"getAdapterPciFnData", obj({{"indexStr", CNA}})},
        {"getPortByWwn", obj({{"wwn", FC_PORT1}})},
        {"getFcByFcWwn", obj({{"wwn", FC_PORT0}})},
        {"getFcoeByPort", obj({{"indexStr", FCOE_PORT}})},
        {"getBootOverSanByPort", obj({{"indexStr", FC_PORT0}})},
        {"getAdvPortDataByPort", obj({{"indexStr", FC_PORT0}})},
        {"getPortAuthentication", obj({{"wwn", FC_PORT0}})},
        {"getAllVPorts", obj({{"wwn", FC_PORT0}})},
        {"getVPort", obj({{"pPortWwn", FC_PORT0}, {"lPortWwn", VPORT}})},
        {"getAllRemotePorts", pp},
        {"getCompleteRemotePort", pp},
        {"getAllLunsByRemotePort", pp},
        {"getLunMaskData", obj({{"indexStr", FC_PORT0}})},
        {"getAdvIoProfile", obj({{"indexStr", FC_PORT0}})},
        {"getOpticsSFP", obj({{"indexStr", FC_PORT1}})},
        {"getOpticsPOM", obj({{"portWwn", FC_PORT1}})},
        {"getEthPortByEthMac", obj({{"mac", ETH_PORT}})},
        {"getAllEthPortByEthMac", obj({{"mac", ETH_PORT}})},
        {"getLldp", obj({{"mac", ETH_PORT}})},
        {"getCee", obj({{"mac", ETH_PORT}})},
        {"getPortStatistics", obj({{"indexStr", FC_PORT0}})},
        {"getDynamicPortStatistics", obj({{"indexStr", FC_PORT0}})},
        {"getDynamicQosStatistics", obj({{"pPortWwn", FC_PORT0}})},
        {"getDynamicRPortStatistics", pp},
        {"getDynamicVPortStatistics", obj({{"pPortWwn", FC_PORT0}, {"lPortWwn", VPORT}, {"vfId", 0}})},
        {"getDynamicLogicalPortStatistics", pp},
        {"getDynamicFcpimIopStatistics", pp},
        {"getDynamicFcpimStatistics", pp},
        {"getDynamicFabricStatistics", obj({{"wwn", FC_PORT0}, {"vfID", 0}})},
        {"getDynamicPortAuthStatistics", obj({{"pPortWwn", FC_PORT0}})},
        {"getDynamicIocStatistics", obj({{"pwwn", FC_PORT0}})},
        {"getDynamicFcoeStatistics", obj({{"indexStr", FCOE_PORT}})},
        {"getDynamicFcpimModStatistics", obj({{"indexStr", FC_PORT0}})},
        {"getDynamicFirmwareStatistics", obj({{"indexStr", FC_HBA}})},
        {"getDynamicTrunkingStatistics", obj({{"indexStr", FC_PORT0}})},
        {"getDynamicEthernetPortStatistics", obj({{"mac", ETH_PORT}})},
        {"getDynamicIOCEthernetStatistics", obj({{"mac", ETH_PORT}})},
        {"getDynamicvHBAStatistics", obj({{"wwn", FC_PORT0}})},
        {"getDynamicvNICStatistics", obj({{"mac", ETH_PORT}})},
        {"getDynamicvNICStatisticsForGraph", obj({{"mac", ETH_PORT}})},
        {"getDynamicLldpStatistics", obj({{"mac", ETH_PORT}})},
        {"getDynamicAdvancedIoDataAtPPort", obj({{"pPortWwn", FC_PORT0}, {"vfId", 0}})},
        {"getDynamicAdvancedIoDataAtLPort", pp},
        {"getDynamicAdvancedIoDataAtRPort", pp},
        {"getDynamicAdvancedIoDataAtLun", lun},
        {"resetStatisticsForPortAuth", obj({{"wwn", FC_PORT0}})},
        {"resetStatisticsForPort", obj({{"indexStr", FC_PORT0}})},
        {"resetStatisticsForLPort", obj({{"pwwn", FC_PORT0}, {"lwwn", FC_PORT0}, {"vfId", 0}})},
        {"resetStatisticsForVPort", obj({{"pwwn", FC_PORT0}, {"vwwn", VPORT}, {"vfId", 0}})},
        {"resetStatisticsForRPort", pp},
        {"resetStatisticsForFcpim", pp},
        {"resetStatisticsForIoc", obj({{"pwwn", FC_PORT0}})},
        {"resetStatisticsForFabric", obj({{"pwwn", FC_PORT0}, {"vfId", 0}})},
        {"resetStatisticsForQos", obj({{"pPortWwn", FC_PORT0}})},
        {"resetFirmwareStatistics", obj({{"indexStr", FC_HBA}})},
        {"resetTrunkingStatistics", obj({{"indexStr", FC_PORT0}})},
        {"resetLldpStatistics", obj({{"mac", ETH_PORT}})},
        {"resetIOCEthernetStatistics", obj({{"mac", ETH_PORT}})},
        {"resetEthernetPortStatistics", obj({{"mac", ETH_PORT}})},
        {"resetvNICStatistics", obj({{"mac", ETH_PORT}})},
        {"resetvHBAStatistics", obj({{"wwn", FC_PORT0}})},
        {"resetFcoeStatistics", obj({{"indexStr", FCOE_PORT}})},
        {"resetStatisticsForFcpimMod", obj({{"indexStr", FC_PORT0}})},
        {"resetDataForAdvIoProf", obj({{"indexStr", FC_PORT0}})},
        {"setPortByWwn", obj({{"indexStr", FC_PORT1}, {"port", obj({{"beaconState", true}})},
                               {"propArray", strArray({"beaconState"})}})},
        {"setPortAuthentication", obj({{"pPortWwn", FC_PORT0}, {"portAuth", obj({{"authEnabled", true}})}})},
        {"resetPortAuthentication", obj({{"pPortWwn", FC_PORT0}})},
        {"setFcByFcWwn", obj({{"portWwn", FC_PORT0}, {"fcPortData", obj({{"bbCredit", 32}})},
                               {"paramsConfigured", strArray({"bbCredit"})}})},
        {"setFcoeByPort", obj({{"indexStr", FCOE_PORT}, {"fcoePort", obj({{"vlanId", 1003}})},
                                {"propArray", strArray({"vlanId"})}})},
        {"setEthPort", obj({{"mac", ETH_PORT}, {"ethPort", obj({{"mtu", 1500}})}, {"propArray", strArray({"mtu"})}})},
        {"setAdapterAlias", obj({{"type", "Node"}, {"wwn", FC_HBA}, {"alias", "a"}})},
        {"setPortAlias", obj({{"type", "Port"}, {"wwn", FC_PORT0}, {"alias", "p"}})},
        {"setFcTrunkingState", obj({{"indexStr", FC_PORT0}, {"enableState", true}})},
        {"setAdapterMode", obj({{"indexStr", CNA}, {"adapterMode", "NIC"}})},
        {"setAdapterState", obj({{"indexStr", FC_HBA}, {"enableState", true}})},
        {"clearLogsForPort", obj({{"propArray", strArray({FC_PORT0})}})},
        {"createVport", obj({{"pwwn", FC_PORT1}, {"nwwn", ""}, {"vwwn", ""}, {"symbolicName", "vm"}, {"vfId", 0}})},
        {"deleteVport", obj({{"pwwn", FC_PORT0}, {"vportArray", strArray({VPORT})}, {"vfId", 0}})},
        {"setLunMaskData", obj({{"indexStr", FC_PORT0}, {"addedLunMaskData", Json::Value()},
                                 {"removedLunMaskData", Json::Value()}, {"clearLunMaskData", false}})},
        {"createvNIC", obj({{"mac", ETH_PORT}, {"minBandwidth", 10}, {"maxBandwidth", 50}})},
        {"modifyvNIC", obj({{"mac", ETH_PORT}, {"vNICs", arr({obj({{"pciFunctionIndex", 1}, {"maxBandwidth", 60}})})}})},
        {"deletevNICs", obj({{"mac", ETH_PORT}, {"pciFunctionIndices", arr({1})}})},
        {"setAdvIoProfile", obj({{"indexStr", FC_PORT0}, {"addedAdvancedIoProfiles", Json::Value(Json::arrayValue)}})},
        {"clearAdvIoProfile", obj({{"indexStr", FC_PORT0}})},
        {"setDport", obj({{"requestID", rid}, {"portWwn", FC_PORT1}, {"state", true}})},
        {"getDPortTestResult", obj({{"portWwn", FC_PORT1}})},
        {"postDiagnostics", obj({{"function", "QuickTest"}, {"requestID", rid}, {"hbaWwn", FC_HBA}})},
        {"startTests", obj({{"requestID", rid}, {"stopOnError", false}})},
        {"getDiagnosticsResults", obj({{"requestID", rid}})},
        {"cancelTests", obj({{"requestID", rid}})},
        {"diagPCILoopbackTest", obj({{"portWwn", FC_PORT0}, {"dataPattern", 0xB5B5B5B5u}, {"frameCount", 16}})},
        {"register_for_events", obj({{"dropOldEvents", true}})},
        {"unregister_for_events", Json::Value()},
        {"init_hba_lib", obj({{"appId", 2}})},
    };
    std::set<std::string> seen;
    for (Case& c : cases) {
        Json::Value r = lib.call(c.entry, c.req);
        EXPECT_FALSE(r.isNull()) << c.entry;
        EXPECT_FALSE(isError(r)) << c.entry << ": " << r.toStyledString();
        seen.insert(c.entry);
    }
    // The other four JSON entries need a disabled element or an image file
    // and have tests of their own: diagLoopbackTest, diagEthLoopbackTest,
    // diagMemoryTest, adapterUpdateFlash.
    EXPECT_EQ(107u, seen.size());
}

// Requests of the wrong shape, or with members of the wrong type, answer an
// error and never throw: the library is driven by consoles too.
TEST_F(DtrujEntries, MalformedRequestsNeverThrow)
{
    Json::Reader reader;
    Json::Value wrongTypes;
    ASSERT_TRUE(reader.parse(R"({"wwn": 5, "mac": [], "indexStr": {}, "pPortWwn": true, "portWwn": 1.5,
        "hbaWwn": null, "requestID": 7, "function": [], "enableState": "yes", "state": "on",
        "stopOnError": "x", "dropOldEvents": "x", "frameCount": -4, "port": 5, "propArray": "portStatus",
        "vportArray": [[1]], "pciFunctionIndices": [{}], "vNICs": [5], "addedLunMaskData": [5],
        "removedLunMaskData": {}, "clearLunMaskData": "x", "addedAdvancedIoProfiles": [{"lunId": -3}],
        "minBandwidth": "x", "maxBandwidth": 1e30, "adapterMode": 3, "file": 9, "alias": 4,
        "portAuth": [], "fcPortData": 3, "paramsConfigured": [3]})", wrongTypes));
    // Real WWNs with wrong-typed companions reach deeper into each entry.
    Json::Value deeper = wrongTypes;
    for (const char* m : {"wwn", "indexStr", "pPortWwn", "pwwn", "portWwn"})
        deeper[m] = FC_PORT0;
    deeper["mac"] = ETH_PORT;
    deeper["hbaWwn"] = FC_HBA;
    deeper["lPortWwn"] = FC_PORT0;
    deeper["rPortWwn"] = DISK_RPORT;
    std::vector<Json::Value> requests = {Json::Value(Json::arrayValue), Json::Value("text"), Json::Value(3),
                                         Json::Value(Json::objectValue), wrongTypes, deeper};
    requests[0].append(1);
    for (const char* e : entryNames) {
        if (!strcmp(e, "init_hba_lib") || !strcmp(e, "free_hba_lib") || !strcmp(e, "getRequestID")
            || !strcmp(e, "getNumberOfAdapters") || !strcmp(e, "get_agt_version")
            || !strcmp(e, "registerEventProcessingCb") || !strcmp(e, "registerLogMsgCb"))
            continue;
        for (const Json::Value& r : requests)
            EXPECT_NO_THROW(lib.call(e, r)) << e << " " << r.toStyledString();
    }
    lib.call("unregister_for_events");
    // The library still answers afterwards.
    EXPECT_EQ(2u, lib.call("getAllAdaptersIndexString")["indexStrings"].size());
}

} // namespace
