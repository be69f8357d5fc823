#include "VESPERA_RegisteredProfile_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_RegisteredProfile_Provider::enum_instances(
    const VESPERA_RegisteredProfile*, Enum_Instances_Handler<VESPERA_RegisteredProfile>* handler)
{
    return enumServerInstances(ID_VESPERA_RegisteredProfile, handler);
}

} // namespace OLMA
