#include <gtest/gtest.h>
#include "records.h"

using namespace OLMA;

namespace
{

const Meta_Class* device_class = &Test_Device::static_meta_class;

Test_Device* make_device(const char* id)
{
    Test_Device* d = create<Test_Device>(true);
    d->SystemCreationClassName.set("Test_System");
    d->SystemName.set("host");
    d->CreationClassName.set("Test_Device");
    d->DeviceID.set(id);
    return d;
}

std::string path_of(const Instance* instance)
{
    String s;
    EXPECT_EQ(instance_to_model_path(instance, s), 0);
    return s.c_str();
}

// The path must read back into an instance with the same keys and class.
void expect_round_trip(const Instance* instance)
{
    String s;
    ASSERT_EQ(instance_to_model_path(instance, s), 0);
    Ref<Instance> back(model_path_to_instance(device_class, s.c_str()));
    ASSERT_TRUE(back) << s.c_str();
    EXPECT_EQ(back->meta_class, instance->meta_class);
    EXPECT_TRUE(key_eq(instance, back.ptr())) << s.c_str();
    EXPECT_TRUE(key_eq(back.ptr(), instance)) << s.c_str();
}

} // namespace

TEST(ModelPath, StringKeys)
{
    Ref<Test_Device> d(make_device("d1"));
    d->Speed.set(5);
    EXPECT_EQ(path_of(d.ptr()),
        "Test_Device.SystemCreationClassName=\"Test_System\",SystemName=\"host\","
        "CreationClassName=\"Test_Device\",DeviceID=\"d1\"");
    expect_round_trip(d.ptr());

    // Read back, only the keys are wanted.
    String s;
    instance_to_model_path(d.ptr(), s);
    Ref<Test_Device> m((Test_Device*)model_path_to_instance(device_class, s.c_str()));
    ASSERT_TRUE(m);
    EXPECT_EQ(m->DeviceID.null, 0);
    EXPECT_EQ(m->Speed.null, 1);
    EXPECT_EQ(m->PortAvailability.null, 1);
}

TEST(ModelPath, NumberKeys)
{
    Ref<Test_Numbers> n(create<Test_Numbers>(false));
    n->U8.set(255);
    n->S8.set(-128);
    n->U16.set(65535);
    n->S16.set(-32768);
    n->U32.set(4294967295u);
    n->S32.set(-2147483647 - 1);
    n->U64.set(18446744073709551615ULL);
    n->S64.set(-9223372036854775807LL - 1);
    n->Flag.set(true);

    EXPECT_EQ(path_of(n.ptr()),
        "Test_Numbers.U8=255,S8=-128,U16=65535,S16=-32768,U32=4294967295,"
        "S32=-2147483648,U64=18446744073709551615,S64=-9223372036854775808,Flag=true");
    expect_round_trip(n.ptr());

    // Hexadecimal is read when decimal stops short; booleans in any case.
    Ref<Test_Numbers> h((Test_Numbers*)model_path_to_instance(device_class,
        "test_numbers.u8=0x10,S8=1,U16=2,S16=3,U32=0xFFFFFFFF,S32=4,U64=5,S64=-6,flag=FALSE"));
    ASSERT_TRUE(h);
    EXPECT_EQ(h->meta_class, &Test_Numbers::static_meta_class);
    EXPECT_EQ(h->U8.value, 16);
    EXPECT_EQ(h->U32.value, 4294967295u);
    EXPECT_EQ(h->S64.value, -6);
    EXPECT_FALSE(h->Flag.value);
    EXPECT_EQ(h->Flag.null, 0);
}

