#ifndef _VESPERA_EthernetPort_Provider_h
#define _VESPERA_EthernetPort_Provider_h

#include "Provider.h"
#include "VESPERA_EthernetPort.h"

namespace OLMA
{

// Serves VESPERA_EthernetPort: enumeration only, from FCHBAManager.
class VESPERA_EthernetPort_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_EthernetPort* model, Enum_Instances_Handler<VESPERA_EthernetPort>* handler);
};

} // namespace OLMA

#endif // _VESPERA_EthernetPort_Provider_h
