// Events reach the registered callback on the library's own thread.
#include "Lib.h"

#include <atomic>
#include <chrono>
#include <cstring>
#include <fcntl.h>
#include <mutex>
#include <sys/stat.h>
#include <thread>
#include <unistd.h>
#include <vector>

using namespace dtrujtest;

namespace {

std::mutex gMtx;
std::vector<std::string> gEvents;
std::vector<std::thread::id> gThreads;

void onEvent(const char* text)
{
    std::lock_guard<std::mutex> g(gMtx);
    gEvents.push_back(text);
    gThreads.push_back(std::this_thread::get_id());
}

size_t waitFor(size_t n, int ms = 2000)
{
    for (int i = 0; i < ms / 10; ++i) {
        {
            std::lock_guard<std::mutex> g(gMtx);
            if (gEvents.size() >= n)
                return gEvents.size();
        }
        usleep(10000);
    }
    std::lock_guard<std::mutex> g(gMtx);
    return gEvents.size();
}

class DtrujEvents : public ::testing::Test {
protected:
    Lib lib;
    void SetUp() override
    {
        unsetenv("DTRUJ_HOST");
        unsetenv("DTRUJ_EVENTS");
        lib.reset();
        std::lock_guard<std::mutex> g(gMtx);
        gEvents.clear();
        gThreads.clear();
    }
    void TearDown() override
    {
        lib.sym<OLMA::evtProcessCBRetVoidFP>("registerEventProcessingCb")(nullptr);
        lib.call("unregister_for_events");
    }
    void subscribe()
    {
        lib.sym<OLMA::evtProcessCBRetVoidFP>("registerEventProcessingCb")(onEvent);
        ASSERT_FALSE(isError(lib.call("register_for_events", obj({{"dropOldEvents", true}}))));
    }
};

TEST_F(DtrujEvents, InjectedEventsArriveOnTheLibraryThread)
{
    EXPECT_EQ(-1, lib.inject("{\"eventCategory\":2,\"eventId\":1}"));   // nobody listens yet
    subscribe();
    ASSERT_EQ(0, lib.inject("{\"eventCategory\":2,\"eventId\":1}"));
    ASSERT_EQ(0, lib.inject("not json at all"));   // delivered as it is: the module judges
    ASSERT_EQ(2u, waitFor(2));
    std::lock_guard<std::mutex> g(gMtx);
    EXPECT_EQ("{\"eventCategory\":2,\"eventId\":1}", gEvents[0]);
    EXPECT_EQ("not json at all", gEvents[1]);
    EXPECT_NE(std::this_thread::get_id(), gThreads[0]);
}

TEST_F(DtrujEvents, StateChangesRaiseTheirEvents)
{
    subscribe();
    lib.call("setPortByWwn", obj({{"indexStr", FC_PORT1}, {"port", obj({{"portStatus", false}})},
                                  {"propArray", strArray({"portStatus"})}}));
    lib.call("setEthPort", obj({{"mac", ETH_PORT}, {"ethPort", obj({{"portStatus", false}})},
                                {"propArray", strArray({"portStatus"})}}));
    ASSERT_EQ(2u, waitFor(2));
    Json::Reader reader;
    Json::Value fc, eth;
    {
        std::lock_guard<std::mutex> g(gMtx);
        ASSERT_TRUE(reader.parse(gEvents[0], fc));
        ASSERT_TRUE(reader.parse(gEvents[1], eth));
    }
    EXPECT_EQ(2, fc["eventCategory"].asInt());
    EXPECT_EQ(8, fc["eventId"].asInt());
    EXPECT_EQ("100000051e8a1002", fc["portIndexString"].asString());   // the plain form names the port
    EXPECT_EQ(FC_PORT1, fc["basePortWWN"].asString());
    EXPECT_EQ(0, fc["eventIdValue"].asString().compare(0, 4, "TRU_"));
    EXPECT_TRUE(fc["eventSeverity"].isInt());
    EXPECT_TRUE(fc["eventMsg"].isString());
    EXPECT_EQ(10, eth["eventCategory"].asInt());
    EXPECT_EQ(4, eth["eventId"].asInt());
    EXPECT_EQ("00051e8b2002", eth["portIndexString"].asString());
}

TEST_F(DtrujEvents, BurstsArriveBackToBackInOrder)
{
    EXPECT_EQ(-1, lib.injectCopies("{}", 3));   // nobody listens yet
    subscribe();
    unsigned long before = lib.eventsDelivered();
    EXPECT_EQ(200, lib.injectCopies("{\"eventCategory\":2,\"eventId\":1}", 200));
    // Strings go as they are, anything else as compact JSON.
    EXPECT_EQ(3, lib.injectList("[{\"eventCategory\": 8, \"eventId\": 2}, \"{broken\", 7]"));
    EXPECT_EQ(-1, lib.injectList("{\"eventCategory\":2}"));
    EXPECT_EQ(-1, lib.injectList("[unterminated"));
    ASSERT_EQ(203u, waitFor(203));
    EXPECT_EQ(before + 203, lib.eventsDelivered());
    std::lock_guard<std::mutex> g(gMtx);
    EXPECT_EQ("{\"eventCategory\":2,\"eventId\":1}", gEvents[199]);
    EXPECT_EQ("{\"eventCategory\":8,\"eventId\":2}", gEvents[200]);
    EXPECT_EQ("{broken", gEvents[201]);
    EXPECT_EQ("7", gEvents[202]);
}

TEST_F(DtrujEvents, AdapterAndLinkChangesRaiseWhatTheAdapterWould)
{
    subscribe();
    Json::Value off = obj({{"portStatus", false}});
    lib.call("setPortByWwn", obj({{"indexStr", FCOE_PORT}, {"port", off},
                                  {"propArray", strArray({"portStatus"})}}));
    ASSERT_EQ(1u, waitFor(1));
    // The port that is off already raises nothing with its adapter; the
    // Ethernet port goes off with it.
    lib.call("setAdapterState", obj({{"indexStr", CNA}, {"enableState", false}}));
    lib.call("setPortByWwn", obj({{"indexStr", FC_PORT0}, {"port", obj({{"linkUp", false}})},
                                  {"propArray", strArray({"linkUp"})}}));
    lib.call("setEthPort", obj({{"mac", ETH_PORT}, {"ethPort", obj({{"linkUp", true}})},
                                {"propArray", strArray({"linkUp"})}}));   // no change, no event
    lib.call("setEthPort", obj({{"mac", ETH_PORT}, {"ethPort", obj({{"linkUp", false}})},
                                {"propArray", strArray({"linkUp"})}}));
    ASSERT_EQ(4u, waitFor(4));
    usleep(100000);
    std::vector<std::string> seen;
    {
        std::lock_guard<std::mutex> g(gMtx);
        ASSERT_EQ(4u, gEvents.size());
        for (const std::string& text : gEvents) {
            Json::Value e;
            Json::Reader().parse(text, e);
            seen.push_back(std::to_string(e["eventCategory"].asInt()) + "/" +
                           std::to_string(e["eventId"].asInt()) + " " +
                           e["basePortWWN"].asString() + " " +
                           std::to_string(e["eventSeverity"].asInt()));
        }
    }
    EXPECT_EQ((std::vector<std::string>{
                  std::string("2/8 ") + FCOE_PORT + " 3",
                  std::string("10/4 ") + ETH_PORT + " 3",
                  std::string("2/11 ") + FC_PORT0 + " 2",
                  std::string("10/2 ") + ETH_PORT + " 2"}),
              seen);
}

TEST_F(DtrujEvents, EventsWaitForACallback)
{
    // Registered for events, but no callback yet, as a caller has it for a
    // moment between the two calls.
    ASSERT_FALSE(isError(lib.call("register_for_events", obj({{"dropOldEvents", true}}))));
    ASSERT_EQ(0, lib.inject("{\"eventCategory\":2,\"eventId\":1}"));
    usleep(100000);
    EXPECT_EQ(0u, waitFor(0, 0));
    lib.sym<OLMA::evtProcessCBRetVoidFP>("registerEventProcessingCb")(onEvent);
    EXPECT_EQ(1u, waitFor(1));
}

TEST_F(DtrujEvents, UnregisterStopsDelivery)
{
    subscribe();
    lib.inject("{\"eventCategory\":8,\"eventId\":1}");
    ASSERT_EQ(1u, waitFor(1));
    ASSERT_FALSE(isError(lib.call("unregister_for_events")));
    EXPECT_EQ(-1, lib.inject("{\"eventCategory\":8,\"eventId\":2}"));
    lib.call("setAdapterState", obj({{"indexStr", FC_HBA}, {"enableState", false}}));
    usleep(100000);
    EXPECT_EQ(1u, waitFor(1, 0));
    // And a second registration delivers again.
    subscribe();
    lib.inject("{\"eventCategory\":8,\"eventId\":2}");
    EXPECT_EQ(2u, waitFor(2));
}

// The callback may call back into the library, even to unregister.
void reentrantEvent(const char* text);
Lib* gLib = nullptr;
std::atomic<int> gReentered{0};
void reentrantEvent(const char*)
{
    gLib->call("getGlobalInfo");
    gLib->call("unregister_for_events");
    gReentered++;
}

TEST_F(DtrujEvents, CallbackMayCallTheLibrary)
{
    gLib = &lib;
    lib.sym<OLMA::evtProcessCBRetVoidFP>("registerEventProcessingCb")(reentrantEvent);
    lib.call("register_for_events", obj({{"dropOldEvents", true}}));
    lib.inject("{}");
    for (int i = 0; i < 200 && gReentered == 0; ++i)
        usleep(10000);
    EXPECT_EQ(1, gReentered.load());
    EXPECT_EQ(-1, lib.inject("{}"));
}

TEST_F(DtrujEvents, LinesFromAFifo)
{
    std::string path = testing::TempDir() + "dtruj_events_fifo_" + std::to_string(getpid());
    ASSERT_EQ(0, mkfifo(path.c_str(), 0600));
    setenv("DTRUJ_EVENTS", path.c_str(), 1);
    subscribe();
    // A writer that comes and goes, as `echo ... > fifo` does.
    for (const char* line : {"{\"eventCategory\":10,\"eventId\":1}\n", "\n{\"eventCategory\":10,\"eventId\":2}\n"}) {
        int fd = open(path.c_str(), O_WRONLY);
        ASSERT_GE(fd, 0);
        ASSERT_GT(write(fd, line, strlen(line)), 0);
        close(fd);
    }
    EXPECT_EQ(2u, waitFor(2));
    lib.call("unregister_for_events");
    unsetenv("DTRUJ_EVENTS");
    unlink(path.c_str());
    std::lock_guard<std::mutex> g(gMtx);
    ASSERT_EQ(2u, gEvents.size());
    EXPECT_EQ("{\"eventCategory\":10,\"eventId\":2}", gEvents[1]);
}

} // namespace

namespace {

// A process that ends while still subscribed ends cleanly: the library
// stops its thread on the way out.
TEST(DtrujEventsExit, SubscribedAtExit)
{
    EXPECT_EXIT(
        {
            Lib lib;
            lib.reset();
            lib.sym<OLMA::evtProcessCBRetVoidFP>("registerEventProcessingCb")(onEvent);
            lib.call("register_for_events", obj({{"dropOldEvents", true}}));
            lib.inject("{}");
            exit(0);
        },
        ::testing::ExitedWithCode(0), "");
}

} // namespace
