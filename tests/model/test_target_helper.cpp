// TargetHelper in the test process: the units behind the remote ports of a
// host of our own, reached through the port walk as the facade reaches
// them, and called directly for one port where a reply must be scripted.

#include "test_port_helper.h"

#include <string.h>

#include "PortHelper.h"
#include "TargetHelper.h"
#include "VESPERA_LogicalDisk.h"
#include "VESPERA_StorageExtent.h"
#include "VESPERA_TapeDrive.h"

using namespace OLMA;
using namespace port_test;

namespace
{

// One port whose disk array shows every kind of description, a media
// changer, an initiator, and two tape drives of which the first unit has no
// description. A second port has a disk whose first unit has none.
const char* const HOST = R"({ "adapters": [
  { "hbaData": { "wwn": "20:00:00:00:c9:cc:00:00" },
    "fcPorts": [
      { "wwn": "10:00:00:00:c9:cc:00:01",
        "remotePorts": [
          { "remotePortWwn": "50:00:00:00:00:00:01:01",
            "deviceData": { "isTarget": true, "type": "Disk" },
            "lunList": [
              { "number": 0, "vendor": "VSPRSTOR", "productID": "ARRAY-9000      ",
                "lunDescIdType": 3, "lunDescription": "600601603b201a01",
                "productSerialNumber": "ARR-1" },
              { "number": 7, "vendor": "V", "productID": "P", "lunDescIdType": 1,
                "lunDescription": "t10.V.P.7" },
              { "number": 8, "vendor": "V", "productID": "P", "lunDescIdType": 2,
                "lunDescription": "eui.8" },
              { "number": 9, "vendor": "V", "productID": "P", "lunDescIdType": 8,
                "lunDescription": "name 9" },
              { "number": 10, "vendor": "V", "productID": "P", "lunDescIdType": 5,
                "lunDescription": "odd kind" } ] },
          { "remotePortWwn": "50:00:00:00:00:00:02:01",
            "deviceData": { "isTarget": true, "type": "Media Changer" },
            "lunList": [
              { "number": 1, "vendor": "VSPRTAPE", "productID": "TL-2000 CHANGER ",
                "lunDescIdType": 1, "lunDescription": "CH-01", "productSerialNumber": "TL2K" } ] },
          { "remotePortWwn": "21:00:00:00:00:00:03:01",
            "deviceData": { "isTarget": false, "type": "Initiator" } },
          { "remotePortWwn": "50:00:00:00:00:00:04:01",
            "deviceData": { "isTarget": true, "type": "Tape" },
            "lunList": [
              { "number": 0, "vendor": "VSPRTAPE", "productID": "ULTRIUM-TD8     ",
                "lunDescIdType": 8, "productSerialNumber": " TD8-17 " } ] },
          { "remotePortWwn": "50:00:00:00:00:00:05:01",
            "deviceData": { "isTarget": true, "type": "Tape" },
            "lunList": [
              { "number": 2, "vendor": "VSPRTAPE", "productID": "ULTRIUM-TD9",
                "lunDescIdType": 1, "lunDescription": "TD9-desc", "productSerialNumber": "TD9-1" },
              { "number": 3, "vendor": "VSPRTAPE", "productID": "ULTRIUM-TD9",
                "lunDescIdType": 1, "lunDescription": "TD9-desc" } ] } ] },
      { "wwn": "10:00:00:00:c9:cc:00:02",
        "remotePorts": [
          { "remotePortWwn": "50:00:00:00:00:00:06:01",
            "deviceData": { "isTarget": true, "type": "Disk" },
            "lunList": [
              { "number": 4, "vendor": "VND", "productID": "PRD", "lunDescIdType": 3,
                "productSerialNumber": "SN4" },
              { "number": 5, "vendor": "VND", "productID": "PRD", "lunDescIdType": 3,
                "lunDescription": "desc 5", "productSerialNumber": "SN5" },
              { "number": 6, "vendor": "VND", "productID": "PRD", "lunDescIdType": 3,
                "lunDescription": "desc 6" } ] } ] } ] } ] })";

