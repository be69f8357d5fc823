#include "JsonRpcManager.h"

#include <exception>

#include "JsonParams.h"
#include "JsonText.h"
#include "MethodRegistration.h"
#include "dtruj.h"
#include "log.h"

namespace OLMA
{

// A global, as the other singletons: it lives as long as the module, and
// goes with it when a CIM server unloads the module.
static JsonRpcManager gJsonRpcManager;

JsonRpcManager* JsonRpcManager::s_instance = 0;

JsonRpcManager* JsonRpcManager::instance()
{
    if (s_instance)
        return s_instance;

    // The pointer first: registration comes back through instance().
    s_instance = &gJsonRpcManager;
    MethodRegistration::registerMethods();
    return s_instance;
}

void JsonRpcManager::registerMethod(const std::string& name, handler method)
{
    instance()->_registerMethod(name, method);
}

void JsonRpcManager::_registerMethod(const std::string& name, handler method)
{
    _methods[name] = method;
}

std::vector<std::string> JsonRpcManager::getMethods() const
{
    std::vector<std::string> names;
    names.reserve(_methods.size());
    for (const auto& m : _methods)
        names.push_back(m.first);
    return names;
}

static Json::Value errorObject(const char* name, int code, const std::string& message)
{
    Json::Value e(Json::objectValue);
    e["name"] = name;
    e["code"] = code;
    e["message"] = message;
    return e;
}

// A request that parses but can't be served still gets a JSON reply, with
// its "id" when it has one, so that a console can match it:
//
// - a root that isn't an object (an array, which would be a JSON-RPC 2.0
//   batch, a number, a text, a boolean): "USERDEFINEDError" 55 "Not a JSON
//   Object format.", the failure of any value that must be an object; a
//   null root is an empty request and gets 105 like "{}";
// - a "method" or "version" that isn't text: the failure of reading it as a
//   string, "JSONRPCError" 200 "Type is not convertible to string" (null and
//   booleans read as text: null is the empty name, so 105);
// - "params" as an object of named parameters: "USERDEFINEDError" 54 "Not a
//   JSON array format." once the handler reads a position (the count check
//   comes first and counts its members); the methods that hand their params
//   to the library unread take an object as they take anything.
void JsonRpcManager::process(const std::string& request, response& out)
{
    Json::Value root;
    std::string errors;

    if (!parseJsonText(request, root, errors))
    {
        out.status = 500;
        out.text = "There was an error parsing the JSON text comprising the Procedure Call:\n" +
            errors;
        return;
    }

    Json::Value reply;
    if (root.isObject() && root.isMember("id"))
        reply["id"] = root["id"];
    reply["version"] = "1.1";

    Json::Value result;
    bool served = false;

    try
    {
        JsonParams::checkObject(root);

        const Json::Value& version = JsonParams::member(root, "version");
        std::string protocol = root.isMember("version") ? JsonParams::readString(version) : "1.0";
        (void)protocol;

        std::string method = JsonParams::readString(JsonParams::member(root, "method"));
        const Json::Value& params = JsonParams::member(root, "params");

        std::map<std::string, handler>::const_iterator m = _methods.find(method);
        if (m == _methods.end())
        {
            reply["error"] = errorObject("JSONRPCError", 105, "Procedure not found");
        }
        else
        {
            m->second(params, result);
            served = true;
        }
    }
    catch (const HbaAgentError& e)
    {
        served = false;
        reply["error"] = errorObject("USERDEFINEDError", e.code, e.message);
    }
    catch (const std::exception& e)
    {
        served = false;
        reply["error"] = errorObject("JSONRPCError", 200, e.what());
    }
    catch (...)
    {
        served = false;
        reply["error"] = errorObject("UnCaughtError", 5000, "Unknown error that was not caught");
    }

    if (served)
    {
        // Only an object is looked into: an array whose elements hold
        // "error" is a success, as are texts and numbers.
        const Json::Value* libraryError = result.isObject() ? result.find("error", "error" + 5) : 0;
        if (libraryError)
            reply["error"] = *libraryError;
        else
            reply["result"].swap(result);
    }

    out.status = 200;
    out.text = styledJson(reply);
}

} // namespace OLMA
