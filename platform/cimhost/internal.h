#ifndef _OLMA_cimhost_internal_h
#define _OLMA_cimhost_internal_h

// Pieces of cimhost shared between its sources; not for users.

#include <cstdarg>
#include <cstdint>
#include <map>
#include <mutex>
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

// Class knowledge, as a CIM server has it from the MOF compiled into its
// repository. tools/gen_cimhost_classes.py writes it as tables of the
// records below: each class with its parent, its kind and the features it
// declares itself, parents ahead of their children.
enum : unsigned
{
    FD_KEY = 1u << 0,
    FD_METHOD = 1u << 1,
    FD_STATIC = 1u << 2,
    FD_IN = 1u << 3,       // parameters only
    FD_OUT = 1u << 4,      // parameters only
    FD_EMBEDDED = 1u << 5, // a string that holds an embedded instance or object
};

enum : unsigned
{
    CD_ASSOCIATION = 1u << 0,
    CD_INDICATION = 1u << 1,
};

struct Feature_Desc
{
    const char* name;
    CMPIType type;              // CMPI code with the array bit; a method's return type
    unsigned flags;             // FD_*
    const char* ref_class;      // the declared class of a reference, else null
    const Feature_Desc* params; // a method's parameters
    size_t num_params;
};

struct Class_Desc
{
    const char* name;
    const char* super;          // null for a root
    unsigned kind;              // CD_*, 0 for a plain class
    const Feature_Desc* features;
    size_t num_features;
};

struct Class_Table
{
    const Class_Desc* classes;
    size_t num_classes;
};

// The module's namespace: the DMTF CIM schema 2.26 Final and
// schema/mof/vespera.mof (vespera_classes.cpp).
extern const Class_Table vespera_classes;

struct Feature_Info
{
    std::string name;
    CMPIType type = 0;      // CMPI code, array bit included
    bool key = false;
    bool reference = false; // a reference or an embedded instance
    bool embedded = false;  // a string declared to hold an embedded instance or object
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
    // False for a class that only the .reg file names: nothing is known of
    // its features then, so nothing is checked against them.
    bool declared = false;
    std::vector<Feature_Info> features;
    std::vector<Method_Info> methods;

    const Feature_Info* feature(const std::string& n) const;
    const Method_Info* method(const std::string& n) const;
};

class Catalogue
{
public:
    // Takes the classes of a generated table, resolving what each inherits.
    // A class whose parent the table lacks is taken as a root.
    void load(const Class_Table& table);
    // Adds a class known only by name (from the .reg file).
    void add_name_only(const std::string& name, bool association, bool indication);
    const Class_Info* find(const std::string& name) const;
    bool is_a(const std::string& cls, const std::string& ancestor) const;
    size_t size() const { return classes.size(); }

    // Whether an instance of `cls` may take the property, as a server asks
    // its repository: CMPI_RC_ERR_NO_SUCH_PROPERTY if the class doesn't
    // declare it, CMPI_RC_ERR_TYPE_MISMATCH if it declares another type
    // (a value of type CMPI_null passes: it sets no type). Refusals are
    // noted, one line each, for refused_properties().
    CMPIrc check_property(const std::string& cls, const std::string& name, CMPIType type) const;
    std::vector<std::string> refused_properties() const;
    void clear_refused_properties();

private:
    std::map<std::string, Class_Info> classes;   // by lower-case name
    mutable std::mutex refusal_mutex;            // providers set properties on their own threads
    mutable std::vector<std::string> refusals;
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
