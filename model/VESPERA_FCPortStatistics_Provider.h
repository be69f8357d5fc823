#ifndef _VESPERA_FCPortStatistics_Provider_h
#define _VESPERA_FCPortStatistics_Provider_h

#include "Provider.h"
#include "VESPERA_FCPortStatistics.h"

namespace OLMA
{

// Serves VESPERA_FCPortStatistics: enumeration only, from FCHBAManager.
class VESPERA_FCPortStatistics_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_FCPortStatistics* model, Enum_Instances_Handler<VESPERA_FCPortStatistics>* handler);
};

} // namespace OLMA

#endif // _VESPERA_FCPortStatistics_Provider_h
