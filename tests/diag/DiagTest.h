// Diagnostic runs as a WBEM client makes them through the stand-in CIM
// server: find a test and an element, call RunDiagnostic, poll the job,
// read the records of the run. The simulator's host is the default one
// with short test durations, so that a run takes little more than the
// port's settling pauses.
#ifndef _VSPR_diag_DiagTest_h
#define _VSPR_diag_DiagTest_h

#include <algorithm>
#include <chrono>
#include <thread>

#include "ProvidersSupport.h"

extern "C" char* dtruj_sim_calls(void);
extern "C" void dtruj_sim_clear_calls(void);

namespace diag_test
{

using namespace providers_test;

const char* const FC_HBA = "200000051e8a1000";
const char* const FC_PORT = "100000051e8a1001";
const char* const CNA = "00051e8b2000";
const char* const FCOE_PORT = "100000051e8b2001";
const char* const ETH_PORT = "00051e8b2002";

// One record as a client reads it.
struct Record
{
    std::string id;
    std::string text;
    unsigned state;     // CompletionState; 0 for a service record
};

// What a run left: its job and its records, oldest first.
struct TestRun
{
    uint32_t status = 0;
    std::string job;            // InstanceID of the job, "" if none
    std::vector<Record> service;
    std::vector<Record> completion;

    std::vector<std::string> serviceTexts() const
    {
        std::vector<std::string> t;
        for (const Record& r : service)
            t.push_back(r.text);
        return t;
    }

    std::vector<std::string> completionTexts() const
    {
        std::vector<std::string> t;
        for (const Record& r : completion)
            t.push_back(r.text);
        return t;
    }
};

inline Json::Value simCalls()
{
    char* text = dtruj_sim_calls();
    Json::Value v = parseJson(text ? text : "[]");
    free(text);
    return v;
}

// The entries called, in order, of those named.
inline std::vector<std::string> calledOf(const std::vector<std::string>& names)
{
    std::vector<std::string> seen;
    for (const Json::Value& c : simCalls())
        for (const std::string& n : names)
            if (c["entry"].asString() == n)
                seen.push_back(n);
    return seen;
}

class DiagTest : public ProvidersTest
{
protected:
    // The default host with the given diagnostics, durations short.
    static Json::Value fastHost()
    {
        Json::Value h = defaultHost();
        Json::Value& d = h["diagnostics"];
        for (const char* t : {"loopback", "ethLoopback", "pciLoopback", "memory"})
            d[t]["durationMs"] = 20;
        return h;
    }

    void SetUp() override
    {
        ProvidersTest::SetUp();
        useHost(fastHost());
    }

    void TearDown() override
    {
        // No test thread may outlive its test: the next one starts from a
        // clean host.
        waitIdle();
        ProvidersTest::TearDown();
    }

    static ch::Object_Path testPath(const std::string& cls, const std::string& name)
    {
        ch::Result r = ein(cls);
        for (const ch::Object_Path& p : r.paths)
            if (p.key("Name") && p.key("Name")->str == name)
                return p;
        ADD_FAILURE() << cls << " offers no " << name;
        return classPath(cls);
    }

    static ch::Object_Path elementPath(const std::string& cls, const std::string& deviceId)
    {
        for (const ch::Object_Path& p : ein(cls).paths)
            if (p.key("DeviceID") && p.key("DeviceID")->str == deviceId)
                return p;
        ADD_FAILURE() << "no " << cls << " " << deviceId;
        ch::Object_Path p = classPath(cls);
        return p;
    }

    static void setKey(ch::Object_Path& path, const std::string& name, const std::string& value)
    {
        for (ch::Property& k : path.keys)
            if (k.name == name)
                k.value = ch::Value::of_string(value);
    }

    static ch::Result runDiagnostic(const ch::Object_Path& test, const ch::Object_Path& element)
    {
        std::vector<ch::Property> in(1);
        in[0].name = "ManagedElement";
        in[0].value = ch::Value::of_ref(element);
        return host->cm(test, "RunDiagnostic", in);
    }

