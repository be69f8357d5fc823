// The software installation service as a WBEM client sees it: its instance
// and capabilities, and InstallFromURI from a file, with each of its checks,
// and with hostile tftp URIs that must never start anything.

#include <chrono>
#include <thread>

#include "UpdateSupport.h"

using namespace update_test;

namespace
{

class Install : public UpdateTest
{
protected:
    std::string image(const std::string& name, const std::string& version)
    {
        std::string path = workDir() + "/" + name;
        writeFile(path, "VSPR image\nversion=" + version + "\n" + std::string(4096, '\x7f'));
        return path;
    }
};

} // namespace

TEST_F(Install, OneServiceAndItsCapabilitiesOnTheHost)
{
    std::vector<ch::Instance> service = served("VESPERA_HBASoftwareInstallationService");
    std::vector<ch::Instance> system = served("VESPERA_ComputerSystem");
    ASSERT_EQ(1u, service.size());
    ASSERT_EQ(1u, system.size());
    EXPECT_EQ("Vespera Adapter Software Update Service", text(service[0], "Name"));
    EXPECT_EQ("VESPERA_HBASoftwareInstallationService", text(service[0], "CreationClassName"));
    EXPECT_EQ("VESPERA_ComputerSystem", text(service[0], "SystemCreationClassName"));
    // So that an association can hang it on the host.
    EXPECT_EQ(text(system[0], "Name"), text(service[0], "SystemName"));

    std::vector<ch::Instance> caps = served("VESPERA_HBASoftwareInstallationServiceCapabilities");
    ASSERT_EQ(1u, caps.size());
    EXPECT_EQ("Vespera Adapter Software Update Service", text(caps[0], "InstanceID"));
    EXPECT_EQ("{4, 5}", text(caps[0], "SupportedInstallOptions"));
    EXPECT_EQ("{3, 8}", text(caps[0], "SupportedURISchemes"));
    EXPECT_EQ("{5}", text(caps[0], "SupportedSynchronousActions"));
    EXPECT_EQ(std::vector<std::string>(), host->refused_properties());

    // A host without adapters still has the service.
    useHostFile(std::string(DTRUJ_HOSTS_DIR) + "/no-adapter.json");
    EXPECT_EQ(1u, served("VESPERA_HBASoftwareInstallationService").size());
}

TEST_F(Install, AGoodFileReachesTheFlashAndTheInventory)
{
    for (size_t n = 0; n < 2; n++)
    {
        ch::Object_Path adapter = adapterPath(n);
        std::string id = deviceIdOf(adapter);
        std::string version = "9.0." + std::to_string(n);
        LogMark mark;

        // Only the first option counts.
        EXPECT_EQ(0u, install("file://" + image("fw.img", version), &adapter, {4, 2}));
        EXPECT_EQ(version, firmwareOf(id)) << id;
        EXPECT_EQ(1u, countLines(mark.text(), {"DBG: ", "Software update is success"}));
        EXPECT_EQ(1u, countLines(mark.text(), {"status=0 message = Flash updated"}));
    }

    // Each adapter has its own version.
    EXPECT_EQ("9.0.0", firmwareOf(deviceIdOf(adapterPath(0))));
}

