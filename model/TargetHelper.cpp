#include "TargetHelper.h"

#include <stdio.h>
#include <string.h>

#include <exception>

#include "CIMProviderTruj.h"
#include "ProviderUtil.h"
#include "Strings.h"
#include "log.h"

#include "VESPERA_LogicalDisk.h"
#include "VESPERA_StorageExtent.h"
#include "VESPERA_TapeDrive.h"

namespace OLMA
{

TargetHelper gTargetHelperObj;
TargetHelper* TargetHelper::helperObj = 0;

TargetHelper::TargetHelper()
{
}

TargetHelper* TargetHelper::getTargetHelperObject()
{
    if (!helperObj)
        helperObj = &gTargetHelperObj;

    return helperObj;
}

namespace
{

const Json::Value& member(const Json::Value& object, const char* name)
{
    static const Json::Value none;
    return object.isObject() ? object[name] : none;
}

const char* textOf(const Json::Value& object, const char* name)
{
    const Json::Value& v = member(object, name);
    return v.isString() ? v.asCString() : 0;
}

// The inquiry fields have fixed widths; a longer text is cut, a shorter one
// copied as it is.
void copyField(char* field, size_t size, const char* text)
{
    if (text)
        strlcpy(field, text, size);
}

bool callLib(const char* name, JsonReqFP fp, const Json::Value& request,
    Json::Value& reply)
{
    try
    {
        reply = fp(request);
        return true;
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "%s got User exception %d: %s", name, e.getCode(),
            e.getMessage().c_str());
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "%s got std exception: %s", name, e.what());
    }
    catch (...)
    {
        TLOG(LL_ERR, "%s got default exception", name);
    }

    reply = Json::Value();
    return false;
}

bool isTapeLike(const char* type)
{
    return type && (strcmp(type, "Tape") == 0 || strcmp(type, "Media Changer") == 0);
}

bool servesKind(bool tapeLike, classId_t id)
{
    if (tapeLike)
        return id == ID_VESPERA_TapeDrive;

    return id == ID_VESPERA_StorageExtent || id == ID_VESPERA_LogicalDisk;
}

// Whether a remote port of this device data holds units of the class: a
// target of the kind the class shows. Says why not, as the walk always has.
bool serves(const Json::Value& device, classId_t id)
{
    if (!member(device, "isTarget").asBool())
    {
        TLOG(LL_DBG, "Nothing to do since the its not a Target Rport.");
        return false;
    }

    const char* type = textOf(device, "type");
    TLOG(LL_DBG, "Device type = %s", type ? type : "");

    if (!servesKind(isTapeLike(type), id))
    {
        TLOG(LL_INFO, "Continue with next rport. Looking for another device type ");
        return false;
    }

    return true;
}

String trimmed(char* text)
{
    char out[128];
    char* buffer = strlen(text) < sizeof(out) ? out : 0;

    if (!buffer)
        return String(text);

    ProviderUtil::trimString(text, buffer);
    return String(buffer);
}

String unitName(const _hbaLunInfo& lun)
{
    char name[32];
    snprintf(name, sizeof(name), "LUN_%u", lun.number);
    return String(name);
}

const String describeStorageExtent("It is a unique identification for a Storage Extent");
const String describeTapeDrive("It is a unique identification for a Tape Drive");
const String describeLogicalDisk("It is a unique identification for a Logical Disk");

// An array property holding one element, built in place: a temporary array
// assigned to it would cost two more allocations for each of the thousands
// of units a walk makes.
template<class T>
void setSingle(Property<Array<T> >& p, const T& x)
{
    p.value.clear();
    p.value.append(x);
    p.null = 0;
}

// What the three classes share. The DeviceID ties a unit to its local and
// remote port, which is how the paths of the host's view find it.
void setCommon(CIM_LogicalDevice* p, classId_t id, const String& description,
    _hbaPortInfo& port, _hbaLunInfo& lun)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    String unit = unitName(lun);

    // Put together in one piece: the vendor and product fields are short
    // and bounded, and the whole fits the buffer with room to spare.
    char vendor[sizeof(lun.vendor)];
    char product[sizeof(lun.productId)];
    ProviderUtil::trimString(lun.vendor, vendor);
    ProviderUtil::trimString(lun.productId, product);
    char text[160];
    snprintf(text, sizeof(text), "%s_%s_%s_%s_%s", port.portWwn, lun.rPortWwn, vendor,
        product, unit.c_str());
    String deviceId(text);

    p->CreationClassName.set(util->getClassName(id));
    p->SystemCreationClassName.set(util->getClassName(ID_VESPERA_ComputerSystem));
    p->SystemName.set(port.hostName);
    p->ElementName.set(unit);
    p->DeviceID.set(deviceId);
    setSingle(p->OtherIdentifyingInfo, deviceId);
    setSingle(p->IdentifyingDescriptions, description);
    setSingle(p->OperationalStatus, (uint16)2);
}

