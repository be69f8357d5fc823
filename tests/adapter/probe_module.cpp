// A stand-in for the provider module in start-up tests: the adapter code,
// whole, in a shared object that the probe loads as a CIM server would, plus
// a few exported questions about the state it ended in.

#include <dlfcn.h>
#include <stdio.h>

#include <string>

#include "CIMProviderTruj.h"
#include "ProviderInit.h"

using namespace OLMA;

#define PROBE_API extern "C" __attribute__((visibility("default")))

PROBE_API int probe_driver_status()
{
    return ProviderInit::getDriverStatus();
}

PROBE_API int probe_library_loaded()
{
    return gTrujLibLoaded ? 1 : 0;
}

// Entries whose pointer is the library's own symbol; the names of the
// others go to unbound, separated by blanks.
PROBE_API int probe_bound_entries(char* unbound, size_t size)
{
    std::string missing;
    int bound = 0;

#define PROBE_CHECK(type, name, global) \
    { \
        void* sym = libHandle ? dlsym(libHandle, #name) : 0; \
        type stub = default_##type; \
        if (sym && (void*)global == sym && global != stub) \
            bound++; \
        else \
            missing += std::string(missing.empty() ? "" : " ") + #name; \
    }
    VSPR_TRUJ_ENTRIES(PROBE_CHECK)
#undef PROBE_CHECK

    snprintf(unbound, size, "%s", missing.c_str());

    return bound;
}

static bool _answersAsStub(Json::Value (*fp)(const Json::Value&))
{
    return fp(Json::Value()).isNull();
}

static bool _answersAsStub(int (*fp)())
{
    return fp() == -1;
}

static bool _answersAsStub(unsigned int (*fp)())
{
    return fp() == 65535;
}

static bool _answersAsStub(const char* (*fp)())
{
    return fp() == 0;
}

// The callback registrations answer nothing: being the stub, and callable
// with a null callback, is all there is to see.
static bool _answersAsStub(void (*fp)(EventProcessCB))
{
    fp(0);
    return fp == default_evtProcessCBRetVoidFP;
}

static bool _answersAsStub(void (*fp)(LogMsgCB))
{
    fp(0);
    return fp == default_log4cxxMsgRetVoidFP;
}

// Calls every entry once and counts those that answer as their stub does.
PROBE_API int probe_stub_answers()
{
    int count = 0;

#define PROBE_CALL(type, name, global) \
    if (_answersAsStub(global)) \
        count++;
    VSPR_TRUJ_ENTRIES(PROBE_CALL)
#undef PROBE_CALL

    return count;
}
