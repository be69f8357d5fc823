// The extrinsic methods of the module's classes, and the call frames that
// carry their parameters.

#include <gtest/gtest.h>
#include <cstddef>
#include <cstring>
#include <set>
#include <string>
#include <vector>
#include "module.h"

// Frames derive from Instance, which is not standard-layout.
#pragma GCC diagnostic ignored "-Winvalid-offsetof"

using namespace OLMA;

namespace
{

struct Provider
{
    const char* cls;
    std::vector<std::string> methods;
};

// By provider, in the order of the class's features.
const Provider providers[] =
{
    { "VESPERA_ComputerSystem", { "RequestStateChange", "SetPowerState" } },
    { "VESPERA_PortController", { "RequestStateChange", "SetPowerState", "Reset", "EnableDevice", "OnlineDevice", "QuiesceDevice", "SaveProperties", "RestoreProperties" } },
    { "VESPERA_FCPort", { "RequestStateChange", "SetPowerState", "Reset", "EnableDevice", "OnlineDevice", "QuiesceDevice", "SaveProperties", "RestoreProperties" } },
    { "VESPERA_LogicalDisk", { "RequestStateChange", "SetPowerState", "Reset", "EnableDevice", "OnlineDevice", "QuiesceDevice", "SaveProperties", "RestoreProperties" } },
    { "VESPERA_StorageExtent", { "RequestStateChange", "SetPowerState", "Reset", "EnableDevice", "OnlineDevice", "QuiesceDevice", "SaveProperties", "RestoreProperties" } },
    { "VESPERA_EthernetPort", { "RequestStateChange", "SetPowerState", "Reset", "EnableDevice", "OnlineDevice", "QuiesceDevice", "SaveProperties", "RestoreProperties" } },
    { "VESPERA_FCPortStatistics", { "ResetSelectedStats" } },
    { "VESPERA_PhysicalPackage", { "IsCompatible" } },
    { "VESPERA_SCSIProtocolEndpoint", { "RequestStateChange", "BroadcastReset" } },
    { "VESPERA_LANEndpoint", { "RequestStateChange", "BroadcastReset" } },
    { "VESPERA_ObjectManager", { "RequestStateChange", "StartService", "StopService", "ChangeAffectedElementsAssignedSequence" } },
    { "VESPERA_CIMXMLCommunicationMechanism", { "RequestStateChange" } },
    { "VESPERA_RemoteServiceAccessPoint", { "RequestStateChange" } },
    { "VESPERA_RegisteredProfile", { "CloseConformantInstances", "OpenConformantInstances", "PullConformantInstances" } },
    { "VESPERA_RegisteredSubProfile", { "CloseConformantInstances", "OpenConformantInstances", "PullConformantInstances" } },
    { "VESPERA_TapeDrive", { "RequestStateChange", "SetPowerState", "Reset", "EnableDevice", "OnlineDevice", "QuiesceDevice", "SaveProperties", "RestoreProperties", "LockMedia" } },
    { "VESPERA_HBASoftwareInstallationService", { "RequestStateChange", "StartService", "StopService", "ChangeAffectedElementsAssignedSequence", "CheckSoftwareIdentity", "InstallFromSoftwareIdentity", "InstallFromByteStream", "InstallFromURI" } },
    { "VESPERA_HBASoftwareInstallationServiceCapabilities", { "CreateGoalSettings" } },
    { "VESPERA_MemoryDiagnosticTest", { "RequestStateChange", "StartService", "StopService", "ChangeAffectedElementsAssignedSequence", "RunDiagnostic", "RunDiagnosticService", "RunTest", "ClearResults", "DiscontinueTest" } },
    { "VESPERA_LoopbackDiagnosticTest", { "RequestStateChange", "StartService", "StopService", "ChangeAffectedElementsAssignedSequence", "RunDiagnostic", "RunDiagnosticService", "RunTest", "ClearResults", "DiscontinueTest" } },
    { "VESPERA_PCILoopbackDiagnosticTest", { "RequestStateChange", "StartService", "StopService", "ChangeAffectedElementsAssignedSequence", "RunDiagnostic", "RunDiagnosticService", "RunTest", "ClearResults", "DiscontinueTest" } },
    { "VESPERA_EthLoopbackDiagnosticTest", { "RequestStateChange", "StartService", "StopService", "ChangeAffectedElementsAssignedSequence", "RunDiagnostic", "RunDiagnosticService", "RunTest", "ClearResults", "DiscontinueTest" } },
    { "VESPERA_ConcreteJob", { "KillJob", "RequestStateChange", "GetError", "GetErrors" } },
    { "VESPERA_AlarmDevice", { "RequestStateChange", "SetPowerState", "Reset", "EnableDevice", "OnlineDevice", "QuiesceDevice", "SaveProperties", "RestoreProperties", "SetAlarmState", "SetAlarmIndicator", "SetUrgency" } },
    { "VESPERA_AgentService", { "executeMethod" } },
};

std::vector<std::string> methods_of(const Meta_Class* mc)
{
    std::vector<std::string> r;
    for (size_t i = 0; i < mc->num_meta_features; i++)
        if (mc->meta_features[i]->flags & FLAG_METHOD)
            r.push_back(mc->meta_features[i]->name);
    return r;
}

const Meta_Method* method(const char* cls, const char* name)
{
    const Meta_Class* mc = find_meta_class(repository(), cls);
    return mc ? find_method(mc, name) : nullptr;
}

std::string signature(const Meta_Method* mm)
{
    std::string r;
    for (size_t i = 0; i < mm->num_meta_features; i++)
    {
        const Meta_Feature* f = mm->meta_features[i];
        r += i ? "," : "";
        r += f->name;
        if (f->flags & FLAG_IN)
            r += "<";
        if (f->flags & FLAG_OUT)
            r += ">";
    }
    return r;
}

} // namespace

