#!/usr/bin/env python3
"""Generates the provider glue of the module: for each provider its dispatch
function, its Registration record and its exported CMPI entries, plus the
linker version script and the list of exported names; the test that calls
every operation and method of every provider through its dispatch; and the
registrations with the CIM servers: SFCB's .reg file, OpenPegasus's
registration instances, and the MOF of the classes that the interop
namespace needs.

    tools/gen_providers.py [--schema DIR] [--out-dir DIR] [--tests-dir DIR]
                           [--reg-dir DIR] [--check]

A dispatch function calls only the members that its provider class declares
(cmpi/Dispatch.h finds them at compile time); the generated code names every
method the class model gives, whether the provider has it or not.

The providers, their order and kinds are the tables below; the extrinsic
methods and their parameters come from the class model that
tools/gen_schema.py builds (the DMTF MOF under --schema plus the module's
MOF), so that the dispatch functions and the method records agree. Output is
deterministic.
"""

import argparse
import os
import re
import sys

HERE = os.path.dirname(os.path.abspath(__file__))
ROOT = os.path.dirname(HERE)
sys.path.insert(0, HERE)

import gen_schema  # noqa: E402

# Providers in registration order, with the parent of the class they serve
# and the kind of that class: 'C' plain, 'A' association, 'N' indication.
PROVIDERS = [
    ("VESPERA_ComputerSystem", "CIM_ComputerSystem", "C"),
    ("VESPERA_PortController", "CIM_PortController", "C"),
    ("VESPERA_FCPort", "CIM_FCPort", "C"),
    ("VESPERA_FCPortStatistics", "CIM_FCPortStatistics", "C"),
    ("VESPERA_AdapterSoftwareIdentity", "CIM_SoftwareIdentity", "C"),
    ("VESPERA_PhysicalPackage", "CIM_PhysicalPackage", "C"),
    ("VESPERA_Product", "CIM_Product", "C"),
    ("VESPERA_SCSIProtocolEndpoint", "CIM_SCSIProtocolEndpoint", "C"),
    ("VESPERA_ElementStatisticalData", "CIM_ElementStatisticalData", "A"),
    ("VESPERA_ControlledBy", "CIM_ControlledBy", "A"),
    ("VESPERA_AdapterElementSoftwareIdentity", "CIM_ElementSoftwareIdentity", "A"),
    ("VESPERA_Realizes", "CIM_Realizes", "A"),
    ("VESPERA_ProductPhysicalComponent", "CIM_ProductPhysicalComponent", "A"),
    ("VESPERA_FCPortSystemDevice", "CIM_SystemDevice", "A"),
    ("VESPERA_PortControllerSystemDevice", "CIM_SystemDevice", "A"),
    ("VESPERA_HostedAccessPoint", "CIM_HostedAccessPoint", "A"),
    ("VESPERA_DeviceSAPImplementation", "CIM_DeviceSAPImplementation", "A"),
    ("VESPERA_InstalledSoftwareIdentity", "CIM_InstalledSoftwareIdentity", "A"),
    ("VESPERA_ObjectManager", "CIM_ObjectManager", "C"),
    ("VESPERA_Namespace", "CIM_Namespace", "C"),
    ("VESPERA_CIMXMLCommunicationMechanism", "CIM_CIMXMLCommunicationMechanism", "C"),
    ("VESPERA_CommMechanismForManager", "CIM_CommMechanismForManager", "A"),
    ("VESPERA_NamespaceInManager", "CIM_NamespaceInManager", "A"),
    ("VESPERA_ObjectManagerHostedService", "CIM_HostedService", "A"),
    ("VESPERA_CommMechHostedAccessPoint", "CIM_HostedAccessPoint", "A"),
    ("VESPERA_RegisteredProfile", "CIM_RegisteredProfile", "C"),
    ("VESPERA_RegisteredSubProfile", "CIM_RegisteredSubProfile", "C"),
    ("VESPERA_ProfileSoftwareIdentity", "CIM_SoftwareIdentity", "C"),
    ("VESPERA_ElementConformsToProfile", "CIM_ElementConformsToProfile", "A"),
    ("VESPERA_ProfileElementSoftwareIdentity", "CIM_ElementSoftwareIdentity", "A"),
    ("VESPERA_SubProfileRequiresProfile", "CIM_SubProfileRequiresProfile", "A"),
    ("VESPERA_LogicalDisk", "CIM_LogicalDisk", "C"),
    ("VESPERA_StorageExtent", "CIM_StorageExtent", "C"),
    ("VESPERA_TapeDrive", "CIM_TapeDrive", "C"),
    ("VESPERA_StorageResourcesSystemDevice", "CIM_SystemDevice", "A"),
    ("VESPERA_RemoteServiceAccessPoint", "CIM_RemoteServiceAccessPoint", "C"),
    ("VESPERA_RemoteServiceHostedAccessPoint", "CIM_HostedAccessPoint", "A"),
    ("VESPERA_HBASoftwareInstallationService", "CIM_SoftwareInstallationService", "C"),
    ("VESPERA_HBASoftwareInstallationServiceCapabilities", "CIM_SoftwareInstallationServiceCapabilities", "C"),
    ("VESPERA_HBASoftwareInstallationServiceHostedService", "CIM_HostedService", "A"),
    ("VESPERA_HBASoftwareInstallationServiceElementCapabilities", "CIM_ElementCapabilities", "A"),
    ("VESPERA_EthernetPort", "CIM_EthernetPort", "C"),
    ("VESPERA_EthernetPortSystemDevice", "CIM_SystemDevice", "A"),
    ("VESPERA_EthernetPortControlledBy", "CIM_ControlledBy", "A"),
    ("VESPERA_ProductElementComponent", "CIM_ProductElementComponent", "A"),
    ("VESPERA_AlertIndication", "CIM_AlertIndication", "N"),
    ("VESPERA_MemoryDiagnosticTest", "CIM_DiagnosticTest", "C"),
    ("VESPERA_LoopbackDiagnosticTest", "CIM_DiagnosticTest", "C"),
    ("VESPERA_PCILoopbackDiagnosticTest", "CIM_DiagnosticTest", "C"),
    ("VESPERA_EthLoopbackDiagnosticTest", "CIM_DiagnosticTest", "C"),
    ("VESPERA_DiagnosticSoftwareIdentity", "CIM_SoftwareIdentity", "C"),
    ("VESPERA_ConcreteJob", "CIM_ConcreteJob", "C"),
    ("VESPERA_DiagnosticServiceRecord", "CIM_DiagnosticServiceRecord", "C"),
    ("VESPERA_DiagnosticCompletionRecord", "CIM_DiagnosticCompletionRecord", "C"),
    ("VESPERA_DiagnosticElementSoftwareIdentity", "CIM_ElementSoftwareIdentity", "A"),
    ("VESPERA_OwningJobElement", "CIM_OwningJobElement", "A"),
    ("VESPERA_AffectedJobElement", "CIM_AffectedJobElement", "A"),
    ("VESPERA_AvailableDiagnosticServiceForAdapter", "CIM_AvailableDiagnosticService", "A"),
    ("VESPERA_AvailableDiagnosticServiceForFCPort", "CIM_AvailableDiagnosticService", "A"),
    ("VESPERA_AvailableDiagnosticServiceForEthernetPort", "CIM_AvailableDiagnosticService", "A"),
    ("VESPERA_ServiceRecordAppliesToElement", "CIM_RecordAppliesToElement", "A"),
    ("VESPERA_CompletionRecordAppliesToElement", "CIM_RecordAppliesToElement", "A"),
    ("VESPERA_LogicalPortGroup", "CIM_LogicalPortGroup", "C"),
    ("VESPERA_MemberOfCollection", "CIM_MemberOfCollection", "A"),
    ("VESPERA_HostedCollection", "CIM_HostedCollection", "A"),
    ("VESPERA_HostedDependency", "CIM_HostedDependency", "A"),
    ("VESPERA_PhysicalConnector", "CIM_PhysicalConnector", "C"),
    ("VESPERA_EthernetPortRealizes", "CIM_Realizes", "A"),
    ("VESPERA_PhysicalConnectorContainer", "CIM_Container", "A"),
    ("VESPERA_LANEndpoint", "CIM_LANEndpoint", "C"),
    ("VESPERA_LANEndpointDeviceSAPImplementation", "CIM_DeviceSAPImplementation", "A"),
    ("VESPERA_HostedLANEndpoint", "CIM_HostedAccessPoint", "A"),
    ("VESPERA_AlarmDevice", "CIM_AlarmDevice", "C"),
    ("VESPERA_AssociatedAlarm", "CIM_AssociatedAlarm", "A"),
    ("VESPERA_SCSIInitiatorTargetLogicalUnitPath", "CIM_SCSIInitiatorTargetLogicalUnitPath", "A"),
    ("VESPERA_AgentService", None, "C"),
]

