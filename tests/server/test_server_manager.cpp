// ServerManager on its own: the fixed tables, the profile tree, the build
// version and the three answers that the CIM server can give about itself.

#include <gtest/gtest.h>
#include <algorithm>
#include <string>
#include <vector>

#include "ServerManager.h"
#include "Thread_Context.h"
#include "cimom.h"
#include "CIM_ObjectManager.h"
#include "VESPERA_RegisteredProfile.h"
#include "VESPERA_RegisteredSubProfile.h"
#include "VESPERA_Namespace.h"
#include "VESPERA_ObjectManager.h"
#include "VESPERA_CIMXMLCommunicationMechanism.h"
#include "VESPERA_ProfileSoftwareIdentity.h"
#include "VESPERA_AgentService.h"

using namespace OLMA;

namespace
{

// Owns what getInstances hands out, so that a failing assertion leaks
// nothing under the sanitizer.
struct Instances
{
    explicit Instances(const Array<Instance*>& a) : array(a) { }
    ~Instances()
    {
        for (size_t i = 0; i < array.size(); i++)
            destroyer(array[i]);
    }
    size_t size() const { return array.size(); }
    template<class T>
    const T* at(size_t i) const
    {
        const T* p = checked_cast<T>(array[i]);
        EXPECT_TRUE(p != 0) << "element " << i << " is not a " << T::static_meta_class.name;
        return p;
    }
    Array<Instance*> array;
};

std::string text(const Property<String>& p)
{
    return p.null ? std::string("<null>") : std::string(p.value.c_str());
}

std::vector<unsigned> numbers(const Property<Array<uint16> >& p)
{
    std::vector<unsigned> v;
    for (size_t i = 0; i < p.value.size(); i++)
        v.push_back(p.value[i]);
    return v;
}

std::vector<std::string> texts(const Array<String>& a)
{
    std::vector<std::string> v;
    for (size_t i = 0; i < a.size(); i++)
        v.push_back(a[i].c_str());
    return v;
}

// What the fake CIM server holds in its interop namespace.
enum Interop_Mode
{
    INTEROP_FAILS,
    INTEROP_EMPTY,
    INTEROP_ANSWERS,
};

struct Fake_Enumerator
{
    std::vector<Instance*> items;
    size_t pos = 0;
};

// A request context that answers enum_instances from a list of instances,
// and records what it was asked.
class Interop_Context : public Thread_Context
{
public:
    Interop_Mode mode = INTEROP_FAILS;
    std::vector<Instance*> answer;
    std::vector<std::string> asked_namespaces;
    std::vector<std::string> asked_classes;
    int open_enumerators = 0;

    ~Interop_Context()
    {
        for (Instance* i : answer)
            unref(i);
    }

    Thread_Context* thread_create_hook(void*) { return 0; }
    void thread_start_hook() { }
    void thread_exit_hook() { }

    Instance_Enumerator_Rep* instance_enumerator_create(const char* name_space, const Instance* model)
    {
        asked_namespaces.push_back(name_space ? name_space : "");
        asked_classes.push_back(model ? model->meta_class->name : "");
        if (mode == INTEROP_FAILS)
            return 0;
        Fake_Enumerator* e = new Fake_Enumerator;
        if (mode == INTEROP_ANSWERS)
        {
            for (Instance* i : answer)
            {
                ref(i);
                e->items.push_back(i);
            }
        }
        open_enumerators++;
        return reinterpret_cast<Instance_Enumerator_Rep*>(e);
    }

    void instance_enumerator_destroy(Instance_Enumerator_Rep* rep)
    {
        Fake_Enumerator* e = reinterpret_cast<Fake_Enumerator*>(rep);
        for (size_t i = e->pos; i < e->items.size(); i++)
            unref(e->items[i]);
        delete e;
        open_enumerators--;
    }

    bool instance_enumerator_more(Instance_Enumerator_Rep* rep)
    {
        Fake_Enumerator* e = reinterpret_cast<Fake_Enumerator*>(rep);
        return e->pos < e->items.size();
    }

