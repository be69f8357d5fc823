// The encapsulated CMPI objects and their function tables.

#include <cstring>

#include "objects.h"

namespace OLMA
{
namespace cimhost
{

namespace
{

std::mutex arena_mutex;
Arena the_host_arena;
size_t live_objects = 0;
thread_local std::vector<Arena*> arenas;

// Released objects are kept poisoned until their scope ends; a scope that
// never ends (a long-lived provider thread) forgets the oldest beyond this.
const size_t MAX_HUSKS = 100000;

void link(Obj* o, Arena* a)
{
    std::lock_guard<std::mutex> g(arena_mutex);
    o->arena = a;
    o->prev = nullptr;
    o->next = a->head;
    if (a->head)
        a->head->prev = o;
    a->head = o;
    a->count++;
    live_objects++;
}

void unlink(Obj* o)
{
    Arena* a = o->arena;
    if (o->prev)
        o->prev->next = o->next;
    else
        a->head = o->next;
    if (o->next)
        o->next->prev = o->prev;
    a->count--;
    live_objects--;
}

void unlink_husk(Obj* o)
{
    Arena* a = o->arena;
    if (o->prev)
        o->prev->next = o->next;
    else
        a->husks = o->next;
    if (o->next)
        o->next->prev = o->prev;
    else
        a->oldest_husk = o->prev;
    a->husk_count--;
}

// Moves a live object to the husks of its arena; gives back the oldest husk
// if there are too many, for the caller to free.
Obj* bury(Obj* o)
{
    std::lock_guard<std::mutex> g(arena_mutex);
    Arena* a = o->arena;
    unlink(o);
    o->prev = nullptr;
    o->next = a->husks;
    if (a->husks)
        a->husks->prev = o;
    else
        a->oldest_husk = o;
    a->husks = o;
    a->husk_count++;
    if (a->husk_count <= MAX_HUSKS)
        return nullptr;
    Obj* old = a->oldest_husk;
    unlink_husk(old);
    return old;
}

void delete_obj(Obj* o)
{
    o->magic = 0;
    switch (o->kind)
    {
    case K_CONTEXT: delete static_cast<Ctx_Obj*>(o); break;
    case K_RESULT: delete static_cast<Result_Obj*>(o); break;
    case K_INSTANCE: delete static_cast<Inst_Obj*>(o); break;
    case K_PATH: delete static_cast<Path_Obj*>(o); break;
    case K_ARGS: delete static_cast<Args_Obj*>(o); break;
    case K_STRING: delete static_cast<String_Obj*>(o); break;
    case K_ARRAY: delete static_cast<Array_Obj*>(o); break;
    case K_ENUM: delete static_cast<Enum_Obj*>(o); break;
    case K_DATETIME: delete static_cast<DT_Obj*>(o); break;
    case K_SELECTEXP: delete static_cast<Select_Obj*>(o); break;
    }
}

template <class T>
T* make(Kind k, void* ft, Arena* arena = nullptr)
{
    T* o = new T;
    o->hdl = o;
    o->ft = ft;
    o->magic = OBJ_LIVE;
    o->kind = k;
    link(o, arena ? arena : current_arena());
    return o;
}

template <class T>
T* as(const void* p, Kind k)
{
    return obj_cast<T>(p, k);
}

std::string quoted(const std::string& s)
{
    return "\"" + (s.size() > 60 ? s.substr(0, 57) + "..." : s) + "\"";
}

std::string step(const std::string& where, const std::string& s)
{
    return where.empty() ? s : where + " > " + s;
}

// What an object is, without reading what it points to.
std::string describe(const Obj* o)
{
    std::string d = kind_name(o->kind);
    switch (o->kind)
    {
    case K_STRING:
    {
        const String_Obj* s = static_cast<const String_Obj*>(o);
        return d + " " + (s->is_null ? std::string("NULL") : quoted(s->s));
    }
    case K_DATETIME: return d + " " + static_cast<const DT_Obj*>(o)->text;
    case K_ARRAY:
    {
        const Array_Obj* a = static_cast<const Array_Obj*>(o);
        return d + " " + type_name(a->el) + "[" + std::to_string(a->items.size()) + "]";
    }
    case K_INSTANCE:
    {
        const Inst_Obj* i = static_cast<const Inst_Obj*>(o);
        return d + " of " + i->name_space + ":" + i->class_name;
    }
    case K_PATH:
    {
        const Path_Obj* p = static_cast<const Path_Obj*>(o);
        d += " " + p->name_space + ":" + p->class_name;
        for (size_t i = 0; i < p->keys.size(); i++)
            d += (i ? "," : ".") + p->keys[i].name + "=" +
                 (p->keys[i].held.obj ? std::string("...") : key_value_text(p->keys[i].held.value));
        return d;
    }
    case K_ARGS:
    {
        const Args_Obj* a = static_cast<const Args_Obj*>(o);
        d += " (";
        for (size_t i = 0; i < a->args.size(); i++)
            d += (i ? ", " : "") + a->args[i].name;
        return d + ")";
    }
    case K_SELECTEXP: return d + " " + quoted(static_cast<const Select_Obj*>(o)->query);
    default: return d;
    }
}

// A husk keeps its head and its description only.
void clear_payload(Obj* o)
{
    switch (o->kind)
    {
    case K_CONTEXT: static_cast<Ctx_Obj*>(o)->entries.clear(); break;
    case K_INSTANCE: static_cast<Inst_Obj*>(o)->props.clear(); break;
    case K_PATH: static_cast<Path_Obj*>(o)->keys.clear(); break;
    case K_ARGS: static_cast<Args_Obj*>(o)->args.clear(); break;
    case K_STRING: static_cast<String_Obj*>(o)->s.clear(); break;
    case K_ARRAY: static_cast<Array_Obj*>(o)->items.clear(); break;
    case K_ENUM: static_cast<Enum_Obj*>(o)->items.clear(); break;
    default: break;
    }
}

CMPIStatus release_any(const void* p)
{
    return status(release_obj(p) ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
}

CMPIData bad_data(CMPIValueState state)
{
    CMPIData d;
    memset(&d, 0, sizeof(d));
    d.type = CMPI_null;
    d.state = state;
    return d;
}

const Property* find_prop(const std::vector<Property>& v, const char* name)
{
    if (!name)
        return nullptr;
    for (const Property& p : v)
        if (name_eq(p.name, name))
            return &p;
    return nullptr;
}

const Held_Property* find_held(const std::vector<Held_Property>& v, const char* name)
{
    if (!name)
        return nullptr;
    for (const Held_Property& p : v)
        if (name_eq(p.name, name))
            return &p;
    return nullptr;
}

// Replaces or appends.
void put_prop(std::vector<Property>& v, const char* name, const Value& value)
{
    for (Property& p : v)
        if (name_eq(p.name, name))
        {
            p.value = value;
            return;
        }
    v.push_back(Property {name, value});
}

void put_held(std::vector<Held_Property>& v, const std::string& name, const Held& held)
{
    for (Held_Property& p : v)
        if (name_eq(p.name, name))
        {
            p.held = held;
            return;
        }
    v.push_back(Held_Property {name, held});
}

Held copy_of(const Value& v)
{
    Held h;
    h.value = v;
    return h;
}

CMPIData get_named(const std::vector<Property>& v, const char* name, CMPIStatus* rc,
                   CMPIrc missing)
{
    const Property* p = find_prop(v, name);
    if (!p)
    {
        set_rc(rc, name ? missing : CMPI_RC_ERR_INVALID_PARAMETER);
        return bad_data(CMPI_notFound);
    }
    set_rc(rc, CMPI_RC_OK);
    return to_cmpi(p->value);
}

CMPIData get_at(const std::vector<Property>& v, CMPICount i, CMPIString** name, CMPIStatus* rc,
                CMPIrc missing)
{
    if (i >= v.size())
    {
        set_rc(rc, missing);
        if (name)
            *name = nullptr;
        return bad_data(CMPI_notFound);
    }
    if (name)
        *name = new_string(v[i].name.c_str());
    set_rc(rc, CMPI_RC_OK);
    return to_cmpi(v[i].value);
}

CMPIData get_held_named(const std::vector<Held_Property>& v, const char* name, CMPIStatus* rc,
                        const std::string& where)
{
    const Held_Property* p = find_held(v, name);
    if (!p)
    {
        set_rc(rc, name ? CMPI_RC_ERR_NO_SUCH_PROPERTY : CMPI_RC_ERR_INVALID_PARAMETER);
        return bad_data(CMPI_notFound);
    }
    set_rc(rc, CMPI_RC_OK);
    return to_cmpi(resolve(p->held, step(where, p->name)));
}

CMPIData get_held_at(const std::vector<Held_Property>& v, CMPICount i, CMPIString** name,
                     CMPIStatus* rc, const std::string& where)
{
    if (i >= v.size())
    {
        set_rc(rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
        if (name)
            *name = nullptr;
        return bad_data(CMPI_notFound);
    }
    if (name)
        *name = new_string(v[i].name.c_str());
    set_rc(rc, CMPI_RC_OK);
    return to_cmpi(resolve(v[i].held, step(where, v[i].name)));
}

CMPIType norm(CMPIType t)
{
    return t == CMPI_chars ? CMPIType(CMPI_string) : t;
}

//
// Context: its entries are copies.
//

CMPIStatus ctx_release(CMPIContext* c) { return release_any(c); }

CMPIContext* ctx_clone(const CMPIContext* c, CMPIStatus* rc)
{
    Ctx_Obj* o = as<Ctx_Obj>(c, K_CONTEXT);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_context(o->entries) : nullptr;
}

CMPIData ctx_get_entry(const CMPIContext* c, const char* name, CMPIStatus* rc)
{
    Ctx_Obj* o = as<Ctx_Obj>(c, K_CONTEXT);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    return get_named(o->entries, name, rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

CMPIData ctx_get_entry_at(const CMPIContext* c, CMPICount i, CMPIString** name, CMPIStatus* rc)
{
    Ctx_Obj* o = as<Ctx_Obj>(c, K_CONTEXT);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    return get_at(o->entries, i, name, rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

CMPICount ctx_count(const CMPIContext* c, CMPIStatus* rc)
{
    Ctx_Obj* o = as<Ctx_Obj>(c, K_CONTEXT);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? CMPICount(o->entries.size()) : 0;
}

CMPIStatus ctx_add(const CMPIContext* c, const char* name, const CMPIValue* v, CMPIType t)
{
    Ctx_Obj* o = as<Ctx_Obj>(c, K_CONTEXT);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (!name)
        return status(CMPI_RC_ERR_INVALID_PARAMETER);
    Value val;
    CMPIrc rc = from_cmpi(v, t, val, "CMAddContextEntry");
    if (rc != CMPI_RC_OK)
        return status(rc);
    put_prop(o->entries, name, val);
    return status(CMPI_RC_OK);
}

CMPIContextFT context_ft = {100, ctx_release, ctx_clone, ctx_get_entry, ctx_get_entry_at,
                            ctx_count, ctx_add};

//
// Result: what a provider returns is consumed, and so read, at the call.
//

CMPIStatus res_release(CMPIResult* r) { return release_any(r); }

CMPIResult* res_clone(const CMPIResult*, CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_ERR_NOT_SUPPORTED);
    return nullptr;
}

CMPIStatus res_add(const CMPIResult* r, Value v)
{
    Result_Obj* o = as<Result_Obj>(r, K_RESULT);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (o->sink)
        o->sink->items.push_back(std::move(v));
    return status(CMPI_RC_OK);
}

CMPIStatus res_data(const CMPIResult* r, const CMPIValue* v, CMPIType t)
{
    Value val;
    CMPIrc rc = from_cmpi(v, t, val, "CMReturnData");
    if (rc != CMPI_RC_OK)
        return status(rc);
    return res_add(r, std::move(val));
}

CMPIStatus res_instance(const CMPIResult* r, const CMPIInstance* i)
{
    Inst_Obj* o = obj_cast<Inst_Obj>(i, K_INSTANCE, "CMReturnInstance");
    if (!o)
        return status(i ? CMPI_RC_ERR_INVALID_HANDLE : CMPI_RC_ERR_INVALID_PARAMETER);
    return res_add(r, Value::of_instance(read_instance(o, "CMReturnInstance")));
}

CMPIStatus res_path(const CMPIResult* r, const CMPIObjectPath* p)
{
    Path_Obj* o = obj_cast<Path_Obj>(p, K_PATH, "CMReturnObjectPath");
    if (!o)
        return status(p ? CMPI_RC_ERR_INVALID_HANDLE : CMPI_RC_ERR_INVALID_PARAMETER);
    return res_add(r, Value::of_ref(read_path(o, "CMReturnObjectPath")));
}

CMPIStatus res_done(const CMPIResult* r)
{
    Result_Obj* o = as<Result_Obj>(r, K_RESULT);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (o->sink)
        o->sink->done = true;
    return status(CMPI_RC_OK);
}

CMPIResultFT result_ft = {100, res_release, res_clone, res_data, res_instance, res_path, res_done};

//
// Instance
//

CMPIStatus inst_release(CMPIInstance* i) { return release_any(i); }

std::string where_in(const Inst_Obj* o, const char* call)
{
    return std::string(call) + " > CMPIInstance of " + o->class_name;
}

CMPIInstance* inst_clone(const CMPIInstance* i, CMPIStatus* rc)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    if (!o)
        return nullptr;
    // A clone is a copy of what the instance holds now.
    Inst_Obj* n = make<Inst_Obj>(K_INSTANCE, o->ft);
    n->class_name = o->class_name;
    n->host = o->host;
    n->name_space = o->name_space;
    n->key_names = o->key_names;
    n->filtered = o->filtered;
    n->filter = o->filter;
    std::string where = where_in(o, "CMClone");
    for (const Held_Property& p : o->props)
        n->props.push_back(Held_Property {p.name, copy_of(resolve(p.held, step(where, p.name)))});
    return reinterpret_cast<CMPIInstance*>(n);
}

CMPIData inst_get(const CMPIInstance* i, const char* name, CMPIStatus* rc)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    return get_held_named(o->props, name, rc, where_in(o, "CMGetProperty"));
}

CMPIData inst_get_at(const CMPIInstance* i, CMPICount n, CMPIString** name, CMPIStatus* rc)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    return get_held_at(o->props, n, name, rc, where_in(o, "CMGetPropertyAt"));
}

CMPICount inst_count(const CMPIInstance* i, CMPIStatus* rc)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? CMPICount(o->props.size()) : 0;
}

// With a filter, only the properties it names stay: those of the list and
// those of the key list the provider gave. The class's keys get no favour,
// as a server that builds the path from the key properties left on the
// instance gives none.
bool passes_filter(const Inst_Obj* o, const std::string& name)
{
    if (!o->filtered)
        return true;
    for (const std::string& f : o->filter)
        if (name_eq(f, name))
            return true;
    return false;
}

CMPIStatus inst_set(const CMPIInstance* i, const char* name, const CMPIValue* v, CMPIType t)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (!name || !*name)
        return status(CMPI_RC_ERR_INVALID_PARAMETER);
    Held val;
    CMPIrc rc = hold(v, t, val, std::string("CMSetProperty of ") + name);
    if (rc != CMPI_RC_OK)
        return status(rc);
    // A server takes only what the class in its repository declares, and
    // with the declared type, property list or not.
    const Catalogue* cat = host_catalogue();
    rc = cat ? cat->check_property(o->class_name, name, val.value.type) : CMPI_RC_OK;
    if (rc != CMPI_RC_OK)
        return status(rc);
    // A filtered-out property is dropped silently, as the client asked for
    // fewer properties, not for an error.
    if (passes_filter(o, name))
        put_held(o->props, name, val);
    return status(CMPI_RC_OK);
}

CMPIObjectPath* inst_get_path(const CMPIInstance* i, CMPIStatus* rc)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_path(read_instance(o, "CMGetObjectPath").path) : nullptr;
}

CMPIStatus inst_set_filter(CMPIInstance* i, const char** props, const char** keys)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (!props)
    {
        o->filtered = false;
        o->filter.clear();
        return status(CMPI_RC_OK);
    }
    o->filtered = true;
    o->filter.clear();
    for (size_t n = 0; props[n]; n++)
        o->filter.push_back(props[n]);
    for (size_t n = 0; keys && keys[n]; n++)
        o->filter.push_back(keys[n]);
    std::vector<Held_Property> kept;
    for (const Held_Property& p : o->props)
        if (passes_filter(o, p.name))
            kept.push_back(p);
    o->props.swap(kept);
    return status(CMPI_RC_OK);
}

// The path's namespace, class and keys; its keys become properties, as
// they do when an instance is made from a path.
void take_path(Inst_Obj* o, const Path_Obj* p)
{
    o->host = p->host;
    o->name_space = p->name_space;
    if (!p->class_name.empty())
        o->class_name = p->class_name;
    o->key_names.clear();
    for (const Held_Property& k : p->keys)
    {
        o->key_names.push_back(k.name);
        if (passes_filter(o, k.name))
            put_held(o->props, k.name, k.held);
    }
}

CMPIStatus inst_set_path(CMPIInstance* i, const CMPIObjectPath* p)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    Path_Obj* po = as<Path_Obj>(p, K_PATH);
    if (!o || (p && !po))
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (!po)
        return status(CMPI_RC_ERR_INVALID_PARAMETER);
    take_path(o, po);
    return status(CMPI_RC_OK);
}

