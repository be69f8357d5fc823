#include "ProviderInit.h"

#include <exception>

#include <json/json.h>

#include "CIMProviderTruj.h"
#include "ProviderUtil.h"
#include "dtruj.h"
#include "log.h"

namespace OLMA
{

// Constant-initialised, so that anything that reads it before the
// constructor ran sees "no adapters".
int ProviderInit::driverStatus = 1;

// Libraries before 3.2.1 crash when handed a log callback. Each of the three
// digits is compared by itself, as those libraries did.
static bool _versionTakesLogCallback(const char* version)
{
    if (!version)
        return false;

    for (int i = 0; i < 5; i++)
    {
        if (version[i] == '\0')
            return false;
    }

    return version[0] - '0' > 2 && version[2] - '0' > 1 && version[4] - '0' > 0;
}

// A plain entry of the library, which may throw like any other: nothing may
// leave the start-up, which runs while the CIM server loads the module, nor
// the end, which runs while it unloads it or exits. A throw counts as
// `failed`, after an ERR line that names the entry.
template<class R, class Call>
static R _guarded(const char* entry, Call call, R failed)
{
    try
    {
        return call();
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "%s got User exception %d: %s", entry, e.getCode(), e.getMessage().c_str());
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "%s got std exception: %s", entry, e.what());
    }
    catch (...)
    {
        TLOG(LL_ERR, "%s got default exception", entry);
    }

    return failed;
}

// Runs init_hba_lib; the library may throw, and nothing may leave here
// because this runs while the CIM server loads the module.
static bool _initLibrary(Json::Value& reply)
{
    Json::Value request(Json::objectValue);
    request["appId"] = 2;

    try
    {
        reply = libInitHbaLib(request);
        return true;
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "%s - libInitHbaLib got User exception %d: %s",
            "ProviderInit", e.getCode(), e.getMessage().c_str());
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "%s - libInitHbaLib got std exception: %s",
            "ProviderInit", e.what());
    }
    catch (...)
    {
        TLOG(LL_ERR, "%s - libInitHbaLib got default exception",
            "ProviderInit");
    }

    return false;
}

ProviderInit::ProviderInit()
{
    TLOG(LL_DBG, "Inside ProviderInit Constructor.");

    setupDLLEntryPoints();

    const char* version = _guarded("libGetAgtVersion",
        [] { return libGetAgtVersion(); }, (const char*)0);

    if (_versionTakesLogCallback(version))
        _guarded("libRegisterLogMsgCb",
            [] { libRegisterLogMsgCb(ProviderUtil::logMsg); return true; }, false);

    if (version)
        TLOG(LL_INFO, "TRUJ Library version: %s", version);
    else
        TLOG(LL_INFO, "TRUJ Library version: %s",
            gTrujLibLoaded ? "Unknown" : "NOT Loaded");

    Json::Value reply;

    if (!_initLibrary(reply))
    {
        driverStatus = 1;
        return;
    }

    if (!ProviderUtil::isValidJsonResponse(reply))
    {
        TLOG(LL_ERR, "libInitHbaLib returns NULL response or has error");
        driverStatus = 1;
        return;
    }

    int result = -1;

    if (reply.isObject() && reply.isMember("result") && reply["result"].isInt())
        result = reply["result"].asInt();

    if (result != 0)
    {
        TLOG(LL_ERR, "libInitHbaLib is failed - %d ", result);
        driverStatus = 1;
        return;
    }

    unsigned int count = _guarded("libGetNumOfAdapters",
        [] { return libGetNumOfAdapters(); }, 0u);
    TLOG(LL_DBG, "Adapter Count = %d\n", (int)count);

    driverStatus = count != 0 ? 0 : 1;
}

ProviderInit::~ProviderInit()
{
    TLOG(LL_DBG, "Inside ProviderInit Destructor.");

    _guarded("libFreeHbaLib", [] { return libFreeHbaLib(); }, -1);
}

int ProviderInit::getDriverStatus()
{
    return driverStatus;
}

ProviderInit gProviderInit;

} // namespace OLMA
