// The Ethernet ports, LAN endpoints, host and access point as a WBEM client
// sees them: the built module run by the `cimhost` command on the simulated
// adapter library, one process per request, on the default host and on host
// descriptions written here.

#include <gtest/gtest.h>
#include <json/json.h>

#include <signal.h>
#include <stdio.h>
#include <stdlib.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

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

// HOME of the module's log and of the host descriptions; removed at exit.
const std::string& dir()
{
    struct Dir
    {
        std::string path;
        Dir()
        {
            char name[] = "/tmp/vspr-ethcim-XXXXXX";
            path = mkdtemp(name) ? name : "/tmp";
            std::ofstream(path + "/.tesselrc") << "LOG_LEVEL=DBG\n";
        }
        ~Dir()
        {
            std::error_code ec;
            std::filesystem::remove_all(path, ec);
        }
    };
    static Dir d;
    return d.path;
}

std::string logText()
{
    return readFile(dir() + "/.tessel/messages");
}

size_t countLines(const std::string& text, const std::string& level,
    const std::string& piece)
{
    std::istringstream in(text);
    std::string line;
    size_t n = 0;
    while (std::getline(in, line))
        n += line.find(level + ": ") != std::string::npos &&
            line.find(piece) != std::string::npos;
    return n;
}

std::string quote(const std::string& s)
{
    std::string q = "'";
    for (char c : s)
        q += c == '\'' ? std::string("'\\''") : std::string(1, c);
    return q + "'";
}

struct Reply
{
    Json::Value doc;
    std::string log;       // what the module logged for this request

    const Json::Value& instances() const { return doc["instances"]; }
    std::string rc() const { return doc["rc_name"].asString(); }
};

// One request of the cimhost command, on the host description at hostPath
// (empty: the simulator's default host).
Reply cimhost(const std::string& verb, const std::string& arg,
    const std::string& hostPath = "")
{
    size_t start = logText().size();
    std::string cmd = "HOME=" + quote(dir()) + " LD_LIBRARY_PATH=" + quote(DTRUJ_DIR) +
        (hostPath.empty() ? std::string(" DTRUJ_HOST= ") : " DTRUJ_HOST=" + quote(hostPath) + " ") +
        quote(CIMHOST) + " --json " + verb + " " + quote(arg) + " 2>/dev/null";

    std::string out;
    if (FILE* pipe = popen(cmd.c_str(), "r"))
    {
        char buf[4096];
        size_t n;
        while ((n = fread(buf, 1, sizeof(buf), pipe)) > 0)
            out.append(buf, n);
        pclose(pipe);
    }

    Reply r;
    Json::Reader reader;
    EXPECT_TRUE(reader.parse(out, r.doc)) << cmd << "\n" << out;
    std::string all = logText();
    r.log = all.size() > start ? all.substr(start) : std::string();
    return r;
}

Reply ei(const std::string& cls, const std::string& hostPath = "")
{
    return cimhost("ei", "root/vespera:" + cls, hostPath);
}

// name -> value of an instance's properties.
std::map<std::string, Json::Value> props(const Json::Value& instance)
{
    std::map<std::string, Json::Value> m;
    for (const Json::Value& p : instance["properties"])
        m[p["name"].asString()] = p["null"].asBool() ? Json::Value() : p["value"];
    return m;
}

Json::Value list(std::initializer_list<Json::Value> items)
{
    Json::Value a(Json::arrayValue);
    for (const Json::Value& v : items)
        a.append(v);
    return a;
}

std::string writeHost(const std::string& name, const std::string& text)
{
    std::string path = dir() + "/" + name;
    std::ofstream(path.c_str(), std::ios::trunc) << text;
    return path;
}

