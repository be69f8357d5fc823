#ifndef _VESPERA_ProductPhysicalComponent_Provider_h
#define _VESPERA_ProductPhysicalComponent_Provider_h

#include "Provider.h"
#include "VESPERA_ProductPhysicalComponent.h"

namespace OLMA
{

// Serves VESPERA_ProductPhysicalComponent: each card's product with the card. Enumeration
// only; the bridge walks the associations.
class VESPERA_ProductPhysicalComponent_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ProductPhysicalComponent* model, Enum_Instances_Handler<VESPERA_ProductPhysicalComponent>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ProductPhysicalComponent_Provider_h
