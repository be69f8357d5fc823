#include "PortHelper.h"

#include <stdlib.h>
#include <string.h>

#include <exception>

#include "CIMProviderTruj.h"
#include "ProviderUtil.h"
#include "Strings.h"
#include "TargetHelper.h"
#include "log.h"

#include "VESPERA_AlarmDevice.h"
#include "VESPERA_FCPort.h"
#include "VESPERA_FCPortStatistics.h"
#include "VESPERA_LogicalDisk.h"
#include "VESPERA_LogicalPortGroup.h"
#include "VESPERA_PhysicalConnector.h"
#include "VESPERA_SCSIProtocolEndpoint.h"
#include "VESPERA_StorageExtent.h"
#include "VESPERA_TapeDrive.h"

namespace OLMA
{

PortHelper gPortHelperObj;
PortHelper* PortHelper::helperObj = 0;

PortHelper::PortHelper() : _targetHelper(TargetHelper::getTargetHelperObject())
{
}

PortHelper* PortHelper::getPortHelperObject()
{
    if (!helperObj)
        helperObj = &gPortHelperObj;

    return helperObj;
}

//------------------------------------------------------------------------------
// Reading untrusted replies
//------------------------------------------------------------------------------

namespace
{

// A link that reports no speed says 99999 Gbit/s.
const sint64 NO_SPEED = 99999;
const uint64 GIGA = 1000000000ULL;

const Json::Value& member(const Json::Value& object, const char* name)
{
    static const Json::Value none;
    return object.isObject() ? object[name] : none;
}

// The text of a member, or null if it is missing or not a text.
const char* textOf(const Json::Value& object, const char* name)
{
    const Json::Value& v = member(object, name);
    return v.isString() ? v.asCString() : 0;
}

bool boolOf(const Json::Value& object, const char* name, bool& out)
{
    const Json::Value& v = member(object, name);

    if (!v.isBool())
        return false;

    out = v.asBool();
    return true;
}

// Gbit/s in bit/s, if a member holds a count of Gbit/s that bit/s can hold.
bool gigabitsToBits(const Json::Value& v, uint64& bits)
{
    if (!v.isInt64())
        return false;

    sint64 gbps = v.asInt64();

    if (gbps < 0 || (uint64)gbps > UINT64_MAX / GIGA)
        return false;

    bits = (uint64)gbps * GIGA;
    return true;
}

// The current speed: a link without one says 99999, which reads as 0.
bool operatingSpeed(const Json::Value& v, uint64& bits)
{
    if (v.isInt64() && v.asInt64() == NO_SPEED)
    {
        bits = 0;
        return true;
    }

    return gigabitsToBits(v, bits);
}

// The first supported speed is the port's maximum, taken as it stands: 99999
// means "no value" only for a link's current speed.
bool maximumSpeed(const Json::Value& speeds, uint64& bits)
{
    return speeds.isArray() && speeds.size() > 0 && gigabitsToBits(speeds[0u], bits);
}

// Copies a text into a record field, cut to fit; the cut is logged since it
// can make two keys equal.
void copyField(char* field, size_t size, const char* text, const char* what)
{
    if (!text)
        return;

    if (strlcpy(field, text, size) >= size)
        TLOG(LL_WARN, "%s is longer than %u characters and is cut: %s", what,
            (unsigned)(size - 1), field);
}

void copyPlainAddress(char* field, size_t size, const char* text, const char* what)
{
    if (text)
        copyField(field, size,
            ProviderUtil::eraseColonsFromIndex(String(text)).c_str(), what);
}

enum Call_Style
{
    // "<entry> got ...": the port walk.
    CALL_WALK,
    // "<index> - <entry> got ...": look-ups of one element.
    CALL_INDEXED
};

// One call of a library entry. The library may throw anything, and nothing
// may reach the CIM server's thread. name is the entry as the log names it.
bool callLib(const char* name, JsonReqFP fp, const Json::Value& request,
    Json::Value& reply, Call_Style style = CALL_WALK, const char* index = "")
{
    try
    {
        reply = fp(request);
        return true;
    }
    catch (const HbaAgentError& e)
    {
        if (style == CALL_WALK)
            TLOG(LL_ERR, "%s got User exception %d: %s", name, e.getCode(),
                e.getMessage().c_str());
        else
            TLOG(LL_ERR, "%s - %s got User exception %d: %s", index, name,
                e.getCode(), e.getMessage().c_str());
    }
    catch (const std::exception& e)
    {
        if (style == CALL_WALK)
            TLOG(LL_ERR, "%s got std exception: %s", name, e.what());
        else
            TLOG(LL_ERR, "%s - %s got std exception: %s", index, name, e.what());
    }
    catch (...)
    {
        if (style == CALL_WALK)
            TLOG(LL_ERR, "%s got default exception", name);
        else
            TLOG(LL_ERR, "%s - %s got default exception", index, name);
    }

    reply = Json::Value();
    return false;
}

bool isGood(const Json::Value& reply)
{
    return ProviderUtil::isValidJsonResponse(reply);
}

String colonForm(const char* plain)
{
    return ProviderUtil::getIndexInColonFormat(String(plain));
}

String className(classId_t id)
{
    return ProviderUtil::getProviderUtil()->getClassName(id);
}

Array<uint16> oneElement(uint16 x)
{
    Array<uint16> a;
    a.append(x);
    return a;
}

// The classes that the port walk builds; a walk by address leaves out the
// logical disks.
bool walkServes(classId_t id, bool byAddress)
{
    switch (id)
    {
        case ID_VESPERA_FCPort:
        case ID_VESPERA_SCSIProtocolEndpoint:
        case ID_VESPERA_FCPortStatistics:
        case ID_VESPERA_StorageExtent:
        case ID_VESPERA_TapeDrive:
        case ID_VESPERA_LogicalPortGroup:
        case ID_VESPERA_AlarmDevice:
            return true;
        case ID_VESPERA_LogicalDisk:
            return !byAddress;
        default:
            return false;
    }
}

// The classes of what lies behind a port's remote ports.
bool walksTargets(classId_t id)
{
    return id == ID_VESPERA_StorageExtent || id == ID_VESPERA_TapeDrive ||
        id == ID_VESPERA_LogicalDisk;
}

// The group of a node, if the walk built it already. Nodes are one whatever
// the case their ports spell the WWN in.
bool hasGroup(const Array<Instance*>& built, const char* nodeWwn)
{
    for (size_t i = 0; i < built.size(); i++)
    {
        const VESPERA_LogicalPortGroup* g =
            checked_cast<VESPERA_LogicalPortGroup>(static_cast<const Instance*>(built[i]));

        if (g && !g->InstanceID.null && g->InstanceID.value.equali(nodeWwn))
            return true;
    }

    return false;
}

struct Stat_Id
{
    int id;
    uint64 prov_pport_stats_s::*counter;
};

const Stat_Id fcStatIds[] =
{
    { 1402, &prov_pport_stats_s::txFrames },
    { 1403, &prov_pport_stats_s::txWords },
    { 1409, &prov_pport_stats_s::rxFrames },
    { 1410, &prov_pport_stats_s::rxWords },
    { 1411, &prov_pport_stats_s::lipCount },
    { 1412, &prov_pport_stats_s::nosCount },
    { 1416, &prov_pport_stats_s::crcErrors },
    { 1421, &prov_pport_stats_s::errorFrames },
    { 1422, &prov_pport_stats_s::dumpedFrames },
    { 1423, &prov_pport_stats_s::linkFailures },
    { 1424, &prov_pport_stats_s::lossOfSync },
    { 1425, &prov_pport_stats_s::lossOfSignal },
    { 1426, &prov_pport_stats_s::primitiveSeqErrors },
    { 1428, &prov_pport_stats_s::invalidTxWords },
    { 0, 0 }
};

const Stat_Id fcoeStatIds[] =
{
    { 1603, &prov_pport_stats_s::fcoeTxUcastFrames },
    { 1604, &prov_pport_stats_s::fcoeTxMcastFrames },
    { 1605, &prov_pport_stats_s::fcoeTxBcastFrames },
    { 1606, &prov_pport_stats_s::fcoeTxUcastBytes },
    { 1607, &prov_pport_stats_s::fcoeTxMcastBytes },
    { 1608, &prov_pport_stats_s::fcoeTxBcastBytes },
    { 1609, &prov_pport_stats_s::fcoeRxUcastFrames },
    { 1610, &prov_pport_stats_s::fcoeRxMcastFrames },
    { 1611, &prov_pport_stats_s::fcoeRxBcastFrames },
    { 1612, &prov_pport_stats_s::fcoeRxUcastBytes },
    { 1613, &prov_pport_stats_s::fcoeRxMcastBytes },
    { 1614, &prov_pport_stats_s::fcoeRxBcastBytes },
    { 1615, &prov_pport_stats_s::fcoeError1 },
    { 1616, &prov_pport_stats_s::fcoeCrcErrors },
    { 1624, &prov_pport_stats_s::fcoeDumpedFrames },
    { 1625, &prov_pport_stats_s::fcoeError2 },
    { 1626, &prov_pport_stats_s::fcoeCrcErrors },
    { 1627, &prov_pport_stats_s::fcoeError3 },
    { 1628, &prov_pport_stats_s::fcoeError4 },
    { 0, 0 }
};

} // namespace

//------------------------------------------------------------------------------
// Look-ups by keys
//------------------------------------------------------------------------------

namespace
{

template<class C>
const Property<String>* keyOf(const Instance* model, Property<String> C::*key)
{
    const C* typed = checked_cast<C>(model);
    return typed ? &(typed->*key) : 0;
}

} // namespace

bool _keyLookup::of(classId_t id, const Instance* model, _keyLookup& lookup)
{
    lookup.model = model;
    lookup.key = 0;

    if (!model)
        return false;

    const Property<String>* key = 0;

    switch (id)
    {
        case ID_VESPERA_FCPort:
            key = keyOf(model, &VESPERA_FCPort::DeviceID);
            break;
        case ID_VESPERA_AlarmDevice:
            key = keyOf(model, &VESPERA_AlarmDevice::DeviceID);
            break;
        case ID_VESPERA_FCPortStatistics:
            key = keyOf(model, &VESPERA_FCPortStatistics::InstanceID);
            break;
        case ID_VESPERA_SCSIProtocolEndpoint:
            key = keyOf(model, &VESPERA_SCSIProtocolEndpoint::Name);
            break;
        case ID_VESPERA_StorageExtent:
            key = keyOf(model, &VESPERA_StorageExtent::DeviceID);
            break;
        case ID_VESPERA_TapeDrive:
            key = keyOf(model, &VESPERA_TapeDrive::DeviceID);
            break;
        case ID_VESPERA_LogicalDisk:
            key = keyOf(model, &VESPERA_LogicalDisk::DeviceID);
            break;
        case ID_VESPERA_PhysicalConnector:
            key = keyOf(model, &VESPERA_PhysicalConnector::Tag);
            break;
        default:
            break;
    }

    if (!key)
        return true;

    // Every instance has its keys set: a null one matches none.
    if (key->null)
        return false;

    lookup.key = key->value.c_str();
    return true;
}

bool _keyLookup::is(const char* text) const
{
    return !key || strcmp(key, text) == 0;
}

bool _keyLookup::isBehind(const char* portWwn, const char* remoteWwn) const
{
    if (!key)
        return true;

    size_t n = strlen(portWwn);

    if (strncmp(key, portWwn, n) != 0 || key[n] != '_')
        return false;

    if (!remoteWwn)
        return true;

    const char* rest = key + n + 1;
    size_t m = strlen(remoteWwn);
    return strncmp(rest, remoteWwn, m) == 0 && rest[m] == '_';
}

bool _keyLookup::endsWith(const char* text) const
{
    if (!key)
        return true;

    size_t n = strlen(key);
    size_t m = strlen(text);
    return n > m && key[n - m - 1] == '_' && strcmp(key + n - m, text) == 0;
}

bool _keyLookup::keepMatch(Array<Instance*>& result, size_t from) const
{
    Instance* match = 0;

    for (size_t i = from; i < result.size(); i++)
    {
        if (!match && result[i] && key_eq(model, result[i]))
            match = result[i];
        else if (result[i])
            destroy(result[i]);
    }

    result.remove(from, result.size() - from);

    if (match)
        result.append(match);

    return match != 0;
}

//------------------------------------------------------------------------------
// Records
//------------------------------------------------------------------------------

void PortHelper::fillPortInfo(const Json::Value& reply, const String& index,
    uint16 portNumber, _hbaPortInfo& port)
{
    const char* wwn = textOf(reply, "wwn");

    // The index string that the port was asked by is its WWN, so a reply
    // that doesn't repeat it still names the port.
    if (!wwn || !*wwn)
    {
        TLOG(LL_WARN, "Port reply for %s has no wwn", index.c_str());
        wwn = index.c_str();
    }

    copyPlainAddress(port.portWwn, sizeof(port.portWwn), wwn, "wwn");

    // A member that is missing, or of another type, leaves its field at the
    // record's zero, as the builders expect.
    const char* node = textOf(reply, "nodeWwn");

    if (node)
        copyPlainAddress(port.nodeWwn, sizeof(port.nodeWwn), node, "nodeWwn");

    const char* symbolicName = textOf(reply, "PortSymbolicName");

    if (symbolicName)
        copyField(port.symbolicName, sizeof(port.symbolicName), symbolicName,
            "PortSymbolicName");

    const Json::Value& state = member(reply, "portStatusValue");

    if (state.isInt())
        port.state = state.asInt();

    const Json::Value& type = member(reply, "portTypeMOFValue");

    if (type.isUInt() && type.asUInt() <= 0xFFFF)
        port.portType = (uint16)type.asUInt();

    const Json::Value& frame = member(reply, "maxFrameSize");

    if (frame.isUInt64())
        port.maxFrameSize = frame.asUInt64();

    operatingSpeed(member(reply, "operatingSpeed"), port.speed);
    maximumSpeed(member(reply, "supportedPortSpeeds"), port.maxSpeed);

    port.portNumber = portNumber;
}

void PortHelper::fillPortStatistics(const Json::Value& reply, bool isFCoE,
    prov_pport_stats_s& stats)
{
    if (!reply.isArray())
        return;

    const Stat_Id* table = isFCoE ? fcoeStatIds : fcStatIds;

    for (Json::ArrayIndex i = 0; i < reply.size(); i++)
    {
        const Json::Value& id = member(reply[i], "id");
        const char* value = textOf(reply[i], "value");

        if (!id.isInt() || !value)
            continue;

        for (const Stat_Id* s = table; s->id; s++)
        {
            if (s->id != id.asInt())
                continue;

            // A counter never runs backwards; a negative text is garbage.
            long long n = strtoll(value, 0, 10);
            stats.*(s->counter) = n > 0 ? (uint64)n : 0;
            break;
        }
    }
}

uint16 PortHelper::getEnabledState(int state)
{
    switch (state)
    {
        case 8:
            return 9;
        case 9:
            return 4;
        case 10:
            return 3;
        case 11:
            return 2;
        case 13:
            return 6;
        default:
            return 1;
    }
}

//------------------------------------------------------------------------------
// The walk
//------------------------------------------------------------------------------

Array<Instance*> PortHelper::getInstancesByClass(classId_t id)
{
    HostInfoScope hostInfo;
    Array<Instance*> result;

    if (!walkServes(id, false))
    {
        TLOG(LL_INFO, "Unhandled class support");
        return result;
    }

    Json::Value adapters;
    bool called = callLib("libGetAllAdaptersIndexString", libGetAllAdaptersIndexString,
        Json::Value(), adapters);

    if (!called || !isGood(adapters) || !member(adapters, "indexStrings").isArray())
    {
        TLOG(LL_ERR, "libGetAllAdaptersIndexString returns NULL.");
        return result;
    }

    int count = (int)adapters["indexStrings"].size();

    if (count == 0)
    {
        TLOG(LL_WARN, "No adapters in the system. ");
        return result;
    }

    for (int adapterId = 1; adapterId <= count; adapterId++)
    {
        Array<Instance*> more = getInstancesByAdapterId(adapterId, id, adapters);

        if (id != ID_VESPERA_LogicalPortGroup)
        {
            result.append(more);
            continue;
        }

        // A node whose ports lie on several adapters stays one group.
        for (size_t i = 0; i < more.size(); i++)
        {
            const VESPERA_LogicalPortGroup* g =
                checked_cast<VESPERA_LogicalPortGroup>(static_cast<const Instance*>(more[i]));

            if (g && hasGroup(result, g->InstanceID.value.c_str()))
                destroyer(more[i]);
            else
                result.append(more[i]);
        }
    }

    return result;
}

Array<Instance*> PortHelper::getInstancesByAdapterId(int adapterId, classId_t id,
    Json::Value adapters)
{
    HostInfoScope hostInfo;
    Array<Instance*> result;

    if (!walkServes(id, false))
    {
        TLOG(LL_INFO, "Unhandled class support");
        return result;
    }

    const Json::Value& list = member(adapters, "indexStrings");

    if (!list.isArray() || adapterId < 1 || (Json::ArrayIndex)adapterId > list.size() ||
        !list[adapterId - 1].isString())
    {
        TLOG(LL_ERR, "No adapter index string at place %d", adapterId);
        return result;
    }

    _walkAdapter(String(list[adapterId - 1].asCString()), id, false, result);
    return result;
}

Array<Instance*> PortHelper::getInstancesByAdapterAddress(String address, classId_t id)
{
    HostInfoScope hostInfo;
    Array<Instance*> result;

    if (!walkServes(id, true))
    {
        TLOG(LL_INFO, "Unhandled class support");
        return result;
    }

    if (address.size() < 2)
    {
        TLOG(LL_ERR, "The address passed is not MAC or WWN");
        return result;
    }

    _walkAdapter(ProviderUtil::getIndexInColonFormat(address), id, true, result);
    return result;
}

Array<Instance*> PortHelper::getFCPortInstancesByAdapter(String address)
{
    return getInstancesByAdapterAddress(address, ID_VESPERA_FCPort);
}

Instance* PortHelper::getInstanceByKeys(classId_t id, const Instance* model)
{
    if (!walkServes(id, false) || id == ID_VESPERA_LogicalPortGroup)
    {
        TLOG(LL_INFO, "Unhandled class support");
        return 0;
    }

    _keyLookup lookup;

    if (!_keyLookup::of(id, model, lookup))
        return 0;

    HostInfoScope hostInfo;

    Json::Value adapters;
    bool called = callLib("libGetAllAdaptersIndexString", libGetAllAdaptersIndexString,
        Json::Value(), adapters);

    if (!called || !isGood(adapters) || !member(adapters, "indexStrings").isArray())
    {
        TLOG(LL_ERR, "libGetAllAdaptersIndexString returns NULL.");
        return 0;
    }

    const Json::Value& list = adapters["indexStrings"];

    if (list.size() == 0)
    {
        TLOG(LL_WARN, "No adapters in the system. ");
        return 0;
    }

    for (Json::ArrayIndex i = 0; i < list.size(); i++)
    {
        if (!list[i].isString())
        {
            TLOG(LL_ERR, "No adapter index string at place %d", (int)i + 1);
            continue;
        }

        Array<Instance*> found;
        _walkAdapter(String(list[i].asCString()), id, false, found, &lookup);

        if (found.size() > 0)
            return found[0];
    }

    return 0;
}

bool PortHelper::_walkAdapter(const String& index, classId_t id, bool byAddress,
    Array<Instance*>& result, const _keyLookup* lookup)
{
    Json::Value request(Json::objectValue);
    request["indexStr"] = index.c_str();

    Json::Value ports;

    if (!callLib("libGetFcPhyPortIndicesByAdapter", libGetFcPhyPortIndicesByAdapter,
        request, ports))
        return false;

    if (byAddress)
    {
        // A client that names an adapter is told which part of the answer
        // was wrong.
        if (!isGood(ports))
        {
            TLOG(LL_ERR, "libGetFcPhyPortIndicesByAdapter returns NULL");
            return false;
        }

        if (!ports.isObject() || !ports.isMember("indexStrings"))
        {
            TLOG(LL_ERR, "indexStrings is not member");
            return false;
        }

        if (!ports["indexStrings"].isArray())
        {
            TLOG(LL_ERR, "indexString not Array");
            return false;
        }
    }
    else if (!isGood(ports) || !member(ports, "indexStrings").isArray())
    {
        TLOG(LL_ERR, "libGetFcPhyPortIndicesByAdapter returns NULL.");
        return false;
    }

    const Json::Value& list = ports["indexStrings"];
    TLOG(LL_DBG, "numOfPorts = %u", (unsigned)list.size());

    for (Json::ArrayIndex place = 0; place < list.size(); place++)
    {
        if (!list[place].isString())
        {
            TLOG(LL_ERR, "Port %u of adapter %s has no index string", (unsigned)place,
                index.c_str());
            continue;
        }

        String portIndex(list[place].asCString());

        Json::Value portRequest(Json::objectValue);
        portRequest["wwn"] = portIndex.c_str();

        Json::Value reply;

        if (!callLib("libGetPortByWwn", libGetPortByWwn, portRequest, reply))
            continue;

        if (!isGood(reply) || !reply.isObject())
        {
            TLOG(LL_ERR, "libGetPortByWwn response is null or has error");
            continue;
        }

        _hbaPortInfo port;
        memset(&port, 0, sizeof(port));
        fillPortInfo(reply, portIndex, (uint16)place, port);
        ProviderUtil::getProviderUtil()->getHostInfo(port.hostName,
            (int)sizeof(port.hostName) - 1);

        if (!lookup)
        {
            _buildForPort(portIndex, reply, port, id, result, 0);
            continue;
        }

        // What a port holds is named by its WWN: the port itself, or what
        // lies behind it.
        bool mayHold = id == ID_VESPERA_SCSIProtocolEndpoint ?
            lookup->is(port.portWwn) || lookup->isBehind(port.portWwn) :
            walksTargets(id) ? lookup->isBehind(port.portWwn) : lookup->is(port.portWwn);

        if (!mayHold)
            continue;

        size_t from = result.size();
        _buildForPort(portIndex, reply, port, id, result, lookup);

        if (lookup->keepMatch(result, from))
            break;
    }

    return true;
}

void PortHelper::_buildForPort(const String& portIndex, const Json::Value& reply,
    const _hbaPortInfo& port, classId_t id, Array<Instance*>& result,
    const _keyLookup* lookup)
{
    switch (id)
    {
        case ID_VESPERA_FCPort:
            result.append(getFCPortInstance(port));
            break;

        case ID_VESPERA_LogicalPortGroup:
            // A port that names no node belongs to no group: an empty key
            // would stand for no node at all.
            if (port.nodeWwn[0] == '\0')
                TLOG(LL_WARN, "No logical port group for %s: its node WWN is unknown",
                    port.portWwn);
            else if (!hasGroup(result, port.nodeWwn))
                result.append(getLogicalPortGroupInstance(port));
            break;

        case ID_VESPERA_AlarmDevice:
        {
            bool isMezz = false;
            bool beaconOn = false;

            if (!boolOf(reply, "isMezz", isMezz) || !boolOf(reply, "beaconState", beaconOn))
                TLOG(LL_INFO, "beaconState is NOT available failed for %s.", port.portWwn);
            else if (!isMezz)
                result.append(getAlarmDeviceInstance(port, beaconOn));
            break;
        }

        case ID_VESPERA_SCSIProtocolEndpoint:
            if (!lookup || lookup->is(port.portWwn))
                result.append(getSCSIProtocolEndpointInstance(port, true));
            if (!lookup || lookup->isBehind(port.portWwn))
                _addTargetEndpoints(port, result, lookup);
            break;

        case ID_VESPERA_FCPortStatistics:
            _addStatistics(portIndex, reply, port, result);
            break;

        case ID_VESPERA_StorageExtent:
        case ID_VESPERA_TapeDrive:
        case ID_VESPERA_LogicalDisk:
            result.append(_targetHelper->getTargetInstances(port, id, lookup));
            break;

        default:
            TLOG(LL_INFO, "Unhandled class support");
            break;
    }
}

void PortHelper::_addTargetEndpoints(const _hbaPortInfo& port, Array<Instance*>& result,
    const _keyLookup* lookup)
{
    Json::Value request(Json::objectValue);
    String wwn = colonForm(port.portWwn);
    request["pPortWwn"] = wwn.c_str();
    request["lPortWwn"] = wwn.c_str();

    Json::Value remotePorts;

    if (!callLib("libGetAllRemotePorts", libGetAllRemotePorts, request, remotePorts))
        return;

    if (!isGood(remotePorts) || !remotePorts.isArray())
    {
        TLOG(LL_ERR, "libGetAllRemotePorts returns NULL.");
        return;
    }

    TLOG(LL_DBG, "Number of Rports = %u", (unsigned)remotePorts.size());

    for (Json::ArrayIndex i = 0; i < remotePorts.size(); i++)
    {
        const char* remoteWwn = textOf(remotePorts[i], "remotePortWwn");

        if (!remoteWwn)
        {
            TLOG(LL_ERR, "Remote port %u of %s has no remotePortWwn", (unsigned)i,
                port.portWwn);
            continue;
        }

        _hbaPortInfo target = port;
        copyPlainAddress(target.rPortWwn, sizeof(target.rPortWwn), remoteWwn,
            "remotePortWwn");

        if (lookup)
        {
            String name(port.portWwn, "_", target.rPortWwn);

            if (!lookup->is(name.c_str()))
                continue;
        }

        // The list tells what the endpoint needs where it carries the
        // remote port's device data; only a list without it makes the walk
        // ask for the whole remote port, with all its logical units.
        const Json::Value* device = TargetHelper::listedDeviceData(remotePorts[i]);
        Json::Value reply;

        if (!device)
        {
            request["rPortWwn"] = remoteWwn;

            if (!callLib("libGetCompleteRemotePort", libGetCompleteRemotePort, request,
                reply))
                continue;

            device = isGood(reply) ? &member(reply, "deviceData") : 0;
        }

        bool isTarget = false;

        if (!device || !boolOf(*device, "isTarget", isTarget))
        {
            TLOG(LL_ERR, "libGetCompleteRemotePort returned NULL for %s", remoteWwn);
            continue;
        }

        if (!isTarget)
            continue;

        const Json::Value& state = member(*device, "stateMofValue");
        target.state = state.isInt() ? state.asInt() : 0;

        result.append(getSCSIProtocolEndpointInstance(target, false));
    }
}

void PortHelper::_addStatistics(const String& portIndex, const Json::Value& reply,
    const _hbaPortInfo& port, Array<Instance*>& result)
{
    Json::Value request(Json::objectValue);
    request["indexStr"] = portIndex.c_str();

    Json::Value stats;

    // The log has long named this entry so; scripts that watch it match it.
    if (!callLib("libGetDynamicPortStatisticsat", libGetDynamicPortStatistics, request,
        stats))
        return;

    if (!isGood(stats) || !stats.isArray() || stats.size() == 0)
    {
        TLOG(LL_WARN, "libGetDynamicPortStatistics failed for port WWN= %s", port.portWwn);
        return;
    }

    bool isFCoE = false;
    boolOf(reply, "isFCoE", isFCoE);

    prov_pport_stats_s counters;
    memset(&counters, 0, sizeof(counters));
    fillPortStatistics(stats, isFCoE, counters);

    result.append(getFCPortStatisticsInstance(port, counters, isFCoE));
}

//------------------------------------------------------------------------------
// Single ports
//------------------------------------------------------------------------------

int PortHelper::getPortDetails(String index, Json::Value& reply)
{
    Json::Value request(Json::objectValue);
    String colon = ProviderUtil::getIndexInColonFormat(index);
    request[index.size() == 12 ? "mac" : "wwn"] = colon.c_str();

    try
    {
        reply = libGetPortByWwn(request);
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "%s - libGetPortByWwn got User exception %d: %s", index.c_str(),
            e.getCode(), e.getMessage().c_str());
        reply = Json::Value();
        return -1;
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "%s - libGetPortByWwn got std exception: %s", index.c_str(),
            e.what());
        reply = Json::Value();
        return -1;
    }
    catch (...)
    {
        TLOG(LL_ERR, "libGetPortByWwn got default exception for %s", index.c_str());
        reply = Json::Value();
        return -1;
    }

    if (!isGood(reply))
    {
        TLOG(LL_ERR, "Port Info is NOT available");
        return -1;
    }

    TLOG(LL_INFO, "getPortDetails success - %s", index.c_str());
    return 0;
}

