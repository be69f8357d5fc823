// The host: loads the module, routes operations and up-calls to the
// providers registered for their classes, and is the broker they call.

#include <cerrno>
#include <chrono>
#include <condition_variable>
#include <cstdlib>
#include <cstring>
#include <dlfcn.h>
#include <pthread.h>
#include <time.h>
#include <unistd.h>

#include "objects.h"

#ifndef CIMHOST_DEFAULT_MODULE
#define CIMHOST_DEFAULT_MODULE "libvsprprovider_Module.so"
#endif
#ifndef CIMHOST_DEFAULT_REG
#define CIMHOST_DEFAULT_REG "vsprprovider.reg"
#endif

namespace OLMA
{
namespace cimhost
{

namespace
{

// The MIs the host holds of one provider, and its indication bookkeeping
// (touched only by the thread that drives the host).
struct Provider_State
{
    void* instance_mi = nullptr;
    void* method_mi = nullptr;
    void* association_mi = nullptr;
    void* indication_mi = nullptr;
    int filters = 0;
    bool enabled = false;
};

void*& slot_of(Provider_State& ps, unsigned kind)
{
    switch (kind)
    {
    case MI_INSTANCE: return ps.instance_mi;
    case MI_ASSOCIATION: return ps.association_mi;
    case MI_METHOD: return ps.method_mi;
    default: return ps.indication_mi;
    }
}

struct Subscription
{
    std::string name_space;
    std::string class_name;
    std::vector<std::string> providers;
    CMPISelectExp* filter = nullptr;
    CMPIObjectPath* path = nullptr;
};

// One operation's scope: what it makes is freed at its end.
struct Op_Scope
{
    Arena arena;
    Op_Scope() { push_arena(&arena); }
    ~Op_Scope()
    {
        pop_arena();
        free_arena(&arena);
    }
};

enum Assoc_Op
{
    A_ASSOCIATORS,
    A_ASSOCIATOR_NAMES,
    A_REFERENCES,
    A_REFERENCE_NAMES,
};

// A slot a provider left empty answers as a server would for an operation
// the provider doesn't offer.
#define MI_CALL(mi, slot, ...) \
    ((mi)->ft->slot ? (mi)->ft->slot((mi), __VA_ARGS__) : status(CMPI_RC_ERR_NOT_SUPPORTED))

const char* c_or_null(const std::string& s)
{
    return s.empty() ? nullptr : s.c_str();
}

std::string status_text(const CMPIStatus& st)
{
    String_Obj* s = obj_cast<String_Obj>(st.msg, K_STRING);
    return s && !s->is_null ? s->s : "";
}

// "activateFilter" or "activateFilter: <the provider's text>".
std::string with_text(const char* what, const CMPIStatus& st)
{
    std::string t = status_text(st);
    return t.empty() ? std::string(what) : std::string(what) + ": " + t;
}

// A property list as the char** form.
struct Prop_List
{
    std::vector<const char*> ptrs;
    const char** get(const std::vector<std::string>* props)
    {
        if (!props)
            return nullptr;
        ptrs.clear();
        for (const std::string& p : *props)
            ptrs.push_back(p.c_str());
        ptrs.push_back(nullptr);
        return ptrs.data();
    }
};

} // namespace

class Host_Impl
{
public:
    Options opts;
    std::string err;
    bool ok = false;
    void* dl = nullptr;
    std::vector<Registration_Entry> regs;
    Catalogue cat;
    std::map<std::string, Provider_State> providers;
    std::recursive_mutex mi_mutex;
    CMPIBroker broker;
    CMPIBrokerFT bft;
    CMPIBrokerEncFT eft;
    CMPIBrokerExtFT xft;
    std::map<int, Subscription> subs;
    int next_sub = 1;
    mutable std::mutex ind_mutex;
    mutable std::condition_variable ind_cv;
    std::vector<Indication_Record> inds;
    std::string default_ns;

    explicit Host_Impl(const Options& o);
    ~Host_Impl();

    std::vector<Property> context_entries(const std::string& ns) const
    {
        return {Property {CMPIPrincipal, Value::of_string(opts.principal)},
                Property {CMPIInvocationFlags, Value::of_uint(CMPI_uint32, 0)},
                Property {CMPIInitNameSpace, Value::of_string(ns)}};
    }

    CMPIContext* context(const std::string& ns) { return new_context(context_entries(ns)); }

    bool known_ns(const std::string& ns) const
    {
        for (const Registration_Entry& e : regs)
            for (const std::string& n : e.name_spaces)
                if (name_eq(n, ns))
                    return true;
        return false;
    }

    bool serves_ns(const Registration_Entry& e, const std::string& ns) const
    {
        if (e.name_spaces.empty())
            return true;
        for (const std::string& n : e.name_spaces)
            if (name_eq(n, ns))
                return true;
        return false;
    }

    bool knows_class(const std::string& cls) const
    {
        if (cat.find(cls))
            return true;
        for (const Registration_Entry& e : regs)
            if (name_eq(e.class_name, cls))
                return true;
        return false;
    }

    // Whether the stand-in object manager answers in ns. A module may serve
    // classes of its own there too, as it would in a real server's interop
    // namespace; both then answer.
    bool is_interop(const std::string& ns) const
    {
        return opts.interop && name_eq(ns, opts.interop_namespace);
    }

    void* mi_for(const std::string& provider, unsigned kind, const std::string& ns, CMPIrc& rc,
                 std::string& msg);

    // Map nodes stay put, so the reference outlives the lock.
    Provider_State& state(const std::string& provider)
    {
        std::lock_guard<std::recursive_mutex> g(mi_mutex);
        return providers[provider];
    }

    // Registrations of `kind` that serve `cls` in `ns`: the class's own,
    // then (with `subclasses`) those of its subclasses, else those of its
    // nearest registered ancestor.
    std::vector<const Registration_Entry*> find_regs(const std::string& ns, const std::string& cls,
                                                     unsigned kind, bool subclasses, CMPIrc& rc,
                                                     std::string& msg);

    CMPIrc check_ns(std::string& ns, std::string& msg)
    {
        if (ns.empty())
            ns = default_ns;
        if (known_ns(ns))
            return CMPI_RC_OK;
        if (name_eq(ns, opts.interop_namespace) && opts.interop)
            return CMPI_RC_OK;
        msg = "namespace " + ns + " is not served";
        return CMPI_RC_ERR_INVALID_NAMESPACE;
    }

    CMPIrc interop_enum(const Object_Path& cls, bool names, std::vector<Value>& out);
    Instance interop_instance() const;

    CMPIrc do_enum(Object_Path cls, const char** props, bool names, std::vector<Value>& out,
                   std::string& msg);
    CMPIrc do_get(Object_Path path, const char** props, Value& out, std::string& msg);
    CMPIrc do_create(Object_Path path, const Instance& inst, Object_Path& made, std::string& msg);
    CMPIrc do_modify(Object_Path path, const Instance& inst, const char** props,
                     std::string& msg);
    CMPIrc do_delete(Object_Path path, std::string& msg);
    CMPIrc do_query(Object_Path cls, const std::string& query, const std::string& lang,
                    std::vector<Value>& out, std::string& msg);
    CMPIrc do_assoc(Assoc_Op op, Object_Path path, const std::string& assoc_class,
                    const std::string& result_class, const std::string& role,
                    const std::string& result_role, const char** props, std::vector<Value>& out,
                    std::string& msg);
    CMPIrc do_invoke(Object_Path path, const std::string& method, const std::vector<Property>& in,
                     Value& ret, std::vector<Property>& out, std::string& msg);

