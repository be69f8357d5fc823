#ifndef _OLMA_VESPERA_RegisteredProfile_Provider_h
#define _OLMA_VESPERA_RegisteredProfile_Provider_h

#include "Provider.h"
#include "VESPERA_RegisteredProfile.h"

namespace OLMA
{

// Serves VESPERA_RegisteredProfile, the profiles that the module registers.
// Read-only: instances come from ServerManager, and no method does anything.
class VESPERA_RegisteredProfile_Provider
{
public:

    VESPERA_RegisteredProfile_Provider();

    ~VESPERA_RegisteredProfile_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_RegisteredProfile* model, VESPERA_RegisteredProfile*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_RegisteredProfile* model, Enum_Instances_Handler<VESPERA_RegisteredProfile>* handler);

    Create_Instance_Status create_instance(VESPERA_RegisteredProfile* instance);

    Delete_Instance_Status delete_instance(const VESPERA_RegisteredProfile* instance);

    Modify_Instance_Status modify_instance(const VESPERA_RegisteredProfile* model, const VESPERA_RegisteredProfile* instance);

    Invoke_Method_Status CloseConformantInstances(
        const VESPERA_RegisteredProfile* self,
        const Property<String>& EnumerationContext,
        Property<uint32>& return_value);

    Invoke_Method_Status OpenConformantInstances(
        const VESPERA_RegisteredProfile* self,
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
        const VESPERA_RegisteredProfile* self,
        Property<String>& EnumerationContext,
        const Property<uint32>& MaxObjectCount,
        Property<bool>& EndOfSequence,
        Property<Array<uint16> >& InstanceType,
        Property<Array<String> >& InstanceWithPathList,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_RegisteredProfile_Provider_h
