#ifndef _VESPERA_Realizes_Provider_h
#define _VESPERA_Realizes_Provider_h

#include "Provider.h"
#include "VESPERA_Realizes.h"

namespace OLMA
{

// Serves VESPERA_Realizes: each card with the adapter it realizes. Enumeration only; the
// bridge walks the associations.
class VESPERA_Realizes_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_Realizes* model, Enum_Instances_Handler<VESPERA_Realizes>* handler);
};

} // namespace OLMA

#endif // _VESPERA_Realizes_Provider_h
