#ifndef _VESPERA_RemoteServiceAccessPoint_Provider_h
#define _VESPERA_RemoteServiceAccessPoint_Provider_h

#include "Provider.h"
#include "VESPERA_RemoteServiceAccessPoint.h"

namespace OLMA
{

// Serves VESPERA_RemoteServiceAccessPoint: enumeration only, from FCHBAManager.
class VESPERA_RemoteServiceAccessPoint_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_RemoteServiceAccessPoint* model, Enum_Instances_Handler<VESPERA_RemoteServiceAccessPoint>* handler);
};

} // namespace OLMA

#endif // _VESPERA_RemoteServiceAccessPoint_Provider_h
