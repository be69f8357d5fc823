#ifndef _VSPR_ProviderDiscoveryMethods_h
#define _VSPR_ProviderDiscoveryMethods_h

// The console's methods: discovery, configuration, diagnostics and
// statistics. Handlers don't catch what the library throws and don't look
// at its replies, except where a method walks several elements; the engine
// makes the reply of both.

#include <json/json.h>

#include "Array.h"
#include "String.h"

namespace OLMA
{

class JsonRpcManager;
struct MethodRow;

class ProviderDiscoveryMethods
{
public:
    // Registers the whole catalogue with the engine.
    static void registerMethods(JsonRpcManager& manager);

    // A method of the common form, as its catalogue row says.
    static void serve(const MethodRow& row, const Json::Value& params, Json::Value& result);

    // The methods that do more than one call of the common form.
    static void getHbaByWwn(const Json::Value& params, Json::Value& result);
    static void getPortByWwn(const Json::Value& params, Json::Value& result);
    static void getAllHbasByHost(const Json::Value& params, Json::Value& result);
    static void getAllPortsByHba(const Json::Value& params, Json::Value& result);
    static void getRequestID(const Json::Value& params, Json::Value& result);
    static void resetStatisticsForPorts(const Json::Value& params, Json::Value& result);
    static void setAlias(const Json::Value& params, Json::Value& result);
    static void setAliases(const Json::Value& params, Json::Value& result);
    static void setAdvancedIoProfile(const Json::Value& params, Json::Value& result);
    static void setLunMaskDataForPort(const Json::Value& params, Json::Value& result);
    static void doEchoTest(const Json::Value& params, Json::Value& result);
    static void doFCPingTest(const Json::Value& params, Json::Value& result);
    static void doFCTraceRoute(const Json::Value& params, Json::Value& result);

    // On a host under an ESX hypervisor: elements 1 and 2 of the
    // OtherIdentifyingInfo of its VMWARE_ESXComputerSystem in "vmware/esxv2";
    // empty elsewhere. No method calls it.
    static Array<String> getOtherIdentifyingInfo();
};

} // namespace OLMA

#endif // _VSPR_ProviderDiscoveryMethods_h
