#ifndef _VESPERA_ComputerSystem_Provider_h
#define _VESPERA_ComputerSystem_Provider_h

#include "Provider.h"
#include "VESPERA_ComputerSystem.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_ComputerSystem: enumeration only, from FCHBAManager.
class VESPERA_ComputerSystem_Provider
{
public:

    VESPERA_ComputerSystem_Provider();

    ~VESPERA_ComputerSystem_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_ComputerSystem* model, VESPERA_ComputerSystem*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_ComputerSystem* model, Enum_Instances_Handler<VESPERA_ComputerSystem>* handler);

    Create_Instance_Status create_instance(VESPERA_ComputerSystem* instance);

    Delete_Instance_Status delete_instance(const VESPERA_ComputerSystem* instance);

    Modify_Instance_Status modify_instance(const VESPERA_ComputerSystem* model, const VESPERA_ComputerSystem* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_ComputerSystem* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status SetPowerState(
        const VESPERA_ComputerSystem* self,
        const Property<uint32>& PowerState,
        const Property<Datetime>& Time,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_ComputerSystem_Provider_h
