#ifndef _VESPERA_HostedDependency_Provider_h
#define _VESPERA_HostedDependency_Provider_h

#include "Provider.h"
#include "VESPERA_HostedDependency.h"

namespace OLMA
{

// Serves VESPERA_HostedDependency: each FCoE port of a converged adapter with the
// Ethernet port of its place. Enumeration only; the bridge walks the associations.
class VESPERA_HostedDependency_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_HostedDependency* model, Enum_Instances_Handler<VESPERA_HostedDependency>* handler);
};

} // namespace OLMA

#endif // _VESPERA_HostedDependency_Provider_h
