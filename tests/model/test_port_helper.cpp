// PortHelper in the test process, against the simulated adapter library on
// a host of our own, with injected faults and scripted replies for the
// shapes the simulator never answers. Plain property values are checked
// through the stand-in server (test_port_helper_cimhost.cpp); here the
// rules that derive them.

#include "test_port_helper.h"

#include "PortHelper.h"
#include "VESPERA_AlarmDevice.h"
#include "VESPERA_FCPort.h"
#include "VESPERA_FCPortStatistics.h"
#include "VESPERA_LogicalPortGroup.h"
#include "VESPERA_SCSIProtocolEndpoint.h"

using namespace OLMA;
using namespace port_test;

namespace
{

// An FC HBA with two ports on one node WWN (the second without light), and
// a mezzanine card with one FCoE port, whose first supported speed is the
// figure that means "no speed" for a current speed.
const char* const HOST = R"({ "adapters": [
  { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00", "isMezz": false },
    "fcPorts": [
      { "wwn": "10:00:00:00:c9:aa:00:01", "nodeWwn": "20:00:00:00:c9:aa:00:00",
        "operatingSpeed": 8, "supportedPortSpeeds": [16, 8], "beaconState": true,
        "remotePorts": [
          { "remotePortWwn": "50:00:00:00:00:00:00:01",
            "deviceData": { "isTarget": true, "type": "Disk", "stateMofValue": 2 } },
          { "remotePortWwn": "21:00:00:00:00:00:00:02",
            "deviceData": { "isTarget": false, "type": "Initiator", "stateMofValue": 2 } },
          { "remotePortWwn": "50:00:00:00:00:00:00:03",
            "deviceData": { "isTarget": true, "type": "Tape", "stateMofValue": 8 } } ] },
      { "wwn": "10:00:00:00:c9:aa:00:02", "nodeWwn": "20:00:00:00:c9:aa:00:00",
        "operatingSpeed": 8, "supportedPortSpeeds": [8], "linkUp": false, "beaconState": false } ] },
  { "hbaData": { "wwn": "20:00:00:00:c9:bb:00:00", "isMezz": true },
    "fcPorts": [ { "wwn": "10:00:00:00:c9:bb:00:01", "operatingSpeed": 10,
                   "supportedPortSpeeds": [99999], "beaconState": false,
                   "unchecked": { "isFCoE": true } } ] } ] })";

const char* const LEFT = "10000000c9aa0001";
const char* const RIGHT = "10000000c9aa0002";
const char* const MEZZ = "10000000c9bb0001";

PortHelper* helper()
{
    return PortHelper::getPortHelperObject();
}

template<class T>
std::string key(const Walk& w, size_t i)
{
    T* p = w.at<T>(i);
    return p ? str(p->Name.value) : "";
}

class PortHelperTest : public ::testing::Test
{
protected:
    void SetUp() override { useHost(HOST); }
    void TearDown() override { useDefaultHost(); }
};

} // namespace

