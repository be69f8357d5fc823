// Indications: the namespaces of active filters, enabling and disabling the
// provider, and delivery from the provider's own thread.

#include "tst_support.h"
#include "Time.h"

using namespace OLMA;

namespace
{

class Indication : public Tst_Host
{
protected:

    size_t delivered_in(const std::string& ns)
    {
        size_t n = 0;
        for (const ch::Indication_Record& r : host->indications())
            n += r.name_space == ns;
        return n;
    }
};

TEST_F(Indication, EachAlertReachesEveryNamespaceWithAFilter)
{
    int a = 0, b = 0, c = 0;
    ASSERT_TRUE(host->subscribe("root/test", "TST_Alert", a).ok());
    ASSERT_TRUE(host->subscribe("root/test", "TST_Alert", b).ok());
    ASSERT_TRUE(host->subscribe("root/other", "TST_Alert", c).ok());
    EXPECT_EQ(1u, state->enables);

    __atomic_store_n(&state->pending, 2u, __ATOMIC_RELEASE);
    EXPECT_EQ(4u, host->wait_indications(4, 5000));
    EXPECT_EQ(2u, delivered_in("root/test"));
    EXPECT_EQ(2u, delivered_in("root/other"));

    std::vector<ch::Indication_Record> got = host->indications();
    ASSERT_FALSE(got.empty());
    EXPECT_EQ("TST_Alert", got[0].instance.class_name);
    EXPECT_EQ("alert", got[0].instance.get_text("Message"));

    // One of two filters in a namespace keeps it; the last one ends it.
    host->clear_indications();
    ASSERT_TRUE(host->unsubscribe(a).ok());
    ASSERT_TRUE(host->unsubscribe(c).ok());
    __atomic_store_n(&state->pending, 1u, __ATOMIC_RELEASE);
    EXPECT_EQ(1u, host->wait_indications(1, 5000));
    Time::sleep(50 * Time::MSEC);
    EXPECT_EQ(1u, delivered_in("root/test"));
    EXPECT_EQ(0u, delivered_in("root/other"));

    // The last filter disables the provider, which waits for its thread
    // and ends the stream.
    ASSERT_TRUE(host->unsubscribe(b).ok());
    EXPECT_EQ(1u, state->disables);
    EXPECT_TRUE(state->stream_ended);
}

// The last unsubscription disables the provider while its thread is in
// the middle of a delivery, which needs the adapter's lock that the disable
// holds: the delivery gives up rather than wait, and the disable ends.
TEST_F(Indication, DisableDoesNotWaitForADeliveryInFlight)
{
    // A disable catches the thread inside a delivery more often than not;
    // at least twenty cycles, and on until one has.
    unsigned refused = 0;
    for (int cycle = 0; cycle < 20 || (refused == 0 && cycle < 500); cycle++)
    {
        int a = 0;
        ASSERT_TRUE(host->subscribe("root/test", "TST_Alert", a).ok());
        size_t before = host->indications().size();
        state->stream_ended = false;
        __atomic_store_n(&state->pending, 1000000u, __ATOMIC_RELEASE);
        ASSERT_GE(host->wait_indications(before + 10, 5000), before + 10);
        ASSERT_TRUE(host->unsubscribe(a).ok()) << cycle;
        EXPECT_TRUE(state->stream_ended);
        refused += state->refused;
        state->refused = 0;
        __atomic_store_n(&state->pending, 0u, __ATOMIC_RELEASE);
    }
    EXPECT_GT(refused, 0u) << "no delivery was caught by a disable";
}

TEST_F(Indication, FailedEnableIsNotRetried)
{
    state->enable_status = ENABLE_INDICATIONS_FAILED;
    int a = 0;
    ch::Result r = host->subscribe("root/test", "TST_Alert", a);
    EXPECT_EQ(CMPI_RC_ERR_FAILED, r.rc);
    EXPECT_EQ(1u, state->enables);
}

} // namespace
