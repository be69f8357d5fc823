#ifndef _OLMA_Thread_Context_h
#define _OLMA_Thread_Context_h

// A per-thread stack of contexts through which providers reach the CIM
// server without seeing CMPI. The server's request frame pushes one; a
// thread started by the runtime inherits one through thread_create_hook().

#include "config.h"
#include "String.h"
#include "Instance.h"

namespace OLMA
{

// Belongs to the context's implementation.
struct Instance_Enumerator_Rep;

class Thread_Context
{
public:
    Thread_Context() : prev(0) { }

    virtual ~Thread_Context();

    // On the parent thread: the context of a new thread.
    virtual Thread_Context* thread_create_hook(void* arg) = 0;

    // On the new thread, after its context is pushed.
    virtual void thread_start_hook() = 0;

    // On the thread that ends, while its context is still on top.
    virtual void thread_exit_hook() = 0;

    virtual Instance_Enumerator_Rep* instance_enumerator_create(
        const char* name_space, const Instance* model) = 0;

    virtual void instance_enumerator_destroy(Instance_Enumerator_Rep* rep) = 0;

    virtual bool instance_enumerator_more(Instance_Enumerator_Rep* rep) = 0;

    virtual void instance_enumerator_next(Instance_Enumerator_Rep* rep) = 0;

    virtual Ref<Instance> instance_enumerator_get(Instance_Enumerator_Rep* rep) = 0;

    virtual Ref<Instance> get_instance(const char* name_space, const Instance* model) = 0;

    virtual int create_instance(const char* name_space, const Instance* instance) = 0;

    virtual int delete_instance(const char* name_space, const Instance* instance) = 0;

    virtual int modify_instance(const char* name_space, const Instance* instance) = 0;

    virtual int invoke_method(
        const char* name_space, const Instance* instance, Instance* method) = 0;

    virtual void allow_unload(bool flag) = 0;

    virtual bool get_username(String& user_name) = 0;

    // The context becomes the top; the former top is its prev.
    static void push(Thread_Context* context);

    // Takes the top off (without destroying it) and clears its prev. An
    // empty stack is left alone.
    static void pop();

    // This thread's top context, or null.
    static Thread_Context* top();

    // The context below on the same thread; null when not on a stack.
    Thread_Context* prev;

private:
    Thread_Context(const Thread_Context&);
    Thread_Context& operator=(const Thread_Context&);
};

} // namespace OLMA

#endif // _OLMA_Thread_Context_h
