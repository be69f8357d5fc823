#include "IndicationHelper.h"

#include <stdint.h>
#include <stdio.h>
#include <string.h>

#include <exception>

#include "CIMProviderTruj.h"
#include "Datetime.h"
#include "ProviderTypes.h"
#include "ProviderUtil.h"
#include "VESPERA_AgentService.h"
#include "VESPERA_ComputerSystem.h"
#include "VESPERA_EthernetPort.h"
#include "VESPERA_FCPort.h"
#include "dtruj.h"
#include "log.h"

namespace OLMA
{

IndicationHelper gIndicationHelperObj;
IndicationHelper* IndicationHelper::indHelperObj = 0;

//------------------------------------------------------------------------------
// The catalogue
//------------------------------------------------------------------------------

namespace
{

struct Catalogue_Row
{
    int key;
    const char* prefix;   // of the message id, followed by number
    int number;
    const char* cause;
    const char* action;
};

const char NO_ACTION[] = "No action required.";
const char CHECK_CONFIG[] = "Check switch and HBA configuration.";

// Two rows are messages of the DMTF registry, and carry its ids.
const Catalogue_Row catalogue[] =
{
    { 0x20001, "VSPR", 0x20001, "Base port logged into Fabric.", NO_ACTION },
    { 0x20002, "VSPR", 0x20002, "Base port logged out of Fabric.", NO_ACTION },
    { 0x20003, "VSPR", 0x20003, "", "No action required. Not supported" },
    { 0x20004, "VSPR", 0x20004, "User plugged in a SFP.", NO_ACTION },
    { 0x20005, "VSPR", 0x20005, "SFP removed.", "Check whether SFP is inserted properly." },
    { 0x20006, "VSPR", 0x20006,
      "A POM is a Pluggable Optical Module inserted into a Small Form-Factor Pluggable "
      "(SFP) socket. Event is triggered if there is a change of current value against "
      "threshold of operational characteristics (temperature, voltage and rx/tx power) "
      "of SFP.",
      "If POM level is not normal please check the SFP." },
    { 0x20007, "VSPR", 0x20007, "Base port enabled by user command.", NO_ACTION },
    { 0x20008, "VSPR", 0x20008, "Base port disabled by user command.", NO_ACTION },
    { 0x20009, "VSPR", 0x20009, "Authentication successful.", NO_ACTION },
    { 0x2000A, "VSPR", 0x2000A, "Authentication failure.",
      "Mismatch of FC-SP configuration between switch and HBA. Also, check the secret." },
    { 0x2000B, "VSPR", 0x2000B, "Base port lost connection with fabric.",
      "Check switch and HBA configuration. Also, check SFP and cable connection." },
    { 0x2000C, "VSPR", 0x2000C, "QOS negotiation failed.", CHECK_CONFIG },
    { 0x2000D, "VSPR", 0x2000D, "Fabric WWN changed.", CHECK_CONFIG },
    { 0x2000E, "VSPR", 0x2000E, "Can not read SFP registers.", "Recommend to replace the SFP." },
    { 0x2000F, "VSPR", 0x2000F, "SFP is not supported.", "Recommend to use supported SFP." },
    { 0x80001, "VSPR", 0x80001, "Authentication enabled by user command.", NO_ACTION },
    { 0x80002, "VSPR", 0x80002, "Authentication disabled by user command.", NO_ACTION },
    { 0xA0001, "VSPR", 0xA0001, "Base port ethernet link is up.", NO_ACTION },
    { 0xA0002, "VSPR", 0xA0002, "Base port ethernet link is down.", NO_ACTION },
    { 0xA0003, "PLAT", 260, "Base port ethernet interface is enabled.", NO_ACTION },
    { 0xA0004, "PLAT", 261, "Base port ethernet interface is disabled.", NO_ACTION },
};

String lookUp(const std::map<int, String>& map, int key)
{
    std::map<int, String>::const_iterator i = map.find(key);
    return i == map.end() ? String("Unknown") : i->second;
}

} // namespace

void IndicationHelper::initEventDetailsMaps()
{
    for (const Catalogue_Row& row : catalogue)
    {
        char id[16];
        snprintf(id, sizeof(id), "%s%d", row.prefix, row.number);
        causeMap[row.key] = String(row.cause);
        actionMap[row.key] = String(row.action);
        messageIdMap[row.key] = String(id);
    }
}

void IndicationHelper::clearEventDetailsMaps()
{
    causeMap.clear();
    actionMap.clear();
}

String IndicationHelper::getEventCauseById(int key)
{
    return lookUp(causeMap, key);
}

String IndicationHelper::getEventActionById(int key)
{
    return lookUp(actionMap, key);
}

String IndicationHelper::getMessageIDById(int key)
{
    return lookUp(messageIdMap, key);
}

//------------------------------------------------------------------------------
// Object paths
//------------------------------------------------------------------------------

namespace
{

String hostString()
{
    char host[255];
    memset(host, 0, sizeof(host));
    ProviderUtil::getProviderUtil()->getHostInfo(host, sizeof(host) - 1);
    return String(host);
}

// Takes the instance: its model path, under this host and namespace.
String fullPath(Instance* instance)
{
    String model;
    int rc = instance_to_model_path(instance, model);
    destroy(instance);

    if (rc != 0)
    {
        TLOG(LL_ERR, "Unable to make the object path of an alerting element");
        return String();
    }

    return ProviderUtil::getProviderUtil()->updateNamespacePath(model);
}

template<class PORT>
String portPath(classId_t id, const String& deviceId)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    PORT* port = create<PORT>(false);
    port->SystemCreationClassName.set(util->getClassName(ID_VESPERA_ComputerSystem));
    port->CreationClassName.set(util->getClassName(id));
    port->SystemName.set(hostString());
    port->DeviceID.set(deviceId);
    return fullPath(port);
}

} // namespace

