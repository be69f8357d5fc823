#ifndef _VESPERA_SCSIProtocolEndpoint_Provider_h
#define _VESPERA_SCSIProtocolEndpoint_Provider_h

#include "Provider.h"
#include "VESPERA_SCSIProtocolEndpoint.h"

namespace OLMA
{

// Serves VESPERA_SCSIProtocolEndpoint from FCHBAManager: enumeration, and getInstance by
// looking up the one instance that the keys name.
class VESPERA_SCSIProtocolEndpoint_Provider
{
public:

    Get_Instance_Status get_instance(const VESPERA_SCSIProtocolEndpoint* model, VESPERA_SCSIProtocolEndpoint*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_SCSIProtocolEndpoint* model, Enum_Instances_Handler<VESPERA_SCSIProtocolEndpoint>* handler);
};

} // namespace OLMA

#endif // _VESPERA_SCSIProtocolEndpoint_Provider_h