    Result subscribe(const std::string& ns, const std::string& cls, int& id,
                     const std::string& query);
    Result unsubscribe(int id);
    int cleanup(bool terminating);
};

namespace
{

Host_Impl* the_host = nullptr;

Host_Impl* host_of(const CMPIBroker* mb)
{
    return mb ? static_cast<Host_Impl*>(mb->hdl) : nullptr;
}

const char* kind_word(unsigned kind)
{
    switch (kind)
    {
    case MI_INSTANCE: return "Instance";
    case MI_ASSOCIATION: return "Association";
    case MI_METHOD: return "Method";
    default: return "Indication";
    }
}

void fill_from(std::vector<Value>& out, Collector& c)
{
    out.insert(out.end(), std::make_move_iterator(c.items.begin()),
               std::make_move_iterator(c.items.end()));
    c.items.clear();
}

//
// Broker functions (bft)
//

CMPIContext* b_prepare_attach(const CMPIBroker* mb, const CMPIContext* ctx)
{
    Host_Impl* h = host_of(mb);
    Ctx_Obj* c = obj_cast<Ctx_Obj>(ctx, K_CONTEXT);
    if (!h || !c)
        return nullptr;
    // The new thread outlives the request that starts it.
    return new_context(c->entries, host_arena());
}

thread_local std::vector<Arena*> attached;

CMPIStatus b_attach(const CMPIBroker* mb, const CMPIContext* ctx)
{
    if (!host_of(mb) || !obj_cast<Ctx_Obj>(ctx, K_CONTEXT))
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    Arena* a = new Arena;
    attached.push_back(a);
    push_arena(a);
    return status(CMPI_RC_OK);
}

CMPIStatus b_detach(const CMPIBroker* mb, const CMPIContext* ctx)
{
    if (!host_of(mb))
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (attached.empty())
        return status(CMPI_RC_ERR_FAILED);
    Arena* a = attached.back();
    attached.pop_back();
    pop_arena();
    free_arena(a);
    delete a;
    // The context that prepareAttachThread made for this thread ends with
    // it, as the standard has it: a provider never releases it itself.
    if (obj_cast<Ctx_Obj>(ctx, K_CONTEXT))
        release_obj(ctx);
    return status(CMPI_RC_OK);
}

CMPIStatus b_deliver(const CMPIBroker* mb, const CMPIContext* ctx, const char* ns,
                     const CMPIInstance* ind)
{
    Host_Impl* h = host_of(mb);
    if (!h || !obj_cast<Ctx_Obj>(ctx, K_CONTEXT))
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    Inst_Obj* io = obj_cast<Inst_Obj>(ind, K_INSTANCE, "CBDeliverIndication");
    if (!io || !ns)
        return status(ind && ns ? CMPI_RC_ERR_INVALID_HANDLE : CMPI_RC_ERR_INVALID_PARAMETER);
    Indication_Record r;
    r.name_space = ns;
    r.instance = read_instance(io, "CBDeliverIndication");
    {
        std::lock_guard<std::mutex> g(h->ind_mutex);
        h->inds.push_back(r);
    }
    h->ind_cv.notify_all();
    return status(CMPI_RC_OK);
}

// The checks every up-call makes of its arguments; the path as it is read
// when the call is made.
bool upcall_path(const CMPIBroker* mb, const CMPIContext* ctx, const CMPIObjectPath* op,
                 const char* call, Object_Path& path, CMPIStatus* rc)
{
    Path_Obj* p = obj_cast<Path_Obj>(op, K_PATH, call);
    if (!host_of(mb) || !obj_cast<Ctx_Obj>(ctx, K_CONTEXT, call) || (op && !p))
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return false;
    }
    if (!p)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_PARAMETER);
        return false;
    }
    path = read_path(p, call);
    return true;
}

CMPIEnumeration* enum_result(const CMPIBroker* mb, CMPIrc code, const std::vector<Value>& items,
                             CMPIStatus* rc)
{
    set_rc(rc, code);
    if (code != CMPI_RC_OK)
        return nullptr;
    CMPIEnumeration* e = new_enum(items);
    obj_cast<Enum_Obj>(e, K_ENUM)->null_state = host_of(mb)->opts.pegasus_enumerations;
    return e;
}

CMPIEnumeration* b_enum_names(const CMPIBroker* mb, const CMPIContext* ctx,
                              const CMPIObjectPath* op, CMPIStatus* rc)
{
    Object_Path p;
    if (!upcall_path(mb, ctx, op, "CBEnumInstanceNames", p, rc))
        return nullptr;
    std::vector<Value> out;
    std::string msg;
    CMPIrc code = host_of(mb)->do_enum(p, nullptr, true, out, msg);
    return enum_result(mb, code, out, rc);
}

CMPIEnumeration* b_enum(const CMPIBroker* mb, const CMPIContext* ctx, const CMPIObjectPath* op,
                        const char** props, CMPIStatus* rc)
{
    Object_Path p;
    if (!upcall_path(mb, ctx, op, "CBEnumInstances", p, rc))
        return nullptr;
    std::vector<Value> out;
    std::string msg;
    CMPIrc code = host_of(mb)->do_enum(p, props, false, out, msg);
    return enum_result(mb, code, out, rc);
}

CMPIInstance* b_get(const CMPIBroker* mb, const CMPIContext* ctx, const CMPIObjectPath* op,
                    const char** props, CMPIStatus* rc)
{
    Object_Path p;
    if (!upcall_path(mb, ctx, op, "CBGetInstance", p, rc))
        return nullptr;
    Value out;
    std::string msg;
    CMPIrc code = host_of(mb)->do_get(p, props, out, msg);
    set_rc(rc, code);
    return code == CMPI_RC_OK && out.inst ? new_instance(*out.inst) : nullptr;
}

CMPIObjectPath* b_create(const CMPIBroker* mb, const CMPIContext* ctx, const CMPIObjectPath* op,
                         const CMPIInstance* inst, CMPIStatus* rc)
{
    Object_Path p;
    if (!upcall_path(mb, ctx, op, "CBCreateInstance", p, rc))
        return nullptr;
    Inst_Obj* i = obj_cast<Inst_Obj>(inst, K_INSTANCE, "CBCreateInstance");
    if (!i)
    {
        set_rc(rc, inst ? CMPI_RC_ERR_INVALID_HANDLE : CMPI_RC_ERR_INVALID_PARAMETER);
        return nullptr;
    }
    Object_Path made;
    std::string msg;
    CMPIrc code = host_of(mb)->do_create(p, read_instance(i, "CBCreateInstance"), made, msg);
    set_rc(rc, code);
    return code == CMPI_RC_OK ? new_path(made) : nullptr;
}

CMPIStatus b_modify(const CMPIBroker* mb, const CMPIContext* ctx, const CMPIObjectPath* op,
                    const CMPIInstance* inst, const char** props)
{
    CMPIStatus st = status(CMPI_RC_OK);
    Object_Path p;
    if (!upcall_path(mb, ctx, op, "CBModifyInstance", p, &st))
        return st;
    Inst_Obj* i = obj_cast<Inst_Obj>(inst, K_INSTANCE, "CBModifyInstance");
    if (!i)
        return status(inst ? CMPI_RC_ERR_INVALID_HANDLE : CMPI_RC_ERR_INVALID_PARAMETER);
    std::string msg;
    return status(
        host_of(mb)->do_modify(p, read_instance(i, "CBModifyInstance"), props, msg));
}

CMPIStatus b_delete(const CMPIBroker* mb, const CMPIContext* ctx, const CMPIObjectPath* op)
{
    CMPIStatus st = status(CMPI_RC_OK);
    Object_Path p;
    if (!upcall_path(mb, ctx, op, "CBDeleteInstance", p, &st))
        return st;
    std::string msg;
    return status(host_of(mb)->do_delete(p, msg));
}

CMPIEnumeration* b_query(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
                         const char*, const char*, CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_ERR_NOT_SUPPORTED);
    return nullptr;
}

CMPIEnumeration* b_assoc(Assoc_Op aop, const CMPIBroker* mb, const CMPIContext* ctx,
                         const CMPIObjectPath* op, const char* assoc, const char* result,
                         const char* role, const char* rrole, const char** props, CMPIStatus* rc)
{
    static const char* const calls[] = {"CBAssociators", "CBAssociatorNames", "CBReferences",
                                        "CBReferenceNames"};
    Object_Path p;
    if (!upcall_path(mb, ctx, op, calls[aop], p, rc))
        return nullptr;
    std::vector<Value> out;
    std::string msg;
    CMPIrc code = host_of(mb)->do_assoc(aop, p, assoc ? assoc : "", result ? result : "",
                                        role ? role : "", rrole ? rrole : "", props, out, msg);
    return enum_result(mb, code, out, rc);
}

CMPIEnumeration* b_associators(const CMPIBroker* mb, const CMPIContext* ctx,
                               const CMPIObjectPath* op, const char* assoc, const char* result,
                               const char* role, const char* rrole, const char** props,
                               CMPIStatus* rc)
{
    return b_assoc(A_ASSOCIATORS, mb, ctx, op, assoc, result, role, rrole, props, rc);
}

CMPIEnumeration* b_associator_names(const CMPIBroker* mb, const CMPIContext* ctx,
                                    const CMPIObjectPath* op, const char* assoc,
                                    const char* result, const char* role, const char* rrole,
                                    CMPIStatus* rc)
{
    return b_assoc(A_ASSOCIATOR_NAMES, mb, ctx, op, assoc, result, role, rrole, nullptr, rc);
}

CMPIEnumeration* b_references(const CMPIBroker* mb, const CMPIContext* ctx,
                              const CMPIObjectPath* op, const char* result, const char* role,
                              const char** props, CMPIStatus* rc)
{
    return b_assoc(A_REFERENCES, mb, ctx, op, nullptr, result, role, nullptr, props, rc);
}

CMPIEnumeration* b_reference_names(const CMPIBroker* mb, const CMPIContext* ctx,
                                   const CMPIObjectPath* op, const char* result, const char* role,
                                   CMPIStatus* rc)
{
    return b_assoc(A_REFERENCE_NAMES, mb, ctx, op, nullptr, result, role, nullptr, nullptr, rc);
}

CMPIData null_data()
{
    CMPIData d;
    memset(&d, 0, sizeof(d));
    d.type = CMPI_null;
    d.state = CMPI_nullValue;
    return d;
}

