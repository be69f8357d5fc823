#include "EthernetPortHelper.h"

#include <limits.h>
#include <string.h>

#include <exception>

#include "CIMProviderTruj.h"
#include "ProviderUtil.h"
#include "Strings.h"
#include "log.h"

namespace OLMA
{

EthernetPortHelper gEthernetPortHelperObj;
EthernetPortHelper* EthernetPortHelper::helperObj = 0;

EthernetPortHelper::EthernetPortHelper()
{
}

EthernetPortHelper* EthernetPortHelper::getEthernetPortHelperObject()
{
    if (!helperObj)
        helperObj = &gEthernetPortHelperObj;

    return helperObj;
}

//------------------------------------------------------------------------------
// Library calls
//------------------------------------------------------------------------------

// Nothing the library throws may reach the CIM server's thread. On an
// exception the reply is left null, which every caller treats as a failure.
// defaultFormat takes the subject only; it differs between entries.
static bool _callLib(JsonReqFP fp, const char* entry, const char* subject,
    const char* defaultFormat, const Json::Value& request, Json::Value& reply)
{
    try
    {
        reply = fp(request);
        return true;
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "%s - %s got User exception %d: %s", subject, entry,
            e.getCode(), e.getMessage().c_str());
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "%s - %s got std exception: %s", subject, entry,
            e.what());
    }
    catch (...)
    {
        TLOG(LL_ERR, defaultFormat, subject);
    }

    reply = Json::Value();
    return false;
}

// A good reply that is an object: only then may members be looked up, since
// JsonCpp refuses a member look-up on an array or a scalar.
static bool _goodObject(const Json::Value& reply)
{
    return ProviderUtil::isValidJsonResponse(reply) && reply.isObject();
}

static bool _hasArray(const Json::Value& reply, const char* name)
{
    return _goodObject(reply) && reply.isMember(name) && reply[name].isArray();
}

static const char* _textMember(const Json::Value& object, const char* name)
{
    if (!object.isObject() || !object.isMember(name))
        return 0;

    const Json::Value& member = object[name];
    return member.isString() ? member.asCString() : 0;
}

// An unsigned member that fits in 32 bits, or false.
static bool _uintMember(const Json::Value& object, const char* name,
    unsigned int& out)
{
    if (!object.isObject() || !object.isMember(name))
        return false;

    const Json::Value& member = object[name];

    if (!member.isIntegral() || !member.isUInt())
        return false;

    out = member.asUInt();
    return true;
}

//------------------------------------------------------------------------------
// Mapping rules
//------------------------------------------------------------------------------

static uint16 _enabledState(unsigned int state)
{
    switch (state)
    {
        case 8: return 9;
        case 9: return 4;
        case 10: return 3;
        case 11: return 2;
        case 13: return 6;
        default: return 1;
    }
}

static uint16 _healthState(unsigned int state)
{
    switch (state)
    {
        case 8:
        case 11:
            return 5;
        case 9:
        case 10:
        case 13:
            return 10;
        case 6:
            return 15;
        default:
            return 0;
    }
}

uint16 EthernetPortHelper::getPortType(const char* transceiver)
{
    if (!transceiver)
        return 0;

    if (strcmp(transceiver, "10G_BASE-SR") == 0)
        return 105;

    if (strcmp(transceiver, "10G_BASE-LR") == 0 ||
        strcmp(transceiver, "10G_BASE-LRM") == 0)
        return 108;

    return 0;
}

void EthernetPortHelper::fillFromEthData(const Json::Value& ethData,
    _ethPortInfo* info)
{
    if (!info)
        return;

    // The caller's record need not be terminated.
    int macSize = (int)strnlen(info->macAddress, sizeof(info->macAddress));
    const char* dev = _textMember(ethData, "ethDev");

    if (dev)
        strlcpy(info->deviceName, dev, sizeof(info->deviceName));
    else
        TLOG(LL_WARN, "No Ethernet device name for %.*s", macSize,
            info->macAddress);

    // A state goes out as a uint16 of OperationalStatus.
    if (!_uintMember(ethData, "ethPortStateMOFValue", info->state) ||
        info->state > 0xFFFF)
    {
        // 0 reads as "Unknown" to a client, which is the truth here.
        info->state = 0;
        TLOG(LL_WARN, "No Ethernet port state for %.*s", macSize,
            info->macAddress);
    }

    // MaxDataSize holds the MTU in bits; an MTU beyond that is no MTU.
    unsigned int mtu = 0;

    if (_uintMember(ethData, "mtu", mtu) && mtu <= UINT_MAX / 8)
        info->mtu = mtu;
    else
        info->mtu = 0;
}