String serialName(_hbaLunInfo& lun)
{
    String name = trimmed(lun.vendor);
    name += "+";
    name += trimmed(lun.productId);
    name += "+";
    name += trimmed(lun.serialNumber);
    return name;
}

} // namespace

const Json::Value* TargetHelper::listedDeviceData(const Json::Value& remotePort)
{
    const Json::Value& device = member(remotePort, "deviceData");

    if (!device.isObject() || !device["isTarget"].isBool())
        return 0;

    if (device["isTarget"].asBool() && !device["type"].isString())
        return 0;

    return &device;
}

Array<Instance*> TargetHelper::getTargetInstances(_hbaPortInfo port, classId_t id,
    const _keyLookup* lookup)
{
    Array<Instance*> result;

    Json::Value request(Json::objectValue);
    String wwn = ProviderUtil::getIndexInColonFormat(String(port.portWwn));
    request["pPortWwn"] = wwn.c_str();
    request["lPortWwn"] = wwn.c_str();

    Json::Value remotePorts;

    if (!callLib("libGetAllRemotePorts", libGetAllRemotePorts, request, remotePorts))
        return result;

    if (!ProviderUtil::isValidJsonResponse(remotePorts) || !remotePorts.isArray())
    {
        TLOG(LL_ERR, "libGetAllRemotePorts returns NULL.");
        return result;
    }

    TLOG(LL_DBG, "libGetAllRemotePorts. Number of rports -  %d", (int)remotePorts.size());

    // Once one unit of this port lacks a description, the library's
    // descriptions of the port aren't trusted any more: every later unit is
    // named by its serial number instead. Only the logical disk doesn't
    // show what the rule changes.
    bool serialRule = false;
    bool ruleMatters = id != ID_VESPERA_LogicalDisk;

    for (Json::ArrayIndex r = 0; r < remotePorts.size(); r++)
    {
        const char* remoteWwn = textOf(remotePorts[r], "remotePortWwn");

        if (!remoteWwn)
        {
            TLOG(LL_ERR, "Remote port %u of %s has no remotePortWwn", (unsigned)r,
                port.portWwn);
            continue;
        }

        char plainRemote[sizeof(((_hbaLunInfo*)0)->rPortWwn)] = "";
        copyField(plainRemote, sizeof(plainRemote),
            ProviderUtil::eraseColonsFromIndex(String(remoteWwn)).c_str());

        // A look-up reads another remote port only while its units can
        // still change how the one looked for is named.
        bool candidate = !lookup || lookup->isBehind(port.portWwn, plainRemote);

        if (!candidate && (serialRule || !ruleMatters))
            continue;

        // The list answers whether a remote port serves this class where it
        // carries the device data: then only the ports that do are read
        // whole, with their logical units.
        const Json::Value* listed = listedDeviceData(remotePorts[r]);

        if (listed && !serves(*listed, id))
            continue;

        request["rPortWwn"] = remoteWwn;

        Json::Value reply;

        if (!callLib("libGetCompleteRemotePort", libGetCompleteRemotePort, request, reply))
            continue;

        if (!ProviderUtil::isValidJsonResponse(reply) || !reply.isObject())
        {
            TLOG(LL_ERR, "libGetCompleteRemotePort response is null or has error");
            continue;
        }

        const Json::Value& device = member(reply, "deviceData");

        if (!member(device, "isTarget").isBool())
        {
            TLOG(LL_ERR, "No device data for Rport %s.", remoteWwn);
            continue;
        }

        if (!serves(device, id))
            continue;

        const Json::Value& luns = member(reply, "lunList");

        if (!luns.isArray())
        {
            TLOG(LL_ERR, "No LUN Info is available for Rport %s.", remoteWwn);
            continue;
        }

        TLOG(LL_DBG, "Number of Luns = %d.", (int)luns.size());

        for (Json::ArrayIndex u = 0; u < luns.size(); u++)
        {
            const Json::Value& unit = luns[u];

            _hbaLunInfo lun;
            memset(&lun, 0, sizeof(lun));
            memcpy(lun.rPortWwn, plainRemote, sizeof(lun.rPortWwn));

            const Json::Value& number = member(unit, "number");
            const char* vendor = textOf(unit, "vendor");
            const char* productId = textOf(unit, "productID");

            if (!number.isUInt() || !vendor || !productId)
            {
                TLOG(LL_ERR, "LUN info is NOT available");
                continue;
            }

            lun.number = number.asUInt();
            copyField(lun.vendor, sizeof(lun.vendor), vendor);
            copyField(lun.productId, sizeof(lun.productId), productId);

            // Without a kind, no description can be told apart.
            const Json::Value& kind = member(unit, "lunDescIdType");
            lun.idType = kind.isUInt() ? kind.asUInt() : (unsigned)LUN_ID_NONE;

            const char* description = textOf(unit, "lunDescription");

            if (description)
                copyField(lun.description, sizeof(lun.description), description);
            else
                serialRule = true;

            if (serialRule)
            {
                const char* serial = textOf(unit, "productSerialNumber");

                if (serial)
                {
                    copyField(lun.serialNumber, sizeof(lun.serialNumber), serial);
                    lun.idType = LUN_ID_SERIAL;
                }
                else
                    lun.idType = LUN_ID_NONE;
            }

            if (!candidate || (lookup && !lookup->endsWith(unitName(lun).c_str())))
                continue;

            Instance* instance = 0;

            if (id == ID_VESPERA_StorageExtent)
                instance = getStorageExtentInstance(port, lun);
            else if (id == ID_VESPERA_TapeDrive)
                instance = getTapeDriveInstance(port, lun);
            else
                instance = getLogicalDiskInstance(port, lun);

            result.append(instance);

            if (lookup && lookup->keepMatch(result, result.size() - 1))
                return result;
        }
    }

    return result;
}

