// The engine as a console meets it: what becomes of every kind of request,
// and of every way the library fails, in the text of the response.

#include "RpcSupport.h"

using namespace rpc_test;

namespace
{

const char* const PARSE_PREFIX =
    "There was an error parsing the JSON text comprising the Procedure Call:\n";

class Engine : public RpcTest
{
};

} // namespace

TEST_F(Engine, TextThatIsNotJsonGetsThePlainParseFailure)
{
    EXPECT_EQ(std::string(PARSE_PREFIX) +
        "* Line 1, Column 1\n  Syntax error: value, object or array expected.\n", send(""));
    EXPECT_EQ(std::string(PARSE_PREFIX) +
        "* Line 1, Column 39\n  Extra non-whitespace after JSON value.\n",
        send("{\"method\":\"discovery.getHost\",\"id\":1} trail"));

    for (const char* text : {"{\"method\":", "[1,]", "{\"id\":01}", "{'id':1}",
                             "{\"method\":\"discovery.getHost\"}}"})
        EXPECT_EQ(0u, send(text).find(PARSE_PREFIX)) << text;

    std::string deep = "{\"id\":" + std::string(2000, '[') + std::string(2000, ']') + "}";
    EXPECT_EQ(0u, send(deep).find(PARSE_PREFIX));

    // Comments are read, and never come back.
    std::string text = send("/* console */ {\"method\": \"discovery.getServerTime\", // now\n"
                            "\"id\": 3 /* three */}");
    EXPECT_EQ(std::string::npos, text.find("three"));
    EXPECT_EQ(3, json(text)["id"].asInt());
}

TEST_F(Engine, AnEmptyRequestIsAnUnknownProcedure)
{
    const std::string notFound =
        "{\n"
        "   \"error\" : {\n"
        "      \"code\" : 105,\n"
        "      \"message\" : \"Procedure not found\",\n"
        "      \"name\" : \"JSONRPCError\"\n"
        "   },\n"
        "   \"version\" : \"1.1\"\n"
        "}\n";
    EXPECT_EQ(notFound, send("{}"));
    EXPECT_EQ(notFound, send("null"));
    EXPECT_EQ(notFound, send(" { \"params\" : [1] , \"jsonrpc\" : \"2.0\" } "));
    EXPECT_EQ(notFound, send("{\"method\":null}"));
}

TEST_F(Engine, IdComesBackUnchangedAndVersionIsAlwaysOneOne)
{
    const char* const ids[] = {"null", "0", "-17", "18446744073709551615", "2.5", "\"abc\"",
                               "\"\"", "true", "{\"a\":[1,{\"b\":null}]}", "[1,\"x\"]"};
    for (const char* id : ids)
    {
        std::string text = send(std::string("{\"method\":\"discovery.getServerTime\",\"id\":") + id +
                                ",\"version\":\"2.0\"}");
        Json::Value reply = json(text);
        EXPECT_TRUE(reply.isMember("id")) << id;
        EXPECT_EQ(json(id), reply["id"]) << id;
        EXPECT_EQ("1.1", reply["version"].asString()) << id;
        EXPECT_TRUE(reply["result"].isMember("utcTime")) << text;
    }

    Json::Value reply = json(send("{\"method\":\"discovery.getServerTime\"}"));
    EXPECT_FALSE(reply.isMember("id"));
    EXPECT_EQ("1.1", reply["version"].asString());
    EXPECT_TRUE(reply["result"].isMember("utcTime"));
    EXPECT_EQ(2u, reply.size());
}

TEST_F(Engine, ReplyLayout)
{
    // The reply's own members in byte order, an array of plain values on
    // one line, and nesting by three blanks.
    std::string text = send("{\"id\":[1,2],\"method\":\"discovery.getAllFcByPort\","
                            "\"params\":[\"10:00:00:05:1e:8b:20:01\"]}");
    EXPECT_EQ(0u, text.find("{\n   \"id\" : [ 1, 2 ],\n   \"result\" : [\n      {\n         \""))
        << text;
    EXPECT_NE(std::string::npos, text.find("\n   ],\n   \"version\" : \"1.1\"\n}\n")) << text;
    EXPECT_EQ('\n', text.back());
}

TEST_F(Engine, MethodNamesAreCaseSensitive)
{
    for (const char* name : {"Discovery.getHost", "discovery.gethost", "discovery.getHost ",
                             "getHost", "discovery."})
        EXPECT_EQ(errorObject("JSONRPCError", 105, "Procedure not found"), error(name)) << name;
}

