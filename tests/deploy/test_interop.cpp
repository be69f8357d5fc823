// The module as the shipped registration puts it into a server: the profile
// classes answer in the interop namespace as well as in root/vespera, with
// paths in the namespace that was asked, and the server's own object
// manager beside them still answers the module's questions.

#include <gtest/gtest.h>
#include <algorithm>
#include <string>
#include <vector>

#include "cimhost.h"

namespace ch = OLMA::cimhost;

namespace
{

class Interop : public ::testing::Test
{
protected:
    static ch::Host* host;

    static void SetUpTestSuite() { host = new ch::Host(ch::Options()); }

    static void TearDownTestSuite()
    {
        delete host;
        host = 0;
    }

    void SetUp() override
    {
        ASSERT_TRUE(host->ok()) << host->error();
        host->set_interop(true);
        host->set_interop_namespace("root/PG_InterOp");
    }

    static ch::Object_Path cls(const std::string& ns, const std::string& name)
    {
        ch::Object_Path p;
        p.name_space = ns;
        p.class_name = name;
        return p;
    }

    static ch::Object_Path parse(const std::string& text)
    {
        ch::Object_Path p;
        std::string err;
        EXPECT_TRUE(ch::parse_path(text, p, err)) << err;
        return p;
    }

    static std::vector<std::string> names(const ch::Result& r, const char* key)
    {
        std::vector<std::string> v;
        for (const ch::Instance& i : r.instances)
            v.push_back(i.get_text(key));
        return v;
    }
};

ch::Host* Interop::host = 0;

} // namespace

TEST_F(Interop, ProfilesAnswerInBothNamespacesWithTheirOwnPaths)
{
    for (const char* ns : { "root/vespera", "root/interop" })
    {
        ch::Result r = host->ei(cls(ns, "VESPERA_RegisteredProfile"));
        ASSERT_EQ(CMPI_RC_OK, r.rc) << ns << ": " << r.message;
        EXPECT_EQ(5u, r.instances.size()) << ns;
        for (const ch::Instance& i : r.instances)
            EXPECT_EQ(ns, i.path.name_space) << i.get_text("InstanceID");
    }

    // Where SMI-S discovery starts: CIM_RegisteredProfile in the interop
    // namespace gives the profiles and subprofiles, found again by key.
    ch::Result r = host->ei(cls("root/interop", "CIM_RegisteredProfile"));
    ASSERT_EQ(CMPI_RC_OK, r.rc) << r.message;
    std::vector<std::string> found = names(r, "RegisteredName");
    EXPECT_EQ(15u, found.size());
    for (const char* profile : { "FC HBA", "Storage HBA", "Host Discovered Resources" })
        EXPECT_NE(found.end(), std::find(found.begin(), found.end(), profile)) << profile;
    ch::Object_Path fcHba = parse("root/interop:VESPERA_RegisteredProfile.InstanceID=\"FC HBA\"");
    r = host->gi(fcHba);
    ASSERT_EQ(1u, r.instances.size()) << r.message;
    EXPECT_EQ("root/interop", r.instances[0].path.name_space);

    // The associations that lead on from a profile are served there too
    // (their providers have no pairs yet, but the request reaches them).
    for (const char* assoc : { "VESPERA_ElementConformsToProfile", "VESPERA_SubProfileRequiresProfile" })
        EXPECT_EQ(CMPI_RC_OK, host->an(fcHba, assoc).rc) << assoc;

    // The inventory stays in the module's namespace.
    EXPECT_EQ(CMPI_RC_ERR_INVALID_NAMESPACE, host->ei(cls("root/interop", "VESPERA_FCPort")).rc);
}

// SFCB keeps its own object manager in root/interop, the namespace where the
// module's profile classes are registered too. Both answer there, and the
// module still learns the server's name.
TEST_F(Interop, ServersOwnObjectManagerBesideTheModulesClasses)
{
    host->set_interop_namespace("root/interop");
    ch::Result om = host->ei(cls("root/interop", "CIM_ObjectManager"));
    ASSERT_EQ(CMPI_RC_OK, om.rc) << om.message;
    ASSERT_EQ(1u, om.instances.size());
    EXPECT_EQ("CIM_ObjectManager", om.instances[0].class_name);
    std::string name = om.instances[0].get_text("Name");
    EXPECT_EQ(CMPI_RC_OK, host->gi(om.instances[0].path).rc);

    for (const char* ns : { "root/vespera", "root/interop" })
    {
        ch::Result n = host->ei(cls(ns, "VESPERA_Namespace"));
        ASSERT_EQ(1u, n.instances.size()) << ns;
        EXPECT_EQ(name, n.instances[0].get_text("ObjectManagerName")) << ns;
    }
    ch::Result r = host->ei(cls("root/interop", "CIM_Namespace"));
    EXPECT_EQ((std::vector<std::string> { "root/vespera" }), names(r, "Name"));
    EXPECT_EQ(5u, host->ei(cls("root/interop", "VESPERA_RegisteredProfile")).instances.size());

    // Off, the stand-in leaves the module's classes answering alone.
    host->set_interop(false);
    EXPECT_TRUE(host->ei(cls("root/interop", "CIM_ObjectManager")).instances.empty());
    EXPECT_EQ(5u, host->ei(cls("root/interop", "VESPERA_RegisteredProfile")).instances.size());
}
