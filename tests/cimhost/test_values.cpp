// Text forms the host reads from users and prints back: object paths, typed
// values, datetimes and the registration file.

#include <cstdio>
#include <fstream>

#include <gtest/gtest.h>

#include "cimhost.h"
#include "internal.h"

using namespace OLMA::cimhost;

TEST(CimhostPathText, ParsesKeysOfEveryKindAndPrintsThemBack)
{
    Object_Path p;
    std::string err;
    const std::string text = "root/vespera:VESPERA_FCPort.CreationClassName=\"VESPERA_FCPort\","
                             "DeviceID=\"a\\\"b\\\\c\",Speed=4,Delta=-2,Up=TRUE";
    ASSERT_TRUE(parse_path(text, p, err)) << err;
    EXPECT_EQ("root/vespera", p.name_space);
    EXPECT_EQ("VESPERA_FCPort", p.class_name);
    ASSERT_EQ(5u, p.keys.size());
    EXPECT_EQ("a\"b\\c", p.key("deviceid")->str);
    EXPECT_EQ(CMPI_uint64, p.key("Speed")->type);
    EXPECT_EQ(4u, p.key("Speed")->num.uint64);
    EXPECT_EQ(CMPI_sint64, p.key("Delta")->type);
    EXPECT_EQ(-2, p.key("Delta")->num.sint64);
    EXPECT_EQ(CMPI_boolean, p.key("Up")->type);
    // Printing keeps order and escapes, so the text survives a round trip.
    EXPECT_EQ(text, p.to_string());

    Object_Path again;
    ASSERT_TRUE(parse_path(p.to_string(), again, err));
    EXPECT_TRUE(path_equal(p, again));

    // A real key stays a real, also when its value is whole.
    ASSERT_TRUE(parse_path("X.R=1.5e3,S=-2.0", p, err)) << err;
    EXPECT_EQ("X.R=1500.0,S=-2.0", p.to_string());
    ASSERT_TRUE(parse_path(p.to_string(), again, err));
    EXPECT_EQ(CMPI_real64, again.key("R")->type);
    EXPECT_TRUE(path_equal(p, again));
}

TEST(CimhostPathText, QuotedPathsAreReferencesAndNestWithEscapes)
{
    Object_Path inner;
    inner.name_space = "root/vespera";
    inner.class_name = "VESPERA_PortController";
    inner.keys.push_back({"DeviceID", Value::of_string("pc \"1\"")});
    Object_Path outer;
    outer.name_space = "root/vespera";
    outer.class_name = "VESPERA_ControlledBy";
    outer.keys.push_back({"Antecedent", Value::of_ref(inner)});
    outer.keys.push_back({"Dependent", Value::of_string("plain text")});

    Object_Path back;
    std::string err;
    ASSERT_TRUE(parse_path(outer.to_string(), back, err)) << err;
    ASSERT_EQ(CMPI_ref, back.key("Antecedent")->type);
    EXPECT_TRUE(path_equal(inner, *back.key("Antecedent")->ref));
    EXPECT_EQ(CMPI_string, back.key("Dependent")->type);
    EXPECT_TRUE(path_equal(outer, back));
}

TEST(CimhostPathText, HostDefaultNamespaceAndClassOnly)
{
    Object_Path p;
    std::string err;
    ASSERT_TRUE(parse_path("//server/root/test:Test_Widget", p, err)) << err;
    EXPECT_EQ("server", p.host);
    EXPECT_EQ("root/test", p.name_space);
    EXPECT_TRUE(p.keys.empty());
    ASSERT_TRUE(parse_path("Test_Widget.Name=\"a\"", p, err, "root/dflt"));
    EXPECT_EQ("root/dflt", p.name_space);
}

TEST(CimhostPathText, BadInputGivesAReasonNotACrash)
{
    const char* bad[] = {
        "",
        "root/x:",
        ":Class",
        "root/x:Class.",
        "root/x:Class.Key",
        "root/x:Class.Key=\"open",
        "root/x:Class.Key=\"a\"junk",
        "root/x:Class.K=1,K=2",
        "root/x:Class.K=notquoted",
        "root/x:9Class",
        "root/x:Cl$ass",
        "//hostonly",
    };
    for (const char* t : bad)
    {
        Object_Path p;
        std::string err;
        EXPECT_FALSE(parse_path(t, p, err)) << t;
        EXPECT_FALSE(err.empty()) << t;
        EXPECT_EQ(std::string::npos, err.find('\n')) << t;
    }
}

TEST(CimhostPathEquality, ClassAndNamespaceIgnoreCaseKeyValuesDoNot)
{
    Object_Path a, b;
    std::string err;
    ASSERT_TRUE(parse_path("root/X:Cls.K=\"v\",N=3", a, err));
    ASSERT_TRUE(parse_path("ROOT/x:cls.n=3,k=\"v\"", b, err));
    EXPECT_TRUE(path_equal(a, b));
    ASSERT_TRUE(parse_path("root/x:Cls.K=\"V\",N=3", b, err));
    EXPECT_FALSE(path_equal(a, b));
    // An integer key matches by number whatever width the provider used.
    b = a;
    b.keys[1].value = Value::of_uint(CMPI_uint16, 3);
    EXPECT_TRUE(path_equal(a, b));
}