// A process named zarkagent while the object lives.
class Agent
{
public:
    Agent()
    {
        std::string link = dir() + "/zarkagent";
        std::error_code ec;
        std::filesystem::remove(link, ec);
        std::filesystem::create_symlink("/bin/sleep", link, ec);
        _pid = fork();
        if (_pid == 0)
        {
            execl(link.c_str(), "zarkagent", "60", (char*)0);
            _exit(127);
        }
        usleep(100000);
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

class EthernetCim : public ::testing::Test
{
protected:
    void SetUp() override
    {
        ASSERT_TRUE(std::filesystem::exists(CIMHOST)) << "build the cimhost target";
        ASSERT_TRUE(std::filesystem::exists(MODULE)) << "build the module";
    }
};

// The host's name as the module gives it.
std::string hostName()
{
    Reply r = ei("VESPERA_ComputerSystem");
    EXPECT_EQ(1u, r.instances().size());
    return r.instances().size() ? props(r.instances()[0])["Name"].asString() : "";
}

} // namespace

TEST_F(EthernetCim, DefaultHost)
{
    std::string host = hostName();
    ASSERT_FALSE(host.empty());

    Reply ports = ei("VESPERA_EthernetPort");
    ASSERT_EQ("CMPI_RC_OK", ports.rc());
    ASSERT_EQ(1u, ports.instances().size());
    auto p = props(ports.instances()[0]);
    EXPECT_EQ("VESPERA_EthernetPort", p["CreationClassName"].asString());
    EXPECT_EQ("VESPERA_ComputerSystem", p["SystemCreationClassName"].asString());
    EXPECT_EQ(host, p["SystemName"].asString());
    EXPECT_EQ("00051e8b2002", p["DeviceID"].asString());
    EXPECT_EQ("00051e8b2002", p["PermanentAddress"].asString());
    EXPECT_EQ(list({"00051e8b2002"}), p["NetworkAddresses"]);
    EXPECT_EQ("eth2", p["ElementName"].asString());
    EXPECT_EQ(2, p["LinkTechnology"].asInt());
    EXPECT_EQ(list({0}), p["Capabilities"]);
    EXPECT_EQ(list({0}), p["EnabledCapabilities"]);
    EXPECT_EQ(list({11}), p["OperationalStatus"]);
    EXPECT_EQ(105, p["PortType"].asInt());
    EXPECT_EQ(0, p["PortNumber"].asInt());
    EXPECT_EQ(0u, countLines(ports.log, "ERR", ""));

    Reply ends = ei("VESPERA_LANEndpoint");
    ASSERT_EQ(1u, ends.instances().size());
    auto e = props(ends.instances()[0]);
    EXPECT_EQ("VESPERA_LANEndpoint", e["CreationClassName"].asString());
    EXPECT_EQ("VESPERA_ComputerSystem", e["SystemCreationClassName"].asString());
    EXPECT_EQ(host, e["SystemName"].asString());
    for (const char* name : { "Name", "ElementName", "Description", "LANID" })
        EXPECT_EQ("eth2", e[name].asString()) << name;
    EXPECT_EQ("eth2_ETHERNET", e["NameFormat"].asString());
    EXPECT_EQ(1, e["ProtocolIFType"].asInt());
    EXPECT_EQ("00051e8b2002", e["MACAddress"].asString());
    EXPECT_EQ(72000u, e["MaxDataSize"].asUInt());
    EXPECT_EQ(5, e["HealthState"].asInt());
    EXPECT_EQ(2, e["EnabledState"].asInt());

    // Both are found again by their paths.
    for (const Reply* r : { &ports, &ends })
    {
        Reply again = cimhost("gi", r->instances()[0]["path"].asString());
        ASSERT_EQ("CMPI_RC_OK", again.rc());
        EXPECT_EQ(r->instances()[0], again.instances()[0]);
    }

    // A port that isn't there.
    Reply gone = cimhost("gi", "root/vespera:VESPERA_EthernetPort.SystemCreationClassName="
        "\"VESPERA_ComputerSystem\",SystemName=\"" + host + "\",CreationClassName="
        "\"VESPERA_EthernetPort\",DeviceID=\"00051e8b20ff\"");
    EXPECT_EQ("CMPI_RC_ERR_NOT_FOUND", gone.rc());
}

TEST_F(EthernetCim, HostWithFcHbasOnly)
{
    std::string path = writeHost("fc-only.json", R"({ "adapters": [
      { "hbaData": { "wwn": "20:00:00:05:1e:01:00:00" },
        "fcPorts": [ { "wwn": "10:00:00:05:1e:01:00:01" } ] },
      { "hbaData": { "wwn": "20:00:00:05:1e:02:00:00" },
        "fcPorts": [ { "wwn": "10:00:00:05:1e:02:00:01" } ] } ] })");

    // No instances and success either way; only the log tells the classes
    // apart, and no helper line is an error.
    Reply ports = ei("VESPERA_EthernetPort", path);
    EXPECT_EQ("CMPI_RC_OK", ports.rc());
    EXPECT_EQ(0u, ports.instances().size());
    EXPECT_EQ(2u, countLines(ports.log, "INFO", "No Ethernet ports found for Adapter - "));
    EXPECT_EQ(1u, countLines(ports.log, "ERR", "Error: Invalid mapping information"));
    EXPECT_EQ(1u, countLines(ports.log, "ERR", ""));

    Reply ends = ei("VESPERA_LANEndpoint", path);
    EXPECT_EQ("CMPI_RC_OK", ends.rc());
    EXPECT_EQ(0u, ends.instances().size());
    EXPECT_EQ(1u, countLines(ends.log, "WARN", "No Ethernet Port Found"));
    EXPECT_EQ(0u, countLines(ends.log, "ERR", ""));

    // The host is there all the same.
    Reply cs = ei("VESPERA_ComputerSystem", path);
    EXPECT_EQ(1u, cs.instances().size());
}

