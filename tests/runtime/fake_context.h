#ifndef _vspr_tests_runtime_fake_context_h
#define _vspr_tests_runtime_fake_context_h

// A stand-in for the CIM server's context: it serves a fixed list of
// instances, records what reaches it, and counts its own births and deaths
// so that tests can see contexts handed to threads and released again.

#include <atomic>
#include <string>
#include <vector>
#include "Thread_Context.h"
#include "records.h"

namespace OLMA
{

struct Instance_Enumerator_Rep
{
    std::vector<Ref<Instance>> instances;
    size_t pos;
};

struct Fake_Stats
{
    std::atomic<int> contexts{0};
    std::atomic<int> destroyed{0};
    std::atomic<int> started{0};
    std::atomic<int> exited{0};
    std::atomic<int> reps{0};
    std::atomic<int> reps_destroyed{0};
};

class Fake_Context : public Thread_Context
{
public:
    Fake_Context(const std::string& name_, Fake_Stats& stats_) : name(name_), stats(stats_)
    {
        stats.contexts++;
    }

    ~Fake_Context() override { stats.destroyed++; }

    Thread_Context* thread_create_hook(void*) override
    {
        return new Fake_Context(name + "/child", stats);
    }

    void thread_start_hook() override
    {
        if (top() == this)
            stats.started++;
    }

    void thread_exit_hook() override
    {
        if (top() == this)
            stats.exited++;
    }

    Instance_Enumerator_Rep* instance_enumerator_create(const char* ns, const Instance*) override
    {
        last_name_space = ns ? ns : "";

        if (fail)
            return 0;

        Instance_Enumerator_Rep* rep = new Instance_Enumerator_Rep;
        rep->pos = 0;

        for (const Ref<Instance>& x : served)
            rep->instances.push_back(Ref<Instance>(clone(x.ptr())));

        stats.reps++;
        return rep;
    }

    void instance_enumerator_destroy(Instance_Enumerator_Rep* rep) override
    {
        stats.reps_destroyed++;
        delete rep;
    }

    bool instance_enumerator_more(Instance_Enumerator_Rep* rep) override
    {
        return rep->pos < rep->instances.size();
    }

    void instance_enumerator_next(Instance_Enumerator_Rep* rep) override { rep->pos++; }

    Ref<Instance> instance_enumerator_get(Instance_Enumerator_Rep* rep) override
    {
        if (rep->pos < rep->instances.size())
            return rep->instances[rep->pos];
        return Ref<Instance>();
    }

    Ref<Instance> get_instance(const char*, const Instance* model) override
    {
        for (const Ref<Instance>& x : served)
        {
            if (key_eq(model, x.ptr()))
                return Ref<Instance>(clone(x.ptr()));
        }

        return Ref<Instance>();
    }

    int create_instance(const char* ns, const Instance*) override
    {
        last_name_space = ns;
        calls.push_back("create");
        return 0;
    }

    int delete_instance(const char* ns, const Instance*) override
    {
        last_name_space = ns;
        calls.push_back("delete");
        return 0;
    }

    int modify_instance(const char* ns, const Instance*) override
    {
        last_name_space = ns;
        calls.push_back("modify");
        return 0;
    }

    int invoke_method(const char*, const Instance*, Instance* method) override
    {
        calls.push_back(method->meta_class->name);
        return 0;
    }

    void allow_unload(bool flag) override { unload_allowed = flag; }

    bool get_username(String& user) override
    {
        user = "tester";
        return true;
    }

    std::string name;
    Fake_Stats& stats;
    std::vector<Ref<Instance>> served;
    std::vector<std::string> calls;
    std::string last_name_space;
    bool unload_allowed = true;
    bool fail = false;
};

} // namespace OLMA

#endif // _vspr_tests_runtime_fake_context_h