bool PortHelper::isPortDisabled(String index)
{
    Json::Value reply;

    if (getPortDetails(index, reply) != 0)
        return false;

    bool enabled = true;

    if (!boolOf(reply, "portStatus", enabled))
    {
        TLOG(LL_ERR, "Unable to get port status");
        return false;
    }

    return !enabled;
}

int PortHelper::getNumberOfPorts(String index, Json::Value& reply)
{
    Json::Value request(Json::objectValue);
    request["indexStr"] = ProviderUtil::getIndexInColonFormat(index).c_str();

    bool called = callLib("libGetFcPhyPortIndicesByAdapter", libGetFcPhyPortIndicesByAdapter,
        request, reply);

    if (!called || !isGood(reply) || !member(reply, "indexStrings").isArray())
    {
        TLOG(LL_ERR, "libGetFcPhyPortIndicesByAdapter returns NULL for %s", index.c_str());
        return -1;
    }

    return (int)reply["indexStrings"].size();
}

int PortHelper::getOpticsInfo(String index, Json::Value& reply)
{
    Json::Value request(Json::objectValue);
    request["indexStr"] = ProviderUtil::getIndexInColonFormat(index).c_str();

    bool called = callLib("libGetOpticsSFP", libGetOpticsSFP, request, reply,
        CALL_INDEXED, index.c_str());

    if (!called || !isGood(reply))
    {
        TLOG(LL_ERR, "Unable to get SFP info for %s", index.c_str());
        return -1;
    }

    return 0;
}