# The classes that are also served in the CIM server's interop namespace,
# where SMI-S clients start their discovery: the profiles, what implements
# them and the server's side of the profile tree. VESPERA_ObjectManager stays
# out on purpose: the module learns the server's own name by enumerating
# CIM_ObjectManager in that namespace, and with a provider of ours among the
# answers the server would call back into the very provider that is waiting
# for it (a deadlock on a real server). References to it from the interop
# namespace point into root/vespera.
INTEROP = [
    "VESPERA_RegisteredProfile",
    "VESPERA_RegisteredSubProfile",
    "VESPERA_ProfileSoftwareIdentity",
    "VESPERA_Namespace",
    "VESPERA_CIMXMLCommunicationMechanism",
    "VESPERA_ElementConformsToProfile",
    "VESPERA_SubProfileRequiresProfile",
    "VESPERA_ProfileElementSoftwareIdentity",
    "VESPERA_CommMechanismForManager",
    "VESPERA_NamespaceInManager",
    "VESPERA_ObjectManagerHostedService",
    "VESPERA_CommMechHostedAccessPoint",
]

MODULE = "vsprprovider_Module"
NAMESPACE = "root/vespera"
SFCB_INTEROP = "root/interop"
PEGASUS_INTEROP = "root/PG_InterOp"