CMPIInstanceFT instance_ft = {100,         inst_release,   inst_clone,      inst_get,
                              inst_get_at, inst_count,     inst_set,        inst_get_path,
                              inst_set_filter, inst_set_path};

//
// Object path
//

CMPIStatus path_release(CMPIObjectPath* p) { return release_any(p); }

CMPIObjectPath* path_clone(const CMPIObjectPath* p, CMPIStatus* rc)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_path(read_path(o, "CMClone")) : nullptr;
}

CMPIStatus path_set_text(CMPIObjectPath* p, const char* s, std::string Path_Obj::*field)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    o->*field = s ? s : "";
    return status(CMPI_RC_OK);
}

CMPIString* path_get_text(const CMPIObjectPath* p, CMPIStatus* rc, std::string Path_Obj::*field)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_string((o->*field).c_str()) : nullptr;
}

CMPIStatus path_set_ns(CMPIObjectPath* p, const char* s)
{
    return path_set_text(p, s, &Path_Obj::name_space);
}
CMPIString* path_get_ns(const CMPIObjectPath* p, CMPIStatus* rc)
{
    return path_get_text(p, rc, &Path_Obj::name_space);
}
CMPIStatus path_set_host(CMPIObjectPath* p, const char* s)
{
    return path_set_text(p, s, &Path_Obj::host);
}
CMPIString* path_get_host(const CMPIObjectPath* p, CMPIStatus* rc)
{
    return path_get_text(p, rc, &Path_Obj::host);
}
CMPIStatus path_set_class(CMPIObjectPath* p, const char* s)
{
    return path_set_text(p, s, &Path_Obj::class_name);
}
CMPIString* path_get_class(const CMPIObjectPath* p, CMPIStatus* rc)
{
    return path_get_text(p, rc, &Path_Obj::class_name);
}

