// A second shared object, built like the module, that calls an entry of the
// library and tells how what it threw was caught.
#include <dlfcn.h>
#include <exception>
#include <string>

#include "dtruj.h"

// 0 nothing thrown, 1 HbaAgentError, 2 std::exception, 3 anything else;
// -1 entry not found. The code and message of an HbaAgentError are copied out.
extern "C" __attribute__((visibility("default"))) int
dtruj_catch(const char* entry, int* code, char* message, size_t size)
{
    void* h = dlopen("libdtruj.so", RTLD_NOW);
    if (!h)
        return -1;
    auto f = reinterpret_cast<OLMA::JsonReqFP>(dlsym(h, entry));
    if (!f)
        return -1;
    try {
        f(Json::Value());
        return 0;
    } catch (OLMA::HbaAgentError& e) {
        *code = e.code;
        std::string m = e.message.substr(0, size ? size - 1 : 0);
        m.copy(message, m.size());
        if (size)
            message[m.size()] = '\0';
        return 1;
    } catch (std::exception&) {
        return 2;
    } catch (...) {
        return 3;
    }
}
