#include "VESPERA_CIMXMLCommunicationMechanism_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_CIMXMLCommunicationMechanism_Provider::enum_instances(
    const VESPERA_CIMXMLCommunicationMechanism*, Enum_Instances_Handler<VESPERA_CIMXMLCommunicationMechanism>* handler)
{
    return enumServerInstances(ID_VESPERA_CIMXMLCommunicationMechanism, handler);
}

} // namespace OLMA