CMPIStatus path_add_key(CMPIObjectPath* p, const char* name, const CMPIValue* v, CMPIType t)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (!name || !*name)
        return status(CMPI_RC_ERR_INVALID_PARAMETER);
    Held val;
    CMPIrc rc = hold(v, t, val, std::string("CMAddKey of ") + name);
    if (rc != CMPI_RC_OK)
        return status(rc);
    if (!val.obj)
        widen_key(val.value);
    put_held(o->keys, name, val);
    return status(CMPI_RC_OK);
}

std::string where_in(const Path_Obj* o, const char* call)
{
    return std::string(call) + " > CMPIObjectPath " + o->name_space + ":" + o->class_name;
}

CMPIData path_get_key(const CMPIObjectPath* p, const char* name, CMPIStatus* rc)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    CMPIData d = get_held_named(o->keys, name, rc, where_in(o, "CMGetKey"));
    if (!(d.state & CMPI_notFound))
        d.state |= CMPI_keyValue;
    return d;
}

CMPIData path_get_key_at(const CMPIObjectPath* p, CMPICount i, CMPIString** name, CMPIStatus* rc)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    CMPIData d = get_held_at(o->keys, i, name, rc, where_in(o, "CMGetKeyAt"));
    if (!(d.state & CMPI_notFound))
        d.state |= CMPI_keyValue;
    return d;
}