DEVICE_OPS = ["RequestStateChange", "SetPowerState", "Reset", "EnableDevice",
              "OnlineDevice", "QuiesceDevice", "SaveProperties", "RestoreProperties"]
SERVICE_OPS = ["RequestStateChange", "StartService", "StopService",
               "ChangeAffectedElementsAssignedSequence"]
DIAG_OPS = SERVICE_OPS + ["RunDiagnostic", "RunDiagnosticService", "RunTest",
                          "ClearResults", "DiscontinueTest"]
PROFILE_OPS = ["CloseConformantInstances", "OpenConformantInstances",
               "PullConformantInstances"]

# Extrinsic methods per class, in the order of the class's features.
METHODS = {
    "VESPERA_ComputerSystem": ["RequestStateChange", "SetPowerState"],
    "VESPERA_PortController": DEVICE_OPS,
    "VESPERA_FCPort": DEVICE_OPS,
    "VESPERA_LogicalDisk": DEVICE_OPS,
    "VESPERA_StorageExtent": DEVICE_OPS,
    "VESPERA_EthernetPort": DEVICE_OPS,
    "VESPERA_FCPortStatistics": ["ResetSelectedStats"],
    "VESPERA_PhysicalPackage": ["IsCompatible"],
    "VESPERA_SCSIProtocolEndpoint": ["RequestStateChange", "BroadcastReset"],
    "VESPERA_LANEndpoint": ["RequestStateChange", "BroadcastReset"],
    "VESPERA_ObjectManager": SERVICE_OPS,
    "VESPERA_CIMXMLCommunicationMechanism": ["RequestStateChange"],
    "VESPERA_RemoteServiceAccessPoint": ["RequestStateChange"],
    "VESPERA_RegisteredProfile": PROFILE_OPS,
    "VESPERA_RegisteredSubProfile": PROFILE_OPS,
    "VESPERA_TapeDrive": DEVICE_OPS + ["LockMedia"],
    "VESPERA_HBASoftwareInstallationService": SERVICE_OPS + [
        "CheckSoftwareIdentity", "InstallFromSoftwareIdentity",
        "InstallFromByteStream", "InstallFromURI"],
    "VESPERA_HBASoftwareInstallationServiceCapabilities": ["CreateGoalSettings"],
    "VESPERA_MemoryDiagnosticTest": DIAG_OPS,
    "VESPERA_LoopbackDiagnosticTest": DIAG_OPS,
    "VESPERA_PCILoopbackDiagnosticTest": DIAG_OPS,
    "VESPERA_EthLoopbackDiagnosticTest": DIAG_OPS,
    "VESPERA_ConcreteJob": ["KillJob", "RequestStateChange", "GetError", "GetErrors"],
    "VESPERA_AlarmDevice": DEVICE_OPS + ["SetAlarmState", "SetAlarmIndicator",
                                         "SetUrgency"],
    "VESPERA_AgentService": ["executeMethod"],
}

