#include <gtest/gtest.h>
#include <cmath>
#include <thread>
#include <vector>
#include "records.h"

using namespace OLMA;

namespace
{

Test_Device* make_device(const char* id)
{
    Test_Device* d = create<Test_Device>(true);
    d->SystemCreationClassName.set("Test_System");
    d->SystemName.set("host");
    d->CreationClassName.set("Test_Device");
    d->DeviceID.set(id);
    return d;
}

Test_Port* make_port(const char* id)
{
    Test_Port* p = create<Test_Port>(true);
    p->SystemCreationClassName.set("Test_System");
    p->SystemName.set("host");
    p->CreationClassName.set("Test_Port");
    p->DeviceID.set(id);
    return p;
}

} // namespace

TEST(Instance, CreateWithAndWithoutDefaults)
{
    Ref<Test_Device> d(create<Test_Device>(true));
    EXPECT_EQ(d->magic, (uint32)INSTANCE_MAGIC);
    EXPECT_EQ(d->refs, 1u);
    EXPECT_EQ(d->meta_class, &Test_Device::static_meta_class);
    EXPECT_EQ(d->__name_space.size(), 0u);

    EXPECT_EQ(d->PortAvailability.value, 2);
    EXPECT_EQ(d->PortAvailability.null, 0);
    EXPECT_EQ(d->Caption.null, 1);
    EXPECT_EQ(d->Description.null, 0);
    EXPECT_STREQ(d->Description.value.c_str(), "none");
    ASSERT_EQ(d->OperationalStatus.value.size(), 2u);
    EXPECT_EQ(d->OperationalStatus.value[0], 2);
    EXPECT_EQ(d->OperationalStatus.value[1], 5);
    EXPECT_EQ(d->OperationalStatus.null, 0);
    EXPECT_EQ(d->Uptime.null, 0);
    EXPECT_TRUE(d->Uptime.value.is_interval());
    EXPECT_EQ(d->Uptime.value.usec(), 86400000000ULL);
    ASSERT_EQ(d->Aliases.value.size(), 2u);
    EXPECT_STREQ(d->Aliases.value[1].c_str(), "b");
    EXPECT_EQ(d->Speed.null, 1);
    EXPECT_EQ(d->DeviceID.null, 1);

    Ref<Test_Device> e(create<Test_Device>(false));
    EXPECT_EQ(e->PortAvailability.value, 0);
    EXPECT_EQ(e->PortAvailability.null, 0);
    EXPECT_EQ(e->Caption.null, 0);
    EXPECT_EQ(e->OperationalStatus.value.size(), 0u);
    EXPECT_EQ(e->OperationalStatus.null, 0);
    EXPECT_EQ(e->Aliases.value.size(), 0u);
    EXPECT_TRUE(e->Started.value.is_interval());

    EXPECT_EQ(create((const Meta_Class*)0, true), (Instance*)0);
}

TEST(Instance, MethodRecordStartsNull)
{
    Ref<Test_Port_Reset_method> m(create<Test_Port_Reset_method>());
    EXPECT_EQ((const void*)m->meta_class, (const void*)&Test_Port_Reset_method::static_meta_class);
    EXPECT_EQ(m->Force.null, 1);
    EXPECT_EQ(m->return_value.null, 1);
    EXPECT_EQ(m->Job, (Test_Job*)0);

    m->Job = create<Test_Job>(false);
    m->Job->InstanceID.set("job-1");
    Ref<Test_Port_Reset_method> c(clone(m.ptr()));
    ASSERT_NE(c->Job, (Test_Job*)0);
    EXPECT_NE(c->Job, m->Job);
    EXPECT_STREQ(c->Job->InstanceID.value.c_str(), "job-1");
}

TEST(Instance, CloneIsDeepAndIndependent)
{
    Ref<Test_Dependency> a(create<Test_Dependency>(true));
    a->__name_space = "root/test";
    a->Antecedent = make_device("d1");
    a->Dependent = make_port("p1");
    ((Test_Device*)a->Antecedent)->Aliases.value.append(String("c"));

    Ref<Test_Dependency> b(clone(a.ptr()));
    EXPECT_EQ(b->refs, 1u);
    EXPECT_TRUE(identical(a.ptr(), b.ptr()));
    EXPECT_NE(b->Antecedent, a->Antecedent);
    EXPECT_EQ(b->Antecedent->refs, 1u);
    EXPECT_EQ(b->Antecedent->meta_class, &Test_Device::static_meta_class);
    EXPECT_EQ(b->Dependent->meta_class, &Test_Port::static_meta_class);

    // Changing the clone's referenced instance leaves the source alone.
    ((Test_Device*)b->Antecedent)->DeviceID.set("other");
    ((Test_Device*)b->Antecedent)->Aliases.value.remove(0);
    EXPECT_STREQ(((Test_Device*)a->Antecedent)->DeviceID.value.c_str(), "d1");
    EXPECT_EQ(((Test_Device*)a->Antecedent)->Aliases.value.size(), 3u);
    EXPECT_FALSE(identical(a.ptr(), b.ptr()));
}

