// The adapter and optics classes as a WBEM client sees them: the built
// module in the stand-in CIM server (the cimhost command, one process per
// request), on the default simulated host and on host descriptions with
// faults, checked property by property against the description.

#include <gtest/gtest.h>
#include <json/json.h>

#include <stdio.h>
#include <stdlib.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "ProviderUtil.h"

namespace
{

const std::string CIMHOST = std::string(VSPR_BUILD_DIR) + "/platform/cimhost/cimhost";
const std::string MODULE = std::string(VSPR_BUILD_DIR) + "/libvsprprovider_Module.so";

std::string readFile(const std::string& path)
{
    std::stringstream text;
    text << std::ifstream(path.c_str(), std::ios::binary).rdbuf();
    return text.str();
}

// HOME of the server processes, with the log on at DBG.
const std::string& homeDir()
{
    struct Home
    {
        std::string dir;
        Home()
        {
            char name[] = "/tmp/vspr-adapter-stand-in-XXXXXX";
            dir = mkdtemp(name) ? name : "/tmp";
            std::ofstream(dir + "/.tesselrc") << "LOG_LEVEL=DBG\n";
        }
        ~Home()
        {
            std::error_code ec;
            std::filesystem::remove_all(dir, ec);
        }
    };
    static Home home;
    return home.dir;
}

size_t countLines(const std::string& text, const std::string& piece)
{
    std::istringstream in(text);
    std::string line;
    size_t n = 0;
    while (std::getline(in, line))
        n += line.find(piece) != std::string::npos;
    return n;
}

struct Enumeration
{
    int rc = -1;
    std::vector<Json::Value> instances;
    std::string log;        // what the module logged during the request
};

class StandIn : public ::testing::Test
{
protected:
    void SetUp() override
    {
        struct stat st;
        if (stat(CIMHOST.c_str(), &st) != 0 || stat(MODULE.c_str(), &st) != 0)
            GTEST_SKIP() << "the stand-in server or the module isn't built";
        hostFile.clear();
    }

    // Enumerates a class in a server of its own, on the default host or on
    // the description given to useHost.
    Enumeration ei(const std::string& cls)
    {
        std::string logPath = homeDir() + "/.tessel/messages";
        size_t start = readFile(logPath).size();

        std::string cmd = std::string("env ") +
            (hostFile.empty() ? std::string("-u DTRUJ_HOST") : "DTRUJ_HOST='" + hostFile + "'") +
            " HOME='" + homeDir() + "' LD_LIBRARY_PATH='" DTRUJ_DIR "'" +
            " '" + CIMHOST + "' --module '" + MODULE + "' --json ei root/vespera:" + cls +
            " 2>/dev/null";

        std::string out;
        if (FILE* p = popen(cmd.c_str(), "r"))
        {
            char buf[4096];
            size_t n;
            while ((n = fread(buf, 1, sizeof(buf), p)) > 0)
                out.append(buf, n);
            pclose(p);
        }

        Enumeration e;
        Json::Value doc;
        EXPECT_TRUE(Json::Reader().parse(out, doc)) << cls << ": " << out;
        e.rc = doc.get("rc", -1).asInt();
        for (const Json::Value& i : doc["instances"])
            e.instances.push_back(i);
        std::string log = readFile(logPath);
        e.log = log.size() > start ? log.substr(start) : std::string();
        return e;
    }

    void useHost(const std::string& json)
    {
        hostFile = homeDir() + "/host.json";
        std::ofstream(hostFile.c_str(), std::ios::trunc) << json;
    }

    // The value of a property, null if the instance hasn't got it.
    static Json::Value prop(const Json::Value& instance, const char* name)
    {
        for (const Json::Value& p : instance["properties"])
            if (p["name"].asString() == name)
                return p["null"].asBool() ? Json::Value() : p["value"];
        return Json::Value();
    }

    static std::string text(const Json::Value& instance, const char* name)
    {
        Json::Value v = prop(instance, name);
        return v.isString() ? v.asString() : "<" + v.toStyledString() + ">";
    }

