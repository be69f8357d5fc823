#ifndef _VESPERA_DeviceSAPImplementation_Provider_h
#define _VESPERA_DeviceSAPImplementation_Provider_h

#include "Provider.h"
#include "VESPERA_DeviceSAPImplementation.h"

namespace OLMA
{

// Serves VESPERA_DeviceSAPImplementation: each FC port with its initiator endpoint.
// Enumeration only; the bridge walks the associations.
class VESPERA_DeviceSAPImplementation_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_DeviceSAPImplementation* model, Enum_Instances_Handler<VESPERA_DeviceSAPImplementation>* handler);
};

} // namespace OLMA

#endif // _VESPERA_DeviceSAPImplementation_Provider_h
