// The interop classes as a WBEM client sees them: the built module loaded
// into the stand-in CIM server. The same tests run once with the adapter
// library's directory in LD_LIBRARY_PATH and once without it, since nothing
// here may depend on the library.

#include <gtest/gtest.h>
#include <dlfcn.h>
#include <unistd.h>
#include <fstream>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>
#include <vector>

#include "cimhost.h"

namespace ch = OLMA::cimhost;

namespace
{

class Interop : public ::testing::Test
{
protected:
    static ch::Host* host;

    static void SetUpTestSuite()
    {
        host = new ch::Host(ch::Options());
    }

    static void TearDownTestSuite()
    {
        delete host;
        host = 0;
    }

    void SetUp() override
    {
        ASSERT_TRUE(host->ok()) << host->error();
        host->set_interop(true);
        host->set_interop_namespace("root/PG_InterOp");
        host->set_pegasus_enumerations(false);
    }

    static ch::Result ei(const std::string& ns, const std::string& cls)
    {
        ch::Object_Path path;
        path.name_space = ns;
        path.class_name = cls;
        return host->ei(path);
    }

    static ch::Result served(const std::string& cls)
    {
        ch::Result r = ei("root/vespera", cls);
        EXPECT_EQ(r.rc, CMPI_RC_OK) << cls << ": " << ch::rc_name(r.rc) << " " << r.message;
        return r;
    }

    static std::vector<std::string> column(const ch::Result& r, const char* property)
    {
        std::vector<std::string> v;
        for (const ch::Instance& i : r.instances)
            v.push_back(i.get_text(property));
        return v;
    }

    // A null property may travel as null or not at all.
    static bool isNull(const ch::Instance& i, const char* property)
    {
        const ch::Value* v = i.get(property);
        return !v || v->null;
    }

    static std::string key(const ch::Instance& i, const char* name)
    {
        const ch::Value* v = i.path.key(name);
        return v ? v->text() : "(no key " + std::string(name) + ")";
    }

    static const ch::Value& get(const ch::Instance& i, const char* property)
    {
        static const ch::Value absent;
        const ch::Value* v = i.get(property);
        EXPECT_TRUE(v != 0) << "no property " << property << " in " << i.class_name;
        return v ? *v : absent;
    }
};

ch::Host* Interop::host = 0;

} // namespace

TEST_F(Interop, AdapterLibraryIsAsTheRunExpects)
{
    // Loading the module brings the library in if it can be found, so the
    // two runs really differ.
    const char* path = getenv("LD_LIBRARY_PATH");
    bool expected = path && strstr(path, "platform/dtruj");
    void* lib = dlopen("libdtruj.so", RTLD_NOW | RTLD_NOLOAD);
    EXPECT_EQ(lib != 0, expected);
    if (lib)
        dlclose(lib);
}

// One line per instance of a profile class, with the columns of its table:
// name, element name, organization, version, description.
static std::vector<std::string> profileRows(const ch::Result& r)
{
    std::vector<std::string> rows;
    for (const ch::Instance& i : r.instances)
    {
        // Both pairs of properties carry the same text.
        EXPECT_EQ(i.get_text("RegisteredName"), i.get_text("InstanceID"));
        EXPECT_EQ(i.get_text("Caption"), i.get_text("ElementName"));
        EXPECT_EQ(i.get_text("AdvertiseTypes"), "{3}");
        rows.push_back(i.get_text("InstanceID") + "|" + i.get_text("ElementName") + "|" +
            i.get_text("RegisteredOrganization") + "|" + i.get_text("RegisteredVersion") + "|" +
            i.get_text("Description"));
    }
    return rows;
}

TEST_F(Interop, RegisteredProfiles)
{
    EXPECT_EQ(profileRows(served("VESPERA_RegisteredProfile")), (std::vector<std::string>{
        "SMI-S|SMI-S|11|1.2.0|This instance models the SMI-S standard as such",
        "FC HBA|FC HBA Profile|11|1.2.0|The FC HBA Profile models the HBA device",
        "Server|Server Profile|11|1.2.0|The Server Profile models the CIM Server",
        "Host Discovered Resources|Host Discovered Resources Profile|11|1.2.0|"
            "The HDR profile models the discovered storage resources",
        "Storage HBA|Storage HBA Profile|11|1.3.0|"
            "The Storage HBA Profile models the manageable elements of an HBA",
    }));
}

