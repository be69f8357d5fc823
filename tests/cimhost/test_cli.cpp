// The cimhost command as a user meets it: bad input is one line and exit
// status 2, failed operations name the CMPI code, --json is one document.

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>
#include <json/json.h>

namespace
{

struct Outcome
{
    int status;
    std::string out;
    std::string err;
};

std::string quote(const std::string& s)
{
    std::string r = "'";
    for (char c : s)
        r += c == '\'' ? std::string("'\\''") : std::string(1, c);
    return r + "'";
}

std::string slurp(const std::string& path)
{
    std::ifstream f(path);
    std::stringstream ss;
    ss << f.rdbuf();
    return ss.str();
}

Outcome cimhost(const std::vector<std::string>& args, bool with_module = true,
                const std::string& input = "")
{
    std::string cmd = CIMHOST_EXE;
    if (with_module)
        cmd += std::string(" --module ") + TESTPROV_MODULE + " --reg " + TESTPROV_REG;
    for (const std::string& a : args)
        cmd += " " + quote(a);
    std::string out = "/tmp/cimhost_cli_out." + std::to_string(getpid());
    std::string err = "/tmp/cimhost_cli_err." + std::to_string(getpid());
    std::string in = "/tmp/cimhost_cli_in." + std::to_string(getpid());
    std::ofstream(in) << input;
    int rc = system((cmd + " <" + in + " >" + out + " 2>" + err).c_str());
    Outcome r {WIFEXITED(rc) ? WEXITSTATUS(rc) : -1, slurp(out), slurp(err)};
    remove(in.c_str());
    remove(out.c_str());
    remove(err.c_str());
    return r;
}

Json::Value json_of(const std::string& text)
{
    Json::Value v;
    Json::Reader reader;
    EXPECT_TRUE(reader.parse(text, v)) << text;
    return v;
}

const char widget_a[] = "root/test:Test_Widget.Name=\"a\"";

} // namespace

TEST(CimhostCli, HelpDocumentsEveryVerbAndOption)
{
    Outcome r = cimhost({"--help"}, false);
    EXPECT_EQ(0, r.status);
    for (const char* word : {" ei ", " ein ", " gi ", " ai ", " an ", " ri ", " rn ", " cm ",
                             " listen ", " session ", "--module", "--reg", "--json", "--props", "--assoc-class",
                             "--result-class", "--role", "--result-role", "--seconds",
                             "--no-interop"})
        EXPECT_NE(std::string::npos, r.out.find(word)) << word;
}

TEST(CimhostCli, BadInputIsOneLineAndStatusTwo)
{
    const std::vector<std::vector<std::string>> cases = {
        {},
        {"frobnicate", "x"},
        {"ei"},
        {"ei", "root/test:"},
        {"ei", "root/test:No_Such_Class"},
        {"ei", widget_a},
        {"gi", "root/test:Test_Widget.Name=\"a"},
        {"ai", widget_a, "--assoc-class", "No_Such"},
        {"ei", "root/test:Test_Widget", "--bogus"},
        {"ei", "root/test:Test_Widget", "--props"},
        {"listen", "root/test:Test_Event", "--seconds", "soon"},
        {"cm", widget_a},
        {"cm", widget_a, "Double", "X"},
        {"cm", widget_a, "Double", "Unknown=3"},
        {"cm", widget_a, "Double", "X=abc"},
        {"cm", widget_a, "Double", "X=uint32:4294967296"},
        {"cm", widget_a, "Lookup", "Target=root/test:No_Such.K=\"1\""},
    };
    for (const auto& args : cases)
    {
        Outcome r = cimhost(args);
        std::string shown;
        for (const std::string& a : args)
            shown += a + " ";
        EXPECT_EQ(2, r.status) << shown << "\n" << r.err;
        EXPECT_EQ(0, r.err.compare(0, 9, "cimhost: ")) << shown << r.err;
        EXPECT_EQ(1, std::count(r.err.begin(), r.err.end(), '\n')) << shown << r.err;
    }
}

TEST(CimhostCli, FailuresNameTheReturnCode)
{
    Outcome r = cimhost({"gi", "root/test:Test_Widget.Name=\"zz\""});
    EXPECT_EQ(1, r.status);
    EXPECT_NE(std::string::npos, r.err.find("CMPI_RC_ERR_NOT_FOUND")) << r.err;

    r = cimhost({"--json", "cm", widget_a, "Fail"});
    EXPECT_EQ(1, r.status);
    Json::Value j = json_of(r.out);
    EXPECT_EQ("CMPI_RC_ERR_ACCESS_DENIED", j["rc_name"].asString());
    EXPECT_EQ("no way", j["message"].asString());

    r = cimhost({"--module", "/nonexistent/lib.so", "--reg", TESTPROV_REG, "ei", "root/test:X"},
                false);
    EXPECT_EQ(1, r.status);
}