# Where each provider class lives.
SERVER = {"VESPERA_RegisteredProfile", "VESPERA_RegisteredSubProfile",
          "VESPERA_Namespace", "VESPERA_ObjectManager",
          "VESPERA_CIMXMLCommunicationMechanism", "VESPERA_ProfileSoftwareIdentity"}
DIAG = {"VESPERA_MemoryDiagnosticTest", "VESPERA_LoopbackDiagnosticTest",
        "VESPERA_PCILoopbackDiagnosticTest", "VESPERA_EthLoopbackDiagnosticTest",
        "VESPERA_DiagnosticSoftwareIdentity", "VESPERA_ConcreteJob",
        "VESPERA_DiagnosticServiceRecord", "VESPERA_DiagnosticCompletionRecord",
        "VESPERA_DiagnosticElementSoftwareIdentity", "VESPERA_OwningJobElement",
        "VESPERA_AffectedJobElement", "VESPERA_AvailableDiagnosticServiceForAdapter",
        "VESPERA_AvailableDiagnosticServiceForFCPort",
        "VESPERA_AvailableDiagnosticServiceForEthernetPort",
        "VESPERA_ServiceRecordAppliesToElement",
        "VESPERA_CompletionRecordAppliesToElement"}
UPDATE = {"VESPERA_HBASoftwareInstallationService",
          "VESPERA_HBASoftwareInstallationServiceCapabilities",
          "VESPERA_HBASoftwareInstallationServiceHostedService",
          "VESPERA_HBASoftwareInstallationServiceElementCapabilities"}


def home_dir(cls):
    if cls in SERVER:
        return "server"
    if cls in DIAG:
        return "diag"
    if cls in UPDATE:
        return "update"
    if cls == "VESPERA_AlertIndication":
        return "indication"
    if cls == "VESPERA_AgentService":
        return "rpc"
    return "model"


def slot_type(p):
    """The C++ type of a parameter's slot in the method record."""
    return gen_schema.slot_type(p)


def is_out(p):
    return bool(p.flags & gen_schema.F_OUT)


def param_type(p):
    """The type of the provider member's parameter for p."""
    if p.kind == "reference" and not p.subscript:
        return ("%s*&" if is_out(p) else "const %s*") % p.type
    return ("%s&" if is_out(p) else "const %s&") % slot_type(p)


def param_decl(p):
    """The provider member's parameter for p."""
    return "%s %s" % (param_type(p), p.member)


KIND_FLAGS = {"C": gen_schema.F_CLASS, "A": gen_schema.F_ASSOCIATION,
              "N": gen_schema.F_INDICATION}


def collect(model):
    out = []
    for cls, parent, kind in PROVIDERS:
        c = model.classes[cls.lower()]
        if not (c.flags & KIND_FLAGS[kind]):
            raise ValueError("%s is not of kind %s" % (cls, kind))
        methods = [f for f in c.features if f.kind == "method"]
        names = [m.name for m in methods]
        if names != METHODS.get(cls, []):
            raise ValueError("%s has the methods %s" % (cls, names))
        out.append(dict(cls=cls, parent=parent, kind=kind, methods=methods))
    return out


def entry_kinds(kind):
    if kind == "N":
        return ["Method", "Indication"]
    if kind == "A":
        return ["Instance", "Method", "Association"]
    return ["Instance", "Method"]


KIND_TYPES = {"Instance": ("CMPIInstanceMI", "I"), "Method": ("CMPIMethodMI", "M"),
              "Association": ("CMPIAssociationMI", "A"),
              "Indication": ("CMPIIndicationMI", "N")}

