#ifndef _VESPERA_FCPortSystemDevice_Provider_h
#define _VESPERA_FCPortSystemDevice_Provider_h

namespace OLMA
{

// Serves VESPERA_FCPortSystemDevice. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_FCPortSystemDevice_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_FCPortSystemDevice_Provider_h
