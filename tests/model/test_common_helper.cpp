// The host's ComputerSystem and the console agent's access point, in the
// test process. This executable defines gethostname and gethostbyname_r over
// the C library's, so that a test can play a host of any name and addresses
// (no name: gethostname fails; no address: the name doesn't resolve). Until
// a test plays one, both pass through to the real functions.

#include <dlfcn.h>
#include <errno.h>
#include <netdb.h>
#include <arpa/inet.h>
#include <string.h>

#include <vector>

#include "AccessPointHelper.h"
#include "CommonHelper.h"
#include "EthernetPortHelper.h"
#include "VESPERA_ComputerSystem.h"
#include "test_ethernet_helper.h"

using namespace eth_test;

namespace
{

struct
{
    bool on = false;
    std::string name;
    std::vector<std::string> addresses;
} played;

} // namespace

extern "C" int gethostname(char* name, size_t len) __THROW
{
    typedef int (*Fn)(char*, size_t);
    static Fn real = (Fn)dlsym(RTLD_NEXT, "gethostname");
    if (!played.on)
        return real(name, len);
    strncpy(name, played.name.c_str(), len);
    return played.name.empty() ? (errno = EFAULT, -1) : 0;
}

extern "C" int gethostbyname_r(const char* name, struct hostent* ret, char* buf, size_t buflen,
    struct hostent** result, int* h_errnop)
{
    typedef int (*Fn)(const char*, struct hostent*, char*, size_t, struct hostent**, int*);
    static Fn real = (Fn)dlsym(RTLD_NEXT, "gethostbyname_r");
    if (!played.on)
        return real(name, ret, buf, buflen, result, h_errnop);

    *result = 0;
    size_t n = played.addresses.size();
    if (n == 0)
        return *h_errnop = HOST_NOT_FOUND, ENOENT;
    if (buflen < (n + 1) * sizeof(char*) + n * sizeof(in_addr))
        return ERANGE;

    // The list of pointers, then the addresses they point to.
    char** list = (char**)buf;
    in_addr* addrs = (in_addr*)(list + n + 1);
    for (size_t i = 0; i < n; i++)
    {
        inet_pton(AF_INET, played.addresses[i].c_str(), &addrs[i]);
        list[i] = (char*)&addrs[i];
    }
    list[n] = 0;
    memset(ret, 0, sizeof(*ret));
    ret->h_name = (char*)name;
    ret->h_aliases = list + n;
    ret->h_addrtype = AF_INET;
    ret->h_length = sizeof(in_addr);
    ret->h_addr_list = list;
    *result = ret;
    return 0;
}

namespace
{

class HostTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        workDir();
        ASSERT_TRUE(gTrujLibLoaded);
    }
    void TearDown() override { played.on = false; }

    void play(const std::string& name, const std::vector<std::string>& addresses = {})
    {
        played.on = true;
        played.name = name;
        played.addresses = addresses;
    }

    // The one host instance.
    VESPERA_ComputerSystem* host(Walk<VESPERA_ComputerSystem>& w)
    {
        EXPECT_EQ(1u, w.size());
        return w.size() ? w[0] : 0;
    }
};

CommonHelper* common()
{
    return CommonHelper::getCommonHelperObject();
}

AccessPointHelper* accessPoints()
{
    return AccessPointHelper::getAccessPointHelperInstance();
}

std::vector<std::string> strs(const Property<Array<String> >& p)
{
    std::vector<std::string> v;
    for (size_t i = 0; i < p.value.size(); i++)
        v.push_back(str(p.value[i]));
    return v;
}

typedef std::vector<std::string> Texts;

} // namespace

