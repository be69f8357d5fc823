#include "VESPERA_AlertIndication_Provider.h"

#include "IndicationManager.h"
#include "Time.h"
#include "log.h"

namespace OLMA
{

VESPERA_AlertIndication_Provider::VESPERA_AlertIndication_Provider() :
    deliveryEnabled(0),
    handler(0),
    threadRunning(false)
{
}

VESPERA_AlertIndication_Provider::~VESPERA_AlertIndication_Provider()
{
    // The bridge unloads us first; this is for a provider destroyed
    // without that, whose thread must not outlive it.
    if (threadRunning)
        disable_indications();

    delete handler;
}

Load_Status VESPERA_AlertIndication_Provider::load()
{
    TLOG(LL_DBG, "VESPERA_AlertIndication_Provider::load()");
    return LOAD_OK;
}

Unload_Status VESPERA_AlertIndication_Provider::unload()
{
    TLOG(LL_DBG, "VESPERA_AlertIndication_Provider::unload()");

    if (handler)
        disable_indications();

    return UNLOAD_OK;
}

Enable_Indications_Status VESPERA_AlertIndication_Provider::enable_indications(
    Indication_Handler<VESPERA_AlertIndication>* newHandler)
{
    TLOG(LL_DBG, "Entering: %s", "enable_indications");

    // One thread and one handler at a time: a second enable without a
    // disable between keeps what runs.
    if (threadRunning)
    {
        TLOG(LL_INFO, "Indications are already enabled");
        delete newHandler;
        return ENABLE_INDICATIONS_OK;
    }

    IndicationManager* manager = IndicationManager::getIndicationManager();

    if (!manager->subscribeForEventNotifications())
    {
        TLOG(LL_ERR, "Subscribtion for event notifications FAILED.");
        delete newHandler;
        return ENABLE_INDICATIONS_FAILED;
    }

    handler = newHandler;
    TLOG(LL_INFO, "Subscribtion for event notifications is successful.");

    if (deliveryEnabled.load() == 0)
        deliveryEnabled.fetch_add(1);

    // Started within the server's request, so the thread is attached to
    // the server and can deliver.
    if (Thread::create_joinable(deliveryThread, deliverIndications, this) != 0)
    {
        TLOG(LL_ERR, "Unable to start the thread that delivers indications");
        deliveryEnabled.store(0);
        manager->unsubscribeForEventNotifications();
        delete handler;
        handler = 0;
        return ENABLE_INDICATIONS_FAILED;
    }

    threadRunning = true;
    TLOG(LL_DBG, "Returning: %s", "enable_indications");
    return ENABLE_INDICATIONS_OK;
}

Disable_Indications_Status VESPERA_AlertIndication_Provider::disable_indications()
{
    TLOG(LL_DBG, "Entering: %s", "disable_indications");

    if (deliveryEnabled.load() == 0)
    {
        TLOG(LL_INFO, "No subscription for event notifications happened or successful");
        return DISABLE_INDICATIONS_OK;
    }

    // No new events first; alerts already queued stay for the next enable.
    if (IndicationManager::getIndicationManager()->unsubscribeForEventNotifications())
        TLOG(LL_INFO, "Unsubscribtion for event notifications is successful.");
    else
    {
        TLOG(LL_ERR, "Un-subscribtion for event notifications FAILED.");
        TLOG(LL_INFO, "Continue to stop the thread created for listening to events");
    }

    deliveryEnabled.fetch_sub(1);
    TLOG(LL_INFO, "Stopping the indication thread created.");

    void* result;
    Thread::join(deliveryThread, result);
    threadRunning = false;

    // The end of the stream; the handler goes with it.
    if (handler)
    {
        handler->handle(0);
        delete handler;
        handler = 0;
    }

    TLOG(LL_DBG, "Returning: %s", "disable_indications");
    return DISABLE_INDICATIONS_OK;
}

void* VESPERA_AlertIndication_Provider::deliverIndications(void* arg)
{
    VESPERA_AlertIndication_Provider* self = (VESPERA_AlertIndication_Provider*)arg;
    IndicationManager* manager = IndicationManager::getIndicationManager();

    while (self->deliveryEnabled.load() != 0)
    {
        VESPERA_AlertIndication* alert = 0;

        if (manager->getIndicationObject(&alert))
        {
            // The handler takes the clone. False means that the server's
            // side is being disabled and sent nothing: the alert goes back
            // to the head of the queue, for the next enable.
            if (self->handler->handle(clone(alert)))
            {
                TLOG(LL_INFO, "Delivered indication to the CIM server");
                destroy(alert);
            }
            else
            {
                TLOG(LL_DBG, "Delivery given up while indications go off; "
                    "the alert stays queued");
                manager->returnIndicationObject(alert);
            }
        }

        Time::sleep(DELIVERY_PACE);
    }

    return 0;
}

} // namespace OLMA
