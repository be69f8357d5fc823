#include "VESPERA_ObjectManager_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_ObjectManager_Provider::enum_instances(
    const VESPERA_ObjectManager*, Enum_Instances_Handler<VESPERA_ObjectManager>* handler)
{
    return enumServerInstances(ID_VESPERA_ObjectManager, handler);
}

} // namespace OLMA
