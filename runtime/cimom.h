#ifndef _OLMA_cimom_h
#define _OLMA_cimom_h

// Calls back into the CIM server, for providers. Each goes through the
// calling thread's top Thread_Context; a thread without one gets the
// failure result of each function.

#include "config.h"
#include "String.h"
#include "Instance.h"

namespace OLMA
{

struct Instance_Enumerator_Rep;

// Walks the result of cimom::enum_instances():
//
//     Instance_Enumerator e;
//     if (cimom::enum_instances(ns, model, e) == 0)
//         for (; e; e++)
//             Ref<Instance> x = e();
//
// Use it on the thread that made it, within the same context.
class Instance_Enumerator
{
public:
    Instance_Enumerator() : _rep(0) { }

    ~Instance_Enumerator();

    explicit operator bool() const;

    void operator++(int);

    Ref<Instance> operator()() const;

    Instance_Enumerator_Rep* _rep;

private:
    Instance_Enumerator(const Instance_Enumerator&);
    Instance_Enumerator& operator=(const Instance_Enumerator&);
};

class cimom
{
public:
    // 0, or -1 if the server gave nothing (or there is no context).
    static int enum_instances(const char* name_space, const Instance* model, Instance_Enumerator& e);

    // A new reference, or null.
    static Ref<Instance> get_instance(const char* name_space, const Instance* model);

    static int create_instance(const char* name_space, const Instance* instance);

    static int delete_instance(const char* name_space, const Instance* instance);

    static int modify_instance(const char* name_space, const Instance* instance);

    static int invoke_method(const char* name_space, const Instance* instance, Instance* method);

    static void allow_unload(bool flag);

    static bool get_username(String& user_name);
};

} // namespace OLMA

#endif // _OLMA_cimom_h
