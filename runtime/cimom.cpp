#include "cimom.h"
#include "Thread_Context.h"

namespace OLMA
{

Instance_Enumerator::~Instance_Enumerator()
{
    Thread_Context* top = Thread_Context::top();

    if (_rep && top)
        top->instance_enumerator_destroy(_rep);
}

Instance_Enumerator::operator bool() const
{
    Thread_Context* top = Thread_Context::top();
    return _rep && top && top->instance_enumerator_more(_rep);
}

void Instance_Enumerator::operator++(int)
{
    Thread_Context* top = Thread_Context::top();

    if (_rep && top)
        top->instance_enumerator_next(_rep);
}

Ref<Instance> Instance_Enumerator::operator()() const
{
    Thread_Context* top = Thread_Context::top();

    if (_rep && top)
        return top->instance_enumerator_get(_rep);

    return Ref<Instance>();
}

int cimom::enum_instances(const char* name_space, const Instance* model, Instance_Enumerator& e)
{
    Thread_Context* top = Thread_Context::top();

    if (!top)
        return -1;

    if (e._rep)
    {
        top->instance_enumerator_destroy(e._rep);
        e._rep = 0;
    }

    e._rep = top->instance_enumerator_create(name_space, model);
    return e._rep ? 0 : -1;
}

Ref<Instance> cimom::get_instance(const char* name_space, const Instance* model)
{
    Thread_Context* top = Thread_Context::top();
    return top ? top->get_instance(name_space, model) : Ref<Instance>();
}

int cimom::create_instance(const char* name_space, const Instance* instance)
{
    Thread_Context* top = Thread_Context::top();
    return top ? top->create_instance(name_space, instance) : -1;
}

int cimom::delete_instance(const char* name_space, const Instance* instance)
{
    Thread_Context* top = Thread_Context::top();
    return top ? top->delete_instance(name_space, instance) : -1;
}

int cimom::modify_instance(const char* name_space, const Instance* instance)
{
    Thread_Context* top = Thread_Context::top();
    return top ? top->modify_instance(name_space, instance) : -1;
}

int cimom::invoke_method(const char* name_space, const Instance* instance, Instance* method)
{
    Thread_Context* top = Thread_Context::top();
    return top ? top->invoke_method(name_space, instance, method) : -1;
}

void cimom::allow_unload(bool flag)
{
    if (Thread_Context* top = Thread_Context::top())
        top->allow_unload(flag);
}

bool cimom::get_username(String& user_name)
{
    Thread_Context* top = Thread_Context::top();
    return top ? top->get_username(user_name) : false;
}

} // namespace OLMA
