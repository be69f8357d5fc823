#include "MethodCatalogue.h"

#include <utility>

#include "ProviderDiscoveryMethods.h"

namespace OLMA
{

namespace
{

#define STR(m) {P_STRING, m}
#define INT(m) {P_INT, m}
#define BOOL(m) {P_BOOL, m}
#define ARR(m) {P_ARRAY, m}
#define OBJ(m) {P_OBJECT, m}
#define UNREAD {P_UNREAD, 0}

// A row: method, handler, entry, and the parameters in position order.
#define CALL(method, handler, entry, ...) \
    {method, handler, FORM_COMMON, &entry, VF_NONE, 0, 0, {__VA_ARGS__}, 0}
// ... with "vfId" 0 or "vfID" 0.
#define CALL_VF(method, handler, entry, ...) \
    {method, handler, FORM_COMMON, &entry, VF_ID, 0, 0, {__VA_ARGS__}, 0}
#define CALL_VF_UPPER(method, handler, entry, ...) \
    {method, handler, FORM_COMMON, &entry, VF_ID_UPPER, 0, 0, {__VA_ARGS__}, 0}
// ... whose trace lines name another function.
#define CALL_TRACE(method, handler, trace, entry, ...) \
    {method, handler, FORM_COMMON, &entry, VF_NONE, 0, trace, {__VA_ARGS__}, 0}
// The result is an array holding the one reply.
#define WRAP(method, handler, entry, ...) \
    {method, handler, FORM_WRAP, &entry, VF_NONE, 0, 0, {__VA_ARGS__}, 0}
// The params, whatever they are, are the request.
#define PASS(method, handler, entry) \
    {method, handler, FORM_PASS, &entry, VF_NONE, 0, 0, {}, 0}
// A test posted to the library under its "function".
#define POST(method, handler, function, ...) \
    {method, handler, FORM_COMMON, &libPostDiagnostics, VF_NONE, function, 0, {__VA_ARGS__}, 0}
// A method with a function of its own.
#define OWN(method, handler) \
    {method, #handler, FORM_OWN, 0, VF_NONE, 0, 0, {}, &ProviderDiscoveryMethods::handler}

const MethodRow catalogue[] = {
    // Discovery.
    PASS("discovery.getHost", "getHost", libGetHost),
    PASS("discovery.getGlobalInfo", "getGlobalInfo", libGetGlobalInfo),
    OWN("discovery.getHbaByWwn", getHbaByWwn),
    OWN("discovery.getAllHbasByHost", getAllHbasByHost),
    OWN("discovery.getAllPortsByHba", getAllPortsByHba),
    OWN("discovery.getPortByWwn", getPortByWwn),
    CALL("discovery.getFcByFcWwn", "getFcByFcWwn", libGetFcByFcWwn, STR("wwn")),
    WRAP("discovery.getAllFcByPort", "getAllFcByPort", libGetFcByFcWwn, STR("wwn")),
    CALL("discovery.getPortAuthentication", "getPortAuthentication", libGetPortAuthentication,
        STR("wwn")),
    CALL("discovery.getAllRemotePorts", "getAllRemotePorts", libGetAllRemotePorts,
        STR("pPortWwn"), STR("lPortWwn")),
    CALL("discovery.getCompleteRemotePort", "getCompleteRemotePort", libGetCompleteRemotePort,
        STR("pPortWwn"), STR("lPortWwn"), STR("rPortWwn")),
    CALL("discovery.getAllLunsByRemotePort", "getAllLunsByRemotePort", libGetAllLunsByRemotePort,
        STR("pPortWwn"), STR("lPortWwn"), STR("rPortWwn")),
    CALL("discovery.getAllVPorts", "getAllVPorts", libGetAllVPorts, STR("wwn")),
    CALL("discovery.getVPort", "getVPort", libGetVPort, STR("pPortWwn"), STR("lPortWwn")),
    PASS("discovery.getServerTime", "getServerTime", libGetServerTime),
    CALL("discovery.getBootOverSanByPort", "getBootOverSanByPort", libGetBootOverSanByPort,
        STR("indexStr")),
    CALL("discovery.getAdvPortDataByPort", "getAdvPortDataByPort", libGetAdvPortDataByPort,
        STR("indexStr")),
    CALL("discovery.getFcoeByPort", "getFcoeByPort", libGetFcoeByPort, STR("indexStr")),
    CALL("discovery.getFcoeByFcoeWwn", "getFcoeByPort", libGetFcoeByPort, STR("indexStr")),
    WRAP("discovery.getAllFcoeByPort", "getAllFcoeByPort", libGetFcoeByPort, STR("indexStr")),
    CALL("discovery.getCompleteEthByPort", "getCompleteEthByPort", libGetEthPortByEthMac,
        STR("mac")),
    CALL("discovery.getCompleteEthByEthMac", "getCompleteEthByEthMac", libGetEthPortByEthMac,
        STR("mac")),
    CALL("discovery.getAllEthByPort", "getAllEthByPort", libGetAllEthPortByEthMac, STR("mac")),
    CALL("discovery.getLldp", "getLldp", libGetLldp, STR("mac")),
    CALL("discovery.getCee", "getCee", libGetCee, STR("mac")),
    PASS("discovery.getDriverUpdateStatusLog", "getDriverUpdateStatusLog",
        libGetDriverUpdateStatus),
    CALL("discovery.getLunMaskDataByPort", "getLunMaskDataByPort", libGetLunMaskData,
        STR("indexStr")),
    CALL("discovery.getAdvAdapterData", "getAdvAdapterData", libGetAdvAdapterData,
        STR("indexStr")),
    CALL("discovery.getAllPCIFunctions", "getAllPCIFunctions", libGetAdapterPciFnData,
        STR("indexStr")),
    CALL("discovery.getAdvancedIoProfile", "getAdvancedIoProfile", libGetAdvIoProfile,
        STR("indexStr")),

    // Statistics, reading.
    CALL("discovery.getPortStatistics", "getPortStatistics", libGetPortStatistics,
        STR("indexStr")),
    CALL("discovery.getDynamicQosStatistics", "getDynamicQosStatistics",
        libGetDynamicQosStatistics, STR("pPortWwn")),
    CALL("discovery.getDynamicPortStatistics", "getDynamicPortStatistics",
        libGetDynamicPortStatistics, STR("indexStr")),
    CALL_VF("discovery.getDynamicRemotePortStatistics", "getDynamicRPortStatistics",
        libGetDynamicRPortStatistics, STR("pPortWwn"), STR("lPortWwn"), STR("rPortWwn")),
    CALL_VF("discovery.getDynamicVportStatistics", "getDynamicVportStatistics",
        libGetDynamicVPortStatistics, STR("pPortWwn"), STR("lPortWwn")),
    CALL_VF("discovery.getDynamicLogicalPortStatistics", "getDynamicLogicalPortStatistics",
        libGetDynamicLogicalPortStatistics, STR("pPortWwn"), STR("lPortWwn")),
    CALL_VF("discovery.getDynamicFcpimIOPStatistics", "getDynamicFcpimIOPStatistics",
        libGetDynamicFcpimIopStatistics, STR("pPortWwn"), STR("lPortWwn"), STR("rPortWwn")),
    CALL("discovery.getDynamicFcpimStatistics", "getDynamicFcpimStatistics",
        libGetDynamicFcpimStatistics, STR("pPortWwn"), STR("lPortWwn"), STR("rPortWwn")),
    CALL_VF_UPPER("discovery.getDynamicFabricStatistics", "getDynamicFabricStatistics",
        libGetDynamicFabricStatistics, STR("wwn")),
    CALL("discovery.getDynamicPortAuthenticationStatistics", "getDynamicPortAuthStatistics",
        libGetDynamicPortAuthStatistics, STR("pPortWwn")),
    CALL("discovery.getDynamicIocStatistics", "getDynamicIocStatistics",
        libGetDynamicIocStatistics, STR("pwwn")),
    CALL("discovery.getDynamicFcoeStatistics", "getDynamicFcoeStatistics",
        libGetDynamicFcoeStatistics, STR("indexStr")),
    CALL("discovery.getDynamicFcpimModStatistics", "getDynamicFcpimModStatistics",
        libGetDynamicFcpimModStatistics, STR("indexStr")),
    CALL("discovery.getDynamicFirmwareStatistics", "getDynamicFirmwareStatistics",
        libGetDynamicFirmwareStatistics, STR("indexStr")),
    CALL("discovery.getDynamicTrunkingStatistics", "getDynamicTrunkingStatistics",
        libGetDynamicTrunkingStatistics, STR("indexStr")),
    CALL("discovery.getDynamicEthernetPortStatistics", "getDynamicEthernetPortStatistics",
        libGetDynamicEthernetPortStatistics, STR("mac")),
    CALL("discovery.getDynamicIOCEthernetStatistics", "getDynamicIOCEthernetStatistics",
        libGetDynamicIOCEthernetStatistics, STR("mac")),
    CALL("discovery.getDynamicvHBAStatistics", "getDynamicvHBAStatistics",
        libGetDynamicvHBAStatistics, STR("wwn")),
    CALL("discovery.getDynamicvNICStatistics", "getDynamicvNICStatistics",
        libGetDynamicvNICStatistics, STR("mac")),
    CALL("discovery.getDynamicvNICStatisticsForGraph", "getDynamicvNICStatisticsForGraph",
        libGetDynamicvNICStatisticsForGraph, STR("mac")),
    CALL("discovery.getDynamicLldpStatistics", "getDynamicLldpStatistics",
        libGetDynamicLldpStatistics, STR("mac")),
    CALL_VF("discovery.getDynamicAdvancedIoDataAtPPort", "getDynamicAdvancedIoDataAtPPort",
        libGetDynamicAdvancedIoDataAtPPort, STR("pPortWwn")),
    CALL_VF("discovery.getDynamicAdvancedIoDataAtLPort", "getDynamicAdvancedIoDataAtLPort",
        libGetDynamicAdvancedIoDataAtLPort, STR("pPortWwn"), STR("lPortWwn")),
    CALL_VF("discovery.getDynamicAdvancedIoDataAtRPort", "getDynamicAdvancedIoDataAtRPort",
        libGetDynamicAdvancedIoDataAtRPort, STR("pPortWwn"), STR("lPortWwn"), STR("rPortWwn")),
    CALL_VF("discovery.getDynamicAdvancedIoDataAtLun", "getDynamicAdvancedIoDataAtLun",
        libGetDynamicAdvancedIoDataAtLun, STR("pPortWwn"), STR("lPortWwn"), STR("rPortWwn"),
        STR("lunId")),

    // Configuration.
    CALL_VF("configuration.createVPort", "createVPort", libCreateVport,
        STR("pwwn"), STR("nwwn"), STR("vwwn"), STR("symbolicName")),
    CALL_VF("configuration.deleteVPort", "deleteVPort", libDeleteVport,
        STR("pwwn"), ARR("vportArray")),
    OWN("configuration.setAlias", setAlias),
    OWN("configuration.setAliases", setAliases),
    CALL("configuration.setPortByWwn", "setPortByWwn", libSetPortByWwn,
        STR("indexStr"), OBJ("port"), ARR("propArray")),
    CALL("configuration.setPortAuthentication", "setPortAuthentication",
        libSetPortAuthentication, STR("pPortWwn"), OBJ("portAuth")),
    CALL("configuration.setFcByFcWwn", "setFcByFcWwn", libSetFcByFcWwn,
        STR("portWwn"), OBJ("fcPortData"), ARR("paramsConfigured")),
    CALL("configuration.setHbaStatus", "setHbaStatus", libSetAdapterState,
        STR("indexStr"), BOOL("enableState")),
    CALL("configuration.setFCTrunkingState", "setFCTrunkingState", libSetFcTrunkingState,
        STR("indexStr"), BOOL("enableState")),
    CALL("configuration.setFcoeByFcoeWwn", "setFcByFcWwn", libSetFcByFcWwn,
        STR("portWwn"), OBJ("fcPortData"), ARR("paramsConfigured")),
    CALL("configuration.setFcoePort", "setFcoePort", libSetFcoeByPort,
        STR("indexStr"), OBJ("fcoePort"), ARR("propArray")),
    CALL("configuration.setEthPort", "setEthPort", libSetEthPort,
        STR("mac"), OBJ("ethPort"), ARR("propArray")),
    CALL("configuration.clearLogsForPort", "clearLogsForPort", libClearLogsForPort,
        ARR("propArray")),
    CALL_TRACE("configuration.setAdapterMode", "setAdapterMode", "setHbaMode", libSetAdapterMode,
        STR("indexStr"), STR("adapterMode")),
    OWN("configuration.setLunMaskDataForPort", setLunMaskDataForPort),
    OWN("configuration.setAdvancedIoProfile", setAdvancedIoProfile),
    CALL("configuration.clearAdvancedIoProfilesAtPort", "clearAdvancedIoProfilesAtPort",
        libClearAdvIoProfile, STR("indexStr")),
    CALL("configuration.clearAdvancedIoProfilesAtLogicalPort",
        "clearAdvancedIoProfilesAtLogicalPort", libClearAdvIoProfile,
        STR("indexStr"), STR("lPortWwn")),
    CALL("configuration.clearAdvancedIoProfilesAtRemotePort",
        "clearAdvancedIoProfilesAtRemotePort", libClearAdvIoProfile,
        STR("indexStr"), STR("lPortWwn"), STR("rPortWwn")),
    CALL("configuration.clearAdvancedIoProfileOfLun", "clearAdvancedIoProfileOfLun",
        libClearAdvIoProfile, STR("indexStr"), STR("lPortWwn"), STR("rPortWwn"), STR("lunId")),
    CALL("configuration.resetDataForAdvancedIoAtPPort", "resetDataForAdvancedIoAtPPort",
        libResetDataForAdvIoProf, STR("indexStr")),
    CALL("configuration.resetDataForAdvancedIoAtLPort", "resetDataForAdvancedIoAtLPort",
        libResetDataForAdvIoProf, STR("indexStr"), STR("lPortWwn")),
    CALL("configuration.resetDataForAdvancedIoAtRPort", "resetDataForAdvancedIoAtRPort",
        libResetDataForAdvIoProf, STR("indexStr"), STR("lPortWwn"), STR("rPortWwn")),
    CALL("configuration.resetDataForAdvancedIoAtLun", "resetDataForAdvancedIoAtLun",
        libResetDataForAdvIoProf, STR("indexStr"), STR("lPortWwn"), STR("rPortWwn"),
        STR("lunId")),
    CALL("configuration.resetDataForAdvancedIoForLunRange", "resetDataForAdvancedIoForLunRange",
        libResetDataForAdvIoProf, STR("indexStr"), STR("lPortWwn"), STR("rPortWwn"),
        STR("lunId"), STR("endLunRange")),
    CALL("configuration.createVnic", "createVnic", libCreatevNIC,
        STR("mac"), INT("minBandwidth"), INT("maxBandwidth")),
    CALL("configuration.deleteVnics", "deleteVnics", libDeletevNICs,
        STR("mac"), ARR("pciFunctionIndices")),
    CALL("configuration.modifyVnic", "modifyVnic", libModifyvNIC, STR("mac"), ARR("vNICs")),
    CALL("configuration.resetPortAuthentication", "resetPortAuthentication",
        libResetPortAuthentication, STR("pPortWwn")),

    // Statistics, resetting.
    CALL("configuration.resetStatisticsForPortAuthentication", "resetStatisticsForPortAuth",
        libResetStatisticsForPortAuth, STR("wwn")),
    OWN("configuration.resetStatisticsForPorts", resetStatisticsForPorts),
    CALL("configuration.resetStatisticsForPort", "resetStatisticsForPort",
        libResetStatisticsForPort, STR("indexStr")),
    CALL_VF("configuration.resetStatisticsForLPort", "resetStatisticsForLPort",
        libResetStatisticsForLPort, STR("pwwn"), STR("lwwn")),
    CALL_VF("configuration.resetStatisticsForVPort", "resetStatisticsForVPort",
        libResetStatisticsForVPort, STR("pwwn"), STR("vwwn")),
    CALL_VF("configuration.resetStatisticsForRPort", "resetStatisticsForRPort",
        libResetStatisticsForRPort, STR("pPortWwn"), STR("lPortWwn"), STR("rPortWwn")),
    CALL_VF("configuration.resetStatisticsForFcpim", "resetStatisticsForFcpim",
        libResetStatisticsForFcpim, STR("pPortWwn"), STR("lPortWwn"), STR("rPortWwn")),
    CALL("configuration.resetStatisticsForIoc", "resetStatisticsForIoc",
        libResetStatisticsForIoc, STR("pwwn")),
    CALL_VF("configuration.resetStatisticsForFabric", "resetStatisticsForFabric",
        libResetStatisticsForFabric, STR("pwwn")),
    CALL("configuration.resetStatisticsForQos", "resetStatisticsForQos",
        libResetStatisticsForQos, STR("pPortWwn")),
    CALL("configuration.resetFirmwareStatistics", "resetFirmwareStatistics",
        libResetFirmwareStatistics, STR("indexStr")),
    CALL("configuration.resetTrunkingStatistics", "resetTrunkingStatistics",
        libResetTrunkingStatistics, STR("indexStr")),
    CALL("configuration.resetLldpStatistics", "resetLldpStatistics",
        libResetLldpStatistics, STR("mac")),
    CALL("configuration.resetIOCEthernetStatistics", "resetIOCEthernetStatistics",
        libResetIOCEthernetStatistics, STR("mac")),
    CALL("configuration.resetEthernetPortStatistics", "resetEthernetPortStatistics",
        libResetEthernetPortStatistics, STR("mac")),
    CALL("configuration.resetvNICStatistics", "resetvNICStatistics",
        libResetvNICStatistics, STR("mac")),
    CALL("configuration.resetFcoeStatistics", "resetFcoeStatistics",
        libResetFcoeStatistics, STR("indexStr")),
    CALL("configuration.resetvHBAStatistics", "resetvHBAStatistics",
        libResetvHBAStatistics, STR("wwn")),
    CALL("configuration.resetStatisticsForFcpimMod", "resetStatisticsForFcpimMod",
        libResetStatisticsForFcpimMod, STR("indexStr")),

    // Diagnostics.
    CALL("diagnostics.startTests", "startTests", libStartTests,
        STR("requestID"), BOOL("stopOnError")),
    CALL("diagnostics.cancelTests", "cancelTests", libCancelTests, STR("requestID")),
    POST("diagnostics.doQuickTest", "doQuickTest", "QuickTest",
        STR("requestID"), STR("hbaWwn")),
    // Not a posted test: another name for dPortEnable.
    CALL("diagnostics.doPOSTest", "doPOSTest", libSetDport,
        STR("requestID"), STR("portWwn"), BOOL("state")),
    OWN("diagnostics.doEchoTest", doEchoTest),
    POST("diagnostics.doMemoryTest", "doMemoryTest", "MemoryTest",
        STR("requestID"), STR("hbaWwn")),
    POST("diagnostics.doPCILoopbackTest", "doPCILoopbackTest", "PCILoopbackTest",
        STR("requestID"), STR("hbaWwn"), STR("portWwn"), STR("frameCount"), STR("dataPattern"),
        INT("numCycles")),
    // Position 1 must be there but isn't read.
    POST("diagnostics.doLoopbackTest", "doLoopbackTest", "LoopbackTest",
        STR("requestID"), UNREAD, STR("portWwn"), INT("mode"), INT("speed"), INT("numCycles"),
        STR("frameCount"), STR("dataPattern")),
    POST("diagnostics.doLEDTest", "doLEDTest", "LEDTest",
        STR("requestID"), STR("hbaWwn"), STR("portWwn"), INT("ledBitmap"), INT("command"),
        INT("color"), INT("frequency")),
    OWN("diagnostics.doFCPingTest", doFCPingTest),
    OWN("diagnostics.doFCTraceRoute", doFCTraceRoute),
    POST("diagnostics.doEthLoopbackTest", "doEthLoopbackTest", "EthLoopbackTest",
        STR("requestID"), UNREAD, STR("portWwn"), INT("mode"), INT("speed"), INT("numCycles"),
        STR("frameCount"), STR("dataPattern")),
    POST("diagnostics.doQueueTest", "doQueueTest", "QueueTest",
        STR("requestID"), STR("hbaWwn"), STR("portWwn")),
    CALL("diagnostics.getOpticsPOM", "getOpticsPOM", libGetOpticsPOM, STR("portWwn")),
    CALL("diagnostics.getOpticsSFP", "getOpticsSFP", libGetOpticsSFP, STR("indexStr")),
    OWN("diagnostics.getRequestID", getRequestID),
    CALL("diagnostics.getDiagnosticsResults", "getDiagnosticsResults", libGetDiagnosticsResults,
        STR("requestID")),
    CALL("diagnostics.dPortEnable", "dPortEnable", libSetDport,
        STR("requestID"), STR("portWwn"), BOOL("state")),
    POST("diagnostics.doDportTest", "doDportTest", "DPortTest",
        STR("requestID"), STR("hbaWwn"), STR("portWwn"), STR("frameCount"), STR("dataPattern"),
        INT("numCycles")),
    CALL("diagnostics.getDPortTestResults", "getDPortTestResult", libGetDPortTestResult,
        STR("portWwn")),
};

const size_t ROWS = sizeof(catalogue) / sizeof(catalogue[0]);
static_assert(ROWS == 123, "the console protocol has 123 methods");

// One plain function per row of the common form, as the registry wants.
template<size_t I>
void rowHandler(const Json::Value& params, Json::Value& result)
{
    ProviderDiscoveryMethods::serve(catalogue[I], params, result);
}

template<size_t... I>
const JsonRpcManager::handler* rowHandlers(std::index_sequence<I...>)
{
    static const JsonRpcManager::handler handlers[] = {&rowHandler<I>...};
    return handlers;
}

} // namespace

size_t catalogueSize()
{
    return ROWS;
}

const MethodRow& catalogueRow(size_t i)
{
    return catalogue[i];
}

JsonRpcManager::handler catalogueHandler(size_t i)
{
    if (catalogue[i].form == FORM_OWN)
        return catalogue[i].own;
    return rowHandlers(std::make_index_sequence<ROWS>())[i];
}

} // namespace OLMA
