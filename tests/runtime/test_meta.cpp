#include <gtest/gtest.h>
#include <cstring>
#include <string>
#include "records.h"

using namespace OLMA;

namespace
{

const Meta_Class* const element = &Test_ManagedElement::static_meta_class;
const Meta_Class* const device = &Test_Device::static_meta_class;
const Meta_Class* const port = &Test_Port::static_meta_class;
const Meta_Class* const job = &Test_Job::static_meta_class;

std::string print_to_string(const Meta_Class* mc, bool qualifiers)
{
    char* text = 0;
    size_t size = 0;
    FILE* os = open_memstream(&text, &size);
    fprint(os, mc, qualifiers);
    fclose(os);
    std::string s(text);
    free(text);
    return s;
}

} // namespace

TEST(Meta, FlagNames)
{
    // The bit of each flag is its index in the table.
    ASSERT_EQ(num_flag_names, 32u);
    for (size_t i = 0; i < num_flag_names; i++)
        EXPECT_EQ(flag_name_to_index(flag_names[i]), (int)i);

    EXPECT_EQ(FLAG_KEY, 1u << flag_name_to_index("key"));
    EXPECT_EQ(FLAG_EMBEDDED_INSTANCE, 1u << flag_name_to_index("EMBEDDEDINSTANCE"));
    EXPECT_EQ(flag_name_to_index("Keys"), -1);
    EXPECT_EQ(flag_name_to_index(0), -1);
}

TEST(Meta, FindFeatureByNameAndKind)
{
    const Meta_Feature* f = find_feature(port, "deviceid", FLAG_PROPERTY);
    ASSERT_NE(f, (const Meta_Feature*)0);
    // The re-declared feature, not the parent's.
    EXPECT_EQ(f, &_Test_Port_DeviceID);

    EXPECT_EQ(find_feature(port, "DeviceID", FLAG_REFERENCE), (const Meta_Feature*)0);
    EXPECT_EQ(find_feature(port, "reset", FLAG_PROPERTY | FLAG_REFERENCE), (const Meta_Feature*)0);
    EXPECT_EQ((const void*)find_method(port, "RESET"),
        (const void*)&Test_Port_Reset_method::static_meta_class);
    EXPECT_EQ(find_feature(port, "Device", FLAG_ANY_FEATURE), (const Meta_Feature*)0);
    EXPECT_EQ(find_feature((const Meta_Class*)0, "x", FLAG_ANY_FEATURE), (const Meta_Feature*)0);

    const Meta_Method* reset = &Test_Port_Reset_method::static_meta_class;
    EXPECT_EQ(find_parameter(reset, "force"), &_Test_Port_Reset_method_Force);
    EXPECT_EQ(find_parameter(reset, "Job"), (const Meta_Property*)0);
    EXPECT_EQ(find_reference(reset, "job"), &_Test_Port_Reset_method_Job);
    EXPECT_NE(find_parameter(reset, "return_value"), (const Meta_Property*)0);

    EXPECT_TRUE(__has_meta_feature(port, FLAG_METHOD));
    EXPECT_FALSE(__has_meta_feature(device, FLAG_METHOD));
    EXPECT_TRUE(__has_meta_feature(&Test_Dependency::static_meta_class, FLAG_REFERENCE));
    EXPECT_FALSE(__has_meta_feature(&Instance::static_meta_class, FLAG_ANY_FEATURE));
}

