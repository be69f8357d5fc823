// Class knowledge for the host: the hierarchy (classPathIsA, isOfType, which
// association providers to ask) and property and parameter types (typing the
// arguments of `cm`). Our module describes its classes in static tables that
// it reaches through `tessel_module`; we read those tables in place. The
// records are mirrored here rather than included so that the host builds
// without the runtime, and every walk is bounded, because a module is a
// foreign library whose tables we only trust as far as we check them.

#include <cstring>
#include <dlfcn.h>
#include <set>

#include "internal.h"

namespace OLMA
{
namespace cimhost
{

namespace
{

// The plain layout of the module's meta records (see runtime/Meta_Class.h).
struct M_Head
{
    uint32_t refs;
    uint32_t flags;
    const char* name;
    void** meta_qualifiers;
    size_t num_meta_qualifiers;
};

struct M_Feature : M_Head
{
};

struct M_Property : M_Head
{
    uint16_t type;
    int16_t subscript;
    uint32_t offset;
    const void* value;
};

struct M_Class;

struct M_Reference : M_Head
{
    int16_t subscript;
    const M_Class* meta_class;
    uint32_t offset;
};

struct M_Method : M_Head
{
    M_Feature** meta_features;
    size_t num_meta_features;
    uint32_t size;
    uint16_t return_type;
};

struct M_Repository;

struct M_Class : M_Head
{
    M_Feature** meta_features;
    size_t num_meta_features;
    uint32_t size;
    const uint8_t* locals;
    const M_Class* super_meta_class;
    size_t num_keys;
    const M_Repository* meta_repository;
};

struct M_Repository
{
    const M_Class* const* meta_classes;
    size_t num_meta_classes;
};

struct M_Registration
{
    const char* module_name;
    const char* provider_name;
    void* proc;
    const M_Class* meta_class;
    const M_Registration* next;
};

enum : uint32_t
{
    F_PROPERTY = 1u << 0,
    F_REFERENCE = 1u << 1,
    F_METHOD = 1u << 2,
    F_ASSOCIATION = 1u << 7,
    F_EMBEDDED_OBJECT = 1u << 12,
    F_IN = 1u << 18,
    F_INDICATION = 1u << 19,
    F_KEY = 1u << 21,
    F_OUT = 1u << 24,
    F_STATIC = 1u << 27,
    F_EMBEDDED_INSTANCE = 1u << 31,
};

const size_t MAX_ITEMS = 100000;
const size_t MAX_NAME = 256;

// The runtime's Type numbering, 0 to 13.
const CMPIType type_codes[] = {
    CMPI_boolean, CMPI_uint8,  CMPI_sint8,  CMPI_uint16, CMPI_sint16,  CMPI_uint32, CMPI_sint32,
    CMPI_uint64,  CMPI_sint64, CMPI_real32, CMPI_real64, CMPI_char16, CMPI_string, CMPI_dateTime,
};

bool good_name(const char* s)
{
    return s && *s && strnlen(s, MAX_NAME) < MAX_NAME;
}

CMPIType cmpi_type(uint16_t t)
{
    return t < sizeof(type_codes) / sizeof(type_codes[0]) ? type_codes[t] : CMPIType(0);
}

bool read_feature(const M_Feature* mf, Feature_Info& fi)
{
    if (!mf || !good_name(mf->name))
        return false;
    fi.name = mf->name;
    fi.key = (mf->flags & F_KEY) != 0;
    fi.in = (mf->flags & F_IN) != 0;
    fi.out = (mf->flags & F_OUT) != 0;
    if (mf->flags & F_PROPERTY)
    {
        const M_Property* mp = static_cast<const M_Property*>(static_cast<const M_Head*>(mf));
        CMPIType t = cmpi_type(mp->type);
        if (!t)
            return false;
        fi.type = mp->subscript ? CMPIType(t | CMPI_ARRAY) : t;
        return true;
    }
    if (mf->flags & F_REFERENCE)
    {
        const M_Reference* mr = static_cast<const M_Reference*>(static_cast<const M_Head*>(mf));
        bool embedded = (mf->flags & (F_EMBEDDED_OBJECT | F_EMBEDDED_INSTANCE)) != 0;
        CMPIType t = embedded ? CMPIType(CMPI_instance) : CMPIType(CMPI_ref);
        fi.type = mr->subscript ? CMPIType(t | CMPI_ARRAY) : t;
        fi.reference = true;
        if (mr->meta_class && good_name(mr->meta_class->name))
            fi.ref_class = mr->meta_class->name;
        return true;
    }
    return false;
}

void read_method(const M_Method* mm, Method_Info& mi)
{
    mi.name = mm->name;
    mi.return_type = cmpi_type(mm->return_type);
    mi.is_static = (mm->flags & F_STATIC) != 0;
    if (!mm->meta_features || mm->num_meta_features > MAX_ITEMS)
        return;
    for (size_t i = 0; i < mm->num_meta_features; i++)
    {
        Feature_Info fi;
        if (read_feature(mm->meta_features[i], fi) && !name_eq(fi.name, "return_value"))
            mi.params.push_back(fi);
    }
}

} // namespace

const Feature_Info* Class_Info::feature(const std::string& n) const
{
    for (const Feature_Info& f : features)
        if (name_eq(f.name, n))
            return &f;
    return nullptr;
}

const Method_Info* Class_Info::method(const std::string& n) const
{
    for (const Method_Info& m : methods)
        if (name_eq(m.name, n))
            return &m;
    return nullptr;
}

bool Catalogue::load(void* dl_handle, std::string& err)
{
    typedef const M_Registration* (*Module_Fn)();
    void* sym = dlsym(dl_handle, "tessel_module");
    if (!sym)
    {
        err = "module has no tessel_module";
        return false;
    }
    Module_Fn fn = reinterpret_cast<Module_Fn>(sym);
    std::set<const M_Repository*> repositories;
    std::set<const M_Class*> seen;
    std::vector<const M_Class*> pending;
    size_t n = 0;
    for (const M_Registration* r = fn(); r && n < MAX_ITEMS; r = r->next, n++)
    {
        if (!r->meta_class)
            continue;
        pending.push_back(r->meta_class);
        if (r->meta_class->meta_repository)
            repositories.insert(r->meta_class->meta_repository);
    }
    for (const M_Repository* mr : repositories)
        if (mr->meta_classes && mr->num_meta_classes < MAX_ITEMS)
            for (size_t i = 0; i < mr->num_meta_classes; i++)
                pending.push_back(mr->meta_classes[i]);
    while (!pending.empty())
    {
        const M_Class* mc = pending.back();
        pending.pop_back();
        if (!mc || seen.count(mc) || seen.size() > MAX_ITEMS || !good_name(mc->name))
            continue;
        seen.insert(mc);
        Class_Info ci;
        ci.name = mc->name;
        if (mc->super_meta_class && good_name(mc->super_meta_class->name))
        {
            ci.super = mc->super_meta_class->name;
            pending.push_back(mc->super_meta_class);
        }
        ci.association = (mc->flags & F_ASSOCIATION) != 0;
        ci.indication = (mc->flags & F_INDICATION) != 0;
        if (mc->meta_features && mc->num_meta_features < MAX_ITEMS)
        {
            for (size_t i = 0; i < mc->num_meta_features; i++)
            {
                const M_Feature* mf = mc->meta_features[i];
                if (!mf || !good_name(mf->name))
                    continue;
                if (mf->flags & F_METHOD)
                {
                    Method_Info mi;
                    read_method(static_cast<const M_Method*>(static_cast<const M_Head*>(mf)), mi);
                    ci.methods.push_back(mi);
                    continue;
                }
                Feature_Info fi;
                if (read_feature(mf, fi))
                    ci.features.push_back(fi);
            }
        }
        classes[lower(ci.name)] = ci;
    }
    tables = !classes.empty();
    if (!tables)
        err = "tessel_module gave no classes";
    return tables;
}

void Catalogue::add_name_only(const std::string& name, bool association, bool indication)
{
    std::string key = lower(name);
    if (classes.count(key))
        return;
    Class_Info ci;
    ci.name = name;
    ci.association = association;
    ci.indication = indication;
    classes[key] = ci;
}

const Class_Info* Catalogue::find(const std::string& name) const
{
    auto it = classes.find(lower(name));
    return it == classes.end() ? nullptr : &it->second;
}

bool Catalogue::is_a(const std::string& cls, const std::string& ancestor) const
{
    std::string cur = cls;
    for (size_t depth = 0; depth < 64 && !cur.empty(); depth++)
    {
        if (name_eq(cur, ancestor))
            return true;
        const Class_Info* ci = find(cur);
        if (!ci)
            return false;
        cur = ci->super;
    }
    return false;
}

} // namespace cimhost
} // namespace OLMA
