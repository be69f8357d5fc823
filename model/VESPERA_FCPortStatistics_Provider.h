#ifndef _VESPERA_FCPortStatistics_Provider_h
#define _VESPERA_FCPortStatistics_Provider_h

#include "Provider.h"
#include "VESPERA_FCPortStatistics.h"

namespace OLMA
{

// Serves VESPERA_FCPortStatistics from FCHBAManager: enumeration, and getInstance by
// looking up the one instance that the keys name.
class VESPERA_FCPortStatistics_Provider
{
public:

    Get_Instance_Status get_instance(const VESPERA_FCPortStatistics* model, VESPERA_FCPortStatistics*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_FCPortStatistics* model, Enum_Instances_Handler<VESPERA_FCPortStatistics>* handler);
};

} // namespace OLMA

#endif // _VESPERA_FCPortStatistics_Provider_h
