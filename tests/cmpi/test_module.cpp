// The module as a CIM server sees it: exactly the entries it should export,
// and nothing left for the loader to resolve beyond the C and C++ runtimes
// and JsonCpp.

#include <dlfcn.h>
#include <sys/stat.h>
#include <cstdio>
#include <fstream>
#include <set>
#include <string>
#include <vector>
#include <gtest/gtest.h>
#include "Registration.h"

namespace
{

bool module_built()
{
    struct stat st;
    return stat(VSPR_MODULE, &st) == 0;
}

std::set<std::string> command_lines(const std::string& command)
{
    std::set<std::string> out;
    FILE* f = popen(command.c_str(), "r");
    if (!f)
        return out;
    char line[1024];
    while (fgets(line, sizeof(line), f))
    {
        std::string s(line);
        while (!s.empty() && (s.back() == '\n' || s.back() == ' '))
            s.pop_back();
        if (!s.empty())
            out.insert(s);
    }
    pclose(f);
    return out;
}

TEST(Module, ExportsExactlyTheEntries)
{
    if (!module_built())
        GTEST_SKIP() << VSPR_MODULE << " not built";

    std::set<std::string> expected;
    std::ifstream in(VSPR_EXPORTS);
    std::string name;
    while (in >> name)
        expected.insert(name);
    ASSERT_EQ(388u, expected.size());
    EXPECT_TRUE(expected.count("VESPERA_FCPort_Provider_Create_InstanceMI"));
    EXPECT_TRUE(expected.count("VESPERA_FCPort_Create_MethodMI"));
    EXPECT_TRUE(expected.count("VESPERA_AlertIndication_Create_IndicationMI"));
    EXPECT_FALSE(expected.count("VESPERA_AlertIndication_Create_InstanceMI"));
    EXPECT_TRUE(expected.count("VESPERA_ControlledBy_Provider_Create_AssociationMI"));

    std::set<std::string> exported = command_lines(
        std::string("nm -D --defined-only ") + VSPR_MODULE + " | awk '{print $3}'");
    ASSERT_FALSE(exported.empty()) << "nm gave nothing";

    for (const std::string& n : exported)
        EXPECT_TRUE(expected.count(n)) << "exported but not an entry: " << n;
    for (const std::string& n : expected)
        EXPECT_TRUE(exported.count(n)) << "entry not exported: " << n;
}

TEST(Module, LoadsWithEverySymbolResolved)
{
    if (!module_built())
        GTEST_SKIP() << VSPR_MODULE << " not built";

    void* dl = dlopen(VSPR_MODULE, RTLD_NOW | RTLD_LOCAL);
    ASSERT_TRUE(dl != nullptr) << dlerror();

    typedef const void* (*Module_Proc)();
    Module_Proc tessel_module = (Module_Proc)dlsym(dl, "tessel_module");
    ASSERT_TRUE(tessel_module != nullptr);
    EXPECT_TRUE(tessel_module() != nullptr);
    EXPECT_TRUE(dlsym(dl, "__tessel_version_2_0_16") != nullptr);
    EXPECT_EQ(nullptr, dlsym(dl, "tessel_cmpi_adapter"));
    dlclose(dl);

    // The libraries it needs: the C and C++ runtimes and JsonCpp (and the
    // sanitizers' runtimes in such a build). The adapter library is opened
    // at run time, never linked.
    const char* allowed[] = { "libc.so", "libstdc++.so", "libm.so", "libgcc_s.so",
        "libpthread.so", "libdl.so", "libjsoncpp.so", "ld-linux", "libasan.so",
        "libubsan.so", "libtsan.so" };

    std::set<std::string> needed = command_lines(std::string("readelf -d ") + VSPR_MODULE +
        " | sed -n 's/.*(NEEDED).*\\[\\(.*\\)\\]/\\1/p'");
    ASSERT_FALSE(needed.empty());

    for (const std::string& lib : needed)
    {
        bool ok = false;
        for (const char* a : allowed)
            ok = ok || lib.compare(0, strlen(a), a) == 0;
        EXPECT_TRUE(ok) << "needs " << lib;
    }
}

TEST(Module, RegistrationChainAndDispatch)
{
    if (!module_built())
        GTEST_SKIP() << VSPR_MODULE << " not built";

    void* dl = dlopen(VSPR_MODULE, RTLD_NOW | RTLD_LOCAL);
    ASSERT_TRUE(dl != nullptr) << dlerror();
    typedef const OLMA::Registration* (*Module_Proc)();
    Module_Proc tessel_module = (Module_Proc)dlsym(dl, "tessel_module");
    ASSERT_TRUE(tessel_module != nullptr);

    // From the last registered to the first.
    std::vector<const OLMA::Registration*> chain;
    for (const OLMA::Registration* r = tessel_module(); r && chain.size() < 1000; r = r->next)
        chain.push_back(r);
    ASSERT_EQ(76u, chain.size());
    EXPECT_STREQ("VESPERA_AgentService_Provider", chain.front()->provider_name);
    EXPECT_STREQ("VESPERA_ComputerSystem_Provider", chain.back()->provider_name);

    for (const OLMA::Registration* r : chain)
    {
        EXPECT_STREQ("vsprprovider_Module", r->module_name);

        // Each provider serves the class it is named after.
        const OLMA::Meta_Class* mc = 0;
        ASSERT_EQ(0, r->proc(r, OLMA::OP_GET_META_CLASS, &mc, 0, 0, 0, 0, 0, 0, 0));
        ASSERT_TRUE(mc);
        EXPECT_EQ(mc, r->meta_class);
        EXPECT_EQ(std::string(mc->name) + "_Provider", r->provider_name);

        const OLMA::Meta_Repository* mr = 0;
        ASSERT_EQ(0, r->proc(r, OLMA::OP_GET_REPOSITORY, &mr, 0, 0, 0, 0, 0, 0, 0));
        EXPECT_EQ(mc->meta_repository, mr);

        // Operations that the class's kind doesn't have, and numbers beyond
        // the last, give -1 without touching the provider.
        EXPECT_EQ(-1, r->proc(r, 17, 0, 0, 0, 0, 0, 0, 0, 0)) << r->provider_name;
        EXPECT_EQ(-1, r->proc(r, -1, 0, 0, 0, 0, 0, 0, 0, 0)) << r->provider_name;

        if (mc->flags & OLMA::FLAG_INDICATION)
        {
            for (int op = OLMA::OP_GET_INSTANCE; op <= OLMA::OP_INVOKE_METHOD; op++)
                EXPECT_EQ(-1, r->proc(r, op, 0, 0, 0, 0, 0, 0, 0, 0)) << op;
            EXPECT_EQ(-1, r->proc(r, OLMA::OP_ENUM_ASSOCIATORS, 0, 0, 0, 0, 0, 0, 0, 0));
        }
        else
        {
            EXPECT_EQ(-1, r->proc(r, OLMA::OP_ENABLE_INDICATIONS, 0, 0, 0, 0, 0, 0, 0, 0));
            EXPECT_EQ(-1, r->proc(r, OLMA::OP_DISABLE_INDICATIONS, 0, 0, 0, 0, 0, 0, 0, 0));
            if (!(mc->flags & OLMA::FLAG_ASSOCIATION))
            {
                EXPECT_EQ(-1, r->proc(r, OLMA::OP_ENUM_REFERENCES, 0, 0, 0, 0, 0, 0, 0, 0));
            }
        }
    }

    dlclose(dl);
}

} // namespace
