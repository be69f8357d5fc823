// The reply writer and the request reader, on their own.

#include <gtest/gtest.h>

#include <cmath>

#include "JsonText.h"

using OLMA::parseJsonText;
using OLMA::styledJson;

namespace
{

Json::Value parsed(const std::string& text)
{
    Json::Value v;
    std::string errors;
    EXPECT_TRUE(parseJsonText(text, v, errors)) << text << "\n" << errors;
    return v;
}

// Plain values, one-line and multi-line arrays, nested and empty containers.
Json::Value layoutSample()
{
    return parsed(R"({
        "version": "1.1", "id": {"a": [1, 2], "b": {}}, "empty": [], "zero": {},
        "short": [true, false, null, "x", -7, 18446744073709551615],
        "margin": ["abcdefghij", "abcdefghij", "abcdefghij", "abcdefghij", "abcdefghij", "abcdefghi"],
        "beyond": ["abcdefghij", "abcdefghij", "abcdefghij", "abcdefghij", "abcdefghij", "abcdefghij"],
        "many": [0,1,2,3,4,5,6,7,8,9,0,1,2,3,4,5,6,7,8,9,0,1,2,3,4],
        "fewer": [0,1,2,3,4,5,6,7,8,9,0,1,2,3,4,5,6,7,8,9,0,1,2,3],
        "empties": [[], {}, []],
        "nested": [[1], {"k": [{"deep": ["x", {"y": null}]}]}, 3],
        "result": [{"error": {"code": 1}}, {"hbaData": {"wwn": "20:00", "isCNA": false}}]
    })");
}

} // namespace

