// EthernetPortHelper in the test process, against the simulated adapter
// library: its default host (an FC HBA and a CNA with one Ethernet port), a
// host of our own with ports that are odd in every way
// a reply can be, injected faults, and hand-made replies for the shapes the
// simulator never answers.

#include <gtest/gtest.h>

#include <stdlib.h>
#include <string.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include "CIMProviderTruj.h"
#include "EthernetPortHelper.h"
#include "ProviderUtil.h"
#include "log.h"

extern "C" int dtruj_sim_set_fault(const char* entry, const char* kind);
extern "C" int dtruj_sim_reset(void);

using namespace OLMA;

namespace
{

std::string readFile(const std::string& path)
{
    std::stringstream text;
    text << std::ifstream(path.c_str(), std::ios::binary).rdbuf();
    return text.str();
}

// A HOME of this process with the log on at DBG; removed at exit.
std::string home()
{
    struct Home
    {
        std::string dir;
        Home()
        {
            char name[] = "/tmp/vspr-eth-XXXXXX";
            dir = mkdtemp(name) ? name : "/tmp";
            std::ofstream(dir + "/.tesselrc") << "LOG_LEVEL=DBG\n";
            setenv("HOME", dir.c_str(), 1);
            close_log();
            log(LL_INFO, "test_ethernet_helper.cpp", __LINE__, "test log");
        }
        ~Home()
        {
            std::error_code ec;
            std::filesystem::remove_all(dir, ec);
        }
    };
    static Home h;
    return h.dir;
}

// What was logged between its construction and text().
class Log
{
public:
    Log() : _start(readFile(path()).size()) { }
    std::string text() const { return readFile(path()).substr(_start); }

    size_t count(const std::string& level, const std::string& piece) const
    {
        std::istringstream in(text());
        std::string line;
        size_t n = 0;
        while (std::getline(in, line))
            n += line.find(level + ": ") != std::string::npos &&
                line.find(piece) != std::string::npos;
        return n;
    }

    static std::string path() { return home() + "/.tessel/messages"; }

private:
    size_t _start;
};

std::string str(const String& s)
{
    return std::string(s.c_str(), s.size());
}

std::string hostString()
{
    char host[256] = "";
    ProviderUtil::getProviderUtil()->getHostInfo(host, 255);
    return std::string(host).substr(0, 63);
}

EthernetPortHelper* helper()
{
    return EthernetPortHelper::getEthernetPortHelperObject();
}

// Owns the instances of a walk.
struct Walk
{
    Array<Instance*> all;
    explicit Walk(const Array<Instance*>& a) : all(a) { }
    ~Walk()
    {
        for (size_t i = 0; i < all.size(); i++)
            destroyer(all[i]);
    }
    size_t size() const { return all.size(); }

    template<class T>
    T* at(size_t i) const
    {
        T* p = checked_cast<T>(all[i]);
        EXPECT_TRUE(p != 0) << "element " << i << " is of another class";
        return p;
    }