//------------------------------------------------------------------------------
// Walks
//------------------------------------------------------------------------------

Array<Instance*> EthernetPortHelper::getInstancesByClass(classId_t id)
{
    Array<Instance*> result;
    Json::Value reply;

    _callLib(libGetAllAdaptersIndexString, "libGetAllAdaptersIndexString",
        "all adapters",
        "%s - libGetAllAdaptersIndexString got default exception",
        Json::Value(), reply);

    if (!_hasArray(reply, "indexStrings"))
    {
        TLOG(LL_ERR, "libGetAllAdaptersIndexString returns NULL.");
        return result;
    }

    const Json::Value& adapters = reply["indexStrings"];

    if (adapters.size() == 0)
    {
        TLOG(LL_WARN, "No adapters in the system. ");
        return result;
    }

    ProviderUtil* util = ProviderUtil::getProviderUtil();

    for (Json::ArrayIndex i = 0; i < adapters.size(); i++)
    {
        int adapterId = (int)i + 1;

        if (!adapters[i].isString())
        {
            TLOG(LL_ERR, "Adapter %d has no index string", adapterId);
            continue;
        }

        String index(adapters[i].asCString());

        if (!util->hasEthernetPort(index))
        {
            TLOG(LL_INFO, "No Ethernet ports found for Adapter - %s",
                index.c_str());
            continue;
        }

        result.append(getInstancesByAdapterId(adapterId, id));
    }

    return result;
}

Array<Instance*> EthernetPortHelper::getInstancesByAdapterId(int adapterId,
    classId_t id)
{
    Array<Instance*> result;
    ProviderUtil* util = ProviderUtil::getProviderUtil();

    String adapter = util->getAddrByAdapterId(adapterId);

    if (adapter.size() == 0)
        return result;

    Json::Value request(Json::objectValue);
    request["indexStr"] = adapter.c_str();

    Json::Value ports;

    if (!_callLib(libGetEthPhyPortIndicesByAdapter,
        "libGetEthPhyPortIndicesByAdapter", adapter.c_str(),
        "%s - libGetEthPhyPortIndicesByAdapter got default exception",
        request, ports))
        return result;

    if (!_hasArray(ports, "indexStrings"))
    {
        TLOG(LL_ERR, "libGetEthPhyPortIndicesByAdapter returns NULL.");
        return result;
    }

    const Json::Value& indexes = ports["indexStrings"];

    // One host string serves every port of the walk.
    char host[256];
    memset(host, 0, sizeof(host));
    util->getHostInfo(host, sizeof(host) - 1);

    if (strlen(host) >= sizeof(((_ethPortInfo*)0)->hostName))
    {
        TLOG(LL_WARN, "Host string %s is longer than %u characters and is "
            "cut in the Ethernet port instances", host,
            (unsigned)sizeof(((_ethPortInfo*)0)->hostName) - 1);
    }

    for (Json::ArrayIndex place = 0; place < indexes.size(); place++)
    {
        if (!indexes[place].isString())
        {
            TLOG(LL_ERR, "Ethernet port %u of %s has no index string",
                (unsigned)place, adapter.c_str());
            continue;
        }

        const char* portIndex = indexes[place].asCString();
        Json::Value details;

        if (getEthPortDetails(String(portIndex), details) != 0)
        {
            TLOG(LL_ERR, "Unable to get Eth port data for %s", portIndex);
            continue;
        }

        _ethPortInfo info;
        memset(&info, 0, sizeof(info));

        String plain = ProviderUtil::eraseColonsFromIndex(String(portIndex));
        strlcpy(info.macAddress, plain.c_str(), sizeof(info.macAddress));
        strlcpy(info.permanentAddress, plain.c_str(),
            sizeof(info.permanentAddress));
        strlcpy(info.hostName, host, sizeof(info.hostName));
        info.portNumber = (uint16)place;
        fillFromEthData(details["ethData"], &info);

        if (id == ID_VESPERA_EthernetPort)
        {
            Json::Value sfpRequest(Json::objectValue);
            sfpRequest["indexStr"] = portIndex;
            Json::Value sfp;

            _callLib(libGetOpticsSFP, "libGetOpticsSFP", portIndex,
                "%s - libGetOpticsSFP got default exception", sfpRequest, sfp);

            const char* transceiver =
                _goodObject(sfp) ? _textMember(sfp, "transceiver") : 0;

            if (transceiver)
                info.portType = getPortType(transceiver);
            else
                TLOG(LL_ERR, "Unable to get SFP info for %s", portIndex);

            result.append(getEthernetPortInstance(info));
        }
        else if (id == ID_VESPERA_LANEndpoint)
        {
            // A port without a device name still is an endpoint; its key
            // is then the empty name.
            result.append(getLANEndpointInstance(info));
        }
        else
        {
            TLOG(LL_INFO, "Unhandled class support");
        }
    }

    return result;
}

