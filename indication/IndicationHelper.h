#ifndef _VSPR_IndicationHelper_h
#define _VSPR_IndicationHelper_h

#include <deque>
#include <map>

#include "Mutex.h"
#include "String.h"
#include "VESPERA_AlertIndication.h"

namespace OLMA
{

// Turns the adapter library's events into VESPERA_AlertIndication and keeps
// them for the delivery thread. Three kinds of thread meet here: the CIM
// server's (subscribe and unsubscribe), the library's (processEvent) and the
// delivery thread of the provider (getIndicationObject).
//
// An event's meaning lies in its category and id; the catalogue turns the
// pair (the event key: category in the upper 16 bits, id in the lower) into
// a cause, a recommended action and a message id.
class IndicationHelper
{
public:

    // Alerts waiting beyond this many are dropped, oldest first: delivery
    // runs at 50 a second at most, and an event storm must not eat the CIM
    // server's memory.
    enum { MAX_QUEUED_ALERTS = 4096 };

    IndicationHelper();

    // Frees the alerts that were never delivered.
    ~IndicationHelper();

    static IndicationHelper* getIndicationHelperInstance();

    // The catalogue.
    void initEventDetailsMaps();
    void clearEventDetailsMaps();
    String getEventCauseById(int key);
    String getEventActionById(int key);
    String getMessageIDById(int key);

    // One event text of the library: queued as an alert (true), valid but
    // not delivered (true), or dropped (false) with a log line.
    bool processEvent(const char* text);

    // An event's severity (1 to 4) as a CIM PerceivedSeverity.
    static uint16 getPerceivedSeverity(int severity);
    static uint16 getExactPerceivedSeverity(int severity);

    // With the library: the catalogue is filled before the callback goes
    // in, and emptied only after it is out and no event is in flight.
    bool subscribeForEventNotifications();
    bool unsubscribeForEventNotifications();
    bool registerForEvents();
    bool deRegisterForEvents();

    // Numbers the alert and queues it; takes over its reference.
    bool updateIndicationObjects(VESPERA_AlertIndication* alert);

    // The oldest alert and its reference, or false if there is none.
    bool getIndicationObject(VESPERA_AlertIndication** alert);

    // An alert that getIndicationObject gave and that could not be
    // delivered goes back to the head of the queue, with its number.
    void returnIndicationObject(VESPERA_AlertIndication* alert);

    static IndicationHelper* indHelperObj;

private:

    IndicationHelper(const IndicationHelper&);
    IndicationHelper& operator=(const IndicationHelper&);

    bool _processEvent(const char* text);
    void _dropOldest();

    std::map<int, String> causeMap;
    std::map<int, String> actionMap;
    std::map<int, String> messageIdMap;

    // Held by processEvent from start to end, and by whatever changes the
    // catalogue or acceptingEvents, so that no event reads the catalogue
    // while it changes. Never held while the library is called from here
    // but within processEvent.
    Mutex eventLock;
    bool acceptingEvents;
    bool callbackSet;

    std::deque<VESPERA_AlertIndication*> indicationQueue;
    Mutex queueLock;
    uint32 droppedAlerts;
};

extern IndicationHelper gIndicationHelperObj;

// The callback that the library calls with each event, on its own thread.
void providerHandleEvent(const char* text);

// Full object paths ("//<host>/root/vespera:<model path>") of the elements
// an alert can point at.
String getComputerSystemObjectPath();
String getFCPortObjectPath(String deviceId);
String getEthernetPortObjectPath(String deviceId);
String getAgentServiceObjectPath();

} // namespace OLMA

#endif