TEST_F(Interop, RegisteredSubProfiles)
{
    EXPECT_EQ(profileRows(served("VESPERA_RegisteredSubProfile")), (std::vector<std::string>{
        "FC Initiator Ports|FC Initiator Ports subprofile|11|1.2.0|"
            "The FC Initiator Ports subprofile models the ports present in the HBA device",
        "Profile Registration|Profile Registration Profile|11|1.0.0|"
            "The Profile Registration Profile models the profiles registered in the object manager.",
        "Access Points|Access Points subprofile|11|1.2.0|"
            "This models the management service(s) points available to the user.",
        "Software Update|Software Update profile|2|1.0.0|"
            "This models the software installation service available to the user.",
        "Software Inventory|Software Inventory profile|2|1.0.0|"
            "This models the softwares installed and available for installation on the system.",
        "Physical Asset|Physical Asset profile|2|1.0.2|"
            "This models the physical aspects of the adapter hardware.",
        "Ethernet Port|Ethernet Port profile|2|1.0.0|"
            "This models the ethernet characteristics of the port present in the adapter.",
        "Diagnostics Profile|Diagnostics Profile|2|2.0.0|"
            "This models the diagnostic services available for the adapters and its ports.",
        "Host LAN Network Port|Host LAN Network Port Profile|2|1.0.0|"
            "This models the network interfaces associated with the network ports",
        "FCoE Initiator Ports|FCoE Initiator Ports Profile|11|1.0.0|"
            "This models the FCoE functionality of CNAs",
    }));
}

TEST_F(Interop, OneProfileByItsKey)
{
    // The providers only enumerate; the bridge finds one instance by key.
    ch::Object_Path path;
    std::string err;
    ASSERT_TRUE(ch::parse_path("root/vespera:VESPERA_RegisteredProfile.InstanceID=\"Server\"", path, err)) << err;
    ch::Result r = host->gi(path);
    ASSERT_EQ(r.rc, CMPI_RC_OK) << ch::rc_name(r.rc) << " " << r.message;
    ASSERT_EQ(r.instances.size(), 1u);
    EXPECT_EQ(r.instances[0].get_text("ElementName"), "Server Profile");

    ASSERT_TRUE(ch::parse_path("root/vespera:VESPERA_RegisteredProfile.InstanceID=\"server\"", path, err)) << err;
    EXPECT_EQ(host->gi(path).rc, CMPI_RC_ERR_NOT_FOUND);
}

