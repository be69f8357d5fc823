// The host against the C test module: operations reach the right MI,
// values keep their types both ways, up-calls re-enter other providers on
// the same thread, subscriptions are counted, and nothing handed out leaks.

#include <cstring>
#include <dlfcn.h>

#include <gtest/gtest.h>

#include "cimhost.h"
#include "cmpimacs.h"
#include "internal.h"

using namespace OLMA::cimhost;

namespace OLMA
{
namespace cimhost
{
// testprov/testprov_classes.cpp, from testprov.mof.
extern const Class_Table testprov_classes;
} // namespace cimhost
} // namespace OLMA

namespace
{

struct Counters
{
    int creates;
    int cleanups;
    int authorize;
    int must_poll;
    int activate;
    int first_activation;
    int deactivate;
    int last_deactivation;
    int enable;
    int disable;
    int delivered;
    int refuse_unload;
    int fail_enable;
};

Object_Path path_of(const std::string& text)
{
    Object_Path p;
    std::string err;
    EXPECT_TRUE(parse_path(text, p, err)) << err;
    return p;
}

Value typed(const std::string& text)
{
    Value v;
    std::string err;
    EXPECT_TRUE(parse_typed_value(text, v, err)) << err;
    return v;
}

const Value* out_arg(const Result& r, const std::string& name)
{
    for (const Property& p : r.out)
        if (p.name == name)
            return &p.value;
    return nullptr;
}

class CimhostHost : public ::testing::Test
{
protected:
    Options opts()
    {
        Options o;
        o.module_path = TESTPROV_MODULE;
        o.reg_path = TESTPROV_REG;
        o.classes = &testprov_classes;
        return o;
    }

    void SetUp() override
    {
        host.reset(new Host(opts()));
        ASSERT_TRUE(host->ok()) << host->error();
        counters = static_cast<Counters*>(dlsym(RTLD_DEFAULT, "testprov_counters"));
        ASSERT_NE(nullptr, counters);
        memset(counters, 0, sizeof(*counters));
    }

    void TearDown() override
    {
        host.reset();
    }

    Result call(const std::string& method, std::vector<Property> in = {},
                const std::string& path = "root/test:Test_Widget.Name=\"a\"")
    {
        return host->cm(path_of(path), method, in);
    }

    std::unique_ptr<Host> host;
    Counters* counters = nullptr;
};

} // namespace

TEST_F(CimhostHost, EnumerationKeepsEveryPropertyTypeAndNull)
{
    Result r = host->ei(path_of("root/test:Test_Widget"));
    ASSERT_TRUE(r.ok()) << rc_name(r.rc) << " " << r.message;
    ASSERT_EQ(3u, r.instances.size());
    const Instance& a = r.instances[0];
    EXPECT_EQ("Test_Widget", a.class_name);
    EXPECT_EQ("root/test:Test_Widget.Name=\"a\"", a.path.to_string());
    ASSERT_NE(nullptr, a.get("Size"));
    EXPECT_EQ(CMPI_uint16, a.get("Size")->type);
    EXPECT_EQ(1, a.get("Size")->num.uint16);
    ASSERT_EQ(CMPI_stringA, a.get("Tags")->type);
    ASSERT_EQ(2u, a.get("Tags")->elements.size());
    EXPECT_EQ("red", a.get("Tags")->elements[0].str);
    EXPECT_TRUE(a.get("Tags")->elements[1].null);
    EXPECT_EQ(CMPI_dateTime, a.get("Created")->type);
    EXPECT_EQ("20240102030405.000006+060", a.get_text("Created"));
    EXPECT_EQ("true", a.get_text("Enabled"));
    EXPECT_EQ(0.25, a.get("Ratio")->num.real64);
    EXPECT_EQ(CMPI_string, a.get("Note")->type);
    EXPECT_TRUE(a.get("Note")->null);

    Result names = host->ein(path_of("root/test:Test_Widget"));
    ASSERT_TRUE(names.ok());
    ASSERT_EQ(3u, names.paths.size());
    EXPECT_EQ("root/test:Test_Widget.Name=\"c\"", names.paths[2].to_string());
    EXPECT_EQ(0u, host->live_objects());
}

