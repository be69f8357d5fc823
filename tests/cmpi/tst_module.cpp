// The bridge's test module: one provider of TST_Part whose answers the tests
// choose, registered and exported as the generated glue does for the real
// providers, and linked the same way.

#include <atomic>
#include <cstdio>
#include <cstring>
#include "tst_classes.h"
#include "tst_state.h"
#include "Provider.h"
#include "Dispatch.h"
#include "CMPI_Adapter.h"
#include "cimom.h"
#include "Thread.h"
#include "Time.h"

namespace OLMA
{

static Tst_State _state;

static void _observe(const char* op, const TST_Part* x)
{
    snprintf(_state.last_op, sizeof(_state.last_op), "%s", op);
    _state.name[0] = 0;
    _state.index = 0;
    _state.non_null = 0;

    if (!x)
        return;

    snprintf(_state.name, sizeof(_state.name), "%s", x->Name.value.c_str());
    _state.index = x->Index.value;

    const Meta_Class* mc = x->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];
        if ((mf->flags & FLAG_PROPERTY) && !(mf->flags & FLAG_KEY) &&
            !__null_of(x, (const Meta_Property*)mf))
            _state.non_null++;
    }
}

// On a thread the provider starts: the server through the thread's own
// attached context. (Not this provider: the request that waits for the
// thread holds its lock.)
static void* _thread_proc(void*)
{
    String user;
    _state.thread_user_ok = cimom::get_username(user) && user == "cimhost";
    return 0;
}

// Frob's text picks a round trip through the server, for the context
// tests; the count says what came back.
static uint32 _through_server(const String& what, bool& handled)
{
    handled = true;

    if (what == "enum")
    {
        Ref<TST_Part> model(tst_make_key("", 0));
        Instance_Enumerator e;
        if (cimom::enum_instances("root/test", model.ptr(), e) != 0)
            return 1000;
        uint32 n = 0;
        for (; e; e++)
        {
            Ref<Instance> i = e();
            if (i && checked_cast<TST_Part>(i.ptr()))
                n++;
        }
        return n;
    }

    if (what == "get")
    {
        Ref<TST_Part> model(tst_make_key("part1", 1));
        Ref<Instance> i = cimom::get_instance("root/test", model.ptr());
        TST_Part* p = checked_cast<TST_Part>(i.ptr());
        return p ? p->U8.value : 1000;
    }

    if (what == "invoke")
    {
        // Frob again, through the server, asking it for a get.
        Ref<TST_Part> self(tst_make_key("inner", 5));
        Ref<TST_Part_Frob_method> m(create<TST_Part_Frob_method>(false));
        __set_null_flags(m.ptr(), true, true, 1);
        m->Text.set("get");
        if (cimom::invoke_method("root/test", self.ptr(), m.ptr()) != 0)
            return 1000;
        if (m->Count.null || m->return_value.null || m->return_value.value != 7 || !m->Made)
            return 1001;
        return m->Count.value;
    }

    if (what == "create")
    {
        Ref<TST_Part> part(tst_make_part("created", 6));
        int created = cimom::create_instance("root/test", part.ptr());
        int deleted = cimom::delete_instance("root/test", part.ptr());
        return (created == 0 ? 1 : 0) + (deleted == 0 ? 2 : 0);
    }

    if (what == "thread")
    {
        Thread t;
        if (Thread::create_joinable(t, _thread_proc, 0) != 0)
            return 1000;
        void* rv;
        Thread::join(t, rv);
        return _state.thread_user_ok ? 1 : 0;
    }

    handled = false;
    return 0;
}

class TST_Part_Provider
{
public:

    TST_Part_Provider() { _state.constructed++; }

    ~TST_Part_Provider() { _state.destructed++; }

    Load_Status load()
    {
        _state.loads++;
        if (_state.deny_unload)
            cimom::allow_unload(false);
        return LOAD_OK;
    }

    Unload_Status unload()
    {
        _state.unloads++;
        return UNLOAD_OK;
    }

    Get_Instance_Status get_instance(const TST_Part* model, TST_Part*& instance)
    {
        _observe("get_instance", model);
        if (_state.get_status == GET_INSTANCE_OK)
            instance = tst_make_part(model->Name.value.c_str(), model->Index.value);
        return Get_Instance_Status(_state.get_status);
    }

