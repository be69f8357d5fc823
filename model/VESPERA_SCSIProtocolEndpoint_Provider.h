#ifndef _VESPERA_SCSIProtocolEndpoint_Provider_h
#define _VESPERA_SCSIProtocolEndpoint_Provider_h

#include "Provider.h"
#include "VESPERA_SCSIProtocolEndpoint.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_SCSIProtocolEndpoint: enumeration only, from FCHBAManager.
class VESPERA_SCSIProtocolEndpoint_Provider
{
public:

    VESPERA_SCSIProtocolEndpoint_Provider();

    ~VESPERA_SCSIProtocolEndpoint_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_SCSIProtocolEndpoint* model, VESPERA_SCSIProtocolEndpoint*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_SCSIProtocolEndpoint* model, Enum_Instances_Handler<VESPERA_SCSIProtocolEndpoint>* handler);

    Create_Instance_Status create_instance(VESPERA_SCSIProtocolEndpoint* instance);

    Delete_Instance_Status delete_instance(const VESPERA_SCSIProtocolEndpoint* instance);

    Modify_Instance_Status modify_instance(const VESPERA_SCSIProtocolEndpoint* model, const VESPERA_SCSIProtocolEndpoint* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_SCSIProtocolEndpoint* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status BroadcastReset(
        const VESPERA_SCSIProtocolEndpoint* self,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_SCSIProtocolEndpoint_Provider_h
