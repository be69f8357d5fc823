#ifndef _VESPERA_AlarmDevice_Provider_h
#define _VESPERA_AlarmDevice_Provider_h

#include "Provider.h"
#include "VESPERA_AlarmDevice.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_AlarmDevice: enumeration only, from FCHBAManager.
class VESPERA_AlarmDevice_Provider
{
public:

    VESPERA_AlarmDevice_Provider();

    ~VESPERA_AlarmDevice_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_AlarmDevice* model, VESPERA_AlarmDevice*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_AlarmDevice* model, Enum_Instances_Handler<VESPERA_AlarmDevice>* handler);

    Create_Instance_Status create_instance(VESPERA_AlarmDevice* instance);

    Delete_Instance_Status delete_instance(const VESPERA_AlarmDevice* instance);

    Modify_Instance_Status modify_instance(const VESPERA_AlarmDevice* model, const VESPERA_AlarmDevice* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_AlarmDevice* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status SetPowerState(
        const VESPERA_AlarmDevice* self,
        const Property<uint16>& PowerState,
        const Property<Datetime>& Time,
        Property<uint32>& return_value);

    Invoke_Method_Status Reset(
        const VESPERA_AlarmDevice* self,
        Property<uint32>& return_value);

    Invoke_Method_Status EnableDevice(
        const VESPERA_AlarmDevice* self,
        const Property<bool>& Enabled,
        Property<uint32>& return_value);

    Invoke_Method_Status OnlineDevice(
        const VESPERA_AlarmDevice* self,
        const Property<bool>& Online,
        Property<uint32>& return_value);

    Invoke_Method_Status QuiesceDevice(
        const VESPERA_AlarmDevice* self,
        const Property<bool>& Quiesce,
        Property<uint32>& return_value);

    Invoke_Method_Status SaveProperties(
        const VESPERA_AlarmDevice* self,
        Property<uint32>& return_value);

    Invoke_Method_Status RestoreProperties(
        const VESPERA_AlarmDevice* self,
        Property<uint32>& return_value);

    Invoke_Method_Status SetAlarmState(
        const VESPERA_AlarmDevice* self,
        const Property<uint16>& RequestedAlarmState,
        Property<uint32>& return_value);

    Invoke_Method_Status SetAlarmIndicator(
        const VESPERA_AlarmDevice* self,
        const Property<uint16>& AudioIndicator,
        const Property<uint16>& VisualIndicator,
        const Property<uint16>& MotionIndicator,
        Property<uint32>& return_value);

    Invoke_Method_Status SetUrgency(
        const VESPERA_AlarmDevice* self,
        const Property<uint16>& RequestedUrgency,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_AlarmDevice_Provider_h