TEST_F(HostTest, EachKindOfHost)
{
    struct Case { const char* played; std::vector<std::string> addresses; const char* name;
        const char* nameFormat; const char* description; };
    // Loopback addresses are passed over; a host without another address is
    // named by its plain name, and one without a name is "localhost".
    const char* const FQDN = "Fully Qualified Domain Name";
    const Case cases[] = {
        { "blade7", { "127.0.1.1", "10.20.30.40", "10.20.30.41" }, "10.20.30.40", "IP", "Ipv4 Address" },
        { "blade7", { "127.0.0.1", "127.0.1.1" }, "blade7", "Other", FQDN },
        { "blade7", {}, "blade7", "Other", FQDN },
        { "", {}, "localhost", "Other", FQDN },
    };
    for (const Case& c : cases)
    {
        play(c.played, c.addresses);
        Log log;
        Walk<VESPERA_ComputerSystem> w(common()->getComputerSystemInstances(ID_VESPERA_ComputerSystem));
        VESPERA_ComputerSystem* cs = host(w);
        ASSERT_TRUE(cs);
        EXPECT_EQ(c.name, str(cs->Name.value));
        EXPECT_EQ("VESPERA_ComputerSystem", str(cs->CreationClassName.value));
        EXPECT_EQ(c.nameFormat, str(cs->NameFormat.value));
        EXPECT_EQ(Texts{c.name}, strs(cs->OtherIdentifyingInfo));
        EXPECT_EQ(Texts{c.description}, strs(cs->IdentifyingDescriptions));
        for (const Property<String>* p : { &cs->ElementName, &cs->Description, &cs->Caption })
            EXPECT_EQ("The host with Vespera's adapters installed.", str(p->value));
        ASSERT_EQ(2u, cs->Dedicated.value.size());
        EXPECT_EQ(0, cs->Dedicated.value[0]);
        EXPECT_EQ(14, cs->Dedicated.value[1]);
        ASSERT_EQ(1u, cs->OperationalStatus.value.size());
        EXPECT_EQ(2, cs->OperationalStatus.value[0]);
        EXPECT_EQ(Texts{"The System is in service"}, strs(cs->StatusDescriptions));
        EXPECT_EQ(c.played[0] ? 0u : 1u, log.count("WARN", "No host IP / Name  retrived "
            "in the function, So function fills localhost for host info."));

        // The ports name the host the same way.
        Walk<VESPERA_LANEndpoint> ends(EthernetPortHelper::getEthernetPortHelperObject()->
            getInstancesByClass(ID_VESPERA_LANEndpoint));
        ASSERT_EQ(1u, ends.size());
        EXPECT_EQ(c.name, str(ends[0]->SystemName.value));
    }
}

TEST_F(HostTest, LongHostName)
{
    // The longest name Linux allows. The host keeps it whole; the Ethernet
    // records have room for one character less, and say so.
    std::string name(64, 'h');
    play(name, { "127.0.0.1" });
    Walk<VESPERA_ComputerSystem> w(common()->getComputerSystemInstances(ID_VESPERA_ComputerSystem));
    ASSERT_TRUE(host(w));
    EXPECT_EQ(name, str(host(w)->Name.value));

    Log log;
    Walk<VESPERA_EthernetPort> ports(EthernetPortHelper::getEthernetPortHelperObject()->
        getInstancesByClass(ID_VESPERA_EthernetPort));
    ASSERT_EQ(1u, ports.size());
    EXPECT_EQ(name.substr(0, 63), str(ports[0]->SystemName.value));
    EXPECT_EQ(1u, log.count("WARN", "is longer than 63 characters"));
}

TEST_F(HostTest, AccessPointWithAgentRunning)
{
    typedef Walk<VESPERA_RemoteServiceAccessPoint> Points;
    play("blade7", { "192.168.7.9" });
    // Other tests run agents of their own, perhaps right now.
    if (!Agent::running())
    {
        Log log;
        Points none(accessPoints()->getInstancesByClass(ID_VESPERA_RemoteServiceAccessPoint));
        EXPECT_EQ(0u, none.size());
        EXPECT_EQ(1u, log.count("WARN", "The ZARK Agent is not running so no service available"));
    }

    Agent agent;
    ASSERT_TRUE(Agent::running());
    {
        Log log;
        Points w(accessPoints()->getInstancesByClass(ID_VESPERA_RemoteServiceAccessPoint));
        ASSERT_EQ(1u, w.size());
        EXPECT_EQ("192.168.7.9", str(w[0]->SystemName.value));
        EXPECT_EQ("https://192.168.7.9:34568/index.html", str(w[0]->AccessInfo.value));
        EXPECT_EQ(1u, log.count("INFO", "Number of instances: 1"));
    }

    // "localhost" would send a client to itself: no access point.
    play("");
    Log log;
    Points local(accessPoints()->getInstancesByClass(ID_VESPERA_RemoteServiceAccessPoint));
    EXPECT_EQ(0u, local.size());
    EXPECT_EQ(1u, log.count("WARN", "getHostInfo returned localhost"));

    // A record whose host name fills its field without a terminator.
    _adapterData data;
    memset(&data, 'h', sizeof(data));
    VESPERA_RemoteServiceAccessPoint* full = accessPoints()->getRemoteServiceAccessPointInstance(data);
    ASSERT_TRUE(full);
    EXPECT_EQ("https://" + std::string(sizeof(data.hostName), 'h') + ":34568/index.html",
        str(full->AccessInfo.value));
    destroy(full);
}
