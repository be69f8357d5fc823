#include "HDRManager.h"

#include "PortHelper.h"
#include "ProviderUtil.h"
#include "log.h"

namespace OLMA
{

HDRManager gHDRManagerObj;
HDRManager* HDRManager::helperObj = 0;

// Only the pointer is taken: the helper's object may not be built yet.
HDRManager::HDRManager() :
    portHelper(PortHelper::getPortHelperObject())
{
}

HDRManager* HDRManager::getHDRManager()
{
    if (!helperObj)
        helperObj = &gHDRManagerObj;

    return helperObj;
}

Array<Instance*> HDRManager::getInstances(classId_t id)
{
    HostInfoScope hostInfo;

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

    // INVENTORY DISPATCH: the same walk of adapters and ports as for the
    // ports themselves, which asks TargetHelper for what lies behind each.
    return portHelper->getInstancesByClass(id);
}

Instance* HDRManager::getInstance(classId_t id, const Instance* model)
{
    TLOG(LL_INFO, "Requested classId : %d", (int)id);
    TLOG(LL_INFO, "Requested class is: %s",
        ProviderUtil::getProviderUtil()->getClassName(id).c_str());

    if (id != ID_VESPERA_StorageExtent && id != ID_VESPERA_TapeDrive &&
        id != ID_VESPERA_LogicalDisk)
    {
        TLOG(LL_INFO, "Requested class is NOT supported.");
        return 0;
    }

    if (!ProviderUtil::getDriverStatus())
    {
        TLOG(LL_ERR, "Driver is not installed or there is a trul mismatch "
            "hence no instances returned");
        return 0;
    }

    HostInfoScope hostInfo;
    return portHelper->getInstanceByKeys(id, model);
}

} // namespace OLMA
