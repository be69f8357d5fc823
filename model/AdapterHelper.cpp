#include "AdapterHelper.h"

#include <string.h>
#include <strings.h>

#include <exception>

#include "CIMProviderTruj.h"
#include "ProviderUtil.h"
#include "String.h"
#include "log.h"

#include "VESPERA_AdapterSoftwareIdentity.h"
#include "VESPERA_PhysicalPackage.h"
#include "VESPERA_PortController.h"
#include "VESPERA_Product.h"

namespace OLMA
{

AdapterHelper gAdapterHelperObj;
AdapterHelper* AdapterHelper::helperObj = 0;

AdapterHelper* AdapterHelper::getAdapterHelperInstance()
{
    if (!helperObj)
        helperObj = &gAdapterHelperObj;

    return helperObj;
}

//------------------------------------------------------------------------------
// Reading replies
//------------------------------------------------------------------------------

const Json::Value* AdapterHelper::jsonMember(const Json::Value& obj, const char* name)
{
    // find() on anything but an object or null throws in JsonCpp.
    if (!obj.isObject() || !name)
        return 0;

    return obj.find(name, name + strlen(name));
}

const char* AdapterHelper::jsonText(const Json::Value& obj, const char* name)
{
    const Json::Value* member = jsonMember(obj, name);

    if (!member || !member->isString())
        return "";

    const char* text = member->asCString();
    return text ? text : "";
}

void AdapterHelper::copyField(char* dst, size_t size, const char* src)
{
    if (!dst || size == 0)
        return;

    size_t n = src ? strnlen(src, size - 1) : 0;

    if (n > 0)
        memcpy(dst, src, n);

    dst[n] = '\0';
}

void AdapterHelper::copyTrimmedField(char* dst, size_t size, const char* src)
{
    if (!dst || size == 0)
        return;

    if (!src)
        src = "";

    while (*src == ' ')
        src++;

    size_t n = strlen(src);

    while (n > 0 && src[n - 1] == ' ')
        n--;

    if (n > size - 1)
        n = size - 1;

    // Cutting may leave a blank at the new end.
    while (n > 0 && src[n - 1] == ' ')
        n--;

    if (n > 0)
        memcpy(dst, src, n);

    dst[n] = '\0';
}

// A record may come from anyone; the builders read its fields as C texts.
static void _terminate(_adapterData& d)
{
    d.nodeWwn[sizeof(d.nodeWwn) - 1] = '\0';
    d.mac[sizeof(d.mac) - 1] = '\0';
    d.hostName[sizeof(d.hostName) - 1] = '\0';
    d.model[sizeof(d.model) - 1] = '\0';
    d.serialNumber[sizeof(d.serialNumber) - 1] = '\0';
    d.manufacturer[sizeof(d.manufacturer) - 1] = '\0';
    d.fruNumber[sizeof(d.fruNumber) - 1] = '\0';
    d.partNumber[sizeof(d.partNumber) - 1] = '\0';
    d.storageDriverName[sizeof(d.storageDriverName) - 1] = '\0';
    d.storageDriverVersion[sizeof(d.storageDriverVersion) - 1] = '\0';
    d.networkDriverName[sizeof(d.networkDriverName) - 1] = '\0';
    d.networkDriverVersion[sizeof(d.networkDriverVersion) - 1] = '\0';
    d.firmwareVersion[sizeof(d.firmwareVersion) - 1] = '\0';
    d.biosVersion[sizeof(d.biosVersion) - 1] = '\0';
    d.uuid[sizeof(d.uuid) - 1] = '\0';
}

// One call of a library entry. Whatever it throws stays here: our callers run
// on the CIM server's threads. A failed call leaves a null reply.
static Json::Value _callLib(const char* entry, JsonReqFP fp,
    const Json::Value& request, const char* what)
{
    try
    {
        return fp(request);
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "%s - %s got User exception %d: %s", what, entry,
            e.getCode(), e.getMessage().c_str());
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "%s - %s got std exception: %s", what, entry, e.what());
    }
    catch (...)
    {
        TLOG(LL_ERR, "%s - %s got default exception", what, entry);
    }

    return Json::Value();
}