TEST_F(PortHelperTest, PortsGroupsEndpointsAndBeaconsOfEveryAdapter)
{
    Walk ports(helper()->getInstancesByClass(ID_VESPERA_FCPort));
    ASSERT_EQ(3u, ports.size());

    VESPERA_FCPort* left = ports.at<VESPERA_FCPort>(0);
    EXPECT_EQ(8000000000ULL, left->Speed.value);
    EXPECT_EQ(16000000000ULL, left->MaxSpeed.value);
    EXPECT_EQ(2, left->EnabledState.value);

    // No light: state 13, and the speed 99999 that means none.
    VESPERA_FCPort* right = ports.at<VESPERA_FCPort>(1);
    EXPECT_EQ(1, right->PortNumber.value);
    EXPECT_EQ(std::vector<uint16>{13}, vec(right->OperationalStatus));
    EXPECT_EQ(6, right->EnabledState.value);
    EXPECT_EQ(0u, right->Speed.value);
    EXPECT_EQ(0, right->Speed.null);

    // 99999 is no speed only for the current speed.
    VESPERA_FCPort* mezz = ports.at<VESPERA_FCPort>(2);
    EXPECT_EQ(MEZZ, str(mezz->DeviceID.value));
    EXPECT_EQ(0, mezz->PortNumber.value);
    EXPECT_EQ(10000000000ULL, mezz->Speed.value);
    EXPECT_EQ(99999000000000ULL, mezz->MaxSpeed.value);

    // A node is one group, however many ports it has, named by its WWN.
    Walk groups(helper()->getInstancesByClass(ID_VESPERA_LogicalPortGroup));
    ASSERT_EQ(2u, groups.size());
    for (size_t i = 0; i < 2; i++)
    {
        VESPERA_LogicalPortGroup* g = groups.at<VESPERA_LogicalPortGroup>(i);
        std::string node = i == 0 ? "20000000c9aa0000" : "20000000c9bb0000";
        EXPECT_EQ(node, str(g->InstanceID.value));
        EXPECT_EQ(node, str(g->Name.value));
        EXPECT_EQ(node, str(g->ElementName.value));
        EXPECT_EQ("WWN", str(g->NameFormat.value));
        EXPECT_EQ(hostString(), str(g->Caption.value));
    }

    // Each port, then its targets in remote order; the initiator is no
    // target. A target's name is longer than a WWN field.
    Walk ends(helper()->getInstancesByClass(ID_VESPERA_SCSIProtocolEndpoint));
    ASSERT_EQ(5u, ends.size());
    EXPECT_EQ(LEFT, key<VESPERA_SCSIProtocolEndpoint>(ends, 0));
    EXPECT_EQ(std::string(LEFT) + "_5000000000000001", key<VESPERA_SCSIProtocolEndpoint>(ends, 1));
    EXPECT_EQ(std::string(LEFT) + "_5000000000000003", key<VESPERA_SCSIProtocolEndpoint>(ends, 2));
    EXPECT_EQ(RIGHT, key<VESPERA_SCSIProtocolEndpoint>(ends, 3));
    EXPECT_EQ(MEZZ, key<VESPERA_SCSIProtocolEndpoint>(ends, 4));
    EXPECT_EQ(2, ends.at<VESPERA_SCSIProtocolEndpoint>(0)->Role.value);
    EXPECT_EQ(3, ends.at<VESPERA_SCSIProtocolEndpoint>(2)->Role.value);
    EXPECT_EQ(std::vector<uint16>{8}, vec(ends.at<VESPERA_SCSIProtocolEndpoint>(2)->OperationalStatus));
    EXPECT_EQ(9, ends.at<VESPERA_SCSIProtocolEndpoint>(2)->EnabledState.value);

    // The mezzanine card has no beacon.
    Walk alarms(helper()->getInstancesByClass(ID_VESPERA_AlarmDevice));
    ASSERT_EQ(2u, alarms.size());
    EXPECT_EQ(3, alarms.at<VESPERA_AlarmDevice>(0)->AlarmState.value);
    EXPECT_EQ(1, alarms.at<VESPERA_AlarmDevice>(1)->AlarmState.value);
    EXPECT_EQ(RIGHT, str(alarms.at<VESPERA_AlarmDevice>(1)->DeviceID.value));
}

