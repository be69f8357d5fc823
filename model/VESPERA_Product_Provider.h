#ifndef _VESPERA_Product_Provider_h
#define _VESPERA_Product_Provider_h

#include "Provider.h"
#include "VESPERA_Product.h"

namespace OLMA
{

// Serves VESPERA_Product: enumeration only, from FCHBAManager.
class VESPERA_Product_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_Product* model, Enum_Instances_Handler<VESPERA_Product>* handler);
};

} // namespace OLMA

#endif // _VESPERA_Product_Provider_h
