// PortHelper in the test process, against the simulated adapter library: a
// host of our own whose every member is spelled out, injected faults, and
// scripted replies for the shapes the simulator never answers.

#include "test_port_helper.h"

#include <string.h>

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
// a mezzanine card with one FCoE port.
const char* const HOST = R"({ "adapters": [
  { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00" },
    "fcPorts": [
      { "wwn": "10:00:00:00:c9:aa:00:01", "nodeWwn": "20:00:00:00:c9:aa:00:00",
        "PortSymbolicName": "left port", "operatingSpeed": 8, "supportedPortSpeeds": [16, 8],
        "portTypeMOFValue": 10, "maxFrameSize": 2048, "portStatusValue": 11,
        "beaconState": true,
        "remotePorts": [
          { "remotePortWwn": "50:00:00:00:00:00:00:01",
            "deviceData": { "isTarget": true, "type": "Disk", "stateMofValue": 2 } },
          { "remotePortWwn": "21:00:00:00:00:00:00:02",
            "deviceData": { "isTarget": false, "type": "Initiator", "stateMofValue": 2 } },
          { "remotePortWwn": "50:00:00:00:00:00:00:03",
            "deviceData": { "isTarget": true, "type": "Tape", "stateMofValue": 8 } } ] },
      { "wwn": "10:00:00:00:c9:aa:00:02", "nodeWwn": "20:00:00:00:c9:aa:00:00",
        "PortSymbolicName": "right port", "operatingSpeed": 8, "supportedPortSpeeds": [8],
        "portTypeMOFValue": 10, "maxFrameSize": 2112, "portStatusValue": 11,
        "linkUp": false } ] },
  { "hbaData": { "wwn": "20:00:00:00:c9:bb:00:00", "isMezz": true },
    "fcPorts": [
      { "wwn": "10:00:00:00:c9:bb:00:01", "operatingSpeed": 10, "supportedPortSpeeds": [10],
        "portTypeMOFValue": 10, "portStatusValue": 11, "isFCoE": true } ] } ] })";

const char* const LEFT = "10000000c9aa0001";
const char* const RIGHT = "10000000c9aa0002";
const char* const MEZZ = "10000000c9bb0001";

PortHelper* helper()
{
    return PortHelper::getPortHelperObject();
}

class PortHelperTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        workDir();
        useHost(HOST);
    }

    void TearDown() override
    {
        useDefaultHost();
    }
};

} // namespace

TEST_F(PortHelperTest, FCPortsCarryTheRepliesOfEveryAdapterInOrder)
{
    Walk w(helper()->getInstancesByClass(ID_VESPERA_FCPort));
    ASSERT_EQ(3u, w.size());

    VESPERA_FCPort* left = w.at<VESPERA_FCPort>(0);
    ASSERT_TRUE(left);
    EXPECT_EQ("VESPERA_FCPort", str(left->CreationClassName.value));
    EXPECT_EQ("VESPERA_ComputerSystem", str(left->SystemCreationClassName.value));
    EXPECT_EQ(hostString(), str(left->SystemName.value));
    EXPECT_EQ(LEFT, str(left->DeviceID.value));
    EXPECT_EQ(LEFT, str(left->PermanentAddress.value));
    EXPECT_EQ("20000000c9aa0000:10000000c9aa0001", str(left->ElementName.value));
    EXPECT_EQ("20000000c9aa0000:10000000c9aa0001", str(left->Name.value));
    EXPECT_EQ("left port", str(left->Caption.value));
    EXPECT_EQ(std::vector<uint16>{11}, vec(left->OperationalStatus));
    EXPECT_EQ(3, left->UsageRestriction.value);
    EXPECT_EQ(10, left->PortType.value);
    EXPECT_EQ(8000000000ULL, left->Speed.value);
    EXPECT_EQ(16000000000ULL, left->MaxSpeed.value);
    EXPECT_EQ(4, left->LinkTechnology.value);
    EXPECT_EQ(2048u, left->SupportedMaximumTransmissionUnit.value);
    EXPECT_EQ(0, left->PortNumber.value);
    EXPECT_EQ(2, left->EnabledState.value);
    EXPECT_EQ(2, left->EnabledDefault.value);

    // No light: the library says state 13 and speed 99999, which is no speed.
    VESPERA_FCPort* right = w.at<VESPERA_FCPort>(1);
    ASSERT_TRUE(right);
    EXPECT_EQ(RIGHT, str(right->DeviceID.value));
    EXPECT_EQ(1, right->PortNumber.value);
    EXPECT_EQ(std::vector<uint16>{13}, vec(right->OperationalStatus));
    EXPECT_EQ(6, right->EnabledState.value);
    EXPECT_EQ(0u, right->Speed.value);
    EXPECT_EQ(0, right->Speed.null);
    EXPECT_EQ(8000000000ULL, right->MaxSpeed.value);

    VESPERA_FCPort* mezz = w.at<VESPERA_FCPort>(2);
    ASSERT_TRUE(mezz);
    EXPECT_EQ(MEZZ, str(mezz->DeviceID.value));
    EXPECT_EQ(0, mezz->PortNumber.value);
    EXPECT_EQ(10000000000ULL, mezz->Speed.value);
}

