// The interop providers as their dispatch function calls them: what reaches
// the handler, and what happens when the handler stops early. What they
// enumerate is checked through the stand-in CIM server.

#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "VESPERA_RegisteredProfile_Provider.h"
#include "VESPERA_RegisteredSubProfile_Provider.h"

using namespace OLMA;

namespace
{

// Collects what a provider hands up, and says stop after `limit` instances.
struct Sink
{
    std::vector<Instance*> got;
    size_t limit = (size_t)-1;
    int calls = 0;

    ~Sink()
    {
        for (Instance* i : got)
            unref(i);
    }

    static bool proc(Instance* instance, Enum_Instances_Status status, void* client_data)
    {
        Sink* s = static_cast<Sink*>(client_data);
        s->calls++;
        EXPECT_EQ(status, ENUM_INSTANCES_OK);
        if (!instance)
            return false;
        s->got.push_back(instance);
        return s->got.size() < s->limit;
    }

    std::vector<std::string> keys(const char* property) const
    {
        std::vector<std::string> v;
        for (Instance* i : got)
        {
            const Meta_Property* mp = find_property(i->meta_class, property);
            EXPECT_TRUE(mp != 0);
            if (mp)
                v.push_back(static_cast<Property<String>*>(__slot(i, mp->offset))->value.c_str());
        }
        return v;
    }
};

template<class PROVIDER, class CLASS>
Enum_Instances_Status enumerate(Sink& sink)
{
    PROVIDER provider;
    Enum_Instances_Handler<CLASS> handler(Sink::proc, &sink);
    CLASS* model = create<CLASS>(false);
    Enum_Instances_Status status = provider.enum_instances(model, &handler);
    destroy(model);
    return status;
}

} // namespace

TEST(ServerProviders, HandlerGetsItsOwnInstances)
{
    Sink s;
    enumerate<VESPERA_RegisteredProfile_Provider, VESPERA_RegisteredProfile>(s);
    ASSERT_FALSE(s.got.empty());
    for (Instance* i : s.got)
    {
        EXPECT_EQ(i->refs, 1u);
        EXPECT_EQ(i->meta_class, &VESPERA_RegisteredProfile::static_meta_class);
    }
}

TEST(ServerProviders, StopWhenTheHandlerSaysSo)
{
    // The provider must neither call the handler again nor leak what it
    // didn't send; the sanitizer build catches the latter.
    Sink s;
    s.limit = 2;
    EXPECT_EQ((enumerate<VESPERA_RegisteredSubProfile_Provider, VESPERA_RegisteredSubProfile>(s)),
        ENUM_INSTANCES_OK);
    EXPECT_EQ(s.calls, 2);
    EXPECT_EQ(s.keys("InstanceID"), (std::vector<std::string>{ "FC Initiator Ports", "Profile Registration" }));
}
