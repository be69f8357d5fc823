#include "VESPERA_AlarmDevice_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "PortHelper.h"
#include "log.h"

namespace OLMA
{

Get_Instance_Status VESPERA_AlarmDevice_Provider::get_instance(const VESPERA_AlarmDevice* model,
    VESPERA_AlarmDevice*& instance)
{
    TLOG(LL_DBG, "Entering: %s", "get_instance");
    Get_Instance_Status status = deliverInstance(
        FCHBAManager::getFCHBAManager()->getInstance(ID_VESPERA_AlarmDevice, model), instance);
    TLOG(LL_DBG, "Returning: %s", "get_instance");
    return status;
}

Enum_Instances_Status VESPERA_AlarmDevice_Provider::enum_instances(
    const VESPERA_AlarmDevice*, Enum_Instances_Handler<VESPERA_AlarmDevice>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_AlarmDevice);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "Invalid number of Instances returned");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

// The only write of the inventory: the beacon of one port. Its outcome goes
// to the client in return_value (0 done, 1 not possible on this card, 2
// failed or nothing to do); the call itself always succeeds.
Invoke_Method_Status VESPERA_AlarmDevice_Provider::SetAlarmState(
    const VESPERA_AlarmDevice* self,
    const Property<uint16>& RequestedAlarmState,
    Property<uint32>& return_value)
{
    TLOG(LL_DBG, "Entering: %s", "SetAlarmState");

    // 1 is "Off", 3 is "Alternating"; the beacon can't do "Steady" (2).
    uint16 state = RequestedAlarmState.null ? 0 : RequestedAlarmState.value;

    if (state != 1 && state != 3)
    {
        TLOG(LL_ERR, "Error: Invalid Input State");
        return_value.set(2);
        return INVOKE_METHOD_OK;
    }

    String deviceId;
    if (self && !self->DeviceID.null)
        deviceId = self->DeviceID.value;

    int rc = FCHBAManager::getFCHBAManager()->portHelper->setAlarmState(
        deviceId, state);

    uint32 result;
    if (rc == 1)
        result = 0;
    else if (rc == 2)
        result = 1;
    else
        result = 2;

    return_value.set(result);
    TLOG(LL_DBG, "return value = %d\n", (int)result);
    return INVOKE_METHOD_OK;
}

} // namespace OLMA
