// The text form of an instance's keys: <class>.<key>=<value>,<key>=<value>.
// Alert indications carry it as the path of the alerting element, and a
// reference key nests the referenced instance's path as a string literal.

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include "Instance.h"
#include "Strings.h"

namespace OLMA
{

//
// Writing
//

static int _append_value(String& out, const Instance* instance, const Meta_Property* mp)
{
    if (mp->subscript || mp->type >= NUM_TYPES || __null_of(instance, mp))
        return -1;

    const void* p = __slot(instance, mp->offset);
    char buf[64];

    switch (mp->type)
    {
        case BOOLEAN:
            out.append(*(const uint8*)p ? "true" : "false");
            return 0;
        case UINT8:
            snprintf(buf, sizeof(buf), "%u", *(const uint8*)p);
            break;
        case SINT8:
            snprintf(buf, sizeof(buf), "%d", *(const sint8*)p);
            break;
        case UINT16:
            snprintf(buf, sizeof(buf), "%u", *(const uint16*)p);
            break;
        case SINT16:
            snprintf(buf, sizeof(buf), "%d", *(const sint16*)p);
            break;
        case UINT32:
            snprintf(buf, sizeof(buf), "%u", *(const uint32*)p);
            break;
        case SINT32:
            snprintf(buf, sizeof(buf), "%d", *(const sint32*)p);
            break;
        case UINT64:
            snprintf(buf, sizeof(buf), "%llu", *(const uint64*)p);
            break;
        case SINT64:
            snprintf(buf, sizeof(buf), "%lld", *(const sint64*)p);
            break;
        case REAL32:
            out.append(string_printf("%f", *(const real32*)p));
            return 0;
        case REAL64:
            out.append(string_printf("%f", *(const real64*)p));
            return 0;
        case CHAR16:
            snprintf(buf, sizeof(buf), "'%c'", (int)*(const uint16*)p);
            break;
        case STRING:
            out.append('"');
            out.append(*(const String*)p);
            out.append('"');
            return 0;
        case DATETIME:
            out.append(((const Datetime*)p)->ascii(false));
            return 0;
        default:
            return -1;
    }

    out.append(buf);
    return 0;
}

int instance_to_model_path(const Instance* instance, String& out)
{
    out.clear();

    if (!instance)
        return -1;

    const Meta_Class* mc = instance->meta_class;

    if (mc->num_keys == 0)
        return -1;

    out.append(mc->name);
    out.append('.');

    size_t n = 0;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (!(mf->flags & FLAG_KEY) || !(mf->flags & (FLAG_PROPERTY | FLAG_REFERENCE)))
            continue;

        out.append(mf->name);
        out.append('=');

        if (mf->flags & FLAG_PROPERTY)
        {
            if (_append_value(out, instance, (const Meta_Property*)mf) != 0)
                return -1;
        }
        else
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;

            if (mr->subscript)
                return -1;

            const Instance* x = *(Instance* const*)__slot(instance, mr->offset);
            String path;

            if (!x || instance_to_model_path(x, path) != 0)
                return -1;

            out.append('"');

            for (size_t j = 0; j < path.size(); j++)
            {
                if (path[j] == '"')
                    out.append('\\');
                out.append(path[j]);
            }

            out.append('"');
        }

        if (++n < mc->num_keys)
            out.append(',');
    }

    return 0;
}

//
// Reading. Paths come from clients and events, so anything malformed is
// refused with a null result rather than guessed at.
//

static bool _parse_ident(const char*& p, String& ident)
{
    const char* start = p;

    if (!((*p >= 'A' && *p <= 'Z') || (*p >= 'a' && *p <= 'z') || *p == '_'))
        return false;

    while ((*p >= 'A' && *p <= 'Z') || (*p >= 'a' && *p <= 'z') || (*p >= '0' && *p <= '9') ||
        *p == '_')
        p++;

    ident.assign(start, p - start);
    return true;
}

