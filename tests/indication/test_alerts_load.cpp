// Many alerts, and indications turned off, on and unloaded under a stream
// of events, on a clock a hundred times faster than the module's real one
// (FastClock.h): 1,000 alerts take a second or so instead of twenty.

#include "AlertSupport.h"
#include "FastClock.h"

#include <atomic>
#include <regex>
#include <thread>

using namespace alerts_test;

namespace
{

typedef std::chrono::steady_clock Clock;

long msSince(Clock::time_point start)
{
    return long(std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - start).count());
}

// The number after prefix in a message, -1 for another message.
long numberIn(const ch::Instance& alert, const std::string& prefix)
{
    std::string m = alert.get_text("Message");
    return m.compare(0, prefix.size(), prefix) == 0 ? std::stol(m.substr(prefix.size())) : -1;
}

// Alerts numbered in rising order with `gaps` numbers missing in all, and
// carrying the events' own numbers strictly increasing: in order, none
// twice.
void expectInOrderOnce(const std::vector<ch::Instance>& got, const std::string& prefix,
                       size_t gaps = 0)
{
    size_t missing = 0;
    for (size_t i = 1; i < got.size(); i++)
    {
        ASSERT_LT(sequence(got[i - 1]), sequence(got[i])) << i;
        ASSERT_LT(numberIn(got[i - 1], prefix), numberIn(got[i], prefix)) << i;
        missing += size_t(sequence(got[i]) - sequence(got[i - 1]) - 1);
    }
    EXPECT_EQ(gaps, missing);
}

// Sends events "<prefix><n>" one after the other while it lives, and
// counts those that the library took.
class Feeder
{
public:
    explicit Feeder(const std::string& prefix) :
        _thread([this, prefix] {
            while (!_stop)
            {
                std::string e = compact(event(2, 1, prefix + std::to_string(_accepted)));
                if (dtruj_sim_inject_event(e.c_str()) == 0)
                    _accepted++;
                usleep(300);
            }
        })
    {
    }

    ~Feeder() { stop(); }

    int stop()
    {
        _stop = true;
        if (_thread.joinable())
            _thread.join();
        return _accepted;
    }

private:
    std::atomic<bool> _stop{false};
    std::atomic<int> _accepted{0};
    std::thread _thread;
};

class AlertLoad : public AlertTest
{
protected:
    void SetUp() override
    {
        AlertTest::SetUp();
        fast_clock::setDivisor(100);
    }

    void TearDown() override
    {
        fast_clock::resume();
        AlertTest::TearDown();
    }

    // Every event that the library handed to the module since `handed`
    // (the library's count then) went to the bridge once: waits for a
    // sentinel event behind them, and returns the alerts that arrived
    // before it. An alert that reaches the bridge while no filter is
    // active (a server deactivates the last filter before it disables)
    // goes nowhere, as it should; `unfiltered` tells how many did.
    std::vector<ch::Instance> everythingSince(unsigned long handed, const LogMark& mark)
    {
        alertsOf(Json::Value(Json::arrayValue), 60000);
        std::vector<ch::Instance> all = alerts();
        all.resize(all.size() - 1);
        // The provider logs a delivery once the handler has returned, just
        // after the client may have seen it.
        unsigned long expected = dtruj_sim_events_delivered() - handed;
        size_t sent = 0;
        for (int i = 0; i < 200 && sent < expected; i++, usleep(10000))
            sent = countLines(mark.text(), {"INFO", "Delivered indication to the CIM server"});
        EXPECT_EQ(expected, sent) << "lost or doubled";
        unfiltered = sent - 1 - all.size();
        return all;
    }

    size_t unfiltered = 0;

    // The threads of this process once indications have been on and off,
    // so that those which a runtime starts once are there already.
    size_t settledThreadCount()
    {
        EXPECT_TRUE(unsubscribe(subscribe()).ok());
        return threadCount();
    }
};

TEST_F(AlertLoad, ABurstOfAThousandArrivesWholeInOrder)
{
    subscribe();
    Json::Value events(Json::arrayValue);
    for (int i = 0; i < 1000; i++)
    {
        events.append(event(2, 11, "burst-" + std::to_string(i)));
        if (i % 10 == 0)
            events.append("{\"eventCategory\": 2, \"eventId\": \"broken\"}");
    }

    Clock::time_point start = Clock::now();
    std::vector<ch::Instance> got = alertsOf(events, 60000);
    long ms = msSince(start);
    ASSERT_EQ(1000u, got.size());
    EXPECT_EQ(0, numberIn(got.front(), "burst-"));
    EXPECT_EQ(999, numberIn(got.back(), "burst-"));
    expectInOrderOnce(got, "burst-");
    RecordProperty("burst_ms", int(ms));
    printf("1,000 alerts in %ld ms on the fast clock\n", ms);
}

