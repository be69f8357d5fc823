// Start-up of the adapter code as a CIM server sees it: the probe loads a
// module made of the adapter code, in a fresh HOME, with the adapter library
// found (or not) through LD_LIBRARY_PATH, and reports what it ended with.

#include <gtest/gtest.h>

#include <stdlib.h>

#include <map>
#include <string>

#include <json/json.h>

#include "AdapterTestSupport.h"

using namespace adapter_test;

namespace
{

struct ProbeRun
{
    std::map<std::string, std::string> report;
    std::string out;
    std::string log;
};

ProbeRun runProbe(const std::string& libDir, std::map<std::string, std::string> env,
    const std::string& extra = "bound", const std::string& fault = "")
{
    std::string home = makeHome();
    env["HOME"] = home;
    env["LD_LIBRARY_PATH"] = libDir;

    for (const char* name : { "ASAN_OPTIONS", "UBSAN_OPTIONS", "LSAN_OPTIONS", "PATH" })
    {
        if (getenv(name) && !env.count(name))
            env[name] = getenv(name);
    }

    ProbeRun run;
    int status = -1;
    std::vector<std::string> argv = { PROBE_EXE };
    if (!fault.empty())
        argv.insert(argv.end(), { "--fault", fault });
    argv.insert(argv.end(), { PROBE_MODULE, extra });
    run.out = runWithEnv(argv, env, &status);
    run.report = parseReport(run.out);
    run.log = readFile(home + "/.tessel/messages");
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << run.out;
    EXPECT_EQ("1", run.report["loaded"]) << run.out;
    return run;
}

// The default host with one change, written where DTRUJ_HOST can name it.
std::string hostFile(const std::string& name, void (*change)(Json::Value&))
{
    Json::Value host;
    Json::Reader reader;
    EXPECT_TRUE(reader.parse(readFile(DEFAULT_HOST), host));
    change(host);
    std::string path = makeHome() + "/" + name + ".json";
    writeFile(path, Json::StyledWriter().write(host));
    return path;
}

size_t errLines(const std::string& log)
{
    return countLines(log, {"ERR: "});
}

} // namespace

TEST(Startup, LibraryBindsInitialisesAndFindsAdapters)
{
    ProbeRun run = runProbe(DTRUJ_DIR, {{"DTRUJ_HOST", DEFAULT_HOST}});

    EXPECT_EQ("1", run.report["libraryLoaded"]);
    EXPECT_EQ("0", run.report["driverStatus"]);
    EXPECT_EQ("117", run.report["bound"]);
    EXPECT_EQ("", run.report["unbound"]);

    const std::string& log = run.log;
    EXPECT_EQ(0u, errLines(log)) << log;
    EXPECT_EQ(1u, countLines(log, {"DBG: ", "Inside ProviderInit Constructor."}));
    EXPECT_EQ(1u, countLines(log, {"DBG: ", "inside setupDLLEntryPoints"}));
    EXPECT_EQ(1u, countLines(log, {"DBG: ", "Returning: setupDLLEntryPoints"}));
    EXPECT_EQ(1u, countLines(log, {"INFO: ", "TRUJ Library version: 3.2.1"}));
    EXPECT_EQ(1u, countLines(log, {"DBG: ", "Adapter Count = 2"}));
    EXPECT_EQ(1u, countLines(log, {"DBG: ", "Inside ProviderInit Destructor."}));

    // 3.2.1 takes the log callback: the library's own lines come through
    // under our source name.
    EXPECT_GE(countLines(log, {"ProviderUtil.cpp(", "host loaded from"}), 1u) << log;

    // In that order.
    EXPECT_LT(log.find("Inside ProviderInit Constructor."), log.find("inside setupDLLEntryPoints"));
    EXPECT_LT(log.find("Returning: setupDLLEntryPoints"), log.find("TRUJ Library version"));
    EXPECT_LT(log.find("TRUJ Library version"), log.find("Adapter Count"));
}

TEST(Startup, WithoutLibraryEveryEntryIsItsStub)
{
    ProbeRun run = runProbe(makeHome(), {}, "stubs");

    EXPECT_EQ("0", run.report["libraryLoaded"]);
    EXPECT_EQ("1", run.report["driverStatus"]);
    EXPECT_EQ("117", run.report["stubs"]);

    const std::string& log = run.log;
    EXPECT_EQ(1u, countLines(log, {"DBG: ", "Error in loading library: ", "libdtruj.so"}));
    EXPECT_EQ(1u, countLines(log, {"INFO: ", "TRUJ Library version: NOT Loaded"}));
    EXPECT_EQ(1u, countLines(log, {"ERR: ", "libInitHbaLib returns NULL response or has error"}));
    EXPECT_EQ(1u, errLines(log)) << log;
    EXPECT_EQ(0u, countLines(log, {"Adapter Count"}));
}

TEST(Startup, MissingEntryIsNamedAndTheRestBound)
{
    if (std::string(DTRUJ_NOLLDP_DIR).empty())
        GTEST_SKIP() << "no library variant without getLldp in this build";

    ProbeRun run = runProbe(DTRUJ_NOLLDP_DIR, {{"DTRUJ_HOST", DEFAULT_HOST}});

    EXPECT_EQ("116", run.report["bound"]);
    EXPECT_EQ("getLldp", run.report["unbound"]);
    EXPECT_EQ("0", run.report["driverStatus"]);
    EXPECT_EQ(1u, errLines(run.log)) << run.log;
    EXPECT_EQ(1u, countLines(run.log, {"ERR: ", "): getLldp not found. "}));
}