TEST_F(PortHelperTest, EnabledStateFollowsThePortState)
{
    const int states[] = {8, 9, 10, 11, 13, 0, 12, -1};
    const uint16 enabled[] = {9, 4, 3, 2, 6, 1, 1, 1};

    for (size_t i = 0; i < sizeof(states) / sizeof(states[0]); i++)
        EXPECT_EQ(enabled[i], PortHelper::getEnabledState(states[i])) << states[i];
}

TEST_F(PortHelperTest, PortsOfOneNodeShareTheGroupButNotTheName)
{
    Walk w(helper()->getInstancesByClass(ID_VESPERA_LogicalPortGroup));
    ASSERT_EQ(3u, w.size());

    VESPERA_LogicalPortGroup* a = w.at<VESPERA_LogicalPortGroup>(0);
    VESPERA_LogicalPortGroup* b = w.at<VESPERA_LogicalPortGroup>(1);
    ASSERT_TRUE(a && b);
    EXPECT_EQ("20000000c9aa0000", str(a->InstanceID.value));
    EXPECT_EQ(str(a->InstanceID.value), str(b->InstanceID.value));
    EXPECT_EQ(LEFT, str(a->Name.value));
    EXPECT_EQ(RIGHT, str(b->Name.value));
    EXPECT_EQ("WWN", str(a->NameFormat.value));
    EXPECT_EQ("20000000c9aa0000:10000000c9aa0002", str(b->ElementName.value));
    EXPECT_EQ(hostString(), str(a->Caption.value));
    EXPECT_EQ(hostString(), str(a->Description.value));
}

TEST_F(PortHelperTest, EndpointsAreThePortThenItsTargetsInRemoteOrder)
{
    Walk w(helper()->getInstancesByClass(ID_VESPERA_SCSIProtocolEndpoint));

    // left: itself and two targets (the initiator between them is left out);
    // right and the mezzanine port: themselves.
    ASSERT_EQ(5u, w.size());

    VESPERA_SCSIProtocolEndpoint* self = w.at<VESPERA_SCSIProtocolEndpoint>(0);
    ASSERT_TRUE(self);
    EXPECT_EQ("VESPERA_SCSIProtocolEndpoint", str(self->CreationClassName.value));
    EXPECT_EQ("VESPERA_ComputerSystem", str(self->SystemCreationClassName.value));
    EXPECT_EQ(hostString(), str(self->SystemName.value));
    EXPECT_EQ(LEFT, str(self->Name.value));
    EXPECT_EQ(LEFT, str(self->ElementName.value));
    EXPECT_EQ(2, self->Role.value);
    EXPECT_EQ(1, self->ProtocolIFType.value);
    EXPECT_EQ("SCSI", str(self->OtherTypeDescription.value));
    EXPECT_EQ(2, self->ConnectionType.value);
    EXPECT_EQ(std::vector<uint16>{11}, vec(self->OperationalStatus));
    EXPECT_EQ(2, self->EnabledState.value);

    VESPERA_SCSIProtocolEndpoint* disk = w.at<VESPERA_SCSIProtocolEndpoint>(1);
    VESPERA_SCSIProtocolEndpoint* tape = w.at<VESPERA_SCSIProtocolEndpoint>(2);
    ASSERT_TRUE(disk && tape);

    // Longer than a WWN field: the whole name must survive.
    EXPECT_EQ(std::string(LEFT) + "_5000000000000001", str(disk->Name.value));
    EXPECT_EQ(str(disk->Name.value), str(disk->ElementName.value));
    EXPECT_EQ(3, disk->Role.value);
    EXPECT_EQ(std::vector<uint16>{2}, vec(disk->OperationalStatus));
    EXPECT_EQ(1, disk->EnabledState.value);

    EXPECT_EQ(std::string(LEFT) + "_5000000000000003", str(tape->Name.value));
    EXPECT_EQ(std::vector<uint16>{8}, vec(tape->OperationalStatus));
    EXPECT_EQ(9, tape->EnabledState.value);

    EXPECT_EQ(RIGHT, str(w.at<VESPERA_SCSIProtocolEndpoint>(3)->Name.value));
    EXPECT_EQ(MEZZ, str(w.at<VESPERA_SCSIProtocolEndpoint>(4)->Name.value));
}

