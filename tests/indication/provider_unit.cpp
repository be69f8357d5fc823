// The alert provider through its dispatch function alone, in this process,
// with a handler of the test's own: what the CIM bridge can't show, since
// it never enables twice and always takes what it is given.

#include <dirent.h>

#include <atomic>
#include <map>
#include <mutex>
#include <vector>

#include <gtest/gtest.h>

#include "TestSupport.h"
#include "Provider_Status.h"
#include "Registration.h"
#include "Time.h"
#include "VESPERA_AlertIndication.h"

extern "C" OLMA::sint32 __tessel_VESPERA_AlertIndication_Provider_proc(
    const OLMA::Registration*, int, void*, void*, void*, void*, void*, void*, void*, void*);
extern "C" int dtruj_sim_inject_copies(const char* json, int count);

using namespace OLMA;

namespace
{

size_t threadCount()
{
    size_t n = 0;
    if (DIR* d = opendir("/proc/self/task"))
    {
        while (dirent* e = readdir(d))
            n += e->d_name[0] != '.';
        closedir(d);
    }
    return n;
}

// What one handler was given: the sequence numbers of the alerts it took,
// how often each was offered, and the ends of its stream.
struct Received
{
    std::mutex mutex;
    std::vector<sint64> taken;
    std::map<sint64, int> offers;
    std::atomic<int> ends{0};
    bool declineFirstOffer = false;

    static bool proc(Instance* instance, void* data)
    {
        Received* self = (Received*)data;
        if (!instance)
        {
            self->ends++;
            return false;
        }
        sint64 number = ((VESPERA_AlertIndication*)instance)->SequenceNumber.value;
        unref(instance);
        std::lock_guard<std::mutex> g(self->mutex);
        bool take = !self->declineFirstOffer || self->offers[number] > 0;
        self->offers[number]++;
        if (take)
            self->taken.push_back(number);
        return take;
    }

    size_t wait(size_t count)
    {
        for (int i = 0; i < 500; i++)
        {
            {
                std::lock_guard<std::mutex> g(mutex);
                if (taken.size() >= count)
                    return taken.size();
            }
            Time::sleep(10 * Time::MSEC);
        }
        std::lock_guard<std::mutex> g(mutex);
        return taken.size();
    }
};

class AlertProvider : public ::testing::Test
{
protected:
    void* provider = nullptr;

    void SetUp() override
    {
        adapter_test::InProcessLog::path();
        ASSERT_EQ(0, call(OP_CREATE_PROVIDER, &provider));
        call(OP_LOAD, provider);
    }

    void TearDown() override
    {
        call(OP_UNLOAD, provider);
        call(OP_DESTROY_PROVIDER, provider);
    }

    static sint32 call(int op, void* a0, void* a1 = nullptr, void* a2 = nullptr)
    {
        return __tessel_VESPERA_AlertIndication_Provider_proc(0, op, a0, a1, a2, 0, 0, 0, 0, 0);
    }

    sint32 enable(Received& r)
    {
        return call(OP_ENABLE_INDICATIONS, provider, (void*)&Received::proc, &r);
    }

    sint32 disable() { return call(OP_DISABLE_INDICATIONS, provider); }

    // Thread counts once the runtimes have started their own threads.
    size_t settledThreads()
    {
        Received warm;
        enable(warm);
        disable();
        return threadCount();
    }
};

const char EVENT[] = "{\"eventCategory\":2,\"eventId\":1,\"portIndexString\":\"100000051e8a1001\"}";

TEST_F(AlertProvider, ASecondEnableKeepsTheThreadAndTheHandler)
{
    size_t threads = settledThreads();
    Received first, second;
    ASSERT_EQ(ENABLE_INDICATIONS_OK, enable(first));
    size_t on = threadCount();
    EXPECT_EQ(ENABLE_INDICATIONS_OK, enable(second));
    EXPECT_EQ(on, threadCount());

    ASSERT_EQ(2, dtruj_sim_inject_copies(EVENT, 2));
    EXPECT_EQ(2u, first.wait(2));

    adapter_test::InProcessLog log;
    EXPECT_EQ(DISABLE_INDICATIONS_OK, disable());
    EXPECT_EQ(1, first.ends.load()) << "the stream ends once";
    EXPECT_EQ(threads, threadCount());
    EXPECT_EQ(DISABLE_INDICATIONS_OK, disable());
    EXPECT_EQ(1, first.ends.load());
    EXPECT_EQ(0, second.ends.load());
    EXPECT_TRUE(second.taken.empty());
    EXPECT_EQ(1u, adapter_test::countLines(log.text(),
        {"INFO", "No subscription for event notifications happened or successful"}));
}

TEST_F(AlertProvider, AnAlertTheHandlerDeclinesIsOfferedAgainWithItsNumber)
{
    Received r;
    r.declineFirstOffer = true;
    ASSERT_EQ(ENABLE_INDICATIONS_OK, enable(r));
    ASSERT_EQ(3, dtruj_sim_inject_copies(EVENT, 3));
    ASSERT_EQ(3u, r.wait(3));
    disable();

    std::lock_guard<std::mutex> g(r.mutex);
    EXPECT_EQ(r.taken[0] + 1, r.taken[1]);
    EXPECT_EQ(r.taken[1] + 1, r.taken[2]);
    for (sint64 number : r.taken)
        EXPECT_EQ(2, r.offers[number]) << number;
}

} // namespace
