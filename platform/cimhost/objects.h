#ifndef _OLMA_cimhost_objects_h
#define _OLMA_cimhost_objects_h

// The encapsulated CMPI objects that the host hands to providers.
//
// Every object starts with the CMPI head (hdl, ft) and is linked into the
// arena of the scope that made it: the request running on this thread (an
// up-call is a request of its own), an attached provider thread, or the host
// itself. Ending the scope frees what is left in its arena.
//
// The host is as strict as the strictest server about who owns what.
// Instances, paths, arguments and arrays keep the pointers of the strings,
// datetimes, arrays, paths and instances they are given, and read them only
// when they are read or consumed (returned, delivered, passed to an
// up-call). A released object stays behind, poisoned, until its scope ends:
// any later use of it, directly or through a container that kept its
// pointer, aborts with a message that names it.

#include <atomic>
#include <mutex>
#include <type_traits>

#include <cstring>

#include "internal.h"

namespace OLMA
{
namespace cimhost
{

enum Kind : uint32_t
{
    K_CONTEXT = 1,
    K_RESULT,
    K_INSTANCE,
    K_PATH,
    K_ARGS,
    K_STRING,
    K_ARRAY,
    K_ENUM,
    K_DATETIME,
    K_SELECTEXP,
};

struct Arena;

struct Obj
{
    void* hdl;
    void* ft;
    uint32_t magic;
    Kind kind;
    Arena* arena;
    Obj* prev;
    Obj* next;
    // Once released: what the object was, for the message of a later use.
    std::string released;
};

struct Arena
{
    Obj* head = nullptr;   // live objects, newest first
    size_t count = 0;
    Obj* husks = nullptr;  // released ones, newest first
    Obj* oldest_husk = nullptr;
    size_t husk_count = 0;
};

// A value inside an instance, path, argument list or array. Plain data and
// CMPI_chars text are copies; an object given by its pointer is kept as
// that pointer (`value` then holds only the type) and read when the
// container is.
struct Held
{
    Value value;
    Obj* obj = nullptr;
};

struct Held_Property
{
    std::string name;
    Held held;
};

struct Ctx_Obj : Obj
{
    std::vector<Property> entries;
};

// Where a CMPIResult's data go.
struct Collector
{
    std::vector<Value> items;
    bool done = false;
};

struct Result_Obj : Obj
{
    Collector* sink;
};

struct Inst_Obj : Obj
{
    std::string class_name;
    std::string host;
    std::string name_space;
    // The keys of the path it was made from: its keys when the class tables
    // don't know the class.
    std::vector<std::string> key_names;
    std::vector<Held_Property> props;
    bool filtered = false;
    std::vector<std::string> filter;
};

struct Path_Obj : Obj
{
    std::string host;
    std::string name_space;
    std::string class_name;
    std::vector<Held_Property> keys;
};

struct Args_Obj : Obj
{
    std::vector<Held_Property> args;
};

struct String_Obj : Obj
{
    std::string s;
    bool is_null = false;
};

struct Array_Obj : Obj
{
    CMPIType el = 0;
    std::vector<Held> items;
};

struct Enum_Obj : Obj
{
    std::vector<Value> items;
    size_t pos = 0;
    // Instances come out as OpenPegasus hands them back from an up-call:
    // state CMPI_nullValue, with a good value.inst.
    bool null_state = false;
};

struct DT_Obj : Obj
{
    std::string text;
};

struct Select_Obj : Obj
{
    std::string query;
    std::string lang;
    std::string class_name;
};

// Scopes. The outermost scope of a thread owns the objects made on it;
// nested ones (re-entrant up-calls) add to it.
void push_arena(Arena* a);
void pop_arena();
Arena* current_arena();
void free_arena(Arena* a);
// The host's own arena: objects made on threads with no scope.
Arena* host_arena();
size_t live_object_count();
// What each live object is, newest first in each arena.
std::vector<std::string> live_object_descriptions();

// How many released objects a scope that doesn't end keeps poisoned.
void set_released_kept(size_t n);

// Poisons an object of ours; false if it isn't one. Releasing one twice
// aborts.
bool release_obj(const void* cmpi);

const uint32_t OBJ_LIVE = 0xC1A0B0E5u;
const uint32_t OBJ_RELEASED = 0xDEADB0E5u;

// Aborts the process: `where` used `o` after its release.
[[noreturn]] void used_after_release(const Obj* o, const std::string& where);

// The object behind a CMPI pointer, or null if it isn't a live one of that
// kind. A released one aborts.
template <class T>
T* obj_cast(const void* p, Kind k, const char* where = nullptr)
{
    if (!p)
        return nullptr;
    const Obj* o = static_cast<const Obj*>(p);
    if (o->magic == OBJ_RELEASED && o->hdl == o)
        used_after_release(o, where ? where : "a call of the broker or of its own table");
    if (o->magic != OBJ_LIVE || o->kind != k || o->hdl != o)
        return nullptr;
    return static_cast<T*>(const_cast<Obj*>(o));
}

// The name of a kind, "CMPIInstance" and so on.
const char* kind_name(Kind k);

CMPIContext* new_context(const std::vector<Property>& entries, Arena* arena = nullptr);
CMPIResult* new_result(Collector* sink);
// Keys of the instance's path that it has no property for become ones.
CMPIInstance* new_instance(const Instance& inst);
// As CMNewInstance makes it: namespace and class of the path, its keys as
// properties (kept as the path keeps them).
CMPIInstance* new_instance_of(const Path_Obj* path);
CMPIObjectPath* new_path(const Object_Path& path, Arena* arena = nullptr);
CMPIArgs* new_args(const std::vector<Property>& args);
void add_args(Args_Obj* o, const std::vector<Property>& args);
CMPIString* new_string(const char* s);
CMPIArray* new_array(CMPIType el, size_t n);
CMPIEnumeration* new_enum(const std::vector<Value>& items);
CMPIDateTime* new_datetime(const std::string& text);
CMPISelectExp* new_select(const std::string& query, const std::string& lang,
                          const std::string& class_name, Arena* arena = nullptr);

// A CMPI value and type as a container keeps it; an error code for a bad
// handle or type.
CMPIrc hold(const CMPIValue* v, CMPIType type, Held& out, const std::string& where);
// What a kept value is now. `where` names the container and the place in
// it, for the message if what it points to was released.
Value resolve(const Held& h, const std::string& where);
// CMPI value and type to ours, read at once.
CMPIrc from_cmpi(const CMPIValue* v, CMPIType type, Value& out,
                 const std::string& where = "a broker call");
// Ours to CMPI; objects are made in the current scope.
CMPIData to_cmpi(const Value& v);

// What a container holds now, as plain values. `what` names the call that
// reads or consumes it.
Instance read_instance(const Inst_Obj* o, const std::string& what);
Object_Path read_path(const Path_Obj* o, const std::string& what);
std::vector<Property> read_args(const Args_Obj* o, const std::string& what);
Value read_array(const Array_Obj* o, const std::string& what);

// The path of an instance as a server builds it: the class's keys (from the
// class tables, else the keys of the path it was made from), each from the
// key property left on the instance.
Object_Path instance_path(const Instance& inst);

// Integer keys as a server keeps them: 64 bits of the same signedness.
void widen_key(Value& v);

// Helpers for status results.
inline CMPIStatus status(CMPIrc rc)
{
    CMPIStatus st;
    st.rc = rc;
    st.msg = nullptr;
    return st;
}

inline void set_rc(CMPIStatus* rc, CMPIrc code)
{
    if (rc)
    {
        rc->rc = code;
        rc->msg = nullptr;
    }
}

// Broker faults. Every call that a provider makes of the broker's functions
// or of a CMPI object's own functions (but release) is counted; those of a
// planned range fail as a server short of memory, or one whose client went
// away, fails them: a null object, a failed status, a bad value.
struct Broker_Faults
{
    std::atomic<uint64_t> calls {0};
    std::atomic<uint64_t> first {0};   // 0: none planned
    std::atomic<uint64_t> last {0};    // inclusive; UINT64_MAX for no end
};
Broker_Faults& broker_faults();

// Counts this call; true if it is to fail. With CIMHOST_TRACE_BROKER set in
// the environment, each call is printed with its number and `name`.
bool broker_call_fails(const char* name = nullptr);

inline void fail_rc(CMPIStatus* rc)
{
    set_rc(rc, CMPI_RC_ERR_FAILED);
}
template <class T>
void fail_rc(T)
{
}

template <class R, class... A>
R failed_call(A... a)
{
    (fail_rc(a), ...);
    if constexpr (std::is_same<R, CMPIStatus>::value)
        return status(CMPI_RC_ERR_FAILED);
    else if constexpr (std::is_same<R, CMPIData>::value)
    {
        CMPIData d;
        memset(&d, 0, sizeof(d));
        d.type = CMPI_null;
        d.state = CMPI_badValue;
        return d;
    }
    else
        return R();
}

// A function of a table, counted and failed as planned.
template <auto F>
struct Fallible;

template <class R, class... A, R (*F)(A...)>
struct Fallible<F>
{
    static R call(A... a)
    {
        if (broker_call_fails(__PRETTY_FUNCTION__))
            return failed_call<R>(a...);
        return F(a...);
    }
};

#define FALLIBLE(f) (&::OLMA::cimhost::Fallible<&(f)>::call)

// Provided by the host: the class knowledge of the loaded module.
const Catalogue* host_catalogue();

} // namespace cimhost
} // namespace OLMA

#endif