    // By DeviceID or Name, whichever the class has.
    template<class T>
    std::map<std::string, T*> byKey() const;
};

template<>
std::map<std::string, VESPERA_EthernetPort*> Walk::byKey() const
{
    std::map<std::string, VESPERA_EthernetPort*> m;
    for (size_t i = 0; i < all.size(); i++)
        if (VESPERA_EthernetPort* p = at<VESPERA_EthernetPort>(i))
            m[str(p->DeviceID.value)] = p;
    return m;
}

template<>
std::map<std::string, VESPERA_LANEndpoint*> Walk::byKey() const
{
    std::map<std::string, VESPERA_LANEndpoint*> m;
    for (size_t i = 0; i < all.size(); i++)
        if (VESPERA_LANEndpoint* p = at<VESPERA_LANEndpoint>(i))
            m[str(p->MACAddress.value)] = p;
    return m;
}

template<class T>
std::vector<T> vec(const Property<Array<T> >& p)
{
    EXPECT_EQ(0, p.null);
    return std::vector<T>(p.value.data(), p.value.data() + p.value.size());
}

Json::Value lastRequest;
Json::Value cannedReply;

Json::Value recordAndAnswer(const Json::Value& request)
{
    lastRequest = request;
    return cannedReply;
}

// Puts recordAndAnswer in place of one library entry for the object's life.
class Fake
{
public:
    Fake(JsonReqFP& slot, const Json::Value& reply) : _slot(slot), _saved(slot)
    {
        cannedReply = reply;
        _slot = recordAndAnswer;
    }
    ~Fake() { _slot = _saved; }
private:
    JsonReqFP& _slot;
    JsonReqFP _saved;
};

Json::Value parse(const std::string& text)
{
    Json::Value v;
    Json::Reader().parse(text, v, false);
    return v;
}

// An FC HBA, a CNA whose six Ethernet ports are odd in the ways a reply can
// be, and a second CNA: a failure at one port must leave the others.
const char* const ODD_HOST = R"({ "adapters": [
  { "hbaData": { "wwn": "20:00:00:05:1e:01:00:00" },
    "fcPorts": [ { "wwn": "10:00:00:05:1e:01:00:01" } ] },
  { "hbaData": { "wwn": "20:00:00:05:1e:02:00:00", "hbaMAC": "00:05:1e:02:00:00" },
    "driver": { "networkDriverName": "vspreth", "networkDriverVersion": "1" },
    "fcPorts": [ { "wwn": "10:00:00:05:1e:02:00:01" } ],
    "ethPorts": [
      { "mac": "00:05:1e:02:00:01", "ethDev": "eth10", "mtu": 1500,
        "sfp": { "transceiver": "10G_BASE-LR" } },
      { "mac": "00:05:1e:02:00:02", "ethDev": "eth11", "mtu": null,
        "ethPortStateMOFValue": 7, "sfp": { "transceiver": "10G_BASE-LRM" } },
      { "mac": "00:05:1e:02:00:03", "ethDev": "LONGNAME", "portStatus": false,
        "sfp": { "transceiver": "1G_BASE-T" } },
      { "mac": "00:05:1e:02:00:04", "ethDev": 42, "ethPortStateMOFValue": "11",
        "mtu": -5 },
      { "mac": "00:05:1e:02:00:05", "ethDev": "eth14", "linkUp": false,
        "sfp": { "transceiver": 5 } },
      { "mac": "00:05:1e:02:00:06", "ethDev": "eth15", "ethPortStateMOFValue": 8,
        "mtu": 4294967295, "sfp": { "transceiver": "10G_BASE-SR" } } ] },
  { "hbaData": { "wwn": "20:00:00:05:1e:03:00:00", "hbaMAC": "00:05:1e:03:00:00" },
    "ethPorts": [ { "mac": "00:05:1e:03:00:01", "ethDev": "eth20", "mtu": 9000 } ] }
] })";

const std::string LONG_NAME(2000, 'n');

class EthernetHelper : public ::testing::Test
{
protected:
    void SetUp() override
    {
        home();
        ASSERT_TRUE(gTrujLibLoaded) << "the start-up didn't load libdtruj.so";
    }

    void TearDown() override
    {
        unsetenv("DTRUJ_HOST");
        dtruj_sim_reset();
    }

    void useHost(std::string text)
    {
        size_t at = text.find("LONGNAME");
        if (at != std::string::npos)
            text.replace(at, 8, LONG_NAME);

        std::string path = home() + "/host.json";
        std::ofstream(path.c_str(), std::ios::trunc) << text;
        setenv("DTRUJ_HOST", path.c_str(), 1);
        ASSERT_EQ(0, dtruj_sim_reset());
    }

    void fault(const char* entry, const char* kind)
    {
        ASSERT_EQ(0, dtruj_sim_set_fault(entry, kind)) << entry << " " << kind;
    }
};

} // namespace