    void instance_enumerator_next(Instance_Enumerator_Rep* rep)
    {
        Fake_Enumerator* e = reinterpret_cast<Fake_Enumerator*>(rep);
        if (e->pos < e->items.size())
            unref(e->items[e->pos++]);
    }

    Ref<Instance> instance_enumerator_get(Instance_Enumerator_Rep* rep)
    {
        Fake_Enumerator* e = reinterpret_cast<Fake_Enumerator*>(rep);
        if (e->pos >= e->items.size())
            return Ref<Instance>();
        ref(e->items[e->pos]);
        return Ref<Instance>(e->items[e->pos]);
    }

    Ref<Instance> get_instance(const char*, const Instance*) { return Ref<Instance>(); }
    int create_instance(const char*, const Instance*) { return -1; }
    int delete_instance(const char*, const Instance*) { return -1; }
    int modify_instance(const char*, const Instance*) { return -1; }
    int invoke_method(const char*, const Instance*, Instance*) { return -1; }
    void allow_unload(bool) { }
    bool get_username(String&) { return false; }
};

// Pushes the context for one test and pops it again.
struct Pushed
{
    explicit Pushed(Thread_Context* c) { Thread_Context::push(c); }
    ~Pushed() { Thread_Context::pop(); }
};

CIM_ObjectManager* serverObjectManager(const char* name, const char* elementName, const char* description)
{
    CIM_ObjectManager* om = create<CIM_ObjectManager>(true);
    if (name)
        om->Name.set(name);
    if (elementName)
        om->ElementName.set(elementName);
    if (description)
        om->Description.set(description);
    return om;
}

ServerManager* sm()
{
    return ServerManager::getServerManager();
}

} // namespace

TEST(ServerManager, IsOneObject)
{
    EXPECT_EQ(sm(), ServerManager::getServerManager());
}

TEST(ServerManager, RegisteredProfilesInTableOrder)
{
    struct Row { const char* name; const char* element; const char* version; const char* description; };
    const Row rows[] = {
        { "SMI-S", "SMI-S", "1.2.0", "This instance models the SMI-S standard as such" },
        { "FC HBA", "FC HBA Profile", "1.2.0", "The FC HBA Profile models the HBA device" },
        { "Server", "Server Profile", "1.2.0", "The Server Profile models the CIM Server" },
        { "Host Discovered Resources", "Host Discovered Resources Profile", "1.2.0",
          "The HDR profile models the discovered storage resources" },
        { "Storage HBA", "Storage HBA Profile", "1.3.0",
          "The Storage HBA Profile models the manageable elements of an HBA" },
    };
    Instances got(sm()->getInstances(ID_VESPERA_RegisteredProfile));
    ASSERT_EQ(got.size(), 5u);
    for (size_t i = 0; i < got.size(); i++)
    {
        SCOPED_TRACE(rows[i].name);
        const VESPERA_RegisteredProfile* p = got.at<VESPERA_RegisteredProfile>(i);
        ASSERT_TRUE(p);
        EXPECT_EQ(p->meta_class, &VESPERA_RegisteredProfile::static_meta_class);
        EXPECT_EQ(text(p->InstanceID), rows[i].name);
        EXPECT_EQ(text(p->RegisteredName), rows[i].name);
        EXPECT_EQ(text(p->Caption), rows[i].element);
        EXPECT_EQ(text(p->ElementName), rows[i].element);
        EXPECT_EQ(text(p->RegisteredVersion), rows[i].version);
        EXPECT_EQ(text(p->Description), rows[i].description);
        EXPECT_FALSE(p->RegisteredOrganization.null);
        EXPECT_EQ(p->RegisteredOrganization.value, 11);
        EXPECT_FALSE(p->AdvertiseTypes.null);
        EXPECT_EQ(numbers(p->AdvertiseTypes), std::vector<unsigned>{ 3 });
        // Whatever the tables don't set is null, not an empty text.
        EXPECT_TRUE(p->OtherRegisteredOrganization.null);
    }
}

