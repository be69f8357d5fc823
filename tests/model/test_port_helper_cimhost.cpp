// The FC port and target classes as a WBEM client sees them: the built
// module in the stand-in server, one `cimhost --json` run per request, each
// on a host description of its own. Expected values are computed from the
// description itself, so the test follows the default host when it grows.

#include "test_port_helper.h"

#include <stdio.h>
#include <sys/stat.h>
#include <sys/wait.h>

#include <algorithm>
#include <set>

using namespace port_test;

namespace
{

std::string cimhostPath()
{
    return std::string(VSPR_BUILD_DIR) + "/platform/cimhost/cimhost";
}

std::string modulePath()
{
    return std::string(VSPR_BUILD_DIR) + "/libvsprprovider_Module.so";
}

bool exists(const std::string& path)
{
    struct stat st;
    return stat(path.c_str(), &st) == 0;
}

struct Run
{
    int status;
    Json::Value out;
};

// Runs cimhost with the given arguments on a host description (empty: the
// default host) and reads its JSON answer.
Run cimhost(const std::string& args, const std::string& hostFile = "")
{
    std::string command = "HOME='" + workDir() + "' LD_LIBRARY_PATH='" + DTRUJ_DIR + "'";
    command += hostFile.empty() ? " DTRUJ_HOST=" : " DTRUJ_HOST='" + hostFile + "'";
    command += " '" + cimhostPath() + "' --module '" + modulePath() + "' --json " + args;
    command += " 2>/dev/null";

    Run run;
    std::string text;
    FILE* pipe = popen(command.c_str(), "r");

    if (pipe)
    {
        char buffer[4096];
        size_t n;
        while ((n = fread(buffer, 1, sizeof(buffer), pipe)) > 0)
            text.append(buffer, n);
        run.status = pclose(pipe);
    }
    else
        run.status = -1;

    Json::Reader().parse(text, run.out, false);
    return run;
}

// One instance's properties by name.
typedef std::map<std::string, Json::Value> Props;

std::vector<Props> enumerate(const std::string& cls, const std::string& hostFile = "")
{
    Run run = cimhost("ei root/vespera:" + cls, hostFile);
    EXPECT_EQ(0, run.status) << cls;

    std::vector<Props> result;
    for (const Json::Value& i : run.out["instances"])
    {
        Props p;
        for (const Json::Value& prop : i["properties"])
            p[prop["name"].asString()] = prop["null"].asBool() ? Json::Value() : prop["value"];
        p["__path"] = i["path"];
        result.push_back(p);
    }
    return result;
}

std::string plain(const Json::Value& colon)
{
    std::string s = colon.asString(), out;
    for (char c : s)
        if (c != ':')
            out += c;
    return out;
}

Json::Value u64(unsigned long long x)
{
    return Json::Value((Json::UInt64)x);
}

Json::Value list(const Json::Value& x)
{
    Json::Value a(Json::arrayValue);
    a.append(x);
    return a;
}

std::string writeHost(const std::string& name, const std::string& json)
{
    std::string path = workDir() + "/" + name;
    std::ofstream(path.c_str(), std::ios::trunc) << json;
    return path;
}

class PortStandIn : public ::testing::Test
{
protected:
    void SetUp() override
    {
        if (!exists(cimhostPath()) || !exists(modulePath()))
            GTEST_SKIP() << "needs the cimhost command and the built module";

        host = parse(readFile(std::string(DTRUJ_HOSTS_DIR) + "/default.json"));
    }

    // Every FC port of the description, in walk order, with its adapter.
    struct Port
    {
        Json::Value adapter;
        Json::Value port;
        unsigned place;
    };

    std::vector<Port> ports() const
    {
        std::vector<Port> v;
        for (const Json::Value& a : host["adapters"])
            for (Json::ArrayIndex i = 0; i < a["fcPorts"].size(); i++)
                v.push_back(Port{a, a["fcPorts"][i], i});
        return v;
    }

    Json::Value host;
};

} // namespace