//------------------------------------------------------------------------------
// Filling the record
//------------------------------------------------------------------------------

static String _plainForm(const char* colonForm)
{
    return ProviderUtil::eraseColonsFromIndex(String(colonForm));
}

void AdapterHelper::fillVPDInfo(Json::Value hbaData, _adapterData* data)
{
    if (!data)
        return;

    const char* oem = jsonText(hbaData, "oem");
    TLOG(LL_DBG, "Adapter vendor code is :%s", oem);

    // These vendors' VPD has no FRU number, whatever the reply says.
    if (strncasecmp(oem, "HP", 2) == 0 || strncasecmp(oem, "DELL", 4) == 0)
        TLOG(LL_INFO, "%s VPD info doesnt have the FRU details to print.", oem);
    else
        copyField(data->fruNumber, sizeof(data->fruNumber), jsonText(hbaData, "fruNum"));

    const char* partNum = jsonText(hbaData, "partNum");
    copyField(data->partNumber, sizeof(data->partNumber), partNum);

    // OEM serial numbers often carry the part number in front.
    const char* oemSerial = jsonText(hbaData, "oemSerialNum");

    if (*oemSerial)
    {
        size_t n = strlen(partNum);

        if (n > 0 && strncmp(oemSerial, partNum, n) == 0)
            oemSerial += n;

        copyField(data->serialNumber, sizeof(data->serialNumber), oemSerial);
    }

    const char* uuid = jsonText(hbaData, "uuid");

    if (*uuid)
        copyField(data->uuid, sizeof(data->uuid), uuid);
}

// What every adapter with a driver shows, whichever driver it is.
static void _commonFill(AdapterHelper* helper, const Json::Value& hbaData,
    const Json::Value& firmware, _adapterData& data)
{
    AdapterHelper::copyField(data.serialNumber, sizeof(data.serialNumber),
        AdapterHelper::jsonText(hbaData, "serialNumber"));
    helper->fillVPDInfo(hbaData, &data);
    AdapterHelper::copyField(data.manufacturer, sizeof(data.manufacturer), "VSPR");
    AdapterHelper::copyTrimmedField(data.firmwareVersion, sizeof(data.firmwareVersion),
        AdapterHelper::jsonText(firmware, "version"));
    AdapterHelper::copyField(data.model, sizeof(data.model),
        AdapterHelper::jsonText(hbaData, "model"));
}

// "portCount" as a count; anything but a positive integer counts as none.
static bool _hasPorts(const Json::Value& hbaData)
{
    const Json::Value* count = AdapterHelper::jsonMember(hbaData, "portCount");
    return count && count->isUInt64() && count->asUInt64() > 0;
}

static bool _isTrue(const Json::Value& obj, const char* name)
{
    const Json::Value* member = AdapterHelper::jsonMember(obj, name);
    return member && member->isBool() && member->asBool();
}

//------------------------------------------------------------------------------
// The walk
//------------------------------------------------------------------------------