TEST_F(EthernetCim, FaultsOfAHostDescription)
{
    // One port of the first CNA fails its details once, another has no
    // optics, one has texts of the wrong type and one an over-long name;
    // the second CNA's optics throw.
    std::string path = writeHost("faults.json", std::string(R"({
      "faults": { "getEthPortByEthMac": { "kind": "std", "message": "lost", "count": 1 },
                  "getLldp": "null" },
      "adapters": [
      { "hbaData": { "wwn": "20:00:00:05:1e:02:00:00", "hbaMAC": "00:05:1e:02:00:00" },
        "ethPorts": [
          { "mac": "00:05:1e:02:00:01", "ethDev": "eth10", "sfp": { "transceiver": "10G_BASE-LR" } },
          { "mac": "00:05:1e:02:00:02", "ethDev": "eth11", "ethPortStateMOFValue": 7 },
          { "mac": "00:05:1e:02:00:03", "ethDev": ["eth12"], "ethPortStateMOFValue": "11",
            "mtu": "9000", "sfp": { "transceiver": "10G_BASE-LRM" } },
          { "mac": "00:05:1e:02:00:04", "ethDev": ")") + std::string(3000, 'n') + R"(",
            "portStatus": false, "mtu": 2000 } ] },
      { "hbaData": { "wwn": "20:00:00:05:1e:03:00:00", "hbaMAC": "00:05:1e:03:00:00" },
        "ethPorts": [ { "mac": "00:05:1e:03:00:01", "ethDev": "eth20", "linkUp": false,
                        "sfp": { "transceiver": "10G_BASE-SR" } } ] } ] })");

    Reply ports = ei("VESPERA_EthernetPort", path);
    ASSERT_EQ("CMPI_RC_OK", ports.rc());
    std::map<std::string, std::map<std::string, Json::Value> > p;
    for (const Json::Value& i : ports.instances())
        p[props(i)["DeviceID"].asString()] = props(i);

    ASSERT_EQ(4u, p.size()) << ports.log;
    EXPECT_EQ(0u, p.count("00051e020001"));
    EXPECT_EQ(1u, countLines(ports.log, "ERR",
        "00:05:1e:02:00:01 - libGetEthPortByEthMac got std exception: lost"));
    EXPECT_EQ(1u, countLines(ports.log, "ERR", "Unable to get Eth port data for 00:05:1e:02:00:01"));

    EXPECT_EQ(1, p["00051e020002"]["PortNumber"].asInt());
    EXPECT_EQ(0, p["00051e020002"]["PortType"].asInt());
    EXPECT_EQ(1u, countLines(ports.log, "ERR", "Unable to get SFP info for 00:05:1e:02:00:02"));
    EXPECT_EQ(list({7}), p["00051e020002"]["OperationalStatus"]);

    EXPECT_EQ("", p["00051e020003"]["ElementName"].asString());
    EXPECT_EQ(list({0}), p["00051e020003"]["OperationalStatus"]);
    EXPECT_EQ(108, p["00051e020003"]["PortType"].asInt());

    EXPECT_EQ(std::string(1027, 'n'), p["00051e020004"]["ElementName"].asString());
    EXPECT_EQ(list({10}), p["00051e020004"]["OperationalStatus"]);

    EXPECT_EQ(list({13}), p["00051e030001"]["OperationalStatus"]);
    EXPECT_EQ(0, p["00051e030001"]["PortNumber"].asInt());
    EXPECT_EQ(105, p["00051e030001"]["PortType"].asInt());

    Reply ends = ei("VESPERA_LANEndpoint", path);
    std::map<std::string, std::map<std::string, Json::Value> > e;
    for (const Json::Value& i : ends.instances())
        e[props(i)["MACAddress"].asString()] = props(i);

    // Each request is a new process, so the first port fails again; the one
    // without a device name has no endpoint.
    ASSERT_EQ(3u, e.size()) << ends.log;
    EXPECT_EQ(0u, e.count("00051e020001"));
    EXPECT_EQ(0u, e.count("00051e020003"));
    EXPECT_EQ(1u, countLines(ends.log, "ERR", "No LAN endpoint for 00:05:1e:02:00:03"));
    EXPECT_EQ(0, e["00051e020002"]["HealthState"].asInt());
    EXPECT_EQ(1, e["00051e020002"]["EnabledState"].asInt());
    EXPECT_EQ(std::string(1027, 'n') + "_ETHERNET", e["00051e020004"]["NameFormat"].asString());
    EXPECT_EQ(16000u, e["00051e020004"]["MaxDataSize"].asUInt());
    EXPECT_EQ(10, e["00051e020004"]["HealthState"].asInt());
    EXPECT_EQ(3, e["00051e020004"]["EnabledState"].asInt());
    EXPECT_EQ(10, e["00051e030001"]["HealthState"].asInt());
    EXPECT_EQ(6, e["00051e030001"]["EnabledState"].asInt());

    // Optics that throw leave the port, with no port type.
    std::string thrown = writeHost("optics.json", R"({
      "faults": { "getOpticsSFP": { "kind": "hba", "code": 6, "message": "no optics" } },
      "adapters": [ { "hbaData": { "wwn": "20:00:00:05:1e:03:00:00", "hbaMAC": "00:05:1e:03:00:00" },
        "ethPorts": [ { "mac": "00:05:1e:03:00:01", "sfp": { "transceiver": "10G_BASE-SR" } } ] } ] })");
    Reply optics = ei("VESPERA_EthernetPort", thrown);
    ASSERT_EQ(1u, optics.instances().size());
    EXPECT_EQ(0, props(optics.instances()[0])["PortType"].asInt());
    EXPECT_EQ(1u, countLines(optics.log, "ERR",
        "00:05:1e:03:00:01 - libGetOpticsSFP got User exception 6: no optics"));
}

