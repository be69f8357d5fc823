// Host descriptions: the shipped examples, generated hosts, and descriptions
// that can't be used.
#include "Lib.h"

#include <cstdlib>
#include <fstream>
#include <map>
#include <set>

using namespace dtrujtest;

namespace {

// The source tree, from where this file lies in it.
std::string sourceDir()
{
    std::string f = __FILE__;
    return f.substr(0, f.rfind("/tests/dtruj/"));
}

class DtrujHost : public ::testing::Test {
protected:
    Lib lib;
    void TearDown() override { unsetenv("DTRUJ_HOST"); }

    Json::Value initWith(const std::string& path)
    {
        setenv("DTRUJ_HOST", path.c_str(), 1);
        lib.sym<int (*)()>("dtruj_sim_reset")();
        return lib.call("init_hba_lib", obj({{"appId", 2}}));
    }
    Json::Value initWithText(const std::string& text)
    {
        std::string path = testing::TempDir() + "dtruj_host_test.json";
        std::ofstream(path) << text;
        return initWith(path);
    }
};

TEST_F(DtrujHost, ShippedDefaultIsTheBuiltInHost)
{
    unsetenv("DTRUJ_HOST");
    lib.reset();
    Json::Value builtin = lib.call("getGlobalInfo");
    ASSERT_EQ(0, initWith(sourceDir() + "/platform/dtruj/hosts/default.json")["result"].asInt());
    EXPECT_EQ(builtin, lib.call("getGlobalInfo"));
}

TEST_F(DtrujHost, MezzanineCard)
{
    ASSERT_EQ(0, initWith(sourceDir() + "/platform/dtruj/hosts/mezzanine.json")["result"].asInt());
    const char* port = "10:00:00:05:1e:9c:30:01";
    Json::Value p = lib.call("getPortByWwn", obj({{"wwn", port}}));
    EXPECT_TRUE(p["isMezz"].asBool());
    EXPECT_TRUE(isError(lib.call("setPortByWwn", obj({{"indexStr", port}, {"port", obj({{"beaconState", true}})},
                                                      {"propArray", strArray({"beaconState"})}}))));
    // A port without light reports no speed and lost communication.
    p = lib.call("getPortByWwn", obj({{"wwn", "10:00:00:05:1e:9c:30:02"}}));
    EXPECT_EQ(99999, p["operatingSpeed"].asInt());
    EXPECT_EQ(13, p["portStatusValue"].asInt());
    Json::Value h = lib.call("getHbaByWwn", obj({{"wwn", "20:00:00:05:1e:9c:30:00"}}))["hbaData"];
    EXPECT_EQ("DELL", h["oem"].asString());
    EXPECT_FALSE(h.isMember("fruNum"));
    // A refused flash keeps the old version and says why.
    std::string image = testing::TempDir() + "dtruj_mezz.img";
    std::ofstream(image) << "version=9.9\n";
    Json::Value r = lib.call("adapterUpdateFlash", obj({{"indexStr", "20:00:00:05:1e:9c:30:00"}, {"file", image}}));
    EXPECT_EQ(1, r["status"].asInt());
    EXPECT_EQ("3.2.0.2", lib.call("getFlashInfo", obj({{"indexStr", "20:00:00:05:1e:9c:30:00"}}))["firmwareVersion"].asString());
}

TEST_F(DtrujHost, NoAdapter)
{
    ASSERT_EQ(0, initWith(sourceDir() + "/platform/dtruj/hosts/no-adapter.json")["result"].asInt());
    EXPECT_EQ(0u, lib.sym<OLMA::voidRetUIntFP>("getNumberOfAdapters")());
    EXPECT_EQ(0u, lib.call("getAllAdaptersIndexString")["indexStrings"].size());
    EXPECT_EQ(0, lib.call("getGlobalInfo")["numOfAdapters"].asInt());
}

TEST_F(DtrujHost, GeneratedHostHasTheAskedShape)
{
    std::string path = testing::TempDir() + "dtruj_gen_host.json";
    std::string cmd = "python3 " + sourceDir() + "/tools/gen_host.py --adapters 5 --ports 3 --rports 6 --luns 7 -o " + path;
    ASSERT_EQ(0, system(cmd.c_str()));
    ASSERT_EQ(0, initWith(path)["result"].asInt());
    Json::Value idx = lib.call("getAllAdaptersIndexString")["indexStrings"];
    ASSERT_EQ(5u, idx.size());
    size_t ports = 0, luns = 0, tapes = 0;
    for (const Json::Value& a : idx) {
        Json::Value pl = lib.call("getFcPhyPortIndicesByAdapter", obj({{"indexStr", a}}))["indexStrings"];
        ports += pl.size();
        for (const Json::Value& p : pl) {
            Json::Value rps = lib.call("getAllRemotePorts", obj({{"pPortWwn", p}, {"lPortWwn", p}}));
            ASSERT_EQ(6u, rps.size());
            for (const Json::Value& r : rps) {
                Json::Value c = lib.call("getCompleteRemotePort", obj({{"pPortWwn", p}, {"lPortWwn", p},
                                                                       {"rPortWwn", r["remotePortWwn"]}}));
                if (c["deviceData"]["type"].asString() == "Tape")
                    ++tapes;
                else
                    luns += c["lunList"].size();
            }
        }
    }
    EXPECT_EQ(15u, ports);
    EXPECT_EQ(15u, tapes);              // one remote port in four
    EXPECT_EQ(15u * 5 * 7, luns);
    // Index strings are unique across the host.
    Json::Value g = lib.call("getGlobalInfo");
    std::set<std::string> wwns;
    for (const Json::Value& a : g["adapter"])
        for (const Json::Value& w : a["portWwn"])
            if (!w.asString().empty()) {
                EXPECT_TRUE(wwns.insert(w.asString()).second) << w.asString();
            }
    remove(path.c_str());
}

TEST_F(DtrujHost, UnusableDescriptionsFailInitialisation)
{
    const std::string one = R"({ "adapters": [ { "hbaData": { "wwn": "20:00:00:00:00:00:00:01" }, )";
    struct { std::string text; const char* message; } cases[] = {
        {"{ \"adapters\": [ ", "Syntax error"},
        {"[1, 2]", "the host description is not a JSON object"},
        {"{ \"adapters\": {} }", "adapters: expected an array"},
        {"{ \"adapters\": [ { \"hbaData\": { \"model\": \"x\" } } ] }",
         "adapters[0].hbaData: has neither \"wwn\" nor \"hbaMAC\""},
        {"{ \"adapters\": [ { } ] }", "adapters[0]: has no object \"hbaData\""},
        {one + R"("fcPorts": [ {} ] } ] })", "adapters[0].fcPorts[0]: has no \"wwn\""},
        // Members of the wrong type, named by their path.
        {one + R"("ethPorts": [ { "mac": "00:00:00:00:00:01" },
                                { "mac": "00:00:00:00:00:02", "mtu": "9000" } ] } ] })",
         "adapters[0].ethPorts[1].mtu: expected a number"},
        {one + R"("ethPorts": [ { "mac": "00:00:00:00:00:01", "mtu": 1500.5 } ] } ] })",
         "adapters[0].ethPorts[0].mtu: expected a whole number"},
        {one + R"("fcPorts": [ { "wwn": "10:00:00:00:00:00:00:01", "supportedPortSpeeds": [16, "8"] } ] } ] })",
         "adapters[0].fcPorts[0].supportedPortSpeeds[1]: expected a number"},
        {one + R"("fcPorts": [ { "wwn": "10:00:00:00:00:00:00:01", "beaconState": null } ] } ] })",
         "adapters[0].fcPorts[0].beaconState: expected a boolean"},
        {one + R"("fcPorts": [ { "wwn": "10:00:00:00:00:00:00:01", "remotePorts": [
                   { "remotePortWwn": "50:00:00:00:00:00:00:01", "lunList": [ { "vendor": 7 } ] } ] } ] } ] })",
         "adapters[0].fcPorts[0].remotePorts[0].lunList[0].vendor: expected a string"},
        {one + R"("fcPorts": [ { "wwn": 1 } ] } ] })", "adapters[0].fcPorts[0].wwn: expected a string"},
        {R"({ "adapters": [ { "hbaData": { "wwn": "20:00:00:00:00:00:00:01", "isMezz": "no" } } ] })",
         "adapters[0].hbaData.isMezz: expected a boolean"},
        {R"({ "diagnostics": { "posted": { "QuickTest": { "durationMs": "fast" } } } })",
         "diagnostics.posted.QuickTest.durationMs: expected a number"},
        {R"({ "faults": { "getHost": 7 } })", "faults.getHost: expected a string or an object"},
        {one + R"("unchecked": 5 } ] })", "adapters[0].unchecked: expected an object"},
    };
    for (auto& c : cases) {
        Json::Value r = initWithText(c.text);
        EXPECT_NE(0, r["result"].asInt()) << c.text;
        const std::string m = r["message"].asString();
        EXPECT_NE(std::string::npos, m.find(c.message)) << m;
        // Until a good description comes, every JSON entry answers an error.
        EXPECT_TRUE(isError(lib.call("getHost")));
        EXPECT_TRUE(isError(lib.call("getAllAdaptersIndexString")));
    }
    EXPECT_NE(0, initWith("/nonexistent/dtruj.json")["result"].asInt());
    // A description may refuse initialisation on purpose.
    EXPECT_EQ(4, initWithText("{ \"host\": { \"initResult\": 4 } }")["result"].asInt());
}