// BIOS, when the flash says it holds one, then firmware; each driver kind only
// once a walk, from the first adapter that has it.
static void _appendSoftware(AdapterHelper* helper, const char* index,
    const Json::Value& firmware, _adapterData& data, bool& networkDriverBuilt,
    bool& storageDriverBuilt, Array<Instance*>& result)
{
    Instance* instance;

    if (!networkDriverBuilt && data.networkDriverName[0])
    {
        if ((instance = helper->getAdapterSoftwareIdentityInstance(data, SOFTWARE_DRIVER, true)))
            result.append(instance);
        networkDriverBuilt = true;
    }

    if (!storageDriverBuilt && data.storageDriverName[0])
    {
        if ((instance = helper->getAdapterSoftwareIdentityInstance(data, SOFTWARE_DRIVER, false)))
            result.append(instance);
        storageDriverBuilt = true;
    }

    AdapterHelper::copyTrimmedField(data.biosVersion, sizeof(data.biosVersion),
        AdapterHelper::jsonText(firmware, "biosVersion"));

    // An erased boot image reads as 0xFF bytes, which no client could show.
    if (!ProviderUtil::valid_UTF_string(data.biosVersion))
        data.biosVersion[0] = '\0';

    Json::Value request(Json::objectValue);
    request["indexStr"] = index;
    Json::Value flash = _callLib("libGetFlashInfo", libGetFlashInfo, request, index);

    if (ProviderUtil::isValidJsonResponse(flash) && _isTrue(flash, "flashStatus"))
    {
        if ((instance = helper->getAdapterSoftwareIdentityInstance(data, SOFTWARE_BIOS, false)))
            result.append(instance);
    }

    if ((instance = helper->getAdapterSoftwareIdentityInstance(data, SOFTWARE_FIRMWARE, false)))
        result.append(instance);
}

Array<Instance*> AdapterHelper::getInstancesByClass(classId_t id)
{
    TLOG(LL_DBG, "Entering: %s", "AdapterHelper::getInstancesByClass");

    Array<Instance*> result;

    if (id != ID_VESPERA_PortController && id != ID_VESPERA_PhysicalPackage &&
        id != ID_VESPERA_Product && id != ID_VESPERA_AdapterSoftwareIdentity)
    {
        TLOG(LL_INFO, "Unhandled class support");
        return result;
    }

    ProviderUtil* util = ProviderUtil::getProviderUtil();

    Json::Value adapters = _callLib("libGetAllAdaptersIndexString",
        libGetAllAdaptersIndexString, Json::Value(), "AdapterHelper");
    const Json::Value* list = ProviderUtil::isValidJsonResponse(adapters) ?
        jsonMember(adapters, "indexStrings") : 0;

    if (!list || !list->isArray())
    {
        TLOG(LL_ERR, "libGetAllAdaptersIndexString returns NULL.");
        return result;
    }

    int count = (int)list->size();
    TLOG(LL_INFO, "Number of Adapters: %d", count);

    if (count == 0)
    {
        TLOG(LL_WARN, "No adapters in the system!");
        return result;
    }

    bool networkDriverBuilt = false;
    bool storageDriverBuilt = false;

    for (int i = 0; i < count; i++)
    {
        int adapterId = i + 1;
        const Json::Value& element = (*list)[i];
        const char* index = element.isString() ? element.asCString() : "";

        _adapterData data;
        memset(&data, 0, sizeof(data));

        Json::Value details;

        if (!*index || util->getAdapterDetails(String(index), details) != 0)
        {
            TLOG(LL_INFO, "Unable to get Adapter info %d - %s", adapterId, index);
            continue;
        }

        if (details.isNull())
        {
            TLOG(LL_ERR, "adapter is NULL for %s", index);
            continue;
        }

        static const Json::Value none;
        const Json::Value* member;
        const Json::Value& hbaData = (member = jsonMember(details, "hbaData")) ? *member : none;
        const Json::Value& driver = (member = jsonMember(details, "driver")) ? *member : none;
        const Json::Value& firmware = (member = jsonMember(details, "firmware")) ? *member : none;

        data.isCNA = jsonMember(hbaData, "hbaMAC") != 0;
        TLOG(LL_INFO, "Adapter Type : %s", data.isCNA ? "CNA" : "FC HBA");

        if (!_hasPorts(hbaData))
        {
            TLOG(LL_WARN, "There are no ports associated to Adapter id %d - %s", adapterId, index);
            continue;
        }

        util->getHostInfo(data.hostName, sizeof(data.hostName) - 1);

        if (data.isCNA)
            copyField(data.mac, sizeof(data.mac), _plainForm(jsonText(hbaData, "hbaMAC")).c_str());

        bool filled = false;

        if (jsonMember(driver, "networkDriverName"))
        {
            copyField(data.networkDriverName, sizeof(data.networkDriverName),
                jsonText(driver, "networkDriverName"));
            copyTrimmedField(data.networkDriverVersion, sizeof(data.networkDriverVersion),
                jsonText(driver, "networkDriverVersion"));
            _commonFill(this, hbaData, firmware, data);
            filled = true;
        }

        if (jsonMember(driver, "storageDriverName"))
        {
            copyField(data.nodeWwn, sizeof(data.nodeWwn), _plainForm(jsonText(hbaData, "wwn")).c_str());
            copyField(data.storageDriverName, sizeof(data.storageDriverName),
                jsonText(driver, "storageDriverName"));
            copyTrimmedField(data.storageDriverVersion, sizeof(data.storageDriverVersion),
                jsonText(driver, "storageDriverVersion"));

            if (!filled)
                _commonFill(this, hbaData, firmware, data);
        }

        Instance* instance = 0;

        switch (id)
        {
            case ID_VESPERA_PortController:
                data.state = _isTrue(hbaData, "hbaStatus") ? 11 : 10;
                instance = getPortControllerInstance(data);
                break;

            case ID_VESPERA_PhysicalPackage:
                instance = getPhysicalPackageInstance(data);
                break;

            case ID_VESPERA_Product:
                instance = getProductInstance(data);
                break;

            default:
                _appendSoftware(this, index, firmware, data,
                    networkDriverBuilt, storageDriverBuilt, result);
                break;
        }

        if (instance)
            result.append(instance);
    }

    TLOG(LL_INFO, "Number of instances: %d", (int)result.size());
    TLOG(LL_DBG, "Returning: %s", "AdapterHelper::getInstancesByClass");
    return result;
}

