#include "HDRManager.h"

#include "ProviderUtil.h"
#include "log.h"

namespace OLMA
{

HDRManager gHDRManagerObj;
HDRManager* HDRManager::helperObj = 0;

HDRManager::HDRManager()
{
}

HDRManager* HDRManager::getHDRManager()
{
    if (!helperObj)
        helperObj = &gHDRManagerObj;

    return helperObj;
}

// INVENTORY DISPATCH: PortHelper::getInstancesByClass(id) walks the adapters
// and ports and asks TargetHelper for what lies behind each port. Until
// PortHelper is part of the module, the targets answer with no instances.
static Array<Instance*> _targetsOfClass(classId_t id)
{
    (void)id;
    return Array<Instance*>();
}

Array<Instance*> HDRManager::getInstances(classId_t id)
{
    TLOG(LL_INFO, "Requested classId : %d", (int)id);
    TLOG(LL_INFO, "Requested class is: %s",
        ProviderUtil::getProviderUtil()->getClassName(id).c_str());

    if (id != ID_VESPERA_StorageExtent && id != ID_VESPERA_TapeDrive &&
        id != ID_VESPERA_LogicalDisk)
    {
        TLOG(LL_INFO, "Requested class is NOT supported.");
        return Array<Instance*>();
    }

    if (!ProviderUtil::getDriverStatus())
    {
        TLOG(LL_ERR, "Driver is not installed or there is a trul mismatch "
            "hence no instances returned");
        return Array<Instance*>();
    }

    return _targetsOfClass(id);
}

} // namespace OLMA
