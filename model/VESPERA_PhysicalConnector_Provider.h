#ifndef _VESPERA_PhysicalConnector_Provider_h
#define _VESPERA_PhysicalConnector_Provider_h

#include "Provider.h"
#include "VESPERA_PhysicalConnector.h"

namespace OLMA
{

// Serves VESPERA_PhysicalConnector: enumeration only, from FCHBAManager.
class VESPERA_PhysicalConnector_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_PhysicalConnector* model, Enum_Instances_Handler<VESPERA_PhysicalConnector>* handler);
};

} // namespace OLMA

#endif // _VESPERA_PhysicalConnector_Provider_h