TEST_F(PortHelperTest, SetAlarmStateResults)
{
    Log log;
    {
        Script<libSetPortByWwn> set("indexStr");
        EXPECT_EQ(3, helper()->setAlarmState(LEFT, 3));
        EXPECT_TRUE(set.requests.empty());

        // Colon form too; any state but 3 means off.
        EXPECT_EQ(1, helper()->setAlarmState("10:00:00:00:c9:aa:00:01", 2));
        ASSERT_EQ(1u, set.requests.size());
        const Json::Value& r = set.requests[0];
        EXPECT_EQ("10:00:00:00:c9:aa:00:01", r["indexStr"].asString());
        EXPECT_FALSE(r["port"]["beaconState"].asBool());
        EXPECT_EQ(parse(R"(["beaconState"])"), r["propArray"]);
        EXPECT_EQ(3, helper()->setAlarmState(LEFT, 1));

        set.on("10:00:00:00:c9:aa:00:01", parse(R"({"error": {"code": 1}})"));
        EXPECT_EQ(0, helper()->setAlarmState(LEFT, 3));
        set.on("10:00:00:00:c9:aa:00:01", Json::Value("throw"));
        EXPECT_EQ(0, helper()->setAlarmState(LEFT, 3));
    }
    EXPECT_EQ(1u, log.count("ERR", "libSetPortByWwn response is null or has error"));
    EXPECT_EQ(1u, log.count("ERR", "libSetPortByWwn got User exception 9: scripted"));
    EXPECT_EQ(2u, log.count("WARN", "setAlarmState : State already set"));

    EXPECT_EQ(2, helper()->setAlarmState(MEZZ, 3));
    EXPECT_EQ(1u, log.count("WARN", "setAlarmState: Operation not supported on Mezz cards"));

    // Through the simulator the beacon really turns.
    EXPECT_EQ(1, helper()->setAlarmState(RIGHT, 3));
    Walk alarms(helper()->getInstancesByClass(ID_VESPERA_AlarmDevice));
    EXPECT_EQ(3, alarms.at<VESPERA_AlarmDevice>(1)->AlarmState.value);

    Script<libGetPortByWwn> get("wwn");
    get.on("10:00:00:00:c9:aa:00:02", parse(R"({"isMezz": false, "beaconState": "on"})"));
    EXPECT_EQ(0, helper()->setAlarmState(RIGHT, 1));
    EXPECT_EQ(0, helper()->setAlarmState("10000000c9ffffff", 3));
    EXPECT_EQ(2u, log.count("ERR", "Current ALARM STATE is not available"));
}

TEST_F(PortHelperTest, StatisticsByIdWithTheLaterIdWinning)
{
    Script<libGetDynamicPortStatistics> stats("indexStr");

    // 1402 twice; no 1416; ids of the other kind, malformed elements, a
    // negative count and one beyond 64 bits.
    stats.on("10:00:00:00:c9:aa:00:01", parse(R"([
        {"id": 1402, "value": "10"}, {"id": 1403, "value": "100"}, {"id": 1410, "value": "200"},
        {"id": 1411, "value": "1"}, {"id": 1424, "value": "6"}, {"id": 1425, "value": "7"},
        {"id": 1402, "value": "11"}, {"id": 1616, "value": "77"}, {"id": 1412, "value": 5},
        {"id": "1421", "value": "6"}, 7, {"id": 1422, "value": "-4"},
        {"id": 1423, "value": "99999999999999999999"}])"));
    stats.on("10:00:00:00:c9:aa:00:02", parse("[]"));

    // 1626 after 1616: the CRC count is 9 wherever it shows.
    stats.on("10:00:00:00:c9:bb:00:01", parse(R"([
        {"id": 1603, "value": "1"}, {"id": 1604, "value": "2"}, {"id": 1605, "value": "3"},
        {"id": 1606, "value": "10"}, {"id": 1607, "value": "20"}, {"id": 1608, "value": "30"},
        {"id": 1609, "value": "4"}, {"id": 1610, "value": "5"}, {"id": 1611, "value": "6"},
        {"id": 1612, "value": "40"}, {"id": 1613, "value": "50"}, {"id": 1614, "value": "60"},
        {"id": 1615, "value": "100"}, {"id": 1616, "value": "7"}, {"id": 1624, "value": "300"},
        {"id": 1625, "value": "1000"}, {"id": 1627, "value": "10000"},
        {"id": 1628, "value": "100000"}, {"id": 1626, "value": "9"}, {"id": 1411, "value": "66"}])"));

    Log log;
    Walk w(helper()->getInstancesByClass(ID_VESPERA_FCPortStatistics));
    ASSERT_EQ(2u, w.size());
    EXPECT_EQ(1u, log.count("WARN", "libGetDynamicPortStatistics failed for port WWN= " +
        std::string(RIGHT)));

    VESPERA_FCPortStatistics* fc = w.at<VESPERA_FCPortStatistics>(0);
    EXPECT_EQ(LEFT, str(fc->InstanceID.value));
    EXPECT_EQ(11u, fc->PacketsTransmitted.value);
    EXPECT_EQ(400u, fc->BytesTransmitted.value);
    EXPECT_EQ(800u, fc->BytesReceived.value);
    EXPECT_EQ(1u, fc->LIPCount.value);
    EXPECT_EQ(6u, fc->LossOfSyncCounter.value);
    EXPECT_EQ(7u, fc->LossOfSignalCounter.value);
    EXPECT_EQ(0u, fc->NOSCount.value);
    EXPECT_EQ(0u, fc->ErrorFrames.value);
    EXPECT_EQ(0u, fc->DumpedFrames.value);
    EXPECT_EQ(9223372036854775807ULL, fc->LinkFailures.value);
    EXPECT_EQ(0u, fc->CRCErrors.value);
    EXPECT_EQ(0, fc->CRCErrors.null);

    VESPERA_FCPortStatistics* fcoe = w.at<VESPERA_FCPortStatistics>(1);
    EXPECT_EQ(MEZZ, str(fcoe->InstanceID.value));
    EXPECT_EQ(6u, fcoe->PacketsTransmitted.value);
    EXPECT_EQ(60u, fcoe->BytesTransmitted.value);
    EXPECT_EQ(15u, fcoe->PacketsReceived.value);
    EXPECT_EQ(150u, fcoe->BytesReceived.value);
    EXPECT_EQ(9u, fcoe->CRCErrors.value);
    EXPECT_EQ(111109u, fcoe->ErrorFrames.value);
    EXPECT_EQ(300u, fcoe->DumpedFrames.value);
    EXPECT_EQ(0u, fcoe->LIPCount.value);
}