CMPICount path_key_count(const CMPIObjectPath* p, CMPIStatus* rc)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? CMPICount(o->keys.size()) : 0;
}

CMPIStatus path_ns_from(CMPIObjectPath* p, const CMPIObjectPath* src)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    Path_Obj* s = as<Path_Obj>(src, K_PATH);
    if (!o || !s)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    o->name_space = s->name_space;
    return status(CMPI_RC_OK);
}

CMPIStatus path_host_ns_from(CMPIObjectPath* p, const CMPIObjectPath* src)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    Path_Obj* s = as<Path_Obj>(src, K_PATH);
    if (!o || !s)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    o->name_space = s->name_space;
    o->host = s->host;
    return status(CMPI_RC_OK);
}

// The host keeps no qualifiers.
CMPIData path_class_q(const CMPIObjectPath*, const char*, CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_ERR_NOT_SUPPORTED);
    return bad_data(CMPI_notFound);
}
CMPIData path_prop_q(const CMPIObjectPath*, const char*, const char*, CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_ERR_NOT_SUPPORTED);
    return bad_data(CMPI_notFound);
}
CMPIData path_param_q(const CMPIObjectPath*, const char*, const char*, const char*,
                      CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_ERR_NOT_SUPPORTED);
    return bad_data(CMPI_notFound);
}

CMPIString* path_to_string(const CMPIObjectPath* p, CMPIStatus* rc)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_string(read_path(o, "CMObjectPathToString").to_string().c_str()) : nullptr;
}

CMPIObjectPathFT path_ft = {100,
                            path_release,
                            path_clone,
                            path_set_ns,
                            path_get_ns,
                            path_set_host,
                            path_get_host,
                            path_set_class,
                            path_get_class,
                            path_add_key,
                            path_get_key,
                            path_get_key_at,
                            path_key_count,
                            path_ns_from,
                            path_host_ns_from,
                            path_class_q,
                            path_prop_q,
                            path_prop_q,
                            path_param_q,
                            path_to_string};

//
// Args
//

CMPIStatus args_release(CMPIArgs* a) { return release_any(a); }

CMPIArgs* args_clone(const CMPIArgs* a, CMPIStatus* rc)
{
    Args_Obj* o = as<Args_Obj>(a, K_ARGS);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_args(read_args(o, "CMClone")) : nullptr;
}

CMPIStatus args_add(const CMPIArgs* a, const char* name, const CMPIValue* v, CMPIType t)
{
    Args_Obj* o = as<Args_Obj>(a, K_ARGS);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (!name || !*name)
        return status(CMPI_RC_ERR_INVALID_PARAMETER);
    Held val;
    CMPIrc rc = hold(v, t, val, std::string("CMAddArg of ") + name);
    if (rc != CMPI_RC_OK)
        return status(rc);
    put_held(o->args, name, val);
    return status(CMPI_RC_OK);
}

CMPIData args_get(const CMPIArgs* a, const char* name, CMPIStatus* rc)
{
    Args_Obj* o = as<Args_Obj>(a, K_ARGS);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    return get_held_named(o->args, name, rc, "CMGetArg > CMPIArgs");
}

CMPIData args_get_at(const CMPIArgs* a, CMPICount i, CMPIString** name, CMPIStatus* rc)
{
    Args_Obj* o = as<Args_Obj>(a, K_ARGS);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    return get_held_at(o->args, i, name, rc, "CMGetArgAt > CMPIArgs");
}

CMPICount args_count(const CMPIArgs* a, CMPIStatus* rc)
{
    Args_Obj* o = as<Args_Obj>(a, K_ARGS);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? CMPICount(o->args.size()) : 0;
}

CMPIArgsFT args_ft = {100, args_release, args_clone, args_add, args_get, args_get_at, args_count};

//
// String
//

CMPIStatus str_release(CMPIString* s) { return release_any(s); }

CMPIString* str_clone(const CMPIString* s, CMPIStatus* rc)
{
    String_Obj* o = as<String_Obj>(s, K_STRING);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_string(o->is_null ? nullptr : o->s.c_str()) : nullptr;
}

char* str_chars(const CMPIString* s, CMPIStatus* rc)
{
    String_Obj* o = as<String_Obj>(s, K_STRING);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    if (!o || o->is_null)
        return nullptr;
    return &o->s[0];
}

