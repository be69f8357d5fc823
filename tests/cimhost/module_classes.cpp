// The module in the stand-in, which knows the classes as a CIM server does:
// from the DMTF schema 2.26 Final and the module's MOF. Every class that the
// module serves answers without a property refused; with the FC port class
// as the MOF declared it before it carried PortAvailability, the stand-in
// refuses that property, as OpenPegasus did.

#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "cimhost.h"
#include "internal.h"

namespace ch = OLMA::cimhost;

namespace
{

const std::string& home()
{
    static std::string dir = [] {
        char name[] = "/tmp/vspr-module-classes-XXXXXX";
        return std::string(mkdtemp(name) ? name : "/tmp");
    }();
    return dir;
}

ch::Object_Path class_path(const std::string& ns, const std::string& cls)
{
    ch::Object_Path p;
    p.name_space = ns;
    p.class_name = cls;
    return p;
}

// The built-in classes with one property taken out of one class.
struct Without
{
    std::vector<ch::Class_Desc> classes;
    std::vector<ch::Feature_Desc> features;
    ch::Class_Table table;

    Without(const char* cls, const char* property)
    {
        const ch::Class_Table& all = ch::vespera_classes;
        classes.assign(all.classes, all.classes + all.num_classes);
        for (ch::Class_Desc& c : classes)
            if (strcmp(c.name, cls) == 0)
            {
                for (size_t i = 0; i < c.num_features; i++)
                    if (strcmp(c.features[i].name, property) != 0)
                        features.push_back(c.features[i]);
                EXPECT_EQ(c.num_features - 1, features.size()) << cls << "." << property;
                c.features = features.data();
                c.num_features = features.size();
            }
        table = {classes.data(), classes.size()};
    }
};

class ModuleClasses : public ::testing::Test
{
protected:
    static void SetUpTestSuite()
    {
        setenv("HOME", home().c_str(), 1);
        unsetenv("DTRUJ_HOST");
    }

    static void TearDownTestSuite()
    {
        std::error_code ec;
        std::filesystem::remove_all(home(), ec);
    }
};

TEST_F(ModuleClasses, EveryServedClassAnswersWithNothingRefused)
{
    ch::Host host;
    ASSERT_TRUE(host.ok()) << host.error();
    std::vector<ch::Registration_Entry> regs;
    std::string err;
    ASSERT_TRUE(ch::read_reg_file(std::string(VSPR_SOURCE_DIR) + "/schema/vsprprovider.reg",
                                  regs, err)) << err;
    size_t answered = 0;
    for (const ch::Registration_Entry& e : regs)
    {
        if (!(e.kinds & ch::MI_INSTANCE))
            continue;
        ch::Result r = host.ei(class_path("root/vespera", e.class_name));
        EXPECT_EQ(CMPI_RC_OK, r.rc) << e.class_name << ": " << r.message;
        answered += !r.instances.empty();
    }
    // Every inventory, interop and software class of the default host.
    EXPECT_GE(answered, 20u);
    for (const std::string& line : host.refused_properties())
        ADD_FAILURE() << line;

    ch::Result ports = host.ei(class_path("root/vespera", "VESPERA_FCPort"));
    ASSERT_FALSE(ports.instances.empty());
    EXPECT_EQ("2", ports.instances[0].get_text("PortAvailability"));
}

TEST_F(ModuleClasses, TheOldFCPortClassRefusesPortAvailability)
{
    Without old("VESPERA_FCPort", "PortAvailability");
    ch::Options o;
    o.classes = &old.table;
    ch::Host host(o);
    ASSERT_TRUE(host.ok()) << host.error();
    ch::Result r = host.ei(class_path("root/vespera", "VESPERA_FCPort"));
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_FALSE(r.instances.empty());
    for (const ch::Instance& i : r.instances)
    {
        EXPECT_EQ(nullptr, i.get("PortAvailability"));
        EXPECT_FALSE(i.get_text("DeviceID").empty());
    }
    std::vector<std::string> refused = host.refused_properties();
    ASSERT_EQ(1u, refused.size());
    EXPECT_EQ("Property PortAvailability not set on the created instance of class "
              "VESPERA_FCPort: the class doesn't declare it", refused[0]);
}

TEST_F(ModuleClasses, HierarchyAndTypesAreTheServersOwn)
{
    ch::Host host;
    ASSERT_TRUE(host.ok()) << host.error();
    EXPECT_TRUE(host.class_is_a("VESPERA_MemoryDiagnosticTest", "CIM_DiagnosticService"));
    // Where the module's tables put a later parent, a 2.26 Final server
    // holds the 2.26 one.
    EXPECT_TRUE(host.class_is_a("VESPERA_DiagnosticServiceRecord", "CIM_RecordForLog"));
    EXPECT_FALSE(host.class_is_a("VESPERA_DiagnosticServiceRecord", "CIM_LogEntry"));
    EXPECT_FALSE(host.knows_class("CIM_InitiatorTargetLogicalUnitPath"));

    EXPECT_EQ(CMPI_uint16, host.property_type("VESPERA_FCPort", "portavailability"));
    EXPECT_EQ(CMPI_uint16, host.parameter_type("VESPERA_FCPort", "RequestStateChange",
                                               "RequestedState"));
    EXPECT_EQ(CMPI_ref, host.parameter_type("VESPERA_FCPort", "RequestStateChange", "Job"));

    // The interop namespace's object manager, which the module reads.
    ch::Result r = host.ei(class_path("root/PG_InterOp", "CIM_ObjectManager"));
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(1u, r.instances.size());
    r = host.ei(class_path("root/vespera", "VESPERA_ObjectManager"));
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(1u, r.instances.size());
}

} // namespace
