#ifndef _VESPERA_ProductElementComponent_Provider_h
#define _VESPERA_ProductElementComponent_Provider_h

namespace OLMA
{

// Serves VESPERA_ProductElementComponent. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ProductElementComponent_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_ProductElementComponent_Provider_h
