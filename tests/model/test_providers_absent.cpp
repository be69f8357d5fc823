// The inventory on a host whose replies lack members, as a WBEM client sees
// it: every class still answers, and a property that rests on a missing
// member follows the rule for that member: most read as zero or empty.

#include <algorithm>

#include "ProvidersSupport.h"

using namespace providers_test;

namespace
{

// Every class the module has a provider for.
std::vector<std::string> providedClasses()
{
    std::vector<std::string> classes;
    const std::string suffix = "_Provider.h";
    for (const auto& f : std::filesystem::directory_iterator(std::string(VSPR_SOURCE_DIR) + "/model"))
    {
        std::string name = f.path().filename().string();
        if (name.compare(0, 8, "VESPERA_") == 0 && name.size() > suffix.size() &&
            name.compare(name.size() - suffix.size(), suffix.size(), suffix) == 0)
            classes.push_back(name.substr(0, name.size() - suffix.size()));
    }
    std::sort(classes.begin(), classes.end());
    return classes;
}

// An FC HBA whose ports tell little: the first nothing but its address, the
// second an empty speed list and no beacon, the third a beacon but no word
// of a mezzanine card. Behind the first port, a remote port without device
// data, a disk without units and a tape whose unit has no description. A CNA
// without a node WWN, whose FC port therefore has none either, and whose
// Ethernet port has neither device name, MTU nor optics.
const char* const SPARSE = R"({ "adapters": [
  { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00" },
    "driver": { "storageDriverName": "vsprfc" },
    "fcPorts": [
      { "wwn": "10:00:00:00:c9:aa:00:01",
        "remotePorts": [
          { "remotePortWwn": "50:00:00:00:00:00:00:01" },
          { "remotePortWwn": "50:00:00:00:00:00:00:02",
            "deviceData": { "isTarget": true, "type": "Disk" } },
          { "remotePortWwn": "50:00:00:00:00:00:00:03",
            "deviceData": { "isTarget": true, "type": "Tape" },
            "lunList": [ { "number": 0, "vendor": "VSPRTAPE", "productID": "TD8" } ] } ] },
      { "wwn": "10:00:00:00:c9:aa:00:02", "operatingSpeed": 8, "supportedPortSpeeds": [],
        "isMezz": false },
      { "wwn": "10:00:00:00:c9:aa:00:03", "beaconState": true } ] },
  { "hbaData": { "hbaMAC": "00:05:1e:00:00:00" },
    "driver": { "networkDriverName": "vspreth" },
    "fcPorts": [ { "wwn": "10:00:00:00:c9:bb:00:01", "isFCoE": true } ],
    "ethPorts": [ { "mac": "00:05:1e:00:00:01" } ] } ] })";

class Absent : public ProvidersTest
{
protected:
    void SetUp() override
    {
        ProvidersTest::SetUp();
        useHost(parseJson(SPARSE));
    }

    static const ch::Instance* find(const std::vector<ch::Instance>& all, const char* key,
        const std::string& value)
    {
        for (const ch::Instance& i : all)
            if (i.get_text(key) == value)
                return &i;
        ADD_FAILURE() << "no instance with " << key << " " << value;
        return 0;
    }
};

} // namespace

TEST_F(Absent, EveryClassAnswers)
{
    std::vector<std::string> classes = providedClasses();
    ASSERT_GT(classes.size(), 40u);
    for (const std::string& cls : classes)
    {
        ch::Result r = ei(cls);
        EXPECT_EQ(CMPI_RC_OK, r.rc) << cls << ": " << r.message;
    }
}

TEST_F(Absent, FCPortsShowNoValueTheyWerentGiven)
{
    std::vector<ch::Instance> ports = served("VESPERA_FCPort");
    ASSERT_EQ(4u, ports.size());

    const ch::Instance* bare = find(ports, "DeviceID", "10000000c9aa0001");
    ASSERT_TRUE(bare);
    // What the reply left out reads as the record's zero.
    EXPECT_EQ("", text(*bare, "Caption"));
    for (const char* p : { "Speed", "MaxSpeed", "SupportedMaximumTransmissionUnit" })
        EXPECT_EQ(0u, bare->get(p)->num.uint64) << p;
    EXPECT_EQ(0u, bare->get("PortType")->num.uint16);
    // The node is the adapter's; the state is one the library always tells.
    EXPECT_EQ("20000000c9aa0000:10000000c9aa0001", text(*bare, "Name"));
    EXPECT_EQ(2u, bare->get("EnabledState")->num.uint16);

    const ch::Instance* noSpeeds = find(ports, "DeviceID", "10000000c9aa0002");
    ASSERT_TRUE(noSpeeds);
    EXPECT_EQ(0u, noSpeeds->get("MaxSpeed")->num.uint64);
    EXPECT_EQ(8000000000ULL, noSpeeds->get("Speed")->num.uint64);

    // Without a node its part of the name is empty.
    const ch::Instance* nodeless = find(ports, "DeviceID", "10000000c9bb0001");
    ASSERT_TRUE(nodeless);
    EXPECT_EQ(":10000000c9bb0001", text(*nodeless, "Name"));
    EXPECT_EQ(":10000000c9bb0001", text(*nodeless, "ElementName"));

    // A node is a group only if a port names it.
    LogMark mark;
    std::vector<ch::Instance> groups = served("VESPERA_LogicalPortGroup");
    ASSERT_EQ(1u, groups.size());
    EXPECT_EQ("20000000c9aa0000", text(groups[0], "InstanceID"));
    EXPECT_EQ(1u, countLines(mark.text(), {"WARN", "No logical port group for 10000000c9bb0001"}));
}

