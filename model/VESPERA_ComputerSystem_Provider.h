#ifndef _VESPERA_ComputerSystem_Provider_h
#define _VESPERA_ComputerSystem_Provider_h

#include "Provider.h"
#include "VESPERA_ComputerSystem.h"

namespace OLMA
{

// Serves VESPERA_ComputerSystem: enumeration only, from FCHBAManager.
class VESPERA_ComputerSystem_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ComputerSystem* model, Enum_Instances_Handler<VESPERA_ComputerSystem>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ComputerSystem_Provider_h
