#ifndef _OLMA_VESPERA_CIMXMLCommunicationMechanism_Provider_h
#define _OLMA_VESPERA_CIMXMLCommunicationMechanism_Provider_h

#include "Provider.h"
#include "VESPERA_CIMXMLCommunicationMechanism.h"
#include "CIM_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_CIMXMLCommunicationMechanism, the CIM server's CIM-XML
// protocol. Read-only: instances come from ServerManager, and no method does
// anything.
class VESPERA_CIMXMLCommunicationMechanism_Provider
{
public:

    VESPERA_CIMXMLCommunicationMechanism_Provider();

    ~VESPERA_CIMXMLCommunicationMechanism_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_CIMXMLCommunicationMechanism* model, VESPERA_CIMXMLCommunicationMechanism*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_CIMXMLCommunicationMechanism* model, Enum_Instances_Handler<VESPERA_CIMXMLCommunicationMechanism>* handler);

    Create_Instance_Status create_instance(VESPERA_CIMXMLCommunicationMechanism* instance);

    Delete_Instance_Status delete_instance(const VESPERA_CIMXMLCommunicationMechanism* instance);

    Modify_Instance_Status modify_instance(const VESPERA_CIMXMLCommunicationMechanism* model, const VESPERA_CIMXMLCommunicationMechanism* instance);

    Invoke_Method_Status RequestStateChange(
        const VESPERA_CIMXMLCommunicationMechanism* self,
        const Property<uint16>& RequestedState,
        CIM_ConcreteJob*& Job,
        const Property<Datetime>& TimeoutPeriod,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_CIMXMLCommunicationMechanism_Provider_h
