// Setters and actions change the simulated host as a real adapter would.
#include "Lib.h"

#include <fstream>

using namespace dtrujtest;

namespace {

class DtrujState : public ::testing::Test {
protected:
    Lib lib;
    void SetUp() override
    {
        unsetenv("DTRUJ_HOST");
        lib.reset();
    }
    Json::Value port(const char* wwn) { return lib.call("getPortByWwn", obj({{"wwn", wwn}})); }
};

TEST_F(DtrujState, PortAndAdapterSwitches)
{
    Json::Value beacon = obj({{"indexStr", FC_PORT0}, {"port", obj({{"beaconState", true}})},
                              {"propArray", strArray({"beaconState"})}});
    ASSERT_FALSE(isError(lib.call("setPortByWwn", beacon)));
    EXPECT_TRUE(port(FC_PORT0)["beaconState"].asBool());
    EXPECT_FALSE(port(FC_PORT1)["beaconState"].asBool());

    // The module sends the whole port back with one property named: only
    // that one counts, and identity members can't be changed at all.
    Json::Value whole = port(FC_PORT0);
    whole["beaconState"] = false;
    whole["maxFrameSize"] = 1024;
    ASSERT_FALSE(isError(lib.call("setPortByWwn", obj({{"indexStr", FC_PORT0}, {"port", whole},
                                                       {"propArray", strArray({"beaconState"})}}))));
    EXPECT_FALSE(port(FC_PORT0)["beaconState"].asBool());
    EXPECT_EQ(2112, port(FC_PORT0)["maxFrameSize"].asInt());
    EXPECT_TRUE(isError(lib.call("setPortByWwn", obj({{"indexStr", FC_PORT0}, {"port", whole},
                                                      {"propArray", strArray({"wwn"})}}))));
    // A value of the wrong type or a name without value changes nothing.
    Json::Value bad = obj({{"indexStr", FC_PORT0}, {"port", obj({{"beaconState", "yes"}, {"portStatus", false}})},
                           {"propArray", strArray({"portStatus", "beaconState"})}});
    EXPECT_TRUE(isError(lib.call("setPortByWwn", bad)));
    EXPECT_TRUE(port(FC_PORT0)["portStatus"].asBool());
    EXPECT_TRUE(isError(lib.call("setPortByWwn", obj({{"indexStr", FC_PORT0}, {"port", obj({})},
                                                      {"propArray", strArray({"portStatus"})}}))));

    // Disabling the adapter takes its ports down with it.
    ASSERT_FALSE(isError(lib.call("setAdapterState", obj({{"indexStr", FC_HBA}, {"enableState", false}}))));
    EXPECT_FALSE(lib.call("getHbaByWwn", obj({{"wwn", FC_HBA}}))["hbaData"]["hbaStatus"].asBool());
    EXPECT_EQ(10, port(FC_PORT1)["portStatusValue"].asInt());
    EXPECT_EQ(11, port(FCOE_PORT)["portStatusValue"].asInt());
    ASSERT_FALSE(isError(lib.call("setAdapterState", obj({{"indexStr", FC_HBA}, {"enableState", true}}))));
    EXPECT_EQ(11, port(FC_PORT1)["portStatusValue"].asInt());

    // The Ethernet port is switched by MAC through the same entry.
    ASSERT_FALSE(isError(lib.call("setPortByWwn", obj({{"indexStr", ETH_PORT}, {"port", obj({{"portStatus", false}})},
                                                       {"propArray", strArray({"portStatus"})}}))));
    EXPECT_EQ(10u, lib.call("getEthPortByEthMac", obj({{"mac", ETH_PORT}}))["ethData"]["ethPortStateMOFValue"].asUInt());

    EXPECT_FALSE(isError(lib.call("setAdapterMode", obj({{"indexStr", CNA}, {"adapterMode", "NIC"}}))));
    EXPECT_EQ("NIC", lib.call("getHbaByMac", obj({{"mac", CNA}}))["hbaData"]["mode"].asString());
    EXPECT_TRUE(isError(lib.call("setAdapterMode", obj({{"indexStr", FC_HBA}, {"adapterMode", "NIC"}}))));
}

TEST_F(DtrujState, SettingsReachThePortTheyBelongTo)
{
    // An adapter address sets trunking on every port of the adapter.
    lib.call("setFcTrunkingState", obj({{"indexStr", FC_HBA}, {"enableState", true}}));
    EXPECT_TRUE(port(FC_PORT0)["trunkingEnabled"].asBool());
    EXPECT_TRUE(port(FC_PORT1)["trunkingEnabled"].asBool());
    EXPECT_FALSE(port(FCOE_PORT)["trunkingEnabled"].asBool());

    // The frame size set through the FC settings is the port's.
    lib.call("setFcByFcWwn", obj({{"portWwn", FC_PORT0}, {"fcPortData", obj({{"maxFrameSize", 1024}})},
                                  {"paramsConfigured", strArray({"maxFrameSize"})}}));
    EXPECT_EQ(1024, port(FC_PORT0)["maxFrameSize"].asInt());

    Json::Value mtu = obj({{"mac", ETH_PORT}, {"ethPort", obj({{"mtu", 100000}})}, {"propArray", strArray({"mtu"})}});
    EXPECT_TRUE(isError(lib.call("setEthPort", mtu)));
    EXPECT_TRUE(isError(lib.call("setFcoeByPort", obj({{"indexStr", FC_PORT0}, {"fcoePort", obj({})},
                                                       {"propArray", strArray({"vlanId"})}}))));
}

TEST_F(DtrujState, VirtualPorts)
{
    Json::Value c = lib.call("createVport", obj({{"pwwn", FC_PORT1}, {"nwwn", ""}, {"vwwn", "2f:00:00:05:1e:8a:10:77"},
                                                {"symbolicName", "vm-web"}, {"vfId", 0}}));
    ASSERT_FALSE(isError(c));
    Json::Value all = lib.call("getAllVPorts", obj({{"wwn", FC_PORT1}}));
    ASSERT_EQ(1u, all.size());
    EXPECT_EQ("vm-web", all[0]["symbolicName"].asString());
    EXPECT_EQ(FC_HBA, all[0]["nodeWwn"].asString());
    // The same WWN twice, or one of a physical port, is refused.
    EXPECT_TRUE(isError(lib.call("createVport", obj({{"pwwn", FC_PORT0}, {"vwwn", "2f:00:00:05:1e:8a:10:77"}}))));
    EXPECT_TRUE(isError(lib.call("createVport", obj({{"pwwn", FC_PORT0}, {"vwwn", FC_PORT1}}))));
    EXPECT_TRUE(isError(lib.call("createVport", obj({{"pwwn", FC_PORT0}, {"vwwn", "2f00"}}))));
    // Without a WWN the adapter picks a free one.
    Json::Value gen = lib.call("createVport", obj({{"pwwn", FC_PORT0}, {"vwwn", ""}}));
    ASSERT_FALSE(isError(gen));
    EXPECT_EQ(23u, gen["vwwn"].asString().size());
    EXPECT_EQ(2u, lib.call("getAllVPorts", obj({{"wwn", FC_PORT0}})).size());

    // Deleting is all or nothing.
    EXPECT_TRUE(isError(lib.call("deleteVport", obj({{"pwwn", FC_PORT0},
                                                     {"vportArray", arr({VPORT, "2f:00:00:00:00:00:00:00"})}}))));
    EXPECT_EQ(2u, lib.call("getAllVPorts", obj({{"wwn", FC_PORT0}})).size());
    EXPECT_FALSE(isError(lib.call("deleteVport", obj({{"pwwn", FC_PORT0},
                                                      {"vportArray", arr({VPORT, obj({{"vwwn", gen["vwwn"]}})})}}))));
    EXPECT_EQ(0u, lib.call("getAllVPorts", obj({{"wwn", FC_PORT0}})).size());
    EXPECT_TRUE(isError(lib.call("getVPort", obj({{"pPortWwn", FC_PORT0}, {"lPortWwn", VPORT}}))));
}

TEST_F(DtrujState, VnicsKeepTheirBandwidthWithinThePort)
{
    Json::Value c = lib.call("createvNIC", obj({{"mac", ETH_PORT}, {"minBandwidth", 30}, {"maxBandwidth", 60}}));
    ASSERT_FALSE(isError(c));
    int fn = c["pciFunctionIndex"].asInt();
    EXPECT_GT(fn, 0);
    EXPECT_NE(ETH_PORT, c["mac"].asString());
    EXPECT_EQ(2u, lib.call("getEthPortByEthMac", obj({{"mac", ETH_PORT}}))["ethData"]["numOfvNICs"].asUInt());
    // Guaranteed minimums can't add up beyond the port.
    EXPECT_TRUE(isError(lib.call("createvNIC", obj({{"mac", ETH_PORT}, {"minBandwidth", 80}, {"maxBandwidth", 90}}))));
    EXPECT_TRUE(isError(lib.call("createvNIC", obj({{"mac", ETH_PORT}, {"minBandwidth", 50}, {"maxBandwidth", 40}}))));
    EXPECT_TRUE(isError(lib.call("modifyvNIC", obj({{"mac", ETH_PORT},
                                                    {"vNICs", arr({obj({{"pciFunctionIndex", fn}, {"minBandwidth", 101}})})}}))));
    EXPECT_FALSE(isError(lib.call("modifyvNIC", obj({{"mac", ETH_PORT},
                                                     {"vNICs", arr({obj({{"pciFunctionIndex", fn}, {"minBandwidth", 10}})})}}))));
    // The base function stays.
    EXPECT_TRUE(isError(lib.call("deletevNICs", obj({{"mac", ETH_PORT}, {"pciFunctionIndices", arr({0})}}))));
    EXPECT_TRUE(isError(lib.call("deletevNICs", obj({{"mac", ETH_PORT}, {"pciFunctionIndices", arr({fn + 5})}}))));
    EXPECT_FALSE(isError(lib.call("deletevNICs", obj({{"mac", ETH_PORT}, {"pciFunctionIndices", arr({fn})}}))));
    EXPECT_EQ(1u, lib.call("getEthPortByEthMac", obj({{"mac", ETH_PORT}}))["ethData"]["numOfvNICs"].asUInt());
}

TEST_F(DtrujState, LunMaskHidesUnlistedLuns)
{
    Json::Value rp = obj({{"pPortWwn", FC_PORT0}, {"lPortWwn", FC_PORT0}, {"rPortWwn", DISK_RPORT}});
    ASSERT_EQ(3u, lib.call("getAllLunsByRemotePort", rp).size());
    Json::Value set = obj({{"indexStr", FC_PORT0},
                           {"addedLunMaskData", arr({obj({{"rPortWwn", DISK_RPORT}, {"lunId", "1"}})})},
                           {"removedLunMaskData", Json::Value()}, {"clearLunMaskData", false}});
    ASSERT_FALSE(isError(lib.call("setLunMaskData", set)));
    Json::Value m = lib.call("getLunMaskData", obj({{"indexStr", FC_PORT0}}));
    EXPECT_TRUE(m["lunMaskEnabled"].asBool());
    ASSERT_EQ(1u, m["lunMaskData"].size());
    Json::Value luns = lib.call("getAllLunsByRemotePort", rp);
    ASSERT_EQ(1u, luns.size());
    EXPECT_EQ(1u, luns[0]["number"].asUInt());
    EXPECT_EQ(1u, lib.call("getCompleteRemotePort", rp)["lunList"].size());
    // The other port is not masked.
    EXPECT_EQ(1u, lib.call("getAllLunsByRemotePort", obj({{"pPortWwn", FC_PORT1}, {"lPortWwn", FC_PORT1},
                                                          {"rPortWwn", "50:06:01:68:3b:20:1a:01"}})).size());
    // Clearing lifts the mask.
    lib.call("setLunMaskData", obj({{"indexStr", FC_PORT0}, {"clearLunMaskData", true}}));
    EXPECT_FALSE(lib.call("getLunMaskData", obj({{"indexStr", FC_PORT0}}))["lunMaskEnabled"].asBool());
    EXPECT_EQ(3u, lib.call("getAllLunsByRemotePort", rp).size());
    EXPECT_TRUE(isError(lib.call("setLunMaskData", obj({{"indexStr", FC_PORT0}, {"addedLunMaskData", arr({obj({})})}}))));
}

TEST_F(DtrujState, IoProfilesByScope)
{
    Json::Value p1 = obj({{"lPortWwn", FC_PORT0}, {"rPortWwn", DISK_RPORT}, {"lunId", "0"}, {"latencyThresholdMs", 20}});
    Json::Value p2 = obj({{"lPortWwn", FC_PORT0}, {"rPortWwn", TAPE_RPORT}, {"latencyThresholdMs", 50}});
    ASSERT_FALSE(isError(lib.call("setAdvIoProfile", obj({{"indexStr", FC_PORT0}, {"addedAdvancedIoProfiles", arr({p1, p2})}}))));
    EXPECT_EQ(2u, lib.call("getAdvIoProfile", obj({{"indexStr", FC_PORT0}}))["advancedIoProfiles"].size());
    // Clearing at the remote port's scope leaves the other.
    Json::Value c = lib.call("clearAdvIoProfile", obj({{"indexStr", FC_PORT0}, {"lPortWwn", FC_PORT0}, {"rPortWwn", DISK_RPORT}}));
    EXPECT_EQ(1u, c["cleared"].asUInt());
    Json::Value left = lib.call("getAdvIoProfile", obj({{"indexStr", FC_PORT0}}))["advancedIoProfiles"];
    ASSERT_EQ(1u, left.size());
    EXPECT_EQ(TAPE_RPORT, left[0]["rPortWwn"].asString());
    lib.call("setAdvIoProfile", obj({{"indexStr", FC_PORT0}, {"removedAdvancedIoProfiles", arr({p2})}}));
    EXPECT_EQ(0u, lib.call("getAdvIoProfile", obj({{"indexStr", FC_PORT0}}))["advancedIoProfiles"].size());
}

TEST_F(DtrujState, CounterResetsFollowTheirScope)
{
    auto io = [&](const char* entry, Json::Value req) { return lib.call(entry, req)["ioCount"].asUInt64(); };
    Json::Value lunReq = obj({{"pPortWwn", FC_PORT0}, {"lPortWwn", FC_PORT0}, {"rPortWwn", DISK_RPORT}, {"lunId", "2"}});
    Json::Value portReq = obj({{"pPortWwn", FC_PORT1}});
    uint64_t lunBefore = io("getDynamicAdvancedIoDataAtLun", lunReq);
    uint64_t otherBefore = io("getDynamicAdvancedIoDataAtPPort", portReq);
    // A reset at the physical port covers its logical units.
    lib.call("resetDataForAdvIoProf", obj({{"indexStr", FC_PORT0}}));
    EXPECT_LT(io("getDynamicAdvancedIoDataAtLun", lunReq), lunBefore);
    EXPECT_GE(io("getDynamicAdvancedIoDataAtPPort", portReq), otherBefore);
    // A range resets each unit of it.
    uint64_t unit5 = io("getDynamicAdvancedIoDataAtLun", obj({{"pPortWwn", FC_PORT1}, {"lPortWwn", FC_PORT1},
                                                             {"rPortWwn", DISK_RPORT}, {"lunId", "5"}}));
    lib.call("resetDataForAdvIoProf", obj({{"indexStr", FC_PORT1}, {"lPortWwn", FC_PORT1}, {"rPortWwn", DISK_RPORT},
                                          {"lunId", "3"}, {"endLunRange", "6"}}));
    EXPECT_LT(io("getDynamicAdvancedIoDataAtLun", obj({{"pPortWwn", FC_PORT1}, {"lPortWwn", FC_PORT1},
                                                       {"rPortWwn", DISK_RPORT}, {"lunId", "5"}})), unit5);

    EXPECT_TRUE(isError(lib.call("getDynamicQosStatistics", obj({{"pPortWwn", "10:00:00:00:00:00:00:99"}}))));
    EXPECT_TRUE(isError(lib.call("resetvNICStatistics", obj({{"mac", "00:00:00:00:00:99"}}))));
}

TEST_F(DtrujState, FlashUpdateChangesTheFirmwareVersion)
{
    std::string image = testing::TempDir() + "dtruj_image.bin";
    {
        std::ofstream out(image);
        out << "VSPRFW\nversion=3.3.0.0\n";
    }
    Json::Value r = lib.call("adapterUpdateFlash", obj({{"indexStr", CNA}, {"file", image}}));
    EXPECT_EQ(0, r["status"].asInt());
    EXPECT_TRUE(r["message"].isString());
    EXPECT_EQ("3.3.0.0", lib.call("getHbaByMac", obj({{"mac", CNA}}))["firmware"]["version"].asString());
    EXPECT_EQ("3.2.1.0", lib.call("getHbaByWwn", obj({{"wwn", FC_HBA}}))["firmware"]["version"].asString());

    // An image without a version line raises the last number.
    {
        std::ofstream out(image);
        out << "VSPRFW\n";
    }
    lib.call("adapterUpdateFlash", obj({{"indexStr", FC_HBA}, {"file", image}}));
    EXPECT_EQ("3.2.1.1", lib.call("getHbaByWwn", obj({{"wwn", FC_HBA}}))["firmware"]["version"].asString());

    r = lib.call("adapterUpdateFlash", obj({{"indexStr", FC_HBA}, {"file", image + ".missing"}}));
    EXPECT_NE(0, r["status"].asInt());
    EXPECT_TRUE(r["message"].isString());
    EXPECT_EQ(3u, lib.call("getDriverUpdateStatus")["log"].size());
    remove(image.c_str());
}

} // namespace