    // Starts a test; status and job name in the run.
    static TestRun start(const std::string& testClass, const std::string& testName,
        const std::string& elementClass, const std::string& deviceId)
    {
        ch::Result r = runDiagnostic(testPath(testClass, "Vespera:" + testName),
            elementPath(elementClass, deviceId));
        TestRun run;
        EXPECT_EQ(CMPI_RC_OK, r.rc) << r.message;
        run.status = r.return_value.num.uint32;
        for (const ch::Property& o : r.out)
            if (o.name == "Job" && !o.value.null && o.value.ref)
                if (const ch::Value* id = o.value.ref->key("InstanceID"))
                    run.job = id->str;
        return run;
    }

    static std::vector<ch::Instance> jobs()
    {
        return served("VESPERA_ConcreteJob");
    }

    static unsigned jobState(const std::string& job)
    {
        for (const ch::Instance& j : jobs())
            if (j.get_text("InstanceID") == job)
                return j.get("JobState")->num.uint16;
        return 0;
    }

    // The records of a job, oldest first.
    static std::vector<Record> records(const std::string& cls, const std::string& job)
    {
        std::vector<Record> out;
        for (const ch::Instance& i : served(cls))
        {
            std::string id = i.get_text("InstanceID");
            if (id.compare(0, job.size() + 1, job + ":") != 0)
                continue;
            const ch::Value* state = i.get("CompletionState");
            out.push_back({id, i.get_text("RecordData"), state && !state->null ? state->num.uint16 : 0u});
        }
        return out;
    }

    // Waits until the job is completed and its last verdict is written (the
    // job completes a moment before its last records): completion records
    // stop coming. Fails after the timeout.
    static void await(TestRun& run, int timeoutMs = 15000)
    {
        auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(timeoutMs);
        size_t seen = (size_t)-1;
        while (std::chrono::steady_clock::now() < end)
        {
            if (jobState(run.job) == 7)
            {
                std::vector<Record> c = records("VESPERA_DiagnosticCompletionRecord", run.job);
                if (!c.empty() && c.size() == seen)
                    break;
                seen = c.size();
            }
            std::this_thread::sleep_for(std::chrono::milliseconds(30));
        }
        ASSERT_EQ(7u, jobState(run.job)) << run.job << " didn't complete";
        run.service = records("VESPERA_DiagnosticServiceRecord", run.job);
        run.completion = records("VESPERA_DiagnosticCompletionRecord", run.job);
    }

    static TestRun runToEnd(const std::string& testClass, const std::string& testName,
        const std::string& elementClass, const std::string& deviceId)
    {
        TestRun run = start(testClass, testName, elementClass, deviceId);
        EXPECT_EQ(4096u, run.status) << testName << " on " << deviceId;
        if (run.status == 4096u)
            await(run);
        return run;
    }

    // Until no job runs.
    static void waitIdle()
    {
        for (int i = 0; i < 500; i++)
        {
            bool running = false;
            for (const ch::Instance& j : jobs())
                running = running || j.get("JobState")->num.uint16 == 4;
            if (!running)
                return;
            std::this_thread::sleep_for(std::chrono::milliseconds(30));
        }
        ADD_FAILURE() << "a job still runs";
    }

    // The port's state as the simulator holds it.
    static bool portEnabled(const std::string& plain)
    {
        Json::Value h = simDump();
        for (const Json::Value& a : h["adapters"])
            for (const char* list : {"fcPorts", "ethPorts"})
                for (const Json::Value& p : a[list])
                {
                    std::string addr = p.get(list[0] == 'f' ? "wwn" : "mac", "").asString();
                    addr.erase(std::remove(addr.begin(), addr.end(), ':'), addr.end());
                    if (addr == plain)
                        return p.get("portStatus", true).asBool();
                }
        ADD_FAILURE() << "no port " << plain;
        return false;
    }

    static bool adapterEnabled(int place)
    {
        return simDump()["adapters"][place]["hbaData"].get("hbaStatus", true).asBool();
    }
};

} // namespace diag_test

#endif
