#ifndef _VESPERA_FCPort_Provider_h
#define _VESPERA_FCPort_Provider_h

#include "Provider.h"
#include "VESPERA_FCPort.h"

namespace OLMA
{

// Serves VESPERA_FCPort: enumeration only, from FCHBAManager.
class VESPERA_FCPort_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_FCPort* model, Enum_Instances_Handler<VESPERA_FCPort>* handler);
};

} // namespace OLMA

#endif // _VESPERA_FCPort_Provider_h