// Each check gives 2, its own lines in the log, and stops there: an earlier
// failure hides a later one, and nothing reaches the library.
TEST_F(Install, EachCheckFailsInItsTurn)
{
    ch::Object_Path adapter = adapterPath();
    std::string good = "file://" + image("fw.img", "7.0");
    ch::Object_Path fcPort = ein("VESPERA_FCPort").paths.at(0);
    ch::Object_Path stranger = adapter;
    for (ch::Property& k : stranger.keys)
        if (k.name == "DeviceID")
            k.value = ch::Value::of_string("2000deadbeef0000");

    struct Case
    {
        std::string uri;
        const ch::Object_Path* target;
        std::vector<uint64_t> options;
        std::string error, failure;
    };
    const Case cases[] = {
        { "", 0, {}, "URI.value is empty", "empty input parameters" },
        { good, 0, {}, "Target is empty", "empty input parameters" },
        { good, &adapter, {}, "InstallOptions.value.size() is  0", "empty input parameters" },
        { good, &adapter, {2, 5}, "InstallOptions[0] validation failed", "invalid option type" },
        { "file://", &adapter, {5}, "", "malformed file URI" },
        { "http://server/fw.img", &adapter, {5}, "malformed uri. Throw error", "malformed URI" },
        { "tftp://a/fw.img", &adapter, {5}, "", "malformed tftp URI" },
        { "tftp:///fw.img", &adapter, {5}, "", "malformed tftp URI" },
        { "tftp://server", &adapter, {5}, "", "malformed tftp URI" },
        { "tftp://server/", &adapter, {5}, "", "malformed tftp URI" },
        { "file:///no/such/fw.img", &adapter, {5}, "File doesnt exist", "File not exists" },
        { good, &stranger, {5}, "Couldnt find the matching port controller.",
          "Could not find target controller" },
        { good, &fcPort, {5}, "Couldnt find the matching port controller.",
          "Could not find target controller" },
    };

    size_t attempts = flashAttempts();

    for (const Case& c : cases)
    {
        LogMark mark;
        EXPECT_EQ(2u, install(c.uri, c.target, c.options)) << c.uri << " " << c.failure;
        std::string log = mark.text();
        EXPECT_EQ(1u, countLines(log, {"DBG: ", "InstallFromURI : ERROR - " + c.failure}))
            << c.uri << "\n" << log;
        if (!c.error.empty())
        {
            EXPECT_EQ(1u, countLines(log, {"ERR: ", c.error})) << c.uri;
        }
        EXPECT_EQ(1u, countLines(log, {"return value = 2"}));
    }

    EXPECT_EQ(attempts, flashAttempts()) << "no check may let the library be asked";
    EXPECT_EQ("3.2.1.0", firmwareOf(deviceIdOf(adapter)));
}

TEST_F(Install, AFailingFlashGivesTwoAndKeepsTheVersion)
{
    Json::Value flash;
    flash["updateStatus"] = 1;
    flash["updateMessage"] = "write-protected";
    useHost(hostWithFlash(flash));
    ch::Object_Path adapter = adapterPath();

    LogMark mark;
    EXPECT_EQ(2u, install("file://" + image("fw.img", "7.0"), &adapter));
    std::string log = mark.text();
    EXPECT_EQ(1u, countLines(log, {"status=1 message = write-protected"}));
    EXPECT_EQ(1u, countLines(log, {"ERR: ", "UpdatePortControllerSoftware method failed"}));
    EXPECT_EQ(1u, countLines(log, {"InstallFromURI : ERROR - controller update failed"}));
    EXPECT_EQ("3.2.1.0", firmwareOf(deviceIdOf(adapter)));

    // A library that throws, or answers nothing usable, is a failure too.
    useHost(hostWithFlash(Json::Value()));
    for (const char* fault : { "{\"kind\":\"hba\",\"code\":9}", "std", "unknown", "null",
             "error" })
    {
        ASSERT_EQ(0, dtruj_sim_set_fault("adapterUpdateFlash", fault));
        EXPECT_EQ(2u, install("file://" + image("fw.img", "7.0"), &adapter)) << fault;
    }
    dtruj_sim_set_fault("adapterUpdateFlash", 0);
    EXPECT_EQ("3.2.1.0", firmwareOf(deviceIdOf(adapter)));
}