TEST_F(Engine, RequestsTheEngineCantServe)
{
    // A root that isn't an object needs to be one.
    Json::Value notObject = errorObject("USERDEFINEDError", 55, "Not a JSON Object format.");
    for (const char* text : {"[{\"method\":\"discovery.getHost\",\"id\":1}]", "5", "\"x\"", "true"})
    {
        Json::Value reply = json(send(text));
        EXPECT_EQ(notObject, reply["error"]) << text;
        EXPECT_FALSE(reply.isMember("id")) << text;
        EXPECT_FALSE(reply.isMember("result")) << text;
    }

    // Method and version are texts; what can't be read as one fails as any
    // reading of a string parameter does, with the id kept.
    Json::Value notText = errorObject("JSONRPCError", 200, "Type is not convertible to string");
    for (const char* text : {"{\"method\":5,\"id\":9}", "{\"method\":[\"discovery.getHost\"],\"id\":9}",
                             "{\"method\":{},\"id\":9}",
                             "{\"method\":\"discovery.getHost\",\"version\":2.0,\"id\":9}"})
    {
        Json::Value reply = json(send(text));
        EXPECT_EQ(notText, reply["error"]) << text;
        EXPECT_EQ(9, reply["id"].asInt()) << text;
    }
    // true reads as "true": a name like any other.
    EXPECT_EQ(105, json(send("{\"method\":true}"))["error"]["code"].asInt());

    // Named params: the count check first, then no position can be read.
    EXPECT_EQ(errorObject("USERDEFINEDError", 54, "Not a JSON array format."),
        error("discovery.getCee", json("{\"mac\":\"00:05:1e:8b:20:02\"}")));
    EXPECT_EQ(51, error("discovery.getCee", json("{\"a\":1,\"b\":2}"))["code"].asInt());
    // ... and the methods that hand their params over unread take them.
    EXPECT_TRUE(result("discovery.getHost", json("{\"anything\":1}")).isMember("hostName"));
}

TEST_F(Engine, LibraryFailuresInTheReply)
{
    struct Case
    {
        const char* fault;
        Json::Value error;
    };
    const Case cases[] = {
        {"{\"kind\":\"hba\",\"code\":7,\"message\":\"port busy\"}",
         errorObject("USERDEFINEDError", 7, "port busy")},
        {"{\"kind\":\"std\",\"message\":\"bad_alloc in the driver\"}",
         errorObject("JSONRPCError", 200, "bad_alloc in the driver")},
        {"unknown", errorObject("UnCaughtError", 5000, "Unknown error that was not caught")},
        // The library's own "error" goes as it is, the rest of its reply lost.
        {"{\"kind\":\"error\",\"code\":42,\"message\":\"no such port\"}",
         json("{\"code\":42,\"message\":\"no such port\"}")},
    };
    for (const Case& c : cases)
    {
        ASSERT_EQ(0, dtruj_sim_set_fault("getCee", c.fault));
        Json::Value reply = call("discovery.getCee", "[\"00:05:1e:8b:20:02\"]");
        EXPECT_EQ(c.error, reply["error"]) << c.fault;
        EXPECT_FALSE(reply.isMember("result")) << c.fault;
        EXPECT_EQ(1, reply["id"].asInt());
        EXPECT_EQ(3u, reply.size()) << c.fault;
    }

    // A result left untouched is a null result, and a success.
    ASSERT_EQ(0, dtruj_sim_set_fault("getCee", "null"));
    std::string text = send("{\"method\":\"discovery.getCee\",\"params\":[\"00:05:1e:8b:20:02\"]}");
    EXPECT_EQ("{\n   \"result\" : null,\n   \"version\" : \"1.1\"\n}\n", text);
    ASSERT_EQ(0, dtruj_sim_set_fault("getCee", nullptr));

    // An array is never looked into: "error" in an element is a success.
    ASSERT_EQ(0, dtruj_sim_set_fault("getFcByFcWwn", "error"));
    Json::Value wrapped = result("discovery.getAllFcByPort", "[\"10:00:00:05:1e:8a:10:01\"]");
    ASSERT_EQ(1u, wrapped.size());
    EXPECT_TRUE(wrapped[0].isMember("error"));
    EXPECT_EQ(1, error("discovery.getFcByFcWwn", "[\"10:00:00:05:1e:8a:10:01\"]")["code"].asInt());
}

TEST_F(Engine, AResultWrittenBeforeAnExceptionIsDropped)
{
    // The walk has appended the first adapter when the second one throws.
    ASSERT_EQ(0, dtruj_sim_set_fault("getHbaByMac", "{\"kind\":\"hba\",\"code\":3,\"message\":\"gone\"}"));
    Json::Value reply = call("discovery.getAllHbasByHost", "[]");
    EXPECT_EQ(errorObject("USERDEFINEDError", 3, "gone"), reply["error"]);
    EXPECT_FALSE(reply.isMember("result"));
}

TEST_F(Engine, FaultsOfAHostDescriptionReachTheConsole)
{
    Json::Value host = defaultHost();
    host["faults"]["getLldp"] = json("{\"kind\":\"hba\",\"code\":12,\"message\":\"LLDP agent down\",\"count\":1}");
    useHost(host);
    EXPECT_EQ(errorObject("USERDEFINEDError", 12, "LLDP agent down"),
        error("discovery.getLldp", json("[\"00:05:1e:8b:20:02\"]")));
    EXPECT_TRUE(result("discovery.getLldp", json("[\"00:05:1e:8b:20:02\"]")).isMember("systemName"));
}
