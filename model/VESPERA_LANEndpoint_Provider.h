#ifndef _VESPERA_LANEndpoint_Provider_h
#define _VESPERA_LANEndpoint_Provider_h

#include "Provider.h"
#include "VESPERA_LANEndpoint.h"

namespace OLMA
{

// Serves VESPERA_LANEndpoint: enumeration only, from FCHBAManager.
class VESPERA_LANEndpoint_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_LANEndpoint* model, Enum_Instances_Handler<VESPERA_LANEndpoint>* handler);
};

} // namespace OLMA

#endif // _VESPERA_LANEndpoint_Provider_h