// A double-quoted literal in which only \" and \\ are escapes.
static bool _parse_literal(const char*& p, String& value)
{
    if (*p != '"')
        return false;

    p++;
    value.clear();

    for (;;)
    {
        if (*p == '\0')
            return false;

        if (*p == '"')
        {
            p++;
            return true;
        }

        if (*p == '\\')
        {
            p++;

            if (*p != '"' && *p != '\\')
                return false;
        }

        value.append(*p++);
    }
}

static inline bool _at_end_of_value(const char* p)
{
    return *p == ',' || *p == '\0';
}

static bool _parse_boolean(const char*& p, uint8& x)
{
    const char* end = p;

    while (!_at_end_of_value(end))
        end++;

    const size_t n = end - p;

    if (n == 4 && strncasecmp(p, "true", 4) == 0)
        x = 1;
    else if (n == 5 && strncasecmp(p, "false", 5) == 0)
        x = 0;
    else
        return false;

    p = end;
    return true;
}

// Decimal first; if that stops short of the value's end, hexadecimal (so
// "0x10" is 16). Unsigned types read the whole 64-bit range.
static bool _parse_integer(const char*& p, bool is_signed, uint64& x)
{
    for (int base = 10; base <= 16; base += 6)
    {
        char* end = 0;
        errno = 0;
        uint64 v = is_signed ? (uint64)strtoll(p, &end, base) : strtoull(p, &end, base);

        if (end != p && _at_end_of_value(end) && errno == 0)
        {
            x = v;
            p = end;
            return true;
        }
    }

    return false;
}

static void _store_integer(void* slot, Type type, uint64 v)
{
    switch (type)
    {
        case UINT8:
        case SINT8:
        {
            uint8 x = (uint8)v;
            memcpy(slot, &x, sizeof(x));
            break;
        }
        case UINT16:
        case SINT16:
        {
            uint16 x = (uint16)v;
            memcpy(slot, &x, sizeof(x));
            break;
        }
        case UINT32:
        case SINT32:
        {
            uint32 x = (uint32)v;
            memcpy(slot, &x, sizeof(x));
            break;
        }
        default:
            memcpy(slot, &v, sizeof(v));
            break;
    }
}

static bool _parse_property(const char*& p, Instance* instance, const Meta_Property* mp)
{
    if (mp->subscript)
        return false;

    void* slot = __slot(instance, mp->offset);

    switch (mp->type)
    {
        case STRING:
        {
            String s;

            if (!_parse_literal(p, s))
                return false;

            *(String*)slot = s;
            break;
        }
        case BOOLEAN:
        {
            uint8 x;

            if (!_parse_boolean(p, x))
                return false;

            *(uint8*)slot = x;
            break;
        }
        case UINT8:
        case UINT16:
        case UINT32:
        case UINT64:
        case SINT8:
        case SINT16:
        case SINT32:
        case SINT64:
        {
            const bool is_signed =
                mp->type == SINT8 || mp->type == SINT16 || mp->type == SINT32 || mp->type == SINT64;
            uint64 v;

            if (!_parse_integer(p, is_signed, v))
                return false;

            _store_integer(slot, (Type)mp->type, v);
            break;
        }
        default:
            return false;
    }

    __null_of(instance, mp) = 0;
    return true;
}

static bool _parse_reference(const char*& p, Instance* instance, const Meta_Reference* mr)
{
    if (mr->subscript)
        return false;

    String path;

    if (!_parse_literal(p, path))
        return false;

    Instance* x = model_path_to_instance(mr->meta_class, path.c_str());

    if (!x)
        return false;

    // The repository would find any class; a reference must point at the
    // class it was declared with or a subclass of it.
    if (!is_subclass(mr->meta_class, x->meta_class))
    {
        unref(x);
        return false;
    }

    Instance*& slot = *(Instance**)__slot(instance, mr->offset);
    unref(slot);
    slot = x;
    return true;
}