TEST_F(EthernetCim, AccessPointFollowsTheAgent)
{
    std::string host = hostName();
    if (host == "localhost")
        GTEST_SKIP() << "this machine has no name to offer a client";

    Agent agent;
    Reply r = ei("VESPERA_RemoteServiceAccessPoint");
    ASSERT_EQ("CMPI_RC_OK", r.rc());
    ASSERT_EQ(1u, r.instances().size());
    auto a = props(r.instances()[0]);
    EXPECT_EQ("VESPERA_ComputerSystem", a["SystemCreationClassName"].asString());
    EXPECT_EQ("VESPERA_RemoteServiceAccessPoint", a["CreationClassName"].asString());
    EXPECT_EQ(host, a["SystemName"].asString());
    EXPECT_EQ("ZARK Service", a["Name"].asString());
    EXPECT_EQ("Zark Manager Service Access Point", a["ElementName"].asString());
    EXPECT_EQ("https://" + host + ":34568/index.html", a["AccessInfo"].asString());
    EXPECT_EQ(200, a["InfoFormat"].asInt());

    Reply again = cimhost("gi", r.instances()[0]["path"].asString());
    ASSERT_EQ("CMPI_RC_OK", again.rc());
    EXPECT_EQ(r.instances()[0], again.instances()[0]);
}
