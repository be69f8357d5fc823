// The host's ComputerSystem and the console agent's access point, in the
// test process. The host's name and addresses come from gethostname and
// gethostbyname_r, which this executable defines over the C library's, so
// that each kind of host can be played: one with an IPv4 address, one whose
// name resolves to loopback only or not at all, and one without a name.
// Until a test picks a host, both pass through to the real functions.

#include <gtest/gtest.h>

#include <dlfcn.h>
#include <errno.h>
#include <netdb.h>
#include <arpa/inet.h>
#include <signal.h>
#include <stdlib.h>
#include <string.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "AccessPointHelper.h"
#include "CIMProviderTruj.h"
#include "CommonHelper.h"
#include "EthernetPortHelper.h"
#include "ProviderUtil.h"
#include "VESPERA_ComputerSystem.h"
#include "log.h"

using namespace OLMA;

namespace
{

enum Played { REAL, WITH_ADDRESS, LOOPBACK_ONLY, UNRESOLVED, NAMELESS };

struct
{
    Played kind = REAL;
    std::string name;
    std::vector<std::string> addresses;
} played;

} // namespace

extern "C" int gethostname(char* name, size_t len) __THROW
{
    if (played.kind == REAL)
    {
        typedef int (*Fn)(char*, size_t);
        static Fn real = (Fn)dlsym(RTLD_NEXT, "gethostname");
        return real(name, len);
    }

    if (played.kind == NAMELESS)
    {
        errno = EFAULT;
        return -1;
    }

    strncpy(name, played.name.c_str(), len);
    return 0;
}

extern "C" int gethostbyname_r(const char* name, struct hostent* ret,
    char* buf, size_t buflen, struct hostent** result, int* h_errnop)
{
    if (played.kind == REAL)
    {
        typedef int (*Fn)(const char*, struct hostent*, char*, size_t,
            struct hostent**, int*);
        static Fn real = (Fn)dlsym(RTLD_NEXT, "gethostbyname_r");
        return real(name, ret, buf, buflen, result, h_errnop);
    }

    *result = 0;
    size_t n = played.addresses.size();

    if (played.kind == UNRESOLVED || n == 0)
    {
        *h_errnop = HOST_NOT_FOUND;
        return ENOENT;
    }

    size_t need = (n + 1) * sizeof(char*) + n * sizeof(in_addr) + 1;
    if (buflen < need)
        return ERANGE;

    char** list = (char**)buf;
    in_addr* addrs = (in_addr*)(buf + (n + 1) * sizeof(char*));

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
            char name[] = "/tmp/vspr-host-XXXXXX";
            dir = mkdtemp(name) ? name : "/tmp";
            std::ofstream(dir + "/.tesselrc") << "LOG_LEVEL=DBG\n";
            setenv("HOME", dir.c_str(), 1);
            close_log();
            log(LL_INFO, "test_common_helper.cpp", __LINE__, "test log");
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

std::vector<std::string> strs(const Property<Array<String> >& p)
{
    std::vector<std::string> v;
    for (size_t i = 0; i < p.value.size(); i++)
        v.push_back(str(p.value[i]));
    return v;
}

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
};

// The console agent as the process list shows it: a sleep started under the
// name zarkagent. It is ended when the object goes.
class Agent
{
public:
    Agent()
    {
        std::string link = home() + "/zarkagent";
        std::error_code ec;
        std::filesystem::remove(link, ec);
        std::filesystem::create_symlink("/bin/sleep", link, ec);

        _pid = fork();
        if (_pid == 0)
        {
            execl(link.c_str(), "zarkagent", "60", (char*)0);
            _exit(127);
        }

        // Wait until ps can see it.
        for (int i = 0; i < 100 && !ProviderUtil::getProviderUtil()->getAgentPort(); i++)
            usleep(20000);
    }

    ~Agent()
    {
        if (_pid > 0)
        {
            kill(_pid, SIGTERM);
            waitpid(_pid, 0, 0);
        }
    }

private:
    pid_t _pid;
};

class HostTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        home();
        ASSERT_TRUE(gTrujLibLoaded) << "the start-up didn't load libdtruj.so";
    }

    void TearDown() override
    {
        played.kind = REAL;
    }

    void play(Played kind, const std::string& name,
        const std::vector<std::string>& addresses = {})
    {
        played.kind = kind;
        played.name = name;
        played.addresses = addresses;
    }

    VESPERA_ComputerSystem* host(Walk& w)
    {
        EXPECT_EQ(1u, w.size());
        return w.size() ? checked_cast<VESPERA_ComputerSystem>(w.all[0]) : 0;
    }
};

CommonHelper* common()
{
    return CommonHelper::getCommonHelperObject();
}

AccessPointHelper* access()
{
    return AccessPointHelper::getAccessPointHelperInstance();
}

const char* const HOST_TEXT = "The host with Vespera's adapters installed.";

} // namespace

TEST_F(HostTest, HostWithAnAddressIsNamedByIt)
{
    // Loopback addresses come first and are passed over.
    play(WITH_ADDRESS, "blade7", { "127.0.1.1", "10.20.30.40", "10.20.30.41" });
    Log log;
    Walk w(common()->getComputerSystemInstances(ID_VESPERA_ComputerSystem));
    VESPERA_ComputerSystem* cs = host(w);
    ASSERT_TRUE(cs);

    EXPECT_EQ("10.20.30.40", str(cs->Name.value));
    EXPECT_EQ("VESPERA_ComputerSystem", str(cs->CreationClassName.value));
    EXPECT_EQ("IP", str(cs->NameFormat.value));
    EXPECT_EQ(std::vector<std::string>{"10.20.30.40"}, strs(cs->OtherIdentifyingInfo));
    EXPECT_EQ(std::vector<std::string>{"Ipv4 Address"}, strs(cs->IdentifyingDescriptions));
    EXPECT_EQ(HOST_TEXT, str(cs->ElementName.value));
    EXPECT_EQ(HOST_TEXT, str(cs->Description.value));
    EXPECT_EQ(HOST_TEXT, str(cs->Caption.value));
    ASSERT_EQ(2u, cs->Dedicated.value.size());
    EXPECT_EQ(0, cs->Dedicated.value[0]);
    EXPECT_EQ(14, cs->Dedicated.value[1]);
    ASSERT_EQ(1u, cs->OperationalStatus.value.size());
    EXPECT_EQ(2, cs->OperationalStatus.value[0]);
    EXPECT_EQ(std::vector<std::string>{"The System is in service"}, strs(cs->StatusDescriptions));
    EXPECT_EQ(0u, log.count("WARN", ""));

    // The ports name the host the same way.
    Walk ports(EthernetPortHelper::getEthernetPortHelperObject()->getInstancesByClass(
        ID_VESPERA_LANEndpoint));
    ASSERT_EQ(1u, ports.size());
    EXPECT_EQ("10.20.30.40", str(checked_cast<VESPERA_LANEndpoint>(ports.all[0])->SystemName.value));
}

TEST_F(HostTest, HostKnownByNameOnly)
{
    // Resolving to loopback only, or not at all: the plain host name.
    for (Played kind : { LOOPBACK_ONLY, UNRESOLVED })
    {
        play(kind, "blade7", { "127.0.0.1", "127.0.1.1" });
        Log log;
        Walk w(common()->getComputerSystemInstances(ID_VESPERA_ComputerSystem));
        VESPERA_ComputerSystem* cs = host(w);
        ASSERT_TRUE(cs);
        EXPECT_EQ("blade7", str(cs->Name.value));
        EXPECT_EQ("Other", str(cs->NameFormat.value));
        EXPECT_EQ(std::vector<std::string>{"blade7"}, strs(cs->OtherIdentifyingInfo));
        EXPECT_EQ(std::vector<std::string>{"Fully Qualified Domain Name"},
            strs(cs->IdentifyingDescriptions));
        EXPECT_EQ(0u, log.count("WARN", ""));
    }

    // Without a name at all the host still has its instance.
    play(NAMELESS, "");
    Log log;
    Walk w(common()->getComputerSystemInstances(ID_VESPERA_ComputerSystem));
    VESPERA_ComputerSystem* cs = host(w);
    ASSERT_TRUE(cs);
    EXPECT_EQ("localhost", str(cs->Name.value));
    EXPECT_EQ("Other", str(cs->NameFormat.value));
    EXPECT_EQ(std::vector<std::string>{"Fully Qualified Domain Name"},
        strs(cs->IdentifyingDescriptions));
    EXPECT_EQ(1u, log.count("WARN", "No host IP / Name  retrived in the function, So function "
        "fills localhost for host info."));
}

