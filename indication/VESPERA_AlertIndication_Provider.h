#ifndef _VESPERA_AlertIndication_Provider_h
#define _VESPERA_AlertIndication_Provider_h

#include "Provider.h"
#include "VESPERA_AlertIndication.h"

namespace OLMA
{

// Sends VESPERA_AlertIndication to the CIM server. Until events are turned into alerts it
// sends none; it only keeps the handler between enable and disable.
class VESPERA_AlertIndication_Provider
{
public:

    VESPERA_AlertIndication_Provider();

    ~VESPERA_AlertIndication_Provider();

    Enable_Indications_Status enable_indications(Indication_Handler<VESPERA_AlertIndication>* handler);

    Disable_Indications_Status disable_indications();

private:

    Indication_Handler<VESPERA_AlertIndication>* _handler;
};

} // namespace OLMA

#endif // _VESPERA_AlertIndication_Provider_h