Array<Instance*> EthernetPortHelper::getEthernetPortInstancesByAdapter(
    String address)
{
    Array<Instance*> result;
    String colon = ProviderUtil::getIndexInColonFormat(address);

    Json::Value request(Json::objectValue);
    request["indexStr"] = colon.c_str();
    Json::Value reply;

    _callLib(libGetAdapterIdByPort, "libGetAdapterIdByPort", colon.c_str(),
        "%s - libGetAdapterIdByPort got default exception", request, reply);

    if (!_goodObject(reply) || !reply.isMember("adapterId") ||
        !reply["adapterId"].isIntegral())
    {
        TLOG(LL_ERR, "libGetAdapterIdByPort returns NULL.");
        return result;
    }

    const Json::Value& adapterId = reply["adapterId"];

    if (!adapterId.isInt() || adapterId.asInt() < 1)
    {
        TLOG(LL_WARN, "Adapter not found in the system.");
        return result;
    }

    return getInstancesByAdapterId(adapterId.asInt(), ID_VESPERA_EthernetPort);
}

int EthernetPortHelper::getEthPortDetails(String mac, Json::Value& reply)
{
    String colon = ProviderUtil::getIndexInColonFormat(mac);

    Json::Value request(Json::objectValue);
    request["mac"] = colon.c_str();

    if (!_callLib(libGetEthPortByEthMac, "libGetEthPortByEthMac", colon.c_str(),
        "libGetEthPortByEthMac got default exception for %s", request, reply))
        return -1;

    if (_goodObject(reply) && reply.isMember("ethData") &&
        reply["ethData"].isObject())
        return 0;

    TLOG(LL_ERR, "Ethernet Port Info is NOT available");
    return -1;
}

//------------------------------------------------------------------------------
// Builders
//------------------------------------------------------------------------------

template<class T>
static Array<T> _one(const T& x)
{
    Array<T> a;
    a.append(x);
    return a;
}

// The record's texts are cut to their fields already, but a record handed in
// by a caller need not be terminated.
template<size_t N>
static String _field(const char (&text)[N])
{
    return String(text, strnlen(text, N));
}

VESPERA_EthernetPort* EthernetPortHelper::getEthernetPortInstance(
    _ethPortInfo info)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    VESPERA_EthernetPort* p = create<VESPERA_EthernetPort>(true);

    String mac = _field(info.macAddress);
    String permanent = _field(info.permanentAddress);

    p->CreationClassName.set(util->getClassName(ID_VESPERA_EthernetPort));
    p->SystemCreationClassName.set(
        util->getClassName(ID_VESPERA_ComputerSystem));
    p->SystemName.set(_field(info.hostName));
    p->DeviceID.set(mac);
    p->PermanentAddress.set(permanent);
    p->NetworkAddresses.set(_one(permanent));
    p->ElementName.set(_field(info.deviceName));
    p->LinkTechnology.set(2);
    p->Capabilities.set(_one<uint16>(0));
    p->EnabledCapabilities.set(_one<uint16>(0));
    p->OperationalStatus.set(_one<uint16>((uint16)info.state));
    p->PortType.set(info.portType);
    p->PortNumber.set(info.portNumber);

    return p;
}

VESPERA_LANEndpoint* EthernetPortHelper::getLANEndpointInstance(
    _ethPortInfo info)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    VESPERA_LANEndpoint* p = create<VESPERA_LANEndpoint>(true);

    String device = _field(info.deviceName);
    String nameFormat(device);
    nameFormat.append("_");
    nameFormat.append("ETHERNET");

    p->CreationClassName.set(util->getClassName(ID_VESPERA_LANEndpoint));
    p->SystemCreationClassName.set(
        util->getClassName(ID_VESPERA_ComputerSystem));
    p->SystemName.set(_field(info.hostName));
    p->Name.set(device);
    p->ElementName.set(device);
    p->Description.set(device);
    p->LANID.set(device);
    p->NameFormat.set(nameFormat);
    p->ProtocolIFType.set(1);
    p->MACAddress.set(_field(info.macAddress));
    p->MaxDataSize.set(info.mtu <= UINT_MAX / 8 ? info.mtu * 8 : 0);
    p->HealthState.set(_healthState(info.state));
    p->EnabledState.set(_enabledState(info.state));

    return p;
}

} // namespace OLMA