TEST_F(CimhostHost, GetInstanceAndPropertyFilter)
{
    Result r = host->gi(path_of("root/test:Test_Widget.Name=\"b\""));
    ASSERT_TRUE(r.ok());
    ASSERT_EQ(1u, r.instances.size());
    EXPECT_EQ("2", r.instances[0].get_text("Size"));

    r = host->gi(path_of("root/test:Test_Widget.Name=\"zz\""));
    EXPECT_EQ(CMPI_RC_ERR_NOT_FOUND, r.rc);
    EXPECT_EQ("no such widget", r.message);

    // The filter keeps the wanted properties and those of the provider's key
    // list, and the path is made of the key properties left.
    std::vector<std::string> props {"size"};
    r = host->ei(path_of("root/test:Test_Widget"), &props);
    ASSERT_TRUE(r.ok());
    for (const Instance& i : r.instances)
    {
        ASSERT_EQ(2u, i.properties.size());
        EXPECT_NE(nullptr, i.get("Name"));
        EXPECT_NE(nullptr, i.get("Size"));
        EXPECT_EQ(1u, i.path.keys.size());
    }

    // Without a key list, the keys go, from the instance and from its path.
    r = host->gi(path_of("root/test:Test_Widget.Name=\"b\""), &props);
    ASSERT_TRUE(r.ok());
    ASSERT_EQ(1u, r.instances.size());
    EXPECT_EQ(nullptr, r.instances[0].get("Name"));
    EXPECT_EQ("root/test:Test_Widget", r.instances[0].path.to_string());

    // Integer keys reach the provider in 64 bits and still match.
    r = host->gi(path_of("root/test:Test_Gadget.Id=2"));
    ASSERT_TRUE(r.ok()) << rc_name(r.rc);
    EXPECT_EQ("gadget 2", r.instances[0].get_text("Label"));
    EXPECT_EQ(CMPI_uint64, r.instances[0].path.key("Id")->type);
}

TEST_F(CimhostHost, WritesAndQueriesReachTheirOwnSlots)
{
    Object_Path cls = path_of("root/test:Test_Widget");
    Instance w;
    w.properties.push_back({"Name", Value::of_string("new")});
    Result r = host->ci(cls, w);
    ASSERT_TRUE(r.ok()) << rc_name(r.rc);
    ASSERT_EQ(1u, r.paths.size());
    EXPECT_EQ("root/test:Test_Widget.Name=\"new\"", r.paths[0].to_string());
    w.properties[0].value = Value::of_string("a");
    EXPECT_EQ(CMPI_RC_ERR_ALREADY_EXISTS, host->ci(cls, w).rc);

    Object_Path a = path_of("root/test:Test_Widget.Name=\"a\"");
    Instance m;
    m.properties.push_back({"Size", Value::of_uint(CMPI_uint16, 9)});
    std::vector<std::string> props {"Size"};
    EXPECT_EQ(CMPI_RC_OK, host->mi(a, m, &props).rc);
    EXPECT_EQ(CMPI_RC_ERR_INVALID_PARAMETER, host->mi(a, m).rc);
    EXPECT_EQ(CMPI_RC_ERR_NOT_FOUND, host->mi(path_of("root/test:Test_Widget.Name=\"q\""), m, &props).rc);

    EXPECT_EQ(CMPI_RC_OK, host->di(a).rc);
    EXPECT_EQ(CMPI_RC_ERR_NOT_FOUND, host->di(path_of("root/test:Test_Widget.Name=\"q\"")).rc);
    EXPECT_EQ(CMPI_RC_ERR_NOT_SUPPORTED, host->di(path_of("root/test:Test_Gadget.Id=1")).rc);

    r = host->eq(cls, "SELECT * FROM Test_Widget");
    ASSERT_TRUE(r.ok());
    EXPECT_EQ(3u, r.instances.size());
    EXPECT_EQ(CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED, host->eq(cls, "x", "CQL").rc);
    EXPECT_EQ(0u, host->live_objects());
}

