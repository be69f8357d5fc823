// Conversion between CMPI objects and instances, with the stand-in's broker
// making the CMPI side.

#include "tst_support.h"
#include "tst_classes.h"
#include "Converter.h"
#include "CMPI_Containers.h"

using namespace OLMA;

namespace
{

class Converter : public Tst_Host
{
protected:

    const CMPIBroker* mb() { return host->broker(); }

    CMPIObjectPath* part_path(const char* name, CMPIType index_type, uint64 index)
    {
        CMPIObjectPath* op = CMNewObjectPath(mb(), "root/test", "TST_Part", 0);
        CMPIString* s = CMNewString(mb(), name, 0);
        CMAddKey(op, "Name", &s, CMPI_string);
        CMPIValue v;
        v.uint64 = index;
        CMAddKey(op, "Index", &v, index_type);
        return op;
    }
};

// Every property of the class, compared slot by slot.
static void expect_same(const Instance* a, const Instance* b)
{
    const Meta_Class* mc = a->meta_class;
    ASSERT_EQ(mc, b->meta_class);

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (mf->flags & FLAG_PROPERTY)
        {
            const Meta_Property* mp = (const Meta_Property*)mf;
            EXPECT_TRUE(property_eq(mp, __slot(a, mp->offset), __slot(b, mp->offset)))
                << mf->name;
        }
    }
}

TEST_F(Converter, EveryTypeMakesTheRoundTrip)
{
    Ref<TST_Part> part(tst_make_part("round", 4));
    part->Peer = tst_make_key("peer", 1);
    part->Embedded = tst_make_part("inner", 2);
    TST_Part* peers[] = { tst_make_key("p1", 1), tst_make_key("p2", 2) };
    part->Peers.set(Array<TST_Part*>(peers, 2));
    TST_Part* embs[] = { tst_make_part("e1", 3) };
    part->Embeddeds.set(Array<TST_Part*>(embs, 1));

    CMPIInstance* ci = 0;
    ASSERT_EQ(0, make_cmpi_instance(mb(), part.ptr(), "root/test", 0, 0, ci));
    ASSERT_TRUE(ci);

    // The CMPI types of the mapping table; references by their flags.
    struct { const char* name; CMPIType type; } rows[] =
    {
        { "B", CMPI_boolean }, { "U8", CMPI_uint8 }, { "S8", CMPI_sint8 },
        { "U16", CMPI_uint16 }, { "S16", CMPI_sint16 }, { "U32", CMPI_uint32 },
        { "S32", CMPI_sint32 }, { "U64", CMPI_uint64 }, { "S64", CMPI_sint64 },
        { "R32", CMPI_real32 }, { "R64", CMPI_real64 }, { "C16", CMPI_char16 },
        { "Str", CMPI_string }, { "Dt", CMPI_dateTime },
        { "AB", CMPI_booleanA }, { "AU64", CMPI_uint64A }, { "AStr", CMPI_stringA },
        { "ADt", CMPI_dateTimeA }, { "AC16", CMPI_char16A },
        { "Peer", CMPI_ref }, { "Embedded", CMPI_instance },
        { "Peers", CMPI_refA }, { "Embeddeds", CMPI_instanceA },
    };

    for (const auto& row : rows)
    {
        CMPIStatus st;
        CMPIData d = CMGetProperty(ci, row.name, &st);
        EXPECT_EQ(CMPI_RC_OK, st.rc) << row.name;
        EXPECT_EQ(row.type, d.type) << row.name;
    }

    Instance* back_ptr = 0;
    const CMPIObjectPath* op = CMGetObjectPath(ci, 0);
    ASSERT_EQ(0, make_tessel_instance(mb(), &TST_Part::static_meta_class, op, ci, back_ptr));
    Ref<TST_Part> back((TST_Part*)back_ptr);

    expect_same(part.ptr(), back.ptr());

    ASSERT_TRUE(back->Peer);
    EXPECT_TRUE(key_eq(part->Peer, back->Peer));
    ASSERT_TRUE(back->Embedded);
    EXPECT_EQ("text-inner", back->Embedded->Str.value);
    ASSERT_EQ(2u, back->Peers.value.size());
    EXPECT_EQ("p2", back->Peers.value[1]->Name.value);
    ASSERT_EQ(1u, back->Embeddeds.value.size());
    EXPECT_EQ(203u, back->Embeddeds.value[0]->U8.value);

    // Nested instances without a namespace of their own take the request's.
    EXPECT_EQ("root/test", back->Peer->__name_space);
    EXPECT_EQ("root/test", back->__name_space);
}

