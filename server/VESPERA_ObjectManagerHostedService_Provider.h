#ifndef _VESPERA_ObjectManagerHostedService_Provider_h
#define _VESPERA_ObjectManagerHostedService_Provider_h

#include "Provider.h"
#include "VESPERA_ObjectManagerHostedService.h"

namespace OLMA
{

// Serves VESPERA_ObjectManagerHostedService: the host with the object manager.
// Enumeration only; the bridge walks the associations.
class VESPERA_ObjectManagerHostedService_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ObjectManagerHostedService* model, Enum_Instances_Handler<VESPERA_ObjectManagerHostedService>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ObjectManagerHostedService_Provider_h