TEST_F(EthernetHelper, DefaultHostPortAndEndpoint)
{
    std::string host = hostString();
    Log log;
    Walk ports(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));

    ASSERT_EQ(1u, ports.size());
    VESPERA_EthernetPort* p = ports.at<VESPERA_EthernetPort>(0);
    ASSERT_TRUE(p);
    EXPECT_EQ("VESPERA_EthernetPort", str(p->CreationClassName.value));
    EXPECT_EQ("VESPERA_ComputerSystem", str(p->SystemCreationClassName.value));
    EXPECT_EQ(host, str(p->SystemName.value));
    EXPECT_EQ("00051e8b2002", str(p->DeviceID.value));
    EXPECT_EQ("00051e8b2002", str(p->PermanentAddress.value));
    EXPECT_EQ(std::vector<String>{String("00051e8b2002")}, vec(p->NetworkAddresses));
    EXPECT_EQ("eth2", str(p->ElementName.value));
    EXPECT_EQ(2, p->LinkTechnology.value);
    EXPECT_EQ(std::vector<uint16>{0}, vec(p->Capabilities));
    EXPECT_EQ(std::vector<uint16>{0}, vec(p->EnabledCapabilities));
    EXPECT_EQ(std::vector<uint16>{11}, vec(p->OperationalStatus));
    EXPECT_EQ(105, p->PortType.value);
    EXPECT_EQ(0, p->PortNumber.value);
    EXPECT_EQ(0, p->PortNumber.null);

    // The FC HBA says why it gives nothing, and nothing is an error.
    EXPECT_EQ(1u, log.count("INFO", "No Ethernet ports found for Adapter - 20:00:00:05:1e:8a:10:00"));
    EXPECT_EQ(1u, log.count("INFO", "No Ethernet ports found for Adapter - "));
    EXPECT_EQ(0u, log.count("ERR", ""));

    Walk ends(helper()->getInstancesByClass(ID_VESPERA_LANEndpoint));
    ASSERT_EQ(1u, ends.size());
    VESPERA_LANEndpoint* e = ends.at<VESPERA_LANEndpoint>(0);
    ASSERT_TRUE(e);
    EXPECT_EQ("VESPERA_LANEndpoint", str(e->CreationClassName.value));
    EXPECT_EQ("VESPERA_ComputerSystem", str(e->SystemCreationClassName.value));
    EXPECT_EQ(host, str(e->SystemName.value));
    EXPECT_EQ("eth2", str(e->Name.value));
    EXPECT_EQ("eth2", str(e->ElementName.value));
    EXPECT_EQ("eth2", str(e->Description.value));
    EXPECT_EQ("eth2", str(e->LANID.value));
    EXPECT_EQ("eth2_ETHERNET", str(e->NameFormat.value));
    EXPECT_EQ(1, e->ProtocolIFType.value);
    EXPECT_EQ("00051e8b2002", str(e->MACAddress.value));
    EXPECT_EQ(72000u, e->MaxDataSize.value);
    EXPECT_EQ(5, e->HealthState.value);
    EXPECT_EQ(2, e->EnabledState.value);
}