TEST_F(CimhostHost, RoutingByClassHierarchyAndNamespace)
{
    // No provider serves Test_Base; its subclasses' providers answer.
    Result r = host->ei(path_of("root/test:Test_Base"));
    ASSERT_TRUE(r.ok());
    EXPECT_EQ(5u, r.instances.size());

    EXPECT_EQ(CMPI_RC_ERR_INVALID_CLASS, host->ei(path_of("root/test:No_Such")).rc);
    EXPECT_EQ(CMPI_RC_ERR_INVALID_NAMESPACE, host->ei(path_of("root/nowhere:Test_Widget")).rc);
    // Test_Widget is registered, but only in root/test.
    EXPECT_EQ(CMPI_RC_ERR_INVALID_NAMESPACE, host->ei(path_of("root/other:Test_Widget")).rc);
    EXPECT_TRUE(host->class_is_a("Test_Gadget", "test_base"));
    EXPECT_EQ(CMPI_uint16, host->property_type("Test_Widget", "size"));
    EXPECT_EQ(CMPI_uint32, host->parameter_type("Test_Widget", "double", "x"));
    EXPECT_EQ(CMPI_ref, host->parameter_type("Test_Widget", "Lookup", "Target"));
}

TEST_F(CimhostHost, MethodsWithArgumentsStatusesAndMessages)
{
    Result r = call("Double", {{"X", typed("uint32:21")}});
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(CMPI_uint32, r.return_value.type);
    EXPECT_EQ("0", r.return_value.text());
    ASSERT_NE(nullptr, out_arg(r, "Y"));
    EXPECT_EQ(42u, out_arg(r, "Y")->num.uint32);

    EXPECT_EQ(CMPI_RC_ERR_INVALID_PARAMETER, call("Double", {{"X", typed("uint16:21")}}).rc);
    EXPECT_EQ(CMPI_RC_ERR_METHOD_NOT_FOUND, call("NoSuchMethod").rc);
    r = call("Fail");
    EXPECT_EQ(CMPI_RC_ERR_ACCESS_DENIED, r.rc);
    EXPECT_EQ("no way", r.message);

    r = call("Principal");
    ASSERT_TRUE(r.ok());
    EXPECT_EQ("cimhost", out_arg(r, "User")->str);
}

TEST_F(CimhostHost, ArgumentsOfEveryTypeSurviveTheRoundTrip)
{
    std::vector<Property> in = {
        {"B", typed("boolean:true")},
        {"U8", typed("uint8:200")},
        {"S16", typed("sint16:-300")},
        {"U64", typed("uint64:18446744073709551615")},
        {"R32", typed("real32:1.5")},
        {"C16", typed("char16:65")},
        {"S", typed("string:with \"quotes\"")},
        {"D", typed("datetime:00000001020304.000005:000")},
        {"Ref", typed("ref:root/test:Test_Widget.Name=\"a\"")},
        {"Arr", typed("sint32[]:1,-2,3")},
        {"Strs", typed("string[]:x,y")},
        {"Empty", typed("uint8[]:")},
        {"Nothing", Value::null_of(CMPI_string)},
    };
    Instance embedded;
    embedded.class_name = "Test_Gadget";
    embedded.properties.push_back({"Label", Value::of_string("inner")});
    in.push_back({"Emb", Value::of_instance(embedded)});

    Result r = call("Echo", in);
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(in.size(), size_t(r.return_value.num.uint32));
    ASSERT_EQ(in.size(), r.out.size());
    for (size_t i = 0; i < in.size(); i++)
    {
        EXPECT_EQ(in[i].name, r.out[i].name);
        EXPECT_TRUE(in[i].value == r.out[i].value)
            << in[i].name << ": " << in[i].value.text() << " vs " << r.out[i].value.text();
    }
    EXPECT_EQ(0u, host->live_objects());
}

