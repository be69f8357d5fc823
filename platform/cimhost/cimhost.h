#ifndef _OLMA_cimhost_h
#define _OLMA_cimhost_h

// cimhost: a small CIM server for one provider module.
//
// It loads a CMPI provider module with dlopen, learns from an SFCB-style .reg
// file which provider serves which class, and serves the operations a WBEM
// client would send (enumerate, get, associations, methods, indications)
// through the providers' MI tables, with a complete broker behind them. Like
// a CIM server it knows the classes from their MOF (compiled in, see
// Options::classes), and refuses a property that a provider sets on an
// instance if the class doesn't declare it.
// Tests drive a module through a Host; the `cimhost` command is a thin
// wrapper around the same calls.
//
// Typical use:
//
//     OLMA::cimhost::Options opts;            // defaults: the built module
//     OLMA::cimhost::Host host(opts);
//     if (!host.ok()) { puts(host.error().c_str()); ... }
//     OLMA::cimhost::Object_Path cls;
//     std::string err;
//     OLMA::cimhost::parse_path("root/vespera:VESPERA_FCPort", cls, err);
//     OLMA::cimhost::Result r = host.ei(cls);
//     for (auto& inst : r.instances)
//         printf("%s\n", inst.get_text("DeviceID").c_str());
//
// The host is as strict as the strictest CIM server about the CMPI objects a
// provider makes and hands over:
//  - Instances, object paths, argument lists and arrays keep the pointers of
//    the strings, datetimes, arrays, paths and instances they are given (text
//    given as CMPI_chars is copied), and read them only when they are read or
//    consumed: returned (CMReturnInstance, ...), delivered, or passed to an
//    up-call. So a provider must not release an object while another one may
//    still refer to it.
//  - A released object is poisoned: any later use, directly or through a
//    container that kept its pointer, aborts the process with a message on
//    stderr naming the object (its kind and what it held) and the way it was
//    reached.
//  - Everything made during a request is freed when the request ends; an
//    up-call is a request of its own, and a thread attached with
//    CBAttachThread keeps what it makes until it detaches. Results are plain
//    C++ copies and own nothing of CMPI.
//  - The path of a returned instance is built from the key properties left
//    on it (an instance made from a path starts with the path's keys as
//    properties). With a property list, the filter (CMSetPropertyFilter)
//    keeps only the properties of the list and of the key list the provider
//    gives: a provider that passes no key list returns paths without keys.
//
// A Host is not meant to be shared between threads that call it at the same
// time; providers' own threads may call the broker at any time.

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "cmpidt.h"

namespace OLMA
{
namespace cimhost
{

struct Instance;
struct Object_Path;
struct Class_Table;

// One CIM value. `type` is the CMPI type code; arrays have the CMPI_ARRAY bit
// and their elements in `elements`. Numbers, boolean and char16 live in `num`
// (read the member of the type), strings and datetimes (CIM text form) in
// `str`, references in `ref`, embedded instances in `inst`.
struct Value
{
    CMPIType type = CMPI_null;
    bool null = true;
    CMPIValue num {};
    std::string str;
    std::shared_ptr<Object_Path> ref;
    std::shared_ptr<Instance> inst;
    std::vector<Value> elements;

    bool is_array() const { return (type & CMPI_ARRAY) != 0; }

    // The value as text: numbers in decimal, booleans "true"/"false",
    // strings and datetimes as they are, references in the path text form,
    // embedded instances as "instance of <Class>", arrays as
    // "{e1, e2}" with strings quoted; "NULL" for a null value.
    std::string text() const;

    static Value of_string(const std::string& s);
    static Value of_uint(CMPIType type, uint64_t v);
    static Value of_sint(CMPIType type, int64_t v);
    static Value of_bool(bool b);
    static Value of_real(CMPIType type, double v);
    static Value of_datetime(const std::string& cim_text);
    static Value of_ref(const Object_Path& path);
    static Value of_instance(const Instance& inst);
    static Value of_instance(Instance&& inst);
    static Value null_of(CMPIType type);
};

// Equal type, null state and content (recursively).
bool operator==(const Value& a, const Value& b);
inline bool operator!=(const Value& a, const Value& b) { return !(a == b); }

struct Property
{
    std::string name;
    Value value;
};

struct Object_Path
{
    std::string host;
    std::string name_space;
    std::string class_name;
    std::vector<Property> keys;

