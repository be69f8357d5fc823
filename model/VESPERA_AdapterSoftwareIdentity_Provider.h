#ifndef _VESPERA_AdapterSoftwareIdentity_Provider_h
#define _VESPERA_AdapterSoftwareIdentity_Provider_h

#include "Provider.h"
#include "VESPERA_AdapterSoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_AdapterSoftwareIdentity: enumeration only, from FCHBAManager.
class VESPERA_AdapterSoftwareIdentity_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_AdapterSoftwareIdentity* model, Enum_Instances_Handler<VESPERA_AdapterSoftwareIdentity>* handler);
};

} // namespace OLMA

#endif // _VESPERA_AdapterSoftwareIdentity_Provider_h