CMPIStringFT string_ft = {100, str_release, str_clone, str_chars};

//
// Array
//

CMPIStatus arr_release(CMPIArray* a) { return release_any(a); }

CMPIArray* arr_clone(const CMPIArray* a, CMPIStatus* rc)
{
    Array_Obj* o = as<Array_Obj>(a, K_ARRAY);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    if (!o)
        return nullptr;
    Value v = read_array(o, "CMClone");
    CMPIArray* c = new_array(o->el, 0);
    for (const Value& e : v.elements)
        as<Array_Obj>(c, K_ARRAY)->items.push_back(copy_of(e));
    return c;
}

CMPICount arr_size(const CMPIArray* a, CMPIStatus* rc)
{
    Array_Obj* o = as<Array_Obj>(a, K_ARRAY);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? CMPICount(o->items.size()) : 0;
}

CMPIType arr_type(const CMPIArray* a, CMPIStatus* rc)
{
    Array_Obj* o = as<Array_Obj>(a, K_ARRAY);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? o->el : CMPIType(CMPI_null);
}

CMPIData arr_get(const CMPIArray* a, CMPICount i, CMPIStatus* rc)
{
    Array_Obj* o = as<Array_Obj>(a, K_ARRAY);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    if (i >= o->items.size())
    {
        set_rc(rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
        return bad_data(CMPI_notFound);
    }
    set_rc(rc, CMPI_RC_OK);
    return to_cmpi(resolve(o->items[i], "CMGetArrayElementAt > " + describe(o) + " > element " +
                                            std::to_string(i)));
}

CMPIStatus arr_set(CMPIArray* a, CMPICount i, const CMPIValue* v, CMPIType t)
{
    Array_Obj* o = as<Array_Obj>(a, K_ARRAY);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (i >= o->items.size())
        return status(CMPI_RC_ERR_NO_SUCH_PROPERTY);
    if ((t & CMPI_ARRAY) || (norm(t) != o->el && t != CMPI_null))
        return status(CMPI_RC_ERR_TYPE_MISMATCH);
    Held val;
    if (t == CMPI_null)
        val.value = Value::null_of(o->el);
    else
    {
        CMPIrc rc = hold(v, t, val, "CMSetArrayElementAt " + std::to_string(i));
        if (rc != CMPI_RC_OK)
            return status(rc);
        val.value.type = o->el;
    }
    o->items[i] = val;
    return status(CMPI_RC_OK);
}

CMPIArrayFT array_ft = {100, arr_release, arr_clone, arr_size, arr_type, arr_get, arr_set};

//
// Enumeration
//

CMPIStatus enum_release(CMPIEnumeration* e) { return release_any(e); }

CMPIEnumeration* enum_clone(const CMPIEnumeration* e, CMPIStatus* rc)
{
    Enum_Obj* o = as<Enum_Obj>(e, K_ENUM);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    if (!o)
        return nullptr;
    CMPIEnumeration* c = new_enum(o->items);
    as<Enum_Obj>(c, K_ENUM)->pos = o->pos;
    as<Enum_Obj>(c, K_ENUM)->null_state = o->null_state;
    return c;
}

CMPIData enum_next(const CMPIEnumeration* e, CMPIStatus* rc)
{
    Enum_Obj* o = as<Enum_Obj>(e, K_ENUM);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    if (o->pos >= o->items.size())
    {
        set_rc(rc, CMPI_RC_ERR_NOT_FOUND);
        return bad_data(CMPI_notFound);
    }
    set_rc(rc, CMPI_RC_OK);
    CMPIData d = to_cmpi(o->items[o->pos++]);
    if (o->null_state && d.type == CMPI_instance && d.value.inst)
        d.state = CMPI_nullValue;
    return d;
}

CMPIBoolean enum_has_next(const CMPIEnumeration* e, CMPIStatus* rc)
{
    Enum_Obj* o = as<Enum_Obj>(e, K_ENUM);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o && o->pos < o->items.size();
}

CMPIArray* enum_to_array(const CMPIEnumeration* e, CMPIStatus* rc)
{
    Enum_Obj* o = as<Enum_Obj>(e, K_ENUM);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    if (!o)
        return nullptr;
    CMPIType el = o->items.empty() ? CMPIType(CMPI_instance) : o->items[0].type;
    CMPIArray* a = new_array(el, 0);
    for (const Value& v : o->items)
        as<Array_Obj>(a, K_ARRAY)->items.push_back(copy_of(v));
    return a;
}

CMPIEnumerationFT enum_ft = {100, enum_release, enum_clone, enum_next, enum_has_next,
                             enum_to_array};

//
// Datetime
//

CMPIStatus dt_release(CMPIDateTime* d) { return release_any(d); }

CMPIDateTime* dt_clone(const CMPIDateTime* d, CMPIStatus* rc)
{
    DT_Obj* o = as<DT_Obj>(d, K_DATETIME);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_datetime(o->text) : nullptr;
}

CMPIUint64 dt_binary(const CMPIDateTime* d, CMPIStatus* rc)
{
    DT_Obj* o = as<DT_Obj>(d, K_DATETIME);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? datetime_to_binary(o->text) : 0;
}

CMPIString* dt_string(const CMPIDateTime* d, CMPIStatus* rc)
{
    DT_Obj* o = as<DT_Obj>(d, K_DATETIME);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_string(o->text.c_str()) : nullptr;
}

CMPIBoolean dt_interval(const CMPIDateTime* d, CMPIStatus* rc)
{
    DT_Obj* o = as<DT_Obj>(d, K_DATETIME);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o && datetime_is_interval(o->text);
}

CMPIDateTimeFT datetime_ft = {100, dt_release, dt_clone, dt_binary, dt_string, dt_interval};

//
// Select expression: the host's filters select whole classes.
//

CMPIStatus se_release(CMPISelectExp* s) { return release_any(s); }

CMPISelectExp* se_clone(const CMPISelectExp* s, CMPIStatus* rc)
{
    Select_Obj* o = as<Select_Obj>(s, K_SELECTEXP);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_select(o->query, o->lang, o->class_name) : nullptr;
}

CMPIBoolean se_evaluate(const CMPISelectExp* s, const CMPIInstance* i, CMPIStatus* rc)
{
    Select_Obj* o = as<Select_Obj>(s, K_SELECTEXP);
    Inst_Obj* io = as<Inst_Obj>(i, K_INSTANCE);
    if (!o || !io)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return 0;
    }
    set_rc(rc, CMPI_RC_OK);
    const Catalogue* cat = host_catalogue();
    return cat ? cat->is_a(io->class_name, o->class_name) : name_eq(io->class_name, o->class_name);
}

