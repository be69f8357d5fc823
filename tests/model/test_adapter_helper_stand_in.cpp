// The adapter and optics classes as a WBEM client sees them: the built
// module in the stand-in CIM server (the cimhost command, a process per
// request), on the default simulated host and on described hosts with
// faults, property by property.

#include <gtest/gtest.h>
#include <json/json.h>

#include <stdio.h>
#include <sys/stat.h>

#include <vector>

#include "ProviderUtil.h"
#include "test_adapter_helper.h"

using namespace adapter_test;

namespace
{

const std::string CIMHOST = std::string(VSPR_BUILD_DIR) + "/platform/cimhost/cimhost";
const std::string MODULE = std::string(VSPR_BUILD_DIR) + "/libvsprprovider_Module.so";

Json::Value parse(const std::string& text)
{
    Json::Value v;
    EXPECT_TRUE(Json::Reader().parse(text, v)) << text;
    return v;
}

struct Enumeration
{
    int rc = -1;
    std::vector<Json::Value> instances;
    std::string log;
};

class AdapterStandIn : public ::testing::Test
{
protected:
    void SetUp() override
    {
        struct stat st;
        if (stat(CIMHOST.c_str(), &st) != 0 || stat(MODULE.c_str(), &st) != 0)
            GTEST_SKIP() << "the stand-in server or the module isn't built";
    }

    // Enumerates a class in a server of its own, on the default host or on
    // the description last given to useHost.
    Enumeration ei(const std::string& cls)
    {
        LogMark mark;
        std::string cmd = "env " +
            (_hostFile.empty() ? std::string("-u DTRUJ_HOST") : "DTRUJ_HOST='" + _hostFile + "'") +
            " HOME='" + homeDir() + "' LD_LIBRARY_PATH='" DTRUJ_DIR "' '" + CIMHOST +
            "' --module '" + MODULE + "' --json ei root/vespera:" + cls + " 2>/dev/null";

        std::string out;
        if (FILE* p = popen(cmd.c_str(), "r"))
        {
            char buf[4096];
            size_t n;
            while ((n = fread(buf, 1, sizeof(buf), p)) > 0)
                out.append(buf, n);
            pclose(p);
        }

        Json::Value doc = parse(out);
        Enumeration e;
        e.rc = doc.get("rc", -1).asInt();
        for (const Json::Value& i : doc["instances"])
            e.instances.push_back(i);
        e.log = mark.text();
        return e;
    }

    void useHost(const std::string& json)
    {
        _hostFile = homeDir() + "/stand-in-host.json";
        std::ofstream(_hostFile.c_str(), std::ios::trunc) << json;
    }

    static Json::Value prop(const Json::Value& instance, const std::string& name)
    {
        for (const Json::Value& p : instance["properties"])
            if (p["name"].asString() == name)
                return p["null"].asBool() ? Json::Value() : p["value"];
        return Json::Value();
    }

    // want: a JSON object of property names and values, null for a null one.
    static void expectProps(const Json::Value& instance, const std::string& want)
    {
        Json::Value w = parse(want);
        for (const std::string& name : w.getMemberNames())
            EXPECT_EQ(w[name], prop(instance, name)) << name << " of " << instance["path"];
    }

    static std::vector<std::string> column(const Enumeration& e, const char* name)
    {
        std::vector<std::string> v;
        for (const Json::Value& i : e.instances)
            v.push_back(prop(i, name).asString());
        return v;
    }

private:
    std::string _hostFile;
};

typedef std::vector<std::string> Texts;

//------------------------------------------------------------------------------
// The default simulated host: an FC HBA (VSPR vendor data, storage driver,
// BIOS in flash) and a CNA (HP vendor data with an OEM serial number and a
// UUID, both drivers, no BIOS)
//------------------------------------------------------------------------------

TEST_F(AdapterStandIn, PortControllers)
{
    Enumeration e = ei("VESPERA_PortController");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(2u, e.instances.size());

    char host[256] = {0};
    OLMA::ProviderUtil::getProviderUtil()->getHostInfo(host, 255);
    EXPECT_EQ(host, prop(e.instances[0], "SystemName").asString());

    expectProps(e.instances[0], R"({ "CreationClassName": "VESPERA_PortController",
        "SystemCreationClassName": "VESPERA_ComputerSystem", "DeviceID": "200000051e8a1000",
        "Name": "VSP1020A0001", "ElementName": "VSP1020A0001", "Caption": "Vespera FC HBA",
        "Description": "Vespera FC HBA", "OperationalStatus": [11],
        "StatusDescriptions": ["The adapter is in service"], "EnabledState": 2,
        "ControllerType": 4, "OtherControllerType": null })");
    expectProps(e.instances[1], R"({ "DeviceID": "00051e8b2000", "Name": "MY12345",
        "Caption": "Vespera CNA", "Description": "Vespera CNA", "ControllerType": 1,
        "OtherControllerType": "CNA - FC and Ethernet types" })");

    EXPECT_EQ(1u, countLines(e.log, "Adapter Type : FC HBA"));
    EXPECT_EQ(1u, countLines(e.log, "Adapter Type : CNA"));
    EXPECT_EQ(1u, countLines(e.log, "HP VPD info doesnt have the FRU details to print."));
}

