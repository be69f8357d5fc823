#ifndef _VESPERA_ConcreteJob_Provider_h
#define _VESPERA_ConcreteJob_Provider_h

#include "Provider.h"
#include "VESPERA_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_ConcreteJob. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ConcreteJob_Provider
{
public:

    VESPERA_ConcreteJob_Provider();

    ~VESPERA_ConcreteJob_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_ConcreteJob* model, VESPERA_ConcreteJob*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_ConcreteJob* model, Enum_Instances_Handler<VESPERA_ConcreteJob>* handler);

    Create_Instance_Status create_instance(VESPERA_ConcreteJob* instance);

    Delete_Instance_Status delete_instance(const VESPERA_ConcreteJob* instance);

    Modify_Instance_Status modify_instance(const VESPERA_ConcreteJob* model, const VESPERA_ConcreteJob* instance);

    Invoke_Method_Status KillJob(
        const VESPERA_ConcreteJob* self,
        const Property<bool>& DeleteOnKill,
        Property<uint32>& return_value);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_ConcreteJob* self,
        const Property<uint16>& RequestedState,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status GetError(
        const VESPERA_ConcreteJob* self,
        Property<String>& Error,
        Property<uint32>& return_value);

    Invoke_Method_Status GetErrors(
        const VESPERA_ConcreteJob* self,
        Property<Array<String> >& Errors,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_ConcreteJob_Provider_h
