#ifndef _OLMA_VESPERA_CIMXMLCommunicationMechanism_Provider_h
#define _OLMA_VESPERA_CIMXMLCommunicationMechanism_Provider_h

#include "Provider.h"
#include "VESPERA_CIMXMLCommunicationMechanism.h"

namespace OLMA
{

// Serves VESPERA_CIMXMLCommunicationMechanism, the CIM server's CIM-XML
// protocol. Read-only: instances come from ServerManager, and no method does
// anything.
class VESPERA_CIMXMLCommunicationMechanism_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_CIMXMLCommunicationMechanism* model, Enum_Instances_Handler<VESPERA_CIMXMLCommunicationMechanism>* handler);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_CIMXMLCommunicationMechanism_Provider_h
