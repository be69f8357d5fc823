// The encapsulated CMPI objects and their function tables.

#include <cstring>

#include "objects.h"

namespace OLMA
{
namespace cimhost
{

namespace
{

const uint32_t LIVE = 0xC1A0B0E5u;

std::mutex arena_mutex;
Arena the_host_arena;
size_t live_objects = 0;
thread_local std::vector<Arena*> arenas;

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
    std::lock_guard<std::mutex> g(arena_mutex);
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
    o->magic = LIVE;
    o->kind = k;
    link(o, arena ? arena : current_arena());
    return o;
}

template <class T>
T* as(const void* p, Kind k)
{
    return obj_cast<T>(p, k);
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

CMPIType norm(CMPIType t)
{
    return t == CMPI_chars ? CMPIType(CMPI_string) : t;
}

//
// Context
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
    CMPIrc rc = from_cmpi(v, t, val);
    if (rc != CMPI_RC_OK)
        return status(rc);
    put_prop(o->entries, name, val);
    return status(CMPI_RC_OK);
}

CMPIContextFT context_ft = {100, ctx_release, ctx_clone, ctx_get_entry, ctx_get_entry_at,
                            ctx_count, ctx_add};

//
// Result
//

CMPIStatus res_release(CMPIResult* r) { return release_any(r); }

CMPIResult* res_clone(const CMPIResult*, CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_ERR_NOT_SUPPORTED);
    return nullptr;
}

CMPIStatus res_add(const CMPIResult* r, const Value& v)
{
    Result_Obj* o = as<Result_Obj>(r, K_RESULT);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (o->sink)
        o->sink->items.push_back(v);
    return status(CMPI_RC_OK);
}

CMPIStatus res_data(const CMPIResult* r, const CMPIValue* v, CMPIType t)
{
    Value val;
    CMPIrc rc = from_cmpi(v, t, val);
    if (rc != CMPI_RC_OK)
        return status(rc);
    return res_add(r, val);
}

CMPIStatus res_instance(const CMPIResult* r, const CMPIInstance* i)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    if (!o)
        return status(i ? CMPI_RC_ERR_INVALID_HANDLE : CMPI_RC_ERR_INVALID_PARAMETER);
    Instance copy = o->data;
    copy.path = instance_path(o->data);
    return res_add(r, Value::of_instance(copy));
}

CMPIStatus res_path(const CMPIResult* r, const CMPIObjectPath* p)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    if (!o)
        return status(p ? CMPI_RC_ERR_INVALID_HANDLE : CMPI_RC_ERR_INVALID_PARAMETER);
    return res_add(r, Value::of_ref(o->data));
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

CMPIInstance* inst_clone(const CMPIInstance* i, CMPIStatus* rc)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    if (!o)
        return nullptr;
    CMPIInstance* c = new_instance(o->data);
    Inst_Obj* n = as<Inst_Obj>(c, K_INSTANCE);
    n->filtered = o->filtered;
    n->filter = o->filter;
    return c;
}

CMPIData inst_get(const CMPIInstance* i, const char* name, CMPIStatus* rc)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    return get_named(o->data.properties, name, rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

CMPIData inst_get_at(const CMPIInstance* i, CMPICount n, CMPIString** name, CMPIStatus* rc)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    return get_at(o->data.properties, n, name, rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

CMPICount inst_count(const CMPIInstance* i, CMPIStatus* rc)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? CMPICount(o->data.properties.size()) : 0;
}

bool is_key_of(const Instance& inst, const std::string& name)
{
    if (inst.path.key(name))
        return true;
    const Catalogue* cat = host_catalogue();
    const Class_Info* ci = cat ? cat->find(inst.class_name) : nullptr;
    const Feature_Info* f = ci ? ci->feature(name) : nullptr;
    return f && f->key;
}

bool passes_filter(const Inst_Obj* o, const std::string& name)
{
    if (!o->filtered)
        return true;
    for (const std::string& f : o->filter)
        if (name_eq(f, name))
            return true;
    return is_key_of(o->data, name);
}

CMPIStatus inst_set(const CMPIInstance* i, const char* name, const CMPIValue* v, CMPIType t)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (!name || !*name)
        return status(CMPI_RC_ERR_INVALID_PARAMETER);
    Value val;
    CMPIrc rc = from_cmpi(v, t, val);
    if (rc != CMPI_RC_OK)
        return status(rc);
    // A server takes only what the class in its repository declares, and
    // with the declared type, property list or not.
    const Catalogue* cat = host_catalogue();
    rc = cat ? cat->check_property(o->data.class_name, name, val.type) : CMPI_RC_OK;
    if (rc != CMPI_RC_OK)
        return status(rc);
    // A filtered-out property is dropped silently, as the client asked for
    // fewer properties, not for an error.
    if (passes_filter(o, name))
        put_prop(o->data.properties, name, val);
    return status(CMPI_RC_OK);
}

