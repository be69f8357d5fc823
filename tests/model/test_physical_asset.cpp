// PhysicalAssetHelper in the test process, against the simulated adapter
// library on host descriptions of our own, with faults injected at each
// entry of the walk.

#include <gtest/gtest.h>

#include <stdlib.h>
#include <string.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "CIMProviderTruj.h"
#include "PhysicalAssetHelper.h"
#include "log.h"

#include "VESPERA_PhysicalConnector.h"

extern "C" int dtruj_sim_reset(void);
extern "C" int dtruj_sim_set_fault(const char* entry, const char* kind);

using namespace OLMA;

namespace
{

std::string readFile(const std::string& path)
{
    std::stringstream text;
    text << std::ifstream(path.c_str(), std::ios::binary).rdbuf();
    return text.str();
}

// HOME of this process, with the log on at DBG; the descriptions go there too.
const std::string& homeDir()
{
    struct Home
    {
        std::string dir;
        Home()
        {
            char name[] = "/tmp/vspr-physical-asset-XXXXXX";
            dir = mkdtemp(name) ? name : "/tmp";
            std::ofstream(dir + "/.tesselrc") << "LOG_LEVEL=DBG\n";
            setenv("HOME", dir.c_str(), 1);
            close_log();
            log(LL_INFO, "test", __LINE__, "test log");
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

std::string str(const String& s)
{
    return std::string(s.c_str(), s.size());
}

// Adapters 1 and 3 have optics on every port but the first of adapter 3;
// adapter 2 has Ethernet ports only. The optics of adapter 1 share a serial
// number on purpose.
const char* const HOST = R"({ "adapters": [
  { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00" },
    "fcPorts": [
      { "wwn": "10:00:00:00:c9:aa:00:01",
        "sfp": { "vendorName": "  VSPR OPTICS  ", "serialNo": " SFP-1 ", "vendorPart": "57-1000012-01",
                 "revision": "A ", "speed": "4,8,16 Gbps", "extendedID": "SFP" } },
      { "wwn": "10:00:00:00:c9:aa:00:02",
        "sfp": { "vendorName": "VSPR OPTICS", "serialNo": "SFP-1", "vendorPart": "57-1000012-01",
                 "revision": "B", "speed": "8 Gbps", "extendedID": "SFP+" } } ] },
  { "hbaData": { "hbaMAC": "00:05:1e:00:00:01" },
    "ethPorts": [ { "mac": "00:05:1e:00:00:02" } ] },
  { "hbaData": { "wwn": "20:00:00:00:c9:cc:00:00" },
    "fcPorts": [
      { "wwn": "10:00:00:00:c9:cc:00:01" },
      { "wwn": "10:00:00:00:c9:cc:00:02",
        "sfp": { "vendorName": "OTHER", "serialNo": "SFP-9", "vendorPart": "X1",
                 "revision": "1", "speed": "16 Gbps", "extendedID": "QSFP" } } ] } ] })";

class PhysicalAssetTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        homeDir();
        useHost(HOST);
        _logStart = readFile(logPath()).size();
    }

    void TearDown() override
    {
        unsetenv("DTRUJ_HOST");
        dtruj_sim_reset();
    }

    static std::string logPath()
    {
        return homeDir() + "/.tessel/messages";
    }

    static void useHost(const std::string& json)
    {
        std::string path = homeDir() + "/host.json";
        std::ofstream(path.c_str(), std::ios::trunc) << json;
        setenv("DTRUJ_HOST", path.c_str(), 1);
        ASSERT_EQ(0, dtruj_sim_reset());
    }

    std::string logged() const
    {
        std::string all = readFile(logPath());
        return all.size() > _logStart ? all.substr(_logStart) : std::string();
    }

    std::vector<VESPERA_PhysicalConnector*> connectors()
    {
        Array<Instance*> a = PhysicalAssetHelper::getPhysicalAssetHelperObject()->
            getInstancesByClass(ID_VESPERA_PhysicalConnector);
        std::vector<VESPERA_PhysicalConnector*> v;
        for (size_t i = 0; i < a.size(); i++)
        {
            _owned.push_back(Ref<Instance>(a[i]));
            VESPERA_PhysicalConnector* c = checked_cast<VESPERA_PhysicalConnector>(a[i]);
            EXPECT_TRUE(c != 0);
            if (c)
                v.push_back(c);
        }
        return v;
    }

    static std::vector<std::string> tags(const std::vector<VESPERA_PhysicalConnector*>& v)
    {
        std::vector<std::string> t;
        for (auto* c : v)
            t.push_back(str(c->Tag.value));
        return t;
    }

