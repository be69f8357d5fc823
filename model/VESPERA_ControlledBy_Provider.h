#ifndef _VESPERA_ControlledBy_Provider_h
#define _VESPERA_ControlledBy_Provider_h

namespace OLMA
{

// Serves VESPERA_ControlledBy. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ControlledBy_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_ControlledBy_Provider_h