TEST_F(PortHelperTest, AFailureAtOneElementLeavesTheOthers)
{
    struct Case { const char* entry; const char* fault; size_t endpoints; const char* line; };
    const Case cases[] = {
        { "getPortByWwn", R"({"kind": "error", "count": 1})", 2,
          "libGetPortByWwn response is null or has error" },
        { "getPortByWwn", R"({"kind": "hba", "code": 7, "message": "busy", "count": 1})", 2,
          "libGetPortByWwn got User exception 7: busy" },
        { "getPortByWwn", R"({"kind": "std", "message": "bad", "count": 1})", 2,
          "libGetPortByWwn got std exception: bad" },
        { "getPortByWwn", R"({"kind": "unknown", "count": 1})", 2,
          "libGetPortByWwn got default exception" },
        { "getFcPhyPortIndicesByAdapter", R"({"kind": "error", "count": 1})", 1,
          "libGetFcPhyPortIndicesByAdapter returns NULL." },
        { "getFcPhyPortIndicesByAdapter", R"({"kind": "unknown", "count": 1})", 1,
          "libGetFcPhyPortIndicesByAdapter got default exception" },
        { "getAllAdaptersIndexString", "hba", 0, "libGetAllAdaptersIndexString returns NULL." },
        { "getAllRemotePorts", R"({"kind": "error", "count": 1})", 3, "libGetAllRemotePorts returns NULL." },
    };

    for (const Case& c : cases)
    {
        useHost(HOST);
        ASSERT_EQ(0, dtruj_sim_set_fault(c.entry, c.fault)) << c.fault;

        // Endpoints, since their walk calls every entry it needs.
        Log log;
        Walk w(helper()->getInstancesByClass(ID_VESPERA_SCSIProtocolEndpoint));
        size_t want = c.endpoints;
        EXPECT_EQ(want, w.size()) << c.entry << " " << c.fault;
        EXPECT_EQ(1u, log.count("ERR", c.line)) << c.entry << " " << c.fault << "\n" << log.text();
        if (want)
        {
            EXPECT_EQ(MEZZ, key<VESPERA_SCSIProtocolEndpoint>(w, want - 1));
        }
    }

    useHost(R"({"adapters": []})");
    Log log;
    EXPECT_EQ(0u, Walk(helper()->getInstancesByClass(ID_VESPERA_FCPort)).size());
    EXPECT_EQ(1u, log.count("WARN", "No adapters in the system. "));
}

