#include <gtest/gtest.h>
#include <cerrno>
#include <thread>
#include "Thread.h"
#include "Time.h"
#include "fake_context.h"

using namespace OLMA;

// This executable links with --wrap=pthread_create so that a failing
// pthread_create() can be staged.
static std::atomic<int> fail_next_create{0};

extern "C" int __real_pthread_create(
    pthread_t* thread, const pthread_attr_t* attr, void* (*proc)(void*), void* arg);

extern "C" int __wrap_pthread_create(
    pthread_t* thread, const pthread_attr_t* attr, void* (*proc)(void*), void* arg)
{
    if (fail_next_create.exchange(0))
        return EAGAIN;

    return __real_pthread_create(thread, attr, proc, arg);
}

namespace
{

// What a thread body saw of its context stack.
struct Seen
{
    Thread_Context* top = 0;
    Thread_Context* prev = 0;
    std::string name;
};

void* record_context(void* arg)
{
    Seen* seen = (Seen*)arg;
    seen->top = Thread_Context::top();

    if (seen->top)
    {
        seen->prev = seen->top->prev;
        seen->name = ((Fake_Context*)seen->top)->name;
    }

    return arg;
}

void* exit_early(void* arg)
{
    record_context(arg);
    Thread::exit((void*)42);
}

// Pops whatever a test left on this thread's stack; declared after the
// contexts, so that it runs while they still exist.
struct Stack_Guard
{
    ~Stack_Guard()
    {
        while (Thread_Context::top())
            Thread_Context::pop();
    }
};

} // namespace

TEST(Thread_Context, PushAndPop)
{
    Fake_Stats stats;
    Fake_Context a("a", stats);
    Fake_Context b("b", stats);
    Stack_Guard guard;

    Thread_Context::pop();
    EXPECT_EQ(Thread_Context::top(), (Thread_Context*)0);

    Thread_Context::push(&a);
    Thread_Context::push(&b);
    EXPECT_EQ(Thread_Context::top(), &b);
    EXPECT_EQ(b.prev, &a);
    EXPECT_EQ(a.prev, (Thread_Context*)0);

    Thread_Context::pop();
    EXPECT_EQ(Thread_Context::top(), &a);
    EXPECT_EQ(b.prev, (Thread_Context*)0);

    Thread_Context::pop();
    EXPECT_EQ(Thread_Context::top(), (Thread_Context*)0);
    EXPECT_EQ(a.prev, (Thread_Context*)0);

    // Popping doesn't destroy.
    EXPECT_EQ(stats.destroyed, 0);
}

TEST(Thread_Context, StacksArePerThread)
{
    Fake_Stats stats;
    Fake_Context a("a", stats);
    Stack_Guard guard;
    Thread_Context::push(&a);

    Thread_Context* other = &a;
    std::thread t([&other]() { other = Thread_Context::top(); });
    t.join();

    EXPECT_EQ(other, (Thread_Context*)0);
    EXPECT_EQ(Thread_Context::top(), &a);
}

TEST(Thread, InheritsTheHooksContext)
{
    Fake_Stats stats;
    Fake_Context parent("parent", stats);
    Stack_Guard guard;
    Thread_Context::push(&parent);

    Seen seen;
    Thread thread;
    ASSERT_EQ(Thread::create_joinable(thread, record_context, &seen), 0);
    void* result = (void*)1;
    EXPECT_EQ(Thread::join(thread, result), 0);
    EXPECT_EQ(result, &seen);

    // The new thread ran under its own context, alone on its stack, with the
    // start and exit hooks around the body; it was destroyed at the end.
    ASSERT_NE(seen.top, (Thread_Context*)0);
    EXPECT_NE(seen.top, &parent);
    EXPECT_EQ(seen.prev, (Thread_Context*)0);
    EXPECT_EQ(seen.name, "parent/child");
    EXPECT_EQ(stats.contexts, 2);
    EXPECT_EQ(stats.started, 1);
    EXPECT_EQ(stats.exited, 1);
    EXPECT_EQ(stats.destroyed, 1);

    // The parent's stack is untouched.
    EXPECT_EQ(Thread_Context::top(), &parent);
    EXPECT_EQ(parent.prev, (Thread_Context*)0);
}

TEST(Thread, NoContextWithoutOne)
{
    Seen seen;
    seen.top = (Thread_Context*)&seen;
    Thread thread;
    ASSERT_EQ(Thread::create_joinable(thread, record_context, &seen), 0);
    void* result;
    EXPECT_EQ(Thread::join(thread, result), 0);
    EXPECT_EQ(seen.top, (Thread_Context*)0);
}

TEST(Thread, FailingCreateLeavesCallerIntact)
{
    Fake_Stats stats;
    Fake_Context below("below", stats);
    Fake_Context parent("parent", stats);
    Stack_Guard guard;
    Thread_Context::push(&below);
    Thread_Context::push(&parent);

    Seen seen;
    Thread thread;
    fail_next_create = 1;
    EXPECT_EQ(Thread::create_joinable(thread, record_context, &seen), EAGAIN);

    // The hook's context was made and released; nothing ran.
    EXPECT_EQ(stats.contexts, 3);
    EXPECT_EQ(stats.destroyed, 1);
    EXPECT_EQ(stats.started, 0);
    EXPECT_EQ(seen.top, (Thread_Context*)0);
    EXPECT_EQ(Thread_Context::top(), &parent);
    EXPECT_EQ(parent.prev, &below);
}

TEST(Thread, ExitRunsTheHookAndReleasesTheContext)
{
    Fake_Stats stats;
    Fake_Context parent("parent", stats);
    Stack_Guard guard;
    Thread_Context::push(&parent);

    Seen seen;
    Thread thread;
    ASSERT_EQ(Thread::create_joinable(thread, exit_early, &seen), 0);
    void* result = 0;
    EXPECT_EQ(Thread::join(thread, result), 0);

    EXPECT_EQ(result, (void*)42);
    EXPECT_EQ(seen.name, "parent/child");
    EXPECT_EQ(stats.exited, 1);
    EXPECT_EQ(stats.destroyed, 1);
}

TEST(Thread, DetachedAndSelf)
{
    static std::atomic<int> done{0};
    static Thread seen_self;
    Thread thread;

    ASSERT_EQ(Thread::create_detached(thread, [](void*) -> void* {
        seen_self = Thread::self();
        done = 1;
        return 0;
    }, 0), 0);

    for (int i = 0; i < 500 && !done; i++)
        Time::sleep(10 * Time::MSEC);

    ASSERT_EQ(done, 1);
    EXPECT_TRUE(Thread::equal(seen_self, thread));
    EXPECT_FALSE(Thread::equal(Thread::self(), thread));
    EXPECT_TRUE(Thread::equal(Thread::self(), Thread::self()));
}