MARK = "// Generated by tools/gen_providers.py from its provider tables and the class model of tools/gen_schema.py; do not edit.\n"


def gen_cpp(provs):
    w = []
    a = w.append
    a(MARK)
    a("\n#include <strings.h>\n")
    a('#include "Dispatch.h"\n')
    a('#include "CMPI_Adapter.h"\n')
    for p in provs:
        a('#include "%s.h"\n' % p["cls"])
        a('#include "%s_Provider.h"\n' % p["cls"])
    a("\nnamespace OLMA\n{\n\n")
    a('static const char _tessel_module_name[] = "vsprprovider_Module";\n\n')
    a("// A provider declares only the extrinsic methods it implements; the\n"
      "// others answer INVOKE_METHOD_UNSUPPORTED.\n")
    for name in sorted({m.name for p in provs for m in p["methods"]}):
        a("TESSEL_PROVIDER_MEMBER(%s);\n" % name)
    a("\n")
    prev = "0"
    for p in provs:
        cls = p["cls"]
        prov = cls + "_Provider"
        if p["methods"]:
            a("static sint32 _%s_invoke(\n    %s* provider, const %s* self, Instance* method)\n{\n"
              % (prov, prov, cls))
            a("    const char* name = __method_name(method);\n")
            a("    if (!name)\n        return -1;\n")
            for m in p["methods"]:
                rec = "%s_%s_method" % (cls, m.name)
                a("\n    if (strcasecmp(name, \"%s\") == 0)\n    {\n" % m.name)
                a("        // Only the class's own record has the layout cast to here.\n")
                a("        if (!__is_record<%s>(method))\n            return -1;\n" % rec)
                a("        %s* m = (%s*)method;\n" % (rec, rec))
                sig = ", ".join(["const %s*" % cls] + [param_type(q) for q in m.params])
                args = ", ".join(["self"] + ["m->%s" % q.member for q in m.params])
                a("        return __call_member<__member_%s<%s,\n"
                  "            Invoke_Method_Status(%s)> >(\n"
                  "            provider, INVOKE_METHOD_UNSUPPORTED, %s);\n    }\n"
                  % (m.name, prov, sig, args))
            a("\n    return -1;\n}\n\n")
        a("extern \"C\" sint32 __tessel_%s_proc(\n    const Registration* registration, int operation,\n"
          "    void* arg0, void* arg1, void* arg2, void* arg3,\n"
          "    void* arg4, void* arg5, void* arg6, void* arg7)\n{\n" % prov)
        if p["methods"]:
            a("    if (operation == OP_INVOKE_METHOD)\n")
            a("        return _%s_invoke((%s*)arg0, (const %s*)arg1, (Instance*)arg2);\n\n"
              % (prov, prov, cls))
        disp = {"C": "__dispatch_instance", "A": "__dispatch_association",
                "N": "__dispatch_indication"}[p["kind"]]
        a("    return %s<%s, %s>(\n        registration, operation, arg0, arg1, arg2, arg3, arg4, arg5, arg6, arg7);\n}\n\n"
          % (disp, cls, prov))
        a("static Registration _%s_registration =\n{\n" % prov)
        a("    _tessel_module_name,\n    \"%s\",\n    __tessel_%s_proc,\n    &%s::static_meta_class,\n    %s,\n};\n\n"
          % (prov, prov, cls, prev))
        a("static CMPI_Static_Data _cmpi_static_data%s;\n\n" % prov)
        prev = "&_%s_registration" % prov
    a("extern \"C\" CMPI_EXPORT const Registration* tessel_module()\n{\n    return %s;\n}\n\n" % prev)
    a("} // namespace OLMA\n\nusing namespace OLMA;\n\n")
    for p in provs:
        prov = p["cls"] + "_Provider"
        for kind in entry_kinds(p["kind"]):
            mi, letter = KIND_TYPES[kind]
            a("extern \"C\" CMPI_EXPORT %s* %s_Create_%sMI(\n"
              "    const CMPIBroker* broker, const CMPIContext* context, CMPIStatus*)\n{\n"
              "    void* mi = 0;\n"
              "    tessel_cmpi_adapter(&_cmpi_static_data%s, &_%s_registration,\n"
              "        broker, context, \"%s\", '%s', &mi);\n"
              "    return (%s*)mi;\n}\n\n"
              % (mi, prov, kind, prov, prov, prov, letter, mi))
            a("extern \"C\" CMPI_EXPORT %s* %s_Create_%sMI(\n"
              "    const CMPIBroker* broker, const CMPIContext* context, CMPIStatus* status)\n{\n"
              "    return %s_Create_%sMI(broker, context, status);\n}\n\n"
              % (mi, p["cls"], kind, prov, kind))
    text = "".join(w)
    return text.rstrip("\n") + "\n"


