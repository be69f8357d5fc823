#ifndef _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h
#define _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h

#include "Provider.h"
#include "VESPERA_SCSIInitiatorTargetLogicalUnitPath.h"

namespace OLMA
{

// Serves VESPERA_SCSIInitiatorTargetLogicalUnitPath: each initiator, target and logical
// unit that lie on one path. The bridge walks the associations for names and
// references; associators come from here, whole, from the one enumeration:
// fetching each unit again through the server would cost, per unit, a walk
// of the units before it on its port (their names depend on each other), so
// an initiator's units would cost the square of their number.
class VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_SCSIInitiatorTargetLogicalUnitPath* model, Enum_Instances_Handler<VESPERA_SCSIInitiatorTargetLogicalUnitPath>* handler);

    Enum_Associators_Status enum_associators(const Instance* instance,
        const String& result_class, const String& role, const String& result_role,
        Enum_Associators_Handler<Instance>* handler);
};

} // namespace OLMA

#endif // _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h
