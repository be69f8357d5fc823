#ifndef _VESPERA_ElementStatisticalData_Provider_h
#define _VESPERA_ElementStatisticalData_Provider_h

namespace OLMA
{

// Serves VESPERA_ElementStatisticalData. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ElementStatisticalData_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_ElementStatisticalData_Provider_h