TEST(Instance, CloneOfReferenceArray)
{
    Ref<Test_Collection> c(create<Test_Collection>(true));
    Test_Device* d = make_device("d1");
    Test_Device* none = 0;
    c->Members.value.append(d);
    c->Members.value.append(none);
    c->Members.null = 0;

    Ref<Test_Collection> e(clone(c.ptr()));
    ASSERT_EQ(e->Members.value.size(), 2u);
    EXPECT_NE(e->Members.value[0], d);
    EXPECT_TRUE(key_eq(e->Members.value[0], d));
    EXPECT_EQ(e->Members.value[1], (Test_Device*)0);
    EXPECT_TRUE(identical(c.ptr(), e.ptr()));

    e->Members.null = 1;
    EXPECT_FALSE(identical(c.ptr(), e.ptr()));

    clear(e.ptr());
    EXPECT_EQ(e->Members.value.size(), 0u);
    EXPECT_EQ(e->Members.null, 1);
    EXPECT_EQ(e->InstanceID.null, 1);
}

TEST(Instance, RefCountsAcrossThreads)
{
    Test_Device* d = make_device("d1");
    const int threads = 4;
    const int rounds = 20000;
    std::vector<std::thread> pool;

    for (int t = 0; t < threads; t++)
    {
        pool.emplace_back([d]() {
            for (int i = 0; i < rounds; i++)
            {
                ref(d);
                Ref<Test_Device> r(d);
                Ref<Test_Device> s(r);
                unref(d);
                ref(d);
            }
        });
    }

    for (auto& t : pool)
        t.join();

    // Lost updates would have freed it early or left it over-counted.
    EXPECT_EQ(d->refs, 1u);
    unref(d);
}

TEST(Instance, RefSemantics)
{
    Test_Device* d = make_device("d1");
    {
        Ref<Test_Device> a(d);
        EXPECT_EQ(d->refs, 1u);
        Ref<Test_Device> b;
        b = a;
        b = b;
        Ref<Instance> c(a);
        EXPECT_EQ(d->refs, 3u);
        unref(b.steal());
        EXPECT_EQ(d->refs, 2u);
    }

    unref((Instance*)0);
    destroyer(0);
}

TEST(Instance, CheckedCast)
{
    Ref<Test_Port> p(make_port("p1"));
    Ref<Test_Job> j(create<Test_Job>(true));

    EXPECT_EQ(checked_cast<Test_Device>((Instance*)p.ptr()), p.ptr());
    EXPECT_EQ(checked_cast<Test_ManagedElement>((Instance*)p.ptr()), p.ptr());
    EXPECT_EQ(checked_cast<Instance>((Instance*)p.ptr()), p.ptr());
    EXPECT_EQ(checked_cast<Test_Device>((Instance*)j.ptr()), (Test_Device*)0);
    EXPECT_EQ(checked_cast<Test_Port>((const Instance*)0), (const Test_Port*)0);

    Ref<Test_Device> d(make_device("d1"));
    EXPECT_EQ(checked_cast<Test_Port>((Instance*)d.ptr()), (Test_Port*)0);
}

TEST(Instance, KeyEqAcrossSubclassAndParent)
{
    Ref<Test_Port> port(make_port("p1"));
    port->Speed.set(100);

    // A model of the parent class with the same keys.
    Ref<Test_Device> model(create<Test_Device>(false));
    model->SystemCreationClassName.set("Test_System");
    model->SystemName.set("host");
    model->CreationClassName.set("Test_Port");
    model->DeviceID.set("p1");
    __set_null_flags(model.ptr(), false, true, 1);

    EXPECT_TRUE(key_eq(model.ptr(), port.ptr()));
    EXPECT_TRUE(key_eq(port.ptr(), model.ptr()));

    // Key values compare with regard to case.
    model->DeviceID.set("P1");
    EXPECT_FALSE(key_eq(model.ptr(), port.ptr()));

    // A null key against a value differs; two nulls compare stale values.
    model->DeviceID.set("p1");
    model->DeviceID.null = 1;
    EXPECT_FALSE(key_eq(model.ptr(), port.ptr()));
    port->DeviceID.null = 1;
    EXPECT_TRUE(key_eq(model.ptr(), port.ptr()));
    port->DeviceID.value = "stale";
    EXPECT_FALSE(key_eq(model.ptr(), port.ptr()));

    // A class that lacks the keys doesn't match.
    Ref<Test_Job> job(create<Test_Job>(false));
    EXPECT_FALSE(key_eq(port.ptr(), job.ptr()));

    // No keys: always equal.
    Ref<Test_Alert> a1(create<Test_Alert>(true));
    Ref<Test_Alert> a2(create<Test_Alert>(true));
    a2->Message.set("x");
    EXPECT_TRUE(key_eq(a1.ptr(), a2.ptr()));
}