    static std::string hostString()
    {
        char host[256] = {0};
        OLMA::ProviderUtil::getProviderUtil()->getHostInfo(host, 255);
        return host;
    }

    static Json::Value list(std::initializer_list<Json::Value> values)
    {
        Json::Value a(Json::arrayValue);
        for (const Json::Value& v : values)
            a.append(v);
        return a;
    }

    std::string hostFile;
};

//------------------------------------------------------------------------------
// The default simulated host: an FC HBA (VSPR vendor data, storage driver,
// BIOS in flash) and a CNA (HP vendor data with an OEM serial number and a
// UUID, both drivers, no BIOS)
//------------------------------------------------------------------------------

TEST_F(StandIn, PortControllers)
{
    Enumeration e = ei("VESPERA_PortController");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(2u, e.instances.size());

    const Json::Value& fc = e.instances[0];
    EXPECT_EQ("VESPERA_PortController", text(fc, "CreationClassName"));
    EXPECT_EQ("VESPERA_ComputerSystem", text(fc, "SystemCreationClassName"));
    EXPECT_EQ(hostString(), text(fc, "SystemName"));
    EXPECT_EQ("200000051e8a1000", text(fc, "DeviceID"));
    EXPECT_EQ("VSP1020A0001", text(fc, "Name"));
    EXPECT_EQ("VSP1020A0001", text(fc, "ElementName"));
    EXPECT_EQ("Vespera FC HBA", text(fc, "Caption"));
    EXPECT_EQ("Vespera FC HBA", text(fc, "Description"));
    EXPECT_EQ(list({11}), prop(fc, "OperationalStatus"));
    EXPECT_EQ(list({"The adapter is in service"}), prop(fc, "StatusDescriptions"));
    EXPECT_EQ(2, prop(fc, "EnabledState").asInt());
    EXPECT_EQ(4, prop(fc, "ControllerType").asInt());
    EXPECT_TRUE(prop(fc, "OtherControllerType").isNull());

    const Json::Value& cna = e.instances[1];
    EXPECT_EQ("00051e8b2000", text(cna, "DeviceID"));
    EXPECT_EQ("MY12345", text(cna, "Name"));
    EXPECT_EQ("Vespera CNA", text(cna, "Caption"));
    EXPECT_EQ("Vespera CNA", text(cna, "Description"));
    EXPECT_EQ(1, prop(cna, "ControllerType").asInt());
    EXPECT_EQ("CNA - FC and Ethernet types", text(cna, "OtherControllerType"));

    EXPECT_EQ(1u, countLines(e.log, "Adapter Type : FC HBA"));
    EXPECT_EQ(1u, countLines(e.log, "Adapter Type : CNA"));
    EXPECT_EQ(1u, countLines(e.log, "HP VPD info doesnt have the FRU details to print."));
}

TEST_F(StandIn, PhysicalPackagesAndProducts)
{
    Enumeration e = ei("VESPERA_PhysicalPackage");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(2u, e.instances.size());

    const Json::Value& fc = e.instances[0];
    EXPECT_EQ("VESPERA_PhysicalPackage", text(fc, "CreationClassName"));
    EXPECT_EQ("10000000-0000-0000-2000-00051e8a1000", text(fc, "Tag"));
    EXPECT_EQ("VSPR", text(fc, "Manufacturer"));
    EXPECT_EQ("Vespera FC HBA", text(fc, "Caption"));
    EXPECT_EQ("Vespera FC HBA", text(fc, "ElementName"));
    EXPECT_EQ("Vespera FC HBA", text(fc, "Description"));
    EXPECT_EQ("Vespera-1020", text(fc, "Model"));
    EXPECT_EQ("VSP1020A0001", text(fc, "SerialNumber"));
    EXPECT_EQ("PN1020", text(fc, "PartNumber"));
    EXPECT_EQ("FRU-1020-A", text(fc, "SKU"));
    EXPECT_EQ("VSPR Fiber Channel Adapter VSP1020A0001", text(fc, "Name"));
    EXPECT_EQ(9, prop(fc, "PackageType").asInt());

    const Json::Value& cna = e.instances[1];
    EXPECT_EQ("6a1f0c2e9b7d4e1f8c3a5b6d7e8f9012", text(cna, "Tag"));
    EXPECT_EQ("Vespera CNA", text(cna, "ElementName"));
    EXPECT_EQ("Vespera-1860", text(cna, "Model"));
    EXPECT_EQ("MY12345", text(cna, "SerialNumber"));
    EXPECT_EQ("PN1860", text(cna, "PartNumber"));
    EXPECT_EQ("", text(cna, "SKU"));
    EXPECT_EQ("VSPR Ethernet Adapter MY12345", text(cna, "Name"));

    e = ei("VESPERA_Product");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(2u, e.instances.size());
    EXPECT_EQ("VESPERA CIM Provider", text(e.instances[0], "Name"));
    EXPECT_EQ("Vespera FC HBA", text(e.instances[0], "Caption"));
    EXPECT_EQ("3.2.1.0", text(e.instances[0], "Version"));
    EXPECT_EQ("VSPR", text(e.instances[0], "Vendor"));
    EXPECT_EQ("VSP1020A0001", text(e.instances[0], "IdentifyingNumber"));
    EXPECT_EQ("Vespera CNA", text(e.instances[1], "Description"));
    EXPECT_EQ("3.2.1.1", text(e.instances[1], "Version"));
    EXPECT_EQ("MY12345", text(e.instances[1], "IdentifyingNumber"));
}

TEST_F(StandIn, SoftwareIdentities)
{
    Enumeration e = ei("VESPERA_AdapterSoftwareIdentity");
    ASSERT_EQ(0, e.rc);

    struct Want
    {
        const char* id;
        const char* version;
        int classification;
        const char* caption;
        const char* name;
        const char* identity;
    };
    const Want want[] = {
        {"vsprfc", "3.2.1.0", 2, "Storage driver", "Storage driver for Vespera adapter",
            "Storage driver for Vespera adapter"},
        {"200000051e8a1000_bios", "3.2.1.0", 32770, "BIOS for Vespera FC HBA",
            "VSPR Fiber Channel Adapter VSP1020A0001 BIOS", "Vespera-1020"},
        {"200000051e8a1000_firmware", "3.2.1.0", 10, "Firmware for Vespera FC HBA",
            "VSPR Fiber Channel Adapter VSP1020A0001 Firmware", "Vespera-1020"},
        {"vspreth", "3.2.1.0", 2, "Network driver", "Network driver for Vespera adapter",
            "Network driver for Vespera adapter"},
        {"00051e8b2000_firmware", "3.2.1.1", 10, "Firmware for Vespera CNA",
            "VSPR Ethernet Adapter MY12345 Firmware", "Vespera-1860"},
    };
    ASSERT_EQ(sizeof(want) / sizeof(want[0]), e.instances.size());

    for (size_t i = 0; i < e.instances.size(); i++)
    {
        const Json::Value& s = e.instances[i];
        SCOPED_TRACE(want[i].id);
        EXPECT_EQ(want[i].id, text(s, "InstanceID"));
        EXPECT_EQ(want[i].version, text(s, "VersionString"));
        EXPECT_EQ(list({want[i].classification}), prop(s, "Classifications"));
        EXPECT_EQ(want[i].caption, text(s, "ElementName"));
        EXPECT_EQ(want[i].caption, text(s, "Caption"));
        EXPECT_EQ(want[i].caption, text(s, "Description"));
        EXPECT_EQ(want[i].name, text(s, "Name"));
        EXPECT_EQ("VSPR", text(s, "Manufacturer"));
        EXPECT_EQ(list({"SoftwareID", "SoftwareStatus"}), prop(s, "IdentityInfoType"));
        EXPECT_EQ(list({want[i].identity, "Primary"}), prop(s, "IdentityInfoValue"));
    }
}

TEST_F(StandIn, PhysicalConnectors)
{
    Enumeration e = ei("VESPERA_PhysicalConnector");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(2u, e.instances.size());

    const char* const tags[] = {"SFP0001A_1_0", "SFP0001B_1_1"};
    for (size_t i = 0; i < 2; i++)
    {
        const Json::Value& c = e.instances[i];
        EXPECT_EQ(tags[i], text(c, "Tag"));
        EXPECT_EQ("VESPERA_PhysicalConnector", text(c, "CreationClassName"));
        EXPECT_EQ("VESPERA_PhysicalConnector", text(c, "Caption"));
        EXPECT_EQ("VESPERA_PhysicalConnector", text(c, "ElementName"));
        EXPECT_EQ("VSPR OPTICS", text(c, "Manufacturer"));
        EXPECT_EQ("57-1000012-01", text(c, "PartNumber"));
        EXPECT_EQ(std::string(tags[i]).substr(0, 8), text(c, "SerialNumber"));
        EXPECT_EQ("SFP", text(c, "Model"));
        EXPECT_EQ("SFP", text(c, "ConnectorDescription"));
        EXPECT_EQ("A", text(c, "Version"));
        EXPECT_EQ("4,8,16 Gbps", text(c, "Description"));
        EXPECT_EQ(list({118}), prop(c, "ConnectorType"));
        EXPECT_EQ(0, prop(c, "ConnectorGender").asInt());
        EXPECT_EQ("0", text(c, "ConnectorPinout"));
        EXPECT_EQ(0, prop(c, "NumPhysicalPins").asInt());
        EXPECT_EQ(1, prop(c, "ConnectorLayout").asInt());
    }
}

//------------------------------------------------------------------------------
// Described hosts with faults
//------------------------------------------------------------------------------

// Adapter 1 can't be read: the adapter classes go on with adapter 2, the
// optics walk ends there.
TEST_F(StandIn, AdapterWhoseDetailsFail)
{
    useHost(R"({ "faults": { "getHbaByWwn": { "kind": "error", "count": 1 } },
      "adapters": [
        { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00", "serialNumber": "SN-A" },
          "driver": { "storageDriverName": "vsprfc", "storageDriverVersion": "1.0" },
          "fcPorts": [ { "wwn": "10:00:00:00:c9:aa:00:01",
                         "sfp": { "serialNo": "SFP-A" } } ] },
        { "hbaData": { "wwn": "20:00:00:00:c9:bb:00:00", "serialNumber": "SN-B" },
          "driver": { "storageDriverName": "vsprfc", "storageDriverVersion": "1.0" },
          "fcPorts": [ { "wwn": "10:00:00:00:c9:bb:00:01",
                         "sfp": { "serialNo": "SFP-B" } } ] } ] })");

