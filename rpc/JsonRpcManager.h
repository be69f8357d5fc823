#ifndef _VSPR_JsonRpcManager_h
#define _VSPR_JsonRpcManager_h

// The engine behind executeMethod of VESPERA_AgentService: a console's
// JSON-RPC request in, a reply text out, with every failure inside the text.

#include <map>
#include <string>
#include <vector>
#include <json/json.h>

namespace OLMA
{

class JsonRpcManager
{
public:
    // A method: the params of the request in, whatever it leaves in the
    // result out. Library failures come as an "error" member of the result
    // or as exceptions; the engine turns both into the reply's "error".
    typedef void (*handler)(const Json::Value& params, Json::Value& result);

    struct response
    {
        std::string text;   // the reply, or plain text after a parse failure
        int status;         // 200 with a JSON reply, 500 after a parse failure
    };

    // The singleton; the first call fills the registry.
    static JsonRpcManager* instance();

    void process(const std::string& request, response& response);

    // The last registration of a name wins.
    static void registerMethod(const std::string& name, handler method);
    void _registerMethod(const std::string& name, handler method);

    // Every name, in byte order.
    std::vector<std::string> getMethods() const;

private:
    // Method names are compared byte by byte: case counts.
    std::map<std::string, handler> _methods;

    static JsonRpcManager* s_instance;
};

} // namespace OLMA

#endif // _VSPR_JsonRpcManager_h