CMPIData b_invoke(const CMPIBroker* mb, const CMPIContext* ctx, const CMPIObjectPath* op,
                  const char* method, const CMPIArgs* in, CMPIArgs* out, CMPIStatus* rc)
{
    Object_Path p;
    if (!upcall_path(mb, ctx, op, "CBInvokeMethod", p, rc))
        return null_data();
    Args_Obj* ia = obj_cast<Args_Obj>(in, K_ARGS, "CBInvokeMethod");
    Args_Obj* oa = obj_cast<Args_Obj>(out, K_ARGS, "CBInvokeMethod");
    if ((in && !ia) || (out && !oa))
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return null_data();
    }
    if (!method)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_PARAMETER);
        return null_data();
    }
    Value ret;
    std::vector<Property> outs;
    std::string msg;
    CMPIrc code = host_of(mb)->do_invoke(
        p, method, ia ? read_args(ia, "CBInvokeMethod") : std::vector<Property>(), ret, outs, msg);
    set_rc(rc, code);
    if (code != CMPI_RC_OK)
        return null_data();
    if (oa)
        add_args(oa, outs);
    return to_cmpi(ret);
}

CMPIStatus b_set_property(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
                          const char*, const CMPIValue*, CMPIType)
{
    return status(CMPI_RC_ERR_NOT_SUPPORTED);
}

CMPIData b_get_property(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*, const char*,
                        CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_ERR_NOT_SUPPORTED);
    return null_data();
}

//
// Encoded functions (eft)
//

CMPIInstance* e_new_instance(const CMPIBroker* mb, const CMPIObjectPath* op, CMPIStatus* rc)
{
    Path_Obj* p = obj_cast<Path_Obj>(op, K_PATH, "CMNewInstance");
    if (!host_of(mb) || !p)
    {
        set_rc(rc, op ? CMPI_RC_ERR_INVALID_HANDLE : CMPI_RC_ERR_INVALID_PARAMETER);
        return nullptr;
    }
    set_rc(rc, CMPI_RC_OK);
    return new_instance_of(p);
}

CMPIObjectPath* e_new_path(const CMPIBroker* mb, const char* ns, const char* cn, CMPIStatus* rc)
{
    if (!host_of(mb))
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return nullptr;
    }
    Object_Path p;
    p.name_space = ns ? ns : "";
    p.class_name = cn ? cn : "";
    set_rc(rc, CMPI_RC_OK);
    return new_path(p);
}

CMPIArgs* e_new_args(const CMPIBroker*, CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_OK);
    return new_args({});
}

CMPIString* e_new_string(const CMPIBroker*, const char* s, CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_OK);
    return new_string(s);
}

CMPIArray* e_new_array(const CMPIBroker*, CMPICount max, CMPIType type, CMPIStatus* rc)
{
    CMPIType el = CMPIType(type & ~CMPI_ARRAY);
    if (type_name(el).empty() || max > 1000000)
    {
        set_rc(rc, type_name(el).empty() ? CMPI_RC_ERR_INVALID_DATA_TYPE
                                         : CMPI_RC_ERR_INVALID_PARAMETER);
        return nullptr;
    }
    set_rc(rc, CMPI_RC_OK);
    return new_array(el, max);
}

CMPIDateTime* e_new_datetime(const CMPIBroker*, CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_OK);
    return new_datetime(datetime_now());
}

CMPIDateTime* e_new_datetime_bin(const CMPIBroker*, CMPIUint64 bin, CMPIBoolean interval,
                                 CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_OK);
    return new_datetime(datetime_from_binary(bin, interval != 0));
}

CMPIDateTime* e_new_datetime_chars(const CMPIBroker*, const char* text, CMPIStatus* rc)
{
    if (!text || !datetime_valid(text))
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_PARAMETER);
        return nullptr;
    }
    set_rc(rc, CMPI_RC_OK);
    return new_datetime(text);
}

CMPISelectExp* e_new_select(const CMPIBroker*, const char* query, const char* lang,
                            CMPIArray** projection, CMPIStatus* rc)
{
    if (projection)
        *projection = nullptr;
    if (!query || !lang)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_PARAMETER);
        return nullptr;
    }
    // The class after FROM is all the host reads of a query.
    std::string q = query, cls;
    std::string lq = lower(q);
    size_t from = lq.find(" from ");
    if (from != std::string::npos)
    {
        size_t b = q.find_first_not_of(' ', from + 6);
        size_t e = b == std::string::npos ? b : q.find_first_of(" ;", b);
        if (b != std::string::npos)
            cls = q.substr(b, e == std::string::npos ? std::string::npos : e - b);
    }
    set_rc(rc, CMPI_RC_OK);
    return new_select(q, lang, cls);
}

CMPIBoolean e_class_path_is_a(const CMPIBroker* mb, const CMPIObjectPath* op, const char* type,
                              CMPIStatus* rc)
{
    Host_Impl* h = host_of(mb);
    Path_Obj* p = obj_cast<Path_Obj>(op, K_PATH);
    if (!h || !p || !type)
    {
        set_rc(rc, p && type ? CMPI_RC_ERR_INVALID_HANDLE : CMPI_RC_ERR_INVALID_PARAMETER);
        return 0;
    }
    set_rc(rc, CMPI_RC_OK);
    return h->cat.is_a(p->class_name, type) || name_eq(p->class_name, type);
}

const Obj* live_obj(const void* p)
{
    const Obj* o = static_cast<const Obj*>(p);
    if (o && o->magic == OBJ_RELEASED && o->hdl == o)
        used_after_release(o, "a broker call");
    return o && o->magic == OBJ_LIVE && o->hdl == o ? o : nullptr;
}

CMPIString* e_to_string(const CMPIBroker*, const void* object, CMPIStatus* rc)
{
    const Obj* o = live_obj(object);
    if (!o)
    {
        set_rc(rc, object ? CMPI_RC_ERR_INVALID_HANDLE : CMPI_RC_ERR_INVALID_PARAMETER);
        return nullptr;
    }
    std::string text;
    switch (o->kind)
    {
    case K_INSTANCE:
        text = instance_mof(read_instance(static_cast<const Inst_Obj*>(o), "CDToString"));
        break;
    case K_PATH: text = read_path(static_cast<const Path_Obj*>(o), "CDToString").to_string(); break;
    case K_STRING: text = static_cast<const String_Obj*>(o)->s; break;
    case K_DATETIME: text = static_cast<const DT_Obj*>(o)->text; break;
    case K_SELECTEXP: text = static_cast<const Select_Obj*>(o)->query; break;
    case K_ARGS:
    case K_CONTEXT:
    {
        const std::vector<Property> v =
            o->kind == K_ARGS ? read_args(static_cast<const Args_Obj*>(o), "CDToString")
                              : static_cast<const Ctx_Obj*>(o)->entries;
        for (const Property& p : v)
            text += (text.empty() ? "" : ", ") + p.name + "=" + p.value.text();
        break;
    }
    case K_ARRAY:
    {
        text = read_array(static_cast<const Array_Obj*>(o), "CDToString").text();
        break;
    }
    default: text = kind_name(o->kind); break;
    }
    set_rc(rc, CMPI_RC_OK);
    return new_string(text.c_str());
}

CMPIBoolean e_is_of_type(const CMPIBroker*, const void* object, const char* type, CMPIStatus* rc)
{
    const Obj* o = live_obj(object);
    if (!o || !type)
    {
        set_rc(rc, o ? CMPI_RC_ERR_INVALID_PARAMETER : CMPI_RC_ERR_INVALID_HANDLE);
        return 0;
    }
    set_rc(rc, CMPI_RC_OK);
    return strcmp(kind_name(o->kind), type) == 0;
}

CMPIString* e_get_type(const CMPIBroker*, const void* object, CMPIStatus* rc)
{
    const Obj* o = live_obj(object);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return nullptr;
    }
    set_rc(rc, CMPI_RC_OK);
    return new_string(kind_name(o->kind));
}

CMPIString* e_get_message(const CMPIBroker*, const char*, const char* def_msg, CMPIStatus* rc,
                          CMPICount count, ...)
{
    // The host has no message catalogue: the default text, with $0, $1...
    // replaced by the arguments.
    std::vector<std::string> args;
    va_list ap;
    va_start(ap, count);
    for (CMPICount i = 0; i < count && i < 10; i++)
    {
        int type = va_arg(ap, int);
        char buf[64];
        switch (type)
        {
        case CMPI_sint32: snprintf(buf, sizeof(buf), "%ld", va_arg(ap, long)); break;
        case CMPI_uint32: snprintf(buf, sizeof(buf), "%lu", va_arg(ap, unsigned long)); break;
        case CMPI_sint64: snprintf(buf, sizeof(buf), "%lld", va_arg(ap, long long)); break;
        case CMPI_uint64:
            snprintf(buf, sizeof(buf), "%llu", va_arg(ap, unsigned long long));
            break;
        case CMPI_real64: snprintf(buf, sizeof(buf), "%g", va_arg(ap, double)); break;
        case CMPI_boolean: snprintf(buf, sizeof(buf), "%s", va_arg(ap, int) ? "true" : "false"); break;
        case CMPI_chars:
        {
            const char* s = va_arg(ap, const char*);
            args.push_back(s ? s : "");
            continue;
        }
        case CMPI_string:
        {
            String_Obj* s = obj_cast<String_Obj>(va_arg(ap, CMPIString*), K_STRING);
            args.push_back(s ? s->s : "");
            continue;
        }
        default:
            // An unknown type leaves the rest of the list unreadable.
            i = count;
            continue;
        }
        args.push_back(buf);
    }
    va_end(ap);
    std::string text = def_msg ? def_msg : "";
    std::string r;
    for (size_t i = 0; i < text.size(); i++)
    {
        if (text[i] == '$' && i + 1 < text.size() && text[i + 1] >= '0' && text[i + 1] <= '9' &&
            size_t(text[i + 1] - '0') < args.size())
        {
            r += args[size_t(text[i + 1] - '0')];
            i++;
        }
        else
            r += text[i];
    }
    set_rc(rc, CMPI_RC_OK);
    return new_string(r.c_str());
}