TEST_F(CimhostHost, UpCallsReachOtherProvidersOnTheSameThread)
{
    // CBGetInstance from the widget's method MI into its own instance MI.
    Result r = call("Lookup", {{"Target", typed("ref:root/test:Test_Widget.Name=\"b\"")}});
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ("0", r.return_value.text());
    EXPECT_EQ("b", out_arg(r, "Found")->str);

    r = call("Lookup", {{"Target", typed("ref:root/test:Test_Widget.Name=\"zz\"")}});
    EXPECT_EQ(std::to_string(CMPI_RC_ERR_NOT_FOUND), r.return_value.text());
    r = call("Lookup", {{"Target", typed("ref:root/test:Nope.K=\"1\"")}});
    EXPECT_EQ(std::to_string(CMPI_RC_ERR_INVALID_CLASS), r.return_value.text());

    // CBEnumInstances into the same provider, CBEnumInstanceNames into another.
    r = call("CountAll");
    ASSERT_TRUE(r.ok());
    EXPECT_EQ("5", r.return_value.text());

    // CBInvokeMethod re-entering the method MI that is running.
    r = call("Call", {{"Name", typed("string:c")}});
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ("42", r.return_value.text());

    // classPathIsA walks the module's tables; isOfType names the object.
    EXPECT_EQ("3", call("IsA", {{"Class", typed("string:TEST_BASE")}}).return_value.text());
    EXPECT_EQ("2", call("IsA", {{"Class", typed("string:Test_Gadget")}}).return_value.text());
    EXPECT_EQ(0u, host->live_objects());
}

TEST_F(CimhostHost, InteropStandInCanBeEmptiedOrSwitchedOff)
{
    Result r = call("Interop");
    ASSERT_TRUE(r.ok());
    EXPECT_EQ("0", r.return_value.text());
    EXPECT_EQ("1", out_arg(r, "Count")->text());
    EXPECT_EQ("cimhost:ObjectManager", out_arg(r, "Name")->str);

    host->set_interop(true, true);
    r = call("Interop");
    EXPECT_EQ("0", r.return_value.text());
    EXPECT_EQ("0", out_arg(r, "Count")->text());

    host->set_interop(false);
    r = call("Interop");
    EXPECT_EQ(std::to_string(CMPI_RC_ERR_INVALID_NAMESPACE), r.return_value.text());
    EXPECT_EQ("0", out_arg(r, "Count")->text());
}

TEST_F(CimhostHost, AssociationsThroughTheRegisteredProviders)
{
    Object_Path a = path_of("root/test:Test_Widget.Name=\"a\"");
    Object_Path g2 = path_of("root/test:Test_Gadget.Id=2");

    // No association class given: the host finds Test_WidgetGadget from the
    // class tables, since it refers to widgets.
    Result r = host->an(a);
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_EQ(2u, r.paths.size());
    EXPECT_EQ("Test_Gadget", r.paths[0].class_name);

    r = host->ai(g2, "Test_WidgetGadget");
    ASSERT_TRUE(r.ok()) << r.message;
    ASSERT_EQ(2u, r.instances.size());
    EXPECT_EQ("a", r.instances[0].get_text("Name"));
    EXPECT_EQ("b", r.instances[1].get_text("Name"));

    EXPECT_EQ(0u, host->an(a, "", "Test_Widget").paths.size());
    EXPECT_EQ(0u, host->an(a, "", "", "Gadget").paths.size());
    EXPECT_EQ(2u, host->an(a, "", "", "Widget", "Gadget").paths.size());
    EXPECT_EQ(CMPI_RC_ERR_INVALID_CLASS, host->an(a, "No_Such_Assoc").rc);

    r = host->ri(a);
    ASSERT_TRUE(r.ok());
    ASSERT_EQ(2u, r.instances.size());
    ASSERT_EQ(CMPI_ref, r.instances[0].get("Widget")->type);
    EXPECT_TRUE(path_equal(a, *r.instances[0].get("Widget")->ref));

    r = host->rn(g2, "Test_WidgetGadget", "Gadget");
    ASSERT_TRUE(r.ok());
    ASSERT_EQ(2u, r.paths.size());
    EXPECT_EQ(CMPI_ref, r.paths[0].key("Gadget")->type);
    EXPECT_EQ(0u, host->live_objects());
}