TEST(Meta, IsSubclass)
{
    const Meta_Class* all[] = { element, device, port, job, &Instance::static_meta_class };

    for (const Meta_Class* mc : all)
    {
        EXPECT_TRUE(is_subclass(mc, mc)) << mc->name;
        EXPECT_TRUE(is_subclass(&Instance::static_meta_class, mc)) << mc->name;
    }

    EXPECT_TRUE(is_subclass(&Instance::static_meta_class, 0));
    EXPECT_TRUE(is_subclass(element, port));
    EXPECT_TRUE(is_subclass(device, port));
    EXPECT_FALSE(is_subclass(port, device));
    EXPECT_FALSE(is_subclass(job, port));
    EXPECT_FALSE(is_subclass(device, 0));
    EXPECT_FALSE(is_subclass(0, device));

    // A method record has no parent to walk to.
    const Meta_Class* method = (const Meta_Class*)&Test_Port_Reset_method::static_meta_class;
    EXPECT_FALSE(is_subclass(device, method));
    EXPECT_TRUE(is_subclass(method, method));

    // By name, as a status.
    EXPECT_EQ(is_subclass(&test_repository, "test_managedelement", "TEST_PORT"), 0);
    EXPECT_EQ(is_subclass(&test_repository, "Test_Port", "Test_Device"), 1);
    EXPECT_EQ(is_subclass(&test_repository, "Test_Port", "Nope"), -1);
    EXPECT_EQ(is_subclass(&test_repository, 0, "Test_Port"), -1);
    EXPECT_EQ(is_subclass((const Meta_Repository*)0, "Test_Port", "Test_Port"), -1);
}

TEST(Meta, FindMetaClass)
{
    for (size_t i = 0; i < test_repository.num_meta_classes; i++)
    {
        const Meta_Class* mc = test_repository.meta_classes[i];
        std::string upper(mc->name);
        for (char& c : upper)
            c = (char)toupper((unsigned char)c);

        EXPECT_EQ(find_meta_class(&test_repository, upper.c_str()), mc);
        EXPECT_EQ(find_meta_class(job, mc->name), mc);
    }

    EXPECT_EQ(find_meta_class(port, "test_device"), device);
    EXPECT_EQ(find_meta_class(&test_repository, "Reset"), (const Meta_Class*)0);
    EXPECT_EQ(find_meta_class(&test_repository, "Test_"), (const Meta_Class*)0);
    EXPECT_EQ(find_meta_class((const Meta_Repository*)0, "Test_Port"), (const Meta_Class*)0);
    EXPECT_EQ(find_meta_class(&Instance::static_meta_class, "Instance"), &Instance::static_meta_class);
    EXPECT_EQ(find_meta_class(&Instance::static_meta_class, "Test_Port"), (const Meta_Class*)0);
}

TEST(Meta, SlotLayout)
{
    // The null byte sits where the runtime looks for it.
    EXPECT_EQ(__null_offset(&_Test_Device_Enabled), offsetof(Property<boolean>, null));
    EXPECT_EQ(__null_offset(&_Test_Device_Symbol), offsetof(Property<char16>, null));
    EXPECT_EQ(__null_offset(&_Test_Device_Speed), offsetof(Property<uint64>, null));
    EXPECT_EQ(__null_offset(&_Test_Device_Started), offsetof(Property<Datetime>, null));
    EXPECT_EQ(__null_offset(&_Test_Device_OperationalStatus), offsetof(Property<Array<uint16>>, null));
    EXPECT_EQ(offsetof(Instance, meta_class), 8u);
    EXPECT_EQ(offsetof(Instance, __name_space), 16u);
}

TEST(Meta, CloneOfStaticClassIsIdenticalAndOwned)
{
    Meta_Class* mc = clone(port);
    ASSERT_NE(mc, (Meta_Class*)0);
    EXPECT_EQ(mc->refs, 1u);
    EXPECT_NE(mc->name, port->name);
    EXPECT_TRUE(identical(mc, port));
    EXPECT_TRUE(identical(port, mc));
    EXPECT_FALSE(identical(mc, device));

    // Defaults are deep copies.
    const Meta_Property* status = find_property(mc, "OperationalStatus");
    ASSERT_NE(status, (const Meta_Property*)0);
    EXPECT_NE(status->value, _Test_Device_OperationalStatus.value);
    const Meta_Property* uptime = find_property(mc, "Uptime");
    EXPECT_STREQ(((const Meta_Value_Scalar<const char*>*)uptime->value)->value,
        "00000001000000.000000:000");

    // Instances of a dynamic class keep it alive.
    Instance* i = create(mc, true);
    EXPECT_EQ(mc->refs, 2u);
    EXPECT_EQ(((Test_Port*)i)->PortAvailability.value, 2);
    Instance* j = clone(i);
    EXPECT_EQ(mc->refs, 3u);
    unref(mc);
    unref(i);
    EXPECT_EQ(j->meta_class->refs, 1u);
    unref(j);

    // Changing a clone makes it differ.
    Meta_Class* other = clone(device);
    ((Meta_Property*)find_property(other, "Speed"))->type = UINT32;
    EXPECT_FALSE(identical(other, device));
    destroy(other);
}

