#include <cstring>
#include <new>
#include "Value.h"
#include "Instance.h"
#include "Strings.h"
#include "log.h"

namespace OLMA
{

const char* const _scalar_names[15] =
{
    "boolean", "uint8", "sint8", "uint16", "sint16", "uint32", "sint32",
    "uint64", "sint64", "real32", "real64", "char16", "string", "datetime",
    "instance",
};

const char* const _array_names[15] =
{
    "boolean_array", "uint8_array", "sint8_array", "uint16_array",
    "sint16_array", "uint32_array", "sint32_array", "uint64_array",
    "sint64_array", "real32_array", "real64_array", "char16_array",
    "string_array", "datetime_array", "instance_array",
};

static const char* const _upper_scalar_names[15] =
{
    "BOOLEAN", "UINT8", "SINT8", "UINT16", "SINT16", "UINT32", "SINT32",
    "UINT64", "SINT64", "REAL32", "REAL64", "CHAR16", "STRING", "DATETIME",
    "INSTANCE",
};

static const char* const _upper_array_names[15] =
{
    "BOOLEAN_ARRAY", "UINT8_ARRAY", "SINT8_ARRAY", "UINT16_ARRAY",
    "SINT16_ARRAY", "UINT32_ARRAY", "SINT32_ARRAY", "UINT64_ARRAY",
    "SINT64_ARRAY", "REAL32_ARRAY", "REAL64_ARRAY", "CHAR16_ARRAY",
    "STRING_ARRAY", "DATETIME_ARRAY", "INSTANCE_ARRAY",
};

static inline bool _is_array(Value::Type t)
{
    return t != Value::NONE && (t & Value::ARRAY_FLAG);
}

static inline int _element(Value::Type t)
{
    return t & ~Value::ARRAY_FLAG;
}

static bool _valid(Value::Type t)
{
    if (t == Value::NONE)
        return true;
    int e = _element(t);
    return e >= 0 && e <= Value::INSTANCE;
}

const char* _type_name(Value::Type type)
{
    if (type == Value::NONE || !_valid(type))
        return "NONE";
    return _is_array(type) ? _upper_array_names[_element(type)] :
        _upper_scalar_names[type];
}

const char* name_of(Value::Type type)
{
    if (type == Value::NONE || !_valid(type))
        return "none";
    return _is_array(type) ? _array_names[_element(type)] : _scalar_names[type];
}

// Arrays of instances hold one reference per non-null element.
static void _ref_elements(const __Array_Rep* rep)
{
    Instance* const* p = reinterpret_cast<Instance* const*>(rep->data());
    for (size_t i = 0; i < rep->size; i++)
    {
        if (p[i])
            ref(p[i]);
    }
}

static void _unref_elements(const __Array_Rep* rep)
{
    Instance* const* p = reinterpret_cast<Instance* const*>(rep->data());
    for (size_t i = 0; i < rep->size; i++)
        unref(p[i]);
}

Value::Value() : type(NONE), null(0)
{
    memset(_data, 0, sizeof(_data));
}

Value::Value(const Value& x) : type(NONE), null(0)
{
    memset(_data, 0, sizeof(_data));
    _copy(x);
}

Value::~Value()
{
    _destruct();
}

Value& Value::operator=(const Value& x)
{
    if (&x != this)
    {
        _destruct();
        _copy(x);
    }
    return *this;
}

void Value::_copy(const Value& x)
{
    type = x.type;
    null = x.null;

    if (_is_array(type))
    {
        __Array_Rep*& rep = _as<__Array_Rep*>();
        __construct(rep, x._as<__Array_Rep*>());
        if (type == INSTANCE_ARRAY)
            _ref_elements(rep);
        return;
    }

    switch (type)
    {
        case STRING:
            new (_data) String(x._as<String>());
            break;
        case DATETIME:
            new (_data) Datetime(x._as<Datetime>());
            break;
        case INSTANCE:
            _as<Instance*>() = x._as<Instance*>();
            if (_as<Instance*>())
                ref(_as<Instance*>());
            break;
        default:
            memcpy(_data, x._data, sizeof(_data));
            break;
    }
}

void Value::_destruct()
{
    if (_is_array(type))
    {
        __Array_Rep* rep = _as<__Array_Rep*>();
        if (type == INSTANCE_ARRAY)
            _unref_elements(rep);
        __destruct(rep);
    }
    else if (type == STRING)
        _as<String>().~String();
    else if (type == DATETIME)
        _as<Datetime>().~Datetime();
    else if (type == INSTANCE)
        unref(_as<Instance*>());

    memset(_data, 0, sizeof(_data));
    type = NONE;
}

void Value::clear()
{
    _destruct();
    null = 1;
}

template<class T>
void Value::_set_scalar(Type t, const T& x)
{
    // x may live inside this value.
    T tmp(x);
    clear();
    new (_data) T(tmp);
    type = t;
    null = 0;
}

template<class T>
int Value::_get_scalar(Type t, T& x) const
{
    if (type != t)
        return -1;
    x = _as<T>();
    return 0;
}

template<class T>
void Value::_set_array(Type t, const Array<T>& x)
{
    __Array_Rep* rep;
    __construct(rep, x._rep);
    clear();
    _as<__Array_Rep*>() = rep;
    type = t;
    null = 0;
}

template<class T>
int Value::_get_array(Type t, Array<T>& x) const
{
    if (type != t)
        return -1;
    __assign(x._rep, _as<__Array_Rep*>());
    return 0;
}

#define OLMA_VALUE_SCALAR(T, TYPE) \
    void Value::set_value(const T& x) { _set_scalar(TYPE, x); } \
    int Value::get_value(T& x) const { return _get_scalar(TYPE, x); } \
    void Value::set_value(const Array<T>& x) { _set_array(TYPE##_ARRAY, x); } \
    int Value::get_value(Array<T>& x) const { return _get_array(TYPE##_ARRAY, x); }

OLMA_VALUE_SCALAR(boolean, BOOLEAN)
OLMA_VALUE_SCALAR(uint8, UINT8)
OLMA_VALUE_SCALAR(sint8, SINT8)
OLMA_VALUE_SCALAR(uint16, UINT16)
OLMA_VALUE_SCALAR(sint16, SINT16)
OLMA_VALUE_SCALAR(uint32, UINT32)
OLMA_VALUE_SCALAR(sint32, SINT32)
OLMA_VALUE_SCALAR(uint64, UINT64)
OLMA_VALUE_SCALAR(sint64, SINT64)
OLMA_VALUE_SCALAR(real32, REAL32)
OLMA_VALUE_SCALAR(real64, REAL64)
OLMA_VALUE_SCALAR(char16, CHAR16)
OLMA_VALUE_SCALAR(String, STRING)
OLMA_VALUE_SCALAR(Datetime, DATETIME)

#undef OLMA_VALUE_SCALAR

void Value::set_value(const char* x)
{
    _set_scalar(STRING, String(x ? x : ""));
}

void Value::set_value(Instance* x)
{
    clear();
    _as<Instance*>() = x;
    type = INSTANCE;
    null = 0;
}

int Value::get_value(Instance*& x) const
{
    if (type != INSTANCE)
        return -1;
    x = _as<Instance*>();
    return 0;
}

void Value::set_value(const Array<Instance*>& x)
{
    _set_array(INSTANCE_ARRAY, x);
}

int Value::get_value(Array<Instance*>& x) const
{
    return _get_array(INSTANCE_ARRAY, x);
}

Value::Type Value::type_of(const Meta_Feature* feature)
{
    if (!feature)
        return NONE;

    if (feature->flags & FLAG_REFERENCE)
    {
        const Meta_Reference* mr = (const Meta_Reference*)feature;
        return mr->subscript ? INSTANCE_ARRAY : INSTANCE;
    }

    if (feature->flags & FLAG_PROPERTY)
    {
        const Meta_Property* mp = (const Meta_Property*)feature;
        if (mp->type >= NUM_TYPES)
            return NONE;
        return Type(mp->subscript ? (mp->type | ARRAY_FLAG) : mp->type);
    }

    return NONE;
}

int Value::set(const Instance* instance, const Meta_Feature* feature)
{
    clear();

    if (!instance || !feature)
        return -1;

    Type t = type_of(feature);
    if (t == NONE)
        return -1;

    if (feature->flags & FLAG_REFERENCE)
    {
        const Meta_Reference* mr = (const Meta_Reference*)feature;
        void* slot = __slot(instance, mr->offset);

        if (t == INSTANCE)
        {
            Instance* p = *(Instance**)slot;
            if (p)
                ref(p);
            _as<Instance*>() = p;
            null = p ? 0 : 1;
        }
        else
        {
            __Array_Rep*& rep = _as<__Array_Rep*>();
            __construct(rep, *(__Array_Rep**)slot);
            _ref_elements(rep);
            null = *((uint8*)slot + sizeof(void*));
        }
        type = t;
        return 0;
    }

    const Meta_Property* mp = (const Meta_Property*)feature;
    void* slot = __slot(instance, mp->offset);
    null = __null_of(instance, mp);

    if (_is_array(t))
        __construct(_as<__Array_Rep*>(), *(__Array_Rep**)slot);
    else if (t == STRING)
        new (_data) String(*(String*)slot);
    else if (t == DATETIME)
        new (_data) Datetime(*(Datetime*)slot);
    else
        memcpy(_data, slot, type_size[mp->type]);

    type = t;
    return 0;
}

// The instance must be of the reference's class or derived from it.
static bool _assignable(
    const Instance* target, const Meta_Reference* mr, const Instance* x)
{
    if (!x || is_subclass(mr->meta_class, x->meta_class))
        return true;

    TLOG(LL_WARN, "failed to assign instance of %s to %s.%s",
        x->meta_class ? x->meta_class->name : "?",
        target->meta_class ? target->meta_class->name : "?", mr->name);
    return false;
}

int Value::get(Instance* instance, const Meta_Feature* feature) const
{
    if (!instance)
    {
        TLOG(LL_WARN, "null instance argument");
        return -1;
    }

    if (!feature)
        return -1;

    Type t = type_of(feature);

    if (t == NONE)
        return -1;

    if (t != type)
    {
        TLOG(LL_WARN, "type mismatch: %s.%s",
            instance->meta_class ? instance->meta_class->name : "?", feature->name);
        return -1;
    }

    if (feature->flags & FLAG_REFERENCE)
    {
        const Meta_Reference* mr = (const Meta_Reference*)feature;
        void* slot = __slot(instance, mr->offset);

        if (t == INSTANCE)
        {
            Instance* x = _as<Instance*>();
            if (!_assignable(instance, mr, x))
                return -1;
            Instance*& p = *(Instance**)slot;
            if (x)
                ref(x);
            unref(p);
            p = x;
            return 0;
        }

        // A reference array: rebuilt element by element, so that the ones
        // already placed stay when a later one is refused.
        __Array_Rep*& rep = *(__Array_Rep**)slot;
        _unref_elements(rep);
        __remove(rep, 0, rep->size);
        *((uint8*)slot + sizeof(void*)) = null;

        const __Array_Rep* src = _as<__Array_Rep*>();
        Instance* const* p = reinterpret_cast<Instance* const*>(src->data());

        for (size_t i = 0; i < src->size; i++)
        {
            if (!_assignable(instance, mr, p[i]))
                return -1;
            if (p[i])
                ref(p[i]);
            __append(rep, &p[i], 1);
        }
        return 0;
    }

    const Meta_Property* mp = (const Meta_Property*)feature;
    void* slot = __slot(instance, mp->offset);
    __null_of(instance, mp) = null;

    if (_is_array(t))
        __assign(*(__Array_Rep**)slot, _as<__Array_Rep*>());
    else if (t == STRING)
        *(String*)slot = _as<String>();
    else if (t == DATETIME)
        *(Datetime*)slot = _as<Datetime>();
    else
        memcpy(slot, _data, type_size[mp->type]);

    return 0;
}

static void _fprint_scalar(FILE* os, int t, const void* p)
{
    switch (t)
    {
        case Value::BOOLEAN:
            fprintf(os, "%s", *(const boolean*)p ? "true" : "false");
            break;
        case Value::UINT8:
            fprintf(os, "%u", *(const uint8*)p);
            break;
        case Value::SINT8:
            fprintf(os, "%d", *(const sint8*)p);
            break;
        case Value::UINT16:
            fprintf(os, "%u", *(const uint16*)p);
            break;
        case Value::SINT16:
            fprintf(os, "%d", *(const sint16*)p);
            break;
        case Value::UINT32:
            fprintf(os, "%u", *(const uint32*)p);
            break;
        case Value::SINT32:
            fprintf(os, "%d", *(const sint32*)p);
            break;
        case Value::UINT64:
            fprintf(os, "%llu", *(const uint64*)p);
            break;
        case Value::SINT64:
            fprintf(os, "%lld", *(const sint64*)p);
            break;
        case Value::REAL32:
            fprintf(os, "%f", *(const real32*)p);
            break;
        case Value::REAL64:
            fprintf(os, "%f", *(const real64*)p);
            break;
        case Value::CHAR16:
        {
            uint16 c = ((const char16*)p)->code();
            if (c >= 32 && c <= 126)
                fprintf(os, "'%c'", (char)c);
            else
                fprintf(os, "0x%04X", c);
            break;
        }
        case Value::STRING:
            fprint_string(os, ((const String*)p)->c_str());
            break;
        case Value::DATETIME:
            fprintf(os, "\"%s\"", ((const Datetime*)p)->ascii(false).c_str());
            break;
    }
}

void Value::fprint(FILE* os) const
{
    fprintf(os, "Value\n{\n");
    fprintf(os, "    type=%s\n", _type_name(type));
    fprintf(os, "    null=%s\n", null ? "true" : "false");

    if (null)
    {
        fprintf(os, "    value= NONE\n");
        return;
    }

    fprintf(os, "    value=");

    if (type == INSTANCE)
    {
        if (_as<Instance*>())
        {
            fprintf(os, "\n");
            OLMA::fprint(os, _as<Instance*>(), false);
        }
        else
            fprintf(os, "NULL\n");
    }
    else if (type == INSTANCE_ARRAY)
    {
        const __Array_Rep* rep = _as<__Array_Rep*>();
        Instance* const* p = reinterpret_cast<Instance* const*>(rep->data());
        fprintf(os, "\n    {\n");
        for (size_t i = 0; i < rep->size; i++)
        {
            if (p[i])
                OLMA::fprint(os, p[i], false);
            else
                fprintf(os, "        NULL\n");
        }
        fprintf(os, "    }\n");
    }
    else if (_is_array(type))
    {
        const __Array_Rep* rep = _as<__Array_Rep*>();
        size_t size = rep->traits->size;
        if (rep->size == 0)
            fprintf(os, "{ }");
        else
        {
            fprintf(os, "{ ");
            for (size_t i = 0; i < rep->size; i++)
            {
                if (i)
                    fprintf(os, ", ");
                _fprint_scalar(os, _element(type), rep->data() + i * size);
            }
            fprintf(os, " }");
        }
        fprintf(os, "\n");
    }
    else if (type != NONE)
    {
        _fprint_scalar(os, type, _data);
        fprintf(os, "\n");
    }
    else
        fprintf(os, "NONE\n");

    fprintf(os, "}\n");
}

void Value::print() const
{
    fprint(stdout);
}

} // namespace OLMA