// The flash takes its time; meanwhile the call waits, and the rest of the
// inventory goes on answering with the old version.
TEST_F(Install, TheCallLastsAsLongAsTheFlash)
{
    Json::Value flash;
    flash["durationMs"] = 700;
    useHost(hostWithFlash(flash));
    ch::Object_Path adapter = adapterPath();
    std::string id = deviceIdOf(adapter);
    std::string file = image("fw.img", "8.1");

    auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(0u, install("file://" + file, &adapter));
    EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(700));

    // The library alone, from another thread, while the inventory is read.
    Json::Value request;
    request["indexStr"] = id;
    request["file"] = image("fw2.img", "8.2");
    Json::Value reply;
    std::thread flasher([&] { reply = adapterUpdateFlash(request); });
    std::this_thread::sleep_for(std::chrono::milliseconds(150));
    start = std::chrono::steady_clock::now();
    EXPECT_EQ("8.1", firmwareOf(id));
    EXPECT_EQ("Updating", getDriverUpdateStatus(Json::Value())["status"].asString());
    EXPECT_LT(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(400));
    flasher.join();
    EXPECT_EQ(0, reply["status"].asInt()) << reply.toStyledString();
    EXPECT_EQ("8.2", firmwareOf(id));
    EXPECT_EQ("Idle", getDriverUpdateStatus(Json::Value())["status"].asString());
}

// Hosts and paths that a shell, the client's option parser or a path walk
// would read as more than a name: each gives 2 with an ERR line before
// anything runs, and no file goes.
TEST_F(Install, HostileTftpURIsStartNothingAndRemoveNothing)
{
    ch::Object_Path adapter = adapterPath();
    std::string bin = workDir() + "/bin";
    std::filesystem::create_directories(bin);
    std::string marker = workDir() + "/tftp-ran";
    writeFile(bin + "/tftp", "#!/bin/sh\necho \"$*\" >> '" + marker + "'\n");
    chmod((bin + "/tftp").c_str(), 0755);
    std::string savedPath = getenv("PATH");
    setenv("PATH", (bin + ":" + savedPath).c_str(), 1);

    std::string cwd = workDir() + "/cwd";
    std::filesystem::create_directories(cwd);
    ASSERT_EQ(0, chdir(cwd.c_str()));
    for (const char* name : { "victim", "fw.img", "pwned" })
        writeFile(cwd + "/" + name, "keep");

    const char* const hosts[] = { "srv;rm victim", "$(rm victim)", "srv)", "`rm victim`",
        "srv'x", "srv\"x", "srv x", "srv\nx", "srv|x", "srv&x", "srv>victim", "srv<victim",
        "srv*", "~root", "..", "-c", "srv:69" };
    const char* const paths[] = { "fw.img;rm victim", "$(rm victim)", "fw)", "`rm victim`",
        "fw'", "fw\"", "fw victim", "fw\nvictim", "fw|rm", "fw&rm", "fw>victim", "fw<victim",
        "*", "~/fw.img", "../victim", "a/../victim", "..", "-victim", "a/-c", "/etc/passwd",
        "a//b", "fw.img/" };

    std::vector<std::string> uris;
    for (const char* h : hosts)
        uris.push_back(std::string("tftp://") + h + "/fw.img");
    for (const char* p : paths)
        uris.push_back(std::string("tftp://server/") + p);

    for (const std::string& uri : uris)
    {
        LogMark mark;
        EXPECT_EQ(2u, install(uri, &adapter)) << uri;
        EXPECT_EQ(1u, countLines(mark.text(), {"InstallFromURI : ERROR - malformed tftp URI"}))
            << uri;
        EXPECT_EQ(1u, countLines(mark.text(), {"ERR: ", "refused"})) << uri;
    }

    EXPECT_FALSE(std::filesystem::exists(marker)) << readFile(marker);
    for (const char* name : { "victim", "fw.img", "pwned" })
        EXPECT_EQ("keep", readFile(cwd + "/" + name)) << name;

    // The same client runs for a plain URI, in a directory of its own: so
    // it was found above and had no reason to stay away but the names.
    EXPECT_EQ(2u, install("tftp://server/dir/fw.img", &adapter));
    EXPECT_EQ("server -c get dir/fw.img\n", readFile(marker));
    EXPECT_EQ("keep", readFile(cwd + "/fw.img"));

    setenv("PATH", savedPath.c_str(), 1);
}
