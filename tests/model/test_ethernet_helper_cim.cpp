// Ethernet ports, LAN endpoints and the agent's access point as a WBEM client
// sees them: the built module run by the cimhost command on the simulated
// library, one process per request, on the default host and on host
// descriptions written here.

#include <stdio.h>

#include <map>

#include "test_ethernet_helper.h"

using namespace eth_test;

namespace
{

const std::string CIMHOST = std::string(VSPR_BUILD_DIR) + "/platform/cimhost/cimhost";

std::string quote(const std::string& s)
{
    std::string q = "'";
    for (char c : s)
        q += c == '\'' ? std::string("'\\''") : std::string(1, c);
    return q + "'";
}

typedef std::map<std::string, Json::Value> Props;

struct Reply
{
    Json::Value doc;
    std::string log;
    std::vector<Props> instances;   // name -> value, null for a null property
};

// One cimhost request on the host description at host ("": the default).
Reply cimhost(const std::string& verb, const std::string& arg, const std::string& host = "")
{
    Log log;
    std::string cmd = "HOME=" + quote(workDir(false)) + " LD_LIBRARY_PATH=" + quote(DTRUJ_DIR) +
        " DTRUJ_HOST=" + quote(host) + " " + quote(CIMHOST) + " --json " + verb + " " +
        quote(arg) + " 2>/dev/null";
    std::string out;
    if (FILE* pipe = popen(cmd.c_str(), "r"))
    {
        char buf[4096];
        for (size_t n; (n = fread(buf, 1, sizeof(buf), pipe)) > 0; )
            out.append(buf, n);
        pclose(pipe);
    }

    Reply r;
    EXPECT_TRUE(Json::Reader().parse(out, r.doc)) << cmd << "\n" << out;
    r.log = log.text();
    for (const Json::Value& i : r.doc["instances"])
    {
        Props p;
        for (const Json::Value& x : i["properties"])
            p[x["name"].asString()] = x["null"].asBool() ? Json::Value() : x["value"];
        r.instances.push_back(p);
    }
    return r;
}

Reply ei(const std::string& cls, const std::string& host = "")
{
    return cimhost("ei", "root/vespera:" + cls, host);
}

// Instances by the value of one property.
std::map<std::string, Props> by(const Reply& r, const char* key)
{
    std::map<std::string, Props> m;
    for (const Props& p : r.instances)
        m[p.at(key).asString()] = p;
    return m;
}

Json::Value list(std::initializer_list<Json::Value> items)
{
    Json::Value a(Json::arrayValue);
    for (const Json::Value& v : items)
        a.append(v);
    return a;
}

class EthernetCim : public ::testing::Test
{
protected:
    void SetUp() override
    {
        workDir(false);
        ASSERT_TRUE(std::filesystem::exists(CIMHOST)) << "build cimhost and the module first";
    }
};

} // namespace

TEST_F(EthernetCim, DefaultHost)
{
    Reply cs = ei("VESPERA_ComputerSystem");
    ASSERT_EQ(1u, cs.instances.size());
    std::string host = cs.instances[0]["Name"].asString();

    Reply ports = ei("VESPERA_EthernetPort");
    ASSERT_EQ(1u, ports.instances.size());
    Props p = ports.instances[0];
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
    EXPECT_EQ(0u, count(ports.log, "ERR", ""));

    Reply ends = ei("VESPERA_LANEndpoint");
    ASSERT_EQ(1u, ends.instances.size());
    Props e = ends.instances[0];
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
}

TEST_F(EthernetCim, HostWithFcHbasOnly)
{
    std::string host = writeHost("fc-only.json", R"({ "adapters": [
      { "hbaData": { "wwn": "20:00:00:05:1e:01:00:00" }, "fcPorts": [ { "wwn": "10:00:00:05:1e:01:00:01" } ] },
      { "hbaData": { "wwn": "20:00:00:05:1e:02:00:00" }, "fcPorts": [ { "wwn": "10:00:00:05:1e:02:00:01" } ] } ] })");

    // Success without instances; the helper's lines are no errors, and only
    // the providers' empty messages differ.
    Reply ports = ei("VESPERA_EthernetPort", host);
    EXPECT_EQ(0, ports.doc["rc"].asInt());
    EXPECT_EQ(0u, ports.instances.size());
    EXPECT_EQ(2u, count(ports.log, "INFO", "No Ethernet ports found for Adapter - "));
    EXPECT_EQ(1u, count(ports.log, "ERR", ""));
    EXPECT_EQ(1u, count(ports.log, "ERR", "Error: Invalid mapping information"));

    Reply ends = ei("VESPERA_LANEndpoint", host);
    EXPECT_EQ(0, ends.doc["rc"].asInt());
    EXPECT_EQ(0u, ends.instances.size());
    EXPECT_EQ(0u, count(ends.log, "ERR", ""));
    EXPECT_EQ(1u, count(ends.log, "WARN", "No Ethernet Port Found"));
}

