#include "CIMProviderTruj.h"

#include <dlfcn.h>
#include <string.h>

#include "log.h"

namespace OLMA
{

void* libHandle = 0;
bool gTrujLibLoaded = false;

Json::Value default_JsonReqFP(const Json::Value&)
{
    return Json::Value();
}

int default_voidRetIntFP()
{
    return -1;
}

unsigned int default_voidRetUIntFP()
{
    return 65535;
}

const char* default_voidRetStrFP()
{
    return 0;
}

void default_evtProcessCBRetVoidFP(EventProcessCB)
{
}

void default_log4cxxMsgRetVoidFP(LogMsgCB)
{
}

// Each pointer starts as its stub, set before any code runs, so that even a
// call made ahead of the binding has something to answer it.
#define VSPR_TRUJ_DEFINE(type, name, global) type global = default_##type;
VSPR_TRUJ_ENTRIES(VSPR_TRUJ_DEFINE)
#undef VSPR_TRUJ_DEFINE

// Binds one entry. The stub goes in first so that the pointer is callable
// whatever dlsym says; an entry that the library lacks keeps it.
template<class FP>
static void _bind(FP& pointer, FP stub, const char* name)
{
    pointer = stub;

    if (!libHandle)
        return;

    dlerror();
    void* sym = dlsym(libHandle, name);
    const char* err = dlerror();

    if (err || !sym)
    {
        TLOG(LL_ERR, "%s not found. %s ", name, err ? err : "");
        return;
    }

    // POSIX guarantees that a data pointer from dlsym converts to a
    // function pointer; memcpy says so without a cast warning.
    static_assert(sizeof(FP) == sizeof(void*), "function pointer size");
    memcpy(&pointer, &sym, sizeof(pointer));
}

void setupDLLEntryPoints()
{
    TLOG(LL_DBG, "inside setupDLLEntryPoints");

    // A bare name: the dynamic linker's own search path decides, as it
    // does for the CIM server that loads us.
    libHandle = dlopen("libdtruj.so", RTLD_NOW);
    const char* err = dlerror();

    if (libHandle)
        gTrujLibLoaded = true;
    else
        TLOG(LL_DBG, "Error in loading library: %s", err ? err : "");

#define VSPR_TRUJ_BIND(type, name, global) \
    _bind<type>(global, default_##type, #name);
    VSPR_TRUJ_ENTRIES(VSPR_TRUJ_BIND)
#undef VSPR_TRUJ_BIND

    TLOG(LL_DBG, "Returning: %s", "setupDLLEntryPoints");
}

} // namespace OLMA
