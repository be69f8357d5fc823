// PhysicalAssetHelper in the test process against the simulated library on
// a described host, with faults at each entry of its walk. Values as a
// client sees them are checked through the stand-in server
// (test_adapter_helper_stand_in).

#include <gtest/gtest.h>

#include <string.h>

#include <vector>

#include "CIMProviderTruj.h"
#include "PhysicalAssetHelper.h"
#include "test_adapter_helper.h"

#include "VESPERA_PhysicalConnector.h"

extern "C" int dtruj_sim_reset(void);
extern "C" int dtruj_sim_set_fault(const char* entry, const char* kind);

using namespace OLMA;
using namespace adapter_test;

namespace
{

// Adapter 2 has Ethernet ports only; the first port of adapter 3 has no
// optics. The two optics of adapter 1 share a serial number.
const char* const HOST = R"({ "adapters": [
  { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00" },
    "fcPorts": [
      { "wwn": "10:00:00:00:c9:aa:00:01",
        "sfp": { "vendorName": "  VSPR OPTICS ", "serialNo": " SFP-1 ", "revision": "A ",
                 "speed": "4,8,16 Gbps", "extendedID": "SFP-LONG-ID" } },
      { "wwn": "10:00:00:00:c9:aa:00:02", "sfp": { "serialNo": "SFP-1" } } ] },
  { "hbaData": { "hbaMAC": "00:05:1e:00:00:01" },
    "ethPorts": [ { "mac": "00:05:1e:00:00:02" } ] },
  { "hbaData": { "wwn": "20:00:00:00:c9:cc:00:00" },
    "fcPorts": [ { "wwn": "10:00:00:00:c9:cc:00:01" },
                 { "wwn": "10:00:00:00:c9:cc:00:02", "sfp": { "serialNo": "SFP-9" } } ] } ] })";

class PhysicalAssetTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        std::string path = homeDir() + "/host.json";
        std::ofstream(path.c_str(), std::ios::trunc) << HOST;
        setenv("DTRUJ_HOST", path.c_str(), 1);
        ASSERT_EQ(0, dtruj_sim_reset());
    }

    void TearDown() override
    {
        unsetenv("DTRUJ_HOST");
        dtruj_sim_reset();
    }

    static std::vector<std::string> tags()
    {
        Array<Instance*> a = PhysicalAssetHelper::getPhysicalAssetHelperObject()->
            getInstancesByClass(ID_VESPERA_PhysicalConnector);
        std::vector<std::string> v;
        for (size_t i = 0; i < a.size(); i++)
        {
            auto* c = checked_cast<VESPERA_PhysicalConnector>(a[i]);
            v.push_back(c ? str(c->Tag.value) : "?");
            destroy(a[i]);
        }
        return v;
    }
};

typedef std::vector<std::string> Tags;

TEST_F(PhysicalAssetTest, OneConnectorPerPortWithOptics)
{
    LogMark mark;
    EXPECT_EQ((Tags{"SFP-1_1_0", "SFP-1_1_1", "SFP-9_3_1"}), tags());
    EXPECT_EQ(1u, countLines(mark.text(), "There are no ports associated to Adapter id 2"));
    EXPECT_EQ(1u, countLines(mark.text(), "getOpticsInfo failed for PortIndex =0 Ret = -1"));

    EXPECT_TRUE(PhysicalAssetHelper::getPhysicalAssetHelperObject()->
        getInstancesByClass(ID_VESPERA_PortController).size() == 0);
}

// Unlike the other walks, an adapter that can't be read ends this one.
TEST_F(PhysicalAssetTest, UnreadableAdapterEndsTheWalk)
{
    static JsonReqFP real;
    real = libGetHbaByWwn;
    libGetHbaByWwn = [](const Json::Value& request) -> Json::Value {
        if (request.isMember("mac"))
            throw HbaAgentError(5, "no such adapter");
        return real(request);
    };
    LogMark mark;
    Tags got = tags();
    libGetHbaByWwn = real;

    EXPECT_EQ((Tags{"SFP-1_1_0", "SFP-1_1_1"}), got);
    EXPECT_EQ(1u, countLines(mark.text(), "Unable to get Adapter info 2 - 00:05:1e:00:00:01"));
    EXPECT_EQ(0u, countLines(mark.text(), "Adapter info 3"));
}

// A fault at an entry costs what depends on it, never more.
TEST_F(PhysicalAssetTest, FaultsAtEachEntry)
{
    const struct
    {
        const char* entry;
        const char* kind;
        Tags want;
    } cases[] = {
        {"getAllAdaptersIndexString", "null", {}},
        {"getAllAdaptersIndexString", "error", {}},
        {"getHbaByWwn", "error", {}},
        {"getFcPhyPortIndicesByAdapter", "error", {}},
        {"getFcPhyPortIndicesByAdapter", "{\"kind\": \"std\", \"count\": 1}", {"SFP-9_3_1"}},
        {"getPortByWwn", "error", {}},
        {"getPortByWwn", "{\"kind\": \"hba\", \"count\": 1}", {"SFP-1_1_1", "SFP-9_3_1"}},
        {"getPortByWwn", "unknown", {}},
        {"getOpticsSFP", "null", {}},
        {"getOpticsSFP", "{\"kind\": \"unknown\", \"count\": 2}", {"SFP-9_3_1"}},
        // A reply that isn't an object describes no optics, also where the
        // library said there were none (an error in an array).
        {"getOpticsSFP", "shape", {}},
    };
    LogMark mark;

    for (const auto& c : cases)
    {
        ASSERT_EQ(0, dtruj_sim_reset());
        ASSERT_EQ(0, dtruj_sim_set_fault(c.entry, c.kind));
        EXPECT_EQ(c.want, tags()) << c.entry << " " << c.kind;
    }
    EXPECT_EQ(2u, countLines(mark.text(), "No adapters in the system. "));
}

TEST_F(PhysicalAssetTest, RecordFieldsAreCutAndTerminated)
{
    Array<Instance*> a = PhysicalAssetHelper::getPhysicalAssetHelperObject()->
        getInstancesByClass(ID_VESPERA_PhysicalConnector);
    ASSERT_LT(0u, a.size());
    Ref<Instance> first(a[0]);
    for (size_t i = 1; i < a.size(); i++)
        destroy(a[i]);
    auto* c = checked_cast<VESPERA_PhysicalConnector>(first.ptr());
    ASSERT_TRUE(c != 0);
    EXPECT_EQ("VSPR OPTICS", str(c->Manufacturer.value));
    EXPECT_EQ("SFP-1", str(c->SerialNumber.value));
    EXPECT_EQ("A", str(c->Version.value));
    EXPECT_EQ("SFP-LON", str(c->Model.value));

    _sfpInfo sfp;
    memset(&sfp, 'Z', sizeof(sfp));
    Ref<Instance> full(PhysicalAssetHelper::getPhysicalAssetHelperObject()->
        getPhysicalConnectorInstance(sfp));
    c = checked_cast<VESPERA_PhysicalConnector>(full.ptr());
    ASSERT_TRUE(c != 0);
    EXPECT_EQ(std::string(31, 'Z'), str(c->Tag.value));
    EXPECT_EQ(std::string(5, 'Z'), str(c->Version.value));
}

} // namespace