TEST_F(CimhostHost, SubscriptionsCountFiltersAndEnableOnce)
{
    int id1 = 0, id2 = 0;
    Result r = host->subscribe("root/test", "Test_Event", id1);
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(1, counters->authorize);
    EXPECT_EQ(1, counters->must_poll);
    EXPECT_EQ(1, counters->activate);
    EXPECT_EQ(1, counters->first_activation);
    EXPECT_EQ(1, counters->enable);

    // Delivered from the provider's own, attached thread.
    ASSERT_GE(host->wait_indications(3, 5000), 3u);
    std::vector<Indication_Record> got = host->indications();
    EXPECT_EQ("root/test", got[0].name_space);
    EXPECT_EQ("Test_Event", got[0].instance.class_name);
    EXPECT_EQ("0", got[0].instance.get_text("Seq"));
    EXPECT_EQ("tick", got[2].instance.get_text("Text"));

    r = host->subscribe("root/other", "Test_Event", id2);
    ASSERT_TRUE(r.ok());
    EXPECT_EQ(2, counters->activate);
    EXPECT_EQ(1, counters->first_activation);
    EXPECT_EQ(1, counters->enable);
    EXPECT_EQ(2u, host->active_filters());

    ASSERT_TRUE(host->unsubscribe(id1).ok());
    EXPECT_EQ(1, counters->deactivate);
    EXPECT_EQ(0, counters->last_deactivation);
    EXPECT_EQ(0, counters->disable);
    ASSERT_TRUE(host->unsubscribe(id2).ok());
    EXPECT_EQ(1, counters->last_deactivation);
    EXPECT_EQ(1, counters->disable);
    EXPECT_EQ(CMPI_RC_ERR_NOT_FOUND, host->unsubscribe(id2).rc);
    EXPECT_EQ(0u, host->active_filters());
    // What the provider's thread made, and the context prepared for it, were
    // freed when it detached.
    EXPECT_EQ(0u, host->live_objects());

    int id = 0;
    EXPECT_EQ(CMPI_RC_ERR_INVALID_CLASS, host->subscribe("root/test", "No_Such", id).rc);
    EXPECT_EQ(CMPI_RC_ERR_NOT_SUPPORTED, host->subscribe("root/test", "Test_Widget", id).rc);
}

TEST_F(CimhostHost, FailedEnableIsReportedAndCleanedUpAtExit)
{
    counters->fail_enable = 1;
    int id = 0;
    Result r = host->subscribe("root/test", "Test_Event", id);
    EXPECT_EQ(CMPI_RC_ERR_FAILED, r.rc);
    EXPECT_NE(0, id);
    // The host's exit unsubscribes and cleans up what is left.
    host.reset();
    EXPECT_EQ(1, counters->deactivate);
    EXPECT_EQ(1, counters->disable);
}

TEST_F(CimhostHost, ObjectsOfARequestAreFreedAndCleanupForgetsMIs)
{
    Result r = call("Leak");
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(0u, host->live_objects());

    ASSERT_TRUE(host->ei(path_of("root/test:Test_Widget")).ok());
    int creates = counters->creates;
    counters->refuse_unload = 1;
    EXPECT_EQ(2, host->cleanup(false));   // the widget's instance and method MIs
    ASSERT_TRUE(host->ei(path_of("root/test:Test_Widget")).ok());
    EXPECT_EQ(creates, counters->creates);

    counters->refuse_unload = 0;
    EXPECT_EQ(0, host->cleanup(false));
    ASSERT_TRUE(host->ei(path_of("root/test:Test_Widget")).ok());
    EXPECT_EQ(creates + 1, counters->creates);
}

