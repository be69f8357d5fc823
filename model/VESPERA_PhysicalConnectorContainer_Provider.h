#ifndef _VESPERA_PhysicalConnectorContainer_Provider_h
#define _VESPERA_PhysicalConnectorContainer_Provider_h

#include "Provider.h"
#include "VESPERA_PhysicalConnectorContainer.h"

namespace OLMA
{

// Serves VESPERA_PhysicalConnectorContainer: each card with the optical connectors of its
// ports. Enumeration only; the bridge walks the associations.
class VESPERA_PhysicalConnectorContainer_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_PhysicalConnectorContainer* model, Enum_Instances_Handler<VESPERA_PhysicalConnectorContainer>* handler);
};

} // namespace OLMA

#endif // _VESPERA_PhysicalConnectorContainer_Provider_h
