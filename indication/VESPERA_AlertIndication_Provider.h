#ifndef _VESPERA_AlertIndication_Provider_h
#define _VESPERA_AlertIndication_Provider_h

#include <atomic>

#include "Provider.h"
#include "Thread.h"
#include "Time.h"
#include "VESPERA_AlertIndication.h"

namespace OLMA
{

// Sends the adapter library's events to the CIM server as
// VESPERA_AlertIndication. While indications are on, the library's thread
// queues alerts (IndicationHelper) and a delivery thread of ours hands them
// to the server's handler, one at a time.
class VESPERA_AlertIndication_Provider
{
public:

    VESPERA_AlertIndication_Provider();

    ~VESPERA_AlertIndication_Provider();

    Load_Status load();

    Unload_Status unload();

    Enable_Indications_Status enable_indications(Indication_Handler<VESPERA_AlertIndication>* handler);

    Disable_Indications_Status disable_indications();

    // The delivery thread.
    static void* deliverIndications(void* provider);

    // The pause after each pass of the delivery thread, which hands on at
    // most one alert a pass.
    static constexpr uint64 DELIVERY_PACE = 20 * Time::MSEC;

private:

    VESPERA_AlertIndication_Provider(const VESPERA_AlertIndication_Provider&);
    VESPERA_AlertIndication_Provider& operator=(const VESPERA_AlertIndication_Provider&);

    Thread deliveryThread;

    // Non-zero while the delivery thread shall run; the only signal it
    // reads.
    std::atomic<sint32> deliveryEnabled;

    // Written only while the delivery thread isn't running.
    Indication_Handler<VESPERA_AlertIndication>* handler;
    bool threadRunning;
};

} // namespace OLMA

#endif // _VESPERA_AlertIndication_Provider_h