Instance* TargetHelper::getStorageExtentInstance(_hbaPortInfo port, _hbaLunInfo lun)
{
    VESPERA_StorageExtent* p = create<VESPERA_StorageExtent>(true);

    setCommon(p, ID_VESPERA_StorageExtent,
        describeStorageExtent, port, lun);

    uint16 format = 0;
    uint16 space = 0;

    switch (lun.idType)
    {
        case LUN_ID_SERIAL:
            p->Name.set(serialName(lun));
            format = 7;
            space = 7;
            break;
        case 1:
            p->Name.set(lun.description);
            format = 11;
            space = 4;
            break;
        case 2:
            p->Name.set(lun.description);
            format = 10;
            space = 3;
            break;
        case 3:
            p->Name.set(lun.description);
            format = 9;
            space = 2;
            break;
        case 8:
            p->Name.set(lun.description);
            format = 1;
            space = 1;
            break;
        case LUN_ID_NONE:
            p->Name.set("Unable To Fetch");
            break;
        default:
            TLOG(LL_ERR, "Default idType. Should not have reached here. ");
            p->Name.set(String());
            return p;
    }

    p->NameFormat.set(format);
    p->NameNamespace.set(space);
    return p;
}

Instance* TargetHelper::getTapeDriveInstance(_hbaPortInfo port, _hbaLunInfo lun)
{
    VESPERA_TapeDrive* p = create<VESPERA_TapeDrive>(true);

    setCommon(p, ID_VESPERA_TapeDrive,
        describeTapeDrive, port, lun);

    switch (lun.idType)
    {
        case LUN_ID_SERIAL:
            p->Name.set(serialName(lun));
            break;
        case 1:
        case 2:
        case 3:
        case 8:
            p->Name.set(lun.description);
            break;
        case LUN_ID_NONE:
            p->Name.set("Unable To Fetch");
            break;
        default:
            TLOG(LL_ERR, "Default case for lunInfo.idType. Should not have reached here. ");
            p->Name.set(String());
            break;
    }

    return p;
}

Instance* TargetHelper::getLogicalDiskInstance(_hbaPortInfo port, _hbaLunInfo lun)
{
    VESPERA_LogicalDisk* p = create<VESPERA_LogicalDisk>(true);

    setCommon(p, ID_VESPERA_LogicalDisk,
        describeLogicalDisk, port, lun);

    p->Name.set(lun.description);
    p->NameFormat.set(1);
    p->NameNamespace.set(1);
    return p;
}

} // namespace OLMA
