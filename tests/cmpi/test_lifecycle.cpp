// The life of an adapter and the operations that the stand-in's client API
// doesn't offer (create, modify, delete, query), called through the MI
// tables as a CIM server calls them.

#include "tst_support.h"
#include "objects.h"

using namespace OLMA;

namespace
{

typedef CMPIInstanceMI* (*Instance_Factory)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
typedef CMPIMethodMI* (*Method_Factory)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);

class Lifecycle : public Tst_Host
{
protected:

    void SetUp() override
    {
        Tst_Host::SetUp();
        create_instance_mi = (Instance_Factory)dlsym(dl, "TST_Part_Provider_Create_InstanceMI");
        create_method_mi = (Method_Factory)dlsym(dl, "TST_Part_Provider_Create_MethodMI");
        ASSERT_TRUE(create_instance_mi && create_method_mi);
        context = ch::new_context({ ch::Property { "CMPIPrincipal", ch::Value::of_string("me") } });
    }

    CMPIInstanceMI* instance_mi()
    {
        return create_instance_mi(host->broker(), context, nullptr);
    }

    CMPIObjectPath* cmpi_path(const std::string& name, uint64_t index)
    {
        return ch::new_path(path(name, index));
    }

    CMPIInstance* cmpi_instance(const std::string& name, uint64_t index)
    {
        ch::Instance i;
        i.class_name = "TST_Part";
        i.path = path(name, index);
        i.properties.push_back(ch::Property { "Name", ch::Value::of_string(name) });
        i.properties.push_back(ch::Property { "Index", ch::Value::of_uint(CMPI_uint16, index) });
        i.properties.push_back(ch::Property { "U8", ch::Value::of_uint(CMPI_uint8, 9) });
        return ch::new_instance(i);
    }

    Instance_Factory create_instance_mi = nullptr;
    Method_Factory create_method_mi = nullptr;
    CMPIContext* context = nullptr;
};

TEST_F(Lifecycle, TwoKindsShareOneAdapterUntilTheLastCleanup)
{
    unsigned constructed = state->constructed;
    unsigned loads = state->loads;

    CMPIInstanceMI* imi = instance_mi();
    CMPIMethodMI* mmi = create_method_mi(host->broker(), context, nullptr);
    ASSERT_TRUE(imi && mmi);
    EXPECT_EQ(imi->hdl, mmi->hdl);
    EXPECT_EQ(constructed + 1, state->constructed);
    EXPECT_EQ(loads + 1, state->loads);
    EXPECT_EQ(100, imi->ft->ftVersion);
    EXPECT_EQ(100, mmi->ft->miVersion);
    EXPECT_STREQ("instanceTST_Part_Provider", imi->ft->miName);
    EXPECT_STREQ("methodTST_Part_Provider", mmi->ft->miName);

    unsigned destructed = state->destructed;
    EXPECT_EQ(CMPI_RC_OK, imi->ft->cleanup(imi, context, 0).rc);
    EXPECT_EQ(destructed, state->destructed);

    EXPECT_EQ(CMPI_RC_OK, mmi->ft->cleanup(mmi, context, 0).rc);
    EXPECT_EQ(destructed + 1, state->destructed);
    EXPECT_EQ(state->loads, state->unloads);

    // The MI object outlives its adapter; a new creation makes a new
    // provider and loads it again.
    imi = instance_mi();
    EXPECT_EQ(constructed + 2, state->constructed);
    EXPECT_EQ(loads + 2, state->loads);
    EXPECT_EQ(CMPI_RC_OK, imi->ft->cleanup(imi, context, 0).rc);
    EXPECT_EQ(destructed + 2, state->destructed);
}

TEST_F(Lifecycle, TerminatingCleanupEndsAProviderThatRefusesToUnload)
{
    state->deny_unload = true;
    unsigned destructed = state->destructed;

    CMPIInstanceMI* imi = instance_mi();
    ASSERT_TRUE(imi);
    EXPECT_EQ(CMPI_RC_DO_NOT_UNLOAD, imi->ft->cleanup(imi, context, 0).rc);
    EXPECT_EQ(destructed, state->destructed);

    EXPECT_EQ(CMPI_RC_OK, imi->ft->cleanup(imi, context, 1).rc);
    EXPECT_EQ(destructed + 1, state->destructed);
}

TEST_F(Lifecycle, CreateInstanceStatusesAndCompletedKeys)
{
    CMPIInstanceMI* imi = instance_mi();
    ASSERT_TRUE(imi);

    struct { int status; CMPIrc rc; } rows[] =
    {
        { CREATE_INSTANCE_DUPLICATE, CMPI_RC_ERR_ALREADY_EXISTS },
        { CREATE_INSTANCE_UNSUPPORTED, CMPI_RC_ERR_NOT_SUPPORTED },
        { CREATE_INSTANCE_INVALID_PARAMETER, CMPI_RC_ERR_INVALID_PARAMETER },
        { CREATE_INSTANCE_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED },
        { CREATE_INSTANCE_FAILED, CMPI_RC_ERR_FAILED },
        { CREATE_INSTANCE_OK, CMPI_RC_OK },
    };

    for (const auto& row : rows)
    {
        state->create_status = row.status;
        ch::Collector sink;
        CMPIStatus st = imi->ft->createInstance(imi, context, ch::new_result(&sink),
            cmpi_path("new", 1), cmpi_instance("new", 1));
        EXPECT_EQ(row.rc, st.rc) << row.status;
        EXPECT_STREQ("create_instance", state->last_op);
        EXPECT_EQ(1u, state->non_null);

        if (row.status == CREATE_INSTANCE_OK)
        {
            // The provider completed a key; the path says so.
            ASSERT_EQ(1u, sink.items.size());
            ASSERT_TRUE(sink.items[0].ref);
            EXPECT_EQ("4242", sink.items[0].ref->key("Index")->text());
        }
        else
            EXPECT_TRUE(sink.items.empty());
    }

    imi->ft->cleanup(imi, context, 1);
}

