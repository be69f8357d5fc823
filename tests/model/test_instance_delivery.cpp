// How a provider hands a facade's array to the enumeration's handler: in
// order, clones only of its own class, and every element released whatever
// the handler says (the sanitizer build checks the releasing).

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "InstanceDelivery.h"
#include "VESPERA_EthernetPort.h"
#include "VESPERA_FCPort.h"

using namespace OLMA;

namespace
{

struct Received
{
    std::vector<std::string> ids;
    size_t stopAfter = (size_t)-1;
};

bool receive(Instance* instance, Enum_Instances_Status status, void* client)
{
    Received* r = static_cast<Received*>(client);
    EXPECT_EQ(ENUM_INSTANCES_OK, status);
    VESPERA_FCPort* port = checked_cast<VESPERA_FCPort>(instance);
    EXPECT_TRUE(port != 0);
    r->ids.push_back(port ? port->DeviceID.value.c_str() : "?");
    destroy(instance);
    return r->ids.size() < r->stopAfter;
}

Instance* fcPort(const char* id)
{
    VESPERA_FCPort* p = create<VESPERA_FCPort>();
    p->DeviceID.set(String(id));
    return p;
}

Array<Instance*> mixed()
{
    Array<Instance*> a;
    a.append(fcPort("p1"));
    a.append(0);
    VESPERA_EthernetPort* eth = create<VESPERA_EthernetPort>();
    eth->DeviceID.set(String("e1"));
    a.append(eth);
    a.append(fcPort("p2"));
    a.append(fcPort("p3"));
    return a;
}

} // namespace

TEST(InstanceDelivery, ClonesOfTheClassInOrderAndNothingElse)
{
    Received r;
    Enum_Instances_Handler<VESPERA_FCPort> handler(receive, &r);
    Array<Instance*> a = mixed();

    deliverInstances(a, &handler);

    EXPECT_EQ((std::vector<std::string>{"p1", "p2", "p3"}), r.ids);
    EXPECT_EQ(0u, a.size());
}

TEST(InstanceDelivery, AHandlerThatStopsGetsNoMore)
{
    Received r;
    r.stopAfter = 1;
    Enum_Instances_Handler<VESPERA_FCPort> handler(receive, &r);
    Array<Instance*> a = mixed();

    deliverInstances(a, &handler);

    EXPECT_EQ((std::vector<std::string>{"p1"}), r.ids);
    EXPECT_EQ(0u, a.size());

    // Without a handler, and when the array isn't delivered at all.
    Array<Instance*> b = mixed();
    deliverInstances<VESPERA_FCPort>(b, 0);
    EXPECT_EQ(0u, b.size());
    Array<Instance*> c = mixed();
    destroyInstances(c);
    EXPECT_EQ(0u, c.size());
}
