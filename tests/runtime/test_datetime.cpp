#include <gtest/gtest.h>
#include <limits.h>
#include <stdlib.h>
#include <string.h>
#include <time.h>
#include <thread>
#include <vector>
#include "Datetime.h"

using namespace OLMA;

// Timestamps are read and shown in local time, so each test pins the zone.
class Datetime_Test : public ::testing::Test
{
protected:
    static void zone(const char* tz)
    {
        setenv("TZ", tz, 1);
        tzset();
    }

    void SetUp() override { zone("UTC0"); }
};

TEST_F(Datetime_Test, DefaultIsAZeroInterval)
{
    Datetime d;
    EXPECT_TRUE(d.is_interval());
    EXPECT_FALSE(d.is_timestamp());
    EXPECT_EQ(d.usec(), 0u);
    EXPECT_STREQ(d.ascii(false).c_str(), "00000000000000.000000:000");
    EXPECT_STREQ(d.ascii(true).c_str(), "00000000 00 00 00.000000:000");
}

TEST_F(Datetime_Test, TimestampTextsBothWays)
{
    Datetime d("20100102030405.123456+060");
    EXPECT_TRUE(d.is_timestamp());
    EXPECT_EQ(d.offset(), 60);
    // The fields are local time; the offset is kept, not applied.
    EXPECT_EQ(d.usec(), 1262401445ULL * Datetime::SEC + 123456);
    EXPECT_STREQ(d.ascii(false).c_str(), "20100102030405.123456+060");
    EXPECT_STREQ(d.ascii(true).c_str(), "2010/01/02 03:04:05.123456+060");
    EXPECT_EQ(strlen(d.ascii(true).c_str()), 30u);

    Datetime e("19991231235959.999999-300");
    EXPECT_EQ(e.offset(), -300);
    EXPECT_STREQ(e.ascii(false).c_str(), "19991231235959.999999-300");

    uint32 y, mo, da, h, mi, s, us;
    sint32 utc;
    e.get_timestamp(y, mo, da, h, mi, s, us, utc);
    EXPECT_EQ(y, 1999u);
    EXPECT_EQ(mo, 12u);
    EXPECT_EQ(da, 31u);
    EXPECT_EQ(h, 23u);
    EXPECT_EQ(mi, 59u);
    EXPECT_EQ(s, 59u);
    EXPECT_EQ(us, 999999u);
    EXPECT_EQ(utc, -300);

    Datetime f;
    f.set_timestamp(y, mo, da, h, mi, s, us, utc);
    EXPECT_TRUE(f == e);
}

TEST_F(Datetime_Test, TimestampsFollowTheLocalZone)
{
    zone("EST5");
    Datetime d("20100102030405.000000+000");
    EXPECT_EQ(d.usec(), (1262401445ULL + 5 * 3600) * Datetime::SEC);
    EXPECT_STREQ(d.ascii(false).c_str(), "20100102030405.000000+000");

    // The same instant shown in another zone gives that zone's clock with
    // the stored offset unchanged.
    zone("UTC0");
    EXPECT_STREQ(d.ascii(false).c_str(), "20100102080405.000000+000");

    zone("EST5");
    Datetime now = Datetime::now();
    EXPECT_TRUE(now.is_timestamp());
    EXPECT_EQ(now.offset(), -300);
    uint64 t = (uint64)time(nullptr);
    EXPECT_LE(now.usec() / Datetime::SEC, t);
    EXPECT_GE(now.usec() / Datetime::SEC + 2, t);
}

TEST_F(Datetime_Test, IntervalTextsBothWays)
{
    Datetime d("00000001000000.000000:000");
    EXPECT_TRUE(d.is_interval());
    EXPECT_EQ(d.usec(), 86400000000ULL);
    EXPECT_EQ(d.offset(), 0);
    EXPECT_STREQ(d.ascii(true).c_str(), "00000001 00 00 00.000000:000");

    const char* text = "12345678123456.654321:000";
    Datetime e(text);
    EXPECT_STREQ(e.ascii(false).c_str(), text);
    uint32 days, h, m, s, us;
    e.get_interval(days, h, m, s, us);
    EXPECT_EQ(days, 12345678u);
    EXPECT_EQ(h, 12u);
    EXPECT_EQ(m, 34u);
    EXPECT_EQ(s, 56u);
    EXPECT_EQ(us, 654321u);

    // Fields have no range limits: they add up and normalise on output.
    Datetime f("00000000999999.000000:000");
    EXPECT_EQ(f.usec(), 99 * Datetime::HOUR + 99 * Datetime::MIN + 99 * Datetime::SEC);
    EXPECT_STREQ(f.ascii(false).c_str(), "00000004044039.000000:000");

    Datetime g;
    g.set_interval(1, 2, 3, 4, 5);
    EXPECT_STREQ(g.ascii(false).c_str(), "00000001020304.000005:000");
}