String getComputerSystemObjectPath()
{
    VESPERA_ComputerSystem* cs = create<VESPERA_ComputerSystem>(false);
    cs->CreationClassName.set(
        ProviderUtil::getProviderUtil()->getClassName(ID_VESPERA_ComputerSystem));
    cs->Name.set(hostString());
    return fullPath(cs);
}

String getFCPortObjectPath(String deviceId)
{
    return portPath<VESPERA_FCPort>(ID_VESPERA_FCPort, deviceId);
}

String getEthernetPortObjectPath(String deviceId)
{
    return portPath<VESPERA_EthernetPort>(ID_VESPERA_EthernetPort, deviceId);
}

String getAgentServiceObjectPath()
{
    VESPERA_AgentService* service = create<VESPERA_AgentService>(false);
    service->Name.set(String("Vespera Agent Service Provider"));
    return fullPath(service);
}

//------------------------------------------------------------------------------
// Events
//------------------------------------------------------------------------------

IndicationHelper::IndicationHelper() :
    eventLock(true),
    acceptingEvents(false),
    callbackSet(false),
    queueLock(true),
    droppedAlerts(0)
{
}

IndicationHelper::~IndicationHelper()
{
    // Unloaded while still subscribed (a server that never disabled us):
    // the library must not call into a module that is going away.
    if (callbackSet)
    {
        try
        {
            libRegisterEventProcessingCb(0);
        }
        catch (...)
        {
        }
    }

    for (VESPERA_AlertIndication* alert : indicationQueue)
        destroy(alert);
}

IndicationHelper* IndicationHelper::getIndicationHelperInstance()
{
    if (!indHelperObj)
        indHelperObj = &gIndicationHelperObj;

    return indHelperObj;
}

uint16 IndicationHelper::getPerceivedSeverity(int severity)
{
    switch (severity)
    {
        case 1:
        case 2:
            return 6;
        case 3:
            return 3;
        case 4:
            return 2;
    }

    TLOG(LL_WARN, "Received a un-expected severity value: %d", severity);
    return 0;
}

uint16 IndicationHelper::getExactPerceivedSeverity(int severity)
{
    switch (severity)
    {
        case 1:
            return 6;
        case 2:
            return 5;
        case 3:
            return 3;
        case 4:
            return 2;
    }

    TLOG(LL_WARN, "Received a un-expected severity value: %d", severity);
    return 0;
}

void providerHandleEvent(const char* text)
{
    // This runs on the library's thread: nothing may be thrown back at it.
    try
    {
        IndicationHelper::getIndicationHelperInstance()->processEvent(text);
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "An event was dropped: %s", e.what());
    }
    catch (...)
    {
        TLOG(LL_ERR, "An event was dropped: unknown exception");
    }
}

bool IndicationHelper::processEvent(const char* text)
{
    TLOG(LL_DBG, "Entering: %s", "processEvent");
    Auto_Mutex guard(eventLock);

    // Indications are off, or going off: the catalogue may be empty.
    if (!acceptingEvents)
    {
        TLOG(LL_INFO, "An event arrived while indications are off; dropped");
        return false;
    }

    bool result = _processEvent(text);
    TLOG(LL_DBG, "Returning: %s", "processEvent");
    return result;
}