TEST(Meta, DynamicClasses)
{
    Meta_Class* base = create_meta_class("Dyn_Base", 0, FLAG_CLASS | FLAG_ABSTRACT);
    EXPECT_EQ(base->size, sizeof(Instance));
    EXPECT_EQ(base->num_meta_features, 0u);

    Meta_Property* key = create_meta_property("Id", STRING, 0, sizeof(Instance), true);
    EXPECT_EQ(key->flags, FLAG_PROPERTY | FLAG_READ | FLAG_KEY);
    append(base, key, true);
    base->size = sizeof(Instance) + sizeof(Property<String>);
    EXPECT_EQ(base->num_keys, 1u);

    Meta_Qualifier* q = (Meta_Qualifier*)calloc(1, sizeof(Meta_Qualifier));
    q->refs = 1;
    q->name = strdup("Abstract");
    q->type = BOOLEAN;
    append(base, q);

    Meta_Class* derived = create_meta_class("Dyn_Derived", base, FLAG_CLASS);
    EXPECT_EQ(derived->super_meta_class, base);
    EXPECT_EQ(base->refs, 2u);
    EXPECT_EQ(derived->flags & FLAG_ABSTRACT, 0u);
    EXPECT_EQ(derived->num_meta_qualifiers, 0u);
    EXPECT_EQ(derived->locals[0], 0);
    EXPECT_TRUE(is_subclass(base, derived));
    EXPECT_EQ(find_meta_class(derived, "dyn_base"), base);

    // A model path through the dynamic class works like any other.
    Instance* i = create(derived, false);
    __put_property_from_str(i, find_property(derived, "id"), "x");
    String path;
    EXPECT_EQ(instance_to_model_path(i, path), 0);
    EXPECT_STREQ(path.c_str(), "Dyn_Derived.Id=\"x\"");
    Instance* j = model_path_to_instance(derived, path.c_str());
    ASSERT_NE(j, (Instance*)0);
    EXPECT_TRUE(key_eq(i, j));
    unref(j);
    unref(i);

    const char* names[] = { "abstract" };
    filter_qualifiers(base, names, 1);
    EXPECT_EQ(base->num_meta_qualifiers, 0u);

    unref(base);
    EXPECT_EQ(base->refs, 1u);
    unref(derived);
}

TEST(Meta, PrintAndDump)
{
    const std::string s = print_to_string(port, false);
    EXPECT_EQ(s.rfind("class Test_Port : Test_Device\n{\n", 0), 0u);
    EXPECT_NE(s.find("    string DeviceID;\n"), std::string::npos);
    EXPECT_NE(s.find("    uint16 OperationalStatus[] = { 2, 5 };\n"), std::string::npos);
    EXPECT_NE(s.find("    string Description = \"none\";\n"), std::string::npos);
    EXPECT_NE(s.find("    uint32 Reset("), std::string::npos);
    EXPECT_EQ(s.substr(s.size() - 3), "};\n");

    const std::string q = print_to_string(port, true);
    EXPECT_NE(q.find("    [Key]\n    string DeviceID;\n"), std::string::npos);
    EXPECT_NE(q.find("    [Gauge]\n    uint64 Speed;\n"), std::string::npos);
    EXPECT_NE(q.find("        [In]\n        boolean Force"), std::string::npos);
    EXPECT_NE(q.find("        [Out, In(False)]\n        Test_Job REF Job"), std::string::npos);

    Meta_Property* p = create_meta_property("Hidden", UINT8, 0, 16, false);
    p->flags &= ~FLAG_READ;
    Meta_Class* mc = create_meta_class("Dyn", 0, FLAG_CLASS);
    append(mc, p, true);
    EXPECT_NE(print_to_string(mc, true).find("[Read(False)]\n    uint8 Hidden;"), std::string::npos);
    unref(mc);
}
