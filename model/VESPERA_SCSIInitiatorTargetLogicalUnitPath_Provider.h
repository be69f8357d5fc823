#ifndef _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h
#define _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h

#include "Provider.h"
#include "VESPERA_SCSIInitiatorTargetLogicalUnitPath.h"

namespace OLMA
{

// Serves VESPERA_SCSIInitiatorTargetLogicalUnitPath: each initiator, target and logical
// unit that lie on one path. Enumeration only; the bridge walks the associations.
class VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_SCSIInitiatorTargetLogicalUnitPath* model, Enum_Instances_Handler<VESPERA_SCSIInitiatorTargetLogicalUnitPath>* handler);
};

} // namespace OLMA

#endif // _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h