const char* const PORT = "10000000c9cc0001";

PortHelper* ports()
{
    return PortHelper::getPortHelperObject();
}

TargetHelper* targets()
{
    return TargetHelper::getTargetHelperObject();
}

_hbaPortInfo portRecord(const char* wwn)
{
    _hbaPortInfo port;
    memset(&port, 0, sizeof(port));
    strcpy(port.portWwn, wwn);
    strcpy(port.hostName, "host-a");
    return port;
}

template<class T>
std::vector<T*> all(const Walk& w)
{
    std::vector<T*> v;
    for (size_t i = 0; i < w.size(); i++)
        v.push_back(w.at<T>(i));
    return v;
}

class TargetHelperTest : public ::testing::Test
{
protected:
    void SetUp() override { useHost(HOST); }
    void TearDown() override { useDefaultHost(); }
};

} // namespace

TEST_F(TargetHelperTest, DisksAreNamedByTheKindOfTheirDescription)
{
    Log log;
    Walk e(ports()->getInstancesByClass(ID_VESPERA_StorageExtent));
    Walk d(ports()->getInstancesByClass(ID_VESPERA_LogicalDisk));
    std::vector<VESPERA_StorageExtent*> x = all<VESPERA_StorageExtent>(e);
    std::vector<VESPERA_LogicalDisk*> disks = all<VESPERA_LogicalDisk>(d);
    ASSERT_EQ(8u, x.size());
    ASSERT_EQ(8u, disks.size());

    EXPECT_EQ(std::string(PORT) + "_5000000000000101_VSPRSTOR_ARRAY-9000_LUN_0",
        str(x[0]->DeviceID.value));
    EXPECT_EQ(std::vector<String>{"It is a unique identification for a Storage Extent"},
        vec(x[0]->IdentifyingDescriptions));

    struct Row { const char* name; uint16 format; uint16 space; };
    const Row rows[] = {
        { "600601603b201a01", 9, 2 }, { "t10.V.P.7", 11, 4 }, { "eui.8", 10, 3 },
        { "name 9", 1, 1 },
    };
    for (size_t i = 0; i < 4; i++)
    {
        EXPECT_EQ(rows[i].name, str(x[i]->Name.value)) << i;
        EXPECT_EQ(rows[i].format, x[i]->NameFormat.value) << i;
        EXPECT_EQ(rows[i].space, x[i]->NameNamespace.value) << i;
    }

    // An unknown kind: an empty name and the class's own format.
    EXPECT_EQ("", str(x[4]->Name.value));
    VESPERA_StorageExtent* fresh = create<VESPERA_StorageExtent>(true);
    EXPECT_TRUE(property_eq(find_property(fresh->meta_class, "NameFormat"),
        &fresh->NameFormat, &x[4]->NameFormat));
    destroy(fresh);
    EXPECT_EQ(1u, log.count("ERR", "Default idType. Should not have reached here. "));

    // The second port: its first unit has no description, so from there on
    // every unit is named by its serial number, or can't be named at all.
    EXPECT_EQ("VND+PRD+SN4", str(x[5]->Name.value));
    EXPECT_EQ(7, x[5]->NameFormat.value);
    EXPECT_EQ(7, x[5]->NameNamespace.value);
    EXPECT_EQ("VND+PRD+SN5", str(x[6]->Name.value));
    EXPECT_EQ("Unable To Fetch", str(x[7]->Name.value));
    EXPECT_EQ(0, x[7]->NameFormat.value);

    // A logical disk is its extent under another class, named by its
    // description whatever names the extent.
    for (size_t i = 0; i < disks.size(); i++)
    {
        EXPECT_EQ(str(x[i]->DeviceID.value), str(disks[i]->DeviceID.value));
        EXPECT_EQ(1, disks[i]->NameFormat.value);
        EXPECT_EQ(1, disks[i]->NameNamespace.value);
    }
    EXPECT_EQ(std::vector<String>{"It is a unique identification for a Logical Disk"},
        vec(disks[0]->IdentifyingDescriptions));
    EXPECT_EQ("600601603b201a01", str(disks[0]->Name.value));
    EXPECT_EQ("", str(disks[5]->Name.value));
    EXPECT_EQ("desc 5", str(disks[6]->Name.value));
}

