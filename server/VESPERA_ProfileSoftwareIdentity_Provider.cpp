#include "VESPERA_ProfileSoftwareIdentity_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_ProfileSoftwareIdentity_Provider::enum_instances(
    const VESPERA_ProfileSoftwareIdentity*, Enum_Instances_Handler<VESPERA_ProfileSoftwareIdentity>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    size_t count = 0;
    sendServerInstances(ID_VESPERA_ProfileSoftwareIdentity, handler, &count);
    if (count == 0)
    {
        // The module always has exactly one identity; none means something
        // is badly wrong, and the client should hear of it.
        TLOG(LL_ERR, "Error: Invalid number of ProfileSoftwareIdentity Instances");
        return ENUM_INSTANCES_FAILED;
    }
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

} // namespace OLMA
