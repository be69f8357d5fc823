#ifndef _VESPERA_HBASoftwareInstallationService_Provider_h
#define _VESPERA_HBASoftwareInstallationService_Provider_h

#include "Provider.h"
#include "VESPERA_HBASoftwareInstallationService.h"
#include "CIM_Collection.h"
#include "CIM_ConcreteJob.h"
#include "CIM_ManagedElement.h"
#include "CIM_SoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_HBASoftwareInstallationService. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_HBASoftwareInstallationService_Provider
{
public:

    VESPERA_HBASoftwareInstallationService_Provider();

    ~VESPERA_HBASoftwareInstallationService_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_HBASoftwareInstallationService* model, VESPERA_HBASoftwareInstallationService*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_HBASoftwareInstallationService* model, Enum_Instances_Handler<VESPERA_HBASoftwareInstallationService>* handler);

    Create_Instance_Status create_instance(VESPERA_HBASoftwareInstallationService* instance);

    Delete_Instance_Status delete_instance(const VESPERA_HBASoftwareInstallationService* instance);

    Modify_Instance_Status modify_instance(const VESPERA_HBASoftwareInstallationService* model, const VESPERA_HBASoftwareInstallationService* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_HBASoftwareInstallationService* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);

    Invoke_Method_Status StartService(
        const VESPERA_HBASoftwareInstallationService* self,
        Property<uint32>& return_value);

    Invoke_Method_Status StopService(
        const VESPERA_HBASoftwareInstallationService* self,
        Property<uint32>& return_value);

    Invoke_Method_Status ChangeAffectedElementsAssignedSequence(
        const VESPERA_HBASoftwareInstallationService* self,
        const Property<Array<CIM_ManagedElement*> >& ManagedElements,
        const Property<Array<uint16> >& AssignedSequence,
        CIM_ConcreteJob*& Job,
        Property<uint32>& return_value);

    Invoke_Method_Status CheckSoftwareIdentity(
        const VESPERA_HBASoftwareInstallationService* self,
        const CIM_SoftwareIdentity* Source,
        const CIM_ManagedElement* Target,
        const CIM_Collection* Collection,
        Property<Array<uint16> >& InstallCharacteristics,
        Property<uint32>& return_value);

    Invoke_Method_Status InstallFromSoftwareIdentity(
        const VESPERA_HBASoftwareInstallationService* self,
        CIM_ConcreteJob*& Job,
        const Property<Array<uint16> >& InstallOptions,
        const Property<Array<String> >& InstallOptionsValues,
        const CIM_SoftwareIdentity* Source,
        const CIM_ManagedElement* Target,
        const CIM_Collection* Collection,
        Property<uint32>& return_value);

    Invoke_Method_Status InstallFromByteStream(
        const VESPERA_HBASoftwareInstallationService* self,
        CIM_ConcreteJob*& Job,
        const Property<Array<uint8> >& Image,
        const CIM_ManagedElement* Target,
        const Property<Array<uint16> >& InstallOptions,
        const Property<Array<String> >& InstallOptionsValues,
        Property<uint32>& return_value);

    Invoke_Method_Status InstallFromURI(
        const VESPERA_HBASoftwareInstallationService* self,
        CIM_ConcreteJob*& Job,
        const Property<String>& URI,
        const CIM_ManagedElement* Target,
        const Property<Array<uint16> >& InstallOptions,
        const Property<Array<String> >& InstallOptionsValues,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_HBASoftwareInstallationService_Provider_h