// Every member of a reply, at any depth, has a value: a member the
// description left out is absent, never null.
void expectNoNull(const Json::Value& v, const std::string& where)
{
    if (v.isObject()) {
        for (const std::string& m : v.getMemberNames()) {
            EXPECT_FALSE(v[m].isNull()) << where << "." << m;
            expectNoNull(v[m], where + "." + m);
        }
    } else if (v.isArray()) {
        for (Json::ArrayIndex i = 0; i < v.size(); ++i)
            expectNoNull(v[i], where + "[" + std::to_string(i) + "]");
    }
}

void expectMembers(const Json::Value& v, std::initializer_list<const char*> present,
                   std::initializer_list<const char*> absent, const char* what)
{
    for (const char* m : present)
        EXPECT_TRUE(v.isMember(m)) << what << " lacks " << m;
    for (const char* m : absent)
        EXPECT_FALSE(v.isMember(m)) << what << " has " << m;
}

TEST_F(DtrujHost, ALeftOutMemberIsLeftOutOfTheReplies)
{
    // A CNA without a node WWN; an FC HBA; ports and remote ports that say
    // nothing but their addresses.
    const char* const cna = "00:00:00:00:00:01";
    const char* const fcoe = "10:00:00:00:00:00:00:01";
    const char* const hba = "20:00:00:00:00:00:00:10";
    const char* const fc = "10:00:00:00:00:00:00:11";
    const char* const eth = "00:00:00:00:00:02";
    const char* const vport = "2f:00:00:00:00:00:00:01";
    const char* const bare = "50:00:00:00:00:00:00:01";
    const char* const empty = "50:00:00:00:00:00:00:02";
    ASSERT_EQ(0, initWithText(R"({ "adapters": [
        { "hbaData": { "hbaMAC": "00:00:00:00:00:01" },
          "fcPorts": [ { "wwn": "10:00:00:00:00:00:00:01", "isFCoE": true,
                         "remotePorts": [ { "remotePortWwn": "50:00:00:00:00:00:00:01" },
                                          { "remotePortWwn": "50:00:00:00:00:00:00:02",
                                            "deviceData": {}, "lunList": [ {} ] } ],
                         "vports": [ { "vwwn": "2f:00:00:00:00:00:00:01" } ] } ],
          "ethPorts": [ { "mac": "00:00:00:00:00:02" } ] },
        { "hbaData": { "wwn": "20:00:00:00:00:00:00:10" },
          "fcPorts": [ { "wwn": "10:00:00:00:00:00:00:11" } ] } ] })")["result"].asInt());
    auto dump = lib.sym<char* (*)()>("dtruj_sim_dump");
    char* before = dump();

    Json::Value pp = obj({{"pPortWwn", fcoe}, {"lPortWwn", fcoe}});
    Json::Value bareReq = pp, emptyReq = pp;
    bareReq["rPortWwn"] = bare;
    emptyReq["rPortWwn"] = empty;
    std::vector<std::pair<const char*, Json::Value>> calls = {
        {"getHbaByMac", obj({{"mac", cna}})},
        {"getHbaByWwn", obj({{"wwn", hba}})},
        {"getPortByWwn", obj({{"wwn", fcoe}})},
        {"getPortByWwn", obj({{"wwn", fc}})},
        {"getEthPortByEthMac", obj({{"mac", eth}})},
        {"getAllRemotePorts", pp},
        {"getCompleteRemotePort", bareReq},
        {"getCompleteRemotePort", emptyReq},
        {"getAllLunsByRemotePort", bareReq},
        {"getVPort", obj({{"pPortWwn", fcoe}, {"lPortWwn", vport}})},
        {"getAllVPorts", obj({{"wwn", fcoe}})},
        {"getFlashInfo", obj({{"indexStr", cna}})},
        {"getAdvAdapterData", obj({{"indexStr", cna}})},
        {"getFcByFcWwn", obj({{"wwn", fcoe}})},
        {"getFcoeByPort", obj({{"indexStr", fcoe}})},
        {"getAdvPortDataByPort", obj({{"indexStr", fc}})},
        {"getBootOverSanByPort", obj({{"indexStr", fc}})},
        {"getPortAuthentication", obj({{"wwn", fc}})},
        {"getGlobalInfo", Json::Value()},
        {"getHost", Json::Value()},
        {"getDynamicPortStatistics", obj({{"indexStr", fcoe}})},
        {"getDPortTestResult", obj({{"portWwn", fc}})},
        {"diagMemoryTest", obj({{"hbaWwn", hba}})},
    };
    std::map<std::string, Json::Value> got;
    for (auto& c : calls) {
        Json::Value r = lib.call(c.first, c.second);
        expectNoNull(r, c.first);
        got[std::string(c.first) + Json::FastWriter().write(c.second)] = r;
    }

    Json::Value h = lib.call("getHbaByMac", obj({{"mac", cna}}));
    expectMembers(h["hbaData"], {"hbaMAC", "hbaStatus", "mode", "portCount", "numOfFcPorts", "numOfEthPorts",
                                 "isCNA", "hasEthPort", "adapterId", "indexStr", "manufacturer"},
                  {"wwn", "model", "serialNumber", "oem", "fruNum", "partNum", "oemSerialNum", "uuid",
                   "isMezz", "alias", "pciLocation"}, "hbaData");
    EXPECT_EQ(Json::Value(Json::objectValue), h["driver"]);
    EXPECT_EQ(Json::Value(Json::objectValue), h["firmware"]);

    Json::Value p = lib.call("getPortByWwn", obj({{"wwn", fcoe}}));
    expectMembers(p, {"wwn", "isFCoE", "portStatusValue", "portStatus", "hbaIndexStr", "trunkingEnabled",
                      "numOfVports", "numOfRemotePorts"},
                  {"nodeWwn", "PortSymbolicName", "operatingSpeed", "supportedPortSpeeds", "portTypeMOFValue",
                   "maxFrameSize", "beaconState", "isMezz", "alias", "fcoeMac"}, "FCoE port");
    // A port's node is its adapter's.
    EXPECT_EQ(hba, lib.call("getPortByWwn", obj({{"wwn", fc}}))["nodeWwn"].asString());

    Json::Value e = lib.call("getEthPortByEthMac", obj({{"mac", eth}}))["ethData"];
    expectMembers(e, {"mac", "ethPortStateMOFValue", "portStatus", "hbaIndexStr", "numOfvNICs"},
                  {"ethDev", "mtu", "alias", "operatingSpeed", "isMezz"}, "ethData");

    Json::Value rps = lib.call("getAllRemotePorts", pp);
    ASSERT_EQ(2u, rps.size());
    expectMembers(rps[0], {"remotePortWwn", "numOfLuns"}, {"remoteNodeWwn", "deviceData", "isTarget", "lunList"},
                  "remote port");
    expectMembers(lib.call("getCompleteRemotePort", bareReq), {"remotePortWwn", "pPortWwn"},
                  {"deviceData", "lunList"}, "bare remote port");
    Json::Value full = lib.call("getCompleteRemotePort", emptyReq);
    // A device the library reads is logged in, whatever else it tells.
    EXPECT_EQ(obj({{"stateMofValue", 2}}), full["deviceData"]);
    EXPECT_EQ(arr({obj({})}), full["lunList"]);
    EXPECT_EQ(Json::Value(Json::arrayValue), lib.call("getAllLunsByRemotePort", bareReq));

    expectMembers(lib.call("getVPort", obj({{"pPortWwn", fcoe}, {"lPortWwn", vport}})),
                  {"vwwn", "pPortWwn", "state", "numOfRemotePorts"}, {"nodeWwn", "symbolicName", "vfId"}, "vport");
    expectMembers(lib.call("getFlashInfo", obj({{"indexStr", cna}})), {"flashStatus"},
                  {"firmwareVersion", "biosVersion"}, "flash");
    expectMembers(lib.call("getAdvAdapterData", obj({{"indexStr", cna}})), {"indexStr", "mode", "numPciFunctions"},
                  {"alias", "pciLocation", "pciGeneration", "pciLanes", "temperatureC"}, "advanced adapter data");
    expectMembers(lib.call("getFcByFcWwn", obj({{"wwn", fcoe}})), {"portWwn", "isFCoE"},
                  {"nodeWwn", "topology", "bbCredit", "maxFrameSize"}, "FC data");
    expectMembers(lib.call("getFcByFcWwn", obj({{"wwn", fc}})), {"portWwn", "nodeWwn"}, {"isFCoE"}, "FC data");
    expectMembers(lib.call("getFcoeByPort", obj({{"indexStr", fcoe}})), {"portWwn"},
                  {"nodeWwn", "fcoeMac", "vlanId", "fipMode"}, "FCoE data");
    expectMembers(lib.call("getGlobalInfo")["adapter"][0], {"mac", "numOfPorts"}, {"wwn", "model"}, "global info");

    // Reading changed nothing in the host, also not by a look-up that added
    // what it looked for.
    char* after = dump();
    EXPECT_STREQ(before, after);
    free(before);
    free(after);

    // A setter gives a port a member it lacked, of the member's own type only.
    Json::Value set = obj({{"indexStr", fc}, {"port", obj({{"beaconState", "on"}})},
                           {"propArray", strArray({"beaconState"})}});
    EXPECT_TRUE(isError(lib.call("setPortByWwn", set)));
    set["port"]["beaconState"] = true;
    EXPECT_FALSE(isError(lib.call("setPortByWwn", set)));
    EXPECT_TRUE(lib.call("getPortByWwn", obj({{"wwn", fc}}))["beaconState"].asBool());
}

