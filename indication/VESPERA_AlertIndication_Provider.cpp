#include "VESPERA_AlertIndication_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_AlertIndication_Provider::VESPERA_AlertIndication_Provider() : _handler(0)
{
}

VESPERA_AlertIndication_Provider::~VESPERA_AlertIndication_Provider()
{
    delete _handler;
}

Enable_Indications_Status VESPERA_AlertIndication_Provider::enable_indications(Indication_Handler<VESPERA_AlertIndication>* handler)
{
    delete _handler;
    _handler = handler;
    return ENABLE_INDICATIONS_OK;
}

Disable_Indications_Status VESPERA_AlertIndication_Provider::disable_indications()
{
    // The null instance tells the adapter that the stream has ended.
    if (_handler)
    {
        _handler->handle(0);
        delete _handler;
        _handler = 0;
    }
    return DISABLE_INDICATIONS_OK;
}

} // namespace OLMA