static bool _parse_keys(const char* p, Instance* instance)
{
    const Meta_Class* mc = instance->meta_class;

    // A key named twice would let a path pass the count with a key missing.
    uint8 seen_small[64] = { 0 };
    uint8* seen = mc->num_meta_features <= sizeof(seen_small)
        ? seen_small
        : (uint8*)calloc(mc->num_meta_features, 1);
    size_t n = 0;
    bool ok = false;

    while (*p)
    {
        String name;

        if (!_parse_ident(p, name))
            goto done;

        const Meta_Feature* mf = find_feature(mc, name.c_str(), FLAG_ANY_FEATURE);

        if (!mf || !(mf->flags & FLAG_KEY))
            goto done;

        const ssize_t index = find_feature_index(mc, mf);

        if (index < 0 || seen[index])
            goto done;

        seen[index] = 1;
        n++;

        if (*p++ != '=')
            goto done;

        if (mf->flags & FLAG_REFERENCE)
        {
            if (!_parse_reference(p, instance, (const Meta_Reference*)mf))
                goto done;
        }
        else if (mf->flags & FLAG_PROPERTY)
        {
            if (!_parse_property(p, instance, (const Meta_Property*)mf))
                goto done;
        }
        else
            goto done;

        if (*p == ',')
        {
            p++;

            if (*p == '\0')
                goto done;
        }
        else if (*p != '\0')
            goto done;
    }

    ok = n == mc->num_keys;

done:
    if (seen != seen_small)
        free(seen);

    return ok;
}

Instance* model_path_to_instance(const Meta_Class* meta_class, const char* path)
{
    if (!meta_class || !path)
        return 0;

    const char* p = path;
    String class_name;

    if (!_parse_ident(p, class_name))
        return 0;

    const Meta_Class* mc = find_meta_class(meta_class, class_name.c_str());

    if (!mc || (mc->flags & FLAG_METHOD) || *p != '.')
        return 0;

    p++;

    Instance* instance = create(mc, false);
    __set_null_flags(instance, false, true, 1);

    if (!_parse_keys(p, instance))
    {
        unref(instance);
        return 0;
    }

    return instance;
}

//
// Property values from text
//

template<class T>
static int _put(Instance* instance, const Meta_Property* mp, int (*convert)(const char*, T&),
    const char* str)
{
    T x;

    if (convert(str, x) != 0)
        return -1;

    void* slot = __slot(instance, mp->offset);

    if (mp->subscript)
        __append(*(__Array_Rep**)slot, &x, 1);
    else
        *(T*)slot = x;

    return 0;
}

static int _str_to_char16(const char* str, char16& x)
{
    x = char16((uint16)(uint8)str[0]);
    return 0;
}

static int _str_to_string(const char* str, String& x)
{
    x.assign(str);
    return 0;
}

static int _str_to_datetime(const char* str, Datetime& x)
{
    return x.set(str) ? 0 : -1;
}

int __put_property_from_str(Instance* instance, const Meta_Property* mp, const char* str)
{
    if (!instance || !mp || !str || !(mp->flags & FLAG_PROPERTY))
        return -1;

    __null_of(instance, mp) = 0;

    switch (mp->type)
    {
        case BOOLEAN:
            return _put<boolean>(instance, mp, str_to_boolean, str);
        case UINT8:
            return _put<uint8>(instance, mp, str_to_uint8, str);
        case SINT8:
            return _put<sint8>(instance, mp, str_to_sint8, str);
        case UINT16:
            return _put<uint16>(instance, mp, str_to_uint16, str);
        case SINT16:
            return _put<sint16>(instance, mp, str_to_sint16, str);
        case UINT32:
            return _put<uint32>(instance, mp, str_to_uint32, str);
        case SINT32:
            return _put<sint32>(instance, mp, str_to_sint32, str);
        case UINT64:
            return _put<uint64>(instance, mp, str_to_uint64, str);
        case SINT64:
            return _put<sint64>(instance, mp, str_to_sint64, str);
        case REAL32:
            return _put<real32>(instance, mp, str_to_real32, str);
        case REAL64:
            return _put<real64>(instance, mp, str_to_real64, str);
        case CHAR16:
            return _put<char16>(instance, mp, _str_to_char16, str);
        case STRING:
            return _put<String>(instance, mp, _str_to_string, str);
        case DATETIME:
            return _put<Datetime>(instance, mp, _str_to_datetime, str);
    }

    return -1;
}

} // namespace OLMA