namespace
{

const char* const INT_MEMBERS[] = { "eventCategory", "eventId", "eventSeverity" };
const char* const TEXT_MEMBERS[] = { "portIndexString", "basePortWWN", "eventMsg",
    "eventIdValue", "pomLevel", "fWwn", "cee_state" };

// Every member that is read has its type, or the event is refused whole: a
// number where a text belongs says the sender and we disagree on the event.
bool membersHaveTheirTypes(const Json::Value& event)
{
    for (const char* name : INT_MEMBERS)
        if (event.isMember(name) && !event[name].isInt())
        {
            TLOG(LL_WARN, "%s of the event is not an integer. Return error", name);
            return false;
        }

    for (const char* name : TEXT_MEMBERS)
        if (event.isMember(name) && !event[name].isString())
        {
            TLOG(LL_WARN, "%s of the event is not a string. Return error", name);
            return false;
        }

    return true;
}

String text(const Json::Value& event, const char* name)
{
    return event.isMember(name) ? String(event[name].asCString()) : String();
}

// An alert that isn't queued goes when processing ends, however it ends.
struct Alert_Holder
{
    VESPERA_AlertIndication* alert;
    ~Alert_Holder() { destroyer(alert); }
    VESPERA_AlertIndication* release()
    {
        VESPERA_AlertIndication* a = alert;
        alert = 0;
        return a;
    }
};

} // namespace

