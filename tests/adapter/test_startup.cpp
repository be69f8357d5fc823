// Start-up as a CIM server sees it: the probe loads a module made of the
// adapter code, in a fresh HOME, with the adapter library found (or not)
// through LD_LIBRARY_PATH, and reports what the start-up left behind.

#include <gtest/gtest.h>

#include <spawn.h>
#include <stdlib.h>
#include <sys/wait.h>
#include <unistd.h>

#include <map>
#include <string>
#include <vector>

#include <json/json.h>

#include "TestSupport.h"

using namespace adapter_test;

namespace
{

struct ProbeRun
{
    std::map<std::string, std::string> report;   // its "key=value" lines
    std::string log;
};

std::string spawn(std::vector<std::string> args, const std::vector<std::string>& env)
{
    std::vector<char*> argp, envp;
    for (std::string& a : args)
        argp.push_back(&a[0]);
    for (const std::string& e : env)
        envp.push_back(const_cast<char*>(e.c_str()));
    argp.push_back(0);
    envp.push_back(0);

    int fds[2];
    if (pipe(fds) != 0)
        return std::string();

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, fds[1], 1);
    pid_t pid;
    int rc = posix_spawn(&pid, argp[0], &actions, 0, argp.data(), envp.data());
    posix_spawn_file_actions_destroy(&actions);
    close(fds[1]);

    std::string out;
    char buf[4096];
    ssize_t n;
    while (rc == 0 && (n = read(fds[0], buf, sizeof(buf))) > 0)
        out.append(buf, n);
    close(fds[0]);

    int status = -1;
    if (rc == 0)
        waitpid(pid, &status, 0);
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << out;
    return out;
}

ProbeRun runProbe(const std::string& libDir, std::vector<std::string> env,
    const std::string& fault = "")
{
    std::string home = makeHome();
    env.push_back("HOME=" + home);
    env.push_back("LD_LIBRARY_PATH=" + libDir);
    for (const char* name : { "ASAN_OPTIONS", "UBSAN_OPTIONS" })
        if (getenv(name))
            env.push_back(std::string(name) + "=" + getenv(name));

    std::vector<std::string> args = { PROBE_EXE };
    if (!fault.empty())
        args.insert(args.end(), { "--fault", fault });
    args.push_back(PROBE_MODULE);

    ProbeRun run;
    std::istringstream out(spawn(args, env));
    std::string line;
    while (std::getline(out, line))
        if (line.find('=') != std::string::npos)
            run.report[line.substr(0, line.find('='))] = line.substr(line.find('=') + 1);
    run.log = readFile(home + "/.tessel/messages");
    EXPECT_EQ("1", run.report["loaded"]);
    return run;
}

size_t errLines(const std::string& log)
{
    return countLines(log, {"ERR: "});
}

} // namespace

TEST(Startup, LibraryBindsInitialisesAndFindsAdapters)
{
    ProbeRun run = runProbe(DTRUJ_DIR, {});
    const std::string& log = run.log;

    EXPECT_EQ("0", run.report["driverStatus"]);
    EXPECT_EQ("117", run.report["bound"]);
    EXPECT_EQ(0u, errLines(log)) << log;

    // The steps in their order, the library's own lines (3.2.1 takes the
    // log callback) and the unload.
    const char* const steps[] = { "DBG: ProviderInit.cpp(", "Inside ProviderInit Constructor.",
        "inside setupDLLEntryPoints", "Returning: setupDLLEntryPoints",
        "INFO: ProviderInit.cpp(", "TRUJ Library version: 3.2.1", "INFO: ProviderUtil.cpp(",
        "host loaded from", "DBG: ProviderInit.cpp(", "Adapter Count = 2",
        "Inside ProviderInit Destructor." };
    size_t at = 0;
    for (const char* step : steps)
    {
        at = log.find(step, at);
        ASSERT_NE(std::string::npos, at) << step << "\n" << log;
    }
}

TEST(Startup, WithoutLibraryEveryEntryIsItsStub)
{
    ProbeRun run = runProbe(makeHome(), {});

    EXPECT_EQ("0", run.report["libraryLoaded"]);
    EXPECT_EQ("1", run.report["driverStatus"]);
    EXPECT_EQ("117", run.report["stubs"]);
    EXPECT_EQ(1u, countLines(run.log, {"DBG: ", "Error in loading library: ", "libdtruj.so"}));
    EXPECT_EQ(1u, countLines(run.log, {"INFO: ", "TRUJ Library version: NOT Loaded"}));
    EXPECT_EQ(1u, countLines(run.log, {"ERR: ", "libInitHbaLib returns NULL response or has error"}));
    EXPECT_EQ(1u, errLines(run.log)) << run.log;
    EXPECT_EQ(0u, countLines(run.log, {"Adapter Count"}));
}

TEST(Startup, MissingEntryIsNamedAndTheRestBound)
{
    if (std::string(DTRUJ_NOLLDP_DIR).empty())
        GTEST_SKIP() << "no library variant without getLldp in this build";

    ProbeRun run = runProbe(DTRUJ_NOLLDP_DIR, {});

    EXPECT_EQ("116", run.report["bound"]);
    EXPECT_EQ("getLldp", run.report["unbound"]);
    EXPECT_EQ("0", run.report["driverStatus"]);
    EXPECT_EQ(1u, errLines(run.log)) << run.log;
    EXPECT_EQ(1u, countLines(run.log, {"ERR: ", "): getLldp not found. "}));
}

