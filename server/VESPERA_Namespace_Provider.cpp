#include "VESPERA_Namespace_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_Namespace_Provider::enum_instances(
    const VESPERA_Namespace*, Enum_Instances_Handler<VESPERA_Namespace>* handler)
{
    return enumServerInstances(ID_VESPERA_Namespace, handler);
}

} // namespace OLMA
