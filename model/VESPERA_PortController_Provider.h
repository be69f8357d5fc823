#ifndef _VESPERA_PortController_Provider_h
#define _VESPERA_PortController_Provider_h

#include "Provider.h"
#include "VESPERA_PortController.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_PortController: enumeration only, from FCHBAManager.
class VESPERA_PortController_Provider
{
public:

    VESPERA_PortController_Provider();

    ~VESPERA_PortController_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_PortController* model, VESPERA_PortController*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_PortController* model, Enum_Instances_Handler<VESPERA_PortController>* handler);

    Create_Instance_Status create_instance(VESPERA_PortController* instance);

    Delete_Instance_Status delete_instance(const VESPERA_PortController* instance);

    Modify_Instance_Status modify_instance(const VESPERA_PortController* model, const VESPERA_PortController* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_PortController* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status SetPowerState(
        const VESPERA_PortController* self,
        const Property<uint16>& PowerState,
        const Property<Datetime>& Time,
        Property<uint32>& return_value);

    Invoke_Method_Status Reset(
        const VESPERA_PortController* self,
        Property<uint32>& return_value);

    Invoke_Method_Status EnableDevice(
        const VESPERA_PortController* self,
        const Property<bool>& Enabled,
        Property<uint32>& return_value);

    Invoke_Method_Status OnlineDevice(
        const VESPERA_PortController* self,
        const Property<bool>& Online,
        Property<uint32>& return_value);

    Invoke_Method_Status QuiesceDevice(
        const VESPERA_PortController* self,
        const Property<bool>& Quiesce,
        Property<uint32>& return_value);

    Invoke_Method_Status SaveProperties(
        const VESPERA_PortController* self,
        Property<uint32>& return_value);

    Invoke_Method_Status RestoreProperties(
        const VESPERA_PortController* self,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_PortController_Provider_h
