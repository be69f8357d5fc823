#ifndef _OLMA_cimhost_internal_h
#define _OLMA_cimhost_internal_h

// Pieces of cimhost shared between its sources; not for users.

#include <cstdarg>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "cimhost.h"
#include "cmpift.h"

namespace OLMA
{
namespace cimhost
{

// Case-insensitive comparison of names (classes, properties, methods).
bool name_eq(const std::string& a, const std::string& b);
std::string lower(const std::string& s);

// Type names as in MOF ("uint16"), with "[]" for arrays; "" for unknown.
std::string type_name(CMPIType type);
// The code of a MOF type name (no brackets), 0 if unknown.
CMPIType type_of_name(const std::string& name);
bool is_uint_type(CMPIType t);
bool is_sint_type(CMPIType t);

// Datetime texts: "yyyymmddhhmmss.mmmmmmsutc" (timestamp) or
// "ddddddddhhmmss.mmmmmm:000" (interval).
bool datetime_valid(const std::string& text);
bool datetime_is_interval(const std::string& text);
uint64_t datetime_to_binary(const std::string& text);
std::string datetime_from_binary(uint64_t usec, bool interval);
std::string datetime_now();

// One key or property value in the path text form.
std::string key_value_text(const Value& v);

// Value of a text read with no type known: quoted string (or path),
// TRUE/FALSE, integer, real.
bool parse_untyped_key(const std::string& raw, bool quoted, Value& v, std::string& err);

// Indented MOF-like block of an instance (for printing and toString).
std::string instance_mof(const Instance& inst, int indent = 0);

// Class knowledge, from the module's own tables when it exports them.
struct Feature_Info
{
    std::string name;
    CMPIType type = 0;      // CMPI code, array bit included
    bool key = false;
    bool reference = false; // a reference or an embedded instance
    std::string ref_class;  // declared class of a reference
    bool in = false;
    bool out = false;
};

struct Method_Info
{
    std::string name;
    CMPIType return_type = 0;
    bool is_static = false;
    std::vector<Feature_Info> params;
};

struct Class_Info
{
    std::string name;
    std::string super;
    bool association = false;
    bool indication = false;
    std::vector<Feature_Info> features;
    std::vector<Method_Info> methods;

    const Feature_Info* feature(const std::string& n) const;
    const Method_Info* method(const std::string& n) const;
};

class Catalogue
{
public:
    // Reads the Registration chain behind `tessel_module` of a loaded
    // module. False if the module has none (no class knowledge then).
    bool load(void* dl_handle, std::string& err);
    // Adds a class known only by name (from the .reg file).
    void add_name_only(const std::string& name, bool association, bool indication);
    const Class_Info* find(const std::string& name) const;
    bool is_a(const std::string& cls, const std::string& ancestor) const;
    bool has_tables() const { return tables; }
    size_t size() const { return classes.size(); }

private:
    std::map<std::string, Class_Info> classes;   // by lower-case name
    bool tables = false;
};

// The .reg file: one section per class.
enum Mi_Kind
{
    MI_INSTANCE = 1,
    MI_ASSOCIATION = 2,
    MI_METHOD = 4,
    MI_INDICATION = 8,
};

struct Registration_Entry
{
    std::string class_name;
    std::string provider;
    std::string location;
    unsigned kinds = 0;
    std::vector<std::string> name_spaces;
};

// False with a reason (file and line) on a malformed file.
bool read_reg_file(const std::string& path, std::vector<Registration_Entry>& entries,
                   std::string& err);

} // namespace cimhost
} // namespace OLMA

#endif
