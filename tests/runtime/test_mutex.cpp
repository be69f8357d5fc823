#include <gtest/gtest.h>
#include <cerrno>
#include <thread>
#include "Mutex.h"
#include "Time.h"

using namespace OLMA;

namespace
{

int try_lock_elsewhere(Mutex& m)
{
    int r = -2;
    std::thread t([&]() {
        r = m.try_lock();
        if (r == 0)
            m.unlock();
    });
    t.join();
    return r;
}

} // namespace

TEST(Mutex, TryLockFromAnotherThread)
{
    Mutex m;
    m.lock();
    EXPECT_EQ(try_lock_elsewhere(m), EBUSY);
    m.unlock();
    EXPECT_EQ(try_lock_elsewhere(m), 0);

    // A plain mutex isn't re-entered by its holder either.
    EXPECT_EQ(m.try_lock(), 0);
    EXPECT_EQ(m.try_lock(), EBUSY);
    m.unlock();
}

TEST(Mutex, RecursiveAndScoped)
{
    Mutex m(true);
    {
        Auto_Mutex a(m);
        Auto_Mutex b(m);
        EXPECT_EQ(m.try_lock(), 0);
        m.unlock();
        EXPECT_EQ(try_lock_elsewhere(m), EBUSY);
    }
    EXPECT_EQ(try_lock_elsewhere(m), 0);
}

TEST(Time, SleepLastsAsLong)
{
    const uint64 start = Time::now();
    Time::sleep(2 * Time::SEC);
    const uint64 elapsed = Time::now() - start;
    EXPECT_GE(elapsed, 2 * Time::SEC);
    EXPECT_LT(elapsed, 2 * Time::SEC + 500 * Time::MSEC);

    const uint64 t = Time::now();
    Time::sleep(0);
    EXPECT_LT(Time::now() - t, 100 * Time::MSEC);

    // The clock is the wall clock, in microseconds.
    EXPECT_NEAR((double)(Time::now() / Time::SEC), (double)time(0), 2.0);
}