TEST_F(PortHelperTest, BeaconsOfPortsButNotOfMezzanineCards)
{
    Walk w(helper()->getInstancesByClass(ID_VESPERA_AlarmDevice));
    ASSERT_EQ(2u, w.size());

    VESPERA_AlarmDevice* on = w.at<VESPERA_AlarmDevice>(0);
    VESPERA_AlarmDevice* off = w.at<VESPERA_AlarmDevice>(1);
    ASSERT_TRUE(on && off);
    EXPECT_EQ("VESPERA_AlarmDevice", str(on->CreationClassName.value));
    EXPECT_EQ("VESPERA_ComputerSystem", str(on->SystemCreationClassName.value));
    EXPECT_EQ(hostString(), str(on->SystemName.value));
    EXPECT_EQ(hostString(), str(on->Description.value));
    EXPECT_EQ(LEFT, str(on->DeviceID.value));
    EXPECT_EQ(LEFT, str(on->ElementName.value));
    EXPECT_EQ("left port", str(on->Caption.value));
    EXPECT_TRUE(on->VisibleAlarm.value);
    EXPECT_EQ(3, on->Urgency.value);
    EXPECT_EQ(3, on->AlarmState.value);
    EXPECT_EQ(RIGHT, str(off->DeviceID.value));
    EXPECT_EQ(1, off->AlarmState.value);
}

TEST_F(PortHelperTest, SetAlarmStateSwitchesTheBeaconOnce)
{
    // Both address forms name the port.
    EXPECT_EQ(1, helper()->setAlarmState(RIGHT, 3));
    EXPECT_EQ(3, helper()->setAlarmState("10:00:00:00:c9:aa:00:02", 3));

    {
        Walk w(helper()->getInstancesByClass(ID_VESPERA_AlarmDevice));
        ASSERT_EQ(2u, w.size());
        EXPECT_EQ(3, w.at<VESPERA_AlarmDevice>(1)->AlarmState.value);
    }

    // Any state but 3 means off.
    EXPECT_EQ(1, helper()->setAlarmState(RIGHT, 2));
    EXPECT_EQ(3, helper()->setAlarmState(RIGHT, 1));

    Log log;
    EXPECT_EQ(2, helper()->setAlarmState(MEZZ, 3));
    EXPECT_EQ(1u, log.count("WARN", "setAlarmState: Operation not supported on Mezz cards"));
    EXPECT_EQ(0, helper()->setAlarmState("10000000c9ffffff", 3));
    EXPECT_EQ(1u, log.count("ERR", "Current ALARM STATE is not available"));
}

TEST_F(PortHelperTest, SetAlarmStateAsksNoChangeOfARepeatedStateAndReportsRefusals)
{
    {
        Script<libSetPortByWwn> set("indexStr");
        EXPECT_EQ(3, helper()->setAlarmState(LEFT, 3));
        EXPECT_TRUE(set.requests.empty());

        EXPECT_EQ(1, helper()->setAlarmState(LEFT, 1));
        ASSERT_EQ(1u, set.requests.size());
        const Json::Value& r = set.requests[0];
        EXPECT_EQ("10:00:00:00:c9:aa:00:01", r["indexStr"].asString());
        EXPECT_EQ(false, r["port"]["beaconState"].asBool());
        EXPECT_EQ("10:00:00:00:c9:aa:00:01", r["port"]["wwn"].asString());
        EXPECT_EQ(parse(R"(["beaconState"])"), r["propArray"]);
    }

    Log log;
    {
        Script<libSetPortByWwn> set("indexStr");
        set.on("10:00:00:00:c9:aa:00:01", parse(R"({"error": {"code": 1}})"));
        EXPECT_EQ(0, helper()->setAlarmState(LEFT, 3));
        set.on("10:00:00:00:c9:aa:00:01", Json::Value("throw"));
        EXPECT_EQ(0, helper()->setAlarmState(LEFT, 3));
    }
    EXPECT_EQ(1u, log.count("ERR", "libSetPortByWwn response is null or has error"));
    EXPECT_EQ(1u, log.count("ERR", "libSetPortByWwn got User exception 9: scripted"));

    // A reply without a beacon, or with one of the wrong type, can't be
    // switched.
    Script<libGetPortByWwn> get("wwn");
    get.on("10:00:00:00:c9:aa:00:01", parse(R"({"isMezz": false})"));
    get.on("10:00:00:00:c9:aa:00:02", parse(R"({"isMezz": false, "beaconState": "on"})"));
    EXPECT_EQ(0, helper()->setAlarmState(LEFT, 3));
    EXPECT_EQ(0, helper()->setAlarmState(RIGHT, 3));
    EXPECT_EQ(2u, log.count("ERR", "Current ALARM STATE is not available"));
}

