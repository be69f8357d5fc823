#ifndef _VESPERA_ProductElementComponent_Provider_h
#define _VESPERA_ProductElementComponent_Provider_h

#include "Provider.h"
#include "VESPERA_ProductElementComponent.h"

namespace OLMA
{

// Serves VESPERA_ProductElementComponent: each adapter's product with the adapter.
// Enumeration only; the bridge walks the associations.
class VESPERA_ProductElementComponent_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ProductElementComponent* model, Enum_Instances_Handler<VESPERA_ProductElementComponent>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ProductElementComponent_Provider_h