CMPIString* se_string(const CMPISelectExp* s, CMPIStatus* rc)
{
    Select_Obj* o = as<Select_Obj>(s, K_SELECTEXP);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_string(o->query.c_str()) : nullptr;
}

CMPISelectCond* se_cond(const CMPISelectExp*, CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_ERR_NOT_SUPPORTED);
    return nullptr;
}

CMPIBoolean se_accessor(const CMPISelectExp*, CMPIAccessor*, void*, CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_ERR_NOT_SUPPORTED);
    return 0;
}

CMPISelectExpFT select_ft = {100, se_release, se_clone, se_evaluate, se_string, se_cond, se_cond,
                             se_accessor};

//
// Reading what containers keep.
//

// Deeper than this, a container refers to itself.
const int MAX_DEPTH = 64;

// Where a read stands: the steps that led there. Their text ("CMPIInstance
// of X > property Y > ...") is only built for a message, so that reading a
// sound object costs no strings.
struct Where
{
    enum Step { TEXT, NAMED, NUMBERED, ARRAY_OF };

    Step kind;
    const Where* up;
    const char* label;
    const std::string* text;   // TEXT: the whole step; NAMED: the name
    size_t number;             // NUMBERED: the index; ARRAY_OF: the element type

    std::string str() const
    {
        std::string here;
        switch (kind)
        {
        case TEXT: here = *text; break;
        case NAMED: here = std::string(label) + *text; break;
        case NUMBERED: here = std::string(label) + std::to_string(number); break;
        case ARRAY_OF: here = std::string(label) + type_name(CMPIType(number)); break;
        }
        return up ? step(up->str(), here) : here;
    }
};

Where at_text(const std::string& text, const Where* up = nullptr)
{
    return Where {Where::TEXT, up, nullptr, &text, 0};
}

Where at_name(const Where& up, const char* label, const std::string& name)
{
    return Where {Where::NAMED, &up, label, &name, 0};
}

Value resolve_at(const Held& h, const Where& where, int depth);

Instance read_instance_at(const Inst_Obj* o, const Where& where, int depth)
{
    Instance inst;
    inst.class_name = o->class_name;
    inst.path.host = o->host;
    inst.path.name_space = o->name_space;
    inst.path.class_name = o->class_name;
    for (const std::string& k : o->key_names)
        inst.path.keys.push_back(Property {k, Value()});
    Where here = at_name(where, "CMPIInstance of ", o->class_name);
    inst.properties.reserve(o->props.size());
    for (const Held_Property& p : o->props)
        inst.properties.push_back(
            Property {p.name, resolve_at(p.held, at_name(here, "property ", p.name), depth)});
    inst.path = instance_path(inst);
    return inst;
}

Object_Path read_path_at(const Path_Obj* o, const Where& where, int depth)
{
    Object_Path p;
    p.host = o->host;
    p.name_space = o->name_space;
    p.class_name = o->class_name;
    std::string text = "CMPIObjectPath " + o->name_space + ":" + o->class_name;
    Where here = at_text(text, &where);
    for (const Held_Property& k : o->keys)
        p.keys.push_back(Property {k.name, resolve_at(k.held, at_name(here, "key ", k.name), depth)});
    return p;
}

Value read_array_at(const Array_Obj* o, const Where& where, int depth)
{
    Value v;
    v.type = CMPIType(o->el | CMPI_ARRAY);
    v.null = false;
    Where here {Where::ARRAY_OF, &where, "CMPIArray of ", nullptr, size_t(o->el)};
    v.elements.reserve(o->items.size());
    for (size_t i = 0; i < o->items.size(); i++)
    {
        Where element {Where::NUMBERED, &here, "element ", nullptr, i};
        v.elements.push_back(resolve_at(o->items[i], element, depth));
        v.elements.back().type = o->el;
    }
    return v;
}

Value resolve_at(const Held& h, const Where& where, int depth)
{
    if (!h.obj)
        return h.value;
    const Obj* o = h.obj;
    if (o->magic == OBJ_RELEASED && o->hdl == o)
        used_after_release(o, where.str());
    if (depth > MAX_DEPTH)
    {
        fprintf(stderr, "cimhost: %s: objects nested too deep; does one hold itself?\n",
                where.str().c_str());
        abort();
    }
    switch (o->kind)
    {
    case K_STRING:
    {
        const String_Obj* s = static_cast<const String_Obj*>(o);
        return s->is_null ? Value::null_of(CMPI_string) : Value::of_string(s->s);
    }
    case K_DATETIME: return Value::of_datetime(static_cast<const DT_Obj*>(o)->text);
    case K_PATH:
        return Value::of_ref(read_path_at(static_cast<const Path_Obj*>(o), where, depth + 1));
    case K_INSTANCE:
        return Value::of_instance(
            read_instance_at(static_cast<const Inst_Obj*>(o), where, depth + 1));
    case K_ARRAY: return read_array_at(static_cast<const Array_Obj*>(o), where, depth + 1);
    default: return h.value;
    }
}

} // namespace

[[noreturn]] void used_after_release(const Obj* o, const std::string& where)
{
    fprintf(stderr,
            "cimhost: use after release: %s -> %s\n"
            "cimhost: (the provider released it while something still referred to it)\n",
            where.c_str(), o->released.c_str());
    abort();
}

const char* kind_name(Kind k)
{
    switch (k)
    {
    case K_CONTEXT: return "CMPIContext";
    case K_RESULT: return "CMPIResult";
    case K_INSTANCE: return "CMPIInstance";
    case K_PATH: return "CMPIObjectPath";
    case K_ARGS: return "CMPIArgs";
    case K_STRING: return "CMPIString";
    case K_ARRAY: return "CMPIArray";
    case K_ENUM: return "CMPIEnumeration";
    case K_DATETIME: return "CMPIDateTime";
    case K_SELECTEXP: return "CMPISelectExp";
    }
    return "";
}