TEST_F(Converter, NullPropertiesStayNullBothWays)
{
    Ref<TST_Part> part(tst_make_key("keys", 1));
    CMPIInstance* ci = 0;
    ASSERT_EQ(0, make_cmpi_instance(mb(), part.ptr(), "root/test", 0, 0, ci));

    // Null properties are left out of the CMPI instance.
    EXPECT_EQ(2u, CMGetPropertyCount(ci, 0));

    // A null string in CMPI gives an empty string with null set.
    CMSetProperty(ci, "Str", 0, CMPI_null);
    CMPIValue v;
    v.string = 0;
    CMSetProperty(ci, "Str", &v, CMPI_string);

    Instance* back_ptr = 0;
    ASSERT_EQ(0, make_tessel_instance(mb(), &TST_Part::static_meta_class,
        CMGetObjectPath(ci, 0), ci, back_ptr));
    Ref<TST_Part> back((TST_Part*)back_ptr);
    EXPECT_EQ(1, back->Str.null);
    EXPECT_EQ("", back->Str.value);
    EXPECT_EQ(1, back->U8.null);
    EXPECT_EQ(0, back->Name.null);
}

TEST_F(Converter, OneBadPropertyCostsALogLineNotTheCall)
{
    CMPIObjectPath* op = part_path("bad", CMPI_uint64, 1);
    CMPIInstance* ci = CMNewInstance(mb(), op, 0);
    CMPIValue v;
    v.uint8 = 5;
    CMSetProperty(ci, "U8", &v, CMPI_uint8);
    CMPIString* s = CMNewString(mb(), "no such", 0);
    CMSetProperty(ci, "Bogus", &s, CMPI_string);
    s = CMNewString(mb(), "not a number", 0);
    CMSetProperty(ci, "U16", &s, CMPI_string);
    s = CMNewString(mb(), "2010", 0);
    CMSetProperty(ci, "Str", &s, CMPI_string);

    Instance* back_ptr = 0;
    ASSERT_EQ(0, make_tessel_instance(mb(), &TST_Part::static_meta_class, op, ci, back_ptr));
    Ref<TST_Part> back((TST_Part*)back_ptr);
    EXPECT_EQ(0, back->U8.null);
    EXPECT_EQ(5, back->U8.value);
    EXPECT_EQ(1, back->U16.null);
    EXPECT_EQ("2010", back->Str.value);
}

TEST_F(Converter, PathKeysNarrowWithoutRangeCheck)
{
    Instance* x = 0;
    ASSERT_EQ(0, make_tessel_reference(0, &TST_Part::static_meta_class,
        part_path("n", CMPI_uint64, 70000), x));
    Ref<TST_Part> ref((TST_Part*)x);
    EXPECT_EQ(4464, ref->Index.value);
    EXPECT_EQ(0, ref->Index.null);
    EXPECT_EQ("n", ref->Name.value);
    // Only keys are read from a path; the rest stays null.
    EXPECT_EQ(1, ref->U8.null);
    EXPECT_EQ("root/test", ref->__name_space);

    // A key of the declared type passes as it is; another type doesn't.
    ASSERT_EQ(0, make_tessel_reference(0, &TST_Part::static_meta_class,
        part_path("n", CMPI_uint16, 12), x));
    ref.reset((TST_Part*)x);
    EXPECT_EQ(12, ref->Index.value);

    ASSERT_EQ(0, make_tessel_reference(0, &TST_Part::static_meta_class,
        part_path("n", CMPI_real64, 12), x));
    ref.reset((TST_Part*)x);
    EXPECT_EQ(1, ref->Index.null);

    // A signed 64-bit key becomes an unsigned 32-bit one, null cleared.
    CMPIObjectPath* op = CMNewObjectPath(mb(), "root/test", "TST_Part", 0);
    CMPIValue v;
    v.sint64 = -1;
    CMAddKey(op, "K", &v, CMPI_sint64);
    CMPIObjectPath_Container c(&tst_repository, mb(), "root/test", op);
    Value value;
    ASSERT_EQ(0, c.get_value(0, Value::UINT32, value));
    uint32 u = 0;
    EXPECT_EQ(0, value.get_value(u));
    EXPECT_EQ(4294967295u, u);
    EXPECT_EQ(-1, c.get_value(0, Value::STRING, value));
    EXPECT_EQ(-1, c.get_value(1, Value::UINT32, value));
}

