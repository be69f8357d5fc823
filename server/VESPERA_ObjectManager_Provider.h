#ifndef _OLMA_VESPERA_ObjectManager_Provider_h
#define _OLMA_VESPERA_ObjectManager_Provider_h

#include "Provider.h"
#include "VESPERA_ObjectManager.h"
#include "CIM_ConcreteJob.h"
#include "CIM_ManagedElement.h"

namespace OLMA
{

// Serves VESPERA_ObjectManager, the CIM server that hosts the module.
// Read-only: instances come from ServerManager, and no method does anything.
class VESPERA_ObjectManager_Provider
{
public:

    VESPERA_ObjectManager_Provider();

    ~VESPERA_ObjectManager_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_ObjectManager* model, VESPERA_ObjectManager*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_ObjectManager* model, Enum_Instances_Handler<VESPERA_ObjectManager>* handler);

    Create_Instance_Status create_instance(VESPERA_ObjectManager* instance);

    Delete_Instance_Status delete_instance(const VESPERA_ObjectManager* instance);

    Modify_Instance_Status modify_instance(const VESPERA_ObjectManager* model, const VESPERA_ObjectManager* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_ObjectManager* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status StartService(
        const VESPERA_ObjectManager* self,
        Property<uint32>& return_value);

    Invoke_Method_Status StopService(
        const VESPERA_ObjectManager* self,
        Property<uint32>& return_value);

    Invoke_Method_Status ChangeAffectedElementsAssignedSequence(
        const VESPERA_ObjectManager* self,
        const Property<Array<CIM_ManagedElement*> >& ManagedElements,
        const Property<Array<uint16> >& AssignedSequence,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_ObjectManager_Provider_h