TEST(CimhostCli, JsonCarriesTypesAndTextIsReadable)
{
    Outcome r = cimhost({"--json", "ei", "root/test:Test_Widget", "--props", "Size,Tags"});
    ASSERT_EQ(0, r.status) << r.err;
    Json::Value j = json_of(r.out);
    ASSERT_EQ(3u, j["instances"].size());
    const Json::Value& props = j["instances"][0]["properties"];
    ASSERT_EQ(3u, props.size());
    EXPECT_EQ("root/test:Test_Widget.Name=\"a\"", j["instances"][0]["path"].asString());
    for (const Json::Value& p : props)
        if (p["name"] == "Size")
        {
            EXPECT_EQ("uint16", p["type"].asString());
            EXPECT_EQ(1u, p["value"].asUInt());
        }
        else if (p["name"] == "Tags")
        {
            EXPECT_EQ("string[]", p["type"].asString());
            EXPECT_TRUE(p["value"][1].isNull());
        }

    // Untyped arguments take their type from the module's class tables.
    r = cimhost({"cm", widget_a, "Double", "X=21"});
    ASSERT_EQ(0, r.status) << r.err;
    EXPECT_NE(std::string::npos, r.out.find("ReturnValue = 0\n")) << r.out;
    EXPECT_NE(std::string::npos, r.out.find("Y = 42\n")) << r.out;

    r = cimhost({"--json", "cm", widget_a, "Lookup", "Target=root/test:Test_Widget.Name=\"c\""});
    ASSERT_EQ(0, r.status) << r.err;
    j = json_of(r.out);
    EXPECT_EQ("uint32", j["return_value"]["type"].asString());
    EXPECT_EQ("c", j["out"][0]["value"].asString());

    r = cimhost({"an", "--result-class", "Test_Widget", "root/test:Test_Gadget.Id=2"});
    ASSERT_EQ(0, r.status) << r.err;
    EXPECT_EQ("root/test:Test_Widget.Name=\"a\"\nroot/test:Test_Widget.Name=\"b\"\n", r.out);

    r = cimhost({"gi", widget_a});
    ASSERT_EQ(0, r.status);
    EXPECT_NE(std::string::npos, r.out.find("instance of Test_Widget {")) << r.out;
    EXPECT_NE(std::string::npos, r.out.find("    Size = 1;")) << r.out;
}

TEST(CimhostCli, ListenPrintsIndicationsAndUnsubscribes)
{
    Outcome r = cimhost({"--json", "listen", "root/test:Test_Event", "--seconds", "1"});
    ASSERT_EQ(0, r.status) << r.err;
    Json::Value j = json_of(r.out);
    ASSERT_GE(j["indications"].size(), 3u);
    EXPECT_EQ("root/test", j["indications"][0]["namespace"].asString());
    EXPECT_EQ("Test_Event", j["indications"][0]["instance"]["class"].asString());
}

TEST(CimhostCli, ASessionAnswersEachLineAsTheCommandWould)
{
    // The same verbs one by one, for what the session must print.
    const std::vector<std::vector<std::string>> verbs = {
        {"ei", "root/test:Test_Widget", "--props", "Size"},
        {"--json", "cm", widget_a, "Double", "X=21"},
        {"an", "--result-class", "Test_Widget", "root/test:Test_Gadget.Id=2"},
    };
    std::string expected;
    for (const auto& v : verbs)
        expected += cimhost(v).out;

    const std::string input =
        "# a comment, then a blank line\n"
        "\n"
        "ei root/test:Test_Widget --props Size\n"
        "frobnicate\n"
        "  --json cm 'root/test:Test_Widget.Name=\"a\"' Double X=21\n"
        "sleep 0.05\n"
        "--module /elsewhere.so ei root/test:Test_Widget\n"
        "an --result-class Test_Widget \"root/test:Test_Gadget.Id=2\"\n"
        "gi root/test:Test_Widget.Name=\\\"zz\\\"\n";
    Outcome r = cimhost({"session"}, true, input);

    EXPECT_EQ(expected, r.out);
    // The unknown verb and the session-wide option are bad input, the
    // missing instance a failure: each one line, and the worst status wins.
    EXPECT_EQ(2, r.status);
    EXPECT_EQ(3, std::count(r.err.begin(), r.err.end(), '\n')) << r.err;
    EXPECT_NE(std::string::npos, r.err.find("unknown verb 'frobnicate'")) << r.err;
    EXPECT_NE(std::string::npos, r.err.find("--module holds for the whole session")) << r.err;
    EXPECT_NE(std::string::npos, r.err.find("CMPI_RC_ERR_NOT_FOUND")) << r.err;

    EXPECT_EQ(0, cimhost({"session"}, true, "ei root/test:Test_Widget\n").status);
    EXPECT_EQ(2, cimhost({"session", "extra"}).status);
    EXPECT_EQ(2, cimhost({"session"}, true, "sleep soon\n").status);
    EXPECT_EQ(2, cimhost({"session"}, true, "ei 'root/test:Test_Widget\n").status);
}
