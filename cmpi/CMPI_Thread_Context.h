#ifndef _OLMA_CMPI_Thread_Context_h
#define _OLMA_CMPI_Thread_Context_h

// The CMPI form of Thread_Context: a provider that calls cimom reaches the
// CIM server through the broker and the context of the request (or of the
// attached thread) on top of its thread's stack.

#include "CMPI.h"
#include "Thread_Context.h"

namespace OLMA
{

class CMPI_Adapter;

class CMPI_Thread_Context : public Thread_Context
{
public:

    CMPI_Thread_Context(const CMPIBroker* broker, const CMPIContext* context,
        CMPI_Adapter* adapter);

    virtual ~CMPI_Thread_Context();

    virtual Thread_Context* thread_create_hook(void* arg);

    virtual void thread_start_hook();

    virtual void thread_exit_hook();

    virtual Instance_Enumerator_Rep* instance_enumerator_create(
        const char* name_space, const Instance* model);

    virtual void instance_enumerator_destroy(Instance_Enumerator_Rep* rep);

    virtual bool instance_enumerator_more(Instance_Enumerator_Rep* rep);

    virtual void instance_enumerator_next(Instance_Enumerator_Rep* rep);

    virtual Ref<Instance> instance_enumerator_get(Instance_Enumerator_Rep* rep);

    virtual Ref<Instance> get_instance(const char* name_space, const Instance* model);

    virtual int create_instance(const char* name_space, const Instance* instance);

    virtual int delete_instance(const char* name_space, const Instance* instance);

    virtual int modify_instance(const char* name_space, const Instance* instance);

    virtual int invoke_method(
        const char* name_space, const Instance* instance, Instance* method);

    virtual void allow_unload(bool flag);

    virtual bool get_username(String& user_name);

    const CMPIBroker* broker;
    const CMPIContext* context;
    CMPI_Adapter* adapter;
};

} // namespace OLMA

#endif // _OLMA_CMPI_Thread_Context_h
