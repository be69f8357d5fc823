// The inventory's instance providers as a WBEM client sees them: the built
// module in the stand-in CIM server, on the simulated adapter library.

#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <map>
#include <set>
#include <thread>

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

// Classes whose instances carry the host in SystemName.
const char* const systemClasses[] = {
    "VESPERA_PortController", "VESPERA_FCPort", "VESPERA_SCSIProtocolEndpoint",
    "VESPERA_StorageExtent", "VESPERA_TapeDrive", "VESPERA_EthernetPort",
    "VESPERA_LANEndpoint", "VESPERA_AlarmDevice", "VESPERA_LogicalDisk",
};

bool agentRunning()
{
    FILE* pipe = popen("ps -e | grep zarkagent$", "r");
    if (!pipe)
        return false;
    char line[128];
    bool found = fgets(line, sizeof(line), pipe) != 0;
    pclose(pipe);
    return found;
}

// A process named zarkagent, for as long as the object lives: a copy of
// sleep under that name.
class FakeAgent
{
public:
    FakeAgent() : _pid(-1)
    {
        std::string exe = workDir() + "/zarkagent";
        std::error_code ec;
        std::filesystem::copy_file("/bin/sleep", exe,
            std::filesystem::copy_options::overwrite_existing, ec);
        if (ec)
            return;
        _pid = fork();
        if (_pid == 0)
        {
            execl(exe.c_str(), "zarkagent", "60", (char*)0);
            _exit(127);
        }
        for (int i = 0; i < 100 && !agentRunning(); i++)
            std::this_thread::sleep_for(std::chrono::milliseconds(20));
    }

    ~FakeAgent()
    {
        if (_pid > 0)
        {
            kill(_pid, SIGTERM);
            waitpid(_pid, 0, 0);
        }
    }

    bool ok() const { return _pid > 0 && agentRunning(); }

private:
    pid_t _pid;
};

// Everything but the counters, which grow between two calls.
void expectSameInstance(const ch::Instance& got, const ch::Instance& want)
{
    EXPECT_TRUE(ch::path_equal(got.path, want.path)) << got.path.to_string();
    bool statistics = want.class_name == "VESPERA_FCPortStatistics";

    for (const ch::Property& p : want.properties)
    {
        const ch::Value* v = got.get(p.name);
        ASSERT_TRUE(v != 0) << want.path.to_string() << ": no " << p.name;
        if (statistics && p.value.type != CMPI_string && p.value.type != CMPI_dateTime)
            continue;
        if (statistics && p.value.type == CMPI_dateTime)
            continue;
        EXPECT_TRUE(*v == p.value) << want.path.to_string() << "." << p.name << ": "
            << v->text() << " != " << p.value.text();
    }
    EXPECT_EQ(want.properties.size(), got.properties.size()) << want.path.to_string();
}

class Providers : public ProvidersTest
{
};

} // namespace

// Each class answers on the default host, with instances of its own class
// and keys that tell them apart, all on the one host the model names.
TEST_F(Providers, EveryClassAnswersOnTheDefaultHost)
{
    std::vector<ch::Instance> system = served("VESPERA_ComputerSystem");
    ASSERT_EQ(1u, system.size());
    std::string hostName = text(system[0], "Name");
    EXPECT_FALSE(hostName.empty());

    for (const char* cls : inventoryClasses)
    {
        std::vector<ch::Instance> instances = served(cls);
        if (std::string(cls) != "VESPERA_RemoteServiceAccessPoint")
        {
            EXPECT_FALSE(instances.empty()) << cls;
        }

        std::set<std::string> paths;
        for (const ch::Instance& i : instances)
        {
            EXPECT_EQ(cls, i.class_name);
            EXPECT_TRUE(paths.insert(i.path.to_string()).second)
                << "two instances with the path " << i.path.to_string();
        }
    }

    for (const char* cls : systemClasses)
    {
        for (const ch::Instance& i : served(cls))
        {
            EXPECT_EQ(hostName, text(i, "SystemName")) << i.path.to_string();
            EXPECT_EQ("VESPERA_ComputerSystem", text(i, "SystemCreationClassName"));
        }
    }

    // The default host: an FC HBA with two ports, a CNA with one FC and one
    // Ethernet port.
    EXPECT_EQ(2u, served("VESPERA_PortController").size());
    EXPECT_EQ(3u, served("VESPERA_FCPort").size());
    EXPECT_EQ(3u, served("VESPERA_AlarmDevice").size());
    EXPECT_EQ(3u, served("VESPERA_FCPortStatistics").size());
    EXPECT_EQ(1u, served("VESPERA_EthernetPort").size());
    EXPECT_EQ(1u, served("VESPERA_LANEndpoint").size());
}