TEST_F(Converter, ArraysWithNullElements)
{
    // A string array with a null element fails as a whole.
    CMPIArray* strings = CMNewArray(mb(), 2, CMPI_string, 0);
    CMPIString* s = CMNewString(mb(), "a", 0);
    CMSetArrayElementAt(strings, 0, &s, CMPI_string);
    CMSetArrayElementAt(strings, 1, 0, CMPI_null);

    CMPIData d;
    d.type = CMPI_stringA;
    d.state = 0;
    d.value.array = strings;
    Value value;
    EXPECT_EQ(-1, cmpi_to_tessel_value(&tst_repository, mb(), "root/test", d, value));

    // A reference array keeps its null element as a null pointer.
    CMPIArray* refs = CMNewArray(mb(), 2, CMPI_ref, 0);
    CMPIObjectPath* op = part_path("r", CMPI_uint64, 1);
    CMSetArrayElementAt(refs, 0, &op, CMPI_ref);
    CMSetArrayElementAt(refs, 1, 0, CMPI_null);
    d.type = CMPI_refA;
    d.value.array = refs;
    ASSERT_EQ(0, cmpi_to_tessel_value(&tst_repository, mb(), "root/test", d, value));
    Array<Instance*> a;
    ASSERT_EQ(0, value.get_value(a));
    ASSERT_EQ(2u, a.size());
    ASSERT_TRUE(a[0]);
    EXPECT_EQ("r", ((TST_Part*)a[0])->Name.value);
    EXPECT_EQ(nullptr, a[1]);

    // A class the repository lacks fails the element, and the value.
    CMPIObjectPath* alien = CMNewObjectPath(mb(), "root/test", "TST_Alien", 0);
    CMSetArrayElementAt(refs, 1, &alien, CMPI_ref);
    EXPECT_EQ(-1, cmpi_to_tessel_value(&tst_repository, mb(), "root/test", d, value));
}

TEST_F(Converter, NullDataAndDatetimes)
{
    CMPIData d;
    memset(&d, 0, sizeof(d));
    d.state = CMPI_nullValue;
    Value value;

    d.type = CMPI_uint32A;
    ASSERT_EQ(0, cmpi_to_tessel_value(&tst_repository, mb(), "", d, value));
    EXPECT_EQ(Value::UINT32_ARRAY, value.type);
    EXPECT_EQ(1, value.null);

    d.type = CMPI_ref;
    ASSERT_EQ(0, cmpi_to_tessel_value(&tst_repository, mb(), "", d, value));
    EXPECT_EQ(Value::INSTANCE, value.type);
    EXPECT_EQ(1, value.null);

    d.type = CMPI_args;
    EXPECT_EQ(-1, cmpi_to_tessel_value(&tst_repository, mb(), "", d, value));

    // Intervals and timestamps both pass.
    const char* texts[] = { "00000010101010.000001:000", "20201231120000.000000-120" };
    for (const char* text : texts)
    {
        d.state = 0;
        d.type = CMPI_dateTime;
        d.value.dateTime = CMNewDateTimeFromChars(mb(), text, 0);
        ASSERT_EQ(0, cmpi_to_tessel_value(&tst_repository, mb(), "", d, value)) << text;
        Datetime dt;
        ASSERT_EQ(0, value.get_value(dt));
        EXPECT_EQ(text, dt.ascii(false)) << text;
    }
}

TEST_F(Converter, MethodResultTravelsApartFromOutputArguments)
{
    Ref<Instance> m(create(&TST_Part_Frob_method::static_meta_class));
    __set_null_flags(m.ptr(), true, true, 1);
    TST_Part_Frob_method* frob = (TST_Part_Frob_method*)m.ptr();
    frob->Count.set(3);
    frob->Text.set("in only");
    frob->return_value.set(42);

    CMPIArgs* out = CMNewArgs(mb(), 0);
    CMPIValue rv;
    CMPIType type = 99;
    ASSERT_EQ(0, make_cmpi_method(mb(), "root/test", m.ptr(), out, rv, type));
    EXPECT_EQ(CMPI_uint32, type);
    EXPECT_EQ(42u, rv.uint32);

    // Output parameters only, and no return_value among them.
    EXPECT_EQ(1u, CMGetArgCount(out, 0));
    CMPIData d = CMGetArg(out, "Count", 0);
    EXPECT_EQ(CMPI_uint32, d.type);
    EXPECT_EQ(3u, d.value.uint32);

    frob->return_value.null = 1;
    ASSERT_EQ(0, make_cmpi_method(mb(), "root/test", m.ptr(), CMNewArgs(mb(), 0), rv, type));
    EXPECT_EQ(0, type);
}

} // namespace
