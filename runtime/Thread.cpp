#include "Thread.h"
#include "Thread_Context.h"
#include "log.h"

namespace OLMA
{

struct Thread_Start
{
    void* (*proc)(void*);
    void* arg;
    Thread_Context* context;
};

// Pops and destroys the thread's inherited context however the thread ends:
// by returning or by Thread::exit(), whose pthread_exit() unwinds the stack.
struct Thread_Context_Guard
{
    Thread_Context* context;

    ~Thread_Context_Guard()
    {
        if (!context)
            return;

        // The thread body must leave its stack as it found it.
        if (Thread_Context::top() != context)
            TLOG(LL_ERR, "thread ends with a foreign context on top");

        while (Thread_Context::top() && Thread_Context::top() != context)
            Thread_Context::pop();

        Thread_Context::pop();
        delete context;
    }
};

static void* _thread_proc(void* data)
{
    Thread_Start* start = (Thread_Start*)data;
    void* (*proc)(void*) = start->proc;
    void* arg = start->arg;
    Thread_Context_Guard guard = { start->context };
    delete start;

    if (guard.context)
    {
        Thread_Context::push(guard.context);
        guard.context->thread_start_hook();
    }

    void* result = proc(arg);

    if (guard.context)
        guard.context->thread_exit_hook();

    return result;
}

static int _create(Thread& thread, void* (*proc)(void*), void* arg, bool detached)
{
    Thread_Start* start = new Thread_Start;
    start->proc = proc;
    start->arg = arg;
    start->context = 0;

    if (Thread_Context* top = Thread_Context::top())
        start->context = top->thread_create_hook(arg);

    pthread_attr_t attr;
    pthread_attr_init(&attr);
    pthread_attr_setdetachstate(
        &attr, detached ? PTHREAD_CREATE_DETACHED : PTHREAD_CREATE_JOINABLE);

    const int r = pthread_create(&thread._thread, &attr, _thread_proc, start);
    pthread_attr_destroy(&attr);

    if (r != 0)
    {
        TLOG(LL_ERR, "pthread_create() failed: %d", r);
        delete start->context;
        delete start;
    }

    return r;
}

int Thread::create_joinable(Thread& thread, void* (*proc)(void*), void* arg)
{
    return _create(thread, proc, arg, false);
}

int Thread::create_detached(Thread& thread, void* (*proc)(void*), void* arg)
{
    return _create(thread, proc, arg, true);
}

void Thread::exit(void* return_value)
{
    if (Thread_Context* top = Thread_Context::top())
        top->thread_exit_hook();

    pthread_exit(return_value);
}

int Thread::join(Thread& thread, void*& return_value)
{
    return_value = 0;
    return pthread_join(thread._thread, &return_value);
}

Thread Thread::self()
{
    Thread thread;
    thread._thread = pthread_self();
    return thread;
}

bool Thread::equal(const Thread& x, const Thread& y)
{
    return pthread_equal(x._thread, y._thread) != 0;
}

} // namespace OLMA
