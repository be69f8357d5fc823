// Contract between the provider module and the adapter library libdtruj.so:
// the types of the exported entries and the exception the library throws.
// Both sides compile this header, so keep it free of anything but JsonCpp
// and the standard library.
#ifndef DTRUJ_DTRUJ_H
#define DTRUJ_DTRUJ_H

#include <string>
#include <json/json.h>

// The exception classes cross the boundary between two shared objects: their
// type_info must be visible (not hidden by -fvisibility=hidden) so that a
// catch in the module matches a throw in the library.
#define DTRUJ_EXPORT __attribute__((visibility("default")))

namespace OLMA {

// The library's own exception: an error code and a message. A plain class on
// purpose; callers catch it before std::exception.
class DTRUJ_EXPORT HbaAgentError {
public:
    HbaAgentError(int code_, const std::string& message_) : code(code_), message(message_) {}
    int getCode() const { return code; }
    const std::string& getMessage() const { return message; }

    int code;
    std::string message;
};

class DTRUJ_EXPORT ErrorParamMismatch : public HbaAgentError {
public:
    ErrorParamMismatch() : HbaAgentError(51, "Mismatch in number of parameters.") {}
    ErrorParamMismatch(int c, const std::string& m) : HbaAgentError(c, m) {}
};

class DTRUJ_EXPORT ErrorBadJsonArray : public HbaAgentError {
public:
    ErrorBadJsonArray() : HbaAgentError(54, "Not a JSON array format.") {}
    ErrorBadJsonArray(int c, const std::string& m) : HbaAgentError(c, m) {}
};

class DTRUJ_EXPORT ErrorBadJsonObject : public HbaAgentError {
public:
    ErrorBadJsonObject() : HbaAgentError(55, "Not a JSON Object format.") {}
    ErrorBadJsonObject(int c, const std::string& m) : HbaAgentError(c, m) {}
};

// Callbacks the library calls: an event as a JSON text, and a log line as
// (level, source file, line, text).
typedef void (*EventProcessCB)(const char* eventJson);
typedef void (*LogMsgCB)(int level, const char* file, int line, const char* text);

// The six signature classes of the exported entries.
typedef Json::Value (*JsonReqFP)(const Json::Value& request);
typedef int (*voidRetIntFP)();
typedef unsigned int (*voidRetUIntFP)();
typedef const char* (*voidRetStrFP)();
typedef void (*evtProcessCBRetVoidFP)(EventProcessCB cb);
typedef void (*log4cxxMsgRetVoidFP)(LogMsgCB cb);

} // namespace OLMA