TEST(ModelPath, ReferenceKeysNest)
{
    Ref<Test_PortOfDevice> a(create<Test_PortOfDevice>(true));
    a->Antecedent = make_device("d1");
    Test_Port* p = create<Test_Port>(true);
    p->SystemCreationClassName.set("S");
    p->SystemName.set("h");
    p->CreationClassName.set("Test_Port");
    p->DeviceID.set("p1");
    a->Dependent = p;

    const std::string s = path_of(a.ptr());
    EXPECT_EQ(s,
        "Test_PortOfDevice.Antecedent=\"Test_Device.SystemCreationClassName=\\\"Test_System\\\","
        "SystemName=\\\"host\\\",CreationClassName=\\\"Test_Device\\\",DeviceID=\\\"d1\\\"\","
        "Dependent=\"Test_Port.SystemCreationClassName=\\\"S\\\",SystemName=\\\"h\\\","
        "CreationClassName=\\\"Test_Port\\\",DeviceID=\\\"p1\\\"\"");
    expect_round_trip(a.ptr());

    Ref<Test_PortOfDevice> back(
        (Test_PortOfDevice*)model_path_to_instance(device_class, s.c_str()));
    ASSERT_TRUE(back);
    EXPECT_EQ(back->Dependent->meta_class, &Test_Port::static_meta_class);

    // A referenced path may name a subclass of the declared class.
    Ref<Instance> sub(model_path_to_instance(device_class,
        "Test_Dependency.Antecedent=\"Test_Job.InstanceID=\\\"j\\\"\","
        "Dependent=\"Test_Port.SystemCreationClassName=\\\"S\\\",SystemName=\\\"h\\\","
        "CreationClassName=\\\"C\\\",DeviceID=\\\"p\\\"\""));
    ASSERT_TRUE(sub);
    EXPECT_EQ(((Test_Dependency*)sub.ptr())->Antecedent->meta_class, &Test_Job::static_meta_class);
}

TEST(ModelPath, WriteFailures)
{
    String s;

    // Null key.
    Ref<Test_Device> d(make_device("d1"));
    d->SystemName.null = 1;
    EXPECT_EQ(instance_to_model_path(d.ptr(), s), -1);

    // No keys at all.
    Ref<Test_Alert> alert(create<Test_Alert>(true));
    EXPECT_EQ(instance_to_model_path(alert.ptr(), s), -1);

    // A null reference, or a reference whose own path fails.
    Ref<Test_Dependency> a(create<Test_Dependency>(true));
    a->Antecedent = make_device("d1");
    EXPECT_EQ(instance_to_model_path(a.ptr(), s), -1);
    a->Dependent = make_device("d2");
    EXPECT_EQ(instance_to_model_path(a.ptr(), s), 0);
    ((Test_Device*)a->Dependent)->DeviceID.null = 1;
    EXPECT_EQ(instance_to_model_path(a.ptr(), s), -1);
}

TEST(ModelPath, ReadFailures)
{
    const char* bad[] = {
        "",
        ".DeviceID=\"x\"",
        "Test_Device",
        "Test_Device:",
        "NoSuchClass.Key=\"x\"",
        // One of four keys.
        "Test_Device.DeviceID=\"x\"",
        "Test_Device.",
        // A feature that isn't a key, or doesn't exist.
        "Test_Job.InstanceID=\"j\",Priority=1",
        "Test_Job.InstanceID=\"j\",Nope=1",
        "Test_Job.Reset=\"j\"",
        // Broken values.
        "Test_Job.InstanceID=j",
        "Test_Job.InstanceID=\"j",
        "Test_Job.InstanceID=\"a\\nb\"",
        "Test_Job.InstanceID",
        "Test_Job.InstanceID=\"j\"x",
        "Test_Job.InstanceID=\"j\",",
        "Test_Job.InstanceID=\"j\",InstanceID=\"k\"",
        "Test_Numbers.U8=1,S8=1,U16=1,S16=1,U32=1,S32=1,U64=1,S64=1,Flag=yes",
        "Test_Numbers.U8=,S8=1,U16=1,S16=1,U32=1,S32=1,U64=1,S64=1,Flag=true",
        "Test_Numbers.U8=1g,S8=1,U16=1,S16=1,U32=1,S32=1,U64=1,S64=1,Flag=true",
        "Test_Numbers.U8=1,S8=1,U16=1,S16=1,U32=1,S32=1,U64=1,S64=99999999999999999999,Flag=true",
        // A reference needs a quoted path of a related class.
        "Test_Dependency.Antecedent=Test_Job.InstanceID=\"j\",Dependent=\"Test_Job.InstanceID=\\\"k\\\"\"",
        "Test_Dependency.Antecedent=\"Test_Job.InstanceID=j\",Dependent=\"Test_Job.InstanceID=\\\"k\\\"\"",
        "Test_Dependency.Antecedent=\"Test_Job.InstanceID=\\\"j\\\"\"",
        "Test_PortOfDevice.Antecedent=\"Test_Job.InstanceID=\\\"j\\\"\",Dependent=\"Test_Job.InstanceID=\\\"k\\\"\"",
        // Non-key-valued types aren't accepted as keys.
        "Test_Collection.InstanceID=\"c\",Members=\"x\"",
    };

    for (const char* path : bad)
    {
        Instance* x = model_path_to_instance(device_class, path);
        EXPECT_EQ(x, (Instance*)0) << path;
        unref(x);
    }

    EXPECT_EQ(model_path_to_instance(0, "Test_Job.InstanceID=\"j\""), (Instance*)0);
    EXPECT_EQ(model_path_to_instance(device_class, 0), (Instance*)0);
}

