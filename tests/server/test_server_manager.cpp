// ServerManager on its own: class ids, the profile tree, the build version
// and the three answers that the CIM server can give about itself. The
// tables' values are checked through the stand-in CIM server.

#include <gtest/gtest.h>
#include <algorithm>
#include <fstream>
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
    // When set, every other namespace fails.
    std::string only_in;
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
        if (mode == INTEROP_FAILS || (!only_in.empty() && only_in != name_space))
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

TEST(ServerManager, BuildVersionNumbers)
{
    EXPECT_STREQ(prov_build_version, VSPR_BUILD_VERSION);

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

TEST(ServerManager, EachClassIdGivesItsClass)
{
    struct Row { classId_t id; const Meta_Class* mc; size_t count; };
    const Row rows[] = {
        { ID_VESPERA_RegisteredProfile, &VESPERA_RegisteredProfile::static_meta_class, 5 },
        { ID_VESPERA_RegisteredSubProfile, &VESPERA_RegisteredSubProfile::static_meta_class, 10 },
        { ID_VESPERA_Namespace, &VESPERA_Namespace::static_meta_class, 1 },
        { ID_VESPERA_ObjectManager, &VESPERA_ObjectManager::static_meta_class, 1 },
        { ID_VESPERA_CIMXMLCommunicationMechanism, &VESPERA_CIMXMLCommunicationMechanism::static_meta_class, 1 },
        { ID_VESPERA_ProfileSoftwareIdentity, &VESPERA_ProfileSoftwareIdentity::static_meta_class, 1 },
        { ID_VESPERA_AgentService, &VESPERA_AgentService::static_meta_class, 1 },
    };
    for (const Row& row : rows)
    {
        Instances got(sm()->getInstances(row.id));
        EXPECT_EQ(got.size(), row.count) << row.mc->name;
        for (size_t i = 0; i < got.size(); i++)
            EXPECT_EQ(got.array[i]->meta_class, row.mc) << row.mc->name;
    }
    EXPECT_EQ(sm(), ServerManager::getServerManager());

    // The agent service's provider belongs elsewhere; its one value is
    // checked here.
    Instances agent(sm()->getInstances(ID_VESPERA_AgentService));
    ASSERT_EQ(agent.size(), 1u);
    EXPECT_EQ(text(agent.at<VESPERA_AgentService>(0)->Name), "Vespera Agent Service Provider");
}

TEST(ServerManager, OtherClassIdsGiveNothing)
{
    for (int id : { 0, 1, 3, 9, 16, 29, 36, 38, 39, 1000, -1 })
        EXPECT_EQ(Instances(sm()->getInstances((classId_t)id)).size(), 0u) << id;
}

// Name, Caption and Description of the object manager and ObjectManagerName
// of the namespace, joined by "|", with the context on top of the stack (none:
// the CIM server can't be asked).
static std::string askBoth(Interop_Context* c)
{
    if (c)
        Thread_Context::push(c);
    Instances om(sm()->getInstances(ID_VESPERA_ObjectManager));
    Instances ns(sm()->getInstances(ID_VESPERA_Namespace));
    if (c)
        Thread_Context::pop();
    if (om.size() != 1 || ns.size() != 1)
        return "wrong number of instances";
    const VESPERA_ObjectManager* o = om.at<VESPERA_ObjectManager>(0);
    const VESPERA_Namespace* n = ns.at<VESPERA_Namespace>(0);
    if (!o || !n)
        return "wrong class";
    // The element name is ours, whatever the server says.
    EXPECT_EQ(text(o->ElementName), "CIM Server");
    return text(o->Name) + "|" + text(o->Caption) + "|" + text(o->Description) + "|" +
        text(n->ObjectManagerName);
}

TEST(ServerManagerInterop, ServerThatCantBeAskedIsCalledCIMServer)
{
    const std::string fallback = "CIM Server|CIM Server|CIM Server|CIM Server";
    EXPECT_EQ(askBoth(0), fallback);

    Interop_Context failing;
    failing.mode = INTEROP_FAILS;
    EXPECT_EQ(askBoth(&failing), fallback);
    // Each class asks for the object manager in OpenPegasus's interop
    // namespace, then in SFCB's.
    EXPECT_EQ(failing.asked_namespaces, (std::vector<std::string>{
        "root/PG_InterOp", "root/interop", "root/PG_InterOp", "root/interop" }));
    EXPECT_EQ(failing.asked_classes, std::vector<std::string>(4, "CIM_ObjectManager"));

    // An answer that isn't an object manager can't be read either.
    Interop_Context other;
    other.mode = INTEROP_ANSWERS;
    VESPERA_AgentService* agent = create<VESPERA_AgentService>(true);
    agent->Name.set("not an object manager");
    other.answer.push_back(agent);
    EXPECT_EQ(askBoth(&other), fallback);
}

TEST(ServerManagerInterop, ServerAnswerIsTakenFromItsFirstInstance)
{
    Interop_Context c;
    c.mode = INTEROP_ANSWERS;
    c.answer.push_back(serverObjectManager("PG:10.0.0.1", "Pegasus", "Pegasus CIM Server 2.14"));
    c.answer.push_back(serverObjectManager("second", "second", "second"));
    EXPECT_EQ(askBoth(&c), "PG:10.0.0.1|Pegasus|Pegasus CIM Server 2.14|PG:10.0.0.1");
    // Enumerators and the server's instances are released again.
    EXPECT_EQ(c.open_enumerators, 0);
    for (Instance* i : c.answer)
        EXPECT_EQ(i->refs, 1u);

    // SFCB has no root/PG_InterOp; its own namespace answers.
    Interop_Context sfcb;
    sfcb.mode = INTEROP_ANSWERS;
    sfcb.only_in = "root/interop";
    sfcb.answer.push_back(serverObjectManager("sfcb:host1", "sfcb", "Small Footprint CIM Broker"));
    EXPECT_EQ(askBoth(&sfcb), "sfcb:host1|sfcb|Small Footprint CIM Broker|sfcb:host1");

    // Keys are never left null: an answer without a name, or no answer at
    // all, names the object manager generically; the rest stays unknown.
    Interop_Context nulls;
    nulls.mode = INTEROP_ANSWERS;
    nulls.answer.push_back(serverObjectManager(0, "Pegasus", 0));
    EXPECT_EQ(askBoth(&nulls), "CIM Server|Pegasus|<null>|CIM Server");

    Interop_Context empty;
    empty.mode = INTEROP_EMPTY;
    EXPECT_EQ(askBoth(&empty), "CIM Server|<null>|<null>|CIM Server");
    EXPECT_EQ(empty.open_enumerators, 0);
    // An empty answer is an answer: SFCB's namespace isn't asked.
    EXPECT_EQ(empty.asked_namespaces, std::vector<std::string>(2, "root/PG_InterOp"));
}

// A reference made while serving a request in the interop namespace points
// where its instance answers: the profile classes in the request's own
// namespace, everything else in root/vespera.
TEST(ServerManager, ReferencesPointWhereTheirInstancesAnswer)
{
    Instances profiles(ServerManager::getServerManager()->getRegisteredProfileInstances());
    Instances managers(ServerManager::getServerManager()->getObjectManagerInstance());
    ASSERT_GT(profiles.size(), 0u);
    ASSERT_EQ(managers.size(), 1u);
    Instance* profile = profiles.array[0];
    Instance* manager = managers.array[0];

    struct { const char* request; const char* profile; const char* manager; } rows[] =
    {
        { "root/interop", "", "root/vespera" },
        { "root/PG_InterOp", "", "root/vespera" },
        { "root/vespera", "root/elsewhere", "root/elsewhere" },
        { "ROOT/Vespera", "root/elsewhere", "root/elsewhere" },
        { "", "root/elsewhere", "root/elsewhere" },
    };
    for (const auto& row : rows)
    {
        // A namespace the references may carry already: in root/vespera
        // nothing moves them.
        profile->__name_space.assign("root/elsewhere");
        manager->__name_space.assign("root/elsewhere");
        ServerManager::placeReference(profile, String(row.request));
        ServerManager::placeReference(manager, String(row.request));
        EXPECT_STREQ(row.profile, profile->__name_space.c_str()) << row.request;
        EXPECT_STREQ(row.manager, manager->__name_space.c_str()) << row.request;
    }
    ServerManager::placeReference(0, String("root/interop"));
}

// The classes ServerManager places in the interop namespace are the ones
// registered there.
TEST(ServerManager, InteropClassesAreTheRegisteredOnes)
{
    std::ifstream reg(VSPR_SOURCE_DIR "/schema/vsprprovider.reg");
    ASSERT_TRUE(reg.good());
    std::string line, cls;
    size_t classes = 0, interop = 0;
    while (std::getline(reg, line))
    {
        if (line.size() > 2 && line[0] == '[')
        {
            cls = line.substr(1, line.find(']') - 1);
            classes++;
        }
        else if (line.find("namespace:") != std::string::npos)
        {
            bool registered = line.find(" root/interop") != std::string::npos;
            interop += registered;
            EXPECT_EQ(registered, ServerManager::isServedInInterop(cls.c_str())) << cls;
        }
    }
    EXPECT_EQ(76u, classes);
    EXPECT_GT(interop, 0u);
    EXPECT_TRUE(ServerManager::isServedInInterop("vespera_registeredprofile"));
    EXPECT_FALSE(ServerManager::isServedInInterop(0));
}