    // "root/vespera:VESPERA_FCPort.CreationClassName=\"VESPERA_FCPort\",DeviceID=\"x\"";
    // keys in their stored order.
    std::string to_string() const;
    // By name, without regard to case; null if absent.
    const Value* key(const std::string& name) const;
};

// Same class and namespace (without regard to case), same keys in any
// order, values compared with regard to case.
bool path_equal(const Object_Path& a, const Object_Path& b);

struct Instance
{
    std::string class_name;
    Object_Path path;
    // In the order the provider set them.
    std::vector<Property> properties;

    // By name, without regard to case; null if absent.
    const Value* get(const std::string& name) const;
    // Value::text() of the property, "" if absent.
    std::string get_text(const std::string& name) const;
};

// The outcome of one operation.
struct Result
{
    CMPIrc rc = CMPI_RC_OK;
    std::string message;   // the provider's status text, or the host's reason
    std::vector<Instance> instances;
    std::vector<Object_Path> paths;
    Value return_value;    // cm only
    std::vector<Property> out;   // cm only: out parameters

    bool ok() const { return rc == CMPI_RC_OK; }
};

// "CMPI_RC_ERR_NOT_FOUND" and so on; "CMPI_RC_<n>" for an unknown code.
std::string rc_name(int rc);

struct Indication_Record
{
    std::string name_space;
    Instance instance;
};

struct Options
{
    // Defaults: the module and .reg file of the build that made this library.
    std::string module_path;
    std::string reg_path;
    // Serve CIM_ObjectManager in the interop namespace from the built-in
    // stand-in, beside whatever the module registers there. When off,
    // enumerations of that namespace fail with CMPI_RC_ERR_INVALID_NAMESPACE,
    // unless the module serves classes there.
    bool interop = true;
    // When on together with interop, the stand-in answers with no instance.
    bool interop_empty = false;
    // The interop namespace: OpenPegasus's by default; SFCB's is "root/interop".
    std::string interop_namespace = "root/PG_InterOp";
    // Enumerations that up-calls (CBEnumInstances, CBAssociators, ...) hand
    // back give their instances as OpenPegasus does: state CMPI_nullValue,
    // with a valid value.inst.
    bool pegasus_enumerations = false;
    // The "CMPIPrincipal" entry of every context.
    std::string principal = "cimhost";
    // The classes the host knows, as a server knows those compiled into its
    // repository; null for the built-in ones of the module's namespace (the
    // DMTF CIM schema 2.26 Final and schema/mof/vespera.mof). A class that
    // only the .reg file names is known by name alone.
    const Class_Table* classes = nullptr;
};

// Path text parsing. Accepts "[//host/]ns:Class[.key=value,...]" and
// "Class[.key=...]" (namespace then comes from `default_ns`). Values are
// "quoted strings" (backslash escapes \" and \\), TRUE/FALSE, integers,
// reals, or quoted paths for references. Without class knowledge a quoted
// text that reads as a path with keys becomes a reference. False with a
// one-line reason in `err`.
bool parse_path(const std::string& text, Object_Path& path, std::string& err,
                const std::string& default_ns = "");

// A typed value from "TYPE:VALUE": TYPE one of boolean, uint8..sint64,
// real32, real64, char16, string, datetime, ref (VALUE a path), with "[]"
// after TYPE for an array whose elements are separated by commas (a
// backslash escapes a comma). "null:" gives a null value of no type.
bool parse_typed_value(const std::string& text, Value& v, std::string& err);

// Text of VALUE read as the given CMPI type (array or not).
bool parse_value_as(CMPIType type, const std::string& text, Value& v, std::string& err);

class Host_Impl;

class Host
{
public:
    explicit Host(const Options& options = Options());
    ~Host();
    Host(const Host&) = delete;
    Host& operator=(const Host&) = delete;

    // False if the module or the .reg file couldn't be loaded; error() says why.
    bool ok() const;
    const std::string& error() const;

    // Switch the interop stand-in on or off between operations.
    void set_interop(bool on, bool empty = false);
    void set_interop_namespace(const std::string& name_space);
    void set_pegasus_enumerations(bool on);