def export_names(provs):
    names = []
    for p in provs:
        for kind in entry_kinds(p["kind"]):
            names.append("%s_Provider_Create_%sMI" % (p["cls"], kind))
            names.append("%s_Create_%sMI" % (p["cls"], kind))
    names += ["tessel_module", "__tessel_version_2_0_16"]
    return sorted(names)


def gen_exports(provs):
    return "".join(n + "\n" for n in export_names(provs))


def gen_version_script(provs):
    w = ["/* Generated by tools/gen_providers.py from its provider tables; do not edit.\n"
         "   Only the CMPI entries, tessel_module and the version word leave the module. */\n",
         "{\n  global:\n"]
    for n in export_names(provs):
        w.append("    %s;\n" % n)
    w.append("  local:\n    *;\n};\n")
    return "".join(w)


TEST_MARK = ("// Generated by tools/gen_providers.py from its provider tables and the class model of "
             "tools/gen_schema.py; do not edit.\n")


def gen_test(provs):
    """The test that calls every operation and method of every provider
    through its dispatch function; the outcomes it expects are data, in
    tests/cmpi/dispatch_outcomes.txt."""
    w = [TEST_MARK, "\n#include \"dispatch_outcomes.h\"\n\n", "extern \"C\"\n{\n"]
    for p in provs:
        w.append("OLMA::sint32 __tessel_%s_Provider_proc(const OLMA::Registration*, int,\n"
                 "    void*, void*, void*, void*, void*, void*, void*, void*);\n" % p["cls"])
    w.append("}\n\nnamespace dispatch_test\n{\n\nstatic const Case cases[] =\n{\n")
    for p in provs:
        prov = p["cls"] + "_Provider"
        methods = "".join(' "%s",' % m.name for m in p["methods"]).rstrip(",")
        w.append("    { \"%s\", __tessel_%s_proc,\n      {%s } },\n" % (prov, prov, methods))
    w.append("};\n\n"
             "class Dispatch : public ::testing::TestWithParam<Case>\n{\n};\n\n"
             "TEST_P(Dispatch, EveryOperationAndMethod)\n{\n    Calls(GetParam()).all();\n}\n\n"
             "INSTANTIATE_TEST_SUITE_P(Providers, Dispatch, ::testing::ValuesIn(cases),\n"
             "    [](const ::testing::TestParamInfo<Case>& info) { return std::string(info.param.provider); });\n\n"
             "TEST(DispatchOutcomes, NameEveryProviderAndNoOther)\n{\n"
             "    std::set<std::string> providers;\n"
             "    for (const Case& c : cases)\n        providers.insert(c.provider);\n"
             "    for (const Table::value_type& row : outcomes())\n"
             "        EXPECT_TRUE(providers.count(row.first)) << row.first;\n"
             "    EXPECT_EQ(providers.size(), outcomes().size());\n}\n\n"
             "} // namespace dispatch_test\n")
    return "".join(w)


REG_TYPES = {"C": "instance method", "A": "instance association method",
             "N": "indication method"}


def namespaces(cls, interop):
    return [NAMESPACE, interop] if cls in INTEROP else [NAMESPACE]