TEST_F(DtrujHost, LookUpsTakeEitherFormAndFollowTheLoadedHost)
{
    unsetenv("DTRUJ_HOST");
    lib.reset();
    EXPECT_EQ(FC_HBA, lib.call("getHbaByWwn", obj({{"wwn", "200000051E8A1000"}}))["hbaData"]["wwn"].asString());
    EXPECT_EQ(CNA, lib.call("getHbaByWwn", obj({{"wwn", "00051E8B2000"}}))["hbaData"]["hbaMAC"].asString());
    EXPECT_EQ(FC_PORT1, lib.call("getPortByWwn", obj({{"wwn", "10:00:00:05:1E:8A:10:02"}}))["wwn"].asString());
    // An FCoE port also answers to its MAC.
    EXPECT_EQ(FCOE_PORT, lib.call("getPortByWwn", obj({{"wwn", "00051e8b2003"}}))["wwn"].asString());
    EXPECT_EQ(ETH_PORT, lib.call("getEthPortByEthMac", obj({{"mac", "00051E8B2002"}}))["ethData"]["mac"].asString());
    EXPECT_EQ(DISK_RPORT, lib.call("getCompleteRemotePort", obj({{"pPortWwn", "100000051e8a1001"},
                                                                 {"rPortWwn", "500601603B201A01"}}))["remotePortWwn"]
                              .asString());

    // Another description: the old addresses are gone, the new ones found.
    ASSERT_EQ(0, initWithText(R"({ "adapters": [ { "hbaData": { "wwn": "20:00:00:00:00:00:00:10" },
        "fcPorts": [ { "wwn": "10:00:00:00:00:00:00:11" } ] } ] })")["result"].asInt());
    EXPECT_TRUE(isError(lib.call("getHbaByWwn", obj({{"wwn", FC_HBA}}))));
    EXPECT_TRUE(isError(lib.call("getPortByWwn", obj({{"wwn", FC_PORT0}}))));
    EXPECT_FALSE(isError(lib.call("getPortByWwn", obj({{"wwn", "10:00:00:00:00:00:00:11"}}))));
    EXPECT_EQ(1, lib.call("getAdapterIdByPort", obj({{"indexStr", "10:00:00:00:00:00:00:11"}}))["adapterId"].asInt());
}