int PortHelper::setAlarmState(String deviceId, int state)
{
    bool wanted = state == 3;
    String wwn = ProviderUtil::getIndexInColonFormat(deviceId);

    Json::Value request(Json::objectValue);
    request["wwn"] = wwn.c_str();

    Json::Value port;

    if (!callLib("libGetPortByWwn", libGetPortByWwn, request, port))
        return 0;

    bool isMezz = false;
    bool beaconOn = false;

    if (!isGood(port) || !boolOf(port, "isMezz", isMezz) ||
        !boolOf(port, "beaconState", beaconOn))
    {
        TLOG(LL_ERR, "Current ALARM STATE is not available");
        return 0;
    }

    if (isMezz)
    {
        TLOG(LL_WARN, "setAlarmState: Operation not supported on Mezz cards");
        return 2;
    }

    if (beaconOn == wanted)
    {
        TLOG(LL_WARN, "setAlarmState : State already set");
        return 3;
    }

    port["beaconState"] = wanted;

    Json::Value change(Json::objectValue);
    change["indexStr"] = wwn.c_str();
    change["port"] = port;
    change["propArray"] = Json::Value(Json::arrayValue);
    change["propArray"].append("beaconState");

    Json::Value reply;

    if (!callLib("libSetPortByWwn", libSetPortByWwn, change, reply))
        return 0;

    if (!isGood(reply))
    {
        TLOG(LL_ERR, "libSetPortByWwn response is null or has error");
        return 0;
    }

    TLOG(LL_INFO, "setAlarmState success");
    return 1;
}

