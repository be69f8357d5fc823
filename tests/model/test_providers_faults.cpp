// Every inventory class under every kind of failure of each library entry
// the inventory reads: the enumeration still succeeds, shows no more than
// the healthy host, names the failing entry in the log, and a failure of one
// element leaves the others.

#include <map>

#include "ProvidersSupport.h"

using namespace providers_test;

namespace
{

const char* const inventoryClasses[] = {
    "VESPERA_ComputerSystem", "VESPERA_PortController", "VESPERA_FCPort",
    "VESPERA_SCSIProtocolEndpoint", "VESPERA_FCPortStatistics",
    "VESPERA_PhysicalPackage", "VESPERA_Product", "VESPERA_AdapterSoftwareIdentity",
    "VESPERA_StorageExtent", "VESPERA_TapeDrive", "VESPERA_RemoteServiceAccessPoint",
    "VESPERA_EthernetPort", "VESPERA_LogicalPortGroup", "VESPERA_LANEndpoint",
    "VESPERA_PhysicalConnector", "VESPERA_AlarmDevice", "VESPERA_LogicalDisk",
};

// The entries that some enumeration of the inventory calls.
const char* const entries[] = {
    "getAllAdaptersIndexString", "getHbaByWwn", "getFlashInfo",
    "getFcPhyPortIndicesByAdapter", "getPortByWwn", "getDynamicPortStatistics",
    "getOpticsSFP", "getAllRemotePorts", "getCompleteRemotePort",
    "getEthPhyPortIndicesByAdapter", "getEthPortByEthMac",
};

const char* const kinds[] = { "null", "error", "hba", "std", "unknown" };

class Faults : public ProvidersTest, public ::testing::WithParamInterface<const char*>
{
protected:
    static std::map<std::string, size_t>& healthy()
    {
        static std::map<std::string, size_t> counts;
        if (counts.empty())
        {
            useDefaultHost();
            for (const char* cls : inventoryClasses)
                counts[cls] = served(cls).size();
        }
        return counts;
    }
};

std::string entryName(const testing::TestParamInfo<const char*>& info)
{
    return info.param;
}

} // namespace

TEST_P(Faults, EveryClassSurvivesEveryKindOfFailure)
{
    const std::string entry = GetParam();
    std::map<std::string, size_t> counts = healthy();
    std::string libName = "lib" + entry;
    libName[3] = (char)toupper((unsigned char)libName[3]);

    for (const char* kind : kinds)
    {
        ASSERT_EQ(0, dtruj_sim_set_fault(entry.c_str(), kind));
        LogMark mark;

        for (const char* cls : inventoryClasses)
        {
            ch::Result r = ei(cls);
            EXPECT_EQ(CMPI_RC_OK, r.rc) << entry << " " << kind << ": " << cls << " "
                << ch::rc_name(r.rc) << " " << r.message;
            EXPECT_LE(r.instances.size(), counts[cls]) << entry << " " << kind << ": " << cls;
        }

        // An exception is caught where the entry is called, and the line
        // says which entry threw.
        if (std::string(kind) == "hba" || std::string(kind) == "std" ||
            std::string(kind) == "unknown")
        {
            EXPECT_LE(1u, countLines(mark.text(), {"ERR: ", libName}))
                << entry << " " << kind;
        }
    }

    dtruj_sim_set_fault(entry.c_str(), "none");
}

INSTANTIATE_TEST_SUITE_P(Entries, Faults, ::testing::ValuesIn(entries), entryName);

// One port that can't be read, once: that port's elements go, the walk
// reaches the next port and the next adapter.
TEST_F(ProvidersTest, AFailedPortLeavesTheOthers)
{
    size_t ports = served("VESPERA_FCPort").size();
    size_t alarms = served("VESPERA_AlarmDevice").size();
    ASSERT_EQ(3u, ports);

    ASSERT_EQ(0, dtruj_sim_set_fault("getPortByWwn", "{\"kind\":\"hba\",\"count\":1}"));
    EXPECT_EQ(ports - 1, served("VESPERA_FCPort").size());
    ASSERT_EQ(0, dtruj_sim_set_fault("getPortByWwn", "{\"kind\":\"error\",\"count\":1}"));
    EXPECT_EQ(alarms - 1, served("VESPERA_AlarmDevice").size());

    // And the adapter list itself failing once is no lasting harm.
    ASSERT_EQ(0, dtruj_sim_set_fault("getAllAdaptersIndexString",
        "{\"kind\":\"std\",\"count\":1}"));
    EXPECT_TRUE(served("VESPERA_FCPort").empty());
    EXPECT_EQ(ports, served("VESPERA_FCPort").size());
}