TEST_F(PortStandIn, FCPortsAndGroupsOfTheDefaultHost)
{
    std::vector<Props> got = enumerate("VESPERA_FCPort");
    std::vector<Props> groups = enumerate("VESPERA_LogicalPortGroup");
    std::vector<Port> want = ports();
    std::vector<std::string> nodes;
    ASSERT_EQ(want.size(), got.size());

    for (size_t i = 0; i < want.size(); i++)
    {
        const Json::Value& p = want[i].port;
        std::string wwn = plain(p["wwn"]);
        std::string node = plain(p.get("nodeWwn", want[i].adapter["hbaData"]["wwn"]));
        Props& f = got[i];

        EXPECT_EQ(wwn, f["DeviceID"].asString());
        EXPECT_EQ(wwn, f["PermanentAddress"].asString());
        EXPECT_EQ(node + ":" + wwn, f["Name"].asString());
        EXPECT_EQ(node + ":" + wwn, f["ElementName"].asString());
        EXPECT_EQ(p["PortSymbolicName"].asString(), f["Caption"].asString());
        EXPECT_EQ("VESPERA_FCPort", f["CreationClassName"].asString());
        EXPECT_EQ("VESPERA_ComputerSystem", f["SystemCreationClassName"].asString());
        EXPECT_EQ(hostString(), f["SystemName"].asString());
        EXPECT_EQ(u64(p["operatingSpeed"].asUInt64() * 1000000000ULL), f["Speed"]) << wwn;
        EXPECT_EQ(u64(p["supportedPortSpeeds"][0u].asUInt64() * 1000000000ULL), f["MaxSpeed"]);
        EXPECT_EQ(want[i].place, f["PortNumber"].asUInt());
        EXPECT_EQ(list(p.get("portStatusValue", 11)), f["OperationalStatus"]);
        EXPECT_EQ(2u, f["EnabledState"].asUInt());
        EXPECT_EQ(2u, f["EnabledDefault"].asUInt());
        EXPECT_EQ(3u, f["UsageRestriction"].asUInt());
        EXPECT_EQ(4u, f["LinkTechnology"].asUInt());
        EXPECT_EQ(p.get("portTypeMOFValue", 10).asUInt(), f["PortType"].asUInt());
        EXPECT_EQ(p.get("maxFrameSize", 2112).asUInt64(),
            f["SupportedMaximumTransmissionUnit"].asUInt64());

        if (std::find(nodes.begin(), nodes.end(), node) == nodes.end())
            nodes.push_back(node);
    }

    // One group a node, in the order the ports show them.
    ASSERT_EQ(nodes.size(), groups.size());
    for (size_t i = 0; i < nodes.size(); i++)
    {
        Props& g = groups[i];
        EXPECT_EQ(nodes[i], g["InstanceID"].asString());
        EXPECT_EQ(nodes[i], g["Name"].asString());
        EXPECT_EQ(nodes[i], g["ElementName"].asString());
        EXPECT_EQ("WWN", g["NameFormat"].asString());
        EXPECT_EQ(hostString(), g["Caption"].asString());
        EXPECT_EQ(hostString(), g["Description"].asString());
    }
}

TEST_F(PortStandIn, EndpointsBeaconsAndStatisticsOfTheDefaultHost)
{
    std::vector<Props> endpoints = enumerate("VESPERA_SCSIProtocolEndpoint");
    std::vector<Props> alarms = enumerate("VESPERA_AlarmDevice");
    std::vector<Props> stats = enumerate("VESPERA_FCPortStatistics");

    size_t e = 0, a = 0;
    std::vector<Port> want = ports();
    ASSERT_EQ(want.size(), stats.size());

    for (size_t i = 0; i < want.size(); i++)
    {
        const Json::Value& p = want[i].port;
        std::string wwn = plain(p["wwn"]);

        ASSERT_LT(e, endpoints.size());
        EXPECT_EQ(wwn, endpoints[e]["Name"].asString());
        EXPECT_EQ(2u, endpoints[e++]["Role"].asUInt());

        for (const Json::Value& r : p["remotePorts"])
        {
            if (!r["deviceData"]["isTarget"].asBool())
                continue;
            ASSERT_LT(e, endpoints.size());
            EXPECT_EQ(wwn + "_" + plain(r["remotePortWwn"]), endpoints[e]["Name"].asString());
            EXPECT_EQ(endpoints[e]["Name"], endpoints[e]["ElementName"]);
            EXPECT_EQ(3u, endpoints[e]["Role"].asUInt());
            EXPECT_EQ(list(r["deviceData"]["stateMofValue"]), endpoints[e++]["OperationalStatus"]);
        }

        if (!want[i].adapter["hbaData"].get("isMezz", false).asBool())
        {
            ASSERT_LT(a, alarms.size());
            EXPECT_EQ(wwn, alarms[a]["DeviceID"].asString());
            EXPECT_EQ(p.get("beaconState", false).asBool() ? 3u : 1u,
                alarms[a++]["AlarmState"].asUInt());
        }

        EXPECT_EQ(wwn, stats[i]["InstanceID"].asString());
        EXPECT_EQ("FC Port Statistics", stats[i]["ElementName"].asString());

        // FCoE ports have no LIPs; FC ports count them from the last reset.
        if (p.get("isFCoE", false).asBool())
        {
            EXPECT_EQ(0u, stats[i]["LIPCount"].asUInt64());
        }
        EXPECT_FALSE(stats[i]["CRCErrors"].isNull());
    }

    EXPECT_EQ(e, endpoints.size());
    EXPECT_EQ(a, alarms.size());
}