TEST(JsonText, LayoutIsTheClassicStyledLayout)
{
    // Where the package has nothing of its own to add (no reals, no text
    // beyond ASCII) its StyledWriter writes the layout that consoles parse.
    Json::Value v = layoutSample();
    EXPECT_EQ(Json::StyledWriter().write(v), styledJson(v));
    for (const std::string& m : v.getMemberNames())
        EXPECT_EQ(Json::StyledWriter().write(v[m]), styledJson(v[m])) << m;

    EXPECT_EQ("{\n   \"error\" : {\n      \"code\" : 105,\n      \"message\" : \"Procedure not found\",\n"
              "      \"name\" : \"JSONRPCError\"\n   },\n   \"id\" : null,\n   \"version\" : \"1.1\"\n}\n",
        styledJson(parsed(R"({"version":"1.1","id":null,
            "error":{"name":"JSONRPCError","code":105,"message":"Procedure not found"}})")));
    EXPECT_EQ("[ 1, 2 ]\n", styledJson(parsed("[1,2]")));
    EXPECT_EQ("\"x\"\n", styledJson(Json::Value("x")));
    EXPECT_EQ("null\n", styledJson(Json::Value()));
}

TEST(JsonText, KeysInByteOrder)
{
    Json::Value v;
    v["\xc3\xa9"] = 1;
    v["b"] = 2;
    v["_"] = 3;
    v["B"] = 4;
    v["ab"] = 5;
    v["a"] = 6;
    EXPECT_EQ("{\n   \"B\" : 4,\n   \"_\" : 3,\n   \"a\" : 6,\n   \"ab\" : 5,\n   \"b\" : 2,\n"
              "   \"\xc3\xa9\" : 1\n}\n", styledJson(v));
}

TEST(JsonText, RealsReadBackAsTheSameReal)
{
    const double reals[] = {0.1, 3.3, 41.53, 1e300, -2.5e-7, 123456789.125, 3.0, -0.0, 1e22};
    for (double d : reals)
    {
        std::string text = styledJson(Json::Value(d));
        Json::Value back = parsed(text);
        EXPECT_TRUE(back.isDouble()) << text;
        EXPECT_EQ(d, back.asDouble()) << text;
        EXPECT_NE(std::string::npos, text.find_first_of(".e")) << text;
    }
    EXPECT_EQ("0.1\n", styledJson(Json::Value(0.1)));
    EXPECT_EQ("3.0\n", styledJson(Json::Value(3.0)));
    EXPECT_EQ("null\n", styledJson(Json::Value(1e300 * 1e300)));
    EXPECT_EQ("null\n", styledJson(Json::Value(std::nan(""))));
}

TEST(JsonText, TextsStayValidJson)
{
    // Escapes for what JSON requires, UTF-8 as it is, and a stray byte of
    // the library as the character of that byte.
    static const char bytes[] =
        "q\"b\\s/\b\f\n\r\t\x01\x1f\x7f \xc3\xa9 \xe2\x82\xac \xf0\x9f\x98\x80 \xff\xc0\x80 \xed\xa0\x80 \0end";
    std::string raw(bytes, sizeof(bytes) - 1);
    std::string text = styledJson(Json::Value(raw));
    EXPECT_EQ("\"q\\\"b\\\\s/\\b\\f\\n\\r\\t\\u0001\\u001f\x7f \xc3\xa9 \xe2\x82\xac \xf0\x9f\x98\x80 "
              "\\u00ff\\u00c0\\u0080 \\u00ed\\u00a0\\u0080 \\u0000end\"\n", text);
    EXPECT_TRUE(parsed(text).isString());

    Json::Value keyed;
    keyed["a\nb"] = "\xfe";
    EXPECT_EQ("{\n   \"a\\nb\" : \"\\u00fe\"\n}\n", styledJson(keyed));
}

TEST(JsonText, ReaderAcceptsJsonAndComments)
{
    const char* const good[] = {
        "{}", "null", " [ ] ", "0", "-0", "1.5e-3", "-12E+2", "\"\\u00e9\\/\"", "true",
        "{\"a\" : [1, {\"b\": null}], \"c\": \"\xc3\xa9\"}\r\n",
        "/* c */ {\"method\": \"x\" // to the end\n, \"id\": 1} // done",
        "[\"\\ud83d\\ude00\"]",
    };
    for (const char* text : good)
        parsed(text);

    Json::Value v = parsed("{\"id\": 7 /* seven */}");
    EXPECT_EQ("{\n   \"id\" : 7\n}\n", styledJson(v)) << "comments are never written";
}

TEST(JsonText, ReaderRefusesWhatIsNotJson)
{
    struct Case
    {
        const char* text;
        const char* errors;
    };
    const Case bad[] = {
        {"", "* Line 1, Column 1\n  Syntax error: value, object or array expected.\n"},
        {"  \n ", "* Line 2, Column 2\n  Syntax error: value, object or array expected.\n"},
        {"{} x", "* Line 1, Column 4\n  Extra non-whitespace after JSON value.\n"},
        {"{\"a\":1}}", "* Line 1, Column 8\n  Extra non-whitespace after JSON value.\n"},
        {"[1,]", "* Line 1, Column 4\n  Syntax error: value, object or array expected.\n"},
        {"{\"a\":1,}", "* Line 1, Column 8\n  Missing '}' or object member name\n"},
        {"{\n\"a\" 1}", "* Line 2, Column 5\n  Missing ':' after object member name\n"},
        {"[1 2]", "* Line 1, Column 4\n  Missing ',' or ']' in array declaration\n"},
        {"01", "* Line 1, Column 1\n  '01' is not a number.\n"},
        {"-", "* Line 1, Column 1\n  '-' is not a number.\n"},
        {"[1.]", "* Line 1, Column 2\n  '1.' is not a number.\n"},
        {"+1", "* Line 1, Column 1\n  Syntax error: value, object or array expected.\n"},
        {"\"a\tb\"", "* Line 1, Column 3\n  Control character in string: it must be written as an escape\n"},
        {"\"\\x\"", "* Line 1, Column 2\n  Bad escape sequence in string\n"},
        {"\"abc", "* Line 1, Column 1\n  Missing '\"' at the end of a string\n"},
        {"/* open", "* Line 1, Column 1\n  Missing '*/' at the end of a comment\n"},
        {"nul", "* Line 1, Column 1\n  Syntax error: value, object or array expected.\n"},
        {"'a'", "* Line 1, Column 1\n  Syntax error: value, object or array expected.\n"},
    };
    for (const Case& c : bad)
    {
        Json::Value v(5);
        std::string errors;
        EXPECT_FALSE(parseJsonText(c.text, v, errors)) << c.text;
        EXPECT_EQ(c.errors, errors) << c.text;
        EXPECT_TRUE(v.isNull() || v == Json::Value(5)) << c.text;
    }

    // What only the package knows: a number beyond a double, half a
    // surrogate pair.
    for (const char* text : {"1e400", "\"\\ud800\""})
    {
        Json::Value v;
        std::string errors;
        EXPECT_FALSE(parseJsonText(text, v, errors)) << text;
        EXPECT_EQ(0u, errors.find("* Line 1, Column 1\n  ")) << errors;
    }
}

TEST(JsonText, NestingIsBounded)
{
    Json::Value v;
    std::string errors;
    std::string deep = std::string(512, '[') + std::string(512, ']');
    EXPECT_TRUE(parseJsonText(deep, v, errors)) << errors;

    std::string deeper = std::string(513, '[') + std::string(513, ']');
    EXPECT_FALSE(parseJsonText(deeper, v, errors));
    EXPECT_EQ("* Line 1, Column 513\n  Nesting deeper than 512 levels\n", errors);

    std::string huge(200000, '[');
    EXPECT_FALSE(parseJsonText(huge, v, errors));
}
