// EthernetPortHelper in the test process, on the simulator's default host (an
// FC HBA and a CNA with the Ethernet port 00:05:1e:8b:20:02), for what a
// client can't see: replies of shapes the simulator never gives, each kind
// of exception at each entry, and records without terminators.

#include <ctype.h>
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

class EthernetHelper : public ::testing::Test
{
protected:
    void SetUp() override
    {
        workDir();
        ASSERT_TRUE(gTrujLibLoaded) << "the start-up didn't load libdtruj.so";
    }
};

typedef Walk<VESPERA_EthernetPort> Ports;

} // namespace

TEST_F(EthernetHelper, RepliesOfTheWrongShape)
{
    // A port list with an element that isn't a text: the next is still
    // read, at its own place.
    {
        Log log;
        Fake f(libGetEthPhyPortIndicesByAdapter, R"({"indexStrings": [5, "00:05:1e:8b:20:02"]})");
        Ports w(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
        ASSERT_EQ(1u, w.size());
        EXPECT_EQ(1, w[0]->PortNumber.value);
        EXPECT_EQ(1u, log.count("ERR", "Ethernet port 0 of 00:05:1e:8b:20:00 has no index string"));
    }

    struct Case { JsonReqFP* entry; const char* reply; size_t ports; const char* line; };
    const Case cases[] = {
        { &libGetEthPhyPortIndicesByAdapter, R"(["00:05:1e:8b:20:02"])", 0,
          "libGetEthPhyPortIndicesByAdapter returns NULL." },
        { &libGetEthPhyPortIndicesByAdapter, R"({"indexStrings": "00:05:1e:8b:20:02"})", 0,
          "libGetEthPhyPortIndicesByAdapter returns NULL." },
        { &libGetEthPortByEthMac, R"({"ethData": 5})", 0, "Ethernet Port Info is NOT available" },
        { &libGetEthPortByEthMac, R"([{"ethData": {}}])", 0, "Ethernet Port Info is NOT available" },
        { &libGetOpticsSFP, R"([{"transceiver": "10G_BASE-SR"}])", 1,
          "Unable to get SFP info for 00:05:1e:8b:20:02" },
        { &libGetOpticsSFP, R"({"transceiver": ["10G_BASE-SR"]})", 1,
          "Unable to get SFP info for 00:05:1e:8b:20:02" },
        { &libGetAllAdaptersIndexString, R"({"indexStrings": [null]})", 0,
          "Adapter 1 has no index string" },
    };
    for (const Case& c : cases)
    {
        Log log;
        Fake f(*c.entry, c.reply);
        Ports w(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
        ASSERT_EQ(c.ports, w.size()) << c.reply;
        EXPECT_EQ(1u, log.count("ERR", c.line)) << c.reply << "\n" << log.text();
        if (c.ports)
        {
            EXPECT_EQ(0, w[0]->PortType.value);
        }
    }

    // The owner of a port, by an id of the wrong type, none, or below 1.
    const char* const ids[][2] = { { R"({"adapterId": "2"})", "ERR" }, { "[2]", "ERR" },
        { R"({"adapterId": 0})", "WARN" }, { R"({"adapterId": -3})", "WARN" } };
    for (const auto& id : ids)
    {
        Log log;
        Fake f(libGetAdapterIdByPort, id[0]);
        Ports w(helper()->getEthernetPortInstancesByAdapter("00051e8b2002"));
        EXPECT_EQ(0u, w.size());
        EXPECT_EQ("00:05:1e:8b:20:02", Fake::request()["indexStr"].asString());
        EXPECT_EQ(1u, log.count(id[1], std::string(id[1]) == "ERR"
            ? "libGetAdapterIdByPort returns NULL." : "Adapter not found in the system.")) << id[0];
    }
}

TEST_F(EthernetHelper, ExceptionsOfEachEntry)
{
    // entry, what it logs as the subject, ports left
    const char* const entries[][3] = {
        { "getEthPortByEthMac", "00:05:1e:8b:20:02", "0" },
        { "getEthPhyPortIndicesByAdapter", "00:05:1e:8b:20:00", "0" },
        { "getOpticsSFP", "00:05:1e:8b:20:02", "1" },
    };
    for (const auto& e : entries)
    {
        std::string lib = std::string("lib") + (char)toupper(e[0][0]) + (e[0] + 1);
        const std::string kinds[][2] = {
            { R"({"kind":"hba","code":7,"message":"busy"})", " got User exception 7: busy" },
            { R"({"kind":"std","message":"lost"})", " got std exception: lost" },
            { "unknown", " got default exception" } };
        for (const auto& k : kinds)
        {
            ASSERT_EQ(0, dtruj_sim_set_fault(e[0], k[0].c_str()));
            Log log;
            Ports w(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
            EXPECT_EQ(std::string(e[2]) == "1" ? 1u : 0u, w.size()) << e[0] << k[0];
            // The default line of getEthPortByEthMac puts the address last.
            std::string line = lib == "libGetEthPortByEthMac" && k[0] == "unknown"
                ? lib + " got default exception for " + e[1] : e[1] + (" - " + lib) + k[1];
            EXPECT_EQ(1u, log.count("ERR", line)) << log.text();
        }
        dtruj_sim_set_fault(e[0], "none");
    }

    // The owner's look-up throws too, and that mustn't reach the caller.
    dtruj_sim_set_fault("getAdapterIdByPort", "unknown");
    Log log;
    Ports w(helper()->getEthernetPortInstancesByAdapter("00051e8b2002"));
    EXPECT_EQ(0u, w.size());
    EXPECT_EQ(1u, log.count("ERR", "libGetAdapterIdByPort returns NULL."));
    dtruj_sim_set_fault("getAdapterIdByPort", "none");
}

TEST_F(EthernetHelper, RecordsAndStates)
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

    EXPECT_EQ(108, helper()->getPortType("10G_BASE-LRM"));
    EXPECT_EQ(0, helper()->getPortType("10g_base-sr"));
    EXPECT_EQ(0, helper()->getPortType(0));
}