TEST_F(PortHelperTest, OddRepliesGiveZerosAndCutTextsNeverMore)
{
    Json::Value odd = parse(R"({"wwn": "10:00:00:00:c9:aa:00:01", "nodeWwn": ["x"],
        "PortSymbolicName": 42, "operatingSpeed": "8", "supportedPortSpeeds": "16",
        "portTypeMOFValue": -3.5, "maxFrameSize": -1, "portStatusValue": "11",
        "isMezz": 0, "beaconState": "yes"})");
    Json::Value huge = parse(R"({"wwn": "10:00:00:00:c9:aa:00:02",
        "operatingSpeed": 99999999999999, "supportedPortSpeeds": [-16]})");
    huge["PortSymbolicName"] = std::string(5000, 'n');
    huge["nodeWwn"] = std::string(100, 'a');

    Log log;
    Script<libGetPortByWwn> get("wwn");
    get.on("10:00:00:00:c9:aa:00:01", odd);
    get.on("10:00:00:00:c9:aa:00:02", huge);
    get.on("10:00:00:00:c9:bb:00:01", parse(R"({"portStatusValue": 10})"));

    Walk w(helper()->getInstancesByClass(ID_VESPERA_FCPort));
    ASSERT_EQ(3u, w.size());

    VESPERA_FCPort* a = w.at<VESPERA_FCPort>(0);
    EXPECT_EQ(":" + std::string(LEFT), str(a->Name.value));
    EXPECT_EQ("", str(a->Caption.value));
    EXPECT_EQ(0u, a->Speed.value + a->MaxSpeed.value + a->SupportedMaximumTransmissionUnit.value);
    EXPECT_EQ(0, a->PortType.value);
    EXPECT_EQ(1, a->EnabledState.value);

    VESPERA_FCPort* b = w.at<VESPERA_FCPort>(1);
    EXPECT_EQ(1027u, str(b->Caption.value).size());
    EXPECT_EQ(std::string(23, 'a') + ":" + RIGHT, str(b->Name.value));
    EXPECT_EQ(0u, b->Speed.value + b->MaxSpeed.value);
    EXPECT_EQ(1u, log.count("WARN", "PortSymbolicName is longer than 1027 characters"));

    // A reply that doesn't name its port is named by what it was asked for.
    EXPECT_EQ(MEZZ, str(w.at<VESPERA_FCPort>(2)->DeviceID.value));
    EXPECT_EQ(1u, log.count("WARN", "Port reply for 10:00:00:00:c9:bb:00:01 has no wwn"));

    Walk alarms(helper()->getInstancesByClass(ID_VESPERA_AlarmDevice));
    EXPECT_EQ(0u, alarms.size());
    EXPECT_EQ(1u, log.count("INFO", "beaconState is NOT available failed for " +
        std::string(LEFT) + "."));

    // Only a port that names its node has a group: here the cut one.
    Walk cut(helper()->getInstancesByClass(ID_VESPERA_LogicalPortGroup));
    ASSERT_EQ(1u, cut.size());
    EXPECT_EQ(std::string(23, 'a'), str(cut.at<VESPERA_LogicalPortGroup>(0)->InstanceID.value));
    EXPECT_EQ(1u, log.count("WARN", "No logical port group for " + std::string(MEZZ)));

    // Replies that are no object, and port lists with holes.
    get.on("10:00:00:00:c9:aa:00:01", parse("[1, 2]"));
    get.on("10:00:00:00:c9:aa:00:02", Json::Value("text"));
    get.on("10:00:00:00:c9:bb:00:01", parse(R"({"nodeWwn": "20:00:00:00:c9:bb:00:00"})"));
    Script<libGetFcPhyPortIndicesByAdapter> ports("indexStr");
    ports.on("20:00:00:00:c9:bb:00:00", parse(R"({"indexStrings": [7, null,
        "10:00:00:00:c9:bb:00:01"]})"));

    Walk groups(helper()->getInstancesByClass(ID_VESPERA_LogicalPortGroup));
    ASSERT_EQ(1u, groups.size());
    EXPECT_EQ("20000000c9bb0000", key<VESPERA_LogicalPortGroup>(groups, 0));
    EXPECT_EQ(2u, log.count("ERR", "libGetPortByWwn response is null or has error"));
    EXPECT_EQ(2u, log.count("ERR", "has no index string"));
}

