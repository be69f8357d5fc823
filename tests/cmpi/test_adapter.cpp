// The instance and method operations of the adapter, driven through the
// stand-in CIM server as a client's requests would reach them.

#include "tst_support.h"

using namespace OLMA;

namespace
{

class Adapter : public Tst_Host
{
protected:

    void TearDown() override
    {
        // Whatever the adapter made through the broker, it released or left
        // to the operation's scope.
        EXPECT_EQ(expected_live, host->live_objects());
        Tst_Host::TearDown();
    }

    size_t expected_live = 0;
};

TEST_F(Adapter, EnumerateInstancesCarriesEveryTypeAndBothReferenceForms)
{
    state->count = 2;
    ch::Result r = host->ei(cls());
    ASSERT_TRUE(r.ok()) << ch::rc_name(r.rc) << " " << r.message;
    ASSERT_EQ(2u, r.instances.size());

    const ch::Instance& i = r.instances[1];
    EXPECT_EQ("part1", i.get_text("Name"));
    EXPECT_EQ(CMPI_uint16, i.get("Index")->type);

    struct { const char* name; CMPIType type; const char* text; } rows[] =
    {
        { "B", CMPI_boolean, "true" },
        { "U8", CMPI_uint8, "201" },
        { "S8", CMPI_sint8, "-101" },
        { "U16", CMPI_uint16, "60001" },
        { "S16", CMPI_sint16, "-30001" },
        { "U32", CMPI_uint32, "4000000001" },
        { "S32", CMPI_sint32, "-2000000001" },
        { "U64", CMPI_uint64, "18000000000000000001" },
        { "S64", CMPI_sint64, "-9000000000000000001" },
        { "C16", CMPI_char16, 0 },
        { "R32", CMPI_real32, 0 },
        { "R64", CMPI_real64, 0 },
        { "Str", CMPI_string, "text-part1" },
        { "Dt", CMPI_dateTime, "20100102030405.123456+060" },
        { "AB", CMPI_booleanA, 0 },
        { "AU8", CMPI_uint8A, 0 },
        { "AS8", CMPI_sint8A, 0 },
        { "AU16", CMPI_uint16A, 0 },
        { "AS16", CMPI_sint16A, 0 },
        { "AU32", CMPI_uint32A, 0 },
        { "AS32", CMPI_sint32A, 0 },
        { "AU64", CMPI_uint64A, 0 },
        { "AS64", CMPI_sint64A, 0 },
        { "AR32", CMPI_real32A, 0 },
        { "AR64", CMPI_real64A, 0 },
        { "AC16", CMPI_char16A, 0 },
        { "AStr", CMPI_stringA, 0 },
        { "ADt", CMPI_dateTimeA, 0 },
    };

    for (const auto& row : rows)
    {
        const ch::Value* v = i.get(row.name);
        ASSERT_TRUE(v != nullptr) << row.name;
        EXPECT_EQ(row.type, v->type) << row.name;
        EXPECT_FALSE(v->null) << row.name;
        if (row.text)
        {
            EXPECT_EQ(row.text, v->text()) << row.name;
        }
    }

    EXPECT_EQ('B', i.get("C16")->num.char16);
    EXPECT_FLOAT_EQ(2.5f, i.get("R32")->num.real32);
    EXPECT_DOUBLE_EQ(-3.25, i.get("R64")->num.real64);
    EXPECT_EQ(0x263A, i.get("AC16")->elements[1].num.char16);
    EXPECT_EQ("{\"a\", \"\", \"c d\"}", i.get("AStr")->text());
    EXPECT_EQ(18446744073709551615ull, i.get("AU64")->elements[1].num.uint64);
    EXPECT_EQ("00000001020304.000005:000", i.get("ADt")->elements[0].str);

    // The reference's flags decide: a plain one is a path, an embedded one
    // a whole instance.
    const ch::Value* peer = i.get("Peer");
    ASSERT_TRUE(peer && peer->ref);
    EXPECT_EQ(CMPI_ref, peer->type);
    EXPECT_EQ("part0", peer->ref->key("Name")->text());
    EXPECT_EQ("root/test", peer->ref->name_space);

    const ch::Value* emb = i.get("Embedded");
    ASSERT_TRUE(emb && emb->inst);
    EXPECT_EQ(CMPI_instance, emb->type);
    EXPECT_EQ("text-part0", emb->inst->get_text("Str"));

    // The first part has no references: null ones are left out.
    EXPECT_EQ(nullptr, r.instances[0].get("Peer"));
}

TEST_F(Adapter, EnumerateInstancesWithPropertyList)
{
    state->count = 1;
    std::vector<std::string> props = { "u8", "Str" };
    ch::Result r = host->ei(cls(), &props);
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_EQ(1u, r.instances.size());

    // The provider's model asks for the two properties alone.
    EXPECT_EQ(2u, state->non_null);

    const ch::Instance& i = r.instances[0];
    EXPECT_EQ("200", i.get_text("U8"));
    EXPECT_EQ("text-part0", i.get_text("Str"));
    EXPECT_EQ(nullptr, i.get("U16"));
    EXPECT_EQ(nullptr, i.get("AStr"));
}

TEST_F(Adapter, EnumerateInstanceNamesGivesKeysFromAKeysOnlyModel)
{
    state->count = 3;
    ch::Result r = host->ein(cls());
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_EQ(3u, r.paths.size());
    EXPECT_EQ(0u, state->non_null);
    EXPECT_STREQ("enum_instances", state->last_op);

    const ch::Object_Path& p = r.paths[2];
    EXPECT_EQ("TST_Part", p.class_name);
    EXPECT_EQ("root/test", p.name_space);
    ASSERT_EQ(2u, p.keys.size());
    EXPECT_EQ("part2", p.key("Name")->text());
    EXPECT_EQ("2", p.key("Index")->text());
}

TEST_F(Adapter, EnumerationStatusesMapToReturnCodes)
{
    struct { int status; CMPIrc rc; } rows[] =
    {
        { ENUM_INSTANCES_OK, CMPI_RC_OK },
        { ENUM_INSTANCES_FAILED, CMPI_RC_ERR_FAILED },
        { ENUM_INSTANCES_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED },
        { 12345, CMPI_RC_OK },
    };

    for (const auto& row : rows)
    {
        state->enum_status = row.status;
        EXPECT_EQ(row.rc, host->ei(cls()).rc) << row.status;
        EXPECT_EQ(row.rc, host->ein(cls()).rc) << row.status;
    }
}

TEST_F(Adapter, GetInstanceFallsBackToEnumerationAndStopsAtTheMatch)
{
    state->count = 3;
    ch::Result r = host->gi(path("part1", 1));
    ASSERT_TRUE(r.ok()) << ch::rc_name(r.rc) << " " << r.message;
    ASSERT_EQ(1u, r.instances.size());
    EXPECT_EQ("part1", r.instances[0].get_text("Name"));
    EXPECT_EQ("60001", r.instances[0].get_text("U16"));

    // The callback's false answer stopped the provider after the match.
    EXPECT_EQ(2u, state->sent);
    EXPECT_TRUE(state->stopped);

    // Keys compare with regard to case.
    EXPECT_EQ(CMPI_RC_ERR_NOT_FOUND, host->gi(path("PART1", 1)).rc);
    EXPECT_EQ(CMPI_RC_ERR_NOT_FOUND, host->gi(path("part9", 9)).rc);
    EXPECT_FALSE(state->stopped);

    state->enum_status = ENUM_INSTANCES_FAILED;
    EXPECT_EQ(CMPI_RC_ERR_NOT_FOUND, host->gi(path("part1", 1)).rc);
}

TEST_F(Adapter, GetInstanceStatusesMapToReturnCodes)
{
    struct { int status; CMPIrc rc; } rows[] =
    {
        { GET_INSTANCE_OK, CMPI_RC_OK },
        { GET_INSTANCE_NOT_FOUND, CMPI_RC_ERR_NOT_FOUND },
        { GET_INSTANCE_INVALID_PARAMETER, CMPI_RC_ERR_INVALID_PARAMETER },
        { GET_INSTANCE_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED },
        { GET_INSTANCE_FAILED, CMPI_RC_ERR_FAILED },
    };

    for (const auto& row : rows)
    {
        state->get_status = row.status;
        EXPECT_EQ(row.rc, host->gi(path("x", 5)).rc) << row.status;
        EXPECT_STREQ("get_instance", state->last_op);
    }
}

TEST_F(Adapter, PathKeysAreNarrowedToTheDeclaredType)
{
    state->get_status = GET_INSTANCE_OK;
    ch::Result r = host->gi(path("wide", 70000));
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(4464u, state->index);
    EXPECT_STREQ("wide", state->name);
    // The model of a get wants every property.
    EXPECT_EQ(28u, state->non_null);
}

TEST_F(Adapter, GetInstanceWithPropertyListFiltersModelAndAnswer)
{
    state->get_status = GET_INSTANCE_OK;
    std::vector<std::string> props = { "S8" };
    ch::Result r = host->gi(path("f", 1), &props);
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(1u, state->non_null);
    ASSERT_EQ(1u, r.instances.size());
    EXPECT_EQ("-101", r.instances[0].get_text("S8"));
    EXPECT_EQ(nullptr, r.instances[0].get("U8"));
}

TEST_F(Adapter, InvokeMethodByNameInAnyCase)
{
    std::vector<ch::Property> in;
    in.push_back(ch::Property { "Text", ch::Value::of_string("hello") });
    ch::Value lines;
    lines.type = CMPI_stringA;
    lines.null = false;
    lines.elements = { ch::Value::of_string("a"), ch::Value::of_string("b"),
                       ch::Value::of_string("c") };
    in.push_back(ch::Property { "lines", lines });

    ch::Result r = host->cm(path("p", 3), "fROB", in);
    ASSERT_TRUE(r.ok()) << ch::rc_name(r.rc) << " " << r.message;
    EXPECT_STREQ("Frob", state->last_op);
    EXPECT_STREQ("p", state->name);
    EXPECT_EQ(3u, state->index);
    EXPECT_STREQ("hello", state->text);
    EXPECT_EQ(3u, state->lines);

    // The provider reached the request's context through the runtime.
    EXPECT_TRUE(state->user_ok);
    EXPECT_STREQ("cimhost", state->user);

    EXPECT_EQ(CMPI_uint32, r.return_value.type);
    EXPECT_EQ(7u, r.return_value.num.uint32);

    bool count = false, made = false;
    for (const ch::Property& p : r.out)
    {
        EXPECT_NE("return_value", p.name);
        if (p.name == "Count")
        {
            count = true;
            EXPECT_EQ(6u, p.value.num.uint32);
        }
        if (p.name == "Made")
        {
            made = true;
            ASSERT_TRUE(p.value.ref);
            EXPECT_EQ(CMPI_ref, p.value.type);
            EXPECT_EQ("made", p.value.ref->key("Name")->text());
        }
    }
    EXPECT_TRUE(count);
    EXPECT_TRUE(made);
}

TEST_F(Adapter, InvokeMethodWithoutArgumentsLeavesParametersNull)
{
    ch::Result r = host->cm(path("p", 1), "Frob", {});
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_STREQ("(null)", state->text);
    EXPECT_EQ(1000u, state->lines);
}

// A provider reaches the server from inside a request: its own class again
// (through the recursive lock), and from a thread of its own.
TEST_F(Adapter, ProvidersCallBackIntoTheServer)
{
    state->count = 3;

    struct { const char* text; uint32 count; } rows[] =
    {
        { "enum", 3 },
        { "get", 201 },
        { "invoke", 201 },
        { "create", 3 },
        { "thread", 1 },
    };

    for (const auto& row : rows)
    {
        std::vector<ch::Property> in = { ch::Property { "Text", ch::Value::of_string(row.text) } };
        ch::Result r = host->cm(path("p", 1), "Frob", in);
        ASSERT_TRUE(r.ok()) << row.text << ": " << r.message;
        bool found = false;
        for (const ch::Property& p : r.out)
        {
            if (p.name == "Count")
            {
                found = true;
                EXPECT_EQ(row.count, p.value.num.uint32) << row.text;
            }
        }
        EXPECT_TRUE(found) << row.text;
    }

    // The context prepared for the provider's thread ends with the thread's
    // detachThread, so nothing outlives the test.

    // No instances: the enumerator is false at once.
    state->count = 0;
    std::vector<ch::Property> in = { ch::Property { "Text", ch::Value::of_string("enum") } };
    ch::Result r = host->cm(path("p", 1), "Frob", in);
    ASSERT_TRUE(r.ok());
    for (const ch::Property& p : r.out)
    {
        if (p.name == "Count")
        {
            EXPECT_EQ(0u, p.value.num.uint32);
        }
    }
}

TEST_F(Adapter, UnknownMethodIsNotFound)
{
    ch::Result r = host->cm(path("p", 1), "Frobnicate", {});
    EXPECT_EQ(CMPI_RC_ERR_METHOD_NOT_FOUND, r.rc);
    EXPECT_STREQ("", state->last_op);
}

TEST_F(Adapter, InvokeMethodStatusesMapToReturnCodes)
{
    struct { int status; CMPIrc rc; } rows[] =
    {
        { INVOKE_METHOD_OK, CMPI_RC_OK },
        { INVOKE_METHOD_FAILED, CMPI_RC_ERR_FAILED },
        { INVOKE_METHOD_UNSUPPORTED, CMPI_RC_ERR_NOT_SUPPORTED },
        { INVOKE_METHOD_ACCESS_DENIED, CMPI_RC_ERR_ACCESS_DENIED },
        { -1, CMPI_RC_OK },
    };

    for (const auto& row : rows)
    {
        state->invoke_status = row.status;
        EXPECT_EQ(row.rc, host->cm(path("p", 1), "Frob", {}).rc) << row.status;
    }
}

TEST_F(Adapter, UnknownClassFails)
{
    ch::Object_Path p = cls();
    p.class_name = "TST_Nothing";
    ch::Result r = host->ei(p);
    EXPECT_FALSE(r.ok());
    EXPECT_EQ(0u, state->sent);
}

} // namespace