TEST_F(AlertLoad, TheQueueKeepsTheNewest)
{
    const int sent = 5000, bound = 4096;
    subscribe();
    unsigned long handed = dtruj_sim_events_delivered();

    // The delivery thread stands still while the library queues them all.
    fast_clock::pause();
    LogMark mark;
    Json::Value events(Json::arrayValue);
    for (int i = 0; i < sent; i++)
        events.append(event(2, 1, "q-" + std::to_string(i)));
    ASSERT_EQ(sent, dtruj_sim_inject_list(compact(events).c_str()));
    Clock::time_point start = Clock::now();
    while (dtruj_sim_events_delivered() < handed + sent && msSince(start) < 60000)
        usleep(10000);
    ASSERT_EQ(handed + sent, dtruj_sim_events_delivered());

    // One alert may have left before the thread's pause began.
    size_t early = alerts().size();
    ASSERT_LE(early, 1u);
    std::string log = mark.text();
    std::regex line("WARN: .*Alert queue full \\(4096 alerts\\): dropped the oldest, "
                    "SequenceNumber ([0-9]+); ([0-9]+) dropped so far");
    std::vector<int64_t> dropped;
    for (std::sregex_iterator i(log.begin(), log.end(), line), end; i != end; ++i)
        dropped.push_back(std::stoll((*i)[1]));
    ASSERT_EQ(size_t(sent - bound) - early, dropped.size());

    fast_clock::resume();
    ASSERT_TRUE(waitAlerts(sent - dropped.size(), 60000));
    usleep(50000);
    std::vector<ch::Instance> got = alerts();
    ASSERT_EQ(sent - dropped.size(), got.size());
    for (size_t i = early + 1; i < got.size(); i++)
        ASSERT_EQ(numberIn(got[i - 1], "q-") + 1, numberIn(got[i], "q-"));
    EXPECT_EQ(long(early + dropped.size()), numberIn(got[early], "q-"));

    // The dropped are the oldest: the numbers between the one that left
    // early, if any, and the first delivered after the pause.
    int64_t first = sequence(got[early]) - int64_t(dropped.size());
    for (size_t i = 0; i < dropped.size(); i++)
        ASSERT_EQ(first + int64_t(i), dropped[i]);
    if (early)
    {
        EXPECT_EQ(sequence(got[0]) + 1, first);
    }
}

TEST_F(AlertLoad, FiftyDisableEnableCyclesLoseNothing)
{
    size_t threads = settledThreadCount();
    LogMark mark;
    unsigned long handed = dtruj_sim_events_delivered();
    int id = subscribe();
    Feeder feeder("c-");
    ASSERT_TRUE(waitAlerts(5, 10000));

    Clock::time_point start = Clock::now();
    for (int cycle = 0; cycle < 50; cycle++)
    {
        ASSERT_TRUE(unsubscribe(id).ok()) << cycle;
        id = subscribe();
        ASSERT_NE(0, id);
        usleep(2000);
    }
    long ms = msSince(start);
    EXPECT_LT(ms, 10000) << "50 cycles";
    int accepted = feeder.stop();

    // The delivery thread hands on one alert a pass: at most one can fall
    // between a cycle's last filter and its disable.
    std::vector<ch::Instance> got = everythingSince(handed, mark);
    EXPECT_LE(got.size() + unfiltered, size_t(accepted));
    EXPECT_LE(unfiltered, 50u);
    expectInOrderOnce(got, "c-", unfiltered);
    printf("50 cycles in %ld ms; %zu alerts, %zu sent while no filter was active\n", ms,
           got.size(), unfiltered);

    ASSERT_TRUE(unsubscribe(id).ok());
    EXPECT_EQ(threads, threadCount()) << "a thread left behind";
}

TEST_F(AlertLoad, UnloadWhileEventsArriveLosesNothing)
{
    size_t threads = settledThreadCount();
    LogMark mark;
    unsigned long handed = dtruj_sim_events_delivered();
    subscribe();
    Feeder feeder("u-");
    ASSERT_TRUE(waitAlerts(20, 10000));

    LogMark unload;
    EXPECT_EQ(0, host->cleanup(false));
    EXPECT_NE(std::string::npos, unload.text().find("Stopping the indication thread created."));
    usleep(20000);

    // A provider made anew delivers what the old one left in the queue.
    int id = subscribe();
    ASSERT_TRUE(waitAlerts(alerts().size() + 5, 10000));
    feeder.stop();
    std::vector<ch::Instance> got = everythingSince(handed, mark);
    EXPECT_EQ(0u, unfiltered);
    expectInOrderOnce(got, "u-");

    ASSERT_TRUE(unsubscribe(id).ok());
    host->cleanup(false);
    EXPECT_EQ(threads, threadCount()) << "a thread left behind";
}

TEST_F(AlertLoad, AnEventThatComesLateIsDroppedSafely)
{
    subscribe();
    OLMA::EventProcessCB callback = dtruj_sim_event_callback();
    ASSERT_TRUE(callback != nullptr);

    // A library that goes on calling, from a thread of its own, while the
    // provider is unloaded and after.
    std::atomic<bool> stop{false};
    std::atomic<int> calls{0};
    std::thread late([&] {
        std::string e = compact(event(2, 1, "late"));
        while (!stop)
        {
            callback(e.c_str());
            calls++;
        }
    });
    while (calls < 50)
        usleep(1000);

    LogMark mark;
    host->cleanup(false);
    int after = calls;
    while (calls < after + 50)
        usleep(1000);
    stop = true;
    late.join();

    EXPECT_GE(countLines(mark.text(), {"INFO", "An event arrived while indications are off; dropped"}),
              50u);
    EXPECT_EQ(0u, countLines(mark.text(), {"ERR", "An event was dropped"}));
}

} // namespace