TEST_F(EthernetCim, FaultsOfAHostDescription)
{
    // In each process the first port's details throw, and so do the optics
    // of the next; one port has texts of the wrong type, one an over-long
    // name; the second CNA's port has no link.
    std::string host = writeHost("faults.json", std::string(R"({
      "faults": { "getEthPortByEthMac": { "kind": "std", "message": "lost", "count": 1 },
                  "getOpticsSFP": { "kind": "hba", "code": 6, "message": "no optics", "count": 1 } },
      "adapters": [
      { "hbaData": { "wwn": "20:00:00:05:1e:02:00:00", "hbaMAC": "00:05:1e:02:00:00" },
        "ethPorts": [
          { "mac": "00:05:1e:02:00:01", "ethDev": "eth10" },
          { "mac": "00:05:1e:02:00:02", "ethDev": "eth11", "ethPortStateMOFValue": 7,
            "unchecked": { "mtu": null }, "sfp": { "transceiver": "10G_BASE-SR" } },
          { "mac": "00:05:1e:02:00:03",
            "unchecked": { "ethDev": ["eth12"], "ethPortStateMOFValue": "11" },
            "sfp": { "transceiver": "10G_BASE-LR" } },
          { "mac": "00:05:1e:02:00:04", "portStatus": false, "mtu": 2000, "ethDev": ")") +
        std::string(3000, 'n') + R"(" } ] },
      { "hbaData": { "wwn": "20:00:00:05:1e:03:00:00", "hbaMAC": "00:05:1e:03:00:00" },
        "ethPorts": [ { "mac": "00:05:1e:03:00:01", "ethDev": "eth20", "linkUp": false,
                        "sfp": { "transceiver": "10G_BASE-SR" } } ] } ] })");

    Reply ports = ei("VESPERA_EthernetPort", host);
    std::map<std::string, Props> p = by(ports, "DeviceID");
    ASSERT_EQ(4u, p.size()) << ports.log;
    EXPECT_EQ(1u, count(ports.log, "ERR", "00:05:1e:02:00:01 - libGetEthPortByEthMac got std exception: lost"));
    EXPECT_EQ(1u, count(ports.log, "ERR", "Unable to get Eth port data for 00:05:1e:02:00:01"));

    EXPECT_EQ(1, p["00051e020002"]["PortNumber"].asInt());
    EXPECT_EQ(0, p["00051e020002"]["PortType"].asInt());
    EXPECT_EQ(1u, count(ports.log, "ERR", "00:05:1e:02:00:02 - libGetOpticsSFP got User exception 6: no optics"));
    EXPECT_EQ(1u, count(ports.log, "ERR", "Unable to get SFP info for 00:05:1e:02:00:02"));
    EXPECT_EQ(list({7}), p["00051e020002"]["OperationalStatus"]);
    EXPECT_EQ("", p["00051e020003"]["ElementName"].asString());
    EXPECT_EQ(list({0}), p["00051e020003"]["OperationalStatus"]);
    EXPECT_EQ(108, p["00051e020003"]["PortType"].asInt());
    EXPECT_EQ(std::string(1027, 'n'), p["00051e020004"]["ElementName"].asString());
    EXPECT_EQ(list({10}), p["00051e020004"]["OperationalStatus"]);
    EXPECT_EQ(0, p["00051e030001"]["PortNumber"].asInt());
    EXPECT_EQ(105, p["00051e030001"]["PortType"].asInt());

    // The port without a device name is an endpoint all the same, named by
    // the empty name.
    Reply ends = ei("VESPERA_LANEndpoint", host);
    std::map<std::string, Props> e = by(ends, "MACAddress");
    ASSERT_EQ(4u, e.size()) << ends.log;
    EXPECT_EQ("", e["00051e020003"]["Name"].asString());
    EXPECT_EQ("", e["00051e020003"]["ElementName"].asString());
    EXPECT_EQ(1u, count(ends.log, "WARN", "No Ethernet device name for 00051e020003"));
    EXPECT_EQ(0u, e["00051e020002"]["MaxDataSize"].asUInt());
    EXPECT_EQ(0, e["00051e020002"]["HealthState"].asInt());
    EXPECT_EQ(1, e["00051e020002"]["EnabledState"].asInt());
    EXPECT_EQ(std::string(1027, 'n') + "_ETHERNET", e["00051e020004"]["NameFormat"].asString());
    EXPECT_EQ(16000u, e["00051e020004"]["MaxDataSize"].asUInt());
    EXPECT_EQ(10, e["00051e020004"]["HealthState"].asInt());
    EXPECT_EQ(3, e["00051e020004"]["EnabledState"].asInt());
    EXPECT_EQ(10, e["00051e030001"]["HealthState"].asInt());
    EXPECT_EQ(6, e["00051e030001"]["EnabledState"].asInt());

    // Each is found again by its path.
    for (const Reply* r : { &ports, &ends })
        for (const Json::Value& i : r->doc["instances"])
        {
            Reply again = cimhost("gi", i["path"].asString(), host);
            ASSERT_EQ(1u, again.doc["instances"].size()) << i["path"];
            EXPECT_EQ(i, again.doc["instances"][0]);
        }
}

TEST_F(EthernetCim, AccessPointFollowsTheAgentWithAgentRunning)
{
    std::string host = ei("VESPERA_ComputerSystem").instances.at(0)["Name"].asString();
    if (host == "localhost")
        GTEST_SKIP() << "this machine has no name to offer a client";

    Agent agent;
    Reply r = ei("VESPERA_RemoteServiceAccessPoint");
    ASSERT_EQ(1u, r.instances.size()) << r.log;
    Props a = r.instances[0];
    EXPECT_EQ("VESPERA_ComputerSystem", a["SystemCreationClassName"].asString());
    EXPECT_EQ("VESPERA_RemoteServiceAccessPoint", a["CreationClassName"].asString());
    EXPECT_EQ(host, a["SystemName"].asString());
    EXPECT_EQ("ZARK Service", a["Name"].asString());
    EXPECT_EQ("Zark Manager Service Access Point", a["ElementName"].asString());
    EXPECT_EQ("https://" + host + ":34568/index.html", a["AccessInfo"].asString());
    EXPECT_EQ(200, a["InfoFormat"].asInt());
}
