// What the bridge hands over to the server. The stand-in keeps the pointers
// it is given and aborts on any use of a released object, where a real
// server reads freed memory; it builds the path of a returned instance from
// the key properties left on it, as SFCB does.

#include <algorithm>
#include "tst_support.h"
#include "Time.h"

using namespace OLMA;

namespace
{

class Handover : public Tst_Host
{
protected:

    void TearDown() override
    {
        EXPECT_EQ(0u, host->live_objects());
        Tst_Host::TearDown();
    }

    static const ch::Instance* named(const ch::Result& r, const std::string& name)
    {
        for (const ch::Instance& i : r.instances)
            if (i.get_text("Name") == name)
                return &i;
        return nullptr;
    }

    // Arrays of every kind of element that an array keeps by pointer.
    static void expect_arrays(const ch::Instance& i, const std::string& previous)
    {
        EXPECT_EQ("{\"a\", \"\", \"c d\"}", i.get_text("AStr"));
        EXPECT_EQ("{\"00000001020304.000005:000\", \"19991231235959.999999-300\"}",
            i.get_text("ADt"));

        const ch::Value* peers = i.get("Peers");
        ASSERT_TRUE(peers != nullptr);
        EXPECT_EQ(CMPI_refA, peers->type);
        ASSERT_EQ(1u, peers->elements.size());
        ASSERT_TRUE(peers->elements[0].ref != nullptr);
        EXPECT_EQ(previous, peers->elements[0].ref->key("Name")->text());

        // An embedded instance in an array, with an array of its own.
        const ch::Value* embeddeds = i.get("Embeddeds");
        ASSERT_TRUE(embeddeds != nullptr);
        EXPECT_EQ(CMPI_instanceA, embeddeds->type);
        ASSERT_EQ(1u, embeddeds->elements.size());
        ASSERT_TRUE(embeddeds->elements[0].inst != nullptr);
        EXPECT_EQ("text-" + previous, embeddeds->elements[0].inst->get_text("Str"));
        EXPECT_EQ("{\"a\", \"\", \"c d\"}", embeddeds->elements[0].inst->get_text("AStr"));
    }

    // Waits for the provider's thread to deliver what is pending and to be
    // done with it, and gives the number of live objects then.
    size_t settled_live_objects()
    {
        size_t last = (size_t)-1;
        for (int i = 0; i < 400; i++)
        {
            size_t now = host->live_objects();
            if (state->pending == 0 && now == last)
                return now;
            last = now;
            Time::sleep(5 * Time::MSEC);
        }
        return last;
    }
};

TEST_F(Handover, ArraysOfEveryKindReachTheClientWhole)
{
    state->count = 3;
    ch::Result r = host->ei(cls());
    ASSERT_TRUE(r.ok()) << ch::rc_name(r.rc) << " " << r.message;
    const ch::Instance* part2 = named(r, "part2");
    ASSERT_TRUE(part2 != nullptr);
    expect_arrays(*part2, "part1");

    r = host->gi(path("part2", 2));
    ASSERT_TRUE(r.ok()) << ch::rc_name(r.rc) << " " << r.message;
    ASSERT_EQ(1u, r.instances.size());
    expect_arrays(r.instances[0], "part1");
}

TEST_F(Handover, PropertyListsKeepEveryKeyInThePaths)
{
    state->count = 3;
    std::vector<std::string> props = { "U8" };

    ch::Result names = host->ein(cls());
    ch::Result r = host->ei(cls(), &props);
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_EQ(names.paths.size(), r.instances.size());
    for (size_t k = 0; k < r.instances.size(); k++)
    {
        EXPECT_TRUE(ch::path_equal(names.paths[k], r.instances[k].path))
            << r.instances[k].path.to_string();
        // The keys and the one property asked for.
        EXPECT_EQ(3u, r.instances[k].properties.size());
    }

    r = host->gi(path("part1", 1), &props);
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_EQ(1u, r.instances.size());
    EXPECT_TRUE(ch::path_equal(path("part1", 1), r.instances[0].path))
        << r.instances[0].path.to_string();
    EXPECT_EQ("201", r.instances[0].get_text("U8"));

    // The other ends come whole from the server's get, with the list.
    r = host->ai(path("part1", 1), "TST_Link", "", "", "", &props);
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_EQ(2u, r.instances.size());
    for (const ch::Instance& i : r.instances)
        EXPECT_EQ(2u, i.path.keys.size()) << i.path.to_string();

    // An empty list: no property but the keys, which are references.
    std::vector<std::string> none;
    r = host->ri(path("part1", 1), "TST_Link", "", &none);
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_EQ(2u, r.instances.size());
    std::vector<std::string> links;
    for (const ch::Instance& i : r.instances)
    {
        const ch::Value* left = i.path.key("Left");
        const ch::Value* right = i.path.key("Right");
        ASSERT_TRUE(left && left->ref && right && right->ref) << i.path.to_string();
        links.push_back(left->ref->key("Name")->text() + "-" + right->ref->key("Name")->text());
    }
    std::sort(links.begin(), links.end());
    EXPECT_EQ((std::vector<std::string> { "part0-part1", "part1-part2" }), links);
}

// The delivery thread lives as long as indications are on, outside any
// request: what it makes for an indication goes once the server has it.
TEST_F(Handover, DeliveryThreadKeepsNothingOfWhatItSent)
{
    int id = 0;
    ASSERT_TRUE(host->subscribe("root/test", "TST_Alert", id).ok());
    state->pending = 1;
    ASSERT_EQ(1u, host->wait_indications(1, 5000));
    size_t before = settled_live_objects();

    state->pending = 20;
    ASSERT_EQ(21u, host->wait_indications(21, 5000));
    EXPECT_EQ(before, settled_live_objects());

    const ch::Instance last = host->indications().back().instance;
    EXPECT_EQ("21", last.get_text("Sequence"));
    EXPECT_EQ("{\"port\", \"down\"}", last.get_text("Args"));
    EXPECT_EQ("20240102030405.000006+060", last.get_text("When"));
    ASSERT_TRUE(host->unsubscribe(id).ok());
}

} // namespace