TEST_F(PortHelperTest, StatisticsOfFCPortsByIdWithTheLaterIdWinning)
{
    Script<libGetDynamicPortStatistics> stats("indexStr");
    stats.on("10:00:00:00:c9:aa:00:01", parse(R"([
        {"id": 1402, "value": "10"}, {"id": 1403, "value": "100"},
        {"id": 1409, "value": "20"}, {"id": 1410, "value": "200"},
        {"id": 1411, "value": "1"}, {"id": 1412, "value": "2"},
        {"id": 1421, "value": "3"}, {"id": 1422, "value": "4"},
        {"id": 1423, "value": "5"}, {"id": 1424, "value": "6"},
        {"id": 1425, "value": "7"}, {"id": 1426, "value": "8"},
        {"id": 1428, "value": "9"}, {"id": 1404, "value": "999"},
        {"id": 1402, "value": "11"}, {"id": 1616, "value": "77"}])"));

    // Malformed elements are passed over; a negative count reads as 0.
    stats.on("10:00:00:00:c9:aa:00:02", parse(R"([
        {"id": 1402, "value": 5}, {"id": "1409", "value": "6"}, 7,
        {"id": 1411, "value": "-4"}, {"id": 1412, "value": "12abc"},
        {"id": 1416, "value": "99999999999999999999"}])"));

    Walk w(helper()->getInstancesByClass(ID_VESPERA_FCPortStatistics));
    ASSERT_EQ(3u, w.size());

    VESPERA_FCPortStatistics* s = w.at<VESPERA_FCPortStatistics>(0);
    ASSERT_TRUE(s);
    EXPECT_EQ(LEFT, str(s->InstanceID.value));
    EXPECT_EQ("FC Port Statistics", str(s->ElementName.value));
    EXPECT_EQ(11u, s->PacketsTransmitted.value);
    EXPECT_EQ(400u, s->BytesTransmitted.value);
    EXPECT_EQ(20u, s->PacketsReceived.value);
    EXPECT_EQ(800u, s->BytesReceived.value);
    EXPECT_EQ(1u, s->LIPCount.value);
    EXPECT_EQ(2u, s->NOSCount.value);
    EXPECT_EQ(3u, s->ErrorFrames.value);
    EXPECT_EQ(4u, s->DumpedFrames.value);
    EXPECT_EQ(5u, s->LinkFailures.value);
    EXPECT_EQ(6u, s->LossOfSyncCounter.value);
    EXPECT_EQ(7u, s->LossOfSignalCounter.value);
    EXPECT_EQ(8u, s->PrimitiveSeqProtocolErrCount.value);
    EXPECT_EQ(9u, s->InvalidTransmissionWords.value);

    // No 1416 (and 1616 isn't an FC id): zero, but a value all the same.
    EXPECT_EQ(0u, s->CRCErrors.value);
    EXPECT_EQ(0, s->CRCErrors.null);

    VESPERA_FCPortStatistics* odd = w.at<VESPERA_FCPortStatistics>(1);
    ASSERT_TRUE(odd);
    EXPECT_EQ(0u, odd->PacketsTransmitted.value);
    EXPECT_EQ(0u, odd->PacketsReceived.value);
    EXPECT_EQ(0u, odd->LIPCount.value);
    EXPECT_EQ(12u, odd->NOSCount.value);
    EXPECT_EQ(9223372036854775807ULL, odd->CRCErrors.value);
}

