#include "VESPERA_CIMXMLCommunicationMechanism_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

VESPERA_CIMXMLCommunicationMechanism_Provider::VESPERA_CIMXMLCommunicationMechanism_Provider()
{
}

VESPERA_CIMXMLCommunicationMechanism_Provider::~VESPERA_CIMXMLCommunicationMechanism_Provider()
{
}

Load_Status VESPERA_CIMXMLCommunicationMechanism_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_CIMXMLCommunicationMechanism_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_CIMXMLCommunicationMechanism_Provider::get_instance(const VESPERA_CIMXMLCommunicationMechanism*, VESPERA_CIMXMLCommunicationMechanism*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_CIMXMLCommunicationMechanism_Provider::enum_instances(
    const VESPERA_CIMXMLCommunicationMechanism*, Enum_Instances_Handler<VESPERA_CIMXMLCommunicationMechanism>* handler)
{
    return enumServerInstances(ID_VESPERA_CIMXMLCommunicationMechanism, handler);
}

Create_Instance_Status VESPERA_CIMXMLCommunicationMechanism_Provider::create_instance(VESPERA_CIMXMLCommunicationMechanism*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_CIMXMLCommunicationMechanism_Provider::delete_instance(const VESPERA_CIMXMLCommunicationMechanism*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_CIMXMLCommunicationMechanism_Provider::modify_instance(const VESPERA_CIMXMLCommunicationMechanism*, const VESPERA_CIMXMLCommunicationMechanism*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_CIMXMLCommunicationMechanism_Provider::RequestStateChange(
    const VESPERA_CIMXMLCommunicationMechanism*,
    const Property<uint16>&,
    CIM_ConcreteJob*&,
    const Property<Datetime>&,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
