#include "FCHBAManager.h"

#include "ProviderUtil.h"
#include "log.h"

namespace OLMA
{

FCHBAManager gFCHBAManagerObj;
FCHBAManager* FCHBAManager::helperObj = 0;

FCHBAManager::FCHBAManager()
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
// instances. The inventory helpers (AdapterHelper, PortHelper, CommonHelper,
// AccessPointHelper, SoftwareUpdateHelper, EthernetPortHelper,
// DiagnosticHelper, PhysicalAssetHelper) aren't part of the module yet;
// each case names its helper and answers with no instances until that helper
// is wired in here. The driver status has been checked by the caller.
//------------------------------------------------------------------------------

static Array<Instance*> _serve(classId_t id)
{
    Array<Instance*> result;

    switch (id)
    {
        case ID_VESPERA_ComputerSystem:
            // CommonHelper: the host.
            break;

        case ID_VESPERA_PortController:
        case ID_VESPERA_PhysicalPackage:
        case ID_VESPERA_Product:
        case ID_VESPERA_AdapterSoftwareIdentity:
            // AdapterHelper
            break;

        case ID_VESPERA_FCPort:
        case ID_VESPERA_SCSIProtocolEndpoint:
        case ID_VESPERA_FCPortStatistics:
        case ID_VESPERA_LogicalPortGroup:
        case ID_VESPERA_AlarmDevice:
            // PortHelper
            break;

        case ID_VESPERA_RemoteServiceAccessPoint:
            // AccessPointHelper
            break;

        case ID_VESPERA_HBASoftwareInstallationService:
        case ID_VESPERA_HBASoftwareInstallationServiceCapabilities:
            // SoftwareUpdateHelper
            break;

        case ID_VESPERA_EthernetPort:
        case ID_VESPERA_LANEndpoint:
            // EthernetPortHelper
            break;

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
            // DiagnosticHelper
            break;

        case ID_VESPERA_PhysicalConnector:
            // PhysicalAssetHelper
            break;

        default:
            break;
    }

    return result;
}

static Array<Instance*> _fcPortsOf(const String& address)
{
    // PortHelper::getFCPortInstancesByAdapter(address)
    (void)address;
    return Array<Instance*>();
}

static Array<Instance*> _ethernetPortsOf(const String& address)
{
    // EthernetPortHelper::getEthernetPortInstancesByAdapter(address)
    (void)address;
    return Array<Instance*>();
}

static Array<Instance*> _diagnosticServices()
{
    // DiagnosticHelper::getDiagnosticServices()
    return Array<Instance*>();
}

//------------------------------------------------------------------------------

Array<Instance*> FCHBAManager::getInstances(classId_t id)
{
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

Array<Instance*> FCHBAManager::getFCPortInstancesByAdapter(String address)
{
    return _fcPortsOf(address);
}

Array<Instance*> FCHBAManager::getEthernetPortInstancesByAdapter(
    String address)
{
    return _ethernetPortsOf(address);
}

Array<Instance*> FCHBAManager::getAllDiagnosticTestInstances()
{
    return _diagnosticServices();
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