TEST_F(PortHelperTest, StatisticsOfFCoEPortsSumTheirCounters)
{
    Script<libGetDynamicPortStatistics> stats("indexStr");
    stats.on("10:00:00:00:c9:bb:00:01", parse(R"([
        {"id": 1603, "value": "1"}, {"id": 1604, "value": "2"}, {"id": 1605, "value": "3"},
        {"id": 1606, "value": "10"}, {"id": 1607, "value": "20"}, {"id": 1608, "value": "30"},
        {"id": 1609, "value": "4"}, {"id": 1610, "value": "5"}, {"id": 1611, "value": "6"},
        {"id": 1612, "value": "40"}, {"id": 1613, "value": "50"}, {"id": 1614, "value": "60"},
        {"id": 1615, "value": "100"}, {"id": 1616, "value": "7"}, {"id": 1624, "value": "300"},
        {"id": 1625, "value": "1000"}, {"id": 1627, "value": "10000"}, {"id": 1628, "value": "100000"},
        {"id": 1626, "value": "9"}, {"id": 1402, "value": "55"}, {"id": 1411, "value": "66"}])"));

    Walk w(helper()->getInstancesByClass(ID_VESPERA_FCPortStatistics));
    ASSERT_EQ(3u, w.size());

    VESPERA_FCPortStatistics* s = w.at<VESPERA_FCPortStatistics>(2);
    ASSERT_TRUE(s);
    EXPECT_EQ(MEZZ, str(s->InstanceID.value));
    EXPECT_EQ(6u, s->PacketsTransmitted.value);
    EXPECT_EQ(60u, s->BytesTransmitted.value);
    EXPECT_EQ(15u, s->PacketsReceived.value);
    EXPECT_EQ(150u, s->BytesReceived.value);

    // 1626 came after 1616, so the CRC count is 9 wherever it shows.
    EXPECT_EQ(9u, s->CRCErrors.value);
    EXPECT_EQ(111109u, s->ErrorFrames.value);
    EXPECT_EQ(300u, s->DumpedFrames.value);

    // FC counters have no place on an FCoE port.
    EXPECT_EQ(0u, s->LIPCount.value);
    EXPECT_EQ(0, s->LIPCount.null);
    EXPECT_EQ(0u, s->NOSCount.value);
    EXPECT_EQ(0u, s->LinkFailures.value);
    EXPECT_EQ(0u, s->LossOfSignalCounter.value);
    EXPECT_EQ(0u, s->LossOfSyncCounter.value);
    EXPECT_EQ(0u, s->PrimitiveSeqProtocolErrCount.value);
    EXPECT_EQ(0u, s->InvalidTransmissionWords.value);
}

TEST_F(PortHelperTest, StatisticsThatCantBeReadLeaveThePortOut)
{
    Log log;
    {
        Script<libGetDynamicPortStatistics> stats("indexStr");
        stats.on("10:00:00:00:c9:aa:00:01", parse("[]"));
        stats.on("10:00:00:00:c9:aa:00:02", parse(R"({"id": 1402, "value": "1"})"));
        stats.on("10:00:00:00:c9:bb:00:01", Json::Value("throw"));

        Walk w(helper()->getInstancesByClass(ID_VESPERA_FCPortStatistics));
        EXPECT_EQ(0u, w.size());
    }
    EXPECT_EQ(1u, log.count("WARN", "libGetDynamicPortStatistics failed for port WWN= " +
        std::string(LEFT)));
    EXPECT_EQ(1u, log.count("WARN", "libGetDynamicPortStatistics failed for port WWN= " +
        std::string(RIGHT)));
    EXPECT_EQ(1u, log.count("ERR", "libGetDynamicPortStatisticsat got User exception 9: scripted"));

    // The simulator's own statistics give one instance per port.
    Walk w(helper()->getInstancesByClass(ID_VESPERA_FCPortStatistics));
    EXPECT_EQ(3u, w.size());
}

