#include <cstring>
#include "CMPI_Thread_Context.h"
#include "CMPI_Adapter.h"
#include "CMPI_Containers.h"
#include "Converter.h"
#include "log.h"

namespace OLMA
{

// An enumeration of the CIM server, read one instance ahead. The path that
// asked for it and what went into the path go with it.
struct Instance_Enumerator_Rep
{
    CMPIEnumeration* enumeration;
    const Meta_Class* meta_class;
    Ref<Instance> instance;
    CMPIObjectPath* path;
    CMPI_Made made;
};

// The context that decides: the top of this thread's stack.
static CMPI_Thread_Context* _top()
{
    return static_cast<CMPI_Thread_Context*>(Thread_Context::top());
}

CMPI_Thread_Context::CMPI_Thread_Context(const CMPIBroker* broker_,
    const CMPIContext* context_, CMPI_Adapter* adapter_) :
    broker(broker_), context(context_), adapter(adapter_)
{
}

CMPI_Thread_Context::~CMPI_Thread_Context()
{
}

Thread_Context* CMPI_Thread_Context::thread_create_hook(void*)
{
    const CMPIContext* child = 0;
    if (broker && context)
        child = CBPrepareAttachThread(broker, context);
    return new CMPI_Thread_Context(broker, child, adapter);
}

void CMPI_Thread_Context::thread_start_hook()
{
    if (broker && context)
        CBAttachThread(broker, context);
}

void CMPI_Thread_Context::thread_exit_hook()
{
    if (broker && context)
        CBDetachThread(broker, context);
}

// The next instance of the enumeration, or null at its end. Anything but an
// instance ends the enumeration too.
static Instance* _next_instance(CMPIEnumeration* enumeration, const Meta_Class* meta_class)
{
    if (!enumeration || !CMHasNext(enumeration, 0))
        return 0;

    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIData data = CMGetNext(enumeration, &st);
    _read_by_pointer(data);

    if (st.rc != CMPI_RC_OK || data.type != CMPI_instance || !data.value.inst ||
        (data.state & CMPI_nullValue))
        return 0;

    const CMPIObjectPath* path = CMGetObjectPath(data.value.inst, 0);
    Instance* instance = 0;

    if (make_tessel_instance(0, meta_class, path, data.value.inst, instance) != 0)
        return 0;

    return instance;
}

// Up-calls release what they made for the call once it has returned and its
// answer is read, so that a long-lived thread doesn't gather them.
Instance_Enumerator_Rep* CMPI_Thread_Context::instance_enumerator_create(
    const char* name_space, const Instance* model)
{
    CMPI_Thread_Context* top = _top();

    if (!name_space || !model || !top || !top->broker || !top->context)
        return 0;

    Instance_Enumerator_Rep* rep = new Instance_Enumerator_Rep;
    rep->enumeration = 0;
    rep->meta_class = model->meta_class;
    rep->path = 0;

    if (make_cmpi_object_path(top->broker, model, name_space, rep->path, &rep->made) != 0)
    {
        delete rep;
        return 0;
    }

    CMPIStatus st = { CMPI_RC_OK, 0 };
    rep->enumeration = CBEnumInstances(top->broker, top->context, rep->path, 0, &st);

    if (st.rc != CMPI_RC_OK || !rep->enumeration)
    {
        instance_enumerator_destroy(rep);
        return 0;
    }

    rep->instance.reset(_next_instance(rep->enumeration, rep->meta_class));
    return rep;
}

void CMPI_Thread_Context::instance_enumerator_destroy(Instance_Enumerator_Rep* rep)
{
    // The CMPIEnumeration belongs to the server.
    if (rep && rep->path)
        CMRelease(rep->path);
    delete rep;
}

bool CMPI_Thread_Context::instance_enumerator_more(Instance_Enumerator_Rep* rep)
{
    return rep && rep->instance;
}

void CMPI_Thread_Context::instance_enumerator_next(Instance_Enumerator_Rep* rep)
{
    if (rep)
        rep->instance.reset(_next_instance(rep->enumeration, rep->meta_class));
}

Ref<Instance> CMPI_Thread_Context::instance_enumerator_get(Instance_Enumerator_Rep* rep)
{
    if (!rep)
        return Ref<Instance>();
    return rep->instance;
}

Ref<Instance> CMPI_Thread_Context::get_instance(const char* name_space, const Instance* model)
{
    CMPI_Thread_Context* top = _top();

    if (!name_space || !model || !top || !top->broker || !top->context)
        return Ref<Instance>();

    CMPI_Made made;
    CMPIObjectPath* path = 0;

    if (make_cmpi_object_path(top->broker, model, name_space, path, &made) != 0)
        return Ref<Instance>();

    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIInstance* ci = CBGetInstance(top->broker, top->context, path, 0, &st);
    Instance* instance = 0;

    if (st.rc == CMPI_RC_OK && ci)
        make_tessel_instance(0, model->meta_class, path, ci, instance);

    CMRelease(path);
    return Ref<Instance>(instance);
}

// The path and the CMPI form of an instance, for the calls that write.
static int _prepare(CMPI_Thread_Context* top, const char* name_space,
    const Instance* instance, CMPIObjectPath*& path, CMPIInstance*& ci, CMPI_Made& made)
{
    path = 0;
    ci = 0;

    if (make_cmpi_object_path(top->broker, instance, name_space, path, &made) != 0)
        return -1;

    if (make_cmpi_instance(top->broker, instance, name_space, path, 0, ci, &made) != 0)
    {
        CMRelease(path);
        path = 0;
        return -1;
    }

    return 0;
}

int CMPI_Thread_Context::create_instance(const char* name_space, const Instance* instance)
{
    CMPI_Thread_Context* top = _top();

    if (!name_space || !instance || !top || !top->broker || !top->context)
        return -1;

    CMPI_Made made;
    CMPIObjectPath* path;
    CMPIInstance* ci;

    if (_prepare(top, name_space, instance, path, ci, made) != 0)
        return -1;

    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIObjectPath* created = CBCreateInstance(top->broker, top->context, path, ci, &st);

    if (created)
        CMRelease(created);
    CMRelease(ci);
    CMRelease(path);
    return st.rc == CMPI_RC_OK ? 0 : -1;
}

int CMPI_Thread_Context::modify_instance(const char* name_space, const Instance* instance)
{
    CMPI_Thread_Context* top = _top();

    if (!name_space || !instance || !top || !top->broker || !top->context)
        return -1;

    CMPI_Made made;
    CMPIObjectPath* path;
    CMPIInstance* ci;

    if (_prepare(top, name_space, instance, path, ci, made) != 0)
        return -1;

    // Through the table: some servers' 1.0 headers lack the macro.
    CMPIStatus st = top->broker->bft->modifyInstance(top->broker, top->context, path, ci, 0);

    CMRelease(ci);
    CMRelease(path);
    return st.rc == CMPI_RC_OK ? 0 : -1;
}

int CMPI_Thread_Context::delete_instance(const char* name_space, const Instance* instance)
{
    CMPI_Thread_Context* top = _top();

    if (!name_space || !instance || !top || !top->broker || !top->context)
        return -1;

    CMPI_Made made;
    CMPIObjectPath* path = 0;

    if (make_cmpi_object_path(top->broker, instance, name_space, path, &made) != 0)
        return -1;

    CMPIStatus st = CBDeleteInstance(top->broker, top->context, path);
    CMRelease(path);
    return st.rc == CMPI_RC_OK ? 0 : -1;
}

int CMPI_Thread_Context::invoke_method(
    const char* name_space, const Instance* instance, Instance* method)
{
    CMPI_Thread_Context* top = _top();

    if (!name_space || !instance || !method || !instance->meta_class ||
        !instance->meta_class->meta_repository || !method->meta_class ||
        !top || !top->broker || !top->context)
    {
        TLOG(LL_WARN, "failed");
        return -1;
    }

    const CMPIBroker* mb = top->broker;
    const Meta_Repository* mr = instance->meta_class->meta_repository;
    const Meta_Method* mm = (const Meta_Method*)method->meta_class;
    CMPI_Made made;
    CMPIObjectPath* path = 0;

    if (mm->flags & FLAG_STATIC)
        path = CMNewObjectPath(mb, name_space, instance->meta_class->name, 0);
    else if (make_cmpi_object_path(mb, instance, name_space, path, &made) != 0)
        path = 0;

    if (!path)
    {
        TLOG(LL_WARN, "failed");
        return -1;
    }

    CMPIArgs* in_args = CMNewArgs(mb, 0);
    CMPIArgs* out_args = CMNewArgs(mb, 0);

    if (!in_args || !out_args)
    {
        TLOG(LL_WARN, "failed");
        if (in_args)
            CMRelease(in_args);
        if (out_args)
            CMRelease(out_args);
        CMRelease(path);
        return -1;
    }

    CMPIArgs_Container in(mr, mb, name_space, in_args, &made);
    in.convert(method, FLAG_IN);

    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIData data = CBInvokeMethod(mb, top->context, path, mm->name, in_args, out_args, &st);
    _read_by_pointer(data);
    int result = 0;

    if (st.rc != CMPI_RC_OK)
    {
        TLOG(LL_WARN, "failed[%u]", (unsigned)st.rc);
        result = -1;
    }
    else
    {
        const char* ns = _name_space_of(path);
        CMPIArgs_Container out(mr, mb, ns, out_args);
        out.upcall = true;
        out.convert((const Meta_Class*)mm, FLAG_OUT, method);
        __set_name_space_recursive(method, ns, false);

        Value value;
        const Meta_Feature* rv = find_feature(mm, "return_value", FLAG_PROPERTY);

        if (cmpi_to_tessel_value(mr, mb, name_space, data, value) != 0 || !rv ||
            value.get(method, rv) != 0)
        {
            TLOG(LL_WARN, "failed");
            result = -1;
        }
    }

    CMRelease(in_args);
    CMRelease(out_args);
    CMRelease(path);
    return result;
}

void CMPI_Thread_Context::allow_unload(bool flag)
{
    CMPI_Thread_Context* top = _top();
    if (top && top->adapter)
        top->adapter->allow_unload_flag = flag;
}

bool CMPI_Thread_Context::get_username(String& user_name)
{
    CMPI_Thread_Context* top = _top();

    if (!top || !top->context)
        return false;

    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIData data = CMGetContextEntry(top->context, "CMPIPrincipal", &st);
    const char* s = 0;

    if (st.rc == CMPI_RC_OK && !(data.state & CMPI_nullValue))
    {
        if (data.type == CMPI_string)
            s = _chars(data.value.string);
        else if (data.type == CMPI_chars)
            s = data.value.chars;
    }

    if (!s)
    {
        TLOG(LL_ERR, "username not OK cmpirc=%d", (int)st.rc);
        return false;
    }

    user_name.assign(s);
    return true;
}

} // namespace OLMA