TEST(CimhostTypedValues, EachTypeReadsAndRejectsWhatItShould)
{
    struct Case
    {
        const char* text;
        bool ok;
        CMPIType type;
        const char* shown;
    } cases[] = {
        {"uint8:255", true, CMPI_uint8, "255"},
        {"uint8:256", false, 0, ""},
        {"uint16:3", true, CMPI_uint16, "3"},
        {"uint16:-1", false, 0, ""},
        {"uint32:0x10", true, CMPI_uint32, "16"},
        {"uint64:18446744073709551615", true, CMPI_uint64, "18446744073709551615"},
        {"sint8:-128", true, CMPI_sint8, "-128"},
        {"sint8:128", false, 0, ""},
        {"sint64:-9223372036854775808", true, CMPI_sint64, "-9223372036854775808"},
        {"sint32:12abc", false, 0, ""},
        {"boolean:TRUE", true, CMPI_boolean, "true"},
        {"boolean:yes", false, 0, ""},
        {"real64:2.5", true, CMPI_real64, "2.5"},
        {"real32:x", false, 0, ""},
        {"char16:65", true, CMPI_char16, "65"},
        {"string:a:b=c", true, CMPI_string, "a:b=c"},
        {"string:", true, CMPI_string, ""},
        {"datetime:20240102030405.000006+060", true, CMPI_dateTime,
         "20240102030405.000006+060"},
        {"datetime:00000001020304.000000:000", true, CMPI_dateTime,
         "00000001020304.000000:000"},
        {"datetime:2024", false, 0, ""},
        {"datetime:20241302030405.000006+060", false, 0, ""},
        {"ref:root/test:Test_Widget.Name=\"a\"", true, CMPI_ref,
         "root/test:Test_Widget.Name=\"a\""},
        {"ref:not a path", false, 0, ""},
        {"uint16[]:1,2,3", true, CMPI_uint16A, "{1, 2, 3}"},
        {"string[]:a\\,b,c", true, CMPI_stringA, "{\"a,b\", \"c\"}"},
        {"uint8[]:1,300", false, 0, ""},
        {"instance:x", false, 0, ""},
        {"float:1", false, 0, ""},
        {"noprefix", false, 0, ""},
    };
    for (const Case& c : cases)
    {
        Value v;
        std::string err;
        bool ok = parse_typed_value(c.text, v, err);
        EXPECT_EQ(c.ok, ok) << c.text << ": " << err;
        if (ok && c.ok)
        {
            EXPECT_EQ(c.type, v.type) << c.text;
            EXPECT_EQ(c.shown, v.text()) << c.text;
        }
        if (!ok)
        {
            EXPECT_FALSE(err.empty()) << c.text;
        }
    }
}

TEST(CimhostDatetimes, BinaryFormRoundTripsAndHonoursTheOffset)
{
    // 2024-01-02 03:04:05.000006 at UTC+60 minutes is 02:04:05 UTC.
    uint64_t usec = datetime_to_binary("20240102030405.000006+060");
    EXPECT_EQ(1704161045000006ull, usec);
    EXPECT_EQ("20240102020405.000006+000", datetime_from_binary(usec, false));
    uint64_t interval = datetime_to_binary("00000001020304.000005:000");
    EXPECT_EQ((86400ull + 2 * 3600 + 3 * 60 + 4) * 1000000 + 5, interval);
    EXPECT_EQ("00000001020304.000005:000", datetime_from_binary(interval, true));
    EXPECT_TRUE(datetime_is_interval("00000001020304.000005:000"));
    EXPECT_FALSE(datetime_valid("00000001250304.000005:000"));
}

namespace
{

std::string write_temp(const std::string& text)
{
    char name[] = "/tmp/cimhost_regXXXXXX";
    int fd = mkstemp(name);
    EXPECT_GE(fd, 0);
    FILE* f = fdopen(fd, "w");
    fputs(text.c_str(), f);
    fclose(f);
    return name;
}

} // namespace

TEST(CimhostRegFile, ReadsSectionsKindsAndNamespaces)
{
    std::vector<Registration_Entry> e;
    std::string err;
    ASSERT_TRUE(read_reg_file(TESTPROV_REG, e, err)) << err;
    ASSERT_EQ(4u, e.size());
    EXPECT_EQ("Test_WidgetGadget", e[2].class_name);
    EXPECT_EQ(unsigned(MI_INSTANCE | MI_ASSOCIATION), e[2].kinds);
    EXPECT_EQ("cimhost_testprov", e[3].location);
    EXPECT_EQ((std::vector<std::string> {"root/test", "root/other"}), e[3].name_spaces);

    std::string shipped = std::string(VSPR_SOURCE_DIR_FOR_TESTS) + "/schema/vsprprovider.reg";
    ASSERT_TRUE(read_reg_file(shipped, e, err)) << err;
    ASSERT_EQ(76u, e.size());
    size_t assoc = 0, indication = 0;
    for (const Registration_Entry& r : e)
    {
        EXPECT_EQ(r.class_name + "_Provider", r.provider);
        EXPECT_TRUE(r.kinds & MI_METHOD) << r.class_name;
        assoc += (r.kinds & MI_ASSOCIATION) != 0;
        indication += (r.kinds & MI_INDICATION) != 0;
    }
    EXPECT_EQ(41u, assoc);
    EXPECT_EQ(1u, indication);
}

TEST(CimhostRegFile, MalformedFilesNameTheLine)
{
    const char* bad[] = {
        "provider: X\n",
        "[A]\n provider: P\n location: L\n type: instance sometimes\n",
        "[A]\n provider: P\n type: instance\n",
        "[A\n",
        "[A]\n no colon here\n",
    };
    for (const char* text : bad)
    {
        std::string path = write_temp(text);
        std::vector<Registration_Entry> e;
        std::string err;
        EXPECT_FALSE(read_reg_file(path, e, err)) << text;
        EXPECT_NE(std::string::npos, err.find(path)) << err;
        remove(path.c_str());
    }
    std::vector<Registration_Entry> e;
    std::string err;
    EXPECT_FALSE(read_reg_file("/nonexistent/x.reg", e, err));
}