TEST(Startup, OlderLibraryGetsNoLogCallback)
{
    ProbeRun run = runProbe(DTRUJ_DIR, {{"DTRUJ_HOST", DEFAULT_HOST},
        {"DTRUJ_VERSION", "3.1.0"}});

    EXPECT_EQ("0", run.report["driverStatus"]);
    EXPECT_EQ(1u, countLines(run.log, {"INFO: ", "TRUJ Library version: 3.1.0"}));
    EXPECT_EQ(0u, countLines(run.log, {"host loaded from"})) << run.log;
}

TEST(Startup, HostWithoutAdapters)
{
    std::string host = hostFile("empty", [](Json::Value& h) {
        h["adapters"] = Json::Value(Json::arrayValue);
    });
    ProbeRun run = runProbe(DTRUJ_DIR, {{"DTRUJ_HOST", host}});

    EXPECT_EQ("1", run.report["driverStatus"]);
    EXPECT_EQ(1u, countLines(run.log, {"DBG: ", "Adapter Count = 0"}));
    EXPECT_EQ(0u, errLines(run.log)) << run.log;
}

TEST(Startup, InitFailuresStillLoadTheModule)
{
    struct { const char* fault; const char* line; } cases[] = {
        { "hba", "libInitHbaLib got User exception" },
        { "std", "libInitHbaLib got std exception" },
        { "unknown", "libInitHbaLib got default exception" },
        { "error", "libInitHbaLib returns NULL response or has error" },
        { "null", "libInitHbaLib returns NULL response or has error" },
    };

    for (auto& c : cases)
    {
        ProbeRun run = runProbe(DTRUJ_DIR, {{"DTRUJ_HOST", DEFAULT_HOST}}, "bound",
            std::string("init_hba_lib=") + c.fault);

        EXPECT_EQ("1", run.report["driverStatus"]) << c.fault;
        EXPECT_EQ(1u, countLines(run.log, {"ERR: ", c.line})) << c.fault << run.log;
        EXPECT_EQ(1u, errLines(run.log)) << c.fault << run.log;
        EXPECT_EQ(0u, countLines(run.log, {"Adapter Count"})) << c.fault;
    }
}

TEST(Startup, InitReplyIsReadWithCare)
{
    struct { const char* reply; const char* count; const char* status; const char* line; } cases[] = {
        { "{}", "2", "1", "libInitHbaLib is failed - -1 " },
        { "{\"result\": 5}", "2", "1", "libInitHbaLib is failed - 5 " },
        { "{\"result\": \"0\"}", "2", "1", "libInitHbaLib is failed - -1 " },
        { "[1, 2]", "2", "1", "libInitHbaLib is failed - -1 " },
        { "{\"result\": 0}", "3", "0", 0 },
    };

    for (auto& c : cases)
    {
        ProbeRun run = runProbe(FAKE_DTRUJ_DIR, {{"FAKE_DTRUJ_VERSION", "3.2.1"},
            {"FAKE_DTRUJ_INIT", c.reply}, {"FAKE_DTRUJ_COUNT", c.count}}, "");

        EXPECT_EQ(c.status, run.report["driverStatus"]) << c.reply;
        EXPECT_EQ("{\"appId\":2}", run.report["initRequest"]);
        EXPECT_EQ("1", run.report["free_hba_lib"]) << "freed at unload";

        if (c.line)
        {
            EXPECT_EQ(1u, countLines(run.log, {"ERR: ", c.line})) << c.reply << run.log;
            EXPECT_EQ(0u, run.report.count("getNumberOfAdapters")) << c.reply;
        }
        else
        {
            EXPECT_EQ(1u, countLines(run.log, {"DBG: ", "Adapter Count = 3"}));
        }
    }
}

TEST(Startup, LogCallbackOnlyFromVersion321)
{
    struct { const char* version; bool registers; const char* shown; } cases[] = {
        { "3.2.1", true, "3.2.1" },
        { "4.3.2", true, "4.3.2" },
        { "3.2.0", false, "3.2.0" },
        { "4.0.0", false, "4.0.0" },
        { "3.1.9", false, "3.1.9" },
        { "3.2", false, "3.2" },
        { "", false, "" },
        { 0, false, "Unknown" },
    };

    for (auto& c : cases)
    {
        std::map<std::string, std::string> env = {{"FAKE_DTRUJ_INIT", "{\"result\":0}"}};
        if (c.version)
            env["FAKE_DTRUJ_VERSION"] = c.version;

        ProbeRun run = runProbe(FAKE_DTRUJ_DIR, env, "");
        const char* v = c.version ? c.version : "(none)";

        EXPECT_EQ(c.registers ? 1u : 0u, run.report.count("registerLogMsgCb")) << v;
        EXPECT_EQ(c.registers ? 1u : 0u, countLines(run.log,
            {"INFO: ", "ProviderUtil.cpp(", "fake_dtruj.cpp:1 fake library initialising"})) << v;
        EXPECT_EQ(1u, countLines(run.log,
            {"INFO: ", std::string("TRUJ Library version: ") + c.shown})) << v;
    }
}