//------------------------------------------------------------------------------
// Builders
//------------------------------------------------------------------------------

Instance* PortHelper::getFCPortInstance(_hbaPortInfo port)
{
    VESPERA_FCPort* p = create<VESPERA_FCPort>(true);

    p->CreationClassName.set(className(ID_VESPERA_FCPort));
    p->SystemCreationClassName.set(className(ID_VESPERA_ComputerSystem));
    p->SystemName.set(port.hostName);
    p->DeviceID.set(port.portWwn);
    p->PermanentAddress.set(port.portWwn);

    String name(port.nodeWwn, ":", port.portWwn);
    p->ElementName.set(name);
    p->Name.set(name);

    p->Caption.set(port.symbolicName);
    p->OperationalStatus.set(oneElement((uint16)port.state));
    p->UsageRestriction.set(3);
    p->PortType.set(port.portType);
    p->Speed.set(port.speed);
    p->MaxSpeed.set(port.maxSpeed);
    p->LinkTechnology.set(4);
    p->SupportedMaximumTransmissionUnit.set(port.maxFrameSize);
    p->PortNumber.set(port.portNumber);
    p->EnabledState.set(getEnabledState(port.state));
    p->EnabledDefault.set(2);

    return p;
}

Instance* PortHelper::getLogicalPortGroupInstance(_hbaPortInfo port)
{
    VESPERA_LogicalPortGroup* p = create<VESPERA_LogicalPortGroup>(true);

    // The group is the node: its ports are its members, not its name.
    p->InstanceID.set(port.nodeWwn);
    p->Name.set(port.nodeWwn);
    p->NameFormat.set("WWN");
    p->ElementName.set(port.nodeWwn);
    p->Caption.set(port.hostName);
    p->Description.set(port.hostName);

    return p;
}

