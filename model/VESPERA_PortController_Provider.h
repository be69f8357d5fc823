#ifndef _VESPERA_PortController_Provider_h
#define _VESPERA_PortController_Provider_h

#include "Provider.h"
#include "VESPERA_PortController.h"

namespace OLMA
{

// Serves VESPERA_PortController: enumeration only, from FCHBAManager.
class VESPERA_PortController_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_PortController* model, Enum_Instances_Handler<VESPERA_PortController>* handler);
};

} // namespace OLMA

#endif // _VESPERA_PortController_Provider_h