TEST(Methods, EachProviderHasItsMethodsInOrder)
{
    std::set<std::string> listed;
    for (const Provider& p : providers)
    {
        const Meta_Class* mc = find_meta_class(repository(), p.cls);
        ASSERT_TRUE(mc) << p.cls;
        EXPECT_EQ(p.methods, methods_of(mc)) << p.cls;
        listed.insert(p.cls);
    }
    // Every other module class with a provider has no method at all.
    const Meta_Repository* mr = repository();
    for (size_t i = 0; i < mr->num_meta_classes; i++)
    {
        const Meta_Class* mc = mr->meta_classes[i];
        if (strncmp(mc->name, "VESPERA_", 8) || listed.count(mc->name) ||
            strcmp(mc->name, "VESPERA_DiagnosticTest") == 0)
            continue;
        EXPECT_TRUE(methods_of(mc).empty()) << mc->name;
    }
}

TEST(Methods, ParametersStandInSchemaOrderWithReturnValueLast)
{
    const Meta_Repository* mr = repository();
    size_t records = 0;
    std::set<const Meta_Method*> seen;
    for (size_t i = 0; i < mr->num_meta_classes; i++)
    {
        const Meta_Class* mc = mr->meta_classes[i];
        for (size_t j = 0; j < mc->num_meta_features; j++)
        {
            const Meta_Feature* f = mc->meta_features[j];
            if (!(f->flags & FLAG_METHOD) || !seen.insert((const Meta_Method*)f).second)
                continue;
            records++;
            const Meta_Method* mm = (const Meta_Method*)f;
            SCOPED_TRACE(std::string(mc->name) + "." + mm->name);
            ASSERT_GE(mm->num_meta_features, 1u);
            const Meta_Property* rv = (const Meta_Property*)mm->meta_features[mm->num_meta_features - 1];
            EXPECT_STREQ("return_value", rv->name);
            EXPECT_EQ(FLAG_PROPERTY | FLAG_OUT, rv->flags);
            EXPECT_EQ(mm->return_type, rv->type);
            EXPECT_EQ(0, rv->subscript);
            // The frame's last slot, right where the record ends.
            EXPECT_LE(rv->offset + type_size[rv->type] + 1, mm->size);
            for (size_t k = 0; k + 1 < mm->num_meta_features; k++)
            {
                const Meta_Feature* p = mm->meta_features[k];
                EXPECT_TRUE(p->flags & (FLAG_IN | FLAG_OUT)) << p->name;
                EXPECT_NE(0u, p->flags & (FLAG_PROPERTY | FLAG_REFERENCE)) << p->name;
                EXPECT_EQ(0u, p->flags & FLAG_METHOD);
            }
        }
    }
    // One record per method that a class declares.
    EXPECT_EQ(45u, records);
}