Instance* PortHelper::getFCPortStatisticsInstance(_hbaPortInfo port,
    prov_pport_stats_s s, bool isFCoE)
{
    VESPERA_FCPortStatistics* p = create<VESPERA_FCPortStatistics>(true);

    p->InstanceID.set(port.portWwn);
    p->ElementName.set("FC Port Statistics");

    if (isFCoE)
    {
        p->PacketsTransmitted.set(
            s.fcoeTxUcastFrames + s.fcoeTxMcastFrames + s.fcoeTxBcastFrames);
        p->BytesTransmitted.set(
            s.fcoeTxUcastBytes + s.fcoeTxMcastBytes + s.fcoeTxBcastBytes);
        p->PacketsReceived.set(
            s.fcoeRxUcastFrames + s.fcoeRxMcastFrames + s.fcoeRxBcastFrames);
        p->BytesReceived.set(
            s.fcoeRxUcastBytes + s.fcoeRxMcastBytes + s.fcoeRxBcastBytes);
        p->LIPCount.set(0);
        p->NOSCount.set(0);
        p->ErrorFrames.set(s.fcoeError1 + s.fcoeError2 + s.fcoeError3 + s.fcoeError4 +
            s.fcoeCrcErrors);
        p->DumpedFrames.set(s.fcoeDumpedFrames);
        p->LinkFailures.set(0);
        p->LossOfSignalCounter.set(0);
        p->LossOfSyncCounter.set(0);
        p->PrimitiveSeqProtocolErrCount.set(0);
        p->CRCErrors.set(s.fcoeCrcErrors);
        p->InvalidTransmissionWords.set(0);
    }
    else
    {
        // An FC word is four bytes.
        p->PacketsTransmitted.set(s.txFrames);
        p->BytesTransmitted.set(s.txWords * 4);
        p->PacketsReceived.set(s.rxFrames);
        p->BytesReceived.set(s.rxWords * 4);
        p->LIPCount.set(s.lipCount);
        p->NOSCount.set(s.nosCount);
        p->ErrorFrames.set(s.errorFrames);
        p->DumpedFrames.set(s.dumpedFrames);
        p->LinkFailures.set(s.linkFailures);
        p->LossOfSignalCounter.set(s.lossOfSignal);
        p->LossOfSyncCounter.set(s.lossOfSync);
        p->PrimitiveSeqProtocolErrCount.set(s.primitiveSeqErrors);
        p->CRCErrors.set(s.crcErrors);
        p->InvalidTransmissionWords.set(s.invalidTxWords);
    }

    return p;
}

