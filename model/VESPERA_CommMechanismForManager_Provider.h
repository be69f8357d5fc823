#ifndef _VESPERA_CommMechanismForManager_Provider_h
#define _VESPERA_CommMechanismForManager_Provider_h

namespace OLMA
{

// Serves VESPERA_CommMechanismForManager. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_CommMechanismForManager_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_CommMechanismForManager_Provider_h