    Enum_Instances_Status enum_instances(const TST_Part* model,
        Enum_Instances_Handler<TST_Part>* handler)
    {
        _observe("enum_instances", model);
        _state.sent = 0;
        _state.stopped = false;

        for (unsigned i = 0; i < _state.count; i++)
        {
            char name[32];
            snprintf(name, sizeof(name), "part%u", i);
            TST_Part* p = tst_make_part(name, uint16(i));

            // References to the previous part, plain and embedded, alone
            // and in arrays.
            if (i > 0)
            {
                snprintf(name, sizeof(name), "part%u", i - 1);
                p->Peer = tst_make_key(name, uint16(i - 1));
                p->Embedded = tst_make_part(name, uint16(i - 1));
                TST_Part* peers[] = { tst_make_key(name, uint16(i - 1)) };
                p->Peers.set(Array<TST_Part*>(peers, 1));
                TST_Part* embeddeds[] = { tst_make_part(name, uint16(i - 1)) };
                p->Embeddeds.set(Array<TST_Part*>(embeddeds, 1));
            }

            _state.sent++;

            if (!handler->handle(p))
            {
                _state.stopped = true;
                break;
            }
        }

        return Enum_Instances_Status(_state.enum_status);
    }

    Create_Instance_Status create_instance(TST_Part* instance)
    {
        _observe("create_instance", instance);
        if (_state.create_status == CREATE_INSTANCE_OK)
            instance->Index.set(4242);
        return Create_Instance_Status(_state.create_status);
    }

    Delete_Instance_Status delete_instance(const TST_Part* instance)
    {
        _observe("delete_instance", instance);
        return Delete_Instance_Status(_state.delete_status);
    }

    Modify_Instance_Status modify_instance(const TST_Part* model, const TST_Part*)
    {
        _observe("modify_instance", model);
        return Modify_Instance_Status(_state.modify_status);
    }

    Invoke_Method_Status Frob(const TST_Part* self, const Property<String>& Text,
        const Property<Array<String> >& Lines, Property<uint32>& Count,
        TST_Part*& Made, Property<uint32>& return_value)
    {
        _observe("Frob", self);
        snprintf(_state.text, sizeof(_state.text), "%s",
            Text.null ? "(null)" : Text.value.c_str());
        _state.lines = Lines.null ? 1000 : (unsigned)Lines.value.size();

        String user;
        _state.user_ok = cimom::get_username(user);
        snprintf(_state.user, sizeof(_state.user), "%s", user.c_str());

        bool handled = false;
        uint32 through = Text.null ? 0 : _through_server(Text.value, handled);
        Count.set(handled ? through : _state.lines * 2);
        Made = tst_make_key("made", 9);
        return_value.set(7);
        return Invoke_Method_Status(_state.invoke_status);
    }
};

// Serves TST_Link by enumeration alone, so that the runtime's generic
// association paths do the filtering.
class TST_Link_Provider
{
public:

    Load_Status load() { return LOAD_OK; }

    Unload_Status unload() { return UNLOAD_OK; }

    Get_Instance_Status get_instance(const TST_Link*, TST_Link*&)
    {
        return GET_INSTANCE_UNSUPPORTED;
    }

    Enum_Instances_Status enum_instances(const TST_Link* model, Enum_Instances_Handler<TST_Link>* handler)
    {
        snprintf(_state.link_model_ns, sizeof(_state.link_model_ns), "%s",
            model ? model->__name_space.c_str() : "(none)");
        if (_state.self_link && !handler->handle(tst_make_link("part0", 0, "part0", 0)))
            return ENUM_INSTANCES_OK;

        for (unsigned i = 0; i + 1 < _state.count; i++)
        {
            char left[32], right[32];
            snprintf(left, sizeof(left), "part%u", i);
            snprintf(right, sizeof(right), "part%u", i + 1);
            if (!handler->handle(tst_make_link(left, uint16(i), right, uint16(i + 1))))
                break;
        }

        return Enum_Instances_Status(_state.enum_status);
    }

    Create_Instance_Status create_instance(TST_Link*) { return CREATE_INSTANCE_UNSUPPORTED; }

    Delete_Instance_Status delete_instance(const TST_Link*) { return DELETE_INSTANCE_UNSUPPORTED; }

    Modify_Instance_Status modify_instance(const TST_Link*, const TST_Link*)
    {
        return MODIFY_INSTANCE_UNSUPPORTED;
    }

