#ifndef _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h
#define _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h

namespace OLMA
{

// Serves VESPERA_SCSIInitiatorTargetLogicalUnitPath. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h
