#include <gtest/gtest.h>
#include "Thread.h"
#include "cimom.h"
#include "fake_context.h"

using namespace OLMA;

namespace
{

Test_Job* make_job(const char* id)
{
    Test_Job* j = create<Test_Job>(true);
    j->InstanceID.set(id);
    return j;
}

struct Pushed
{
    explicit Pushed(Thread_Context* c) { Thread_Context::push(c); }
    ~Pushed() { Thread_Context::pop(); }
};

} // namespace

TEST(cimom, WithoutAContext)
{
    ASSERT_EQ(Thread_Context::top(), (Thread_Context*)0);
    Ref<Test_Job> job(make_job("j1"));

    Instance_Enumerator e;
    EXPECT_EQ(cimom::enum_instances("root/test", job.ptr(), e), -1);
    EXPECT_FALSE(e);
    EXPECT_FALSE(e());
    e++;

    EXPECT_FALSE(cimom::get_instance("root/test", job.ptr()));
    EXPECT_EQ(cimom::create_instance("root/test", job.ptr()), -1);
    EXPECT_EQ(cimom::delete_instance("root/test", job.ptr()), -1);
    EXPECT_EQ(cimom::modify_instance("root/test", job.ptr()), -1);
    Ref<Instance> method(create<Test_Port_Reset_method>());
    EXPECT_EQ(cimom::invoke_method("root/test", job.ptr(), method.ptr()), -1);
    cimom::allow_unload(false);
    String user("unchanged");
    EXPECT_FALSE(cimom::get_username(user));
    EXPECT_STREQ(user.c_str(), "unchanged");
}

TEST(cimom, ForwardsToTheTopContext)
{
    Fake_Stats stats;
    Fake_Context context("request", stats);
    context.served.push_back(Ref<Instance>(make_job("j1")));
    context.served.push_back(Ref<Instance>(make_job("j2")));
    Pushed pushed(&context);

    Ref<Test_Job> model(create<Test_Job>(false));
    __set_null_flags(model.ptr(), false, true, 1);
    {
        Instance_Enumerator e;
        ASSERT_EQ(cimom::enum_instances("root/test", model.ptr(), e), 0);
        EXPECT_EQ(context.last_name_space, "root/test");

        std::vector<std::string> ids;
        for (; e; e++)
        {
            Ref<Instance> x = e();
            ASSERT_TRUE(x);
            ids.push_back(((Test_Job*)x.ptr())->InstanceID.value.c_str());
        }
        EXPECT_EQ(ids, (std::vector<std::string>{ "j1", "j2" }));
        EXPECT_FALSE(e());

        // Enumerating again through the same enumerator frees the first rep.
        ASSERT_EQ(cimom::enum_instances("root/test", model.ptr(), e), 0);
        EXPECT_EQ(stats.reps, 2);
        EXPECT_EQ(stats.reps_destroyed, 1);
        EXPECT_TRUE(e);

        context.fail = true;
        EXPECT_EQ(cimom::enum_instances("root/test", model.ptr(), e), -1);
        EXPECT_FALSE(e);
        EXPECT_EQ(stats.reps_destroyed, 2);
        context.fail = false;
        ASSERT_EQ(cimom::enum_instances("root/test", model.ptr(), e), 0);
    }
    EXPECT_EQ(stats.reps_destroyed, 3);

    // get_instance hands out a new reference.
    model->InstanceID.set("j2");
    Ref<Instance> got = cimom::get_instance("root/test", model.ptr());
    ASSERT_TRUE(got);
    EXPECT_EQ(got->refs, 1u);
    EXPECT_TRUE(key_eq(model.ptr(), got.ptr()));
    model->InstanceID.set("j3");
    EXPECT_FALSE(cimom::get_instance("root/test", model.ptr()));

    EXPECT_EQ(cimom::create_instance("root/a", model.ptr()), 0);
    EXPECT_EQ(cimom::modify_instance("root/b", model.ptr()), 0);
    EXPECT_EQ(cimom::delete_instance("root/c", model.ptr()), 0);
    EXPECT_EQ(context.last_name_space, "root/c");
    Ref<Instance> method(create<Test_Port_Reset_method>());
    EXPECT_EQ(cimom::invoke_method("root/test", model.ptr(), method.ptr()), 0);
    EXPECT_EQ(context.calls, (std::vector<std::string>{ "create", "modify", "delete", "Reset" }));

    cimom::allow_unload(false);
    EXPECT_FALSE(context.unload_allowed);
    String user;
    EXPECT_TRUE(cimom::get_username(user));
    EXPECT_STREQ(user.c_str(), "tester");
}

TEST(cimom, ReachableFromAThreadStartedInARequest)
{
    Fake_Stats stats;
    Fake_Context context("request", stats);
    Pushed pushed(&context);

    String user;
    Thread thread;
    ASSERT_EQ(Thread::create_joinable(thread, [](void* arg) -> void* {
        return (void*)(intptr_t)cimom::get_username(*(String*)arg);
    }, &user), 0);
    void* result = 0;
    ASSERT_EQ(Thread::join(thread, result), 0);
    EXPECT_EQ(result, (void*)1);
    EXPECT_STREQ(user.c_str(), "tester");
}