TEST_F(PortStandIn, TargetsOfTheDefaultHost)
{
    std::vector<Props> extents = enumerate("VESPERA_StorageExtent");
    std::vector<Props> disks = enumerate("VESPERA_LogicalDisk");
    std::vector<Props> tapes = enumerate("VESPERA_TapeDrive");

    size_t x = 0, t = 0;

    for (const Port& port : ports())
    {
        for (const Json::Value& r : port.port["remotePorts"])
        {
            const Json::Value& d = r["deviceData"];
            if (!d["isTarget"].asBool())
                continue;

            std::string type = d["type"].asString();
            bool tape = type == "Tape" || type == "Media Changer";

            for (const Json::Value& u : r["lunList"])
            {
                std::string product = u["productID"].asString();
                product.erase(product.find_last_not_of(' ') + 1);
                std::string id = plain(port.port["wwn"]) + "_" + plain(r["remotePortWwn"]) + "_" +
                    u["vendor"].asString() + "_" + product + "_LUN_" +
                    std::to_string(u["number"].asUInt());

                Props& got = tape ? tapes.at(t++) : extents.at(x);
                EXPECT_EQ(id, got["DeviceID"].asString());
                EXPECT_EQ(list(Json::Value(id)), got["OtherIdentifyingInfo"]);
                EXPECT_EQ("LUN_" + std::to_string(u["number"].asUInt()),
                    got["ElementName"].asString());
                EXPECT_EQ(list(2), got["OperationalStatus"]);

                if (!tape)
                {
                    Props& disk = disks.at(x++);
                    EXPECT_EQ(id, disk["DeviceID"].asString());
                    EXPECT_EQ(u["lunDescription"], disk["Name"]);
                    EXPECT_EQ(u["lunDescription"], got["Name"]);
                }
            }
        }
    }

    EXPECT_EQ(x, extents.size());
    EXPECT_EQ(x, disks.size());
    EXPECT_EQ(t, tapes.size());
    EXPECT_GT(t, 0u);
}

TEST_F(PortStandIn, AFaultyHostShowsWhatCanBeRead)
{
    // The first port's reply is an error; the second has members of the
    // wrong type; the third has texts far longer than their fields; the
    // fourth has no light, the fifth no supported speed a client could
    // mistake for one; both name the first adapter's node in capitals.
    std::string longText(3000, 'x');
    std::string path = writeHost("faulty.json", R"({
      "faults": { "getPortByWwn": { "kind": "error", "count": 1 } },
      "adapters": [
        { "hbaData": { "wwn": "20:00:00:00:c9:dd:00:00", "isMezz": false },
          "fcPorts": [
            { "wwn": "10:00:00:00:c9:dd:00:01" },
            { "wwn": "10:00:00:00:c9:dd:00:02",
              "unchecked": { "PortSymbolicName": 17, "operatingSpeed": "fast",
                             "supportedPortSpeeds": "16", "portTypeMOFValue": "x",
                             "beaconState": "on" } },
            { "wwn": "10:00:00:00:c9:dd:00:03", "PortSymbolicName": ")" + longText + R"(",
              "nodeWwn": ")" + longText + R"(", "operatingSpeed": 16,
              "supportedPortSpeeds": [16] } ] },
        { "hbaData": { "wwn": "20:00:00:00:c9:ee:00:00" },
          "fcPorts": [ { "wwn": "10:00:00:00:c9:ee:00:01", "operatingSpeed": 99999,
                         "supportedPortSpeeds": [32, 16], "nodeWwn": "20:00:00:00:C9:DD:00:00" },
                       { "wwn": "10:00:00:00:c9:ee:00:02", "operatingSpeed": 99999,
                         "supportedPortSpeeds": [99999], "nodeWwn": "20:00:00:00:C9:DD:00:00" } ] } ] })");

    Log log;
    std::vector<Props> got = enumerate("VESPERA_FCPort", path);
    ASSERT_EQ(4u, got.size());

    EXPECT_EQ("10000000c9dd0002", got[0]["DeviceID"].asString());
    EXPECT_EQ("", got[0]["Caption"].asString());
    EXPECT_EQ(0u, got[0]["Speed"].asUInt64());
    EXPECT_EQ(0u, got[0]["MaxSpeed"].asUInt64());
    EXPECT_EQ(0u, got[0]["PortType"].asUInt());

    EXPECT_EQ(1027u, got[1]["Caption"].asString().size());
    EXPECT_EQ(std::string(23, 'x') + ":10000000c9dd0003", got[1]["Name"].asString());
    EXPECT_EQ(u64(16000000000ULL), got[1]["Speed"]);

    EXPECT_EQ("10000000c9ee0001", got[2]["DeviceID"].asString());
    EXPECT_EQ(0u, got[2]["Speed"].asUInt64());
    EXPECT_EQ(u64(32000000000ULL), got[2]["MaxSpeed"]);
    EXPECT_EQ(0u, got[3]["Speed"].asUInt64());
    EXPECT_EQ(u64(99999000000000ULL), got[3]["MaxSpeed"]);

    std::string text = log.text();
    EXPECT_EQ(1u, log.count("ERR", "libGetPortByWwn response is null or has error")) << text;
    EXPECT_GE(log.count("WARN", "PortSymbolicName is longer than 1027 characters"), 1u);

    // The cut node and the first adapter's, once for three ports.
    std::vector<Props> groups = enumerate("VESPERA_LogicalPortGroup", path);
    ASSERT_EQ(2u, groups.size());
    EXPECT_EQ("20000000c9dd0000", groups[0]["InstanceID"].asString());
    EXPECT_EQ(std::string(23, 'x'), groups[1]["InstanceID"].asString());
}
