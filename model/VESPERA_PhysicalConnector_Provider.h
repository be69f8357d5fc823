#ifndef _VESPERA_PhysicalConnector_Provider_h
#define _VESPERA_PhysicalConnector_Provider_h

#include "Provider.h"
#include "VESPERA_PhysicalConnector.h"

namespace OLMA
{

// Serves VESPERA_PhysicalConnector from FCHBAManager: enumeration, and getInstance by
// looking up the one instance that the keys name.
class VESPERA_PhysicalConnector_Provider
{
public:

    Get_Instance_Status get_instance(const VESPERA_PhysicalConnector* model, VESPERA_PhysicalConnector*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_PhysicalConnector* model, Enum_Instances_Handler<VESPERA_PhysicalConnector>* handler);
};

} // namespace OLMA

#endif // _VESPERA_PhysicalConnector_Provider_h