TEST_F(HostTest, LongHostName)
{
    // The longest name Linux allows. The host keeps it whole; the Ethernet
    // records have room for one character less, and say so.
    std::string name(64, 'h');
    play(LOOPBACK_ONLY, name, { "127.0.0.1" });

    Walk w(common()->getComputerSystemInstances(ID_VESPERA_ComputerSystem));
    VESPERA_ComputerSystem* cs = host(w);
    ASSERT_TRUE(cs);
    EXPECT_EQ(name, str(cs->Name.value));

    Log log;
    Walk ports(EthernetPortHelper::getEthernetPortHelperObject()->getInstancesByClass(
        ID_VESPERA_EthernetPort));
    ASSERT_EQ(1u, ports.size());
    EXPECT_EQ(name.substr(0, 63),
        str(checked_cast<VESPERA_EthernetPort>(ports.all[0])->SystemName.value));
    EXPECT_EQ(1u, log.count("WARN", "is longer than 63 characters"));
}

TEST_F(HostTest, AccessPointWhileTheAgentRuns)
{
    play(WITH_ADDRESS, "blade7", { "192.168.7.9" });

    {
        Log log;
        Walk none(access()->getInstancesByClass(ID_VESPERA_RemoteServiceAccessPoint));
        EXPECT_EQ(0u, none.size());
        EXPECT_EQ(1u, log.count("WARN", "The ZARK Agent is not running so no service available"));
        EXPECT_EQ(0u, log.count("ERR", ""));
    }

    Agent agent;
    ASSERT_EQ(34568u, ProviderUtil::getProviderUtil()->getAgentPort());

    Log log;
    Walk w(access()->getInstancesByClass(ID_VESPERA_RemoteServiceAccessPoint));
    ASSERT_EQ(1u, w.size());
    VESPERA_RemoteServiceAccessPoint* ap =
        checked_cast<VESPERA_RemoteServiceAccessPoint>(w.all[0]);
    ASSERT_TRUE(ap);
    EXPECT_EQ("VESPERA_ComputerSystem", str(ap->SystemCreationClassName.value));
    EXPECT_EQ("VESPERA_RemoteServiceAccessPoint", str(ap->CreationClassName.value));
    EXPECT_EQ("192.168.7.9", str(ap->SystemName.value));
    EXPECT_EQ("ZARK Service", str(ap->Name.value));
    EXPECT_EQ("Zark Manager Service Access Point", str(ap->ElementName.value));
    EXPECT_EQ("https://192.168.7.9:34568/index.html", str(ap->AccessInfo.value));
    EXPECT_EQ(200, ap->InfoFormat.value);
    EXPECT_EQ(1u, log.count("INFO", "Number of instances: 1"));

    // A host known by name only is reached by that name.
    play(UNRESOLVED, "blade7");
    Walk named(access()->getInstancesByClass(ID_VESPERA_RemoteServiceAccessPoint));
    ASSERT_EQ(1u, named.size());
    EXPECT_EQ("https://blade7:34568/index.html",
        str(checked_cast<VESPERA_RemoteServiceAccessPoint>(named.all[0])->AccessInfo.value));

    // "localhost" would send a client to itself: no access point.
    play(NAMELESS, "");
    Log local;
    Walk noName(access()->getInstancesByClass(ID_VESPERA_RemoteServiceAccessPoint));
    EXPECT_EQ(0u, noName.size());
    EXPECT_EQ(1u, local.count("WARN", "getHostInfo returned localhost"));

    // A record whose host name fills its field without a terminator.
    _adapterData data;
    memset(&data, 'h', sizeof(data));
    VESPERA_RemoteServiceAccessPoint* full = access()->getRemoteServiceAccessPointInstance(data);
    ASSERT_TRUE(full);
    EXPECT_EQ(std::string(sizeof(data.hostName), 'h'), str(full->SystemName.value));
    EXPECT_EQ("https://" + std::string(sizeof(data.hostName), 'h') + ":34568/index.html",
        str(full->AccessInfo.value));
    destroy(full);
}