TEST_F(Interop, CommunicationMechanismAndIdentity)
{
    ch::Result cm = served("VESPERA_CIMXMLCommunicationMechanism");
    ASSERT_EQ(cm.instances.size(), 1u);
    const ch::Instance& c = cm.instances[0];
    EXPECT_EQ(c.get_text("Name"), "CIM-XML");
    EXPECT_EQ(c.get_text("CreationClassName"), "VESPERA_CIMXMLCommunicationMechanism");
    EXPECT_EQ(c.get_text("SystemCreationClassName"), "VESPERA_ComputerSystem");
    EXPECT_EQ(c.get_text("FunctionalProfilesSupported"), "{2, 3, 4, 5, 6, 8, 9}");
    EXPECT_EQ(c.get_text("AuthenticationMechanismsSupported"), "{3}");
    EXPECT_EQ(c.get_text("Version"), "1.2");
    EXPECT_EQ(c.get_text("ElementName"), "CIM-XML Communication Mechanism");
    EXPECT_EQ(c.get_text("CommunicationMechanism"), "2");
    EXPECT_EQ(c.get_text("OperationalStatus"), "{2}");
    EXPECT_EQ(c.get_text("CIMValidated"), "true");
    EXPECT_EQ(c.get_text("MultipleOperationsSupported"), "true");
    EXPECT_FALSE(get(c, "SystemName").null);

    ch::Result si = served("VESPERA_ProfileSoftwareIdentity");
    ASSERT_EQ(si.instances.size(), 1u);
    const ch::Instance& s = si.instances[0];
    EXPECT_EQ(s.get_text("VersionString"), VSPR_BUILD_VERSION);
    unsigned major = 0, minor = 0, revision = 0;
    ASSERT_EQ(sscanf(VSPR_BUILD_VERSION, "%u.%u.%u", &major, &minor, &revision), 3);
    EXPECT_EQ(s.get_text("MajorVersion"), std::to_string(major));
    EXPECT_EQ(s.get_text("MinorVersion"), std::to_string(minor));
    EXPECT_EQ(s.get_text("RevisionNumber"), std::to_string(revision));
    for (const char* p : { "InstanceID", "Caption", "ElementName", "Description" })
        EXPECT_EQ(s.get_text(p), "Vespera Adapter CIM Provider") << p;
    EXPECT_EQ(s.get_text("Name"), "VSPR Adapter CIM provider");
    EXPECT_EQ(s.get_text("Manufacturer"), "VSPR");
    EXPECT_EQ(s.get_text("Classifications"), "{32775}");
    EXPECT_EQ(s.get_text("IdentityInfoType"), "{\"SoftwareID\", \"SoftwareStatus\"}");
    EXPECT_EQ(s.get_text("IdentityInfoValue"), "{\"Vespera Adapter CIM Provider\", \"Primary\"}");
}

TEST_F(Interop, AgentService)
{
    ch::Result as = served("VESPERA_AgentService");
    if (as.instances.empty())
        GTEST_SKIP() << "VESPERA_AgentService_Provider doesn't ask ServerManager yet";
    EXPECT_EQ(column(as, "Name"), std::vector<std::string>{ "Vespera Agent Service Provider" });
}

TEST_F(Interop, ObjectManagerAndNamespaceTakeTheServersAnswer)
{
    ch::Result server = ei("root/PG_InterOp", "CIM_ObjectManager");
    ASSERT_EQ(server.rc, CMPI_RC_OK) << ch::rc_name(server.rc);
    ASSERT_FALSE(server.instances.empty());
    const ch::Instance& first = server.instances[0];

    ch::Result om = served("VESPERA_ObjectManager");
    ASSERT_EQ(om.instances.size(), 1u);
    const ch::Instance& o = om.instances[0];
    EXPECT_EQ(get(o, "Name"), get(first, "Name"));
    EXPECT_EQ(get(o, "Caption"), get(first, "ElementName"));
    EXPECT_EQ(get(o, "Description"), get(first, "Description"));
    EXPECT_EQ(o.get_text("ElementName"), "CIM Server");
    EXPECT_EQ(o.get_text("Started"), "true");
    EXPECT_EQ(o.get_text("OperationalStatus"), "{2}");
    EXPECT_EQ(o.get_text("CreationClassName"), "VESPERA_ObjectManager");

    ch::Result ns = served("VESPERA_Namespace");
    ASSERT_EQ(ns.instances.size(), 1u);
    const ch::Instance& n = ns.instances[0];
    EXPECT_EQ(get(n, "ObjectManagerName"), get(first, "Name"));
    EXPECT_EQ(n.get_text("Name"), "root/vespera");
    EXPECT_EQ(n.get_text("ClassTypeVersion"), "2.26.0");
    EXPECT_EQ(n.get_text("ClassInfo"), "11");
    EXPECT_EQ(n.get_text("ClassType"), "2");
    EXPECT_EQ(n.get_text("CreationClassName"), "VESPERA_Namespace");
    EXPECT_EQ(n.get_text("ObjectManagerCreationClassName"), "VESPERA_ObjectManager");
    EXPECT_EQ(n.get_text("SystemCreationClassName"), "VESPERA_ComputerSystem");
    EXPECT_EQ(n.get_text("SystemName"), o.get_text("SystemName"));
}

