#ifndef _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h
#define _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h

#include "Provider.h"
#include "VESPERA_SCSIInitiatorTargetLogicalUnitPath.h"

namespace OLMA
{

// Serves VESPERA_SCSIInitiatorTargetLogicalUnitPath. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider
{
public:

    VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider();

    ~VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_SCSIInitiatorTargetLogicalUnitPath* model, VESPERA_SCSIInitiatorTargetLogicalUnitPath*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_SCSIInitiatorTargetLogicalUnitPath* model, Enum_Instances_Handler<VESPERA_SCSIInitiatorTargetLogicalUnitPath>* handler);

    Create_Instance_Status create_instance(VESPERA_SCSIInitiatorTargetLogicalUnitPath* instance);

    Delete_Instance_Status delete_instance(const VESPERA_SCSIInitiatorTargetLogicalUnitPath* instance);

    Modify_Instance_Status modify_instance(const VESPERA_SCSIInitiatorTargetLogicalUnitPath* model, const VESPERA_SCSIInitiatorTargetLogicalUnitPath* instance);

    Enum_Associator_Names_Status enum_associator_names(const Instance* instance,
        const String& result_class, const String& role, const String& result_role,
        Enum_Associator_Names_Handler<Instance>* handler);

    Enum_Associators_Status enum_associators(const Instance* instance,
        const String& result_class, const String& role, const String& result_role,
        Enum_Associators_Handler<Instance>* handler);

    Enum_References_Status enum_references(const Instance* instance,
        const VESPERA_SCSIInitiatorTargetLogicalUnitPath* model, const String& role, Enum_References_Handler<VESPERA_SCSIInitiatorTargetLogicalUnitPath>* handler);
};

} // namespace OLMA

#endif // _VESPERA_SCSIInitiatorTargetLogicalUnitPath_Provider_h