bool IndicationHelper::_processEvent(const char* eventText)
{
    Json::Value event;
    Json::Reader reader;

    if (!eventText || !reader.parse(eventText, event, true))
    {
        TLOG(LL_WARN, "Unable to parse json string to object. Return error");
        return false;
    }

    if (!event.isObject())
    {
        TLOG(LL_WARN, "The event is not a JSON object. Return error");
        return false;
    }

    if (!event.isMember("eventCategory"))
    {
        TLOG(LL_WARN, "eventCategory is a must in the eventObject. Return error");
        return false;
    }

    if (!event.isMember("eventId"))
    {
        TLOG(LL_WARN, "eventId is a must in the eventObject. Return error");
        return false;
    }

    if (!membersHaveTheirTypes(event))
        return false;

    const int category = event["eventCategory"].asInt();
    const int eventId = event["eventId"].asInt();
    String portIndexString = text(event, "portIndexString");
    String basePortWWN = text(event, "basePortWWN");
    String eventMsg = text(event, "eventMsg");
    String eventIdValue = text(event, "eventIdValue");

    if (strncmp(eventIdValue.c_str(), "TRU_", 4) != 0)
        eventIdValue = String();

    const int severity = event.isMember("eventSeverity") ? event["eventSeverity"].asInt() : 0;

    ProviderUtil* util = ProviderUtil::getProviderUtil();
    String host = hostString();

    Alert_Holder holder = { create<VESPERA_AlertIndication>(true) };
    VESPERA_AlertIndication* alert = holder.alert;

    alert->AlertingElementFormat.set(2);
    alert->SystemCreationClassName.set(util->getClassName(ID_VESPERA_ComputerSystem));
    alert->SystemName.set(host);
    alert->ProviderName.set(String("vsprprovider"));
    alert->EventTime.set(Datetime::now());
    alert->IndicationTime.set(Datetime::now());
    alert->OwningEntity.set(String("VESPERA"));
    alert->AlertType.set(1);
    alert->ProbableCause.set(1);
    alert->IndicationIdentifier.set(eventIdValue);
    alert->EventID.set(eventIdValue);
    alert->PerceivedSeverity.set(getPerceivedSeverity(severity));
    alert->Message.set(eventMsg);

    TLOG(LL_WARN, "Before event category switch : %d", category);
    TLOG(LL_WARN, "Event ID  : %d", eventId);

    bool deliver = true;
    bool supported = true;
    bool dmtfForm = false;
    int key = 0;
    const char* name = 0;
    String element;
    Array<String> arguments;

    // Categories 3 to 5 and 9 name the base port by its WWN, the others by
    // the port's own address.
    switch (category)
    {
        case 2:
            key = (category << 16) | eventId;
            element = getFCPortObjectPath(portIndexString);
            name = "Port";

            if (eventId < 1 || eventId > 15 || eventId == 3)
            {
                TLOG(LL_WARN, "Unsupported event-port is triggered.");
                deliver = supported = false;
            }
            else if (eventId == 6)
            {
                if (event.isMember("pomLevel"))
                    arguments.append(text(event, "pomLevel"));
                arguments.append(portIndexString);
            }
            else if (eventId == 13)
            {
                arguments.append(portIndexString);
                if (event.isMember("fWwn"))
                    arguments.append(text(event, "fWwn"));
            }
            else
                arguments.append(portIndexString);
            break;

        case 3:
            key = (category << 16) | eventId;
            element = getFCPortObjectPath(ProviderUtil::eraseColonsFromIndex(basePortWWN));
            name = "Lport";

            if (eventId == 1 || eventId == 2)
                alert->PerceivedSeverity.set(2);
            else
            {
                TLOG(LL_WARN, "Not supported event is triggered.");
                deliver = supported = false;
            }
            break;

        case 4:
        case 5:
            key = (category << 16) | eventId;
            element = getFCPortObjectPath(ProviderUtil::eraseColonsFromIndex(basePortWWN));
            name = category == 4 ? "Rport" : "ITNIM";

            // Valid events that this provider leaves to others.
            TLOG(LL_WARN, "Non supported event by regular provider is triggered.");
            deliver = false;

            if (eventId < 1 || eventId > (category == 4 ? 5 : 3))
                supported = false;
            break;

        case 8:
            key = (category << 16) | eventId;
            element = getFCPortObjectPath(portIndexString);
            name = "Audit";

            if (eventId == 1 || eventId == 2)
                arguments.append(portIndexString);
            else
            {
                TLOG(LL_WARN, "unsupported eventr-audit is triggered.");
                deliver = supported = false;
            }
            break;

        case 9:
            key = (category << 16) | eventId;
            element = getFCPortObjectPath(ProviderUtil::eraseColonsFromIndex(basePortWWN));
            name = "IOC";
            deliver = false;

            if (eventId < 1 || eventId > 9)
            {
                TLOG(LL_WARN, "Not supported event is triggered.");
                supported = false;
            }
            break;

        case 10:
            key = (category << 16) | eventId;
            element = getEthernetPortObjectPath(portIndexString);
            name = "EthPort";

            if (eventId == 1)
            {
                if (event.isMember("cee_state"))
                    arguments.append(text(event, "cee_state"));
            }
            else if (eventId == 2)
            {
                arguments.append(portIndexString);
                alert->PerceivedSeverity.set(6);
            }
            else if (eventId == 3 || eventId == 4)
            {
                // The messages of the DMTF registry, with the device's name.
                dmtfForm = true;
                String device = util->getEthDeviceNameByMAC(portIndexString);
                char message[256];
                snprintf(message, sizeof(message),
                    eventId == 3 ? "The network port %s has been enabled"
                                 : "The network port %s has been disabled",
                    device.c_str());
                alert->Message.set(String(message));
                alert->OwningEntity.set(String("DMTF"));
                alert->AlertType.set(2);
                alert->PerceivedSeverity.set(eventId == 3 ? 2 : 3);
                arguments.append(device);
                arguments.append(getComputerSystemObjectPath());
            }
            else
            {
                TLOG(LL_WARN, "Not supported event is triggered.");
                deliver = supported = false;
            }
            break;

        case 1:
        case 6:
        case 7:
        case 11:
        case 12:
            deliver = supported = false;
            break;

        default:
            // Categories the library may add later: delivered as they are,
            // pointing at nothing, with "Unknown" from the catalogue.
            break;
    }

    if (name)
    {
        alert->AlertingManagedElement.set(element);
        alert->Category.set(String(name));
        alert->OtherAlertType.set(dmtfForm ? String() : String(name));
    }

    String cause = getEventCauseById(key);
    alert->Description.set(cause);
    alert->ProbableCauseDescription.set(cause);
    Array<String> actions;
    actions.append(getEventActionById(key));
    alert->RecommendedActions.set(actions);
    String messageId = getMessageIDById(key);
    alert->MessageID.set(messageId);
    TLOG(LL_INFO, "Message ID = %s", messageId.c_str());
    alert->MessageArguments.set(arguments);

    if (deliver)
        return updateIndicationObjects(holder.release());

    if (supported)
        return true;

    TLOG(LL_WARN, "Invoked with a unsporrted or invalid event");
    return false;
}

//------------------------------------------------------------------------------
// Subscription with the library
//------------------------------------------------------------------------------