TEST(Instance, KeyEqOfReferences)
{
    // An instance of the narrowed association against a model of the base.
    Ref<Test_PortOfDevice> x(create<Test_PortOfDevice>(true));
    x->Antecedent = make_device("d1");
    x->Dependent = make_port("p1");

    Ref<Test_Dependency> m(create<Test_Dependency>(true));
    m->Antecedent = make_device("d1");
    m->Dependent = make_port("p1");
    EXPECT_TRUE(key_eq(m.ptr(), x.ptr()));
    EXPECT_TRUE(key_eq(x.ptr(), m.ptr()));

    ((Test_Port*)m->Dependent)->DeviceID.set("p2");
    EXPECT_FALSE(key_eq(m.ptr(), x.ptr()));

    unref(m->Dependent);
    m->Dependent = 0;
    EXPECT_FALSE(key_eq(m.ptr(), x.ptr()));

    Ref<Test_Dependency> n(create<Test_Dependency>(true));
    n->Antecedent = make_device("d1");
    EXPECT_TRUE(key_eq(m.ptr(), n.ptr()));
}

TEST(Instance, PropertyEqByType)
{
    Ref<Test_Device> a(make_device("d1"));
    Ref<Test_Device> b(make_device("d1"));
    const Meta_Property* temp = find_property(&Test_Device::static_meta_class, "temperature");
    const Meta_Property* load = find_property(&Test_Device::static_meta_class, "Load");
    const Meta_Property* started = find_property(&Test_Device::static_meta_class, "Started");
    ASSERT_TRUE(temp && load && started);

    a->Temperature.set(NAN);
    b->Temperature.set(NAN);
    EXPECT_FALSE(property_eq(temp, &a->Temperature, &b->Temperature));
    a->Temperature.set(-0.0f);
    b->Temperature.set(0.0f);
    EXPECT_TRUE(property_eq(temp, &a->Temperature, &b->Temperature));

    a->Load.set(1.5);
    b->Load.set(1.5);
    EXPECT_TRUE(property_eq(load, &a->Load, &b->Load));
    b->Load.null = 1;
    EXPECT_FALSE(property_eq(load, &a->Load, &b->Load));

    // Same instant, different zone or kind: different datetimes.
    a->Started.set(Datetime(1000, 60));
    b->Started.set(Datetime(1000, 0));
    EXPECT_FALSE(property_eq(started, &a->Started, &b->Started));
    b->Started.set(Datetime(1000ULL));
    EXPECT_FALSE(property_eq(started, &a->Started, &b->Started));
    b->Started.set(Datetime(1000, 60));
    EXPECT_TRUE(property_eq(started, &a->Started, &b->Started));
}

TEST(Instance, IdenticalComparesEverything)
{
    Ref<Test_Device> a(make_device("d1"));
    Ref<Test_Device> b(clone(a.ptr()));
    EXPECT_TRUE(identical(a.ptr(), b.ptr()));

    b->__name_space = "root/x";
    EXPECT_FALSE(identical(a.ptr(), b.ptr()));
    b->__name_space.clear();

    b->Aliases.value.append(String("c"));
    EXPECT_FALSE(identical(a.ptr(), b.ptr()));
    b->Aliases.value.remove(2);
    EXPECT_TRUE(identical(a.ptr(), b.ptr()));

    // Same keys and values, different class.
    Ref<Test_Port> p(make_port("d1"));
    p->CreationClassName.set("Test_Device");
    EXPECT_TRUE(key_eq(a.ptr(), p.ptr()));
    EXPECT_FALSE(identical(a.ptr(), p.ptr()));
}

