// Each kind of test on the kinds of element it is for, passing and failing:
// the records a client reads, the calls the library got, and the port or
// adapter as the run left it.
#include "DiagTest.h"

using namespace diag_test;

namespace
{

typedef std::vector<std::string> Texts;

const Texts FC_LOOPBACK_STEPS = {
    "Checking whether the port is disabled for running loopback test", "Port is not disabled",
    "Disabling the port", "Running loopback test for the port", "Enabling the port",
    "Checking for return codes for loopback test run"};

const Texts ETH_LOOPBACK_STEPS = {
    "Checking whether the port is disabled for running eth loopback test",
    "Port is not disabled", "Disabling the port", "Running eth loopback test for the port",
    "Enabling the port", "Checking for return codes for eth loopback test run"};

std::vector<unsigned> states(const TestRun& run)
{
    std::vector<unsigned> s;
    for (const Record& r : run.completion)
        s.push_back(r.state);
    return s;
}

// The request of the latest call of an entry.
Json::Value requestOf(const std::string& entry)
{
    Json::Value calls = simCalls();
    for (Json::ArrayIndex i = calls.size(); i-- > 0;)
        if (calls[i]["entry"].asString() == entry)
            return calls[i]["request"];
    ADD_FAILURE() << entry << " wasn't called";
    return Json::Value();
}

class DiagRuns : public DiagTest
{
};

TEST_F(DiagRuns, FCLoopbackOnAnHBAPortTakesThePortOutAndBack)
{
    // An FC HBA's port isn't FCoE: its internal loopback is offered and runs.
    TestRun run = runToEnd("VESPERA_LoopbackDiagnosticTest", "InternalLoopbackTest",
        "VESPERA_FCPort", FC_PORT);

    EXPECT_EQ(FC_LOOPBACK_STEPS, run.serviceTexts());
    EXPECT_EQ(Texts{"Loopback test run is successful"}, run.completionTexts());
    EXPECT_EQ(std::vector<unsigned>{2}, states(run));
    for (const Record& r : run.service)
        EXPECT_EQ(0u, r.state);

    EXPECT_EQ((Texts{"setPortByWwn", "diagLoopbackTest", "setPortByWwn"}),
        calledOf({"setPortByWwn", "diagLoopbackTest"}));
    Json::Value req = requestOf("diagLoopbackTest");
    EXPECT_EQ("10:00:00:05:1e:8a:10:01", req["portWwn"].asString());
    EXPECT_EQ(1u, req["mode"].asUInt());
    EXPECT_EQ(4u, req["speed"].asUInt());
    EXPECT_EQ(131072u, req["frameCount"].asUInt());
    EXPECT_EQ(0xB5B5B5B5u, req["dataPattern"].asUInt());
    EXPECT_TRUE(portEnabled(FC_PORT));

    // The job stays readable, completed.
    std::vector<ch::Instance> j = jobs();
    ASSERT_EQ(1u, j.size());
    EXPECT_EQ(run.job, j[0].get_text("Name"));
    EXPECT_EQ(100u, j[0].get("PercentComplete")->num.uint16);
    EXPECT_EQ("00000000000000.000000:000", j[0].get_text("ElapsedTime"));
}

TEST_F(DiagRuns, FCoEPortHasNoInternalLoopbackAndReportsItsFailureInFull)
{
    Json::Value h = fastHost();
    Json::Value& lb = h["adapters"][1]["fcPorts"][0]["diag"]["loopback"];
    lb["failed"] = true;
    lb["output"] = "CRC mismatch";
    lb["BadFrameNo"] = 2;
    useHost(h);

    TestRun refused = start("VESPERA_LoopbackDiagnosticTest", "InternalLoopbackTest",
        "VESPERA_FCPort", FCOE_PORT);
    EXPECT_EQ(1u, refused.status);
    EXPECT_EQ("", refused.job);
    EXPECT_TRUE(jobs().empty());

    TestRun run = runToEnd("VESPERA_LoopbackDiagnosticTest", "SerdesLoopbackTest",
        "VESPERA_FCPort", FCOE_PORT);
    EXPECT_EQ(FC_LOOPBACK_STEPS, run.serviceTexts());
    EXPECT_EQ((Texts{"Loopback test failed", "Tx frames = 131072, Rx frames = 129024, OSF frames = 3",
                  "Mis-match frame number = 2; Mis-match frame info = 0",
                  "Loopback test run status : CRC mismatch"}),
        run.completionTexts());
    EXPECT_EQ((std::vector<unsigned>{5, 5, 5, 5}), states(run));
    EXPECT_EQ(4u, requestOf("diagLoopbackTest")["mode"].asUInt());
    EXPECT_TRUE(portEnabled(FCOE_PORT));
}

TEST_F(DiagRuns, EthernetLoopbackPassesAndFails)
{
    TestRun pass = runToEnd("VESPERA_EthLoopbackDiagnosticTest", "ExternalEthLoopbackTest",
        "VESPERA_EthernetPort", ETH_PORT);
    EXPECT_EQ(ETH_LOOPBACK_STEPS, pass.serviceTexts());
    EXPECT_EQ(Texts{"Eth loopback test run is successful"}, pass.completionTexts());
    Json::Value req = requestOf("diagEthLoopbackTest");
    EXPECT_EQ("00:05:1e:8b:20:02", req["portWwn"].asString());
    EXPECT_EQ(8u, req["mode"].asUInt());
    EXPECT_EQ(65536u, req["frameCount"].asUInt());
    EXPECT_FALSE(req.isMember("speed"));
    EXPECT_TRUE(portEnabled(ETH_PORT));

    Json::Value h = fastHost();
    h["diagnostics"]["ethLoopback"]["failed"] = true;
    h["diagnostics"]["ethLoopback"]["output"] = "no signal";
    useHost(h);

    // No mismatched frames: three statements of the failure.
    TestRun fail = runToEnd("VESPERA_EthLoopbackDiagnosticTest", "SerdesEthLoopbackTest",
        "VESPERA_EthernetPort", ETH_PORT);
    EXPECT_EQ((Texts{"Eth loopback test failed", "Tx frames = 65536, Rx frames = 64512, OSF frames = 3",
                  "EthLoopback test run status : no signal"}),
        fail.completionTexts());
    EXPECT_EQ((std::vector<unsigned>{5, 5, 5}), states(fail));
    EXPECT_TRUE(portEnabled(ETH_PORT));
}

TEST_F(DiagRuns, PCILoopbackLeavesThePortInService)
{
    Json::Value h = fastHost();
    h["adapters"][1]["ethPorts"][0]["diag"]["pciLoopback"]["failed"] = true;
    h["adapters"][1]["ethPorts"][0]["diag"]["pciLoopback"]["output"] = "DMA timeout";
    useHost(h);

    for (const char* port : {FC_PORT, FCOE_PORT})
    {
        TestRun run = runToEnd("VESPERA_PCILoopbackDiagnosticTest", "PCILoopbackTest",
            "VESPERA_FCPort", port);
        EXPECT_EQ((Texts{"Running PCI Loopback test for the port",
                      "Checking for return codes for PCI Loopback test run"}),
            run.serviceTexts());
        EXPECT_EQ(Texts{"PCI Loopback test run is successful"}, run.completionTexts());
    }

    TestRun fail = runToEnd("VESPERA_PCILoopbackDiagnosticTest", "PCILoopbackTest",
        "VESPERA_EthernetPort", ETH_PORT);
    EXPECT_EQ((Texts{"PCILoopback test run status : DMA timeout", "PCI Loopback test failed"}),
        fail.completionTexts());
    EXPECT_EQ((std::vector<unsigned>{5, 5}), states(fail));
    EXPECT_TRUE(calledOf({"setPortByWwn", "setAdapterState"}).empty());
    EXPECT_EQ("00:05:1e:8b:20:02", requestOf("diagPCILoopbackTest")["portWwn"].asString());
}

TEST_F(DiagRuns, MemoryTestOfAnEnabledAndADisabledAdapter)
{
    TestRun run = runToEnd("VESPERA_MemoryDiagnosticTest", "MemoryTest",
        "VESPERA_PortController", FC_HBA);
    EXPECT_EQ((Texts{"Checking whether the adapter is disabled for running memory test",
                  "Adapter is not disabled", "Disabling the adapter for running memory test",
                  "Running memory test on the adapter", "Running memory test may take a few moments",
                  "Enabling the adapter after running memory test",
                  "Checking for return codes for memory test run"}),
        run.serviceTexts());
    EXPECT_EQ(Texts{"Memory test run is successful"}, run.completionTexts());
    EXPECT_EQ((Texts{"setAdapterState", "diagMemoryTest", "setAdapterState"}),
        calledOf({"setAdapterState", "diagMemoryTest"}));
    EXPECT_EQ("20:00:00:05:1e:8a:10:00", requestOf("diagMemoryTest")["hbaWwn"].asString());
    EXPECT_TRUE(adapterEnabled(0));

    // A CNA, named by its MAC, that was out of service already and whose
    // memory fails: it stays out of service, and the details go to the log.
    Json::Value h = fastHost();
    h["adapters"][1]["hbaData"]["hbaStatus"] = false;
    h["adapters"][1]["diag"]["memory"]["failed"] = true;
    h["adapters"][1]["diag"]["memory"]["status"] = 7;
    useHost(h);
    LogMark mark;

    TestRun fail = runToEnd("VESPERA_MemoryDiagnosticTest", "MemoryTest",
        "VESPERA_PortController", CNA);
    EXPECT_EQ((Texts{"Checking whether the adapter is disabled for running memory test",
                  "Adapter is already disabled", "Running memory test on the adapter",
                  "Running memory test may take a few moments",
                  "Checking for return codes for memory test run"}),
        fail.serviceTexts());
    EXPECT_EQ(Texts{"Memory test failed"}, fail.completionTexts());
    EXPECT_EQ(std::vector<unsigned>{5}, states(fail));
    EXPECT_TRUE(calledOf({"setAdapterState"}).empty());
    EXPECT_EQ("00:05:1e:8b:20:00", requestOf("diagMemoryTest")["hbaWwn"].asString());
    EXPECT_FALSE(adapterEnabled(1));
    EXPECT_EQ(1u, countLines(mark.text(), {"INFO", "Status         :\t0x7"}));
}

TEST_F(DiagRuns, RecordsNameTheirElementAndService)
{
    TestRun run = runToEnd("VESPERA_PCILoopbackDiagnosticTest", "PCILoopbackTest",
        "VESPERA_EthernetPort", ETH_PORT);
    std::string portName;
    for (const ch::Instance& p : served("VESPERA_EthernetPort"))
        if (p.get_text("DeviceID") == ETH_PORT)
            portName = p.get_text("ElementName");
    ASSERT_FALSE(portName.empty());

    for (const char* cls : {"VESPERA_DiagnosticServiceRecord", "VESPERA_DiagnosticCompletionRecord"})
        for (const ch::Instance& r : served(cls))
        {
            EXPECT_EQ(portName, r.get_text("ManagedElementName")) << cls;
            EXPECT_EQ("Vespera:PCILoopbackTest", r.get_text("ServiceName")) << cls;
            EXPECT_EQ(std::string(cls).find("Service") != std::string::npos ? "4" : "6",
                r.get_text("RecordType")) << cls;
            EXPECT_EQ("", r.get_text("RecordFormat"));
            EXPECT_FALSE(r.get("CreationTimeStamp")->null);
        }
}

} // namespace
