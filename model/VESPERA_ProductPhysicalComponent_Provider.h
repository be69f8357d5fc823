#ifndef _VESPERA_ProductPhysicalComponent_Provider_h
#define _VESPERA_ProductPhysicalComponent_Provider_h

namespace OLMA
{

// Serves VESPERA_ProductPhysicalComponent. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ProductPhysicalComponent_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_ProductPhysicalComponent_Provider_h