    Enumeration e = ei("VESPERA_PortController");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(1u, e.instances.size());
    EXPECT_EQ("20000000c9bb0000", text(e.instances[0], "DeviceID"));
    EXPECT_EQ("SN-B", text(e.instances[0], "Name"));
    EXPECT_EQ(1u, countLines(e.log, "Unable to get Adapter info 1 - 20:00:00:00:c9:aa:00:00"));

    e = ei("VESPERA_PhysicalConnector");
    ASSERT_EQ(0, e.rc);
    EXPECT_EQ(0u, e.instances.size());
    EXPECT_EQ(1u, countLines(e.log, "Unable to get Adapter info 1 - 20:00:00:00:c9:aa:00:00"));
    EXPECT_EQ(1u, countLines(e.log, "No Connector Found!"));
}

// Members missing or of the wrong type, texts longer than their fields, a
// port without optics and one whose optics reply is an error: each costs its
// own values only.
TEST_F(StandIn, OddRepliesYieldTheOtherElements)
{
    const std::string longText(2000, 'q');
    useHost(R"({ "faults": { "getOpticsSFP": { "kind": "hba", "count": 1 } },
      "adapters": [
        { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00", "model": 1020,
                       "serialNumber": [ "SN" ], "oem": { }, "hbaStatus": 1 },
          "driver": { "storageDriverName": "vsprfc", "storageDriverVersion": 3 },
          "firmware": { "version": [ ], "biosVersion": 7 },
          "fcPorts": [ { "wwn": "10:00:00:00:c9:aa:00:01", "sfp": { "serialNo": "SFP-0" } },
                       { "wwn": "10:00:00:00:c9:aa:00:02",
                         "sfp": { "serialNo": 5, "vendorName": ")" + longText + R"(" } },
                       { "wwn": "10:00:00:00:c9:aa:00:03" } ] },
        { "hbaData": { "hbaMAC": "00:05:1e:00:00:01", "model": ")" + longText + R"(",
                       "serialNumber": ")" + longText + R"(", "hbaStatus": false },
          "driver": { "networkDriverName": ")" + longText + R"(",
                      "networkDriverVersion": "  )" + longText + R"(  " },
          "firmware": { "version": ")" + longText + R"(" },
          "ethPorts": [ { "mac": "00:05:1e:00:00:02" } ] } ] })");

    Enumeration e = ei("VESPERA_PortController");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(2u, e.instances.size());
    EXPECT_EQ("20000000c9aa0000", text(e.instances[0], "DeviceID"));
    EXPECT_EQ("", text(e.instances[0], "Name"));
    EXPECT_EQ(3, prop(e.instances[0], "EnabledState").asInt());
    EXPECT_EQ("00051e000001", text(e.instances[1], "DeviceID"));
    EXPECT_EQ(std::string(63, 'q'), text(e.instances[1], "Name"));
    EXPECT_EQ(list({"The adapter is disabled"}), prop(e.instances[1], "StatusDescriptions"));

    e = ei("VESPERA_PhysicalPackage");
    ASSERT_EQ(2u, e.instances.size());
    EXPECT_EQ("", text(e.instances[0], "Model"));
    EXPECT_EQ(std::string(15, 'q'), text(e.instances[1], "Model"));
    EXPECT_EQ("10000000-0000-0000-0000-00051e000001", text(e.instances[1], "Tag"));

    e = ei("VESPERA_AdapterSoftwareIdentity");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(6u, e.instances.size());
    EXPECT_EQ("vsprfc", text(e.instances[0], "InstanceID"));
    EXPECT_EQ("", text(e.instances[0], "VersionString"));
    EXPECT_EQ("20000000c9aa0000_bios", text(e.instances[1], "InstanceID"));
    EXPECT_EQ("", text(e.instances[1], "VersionString"));
    EXPECT_EQ(std::string(15, 'q'), text(e.instances[3], "InstanceID"));
    EXPECT_EQ(std::string(63, 'q'), text(e.instances[3], "VersionString"));
    EXPECT_EQ("00051e000001_bios", text(e.instances[4], "InstanceID"));

    // The first port's optics throw once, the third port has none.
    e = ei("VESPERA_PhysicalConnector");
    ASSERT_EQ(0, e.rc);
    ASSERT_EQ(1u, e.instances.size());
    EXPECT_EQ("_1_1", text(e.instances[0], "Tag"));
    EXPECT_EQ(std::string(17, 'q'), text(e.instances[0], "Manufacturer"));
    EXPECT_EQ(1u, countLines(e.log, "getOpticsInfo failed for PortIndex =0 Ret = -1"));
    EXPECT_EQ(1u, countLines(e.log, "getOpticsInfo failed for PortIndex =2 Ret = -1"));
    EXPECT_EQ(1u, countLines(e.log, "libGetOpticsSFP got User exception"));
}

TEST_F(StandIn, HostWithoutAdapters)
{
    useHost(R"({ "adapters": [] })");
    for (const char* cls : {"VESPERA_PortController", "VESPERA_PhysicalPackage",
             "VESPERA_Product", "VESPERA_AdapterSoftwareIdentity", "VESPERA_PhysicalConnector"})
    {
        Enumeration e = ei(cls);
        EXPECT_EQ(0, e.rc) << cls;
        EXPECT_EQ(0u, e.instances.size()) << cls;
    }
}

} // namespace