TEST_F(Interop, ServerThatCantBeAskedIsCalledCIMServer)
{
    // Neither interop namespace may answer: not the stand-in, and not the
    // module's own registrations in root/interop.
    std::string reg = "/tmp/vspr_interop_" + std::to_string(getpid()) + ".reg";
    {
        std::ifstream in(VSPR_SOURCE_DIR "/schema/vsprprovider.reg");
        std::ofstream out(reg);
        std::string line;
        while (std::getline(in, line))
        {
            size_t at = line.find(" root/interop");
            out << (at == std::string::npos ? line : line.substr(0, at)) << "\n";
        }
    }
    ch::Options o;
    o.reg_path = reg;
    o.interop = false;
    delete host;
    host = new ch::Host(o);
    unlink(reg.c_str());
    ASSERT_TRUE(host->ok()) << host->error();
    struct Restore
    {
        ~Restore()
        {
            delete host;
            host = new ch::Host(ch::Options());
        }
    } restore;
    ch::Result om = served("VESPERA_ObjectManager");
    ASSERT_EQ(om.instances.size(), 1u);
    for (const char* p : { "Name", "Caption", "Description", "ElementName" })
        EXPECT_EQ(om.instances[0].get_text(p), "CIM Server") << p;

    ch::Result ns = served("VESPERA_Namespace");
    ASSERT_EQ(ns.instances.size(), 1u);
    EXPECT_EQ(ns.instances[0].get_text("ObjectManagerName"), "CIM Server");
}

TEST_F(Interop, ServerWithoutObjectManagerNamesTheKeysOnly)
{
    host->set_interop(true, true);
    ch::Result om = served("VESPERA_ObjectManager");
    ASSERT_EQ(om.instances.size(), 1u);
    for (const char* p : { "Caption", "Description" })
        EXPECT_TRUE(isNull(om.instances[0], p)) << p;
    EXPECT_EQ(om.instances[0].get_text("Name"), "CIM Server");
    EXPECT_EQ(key(om.instances[0], "Name"), "CIM Server");
    EXPECT_EQ(om.instances[0].get_text("ElementName"), "CIM Server");

    ch::Result ns = served("VESPERA_Namespace");
    ASSERT_EQ(ns.instances.size(), 1u);
    EXPECT_EQ(key(ns.instances[0], "ObjectManagerName"), "CIM Server");
}

// OpenPegasus marks the instances it enumerates for a provider as null;
// SFCB keeps its object manager in root/interop. Either way the server's own
// name is found, and ends up in the keys.
TEST_F(Interop, ObjectManagerIsFoundOnBothServers)
{
    ch::Result server = ei("root/PG_InterOp", "CIM_ObjectManager");
    ASSERT_FALSE(server.instances.empty());
    std::string name = server.instances[0].get_text("Name");

    for (int sfcb = 0; sfcb < 2; sfcb++)
    {
        host->set_pegasus_enumerations(!sfcb);
        host->set_interop_namespace(sfcb ? "root/interop" : "root/PG_InterOp");

        ch::Result om = served("VESPERA_ObjectManager");
        ASSERT_EQ(om.instances.size(), 1u);
        EXPECT_EQ(key(om.instances[0], "Name"), name) << sfcb;
        EXPECT_EQ(om.instances[0].get_text("Caption"), "cimhost") << sfcb;

        ch::Result ns = served("VESPERA_Namespace");
        ASSERT_EQ(ns.instances.size(), 1u);
        EXPECT_EQ(key(ns.instances[0], "ObjectManagerName"), name) << sfcb;
    }
}

TEST_F(Interop, MethodsAreRefused)
{
    ch::Result om = served("VESPERA_ObjectManager");
    ASSERT_EQ(om.instances.size(), 1u);
    ch::Result r = host->cm(om.instances[0].path, "StartService", {});
    EXPECT_EQ(r.rc, CMPI_RC_ERR_NOT_SUPPORTED) << ch::rc_name(r.rc) << " " << r.message;
}