TEST_F(Absent, NoBeaconWithoutBothItsStateAndTheCardKind)
{
    LogMark mark;
    EXPECT_TRUE(served("VESPERA_AlarmDevice").empty());
    EXPECT_EQ(4u, countLines(mark.text(), {"INFO", "beaconState is NOT available failed for "}));

    // Switching it fails for the same reason, before anything is sent.
    ch::Object_Path alarm = served("VESPERA_FCPort").at(0).path;
    alarm.class_name = "VESPERA_AlarmDevice";
    for (ch::Property& k : alarm.keys)
        if (k.name == "CreationClassName")
            k.value = ch::Value::of_string("VESPERA_AlarmDevice");
    LogMark set;
    ch::Result r = setAlarm(alarm, 3);
    ASSERT_EQ(CMPI_RC_OK, r.rc) << r.message;
    EXPECT_EQ(2u, r.return_value.num.uint32);
    EXPECT_EQ(1u, countLines(set.text(), {"ERR", "Current ALARM STATE is not available"}));
    EXPECT_EQ(0u, countLines(set.text(), {"libSetPortByWwn"}));
}

TEST_F(Absent, TargetsWithoutDeviceDataOrUnits)
{
    LogMark mark;
    std::vector<ch::Instance> endpoints = served("VESPERA_SCSIProtocolEndpoint");
    // Four initiators, and the two remote ports that say they are targets.
    ASSERT_EQ(6u, endpoints.size());
    EXPECT_EQ(1u, countLines(mark.text(),
        {"ERR", "libGetCompleteRemotePort returned NULL for 50:00:00:00:00:00:00:01"}));
    const ch::Instance* disk = find(endpoints, "Name", "10000000c9aa0001_5000000000000002");
    ASSERT_TRUE(disk);
    EXPECT_EQ(3u, disk->get("Role")->num.uint16);

    LogMark units;
    EXPECT_TRUE(served("VESPERA_StorageExtent").empty());
    EXPECT_TRUE(served("VESPERA_LogicalDisk").empty());
    // Once for each of the two classes.
    EXPECT_EQ(2u, countLines(units.text(),
        {"ERR", "No LUN Info is available for Rport 50:00:00:00:00:00:00:02."}));

    std::vector<ch::Instance> tapes = served("VESPERA_TapeDrive");
    ASSERT_EQ(1u, tapes.size());
    EXPECT_EQ("Unable To Fetch", text(tapes[0], "Name"));
    EXPECT_EQ("LUN_0", text(tapes[0], "ElementName"));
}

TEST_F(Absent, AnEthernetPortWithoutNameMtuOrOptics)
{
    std::vector<ch::Instance> ports = served("VESPERA_EthernetPort");
    ASSERT_EQ(1u, ports.size());
    EXPECT_EQ("", text(ports[0], "ElementName"));
    EXPECT_EQ(0u, ports[0].get("PortType")->num.uint16);

    std::vector<ch::Instance> ends = served("VESPERA_LANEndpoint");
    ASSERT_EQ(1u, ends.size());
    EXPECT_EQ("", text(ends[0], "Name"));
    EXPECT_EQ("00051e000001", text(ends[0], "MACAddress"));
    EXPECT_EQ(0u, ends[0].get("MaxDataSize")->num.uint32);
    EXPECT_EQ("", text(ends[0], "ElementName"));
    EXPECT_EQ(2u, ends[0].get("EnabledState")->num.uint16);
}

TEST_F(Absent, AdaptersWithoutProductData)
{
    // Texts the adapter didn't give are empty, as its record's fields are.
    std::vector<ch::Instance> cards = served("VESPERA_PhysicalPackage");
    ASSERT_EQ(2u, cards.size());
    for (const ch::Instance& c : cards)
    {
        EXPECT_EQ("", text(c, "Model"));
        EXPECT_EQ("", text(c, "SerialNumber"));
    }
    EXPECT_EQ("10000000-0000-0000-2000-0000c9aa0000", text(cards[0], "Tag"));

    std::vector<ch::Instance> software = served("VESPERA_AdapterSoftwareIdentity");
    const ch::Instance* firmware = find(software, "InstanceID", "20000000c9aa0000_firmware");
    ASSERT_TRUE(firmware);
    EXPECT_EQ("", text(*firmware, "VersionString"));
    EXPECT_EQ(2u, served("VESPERA_PortController").size());
}
