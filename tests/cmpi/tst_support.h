#ifndef _OLMA_tst_support_h
#define _OLMA_tst_support_h

// The stand-in CIM server loaded with the bridge's test module, and quick
// ways to build the paths and values that a client would send.

#include <dlfcn.h>
#include <unistd.h>
#include <cstdio>
#include <cstring>
#include <memory>
#include <string>
#include <gtest/gtest.h>
#include "cimhost.h"
#include "tst_state.h"
#include "Provider_Status.h"

namespace OLMA
{

namespace ch = cimhost;

inline std::string tst_write_reg()
{
    char path[128];
    snprintf(path, sizeof(path), "/tmp/vspr_cmpi_test_%d.reg", (int)getpid());
    FILE* f = fopen(path, "w");
    fprintf(f,
        "[TST_Part]\n"
        "   provider: TST_Part_Provider\n"
        "   location: vspr_cmpi_test_module\n"
        "   type: instance method\n"
        "   namespace: root/test root/other\n"
        "\n"
        "[TST_Link]\n"
        "   provider: TST_Link_Provider\n"
        "   location: vspr_cmpi_test_module\n"
        "   type: instance association method\n"
        "   namespace: root/test root/other\n"
        "\n"
        "[TST_Alert]\n"
        "   provider: TST_Alert_Provider\n"
        "   location: vspr_cmpi_test_module\n"
        "   type: indication method\n"
        "   namespace: root/test root/other\n");
    fclose(f);
    return path;
}

class Tst_Host : public ::testing::Test
{
protected:

    void SetUp() override
    {
        reg = tst_write_reg();
        ch::Options o;
        o.module_path = TST_MODULE;
        o.reg_path = reg;
        host.reset(new ch::Host(o));
        ASSERT_TRUE(host->ok()) << host->error();
        dl = dlopen(TST_MODULE, RTLD_NOW | RTLD_NOLOAD);
        ASSERT_TRUE(dl != nullptr);
        typedef Tst_State* (*State_Proc)();
        state = ((State_Proc)dlsym(dl, "tst_state"))();
        ASSERT_TRUE(state != nullptr);
        unsigned constructed = state->constructed;
        unsigned destructed = state->destructed;
        unsigned loads = state->loads;
        unsigned unloads = state->unloads;
        memset(state, 0, sizeof(*state));
        state->constructed = constructed;
        state->destructed = destructed;
        state->loads = loads;
        state->unloads = unloads;
        state->get_status = GET_INSTANCE_UNSUPPORTED;
    }

    void TearDown() override
    {
        host.reset();
        if (dl)
            dlclose(dl);
        unlink(reg.c_str());
    }

    static ch::Object_Path cls()
    {
        ch::Object_Path p;
        p.name_space = "root/test";
        p.class_name = "TST_Part";
        return p;
    }

    static ch::Object_Path path(const std::string& name, uint64_t index)
    {
        ch::Object_Path p = cls();
        p.keys.push_back(ch::Property { "Name", ch::Value::of_string(name) });
        p.keys.push_back(ch::Property { "Index", ch::Value::of_uint(CMPI_uint64, index) });
        return p;
    }

    std::string reg;
    std::unique_ptr<ch::Host> host;
    void* dl = nullptr;
    Tst_State* state = nullptr;
};

} // namespace OLMA

#endif // _OLMA_tst_support_h
