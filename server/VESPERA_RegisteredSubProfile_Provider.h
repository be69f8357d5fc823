#ifndef _OLMA_VESPERA_RegisteredSubProfile_Provider_h
#define _OLMA_VESPERA_RegisteredSubProfile_Provider_h

#include "Provider.h"
#include "VESPERA_RegisteredSubProfile.h"

namespace OLMA
{

// Serves VESPERA_RegisteredSubProfile, the subprofiles of the registered
// profiles. Read-only: instances come from ServerManager, and no method does
// anything.
class VESPERA_RegisteredSubProfile_Provider
{
public:

    VESPERA_RegisteredSubProfile_Provider();

    ~VESPERA_RegisteredSubProfile_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_RegisteredSubProfile* model, VESPERA_RegisteredSubProfile*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_RegisteredSubProfile* model, Enum_Instances_Handler<VESPERA_RegisteredSubProfile>* handler);

    Create_Instance_Status create_instance(VESPERA_RegisteredSubProfile* instance);

    Delete_Instance_Status delete_instance(const VESPERA_RegisteredSubProfile* instance);

    Modify_Instance_Status modify_instance(const VESPERA_RegisteredSubProfile* model, const VESPERA_RegisteredSubProfile* instance);

    Invoke_Method_Status CloseConformantInstances(
        const VESPERA_RegisteredSubProfile* self,
        const Property<String>& EnumerationContext,
        Property<uint32>& return_value);

    Invoke_Method_Status OpenConformantInstances(
        const VESPERA_RegisteredSubProfile* self,
        const Property<String>& ResultClass,
        const Property<Array<String> >& IncludedPropertyList,
        const Property<uint32>& OperationTimeout,
        const Property<bool>& ContinueOnError,
        const Property<uint32>& MaxObjectCount,
        Property<String>& EnumerationContext,
        Property<bool>& EndOfSequence,
        Property<Array<uint16> >& InstanceType,
        Property<Array<String> >& InstanceWithPathList,
        Property<uint32>& return_value);

    Invoke_Method_Status PullConformantInstances(
        const VESPERA_RegisteredSubProfile* self,
        Property<String>& EnumerationContext,
        const Property<uint32>& MaxObjectCount,
        Property<bool>& EndOfSequence,
        Property<Array<uint16> >& InstanceType,
        Property<Array<String> >& InstanceWithPathList,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_RegisteredSubProfile_Provider_h
