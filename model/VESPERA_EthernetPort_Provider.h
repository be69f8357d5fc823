#ifndef _VESPERA_EthernetPort_Provider_h
#define _VESPERA_EthernetPort_Provider_h

#include "Provider.h"
#include "VESPERA_EthernetPort.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_EthernetPort: enumeration only, from FCHBAManager.
class VESPERA_EthernetPort_Provider
{
public:

    VESPERA_EthernetPort_Provider();

    ~VESPERA_EthernetPort_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_EthernetPort* model, VESPERA_EthernetPort*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_EthernetPort* model, Enum_Instances_Handler<VESPERA_EthernetPort>* handler);

    Create_Instance_Status create_instance(VESPERA_EthernetPort* instance);

    Delete_Instance_Status delete_instance(const VESPERA_EthernetPort* instance);

    Modify_Instance_Status modify_instance(const VESPERA_EthernetPort* model, const VESPERA_EthernetPort* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_EthernetPort* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status SetPowerState(
        const VESPERA_EthernetPort* self,
        const Property<uint16>& PowerState,
        const Property<Datetime>& Time,
        Property<uint32>& return_value);

    Invoke_Method_Status Reset(
        const VESPERA_EthernetPort* self,
        Property<uint32>& return_value);

    Invoke_Method_Status EnableDevice(
        const VESPERA_EthernetPort* self,
        const Property<bool>& Enabled,
        Property<uint32>& return_value);

    Invoke_Method_Status OnlineDevice(
        const VESPERA_EthernetPort* self,
        const Property<bool>& Online,
        Property<uint32>& return_value);

    Invoke_Method_Status QuiesceDevice(
        const VESPERA_EthernetPort* self,
        const Property<bool>& Quiesce,
        Property<uint32>& return_value);

    Invoke_Method_Status SaveProperties(
        const VESPERA_EthernetPort* self,
        Property<uint32>& return_value);

    Invoke_Method_Status RestoreProperties(
        const VESPERA_EthernetPort* self,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_EthernetPort_Provider_h