TEST(Methods, SignaturesOfTheMethodsThatDoSomething)
{
    struct Sig { const char* cls; const char* method; const char* params; Type rt; };
    static const Sig table[] =
    {
        { "VESPERA_AgentService", "executeMethod", "response>,request<,return_value>", UINT32 },
        { "VESPERA_MemoryDiagnosticTest", "RunDiagnostic",
          "ManagedElement<,DiagSetting<,JobSetting<,Job>,return_value>", UINT32 },
        { "VESPERA_EthLoopbackDiagnosticTest", "RunDiagnostic",
          "ManagedElement<,DiagSetting<,JobSetting<,Job>,return_value>", UINT32 },
        { "VESPERA_HBASoftwareInstallationService", "InstallFromURI",
          "Job>,URI<,Target<,InstallOptions<,InstallOptionsValues<,return_value>", UINT32 },
        { "VESPERA_AlarmDevice", "SetAlarmState", "RequestedAlarmState<,return_value>", UINT32 },
        { "VESPERA_FCPort", "RequestStateChange", "RequestedState<,Job>,TimeoutPeriod<,return_value>", UINT32 },
        { "VESPERA_ObjectManager", "ChangeAffectedElementsAssignedSequence",
          "ManagedElements<,AssignedSequence<,Job>,return_value>", UINT32 },
        { "VESPERA_HBASoftwareInstallationServiceCapabilities", "CreateGoalSettings",
          "TemplateGoalSettings<,SupportedGoalSettings<>,return_value>", UINT16 },
        { "VESPERA_RegisteredSubProfile", "CloseConformantInstances", "EnumerationContext<,return_value>", UINT32 },
        { "VESPERA_LANEndpoint", "BroadcastReset", "return_value>", UINT32 },
    };
    for (const Sig& s : table)
    {
        const Meta_Method* mm = method(s.cls, s.method);
        ASSERT_TRUE(mm) << s.cls << "." << s.method;
        EXPECT_EQ(s.params, signature(mm)) << s.cls << "." << s.method;
        EXPECT_EQ(s.rt, mm->return_type);
    }

    // Method names match in any case, but only methods: a property of the
    // same name is not one.
    EXPECT_EQ(method("VESPERA_FCPort", "RequestStateChange"), method("VESPERA_FCPort", "requeststatechange"));
    EXPECT_TRUE(method("VESPERA_FCPort", "DeviceID") == nullptr);
}

TEST(Methods, RecordsMatchTheirTables)
{
    // The frame of RunDiagnostic, reached under the test class's own name.
    typedef VESPERA_MemoryDiagnosticTest_RunDiagnostic_method Frame;
    const Meta_Method* mm = &Frame::static_meta_class;
    EXPECT_EQ(mm, method("VESPERA_MemoryDiagnosticTest", "RunDiagnostic"));
    EXPECT_EQ(sizeof(Frame), mm->size);

    const Meta_Reference* element = find_reference(mm, "ManagedElement");
    ASSERT_TRUE(element);
    EXPECT_EQ(offsetof(Frame, ManagedElement), element->offset);
    EXPECT_STREQ("CIM_ManagedElement", element->meta_class->name);
    const Meta_Reference* setting = find_reference(mm, "DiagSetting");
    ASSERT_TRUE(setting);
    EXPECT_STREQ("CIM_DiagnosticSetting", setting->meta_class->name);
    EXPECT_EQ(offsetof(Frame, DiagSetting), setting->offset);
    EXPECT_TRUE(find_parameter(mm, "DiagSetting") == nullptr);
    const Meta_Property* rv = find_parameter(mm, "return_value");
    EXPECT_EQ(offsetof(Frame, return_value), rv->offset);
    EXPECT_EQ(offsetof(Frame, return_value.null), rv->offset + type_size[UINT32]);

    // create() serves frames too; every slot starts out usable.
    Frame* frame = create<Frame>();
    ASSERT_TRUE(frame);
    EXPECT_EQ(mm, (const Meta_Method*)(const void*)frame->meta_class);
    EXPECT_TRUE(frame->ManagedElement == nullptr);
    frame->return_value.set(7);
    EXPECT_EQ(7u, frame->return_value.value);
    destroy(frame);

    typedef VESPERA_HBASoftwareInstallationService_InstallFromURI_method Install;
    const Meta_Method* install = &Install::static_meta_class;
    const Meta_Property* options = find_parameter(install, "InstallOptions");
    ASSERT_TRUE(options);
    EXPECT_EQ(-1, options->subscript);
    EXPECT_EQ(offsetof(Install, InstallOptions.null), options->offset + 8);
    Install* in = create<Install>();
    in->InstallOptions.value.append(4);
    in->URI.set("file:///tmp/image");
    destroy(in);
}
