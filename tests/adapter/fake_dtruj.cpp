// A bare-bones adapter library for start-up cases the simulator has no
// switch for. It exports only the start-up entries; its answers come from
// the environment:
//   FAKE_DTRUJ_VERSION  the version text (unset: none)
//   FAKE_DTRUJ_INIT     the JSON reply of init_hba_lib
//   FAKE_DTRUJ_COUNT    the adapter count
// It prints what it was asked to the standard output, and says something
// through the log callback at init if it was handed one.

#include <stdio.h>
#include <stdlib.h>

#include <json/json.h>

#include "dtruj.h"

#define FAKE_API extern "C" __attribute__((visibility("default")))

static OLMA::LogMsgCB logCallback = 0;

FAKE_API const char* get_agt_version()
{
    return getenv("FAKE_DTRUJ_VERSION");
}

FAKE_API void registerLogMsgCb(OLMA::LogMsgCB cb)
{
    printf("registerLogMsgCb=1\n");
    logCallback = cb;
}

FAKE_API Json::Value init_hba_lib(const Json::Value& request)
{
    Json::FastWriter writer;
    printf("initRequest=%s", writer.write(request).c_str());
    fflush(stdout);

    if (logCallback)
        logCallback(2, "fake_dtruj.cpp", 1, "fake library initialising");

    Json::Value reply;
    const char* text = getenv("FAKE_DTRUJ_INIT");
    Json::Reader reader;

    if (text)
        reader.parse(text, reply);

    return reply;
}

FAKE_API unsigned int getNumberOfAdapters()
{
    printf("getNumberOfAdapters=1\n");
    const char* text = getenv("FAKE_DTRUJ_COUNT");
    return text ? (unsigned int)atoi(text) : 0;
}

FAKE_API int free_hba_lib()
{
    printf("free_hba_lib=1\n");
    fflush(stdout);
    return 0;
}