TEST_F(PortHelperTest, AFailedPortOrAdapterLeavesTheOthers)
{
    struct Case
    {
        const char* entry;
        const char* fault;
        size_t ports;
        const char* level;
        const char* line;
    };
    const Case cases[] = {
        { "getPortByWwn", R"({"kind": "error", "count": 1})", 2, "ERR",
          "libGetPortByWwn response is null or has error" },
        { "getPortByWwn", R"({"kind": "null", "count": 1})", 2, "ERR",
          "libGetPortByWwn response is null or has error" },
        { "getPortByWwn", R"({"kind": "hba", "code": 7, "message": "port busy", "count": 1})", 2,
          "ERR", "libGetPortByWwn got User exception 7: port busy" },
        { "getPortByWwn", R"({"kind": "std", "message": "bad port", "count": 1})", 2, "ERR",
          "libGetPortByWwn got std exception: bad port" },
        { "getPortByWwn", R"({"kind": "unknown", "count": 1})", 2, "ERR",
          "libGetPortByWwn got default exception" },
        { "getFcPhyPortIndicesByAdapter", R"({"kind": "error", "count": 1})", 1, "ERR",
          "libGetFcPhyPortIndicesByAdapter returns NULL." },
        { "getFcPhyPortIndicesByAdapter", R"({"kind": "hba", "code": 3, "message": "gone", "count": 1})",
          1, "ERR", "libGetFcPhyPortIndicesByAdapter got User exception 3: gone" },
        { "getFcPhyPortIndicesByAdapter", R"({"kind": "std", "message": "gone", "count": 1})",
          1, "ERR", "libGetFcPhyPortIndicesByAdapter got std exception: gone" },
        { "getFcPhyPortIndicesByAdapter", R"({"kind": "unknown", "count": 1})",
          1, "ERR", "libGetFcPhyPortIndicesByAdapter got default exception" },
        { "getAllAdaptersIndexString", "error", 0, "ERR",
          "libGetAllAdaptersIndexString returns NULL." },
        { "getAllAdaptersIndexString", "hba", 0, "ERR",
          "libGetAllAdaptersIndexString returns NULL." },
    };

    for (const Case& c : cases)
    {
        useHost(HOST);
        ASSERT_EQ(0, dtruj_sim_set_fault(c.entry, c.fault)) << c.fault;

        Log log;
        Walk w(helper()->getInstancesByClass(ID_VESPERA_FCPort));
        EXPECT_EQ(c.ports, w.size()) << c.entry << " " << c.fault;
        EXPECT_EQ(1u, log.count(c.level, c.line)) << c.entry << " " << c.fault << "\n" << log.text();

        // The last port always survives: it is neither the first port nor of
        // the first adapter.
        if (c.ports)
        {
            EXPECT_EQ(MEZZ, str(w.at<VESPERA_FCPort>(c.ports - 1)->DeviceID.value));
        }
    }

    useHost(R"({"adapters": []})");
    Log log;
    Walk w(helper()->getInstancesByClass(ID_VESPERA_FCPort));
    EXPECT_EQ(0u, w.size());
    EXPECT_EQ(1u, log.count("WARN", "No adapters in the system. "));
}

TEST_F(PortHelperTest, RemotePortsThatCantBeReadAreSkipped)
{
    Log log;
    {
        Script<libGetCompleteRemotePort> complete("rPortWwn");
        complete.on("50:00:00:00:00:00:00:01", Json::Value("throw"));
        complete.on("50:00:00:00:00:00:00:03", parse(R"({"deviceData": null})"));

        Walk w(helper()->getInstancesByAdapterAddress("20000000c9aa0000",
            ID_VESPERA_SCSIProtocolEndpoint));
        ASSERT_EQ(2u, w.size());
        EXPECT_EQ(LEFT, str(w.at<VESPERA_SCSIProtocolEndpoint>(0)->Name.value));
        EXPECT_EQ(RIGHT, str(w.at<VESPERA_SCSIProtocolEndpoint>(1)->Name.value));
    }
    EXPECT_EQ(1u, log.count("ERR", "libGetCompleteRemotePort got User exception 9: scripted"));
    EXPECT_EQ(1u, log.count("ERR",
        "libGetCompleteRemotePort returned NULL for 50:00:00:00:00:00:00:03"));

    Log log2;
    {
        Script<libGetAllRemotePorts> remotes("pPortWwn");
        remotes.on("10:00:00:00:c9:aa:00:01", parse(R"([{"remotePortWwn": 5},
            {"remotePortWwn": "50:00:00:00:00:00:00:03"}])"));
        remotes.on("10:00:00:00:c9:aa:00:02", parse(R"({"remotePortWwn": "x"})"));

        Walk w(helper()->getInstancesByAdapterAddress("20000000c9aa0000",
            ID_VESPERA_SCSIProtocolEndpoint));
        ASSERT_EQ(3u, w.size());
        EXPECT_EQ(std::string(LEFT) + "_5000000000000003",
            str(w.at<VESPERA_SCSIProtocolEndpoint>(1)->Name.value));
        ASSERT_FALSE(remotes.requests.empty());
        EXPECT_EQ("10:00:00:00:c9:aa:00:01", remotes.requests[0]["lPortWwn"].asString());
        EXPECT_EQ("10:00:00:00:c9:aa:00:01", remotes.requests[0]["pPortWwn"].asString());
    }
    EXPECT_EQ(1u, log2.count("ERR", "libGetAllRemotePorts returns NULL."));
}