TEST(ServerManager, RegisteredSubProfilesInTableOrder)
{
    struct Row { const char* name; const char* element; unsigned org; const char* version; const char* description; };
    const Row rows[] = {
        { "FC Initiator Ports", "FC Initiator Ports subprofile", 11, "1.2.0",
          "The FC Initiator Ports subprofile models the ports present in the HBA device" },
        { "Profile Registration", "Profile Registration Profile", 11, "1.0.0",
          "The Profile Registration Profile models the profiles registered in the object manager." },
        { "Access Points", "Access Points subprofile", 11, "1.2.0",
          "This models the management service(s) points available to the user." },
        { "Software Update", "Software Update profile", 2, "1.0.0",
          "This models the software installation service available to the user." },
        { "Software Inventory", "Software Inventory profile", 2, "1.0.0",
          "This models the softwares installed and available for installation on the system." },
        { "Physical Asset", "Physical Asset profile", 2, "1.0.2",
          "This models the physical aspects of the adapter hardware." },
        { "Ethernet Port", "Ethernet Port profile", 2, "1.0.0",
          "This models the ethernet characteristics of the port present in the adapter." },
        { "Diagnostics Profile", "Diagnostics Profile", 2, "2.0.0",
          "This models the diagnostic services available for the adapters and its ports." },
        { "Host LAN Network Port", "Host LAN Network Port Profile", 2, "1.0.0",
          "This models the network interfaces associated with the network ports" },
        { "FCoE Initiator Ports", "FCoE Initiator Ports Profile", 11, "1.0.0",
          "This models the FCoE functionality of CNAs" },
    };
    Instances got(sm()->getInstances(ID_VESPERA_RegisteredSubProfile));
    ASSERT_EQ(got.size(), 10u);
    for (size_t i = 0; i < got.size(); i++)
    {
        SCOPED_TRACE(rows[i].name);
        const VESPERA_RegisteredSubProfile* p = got.at<VESPERA_RegisteredSubProfile>(i);
        ASSERT_TRUE(p);
        EXPECT_EQ(p->meta_class, &VESPERA_RegisteredSubProfile::static_meta_class);
        EXPECT_EQ(text(p->InstanceID), rows[i].name);
        EXPECT_EQ(text(p->RegisteredName), rows[i].name);
        EXPECT_EQ(text(p->Caption), rows[i].element);
        EXPECT_EQ(text(p->ElementName), rows[i].element);
        EXPECT_EQ(text(p->RegisteredVersion), rows[i].version);
        EXPECT_EQ(text(p->Description), rows[i].description);
        EXPECT_EQ(p->RegisteredOrganization.value, rows[i].org);
        EXPECT_FALSE(p->RegisteredOrganization.null);
    }
}

TEST(ServerManager, SubProfileTreeIgnoresCase)
{
    const std::vector<std::string> fcHba = {
        "FC Initiator Ports", "Software Update", "Software Inventory", "Access Points",
        "Physical Asset", "Ethernet Port", "Diagnostics Profile", "Host LAN Network Port" };
    EXPECT_EQ(texts(sm()->getSubProfilesOfProfile("FC HBA")), fcHba);
    EXPECT_EQ(texts(sm()->getSubProfilesOfProfile("fc hba")), fcHba);
    EXPECT_EQ(texts(sm()->getSubProfilesOfProfile("SERVER")),
        std::vector<std::string>{ "Profile Registration" });
    EXPECT_EQ(texts(sm()->getSubProfilesOfProfile("storage hba")),
        std::vector<std::string>{ "FCoE Initiator Ports" });

    for (const char* none : { "Host Discovered Resources", "SMI-S", "", "FC HBA ", "FC" })
        EXPECT_EQ(sm()->getSubProfilesOfProfile(none).size(), 0u) << '"' << none << '"';

    // Every name in the tree is a registered subprofile, so that the
    // association built from it finds both ends.
    Instances subs(sm()->getInstances(ID_VESPERA_RegisteredSubProfile));
    std::vector<std::string> registered;
    for (size_t i = 0; i < subs.size(); i++)
        registered.push_back(text(subs.at<VESPERA_RegisteredSubProfile>(i)->InstanceID));
    for (const char* profile : { "FC HBA", "Server", "Storage HBA" })
        for (const std::string& name : texts(sm()->getSubProfilesOfProfile(profile)))
            EXPECT_NE(std::find(registered.begin(), registered.end(), name), registered.end()) << name;
}

