#include "Container.h"
#include "Instance.h"
#include "log.h"

namespace OLMA
{

Container::Container(const Meta_Repository* meta_repository_)
    : meta_repository(meta_repository_)
{
}

Container::~Container()
{
}

// A method's parameter record is described by a Meta_Method, which shares
// the head of a Meta_Class; find the feature by the right overload.
static const Meta_Feature* _find(const Meta_Class* mc, const char* name, uint32 mask)
{
    if (mc->flags & FLAG_METHOD)
        return find_feature((const Meta_Method*)mc, name, mask);
    return find_feature(mc, name, mask);
}

int Container::convert(const Meta_Class* meta_class, uint32 flags, Instance*& instance)
{
    if (!instance)
    {
        if (!meta_class)
            return -1;

        if (meta_class->flags & FLAG_METHOD)
            instance = create((const Meta_Method*)meta_class);
        else
            instance = create(meta_class, false);

        if (!instance)
            return -1;
    }

    const Meta_Class* mc = instance->meta_class;
    __set_null_flags(instance, true, true, 1);

    size_t size = get_size();

    for (size_t i = 0; i < size; i++)
    {
        String name;

        if (get_name(i, name) != 0)
        {
            TLOG(LL_WARN, "get_name() failed: class=%s, index=%u", mc->name, (unsigned)i);
            continue;
        }

        const Meta_Feature* mf = _find(mc, name.c_str(), FLAG_PROPERTY | FLAG_REFERENCE);

        if (!mf)
        {
            TLOG(LL_WARN, "unknown feature: %s.%s", mc->name, name.c_str());
            continue;
        }

        if (flags && !(mf->flags & flags))
            continue;

        Value::Type type = Value::type_of(mf);

        if (type == Value::NONE)
        {
            TLOG(LL_WARN, "unexpected error: %s.%s", mc->name, name.c_str());
            continue;
        }

        Value value;

        if (get_value(i, type, value) != 0 || value.get(instance, mf) != 0)
        {
            TLOG(LL_WARN, "conversion error: %s.%s", mc->name, name.c_str());
            continue;
        }
    }

    return 0;
}

int Container::convert(const Instance* instance, uint32 flags)
{
    if (!instance)
    {
        TLOG(LL_WARN, "ignored null instance arg");
        return -1;
    }

    const Meta_Class* mc = instance->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (flags && !(mf->flags & flags))
            continue;

        if (mf->flags & FLAG_METHOD)
            continue;

        if (mf->flags & FLAG_REFERENCE)
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;
            const char* slot = (const char*)__slot(instance, mr->offset);

            if (mr->subscript == 0)
            {
                if (!*(Instance* const*)slot)
                    continue;
            }
            else if (slot[sizeof(void*)])
                continue;
        }
        else if (__null_of(instance, (const Meta_Property*)mf))
            continue;

        Value value;

        if (value.set(instance, mf) != 0)
        {
            TLOG(LL_WARN, "unexpected failure: %s.%s", mc->name, mf->name);
            continue;
        }

        if (set_value(mf->name, value, mf->flags) != 0)
        {
            TLOG(LL_WARN, "conversion error: %s.%s", mc->name, mf->name);
            continue;
        }
    }

    return 0;
}

} // namespace OLMA
