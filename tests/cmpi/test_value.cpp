// Values: ownership, type checks, and the generic Container loops.

#include <gtest/gtest.h>
#include "tst_classes.h"
#include "Value.h"
#include "Container.h"

using namespace OLMA;

namespace
{

TEST(Value, TypeChecksLeaveTheTargetAlone)
{
    Value v;
    EXPECT_EQ(Value::NONE, v.type);
    EXPECT_EQ(0, v.null);

    v.set_value(uint32(7));
    String s("kept");
    EXPECT_EQ(-1, v.get_value(s));
    EXPECT_EQ("kept", s);
    uint16 narrow = 1;
    EXPECT_EQ(-1, v.get_value(narrow));
    EXPECT_EQ(1, narrow);

    v.set_value("text");
    EXPECT_EQ(Value::STRING, v.type);
    EXPECT_EQ(0, v.get_value(s));
    EXPECT_EQ("text", s);

    v.clear();
    EXPECT_EQ(Value::NONE, v.type);
    EXPECT_EQ(1, v.null);

    EXPECT_STREQ("instance_array", name_of(Value::INSTANCE_ARRAY));
    EXPECT_STREQ("DATETIME_ARRAY", _type_name(Value::DATETIME_ARRAY));
    EXPECT_STREQ("none", name_of(Value::NONE));
}

TEST(Value, CopiesShareReferencesAndArraysCopy)
{
    TST_Part* part = tst_make_key("p", 1);
    {
        // The value takes over the reference it is given.
        ref(part);
        Value v;
        v.set_value((Instance*)part);
        EXPECT_EQ(2u, part->refs);

        Value copy(v);
        EXPECT_EQ(3u, part->refs);
        copy = copy;
        EXPECT_EQ(3u, part->refs);
        copy.clear();
        EXPECT_EQ(2u, part->refs);

        Instance* arr[] = { part, 0 };
        ref(part);
        Value va;
        va.set_value(Array<Instance*>(arr, 2));
        Value vb = va;
        EXPECT_EQ(4u, part->refs);

        // The value's own string isn't lost when set from itself.
        Value s;
        s.set_value("self");
        String text;
        s.get_value(text);
        s.set_value(text);
        s.get_value(text);
        EXPECT_EQ("self", text);

        uint8 bytes[] = { 1, 2 };
        Value a;
        a.set_value(Array<uint8>(bytes, 2));
        Value b = a;
        Array<uint8> out;
        ASSERT_EQ(0, b.get_value(out));
        out[0] = 9;
        Array<uint8> again;
        a.get_value(again);
        EXPECT_EQ(1, again[0]);
    }
    EXPECT_EQ(1u, part->refs);
    unref(part);
}

TEST(Value, SlotsReadAndWrittenByFeature)
{
    Ref<TST_Part> part(tst_make_part("slot", 2));
    const Meta_Class* mc = &TST_Part::static_meta_class;

    Value v;
    ASSERT_EQ(0, v.set(part.ptr(), find_feature(mc, "AStr", FLAG_PROPERTY)));
    EXPECT_EQ(Value::STRING_ARRAY, v.type);

    Ref<TST_Part> other(tst_make_key("other", 3));
    ASSERT_EQ(0, v.get(other.ptr(), find_feature(mc, "AStr", FLAG_PROPERTY)));
    EXPECT_EQ(3u, other->AStr.value.size());
    EXPECT_EQ(0, other->AStr.null);

    // Wrong feature type: refused, slot unchanged.
    EXPECT_EQ(-1, v.get(other.ptr(), find_feature(mc, "U8", FLAG_PROPERTY)));
    EXPECT_EQ(1, other->U8.null);
    EXPECT_EQ(-1, v.get(0, find_feature(mc, "AStr", FLAG_PROPERTY)));

    // A null reference reads as a null INSTANCE; an instance of another
    // class can't be written into a reference.
    const Meta_Feature* peer = find_feature(mc, "Peer", FLAG_REFERENCE);
    ASSERT_EQ(0, v.set(other.ptr(), peer));
    EXPECT_EQ(Value::INSTANCE, v.type);
    EXPECT_EQ(1, v.null);

    Instance* plain = create(&Instance::static_meta_class, false);
    v.set_value(plain);
    EXPECT_EQ(-1, v.get(other.ptr(), peer));
    EXPECT_EQ(nullptr, other->Peer);

    v.set_value((Instance*)tst_make_key("peer", 4));
    ASSERT_EQ(0, v.get(other.ptr(), peer));
    ASSERT_TRUE(other->Peer);
    EXPECT_EQ(2u, other->Peer->refs);

    EXPECT_EQ(Value::INSTANCE_ARRAY, Value::type_of(find_feature(mc, "Peers", FLAG_REFERENCE)));
    EXPECT_EQ(Value::NONE, Value::type_of(find_feature(mc, "Frob", FLAG_METHOD)));
    EXPECT_EQ(-1, v.set(part.ptr(), find_feature(mc, "Frob", FLAG_METHOD)));
}

// A foreign object made of a fixed list of named values.
class List_Container : public Container
{
public:

    List_Container() : Container(&tst_repository) { }

    size_t get_size() override { return names.size(); }

    int get_name(size_t i, String& name) override
    {
        if (i >= names.size())
            return -1;
        name = names[i].c_str();
        return 0;
    }

    int get_value(size_t i, Value::Type type, Value& value) override
    {
        value = values[i];
        return value.type == type ? 0 : -1;
    }

    int set_value(const char* name, const Value& value, uint32) override
    {
        names.push_back(name);
        values.push_back(value);
        return 0;
    }

    std::vector<std::string> names;
    std::vector<Value> values;
};

TEST(Container, ConvertsBothWaysAndForgives)
{
    Ref<TST_Part> part(tst_make_part("c", 1));
    List_Container list;
    ASSERT_EQ(0, list.convert(part.ptr(), 0));
    // Every property and the (empty) reference arrays; the null references
    // are left out.
    EXPECT_EQ(32u, list.names.size());

    List_Container keys;
    ASSERT_EQ(0, keys.convert(part.ptr(), FLAG_KEY));
    ASSERT_EQ(2u, keys.names.size());
    EXPECT_EQ("Name", keys.names[0]);

    // Back, with an unknown name and a value of the wrong type among them.
    list.names.push_back("Nothing");
    list.values.push_back(Value());
    list.values[2].set_value("not a boolean");

    Instance* back = 0;
    ASSERT_EQ(0, list.convert(&TST_Part::static_meta_class, 0, back));
    Ref<TST_Part> b((TST_Part*)back);
    EXPECT_EQ(1, b->B.null);
    EXPECT_EQ(0, b->U8.null);
    EXPECT_EQ(201, b->U8.value);
    EXPECT_EQ("text-c", b->Str.value);

    // With the Key flag every non-key stays null.
    back = 0;
    ASSERT_EQ(0, list.convert(&TST_Part::static_meta_class, FLAG_KEY, back));
    b.reset((TST_Part*)back);
    EXPECT_EQ(0, b->Name.null);
    EXPECT_EQ(1, b->U8.null);
    EXPECT_EQ(1, b->AStr.null);

    EXPECT_EQ(-1, list.convert((const Instance*)0, 0));
}

} // namespace
