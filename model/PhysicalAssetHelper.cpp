#include "PhysicalAssetHelper.h"

#include <stdio.h>
#include <string.h>

#include "AdapterHelper.h"
#include "PortHelper.h"
#include "ProviderUtil.h"
#include "String.h"
#include "log.h"

#include "VESPERA_PhysicalConnector.h"

namespace OLMA
{

PhysicalAssetHelper gPhysicalAssetHelperObj;
PhysicalAssetHelper* PhysicalAssetHelper::helperObj = 0;

PhysicalAssetHelper* PhysicalAssetHelper::getPhysicalAssetHelperObject()
{
    if (!helperObj)
        helperObj = &gPhysicalAssetHelperObj;

    return helperObj;
}

static void _fillSfpInfo(const Json::Value& optics, int adapterId, int portPlace, _sfpInfo& sfp)
{
    AdapterHelper::copyTrimmedField(sfp.vendorName, sizeof(sfp.vendorName),
        AdapterHelper::jsonText(optics, "vendorName"));
    AdapterHelper::copyTrimmedField(sfp.vendorPart, sizeof(sfp.vendorPart),
        AdapterHelper::jsonText(optics, "vendorPart"));
    AdapterHelper::copyTrimmedField(sfp.serialNumber, sizeof(sfp.serialNumber),
        AdapterHelper::jsonText(optics, "serialNo"));
    AdapterHelper::copyField(sfp.extendedId, sizeof(sfp.extendedId),
        AdapterHelper::jsonText(optics, "extendedID"));
    AdapterHelper::copyField(sfp.speed, sizeof(sfp.speed),
        AdapterHelper::jsonText(optics, "speed"));
    AdapterHelper::copyTrimmedField(sfp.revision, sizeof(sfp.revision),
        AdapterHelper::jsonText(optics, "revision"));

    // Serial numbers of optics repeat across vendors; the place of the port
    // keeps the tag unique within the host.
    int n = snprintf(sfp.tag, sizeof(sfp.tag), "%s_%d_%d", sfp.serialNumber, adapterId, portPlace);
    if (n < 0 || (size_t)n >= sizeof(sfp.tag))
        TLOG(LL_WARN, "Connector tag of adapter %d port %d cut to %zu characters",
            adapterId, portPlace, sizeof(sfp.tag) - 1);
}

// Whether the connector of this adapter and port place can have the tag
// looked for: it ends in both, unless it is as long as a tag can be and may
// have lost its end.
static bool _mayBeTagOf(const _keyLookup& lookup, int adapterId, int place)
{
    if (!lookup.key || strlen(lookup.key) >= sizeof(((_sfpInfo*)0)->tag) - 1)
        return true;

    char ids[32];
    snprintf(ids, sizeof(ids), "%d_%d", adapterId, place);
    return lookup.endsWith(ids);
}

Array<Instance*> PhysicalAssetHelper::getInstancesByClass(classId_t id)
{
    TLOG(LL_DBG, "Entering: %s", "PhysicalAssetHelper::getInstancesByClass");

    Array<Instance*> result;

    if (id != ID_VESPERA_PhysicalConnector)
    {
        TLOG(LL_INFO, "Unhandled class support");
        return result;
    }

    _walk(result, 0);

    TLOG(LL_INFO, "Number of instances: %d", (int)result.size());
    TLOG(LL_DBG, "Returning: %s", "PhysicalAssetHelper::getInstancesByClass");
    return result;
}

Instance* PhysicalAssetHelper::getInstanceByKeys(classId_t id, const Instance* model)
{
    _keyLookup lookup;

    if (id != ID_VESPERA_PhysicalConnector)
    {
        TLOG(LL_INFO, "Unhandled class support");
        return 0;
    }

    if (!_keyLookup::of(id, model, lookup))
        return 0;

    Array<Instance*> result;
    _walk(result, &lookup);
    return result.size() > 0 ? result[0] : 0;
}

void PhysicalAssetHelper::_walk(Array<Instance*>& result, const _keyLookup* lookup)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    PortHelper* portHelper = PortHelper::getPortHelperObject();