//------------------------------------------------------------------------------
// The builders
//------------------------------------------------------------------------------

static const char* const FC_WORDS = "Vespera FC HBA";
static const char* const CNA_WORDS = "Vespera CNA";
static const char* const FC_KIND = "Fiber Channel Adapter";
static const char* const CNA_KIND = "Ethernet Adapter";

static Array<uint16> _uint16s(uint16 value)
{
    Array<uint16> a;
    a.append(value);
    return a;
}

static Array<String> _strings(const String& first, const String& second)
{
    Array<String> a;
    a.append(first);
    a.append(second);
    return a;
}

static Array<String> _strings(const String& only)
{
    Array<String> a;
    a.append(only);
    return a;
}

Instance* AdapterHelper::getPortControllerInstance(_adapterData data)
{
    _terminate(data);

    VESPERA_PortController* pc = create<VESPERA_PortController>(true);
    const char* words = data.isCNA ? CNA_WORDS : FC_WORDS;
    bool disabled = data.state == 10;

    pc->CreationClassName.set(classNames[ID_VESPERA_PortController]);
    pc->SystemCreationClassName.set(classNames[ID_VESPERA_ComputerSystem]);
    pc->SystemName.set(data.hostName);
    pc->DeviceID.set(data.isCNA ? data.mac : data.nodeWwn);
    pc->Name.set(data.serialNumber);
    pc->ElementName.set(data.serialNumber);
    pc->Caption.set(words);
    pc->Description.set(words);
    pc->OperationalStatus.set(_uint16s((uint16)data.state));
    pc->StatusDescriptions.set(_strings(disabled ?
        "The adapter is disabled" : "The adapter is in service"));
    pc->EnabledState.set(disabled ? 3 : 2);
    pc->ControllerType.set(data.isCNA ? 1 : 4);

    if (data.isCNA)
        pc->OtherControllerType.set("CNA - FC and Ethernet types");

    return pc;
}