TEST(ModelPath, QuotesInStringsDontReadBack)
{
    Ref<Test_Job> j(create<Test_Job>(true));
    j->InstanceID.set("a\"b");
    String s;
    ASSERT_EQ(instance_to_model_path(j.ptr(), s), 0);
    EXPECT_STREQ(s.c_str(), "Test_Job.InstanceID=\"a\"b\"");
    EXPECT_EQ(model_path_to_instance(device_class, s.c_str()), (Instance*)0);

    // Escaped input is accepted, though.
    Ref<Test_Job> k((Test_Job*)model_path_to_instance(device_class,
        "Test_Job.InstanceID=\"a\\\"b\\\\c\""));
    ASSERT_TRUE(k);
    EXPECT_STREQ(k->InstanceID.value.c_str(), "a\"b\\c");
}

TEST(ModelPath, ClassWithoutKeys)
{
    Ref<Instance> a(model_path_to_instance(device_class, "Test_Alert."));
    ASSERT_TRUE(a);
    EXPECT_EQ(a->meta_class, &Test_Alert::static_meta_class);
}

TEST(ModelPath, PutPropertyFromString)
{
    Ref<Test_Device> d(create<Test_Device>(false));
    const Meta_Class* mc = &Test_Device::static_meta_class;
    d->Speed.null = 1;

    EXPECT_EQ(__put_property_from_str(d.ptr(), find_property(mc, "Speed"), "0x10"), 0);
    EXPECT_EQ(d->Speed.value, 16u);
    EXPECT_EQ(d->Speed.null, 0);
    EXPECT_EQ(__put_property_from_str(d.ptr(), find_property(mc, "Offset"), "-129"), -1);
    EXPECT_EQ(__put_property_from_str(d.ptr(), find_property(mc, "Enabled"), "TRUE"), 0);
    EXPECT_TRUE(d->Enabled.value);
    EXPECT_EQ(__put_property_from_str(d.ptr(), find_property(mc, "Load"), "1.5"), 0);
    EXPECT_EQ(d->Load.value, 1.5);
    EXPECT_EQ(__put_property_from_str(d.ptr(), find_property(mc, "Symbol"), "Zed"), 0);
    EXPECT_EQ(d->Symbol.value.code(), 'Z');
    EXPECT_EQ(__put_property_from_str(d.ptr(), find_property(mc, "Started"),
        "20100102030405.123456+060"), 0);
    EXPECT_EQ(d->Started.value.offset(), 60);
    EXPECT_EQ(__put_property_from_str(d.ptr(), find_property(mc, "Started"), "bad"), -1);

    // Array elements accumulate.
    EXPECT_EQ(__put_property_from_str(d.ptr(), find_property(mc, "OperationalStatus"), "2"), 0);
    EXPECT_EQ(__put_property_from_str(d.ptr(), find_property(mc, "OperationalStatus"), "3"), 0);
    ASSERT_EQ(d->OperationalStatus.value.size(), 2u);
    EXPECT_EQ(d->OperationalStatus.value[1], 3);
    EXPECT_EQ(__put_property_from_str(d.ptr(), find_property(mc, "Aliases"), "x"), 0);
    ASSERT_EQ(d->Aliases.value.size(), 1u);
    EXPECT_STREQ(d->Aliases.value[0].c_str(), "x");
}
