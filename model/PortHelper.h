#ifndef _VSPR_PortHelper_h
#define _VSPR_PortHelper_h

#include <json/json.h>

#include "config.h"
#include "Array.h"
#include "Instance.h"
#include "String.h"
#include "ProviderTypes.h"

namespace OLMA
{

class TargetHelper;

// A look-up by keys: the model that holds the keys of the one instance a
// walk looks for, and the key that tells which port's part it can be
// (DeviceID, Name or InstanceID). Given one, a walk asks the library only
// for what can hold that instance and stops at the first instance whose
// keys match, in the order the enumeration would meet it; so the answer is
// the one the enumeration would give, found without building the others.
struct _keyLookup
{
    const Instance* model;
    // Null when the model is of a class whose key can't be read here: the
    // walk then narrows nothing and only key_eq decides.
    const char* key;

    // The key of model for the class id; false if the model leaves it null,
    // so that no instance of the class can match.
    static bool of(classId_t id, const Instance* model, _keyLookup& lookup);

    // Whether the key is exactly text, or begins with the parts joined by
    // "_" and a further "_" (what lies behind a port or a remote port).
    bool is(const char* text) const;
    bool isBehind(const char* portWwn, const char* remoteWwn = 0) const;
    // Whether the key ends with "_" and the text.
    bool endsWith(const char* text) const;

    // Keeps the first of result[from...] whose keys match, destroys the
    // rest; true if one matched.
    bool keepMatch(Array<Instance*>& result, size_t from) const;
};

// One physical FC port as read from getPortByWwn. Addresses are in plain
// form. Zeroed for each port and handed by value to the builders, so a
// builder can never see a half-filled text of another port.
struct _hbaPortInfo
{
    char portWwn[24];
    char nodeWwn[24];
    char symbolicName[1028];
    int state;
    char hostName[256];
    uint16 portType;
    uint64 maxFrameSize;
    uint64 speed;       // bit/s; 0 when the port reports no speed
    uint64 maxSpeed;    // bit/s
    uint16 portNumber;  // place in the adapter's port list, from 0

    // The remote port of a target endpoint (plain form). The endpoint's name
    // is longer than portWwn can hold, so the builder composes it from both.
    char rPortWwn[24];
};

// Counters of getDynamicPortStatistics for one port. FC ports and FCoE ports
// report different ids, hence two groups.
struct prov_pport_stats_s
{
    // FC port
    uint64 txFrames;
    uint64 txWords;
    uint64 rxFrames;
    uint64 rxWords;
    uint64 lipCount;
    uint64 nosCount;
    uint64 crcErrors;
    uint64 errorFrames;
    uint64 dumpedFrames;
    uint64 linkFailures;
    uint64 lossOfSync;
    uint64 lossOfSignal;
    uint64 primitiveSeqErrors;
    uint64 invalidTxWords;

    // FCoE port
    uint64 fcoeError1;
    uint64 fcoeCrcErrors;
    uint64 fcoeDumpedFrames;
    uint64 fcoeError2;
    uint64 fcoeError3;
    uint64 fcoeError4;

    // FCoE traffic comes by unicast, multicast and broadcast.
    uint64 fcoeTxUcastFrames;
    uint64 fcoeTxMcastFrames;
    uint64 fcoeTxBcastFrames;
    uint64 fcoeTxUcastBytes;
    uint64 fcoeTxMcastBytes;
    uint64 fcoeTxBcastBytes;
    uint64 fcoeRxUcastFrames;
    uint64 fcoeRxMcastFrames;
    uint64 fcoeRxBcastFrames;
    uint64 fcoeRxUcastBytes;
    uint64 fcoeRxMcastBytes;
    uint64 fcoeRxBcastBytes;
};

// Builds the instances of the physical FC ports: VESPERA_FCPort,
// VESPERA_SCSIProtocolEndpoint, VESPERA_FCPortStatistics,
// VESPERA_LogicalPortGroup and VESPERA_AlarmDevice, and walks the ports on
// behalf of TargetHelper for the storage extents, tape drives and logical
// disks behind them. It also switches a port's beacon.
//
// A VESPERA_LogicalPortGroup stands for a node: one instance per node WWN,
// in the order the walk first meets it, whichever ports and adapters share it.
//
// Arrays hold new instances that the caller owns. A port or adapter that
// can't be read is left out after an ERR line; nothing here throws.
class PortHelper
{
public:

