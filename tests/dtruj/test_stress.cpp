// Many threads at once: server threads reading and writing, a test thread
// switching faults and subscriptions, and the library's event thread calling
// back into the library. Meant to run clean under ThreadSanitizer.
#include "Lib.h"

#include <atomic>
#include <cstdlib>
#include <thread>
#include <unistd.h>
#include <vector>

using namespace dtrujtest;

namespace {

Lib* gLib = nullptr;
std::atomic<int> gDelivered{0};

void onEvent(const char*)
{
    gLib->call("getAllAdaptersIndexString");
    gDelivered++;
}

TEST(DtrujStress, ConcurrentCallsStayConsistent)
{
    Lib lib;
    gLib = &lib;
    unsetenv("DTRUJ_HOST");
    lib.reset();
    lib.sym<OLMA::evtProcessCBRetVoidFP>("registerEventProcessingCb")(onEvent);
    lib.call("register_for_events", obj({{"dropOldEvents", true}}));

    std::atomic<bool> stop{false};
    std::atomic<int> calls{0}, badReplies{0};
    std::vector<std::thread> threads;

    // Readers: whatever the writers do, an adapter walk stays whole.
    for (int t = 0; t < 3; ++t)
        threads.emplace_back([&] {
            while (!stop) {
                Json::Value idx = lib.call("getAllAdaptersIndexString");
                if (idx.isNull())
                    continue;   // a fault of the test thread
                for (const Json::Value& a : idx["indexStrings"]) {
                    Json::Value pl = lib.call("getFcPhyPortIndicesByAdapter", obj({{"indexStr", a}}));
                    for (const Json::Value& p : pl["indexStrings"]) {
                        Json::Value port = lib.call("getPortByWwn", obj({{"wwn", p}}));
                        if (!port.isNull() && !isError(port) && !port["portStatus"].isBool())
                            badReplies++;
                        lib.call("getDynamicPortStatistics", obj({{"indexStr", p}}));
                        lib.call("getAllRemotePorts", obj({{"pPortWwn", p}, {"lPortWwn", p}}));
                        lib.call("getAllVPorts", obj({{"wwn", p}}));
                        calls += 4;
                    }
                }
                lib.call("getGlobalInfo");
            }
        });

    // Writers: ports up and down, virtual ports and vNICs come and go.
    threads.emplace_back([&] {
        bool on = false;
        while (!stop) {
            for (const char* p : {FC_PORT0, FC_PORT1, ETH_PORT})
                lib.call("setPortByWwn", obj({{"indexStr", p}, {"port", obj({{"portStatus", on}})},
                                              {"propArray", strArray({"portStatus"})}}));
            on = !on;
            calls += 3;
        }
    });
    threads.emplace_back([&] {
        while (!stop) {
            Json::Value v = lib.call("createVport", obj({{"pwwn", FC_PORT1}, {"vwwn", ""}}));
            if (v.isObject() && v.isMember("vwwn"))
                lib.call("deleteVport", obj({{"pwwn", FC_PORT1}, {"vportArray", arr({v["vwwn"]})}}));
            Json::Value n = lib.call("createvNIC", obj({{"mac", ETH_PORT}, {"minBandwidth", 1}, {"maxBandwidth", 10}}));
            if (n.isObject() && n.isMember("pciFunctionIndex"))
                lib.call("deletevNICs", obj({{"mac", ETH_PORT}, {"pciFunctionIndices", arr({n["pciFunctionIndex"]})}}));
            lib.call("resetStatisticsForPort", obj({{"indexStr", FC_PORT0}}));
            calls += 5;
        }
    });
    // Diagnostics beside the rest, including their delays outside the lock.
    threads.emplace_back([&] {
        auto reqId = lib.sym<OLMA::voidRetIntFP>("getRequestID");
        while (!stop) {
            std::string id = std::to_string(reqId());
            lib.call("postDiagnostics", obj({{"function", "QuickTest"}, {"requestID", id}}));
            lib.call("startTests", obj({{"requestID", id}}));
            lib.call("getDiagnosticsResults", obj({{"requestID", id}}));
            lib.call("diagPCILoopbackTest", obj({{"portWwn", FC_PORT0}}));
            calls += 4;
        }
    });
    // The test thread: events, faults and subscriptions switched meanwhile.
    threads.emplace_back([&] {
        int i = 0;
        auto dump = lib.sym<char* (*)()>("dtruj_sim_dump");
        while (!stop) {
            lib.inject("{\"eventCategory\":2,\"eventId\":1}");
            lib.setFault("getGlobalInfo", (i % 2) ? "null" : "none");
            lib.setFault("getAllVPorts", (i % 3) ? "delay:1" : "");
            if (i % 50 == 49) {
                lib.call("unregister_for_events");
                lib.call("register_for_events", obj({{"dropOldEvents", false}}));
            }
            free(dump());
            ++i;
            usleep(1000);
        }
    });

    sleep(2);
    stop = true;
    for (auto& t : threads)
        t.join();
    lib.sym<OLMA::evtProcessCBRetVoidFP>("registerEventProcessingCb")(nullptr);
    lib.call("unregister_for_events");

    EXPECT_EQ(0, badReplies.load());
    EXPECT_GT(calls.load(), 100);
    EXPECT_GT(gDelivered.load(), 0);
    // Every vport and vNIC made was removed again.
    lib.setFault("getAllVPorts", "");
    EXPECT_EQ(0u, lib.call("getAllVPorts", obj({{"wwn", FC_PORT1}})).size());
    EXPECT_EQ(1u, lib.call("getEthPortByEthMac", obj({{"mac", ETH_PORT}}))["ethData"]["numOfvNICs"].asUInt());
}

} // namespace