// A client that lists names and then gets each one sees what the
// enumeration shows.
TEST_F(Providers, GetOfEveryEnumeratedPathGivesTheSameInstanceWithAgentRunning)
{
    FakeAgent agent;   // so that the access point has a path to get too

    for (const char* cls : inventoryClasses)
    {
        ch::Result names = ein(cls);
        ASSERT_EQ(CMPI_RC_OK, names.rc) << cls;
        std::vector<ch::Instance> instances = served(cls);
        ASSERT_EQ(instances.size(), names.paths.size()) << cls;

        for (const ch::Object_Path& path : names.paths)
        {
            // The first of equal paths is the one a get finds.
            const ch::Instance* want = 0;
            for (const ch::Instance& i : instances)
                if (!want && ch::path_equal(i.path, path))
                    want = &i;
            ASSERT_TRUE(want != 0) << "ein gave a path that ei didn't: " << path.to_string();

            ch::Result got = host->gi(path);
            ASSERT_EQ(CMPI_RC_OK, got.rc) << path.to_string() << ": " << got.message;
            ASSERT_EQ(1u, got.instances.size()) << path.to_string();
            expectSameInstance(got.instances[0], *want);
        }
    }
}

// A port that was there at the last enumeration but is gone now is not
// found, by any class built from it; the ports that are left still are.
TEST_F(Providers, GetOfAVanishedPortIsNotFound)
{
    Json::Value desc = defaultHost();
    useHost(desc);

    const char* portClasses[] = {
        "VESPERA_FCPort", "VESPERA_AlarmDevice", "VESPERA_FCPortStatistics",
    };
    std::map<std::string, std::vector<ch::Object_Path>> before;
    for (const char* cls : portClasses)
    {
        before[cls] = ein(cls).paths;
        ASSERT_EQ(3u, before[cls].size()) << cls;
    }

    // The second port of the first adapter goes.
    std::string gone = desc["adapters"][0]["fcPorts"][1]["wwn"].asString();
    Json::Value ports(Json::arrayValue);
    ports.append(desc["adapters"][0]["fcPorts"][0]);
    desc["adapters"][0]["fcPorts"] = ports;
    useHost(desc);

    std::string plain;
    for (char c : gone)
        if (c != ':')
            plain += c;

    for (const char* cls : portClasses)
    {
        size_t missing = 0;
        for (const ch::Object_Path& path : before[cls])
        {
            ch::Result r = host->gi(path);
            bool ofGone = path.to_string().find(plain) != std::string::npos;
            if (ofGone)
            {
                missing++;
                EXPECT_EQ(CMPI_RC_ERR_NOT_FOUND, r.rc)
                    << path.to_string() << ": " << ch::rc_name(r.rc);
            }
            else
            {
                EXPECT_EQ(CMPI_RC_OK, r.rc) << path.to_string() << ": " << r.message;
            }
        }
        EXPECT_EQ(1u, missing) << cls << " had no path naming " << plain;
    }
}

