#ifndef _VESPERA_FCPort_Provider_h
#define _VESPERA_FCPort_Provider_h

#include "Provider.h"
#include "VESPERA_FCPort.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_FCPort: enumeration only, from FCHBAManager.
class VESPERA_FCPort_Provider
{
public:

    VESPERA_FCPort_Provider();

    ~VESPERA_FCPort_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_FCPort* model, VESPERA_FCPort*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_FCPort* model, Enum_Instances_Handler<VESPERA_FCPort>* handler);

    Create_Instance_Status create_instance(VESPERA_FCPort* instance);

    Delete_Instance_Status delete_instance(const VESPERA_FCPort* instance);

    Modify_Instance_Status modify_instance(const VESPERA_FCPort* model, const VESPERA_FCPort* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_FCPort* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status SetPowerState(
        const VESPERA_FCPort* self,
        const Property<uint16>& PowerState,
        const Property<Datetime>& Time,
        Property<uint32>& return_value);

    Invoke_Method_Status Reset(
        const VESPERA_FCPort* self,
        Property<uint32>& return_value);

    Invoke_Method_Status EnableDevice(
        const VESPERA_FCPort* self,
        const Property<bool>& Enabled,
        Property<uint32>& return_value);

    Invoke_Method_Status OnlineDevice(
        const VESPERA_FCPort* self,
        const Property<bool>& Online,
        Property<uint32>& return_value);

    Invoke_Method_Status QuiesceDevice(
        const VESPERA_FCPort* self,
        const Property<bool>& Quiesce,
        Property<uint32>& return_value);

    Invoke_Method_Status SaveProperties(
        const VESPERA_FCPort* self,
        Property<uint32>& return_value);

    Invoke_Method_Status RestoreProperties(
        const VESPERA_FCPort* self,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_FCPort_Provider_h