TEST_F(CimhostHost, InstancesTakeOnlyWhatTheClassDeclares)
{
    const CMPIBroker* b = host->broker();
    CMPIObjectPath* op = CMNewObjectPath(b, "root/test", "Test_Widget", nullptr);
    CMPIInstance* ci = CMNewInstance(b, op, nullptr);
    ASSERT_NE(nullptr, ci);
    CMPIUint16 size = 7;
    CMPIUint32 wide = 8;
    EXPECT_EQ(CMPI_RC_OK, CMSetProperty(ci, "size", &size, CMPI_uint16).rc);
    EXPECT_EQ(CMPI_RC_OK, CMSetProperty(ci, "Caption", "inherited", CMPI_chars).rc);
    EXPECT_EQ(CMPI_RC_OK, CMSetProperty(ci, "Note", nullptr, CMPI_null).rc);
    EXPECT_EQ(CMPI_RC_ERR_NO_SUCH_PROPERTY, CMSetProperty(ci, "Colour", "red", CMPI_chars).rc);
    EXPECT_EQ(CMPI_RC_ERR_TYPE_MISMATCH, CMSetProperty(ci, "Size", &wide, CMPI_uint32).rc);
    EXPECT_EQ(CMPI_RC_ERR_TYPE_MISMATCH, CMSetProperty(ci, "Tags", "one", CMPI_chars).rc);

    // What was refused isn't there, and what was set keeps its value.
    EXPECT_EQ(3u, CMGetPropertyCount(ci, nullptr));
    EXPECT_EQ(7, CMGetProperty(ci, "Size", nullptr).value.uint16);
    std::vector<std::string> refused = host->refused_properties();
    ASSERT_EQ(3u, refused.size());
    EXPECT_EQ("Property Colour not set on the created instance of class Test_Widget: "
              "the class doesn't declare it", refused[0]);
    EXPECT_NE(std::string::npos, refused[1].find("declared uint16, given uint32")) << refused[1];
    EXPECT_NE(std::string::npos, refused[2].find("declared string[], given string")) << refused[2];
    // The same refusal again is no new line.
    CMSetProperty(ci, "Colour", "blue", CMPI_chars);
    EXPECT_EQ(3u, host->refused_properties().size());
    host->clear_refused_properties();
    EXPECT_TRUE(host->refused_properties().empty());
    CMRelease(ci);
    CMRelease(op);
}

TEST(CimhostPlain, ClassesOutsideTheMofAreKnownByTheirRegistrationAlone)
{
    // The built-in classes are the module's: the test module's are in none.
    Options o;
    o.module_path = TESTPROV_MODULE;
    o.reg_path = TESTPROV_REG;
    Host h(o);
    ASSERT_TRUE(h.ok()) << h.error();
    EXPECT_TRUE(h.knows_class("Test_Widget"));
    EXPECT_FALSE(h.knows_class("Test_Base"));
    EXPECT_EQ(0, h.parameter_type("Test_Widget", "Double", "X"));
    EXPECT_EQ(CMPI_RC_ERR_INVALID_CLASS, h.ei(path_of("root/test:Test_Base")).rc);
    // Nor is anything that a provider sets checked against a class.
    Result widgets = h.ei(path_of("root/test:Test_Widget"));
    ASSERT_EQ(3u, widgets.instances.size());
    EXPECT_EQ("1", widgets.instances[0].get_text("Size"));
    EXPECT_TRUE(h.refused_properties().empty());
    // With nothing to tell which associations refer to a widget, every
    // association provider of the namespace is asked.
    Result r = h.an(path_of("root/test:Test_Widget.Name=\"a\""));
    ASSERT_TRUE(r.ok()) << r.message;
    EXPECT_EQ(2u, r.paths.size());
    r = h.cm(path_of("root/test:Test_Widget.Name=\"a\""), "IsA",
             {{"Class", Value::of_string("Test_Widget")}});
    EXPECT_EQ("3", r.return_value.text());
}

TEST(CimhostLoad, MissingModuleOrRegistrationIsAnErrorNotACrash)
{
    Options o;
    o.module_path = "/nonexistent/libnothing.so";
    o.reg_path = TESTPROV_REG;
    Host h(o);
    EXPECT_FALSE(h.ok());
    EXPECT_NE(std::string::npos, h.error().find("/nonexistent/libnothing.so"));
    Object_Path p = path_of("root/test:Test_Widget");
    EXPECT_EQ(CMPI_RC_ERR_FAILED, h.ei(p).rc);

    o.module_path = TESTPROV_MODULE;
    o.reg_path = "/nonexistent/x.reg";
    Host h2(o);
    EXPECT_FALSE(h2.ok());
}