// The beacon of a port, switched through the method and seen by the
// library and in the next enumeration.
TEST_F(Providers, SetAlarmStateSwitchesTheBeacon)
{
    ch::Result names = ein("VESPERA_AlarmDevice");
    ASSERT_FALSE(names.paths.empty());
    const ch::Object_Path& alarm = names.paths[0];
    std::string wwn = alarm.key("DeviceID")->str;

    auto beacon = [&]() {
        Json::Value dump = simDump();
        for (const Json::Value& a : dump["adapters"])
            for (const Json::Value& p : a["fcPorts"])
            {
                std::string w;
                for (char c : p["wwn"].asString())
                    if (c != ':')
                        w += c;
                if (w == wwn)
                    return p["beaconState"].asBool();
            }
        ADD_FAILURE() << "no port " << wwn << " in the simulator";
        return false;
    };
    auto alarmState = [&]() {
        ch::Result r = host->gi(alarm);
        EXPECT_EQ(CMPI_RC_OK, r.rc);
        return r.instances.empty() ? std::string() : text(r.instances[0], "AlarmState");
    };

    ASSERT_FALSE(beacon());
    EXPECT_EQ("1", alarmState());

    struct Step { uint64_t state; uint32_t returned; bool beaconAfter; };
    const Step steps[] = {
        { 3, 0, true },    // on
        { 3, 2, true },    // already on
        { 2, 2, true },    // no such state for a beacon: nothing asked
        { 0, 2, true },
        { 1, 0, false },   // off
        { 1, 2, false },   // already off
    };

    for (const Step& s : steps)
    {
        ch::Result r = setAlarm(alarm, s.state);
        ASSERT_EQ(CMPI_RC_OK, r.rc) << "state " << s.state << ": " << r.message;
        EXPECT_EQ(s.returned, r.return_value.num.uint32) << "state " << s.state;
        EXPECT_EQ(s.beaconAfter, beacon()) << "state " << s.state;
        EXPECT_EQ(s.beaconAfter ? "3" : "1", alarmState()) << "state " << s.state;
    }

    // A state the beacon can't take is refused before the library is asked.
    ASSERT_EQ(0, dtruj_sim_set_fault("getPortByWwn", "hba"));
    LogMark mark;
    ch::Result r = setAlarm(alarm, 2);
    ASSERT_EQ(CMPI_RC_OK, r.rc) << r.message;
    EXPECT_EQ(2u, r.return_value.num.uint32);
    EXPECT_EQ(1u, countLines(mark.text(), {"ERR: ", "Error: Invalid Input State"}));
    EXPECT_EQ(0u, countLines(mark.text(), {"libGetPortByWwn"})) << mark.text();

    // A port that can't be read fails the call, but not the request.
    r = setAlarm(alarm, 3);
    ASSERT_EQ(CMPI_RC_OK, r.rc) << r.message;
    EXPECT_EQ(2u, r.return_value.num.uint32);
    EXPECT_FALSE(beacon());
}

// A mezzanine card has no beacon, so no alarm device; a client that asks
// anyway learns that it can't be done, and a port that can't be read fails.
TEST_F(Providers, SetAlarmStateOnAMezzanineCardOrAMissingPort)
{
    useHostFile(std::string(DTRUJ_HOSTS_DIR) + "/mezzanine.json");

    EXPECT_TRUE(served("VESPERA_AlarmDevice").empty());
    std::vector<ch::Instance> ports = served("VESPERA_FCPort");
    ASSERT_FALSE(ports.empty());

    ch::Object_Path alarm = classPath("VESPERA_AlarmDevice");
    alarm.keys = ports[0].path.keys;
    for (ch::Property& k : alarm.keys)
        if (k.name == "CreationClassName")
            k.value = ch::Value::of_string("VESPERA_AlarmDevice");

    ch::Result r = setAlarm(alarm, 3);
    ASSERT_EQ(CMPI_RC_OK, r.rc) << r.message;
    EXPECT_EQ(1u, r.return_value.num.uint32);

    for (ch::Property& k : alarm.keys)
        if (k.name == "DeviceID")
            k.value = ch::Value::of_string("10000000c9ffffff");
    r = setAlarm(alarm, 3);
    ASSERT_EQ(CMPI_RC_OK, r.rc) << r.message;
    EXPECT_EQ(2u, r.return_value.num.uint32);
}

// The host is always exactly one; the access point is there only while the
// console agent runs, and its absence is no error.
TEST_F(Providers, HostAndAccessPointCountsWithAgentRunning)
{
    useHostFile(std::string(DTRUJ_HOSTS_DIR) + "/no-adapter.json");
    EXPECT_EQ(1u, served("VESPERA_ComputerSystem").size());

    if (!agentRunning())
    {
        LogMark mark;
        EXPECT_TRUE(served("VESPERA_RemoteServiceAccessPoint").empty());
        EXPECT_EQ(1u, countLines(mark.text(), {"WARN", "Warning: No service is available"}));
    }

    FakeAgent agent;
    ASSERT_TRUE(agent.ok());
    std::vector<ch::Instance> sap = served("VESPERA_RemoteServiceAccessPoint");
    ASSERT_EQ(1u, sap.size());
    std::string hostName = text(served("VESPERA_ComputerSystem")[0], "Name");
    EXPECT_EQ("https://" + hostName + ":34568/index.html", text(sap[0], "AccessInfo"));
    EXPECT_EQ(hostName, text(sap[0], "SystemName"));
}