    PortHelper();

    static PortHelper* getPortHelperObject();

    // All adapters, in the library's order.
    Array<Instance*> getInstancesByClass(classId_t id);

    // The adapter at place adapterId (from 1) of "indexStrings" of adapters,
    // a reply of getAllAdaptersIndexString.
    Array<Instance*> getInstancesByAdapterId(int adapterId, classId_t id,
        Json::Value adapters);

    // The adapter named by address (colon or plain form). Serves 3, 4, 5, 9,
    // 16, 30 and 36.
    Array<Instance*> getInstancesByAdapterAddress(String address, classId_t id);

    Array<Instance*> getFCPortInstancesByAdapter(String address);

    // The one instance of class 3, 4, 5, 9, 16, 36 or 38 whose keys model
    // holds, as the enumeration of the class would give it; null if it
    // would give none. The caller owns the instance.
    Instance* getInstanceByKeys(classId_t id, const Instance* model);

    // getPortByWwn of a port (WWN, or a 12-digit MAC); 0 or -1.
    int getPortDetails(String index, Json::Value& reply);

    // True only if the port reports itself disabled; a port that can't be
    // read counts as enabled.
    bool isPortDisabled(String index);

    // The number of FC ports of an adapter, whose list stays in reply; -1
    // if it can't be had.
    int getNumberOfPorts(String index, Json::Value& reply);

    // getOpticsSFP of a port; 0 or -1.
    int getOpticsInfo(String index, Json::Value& reply);

    // Switches the beacon of the port whose DeviceID is deviceId: on for
    // state 3, off for any other. Returns 1 when switched, 2 for a
    // mezzanine card (no beacon), 3 when it already was so, 0 on failure.
    int setAlarmState(String deviceId, int state);

    Instance* getFCPortInstance(_hbaPortInfo port);
    // The group of the port's node.
    Instance* getLogicalPortGroupInstance(_hbaPortInfo port);
    Instance* getFCPortStatisticsInstance(_hbaPortInfo port,
        prov_pport_stats_s stats, bool isFCoE);
    Instance* getSCSIProtocolEndpointInstance(_hbaPortInfo port, bool isInitiator);
    Instance* getAlarmDeviceInstance(_hbaPortInfo port, bool beaconOn);

    // CIM EnabledState of a port state ("portStatusValue" and the like).
    static uint16 getEnabledState(int state);

    static PortHelper* helperObj;

private:

    PortHelper(const PortHelper&);
    PortHelper& operator=(const PortHelper&);

    // Reads the members of a getPortByWwn reply into a zeroed record. The
    // reply is untrusted: missing or mistyped members leave their fields
    // zero, and over-long texts are cut to their field.
    static void fillPortInfo(const Json::Value& reply, const String& index,
        uint16 portNumber, _hbaPortInfo& port);

    // Reads a getDynamicPortStatistics reply into a zeroed record.
    static void fillPortStatistics(const Json::Value& reply, bool isFCoE,
        prov_pport_stats_s& stats);

    // A lookup makes the walk stop once result holds the instance.
    bool _walkAdapter(const String& index, classId_t id, bool byAddress,
        Array<Instance*>& result, const _keyLookup* lookup = 0);
    void _buildForPort(const String& portIndex, const Json::Value& reply,
        const _hbaPortInfo& port, classId_t id, Array<Instance*>& result,
        const _keyLookup* lookup);
    void _addTargetEndpoints(const _hbaPortInfo& port, Array<Instance*>& result,
        const _keyLookup* lookup);
    void _addStatistics(const String& portIndex, const Json::Value& reply,
        const _hbaPortInfo& port, Array<Instance*>& result);

    TargetHelper* _targetHelper;
};

extern PortHelper gPortHelperObj;

} // namespace OLMA

#endif