    Enum_Associator_Names_Status enum_associator_names(const Instance*, const String&,
        const String&, const String&, Enum_Associator_Names_Handler<Instance>*)
    {
        return ENUM_ASSOCIATOR_NAMES_UNSUPPORTED;
    }

    Enum_Associators_Status enum_associators(const Instance*, const String&,
        const String&, const String&, Enum_Associators_Handler<Instance>*)
    {
        return ENUM_ASSOCIATORS_UNSUPPORTED;
    }

    Enum_References_Status enum_references(const Instance*, const TST_Link*,
        const String&, Enum_References_Handler<TST_Link>*)
    {
        return ENUM_REFERENCES_UNSUPPORTED;
    }
};

// Sends TST_Alert from a thread of its own while enabled: as many as the
// tests ask for through pending, which both sides touch atomically.
class TST_Alert_Provider
{
public:

    TST_Alert_Provider() : _handler(0), _stop(false) { }

    ~TST_Alert_Provider() { delete _handler; }

    Load_Status load() { return LOAD_OK; }

    Unload_Status unload() { return UNLOAD_OK; }

    Enable_Indications_Status enable_indications(Indication_Handler<TST_Alert>* handler)
    {
        _state.enables++;
        _handler = handler;

        if (_state.enable_status != ENABLE_INDICATIONS_OK)
            return Enable_Indications_Status(_state.enable_status);

        _stop = false;
        Thread::create_joinable(_thread, _proc, this);
        return ENABLE_INDICATIONS_OK;
    }

    Disable_Indications_Status disable_indications()
    {
        _state.disables++;
        _stop = true;
        void* rv;
        Thread::join(_thread, rv);

        // The end of the stream, and the handler goes with it.
        if (_handler)
        {
            _state.stream_ended = !_handler->handle(0);
            delete _handler;
            _handler = 0;
        }

        return DISABLE_INDICATIONS_OK;
    }

private:

    static void* _proc(void* arg)
    {
        TST_Alert_Provider* self = (TST_Alert_Provider*)arg;

        while (!self->_stop)
        {
            if (__atomic_load_n(&_state.pending, __ATOMIC_ACQUIRE))
            {
                __atomic_fetch_sub(&_state.pending, 1, __ATOMIC_ACQ_REL);
                TST_Alert* alert = create<TST_Alert>(false);
                alert->Message.set("alert");
                alert->Sequence.set(++_state.alerts_sent);
                String args[] = { String("port"), String("down") };
                alert->Args.set(Array<String>(args, 2));
                alert->When.set(Datetime("20240102030405.000006+060"));
                if (!self->_handler->handle(alert))
                    _state.refused++;
            }
            else
                Time::sleep(Time::MSEC);
        }

        return 0;
    }

    Indication_Handler<TST_Alert>* _handler;
    Thread _thread;
    std::atomic<bool> _stop;
};

extern "C" sint32 __tessel_TST_Alert_Provider_proc(
    const Registration* registration, int operation,
    void* arg0, void* arg1, void* arg2, void* arg3,
    void* arg4, void* arg5, void* arg6, void* arg7)
{
    return __dispatch_indication<TST_Alert, TST_Alert_Provider>(
        registration, operation, arg0, arg1, arg2, arg3, arg4, arg5, arg6, arg7);
}

extern "C" sint32 __tessel_TST_Link_Provider_proc(
    const Registration* registration, int operation,
    void* arg0, void* arg1, void* arg2, void* arg3,
    void* arg4, void* arg5, void* arg6, void* arg7)
{
    return __dispatch_association<TST_Link, TST_Link_Provider>(
        registration, operation, arg0, arg1, arg2, arg3, arg4, arg5, arg6, arg7);
}

static sint32 _TST_Part_Provider_invoke(
    TST_Part_Provider* provider, const TST_Part* self, Instance* method)
{
    const char* name = __method_name(method);

    if (name && strcasecmp(name, "Frob") == 0 && __is_record<TST_Part_Frob_method>(method))
    {
        TST_Part_Frob_method* m = (TST_Part_Frob_method*)method;
        return provider->Frob(self, m->Text, m->Lines, m->Count, m->Made, m->return_value);
    }

    return -1;
}