TEST_F(Datetime_Test, MalformedTextsFailAndChangeNothing)
{
    const char* bad[] = {
        "",
        "0000000100000.000000:000",     // 24 characters
        "000000010000000.000000:000",   // 26
        "00000001000000.000000:001",    // interval must end in 000
        "00000001000000.000000*000",    // neither ':' nor a sign
        "00000001000000,000000:000",    // no '.'
        "0000000a000000.000000:000",
        "00000001000000.00000x:000",
        "2010010203040*.000000+000",    // wildcards are refused
        "20100102030405.******+000",
        "20100102030405.000000+06x",
        "20100102030405.000000+ 60",
        "19000101000000.000000+000",    // before the Epoch
    };

    for (const char* text : bad)
    {
        Datetime d(7ULL);
        Datetime shared(d);
        EXPECT_FALSE(d.set(text)) << text;
        EXPECT_TRUE(d.is_interval()) << text;
        EXPECT_EQ(d.usec(), 7u) << text;
        EXPECT_EQ(d._rep, shared._rep) << text;

        Datetime c(text);
        EXPECT_TRUE(c.is_timestamp()) << text;
        EXPECT_EQ(c.usec(), 0u) << text;
    }

    Datetime d;
    EXPECT_FALSE(d.set(nullptr));
}

TEST_F(Datetime_Test, ExtremeValuesStayWithinTheTextBuffer)
{
    char buffer[Datetime::ASCII_SIZE + 8];
    Datetime values[] = {
        Datetime(~0ULL),
        Datetime(~0ULL, INT_MIN),
        Datetime(0ULL, INT_MAX),
        Datetime(253402300799ULL * Datetime::SEC, -999),
    };

    for (const Datetime& d : values)
    {
        for (bool pretty : { false, true })
        {
            memset(buffer, 'Z', sizeof(buffer));
            d.ascii(buffer, pretty);
            EXPECT_LT(strlen(buffer), (size_t)Datetime::ASCII_SIZE);
            EXPECT_EQ(buffer[Datetime::ASCII_SIZE], 'Z');
        }
    }
}

TEST_F(Datetime_Test, CopiesShareUntilModified)
{
    Datetime a("20100102030405.123456+060");
    Datetime b(a);
    EXPECT_EQ(a._rep, b._rep);
    EXPECT_EQ(a._rep->refs, 2);

    b.set(5ULL);
    EXPECT_NE(a._rep, b._rep);
    EXPECT_EQ(a._rep->refs, 1);
    EXPECT_STREQ(a.ascii(false).c_str(), "20100102030405.123456+060");

    Datetime c(a), d(a), e(a), f(a);
    c.clear();
    d.set(1ULL, 2);
    e.set_interval(0, 0, 0, 1, 0);
    f.set("00000000000001.000000:000");
    EXPECT_TRUE(c == Datetime());
    EXPECT_EQ(d.offset(), 2);
    EXPECT_TRUE(e == f);
    EXPECT_EQ(a._rep->refs, 1);
    EXPECT_STREQ(a.ascii(false).c_str(), "20100102030405.123456+060");

    // Unshared: modified in place.
    Datetime_Rep* rep = c._rep;
    c.set(9ULL, 0);
    EXPECT_EQ(c._rep, rep);

    Datetime g;
    g = a;
    g = g;
    EXPECT_EQ(a._rep->refs, 2);
}

TEST_F(Datetime_Test, SharedRepresentationAcrossThreads)
{
    const Datetime shared(123456789ULL, 60);
    std::vector<std::thread> threads;

    for (int t = 0; t < 8; t++)
    {
        threads.emplace_back([&shared]() {
            for (int i = 0; i < 20000; i++)
            {
                Datetime a(shared);
                Datetime b;
                b = a;
                if (i & 1)
                    b.set((uint64)i);
                ASSERT_EQ(a.usec(), 123456789ULL);
                ASSERT_EQ(a.offset(), 60);
            }
        });
    }

    for (auto& t : threads)
        t.join();

    EXPECT_EQ(shared._rep->refs, 1);
}
