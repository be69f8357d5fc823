// Requests as a busy server makes them: side by side on several threads, and
// with broker calls that fail on a plan, as they do in a server short of
// memory.

#include <atomic>
#include <thread>

#include <gtest/gtest.h>

#include "cimhost.h"
#include "cmpimacs.h"
#include "internal.h"

using namespace OLMA::cimhost;

namespace OLMA
{
namespace cimhost
{
extern const Class_Table testprov_classes;
} // namespace cimhost
} // namespace OLMA

namespace
{

Object_Path path_of(const std::string& text)
{
    Object_Path p;
    std::string err;
    EXPECT_TRUE(parse_path(text, p, err)) << err;
    return p;
}

class CimhostRequests : public ::testing::Test
{
protected:
    void SetUp() override
    {
        Options o;
        o.module_path = TESTPROV_MODULE;
        o.reg_path = TESTPROV_REG;
        o.classes = &testprov_classes;
        host.reset(new Host(o));
        ASSERT_TRUE(host->ok()) << host->error();
        mb = host->broker();
    }

    void TearDown() override
    {
        host->clear_broker_faults();
        host.reset();
    }

    std::unique_ptr<Host> host;
    const CMPIBroker* mb = nullptr;
};

} // namespace

TEST_F(CimhostRequests, PlannedBrokerCallsFailAndTheRestWork)
{
    CMPIStatus rc;
    host->fail_broker_calls(2);
    EXPECT_NE(nullptr, CMNewString(mb, "one", &rc));
    EXPECT_EQ(nullptr, CMNewString(mb, "two", &rc));
    EXPECT_EQ(CMPI_RC_ERR_FAILED, rc.rc);
    CMPIString* three = CMNewString(mb, "three", &rc);
    ASSERT_NE(nullptr, three);
    EXPECT_EQ(CMPI_RC_OK, rc.rc);
    EXPECT_EQ(3u, host->broker_calls());

    // An object's own functions count and fail too; release never fails.
    CMPIArray* list = CMNewArray(mb, 1, CMPI_uint8, nullptr);
    host->fail_broker_calls(1, 0);
    EXPECT_EQ(nullptr, CMGetCharsPtr(three, &rc));
    EXPECT_EQ(CMPI_RC_ERR_FAILED, rc.rc);
    CMPIData d = CMGetArrayElementAt(list, 0, &rc);
    EXPECT_EQ(CMPI_badValue, d.state);
    EXPECT_EQ(CMPI_RC_OK, CMRelease(three).rc);

    // Up-calls fail before they reach a provider.
    host->clear_broker_faults();
    CMPIObjectPath* cls = CMNewObjectPath(mb, "root/test", "Test_Widget", nullptr);
    host->fail_broker_calls(1);
    CMPIEnumeration* e = mb->bft->enumerateInstanceNames(mb, nullptr, cls, &rc);
    EXPECT_EQ(nullptr, e);
    EXPECT_EQ(CMPI_RC_ERR_FAILED, rc.rc);

    host->clear_broker_faults();
    EXPECT_EQ("ok", std::string(CMGetCharsPtr(CMNewString(mb, "ok", nullptr), nullptr)));
}

TEST_F(CimhostRequests, ProviderCallsOfAnOperationAreCounted)
{
    host->clear_broker_faults();
    Result r = host->ei(path_of("root/test:Test_Widget"));
    ASSERT_TRUE(r.ok());
    uint64_t calls = host->broker_calls();
    EXPECT_LT(3u, calls);   // at least an instance and a return for each widget
    host->clear_broker_faults();
    host->ei(path_of("root/test:Test_Widget"));
    EXPECT_EQ(calls, host->broker_calls());
}

// Enumerations, gets, associations, methods with up-calls and cleanups from
// eight threads at once: each answer is whole, nothing is left behind.
TEST_F(CimhostRequests, RequestsSideBySide)
{
    std::atomic<int> wrong {0};
    std::atomic<bool> stop {false};
    std::vector<std::thread> clients;
    for (int t = 0; t < 8; t++)
        clients.emplace_back([&, t] {
            for (int i = 0; i < 150; i++)
            {
                Result r;
                switch ((t + i) % 4)
                {
                case 0:
                    r = host->ei(path_of("root/test:Test_Widget"));
                    wrong += !r.ok() || r.instances.size() != 3;
                    break;
                case 1:
                    r = host->gi(path_of("root/test:Test_Widget.Name=\"b\""));
                    wrong += !r.ok() || r.instances.size() != 1;
                    break;
                case 2:
                    r = host->an(path_of("root/test:Test_Widget.Name=\"a\""));
                    wrong += !r.ok() || r.paths.empty();
                    break;
                default:
                    r = host->cm(path_of("root/test:Test_Widget.Name=\"a\""), "CountAll", {});
                    wrong += !r.ok();
                    break;
                }
            }
        });
    std::thread janitor([&] {
        while (!stop)
        {
            host->cleanup(false);
            std::this_thread::sleep_for(std::chrono::milliseconds(2));
        }
    });
    for (std::thread& c : clients)
        c.join();
    stop = true;
    janitor.join();
    EXPECT_EQ(0, wrong.load());
    EXPECT_EQ(0u, host->live_objects());
}
