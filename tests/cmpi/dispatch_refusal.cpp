// Compiled, not run: a provider member whose name the dispatch knows but
// whose signature it can't call must stop the build, never turn quietly into
// "unsupported". REFUSAL picks the fault; 0 is the control, which compiles.

#include "Dispatch.h"

using namespace OLMA;

struct Thing : Instance
{
    static const Meta_Class static_meta_class;
};

struct Thing_Poke_method : Instance
{
    Property<uint32> return_value;
    static const Meta_Method static_meta_class;
};

TESSEL_PROVIDER_MEMBER(Poke);

class Thing_Provider
{
public:

#if REFUSAL == 1
    // The handler of another class.
    Enum_Instances_Status enum_instances(const Thing*, Enum_Instances_Handler<Instance>*);
#elif REFUSAL == 2
    // Right signature, but the dispatch can't reach it.
private:
    Load_Status load();
public:
#elif REFUSAL == 3
    // Overloads, none of them the one the dispatch calls.
    Get_Instance_Status get_instance(const Thing*);
    Get_Instance_Status get_instance(const Thing*, Instance*&);
#elif REFUSAL == 4
    // An extrinsic method without its return value.
    Invoke_Method_Status Poke(const Thing*);
#elif REFUSAL == 5
    // A const member is another type of member.
    Delete_Instance_Status delete_instance(const Thing*) const;
#elif REFUSAL == 6
    Enable_Indications_Status enable_indications(Indication_Handler<Thing>*);
#else
    Enum_Instances_Status enum_instances(const Thing*, Enum_Instances_Handler<Thing>*);
    Get_Instance_Status get_instance(const Thing*);
    Get_Instance_Status get_instance(const Thing*, Thing*&);
    Invoke_Method_Status Poke(const Thing*, Property<uint32>&);
    Enable_Indications_Status enable_indications(Indication_Handler<Thing>*);
    Disable_Indications_Status disable_indications();
#endif
};

sint32 instance_proc(int operation, void* arg0, void* arg1, void* arg2, void* arg3)
{
    return __dispatch_instance<Thing, Thing_Provider>(0, operation, arg0, arg1, arg2, arg3,
        0, 0, 0, 0);
}

sint32 indication_proc(int operation, void* arg0, void* arg1, void* arg2)
{
    return __dispatch_indication<Thing, Thing_Provider>(0, operation, arg0, arg1, arg2, 0,
        0, 0, 0, 0);
}

sint32 poke(Thing_Provider* provider, const Thing* self, Thing_Poke_method* m)
{
    return __call_member<__member_Poke<Thing_Provider,
        Invoke_Method_Status(const Thing*, Property<uint32>&)> >(
        provider, INVOKE_METHOD_UNSUPPORTED, self, m->return_value);
}