TEST_F(DtrujHost, VirtualPortsAndTheirRemotePortsStayFoundAcrossChanges)
{
    const char* const port = "10:00:00:00:00:00:00:11";
    const char* const v1 = "2f:00:00:00:00:00:00:01";
    const char* const v2 = "2f:00:00:00:00:00:00:02";
    const char* const r1 = "50:00:00:00:00:00:00:01";
    const char* const r2 = "50:00:00:00:00:00:00:02";
    ASSERT_EQ(0, initWithText(R"({ "adapters": [
        { "hbaData": { "wwn": "20:00:00:00:00:00:00:10" },
          "fcPorts": [ { "wwn": "10:00:00:00:00:00:00:11",
                         "remotePorts": [ { "remotePortWwn": "50:00:00:00:00:00:00:01" } ],
                         "vports": [ { "vwwn": "2f:00:00:00:00:00:00:01", "symbolicName": "one",
                                       "remotePorts": [ { "remotePortWwn": "50:00:00:00:00:00:00:01" } ] },
                                     { "vwwn": "2f:00:00:00:00:00:00:02", "symbolicName": "two",
                                       "remotePorts": [ { "remotePortWwn": "50:00:00:00:00:00:00:02" } ] } ] } ] },
        { "hbaData": { "wwn": "20:00:00:00:00:00:00:20" },
          "fcPorts": [ { "wwn": "10:00:00:00:00:00:00:21" } ] } ] })")["result"].asInt());
    auto remote = [&](const char* lport, const char* rport) {
        return lib.call("getCompleteRemotePort", obj({{"pPortWwn", port}, {"lPortWwn", lport}, {"rPortWwn", rport}}));
    };
    auto vport = [&](const char* v) { return lib.call("getVPort", obj({{"pPortWwn", port}, {"lPortWwn", v}})); };

    // Each logical port sees its own remote ports only.
    EXPECT_FALSE(isError(remote(port, r1)));
    EXPECT_TRUE(isError(remote(port, r2)));
    EXPECT_FALSE(isError(remote(v2, r2)));
    EXPECT_TRUE(isError(remote(v1, r2)));

    // Deleting the first, named in either form, moves the second up; it is
    // still found, as it is.
    ASSERT_FALSE(isError(lib.call("deleteVport", obj({{"pwwn", port}, {"vportArray", arr({"2F00000000000001"})}}))));
    EXPECT_TRUE(isError(vport(v1)));
    EXPECT_TRUE(isError(remote(v1, r1)));
    EXPECT_EQ("two", vport(v2)["symbolicName"].asString());
    EXPECT_EQ(r2, remote(v2, r2)["remotePortWwn"].asString());

    // The freed WWN can be given again, the taken ones can't; a new port is
    // found at once.
    EXPECT_TRUE(isError(lib.call("createVport", obj({{"pwwn", port}, {"vwwn", v2}}))));
    EXPECT_TRUE(isError(lib.call("createVport", obj({{"pwwn", port}, {"vwwn", "10:00:00:00:00:00:00:21"}}))));
    ASSERT_FALSE(isError(lib.call("createVport", obj({{"pwwn", port}, {"vwwn", v1}, {"symbolicName", "again"}}))));
    EXPECT_EQ("again", vport(v1)["symbolicName"].asString());
    EXPECT_EQ(0u, vport(v1)["numOfRemotePorts"].asUInt());
    EXPECT_EQ("two", vport(v2)["symbolicName"].asString());
    // A virtual port of another physical port isn't one of this port's.
    EXPECT_TRUE(isError(lib.call("getVPort", obj({{"pPortWwn", "10:00:00:00:00:00:00:21"}, {"lPortWwn", v2}}))));
}