    Json::Value adapters;
    int count = util->getNumberOfAdapters(adapters);

    if (count < 1)
    {
        TLOG(LL_WARN, "No adapters in the system. ");
        return;
    }

    const Json::Value* list = AdapterHelper::jsonMember(adapters, "indexStrings");

    if (!list || !list->isArray())
        return;

    for (int i = 0; i < count; i++)
    {
        int adapterId = i + 1;
        const Json::Value& element = (*list)[i];
        const char* index = element.isString() ? element.asCString() : "";

        Json::Value details;

        // Unlike the other walks, a failing adapter ends this one.
        if (!*index || util->getAdapterDetails(String(index), details) != 0)
        {
            TLOG(LL_INFO, "Unable to get Adapter info %d - %s", adapterId, index);
            break;
        }

        Json::Value ports;

        if (portHelper->getNumberOfPorts(String(index), ports) < 1)
        {
            TLOG(LL_WARN, "There are no ports associated to Adapter id %d", adapterId);
            continue;
        }

        const Json::Value* portList = AdapterHelper::jsonMember(ports, "indexStrings");

        if (!portList || !portList->isArray())
            continue;

        for (int place = 0; place < (int)portList->size(); place++)
        {
            const Json::Value& portElement = (*portList)[place];

            if (!portElement.isString())
                continue;

            if (lookup && !_mayBeTagOf(*lookup, adapterId, place))
                continue;

            String portIndex(portElement.asCString());
            Json::Value portDetails;

            if (portHelper->getPortDetails(portIndex, portDetails) != 0)
                continue;

            Json::Value optics;
            int ret = portHelper->getOpticsInfo(portIndex, optics);

            if (ret != 0)
            {
                TLOG(LL_WARN, "getOpticsInfo failed for PortIndex =%d Ret = %d", place, ret);
                continue;
            }

            _sfpInfo sfp;
            memset(&sfp, 0, sizeof(sfp));
            _fillSfpInfo(optics, adapterId, place, sfp);

            Instance* instance = getPhysicalConnectorInstance(sfp);

            if (instance)
                result.append(instance);

            if (lookup && lookup->keepMatch(result, result.size() - (instance ? 1 : 0)))
                return;
        }
    }
}

Instance* PhysicalAssetHelper::getPhysicalConnectorInstance(_sfpInfo sfp)
{
    sfp.vendorName[sizeof(sfp.vendorName) - 1] = '\0';
    sfp.vendorPart[sizeof(sfp.vendorPart) - 1] = '\0';
    sfp.serialNumber[sizeof(sfp.serialNumber) - 1] = '\0';
    sfp.tag[sizeof(sfp.tag) - 1] = '\0';
    sfp.extendedId[sizeof(sfp.extendedId) - 1] = '\0';
    sfp.speed[sizeof(sfp.speed) - 1] = '\0';
    sfp.revision[sizeof(sfp.revision) - 1] = '\0';

    VESPERA_PhysicalConnector* pc = create<VESPERA_PhysicalConnector>(true);
    const char* className = classNames[ID_VESPERA_PhysicalConnector];

    pc->CreationClassName.set(className);
    pc->Caption.set(className);
    pc->ElementName.set(className);
    pc->Tag.set(sfp.tag);
    pc->Manufacturer.set(sfp.vendorName);
    pc->PartNumber.set(sfp.vendorPart);
    pc->SerialNumber.set(sfp.serialNumber);
    pc->Model.set(sfp.extendedId);
    pc->ConnectorDescription.set(sfp.extendedId);
    pc->Version.set(sfp.revision);
    pc->Description.set(sfp.speed);

    Array<uint16> type;
    type.append(118);
    pc->ConnectorType.set(type);
    pc->ConnectorGender.set(0);
    pc->ConnectorPinout.set("0");
    pc->NumPhysicalPins.set(0);
    pc->ConnectorLayout.set(1);

    return pc;
}

} // namespace OLMA