TEST(Instance, CopyAndCopyWithModel)
{
    Ref<Test_Device> src(make_device("d1"));
    src->Speed.set(10);
    src->Caption.set("cap");
    src->__name_space = "ns";

    Ref<Test_Device> dest(create<Test_Device>(true));
    copy(dest.ptr(), src.ptr());
    EXPECT_STREQ(dest->DeviceID.value.c_str(), "d1");
    EXPECT_EQ(dest->Speed.value, 10u);
    EXPECT_EQ(dest->Speed.null, 0);
    EXPECT_STREQ(dest->Caption.value.c_str(), "cap");
    // The namespace isn't a feature.
    EXPECT_EQ(dest->__name_space.size(), 0u);

    // Only what the model wants.
    Ref<Test_Device> model(create<Test_Device>(true));
    __set_null_flags(model.ptr(), true, true, 1);
    model->Speed.null = 0;
    Ref<Test_Device> partial(create<Test_Device>(true));
    copy(partial.ptr(), src.ptr(), model.ptr());
    EXPECT_EQ(partial->Speed.value, 10u);
    EXPECT_EQ(partial->DeviceID.null, 1);
    EXPECT_EQ(partial->Caption.null, 1);

    // Keys only.
    Ref<Test_Device> keys(create<Test_Device>(true));
    copy_keys(keys.ptr(), src.ptr());
    EXPECT_STREQ(keys->DeviceID.value.c_str(), "d1");
    EXPECT_EQ(keys->Speed.null, 1);

    // Between classes nothing happens.
    Ref<Test_Port> port(create<Test_Port>(true));
    copy(port.ptr(), src.ptr());
    EXPECT_EQ(port->DeviceID.null, 1);

    // References are cloned; the old ones are released.
    Ref<Test_Dependency> a(create<Test_Dependency>(true));
    a->Antecedent = make_device("d1");
    Ref<Test_Dependency> b(create<Test_Dependency>(true));
    b->Antecedent = make_device("old");
    b->Dependent = make_device("gone");
    copy(b.ptr(), a.ptr());
    EXPECT_TRUE(identical(a.ptr(), b.ptr()));
    EXPECT_NE(a->Antecedent, b->Antecedent);

    // Copying onto itself changes nothing.
    copy(a.ptr(), a.ptr());
    EXPECT_STREQ(((Test_Device*)a->Antecedent)->DeviceID.value.c_str(), "d1");
}

TEST(Instance, KeyCloneAndKeysNonNull)
{
    Ref<Test_Device> d(make_device("d1"));
    d->Speed.set(5);
    EXPECT_TRUE(keys_non_null(d.ptr()));

    Ref<Test_Device> k(key_clone(d.ptr()));
    EXPECT_TRUE(key_eq(k.ptr(), d.ptr()));
    EXPECT_EQ(k->Speed.null, 1);
    EXPECT_EQ(k->PortAvailability.null, 1);
    EXPECT_TRUE(keys_non_null(k.ptr()));

    k->SystemName.null = 1;
    EXPECT_FALSE(keys_non_null(k.ptr()));

    Ref<Test_Dependency> a(create<Test_Dependency>(true));
    a->Antecedent = make_device("d1");
    EXPECT_FALSE(keys_non_null(a.ptr()));
    a->Dependent = make_device("d2");
    EXPECT_TRUE(keys_non_null(a.ptr()));
}

TEST(Instance, ClearNullsEverything)
{
    Ref<Test_Dependency> a(create<Test_Dependency>(true));
    a->Antecedent = make_device("d1");
    a->__name_space = "ns";
    clear(a.ptr());
    EXPECT_EQ(a->Antecedent, (Test_ManagedElement*)0);
    EXPECT_EQ(a->__name_space.size(), 0u);

    Ref<Test_Device> d(make_device("d1"));
    d->Speed.set(7);
    clear(d.ptr());
    EXPECT_EQ(d->Speed.value, 0u);
    EXPECT_EQ(d->Speed.null, 1);
    EXPECT_EQ(d->DeviceID.value.size(), 0u);
    EXPECT_EQ(d->DeviceID.null, 1);
    EXPECT_EQ(d->OperationalStatus.value.size(), 0u);
    EXPECT_EQ(d->OperationalStatus.null, 1);
}

