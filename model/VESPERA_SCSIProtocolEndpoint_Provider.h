#ifndef _VESPERA_SCSIProtocolEndpoint_Provider_h
#define _VESPERA_SCSIProtocolEndpoint_Provider_h

#include "Provider.h"
#include "VESPERA_SCSIProtocolEndpoint.h"

namespace OLMA
{

// Serves VESPERA_SCSIProtocolEndpoint: enumeration only, from FCHBAManager.
class VESPERA_SCSIProtocolEndpoint_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_SCSIProtocolEndpoint* model, Enum_Instances_Handler<VESPERA_SCSIProtocolEndpoint>* handler);
};

} // namespace OLMA

#endif // _VESPERA_SCSIProtocolEndpoint_Provider_h