TEST_F(Lifecycle, ModifyInstanceStatusesAndTheModel)
{
    CMPIInstanceMI* imi = instance_mi();
    ASSERT_TRUE(imi);

    struct { int status; CMPIrc rc; } rows[] =
    {
        { MODIFY_INSTANCE_NOT_FOUND, CMPI_RC_ERR_NOT_FOUND },
        { MODIFY_INSTANCE_UNSUPPORTED, CMPI_RC_ERR_NOT_SUPPORTED },
        { MODIFY_INSTANCE_INVALID_PARAMETER, CMPI_RC_ERR_INVALID_PARAMETER },
        { MODIFY_INSTANCE_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED },
        { MODIFY_INSTANCE_FAILED, CMPI_RC_ERR_FAILED },
        { MODIFY_INSTANCE_OK, CMPI_RC_OK },
    };

    for (const auto& row : rows)
    {
        state->modify_status = row.status;
        ch::Collector sink;
        CMPIStatus st = imi->ft->modifyInstance(imi, context, ch::new_result(&sink),
            cmpi_path("m", 2), cmpi_instance("m", 2), nullptr);
        EXPECT_EQ(row.rc, st.rc) << row.status;
        EXPECT_EQ(row.status == MODIFY_INSTANCE_OK ? 1u : 0u, sink.items.size());
    }

    // Without a list every property is wanted; with one, those listed.
    EXPECT_EQ(28u, state->non_null);
    const char* props[] = { "U8", "Str", nullptr };
    ch::Collector sink;
    imi->ft->modifyInstance(imi, context, ch::new_result(&sink),
        cmpi_path("m", 2), cmpi_instance("m", 2), props);
    EXPECT_EQ(2u, state->non_null);
    EXPECT_STREQ("m", state->name);

    imi->ft->cleanup(imi, context, 1);
}

TEST_F(Lifecycle, DeleteInstanceStatusesAndQuery)
{
    CMPIInstanceMI* imi = instance_mi();
    ASSERT_TRUE(imi);

    struct { int status; CMPIrc rc; } rows[] =
    {
        { DELETE_INSTANCE_NOT_FOUND, CMPI_RC_ERR_NOT_FOUND },
        { DELETE_INSTANCE_UNSUPPORTED, CMPI_RC_ERR_NOT_SUPPORTED },
        { DELETE_INSTANCE_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED },
        { DELETE_INSTANCE_FAILED, CMPI_RC_ERR_FAILED },
        { DELETE_INSTANCE_OK, CMPI_RC_OK },
    };

    for (const auto& row : rows)
    {
        state->delete_status = row.status;
        ch::Collector sink;
        CMPIStatus st = imi->ft->deleteInstance(imi, context, ch::new_result(&sink),
            cmpi_path("d", 70000));
        EXPECT_EQ(row.rc, st.rc) << row.status;
        EXPECT_STREQ("delete_instance", state->last_op);
        EXPECT_EQ(4464u, state->index);
    }

    ch::Collector sink;
    EXPECT_EQ(CMPI_RC_ERR_NOT_SUPPORTED, imi->ft->execQuery(imi, context,
        ch::new_result(&sink), cmpi_path("d", 1), "select * from TST_Part", "WQL").rc);

    imi->ft->cleanup(imi, context, 1);
}

TEST_F(Lifecycle, TheUserComesFromTheRequestsContext)
{
    CMPIMethodMI* mmi = create_method_mi(host->broker(), context, nullptr);
    ASSERT_TRUE(mmi);

    ch::Collector sink;
    CMPIArgs* out = ch::new_args({});
    EXPECT_EQ(CMPI_RC_OK, mmi->ft->invokeMethod(mmi, context, ch::new_result(&sink),
        cmpi_path("u", 1), "Frob", ch::new_args({}), out).rc);
    EXPECT_TRUE(state->user_ok);
    EXPECT_STREQ("me", state->user);

    // A context without a principal: no user, and the call goes on.
    CMPIContext* anonymous = ch::new_context({});
    EXPECT_EQ(CMPI_RC_OK, mmi->ft->invokeMethod(mmi, anonymous, ch::new_result(&sink),
        cmpi_path("u", 1), "Frob", ch::new_args({}), out).rc);
    EXPECT_FALSE(state->user_ok);

    mmi->ft->cleanup(mmi, context, 1);
}

} // namespace
