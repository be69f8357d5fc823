// Host descriptions: the shipped examples, generated hosts, and descriptions
// that can't be used.
#include "Lib.h"

#include <fstream>
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
    struct { const char* text; const char* words; } cases[] = {
        {"{ \"adapters\": [ ", "Syntax error"},
        {"[1, 2]", "not a JSON object"},
        {"{ \"adapters\": {} }", "not an array"},
        {"{ \"adapters\": [ { \"hbaData\": { \"model\": \"x\" } } ] }", "neither"},
        {"{ \"adapters\": [ { \"hbaData\": { \"wwn\": \"20:00:00:00:00:00:00:01\" }, \"fcPorts\": [ {} ] } ] }",
         "has no \"wwn\""},
    };
    for (auto& c : cases) {
        Json::Value r = initWithText(c.text);
        EXPECT_NE(0, r["result"].asInt()) << c.text;
        EXPECT_NE(std::string::npos, r["message"].asString().find(c.words)) << r["message"].asString();
        EXPECT_TRUE(isError(lib.call("getHost")));
    }
    EXPECT_NE(0, initWith("/nonexistent/dtruj.json")["result"].asInt());
    // A description may refuse initialisation on purpose.
    EXPECT_EQ(4, initWithText("{ \"host\": { \"initResult\": 4 } }")["result"].asInt());
}

TEST_F(DtrujHost, MinimalDescriptionGetsEveryMemberTheModuleReads)
{
    ASSERT_EQ(0, initWithText(R"({ "adapters": [ { "hbaData": { "hbaMAC": "00:00:00:00:00:01" },
                                   "fcPorts": [ { "wwn": "10:00:00:00:00:00:00:01" } ],
                                   "ethPorts": [ { "mac": "00:00:00:00:00:02" } ] } ] })")["result"].asInt());
    Json::Value h = lib.call("getHbaByMac", obj({{"mac", "00:00:00:00:00:01"}}));
    for (const char* m : {"wwn", "portCount", "hbaStatus", "serialNumber", "model", "oem", "partNum", "oemSerialNum", "uuid"})
        EXPECT_TRUE(h["hbaData"].isMember(m)) << m;
    EXPECT_TRUE(h["firmware"]["version"].isString());
    Json::Value p = lib.call("getPortByWwn", obj({{"wwn", "10:00:00:00:00:00:00:01"}}));
    for (const char* m : {"nodeWwn", "PortSymbolicName", "operatingSpeed", "supportedPortSpeeds", "portTypeMOFValue",
                          "maxFrameSize", "portStatusValue", "isFCoE", "isMezz", "beaconState", "portStatus"})
        EXPECT_TRUE(p.isMember(m)) << m;
    Json::Value e = lib.call("getEthPortByEthMac", obj({{"mac", "00:00:00:00:00:02"}}))["ethData"];
    for (const char* m : {"ethDev", "ethPortStateMOFValue", "mtu"})
        EXPECT_TRUE(e.isMember(m)) << m;
}

} // namespace
