// A console's request text is the module's widest door: whatever it holds,
// JsonRpcManager::process must answer with a reply (JSON, or the plain text
// of a parse failure) and neither crash nor leak, against the simulated
// library. The library starts afresh every so often, so that the setters a
// request reaches don't take the host further and further away.

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include <json/json.h>

#include "JsonRpcManager.h"

extern "C" int dtruj_sim_reset(void);

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    static unsigned runs = 0;
    if (runs++ % 64 == 0)
        dtruj_sim_reset();

    OLMA::JsonRpcManager::response response;
    response.status = 0;
    OLMA::JsonRpcManager::instance()->process(
        std::string(reinterpret_cast<const char*>(data), size), response);

    if (response.status == 500)
        return 0;
    // Anything else is a styled JSON object with "version" "1.1" and one of
    // "result" and "error".
    Json::Value reply;
    if (response.status != 200 || !Json::Reader().parse(response.text, reply) ||
        !reply.isObject() || reply["version"] != "1.1" ||
        reply.isMember("result") == reply.isMember("error"))
        abort();
    return 0;
}