    // Operations. `props` null means all properties, and the host passes the
    // list to the provider without filtering the answer itself. For ei/ein
    // the path gives namespace and class; the providers of the class and of
    // its registered subclasses answer. An empty namespace means the first
    // one of the registration file. The host checks the namespace and the
    // class (CMPI_RC_ERR_INVALID_NAMESPACE, CMPI_RC_ERR_INVALID_CLASS) before
    // any provider is asked.
    Result ei(const Object_Path& cls, const std::vector<std::string>* props = nullptr);
    Result ein(const Object_Path& cls);
    Result gi(const Object_Path& path, const std::vector<std::string>* props = nullptr);
    // Empty filter texts mean no filter. With no assoc_class every
    // association provider of the namespace whose class can refer to the
    // source is asked.
    Result ai(const Object_Path& path, const std::string& assoc_class = "",
              const std::string& result_class = "", const std::string& role = "",
              const std::string& result_role = "",
              const std::vector<std::string>* props = nullptr);
    Result an(const Object_Path& path, const std::string& assoc_class = "",
              const std::string& result_class = "", const std::string& role = "",
              const std::string& result_role = "");
    // result_class names the association class, as in CIM.
    Result ri(const Object_Path& path, const std::string& result_class = "",
              const std::string& role = "", const std::vector<std::string>* props = nullptr);
    Result rn(const Object_Path& path, const std::string& result_class = "",
              const std::string& role = "");
    Result cm(const Object_Path& path, const std::string& method,
              const std::vector<Property>& in);

    // Intrinsic writes and queries, through the instance MI of the class.
    // ci gives the new instance's path in paths[0] (the request's path if
    // the provider returned none). `inst.class_name` defaults to the path's.
    Result ci(const Object_Path& path, const Instance& inst);
    Result mi(const Object_Path& path, const Instance& inst,
              const std::vector<std::string>* props = nullptr);
    Result di(const Object_Path& path);
    Result eq(const Object_Path& cls, const std::string& query, const std::string& lang = "WQL");

    // Indications. subscribe() runs authorizeFilter, mustPoll, activateFilter
    // (and enableIndications for a provider's first filter) on every
    // indication provider of the class; `id` receives a handle for
    // unsubscribe(), which runs deActivateFilter and, for the last filter,
    // disableIndications.
    Result subscribe(const std::string& name_space, const std::string& class_name, int& id,
                     const std::string& query = "");
    Result unsubscribe(int id);
    size_t active_filters() const;

    // Indications delivered so far (all namespaces), oldest first.
    std::vector<Indication_Record> indications() const;
    void clear_indications();
    // Waits until at least `count` indications were delivered in all, or the
    // timeout passes; returns how many there are.
    size_t wait_indications(size_t count, int timeout_ms) const;

    // Calls cleanup on every MI the host holds. Those that agree to unload are
    // forgotten, so a later request makes them anew through Create_*MI.
    // Returns how many refused (CMPI_RC_DO_NOT_UNLOAD / NEVER_UNLOAD).
    int cleanup(bool terminating);

    // Class knowledge, from the classes of the options.
    // The CIM type of a property or method parameter (CMPI code with the
    // array bit), 0 if unknown.
    CMPIType property_type(const std::string& class_name, const std::string& property) const;
    CMPIType parameter_type(const std::string& class_name, const std::string& method,
                            const std::string& parameter) const;
    bool knows_class(const std::string& class_name) const;
    bool class_is_a(const std::string& class_name, const std::string& ancestor) const;
    // Types the keys of a parsed path by the class (references,
    // narrower integers), so that it matches what a provider expects.
    void type_keys(Object_Path& path) const;

    // Properties that a provider set on an instance and the host refused,
    // as a server refuses them: the class doesn't declare the property
    // (CMPI_RC_ERR_NO_SUCH_PROPERTY) or declares another type
    // (CMPI_RC_ERR_TYPE_MISMATCH). One line for each class, property and
    // reason, oldest first, until cleared.
    std::vector<std::string> refused_properties() const;
    void clear_refused_properties();

    // Reading user input as the command line does. parse_object_path()
    // parses, checks that the class is known and types the keys;
    // parse_argument() reads "NAME=TYPE:VALUE", or "NAME=VALUE" with the type
    // of the method's parameter from its class. False with a one-line
    // reason for unknown classes and untyped or mistyped values.
    bool parse_object_path(const std::string& text, Object_Path& path, std::string& err) const;
    bool parse_argument(const Object_Path& path, const std::string& method,
                        const std::string& text, Property& arg, std::string& err) const;

    // Raw access for tests that talk CMPI themselves.
    const CMPIBroker* broker() const;
    // Number of CMPI objects alive now (released ones excluded); 0 between
    // operations if nothing leaked into the global scope. Objects that an
    // attached thread makes count until it detaches.
    size_t live_objects() const;

private:
    Host_Impl* impl;
};

} // namespace cimhost
} // namespace OLMA

#endif // _OLMA_cimhost_h
