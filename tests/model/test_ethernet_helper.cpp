// EthernetPortHelper in the test process, on the simulator's default host (an
// FC HBA and a CNA with the Ethernet port 00:05:1e:8b:20:02), for what the
// simulator never answers: replies of the wrong shape, and records without
// terminators.

#include <string.h>

#include "EthernetPortHelper.h"
#include "test_ethernet_helper.h"

extern "C" int dtruj_sim_set_fault(const char* entry, const char* kind);

using namespace eth_test;

namespace
{

EthernetPortHelper* helper()
{
    return EthernetPortHelper::getEthernetPortHelperObject();
}

} // namespace

TEST(EthernetHelper, RepliesOfTheWrongShape)
{
    workDir();
    ASSERT_TRUE(gTrujLibLoaded);

    struct Case { JsonReqFP* entry; const char* reply; size_t ports; const char* level; const char* line; };
    const Case cases[] = {
        // A port that isn't a text is skipped; the next keeps its place (1).
        { &libGetEthPhyPortIndicesByAdapter, R"({"indexStrings": [5, "00:05:1e:8b:20:02"]})", 1,
          "ERR", "Ethernet port 0 of 00:05:1e:8b:20:00 has no index string" },
        { &libGetEthPhyPortIndicesByAdapter, R"(["00:05:1e:8b:20:02"])", 0,
          "ERR", "libGetEthPhyPortIndicesByAdapter returns NULL." },
        { &libGetEthPhyPortIndicesByAdapter, R"({"indexStrings": "00:05:1e:8b:20:02"})", 0,
          "ERR", "libGetEthPhyPortIndicesByAdapter returns NULL." },
        { &libGetEthPortByEthMac, R"({"ethData": 5})", 0, "ERR", "Ethernet Port Info is NOT available" },
        { &libGetEthPortByEthMac, R"([{"ethData": {}}])", 0, "ERR", "Ethernet Port Info is NOT available" },
        { &libGetOpticsSFP, R"([{"transceiver": "10G_BASE-SR"}])", 1,
          "ERR", "Unable to get SFP info for 00:05:1e:8b:20:02" },
        { &libGetOpticsSFP, R"({"transceiver": ["10G_BASE-SR"]})", 1,
          "ERR", "Unable to get SFP info for 00:05:1e:8b:20:02" },
        { &libGetAllAdaptersIndexString, R"({"indexStrings": [null]})", 0, "ERR", "Adapter 1 has no index string" },
    };
    for (const Case& c : cases)
    {
        Log log;
        Fake f(*c.entry, c.reply);
        Walk<VESPERA_EthernetPort> w(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
        ASSERT_EQ(c.ports, w.size()) << c.reply;
        EXPECT_EQ(1u, log.count(c.level, c.line)) << c.reply << "\n" << log.text();
        if (c.ports)
        {
            EXPECT_EQ(c.entry == &libGetOpticsSFP ? 0 : 105, w[0]->PortType.value);
            EXPECT_EQ(c.entry == &libGetEthPhyPortIndicesByAdapter ? 1 : 0, w[0]->PortNumber.value);
        }
    }

    // The owner of a port: an id of the wrong type, none, below 1, a throw.
    const char* const ids[][3] = { { R"({"adapterId": "2"})", "ERR", "libGetAdapterIdByPort returns NULL." },
        { "[2]", "ERR", "libGetAdapterIdByPort returns NULL." },
        { R"({"adapterId": 0})", "WARN", "Adapter not found in the system." },
        { R"({"adapterId": -3})", "WARN", "Adapter not found in the system." } };
    for (const auto& id : ids)
    {
        Log log;
        Fake f(libGetAdapterIdByPort, id[0]);
        Walk<VESPERA_EthernetPort> w(helper()->getEthernetPortInstancesByAdapter("00051e8b2002"));
        EXPECT_EQ(0u, w.size());
        EXPECT_EQ("00:05:1e:8b:20:02", Fake::request()["indexStr"].asString());
        EXPECT_EQ(1u, log.count(id[1], id[2])) << id[0];
    }
    dtruj_sim_set_fault("getAdapterIdByPort", "unknown");
    Log log;
    Walk<VESPERA_EthernetPort> w(helper()->getEthernetPortInstancesByAdapter("00051e8b2002"));
    EXPECT_EQ(0u, w.size());
    EXPECT_EQ(1u, log.count("ERR", "00:05:1e:8b:20:02 - libGetAdapterIdByPort got default exception"));
    dtruj_sim_set_fault("getAdapterIdByPort", "none");
}

TEST(EthernetHelper, RecordsAndStates)
{
    // Every text fills its field without a terminator.
    _ethPortInfo info;
    memset(&info, 'x', sizeof(info));
    info.mtu = 1500;

    VESPERA_EthernetPort* p = helper()->getEthernetPortInstance(info);
    EXPECT_EQ(std::string(36, 'x'), str(p->DeviceID.value));
    EXPECT_EQ(std::string(24, 'x'), str(p->PermanentAddress.value));
    EXPECT_EQ(std::string(64, 'x'), str(p->SystemName.value));
    EXPECT_EQ(std::string(1028, 'x'), str(p->ElementName.value));
    destroy(p);

    // state -> HealthState, EnabledState
    const unsigned int states[][3] = { { 6, 15, 1 }, { 7, 0, 1 }, { 8, 5, 9 },
        { 9, 10, 4 }, { 10, 10, 3 }, { 11, 5, 2 }, { 13, 10, 6 }, { 0, 0, 1 } };
    for (const auto& s : states)
    {
        info.state = s[0];
        VESPERA_LANEndpoint* e = helper()->getLANEndpointInstance(info);
        EXPECT_EQ(std::string(1028, 'x') + "_ETHERNET", str(e->NameFormat.value));
        EXPECT_EQ(12000u, e->MaxDataSize.value);
        EXPECT_EQ(s[1], e->HealthState.value) << s[0];
        EXPECT_EQ(s[2], e->EnabledState.value) << s[0];
        destroy(e);
    }

    // A port that told no device name keeps its endpoint, under the empty
    // name.
    memset(info.deviceName, 0, sizeof(info.deviceName));
    VESPERA_LANEndpoint* e = helper()->getLANEndpointInstance(info);
    EXPECT_EQ(0, e->Name.null);
    EXPECT_EQ("", str(e->Name.value));
    destroy(e);

    EXPECT_EQ(108, helper()->getPortType("10G_BASE-LRM"));
    EXPECT_EQ(0, helper()->getPortType("10g_base-sr"));
    EXPECT_EQ(0, helper()->getPortType(0));
}