def gen_reg(provs):
    """SFCB's registration file, which cimhost reads too."""
    w = ["# Generated by tools/gen_providers.py from its provider tables; do not edit.\n",
         "#\n"
         "# Registration of the providers of vsprprovider_Module with SFCB (cimhost\n"
         "# reads the same file). One section per class: the provider that serves it,\n"
         "# the library (without lib and .so), the MI kinds it exports and the\n"
         "# namespaces it serves. The profile classes are served in SFCB's interop\n"
         "# namespace too, where SMI-S clients look for them; their classes go there\n"
         "# from vespera-interop.mof.\n"]
    for p in provs:
        w.append("\n[%s]\n" % p["cls"])
        w.append("   provider: %s_Provider\n" % p["cls"])
        w.append("   location: %s\n" % MODULE)
        w.append("   type: %s\n" % REG_TYPES[p["kind"]])
        w.append("   namespace: %s\n" % " ".join(namespaces(p["cls"], SFCB_INTEROP)))
    return "".join(w)


PEGASUS_TYPES = {"C": "2, 5", "A": "2, 3, 5", "N": "4, 5"}


def project_version():
    with open(os.path.join(ROOT, "CMakeLists.txt")) as f:
        m = re.search(r"project\(\s*\S+\s+VERSION\s+([0-9.]+)", f.read())
    if not m:
        raise ValueError("CMakeLists.txt names no project version")
    return m.group(1)


def gen_pegasus(provs):
    """OpenPegasus's registration: the module, then a provider and its
    capabilities for each class (provider types: 2 instance, 3 association,
    4 indication, 5 method)."""
    w = ["// Generated by tools/gen_providers.py from its provider tables; do not edit.\n",
         "//\n"
         "// Registration of vsprprovider_Module with OpenPegasus. Compile it into the\n"
         "// server's interop namespace once the classes are in place:\n"
         "//\n"
         "//     cimmof -n root/vespera vespera.mof\n"
         "//     cimmof -n root/PG_InterOp vespera-interop.mof\n"
         "//     cimmof -n root/PG_InterOp vsprprovider-pegasus.mof\n"
         "//\n"
         "// (vspr-register pegasus does all three.) The profile classes are served\n"
         "// in the interop namespace too, where SMI-S clients look for them.\n",
         "\ninstance of PG_ProviderModule\n{\n"
         "    Name = \"%s\";\n"
         "    Vendor = \"Vespera\";\n"
         "    Version = \"%s\";\n"
         "    InterfaceType = \"CMPI\";\n"
         "    InterfaceVersion = \"2.0.0\";\n"
         "    Location = \"%s\";\n"
         "};\n" % (MODULE, project_version(), MODULE)]
    for p in provs:
        prov = p["cls"] + "_Provider"
        ns = ", ".join('"%s"' % n for n in namespaces(p["cls"], PEGASUS_INTEROP))
        w.append("\ninstance of PG_Provider\n{\n"
                 "    Name = \"%s\";\n"
                 "    ProviderModuleName = \"%s\";\n"
                 "};\n" % (prov, MODULE))
        w.append("\ninstance of PG_ProviderCapabilities\n{\n"
                 "    ProviderModuleName = \"%s\";\n"
                 "    ProviderName = \"%s\";\n"
                 "    CapabilityID = \"%s\";\n"
                 "    ClassName = \"%s\";\n"
                 "    Namespaces = { %s };\n"
                 "    ProviderType = { %s };\n"
                 "};\n" % (MODULE, prov, p["cls"], p["cls"], ns, PEGASUS_TYPES[p["kind"]]))
    return "".join(w)


_CLASS_LINE = re.compile(r"^class\s+(\w+)(?:\s*:\s*(\w+))?")
_REF = re.compile(r"\b(VESPERA_\w+)\s+REF\b")


def mof_blocks(text):
    """The class declarations of a MOF written as vespera.mof is: each starts
    with its qualifier list at the start of a line, possibly behind comment
    lines of its own, and ends with a line "};". Returns (name, parent,
    VESPERA_ classes it refers to, text) in file order."""
    lines = text.splitlines(True)
    blocks = []
    i = 0
    while i < len(lines):
        m = _CLASS_LINE.match(lines[i])
        if not m:
            i += 1
            continue
        start = i
        while start > 0 and lines[start - 1].startswith(("[", " ", "\t")) \
                and lines[start - 1].strip() and not lines[start - 1].startswith("};"):
            start -= 1
        while start > 0 and lines[start - 1].startswith("//") \
                and not lines[start - 1].startswith("// ==="):
            start -= 1
        end = i
        while end < len(lines) and lines[end].rstrip() != "};":
            end += 1
        if end == len(lines):
            raise ValueError("class %s has no end" % m.group(1))
        body = "".join(lines[start:end + 1])
        refs = sorted(set(_REF.findall("".join(lines[i:end + 1]))))
        blocks.append((m.group(1), m.group(2), refs, body))
        i = end + 1
    return blocks