Instance* AdapterHelper::getPhysicalPackageInstance(_adapterData data)
{
    _terminate(data);

    VESPERA_PhysicalPackage* pp = create<VESPERA_PhysicalPackage>(true);
    const char* words = data.isCNA ? CNA_WORDS : FC_WORDS;

    // Without a UUID the tag still has a UUID's shape and carries the
    // address in its last places, so that the card can be found from it.
    String tag;

    if (data.uuid[0])
        tag = data.uuid;
    else if (data.isCNA)
        tag = String("10000000-0000-0000-0000-", data.mac);
    else
    {
        size_t n = strnlen(data.nodeWwn, 4);
        tag = "10000000-0000-0000-";
        tag.append(data.nodeWwn, n);
        tag.append('-');
        tag.append(data.nodeWwn + n);
    }

    String name("VSPR ", data.isCNA ? CNA_KIND : FC_KIND);

    if (data.serialNumber[0])
    {
        name.append(' ');
        name.append(data.serialNumber);
    }

    pp->CreationClassName.set(classNames[ID_VESPERA_PhysicalPackage]);
    pp->Tag.set(tag);
    pp->Manufacturer.set(data.manufacturer);
    pp->Caption.set(words);
    pp->ElementName.set(words);
    pp->Description.set(words);
    pp->Model.set(data.model);
    pp->SerialNumber.set(data.serialNumber);
    pp->PartNumber.set(data.partNumber);
    pp->SKU.set(data.fruNumber);
    pp->Name.set(name);
    pp->PackageType.set(9);

    return pp;
}

Instance* AdapterHelper::getProductInstance(_adapterData data)
{
    _terminate(data);

    VESPERA_Product* product = create<VESPERA_Product>(true);
    const char* words = data.isCNA ? CNA_WORDS : FC_WORDS;

    product->Caption.set(words);
    product->ElementName.set(words);
    product->Description.set(words);
    product->Name.set("VESPERA CIM Provider");
    product->Version.set(data.firmwareVersion);
    product->Vendor.set(data.manufacturer);
    product->IdentifyingNumber.set(data.serialNumber);

    return product;
}

Instance* AdapterHelper::getAdapterSoftwareIdentityInstance(
    _adapterData data, softwareType_t type, bool isNetworkDriver)
{
    _terminate(data);

    VESPERA_AdapterSoftwareIdentity* si = create<VESPERA_AdapterSoftwareIdentity>(true);

    String instanceId;
    String version;
    String caption;
    String name;
    String identity;

    switch (type)
    {
        case SOFTWARE_DRIVER:
        {
            const char* kind = isNetworkDriver ? "Network driver" : "Storage driver";
            instanceId = isNetworkDriver ? data.networkDriverName : data.storageDriverName;
            version = isNetworkDriver ? data.networkDriverVersion : data.storageDriverVersion;
            caption = kind;
            name = String(kind, " ", "for Vespera adapter");
            identity = name;
            break;
        }

        case SOFTWARE_FIRMWARE:
        case SOFTWARE_BIOS:
        {
            bool bios = type == SOFTWARE_BIOS;
            const char* suffix = bios ? "bios" : "firmware";
            const char* what = bios ? "BIOS" : "Firmware";

            instanceId = String(data.isCNA ? data.mac : data.nodeWwn, "_", suffix);
            version = bios ? data.biosVersion : data.firmwareVersion;
            caption = String(bios ? "BIOS for " : "Firmware for ",
                data.isCNA ? CNA_WORDS : FC_WORDS);
            name = String("VSPR ", data.isCNA ? CNA_KIND : FC_KIND, " ");

            if (data.serialNumber[0])
                name.append(String(data.serialNumber, " "));

            name.append(what);
            identity = data.model;
            break;
        }

        default:
            TLOG(LL_INFO, "Default case . Other software types");
            return si;
    }

    si->InstanceID.set(instanceId);
    si->VersionString.set(version);
    si->Classifications.set(_uint16s((uint16)type));
    si->ElementName.set(caption);
    si->Caption.set(caption);
    si->Description.set(caption);
    si->Name.set(name);
    si->Manufacturer.set(data.manufacturer);
    si->IdentityInfoType.set(_strings("SoftwareID", "SoftwareStatus"));
    si->IdentityInfoValue.set(_strings(identity, "Primary"));

    return si;
}

} // namespace OLMA
