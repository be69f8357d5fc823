#include "VESPERA_RegisteredSubProfile_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_RegisteredSubProfile_Provider::enum_instances(
    const VESPERA_RegisteredSubProfile*, Enum_Instances_Handler<VESPERA_RegisteredSubProfile>* handler)
{
    return enumServerInstances(ID_VESPERA_RegisteredSubProfile, handler);
}

} // namespace OLMA