private:
    size_t _logStart = 0;
    std::vector<Ref<Instance>> _owned;
};

TEST_F(PhysicalAssetTest, ConnectorsOfEveryPortWithOptics)
{
    auto c = connectors();
    EXPECT_EQ((std::vector<std::string>{"SFP-1_1_0", "SFP-1_1_1", "SFP-9_3_1"}), tags(c));
    ASSERT_EQ(3u, c.size());

    VESPERA_PhysicalConnector* first = c[0];
    EXPECT_EQ("VESPERA_PhysicalConnector", str(first->CreationClassName.value));
    EXPECT_EQ("VESPERA_PhysicalConnector", str(first->Caption.value));
    EXPECT_EQ("VESPERA_PhysicalConnector", str(first->ElementName.value));
    EXPECT_EQ("VSPR OPTICS", str(first->Manufacturer.value));
    EXPECT_EQ("57-1000012-01", str(first->PartNumber.value));
    EXPECT_EQ("SFP-1", str(first->SerialNumber.value));
    EXPECT_EQ("SFP", str(first->Model.value));
    EXPECT_EQ("SFP", str(first->ConnectorDescription.value));
    EXPECT_EQ("A", str(first->Version.value));
    EXPECT_EQ("4,8,16 Gbps", str(first->Description.value));
    ASSERT_EQ(1u, first->ConnectorType.value.size());
    EXPECT_EQ(118, first->ConnectorType.value[0]);
    EXPECT_EQ(0, first->ConnectorGender.value);
    EXPECT_EQ(0, first->ConnectorGender.null);
    EXPECT_EQ("0", str(first->ConnectorPinout.value));
    EXPECT_EQ(0u, first->NumPhysicalPins.value);
    EXPECT_EQ(0, first->NumPhysicalPins.null);
    EXPECT_EQ(1, first->ConnectorLayout.value);

    EXPECT_EQ("SFP+", str(c[1]->Model.value));
    EXPECT_EQ("QSFP", str(c[2]->ConnectorDescription.value));

    std::string log = logged();
    EXPECT_EQ(1u, countLines(log, "There are no ports associated to Adapter id 2"));
    EXPECT_EQ(1u, countLines(log, "getOpticsInfo failed for PortIndex =0 Ret = -1"));
    EXPECT_EQ(1u, countLines(log, "Number of instances: 3"));
}

TEST_F(PhysicalAssetTest, DefaultHostShowsTheOpticsItDescribes)
{
    unsetenv("DTRUJ_HOST");
    ASSERT_EQ(0, dtruj_sim_reset());
    auto c = connectors();
    EXPECT_EQ((std::vector<std::string>{"SFP0001A_1_0", "SFP0001B_1_1"}), tags(c));
}

// An adapter that can't be read ends this walk, though the others go on.
TEST_F(PhysicalAssetTest, UnreadableAdapterEndsTheWalk)
{
    static JsonReqFP real;
    real = libGetHbaByWwn;
    libGetHbaByWwn = [](const Json::Value& request) -> Json::Value {
        if (request.isMember("mac"))
            throw HbaAgentError(5, "no such adapter");
        return real(request);
    };
    auto c = connectors();
    libGetHbaByWwn = real;

    EXPECT_EQ((std::vector<std::string>{"SFP-1_1_0", "SFP-1_1_1"}), tags(c));
    std::string log = logged();
    EXPECT_EQ(1u, countLines(log, "Unable to get Adapter info 2 - 00:05:1e:00:00:01"));
    EXPECT_EQ(0u, countLines(log, "Adapter info 3"));

    ASSERT_EQ(0, dtruj_sim_set_fault("getHbaByWwn", "error"));
    EXPECT_EQ(0u, connectors().size());
}

