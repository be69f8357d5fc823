#ifndef _VSPR_IndicationManager_h
#define _VSPR_IndicationManager_h

#include "VESPERA_AlertIndication.h"

namespace OLMA
{

class IndicationHelper;

// What the alert provider sees of the indication machinery: the
// subscription with the adapter library and the queue of alerts.
class IndicationManager
{
public:

    IndicationManager();

    static IndicationManager* getIndicationManager();

    // Refused without a working driver; otherwise the helper's.
    bool subscribeForEventNotifications();
    bool unsubscribeForEventNotifications();

    bool getIndicationObject(VESPERA_AlertIndication** alert);
    void returnIndicationObject(VESPERA_AlertIndication* alert);

    static IndicationManager* indMgrObj;

private:

    IndicationManager(const IndicationManager&);
    IndicationManager& operator=(const IndicationManager&);

    IndicationHelper* helper;
};

extern IndicationManager gIndicationManagerObj;

} // namespace OLMA

#endif