void push_arena(Arena* a)
{
    arenas.push_back(a);
}

void pop_arena()
{
    if (!arenas.empty())
        arenas.pop_back();
}

Arena* current_arena()
{
    return arenas.empty() ? &the_host_arena : arenas.back();
}

Arena* host_arena()
{
    return &the_host_arena;
}

void free_arena(Arena* a)
{
    for (;;)
    {
        Obj* o;
        {
            std::lock_guard<std::mutex> g(arena_mutex);
            o = a->head;
            if (o)
                unlink(o);
            else if ((o = a->husks))
                unlink_husk(o);
        }
        if (!o)
            break;
        delete_obj(o);
    }
}

size_t live_object_count()
{
    std::lock_guard<std::mutex> g(arena_mutex);
    return live_objects;
}

bool release_obj(const void* p)
{
    if (!p)
        return false;
    Obj* o = const_cast<Obj*>(static_cast<const Obj*>(p));
    if (o->magic == OBJ_RELEASED && o->hdl == o)
        used_after_release(o, "CMRelease (released twice)");
    if (o->magic != OBJ_LIVE || o->hdl != o)
        return false;
    o->released = describe(o);
    o->magic = OBJ_RELEASED;
    clear_payload(o);
    if (Obj* old = bury(o))
        delete_obj(old);
    return true;
}

CMPIContext* new_context(const std::vector<Property>& entries, Arena* arena)
{
    Ctx_Obj* o = make<Ctx_Obj>(K_CONTEXT, &context_ft, arena);
    o->entries = entries;
    return reinterpret_cast<CMPIContext*>(o);
}

CMPIResult* new_result(Collector* sink)
{
    Result_Obj* o = make<Result_Obj>(K_RESULT, &result_ft);
    o->sink = sink;
    return reinterpret_cast<CMPIResult*>(o);
}

CMPIInstance* new_instance(const Instance& inst)
{
    Inst_Obj* o = make<Inst_Obj>(K_INSTANCE, &instance_ft);
    o->class_name = inst.class_name.empty() ? inst.path.class_name : inst.class_name;
    o->host = inst.path.host;
    o->name_space = inst.path.name_space;
    for (const Property& p : inst.properties)
        o->props.push_back(Held_Property {p.name, copy_of(p.value)});
    // Keys only in the path become properties, as they do when a provider
    // makes an instance from a path.
    for (const Property& k : inst.path.keys)
    {
        o->key_names.push_back(k.name);
        if (!find_held(o->props, k.name.c_str()))
            o->props.push_back(Held_Property {k.name, copy_of(k.value)});
    }
    return reinterpret_cast<CMPIInstance*>(o);
}

CMPIInstance* new_instance_of(const Path_Obj* path)
{
    Inst_Obj* o = make<Inst_Obj>(K_INSTANCE, &instance_ft);
    take_path(o, path);
    return reinterpret_cast<CMPIInstance*>(o);
}

CMPIObjectPath* new_path(const Object_Path& path, Arena* arena)
{
    Path_Obj* o = make<Path_Obj>(K_PATH, &path_ft, arena);
    o->host = path.host;
    o->name_space = path.name_space;
    o->class_name = path.class_name;
    for (const Property& k : path.keys)
        o->keys.push_back(Held_Property {k.name, copy_of(k.value)});
    return reinterpret_cast<CMPIObjectPath*>(o);
}

CMPIArgs* new_args(const std::vector<Property>& args)
{
    Args_Obj* o = make<Args_Obj>(K_ARGS, &args_ft);
    for (const Property& a : args)
        o->args.push_back(Held_Property {a.name, copy_of(a.value)});
    return reinterpret_cast<CMPIArgs*>(o);
}

void add_args(Args_Obj* o, const std::vector<Property>& args)
{
    for (const Property& a : args)
        put_held(o->args, a.name, copy_of(a.value));
}

CMPIString* new_string(const char* s)
{
    String_Obj* o = make<String_Obj>(K_STRING, &string_ft);
    o->is_null = s == nullptr;
    o->s = s ? s : "";
    return reinterpret_cast<CMPIString*>(o);
}

CMPIArray* new_array(CMPIType el, size_t n)
{
    Array_Obj* o = make<Array_Obj>(K_ARRAY, &array_ft);
    o->el = norm(CMPIType(el & ~CMPI_ARRAY));
    o->items.assign(n, copy_of(Value::null_of(o->el)));
    return reinterpret_cast<CMPIArray*>(o);
}

CMPIEnumeration* new_enum(const std::vector<Value>& items)
{
    Enum_Obj* o = make<Enum_Obj>(K_ENUM, &enum_ft);
    o->items = items;
    return reinterpret_cast<CMPIEnumeration*>(o);
}

CMPIDateTime* new_datetime(const std::string& text)
{
    DT_Obj* o = make<DT_Obj>(K_DATETIME, &datetime_ft);
    o->text = text;
    return reinterpret_cast<CMPIDateTime*>(o);
}

CMPISelectExp* new_select(const std::string& query, const std::string& lang,
                          const std::string& class_name, Arena* arena)
{
    Select_Obj* o = make<Select_Obj>(K_SELECTEXP, &select_ft, arena);
    o->query = query;
    o->lang = lang;
    o->class_name = class_name;
    return reinterpret_cast<CMPISelectExp*>(o);
}