extern "C" sint32 __tessel_TST_Part_Provider_proc(
    const Registration* registration, int operation,
    void* arg0, void* arg1, void* arg2, void* arg3,
    void* arg4, void* arg5, void* arg6, void* arg7)
{
    if (operation == OP_INVOKE_METHOD)
        return _TST_Part_Provider_invoke(
            (TST_Part_Provider*)arg0, (const TST_Part*)arg1, (Instance*)arg2);

    return __dispatch_instance<TST_Part, TST_Part_Provider>(
        registration, operation, arg0, arg1, arg2, arg3, arg4, arg5, arg6, arg7);
}

static Registration _TST_Part_Provider_registration =
{
    "vspr_cmpi_test_module",
    "TST_Part_Provider",
    __tessel_TST_Part_Provider_proc,
    &TST_Part::static_meta_class,
    0,
};

static CMPI_Static_Data _cmpi_static_dataTST_Part_Provider;

static Registration _TST_Link_Provider_registration =
{
    "vspr_cmpi_test_module",
    "TST_Link_Provider",
    __tessel_TST_Link_Provider_proc,
    &TST_Link::static_meta_class,
    &_TST_Part_Provider_registration,
};

static CMPI_Static_Data _cmpi_static_dataTST_Link_Provider;

static Registration _TST_Alert_Provider_registration =
{
    "vspr_cmpi_test_module",
    "TST_Alert_Provider",
    __tessel_TST_Alert_Provider_proc,
    &TST_Alert::static_meta_class,
    &_TST_Link_Provider_registration,
};

static CMPI_Static_Data _cmpi_static_dataTST_Alert_Provider;

} // namespace OLMA

using namespace OLMA;

extern "C" CMPI_EXPORT Tst_State* tst_state()
{
    return &_state;
}

extern "C" CMPI_EXPORT const Registration* tessel_module()
{
    return &_TST_Alert_Provider_registration;
}

extern "C" CMPI_EXPORT CMPIInstanceMI* TST_Part_Provider_Create_InstanceMI(
    const CMPIBroker* broker, const CMPIContext* context, CMPIStatus*)
{
    void* mi = 0;
    tessel_cmpi_adapter(&_cmpi_static_dataTST_Part_Provider, &_TST_Part_Provider_registration,
        broker, context, "TST_Part_Provider", 'I', &mi);
    return (CMPIInstanceMI*)mi;
}

extern "C" CMPI_EXPORT CMPIMethodMI* TST_Part_Provider_Create_MethodMI(
    const CMPIBroker* broker, const CMPIContext* context, CMPIStatus*)
{
    void* mi = 0;
    tessel_cmpi_adapter(&_cmpi_static_dataTST_Part_Provider, &_TST_Part_Provider_registration,
        broker, context, "TST_Part_Provider", 'M', &mi);
    return (CMPIMethodMI*)mi;
}

#define TST_LINK_ENTRY(TYPE, KIND, LETTER) \
    extern "C" CMPI_EXPORT TYPE* TST_Link_Provider_Create_##KIND##MI( \
        const CMPIBroker* broker, const CMPIContext* context, CMPIStatus*) \
    { \
        void* mi = 0; \
        tessel_cmpi_adapter(&_cmpi_static_dataTST_Link_Provider, \
            &_TST_Link_Provider_registration, broker, context, "TST_Link_Provider", \
            LETTER, &mi); \
        return (TYPE*)mi; \
    }

TST_LINK_ENTRY(CMPIInstanceMI, Instance, 'I')
TST_LINK_ENTRY(CMPIMethodMI, Method, 'M')
TST_LINK_ENTRY(CMPIAssociationMI, Association, 'A')

extern "C" CMPI_EXPORT CMPIIndicationMI* TST_Alert_Provider_Create_IndicationMI(
    const CMPIBroker* broker, const CMPIContext* context, CMPIStatus*)
{
    void* mi = 0;
    tessel_cmpi_adapter(&_cmpi_static_dataTST_Alert_Provider, &_TST_Alert_Provider_registration,
        broker, context, "TST_Alert_Provider", 'N', &mi);
    return (CMPIIndicationMI*)mi;
}

extern "C" CMPI_EXPORT CMPIMethodMI* TST_Alert_Provider_Create_MethodMI(
    const CMPIBroker* broker, const CMPIContext* context, CMPIStatus*)
{
    void* mi = 0;
    tessel_cmpi_adapter(&_cmpi_static_dataTST_Alert_Provider, &_TST_Alert_Provider_registration,
        broker, context, "TST_Alert_Provider", 'M', &mi);
    return (CMPIMethodMI*)mi;
}