CMPIStatus e_log(const CMPIBroker*, int severity, const char* id, const char* text,
                 const CMPIString* string)
{
    if (getenv("CIMHOST_VERBOSE"))
    {
        String_Obj* s = obj_cast<String_Obj>(string, K_STRING);
        fprintf(stderr, "cimhost: log[%d] %s: %s\n", severity, id ? id : "",
                text ? text : (s ? s->s.c_str() : ""));
    }
    return status(CMPI_RC_OK);
}

CMPIStatus e_trace(const CMPIBroker*, int level, const char* component, const char* text,
                   const CMPIString* string)
{
    if (getenv("CIMHOST_VERBOSE"))
    {
        String_Obj* s = obj_cast<String_Obj>(string, K_STRING);
        fprintf(stderr, "cimhost: trace[%d] %s: %s\n", level, component ? component : "",
                text ? text : (s ? s->s.c_str() : ""));
    }
    return status(CMPI_RC_OK);
}

//
// Operating-system services (xft)
//

char* x_resolve(const char* name)
{
    if (!name)
        return nullptr;
    std::string r = std::string("lib") + name + ".so";
    return strdup(r.c_str());
}

void* x_new_thread(void* (*start)(void*), void* parm, int detached)
{
    pthread_t t;
    pthread_attr_t attr;
    pthread_attr_init(&attr);
    if (detached)
        pthread_attr_setdetachstate(&attr, PTHREAD_CREATE_DETACHED);
    int rc = pthread_create(&t, &attr, start, parm);
    pthread_attr_destroy(&attr);
    return rc ? nullptr : reinterpret_cast<void*>(t);
}

int x_join(void* thread, void** retval)
{
    return pthread_join(reinterpret_cast<pthread_t>(thread), retval);
}

int x_exit(void* rc)
{
    pthread_exit(rc);
}

int x_cancel(void* thread)
{
    return pthread_cancel(reinterpret_cast<pthread_t>(thread));
}

int x_sleep(CMPIUint32 msec)
{
    struct timespec ts;
    ts.tv_sec = msec / 1000;
    ts.tv_nsec = long(msec % 1000) * 1000000L;
    while (nanosleep(&ts, &ts) == -1 && errno == EINTR)
    {
    }
    return 0;
}

std::mutex once_mutex;

int x_once(int* once, void (*init)(void))
{
    if (!once || !init)
        return EINVAL;
    std::lock_guard<std::mutex> g(once_mutex);
    if (*once == 0)
    {
        *once = 1;
        init();
    }
    return 0;
}

int x_create_key(pthread_key_t* key, void (*cleanup)(void*))
{
    return pthread_key_create(key, cleanup);
}

int x_destroy_key(pthread_key_t key)
{
    return pthread_key_delete(key);
}

void* x_get_specific(pthread_key_t key)
{
    return pthread_getspecific(key);
}

int x_set_specific(pthread_key_t key, void* value)
{
    return pthread_setspecific(key, value);
}

void* x_new_mutex(int)
{
    pthread_mutex_t* m = new pthread_mutex_t;
    pthread_mutexattr_t attr;
    pthread_mutexattr_init(&attr);
    pthread_mutexattr_settype(&attr, PTHREAD_MUTEX_RECURSIVE);
    pthread_mutex_init(m, &attr);
    pthread_mutexattr_destroy(&attr);
    return m;
}

void x_destroy_mutex(void* m)
{
    if (!m)
        return;
    pthread_mutex_destroy(static_cast<pthread_mutex_t*>(m));
    delete static_cast<pthread_mutex_t*>(m);
}

void x_lock(void* m)
{
    if (m)
        pthread_mutex_lock(static_cast<pthread_mutex_t*>(m));
}

void x_unlock(void* m)
{
    if (m)
        pthread_mutex_unlock(static_cast<pthread_mutex_t*>(m));
}

void* x_new_cond(int)
{
    pthread_cond_t* c = new pthread_cond_t;
    pthread_cond_init(c, nullptr);
    return c;
}

void x_destroy_cond(void* c)
{
    if (!c)
        return;
    pthread_cond_destroy(static_cast<pthread_cond_t*>(c));
    delete static_cast<pthread_cond_t*>(c);
}

int x_wait(void* c, void* m)
{
    return pthread_cond_wait(static_cast<pthread_cond_t*>(c), static_cast<pthread_mutex_t*>(m));
}

int x_timed_wait(void* c, void* m, struct timespec* wait)
{
    return pthread_cond_timedwait(static_cast<pthread_cond_t*>(c),
                                  static_cast<pthread_mutex_t*>(m), wait);
}

int x_signal(void* c)
{
    return pthread_cond_signal(static_cast<pthread_cond_t*>(c));
}

// The build's own file if it is there, else the bare name, which dlopen
// looks up along LD_LIBRARY_PATH.
std::string default_path(const char* value)
{
    if (access(value, R_OK) == 0)
        return value;
    const char* slash = strrchr(value, '/');
    return slash ? slash + 1 : value;
}

} // namespace

const Catalogue* host_catalogue()
{
    return the_host ? &the_host->cat : nullptr;
}

Host_Impl::Host_Impl(const Options& o) : opts(o)
{
    if (opts.module_path.empty())
        opts.module_path = default_path(CIMHOST_DEFAULT_MODULE);
    if (opts.reg_path.empty())
        opts.reg_path = default_path(CIMHOST_DEFAULT_REG);

    memset(&bft, 0, sizeof(bft));
    bft.brokerCapabilities = CMPI_MB_Class_0 | CMPI_MB_Supports_IndicationMI |
                             CMPI_MB_OSEncapsulationSupport;
    bft.brokerVersion = 100;
    bft.brokerName = "cimhost";
    bft.prepareAttachThread = b_prepare_attach;
    bft.attachThread = b_attach;
    bft.detachThread = b_detach;
    bft.deliverIndication = b_deliver;
    bft.enumerateInstanceNames = b_enum_names;
    bft.getInstance = b_get;
    bft.createInstance = b_create;
    bft.modifyInstance = b_modify;
    bft.deleteInstance = b_delete;
    bft.execQuery = b_query;
    bft.enumerateInstances = b_enum;
    bft.associators = b_associators;
    bft.associatorNames = b_associator_names;
    bft.references = b_references;
    bft.referenceNames = b_reference_names;
    bft.invokeMethod = b_invoke;
    bft.setProperty = b_set_property;
    bft.getProperty = b_get_property;

    memset(&eft, 0, sizeof(eft));
    eft.ftVersion = 100;
    eft.newInstance = e_new_instance;
    eft.newObjectPath = e_new_path;
    eft.newArgs = e_new_args;
    eft.newString = e_new_string;
    eft.newArray = e_new_array;
    eft.newDateTime = e_new_datetime;
    eft.newDateTimeFromBinary = e_new_datetime_bin;
    eft.newDateTimeFromChars = e_new_datetime_chars;
    eft.newSelectExp = e_new_select;
    eft.classPathIsA = e_class_path_is_a;
    eft.toString = e_to_string;
    eft.isOfType = e_is_of_type;
    eft.getType = e_get_type;
    eft.getMessage = e_get_message;
    eft.logMessage = e_log;
    eft.trace = e_trace;

    memset(&xft, 0, sizeof(xft));
    xft.ftVersion = 100;
    xft.resolveFileName = x_resolve;
    xft.newThread = x_new_thread;
    xft.joinThread = x_join;
    xft.exitThread = x_exit;
    xft.cancelThread = x_cancel;
    xft.threadSleep = x_sleep;
    xft.threadOnce = x_once;
    xft.createThreadKey = x_create_key;
    xft.destroyThreadKey = x_destroy_key;
    xft.getThreadSpecific = x_get_specific;
    xft.setThreadSpecific = x_set_specific;
    xft.newMutex = x_new_mutex;
    xft.destroyMutex = x_destroy_mutex;
    xft.lockMutex = x_lock;
    xft.unlockMutex = x_unlock;
    xft.newCondition = x_new_cond;
    xft.destroyCondition = x_destroy_cond;
    xft.condWait = x_wait;
    xft.timedCondWait = x_timed_wait;
    xft.signalCondition = x_signal;

    broker.hdl = this;
    broker.bft = &bft;
    broker.eft = &eft;
    broker.xft = &xft;

    if (!read_reg_file(opts.reg_path, regs, err))
        return;
    for (const Registration_Entry& e : regs)
        if (!e.name_spaces.empty() && default_ns.empty())
            default_ns = e.name_spaces[0];
    dl = dlopen(opts.module_path.c_str(), RTLD_NOW | RTLD_GLOBAL);
    if (!dl)
    {
        const char* e = dlerror();
        err = "can't load " + opts.module_path + ": " + (e ? e : "unknown error");
        return;
    }
    cat.load(opts.classes ? *opts.classes : vespera_classes);
    for (const Registration_Entry& e : regs)
        cat.add_name_only(e.class_name, (e.kinds & MI_ASSOCIATION) != 0,
                          (e.kinds & MI_INDICATION) != 0);
    ok = true;
}