CMPIrc hold(const CMPIValue* v, CMPIType type, Held& out, const std::string& where)
{
    out = Held();
    Value& val = out.value;
    if (type & CMPI_ARRAY)
    {
        CMPIType el = norm(CMPIType(type & ~CMPI_ARRAY));
        val.type = CMPIType(el | CMPI_ARRAY);
        if (!v || !v->array)
            return CMPI_RC_OK;
        Array_Obj* a = obj_cast<Array_Obj>(v->array, K_ARRAY, where.c_str());
        if (!a)
            return CMPI_RC_ERR_INVALID_HANDLE;
        if (a->el != el)
            return CMPI_RC_ERR_TYPE_MISMATCH;
        val.null = false;
        out.obj = a;
        return CMPI_RC_OK;
    }
    val.type = norm(type);
    switch (type)
    {
    case CMPI_null:
        return CMPI_RC_OK;
    case CMPI_boolean:
    case CMPI_char16:
    case CMPI_real32:
    case CMPI_real64:
    case CMPI_uint8:
    case CMPI_uint16:
    case CMPI_uint32:
    case CMPI_uint64:
    case CMPI_sint8:
    case CMPI_sint16:
    case CMPI_sint32:
    case CMPI_sint64:
        if (!v)
            return CMPI_RC_OK;
        val.null = false;
        switch (type)
        {
        case CMPI_boolean: val.num.boolean = v->boolean ? 1 : 0; break;
        case CMPI_char16: val.num.char16 = v->char16; break;
        case CMPI_real32: val.num.real32 = v->real32; break;
        case CMPI_real64: val.num.real64 = v->real64; break;
        case CMPI_uint8: val.num.uint8 = v->uint8; break;
        case CMPI_uint16: val.num.uint16 = v->uint16; break;
        case CMPI_uint32: val.num.uint32 = v->uint32; break;
        case CMPI_uint64: val.num.uint64 = v->uint64; break;
        case CMPI_sint8: val.num.sint8 = v->sint8; break;
        case CMPI_sint16: val.num.sint16 = v->sint16; break;
        case CMPI_sint32: val.num.sint32 = v->sint32; break;
        default: val.num.sint64 = v->sint64; break;
        }
        return CMPI_RC_OK;
    case CMPI_chars:
        // Copied at once. As SFCB does: the value pointer is the text itself,
        // which is what the usual CMSetProperty(inst, name, "text",
        // CMPI_chars) passes.
        if (v)
        {
            val.null = false;
            val.str = reinterpret_cast<const char*>(v);
        }
        return CMPI_RC_OK;
    case CMPI_string:
    case CMPI_dateTime:
    case CMPI_ref:
    case CMPI_instance:
    {
        Kind k = type == CMPI_string ? K_STRING
                 : type == CMPI_dateTime ? K_DATETIME
                 : type == CMPI_ref ? K_PATH
                 : K_INSTANCE;
        const void* p = !v ? nullptr
                        : type == CMPI_string ? static_cast<const void*>(v->string)
                        : type == CMPI_dateTime ? static_cast<const void*>(v->dateTime)
                        : type == CMPI_ref ? static_cast<const void*>(v->ref)
                        : static_cast<const void*>(v->inst);
        if (!p)
            return CMPI_RC_OK;
        Obj* o = obj_cast<Obj>(p, k, where.c_str());
        if (!o)
            return CMPI_RC_ERR_INVALID_HANDLE;
        val.null = false;
        out.obj = o;
        return CMPI_RC_OK;
    }
    default:
        val.type = CMPI_null;
        return CMPI_RC_ERR_INVALID_DATA_TYPE;
    }
}

Value resolve(const Held& h, const std::string& where)
{
    return resolve_at(h, at_text(where), 0);
}

CMPIrc from_cmpi(const CMPIValue* v, CMPIType type, Value& out, const std::string& where)
{
    Held h;
    CMPIrc rc = hold(v, type, h, where);
    out = rc == CMPI_RC_OK ? resolve(h, where) : Value();
    return rc;
}

Instance read_instance(const Inst_Obj* o, const std::string& what)
{
    return read_instance_at(o, at_text(what), 0);
}

Object_Path read_path(const Path_Obj* o, const std::string& what)
{
    return read_path_at(o, at_text(what), 0);
}

std::vector<Property> read_args(const Args_Obj* o, const std::string& what)
{
    std::vector<Property> r;
    std::string here = step(what, "CMPIArgs");
    for (const Held_Property& a : o->args)
        r.push_back(Property {a.name, resolve(a.held, step(here, a.name))});
    return r;
}

Value read_array(const Array_Obj* o, const std::string& what)
{
    return read_array_at(o, at_text(what), 0);
}

CMPIData to_cmpi(const Value& v)
{
    CMPIData d;
    memset(&d, 0, sizeof(d));
    d.type = v.type;
    d.state = v.null ? CMPI_nullValue : CMPI_goodValue;
    if (v.null)
        return d;
    if (v.is_array())
    {
        CMPIArray* a = new_array(CMPIType(v.type & ~CMPI_ARRAY), 0);
        for (const Value& e : v.elements)
            as<Array_Obj>(a, K_ARRAY)->items.push_back(copy_of(e));
        d.value.array = a;
        return d;
    }
    switch (v.type)
    {
    case CMPI_string: d.value.string = new_string(v.str.c_str()); break;
    case CMPI_dateTime: d.value.dateTime = new_datetime(v.str); break;
    case CMPI_ref:
        if (v.ref)
            d.value.ref = new_path(*v.ref);
        else
            d.state = CMPI_nullValue;
        break;
    case CMPI_instance:
        if (v.inst)
            d.value.inst = new_instance(*v.inst);
        else
            d.state = CMPI_nullValue;
        break;
    default: d.value = v.num; break;
    }
    return d;
}

void widen_key(Value& val)
{
    // Servers keep integer keys in 64 bits, whatever width was given; the
    // module narrows them back by its class tables.
    if (is_uint_type(val.type) && !val.null)
        val = Value::of_uint(CMPI_uint64, std::stoull(val.text()));
    else if (is_sint_type(val.type) && !val.null)
        val = Value::of_sint(CMPI_sint64, std::stoll(val.text()));
    else if (is_uint_type(val.type))
        val.type = CMPI_uint64;
    else if (is_sint_type(val.type))
        val.type = CMPI_sint64;
}

Object_Path instance_path(const Instance& inst)
{
    Object_Path p;
    p.host = inst.path.host;
    p.name_space = inst.path.name_space;
    p.class_name = inst.path.class_name.empty() ? inst.class_name : inst.path.class_name;
    std::vector<std::string> names;
    const Catalogue* cat = host_catalogue();
    const Class_Info* ci = cat ? cat->find(inst.class_name) : nullptr;
    if (ci)
        for (const Feature_Info& f : ci->features)
            if (f.key)
                names.push_back(f.name);
    if (names.empty())
        for (const Property& k : inst.path.keys)
            names.push_back(k.name);
    for (const std::string& n : names)
    {
        const Value* v = inst.get(n);
        if (!v || v->null)
            continue;
        Property k {n, *v};
        widen_key(k.value);
        p.keys.push_back(k);
    }
    return p;
}

} // namespace cimhost
} // namespace OLMA
