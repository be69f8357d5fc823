// A console's view of the module: executeMethod of VESPERA_AgentService
// through the stand-in CIM server, on the simulated library with its faults
// and its echo.
#ifndef _VSPR_rpc_RpcSupport_h
#define _VSPR_rpc_RpcSupport_h

#include "ProvidersSupport.h"

extern "C" int dtruj_sim_set_echo(const char* entries);
extern "C" char* dtruj_sim_journal(void);

namespace rpc_test
{

using namespace providers_test;

// The default host, as the tests know it.
const char* const FC_HBA = "20:00:00:05:1e:8a:10:00";
const char* const FC_PORT0 = "10:00:00:05:1e:8a:10:01";
const char* const FC_PORT1 = "10:00:00:05:1e:8a:10:02";
const char* const CNA = "00:05:1e:8b:20:00";
const char* const FCOE_PORT = "10:00:00:05:1e:8b:20:01";
const char* const ETH_PORT = "00:05:1e:8b:20:02";
const char* const DISK_RPORT = "50:06:01:60:3b:20:1a:01";
const char* const VPORT = "2f:00:00:05:1e:8a:10:01";

inline Json::Value json(const std::string& text)
{
    return parseJson(text);
}

class RpcTest : public ProvidersTest
{
protected:
    // The response text of one executeMethod; the CIM call itself must
    // succeed with 0, whatever the request.
    static std::string send(const std::string& request)
    {
        ch::Object_Path path;
        path.name_space = "root/vespera";
        path.class_name = "VESPERA_AgentService";
        path.keys.push_back({"Name", ch::Value::of_string("Vespera Agent Service Provider")});

        std::vector<ch::Property> in(1);
        in[0].name = "request";
        in[0].value = ch::Value::of_string(request);

        ch::Result r = host->cm(path, "executeMethod", in);
        EXPECT_EQ(CMPI_RC_OK, r.rc) << ch::rc_name(r.rc) << " " << r.message;
        EXPECT_EQ("0", r.return_value.text());
        for (const ch::Property& p : r.out)
            if (p.name == "response")
            {
                EXPECT_FALSE(p.value.null);
                return p.value.str;
            }
        ADD_FAILURE() << "no response for " << request;
        return std::string();
    }

    // The parsed reply of a call with these params (left out when null)
    // and id 1.
    static Json::Value call(const std::string& method, const Json::Value& params = Json::Value())
    {
        Json::Value request;
        request["method"] = method;
        request["id"] = 1;
        if (!params.isNull())
            request["params"] = params;
        return json(send(Json::FastWriter().write(request)));
    }

    static Json::Value call(const std::string& method, const char* paramsText)
    {
        return call(method, json(paramsText));
    }

    // The result of a call that must succeed.
    static Json::Value result(const std::string& method, const Json::Value& params = Json::Value())
    {
        Json::Value reply = call(method, params);
        EXPECT_FALSE(reply.isMember("error")) << method << ": " << reply.toStyledString();
        EXPECT_TRUE(reply.isMember("result")) << method;
        return reply["result"];
    }

    static Json::Value result(const std::string& method, const char* paramsText)
    {
        return result(method, json(paramsText));
    }

    // The "error" of a call that must fail.
    static Json::Value error(const std::string& method, const Json::Value& params = Json::Value())
    {
        Json::Value reply = call(method, params);
        EXPECT_FALSE(reply.isMember("result")) << method << ": " << reply.toStyledString();
        return reply["error"];
    }

    static Json::Value error(const std::string& method, const char* paramsText)
    {
        return error(method, json(paramsText));
    }

    static Json::Value errorObject(const char* name, int code, const std::string& message)
    {
        Json::Value e;
        e["name"] = name;
        e["code"] = code;
        e["message"] = message;
        return e;
    }

    // The request that one library entry received, through the echo.
    static Json::Value sent(const std::string& method, const char* paramsText, const char* entry)
    {
        EXPECT_EQ(0, dtruj_sim_set_echo(entry));
        Json::Value r = result(method, json(paramsText));
        dtruj_sim_set_echo(nullptr);
        EXPECT_EQ(entry, r["entry"].asString()) << method;
        return r["request"];
    }

    // Every echoed call since the echo was set.
    static Json::Value journal()
    {
        char* text = dtruj_sim_journal();
        Json::Value v = json(text ? text : "");
        free(text);
        return v;
    }

    void TearDown() override
    {
        dtruj_sim_set_echo(nullptr);
        ProvidersTest::TearDown();
    }
};

} // namespace rpc_test

#endif
