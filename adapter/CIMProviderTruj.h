#ifndef _VSPR_CIMProviderTruj_h
#define _VSPR_CIMProviderTruj_h

// One global function pointer per entry of the adapter library libdtruj.so.
// Every caller in the module goes through these pointers, never through
// dlsym, so that a missing library or a missing entry leaves a stub that can
// always be called.

#include <json/json.h>

#include "dtruj.h"

namespace OLMA
{

// The pointer types of the six signature classes come with the contract
// header dtruj.h, which the library compiles too.

// What an entry answers when it isn't bound.
Json::Value default_JsonReqFP(const Json::Value&);   // null value
int default_voidRetIntFP();                          // -1
unsigned int default_voidRetUIntFP();                // 65535
const char* default_voidRetStrFP();                  // null
void default_evtProcessCBRetVoidFP(EventProcessCB);  // nothing
void default_log4cxxMsgRetVoidFP(LogMsgCB);          // nothing

// The entries in binding order: X(pointer type, exported name, global).
// The stub of an entry is default_<pointer type>.
#define VSPR_TRUJ_ENTRIES(X) \
    X(JsonReqFP, getHost, libGetHost) \
    X(JsonReqFP, getHbaByWwn, libGetHbaByWwn) \
    X(JsonReqFP, getHbaByMac, libGetHbaByMac) \
    X(JsonReqFP, getServerTime, libGetServerTime) \
    X(JsonReqFP, setAdapterState, libSetAdapterState) \
    X(JsonReqFP, getOpticsSFP, libGetOpticsSFP) \
    X(JsonReqFP, getDiagnosticsResults, libGetDiagnosticsResults) \
    X(voidRetIntFP, getRequestID, libGetRequestID) \
    X(JsonReqFP, getOpticsPOM, libGetOpticsPOM) \
    X(JsonReqFP, getPortByWwn, libGetPortByWwn) \
    X(JsonReqFP, getFcByFcWwn, libGetFcByFcWwn) \
    X(JsonReqFP, getBootOverSanByPort, libGetBootOverSanByPort) \
    X(JsonReqFP, getAdvPortDataByPort, libGetAdvPortDataByPort) \
    X(JsonReqFP, getDynamicIOCEthernetStatistics, libGetDynamicIOCEthernetStatistics) \
    X(JsonReqFP, setPortByWwn, libSetPortByWwn) \
    X(JsonReqFP, setPortAuthentication, libSetPortAuthentication) \
    X(JsonReqFP, getPortAuthentication, libGetPortAuthentication) \
    X(JsonReqFP, getAllVPorts, libGetAllVPorts) \
    X(JsonReqFP, getLldp, libGetLldp) \
    X(JsonReqFP, getCee, libGetCee) \
    X(JsonReqFP, getPortStatistics, libGetPortStatistics) \
    X(JsonReqFP, getAllLunsByRemotePort, libGetAllLunsByRemotePort) \
    X(JsonReqFP, getVPort, libGetVPort) \
    X(JsonReqFP, getDynamicRPortStatistics, libGetDynamicRPortStatistics) \
    X(JsonReqFP, getDynamicVPortStatistics, libGetDynamicVPortStatistics) \
    X(JsonReqFP, getDynamicLogicalPortStatistics, libGetDynamicLogicalPortStatistics) \
    X(JsonReqFP, getDynamicPortAuthStatistics, libGetDynamicPortAuthStatistics) \
    X(JsonReqFP, getDynamicTrunkingStatistics, libGetDynamicTrunkingStatistics) \
    X(JsonReqFP, getDynamicvHBAStatistics, libGetDynamicvHBAStatistics) \
    X(JsonReqFP, getDynamicvNICStatistics, libGetDynamicvNICStatistics) \
    X(JsonReqFP, getDynamicvNICStatisticsForGraph, libGetDynamicvNICStatisticsForGraph) \
    X(JsonReqFP, getDynamicLldpStatistics, libGetDynamicLldpStatistics) \
    X(JsonReqFP, getDynamicAdvancedIoDataAtPPort, libGetDynamicAdvancedIoDataAtPPort) \
    X(JsonReqFP, getDynamicAdvancedIoDataAtLPort, libGetDynamicAdvancedIoDataAtLPort) \
    X(JsonReqFP, getDynamicAdvancedIoDataAtRPort, libGetDynamicAdvancedIoDataAtRPort) \
    X(JsonReqFP, getDynamicAdvancedIoDataAtLun, libGetDynamicAdvancedIoDataAtLun) \
    X(JsonReqFP, getDriverUpdateStatus, libGetDriverUpdateStatus) \
    X(JsonReqFP, getAllEthPortByEthMac, libGetAllEthPortByEthMac) \
    X(JsonReqFP, getFcoeByPort, libGetFcoeByPort) \
    X(JsonReqFP, getEthPortByEthMac, libGetEthPortByEthMac) \
    X(JsonReqFP, getAllRemotePorts, libGetAllRemotePorts) \
    X(JsonReqFP, getCompleteRemotePort, libGetCompleteRemotePort) \
    X(JsonReqFP, getDynamicPortStatistics, libGetDynamicPortStatistics) \
    X(JsonReqFP, getDynamicQosStatistics, libGetDynamicQosStatistics) \
    X(JsonReqFP, getDynamicFcoeStatistics, libGetDynamicFcoeStatistics) \
    X(JsonReqFP, getDynamicFcpimModStatistics, libGetDynamicFcpimModStatistics) \
    X(JsonReqFP, getDynamicEthernetPortStatistics, libGetDynamicEthernetPortStatistics) \
    X(JsonReqFP, getDynamicFcpimIopStatistics, libGetDynamicFcpimIopStatistics) \
    X(JsonReqFP, getDynamicFcpimStatistics, libGetDynamicFcpimStatistics) \
    X(JsonReqFP, getDynamicFabricStatistics, libGetDynamicFabricStatistics) \
    X(JsonReqFP, getDynamicIocStatistics, libGetDynamicIocStatistics) \
    X(JsonReqFP, getAdvAdapterData, libGetAdvAdapterData) \
    X(JsonReqFP, getAdapterPciFnData, libGetAdapterPciFnData) \
    X(JsonReqFP, getDynamicFirmwareStatistics, libGetDynamicFirmwareStatistics) \
    X(JsonReqFP, getLunMaskData, libGetLunMaskData) \
    X(JsonReqFP, setLunMaskData, libSetLunMaskData) \
    X(JsonReqFP, setFcByFcWwn, libSetFcByFcWwn) \
    X(JsonReqFP, setFcoeByPort, libSetFcoeByPort) \
    X(JsonReqFP, setAdapterAlias, libSetAdapterAlias) \
    X(JsonReqFP, setPortAlias, libSetPortAlias) \
    X(JsonReqFP, setFcTrunkingState, libSetFcTrunkingState) \
    X(JsonReqFP, createVport, libCreateVport) \
    X(JsonReqFP, deleteVport, libDeleteVport) \
    X(JsonReqFP, setEthPort, libSetEthPort) \
    X(JsonReqFP, clearLogsForPort, libClearLogsForPort) \
    X(JsonReqFP, setAdapterMode, libSetAdapterMode) \
    X(JsonReqFP, getDPortTestResult, libGetDPortTestResult) \
    X(JsonReqFP, setDport, libSetDport) \
    X(JsonReqFP, createvNIC, libCreatevNIC) \
    X(JsonReqFP, deletevNICs, libDeletevNICs) \
    X(JsonReqFP, modifyvNIC, libModifyvNIC) \
    X(JsonReqFP, setAdvIoProfile, libSetAdvIoProfile) \
    X(JsonReqFP, clearAdvIoProfile, libClearAdvIoProfile) \
    X(JsonReqFP, getAdvIoProfile, libGetAdvIoProfile) \
    X(JsonReqFP, resetDataForAdvIoProf, libResetDataForAdvIoProf) \
    X(JsonReqFP, resetPortAuthentication, libResetPortAuthentication) \
    X(JsonReqFP, resetStatisticsForPortAuth, libResetStatisticsForPortAuth) \
    X(JsonReqFP, resetStatisticsForPort, libResetStatisticsForPort) \
    X(JsonReqFP, resetStatisticsForLPort, libResetStatisticsForLPort) \
    X(JsonReqFP, resetStatisticsForFcpim, libResetStatisticsForFcpim) \
    X(JsonReqFP, resetStatisticsForRPort, libResetStatisticsForRPort) \
    X(JsonReqFP, resetStatisticsForVPort, libResetStatisticsForVPort) \
    X(JsonReqFP, resetStatisticsForIoc, libResetStatisticsForIoc) \
    X(JsonReqFP, resetTrunkingStatistics, libResetTrunkingStatistics) \
    X(JsonReqFP, resetFirmwareStatistics, libResetFirmwareStatistics) \
    X(JsonReqFP, resetStatisticsForQos, libResetStatisticsForQos) \
    X(JsonReqFP, resetStatisticsForFabric, libResetStatisticsForFabric) \
    X(JsonReqFP, resetLldpStatistics, libResetLldpStatistics) \
    X(JsonReqFP, resetIOCEthernetStatistics, libResetIOCEthernetStatistics) \
    X(JsonReqFP, resetEthernetPortStatistics, libResetEthernetPortStatistics) \
    X(JsonReqFP, resetvNICStatistics, libResetvNICStatistics) \
    X(JsonReqFP, resetvHBAStatistics, libResetvHBAStatistics) \
    X(JsonReqFP, resetFcoeStatistics, libResetFcoeStatistics) \
    X(JsonReqFP, resetStatisticsForFcpimMod, libResetStatisticsForFcpimMod) \
    X(JsonReqFP, startTests, libStartTests) \
    X(JsonReqFP, cancelTests, libCancelTests) \
    X(JsonReqFP, postDiagnostics, libPostDiagnostics) \
    X(evtProcessCBRetVoidFP, registerEventProcessingCb, libRegisterEventProcessingCb) \
    X(log4cxxMsgRetVoidFP, registerLogMsgCb, libRegisterLogMsgCb) \
    X(JsonReqFP, register_for_events, libRegisterForEvents) \
    X(JsonReqFP, unregister_for_events, libUnRegisterForEvents) \
    X(voidRetStrFP, get_agt_version, libGetAgtVersion) \
    X(JsonReqFP, getGlobalInfo, libGetGlobalInfo) \
    X(JsonReqFP, init_hba_lib, libInitHbaLib) \
    X(voidRetIntFP, free_hba_lib, libFreeHbaLib) \
    X(voidRetUIntFP, getNumberOfAdapters, libGetNumOfAdapters) \
    X(JsonReqFP, getAllAdaptersIndexString, libGetAllAdaptersIndexString) \
    X(JsonReqFP, getEthPhyPortIndicesByAdapter, libGetEthPhyPortIndicesByAdapter) \
    X(JsonReqFP, getFcPhyPortIndicesByAdapter, libGetFcPhyPortIndicesByAdapter) \
    X(JsonReqFP, diagEthLoopbackTest, libDiagEthLoopbackTest) \
    X(JsonReqFP, diagLoopbackTest, libDiagLoopbackTest) \
    X(JsonReqFP, diagMemoryTest, libDiagMemoryTest) \
    X(JsonReqFP, diagPCILoopbackTest, libDiagPCILoopbackTest) \
    X(JsonReqFP, getFlashInfo, libGetFlashInfo) \
    X(JsonReqFP, adapterUpdateFlash, libAdapterUpdateFlash) \
    X(JsonReqFP, getAdapterIdByPort, libGetAdapterIdByPort) \
    X(JsonReqFP, getAdapterId, libGetAdapterId)

enum { TRUJ_ENTRY_COUNT = 117 };

#define VSPR_TRUJ_DECLARE(type, name, global) extern type global;
VSPR_TRUJ_ENTRIES(VSPR_TRUJ_DECLARE)
#undef VSPR_TRUJ_DECLARE

// What dlopen returned for the library; null if it couldn't be loaded.
extern void* libHandle;

// True once dlopen succeeded.
extern bool gTrujLibLoaded;

// Loads the library and binds every entry, or its stub. Called once, from
// the start-up of the module (ProviderInit).
void setupDLLEntryPoints();

} // namespace OLMA

#endif
