// Class knowledge for the host: the hierarchy (classPathIsA, isOfType, which
// association providers to ask), keys, property and parameter types (typing
// the arguments of `cm`), and what an instance may hold. A CIM server knows
// its classes from the MOF compiled into its repository, whatever a provider
// module thinks of them; so do we, from a description that
// tools/gen_cimhost_classes.py compiles from the same MOF.

#include "internal.h"

namespace OLMA
{
namespace cimhost
{

namespace
{

// Enough for every class and property a provider gets wrong, without letting
// a runaway provider grow the list without end.
const size_t MAX_REFUSALS = 256;

Feature_Info feature_of(const Feature_Desc& d)
{
    Feature_Info fi;
    fi.name = d.name;
    fi.type = d.type;
    fi.key = (d.flags & FD_KEY) != 0;
    fi.in = (d.flags & FD_IN) != 0;
    fi.out = (d.flags & FD_OUT) != 0;
    fi.embedded = (d.flags & FD_EMBEDDED) != 0;
    fi.reference = (d.type & ~CMPI_ARRAY) == CMPI_ref;
    if (d.ref_class)
        fi.ref_class = d.ref_class;
    return fi;
}

Method_Info method_of(const Feature_Desc& d)
{
    Method_Info mi;
    mi.name = d.name;
    mi.return_type = d.type;
    mi.is_static = (d.flags & FD_STATIC) != 0;
    for (size_t i = 0; i < d.num_params; i++)
        mi.params.push_back(feature_of(d.params[i]));
    return mi;
}

template <class T>
void put(std::vector<T>& items, const T& item)
{
    for (T& x : items)
        if (name_eq(x.name, item.name))
        {
            x = item;
            return;
        }
    items.push_back(item);
}

std::string shown(CMPIType t)
{
    std::string name = type_name(t);
    return name.empty() ? "type " + std::to_string(t) : name;
}

// Whether a value of `given` type fits a property declared as `f`.
bool fits(const Feature_Info& f, CMPIType given)
{
    if (given == f.type)
        return true;
    // An embedded instance or object is declared a string and travels as an
    // instance.
    CMPIType array = f.type & CMPI_ARRAY;
    return f.embedded && given == CMPIType(CMPI_instance | array);
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

void Catalogue::load(const Class_Table& table)
{
    for (size_t i = 0; i < table.num_classes; i++)
    {
        const Class_Desc& cd = table.classes[i];
        const Class_Info* parent = cd.super ? find(cd.super) : nullptr;
        Class_Info ci;
        if (parent)
        {
            ci = *parent;
            ci.super = parent->name;
        }
        ci.name = cd.name;
        ci.declared = true;
        // Kinds pass to subclasses, as the qualifiers do.
        ci.association = ci.association || (cd.kind & CD_ASSOCIATION);
        ci.indication = ci.indication || (cd.kind & CD_INDICATION);
        for (size_t k = 0; k < cd.num_features; k++)
        {
            const Feature_Desc& fd = cd.features[k];
            if (fd.flags & FD_METHOD)
                put(ci.methods, method_of(fd));
            else
                put(ci.features, feature_of(fd));
        }
        classes[lower(ci.name)] = ci;
    }
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

CMPIrc Catalogue::check_property(const std::string& cls, const std::string& name,
                                 CMPIType type) const
{
    const Class_Info* ci = find(cls);
    if (!ci || !ci->declared)
        return CMPI_RC_OK;
    const Feature_Info* f = ci->feature(name);
    std::string why;
    CMPIrc rc = CMPI_RC_OK;
    if (!f)
    {
        rc = CMPI_RC_ERR_NO_SUCH_PROPERTY;
        why = "the class doesn't declare it";
    }
    else if (type != CMPI_null && !fits(*f, type))
    {
        rc = CMPI_RC_ERR_TYPE_MISMATCH;
        why = "declared " + shown(f->type) + ", given " + shown(type);
    }
    if (rc == CMPI_RC_OK)
        return rc;
    std::string line =
        "Property " + name + " not set on the created instance of class " + ci->name + ": " + why;
    std::lock_guard<std::mutex> g(refusal_mutex);
    bool known = false;
    for (const std::string& r : refusals)
        known = known || r == line;
    if (!known && refusals.size() < MAX_REFUSALS)
        refusals.push_back(line);
    return rc;
}

std::vector<std::string> Catalogue::refused_properties() const
{
    std::lock_guard<std::mutex> g(refusal_mutex);
    return refusals;
}

void Catalogue::clear_refused_properties()
{
    std::lock_guard<std::mutex> g(refusal_mutex);
    refusals.clear();
}

} // namespace cimhost
} // namespace OLMA
