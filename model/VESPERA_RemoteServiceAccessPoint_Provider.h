#ifndef _VESPERA_RemoteServiceAccessPoint_Provider_h
#define _VESPERA_RemoteServiceAccessPoint_Provider_h

#include "Provider.h"
#include "VESPERA_RemoteServiceAccessPoint.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_RemoteServiceAccessPoint: enumeration only, from FCHBAManager.
class VESPERA_RemoteServiceAccessPoint_Provider
{
public:

    VESPERA_RemoteServiceAccessPoint_Provider();

    ~VESPERA_RemoteServiceAccessPoint_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_RemoteServiceAccessPoint* model, VESPERA_RemoteServiceAccessPoint*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_RemoteServiceAccessPoint* model, Enum_Instances_Handler<VESPERA_RemoteServiceAccessPoint>* handler);

    Create_Instance_Status create_instance(VESPERA_RemoteServiceAccessPoint* instance);

    Delete_Instance_Status delete_instance(const VESPERA_RemoteServiceAccessPoint* instance);

    Modify_Instance_Status modify_instance(const VESPERA_RemoteServiceAccessPoint* model, const VESPERA_RemoteServiceAccessPoint* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_RemoteServiceAccessPoint* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_RemoteServiceAccessPoint_Provider_h