TEST(ServerManager, CommunicationMechanism)
{
    Instances got(sm()->getInstances(ID_VESPERA_CIMXMLCommunicationMechanism));
    ASSERT_EQ(got.size(), 1u);
    const VESPERA_CIMXMLCommunicationMechanism* cm = got.at<VESPERA_CIMXMLCommunicationMechanism>(0);
    ASSERT_TRUE(cm);
    EXPECT_EQ(text(cm->SystemCreationClassName), "VESPERA_ComputerSystem");
    EXPECT_FALSE(cm->SystemName.null);
    EXPECT_FALSE(cm->SystemName.value.size() == 0);
    EXPECT_EQ(text(cm->CreationClassName), "VESPERA_CIMXMLCommunicationMechanism");
    EXPECT_EQ(text(cm->Name), "CIM-XML");
    EXPECT_EQ(text(cm->ElementName), "CIM-XML Communication Mechanism");
    EXPECT_EQ(cm->CommunicationMechanism.value, 2);
    EXPECT_EQ(text(cm->Version), "1.2");
    EXPECT_FALSE(cm->CIMValidated.null);
    EXPECT_TRUE(cm->CIMValidated.value);
    EXPECT_FALSE(cm->MultipleOperationsSupported.null);
    EXPECT_TRUE(cm->MultipleOperationsSupported.value);
    EXPECT_EQ(numbers(cm->FunctionalProfilesSupported), (std::vector<unsigned>{ 2, 3, 4, 5, 6, 8, 9 }));
    EXPECT_EQ(numbers(cm->AuthenticationMechanismsSupported), std::vector<unsigned>{ 3 });
    EXPECT_EQ(numbers(cm->OperationalStatus), std::vector<unsigned>{ 2 });
}

TEST(ServerManager, ProfileSoftwareIdentityFollowsBuildVersion)
{
    EXPECT_STREQ(prov_build_version, VSPR_BUILD_VERSION);

    Instances got(sm()->getInstances(ID_VESPERA_ProfileSoftwareIdentity));
    ASSERT_EQ(got.size(), 1u);
    const VESPERA_ProfileSoftwareIdentity* si = got.at<VESPERA_ProfileSoftwareIdentity>(0);
    ASSERT_TRUE(si);
    for (const Property<String>* p : { &si->InstanceID, &si->Caption, &si->ElementName, &si->Description })
        EXPECT_EQ(text(*p), "Vespera Adapter CIM Provider");
    EXPECT_EQ(text(si->Name), "VSPR Adapter CIM provider");
    EXPECT_EQ(text(si->Manufacturer), "VSPR");
    EXPECT_EQ(text(si->VersionString), VSPR_BUILD_VERSION);

    uint16 major = 9, minor = 9, revision = 9;
    ASSERT_TRUE(buildVersionNumbers(VSPR_BUILD_VERSION, major, minor, revision));
    EXPECT_EQ(si->MajorVersion.value, major);
    EXPECT_EQ(si->MinorVersion.value, minor);
    EXPECT_EQ(si->RevisionNumber.value, revision);
    EXPECT_FALSE(si->MajorVersion.null || si->MinorVersion.null || si->RevisionNumber.null);

    EXPECT_EQ(numbers(si->Classifications), std::vector<unsigned>{ 32775 });
    EXPECT_EQ(texts(si->IdentityInfoType.value), (std::vector<std::string>{ "SoftwareID", "SoftwareStatus" }));
    EXPECT_EQ(texts(si->IdentityInfoValue.value),
        (std::vector<std::string>{ "Vespera Adapter CIM Provider", "Primary" }));
}

