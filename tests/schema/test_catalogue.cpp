// The module's repository held against the class catalogue: which classes
// exist, under which parent, of which kind, with which keys, and the few
// places where the module's classes differ from their parents.

#include <gtest/gtest.h>
#include <strings.h>
#include <algorithm>
#include <cctype>
#include <cstring>
#include <set>
#include <sstream>
#include <string>
#include <vector>
#include "repository.h"
#include "module.h"

using namespace OLMA;

namespace
{

enum Kind { K_PLAIN, K_ASSOC, K_INDICATION };

struct Expected
{
    const char* name;
    const char* parent;
    Kind kind;
    bool abstract;
    // Key features in table order, comma-separated; null where the catalogue
    // doesn't list them (the CIM_ classes).
    const char* keys;
};

const Expected catalogue[] =
{
    { "CIM_AffectedJobElement", nullptr, K_ASSOC, false, nullptr },
    { "CIM_AlarmDevice", "CIM_LogicalDevice", K_PLAIN, false, nullptr },
    { "CIM_AlertIndication", "CIM_ProcessIndication", K_INDICATION, false, nullptr },
    { "CIM_AssociatedAlarm", "CIM_Dependency", K_ASSOC, false, nullptr },
    { "CIM_AvailableDiagnosticService", "CIM_ServiceAvailableToElement", K_ASSOC, false, nullptr },
    { "CIM_CIMXMLCommunicationMechanism", "CIM_ObjectManagerCommunicationMechanism", K_PLAIN, false, nullptr },
    { "CIM_Capabilities", "CIM_ManagedElement", K_PLAIN, true, nullptr },
    { "CIM_Collection", "CIM_ManagedElement", K_PLAIN, true, nullptr },
    { "CIM_CollectionOfMSEs", "CIM_Collection", K_PLAIN, true, nullptr },
    { "CIM_CommMechanismForManager", "CIM_ServiceAccessBySAP", K_ASSOC, false, nullptr },
    { "CIM_Component", nullptr, K_ASSOC, true, nullptr },
    { "CIM_ComputerSystem", "CIM_System", K_PLAIN, false, nullptr },
    { "CIM_ConcreteJob", "CIM_Job", K_PLAIN, false, nullptr },
    { "CIM_Container", "CIM_Component", K_ASSOC, false, nullptr },
    { "CIM_ControlledBy", "CIM_DeviceConnection", K_ASSOC, false, nullptr },
    { "CIM_Controller", "CIM_LogicalDevice", K_PLAIN, true, nullptr },
    { "CIM_Dependency", nullptr, K_ASSOC, true, nullptr },
    { "CIM_DeviceConnection", "CIM_Dependency", K_ASSOC, false, nullptr },
    { "CIM_DeviceSAPImplementation", "CIM_Dependency", K_ASSOC, false, nullptr },
    { "CIM_DiagnosticCompletionRecord", "CIM_DiagnosticServiceRecord", K_PLAIN, false, nullptr },
    { "CIM_DiagnosticRecord", "CIM_LogEntry", K_PLAIN, false, nullptr },
    { "CIM_DiagnosticResult", nullptr, K_PLAIN, false, nullptr },
    { "CIM_DiagnosticService", "CIM_Service", K_PLAIN, true, nullptr },
    { "CIM_DiagnosticServiceRecord", "CIM_DiagnosticRecord", K_PLAIN, false, nullptr },
    { "CIM_DiagnosticSetting", "CIM_Setting", K_PLAIN, false, nullptr },
    { "CIM_DiagnosticSettingData", "CIM_SettingData", K_PLAIN, false, nullptr },
    { "CIM_DiagnosticTest", "CIM_DiagnosticService", K_PLAIN, false, nullptr },
    { "CIM_ElementCapabilities", nullptr, K_ASSOC, false, nullptr },
    { "CIM_ElementConformsToProfile", nullptr, K_ASSOC, false, nullptr },
    { "CIM_ElementSoftwareIdentity", "CIM_Dependency", K_ASSOC, false, nullptr },
    { "CIM_ElementStatisticalData", nullptr, K_ASSOC, false, nullptr },
    { "CIM_EnabledLogicalElement", "CIM_LogicalElement", K_PLAIN, true, nullptr },
    { "CIM_Error", nullptr, K_INDICATION, false, nullptr },
    { "CIM_EthernetPort", "CIM_NetworkPort", K_PLAIN, false, nullptr },
    { "CIM_FCPort", "CIM_NetworkPort", K_PLAIN, false, nullptr },
    { "CIM_FCPortStatistics", "CIM_NetworkPortStatistics", K_PLAIN, false, nullptr },
    { "CIM_HostedAccessPoint", "CIM_HostedDependency", K_ASSOC, false, nullptr },
    { "CIM_HostedCollection", "CIM_HostedDependency", K_ASSOC, false, nullptr },
    { "CIM_HostedDependency", "CIM_Dependency", K_ASSOC, false, nullptr },
    { "CIM_HostedService", "CIM_HostedDependency", K_ASSOC, false, nullptr },
    { "CIM_Indication", nullptr, K_INDICATION, true, nullptr },
    { "CIM_InitiatorTargetLogicalUnitPath", nullptr, K_ASSOC, false, nullptr },
    { "CIM_InstalledSoftwareIdentity", nullptr, K_ASSOC, false, nullptr },
    { "CIM_Job", "CIM_LogicalElement", K_PLAIN, true, nullptr },
    { "CIM_JobSettingData", "CIM_SettingData", K_PLAIN, false, nullptr },
    { "CIM_LANEndpoint", "CIM_ProtocolEndpoint", K_PLAIN, false, nullptr },
    { "CIM_LogEntry", "CIM_RecordForLog", K_PLAIN, false, nullptr },
    { "CIM_LogicalDevice", "CIM_EnabledLogicalElement", K_PLAIN, true, nullptr },
    { "CIM_LogicalDisk", "CIM_StorageExtent", K_PLAIN, false, nullptr },
    { "CIM_LogicalElement", "CIM_ManagedSystemElement", K_PLAIN, true, nullptr },
    { "CIM_LogicalPort", "CIM_LogicalDevice", K_PLAIN, false, nullptr },
    { "CIM_LogicalPortGroup", "CIM_SystemSpecificCollection", K_PLAIN, false, nullptr },
    { "CIM_ManagedElement", nullptr, K_PLAIN, true, nullptr },
    { "CIM_ManagedSystemElement", "CIM_ManagedElement", K_PLAIN, true, nullptr },
    { "CIM_MediaAccessDevice", "CIM_LogicalDevice", K_PLAIN, false, nullptr },
    { "CIM_MemberOfCollection", nullptr, K_ASSOC, false, nullptr },
    { "CIM_Namespace", "CIM_ManagedElement", K_PLAIN, false, nullptr },
    { "CIM_NamespaceInManager", "CIM_HostedDependency", K_ASSOC, false, nullptr },
    { "CIM_NetworkPort", "CIM_LogicalPort", K_PLAIN, false, nullptr },
    { "CIM_NetworkPortStatistics", "CIM_StatisticalData", K_PLAIN, false, nullptr },
    { "CIM_ObjectManager", "CIM_WBEMService", K_PLAIN, false, nullptr },
    { "CIM_ObjectManagerCommunicationMechanism", "CIM_ServiceAccessPoint", K_PLAIN, false, nullptr },
    { "CIM_OwningJobElement", nullptr, K_ASSOC, false, nullptr },
    { "CIM_PhysicalConnector", "CIM_PhysicalElement", K_PLAIN, false, nullptr },
    { "CIM_PhysicalElement", "CIM_ManagedSystemElement", K_PLAIN, true, nullptr },
    { "CIM_PhysicalPackage", "CIM_PhysicalElement", K_PLAIN, false, nullptr },
    { "CIM_PortController", "CIM_Controller", K_PLAIN, false, nullptr },
    { "CIM_ProcessIndication", "CIM_Indication", K_INDICATION, true, nullptr },
    { "CIM_Product", "CIM_ManagedElement", K_PLAIN, false, nullptr },
    { "CIM_ProductElementComponent", "CIM_Component", K_ASSOC, false, nullptr },
    { "CIM_ProductPhysicalComponent", "CIM_ProductElementComponent", K_ASSOC, false, nullptr },
    { "CIM_ProtocolEndpoint", "CIM_ServiceAccessPoint", K_PLAIN, false, nullptr },
    { "CIM_Realizes", "CIM_Dependency", K_ASSOC, false, nullptr },
    { "CIM_RecordAppliesToElement", "CIM_Dependency", K_ASSOC, false, nullptr },
    { "CIM_RecordForLog", "CIM_ManagedElement", K_PLAIN, true, nullptr },
    { "CIM_ReferencedProfile", "CIM_ReferencedSpecification", K_ASSOC, false, nullptr },
    { "CIM_ReferencedSpecification", "CIM_Dependency", K_ASSOC, false, nullptr },
    { "CIM_RegisteredProfile", "CIM_RegisteredSpecification", K_PLAIN, false, nullptr },
    { "CIM_RegisteredSpecification", "CIM_ManagedElement", K_PLAIN, false, nullptr },
    { "CIM_RegisteredSubProfile", "CIM_RegisteredProfile", K_PLAIN, false, nullptr },
    { "CIM_RemoteServiceAccessPoint", "CIM_ServiceAccessPoint", K_PLAIN, false, nullptr },
    { "CIM_SCSIInitiatorTargetLogicalUnitPath", "CIM_InitiatorTargetLogicalUnitPath", K_ASSOC, false, nullptr },
    { "CIM_SCSIProtocolEndpoint", "CIM_ProtocolEndpoint", K_PLAIN, false, nullptr },
    { "CIM_Service", "CIM_EnabledLogicalElement", K_PLAIN, true, nullptr },
    { "CIM_ServiceAccessBySAP", "CIM_Dependency", K_ASSOC, false, nullptr },
    { "CIM_ServiceAccessPoint", "CIM_EnabledLogicalElement", K_PLAIN, true, nullptr },
    { "CIM_ServiceAvailableToElement", nullptr, K_ASSOC, false, nullptr },
    { "CIM_Setting", "CIM_ManagedElement", K_PLAIN, true, nullptr },
    { "CIM_SettingData", "CIM_ManagedElement", K_PLAIN, true, nullptr },
    { "CIM_SoftwareIdentity", "CIM_LogicalElement", K_PLAIN, false, nullptr },
    { "CIM_SoftwareInstallationService", "CIM_Service", K_PLAIN, false, nullptr },
    { "CIM_SoftwareInstallationServiceCapabilities", "CIM_Capabilities", K_PLAIN, false, nullptr },
    { "CIM_StatisticalData", "CIM_ManagedElement", K_PLAIN, true, nullptr },
    { "CIM_StorageExtent", "CIM_LogicalDevice", K_PLAIN, false, nullptr },
    { "CIM_SubProfileRequiresProfile", "CIM_ReferencedProfile", K_ASSOC, false, nullptr },
    { "CIM_System", "CIM_EnabledLogicalElement", K_PLAIN, true, nullptr },
    { "CIM_SystemComponent", "CIM_Component", K_ASSOC, false, nullptr },
    { "CIM_SystemDevice", "CIM_SystemComponent", K_ASSOC, false, nullptr },
    { "CIM_SystemSpecificCollection", "CIM_Collection", K_PLAIN, false, nullptr },
    { "CIM_TapeDrive", "CIM_MediaAccessDevice", K_PLAIN, false, nullptr },
    { "CIM_WBEMService", "CIM_Service", K_PLAIN, true, nullptr },
    { "VESPERA_AdapterElementSoftwareIdentity", "CIM_ElementSoftwareIdentity", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_AdapterSoftwareIdentity", "CIM_SoftwareIdentity", K_PLAIN, false, "InstanceID" },
    { "VESPERA_AffectedJobElement", "CIM_AffectedJobElement", K_ASSOC, false, "AffectedElement,AffectingElement" },
    { "VESPERA_AgentService", nullptr, K_PLAIN, false, "Name" },
    { "VESPERA_AlarmDevice", "CIM_AlarmDevice", K_PLAIN, false, "SystemCreationClassName,SystemName,CreationClassName,DeviceID" },
    { "VESPERA_AlertIndication", "CIM_AlertIndication", K_INDICATION, false, "" },
    { "VESPERA_AssociatedAlarm", "CIM_AssociatedAlarm", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_AvailableDiagnosticServiceForAdapter", "CIM_AvailableDiagnosticService", K_ASSOC, false, "ServiceProvided,UserOfService" },
    { "VESPERA_AvailableDiagnosticServiceForEthernetPort", "CIM_AvailableDiagnosticService", K_ASSOC, false, "ServiceProvided,UserOfService" },
    { "VESPERA_AvailableDiagnosticServiceForFCPort", "CIM_AvailableDiagnosticService", K_ASSOC, false, "ServiceProvided,UserOfService" },
    { "VESPERA_CIMXMLCommunicationMechanism", "CIM_CIMXMLCommunicationMechanism", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_CommMechHostedAccessPoint", "CIM_HostedAccessPoint", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_CommMechanismForManager", "CIM_CommMechanismForManager", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_CompletionRecordAppliesToElement", "CIM_RecordAppliesToElement", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_ComputerSystem", "CIM_ComputerSystem", K_PLAIN, false, "Name,CreationClassName" },
    { "VESPERA_ConcreteJob", "CIM_ConcreteJob", K_PLAIN, false, "InstanceID" },
    { "VESPERA_ControlledBy", "CIM_ControlledBy", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_DeviceSAPImplementation", "CIM_DeviceSAPImplementation", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_DiagnosticCompletionRecord", "CIM_DiagnosticCompletionRecord", K_PLAIN, false, "InstanceID" },
    { "VESPERA_DiagnosticElementSoftwareIdentity", "CIM_ElementSoftwareIdentity", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_DiagnosticServiceRecord", "CIM_DiagnosticServiceRecord", K_PLAIN, false, "InstanceID" },
    { "VESPERA_DiagnosticSoftwareIdentity", "CIM_SoftwareIdentity", K_PLAIN, false, "InstanceID" },
    { "VESPERA_DiagnosticTest", "CIM_DiagnosticTest", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_ElementConformsToProfile", "CIM_ElementConformsToProfile", K_ASSOC, false, "ConformantStandard,ManagedElement" },
    { "VESPERA_ElementStatisticalData", "CIM_ElementStatisticalData", K_ASSOC, false, "ManagedElement,Stats" },
    { "VESPERA_EthLoopbackDiagnosticTest", "VESPERA_DiagnosticTest", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_EthernetPort", "CIM_EthernetPort", K_PLAIN, false, "SystemCreationClassName,SystemName,CreationClassName,DeviceID" },
    { "VESPERA_EthernetPortControlledBy", "CIM_ControlledBy", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_EthernetPortRealizes", "CIM_Realizes", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_EthernetPortSystemDevice", "CIM_SystemDevice", K_ASSOC, false, "GroupComponent,PartComponent" },
    { "VESPERA_FCPort", "CIM_FCPort", K_PLAIN, false, "SystemCreationClassName,SystemName,CreationClassName,DeviceID" },
    { "VESPERA_FCPortStatistics", "CIM_FCPortStatistics", K_PLAIN, false, "InstanceID" },
    { "VESPERA_FCPortSystemDevice", "CIM_SystemDevice", K_ASSOC, false, "GroupComponent,PartComponent" },
    { "VESPERA_HBASoftwareInstallationService", "CIM_SoftwareInstallationService", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_HBASoftwareInstallationServiceCapabilities", "CIM_SoftwareInstallationServiceCapabilities", K_PLAIN, false, "InstanceID" },
    { "VESPERA_HBASoftwareInstallationServiceElementCapabilities", "CIM_ElementCapabilities", K_ASSOC, false, "ManagedElement,Capabilities" },
    { "VESPERA_HBASoftwareInstallationServiceHostedService", "CIM_HostedService", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_HostedAccessPoint", "CIM_HostedAccessPoint", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_HostedCollection", "CIM_HostedCollection", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_HostedDependency", "CIM_HostedDependency", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_HostedLANEndpoint", "CIM_HostedAccessPoint", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_InstalledSoftwareIdentity", "CIM_InstalledSoftwareIdentity", K_ASSOC, false, "System,InstalledSoftware" },
    { "VESPERA_LANEndpoint", "CIM_LANEndpoint", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_LANEndpointDeviceSAPImplementation", "CIM_DeviceSAPImplementation", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_LogicalDisk", "CIM_LogicalDisk", K_PLAIN, false, "SystemCreationClassName,SystemName,CreationClassName,DeviceID" },
    { "VESPERA_LogicalPortGroup", "CIM_LogicalPortGroup", K_PLAIN, false, "InstanceID" },
    { "VESPERA_LoopbackDiagnosticTest", "VESPERA_DiagnosticTest", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_MemberOfCollection", "CIM_MemberOfCollection", K_ASSOC, false, "Collection,Member" },
    { "VESPERA_MemoryDiagnosticTest", "VESPERA_DiagnosticTest", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_Namespace", "CIM_Namespace", K_PLAIN, false, "SystemCreationClassName,SystemName,ObjectManagerCreationClassName,ObjectManagerName,CreationClassName,Name" },
    { "VESPERA_NamespaceInManager", "CIM_NamespaceInManager", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_ObjectManager", "CIM_ObjectManager", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_ObjectManagerHostedService", "CIM_HostedService", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_OwningJobElement", "CIM_OwningJobElement", K_ASSOC, false, "OwningElement,OwnedElement" },
    { "VESPERA_PCILoopbackDiagnosticTest", "VESPERA_DiagnosticTest", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_PhysicalConnector", "CIM_PhysicalConnector", K_PLAIN, false, "Tag,CreationClassName" },
    { "VESPERA_PhysicalConnectorContainer", "CIM_Container", K_ASSOC, false, "GroupComponent,PartComponent" },
    { "VESPERA_PhysicalPackage", "CIM_PhysicalPackage", K_PLAIN, false, "Tag,CreationClassName" },
    { "VESPERA_PortController", "CIM_PortController", K_PLAIN, false, "SystemCreationClassName,SystemName,CreationClassName,DeviceID" },
    { "VESPERA_PortControllerSystemDevice", "CIM_SystemDevice", K_ASSOC, false, "GroupComponent,PartComponent" },
    { "VESPERA_Product", "CIM_Product", K_PLAIN, false, "Name,IdentifyingNumber,Vendor,Version" },
    { "VESPERA_ProductElementComponent", "CIM_ProductElementComponent", K_ASSOC, false, "GroupComponent,PartComponent" },
    { "VESPERA_ProductPhysicalComponent", "CIM_ProductPhysicalComponent", K_ASSOC, false, "GroupComponent,PartComponent" },
    { "VESPERA_ProfileElementSoftwareIdentity", "CIM_ElementSoftwareIdentity", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_ProfileSoftwareIdentity", "CIM_SoftwareIdentity", K_PLAIN, false, "InstanceID" },
    { "VESPERA_Realizes", "CIM_Realizes", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_RegisteredProfile", "CIM_RegisteredProfile", K_PLAIN, false, "InstanceID" },
    { "VESPERA_RegisteredSubProfile", "CIM_RegisteredSubProfile", K_PLAIN, false, "InstanceID" },
    { "VESPERA_RemoteServiceAccessPoint", "CIM_RemoteServiceAccessPoint", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_RemoteServiceHostedAccessPoint", "CIM_HostedAccessPoint", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_SCSIInitiatorTargetLogicalUnitPath", "CIM_SCSIInitiatorTargetLogicalUnitPath", K_ASSOC, false, "Initiator,Target,LogicalUnit" },
    { "VESPERA_SCSIProtocolEndpoint", "CIM_SCSIProtocolEndpoint", K_PLAIN, false, "Name,SystemCreationClassName,SystemName,CreationClassName" },
    { "VESPERA_ServiceRecordAppliesToElement", "CIM_RecordAppliesToElement", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_StorageExtent", "CIM_StorageExtent", K_PLAIN, false, "SystemCreationClassName,SystemName,CreationClassName,DeviceID" },
    { "VESPERA_StorageResourcesSystemDevice", "CIM_SystemDevice", K_ASSOC, false, "GroupComponent,PartComponent" },
    { "VESPERA_SubProfileRequiresProfile", "CIM_SubProfileRequiresProfile", K_ASSOC, false, "Antecedent,Dependent" },
    { "VESPERA_TapeDrive", "CIM_TapeDrive", K_PLAIN, false, "SystemCreationClassName,SystemName,CreationClassName,DeviceID" },
};

const size_t num_catalogue = sizeof(catalogue) / sizeof(catalogue[0]);

std::string swap_case(const char* s)
{
    std::string r(s);
    for (auto& c : r)
        c = isupper((unsigned char)c) ? tolower((unsigned char)c) : toupper((unsigned char)c);
    return r;
}

std::string key_list(const Meta_Class* mc)
{
    std::string r;
    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* f = mc->meta_features[i];
        if (f->flags & FLAG_KEY)
            r += (r.empty() ? "" : ",") + std::string(f->name);
    }
    return r;
}

const Meta_Class* must_find(const char* name)
{
    const Meta_Class* mc = find_meta_class(repository(), name);
    EXPECT_TRUE(mc != nullptr) << name;
    return mc;
}

} // namespace

TEST(Catalogue, RepositoryHoldsExactlyTheListedClasses)
{
    const Meta_Repository* mr = repository();
    ASSERT_EQ(178u, num_catalogue);
    ASSERT_EQ(178u, mr->num_meta_classes);
    EXPECT_EQ(178, (int)NUM_SCHEMA_CLASSES);

    size_t cim = 0, vespera = 0;
    std::set<std::string> seen;
    for (size_t i = 0; i < mr->num_meta_classes; i++)
    {
        const Meta_Class* mc = mr->meta_classes[i];
        EXPECT_TRUE(seen.insert(mc->name).second) << "twice: " << mc->name;
        EXPECT_EQ(mr, mc->meta_repository) << mc->name;
        if (strncmp(mc->name, "CIM_", 4) == 0)
            cim++;
        else if (strncmp(mc->name, "VESPERA_", 8) == 0)
            vespera++;
    }
    EXPECT_EQ(101u, cim);
    EXPECT_EQ(77u, vespera);
    for (const Expected& e : catalogue)
    {
        EXPECT_TRUE(seen.count(e.name)) << "missing: " << e.name;
    }
}

TEST(Catalogue, ParentsStandBeforeTheirChildren)
{
    const Meta_Repository* mr = repository();
    EXPECT_STREQ("CIM_ManagedElement", mr->meta_classes[0]->name);
    EXPECT_STREQ("VESPERA_AgentService", mr->meta_classes[mr->num_meta_classes - 1]->name);

    std::set<const Meta_Class*> before;
    for (size_t i = 0; i < mr->num_meta_classes; i++)
    {
        const Meta_Class* mc = mr->meta_classes[i];
        if (mc->super_meta_class)
        {
            EXPECT_TRUE(before.count(mc->super_meta_class)) << mc->name;
        }
        before.insert(mc);
    }
}

TEST(Catalogue, EachClassHasItsParentKindAndKeys)
{
    for (const Expected& e : catalogue)
    {
        SCOPED_TRACE(e.name);
        const Meta_Class* mc = must_find(e.name);
        if (!mc)
            continue;
        EXPECT_STREQ(e.name, mc->name);
        if (e.parent)
        {
            ASSERT_TRUE(mc->super_meta_class != nullptr);
            EXPECT_STREQ(e.parent, mc->super_meta_class->name);
        }
        else
        {
            EXPECT_TRUE(mc->super_meta_class == nullptr);
        }

        uint32 kind = mc->flags & (FLAG_CLASS | FLAG_ASSOCIATION | FLAG_INDICATION);
        switch (e.kind)
        {
            case K_PLAIN: EXPECT_EQ(FLAG_CLASS, kind); break;
            case K_ASSOC: EXPECT_EQ(FLAG_ASSOCIATION, kind); break;
            case K_INDICATION: EXPECT_EQ(FLAG_INDICATION, kind); break;
        }
        EXPECT_EQ(e.abstract, (mc->flags & FLAG_ABSTRACT) != 0);

        std::string keys = key_list(mc);
        size_t n = keys.empty() ? 0 : std::count(keys.begin(), keys.end(), ',') + 1;
        EXPECT_EQ(n, mc->num_keys);
        if (e.keys)
        {
            EXPECT_EQ(std::string(e.keys), keys);
        }

        // An association's keys are its references.
        if (e.kind == K_ASSOC && strncmp(e.name, "VESPERA_", 8) == 0)
        {
            for (size_t i = 0; i < mc->num_meta_features; i++)
            {
                const Meta_Feature* f = mc->meta_features[i];
                if (f->flags & FLAG_KEY)
                {
                    EXPECT_TRUE(f->flags & FLAG_REFERENCE) << f->name;
                }
            }
        }
    }
}

TEST(Catalogue, LookupIgnoresCaseAndKnowsNoMethodRecords)
{
    const Meta_Repository* mr = repository();
    for (const Expected& e : catalogue)
    {
        const Meta_Class* mc = find_meta_class(mr, e.name);
        EXPECT_EQ(mc, find_meta_class(mr, swap_case(e.name).c_str())) << e.name;
        std::string upper(e.name);
        for (auto& c : upper)
            c = toupper((unsigned char)c);
        EXPECT_EQ(mc, find_meta_class(mr, upper.c_str())) << e.name;
    }
    EXPECT_TRUE(find_meta_class(mr, "Instance") == nullptr);
    EXPECT_TRUE(find_meta_class(mr, "VESPERA_AgentService_executeMethod_method") == nullptr);
    EXPECT_TRUE(find_meta_class(mr, "executeMethod") == nullptr);
    EXPECT_TRUE(find_meta_class(mr, "CIM_EnabledLogicalElement_RequestStateChange_method") == nullptr);
    EXPECT_TRUE(find_meta_class(mr, "VESPERA_") == nullptr);

    for (size_t i = 0; i < mr->num_meta_classes; i++)
        for (size_t j = 0; j < mr->meta_classes[i]->num_meta_features; j++)
        {
            // Method records are reached through their class only.
            const Meta_Feature* f = mr->meta_classes[i]->meta_features[j];
            if (f->flags & FLAG_METHOD)
            {
                EXPECT_TRUE(find_meta_class(mr, f->name) == nullptr) << f->name;
            }
        }
}

TEST(Catalogue, NoModuleClassIsAbstractAndAllDeriveFromManagedElementOrStandAlone)
{
    const Meta_Class* me = must_find("CIM_ManagedElement");
    for (const Expected& e : catalogue)
    {
        if (strncmp(e.name, "VESPERA_", 8) != 0)
            continue;
        const Meta_Class* mc = must_find(e.name);
        EXPECT_FALSE(mc->flags & FLAG_ABSTRACT) << e.name;
        if (e.kind == K_PLAIN && strcmp(e.name, "VESPERA_AgentService") != 0)
        {
            EXPECT_TRUE(is_subclass(me, mc)) << e.name;
        }
    }
    EXPECT_TRUE(is_subclass(me, &VESPERA_FCPort::static_meta_class));
    EXPECT_FALSE(is_subclass(&VESPERA_FCPort::static_meta_class, me));
}

TEST(Catalogue, NarrowedReferences)
{
    struct Narrowed { const char* cls; const char* ref; const char* parent_type; const char* type; };
    static const Narrowed table[] =
    {
        { "VESPERA_AvailableDiagnosticServiceForAdapter", "ServiceProvided", "CIM_DiagnosticService", "VESPERA_DiagnosticTest" },
        { "VESPERA_AvailableDiagnosticServiceForAdapter", "UserOfService", "CIM_ManagedElement", "VESPERA_PortController" },
        { "VESPERA_AvailableDiagnosticServiceForEthernetPort", "ServiceProvided", "CIM_DiagnosticService", "VESPERA_DiagnosticTest" },
        { "VESPERA_AvailableDiagnosticServiceForEthernetPort", "UserOfService", "CIM_ManagedElement", "VESPERA_EthernetPort" },
        { "VESPERA_AvailableDiagnosticServiceForFCPort", "ServiceProvided", "CIM_DiagnosticService", "VESPERA_DiagnosticTest" },
        { "VESPERA_AvailableDiagnosticServiceForFCPort", "UserOfService", "CIM_ManagedElement", "VESPERA_FCPort" },
        { "VESPERA_CommMechHostedAccessPoint", "Antecedent", "CIM_System", "VESPERA_ComputerSystem" },
        { "VESPERA_CommMechHostedAccessPoint", "Dependent", "CIM_ServiceAccessPoint", "VESPERA_CIMXMLCommunicationMechanism" },
        { "VESPERA_CommMechanismForManager", "Antecedent", "CIM_ObjectManager", "VESPERA_ObjectManager" },
        { "VESPERA_CommMechanismForManager", "Dependent", "CIM_ObjectManagerCommunicationMechanism", "VESPERA_CIMXMLCommunicationMechanism" },
        { "VESPERA_DiagnosticElementSoftwareIdentity", "Antecedent", "CIM_SoftwareIdentity", "VESPERA_DiagnosticSoftwareIdentity" },
        { "VESPERA_DiagnosticElementSoftwareIdentity", "Dependent", "CIM_ManagedElement", "VESPERA_DiagnosticTest" },
        { "VESPERA_HBASoftwareInstallationServiceElementCapabilities", "ManagedElement", "CIM_ManagedElement", "VESPERA_HBASoftwareInstallationService" },
        { "VESPERA_HBASoftwareInstallationServiceElementCapabilities", "Capabilities", "CIM_Capabilities", "VESPERA_HBASoftwareInstallationServiceCapabilities" },
        { "VESPERA_HBASoftwareInstallationServiceHostedService", "Antecedent", "CIM_System", "VESPERA_ComputerSystem" },
        { "VESPERA_HBASoftwareInstallationServiceHostedService", "Dependent", "CIM_Service", "VESPERA_HBASoftwareInstallationService" },
        { "VESPERA_HostedLANEndpoint", "Antecedent", "CIM_System", "VESPERA_ComputerSystem" },
        { "VESPERA_HostedLANEndpoint", "Dependent", "CIM_ServiceAccessPoint", "VESPERA_LANEndpoint" },
        { "VESPERA_NamespaceInManager", "Antecedent", "CIM_ObjectManager", "VESPERA_ObjectManager" },
        { "VESPERA_NamespaceInManager", "Dependent", "CIM_Namespace", "VESPERA_Namespace" },
        { "VESPERA_ObjectManagerHostedService", "Antecedent", "CIM_System", "VESPERA_ComputerSystem" },
        { "VESPERA_ObjectManagerHostedService", "Dependent", "CIM_Service", "VESPERA_ObjectManager" },
        { "VESPERA_OwningJobElement", "OwningElement", "CIM_ManagedElement", "VESPERA_DiagnosticTest" },
        { "VESPERA_OwningJobElement", "OwnedElement", "CIM_Job", "VESPERA_ConcreteJob" },
        { "VESPERA_RemoteServiceHostedAccessPoint", "Antecedent", "CIM_System", "VESPERA_ComputerSystem" },
        { "VESPERA_RemoteServiceHostedAccessPoint", "Dependent", "CIM_ServiceAccessPoint", "VESPERA_RemoteServiceAccessPoint" },
        { "VESPERA_SCSIInitiatorTargetLogicalUnitPath", "Initiator", "CIM_ProtocolEndpoint", "CIM_SCSIProtocolEndpoint" },
        { "VESPERA_SCSIInitiatorTargetLogicalUnitPath", "Target", "CIM_ProtocolEndpoint", "CIM_SCSIProtocolEndpoint" },
    };
    for (const Narrowed& n : table)
    {
        SCOPED_TRACE(std::string(n.cls) + "." + n.ref);
        const Meta_Class* mc = must_find(n.cls);
        ASSERT_TRUE(mc);
        const Meta_Reference* mine = find_reference(mc, n.ref);
        const Meta_Reference* theirs = find_reference(mc->super_meta_class, n.ref);
        ASSERT_TRUE(mine && theirs);
        EXPECT_STREQ(n.type, mine->meta_class->name);
        EXPECT_STREQ(n.parent_type, theirs->meta_class->name);
        // The narrowed reference keeps the parent's slot and flags.
        EXPECT_EQ(theirs->offset, mine->offset);
        EXPECT_EQ(theirs->flags, mine->flags);
        EXPECT_TRUE(mine->flags & FLAG_KEY);
    }

    // The one class with three references keeps its unit as a plain device.
    const Meta_Class* path = must_find("VESPERA_SCSIInitiatorTargetLogicalUnitPath");
    ASSERT_TRUE(path);
    EXPECT_STREQ("CIM_LogicalDevice", find_reference(path, "LogicalUnit")->meta_class->name);
    EXPECT_EQ(3u, path->num_keys);
}

TEST(Catalogue, DefaultsOfTheModuleClasses)
{
    struct Default { const char* cls; const char* prop; Type type; uint64 value; };
    static const Default table[] =
    {
        { "VESPERA_PortController", "ControllerType", UINT16, 4 },
        { "VESPERA_StorageExtent", "NameFormat", UINT16, 12 },
        { "VESPERA_FCPort", "PortAvailability", UINT16, 2 },
    };
    for (const Default& d : table)
    {
        SCOPED_TRACE(std::string(d.cls) + "." + d.prop);
        const Meta_Class* mc = must_find(d.cls);
        ASSERT_TRUE(mc);
        const Meta_Property* mp = find_property(mc, d.prop);
        ASSERT_TRUE(mp && mp->value);
        EXPECT_EQ(d.type, mp->type);
        EXPECT_EQ(d.value, static_cast<const Meta_Value_Scalar<uint16>*>(mp->value)->value);

        Instance* i = create(mc, true);
        const Property<uint16>& slot = *(const Property<uint16>*)((const char*)i + mp->offset);
        EXPECT_EQ(d.value, slot.value);
        EXPECT_EQ(0, slot.null);
        destroy(i);
    }

    // The parents don't have those defaults: the module's classes add them.
    EXPECT_TRUE(find_property(must_find("CIM_PortController"), "ControllerType")->value == nullptr);
    EXPECT_TRUE(find_property(must_find("CIM_StorageExtent"), "NameFormat")->value == nullptr);

    // A default inherited from the schema stays with the module's class.
    const Meta_Property* removal = find_property(must_find("VESPERA_ConcreteJob"), "TimeBeforeRemoval");
    ASSERT_TRUE(removal && removal->value);
    EXPECT_STREQ("00000000000500.000000:000",
                 static_cast<const Meta_Value_Scalar<const char*>*>(removal->value)->value);

    VESPERA_FCPort* port = create<VESPERA_FCPort>(true);
    EXPECT_EQ(1, port->Caption.null);
    EXPECT_EQ(2, port->PortAvailability.value);
    destroy(port);
    port = create<VESPERA_FCPort>(false);
    EXPECT_EQ(0, port->Caption.null);
    EXPECT_EQ(0, port->PortAvailability.null);
    destroy(port);
}

TEST(Catalogue, AlertIndicationIsKeylessAndAddsCategory)
{
    const Meta_Class* mc = must_find("VESPERA_AlertIndication");
    ASSERT_TRUE(mc);
    EXPECT_EQ(0u, mc->num_keys);

    const Meta_Property* category = find_property(mc, "Category");
    ASSERT_TRUE(category);
    EXPECT_EQ(STRING, category->type);
    EXPECT_EQ(0, category->subscript);
    EXPECT_TRUE(find_property(mc->super_meta_class, "Category") == nullptr);

    for (const char* name : { "Message", "MessageArguments", "MessageID", "OwningEntity" })
    {
        const Meta_Property* mp = find_property(mc, name);
        ASSERT_TRUE(mp) << name;
        EXPECT_TRUE(mp->flags & FLAG_EXPERIMENTAL) << name;
        EXPECT_FALSE(find_property(mc->super_meta_class, name)->flags & FLAG_EXPERIMENTAL) << name;
    }
    EXPECT_FALSE(find_property(mc, "EventID")->flags & FLAG_EXPERIMENTAL);

    Instance* alert = create(mc, true);
    String path;
    EXPECT_EQ(-1, instance_to_model_path(alert, path));
    destroy(alert);
}

TEST(Catalogue, DiagnosticTestsAreTheOneDeepHierarchy)
{
    const Meta_Class* base = must_find("VESPERA_DiagnosticTest");
    ASSERT_TRUE(base);
    for (const char* name : { "VESPERA_MemoryDiagnosticTest", "VESPERA_LoopbackDiagnosticTest",
                              "VESPERA_PCILoopbackDiagnosticTest", "VESPERA_EthLoopbackDiagnosticTest" })
    {
        const Meta_Class* mc = must_find(name);
        ASSERT_TRUE(mc);
        EXPECT_EQ(base, mc->super_meta_class);
        EXPECT_EQ(0, is_subclass(repository(), "CIM_DiagnosticTest", name));
        EXPECT_NE(nullptr, find_method(mc, "RunDiagnostic"));
    }

    // Every other module class sits right on a CIM_ class, or on nothing.
    for (const Expected& e : catalogue)
    {
        if (strncmp(e.name, "VESPERA_", 8) || strstr(e.name, "DiagnosticTest"))
            continue;
        const Meta_Class* mc = must_find(e.name);
        if (mc->super_meta_class)
        {
            EXPECT_EQ(0, strncmp(mc->super_meta_class->name, "CIM_", 4)) << e.name;
        }
    }
}

TEST(Catalogue, AgentServiceStandsAlone)
{
    const Meta_Class* mc = must_find("VESPERA_AgentService");
    ASSERT_TRUE(mc);
    EXPECT_TRUE(mc->super_meta_class == nullptr);
    ASSERT_EQ(2u, mc->num_meta_features);
    EXPECT_EQ(1u, mc->num_keys);
    EXPECT_EQ(1, mc->locals[0]);
    EXPECT_EQ(1, mc->locals[1]);

    const Meta_Property* name = find_property(mc, "Name");
    ASSERT_TRUE(name);
    EXPECT_EQ(STRING, name->type);
    EXPECT_TRUE(name->flags & FLAG_KEY);

    const Meta_Method* mm = find_method(mc, "EXECUTEMETHOD");
    ASSERT_TRUE(mm);
    EXPECT_EQ(&VESPERA_AgentService_executeMethod_method::static_meta_class, mm);
    EXPECT_EQ(UINT32, mm->return_type);
    ASSERT_EQ(3u, mm->num_meta_features);
    const char* names[] = { "response", "request", "return_value" };
    uint32 dirs[] = { FLAG_OUT, FLAG_IN, FLAG_OUT };
    for (size_t i = 0; i < 3; i++)
    {
        const Meta_Property* p = (const Meta_Property*)mm->meta_features[i];
        EXPECT_STREQ(names[i], p->name);
        EXPECT_EQ(FLAG_PROPERTY, p->flags & FLAG_ANY_FEATURE);
        EXPECT_EQ(dirs[i], p->flags & (FLAG_IN | FLAG_OUT)) << names[i];
    }
    EXPECT_EQ(STRING, ((const Meta_Property*)mm->meta_features[0])->type);
    EXPECT_EQ(UINT32, ((const Meta_Property*)mm->meta_features[2])->type);
}

TEST(Catalogue, ModuleClassesMarkWhatTheyRedeclare)
{
    // A re-declared feature is local but, as a rule, keeps the parent's
    // type and flags; what the class adds comes after everything inherited.
    for (const Expected& e : catalogue)
    {
        if (strncmp(e.name, "VESPERA_", 8) != 0 || !e.parent)
            continue;
        SCOPED_TRACE(e.name);
        const Meta_Class* mc = must_find(e.name);
        const Meta_Class* parent = mc->super_meta_class;
        ASSERT_GE(mc->num_meta_features, parent->num_meta_features);
        for (size_t i = 0; i < parent->num_meta_features; i++)
        {
            const Meta_Feature* mine = mc->meta_features[i];
            const Meta_Feature* theirs = parent->meta_features[i];
            EXPECT_STREQ(theirs->name, mine->name);
            if (!mc->locals[i])
            {
                EXPECT_EQ(theirs, mine);
            }
            else if ((mine->flags & FLAG_PROPERTY) && strcmp(e.name, "VESPERA_AlertIndication"))
            {
                EXPECT_EQ(theirs->flags, mine->flags) << mine->name;
                EXPECT_EQ(((const Meta_Property*)theirs)->type, ((const Meta_Property*)mine)->type);
            }
        }
        for (size_t i = parent->num_meta_features; i < mc->num_meta_features; i++)
        {
            EXPECT_EQ(1, mc->locals[i]);
        }
    }
    // The port's provider fills these; the parent's defaults don't.
    const Meta_Class* port = must_find("VESPERA_FCPort");
    ssize_t i = find_feature_index(port, find_feature(port, "DeviceID"));
    ASSERT_GE(i, 0);
    EXPECT_EQ(1, port->locals[i]);
    i = find_feature_index(port, find_feature(port, "ActiveCOS"));
    ASSERT_GE(i, 0);
    EXPECT_EQ(0, port->locals[i]);
}

TEST(Catalogue, ModuleClassesDeclareWhatTheirProvidersFill)
{
    struct Filled { const char* cls; const char* props; };
    static const Filled table[] =
    {
        { "VESPERA_FCPort", "CreationClassName SystemCreationClassName SystemName DeviceID "
          "PermanentAddress ElementName Name Caption OperationalStatus UsageRestriction PortType "
          "Speed MaxSpeed LinkTechnology SupportedMaximumTransmissionUnit PortNumber EnabledState "
          "EnabledDefault" },
        { "VESPERA_PortController", "CreationClassName SystemCreationClassName SystemName DeviceID "
          "Name ElementName Caption Description OperationalStatus StatusDescriptions EnabledState "
          "ControllerType OtherControllerType" },
        { "VESPERA_AlarmDevice", "CreationClassName SystemCreationClassName SystemName Description "
          "DeviceID ElementName Caption VisibleAlarm Urgency AlarmState" },
        { "VESPERA_StorageExtent", "CreationClassName SystemCreationClassName SystemName ElementName "
          "DeviceID OtherIdentifyingInfo IdentifyingDescriptions OperationalStatus Name NameFormat "
          "NameNamespace" },
        { "VESPERA_ConcreteJob", "InstanceID Name JobState StartTime ElapsedTime PercentComplete" },
        { "VESPERA_DiagnosticCompletionRecord", "Caption ElementName Description InstanceID "
          "CreationTimeStamp RecordData ServiceName ManagedElementName RecordType RecordFormat "
          "CompletionState" },
        { "VESPERA_PCILoopbackDiagnosticTest", "Name ElementName SystemName CreationClassName "
          "SystemCreationClassName Characteristics OtherCharacteristicDescription" },
        { "VESPERA_RegisteredSubProfile", "InstanceID RegisteredName Caption ElementName "
          "RegisteredOrganization AdvertiseTypes RegisteredVersion Description" },
        { "VESPERA_Namespace", "SystemCreationClassName SystemName ObjectManagerCreationClassName "
          "ObjectManagerName CreationClassName Name ClassInfo ClassType ClassTypeVersion" },
        { "VESPERA_AlertIndication", "AlertingElementFormat SystemCreationClassName SystemName "
          "ProviderName EventTime IndicationTime OwningEntity AlertType ProbableCause "
          "IndicationIdentifier EventID PerceivedSeverity Message AlertingManagedElement "
          "OtherAlertType Category MessageArguments" },
        { "VESPERA_HBASoftwareInstallationServiceCapabilities", "InstanceID SupportedInstallOptions "
          "SupportedURISchemes SupportedSynchronousActions" },
        { "VESPERA_ProductElementComponent", "GroupComponent PartComponent" },
        { "VESPERA_SCSIInitiatorTargetLogicalUnitPath", "Initiator Target LogicalUnit" },
    };
    for (const Filled& f : table)
    {
        const Meta_Class* mc = must_find(f.cls);
        ASSERT_TRUE(mc);
        std::istringstream names(f.props);
        std::string name;
        while (names >> name)
        {
            const Meta_Feature* mf = find_feature(mc, name.c_str(), FLAG_PROPERTY | FLAG_REFERENCE);
            ssize_t i = mf ? find_feature_index(mc, mf) : -1;
            ASSERT_GE(i, 0) << f.cls << "." << name;
            EXPECT_EQ(1, mc->locals[i]) << f.cls << "." << name;
        }
    }
}
