// The helper's own guards, in the test process: requests that come
// together start one test, and a stop ends a run at its next step.
#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <thread>
#include <vector>

#include "DiagnosticHelper.h"
#include "TestSupport.h"

using namespace OLMA;

namespace
{

DiagnosticHelper* helper()
{
    return DiagnosticHelper::getDiagnosticHelperObject();
}

void waitIdle()
{
    for (int i = 0; i < 1000 && helper()->isAnyJobRunning(); i++)
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    ASSERT_FALSE(helper()->isAnyJobRunning());
    helper()->stopTests();
}

TEST(DiagnosticHelperRace, RequestsThatComeTogetherStartOneTest)
{
    adapter_test::InProcessLog::path();

    for (int round = 0; round < 3; round++)
    {
        const int n = 8;
        std::atomic<int> ready(0);
        std::vector<uint32> status(n);
        std::vector<std::thread> threads;

        for (int i = 0; i < n; i++)
            threads.emplace_back([&, i] {
                ready++;
                while (ready.load() < n)
                    std::this_thread::yield();
                // Every kind of runner, so that no handle is shared.
                DiagnosticRunResult* r = i % 2 ?
                    helper()->runPCILoopbackTest("100000051e8a1001") :
                    helper()->runEthLoopbackTest("00051e8b2002", "Vespera:SerdesEthLoopbackTest");
                status[i] = r->status;
                delete r;
            });

        for (std::thread& t : threads)
            t.join();

        int started = 0;
        for (uint32 s : status)
        {
            started += s == 4096;
            EXPECT_TRUE(s == 4096 || s == 4) << s;
        }
        EXPECT_EQ(1, started) << "round " << round;
        waitIdle();
    }
}

TEST(DiagnosticHelperRace, AJobIsFoundByItsNameInAnyCase)
{
    DiagnosticTestInput input;
    input.testId = DIAG_PCI_LOOPBACK_TEST;
    input.elementClass = ID_VESPERA_FCPort;
    DiagnosticJob job = helper()->createDiagnosticJob(&input);
    helper()->addDiagnosticJob(job);
    ASSERT_TRUE(helper()->isAnyJobRunning());

    String other(job.name);
    for (size_t i = 0; i < other.size(); i++)
        other.set(i, (char)toupper((unsigned char)other[i]));
    helper()->updateJobState(other);

    DiagnosticJob latest;
    ASSERT_TRUE(helper()->getLatestJob(latest));
    EXPECT_EQ(7, latest.jobState);
    EXPECT_EQ(100, latest.percentComplete);
    EXPECT_FALSE(helper()->isAnyJobRunning());
}

} // namespace
