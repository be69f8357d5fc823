#ifndef _VESPERA_LogicalDisk_Provider_h
#define _VESPERA_LogicalDisk_Provider_h

#include "Provider.h"
#include "VESPERA_LogicalDisk.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_LogicalDisk: enumeration only, from HDRManager.
class VESPERA_LogicalDisk_Provider
{
public:

    VESPERA_LogicalDisk_Provider();

    ~VESPERA_LogicalDisk_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_LogicalDisk* model, VESPERA_LogicalDisk*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_LogicalDisk* model, Enum_Instances_Handler<VESPERA_LogicalDisk>* handler);

    Create_Instance_Status create_instance(VESPERA_LogicalDisk* instance);

    Delete_Instance_Status delete_instance(const VESPERA_LogicalDisk* instance);

    Modify_Instance_Status modify_instance(const VESPERA_LogicalDisk* model, const VESPERA_LogicalDisk* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_LogicalDisk* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status SetPowerState(
        const VESPERA_LogicalDisk* self,
        const Property<uint16>& PowerState,
        const Property<Datetime>& Time,
        Property<uint32>& return_value);

    Invoke_Method_Status Reset(
        const VESPERA_LogicalDisk* self,
        Property<uint32>& return_value);

    Invoke_Method_Status EnableDevice(
        const VESPERA_LogicalDisk* self,
        const Property<bool>& Enabled,
        Property<uint32>& return_value);

    Invoke_Method_Status OnlineDevice(
        const VESPERA_LogicalDisk* self,
        const Property<bool>& Online,
        Property<uint32>& return_value);

    Invoke_Method_Status QuiesceDevice(
        const VESPERA_LogicalDisk* self,
        const Property<bool>& Quiesce,
        Property<uint32>& return_value);

    Invoke_Method_Status SaveProperties(
        const VESPERA_LogicalDisk* self,
        Property<uint32>& return_value);

    Invoke_Method_Status RestoreProperties(
        const VESPERA_LogicalDisk* self,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_LogicalDisk_Provider_h
