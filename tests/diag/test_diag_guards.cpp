// What keeps runs safe: requests that are refused, a port that was out of
// service already or can't be taken out, a library that throws or answers
// nothing, one test at a time, the bounded record lists, numbers that go on
// across runs, and an unload in the middle of a run.
#include "DiagTest.h"

using namespace diag_test;

namespace
{

typedef std::vector<std::string> Texts;

class DiagGuards : public DiagTest
{
};

TEST_F(DiagGuards, RequestsThatAreRefused)
{
    const char* const lb = "VESPERA_LoopbackDiagnosticTest";
    ch::Object_Path internal = testPath(lb, "Vespera:InternalLoopbackTest");

    // An element of another class than the test is for.
    ch::Result r = runDiagnostic(internal, elementPath("VESPERA_EthernetPort", ETH_PORT));
    EXPECT_EQ(5u, r.return_value.num.uint32);
    for (const ch::Property& o : r.out)
        EXPECT_TRUE(o.value.null) << o.name;

    // A port address of the wrong length, an adapter the library doesn't
    // know, a test the class doesn't have.
    ch::Object_Path port = elementPath("VESPERA_FCPort", FC_PORT);
    setKey(port, "DeviceID", "100000051e8a10");
    EXPECT_EQ(5u, runDiagnostic(internal, port).return_value.num.uint32);

    ch::Object_Path adapter = elementPath("VESPERA_PortController", FC_HBA);
    setKey(adapter, "DeviceID", "200000051e8a10ff");
    EXPECT_EQ(5u, runDiagnostic(testPath("VESPERA_MemoryDiagnosticTest", "Vespera:MemoryTest"),
        adapter).return_value.num.uint32);

    ch::Object_Path unknown = internal;
    setKey(unknown, "Name", "Vespera:NoSuchTest");
    EXPECT_EQ(1u, runDiagnostic(unknown, elementPath("VESPERA_FCPort", FC_PORT))
        .return_value.num.uint32);

    EXPECT_TRUE(jobs().empty());
    EXPECT_TRUE(served("VESPERA_DiagnosticServiceRecord").empty());
    EXPECT_TRUE(calledOf({"setPortByWwn", "setAdapterState", "diagLoopbackTest",
        "diagMemoryTest"}).empty());
}

TEST_F(DiagGuards, OneTestAtATimeAndNoWayToKillIt)
{
    Json::Value h = fastHost();
    h["diagnostics"]["memory"]["durationMs"] = 800;
    useHost(h);

    TestRun first = start("VESPERA_MemoryDiagnosticTest", "MemoryTest", "VESPERA_PortController",
        FC_HBA);
    ASSERT_EQ(4096u, first.status);

    TestRun second = start("VESPERA_PCILoopbackDiagnosticTest", "PCILoopbackTest", "VESPERA_FCPort",
        FC_PORT);
    EXPECT_EQ(4u, second.status);
    EXPECT_EQ("", second.job);

    std::vector<ch::Instance> j = jobs();
    ASSERT_EQ(1u, j.size());
    EXPECT_EQ(first.job, j[0].get_text("InstanceID"));
    EXPECT_EQ(4u, j[0].get("JobState")->num.uint16);
    EXPECT_EQ(0u, j[0].get("PercentComplete")->num.uint16);

    ch::Object_Path job = classPath("VESPERA_ConcreteJob");
    job.keys.push_back({"InstanceID", ch::Value::of_string(first.job)});
    EXPECT_EQ(CMPI_RC_ERR_NOT_SUPPORTED, host->cm(job, "KillJob", {}).rc);

    await(first);
    EXPECT_EQ(Texts{"Memory test run is successful"}, first.completionTexts());
    EXPECT_TRUE(calledOf({"diagPCILoopbackTest"}).empty());
}

TEST_F(DiagGuards, APortOutOfServiceAlreadyStaysSo)
{
    Json::Value h = fastHost();
    h["adapters"][0]["fcPorts"][0]["portStatus"] = false;
    useHost(h);

    TestRun run = runToEnd("VESPERA_LoopbackDiagnosticTest", "ExternalLoopbackTest",
        "VESPERA_FCPort", FC_PORT);
    EXPECT_EQ((Texts{"Checking whether the port is disabled for running loopback test",
                  "Port is already disabled", "Running loopback test for the port",
                  "Checking for return codes for loopback test run"}),
        run.serviceTexts());
    EXPECT_EQ(Texts{"Loopback test run is successful"}, run.completionTexts());
    EXPECT_TRUE(calledOf({"setPortByWwn"}).empty());
    EXPECT_FALSE(portEnabled(FC_PORT));
}

TEST_F(DiagGuards, APortThatCantBeDisabledIsNotTested)
{
    ASSERT_EQ(0, dtruj_sim_set_fault("setPortByWwn", "{\"kind\": \"error\", \"count\": 1}"));

    TestRun run = runToEnd("VESPERA_EthLoopbackDiagnosticTest", "SerdesEthLoopbackTest",
        "VESPERA_EthernetPort", ETH_PORT);
    EXPECT_EQ((Texts{"Checking whether the port is disabled for running eth loopback test",
                  "Port is not disabled", "Disabling the port"}),
        run.serviceTexts());
    EXPECT_EQ(Texts{"Failed to disable the port"}, run.completionTexts());
    EXPECT_EQ(5u, run.completion[0].state);
    EXPECT_EQ(Texts{"setPortByWwn"}, calledOf({"setPortByWwn", "diagEthLoopbackTest"}));
    EXPECT_TRUE(portEnabled(ETH_PORT));
}

TEST_F(DiagGuards, ALibraryThatThrowsOrAnswersNothingFailsTheRun)
{
    // A throw in the FC loopback, which no reply reaches: the run fails,
    // and the port comes back.
    ASSERT_EQ(0, dtruj_sim_set_fault("diagLoopbackTest",
        "{\"kind\": \"hba\", \"code\": 7, \"message\": \"adapter busy\"}"));
    TestRun thrown = runToEnd("VESPERA_LoopbackDiagnosticTest", "InternalLoopbackTest",
        "VESPERA_FCPort", FC_PORT);
    EXPECT_EQ((Texts{"Loopback test failed", "Tx frames = 0, Rx frames = 0, OSF frames = 0",
                  "Loopback test run status : adapter busy"}),
        thrown.completionTexts());
    EXPECT_EQ((Texts{"setPortByWwn", "diagLoopbackTest", "setPortByWwn"}),
        calledOf({"setPortByWwn", "diagLoopbackTest"}));
    EXPECT_TRUE(portEnabled(FC_PORT));

    // A null reply is no pass.
    ASSERT_EQ(0, dtruj_sim_set_fault("diagEthLoopbackTest", "null"));
    TestRun null = runToEnd("VESPERA_EthLoopbackDiagnosticTest", "SerdesEthLoopbackTest",
        "VESPERA_EthernetPort", ETH_PORT);
    EXPECT_EQ("EthLoopback test run status : Unknown failure", null.completionTexts().back());
    EXPECT_TRUE(portEnabled(ETH_PORT));

    // An exception of no known class in the memory test, and one in taking
    // the adapter out: the adapter is put back all the same.
    ASSERT_EQ(0, dtruj_sim_set_fault("diagMemoryTest", "unknown"));
    ASSERT_EQ(0, dtruj_sim_set_fault("setAdapterState", "{\"kind\": \"std\", \"count\": 1}"));
    TestRun memory = runToEnd("VESPERA_MemoryDiagnosticTest", "MemoryTest", "VESPERA_PortController",
        FC_HBA);
    EXPECT_EQ(Texts{"Memory test failed"}, memory.completionTexts());
    EXPECT_TRUE(adapterEnabled(0));
}

TEST_F(DiagGuards, NumbersGoOnAcrossRunsAndTheListsKeepTheLatestHundred)
{
    // 17 runs of six steps each: more than 100 service records.
    std::vector<TestRun> runs;
    for (int i = 0; i < 17; i++)
        runs.push_back(runToEnd("VESPERA_EthLoopbackDiagnosticTest",
            i % 2 ? "SerdesEthLoopbackTest" : "ExternalEthLoopbackTest", "VESPERA_EthernetPort",
            ETH_PORT));
    TestRun pci = runToEnd("VESPERA_PCILoopbackDiagnosticTest", "PCILoopbackTest",
        "VESPERA_FCPort", FC_PORT);

    // Job numbers count up whatever the test; record numbers run on through
    // both lists.
    auto number = [](const std::string& id) { return std::stol(id.substr(id.rfind('-') + 1)); };
    long first = number(runs[0].job);
    EXPECT_EQ(first + 17, number(pci.job));
    EXPECT_EQ("Vespera:PCILoopbackTest-" + std::to_string(first + 17), pci.job);
    auto recordNumber = [](const Record& r) { return std::stol(r.id.substr(r.id.rfind(':') + 1)); };
    EXPECT_EQ(recordNumber(runs[16].completion.back()) + 1, recordNumber(pci.service.front()));

    // Only the latest job is there.
    ASSERT_EQ(1u, jobs().size());
    EXPECT_EQ(pci.job, jobs()[0].get_text("InstanceID"));

    std::vector<ch::Instance> service = served("VESPERA_DiagnosticServiceRecord");
    EXPECT_EQ(100u, service.size());
    EXPECT_EQ(pci.service.back().id, service.back().get_text("InstanceID"));
    // 17 * 6 + 2 records: the first run's four oldest are gone.
    EXPECT_EQ(2u, records("VESPERA_DiagnosticServiceRecord", runs[0].job).size());
    EXPECT_EQ(6u, records("VESPERA_DiagnosticServiceRecord", runs[16].job).size());

    // The completion list isn't cut by the other's growth.
    for (const TestRun& r : runs)
        EXPECT_EQ(1u, records("VESPERA_DiagnosticCompletionRecord", r.job).size()) << r.job;
}

TEST_F(DiagGuards, AnUnloadStopsARunningTestAndPutsThePortBack)
{
    TestRun run = start("VESPERA_LoopbackDiagnosticTest", "SerdesLoopbackTest", "VESPERA_FCPort",
        FC_PORT);
    ASSERT_EQ(4096u, run.status);

    // The port is out of service and settling when the module goes.
    for (int i = 0; i < 100 && calledOf({"setPortByWwn"}).empty(); i++)
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    ASSERT_FALSE(portEnabled(FC_PORT));

    auto t0 = std::chrono::steady_clock::now();
    EXPECT_EQ(0, host->cleanup(false));
    auto ms = std::chrono::duration_cast<std::chrono::milliseconds>(
        std::chrono::steady_clock::now() - t0).count();
    EXPECT_LT(ms, 1500);

    // Nothing runs on after the unload: the job is completed, the test was
    // never started, and the port is back.
    Json::Value calls = simCalls();
    ASSERT_GE(calls.size(), 2u);
    EXPECT_EQ("setPortByWwn", calls[calls.size() - 1]["entry"].asString());
    EXPECT_TRUE(calls[calls.size() - 1]["request"]["port"]["portStatus"].asBool());
    EXPECT_TRUE(calledOf({"diagLoopbackTest"}).empty());
    EXPECT_TRUE(portEnabled(FC_PORT));

    await(run);
    EXPECT_EQ((Texts{"Loopback test failed", "Tx frames = 0, Rx frames = 0, OSF frames = 0",
                  "Loopback test run status : Loopback test aborted"}),
        run.completionTexts());

    // The providers come back for the next request, and so do the tests.
    TestRun again = runToEnd("VESPERA_PCILoopbackDiagnosticTest", "PCILoopbackTest",
        "VESPERA_FCPort", FC_PORT);
    EXPECT_EQ(Texts{"PCI Loopback test run is successful"}, again.completionTexts());
}

TEST_F(DiagGuards, AnUnloadWaitsForALibraryCallOnlySoLong)
{
    Json::Value h = fastHost();
    h["diagnostics"]["ethLoopback"]["durationMs"] = 7000;
    useHost(h);

    TestRun run = start("VESPERA_EthLoopbackDiagnosticTest", "SerdesEthLoopbackTest",
        "VESPERA_EthernetPort", ETH_PORT);
    ASSERT_EQ(4096u, run.status);
    for (int i = 0; i < 100 && calledOf({"diagEthLoopbackTest"}).empty(); i++)
        std::this_thread::sleep_for(std::chrono::milliseconds(10));

    // The test is in the library: the unload gives up waiting for it, and
    // the test ends by itself with its own outcome.
    auto t0 = std::chrono::steady_clock::now();
    EXPECT_EQ(0, host->cleanup(false));
    auto ms = std::chrono::duration_cast<std::chrono::milliseconds>(
        std::chrono::steady_clock::now() - t0).count();
    EXPECT_GE(ms, 4500);
    EXPECT_LT(ms, 6500);
    EXPECT_EQ(4u, jobState(run.job));

    await(run);
    EXPECT_EQ(Texts{"Eth loopback test run is successful"}, run.completionTexts());
    EXPECT_TRUE(portEnabled(ETH_PORT));
}

TEST_F(DiagGuards, WhatTheHostOffers)
{
    // Every test before any run; records and jobs are empty.
    EXPECT_EQ(1u, served("VESPERA_MemoryDiagnosticTest").size());
    EXPECT_EQ(3u, served("VESPERA_LoopbackDiagnosticTest").size());
    EXPECT_EQ(1u, served("VESPERA_PCILoopbackDiagnosticTest").size());
    EXPECT_EQ(2u, served("VESPERA_EthLoopbackDiagnosticTest").size());
    for (const ch::Instance& t : served("VESPERA_LoopbackDiagnosticTest"))
    {
        std::string c = t.get("Characteristics")->text();
        EXPECT_EQ(t.get_text("Name") == "Vespera:ExternalLoopbackTest" ? "{2, 4, 10}" : "{2, 4}", c);
        EXPECT_EQ("Loopback Diagnostic Test", t.get_text("ElementName"));
        EXPECT_EQ("", t.get_text("OtherCharacteristicDescription"));
    }
    EXPECT_EQ("{2}", served("VESPERA_PCILoopbackDiagnosticTest")[0].get("Characteristics")->text());

    // The model without external tests.
    Json::Value h = fastHost();
    h["adapters"][0]["hbaData"]["model"] = "vespera-4096";
    useHost(h);
    EXPECT_TRUE(served("VESPERA_EthLoopbackDiagnosticTest").empty());
    std::vector<std::string> names;
    for (const ch::Instance& t : served("VESPERA_LoopbackDiagnosticTest"))
        names.push_back(t.get_text("Name"));
    EXPECT_EQ((Texts{"Vespera:InternalLoopbackTest", "Vespera:SerdesLoopbackTest"}), names);

    // Without adapters nothing is there, not even the records of a run.
    useHost(fastHost());
    runToEnd("VESPERA_PCILoopbackDiagnosticTest", "PCILoopbackTest", "VESPERA_FCPort", FC_PORT);
    useHostFile(std::string(DTRUJ_HOSTS_DIR) + "/no-adapter.json");
    for (const char* cls : {"VESPERA_MemoryDiagnosticTest", "VESPERA_LoopbackDiagnosticTest",
             "VESPERA_PCILoopbackDiagnosticTest", "VESPERA_EthLoopbackDiagnosticTest",
             "VESPERA_DiagnosticSoftwareIdentity", "VESPERA_ConcreteJob",
             "VESPERA_DiagnosticServiceRecord", "VESPERA_DiagnosticCompletionRecord"})
        EXPECT_TRUE(served(cls).empty()) << cls;
}

} // namespace