// No adapter is no failure: each class answers with nothing, and only the
// log tells the classes apart.
TEST_F(Providers, AHostWithoutAdaptersAnswersEmpty)
{
    useHostFile(std::string(DTRUJ_HOSTS_DIR) + "/no-adapter.json");

    struct Empty { const char* cls; const char* level; const char* message; };
    const Empty cases[] = {
        { "VESPERA_PortController", "ERR", "No Adapter Found!" },
        { "VESPERA_FCPort", "ERR", "No FC Ports Found!" },
        { "VESPERA_StorageExtent", "ERR", "No StorageExtents Found!" },
        { "VESPERA_TapeDrive", "ERR", "No TapeDrives Found!" },
        { "VESPERA_LogicalDisk", "ERR", "No LogicalDisks Found!" },
        { "VESPERA_EthernetPort", "ERR", "Error: Invalid mapping information" },
        { "VESPERA_LANEndpoint", "WARN", "No Ethernet Port Found" },
        { "VESPERA_LogicalPortGroup", "WARN", "No Logical Port Groups found!" },
        { "VESPERA_AlarmDevice", "ERR", "Invalid number of Instances returned" },
    };

    for (const Empty& c : cases)
    {
        LogMark mark;
        EXPECT_TRUE(served(c.cls).empty()) << c.cls;
        EXPECT_EQ(1u, countLines(mark.text(), {std::string(c.level) + ": ", c.message}))
            << c.cls << "\n" << mark.text();
    }
}

// Only the Ethernet classes differ between an FC-only host and no host: the
// enumeration of LAN endpoints warns where the Ethernet ports' one errs.
TEST_F(Providers, AnFCOnlyHostHasNoEthernetClasses)
{
    Json::Value desc = defaultHost();
    Json::Value fcOnly(Json::arrayValue);
    fcOnly.append(desc["adapters"][0]);
    desc["adapters"] = fcOnly;
    useHost(desc);

    EXPECT_EQ(2u, served("VESPERA_FCPort").size());

    LogMark eth;
    EXPECT_TRUE(served("VESPERA_EthernetPort").empty());
    EXPECT_EQ(1u, countLines(eth.text(), {"ERR: ", "Error: Invalid mapping information"}));

    LogMark lan;
    EXPECT_TRUE(served("VESPERA_LANEndpoint").empty());
    EXPECT_EQ(1u, countLines(lan.text(), {"WARN: ", "No Ethernet Port Found"}));
}

// A client that asks for one property still gets instances it can name: a
// server that builds the paths from the key properties left on the instance
// (SFCB) must find them all there.
TEST_F(Providers, APropertyListKeepsTheKeysOfEveryPath)
{
    const std::vector<std::string> speed = { "Speed" };

    for (const char* cls : { "VESPERA_FCPort", "VESPERA_ComputerSystem", "VESPERA_LogicalDisk" })
    {
        ch::Result names = ein(cls);
        ASSERT_EQ(CMPI_RC_OK, names.rc) << cls;
        ch::Result some = host->ei(classPath(cls), &speed);
        ASSERT_EQ(CMPI_RC_OK, some.rc) << cls;
        ASSERT_EQ(names.paths.size(), some.instances.size()) << cls;

        for (size_t i = 0; i < some.instances.size(); i++)
        {
            EXPECT_TRUE(ch::path_equal(names.paths[i], some.instances[i].path))
                << some.instances[i].path.to_string();

            ch::Result one = host->gi(names.paths[i], &speed);
            ASSERT_EQ(CMPI_RC_OK, one.rc) << names.paths[i].to_string();
            ASSERT_EQ(1u, one.instances.size());
            EXPECT_TRUE(ch::path_equal(names.paths[i], one.instances[0].path))
                << one.instances[0].path.to_string();
        }
    }
}
