// Association requests served from a provider that only enumerates its
// associations: the runtime finds those that refer to the source and
// filters them.

#include <algorithm>
#include "tst_support.h"

using namespace OLMA;

namespace
{

class Association : public Tst_Host
{
protected:

    void TearDown() override
    {
        EXPECT_EQ(0u, host->live_objects());
        Tst_Host::TearDown();
    }

    static std::vector<std::string> names(const std::vector<ch::Object_Path>& paths)
    {
        std::vector<std::string> out;
        for (const ch::Object_Path& p : paths)
            out.push_back(p.key("Name") ? p.key("Name")->text() : "?");
        std::sort(out.begin(), out.end());
        return out;
    }

    typedef std::vector<std::string> Names;
};

TEST_F(Association, AssociatorNamesFilteredByRoleResultRoleAndClass)
{
    state->count = 3;
    ch::Object_Path part1 = path("part1", 1);

    struct { const char* result_class; const char* role; const char* result_role; Names want; }
    rows[] =
    {
        { "", "", "", { "part0", "part2" } },
        { "", "left", "", { "part2" } },
        { "", "", "Left", { "part0" } },
        { "", "Left", "Left", {} },
        { "tst_part", "", "", { "part0", "part2" } },
        { "TST_Link", "", "", {} },
        { "", "Nothing", "", {} },
    };

    for (const auto& row : rows)
    {
        ch::Result r = host->an(part1, "TST_Link", row.result_class, row.role, row.result_role);
        ASSERT_TRUE(r.ok()) << ch::rc_name(r.rc) << " " << r.message;
        EXPECT_EQ(row.want, names(r.paths))
            << row.result_class << "/" << row.role << "/" << row.result_role;
    }

    // An end that no association touches.
    EXPECT_TRUE(host->an(path("part7", 7), "TST_Link").paths.empty());
}

TEST_F(Association, AssociatorsComeWholeFromTheServer)
{
    state->count = 3;
    std::vector<std::string> props = { "U8" };
    ch::Result r = host->ai(path("part1", 1), "TST_Link", "", "", "", &props);
    ASSERT_TRUE(r.ok()) << ch::rc_name(r.rc) << " " << r.message;
    ASSERT_EQ(2u, r.instances.size());

    std::vector<std::string> got;
    for (const ch::Instance& i : r.instances)
    {
        got.push_back(i.get_text("Name") + "=" + i.get_text("U8"));
        EXPECT_EQ(nullptr, i.get("Str"));
    }
    std::sort(got.begin(), got.end());
    EXPECT_EQ((Names { "part0=200", "part2=202" }), got);
}

TEST_F(Association, ReferencesAndReferenceNames)
{
    state->count = 3;

    ch::Result r = host->rn(path("part1", 1), "TST_Link");
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_EQ(2u, r.paths.size());
    for (const ch::Object_Path& p : r.paths)
    {
        EXPECT_EQ("TST_Link", p.class_name);
        ASSERT_EQ(2u, p.keys.size());
        ASSERT_TRUE(p.key("Left") && p.key("Left")->ref);
        EXPECT_TRUE(p.key("Right") && p.key("Right")->ref);
    }

    r = host->ri(path("part1", 1), "TST_Link", "RIGHT");
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_EQ(1u, r.instances.size());
    EXPECT_EQ("part0-part1", r.instances[0].get_text("Note"));

    r = host->ri(path("part2", 2), "TST_Link", "Left");
    ASSERT_TRUE(r.ok());
    EXPECT_TRUE(r.instances.empty());
}

TEST_F(Association, SelfAssociationYieldsNoOtherEnd)
{
    state->count = 2;
    state->self_link = true;

    ch::Result r = host->an(path("part0", 0), "TST_Link");
    ASSERT_TRUE(r.ok());
    EXPECT_EQ((Names { "part1" }), names(r.paths));

    // As a reference, the self link counts.
    r = host->rn(path("part0", 0), "TST_Link");
    ASSERT_TRUE(r.ok());
    EXPECT_EQ(2u, r.paths.size());
}

TEST_F(Association, EnumerationFailureReachesTheClient)
{
    state->count = 3;
    state->enum_status = ENUM_INSTANCES_ACCESS_DENIED;
    EXPECT_EQ(CMPI_RC_ERR_ACCESS_DENIED, host->an(path("part1", 1), "TST_Link").rc);
    EXPECT_EQ(CMPI_RC_ERR_ACCESS_DENIED, host->rn(path("part1", 1), "TST_Link").rc);
    state->enum_status = ENUM_INSTANCES_FAILED;
    EXPECT_EQ(CMPI_RC_ERR_FAILED, host->ri(path("part1", 1), "TST_Link").rc);
}

TEST_F(Association, ProviderSeesTheNamespaceOfTheRequest)
{
    // Classes served in two namespaces answer in the one asked, and the
    // provider's model says which, whatever road the request takes.
    state->count = 3;
    ch::Object_Path part1 = path("part1", 1);
    part1.name_space = "root/other";

    ch::Result r = host->an(part1, "TST_Link");
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(std::string("root/other"), state->link_model_ns);
    ASSERT_EQ(2u, r.paths.size());
    for (const ch::Object_Path& p : r.paths)
        EXPECT_EQ("root/other", p.name_space);

    r = host->rn(part1, "TST_Link");
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(std::string("root/other"), state->link_model_ns);
    ASSERT_EQ(2u, r.paths.size());
    EXPECT_EQ("root/other", r.paths[0].name_space);
    ASSERT_TRUE(r.paths[0].key("Left") && r.paths[0].key("Left")->ref);
    EXPECT_EQ("root/other", r.paths[0].key("Left")->ref->name_space);

    ASSERT_TRUE(host->an(path("part1", 1), "TST_Link").ok());
    EXPECT_EQ(std::string("root/test"), state->link_model_ns);
}

} // namespace
