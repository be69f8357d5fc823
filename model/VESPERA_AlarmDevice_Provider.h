#ifndef _VESPERA_AlarmDevice_Provider_h
#define _VESPERA_AlarmDevice_Provider_h

#include "Provider.h"
#include "VESPERA_AlarmDevice.h"

namespace OLMA
{

// Serves VESPERA_AlarmDevice from FCHBAManager: enumeration, getInstance by
// looking up the one instance that the keys name, and SetAlarmState.
class VESPERA_AlarmDevice_Provider
{
public:

    Get_Instance_Status get_instance(const VESPERA_AlarmDevice* model, VESPERA_AlarmDevice*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_AlarmDevice* model, Enum_Instances_Handler<VESPERA_AlarmDevice>* handler);

    Invoke_Method_Status SetAlarmState(
        const VESPERA_AlarmDevice* self,
        const Property<uint16>& RequestedAlarmState,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_AlarmDevice_Provider_h
