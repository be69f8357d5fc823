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

    state->pending = 2;
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
    state->pending = 1;
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

TEST_F(Indication, FailedEnableIsNotRetried)
{
    state->enable_status = ENABLE_INDICATIONS_FAILED;
    int a = 0;
    ch::Result r = host->subscribe("root/test", "TST_Alert", a);
    EXPECT_EQ(CMPI_RC_ERR_FAILED, r.rc);
    EXPECT_EQ(1u, state->enables);
}

} // namespace