TEST_F(TargetHelperTest, TapesAndChangersAreTapeDrivesOnly)
{
    Log log;
    Walk w(ports()->getInstancesByClass(ID_VESPERA_TapeDrive));
    std::vector<VESPERA_TapeDrive*> t = all<VESPERA_TapeDrive>(w);
    ASSERT_EQ(4u, t.size());

    EXPECT_EQ(std::string(PORT) + "_5000000000000201_VSPRTAPE_TL-2000 CHANGER_LUN_1",
        str(t[0]->DeviceID.value));
    EXPECT_EQ("CH-01", str(t[0]->Name.value));
    EXPECT_EQ("VESPERA_TapeDrive", str(t[0]->CreationClassName.value));
    EXPECT_EQ(std::vector<String>{"It is a unique identification for a Tape Drive"},
        vec(t[0]->IdentifyingDescriptions));

    // The tape without a description is named by its trimmed serial
    // number, and so is every later unit of the port, described or not.
    EXPECT_EQ("VSPRTAPE+ULTRIUM-TD8+TD8-17", str(t[1]->Name.value));
    EXPECT_EQ("LUN_0", str(t[1]->ElementName.value));
    EXPECT_EQ("VSPRTAPE+ULTRIUM-TD9+TD9-1", str(t[2]->Name.value));
    EXPECT_EQ("Unable To Fetch", str(t[3]->Name.value));

    EXPECT_GE(log.count("INFO", "Continue with next rport. Looking for another device type "), 1u);
    EXPECT_GE(log.count("DBG", "Nothing to do since the its not a Target Rport."), 1u);

    // A changer never shows as an extent.
    Walk e(ports()->getInstancesByClass(ID_VESPERA_StorageExtent));
    for (size_t i = 0; i < e.size(); i++)
        EXPECT_EQ(std::string::npos,
            str(e.at<VESPERA_StorageExtent>(i)->DeviceID.value).find("5000000000000201"));
}

