#ifndef _VESPERA_ElementStatisticalData_Provider_h
#define _VESPERA_ElementStatisticalData_Provider_h

#include "Provider.h"
#include "VESPERA_ElementStatisticalData.h"

namespace OLMA
{

// Serves VESPERA_ElementStatisticalData: each FC port with its statistics. Enumeration
// only; the bridge walks the associations.
class VESPERA_ElementStatisticalData_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ElementStatisticalData* model, Enum_Instances_Handler<VESPERA_ElementStatisticalData>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ElementStatisticalData_Provider_h