// A fault at any entry of the walk costs what depends on it, never more.
TEST_F(PhysicalAssetTest, FaultsAtEachEntry)
{
    const struct
    {
        const char* entry;
        const char* kind;
        size_t connectors;
    } cases[] = {
        {"getAllAdaptersIndexString", "null", 0},
        {"getAllAdaptersIndexString", "error", 0},
        {"getFcPhyPortIndicesByAdapter", "error", 0},
        {"getFcPhyPortIndicesByAdapter", "{\"kind\": \"std\", \"count\": 1}", 1},
        {"getPortByWwn", "error", 0},
        {"getPortByWwn", "{\"kind\": \"hba\", \"count\": 1}", 2},
        {"getPortByWwn", "unknown", 0},
        {"getOpticsSFP", "null", 0},
        {"getOpticsSFP", "{\"kind\": \"unknown\", \"count\": 2}", 1},
    };

    for (const auto& c : cases)
    {
        ASSERT_EQ(0, dtruj_sim_reset());
        ASSERT_EQ(0, dtruj_sim_set_fault(c.entry, c.kind));
        EXPECT_EQ(c.connectors, connectors().size()) << c.entry << " " << c.kind;
    }

    std::string log = logged();
    EXPECT_LE(1u, countLines(log, "No adapters in the system. "));
    EXPECT_LE(1u, countLines(log, "There are no ports associated to Adapter id 1"));
}

TEST_F(PhysicalAssetTest, NoAdaptersAndOtherClasses)
{
    useHost(R"({ "adapters": [] })");
    EXPECT_EQ(0u, connectors().size());
    EXPECT_EQ(1u, countLines(logged(), "No adapters in the system. "));

    EXPECT_EQ(0u, PhysicalAssetHelper::getPhysicalAssetHelperObject()->
        getInstancesByClass(ID_VESPERA_PortController).size());
}

// Optics texts of the wrong type read as empty, longer ones are cut to
// their fields, and the tag still fits.
TEST_F(PhysicalAssetTest, OddAndOverLongOptics)
{
    const std::string longText(3000, 'y');
    useHost(R"({ "adapters": [ { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00" }, "fcPorts": [
      { "wwn": "10:00:00:00:c9:aa:00:01",
        "sfp": { "vendorName": 7, "serialNo": [ "SFP-1" ], "vendorPart": { },
                 "revision": true, "speed": null } },
      { "wwn": "10:00:00:00:c9:aa:00:02",
        "sfp": { "vendorName": ")" + longText + R"(", "serialNo": ")" + longText + R"(",
                 "vendorPart": "  )" + longText + R"(", "revision": "REV-ABCDEF",
                 "speed": ")" + longText + R"(", "extendedID": "SFP+ LONG ID" } } ] } ] })");

    auto c = connectors();
    ASSERT_EQ(2u, c.size());
    EXPECT_EQ("_1_0", str(c[0]->Tag.value));
    EXPECT_EQ("", str(c[0]->Manufacturer.value));
    EXPECT_EQ("", str(c[0]->SerialNumber.value));
    EXPECT_EQ("", str(c[0]->Version.value));
    EXPECT_EQ("", str(c[0]->Model.value));

    EXPECT_EQ(std::string(17, 'y'), str(c[1]->Manufacturer.value));
    EXPECT_EQ(std::string(17, 'y'), str(c[1]->PartNumber.value));
    EXPECT_EQ(std::string(17, 'y'), str(c[1]->SerialNumber.value));
    EXPECT_EQ(std::string(17, 'y') + "_1_1", str(c[1]->Tag.value));
    EXPECT_EQ("REV-A", str(c[1]->Version.value));
    EXPECT_EQ(std::string(31, 'y'), str(c[1]->Description.value));
    EXPECT_EQ("SFP+ LO", str(c[1]->Model.value));
}

TEST_F(PhysicalAssetTest, BuilderTakesRecordWithoutTerminators)
{
    _sfpInfo sfp;
    memset(&sfp, 'Z', sizeof(sfp));
    Ref<Instance> i(PhysicalAssetHelper::getPhysicalAssetHelperObject()->getPhysicalConnectorInstance(sfp));
    VESPERA_PhysicalConnector* c = checked_cast<VESPERA_PhysicalConnector>(i.ptr());
    ASSERT_TRUE(c != 0);
    EXPECT_EQ(std::string(31, 'Z'), str(c->Tag.value));
    EXPECT_EQ(std::string(5, 'Z'), str(c->Version.value));
}

} // namespace
