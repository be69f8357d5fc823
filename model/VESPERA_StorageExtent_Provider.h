#ifndef _VESPERA_StorageExtent_Provider_h
#define _VESPERA_StorageExtent_Provider_h

#include "Provider.h"
#include "VESPERA_StorageExtent.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_StorageExtent: enumeration only, from HDRManager.
class VESPERA_StorageExtent_Provider
{
public:

    VESPERA_StorageExtent_Provider();

    ~VESPERA_StorageExtent_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_StorageExtent* model, VESPERA_StorageExtent*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_StorageExtent* model, Enum_Instances_Handler<VESPERA_StorageExtent>* handler);

    Create_Instance_Status create_instance(VESPERA_StorageExtent* instance);

    Delete_Instance_Status delete_instance(const VESPERA_StorageExtent* instance);

    Modify_Instance_Status modify_instance(const VESPERA_StorageExtent* model, const VESPERA_StorageExtent* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_StorageExtent* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status SetPowerState(
        const VESPERA_StorageExtent* self,
        const Property<uint16>& PowerState,
        const Property<Datetime>& Time,
        Property<uint32>& return_value);

    Invoke_Method_Status Reset(
        const VESPERA_StorageExtent* self,
        Property<uint32>& return_value);

    Invoke_Method_Status EnableDevice(
        const VESPERA_StorageExtent* self,
        const Property<bool>& Enabled,
        Property<uint32>& return_value);

    Invoke_Method_Status OnlineDevice(
        const VESPERA_StorageExtent* self,
        const Property<bool>& Online,
        Property<uint32>& return_value);

    Invoke_Method_Status QuiesceDevice(
        const VESPERA_StorageExtent* self,
        const Property<bool>& Quiesce,
        Property<uint32>& return_value);

    Invoke_Method_Status SaveProperties(
        const VESPERA_StorageExtent* self,
        Property<uint32>& return_value);

    Invoke_Method_Status RestoreProperties(
        const VESPERA_StorageExtent* self,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_StorageExtent_Provider_h
