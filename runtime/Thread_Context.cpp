#include "Thread_Context.h"
#include <pthread.h>
#include "log.h"

namespace OLMA
{

// One key holds the top of every thread's stack, so that no lock is needed.
static pthread_key_t _thread_context_key;
static pthread_once_t _thread_context_key_once = PTHREAD_ONCE_INIT;

static void _make_key()
{
    int r = pthread_key_create(&_thread_context_key, 0);
    TESSEL_ASSERT(r == 0);
}

static Thread_Context* _get_top()
{
    pthread_once(&_thread_context_key_once, _make_key);
    return (Thread_Context*)pthread_getspecific(_thread_context_key);
}

static void _set_top(Thread_Context* context)
{
    pthread_once(&_thread_context_key_once, _make_key);
    pthread_setspecific(_thread_context_key, context);
}

Thread_Context::~Thread_Context()
{
}

void Thread_Context::push(Thread_Context* context)
{
    if (!context)
        return;

    context->prev = _get_top();
    _set_top(context);
}

void Thread_Context::pop()
{
    Thread_Context* top = _get_top();

    if (!top)
        return;

    _set_top(top->prev);
    top->prev = 0;
}

Thread_Context* Thread_Context::top()
{
    return _get_top();
}

} // namespace OLMA