Instance* PortHelper::getSCSIProtocolEndpointInstance(_hbaPortInfo port, bool isInitiator)
{
    VESPERA_SCSIProtocolEndpoint* p = create<VESPERA_SCSIProtocolEndpoint>(true);

    String name(port.portWwn);

    if (!isInitiator)
    {
        name.append('_');
        name.append(port.rPortWwn);
    }

    p->CreationClassName.set(className(ID_VESPERA_SCSIProtocolEndpoint));
    p->SystemCreationClassName.set(className(ID_VESPERA_ComputerSystem));
    p->SystemName.set(port.hostName);
    p->Name.set(name);
    p->ElementName.set(name);
    p->OperationalStatus.set(oneElement((uint16)port.state));
    p->ProtocolIFType.set(1);
    p->OtherTypeDescription.set("SCSI");
    p->ConnectionType.set(2);
    p->Role.set(isInitiator ? 2 : 3);
    p->EnabledState.set(getEnabledState(port.state));

    return p;
}

Instance* PortHelper::getAlarmDeviceInstance(_hbaPortInfo port, bool beaconOn)
{
    VESPERA_AlarmDevice* p = create<VESPERA_AlarmDevice>(true);

    p->CreationClassName.set(className(ID_VESPERA_AlarmDevice));
    p->SystemCreationClassName.set(className(ID_VESPERA_ComputerSystem));
    p->SystemName.set(port.hostName);
    p->Description.set(port.hostName);
    p->DeviceID.set(port.portWwn);
    p->ElementName.set(port.portWwn);
    p->Caption.set(port.symbolicName);
    p->VisibleAlarm.set(true);
    p->Urgency.set(3);
    p->AlarmState.set(beaconOn ? 3 : 1);

    return p;
}

} // namespace OLMA