def gen_interop_mof(mof_text):
    """The classes that the interop namespace needs: those served there, and
    the VESPERA_ classes they derive from or refer to."""
    blocks = mof_blocks(mof_text)
    by_name = {b[0]: b for b in blocks}
    wanted = set()
    todo = list(INTEROP)
    while todo:
        name = todo.pop()
        if name in wanted:
            continue
        if name not in by_name:
            raise ValueError("vespera.mof doesn't declare %s" % name)
        wanted.add(name)
        _, parent, refs, _ = by_name[name]
        todo.extend(n for n in [parent] + refs if n and n.startswith("VESPERA_"))
    w = ["// Generated by tools/gen_providers.py from schema/mof/vespera.mof; do not edit.\n",
         "//\n"
         "// The module's classes that the CIM server's interop namespace needs: the\n"
         "// profile classes that are served there too, and the classes that their\n"
         "// references name, whose instances stay in root/vespera. Compile into\n"
         "// the interop namespace (root/interop on SFCB, root/PG_InterOp on\n"
         "// OpenPegasus), which holds the DMTF classes they build on.\n"]
    for name, _, _, body in blocks:
        if name in wanted:
            w.append("\n" + body)
    return "".join(w)


def main():
    ap = argparse.ArgumentParser()
    ap.add_argument("--schema", default=gen_schema.DEFAULT_SCHEMA,
                    help="directory of the DMTF class files (subset.mof)")
    ap.add_argument("--out-dir", default=os.path.join(ROOT, "cmpi", "generated"))
    ap.add_argument("--tests-dir", default=os.path.join(ROOT, "tests", "cmpi"),
                    help="where the dispatch test goes")
    ap.add_argument("--reg-dir", default=os.path.join(ROOT, "schema"),
                    help="where the registrations go (the class MOF is read from its mof/)")
    ap.add_argument("--check", action="store_true",
                    help="fail if a generated file differs from what is on disk")
    ap.add_argument("--signatures", action="store_true",
                    help="print the provider members that the dispatch calls")
    args = ap.parse_args()

    if not os.path.isfile(os.path.join(args.schema, "subset.mof")):
        print("gen_providers: %s not found" % args.schema, file=sys.stderr)
        return 77 if args.check else 2
    provs = collect(gen_schema.load(args.schema))
    if args.signatures:
        for p in provs:
            for m in p["methods"]:
                decl = ", ".join(["const %s* self" % p["cls"]] + [param_decl(q) for q in m.params])
                print("%s %s %s(%s)" % (home_dir(p["cls"]), p["cls"], m.name, decl))
        return 0

    outputs = {
        os.path.join(args.out_dir, "providers.cpp"): gen_cpp(provs),
        os.path.join(args.out_dir, "exports.txt"): gen_exports(provs),
        os.path.join(args.out_dir, "module.map"): gen_version_script(provs),
        os.path.join(args.tests_dir, "dispatch_outcomes.cpp"): gen_test(provs),
        os.path.join(args.reg_dir, "vsprprovider.reg"): gen_reg(provs),
        os.path.join(args.reg_dir, "vsprprovider-pegasus.mof"): gen_pegasus(provs),
    }
    with open(os.path.join(args.reg_dir, "mof", "vespera.mof")) as f:
        outputs[os.path.join(args.reg_dir, "mof", "vespera-interop.mof")] = gen_interop_mof(f.read())
    status = 0
    for path, text in sorted(outputs.items()):
        os.makedirs(os.path.dirname(path), exist_ok=True)
        old = None
        if os.path.exists(path):
            with open(path) as f:
                old = f.read()
        if args.check:
            if old != text:
                print("out of date: %s" % path, file=sys.stderr)
                status = 1
            continue
        if old != text:
            with open(path, "w") as f:
                f.write(text)
    return status


if __name__ == "__main__":
    sys.exit(main())
