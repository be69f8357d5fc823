#ifndef _OLMA_cimhost_objects_h
#define _OLMA_cimhost_objects_h

// The encapsulated CMPI objects that the host hands to providers.
//
// Every object starts with the CMPI head (hdl, ft) and is linked into the
// arena of the scope that made it: the operation running on this thread, an
// attached provider thread, or the host itself. Ending the scope frees what
// is left in its arena; a provider's release frees at once.

#include <mutex>

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
};

struct Arena
{
    Obj* head = nullptr;
    size_t count = 0;
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
    Instance data;
    bool filtered = false;
    std::vector<std::string> filter;
};

struct Path_Obj : Obj
{
    Object_Path data;
};

struct Args_Obj : Obj
{
    std::vector<Property> data;
};

struct String_Obj : Obj
{
    std::string s;
    bool is_null = false;
};

struct Array_Obj : Obj
{
    CMPIType el = 0;
    std::vector<Value> items;
};

struct Enum_Obj : Obj
{
    std::vector<Value> items;
    size_t pos = 0;
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

// Frees an object of ours; false if it isn't one (or no longer lives).
bool release_obj(const void* cmpi);

// The object behind a CMPI pointer, or null if it isn't a live one of that kind.
template <class T>
T* obj_cast(const void* p, Kind k)
{
    if (!p)
        return nullptr;
    const Obj* o = static_cast<const Obj*>(p);
    if (o->magic != 0xC1A0B0E5u || o->kind != k || o->hdl != o)
        return nullptr;
    return static_cast<T*>(const_cast<Obj*>(o));
}

CMPIContext* new_context(const std::vector<Property>& entries, Arena* arena = nullptr);
CMPIResult* new_result(Collector* sink);
CMPIInstance* new_instance(const Instance& inst);
CMPIObjectPath* new_path(const Object_Path& path, Arena* arena = nullptr);
CMPIArgs* new_args(const std::vector<Property>& args);
CMPIString* new_string(const char* s);
CMPIArray* new_array(CMPIType el, size_t n);
CMPIEnumeration* new_enum(const std::vector<Value>& items);
CMPIDateTime* new_datetime(const std::string& text);
CMPISelectExp* new_select(const std::string& query, const std::string& lang,
                          const std::string& class_name, Arena* arena = nullptr);

// CMPI value and type to ours; an error code for a bad handle or type.
CMPIrc from_cmpi(const CMPIValue* v, CMPIType type, Value& out);
// Ours to CMPI; objects are made in the current scope.
CMPIData to_cmpi(const Value& v);

// The instance's path: its stored path with keys refreshed from properties
// of the same name, plus key properties the class tables name.
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

// Provided by the host: the class knowledge of the loaded module.
const Catalogue* host_catalogue();

} // namespace cimhost
} // namespace OLMA

#endif
