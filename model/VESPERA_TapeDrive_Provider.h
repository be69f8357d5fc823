#ifndef _VESPERA_TapeDrive_Provider_h
#define _VESPERA_TapeDrive_Provider_h

#include "Provider.h"
#include "VESPERA_TapeDrive.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_TapeDrive: enumeration only, from HDRManager.
class VESPERA_TapeDrive_Provider
{
public:

    VESPERA_TapeDrive_Provider();

    ~VESPERA_TapeDrive_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_TapeDrive* model, VESPERA_TapeDrive*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_TapeDrive* model, Enum_Instances_Handler<VESPERA_TapeDrive>* handler);

    Create_Instance_Status create_instance(VESPERA_TapeDrive* instance);

    Delete_Instance_Status delete_instance(const VESPERA_TapeDrive* instance);

    Modify_Instance_Status modify_instance(const VESPERA_TapeDrive* model, const VESPERA_TapeDrive* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_TapeDrive* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status SetPowerState(
        const VESPERA_TapeDrive* self,
        const Property<uint16>& PowerState,
        const Property<Datetime>& Time,
        Property<uint32>& return_value);

    Invoke_Method_Status Reset(
        const VESPERA_TapeDrive* self,
        Property<uint32>& return_value);

    Invoke_Method_Status EnableDevice(
        const VESPERA_TapeDrive* self,
        const Property<bool>& Enabled,
        Property<uint32>& return_value);

    Invoke_Method_Status OnlineDevice(
        const VESPERA_TapeDrive* self,
        const Property<bool>& Online,
        Property<uint32>& return_value);

    Invoke_Method_Status QuiesceDevice(
        const VESPERA_TapeDrive* self,
        const Property<bool>& Quiesce,
        Property<uint32>& return_value);

    Invoke_Method_Status SaveProperties(
        const VESPERA_TapeDrive* self,
        Property<uint32>& return_value);

    Invoke_Method_Status RestoreProperties(
        const VESPERA_TapeDrive* self,
        Property<uint32>& return_value);

    Invoke_Method_Status LockMedia(
        const VESPERA_TapeDrive* self,
        const Property<bool>& Lock,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_TapeDrive_Provider_h