TEST_F(AdapterStandIn, PhysicalPackagesAndProducts)
{
    Enumeration e = ei("VESPERA_PhysicalPackage");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(2u, e.instances.size());
    expectProps(e.instances[0], R"({ "CreationClassName": "VESPERA_PhysicalPackage",
        "Tag": "10000000-0000-0000-2000-00051e8a1000", "Manufacturer": "VSPR",
        "Caption": "Vespera FC HBA", "ElementName": "Vespera FC HBA",
        "Description": "Vespera FC HBA", "Model": "Vespera-1020", "SerialNumber": "VSP1020A0001",
        "PartNumber": "PN1020", "SKU": "FRU-1020-A", "PackageType": 9,
        "Name": "VSPR Fiber Channel Adapter VSP1020A0001" })");
    expectProps(e.instances[1], R"({ "Tag": "6a1f0c2e9b7d4e1f8c3a5b6d7e8f9012",
        "ElementName": "Vespera CNA", "Model": "Vespera-1860", "SerialNumber": "MY12345",
        "PartNumber": "PN1860", "SKU": "", "Name": "VSPR Ethernet Adapter MY12345" })");

    e = ei("VESPERA_Product");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(2u, e.instances.size());
    expectProps(e.instances[0], R"({ "Name": "VESPERA CIM Provider", "Caption": "Vespera FC HBA",
        "ElementName": "Vespera FC HBA", "Description": "Vespera FC HBA", "Version": "3.2.1.0",
        "Vendor": "VSPR", "IdentifyingNumber": "VSP1020A0001" })");
    expectProps(e.instances[1], R"({ "Description": "Vespera CNA", "Version": "3.2.1.1",
        "IdentifyingNumber": "MY12345" })");
}

// Both adapters have the storage driver: it shows once, from the first.
TEST_F(AdapterStandIn, SoftwareIdentities)
{
    Enumeration e = ei("VESPERA_AdapterSoftwareIdentity");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(5u, e.instances.size());

    const char* const want[] = {
        R"({ "InstanceID": "vsprfc", "VersionString": "3.2.1.0", "Classifications": [2],
            "ElementName": "Storage driver", "Caption": "Storage driver",
            "Description": "Storage driver", "Name": "Storage driver for Vespera adapter",
            "IdentityInfoValue": ["Storage driver for Vespera adapter", "Primary"] })",
        R"({ "InstanceID": "200000051e8a1000_bios", "VersionString": "3.2.1.0",
            "Classifications": [32770], "Caption": "BIOS for Vespera FC HBA",
            "Name": "VSPR Fiber Channel Adapter VSP1020A0001 BIOS",
            "IdentityInfoValue": ["Vespera-1020", "Primary"] })",
        R"({ "InstanceID": "200000051e8a1000_firmware", "VersionString": "3.2.1.0",
            "Classifications": [10], "Description": "Firmware for Vespera FC HBA",
            "Name": "VSPR Fiber Channel Adapter VSP1020A0001 Firmware" })",
        R"({ "InstanceID": "vspreth", "VersionString": "3.2.1.0", "Classifications": [2],
            "ElementName": "Network driver", "Name": "Network driver for Vespera adapter",
            "IdentityInfoValue": ["Network driver for Vespera adapter", "Primary"] })",
        R"({ "InstanceID": "00051e8b2000_firmware", "VersionString": "3.2.1.1",
            "ElementName": "Firmware for Vespera CNA",
            "Name": "VSPR Ethernet Adapter MY12345 Firmware",
            "IdentityInfoValue": ["Vespera-1860", "Primary"] })",
    };
    for (size_t i = 0; i < e.instances.size(); i++)
    {
        expectProps(e.instances[i], want[i]);
        expectProps(e.instances[i], R"({ "Manufacturer": "VSPR",
            "IdentityInfoType": ["SoftwareID", "SoftwareStatus"] })");
    }
}

TEST_F(AdapterStandIn, PhysicalConnectors)
{
    Enumeration e = ei("VESPERA_PhysicalConnector");
    ASSERT_EQ(0, e.rc);
    EXPECT_EQ((Texts{"SFP0001A_1_0", "SFP0001B_1_1"}), column(e, "Tag"));
    EXPECT_EQ((Texts{"SFP0001A", "SFP0001B"}), column(e, "SerialNumber"));
    for (const Json::Value& c : e.instances)
        expectProps(c, R"({ "CreationClassName": "VESPERA_PhysicalConnector",
            "Caption": "VESPERA_PhysicalConnector", "ElementName": "VESPERA_PhysicalConnector",
            "Manufacturer": "VSPR OPTICS", "PartNumber": "57-1000012-01", "Model": "SFP",
            "ConnectorDescription": "SFP", "Version": "A", "Description": "4,8,16 Gbps",
            "ConnectorType": [118], "ConnectorGender": 0, "ConnectorPinout": "0",
            "NumPhysicalPins": 0, "ConnectorLayout": 1 })");
}

