// Adapter events come as text from the library's thread: whatever the text,
// IndicationHelper::processEvent must queue an alert or drop the event, and
// neither crash nor leak. The queue is emptied after each event, as the
// delivery thread would.

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "IndicationHelper.h"

using namespace OLMA;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    IndicationHelper* helper = IndicationHelper::getIndicationHelperInstance();
    static bool subscribed = helper->subscribeForEventNotifications();
    if (!subscribed)
        abort();

    std::string text(reinterpret_cast<const char*>(data), size);
    helper->processEvent(text.c_str());

    VESPERA_AlertIndication* alert = nullptr;
    while (helper->getIndicationObject(&alert))
    {
        // What the delivery thread reads of each alert.
        if (alert->SequenceNumber.null || alert->MessageID.null)
            abort();
        unref(alert);
    }
    return 0;
}
