#ifndef _VESPERA_LANEndpoint_Provider_h
#define _VESPERA_LANEndpoint_Provider_h

#include "Provider.h"
#include "VESPERA_LANEndpoint.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_LANEndpoint: enumeration only, from FCHBAManager.
class VESPERA_LANEndpoint_Provider
{
public:

    VESPERA_LANEndpoint_Provider();

    ~VESPERA_LANEndpoint_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_LANEndpoint* model, VESPERA_LANEndpoint*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_LANEndpoint* model, Enum_Instances_Handler<VESPERA_LANEndpoint>* handler);

    Create_Instance_Status create_instance(VESPERA_LANEndpoint* instance);

    Delete_Instance_Status delete_instance(const VESPERA_LANEndpoint* instance);

    Modify_Instance_Status modify_instance(const VESPERA_LANEndpoint* model, const VESPERA_LANEndpoint* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_LANEndpoint* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status BroadcastReset(
        const VESPERA_LANEndpoint* self,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_LANEndpoint_Provider_h