// All 117 exported entries in binding order, as X(name, class) where class is
// one of JSON, INT, UINT, TEXT, EVTCB, LOGCB.
#define DTRUJ_ENTRIES(X) \
    X(getHost, JSON) X(getHbaByWwn, JSON) X(getHbaByMac, JSON) X(getServerTime, JSON) \
    X(setAdapterState, JSON) X(getOpticsSFP, JSON) X(getDiagnosticsResults, JSON) \
    X(getRequestID, INT) X(getOpticsPOM, JSON) X(getPortByWwn, JSON) X(getFcByFcWwn, JSON) \
    X(getBootOverSanByPort, JSON) X(getAdvPortDataByPort, JSON) \
    X(getDynamicIOCEthernetStatistics, JSON) X(setPortByWwn, JSON) \
    X(setPortAuthentication, JSON) X(getPortAuthentication, JSON) X(getAllVPorts, JSON) \
    X(getLldp, JSON) X(getCee, JSON) X(getPortStatistics, JSON) \
    X(getAllLunsByRemotePort, JSON) X(getVPort, JSON) X(getDynamicRPortStatistics, JSON) \
    X(getDynamicVPortStatistics, JSON) X(getDynamicLogicalPortStatistics, JSON) \
    X(getDynamicPortAuthStatistics, JSON) X(getDynamicTrunkingStatistics, JSON) \
    X(getDynamicvHBAStatistics, JSON) X(getDynamicvNICStatistics, JSON) \
    X(getDynamicvNICStatisticsForGraph, JSON) X(getDynamicLldpStatistics, JSON) \
    X(getDynamicAdvancedIoDataAtPPort, JSON) X(getDynamicAdvancedIoDataAtLPort, JSON) \
    X(getDynamicAdvancedIoDataAtRPort, JSON) X(getDynamicAdvancedIoDataAtLun, JSON) \
    X(getDriverUpdateStatus, JSON) X(getAllEthPortByEthMac, JSON) X(getFcoeByPort, JSON) \
    X(getEthPortByEthMac, JSON) X(getAllRemotePorts, JSON) X(getCompleteRemotePort, JSON) \
    X(getDynamicPortStatistics, JSON) X(getDynamicQosStatistics, JSON) \
    X(getDynamicFcoeStatistics, JSON) X(getDynamicFcpimModStatistics, JSON) \
    X(getDynamicEthernetPortStatistics, JSON) X(getDynamicFcpimIopStatistics, JSON) \
    X(getDynamicFcpimStatistics, JSON) X(getDynamicFabricStatistics, JSON) \
    X(getDynamicIocStatistics, JSON) X(getAdvAdapterData, JSON) X(getAdapterPciFnData, JSON) \
    X(getDynamicFirmwareStatistics, JSON) X(getLunMaskData, JSON) X(setLunMaskData, JSON) \
    X(setFcByFcWwn, JSON) X(setFcoeByPort, JSON) X(setAdapterAlias, JSON) \
    X(setPortAlias, JSON) X(setFcTrunkingState, JSON) X(createVport, JSON) \
    X(deleteVport, JSON) X(setEthPort, JSON) X(clearLogsForPort, JSON) \
    X(setAdapterMode, JSON) X(getDPortTestResult, JSON) X(setDport, JSON) \
    X(createvNIC, JSON) X(deletevNICs, JSON) X(modifyvNIC, JSON) X(setAdvIoProfile, JSON) \
    X(clearAdvIoProfile, JSON) X(getAdvIoProfile, JSON) X(resetDataForAdvIoProf, JSON) \
    X(resetPortAuthentication, JSON) X(resetStatisticsForPortAuth, JSON) \
    X(resetStatisticsForPort, JSON) X(resetStatisticsForLPort, JSON) \
    X(resetStatisticsForFcpim, JSON) X(resetStatisticsForRPort, JSON) \
    X(resetStatisticsForVPort, JSON) X(resetStatisticsForIoc, JSON) \
    X(resetTrunkingStatistics, JSON) X(resetFirmwareStatistics, JSON) \
    X(resetStatisticsForQos, JSON) X(resetStatisticsForFabric, JSON) \
    X(resetLldpStatistics, JSON) X(resetIOCEthernetStatistics, JSON) \
    X(resetEthernetPortStatistics, JSON) X(resetvNICStatistics, JSON) \
    X(resetvHBAStatistics, JSON) X(resetFcoeStatistics, JSON) \
    X(resetStatisticsForFcpimMod, JSON) X(startTests, JSON) X(cancelTests, JSON) \
    X(postDiagnostics, JSON) X(registerEventProcessingCb, EVTCB) \
    X(registerLogMsgCb, LOGCB) X(register_for_events, JSON) \
    X(unregister_for_events, JSON) X(get_agt_version, TEXT) X(getGlobalInfo, JSON) \
    X(init_hba_lib, JSON) X(free_hba_lib, INT) X(getNumberOfAdapters, UINT) \
    X(getAllAdaptersIndexString, JSON) X(getEthPhyPortIndicesByAdapter, JSON) \
    X(getFcPhyPortIndicesByAdapter, JSON) X(diagEthLoopbackTest, JSON) \
    X(diagLoopbackTest, JSON) X(diagMemoryTest, JSON) X(diagPCILoopbackTest, JSON) \
    X(getFlashInfo, JSON) X(adapterUpdateFlash, JSON) X(getAdapterIdByPort, JSON) \
    X(getAdapterId, JSON)

#endif