TEST(Startup, HostsAndVersions)
{
    // An older library initialises without the log callback.
    ProbeRun old = runProbe(DTRUJ_DIR, {"DTRUJ_VERSION=3.1.0"});
    EXPECT_EQ("0", old.report["driverStatus"]);
    EXPECT_EQ(1u, countLines(old.log, {"INFO: ", "TRUJ Library version: 3.1.0"}));
    EXPECT_EQ(0u, countLines(old.log, {"host loaded from"})) << old.log;

    // No adapter: status 1, and nothing is wrong.
    Json::Value host;
    ASSERT_TRUE(Json::Reader().parse(readFile(DEFAULT_HOST), host));
    host["adapters"] = Json::Value(Json::arrayValue);
    std::string path = makeHome() + "/empty.json";
    writeFile(path, Json::FastWriter().write(host));

    ProbeRun empty = runProbe(DTRUJ_DIR, {"DTRUJ_HOST=" + path});
    EXPECT_EQ("1", empty.report["driverStatus"]);
    EXPECT_EQ(1u, countLines(empty.log, {"DBG: ", "Adapter Count = 0"}));
    EXPECT_EQ(0u, errLines(empty.log)) << empty.log;
}

TEST(Startup, InitFailuresStillLoadTheModule)
{
    struct { const char* fault; const char* line; } cases[] = {
        { "hba", "libInitHbaLib got User exception 1: injected fault" },
        { "std", "libInitHbaLib got std exception" },
        { "unknown", "libInitHbaLib got default exception" },
        { "error", "libInitHbaLib returns NULL response or has error" },
        { "null", "libInitHbaLib returns NULL response or has error" },
    };

    for (auto& c : cases)
    {
        ProbeRun run = runProbe(DTRUJ_DIR, {}, std::string("init_hba_lib=") + c.fault);

        EXPECT_EQ("1", run.report["driverStatus"]) << c.fault;
        EXPECT_EQ(1u, countLines(run.log, {"ERR: ", c.line})) << c.fault << run.log;
        EXPECT_EQ(1u, errLines(run.log)) << c.fault << run.log;
        EXPECT_EQ(0u, countLines(run.log, {"Adapter Count"})) << c.fault;
    }
}

// The plain entries throw like the others: the module still loads and
// unloads, and the ERR line names the entry.
TEST(Startup, PlainEntriesThatThrowStillLoadAndUnload)
{
    struct { const char* entry; const char* kind; const char* status; const char* line; } cases[] = {
        { "get_agt_version", "hba", "0", "libGetAgtVersion got User exception 1: injected fault" },
        { "get_agt_version", "unknown", "0", "libGetAgtVersion got default exception" },
        { "registerLogMsgCb", "std", "0", "libRegisterLogMsgCb got std exception: injected fault" },
        { "getNumberOfAdapters", "hba", "1", "libGetNumOfAdapters got User exception" },
        { "free_hba_lib", "unknown", "0", "libFreeHbaLib got default exception" },
    };

    for (auto& c : cases)
    {
        // Faults of the entries called after init_hba_lib come from the
        // host description it reads.
        Json::Value host;
        ASSERT_TRUE(Json::Reader().parse(readFile(DEFAULT_HOST), host));
        host["faults"][c.entry] = c.kind;
        std::string path = makeHome() + "/faulty.json";
        writeFile(path, Json::FastWriter().write(host));

        ProbeRun run = runProbe(DTRUJ_DIR, {"DTRUJ_HOST=" + path},
            std::string(c.entry) + "=" + c.kind);
        EXPECT_EQ(c.status, run.report["driverStatus"]) << c.entry;
        EXPECT_EQ(1u, countLines(run.log, {"ERR: ", c.line})) << c.entry << run.log;
        EXPECT_EQ(1u, errLines(run.log)) << c.entry << run.log;
    }
}

TEST(Startup, InitReplyAndVersionRules)
{
    // The fake library: its version, init reply and count from the
    // environment; it notes what it was called with.
    struct { const char* version; const char* reply; const char* status; const char* line; } cases[] = {
        { "3.2.1", "{}", "1", "libInitHbaLib is failed - -1 " },
        { "4.3.2", "{\"result\": 5}", "1", "libInitHbaLib is failed - 5 " },
        { "3.2.0", "{\"result\": \"0\"}", "1", "libInitHbaLib is failed - -1 " },
        { "4.0.0", "[0]", "1", "libInitHbaLib is failed - -1 " },
        { "3.1.9", "{\"result\": 0}", "0", "Adapter Count = 3" },
        { "3.2", "{\"result\": 0}", "0", "TRUJ Library version: 3.2" },
        { 0, "{\"result\": 0}", "0", "TRUJ Library version: Unknown" },
    };

    for (auto& c : cases)
    {
        std::vector<std::string> env = { std::string("FAKE_DTRUJ_INIT=") + c.reply,
            "FAKE_DTRUJ_COUNT=3" };
        if (c.version)
            env.push_back(std::string("FAKE_DTRUJ_VERSION=") + c.version);
        ProbeRun run = runProbe(FAKE_DTRUJ_DIR, env);
        std::string v = c.version ? c.version : "none";
        bool registers = v == "3.2.1" || v == "4.3.2";

        EXPECT_EQ(c.status, run.report["driverStatus"]) << v;
        EXPECT_EQ(1u, countLines(run.log, {c.line})) << v << run.log;
        EXPECT_EQ("{\"appId\":2}", run.report["initRequest"]) << v;
        EXPECT_EQ(c.status == std::string("0") ? 1u : 0u,
            run.report.count("getNumberOfAdapters")) << v;
        EXPECT_EQ("1", run.report["free_hba_lib"]) << v;
        EXPECT_EQ(registers ? 1u : 0u, countLines(run.log,
            {"INFO: ProviderUtil.cpp(", "fake_dtruj.cpp:1 fake library initialising"})) << v;
    }
}