TEST(ServerManager, BuildVersionNumbers)
{
    uint16 a, b, c;
    EXPECT_TRUE(buildVersionNumbers("3.2.1.0_beta_bld01", a, b, c));
    EXPECT_EQ(a, 3);
    EXPECT_EQ(b, 2);
    EXPECT_EQ(c, 1);

    EXPECT_TRUE(buildVersionNumbers("10.20.30", a, b, c));
    EXPECT_EQ(a, 10);
    EXPECT_EQ(b, 20);
    EXPECT_EQ(c, 30);

    // Short or broken texts give zeros for what can't be read, never
    // leftovers of the caller's variables.
    a = b = c = 7;
    EXPECT_FALSE(buildVersionNumbers("4.5", a, b, c));
    EXPECT_EQ(a, 4);
    EXPECT_EQ(b, 5);
    EXPECT_EQ(c, 0);
    a = b = c = 7;
    EXPECT_FALSE(buildVersionNumbers("beta", a, b, c));
    EXPECT_EQ(a + b + c, 0);
    a = b = c = 7;
    EXPECT_FALSE(buildVersionNumbers(0, a, b, c));
    EXPECT_EQ(a + b + c, 0);
    // A field that doesn't fit the 16-bit property isn't wrapped.
    EXPECT_TRUE(buildVersionNumbers("70000.1.-2", a, b, c));
    EXPECT_EQ(a, 0);
    EXPECT_EQ(b, 1);
    EXPECT_EQ(c, 0);
}

TEST(ServerManager, AgentService)
{
    Instances got(sm()->getInstances(ID_VESPERA_AgentService));
    ASSERT_EQ(got.size(), 1u);
    const VESPERA_AgentService* as = got.at<VESPERA_AgentService>(0);
    ASSERT_TRUE(as);
    EXPECT_EQ(text(as->Name), "Vespera Agent Service Provider");
}

TEST(ServerManager, OtherClassIdsGiveNothing)
{
    for (int id : { 0, 1, 3, 9, 16, 29, 36, 38, 39, 1000, -1 })
        EXPECT_EQ(Instances(sm()->getInstances((classId_t)id)).size(), 0u) << id;
}

// The object manager and the namespace, for one state of the interop
// namespace.
struct Interop_Result
{
    std::string name, caption, description, elementName, objectManagerName;
};

static Interop_Result askBoth()
{
    Interop_Result r;
    Instances om(sm()->getInstances(ID_VESPERA_ObjectManager));
    Instances ns(sm()->getInstances(ID_VESPERA_Namespace));
    EXPECT_EQ(om.size(), 1u);
    EXPECT_EQ(ns.size(), 1u);
    if (om.size() != 1 || ns.size() != 1)
        return r;
    const VESPERA_ObjectManager* o = om.at<VESPERA_ObjectManager>(0);
    const VESPERA_Namespace* n = ns.at<VESPERA_Namespace>(0);
    if (!o || !n)
        return r;

    // The fixed part doesn't depend on the server's answer.
    EXPECT_EQ(text(o->SystemCreationClassName), "VESPERA_ComputerSystem");
    EXPECT_EQ(text(o->CreationClassName), "VESPERA_ObjectManager");
    EXPECT_FALSE(o->SystemName.null);
    EXPECT_EQ(numbers(o->OperationalStatus), std::vector<unsigned>{ 2 });
    EXPECT_FALSE(o->Started.null);
    EXPECT_TRUE(o->Started.value);

    EXPECT_EQ(text(n->SystemCreationClassName), "VESPERA_ComputerSystem");
    EXPECT_EQ(text(n->SystemName), text(o->SystemName));
    EXPECT_EQ(text(n->ObjectManagerCreationClassName), "VESPERA_ObjectManager");
    EXPECT_EQ(text(n->CreationClassName), "VESPERA_Namespace");
    EXPECT_EQ(text(n->Name), "root/vespera");
    EXPECT_EQ(n->ClassInfo.value, 11);
    EXPECT_EQ(n->ClassType.value, 2);
    EXPECT_EQ(text(n->ClassTypeVersion), "2.26.0");

    r.name = text(o->Name);
    r.caption = text(o->Caption);
    r.description = text(o->Description);
    r.elementName = text(o->ElementName);
    r.objectManagerName = text(n->ObjectManagerName);
    return r;
}