TEST_F(PortHelperTest, LookUpsOfOneAdapterOrPort)
{
    for (const char* address : {"20000000c9aa0000", "20:00:00:00:c9:aa:00:00"})
        EXPECT_EQ(2u, Walk(helper()->getFCPortInstancesByAdapter(address)).size()) << address;

    Log log;
    EXPECT_EQ(0u, Walk(helper()->getInstancesByAdapterAddress("20000000c9aa0000",
        ID_VESPERA_LogicalDisk)).size());
    EXPECT_EQ(1u, log.count("INFO", "Unhandled class support"));
    EXPECT_EQ(0u, Walk(helper()->getFCPortInstancesByAdapter("20000000c9ffffff")).size());
    EXPECT_EQ(1u, log.count("ERR", "libGetFcPhyPortIndicesByAdapter returns NULL"));
    {
        Script<libGetFcPhyPortIndicesByAdapter> ports("indexStr");
        ports.on("20:00:00:00:c9:aa:00:00", parse(R"({"count": 2})"));
        ports.on("20:00:00:00:c9:bb:00:00", parse(R"({"indexStrings": "x"})"));
        EXPECT_EQ(0u, Walk(helper()->getFCPortInstancesByAdapter("20000000c9aa0000")).size());
        EXPECT_EQ(0u, Walk(helper()->getFCPortInstancesByAdapter("20000000c9bb0000")).size());
        EXPECT_EQ(1u, log.count("ERR", "indexStrings is not member"));
        EXPECT_EQ(1u, log.count("ERR", "indexString not Array"));
    }

    Json::Value reply;
    {
        Script<libGetPortByWwn> get("wwn");
        EXPECT_EQ(0, helper()->getPortDetails(LEFT, reply));
        EXPECT_EQ(-1, helper()->getPortDetails("001122334455", reply));
        ASSERT_EQ(2u, get.requests.size());
        EXPECT_EQ("10:00:00:00:c9:aa:00:01", get.requests[0]["wwn"].asString());
        EXPECT_EQ("00:11:22:33:44:55", get.requests[1]["mac"].asString());

        get.on("10:00:00:00:c9:aa:00:01", parse(R"({"portStatus": false})"));
        get.on("10:00:00:00:c9:aa:00:02", parse(R"({"portStatus": "false"})"));
        get.on("10:00:00:00:c9:bb:00:01", Json::Value("throw"));
        EXPECT_TRUE(helper()->isPortDisabled(LEFT));
        EXPECT_FALSE(helper()->isPortDisabled(RIGHT));
        EXPECT_FALSE(helper()->isPortDisabled(MEZZ));
        EXPECT_EQ(1u, log.count("ERR", "Unable to get port status"));
        EXPECT_EQ(1u, log.count("ERR", std::string(MEZZ) +
            " - libGetPortByWwn got User exception 9: scripted"));
    }

    EXPECT_EQ(2, helper()->getNumberOfPorts("20000000c9aa0000", reply));
    EXPECT_EQ(-1, helper()->getNumberOfPorts("20000000c9ffffff", reply));
    EXPECT_EQ(1u, log.count("ERR",
        "libGetFcPhyPortIndicesByAdapter returns NULL for 20000000c9ffffff"));

    // This host has no optics; the default host has.
    EXPECT_EQ(-1, helper()->getOpticsInfo(LEFT, reply));
    EXPECT_EQ(1u, log.count("ERR", std::string("Unable to get SFP info for ") + LEFT));
    useDefaultHost();
    EXPECT_EQ(0, helper()->getOpticsInfo("100000051e8a1001", reply));
    EXPECT_EQ("SFP0001A", reply["serialNo"].asString());

    // A CNA is named by its MAC.
    EXPECT_EQ(1u, Walk(helper()->getFCPortInstancesByAdapter("00051e8b2000")).size());
}