Host_Impl::~Host_Impl()
{
    while (!subs.empty())
        unsubscribe(subs.begin()->first);
    cleanup(true);
    // The module stays loaded, as it does in a server that shuts down: its
    // singletons live in its data, and unmapping that would turn them into
    // leaks for a leak checker and dangle any thread it left behind.
}

void* Host_Impl::mi_for(const std::string& provider, unsigned kind, const std::string& ns,
                        CMPIrc& rc, std::string& msg)
{
    std::lock_guard<std::recursive_mutex> g(mi_mutex);
    void** slot = &slot_of(providers[provider], kind);
    if (*slot)
        return *slot;
    std::string sym = provider + "_Create_" + kind_word(kind) + "MI";
    typedef void* (*Factory)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
    Factory f = reinterpret_cast<Factory>(dlsym(dl, sym.c_str()));
    if (!f)
    {
        rc = CMPI_RC_ERR_NOT_SUPPORTED;
        msg = "module has no " + sym;
        return nullptr;
    }
    CMPIStatus st = status(CMPI_RC_OK);
    void* mi = f(&broker, context(ns), &st);
    if (!mi)
    {
        rc = CMPI_RC_ERR_FAILED;
        msg = sym + " gave no MI";
        return nullptr;
    }
    // Every MI object is {hdl, ft} and every MI table starts with ftVersion
    // and miVersion; a table newer than this broker is refused.
    const int* ft = *reinterpret_cast<int* const*>(static_cast<char*>(mi) + sizeof(void*));
    if (!ft || ft[1] > 100)
    {
        rc = CMPI_RC_ERR_FAILED;
        msg = sym + ": MI version " + (ft ? std::to_string(ft[1]) : "?") + " is newer than 100";
        return nullptr;
    }
    *slot = mi;
    return mi;
}

std::vector<const Registration_Entry*> Host_Impl::find_regs(const std::string& ns,
                                                            const std::string& cls, unsigned kind,
                                                            bool subclasses, CMPIrc& rc,
                                                            std::string& msg)
{
    std::vector<const Registration_Entry*> r;
    rc = CMPI_RC_OK;
    bool wrong_ns = false;
    for (const Registration_Entry& e : regs)
        if ((e.kinds & kind) && name_eq(e.class_name, cls))
        {
            if (serves_ns(e, ns))
                r.push_back(&e);
            else
                wrong_ns = true;
        }
    if (subclasses)
        for (const Registration_Entry& e : regs)
            if ((e.kinds & kind) && !name_eq(e.class_name, cls) && serves_ns(e, ns) &&
                cat.is_a(e.class_name, cls))
                r.push_back(&e);
    if (r.empty() && !subclasses)
    {
        const Class_Info* ci = cat.find(cls);
        for (size_t depth = 0; ci && r.empty() && depth < 64; depth++)
        {
            for (const Registration_Entry& e : regs)
                if ((e.kinds & kind) && name_eq(e.class_name, ci->name) && serves_ns(e, ns))
                    r.push_back(&e);
            ci = ci->super.empty() ? nullptr : cat.find(ci->super);
        }
    }
    if (r.empty())
    {
        if (wrong_ns)
        {
            rc = CMPI_RC_ERR_INVALID_NAMESPACE;
            msg = "class " + cls + " is not served in namespace " + ns;
        }
        else if (!knows_class(cls))
        {
            rc = CMPI_RC_ERR_INVALID_CLASS;
            msg = "unknown class " + cls;
        }
    }
    return r;
}

Instance Host_Impl::interop_instance() const
{
    char host[256] = "localhost";
    gethostname(host, sizeof(host) - 1);
    Instance i;
    i.class_name = "CIM_ObjectManager";
    i.properties = {
        Property {"SystemCreationClassName", Value::of_string("CIM_ComputerSystem")},
        Property {"SystemName", Value::of_string(host)},
        Property {"CreationClassName", Value::of_string("CIM_ObjectManager")},
        Property {"Name", Value::of_string("cimhost:ObjectManager")},
        Property {"ElementName", Value::of_string("cimhost")},
        Property {"Description", Value::of_string("cimhost stand-in CIM object manager")},
    };
    i.path.name_space = opts.interop_namespace;
    i.path.class_name = i.class_name;
    for (size_t k = 0; k < 4; k++)
        i.path.keys.push_back(i.properties[k]);
    return i;
}

CMPIrc Host_Impl::interop_enum(const Object_Path& cls, bool names, std::vector<Value>& out)
{
    static const char* const ancestry[] = {
        "CIM_ObjectManager", "CIM_WBEMService", "CIM_Service", "CIM_EnabledLogicalElement",
        "CIM_LogicalElement", "CIM_ManagedSystemElement", "CIM_ManagedElement"};
    bool match = false;
    for (const char* a : ancestry)
        match = match || name_eq(cls.class_name, a);
    if (!match || opts.interop_empty)
        return CMPI_RC_OK;
    Instance i = interop_instance();
    if (names)
        out.push_back(Value::of_ref(i.path));
    else
        out.push_back(Value::of_instance(i));
    return CMPI_RC_OK;
}