TEST_F(PortHelperTest, OddPortRepliesGiveZerosAndCutTextsNeverMore)
{
    std::string longName(5000, 'n');
    Json::Value odd = parse(R"({"wwn": "10:00:00:00:c9:aa:00:01", "nodeWwn": ["x"],
        "PortSymbolicName": 42, "operatingSpeed": "8", "supportedPortSpeeds": "16",
        "portTypeMOFValue": -3.5, "maxFrameSize": -1, "portStatusValue": "11",
        "isMezz": 0, "beaconState": "yes"})");

    // Far more than an 8-byte speed can hold in bit/s.
    Json::Value huge = parse(R"({"wwn": "10:00:00:00:c9:aa:00:02",
        "operatingSpeed": 99999999999999, "supportedPortSpeeds": [-16]})");
    huge["PortSymbolicName"] = longName;
    huge["nodeWwn"] = std::string(100, 'a');

    Log log;
    Script<libGetPortByWwn> get("wwn");
    get.on("10:00:00:00:c9:aa:00:01", odd);
    get.on("10:00:00:00:c9:aa:00:02", huge);
    get.on("10:00:00:00:c9:bb:00:01", parse(R"({"portStatusValue": 10})"));

    Walk w(helper()->getInstancesByClass(ID_VESPERA_FCPort));
    ASSERT_EQ(3u, w.size());

    VESPERA_FCPort* a = w.at<VESPERA_FCPort>(0);
    EXPECT_EQ(LEFT, str(a->DeviceID.value));
    EXPECT_EQ(":" + std::string(LEFT), str(a->Name.value));
    EXPECT_EQ("", str(a->Caption.value));
    EXPECT_EQ(0u, a->Speed.value);
    EXPECT_EQ(0u, a->MaxSpeed.value);
    EXPECT_EQ(0u, a->SupportedMaximumTransmissionUnit.value);
    EXPECT_EQ(std::vector<uint16>{0}, vec(a->OperationalStatus));
    EXPECT_EQ(1, a->EnabledState.value);

    VESPERA_FCPort* b = w.at<VESPERA_FCPort>(1);
    EXPECT_EQ(1027u, str(b->Caption.value).size());
    EXPECT_EQ(std::string(23, 'a') + ":" + RIGHT, str(b->Name.value));
    EXPECT_EQ(0u, b->Speed.value);
    EXPECT_EQ(0u, b->MaxSpeed.value);
    EXPECT_EQ(1u, log.count("WARN", "PortSymbolicName is longer than 1027 characters"));

    // A reply that doesn't name the port is named by what it was asked for.
    VESPERA_FCPort* c = w.at<VESPERA_FCPort>(2);
    EXPECT_EQ(MEZZ, str(c->DeviceID.value));
    EXPECT_EQ(3, c->EnabledState.value);
    EXPECT_EQ(1u, log.count("WARN", "Port reply for 10:00:00:00:c9:bb:00:01 has no wwn"));

    // Without a beacon of the right type, no alarm device.
    Walk alarms(helper()->getInstancesByClass(ID_VESPERA_AlarmDevice));
    EXPECT_EQ(0u, alarms.size());
    EXPECT_EQ(1u, log.count("INFO", "beaconState is NOT available failed for " +
        std::string(LEFT) + "."));
}

TEST_F(PortHelperTest, RepliesThatAreNoObjectSkipThePort)
{
    Log log;
    Script<libGetPortByWwn> get("wwn");
    get.on("10:00:00:00:c9:aa:00:01", parse("[1, 2]"));
    get.on("10:00:00:00:c9:aa:00:02", Json::Value("text"));

    Script<libGetFcPhyPortIndicesByAdapter> ports("indexStr");
    ports.on("20:00:00:00:c9:bb:00:00", parse(R"({"indexStrings": [7, null,
        "10:00:00:00:c9:bb:00:01"]})"));

    Walk w(helper()->getInstancesByClass(ID_VESPERA_LogicalPortGroup));
    ASSERT_EQ(1u, w.size());
    EXPECT_EQ(MEZZ, str(w.at<VESPERA_LogicalPortGroup>(0)->Name.value));
    EXPECT_EQ(2u, log.count("ERR", "libGetPortByWwn response is null or has error"));
    EXPECT_EQ(2u, log.count("ERR", "has no index string"));
}