TEST(Instance, NullFlagsAndFilterProperties)
{
    Ref<Test_Device> d(make_device("d1"));

    __set_null_flags(d.ptr(), false, true, 1);
    EXPECT_EQ(d->DeviceID.null, 0);
    EXPECT_EQ(d->Description.null, 1);
    __set_null_flags(d.ptr(), true, false, 1);
    EXPECT_EQ(d->DeviceID.null, 1);
    __set_null_flags(d.ptr(), true, true, 0);
    EXPECT_EQ(d->DeviceID.null, 0);
    EXPECT_EQ(d->Caption.null, 0);

    // Keys kept as they were; names match in any case; unknown names and
    // key names are ignored.
    d->SystemName.null = 1;
    const char* names[] = { "speed", "NoSuchThing", "DeviceID", "ALIASES", 0 };
    EXPECT_EQ(filter_properties(d.ptr(), names, true), 0);
    EXPECT_EQ(d->Speed.null, 0);
    EXPECT_EQ(d->Aliases.null, 0);
    EXPECT_EQ(d->Caption.null, 1);
    EXPECT_EQ(d->PortAvailability.null, 1);
    EXPECT_EQ(d->DeviceID.null, 0);
    EXPECT_EQ(d->SystemName.null, 1);

    // Without keep_keys the keys are nulled too, and naming one doesn't help.
    EXPECT_EQ(filter_properties(d.ptr(), names, false), 0);
    EXPECT_EQ(d->DeviceID.null, 1);
    EXPECT_EQ(d->Speed.null, 0);

    // Null list: everything wanted.
    EXPECT_EQ(filter_properties(d.ptr(), 0, true), 0);
    EXPECT_EQ(d->DeviceID.null, 0);
    EXPECT_EQ(d->Caption.null, 0);

    // A method name ends the filter with -1.
    Ref<Test_Port> p(make_port("p1"));
    const char* with_method[] = { "Speed", "reset", "Caption", 0 };
    EXPECT_EQ(filter_properties(p.ptr(), with_method, true), -1);
    EXPECT_EQ(p->Speed.null, 0);
    EXPECT_EQ(p->Caption.null, 1);

    // A wanted reference gets an instance to mark it.
    Ref<Test_Collection> c(create<Test_Collection>(true));
    c->Members.null = 1;
    const char* members[] = { "members", 0 };
    EXPECT_EQ(filter_properties(c.ptr(), members, true), 0);
    EXPECT_EQ(c->Members.null, 0);
}

TEST(Instance, CreateRefsAndNameSpaces)
{
    Ref<Test_Dependency> a(create<Test_Dependency>(true));
    a->Dependent = make_port("p1");
    a->Dependent->__name_space = "root/keep";
    Test_ManagedElement* dependent = a->Dependent;

    __create_refs(a.ptr());
    ASSERT_NE(a->Antecedent, (Test_ManagedElement*)0);
    EXPECT_EQ(a->Antecedent->meta_class, &Test_ManagedElement::static_meta_class);
    EXPECT_EQ(a->Dependent, dependent);

    __set_name_space_recursive(a.ptr(), "root/test", false);
    EXPECT_STREQ(a->__name_space.c_str(), "root/test");
    EXPECT_STREQ(a->Antecedent->__name_space.c_str(), "root/test");
    EXPECT_STREQ(a->Dependent->__name_space.c_str(), "root/keep");

    __set_name_space_recursive(a.ptr(), "root/new", true);
    EXPECT_STREQ(a->Dependent->__name_space.c_str(), "root/new");

    int count = 0;
    __visit(a.ptr(), [](Instance*, void* data) { ++*(int*)data; }, &count);
    EXPECT_EQ(count, 3);
}

TEST(Instance, PrintShowsValuesAndNulls)
{
    Ref<Test_Dependency> a(create<Test_Dependency>(true));
    Test_Device* d = make_device("d\"1");
    d->Symbol.set(char16('Q'));
    d->Notes.set("embedded");
    a->Antecedent = d;
    a->__name_space = "root/test";

    char* text = 0;
    size_t size = 0;
    FILE* os = open_memstream(&text, &size);
    fprint(os, a.ptr(), false);
    fprint(os, d, false);
    fclose(os);

    const std::string s(text);
    free(text);

    EXPECT_NE(s.find("Test_Dependency\n{\n    string __name_space = \"root/test\";\n"), std::string::npos);
    EXPECT_NE(s.find("    Test_Device Antecedent =\n    {\n"), std::string::npos);
    EXPECT_NE(s.find("        string DeviceID = \"d\\\"1\";\n"), std::string::npos);
    // Nested: keys and embedded objects only.
    EXPECT_NE(s.find("        string Notes = \"embedded\";\n"), std::string::npos);
    EXPECT_EQ(s.find("        uint16 PortAvailability"), std::string::npos);
    EXPECT_NE(s.find("    Test_ManagedElement Dependent = NULL;\n"), std::string::npos);
    EXPECT_NE(s.find("    uint16 OperationalStatus[] = { 2, 5 };\n"), std::string::npos);
    EXPECT_NE(s.find("    char16 Symbol = 'Q';\n"), std::string::npos);
    EXPECT_NE(s.find("    uint64 Speed = NULL;\n"), std::string::npos);
    EXPECT_NE(s.find("    datetime Uptime = \"00000001000000.000000:000\";\n"), std::string::npos);
}