CMPIObjectPath* inst_get_path(const CMPIInstance* i, CMPIStatus* rc)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_path(instance_path(o->data)) : nullptr;
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
    std::vector<Property> kept;
    for (const Property& p : o->data.properties)
        if (passes_filter(o, p.name))
            kept.push_back(p);
    o->data.properties.swap(kept);
    return status(CMPI_RC_OK);
}

CMPIStatus inst_set_path(CMPIInstance* i, const CMPIObjectPath* p)
{
    Inst_Obj* o = as<Inst_Obj>(i, K_INSTANCE);
    Path_Obj* po = as<Path_Obj>(p, K_PATH);
    if (!o || (p && !po))
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (!po)
        return status(CMPI_RC_ERR_INVALID_PARAMETER);
    o->data.path = po->data;
    if (!po->data.class_name.empty())
        o->data.class_name = po->data.class_name;
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
    return o ? new_path(o->data) : nullptr;
}

CMPIStatus path_set_text(CMPIObjectPath* p, const char* s, std::string Object_Path::*field)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    o->data.*field = s ? s : "";
    return status(CMPI_RC_OK);
}

CMPIString* path_get_text(const CMPIObjectPath* p, CMPIStatus* rc,
                          std::string Object_Path::*field)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? new_string((o->data.*field).c_str()) : nullptr;
}

CMPIStatus path_set_ns(CMPIObjectPath* p, const char* s)
{
    return path_set_text(p, s, &Object_Path::name_space);
}
CMPIString* path_get_ns(const CMPIObjectPath* p, CMPIStatus* rc)
{
    return path_get_text(p, rc, &Object_Path::name_space);
}
CMPIStatus path_set_host(CMPIObjectPath* p, const char* s)
{
    return path_set_text(p, s, &Object_Path::host);
}
CMPIString* path_get_host(const CMPIObjectPath* p, CMPIStatus* rc)
{
    return path_get_text(p, rc, &Object_Path::host);
}
CMPIStatus path_set_class(CMPIObjectPath* p, const char* s)
{
    return path_set_text(p, s, &Object_Path::class_name);
}
CMPIString* path_get_class(const CMPIObjectPath* p, CMPIStatus* rc)
{
    return path_get_text(p, rc, &Object_Path::class_name);
}

CMPIStatus path_add_key(CMPIObjectPath* p, const char* name, const CMPIValue* v, CMPIType t)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (!name || !*name)
        return status(CMPI_RC_ERR_INVALID_PARAMETER);
    Value val;
    CMPIrc rc = from_cmpi(v, t, val);
    if (rc != CMPI_RC_OK)
        return status(rc);
    widen_key(val);
    put_prop(o->data.keys, name, val);
    return status(CMPI_RC_OK);
}

CMPIData path_get_key(const CMPIObjectPath* p, const char* name, CMPIStatus* rc)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    CMPIData d = get_named(o->data.keys, name, rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
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
    CMPIData d = get_at(o->data.keys, i, name, rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    if (!(d.state & CMPI_notFound))
        d.state |= CMPI_keyValue;
    return d;
}

CMPICount path_key_count(const CMPIObjectPath* p, CMPIStatus* rc)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? CMPICount(o->data.keys.size()) : 0;
}