namespace
{

// Calls an entry and reports any exception, in the three ways the library
// can throw; false if it threw.
template<class CALL>
bool callLibrary(const char* name, CALL call)
{
    try
    {
        call();
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

    return false;
}

} // namespace

bool IndicationHelper::subscribeForEventNotifications()
{
    TLOG(LL_DBG, "Entering: %s", "subscribeForEventNotifications");

    // Everything the callback reads is ready before it can be called.
    {
        Auto_Mutex guard(eventLock);
        initEventDetailsMaps();
        acceptingEvents = true;
    }

    bool ok = registerForEvents();

    if (!ok)
    {
        Auto_Mutex guard(eventLock);
        acceptingEvents = false;
        clearEventDetailsMaps();
    }

    TLOG(LL_DBG, "Returning: %s", "subscribeForEventNotifications");
    return ok;
}

bool IndicationHelper::unsubscribeForEventNotifications()
{
    TLOG(LL_DBG, "Entering: %s", "unsubscribeForEventNotifications");

    bool ok = deRegisterForEvents();

    // Waits for an event still in processEvent, should the library still
    // be delivering one; any that comes later is dropped.
    {
        Auto_Mutex guard(eventLock);
        acceptingEvents = false;
        clearEventDetailsMaps();
    }

    TLOG(LL_DBG, "Returning: %s", "unsubscribeForEventNotifications");
    return ok;
}

bool IndicationHelper::registerForEvents()
{
    Json::Value request(Json::objectValue);
    request["dropOldEvents"] = true;
    Json::Value reply;

    if (!callLibrary("libRegisterForEvents", [&] { reply = libRegisterForEvents(request); }))
        return false;

    if (!ProviderUtil::isValidJsonResponse(reply))
    {
        TLOG(LL_ERR, "libRegisterForEvents returns NULL response or has error");
        return false;
    }

    if (!callLibrary("libRegisterEventProcessingCb",
            [] { libRegisterEventProcessingCb(providerHandleEvent); }))
    {
        callLibrary("libUnRegisterForEvents", [] { libUnRegisterForEvents(Json::Value()); });
        return false;
    }

    callbackSet = true;
    return true;
}

bool IndicationHelper::deRegisterForEvents()
{
    // The callback goes first, so that nothing is handed to us while the
    // library winds down.
    callLibrary("libRegisterEventProcessingCb", [] { libRegisterEventProcessingCb(0); });
    callbackSet = false;

    Json::Value reply;

    if (!callLibrary("libUnRegisterForEvents",
            [&] { reply = libUnRegisterForEvents(Json::Value()); }))
        return false;

    return ProviderUtil::isValidJsonResponse(reply);
}

//------------------------------------------------------------------------------
// The queue
//------------------------------------------------------------------------------

bool IndicationHelper::updateIndicationObjects(VESPERA_AlertIndication* alert)
{
    Auto_Mutex guard(queueLock);

    // Wraps to 1 rather than overflow, after 2^31 - 1 alerts.
    static sint32 evtSeqId = 0;
    evtSeqId = evtSeqId == INT32_MAX ? 1 : evtSeqId + 1;
    alert->SequenceNumber.set(evtSeqId);

    if (indicationQueue.size() >= MAX_QUEUED_ALERTS)
        _dropOldest();

    indicationQueue.push_back(alert);
    return true;
}

bool IndicationHelper::getIndicationObject(VESPERA_AlertIndication** alert)
{
    Auto_Mutex guard(queueLock);

    if (indicationQueue.empty())
        return false;

    *alert = indicationQueue.front();
    indicationQueue.pop_front();
    return true;
}

void IndicationHelper::returnIndicationObject(VESPERA_AlertIndication* alert)
{
    Auto_Mutex guard(queueLock);
    indicationQueue.push_front(alert);

    if (indicationQueue.size() > MAX_QUEUED_ALERTS)
        _dropOldest();
}

// Under queueLock.
void IndicationHelper::_dropOldest()
{
    VESPERA_AlertIndication* oldest = indicationQueue.front();
    indicationQueue.pop_front();
    droppedAlerts++;

    TLOG(LL_WARN, "Alert queue full (%d alerts): dropped the oldest, SequenceNumber %lld; "
        "%u dropped so far", (int)MAX_QUEUED_ALERTS, (long long)oldest->SequenceNumber.value,
        droppedAlerts);

    destroy(oldest);
}

} // namespace OLMA
