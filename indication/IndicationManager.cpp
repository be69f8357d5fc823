#include "IndicationManager.h"

#include "IndicationHelper.h"
#include "ProviderUtil.h"
#include "log.h"

namespace OLMA
{

IndicationManager gIndicationManagerObj;
IndicationManager* IndicationManager::indMgrObj = 0;

IndicationManager::IndicationManager() :
    helper(IndicationHelper::getIndicationHelperInstance())
{
}

IndicationManager* IndicationManager::getIndicationManager()
{
    if (!indMgrObj)
        indMgrObj = &gIndicationManagerObj;

    return indMgrObj;
}

bool IndicationManager::subscribeForEventNotifications()
{
    if (!ProviderUtil::getDriverStatus())
    {
        TLOG(LL_ERR, "Driver is not installed or there is a trul mismatch. "
            "Will not invoke subscription. ");
        return false;
    }

    return helper->subscribeForEventNotifications();
}

bool IndicationManager::unsubscribeForEventNotifications()
{
    return helper->unsubscribeForEventNotifications();
}

bool IndicationManager::getIndicationObject(VESPERA_AlertIndication** alert)
{
    return helper->getIndicationObject(alert);
}

void IndicationManager::returnIndicationObject(VESPERA_AlertIndication* alert)
{
    helper->returnIndicationObject(alert);
}

} // namespace OLMA
