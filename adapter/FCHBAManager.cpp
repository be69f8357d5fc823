#include "FCHBAManager.h"

#include "AccessPointHelper.h"
#include "AdapterHelper.h"
#include "CommonHelper.h"
#include "DiagnosticHelper.h"
#include "EthernetPortHelper.h"
#include "PhysicalAssetHelper.h"
#include "PortHelper.h"
#include "ProviderUtil.h"
#include "SoftwareUpdateHelper.h"
#include "log.h"

namespace OLMA
{

FCHBAManager gFCHBAManagerObj;
FCHBAManager* FCHBAManager::helperObj = 0;

// Only the pointers are taken here: a helper's own object may not be built
// yet, and nothing is asked of it before static initialisation is over.
FCHBAManager::FCHBAManager() :
    adapterHelper(AdapterHelper::getAdapterHelperInstance()),
    portHelper(PortHelper::getPortHelperObject()),
    commonHelper(CommonHelper::getCommonHelperObject()),
    accessPointHelper(AccessPointHelper::getAccessPointHelperInstance()),
    softwareUpdateHelper(SoftwareUpdateHelper::getSoftwareUpdateHelperInstance()),
    ethernetPortHelper(EthernetPortHelper::getEthernetPortHelperObject()),
    diagnosticHelper(DiagnosticHelper::getDiagnosticHelperObject()),
    physicalAssetHelper(PhysicalAssetHelper::getPhysicalAssetHelperObject())
{
}

FCHBAManager* FCHBAManager::getFCHBAManager()
{
    if (!helperObj)
        helperObj = &gFCHBAManagerObj;

    return helperObj;
}

//------------------------------------------------------------------------------
// INVENTORY DISPATCH
//
// The one place where a class id meets the helper that builds its
// instances. The driver status has been checked by the caller.
//------------------------------------------------------------------------------

Array<Instance*> FCHBAManager::_serve(classId_t id)
{
    switch (id)
    {
        case ID_VESPERA_ComputerSystem:
            return commonHelper->getComputerSystemInstances(id);

        case ID_VESPERA_PortController:
        case ID_VESPERA_PhysicalPackage:
        case ID_VESPERA_Product:
        case ID_VESPERA_AdapterSoftwareIdentity:
            return adapterHelper->getInstancesByClass(id);

        case ID_VESPERA_FCPort:
        case ID_VESPERA_SCSIProtocolEndpoint:
        case ID_VESPERA_FCPortStatistics:
        case ID_VESPERA_LogicalPortGroup:
        case ID_VESPERA_AlarmDevice:
            return portHelper->getInstancesByClass(id);

        case ID_VESPERA_RemoteServiceAccessPoint:
            return accessPointHelper->getInstancesByClass(id);

        case ID_VESPERA_HBASoftwareInstallationService:
        case ID_VESPERA_HBASoftwareInstallationServiceCapabilities:
            return softwareUpdateHelper->getInstancesByClass(id);

        case ID_VESPERA_EthernetPort:
        case ID_VESPERA_LANEndpoint:
            return ethernetPortHelper->getInstancesByClass(id);

        case ID_VESPERA_MemoryDiagnosticTest:
        case ID_VESPERA_LoopbackDiagnosticTest:
        case ID_VESPERA_PCILoopbackDiagnosticTest:
        case ID_VESPERA_EthLoopbackDiagnosticTest:
        case ID_VESPERA_DiagnosticSoftwareIdentity:
        case ID_VESPERA_ConcreteJob:
        case ID_VESPERA_DiagnosticServiceRecord:
        case ID_VESPERA_DiagnosticCompletionRecord:
        case ID_VESPERA_AffectedJobElement:
        case ID_VESPERA_ServiceRecordAppliesToElement:
        case ID_VESPERA_CompletionRecordAppliesToElement:
            return diagnosticHelper->getInstancesByClass(id);

        case ID_VESPERA_PhysicalConnector:
            return physicalAssetHelper->getInstancesByClass(id);

        default:
            return Array<Instance*>();
    }
}

//------------------------------------------------------------------------------

Array<Instance*> FCHBAManager::getInstances(classId_t id)
{
    HostInfoScope hostInfo;
    ProviderUtil* util = ProviderUtil::getProviderUtil();

    TLOG(LL_INFO, "Requested classId : %d", (int)id);
    TLOG(LL_INFO, "Requested class is: %s", util->getClassName(id).c_str());

    bool driverStatus = ProviderUtil::getDriverStatus();

    switch (id)
    {
        // The host and its access point exist without any adapter.
        case ID_VESPERA_ComputerSystem:
        case ID_VESPERA_RemoteServiceAccessPoint:
            return _serve(id);

        case ID_VESPERA_PortController:
        case ID_VESPERA_FCPort:
        case ID_VESPERA_SCSIProtocolEndpoint:
        case ID_VESPERA_FCPortStatistics:
        case ID_VESPERA_PhysicalPackage:
        case ID_VESPERA_Product:
        case ID_VESPERA_AdapterSoftwareIdentity:
        case ID_VESPERA_HBASoftwareInstallationService:
        case ID_VESPERA_HBASoftwareInstallationServiceCapabilities:
        case ID_VESPERA_EthernetPort:
        case ID_VESPERA_MemoryDiagnosticTest:
        case ID_VESPERA_LoopbackDiagnosticTest:
        case ID_VESPERA_PCILoopbackDiagnosticTest:
        case ID_VESPERA_EthLoopbackDiagnosticTest:
        case ID_VESPERA_DiagnosticSoftwareIdentity:
        case ID_VESPERA_ConcreteJob:
        case ID_VESPERA_DiagnosticServiceRecord:
        case ID_VESPERA_DiagnosticCompletionRecord:
        case ID_VESPERA_LogicalPortGroup:
        case ID_VESPERA_AffectedJobElement:
        case ID_VESPERA_ServiceRecordAppliesToElement:
        case ID_VESPERA_CompletionRecordAppliesToElement:
        case ID_VESPERA_LANEndpoint:
        case ID_VESPERA_PhysicalConnector:
        case ID_VESPERA_AlarmDevice:
            if (!driverStatus)
            {
                TLOG(LL_ERR, "Driver is not installed or there is a trul "
                    "mismatch hence no instances returned");
                return Array<Instance*>();
            }
            return _serve(id);

        default:
            TLOG(LL_INFO, "Requested class is NOT supported.");
            return Array<Instance*>();
    }
}

Instance* FCHBAManager::getInstance(classId_t id, const Instance* model)
{
    HostInfoScope hostInfo;

    switch (id)
    {
        case ID_VESPERA_FCPort:
        case ID_VESPERA_SCSIProtocolEndpoint:
        case ID_VESPERA_FCPortStatistics:
        case ID_VESPERA_AlarmDevice:
        case ID_VESPERA_PhysicalConnector:
            break;

        default:
            return firstWithKeys(getInstances(id), model);
    }

    TLOG(LL_INFO, "Requested classId : %d", (int)id);
    TLOG(LL_INFO, "Requested class is: %s",
        ProviderUtil::getProviderUtil()->getClassName(id).c_str());

    if (!ProviderUtil::getDriverStatus())
    {
        TLOG(LL_ERR, "Driver is not installed or there is a trul "
            "mismatch hence no instances returned");
        return 0;
    }

    if (id == ID_VESPERA_PhysicalConnector)
        return physicalAssetHelper->getInstanceByKeys(id, model);

    return portHelper->getInstanceByKeys(id, model);
}

Instance* firstWithKeys(Array<Instance*> instances, const Instance* model)
{
    Instance* match = 0;

    for (size_t i = 0; i < instances.size(); i++)
    {
        if (!instances[i])
            continue;

        if (!match && model && key_eq(model, instances[i]))
            match = instances[i];
        else
            destroy(instances[i]);
    }

    return match;
}

Array<Instance*> FCHBAManager::getFCPortInstancesByAdapter(String address)
{
    return portHelper->getFCPortInstancesByAdapter(address);
}

Array<Instance*> FCHBAManager::getEthernetPortInstancesByAdapter(
    String address)
{
    return ethernetPortHelper->getEthernetPortInstancesByAdapter(address);
}

Array<Instance*> FCHBAManager::getAllDiagnosticTestInstances()
{
    return diagnosticHelper->getDiagnosticServices();
}

Array<Instance*> FCHBAManager::getDiagnosticServicesForAdapter()
{
    return getInstances(ID_VESPERA_MemoryDiagnosticTest);
}

Array<Instance*> FCHBAManager::getDiagnosticServicesForFCPort()
{
    Array<Instance*> result = getInstances(ID_VESPERA_LoopbackDiagnosticTest);
    result.append(getInstances(ID_VESPERA_PCILoopbackDiagnosticTest));
    return result;
}

Array<Instance*> FCHBAManager::getDiagnosticServicesForEthernetPort()
{
    Array<Instance*> result = getInstances(ID_VESPERA_EthLoopbackDiagnosticTest);
    result.append(getInstances(ID_VESPERA_PCILoopbackDiagnosticTest));
    return result;
}

} // namespace OLMA