TEST_F(PortHelperTest, WalkOfOneAdapterByAddress)
{
    // Plain and colon forms name the same adapter.
    for (const char* address : {"20000000c9aa0000", "20:00:00:00:c9:aa:00:00"})
    {
        Walk w(helper()->getFCPortInstancesByAdapter(address));
        ASSERT_EQ(2u, w.size()) << address;
        EXPECT_EQ(LEFT, str(w.at<VESPERA_FCPort>(0)->DeviceID.value));
        EXPECT_EQ(RIGHT, str(w.at<VESPERA_FCPort>(1)->DeviceID.value));
    }

    Log log;
    EXPECT_EQ(0u, Walk(helper()->getInstancesByAdapterAddress("20000000c9aa0000",
        ID_VESPERA_LogicalDisk)).size());
    EXPECT_EQ(0u, Walk(helper()->getInstancesByClass(ID_VESPERA_PortController)).size());
    EXPECT_EQ(2u, log.count("INFO", "Unhandled class support"));

    EXPECT_EQ(0u, Walk(helper()->getFCPortInstancesByAdapter("20000000c9ffffff")).size());
    EXPECT_EQ(1u, log.count("ERR", "libGetFcPhyPortIndicesByAdapter returns NULL"));

    Script<libGetFcPhyPortIndicesByAdapter> ports("indexStr");
    ports.on("20:00:00:00:c9:aa:00:00", parse(R"({"count": 2})"));
    ports.on("20:00:00:00:c9:bb:00:00", parse(R"({"indexStrings": "10:00:00:00:c9:bb:00:01"})"));
    EXPECT_EQ(0u, Walk(helper()->getFCPortInstancesByAdapter("20000000c9aa0000")).size());
    EXPECT_EQ(0u, Walk(helper()->getFCPortInstancesByAdapter("20000000c9bb0000")).size());
    EXPECT_EQ(1u, log.count("ERR", "indexStrings is not member"));
    EXPECT_EQ(1u, log.count("ERR", "indexString not Array"));
}

TEST_F(PortHelperTest, SinglePortLookUps)
{
    Json::Value reply;

    {
        Script<libGetPortByWwn> get("wwn");
        EXPECT_EQ(0, helper()->getPortDetails(LEFT, reply));
        EXPECT_EQ(-1, helper()->getPortDetails("001122334455", reply));
        ASSERT_EQ(2u, get.requests.size());
        EXPECT_EQ("10:00:00:00:c9:aa:00:01", get.requests[0]["wwn"].asString());
        EXPECT_EQ("00:11:22:33:44:55", get.requests[1]["mac"].asString());
        EXPECT_FALSE(get.requests[1].isMember("wwn"));
    }

    EXPECT_FALSE(helper()->isPortDisabled(LEFT));
    {
        Script<libGetPortByWwn> get("wwn");
        get.on("10:00:00:00:c9:aa:00:01", parse(R"({"portStatus": false})"));
        get.on("10:00:00:00:c9:aa:00:02", parse(R"({"portStatus": "false"})"));
        get.on("10:00:00:00:c9:bb:00:01", Json::Value("throw"));

        Log log;
        EXPECT_TRUE(helper()->isPortDisabled(LEFT));
        EXPECT_FALSE(helper()->isPortDisabled(RIGHT));
        EXPECT_FALSE(helper()->isPortDisabled(MEZZ));
        EXPECT_EQ(1u, log.count("ERR", "Unable to get port status"));
        EXPECT_EQ(1u, log.count("ERR", std::string(MEZZ) +
            " - libGetPortByWwn got User exception 9: scripted"));
    }

    EXPECT_EQ(2, helper()->getNumberOfPorts("20000000c9aa0000", reply));
    EXPECT_EQ(2u, reply["indexStrings"].size());
    Log log;
    EXPECT_EQ(-1, helper()->getNumberOfPorts("20000000c9ffffff", reply));
    EXPECT_EQ(1u, log.count("ERR",
        "libGetFcPhyPortIndicesByAdapter returns NULL for 20000000c9ffffff"));

    // The host of this test has no optics; the default host has.
    EXPECT_EQ(-1, helper()->getOpticsInfo(LEFT, reply));
    EXPECT_EQ(1u, log.count("ERR", std::string("Unable to get SFP info for ") + LEFT));
    useDefaultHost();
    EXPECT_EQ(0, helper()->getOpticsInfo("100000051e8a1001", reply));
    EXPECT_EQ("SFP0001A", reply["serialNo"].asString());
}
