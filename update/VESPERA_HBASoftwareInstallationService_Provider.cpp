#include "VESPERA_HBASoftwareInstallationService_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_HBASoftwareInstallationService_Provider::VESPERA_HBASoftwareInstallationService_Provider()
{
}

VESPERA_HBASoftwareInstallationService_Provider::~VESPERA_HBASoftwareInstallationService_Provider()
{
}

Load_Status VESPERA_HBASoftwareInstallationService_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_HBASoftwareInstallationService_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_HBASoftwareInstallationService_Provider::get_instance(const VESPERA_HBASoftwareInstallationService*, VESPERA_HBASoftwareInstallationService*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_HBASoftwareInstallationService_Provider::enum_instances(
    const VESPERA_HBASoftwareInstallationService*, Enum_Instances_Handler<VESPERA_HBASoftwareInstallationService>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_HBASoftwareInstallationService_Provider::create_instance(VESPERA_HBASoftwareInstallationService*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_HBASoftwareInstallationService_Provider::delete_instance(const VESPERA_HBASoftwareInstallationService*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_HBASoftwareInstallationService_Provider::modify_instance(const VESPERA_HBASoftwareInstallationService*, const VESPERA_HBASoftwareInstallationService*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_HBASoftwareInstallationService_Provider::RequestStateChange(
    const VESPERA_HBASoftwareInstallationService*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_HBASoftwareInstallationService_Provider::StartService(
    const VESPERA_HBASoftwareInstallationService*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_HBASoftwareInstallationService_Provider::StopService(
    const VESPERA_HBASoftwareInstallationService*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_HBASoftwareInstallationService_Provider::ChangeAffectedElementsAssignedSequence(
    const VESPERA_HBASoftwareInstallationService*,
    const Property<Array<CIM_ManagedElement*> >&,
    const Property<Array<uint16> >&,
    CIM_ConcreteJob*&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_HBASoftwareInstallationService_Provider::CheckSoftwareIdentity(
    const VESPERA_HBASoftwareInstallationService*,
    const CIM_SoftwareIdentity*,
    const CIM_ManagedElement*,
    const CIM_Collection*,
    Property<Array<uint16> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_HBASoftwareInstallationService_Provider::InstallFromSoftwareIdentity(
    const VESPERA_HBASoftwareInstallationService*,
    CIM_ConcreteJob*&,
    const Property<Array<uint16> >&,
    const Property<Array<String> >&,
    const CIM_SoftwareIdentity*,
    const CIM_ManagedElement*,
    const CIM_Collection*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_HBASoftwareInstallationService_Provider::InstallFromByteStream(
    const VESPERA_HBASoftwareInstallationService*,
    CIM_ConcreteJob*&,
    const Property<Array<uint8> >&,
    const CIM_ManagedElement*,
    const Property<Array<uint16> >&,
    const Property<Array<String> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_HBASoftwareInstallationService_Provider::InstallFromURI(
    const VESPERA_HBASoftwareInstallationService*,
    CIM_ConcreteJob*&,
    const Property<String>&,
    const CIM_ManagedElement*,
    const Property<Array<uint16> >&,
    const Property<Array<String> >&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