//------------------------------------------------------------------------------
// Described hosts with faults
//------------------------------------------------------------------------------

// Adapter 1 can't be read: the adapter classes go on with adapter 2, the
// optics walk ends there.
TEST_F(AdapterStandIn, AdapterWhoseDetailsFail)
{
    useHost(R"({ "faults": { "getHbaByWwn": { "kind": "error", "count": 1 } },
      "adapters": [
        { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00", "serialNumber": "SN-A" },
          "driver": { "storageDriverName": "vsprfc" },
          "fcPorts": [ { "wwn": "10:00:00:00:c9:aa:00:01", "sfp": { "serialNo": "SFP-A" } } ] },
        { "hbaData": { "wwn": "20:00:00:00:c9:bb:00:00", "serialNumber": "SN-B" },
          "driver": { "storageDriverName": "vsprfc" },
          "fcPorts": [ { "wwn": "10:00:00:00:c9:bb:00:01", "sfp": { "serialNo": "SFP-B" } } ] } ] })");

    Enumeration e = ei("VESPERA_PortController");
    ASSERT_EQ(0, e.rc);
    EXPECT_EQ((Texts{"20000000c9bb0000"}), column(e, "DeviceID"));
    EXPECT_EQ(1u, countLines(e.log, "Unable to get Adapter info 1 - 20:00:00:00:c9:aa:00:00"));

    e = ei("VESPERA_PhysicalConnector");
    ASSERT_EQ(0, e.rc);
    EXPECT_EQ(0u, e.instances.size());
    EXPECT_EQ(1u, countLines(e.log, "Unable to get Adapter info 1 - 20:00:00:00:c9:aa:00:00"));
}

// Members missing or of the wrong type and texts longer than their fields
// cost their own values only; so do a port without optics and one whose
// optics entry throws. The library's replies take the wrong types from
// "unchecked".
TEST_F(AdapterStandIn, OddRepliesYieldTheOtherElements)
{
    const std::string q(2000, 'q');
    useHost(R"({ "faults": { "getOpticsSFP": { "kind": "hba", "count": 1 } },
      "adapters": [
        { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00",
                       "unchecked": { "model": 1020, "serialNumber": [ "SN" ], "oem": { },
                                      "hbaStatus": 1 } },
          "unchecked": {
            "driver": { "storageDriverName": "vsprfc", "storageDriverVersion": 3 },
            "firmware": { "version": [ ], "biosVersion": 7 } },
          "fcPorts": [ { "wwn": "10:00:00:00:c9:aa:00:01", "sfp": { "serialNo": "SFP-0" } },
                       { "wwn": "10:00:00:00:c9:aa:00:02",
                         "sfp": { "vendorName": ")" + q + R"(", "unchecked": { "serialNo": 5 } } },
                       { "wwn": "10:00:00:00:c9:aa:00:03" } ] },
        { "hbaData": { "hbaMAC": "00:05:1e:00:00:01", "model": ")" + q + R"(",
                       "serialNumber": ")" + q + R"(", "hbaStatus": false },
          "driver": { "networkDriverName": ")" + q + R"(",
                      "networkDriverVersion": "  )" + q + R"(  " },
          "firmware": { "version": ")" + q + R"(" },
          "ethPorts": [ { "mac": "00:05:1e:00:00:02" } ] } ] })");
    const std::string q15(15, 'q'), q63(63, 'q');

    Enumeration e = ei("VESPERA_PortController");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(2u, e.instances.size());
    expectProps(e.instances[0], R"({ "DeviceID": "20000000c9aa0000", "Name": "",
        "EnabledState": 3 })");
    expectProps(e.instances[1], R"({ "DeviceID": "00051e000001", "Name": ")" + q63 + R"(",
        "StatusDescriptions": ["The adapter is disabled"] })");

    e = ei("VESPERA_PhysicalPackage");
    EXPECT_EQ((Texts{"", q15}), column(e, "Model"));
    EXPECT_EQ((Texts{"10000000-0000-0000-2000-0000c9aa0000", "10000000-0000-0000-0000-00051e000001"}),
        column(e, "Tag"));

    e = ei("VESPERA_AdapterSoftwareIdentity");
    EXPECT_EQ((Texts{"vsprfc", "20000000c9aa0000_bios", "20000000c9aa0000_firmware", q15,
        "00051e000001_bios", "00051e000001_firmware"}), column(e, "InstanceID"));
    EXPECT_EQ((Texts{"", "", "", q63, "", q63}), column(e, "VersionString"));

    e = ei("VESPERA_PhysicalConnector");
    ASSERT_EQ(0, e.rc);
    EXPECT_EQ((Texts{"_1_1"}), column(e, "Tag"));
    EXPECT_EQ((Texts{std::string(17, 'q')}), column(e, "Manufacturer"));
    EXPECT_EQ(1u, countLines(e.log, "libGetOpticsSFP got User exception"));
    EXPECT_EQ(1u, countLines(e.log, "getOpticsInfo failed for PortIndex =0 Ret = -1"));
    EXPECT_EQ(1u, countLines(e.log, "getOpticsInfo failed for PortIndex =2 Ret = -1"));
}

} // namespace