TEST_F(TargetHelperTest, UnreadableUnitsAndRemotePortsAreSkipped)
{
    std::string longText(300, 'L');
    Json::Value odd = parse(R"({ "deviceData": { "isTarget": true, "type": 5 },
      "lunList": [
        { "number": -1, "vendor": "V", "productID": "P" },
        { "number": 1, "productID": "P", "lunDescription": "d" },
        { "number": 2, "vendor": 7, "productID": "P" },
        { "number": 3, "vendor": "V" },
        "not a unit",
        { "number": 4, "vendor": "V", "productID": "P", "lunDescIdType": "3",
          "lunDescription": "d4" } ] })");

    Json::Value wide = parse(R"({ "deviceData": { "isTarget": true, "type": "Disk" } })");
    Json::Value unit(Json::objectValue);
    unit["number"] = 12;
    unit["vendor"] = "VENDORVENDOR";
    unit["productID"] = "PRODUCT-PRODUCT-PRODUCT";
    unit["lunDescIdType"] = 1;
    unit["lunDescription"] = longText;
    wide["lunList"].append(unit);

    Script<libGetAllRemotePorts> remotes("pPortWwn");
    remotes.on("10:00:00:00:c9:cc:00:01", parse(R"([
        { "remotePortWwn": "50:00:00:00:00:00:0a:01" },
        { "remotePortWwn": "50:00:00:00:00:00:0b:01" },
        { "remotePortWwn": "50:00:00:00:00:00:0c:01" },
        { "remotePortWwn": "50:00:00:00:00:00:0d:01" },
        { "remotePortWwn": "50:00:00:00:00:00:0e:01" },
        { "remotePortWwn": "50:00:00:00:00:00:0f:01" },
        { "remote": "none" } ])"));

    Script<libGetCompleteRemotePort> complete("rPortWwn");
    complete.on("50:00:00:00:00:00:0a:01", odd);
    complete.on("50:00:00:00:00:00:0b:01", Json::Value("throw"));
    complete.on("50:00:00:00:00:00:0c:01", parse(R"({"error": {"code": 2}})"));
    complete.on("50:00:00:00:00:00:0d:01", parse(R"({ "deviceData": { "isTarget": true } })"));
    complete.on("50:00:00:00:00:00:0e:01", parse(R"({ "deviceData": { "isTarget": "yes" },
        "lunList": [] })"));
    complete.on("50:00:00:00:00:00:0f:01", wide);

    Log log;
    Walk w(targets()->getTargetInstances(portRecord(PORT), ID_VESPERA_StorageExtent));
    std::vector<VESPERA_StorageExtent*> x = all<VESPERA_StorageExtent>(w);
    ASSERT_EQ(2u, x.size());

    // A type that isn't a text is no tape; a kind that isn't a number names
    // nothing.
    EXPECT_EQ("host-a", str(x[0]->SystemName.value));
    EXPECT_EQ(std::string(PORT) + "_5000000000000a01_V_P_LUN_4", str(x[0]->DeviceID.value));
    EXPECT_EQ("Unable To Fetch", str(x[0]->Name.value));

    // Inquiry fields keep their widths; the description is cut to its field.
    EXPECT_EQ(std::string(PORT) + "_5000000000000f01_VENDORVE_PRODUCT-PRODUCT-_LUN_12",
        str(x[1]->DeviceID.value));
    EXPECT_EQ(std::string(64, 'L'), str(x[1]->Name.value));

    EXPECT_EQ(5u, log.count("ERR", "LUN info is NOT available"));
    EXPECT_EQ(1u, log.count("ERR", "libGetCompleteRemotePort got User exception 9: scripted"));
    EXPECT_EQ(1u, log.count("ERR", "libGetCompleteRemotePort response is null or has error"));
    EXPECT_EQ(1u, log.count("ERR", "No LUN Info is available for Rport 50:00:00:00:00:00:0d:01."));
    EXPECT_EQ(1u, log.count("ERR", "Rport 50:00:00:00:00:00:0e:01"));
    EXPECT_EQ(1u, log.count("ERR", "has no remotePortWwn"));
}

TEST_F(TargetHelperTest, ARemotePortListThatCantBeHadGivesNothing)
{
    Log log;
    ASSERT_EQ(0, dtruj_sim_set_fault("getAllRemotePorts", "std"));
    EXPECT_EQ(0u, Walk(targets()->getTargetInstances(portRecord(PORT),
        ID_VESPERA_TapeDrive)).size());
    ASSERT_EQ(0, dtruj_sim_set_fault("getAllRemotePorts", "error"));
    EXPECT_EQ(0u, Walk(targets()->getTargetInstances(portRecord(PORT),
        ID_VESPERA_TapeDrive)).size());
    ASSERT_EQ(0, dtruj_sim_set_fault("getAllRemotePorts", "none"));

    EXPECT_EQ(1u, log.count("ERR", "libGetAllRemotePorts got std exception"));
    EXPECT_EQ(1u, log.count("ERR", "libGetAllRemotePorts returns NULL."));

    // Any class but the three finds nothing to build.
    EXPECT_EQ(0u, Walk(targets()->getTargetInstances(portRecord(PORT),
        ID_VESPERA_FCPort)).size());
}