TEST_F(DtrujHost, UncheckedMembersReachTheRepliesAsTheyAre)
{
    ASSERT_EQ(0, initWithText(R"({ "adapters": [
        { "hbaData": { "wwn": "20:00:00:00:00:00:00:10", "model": "M", "unchecked": { "model": 7 } },
          "unchecked": { "driver": "none" },
          "fcPorts": [ { "wwn": "10:00:00:00:00:00:00:11", "portStatusValue": 11,
                         "unchecked": { "portStatusValue": "up", "supportedPortSpeeds": [ "16" ] },
                         "sfp": { "unchecked": { "transceiver": null } },
                         "remotePorts": [ { "remotePortWwn": "50:00:00:00:00:00:00:01",
                                            "unchecked": { "deviceData": [], "lunList": {} } } ] } ],
          "ethPorts": [ { "mac": "00:00:00:00:00:02", "unchecked": { "mtu": -1 } } ] } ] })")["result"].asInt());
    const char* const port = "10:00:00:00:00:00:00:11";
    Json::Value h = lib.call("getHbaByWwn", obj({{"wwn", "20:00:00:00:00:00:00:10"}}));
    EXPECT_EQ(7, h["hbaData"]["model"].asInt());
    EXPECT_FALSE(h["hbaData"].isMember("unchecked"));
    EXPECT_EQ("none", h["driver"].asString());
    Json::Value p = lib.call("getPortByWwn", obj({{"wwn", port}}));
    EXPECT_EQ("up", p["portStatusValue"].asString());
    EXPECT_EQ(arr({"16"}), p["supportedPortSpeeds"]);
    EXPECT_FALSE(p.isMember("unchecked"));
    Json::Value sfp = lib.call("getOpticsSFP", obj({{"indexStr", port}}));
    EXPECT_TRUE(sfp.isMember("transceiver") && sfp["transceiver"].isNull());
    Json::Value r = lib.call("getCompleteRemotePort", obj({{"pPortWwn", port}, {"lPortWwn", port},
                                                           {"rPortWwn", "50:00:00:00:00:00:00:01"}}));
    EXPECT_TRUE(r["deviceData"].isArray());
    EXPECT_TRUE(r["lunList"].isObject());
    EXPECT_EQ(-1, lib.call("getEthPortByEthMac", obj({{"mac", "00:00:00:00:00:02"}}))["ethData"]["mtu"].asInt());
    // The library itself goes by what the description says.
    EXPECT_FALSE(isError(lib.call("getDynamicPortStatistics", obj({{"indexStr", port}}))));
}

} // namespace