TEST_F(EthernetHelper, OddPortsOfAHost)
{
    useHost(ODD_HOST);
    Log log;
    Walk ports(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
    std::map<std::string, VESPERA_EthernetPort*> p = ports.byKey<VESPERA_EthernetPort>();

    ASSERT_EQ(7u, ports.size()) << log.text();
    ASSERT_EQ(7u, p.size());

    // Adapter order, then port order; places count again for each adapter.
    const char* const order[] = { "00051e020001", "00051e020002", "00051e020003",
        "00051e020004", "00051e020005", "00051e020006", "00051e030001" };
    const uint16 places[] = { 0, 1, 2, 3, 4, 5, 0 };
    for (size_t i = 0; i < 7; i++)
    {
        VESPERA_EthernetPort* x = ports.at<VESPERA_EthernetPort>(i);
        EXPECT_EQ(order[i], str(x->DeviceID.value));
        EXPECT_EQ(places[i], x->PortNumber.value);
    }

    // Port types by transceiver; none known, or none at all, is 0.
    EXPECT_EQ(108, p["00051e020001"]->PortType.value);
    EXPECT_EQ(108, p["00051e020002"]->PortType.value);
    EXPECT_EQ(0, p["00051e020003"]->PortType.value);
    EXPECT_EQ(0, p["00051e020004"]->PortType.value);
    EXPECT_EQ(0, p["00051e020005"]->PortType.value);
    EXPECT_EQ(105, p["00051e020006"]->PortType.value);
    EXPECT_EQ(0, p["00051e030001"]->PortType.value);
    EXPECT_EQ(1u, log.count("ERR", "Unable to get SFP info for 00:05:1e:02:00:04"));
    EXPECT_EQ(1u, log.count("ERR", "Unable to get SFP info for 00:05:1e:02:00:05"));
    EXPECT_EQ(1u, log.count("ERR", "Unable to get SFP info for 00:05:1e:03:00:01"));
    EXPECT_EQ(3u, log.count("ERR", "Unable to get SFP info for "));

    // A disabled port, a port without link, a state of the wrong type.
    EXPECT_EQ(std::vector<uint16>{7}, vec(p["00051e020002"]->OperationalStatus));
    EXPECT_EQ(std::vector<uint16>{10}, vec(p["00051e020003"]->OperationalStatus));
    EXPECT_EQ(std::vector<uint16>{0}, vec(p["00051e020004"]->OperationalStatus));
    EXPECT_EQ(std::vector<uint16>{13}, vec(p["00051e020005"]->OperationalStatus));

    // Texts: cut to the field, or empty when not a text.
    EXPECT_EQ(LONG_NAME.substr(0, 1027), str(p["00051e020003"]->ElementName.value));
    EXPECT_EQ("", str(p["00051e020004"]->ElementName.value));
    EXPECT_EQ(1u, log.count("WARN", "No Ethernet device name for 00051e020004"));
    EXPECT_EQ(1u, log.count("WARN", "No Ethernet port state for 00051e020004"));
    EXPECT_EQ(1u, log.count("INFO", "No Ethernet ports found for Adapter - 20:00:00:05:1e:01:00:00"));

    Log endsLog;
    Walk ends(helper()->getInstancesByClass(ID_VESPERA_LANEndpoint));
    std::map<std::string, VESPERA_LANEndpoint*> e = ends.byKey<VESPERA_LANEndpoint>();

    // The port without a device name has no endpoint: it would have no key.
    ASSERT_EQ(6u, ends.size());
    EXPECT_EQ(0u, e.count("00051e020004"));
    EXPECT_EQ(1u, endsLog.count("ERR", "No LAN endpoint for 00:05:1e:02:00:04"));
    // No optics are asked for endpoints.
    EXPECT_EQ(0u, endsLog.count("ERR", "Unable to get SFP info"));

    EXPECT_EQ(12000u, e["00051e020001"]->MaxDataSize.value);
    EXPECT_EQ(0u, e["00051e020002"]->MaxDataSize.value);    // null mtu
    EXPECT_EQ(0, e["00051e020002"]->MaxDataSize.null);
    EXPECT_EQ(0u, e["00051e020006"]->MaxDataSize.value);    // too big for bits
    EXPECT_EQ(72000u, e["00051e030001"]->MaxDataSize.value);

    // State 7 is "other"; 10 disabled; 13 no link; 8 from the reply as it is.
    EXPECT_EQ(0, e["00051e020002"]->HealthState.value);
    EXPECT_EQ(1, e["00051e020002"]->EnabledState.value);
    EXPECT_EQ(10, e["00051e020003"]->HealthState.value);
    EXPECT_EQ(3, e["00051e020003"]->EnabledState.value);
    EXPECT_EQ(10, e["00051e020005"]->HealthState.value);
    EXPECT_EQ(6, e["00051e020005"]->EnabledState.value);
    EXPECT_EQ(5, e["00051e020006"]->HealthState.value);
    EXPECT_EQ(9, e["00051e020006"]->EnabledState.value);

    std::string name = LONG_NAME.substr(0, 1027);
    EXPECT_EQ(name, str(e["00051e020003"]->Name.value));
    EXPECT_EQ(name + "_ETHERNET", str(e["00051e020003"]->NameFormat.value));
}

TEST_F(EthernetHelper, PortsByAdapterOfAnAddress)
{
    useHost(ODD_HOST);

    // Any port of the adapter, in either form, names it.
    {
        Walk w(helper()->getEthernetPortInstancesByAdapter("00051e020003"));
        EXPECT_EQ(6u, w.size());
    }
    {
        Walk w(helper()->getEthernetPortInstancesByAdapter("10:00:00:05:1e:02:00:01"));
        EXPECT_EQ(6u, w.size());
    }
    {
        Log log;
        Walk w(helper()->getEthernetPortInstancesByAdapter("100000051e010001"));
        EXPECT_EQ(0u, w.size());
        EXPECT_EQ(0u, log.count("ERR", ""));
    }
    {
        Log log;
        Walk w(helper()->getEthernetPortInstancesByAdapter("00051eFFFFFF"));
        EXPECT_EQ(0u, w.size());
        EXPECT_EQ(1u, log.count("WARN", "Adapter not found in the system."));
    }

    // Replies the simulator never gives.
    Log log;
    const char* const bad[] = { R"({"adapterId": "2"})", R"({})", R"([1])",
        R"({"error": {"code": 1}})", "null" };
    for (const char* reply : bad)
    {
        Fake f(libGetAdapterIdByPort, parse(reply));
        Walk w(helper()->getEthernetPortInstancesByAdapter("00051e020003"));
        EXPECT_EQ(0u, w.size()) << reply;
        EXPECT_EQ("00:05:1e:02:00:03", lastRequest["indexStr"].asString());
    }
    EXPECT_EQ(5u, log.count("ERR", "libGetAdapterIdByPort returns NULL."));

    Log negative;
    {
        Fake f(libGetAdapterIdByPort, parse(R"({"adapterId": -3})"));
        Walk w(helper()->getEthernetPortInstancesByAdapter("00051e020003"));
        EXPECT_EQ(0u, w.size());
    }
    EXPECT_EQ(1u, negative.count("WARN", "Adapter not found in the system."));

    // The library may throw here too; it must not reach the caller.
    fault("getAdapterIdByPort", R"({"kind":"std","message":"gone"})");
    Log thrown;
    Walk w(helper()->getEthernetPortInstancesByAdapter("00051e020003"));
    EXPECT_EQ(0u, w.size());
    EXPECT_EQ(1u, thrown.count("ERR", "00:05:1e:02:00:03 - libGetAdapterIdByPort got std exception: gone"));
}

TEST_F(EthernetHelper, LibraryFaultsSkipThePortOrAdapter)
{
    struct Case
    {
        const char* entry;
        const char* kind;
        size_t ports;            // Ethernet ports of the default host left
        const char* level;
        const char* line;
    };
    const Case cases[] = {
        { "getEthPortByEthMac", R"({"kind":"hba","code":7,"message":"port busy"})", 0, "ERR",
          "00:05:1e:8b:20:02 - libGetEthPortByEthMac got User exception 7: port busy" },
        { "getEthPortByEthMac", R"({"kind":"std","message":"bad alloc"})", 0, "ERR",
          "00:05:1e:8b:20:02 - libGetEthPortByEthMac got std exception: bad alloc" },
        { "getEthPortByEthMac", "unknown", 0, "ERR",
          "libGetEthPortByEthMac got default exception for 00:05:1e:8b:20:02" },
        { "getEthPortByEthMac", "error", 0, "ERR", "Ethernet Port Info is NOT available" },
        { "getEthPortByEthMac", "null", 0, "ERR", "Unable to get Eth port data for 00:05:1e:8b:20:02" },
        { "getEthPhyPortIndicesByAdapter", R"({"kind":"hba","code":9,"message":"no"})", 0, "ERR",
          "00:05:1e:8b:20:00 - libGetEthPhyPortIndicesByAdapter got User exception 9: no" },
        { "getEthPhyPortIndicesByAdapter", R"({"kind":"std","message":"x"})", 0, "ERR",
          "00:05:1e:8b:20:00 - libGetEthPhyPortIndicesByAdapter got std exception: x" },
        { "getEthPhyPortIndicesByAdapter", "unknown", 0, "ERR",
          "00:05:1e:8b:20:00 - libGetEthPhyPortIndicesByAdapter got default exception" },
        { "getEthPhyPortIndicesByAdapter", "error", 0, "ERR",
          "libGetEthPhyPortIndicesByAdapter returns NULL." },
        { "getOpticsSFP", R"({"kind":"hba","code":6,"message":"no sfp"})", 1, "ERR",
          "00:05:1e:8b:20:02 - libGetOpticsSFP got User exception 6: no sfp" },
        { "getOpticsSFP", "unknown", 1, "ERR",
          "00:05:1e:8b:20:02 - libGetOpticsSFP got default exception" },
        { "getAllAdaptersIndexString", "null", 0, "ERR",
          "libGetAllAdaptersIndexString returns NULL." },
        { "getAllAdaptersIndexString", "unknown", 0, "ERR",
          "libGetAllAdaptersIndexString returns NULL." },
        { "getHbaByWwn", "error", 0, "ERR", "Unable to get Ethernet info 00:05:1e:8b:20:00" },
    };

    for (const Case& c : cases)
    {
        fault(c.entry, c.kind);
        Log log;
        Walk w(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
        EXPECT_EQ(c.ports, w.size()) << c.entry << " " << c.kind;
        EXPECT_EQ(1u, log.count(c.level, c.line)) << c.entry << " " << c.kind << "\n" << log.text();
        if (c.ports)
        {
            EXPECT_EQ(0, w.at<VESPERA_EthernetPort>(0)->PortType.value);
        }
        fault(c.entry, "none");
    }
}

TEST_F(EthernetHelper, FaultAtOnePortLeavesTheRest)
{
    useHost(ODD_HOST);

    // The first port's details fail once; the other six still appear.
    fault("getEthPortByEthMac", R"({"kind":"hba","code":7,"message":"busy","count":1})");
    Log log;
    Walk w(helper()->getInstancesByClass(ID_VESPERA_LANEndpoint));
    EXPECT_EQ(5u, w.size());
    EXPECT_EQ(1u, log.count("ERR", "Unable to get Eth port data for 00:05:1e:02:00:01"));
    EXPECT_EQ(0u, w.byKey<VESPERA_LANEndpoint>().count("00051e020001"));

    // An adapter whose details fail is skipped; the next still shows.
    fault("getHbaByWwn", R"({"kind":"error","count":2})");
    Walk v(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
    ASSERT_EQ(1u, v.size());
    EXPECT_EQ("00051e030001", str(v.at<VESPERA_EthernetPort>(0)->DeviceID.value));
}

TEST_F(EthernetHelper, RepliesOfTheWrongShape)
{
    // A port list whose first element isn't a text: the second is still
    // read, at its own place.
    {
        Log log;
        Fake f(libGetEthPhyPortIndicesByAdapter,
            parse(R"({"indexStrings": [5, "00:05:1e:8b:20:02"]})"));
        Walk w(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
        ASSERT_EQ(1u, w.size());
        EXPECT_EQ(1, w.at<VESPERA_EthernetPort>(0)->PortNumber.value);
        EXPECT_EQ(1u, log.count("ERR", "Ethernet port 0 of 00:05:1e:8b:20:00 has no index string"));
    }

    const char* const badLists[] = { R"([ "00:05:1e:8b:20:02" ])",
        R"({"indexStrings": "00:05:1e:8b:20:02"})", R"({"indexStrings": {}})", "7" };
    for (const char* reply : badLists)
    {
        Log log;
        Fake f(libGetEthPhyPortIndicesByAdapter, parse(reply));
        Walk w(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
        EXPECT_EQ(0u, w.size()) << reply;
        EXPECT_EQ(1u, log.count("ERR", "libGetEthPhyPortIndicesByAdapter returns NULL.")) << reply;
    }

    const char* const badDetails[] = { R"({"ethData": 5})", R"({"ethData": []})",
        R"([{"ethData": {}}])", R"("ethData")", R"({})" };
    for (const char* reply : badDetails)
    {
        Log log;
        Json::Value out;
        Fake f(libGetEthPortByEthMac, parse(reply));
        EXPECT_EQ(-1, helper()->getEthPortDetails("00051e8b2002", out)) << reply;
        EXPECT_EQ("00:05:1e:8b:20:02", lastRequest["mac"].asString());
        EXPECT_EQ(1u, log.count("ERR", "Ethernet Port Info is NOT available")) << reply;
    }

    // Optics that answer an array, or a transceiver that isn't a text.
    const char* const badOptics[] = { R"([{"transceiver": "10G_BASE-SR"}])",
        R"({"transceiver": ["10G_BASE-SR"]})" };
    for (const char* reply : badOptics)
    {
        Log log;
        Fake f(libGetOpticsSFP, parse(reply));
        Walk w(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
        ASSERT_EQ(1u, w.size());
        EXPECT_EQ(0, w.at<VESPERA_EthernetPort>(0)->PortType.value);
        EXPECT_EQ("00:05:1e:8b:20:02", lastRequest["indexStr"].asString());
        EXPECT_EQ(1u, log.count("ERR", "Unable to get SFP info for 00:05:1e:8b:20:02"));
    }

    // An adapter list with an element that isn't a text.
    {
        Log log;
        Fake f(libGetAllAdaptersIndexString, parse(R"({"indexStrings": [null]})"));
        Walk w(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
        EXPECT_EQ(0u, w.size());
        EXPECT_EQ(1u, log.count("ERR", "Adapter 1 has no index string"));
    }
    {
        Log log;
        Fake f(libGetAllAdaptersIndexString, parse(R"({"indexStrings": []})"));
        Walk w(helper()->getInstancesByClass(ID_VESPERA_EthernetPort));
        EXPECT_EQ(0u, w.size());
        EXPECT_EQ(1u, log.count("WARN", "No adapters in the system. "));
    }
}

TEST_F(EthernetHelper, OtherClassesAndAdapterIds)
{
    Log log;
    {
        Walk w(helper()->getInstancesByAdapterId(2, ID_VESPERA_FCPort));
        EXPECT_EQ(0u, w.size());
    }
    EXPECT_EQ(1u, log.count("INFO", "Unhandled class support"));

    Walk none(helper()->getInstancesByAdapterId(9, ID_VESPERA_EthernetPort));
    EXPECT_EQ(0u, none.size());
    Walk zero(helper()->getInstancesByAdapterId(0, ID_VESPERA_EthernetPort));
    EXPECT_EQ(0u, zero.size());
    Walk cna(helper()->getInstancesByAdapterId(2, ID_VESPERA_LANEndpoint));
    EXPECT_EQ(1u, cna.size());
}

TEST_F(EthernetHelper, PortTypesAndStates)
{
    EXPECT_EQ(105, helper()->getPortType("10G_BASE-SR"));
    EXPECT_EQ(108, helper()->getPortType("10G_BASE-LR"));
    EXPECT_EQ(108, helper()->getPortType("10G_BASE-LRM"));
    EXPECT_EQ(0, helper()->getPortType("10g_base-sr"));
    EXPECT_EQ(0, helper()->getPortType("10G_BASE-SR "));
    EXPECT_EQ(0, helper()->getPortType(""));
    EXPECT_EQ(0, helper()->getPortType(0));

    // state -> HealthState, EnabledState
    const unsigned int states[][3] = { { 6, 15, 1 }, { 7, 0, 1 }, { 8, 5, 9 },
        { 9, 10, 4 }, { 10, 10, 3 }, { 11, 5, 2 }, { 12, 0, 1 }, { 13, 10, 6 },
        { 0, 0, 1 } };
    for (const auto& s : states)
    {
        _ethPortInfo info;
        memset(&info, 0, sizeof(info));
        strcpy(info.deviceName, "eth0");
        info.state = s[0];
        VESPERA_LANEndpoint* e = helper()->getLANEndpointInstance(info);
        EXPECT_EQ(s[1], e->HealthState.value) << s[0];
        EXPECT_EQ(s[2], e->EnabledState.value) << s[0];
        destroy(e);
    }
}

TEST_F(EthernetHelper, BuildersReadNoFurtherThanTheRecord)
{
    // A record whose every text fills its field without a terminator.
    _ethPortInfo info;
    memset(&info, 'x', sizeof(info));
    info.state = 11;
    info.portType = 105;
    info.portNumber = 3;
    info.mtu = 1500;

    VESPERA_EthernetPort* p = helper()->getEthernetPortInstance(info);
    EXPECT_EQ(std::string(36, 'x'), str(p->DeviceID.value));
    EXPECT_EQ(std::string(24, 'x'), str(p->PermanentAddress.value));
    EXPECT_EQ(std::string(64, 'x'), str(p->SystemName.value));
    EXPECT_EQ(std::string(1028, 'x'), str(p->ElementName.value));
    destroy(p);

    VESPERA_LANEndpoint* e = helper()->getLANEndpointInstance(info);
    EXPECT_EQ(std::string(1028, 'x'), str(e->Name.value));
    EXPECT_EQ(std::string(36, 'x'), str(e->MACAddress.value));
    destroy(e);

    // The reading side cuts a member to its field and keeps the terminator.
    _ethPortInfo filled;
    memset(&filled, 0, sizeof(filled));
    Json::Value eth(Json::objectValue);
    eth["ethDev"] = std::string(5000, 'd');
    eth["ethPortStateMOFValue"] = 13;
    eth["mtu"] = 9000;
    EthernetPortHelper::fillFromEthData(eth, &filled);
    EXPECT_EQ(1027u, strlen(filled.deviceName));
    EXPECT_EQ(13u, filled.state);
    EXPECT_EQ(9000u, filled.mtu);

    // A non-object reads as all missing, without a throw.
    EthernetPortHelper::fillFromEthData(Json::Value(Json::arrayValue), &filled);
    EXPECT_EQ(0u, filled.mtu);
    EXPECT_EQ(0u, filled.state);
}