CMPIStatus path_ns_from(CMPIObjectPath* p, const CMPIObjectPath* src)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    Path_Obj* s = as<Path_Obj>(src, K_PATH);
    if (!o || !s)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    o->data.name_space = s->data.name_space;
    return status(CMPI_RC_OK);
}

CMPIStatus path_host_ns_from(CMPIObjectPath* p, const CMPIObjectPath* src)
{
    Path_Obj* o = as<Path_Obj>(p, K_PATH);
    Path_Obj* s = as<Path_Obj>(src, K_PATH);
    if (!o || !s)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    o->data.name_space = s->data.name_space;
    o->data.host = s->data.host;
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
    return o ? new_string(o->data.to_string().c_str()) : nullptr;
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
    return o ? new_args(o->data) : nullptr;
}

CMPIStatus args_add(const CMPIArgs* a, const char* name, const CMPIValue* v, CMPIType t)
{
    Args_Obj* o = as<Args_Obj>(a, K_ARGS);
    if (!o)
        return status(CMPI_RC_ERR_INVALID_HANDLE);
    if (!name || !*name)
        return status(CMPI_RC_ERR_INVALID_PARAMETER);
    Value val;
    CMPIrc rc = from_cmpi(v, t, val);
    if (rc != CMPI_RC_OK)
        return status(rc);
    put_prop(o->data, name, val);
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
    return get_named(o->data, name, rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

CMPIData args_get_at(const CMPIArgs* a, CMPICount i, CMPIString** name, CMPIStatus* rc)
{
    Args_Obj* o = as<Args_Obj>(a, K_ARGS);
    if (!o)
    {
        set_rc(rc, CMPI_RC_ERR_INVALID_HANDLE);
        return bad_data(CMPI_badValue);
    }
    return get_at(o->data, i, name, rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

CMPICount args_count(const CMPIArgs* a, CMPIStatus* rc)
{
    Args_Obj* o = as<Args_Obj>(a, K_ARGS);
    set_rc(rc, o ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_HANDLE);
    return o ? CMPICount(o->data.size()) : 0;
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
    CMPIArray* c = new_array(o->el, 0);
    as<Array_Obj>(c, K_ARRAY)->items = o->items;
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
    return to_cmpi(o->items[i]);
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
    Value val;
    CMPIrc rc = from_cmpi(v, t == CMPI_null ? o->el : t, val);
    if (rc != CMPI_RC_OK)
        return status(rc);
    val.type = o->el;
    if (t == CMPI_null)
        val.null = true;
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
    return to_cmpi(o->items[o->pos++]);
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
    as<Array_Obj>(a, K_ARRAY)->items = o->items;
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
    return cat ? cat->is_a(io->data.class_name, o->class_name)
               : name_eq(io->data.class_name, o->class_name);
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

} // namespace

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
        }
        if (!o)
            break;
        unlink(o);
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
    if (o->magic != LIVE || o->hdl != o)
        return false;
    unlink(o);
    delete_obj(o);
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
    o->data = inst;
    return reinterpret_cast<CMPIInstance*>(o);
}

CMPIObjectPath* new_path(const Object_Path& path, Arena* arena)
{
    Path_Obj* o = make<Path_Obj>(K_PATH, &path_ft, arena);
    o->data = path;
    return reinterpret_cast<CMPIObjectPath*>(o);
}

CMPIArgs* new_args(const std::vector<Property>& args)
{
    Args_Obj* o = make<Args_Obj>(K_ARGS, &args_ft);
    o->data = args;
    return reinterpret_cast<CMPIArgs*>(o);
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
    o->items.assign(n, Value::null_of(o->el));
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

CMPIrc from_cmpi(const CMPIValue* v, CMPIType type, Value& out)
{
    out = Value();
    if (type & CMPI_ARRAY)
    {
        CMPIType el = norm(CMPIType(type & ~CMPI_ARRAY));
        out.type = CMPIType(el | CMPI_ARRAY);
        if (!v || !v->array)
            return CMPI_RC_OK;
        Array_Obj* a = as<Array_Obj>(v->array, K_ARRAY);
        if (!a)
            return CMPI_RC_ERR_INVALID_HANDLE;
        if (a->el != el)
            return CMPI_RC_ERR_TYPE_MISMATCH;
        out.null = false;
        out.elements = a->items;
        return CMPI_RC_OK;
    }
    out.type = norm(type);
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
        out.null = false;
        switch (type)
        {
        case CMPI_boolean: out.num.boolean = v->boolean ? 1 : 0; break;
        case CMPI_char16: out.num.char16 = v->char16; break;
        case CMPI_real32: out.num.real32 = v->real32; break;
        case CMPI_real64: out.num.real64 = v->real64; break;
        case CMPI_uint8: out.num.uint8 = v->uint8; break;
        case CMPI_uint16: out.num.uint16 = v->uint16; break;
        case CMPI_uint32: out.num.uint32 = v->uint32; break;
        case CMPI_uint64: out.num.uint64 = v->uint64; break;
        case CMPI_sint8: out.num.sint8 = v->sint8; break;
        case CMPI_sint16: out.num.sint16 = v->sint16; break;
        case CMPI_sint32: out.num.sint32 = v->sint32; break;
        default: out.num.sint64 = v->sint64; break;
        }
        return CMPI_RC_OK;
    case CMPI_chars:
        // As SFCB does: the value pointer is the text itself, which is what
        // the usual CMSetProperty(inst, name, "text", CMPI_chars) passes.
        if (v)
        {
            out.null = false;
            out.str = reinterpret_cast<const char*>(v);
        }
        return CMPI_RC_OK;
    case CMPI_string:
    {
        if (!v || !v->string)
            return CMPI_RC_OK;
        String_Obj* s = as<String_Obj>(v->string, K_STRING);
        if (!s)
            return CMPI_RC_ERR_INVALID_HANDLE;
        out.null = s->is_null;
        out.str = s->s;
        return CMPI_RC_OK;
    }
    case CMPI_dateTime:
    {
        if (!v || !v->dateTime)
            return CMPI_RC_OK;
        DT_Obj* d = as<DT_Obj>(v->dateTime, K_DATETIME);
        if (!d)
            return CMPI_RC_ERR_INVALID_HANDLE;
        out.null = false;
        out.str = d->text;
        return CMPI_RC_OK;
    }
    case CMPI_ref:
    {
        if (!v || !v->ref)
            return CMPI_RC_OK;
        Path_Obj* p = as<Path_Obj>(v->ref, K_PATH);
        if (!p)
            return CMPI_RC_ERR_INVALID_HANDLE;
        out = Value::of_ref(p->data);
        return CMPI_RC_OK;
    }
    case CMPI_instance:
    {
        if (!v || !v->inst)
            return CMPI_RC_OK;
        Inst_Obj* i = as<Inst_Obj>(v->inst, K_INSTANCE);
        if (!i)
            return CMPI_RC_ERR_INVALID_HANDLE;
        Instance copy = i->data;
        copy.path = instance_path(i->data);
        out = Value::of_instance(copy);
        return CMPI_RC_OK;
    }
    default:
        out.type = CMPI_null;
        return CMPI_RC_ERR_INVALID_DATA_TYPE;
    }
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
        as<Array_Obj>(a, K_ARRAY)->items = v.elements;
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
    Object_Path p = inst.path;
    if (p.class_name.empty())
        p.class_name = inst.class_name;
    for (Property& k : p.keys)
    {
        const Value* v = inst.get(k.name);
        if (v && !v->null)
            k.value = *v;
    }
    const Catalogue* cat = host_catalogue();
    const Class_Info* ci = cat ? cat->find(inst.class_name) : nullptr;
    if (ci)
        for (const Feature_Info& f : ci->features)
            if (f.key && !p.key(f.name))
            {
                const Value* v = inst.get(f.name);
                if (v && !v->null)
                    p.keys.push_back(Property {f.name, *v});
            }
    for (Property& k : p.keys)
        widen_key(k.value);
    return p;
}

} // namespace cimhost
} // namespace OLMA