TEST(ServerManagerInterop, NoContextMeansTheServerCantBeAsked)
{
    ASSERT_EQ(Thread_Context::top(), nullptr);
    Interop_Result r = askBoth();
    EXPECT_EQ(r.name, "CIM Server");
    EXPECT_EQ(r.caption, "CIM Server");
    EXPECT_EQ(r.description, "CIM Server");
    EXPECT_EQ(r.elementName, "CIM Server");
    EXPECT_EQ(r.objectManagerName, "CIM Server");
}

TEST(ServerManagerInterop, FailingEnumeration)
{
    Interop_Context c;
    c.mode = INTEROP_FAILS;
    Pushed pushed(&c);
    Interop_Result r = askBoth();
    EXPECT_EQ(r.name, "CIM Server");
    EXPECT_EQ(r.caption, "CIM Server");
    EXPECT_EQ(r.description, "CIM Server");
    EXPECT_EQ(r.objectManagerName, "CIM Server");
    // Each of the two classes asks once, in the interop namespace, for the
    // server's object manager.
    EXPECT_EQ(c.asked_namespaces, (std::vector<std::string>{ "root/PG_InterOp", "root/PG_InterOp" }));
    EXPECT_EQ(c.asked_classes, (std::vector<std::string>{ "CIM_ObjectManager", "CIM_ObjectManager" }));
}

TEST(ServerManagerInterop, ServerAnswers)
{
    Interop_Context c;
    c.mode = INTEROP_ANSWERS;
    c.answer.push_back(serverObjectManager("PG:10.0.0.1", "Pegasus", "Pegasus CIM Server 2.14"));
    c.answer.push_back(serverObjectManager("second", "second", "second"));
    {
        Pushed pushed(&c);
        Interop_Result r = askBoth();
        EXPECT_EQ(r.name, "PG:10.0.0.1");
        EXPECT_EQ(r.caption, "Pegasus");
        EXPECT_EQ(r.description, "Pegasus CIM Server 2.14");
        EXPECT_EQ(r.elementName, "CIM Server");
        EXPECT_EQ(r.objectManagerName, "PG:10.0.0.1");
    }
    EXPECT_EQ(c.open_enumerators, 0);
    // The server's instances are released again: only the test holds them.
    for (Instance* i : c.answer)
        EXPECT_EQ(i->refs, 1u);
}

TEST(ServerManagerInterop, ServerAnswersWithNullsCarriesThem)
{
    Interop_Context c;
    c.mode = INTEROP_ANSWERS;
    c.answer.push_back(serverObjectManager(0, "Pegasus", 0));
    Pushed pushed(&c);
    Interop_Result r = askBoth();
    EXPECT_EQ(r.name, "<null>");
    EXPECT_EQ(r.caption, "Pegasus");
    EXPECT_EQ(r.description, "<null>");
    EXPECT_EQ(r.objectManagerName, "<null>");
}

TEST(ServerManagerInterop, ServerHasNoObjectManager)
{
    Interop_Context c;
    c.mode = INTEROP_EMPTY;
    {
        Pushed pushed(&c);
        Interop_Result r = askBoth();
        EXPECT_EQ(r.name, "<null>");
        EXPECT_EQ(r.caption, "<null>");
        EXPECT_EQ(r.description, "<null>");
        EXPECT_EQ(r.elementName, "CIM Server");
        EXPECT_EQ(r.objectManagerName, "<null>");
    }
    EXPECT_EQ(c.open_enumerators, 0);
}

TEST(ServerManagerInterop, AnswerOfAnotherClassIsNotRead)
{
    Interop_Context c;
    c.mode = INTEROP_ANSWERS;
    VESPERA_AgentService* other = create<VESPERA_AgentService>(true);
    other->Name.set("not an object manager");
    c.answer.push_back(other);
    Pushed pushed(&c);
    Interop_Result r = askBoth();
    EXPECT_EQ(r.name, "CIM Server");
    EXPECT_EQ(r.objectManagerName, "CIM Server");
}