CMPIrc Host_Impl::do_enum(Object_Path cls, const char** props, bool names,
                          std::vector<Value>& out, std::string& msg)
{
    CMPIrc rc = check_ns(cls.name_space, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    if (is_interop(cls.name_space))
    {
        interop_enum(cls, names, out);
        if (!known_ns(cls.name_space))
            return CMPI_RC_OK;
    }
    std::vector<const Registration_Entry*> rs =
        find_regs(cls.name_space, cls.class_name, MI_INSTANCE, true, rc, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    CMPIrc first_error = CMPI_RC_OK;
    for (const Registration_Entry* e : rs)
    {
        CMPIInstanceMI* mi = static_cast<CMPIInstanceMI*>(
            mi_for(e->provider, MI_INSTANCE, cls.name_space, rc, msg));
        if (!mi)
        {
            if (first_error == CMPI_RC_OK)
                first_error = rc;
            continue;
        }
        Object_Path p;
        p.name_space = cls.name_space;
        p.class_name = e->class_name;
        Collector c;
        CMPIStatus st;
        std::string text;
        {
            Op_Scope request;
            st = names ? MI_CALL(mi, enumerateInstanceNames, context(cls.name_space),
                                 new_result(&c), new_path(p))
                       : MI_CALL(mi, enumerateInstances, context(cls.name_space), new_result(&c),
                                 new_path(p), props);
            text = status_text(st);
        }
        fill_from(out, c);
        // Asked on behalf of a superclass, a provider that can't enumerate
        // costs nothing; asked for its own class, it answers.
        if (st.rc != CMPI_RC_OK && !(rs.size() > 1 && st.rc == CMPI_RC_ERR_NOT_SUPPORTED) &&
            first_error == CMPI_RC_OK)
        {
            first_error = st.rc;
            msg = text;
        }
    }
    return first_error;
}

CMPIrc Host_Impl::do_get(Object_Path path, const char** props, Value& out, std::string& msg)
{
    CMPIrc rc = check_ns(path.name_space, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    if (is_interop(path.name_space))
    {
        std::vector<Value> all;
        interop_enum(path, false, all);
        for (const Value& v : all)
            if (path_equal(instance_path(*v.inst), path))
            {
                out = v;
                return CMPI_RC_OK;
            }
        if (!known_ns(path.name_space))
            return CMPI_RC_ERR_NOT_FOUND;
    }
    std::vector<const Registration_Entry*> rs =
        find_regs(path.name_space, path.class_name, MI_INSTANCE, false, rc, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    if (rs.empty())
    {
        msg = "no instance provider for " + path.class_name;
        return CMPI_RC_ERR_NOT_FOUND;
    }
    CMPIInstanceMI* mi = static_cast<CMPIInstanceMI*>(
        mi_for(rs[0]->provider, MI_INSTANCE, path.name_space, rc, msg));
    if (!mi)
        return rc;
    Collector c;
    CMPIStatus st;
    {
        Op_Scope request;
        st = MI_CALL(mi, getInstance, context(path.name_space), new_result(&c), new_path(path),
                     props);
        msg = status_text(st);
    }
    if (st.rc != CMPI_RC_OK)
        return st.rc;
    msg.clear();
    for (const Value& v : c.items)
        if (v.type == CMPI_instance && v.inst)
        {
            out = v;
            return CMPI_RC_OK;
        }
    msg = "provider returned no instance";
    return CMPI_RC_ERR_NOT_FOUND;
}

CMPIrc Host_Impl::do_create(Object_Path path, const Instance& inst, Object_Path& made,
                            std::string& msg)
{
    CMPIrc rc = check_ns(path.name_space, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    std::vector<const Registration_Entry*> rs =
        find_regs(path.name_space, path.class_name, MI_INSTANCE, false, rc, msg);
    if (rc != CMPI_RC_OK || rs.empty())
        return rc != CMPI_RC_OK ? rc : CMPI_RC_ERR_NOT_SUPPORTED;
    CMPIInstanceMI* mi = static_cast<CMPIInstanceMI*>(
        mi_for(rs[0]->provider, MI_INSTANCE, path.name_space, rc, msg));
    if (!mi)
        return rc;
    Collector c;
    CMPIStatus st;
    {
        Op_Scope request;
        st = MI_CALL(mi, createInstance, context(path.name_space), new_result(&c), new_path(path),
                     new_instance(inst));
        msg = status_text(st);
    }
    if (st.rc == CMPI_RC_OK)
    {
        made = path;
        for (const Value& v : c.items)
            if (v.type == CMPI_ref && v.ref)
                made = *v.ref;
    }
    return st.rc;
}

CMPIrc Host_Impl::do_modify(Object_Path path, const Instance& inst, const char** props,
                            std::string& msg)
{
    CMPIrc rc = check_ns(path.name_space, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    std::vector<const Registration_Entry*> rs =
        find_regs(path.name_space, path.class_name, MI_INSTANCE, false, rc, msg);
    if (rc != CMPI_RC_OK || rs.empty())
        return rc != CMPI_RC_OK ? rc : CMPI_RC_ERR_NOT_SUPPORTED;
    CMPIInstanceMI* mi = static_cast<CMPIInstanceMI*>(
        mi_for(rs[0]->provider, MI_INSTANCE, path.name_space, rc, msg));
    if (!mi)
        return rc;
    Collector c;
    Op_Scope request;
    CMPIStatus st = MI_CALL(mi, modifyInstance, context(path.name_space), new_result(&c),
                            new_path(path), new_instance(inst), props);
    msg = status_text(st);
    return st.rc;
}

CMPIrc Host_Impl::do_delete(Object_Path path, std::string& msg)
{
    CMPIrc rc = check_ns(path.name_space, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    std::vector<const Registration_Entry*> rs =
        find_regs(path.name_space, path.class_name, MI_INSTANCE, false, rc, msg);
    if (rc != CMPI_RC_OK || rs.empty())
        return rc != CMPI_RC_OK ? rc : CMPI_RC_ERR_NOT_SUPPORTED;
    CMPIInstanceMI* mi = static_cast<CMPIInstanceMI*>(
        mi_for(rs[0]->provider, MI_INSTANCE, path.name_space, rc, msg));
    if (!mi)
        return rc;
    Collector c;
    Op_Scope request;
    CMPIStatus st =
        MI_CALL(mi, deleteInstance, context(path.name_space), new_result(&c), new_path(path));
    msg = status_text(st);
    return st.rc;
}

CMPIrc Host_Impl::do_query(Object_Path cls, const std::string& query, const std::string& lang,
                           std::vector<Value>& out, std::string& msg)
{
    CMPIrc rc = check_ns(cls.name_space, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    std::vector<const Registration_Entry*> rs =
        find_regs(cls.name_space, cls.class_name, MI_INSTANCE, false, rc, msg);
    if (rc != CMPI_RC_OK || rs.empty())
        return rc != CMPI_RC_OK ? rc : CMPI_RC_ERR_NOT_SUPPORTED;
    CMPIInstanceMI* mi = static_cast<CMPIInstanceMI*>(
        mi_for(rs[0]->provider, MI_INSTANCE, cls.name_space, rc, msg));
    if (!mi)
        return rc;
    Collector c;
    CMPIStatus st;
    {
        Op_Scope request;
        st = MI_CALL(mi, execQuery, context(cls.name_space), new_result(&c), new_path(cls),
                     query.c_str(), lang.c_str());
        msg = status_text(st);
    }
    fill_from(out, c);
    return st.rc;
}

CMPIrc Host_Impl::do_assoc(Assoc_Op op, Object_Path path, const std::string& assoc_class,
                           const std::string& result_class, const std::string& role,
                           const std::string& result_role, const char** props,
                           std::vector<Value>& out, std::string& msg)
{
    CMPIrc rc = check_ns(path.name_space, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    if (is_interop(path.name_space) && !known_ns(path.name_space))
        return CMPI_RC_OK;
    if (!knows_class(path.class_name))
    {
        msg = "unknown class " + path.class_name;
        return CMPI_RC_ERR_INVALID_CLASS;
    }
    // For references the result class names the association.
    const std::string& want =
        (op == A_REFERENCES || op == A_REFERENCE_NAMES) ? result_class : assoc_class;
    if (!want.empty() && !knows_class(want))
    {
        msg = "unknown class " + want;
        return CMPI_RC_ERR_INVALID_CLASS;
    }
    std::vector<const Registration_Entry*> rs;
    for (const Registration_Entry& e : regs)
    {
        if (!(e.kinds & MI_ASSOCIATION) || !serves_ns(e, path.name_space))
            continue;
        if (!want.empty())
        {
            if (cat.is_a(e.class_name, want))
                rs.push_back(&e);
            continue;
        }
        const Class_Info* ci = cat.find(e.class_name);
        bool refers = !ci || !ci->declared;
        for (size_t i = 0; ci && !refers && i < ci->features.size(); i++)
        {
            const Feature_Info& f = ci->features[i];
            refers = f.reference && !(f.type & CMPI_ARRAY) &&
                     (f.ref_class.empty() || cat.is_a(path.class_name, f.ref_class) ||
                      cat.is_a(f.ref_class, path.class_name));
        }
        if (refers)
            rs.push_back(&e);
    }
    CMPIrc first_error = CMPI_RC_OK;
    for (const Registration_Entry* e : rs)
    {
        CMPIAssociationMI* mi = static_cast<CMPIAssociationMI*>(
            mi_for(e->provider, MI_ASSOCIATION, path.name_space, rc, msg));
        if (!mi)
        {
            if (first_error == CMPI_RC_OK)
                first_error = rc;
            continue;
        }
        Collector c;
        Op_Scope request;
        CMPIContext* ctx = context(path.name_space);
        CMPIResult* res = new_result(&c);
        CMPIObjectPath* cp = new_path(path);
        CMPIStatus st;
        switch (op)
        {
        case A_ASSOCIATORS:
            st = MI_CALL(mi, associators, ctx, res, cp, c_or_null(assoc_class),
                                     c_or_null(result_class), c_or_null(role),
                                     c_or_null(result_role), props);
            break;
        case A_ASSOCIATOR_NAMES:
            st = MI_CALL(mi, associatorNames, ctx, res, cp, c_or_null(assoc_class),
                                         c_or_null(result_class), c_or_null(role),
                                         c_or_null(result_role));
            break;
        case A_REFERENCES:
            st = MI_CALL(mi, references, ctx, res, cp, c_or_null(result_class), c_or_null(role),
                                    props);
            break;
        default:
            st = MI_CALL(mi, referenceNames, ctx, res, cp, c_or_null(result_class),
                                        c_or_null(role));
            break;
        }
        fill_from(out, c);
        if (st.rc != CMPI_RC_OK && !(rs.size() > 1 && st.rc == CMPI_RC_ERR_NOT_SUPPORTED) &&
            first_error == CMPI_RC_OK)
        {
            first_error = st.rc;
            msg = status_text(st);
        }
    }
    return first_error;
}

CMPIrc Host_Impl::do_invoke(Object_Path path, const std::string& method,
                            const std::vector<Property>& in, Value& ret,
                            std::vector<Property>& outs, std::string& msg)
{
    CMPIrc rc = check_ns(path.name_space, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    std::vector<const Registration_Entry*> rs =
        find_regs(path.name_space, path.class_name, MI_METHOD, false, rc, msg);
    if (rc != CMPI_RC_OK)
        return rc;
    if (rs.empty())
    {
        msg = "no method provider for " + path.class_name;
        return CMPI_RC_ERR_NOT_SUPPORTED;
    }
    CMPIMethodMI* mi =
        static_cast<CMPIMethodMI*>(mi_for(rs[0]->provider, MI_METHOD, path.name_space, rc, msg));
    if (!mi)
        return rc;
    Collector c;
    Op_Scope request;
    CMPIArgs* out_args = new_args({});
    CMPIStatus st = MI_CALL(mi, invokeMethod, context(path.name_space), new_result(&c),
                            new_path(path), method.c_str(), new_args(in), out_args);
    msg = status_text(st);
    if (st.rc != CMPI_RC_OK)
        return st.rc;
    if (!c.items.empty())
        ret = c.items[0];
    // The server reads the output arguments once the provider has returned.
    if (Args_Obj* oa = obj_cast<Args_Obj>(out_args, K_ARGS, "invokeMethod's out arguments"))
        outs = read_args(oa, "invokeMethod's out arguments");
    return CMPI_RC_OK;
}

Result Host_Impl::subscribe(const std::string& ns_in, const std::string& cls, int& id,
                            const std::string& query)
{
    Result r;
    id = 0;
    std::string ns = ns_in;
    r.rc = check_ns(ns, r.message);
    if (r.rc != CMPI_RC_OK)
        return r;
    std::vector<const Registration_Entry*> rs;
    for (const Registration_Entry& e : regs)
        if ((e.kinds & MI_INDICATION) && serves_ns(e, ns) &&
            (cat.is_a(e.class_name, cls) || cat.is_a(cls, e.class_name)))
            rs.push_back(&e);
    if (rs.empty())
    {
        r.rc = knows_class(cls) ? CMPI_RC_ERR_NOT_SUPPORTED : CMPI_RC_ERR_INVALID_CLASS;
        r.message = "no indication provider for " + cls + " in " + ns;
        return r;
    }
    Subscription s;
    s.name_space = ns;
    s.class_name = cls;
    std::string q = query.empty() ? "SELECT * FROM " + cls : query;
    s.filter = new_select(q, "WQL", cls, host_arena());
    Object_Path p;
    p.name_space = ns;
    p.class_name = cls;
    s.path = new_path(p, host_arena());
    for (const Registration_Entry* e : rs)
    {
        CMPIrc rc = CMPI_RC_OK;
        CMPIIndicationMI* mi =
            static_cast<CMPIIndicationMI*>(mi_for(e->provider, MI_INDICATION, ns, rc, r.message));
        if (!mi)
        {
            r.rc = rc;
            continue;
        }
        Provider_State& ps = state(e->provider);
        CMPIStatus st = MI_CALL(mi, authorizeFilter, context(ns), s.filter, cls.c_str(), s.path,
                                                opts.principal.c_str());
        if (st.rc != CMPI_RC_OK)
        {
            r.rc = st.rc;
            r.message = with_text("authorizeFilter", st);
            continue;
        }
        // The answer is not used: this host never polls.
        if (mi->ft->mustPoll)
            mi->ft->mustPoll(mi, context(ns), s.filter, cls.c_str(), s.path);
        st = MI_CALL(mi, activateFilter, context(ns), s.filter, cls.c_str(), s.path,
                                    ps.filters == 0);
        if (st.rc != CMPI_RC_OK)
        {
            r.rc = st.rc;
            r.message = with_text("activateFilter", st);
            continue;
        }
        ps.filters++;
        s.providers.push_back(e->provider);
        if (!ps.enabled && mi->ft->enableIndications)
        {
            st = mi->ft->enableIndications(mi, context(ns));
            ps.enabled = true;
            if (st.rc != CMPI_RC_OK)
            {
                r.rc = st.rc;
                r.message = with_text("enableIndications", st);
            }
        }
    }
    id = next_sub++;
    subs[id] = s;
    return r;
}

Result Host_Impl::unsubscribe(int id)
{
    Result r;
    auto it = subs.find(id);
    if (it == subs.end())
    {
        r.rc = CMPI_RC_ERR_NOT_FOUND;
        r.message = "no subscription " + std::to_string(id);
        return r;
    }
    Subscription s = it->second;
    subs.erase(it);
    for (const std::string& prov : s.providers)
    {
        Provider_State& ps = state(prov);
        CMPIIndicationMI* mi = static_cast<CMPIIndicationMI*>(ps.indication_mi);
        if (!mi)
            continue;
        CMPIStatus st = MI_CALL(mi, deActivateFilter, context(s.name_space), s.filter,
                                                 s.class_name.c_str(), s.path, ps.filters == 1);
        if (st.rc != CMPI_RC_OK && r.rc == CMPI_RC_OK)
        {
            r.rc = st.rc;
            r.message = with_text("deActivateFilter", st);
        }
        if (ps.filters > 0)
            ps.filters--;
        if (ps.filters == 0 && ps.enabled)
        {
            ps.enabled = false;
            if (mi->ft->disableIndications)
            {
                st = mi->ft->disableIndications(mi, context(s.name_space));
                if (st.rc != CMPI_RC_OK && r.rc == CMPI_RC_OK)
                {
                    r.rc = st.rc;
                    r.message = with_text("disableIndications", st);
                }
            }
        }
    }
    release_obj(s.filter);
    release_obj(s.path);
    return r;
}

int Host_Impl::cleanup(bool terminating)
{
    // Indication MIs first, since their threads may still call the others;
    // no lock is held across a cleanup, which may wait for such threads.
    static const unsigned order[] = {MI_INDICATION, MI_ASSOCIATION, MI_METHOD, MI_INSTANCE};
    std::vector<std::pair<Provider_State*, unsigned>> todo;
    {
        std::lock_guard<std::recursive_mutex> g(mi_mutex);
        for (unsigned kind : order)
            for (auto& entry : providers)
                if (slot_of(entry.second, kind))
                    todo.push_back({&entry.second, kind});
    }
    int refused = 0;
    for (auto& t : todo)
    {
        void* mi;
        {
            std::lock_guard<std::recursive_mutex> g(mi_mutex);
            mi = slot_of(*t.first, t.second);
        }
        if (!mi)
            continue;
        Op_Scope scope;
        CMPIContext* ctx = context(default_ns);
        CMPIStatus st;
        switch (t.second)
        {
        case MI_INDICATION:
            st = MI_CALL(static_cast<CMPIIndicationMI*>(mi), cleanup, ctx, terminating);
            break;
        case MI_ASSOCIATION:
            st = MI_CALL(static_cast<CMPIAssociationMI*>(mi), cleanup, ctx, terminating);
            break;
        case MI_METHOD:
            st = MI_CALL(static_cast<CMPIMethodMI*>(mi), cleanup, ctx, terminating);
            break;
        default:
            st = MI_CALL(static_cast<CMPIInstanceMI*>(mi), cleanup, ctx, terminating);
            break;
        }
        if (!terminating && (st.rc == CMPI_RC_DO_NOT_UNLOAD || st.rc == CMPI_RC_NEVER_UNLOAD))
        {
            refused++;
            continue;
        }
        std::lock_guard<std::recursive_mutex> g(mi_mutex);
        slot_of(*t.first, t.second) = nullptr;
        // An unloaded provider's filters went with it: a later subscription
        // activates and enables a new one afresh.
        if (t.second == MI_INDICATION)
        {
            t.first->filters = 0;
            t.first->enabled = false;
        }
    }
    return refused;
}

//
// Host
//

// Class knowledge for the object functions comes from the latest host; the
// host arena is shared, so only the last host to go frees it.
namespace
{
int live_hosts = 0;
std::vector<Host_Impl*> hosts;
} // namespace

Host::Host(const Options& options) : impl(new Host_Impl(options))
{
    live_hosts++;
    hosts.push_back(impl);
    the_host = impl;
}

Host::~Host()
{
    delete impl;
    for (size_t i = 0; i < hosts.size(); i++)
        if (hosts[i] == impl)
            hosts.erase(hosts.begin() + long(i));
    the_host = hosts.empty() ? nullptr : hosts.back();
    if (--live_hosts == 0)
        free_arena(host_arena());
}

bool Host::ok() const
{
    return impl->ok;
}

const std::string& Host::error() const
{
    return impl->err;
}

void Host::set_interop(bool on, bool empty)
{
    impl->opts.interop = on;
    impl->opts.interop_empty = empty;
}

void Host::set_interop_namespace(const std::string& name_space)
{
    impl->opts.interop_namespace = name_space;
}

void Host::set_pegasus_enumerations(bool on)
{
    impl->opts.pegasus_enumerations = on;
}

static Result not_loaded(const Host_Impl* h)
{
    Result r;
    r.rc = CMPI_RC_ERR_FAILED;
    r.message = h->err.empty() ? "host not loaded" : h->err;
    return r;
}

// Hands what the providers returned to the caller: an instance or path that
// nothing else shares moves, without a copy.
template<class T>
static void take(std::shared_ptr<T>& from, std::vector<T>& to)
{
    if (from.use_count() == 1)
        to.push_back(std::move(*from));
    else
        to.push_back(*from);
}

static void split(std::vector<Value>& items, Result& r)
{
    r.instances.reserve(items.size());
    for (Value& v : items)
    {
        if (v.type == CMPI_instance && v.inst)
            take(v.inst, r.instances);
        else if (v.type == CMPI_ref && v.ref)
            take(v.ref, r.paths);
    }
}

Result Host::ei(const Object_Path& cls, const std::vector<std::string>* props)
{
    if (!impl->ok)
        return not_loaded(impl);
    Result r;
    std::vector<Value> items;
    {
        Op_Scope scope;
        Prop_List pl;
        r.rc = impl->do_enum(cls, pl.get(props), false, items, r.message);
    }
    split(items, r);
    return r;
}

Result Host::ein(const Object_Path& cls)
{
    if (!impl->ok)
        return not_loaded(impl);
    Result r;
    std::vector<Value> items;
    {
        Op_Scope scope;
        r.rc = impl->do_enum(cls, nullptr, true, items, r.message);
    }
    split(items, r);
    return r;
}

Result Host::gi(const Object_Path& path, const std::vector<std::string>* props)
{
    if (!impl->ok)
        return not_loaded(impl);
    Result r;
    Value v;
    {
        Op_Scope scope;
        Prop_List pl;
        r.rc = impl->do_get(path, pl.get(props), v, r.message);
    }
    if (r.rc == CMPI_RC_OK && v.inst)
        take(v.inst, r.instances);
    return r;
}

static Result assoc(Host_Impl* impl, Assoc_Op op, const Object_Path& path,
                    const std::string& assoc_class, const std::string& result_class,
                    const std::string& role, const std::string& result_role,
                    const std::vector<std::string>* props)
{
    if (!impl->ok)
        return not_loaded(impl);
    Result r;
    std::vector<Value> items;
    {
        Op_Scope scope;
        Prop_List pl;
        r.rc = impl->do_assoc(op, path, assoc_class, result_class, role, result_role,
                              pl.get(props), items, r.message);
    }
    split(items, r);
    return r;
}

Result Host::ai(const Object_Path& path, const std::string& assoc_class,
                const std::string& result_class, const std::string& role,
                const std::string& result_role, const std::vector<std::string>* props)
{
    return assoc(impl, A_ASSOCIATORS, path, assoc_class, result_class, role, result_role, props);
}

Result Host::an(const Object_Path& path, const std::string& assoc_class,
                const std::string& result_class, const std::string& role,
                const std::string& result_role)
{
    return assoc(impl, A_ASSOCIATOR_NAMES, path, assoc_class, result_class, role, result_role,
                 nullptr);
}

Result Host::ri(const Object_Path& path, const std::string& result_class, const std::string& role,
                const std::vector<std::string>* props)
{
    return assoc(impl, A_REFERENCES, path, "", result_class, role, "", props);
}

Result Host::rn(const Object_Path& path, const std::string& result_class, const std::string& role)
{
    return assoc(impl, A_REFERENCE_NAMES, path, "", result_class, role, "", nullptr);
}

Result Host::cm(const Object_Path& path, const std::string& method, const std::vector<Property>& in)
{
    if (!impl->ok)
        return not_loaded(impl);
    Result r;
    {
        Op_Scope scope;
        r.rc = impl->do_invoke(path, method, in, r.return_value, r.out, r.message);
    }
    return r;
}

Result Host::ci(const Object_Path& path, const Instance& inst)
{
    if (!impl->ok)
        return not_loaded(impl);
    Result r;
    Instance i = inst;
    if (i.class_name.empty())
        i.class_name = path.class_name;
    if (i.path.class_name.empty())
        i.path = path;
    Object_Path made;
    {
        Op_Scope scope;
        r.rc = impl->do_create(path, i, made, r.message);
    }
    if (r.rc == CMPI_RC_OK)
        r.paths.push_back(made);
    return r;
}

Result Host::mi(const Object_Path& path, const Instance& inst,
                const std::vector<std::string>* props)
{
    if (!impl->ok)
        return not_loaded(impl);
    Result r;
    Instance i = inst;
    if (i.class_name.empty())
        i.class_name = path.class_name;
    if (i.path.class_name.empty())
        i.path = path;
    Op_Scope scope;
    Prop_List pl;
    r.rc = impl->do_modify(path, i, pl.get(props), r.message);
    return r;
}

Result Host::di(const Object_Path& path)
{
    if (!impl->ok)
        return not_loaded(impl);
    Result r;
    Op_Scope scope;
    r.rc = impl->do_delete(path, r.message);
    return r;
}

Result Host::eq(const Object_Path& cls, const std::string& query, const std::string& lang)
{
    if (!impl->ok)
        return not_loaded(impl);
    Result r;
    std::vector<Value> items;
    {
        Op_Scope scope;
        r.rc = impl->do_query(cls, query, lang, items, r.message);
    }
    split(items, r);
    return r;
}

Result Host::subscribe(const std::string& name_space, const std::string& class_name, int& id,
                       const std::string& query)
{
    if (!impl->ok)
        return not_loaded(impl);
    Op_Scope scope;
    return impl->subscribe(name_space, class_name, id, query);
}

Result Host::unsubscribe(int id)
{
    if (!impl->ok)
        return not_loaded(impl);
    Op_Scope scope;
    return impl->unsubscribe(id);
}

size_t Host::active_filters() const
{
    return impl->subs.size();
}

std::vector<Indication_Record> Host::indications() const
{
    std::lock_guard<std::mutex> g(impl->ind_mutex);
    return impl->inds;
}

void Host::clear_indications()
{
    std::lock_guard<std::mutex> g(impl->ind_mutex);
    impl->inds.clear();
}

size_t Host::wait_indications(size_t count, int timeout_ms) const
{
    std::unique_lock<std::mutex> g(impl->ind_mutex);
    impl->ind_cv.wait_for(g, std::chrono::milliseconds(timeout_ms),
                          [&] { return impl->inds.size() >= count; });
    return impl->inds.size();
}

int Host::cleanup(bool terminating)
{
    return impl->cleanup(terminating);
}

CMPIType Host::property_type(const std::string& class_name, const std::string& property) const
{
    const Class_Info* ci = impl->cat.find(class_name);
    const Feature_Info* f = ci ? ci->feature(property) : nullptr;
    return f ? f->type : CMPIType(0);
}

CMPIType Host::parameter_type(const std::string& class_name, const std::string& method,
                              const std::string& parameter) const
{
    const Class_Info* ci = impl->cat.find(class_name);
    const Method_Info* m = ci ? ci->method(method) : nullptr;
    if (!m)
        return 0;
    for (const Feature_Info& p : m->params)
        if (name_eq(p.name, parameter))
            return p.type;
    return 0;
}

bool Host::knows_class(const std::string& class_name) const
{
    return impl->knows_class(class_name);
}

bool Host::class_is_a(const std::string& class_name, const std::string& ancestor) const
{
    return impl->cat.is_a(class_name, ancestor);
}

std::vector<std::string> Host::refused_properties() const
{
    return impl->cat.refused_properties();
}

void Host::clear_refused_properties()
{
    impl->cat.clear_refused_properties();
}

void Host::type_keys(Object_Path& path) const
{
    if (path.name_space.empty())
        path.name_space = impl->default_ns;
    const Class_Info* ci = impl->cat.find(path.class_name);
    if (!ci)
        return;
    for (Property& k : path.keys)
    {
        const Feature_Info* f = ci->feature(k.name);
        if (!f || k.value.null)
            continue;
        if (f->type == CMPI_ref && k.value.type == CMPI_string)
        {
            Object_Path p;
            std::string err;
            if (parse_path(k.value.str, p, err, path.name_space))
            {
                type_keys(p);
                k.value = Value::of_ref(p);
            }
        }
        else if (f->type == CMPI_string && k.value.type != CMPI_string)
        {
            std::string text = k.value.type == CMPI_ref ? k.value.ref->to_string() : k.value.text();
            k.value = Value::of_string(text);
        }
        else if (f->type == CMPI_ref && k.value.type == CMPI_ref && k.value.ref)
        {
            if (k.value.ref->name_space.empty())
                k.value.ref->name_space = path.name_space;
            type_keys(*k.value.ref);
        }
    }
}

bool Host::parse_object_path(const std::string& text, Object_Path& path, std::string& err) const
{
    if (!parse_path(text, path, err, impl->default_ns))
        return false;
    if (!knows_class(path.class_name))
    {
        err = "unknown class " + path.class_name;
        return false;
    }
    type_keys(path);
    return true;
}

bool Host::parse_argument(const Object_Path& path, const std::string& method,
                          const std::string& text, Property& arg, std::string& err) const
{
    size_t eq = text.find('=');
    if (eq == std::string::npos || eq == 0)
    {
        err = "argument '" + text + "' is not NAME=VALUE";
        return false;
    }
    arg = Property();
    arg.name = text.substr(0, eq);
    std::string value = text.substr(eq + 1);
    size_t colon = value.find(':');
    std::string prefix = colon == std::string::npos ? "" : value.substr(0, colon);
    if (prefix.size() > 2 && prefix.compare(prefix.size() - 2, 2, "[]") == 0)
        prefix.resize(prefix.size() - 2);
    // A namespace before a path ("root/x:...") is no type, so the tables decide.
    if (!prefix.empty() && (type_of_name(prefix) || name_eq(prefix, "null")))
    {
        if (!parse_typed_value(value, arg.value, err))
        {
            err = "argument " + arg.name + ": " + err;
            return false;
        }
    }
    else
    {
        CMPIType t = parameter_type(path.class_name, method, arg.name);
        if (!t)
        {
            err = "argument " + arg.name + ": untyped value; write " + arg.name + "=TYPE:VALUE";
            return false;
        }
        if ((t & ~CMPI_ARRAY) == CMPI_instance)
        {
            err = "argument " + arg.name + ": embedded instances can't be given as text";
            return false;
        }
        if (!parse_value_as(t, value, arg.value, err))
        {
            err = "argument " + arg.name + ": " + err;
            return false;
        }
    }
    if (arg.value.type == CMPI_ref && arg.value.ref)
    {
        if (!knows_class(arg.value.ref->class_name))
        {
            err = "argument " + arg.name + ": unknown class " + arg.value.ref->class_name;
            return false;
        }
        type_keys(*arg.value.ref);
    }
    return true;
}

const CMPIBroker* Host::broker() const
{
    return &impl->broker;
}

size_t Host::live_objects() const
{
    return live_object_count();
}

} // namespace cimhost
} // namespace OLMA
