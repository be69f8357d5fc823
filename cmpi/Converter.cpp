#include <cstdlib>
#include <cstring>
#include "Converter.h"
#include "CMPI_Containers.h"
#include "log.h"

namespace OLMA
{

const char* _chars(const CMPIString* str)
{
    if (!str)
        return 0;
    return CMGetCharsPtr(str, 0);
}

const char* _name_space_of(const CMPIObjectPath* object_path)
{
    if (!object_path)
        return "";
    const char* ns = _chars(CMGetNameSpace(object_path, 0));
    return ns ? ns : "";
}

const char* _class_name_of(const CMPIObjectPath* object_path)
{
    if (!object_path)
        return "";
    const char* cn = _chars(CMGetClassName(object_path, 0));
    return cn ? cn : "";
}

//
// CMPI to runtime values.
//

template<class T>
static void to_tessel_scalar_value(Value& value, const T& x, const CMPIData& data)
{
    value.clear();
    value.set_value(x);
    value.null = (data.state & CMPI_nullValue) ? 1 : 0;
}

// Strings and datetimes, whose CMPI forms are objects.
template<class T>
static int to_tessel_scalar(const CMPIData& data, T& x);

template<>
int to_tessel_scalar<String>(const CMPIData& data, String& x)
{
    if (data.type == CMPI_chars)
    {
        x.assign(data.value.chars ? data.value.chars : "");
        return 0;
    }

    if (!data.value.string)
    {
        TLOG(LL_INFO, "ignored null CMPI string");
        x.clear();
        return 0;
    }

    const char* s = CMGetCharsPtr(data.value.string, 0);

    if (!s)
    {
        TLOG(LL_WARN, "CMGetCharsPtr() failed");
        x.clear();
        return 0;
    }

    x.assign(s);
    return 0;
}

template<>
int to_tessel_scalar<Datetime>(const CMPIData& data, Datetime& x)
{
    if (!data.value.dateTime)
    {
        TLOG(LL_WARN, "CMGetStringFormat() failed");
        return -1;
    }

    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIString* str = CMGetStringFormat(data.value.dateTime, &st);

    if (st.rc != CMPI_RC_OK || !str)
    {
        TLOG(LL_WARN, "CMGetStringFormat() failed");
        return -1;
    }

    const char* s = CMGetCharsPtr(str, 0);
    bool ok = s && x.set(s);
    CMRelease(str);

    if (!ok)
    {
        TLOG(LL_WARN, "conversion error");
        return -1;
    }

    return 0;
}

// The value of a scalar element of the CMPI number types.
template<class T>
static T _number(const CMPIValue& v, CMPIType type);

#define OLMA_NUMBER(T, MEMBER) \
    template<> \
    T _number<T>(const CMPIValue& v, CMPIType) { return (T)v.MEMBER; }

OLMA_NUMBER(uint8, uint8)
OLMA_NUMBER(sint8, sint8)
OLMA_NUMBER(uint16, uint16)
OLMA_NUMBER(sint16, sint16)
OLMA_NUMBER(uint32, uint32)
OLMA_NUMBER(sint32, sint32)
OLMA_NUMBER(uint64, uint64)
OLMA_NUMBER(sint64, sint64)
OLMA_NUMBER(real32, real32)
OLMA_NUMBER(real64, real64)

#undef OLMA_NUMBER

template<>
boolean _number<boolean>(const CMPIValue& v, CMPIType)
{
    return v.boolean != 0;
}

template<>
char16 _number<char16>(const CMPIValue& v, CMPIType)
{
    return char16(v.char16);
}

template<class T>
static int _element(const CMPIData& data, T& x)
{
    x = _number<T>(data.value, data.type);
    return 0;
}

template<>
int _element<String>(const CMPIData& data, String& x)
{
    return to_tessel_scalar<String>(data, x);
}

template<>
int _element<Datetime>(const CMPIData& data, Datetime& x)
{
    return to_tessel_scalar<Datetime>(data, x);
}

template<class T>
static int to_tessel_array_value(const CMPIData& data, Value& value)
{
    const CMPIArray* array = data.value.array;

    if (!array)
        return -1;

    CMPIType element_type = data.type & ~CMPI_ARRAY;
    CMPICount n = CMGetArrayCount(array, 0);
    Array<T> result;
    result.reserve(n);

    for (CMPICount i = 0; i < n; i++)
    {
        CMPIData e = CMGetArrayElementAt(array, i, 0);

        if (e.type != element_type)
        {
            TLOG(LL_WARN, "type mismatch");
            return -1;
        }

        if (e.state & CMPI_nullValue)
        {
            TLOG(LL_WARN, "encountered null array element");
            return -1;
        }

        T x = T();

        if (_element<T>(e, x) != 0)
        {
            TLOG(LL_WARN, "conversion error");
            return -1;
        }

        result.append(x);
    }

    value.set_value(result);
    return 0;
}

static void _release_all(Array<Instance*>& a)
{
    for (size_t i = 0; i < a.size(); i++)
        unref(a[i]);
    a.clear();
}

static int _to_tessel_instance_array(const Meta_Repository* mr,
    const CMPIBroker* broker, const char* name_space, const CMPIData& data, Value& value)
{
    const CMPIArray* array = data.value.array;

    if (!array)
        return -1;

    CMPIType element_type = data.type & ~CMPI_ARRAY;
    CMPICount n = CMGetArrayCount(array, 0);
    Array<Instance*> result;

    for (CMPICount i = 0; i < n; i++)
    {
        CMPIData e = CMGetArrayElementAt(array, i, 0);

        if (e.type != element_type)
        {
            TLOG(LL_WARN, "array element type mismatch");
            _release_all(result);
            return -1;
        }

        if (e.state & CMPI_nullValue)
        {
            Instance* none = 0;
            result.append(none);
            continue;
        }

        if (element_type == CMPI_ref ? !e.value.ref : !e.value.inst)
        {
            TLOG(LL_WARN, "encountered null instance element");
            _release_all(result);
            return -1;
        }

        Instance* x = element_type == CMPI_ref ?
            _to_tessel_instance(mr, broker, name_space, e.value.ref) :
            _to_tessel_instance(mr, broker, name_space, e.value.inst);

        if (!x)
        {
            TLOG(LL_WARN, "failed to create TESSEL instance");
            _release_all(result);
            return -1;
        }

        result.append(x);
    }

    // The value takes over the references.
    value.set_value(result);
    return 0;
}

// A null CMPIData: the value gets the type of the table with an empty or
// zero content, and null set.
static int _null_value(CMPIType type, Value& value)
{
    switch (type)
    {
        case CMPI_boolean: value.set_value(boolean(false)); break;
        case CMPI_uint8: value.set_value(uint8(0)); break;
        case CMPI_sint8: value.set_value(sint8(0)); break;
        case CMPI_uint16: value.set_value(uint16(0)); break;
        case CMPI_sint16: value.set_value(sint16(0)); break;
        case CMPI_uint32: value.set_value(uint32(0)); break;
        case CMPI_sint32: value.set_value(sint32(0)); break;
        case CMPI_uint64: value.set_value(uint64(0)); break;
        case CMPI_sint64: value.set_value(sint64(0)); break;
        case CMPI_real32: value.set_value(real32(0)); break;
        case CMPI_real64: value.set_value(real64(0)); break;
        case CMPI_char16: value.set_value(char16(0)); break;
        case CMPI_chars:
        case CMPI_string: value.set_value(String()); break;
        case CMPI_dateTime: value.set_value(Datetime()); break;
        case CMPI_instance:
        case CMPI_ref: value.set_value((Instance*)0); break;
        case CMPI_booleanA: value.set_value(Array<boolean>()); break;
        case CMPI_uint8A: value.set_value(Array<uint8>()); break;
        case CMPI_sint8A: value.set_value(Array<sint8>()); break;
        case CMPI_uint16A: value.set_value(Array<uint16>()); break;
        case CMPI_sint16A: value.set_value(Array<sint16>()); break;
        case CMPI_uint32A: value.set_value(Array<uint32>()); break;
        case CMPI_sint32A: value.set_value(Array<sint32>()); break;
        case CMPI_uint64A: value.set_value(Array<uint64>()); break;
        case CMPI_sint64A: value.set_value(Array<sint64>()); break;
        case CMPI_real32A: value.set_value(Array<real32>()); break;
        case CMPI_real64A: value.set_value(Array<real64>()); break;
        case CMPI_char16A: value.set_value(Array<char16>()); break;
        case CMPI_stringA: value.set_value(Array<String>()); break;
        case CMPI_dateTimeA: value.set_value(Array<Datetime>()); break;
        case CMPI_instanceA:
        case CMPI_refA: value.set_value(Array<Instance*>()); break;
        default:
            TLOG(LL_WARN, "unknown cmpi type %u", (unsigned)type);
            return -1;
    }

    value.null = 1;
    return 0;
}

int cmpi_to_tessel_value(const Meta_Repository* mr, const CMPIBroker* broker,
    const char* name_space, const CMPIData& data, Value& value)
{
    value.clear();

    if (data.state & CMPI_nullValue)
        return _null_value(data.type, value);

    const CMPIValue& v = data.value;

    switch (data.type)
    {
        case CMPI_boolean:
            to_tessel_scalar_value(value, boolean(v.boolean != 0), data);
            return 0;
        case CMPI_uint8:
            to_tessel_scalar_value(value, uint8(v.uint8), data);
            return 0;
        case CMPI_sint8:
            to_tessel_scalar_value(value, sint8(v.sint8), data);
            return 0;
        case CMPI_uint16:
            to_tessel_scalar_value(value, uint16(v.uint16), data);
            return 0;
        case CMPI_sint16:
            to_tessel_scalar_value(value, sint16(v.sint16), data);
            return 0;
        case CMPI_uint32:
            to_tessel_scalar_value(value, uint32(v.uint32), data);
            return 0;
        case CMPI_sint32:
            to_tessel_scalar_value(value, sint32(v.sint32), data);
            return 0;
        case CMPI_uint64:
            to_tessel_scalar_value(value, uint64(v.uint64), data);
            return 0;
        case CMPI_sint64:
            to_tessel_scalar_value(value, sint64(v.sint64), data);
            return 0;
        case CMPI_real32:
            to_tessel_scalar_value(value, real32(v.real32), data);
            return 0;
        case CMPI_real64:
            to_tessel_scalar_value(value, real64(v.real64), data);
            return 0;
        case CMPI_char16:
            to_tessel_scalar_value(value, char16(v.char16), data);
            return 0;

        case CMPI_chars:
        case CMPI_string:
        {
            String s;
            to_tessel_scalar<String>(data, s);
            value.set_value(s);
            return 0;
        }

        case CMPI_dateTime:
        {
            Datetime dt;
            if (to_tessel_scalar<Datetime>(data, dt) != 0)
                return -1;
            value.set_value(dt);
            return 0;
        }

        case CMPI_instance:
        case CMPI_ref:
        {
            bool is_ref = data.type == CMPI_ref;

            if (is_ref ? !v.ref : !v.inst)
            {
                value.set_value((Instance*)0);
                return 0;
            }

            Instance* x = is_ref ?
                _to_tessel_instance(mr, broker, name_space, v.ref) :
                _to_tessel_instance(mr, broker, name_space, v.inst);

            if (!x)
            {
                TLOG(LL_WARN, "failed to create TESSEL instance");
                return -1;
            }

            value.set_value(x);
            return 0;
        }

        case CMPI_booleanA: return to_tessel_array_value<boolean>(data, value);
        case CMPI_uint8A: return to_tessel_array_value<uint8>(data, value);
        case CMPI_sint8A: return to_tessel_array_value<sint8>(data, value);
        case CMPI_uint16A: return to_tessel_array_value<uint16>(data, value);
        case CMPI_sint16A: return to_tessel_array_value<sint16>(data, value);
        case CMPI_uint32A: return to_tessel_array_value<uint32>(data, value);
        case CMPI_sint32A: return to_tessel_array_value<sint32>(data, value);
        case CMPI_uint64A: return to_tessel_array_value<uint64>(data, value);
        case CMPI_sint64A: return to_tessel_array_value<sint64>(data, value);
        case CMPI_real32A: return to_tessel_array_value<real32>(data, value);
        case CMPI_real64A: return to_tessel_array_value<real64>(data, value);
        case CMPI_char16A: return to_tessel_array_value<char16>(data, value);
        case CMPI_stringA: return to_tessel_array_value<String>(data, value);
        case CMPI_dateTimeA: return to_tessel_array_value<Datetime>(data, value);

        case CMPI_instanceA:
        case CMPI_refA:
            return _to_tessel_instance_array(mr, broker, name_space, data, value);
    }

    TLOG(LL_WARN, "unreachable");
    return -1;
}

Instance* _to_tessel_instance(const Meta_Repository* mr, const CMPIBroker* broker,
    const char* name_space, const CMPIObjectPath* object_path)
{
    if (!object_path)
    {
        TLOG(LL_WARN, "null instance");
        return 0;
    }

    const char* class_name = _chars(CMGetClassName(object_path, 0));

    if (!class_name)
    {
        TLOG(LL_WARN, "CMGetClassName() failed");
        return 0;
    }

    const Meta_Class* mc = find_meta_class(mr, class_name);

    if (!mc)
    {
        TLOG(LL_WARN, "failed to find meta class: %s", class_name);
        return 0;
    }

    // A reference keeps the namespace that its own path names.
    const char* ns = _name_space_of(object_path);
    if (!*ns && name_space)
        ns = name_space;

    CMPIObjectPath_Container cont(mr, broker, ns, object_path);
    Instance* instance = 0;

    if (cont.convert(mc, FLAG_KEY, instance) != 0)
        return 0;

    if (*ns)
        instance->__name_space.assign(ns);

    return instance;
}

Instance* _to_tessel_instance(const Meta_Repository* mr, const CMPIBroker* broker,
    const char* name_space, const CMPIInstance* cmpi_instance)
{
    if (!cmpi_instance)
        return 0;

    const CMPIObjectPath* path = CMGetObjectPath(cmpi_instance, 0);

    if (!path)
    {
        TLOG(LL_WARN, "CMGetObjectPath() failed");
        return 0;
    }

    const char* class_name = _chars(CMGetClassName(path, 0));

    if (!class_name)
    {
        TLOG(LL_WARN, "CMGetClassName() failed");
        return 0;
    }

    const Meta_Class* mc = find_meta_class(mr, class_name);

    if (!mc)
    {
        TLOG(LL_WARN, "failed to find meta class: %s", class_name);
        return 0;
    }

    const char* ns = _name_space_of(path);
    if (!*ns && name_space)
        ns = name_space;

    CMPIInstance_Container cont(mr, broker, ns, cmpi_instance);
    Instance* instance = 0;

    if (cont.convert(mc, 0, instance) != 0)
        return 0;

    if (*ns)
        instance->__name_space.assign(ns);

    return instance;
}

//
// Runtime values to CMPI.
//
// Who frees what: servers keep the pointers of what they are given (an array
// its elements), so nothing made here is released while anything may still
// refer to it. In a request, every object made is left to the broker, which
// frees it when the request ends; a caller outside any request passes a
// CMPI_Made and releases it after the server has consumed the object given
// back.
//

// Whether data holds an encapsulated object by its pointer.
static bool _has_object(const CMPIData& data)
{
    if (data.type & CMPI_ARRAY)
        return data.value.array != 0;

    return (data.type == CMPI_string || data.type == CMPI_dateTime ||
        data.type == CMPI_ref || data.type == CMPI_instance) && data.value.inst;
}

CMPI_Made::CMPI_Made() : _data(0), _size(0), _capacity(0)
{
}

CMPI_Made::~CMPI_Made()
{
    release();
    free(_data);
}

void CMPI_Made::add(const CMPIData& data)
{
    if (!_has_object(data) || (data.state & CMPI_nullValue))
        return;

    if (_size == _capacity)
    {
        size_t capacity = _capacity ? _capacity * 2 : 16;
        CMPIData* grown = (CMPIData*)realloc(_data, capacity * sizeof(CMPIData));

        // Unrecorded, the object stays with the broker.
        if (!grown)
            return;

        _data = grown;
        _capacity = capacity;
    }

    _data[_size++] = data;
}

void CMPI_Made::release()
{
    while (_size)
        _release_cmpi_data(_data[--_size]);
}

static void _made(CMPI_Made* made, CMPIType type, void* object)
{
    if (!made || !object)
        return;

    CMPIData data;
    memset(&data, 0, sizeof(data));
    data.type = type;
    data.value.inst = (CMPIInstance*)object;
    made->add(data);
}

void _read_by_pointer(CMPIData& data)
{
    if (!(data.state & CMPI_nullValue))
        return;

    if (_has_object(data))
        data.state &= ~CMPI_nullValue;
}

void _release_cmpi_data(CMPIData& data)
{
    if (data.state & CMPI_nullValue)
        return;

    CMPIType t = data.type;

    if (t & CMPI_ARRAY)
    {
        if (data.value.array)
            CMRelease(data.value.array);
    }
    else if (t == CMPI_string)
    {
        if (data.value.string)
            CMRelease(data.value.string);
    }
    else if (t == CMPI_dateTime)
    {
        if (data.value.dateTime)
            CMRelease(data.value.dateTime);
    }
    else if (t == CMPI_instance)
    {
        if (data.value.inst)
            CMRelease(data.value.inst);
    }
    else if (t == CMPI_ref)
    {
        if (data.value.ref)
            CMRelease(data.value.ref);
    }

    memset(&data, 0, sizeof(data));
}

// The CMPI scalar type of each Value::Type up to CHAR16, then STRING and
// DATETIME.
static const CMPIType _cmpi_types[14] =
{
    CMPI_boolean, CMPI_uint8, CMPI_sint8, CMPI_uint16, CMPI_sint16,
    CMPI_uint32, CMPI_sint32, CMPI_uint64, CMPI_sint64, CMPI_real32,
    CMPI_real64, CMPI_char16, CMPI_string, CMPI_dateTime,
};

static CMPIString* _new_string(const CMPIBroker* broker, const String& s, CMPI_Made* made)
{
    CMPIString* str = CMNewString(broker, s.c_str(), 0);
    _made(made, CMPI_string, str);
    return str;
}

static CMPIDateTime* _new_datetime(const CMPIBroker* broker, const Datetime& dt,
    CMPI_Made* made)
{
    CMPIDateTime* x = CMNewDateTimeFromChars(broker, dt.ascii(false).c_str(), 0);
    _made(made, CMPI_dateTime, x);
    return x;
}

template<class T>
static int to_cmpi_scalar(const Meta_Repository* mr, const CMPIBroker* broker,
    const char* name_space, T x, CMPIType type, CMPIData& data, CMPI_Made* made);

template<>
int to_cmpi_scalar<const Instance*>(const Meta_Repository* mr, const CMPIBroker* broker,
    const char* name_space, const Instance* instance, CMPIType type, CMPIData& data,
    CMPI_Made* made)
{
    memset(&data, 0, sizeof(data));

    if (!instance)
    {
        TLOG(LL_WARN, "null instance argument");
        return -1;
    }

    const char* ns = instance->__name_space.size() ?
        instance->__name_space.c_str() : name_space;

    if (!ns)
    {
        TLOG(LL_WARN, "null namespace");
        return -1;
    }

    const char* class_name = instance->meta_class ? instance->meta_class->name : 0;

    if (!class_name || !*class_name)
    {
        TLOG(LL_WARN, "null classname");
        return -1;
    }

    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIObjectPath* path = CMNewObjectPath(broker, ns, class_name, &st);
    _made(made, CMPI_ref, path);

    if (st.rc != CMPI_RC_OK || !path)
    {
        TLOG(LL_WARN, "CMNewObjectPath() failed");
        return -1;
    }

    CMPIObjectPath_Container path_cont(mr, broker, ns, path, made);

    if (path_cont.convert(instance, FLAG_KEY) != 0)
    {
        TLOG(LL_WARN, "Container::convert() failed");
        return -1;
    }

    if (type == CMPI_ref)
    {
        data.type = CMPI_ref;
        data.value.ref = path;
        return 0;
    }

    if (type == CMPI_instance)
    {
        CMPIInstance* ci = CMNewInstance(broker, path, &st);
        _made(made, CMPI_instance, ci);

        if (st.rc != CMPI_RC_OK || !ci)
        {
            TLOG(LL_WARN, "CMNewInstance() failed");
            return -1;
        }

        CMPIInstance_Container inst_cont(mr, broker, ns, ci, made);

        if (inst_cont.convert(instance, 0) != 0)
        {
            TLOG(LL_WARN, "Container::convert() failed");
            return -1;
        }

        data.type = CMPI_instance;
        data.value.inst = ci;
        return 0;
    }

    TLOG(LL_WARN, "unexpected type");
    return -1;
}

static bool _embedded(uint32 flags)
{
    return (flags & (FLAG_EMBEDDED_OBJECT | FLAG_EMBEDDED_INSTANCE)) != 0;
}

// One array element of a scalar type into a CMPIValue.
template<class T>
static int _cmpi_element(const CMPIBroker* broker, const T& x, CMPIValue& v, CMPI_Made* made);

#define OLMA_ELEMENT(T, MEMBER) \
    template<> \
    int _cmpi_element<T>(const CMPIBroker*, const T& x, CMPIValue& v, CMPI_Made*) \
    { \
        v.MEMBER = x; \
        return 0; \
    }

OLMA_ELEMENT(uint8, uint8)
OLMA_ELEMENT(sint8, sint8)
OLMA_ELEMENT(uint16, uint16)
OLMA_ELEMENT(sint16, sint16)
OLMA_ELEMENT(uint32, uint32)
OLMA_ELEMENT(sint32, sint32)
OLMA_ELEMENT(uint64, uint64)
OLMA_ELEMENT(sint64, sint64)
OLMA_ELEMENT(real32, real32)
OLMA_ELEMENT(real64, real64)

#undef OLMA_ELEMENT

template<>
int _cmpi_element<boolean>(const CMPIBroker*, const boolean& x, CMPIValue& v, CMPI_Made*)
{
    v.boolean = x ? 1 : 0;
    return 0;
}

template<>
int _cmpi_element<char16>(const CMPIBroker*, const char16& x, CMPIValue& v, CMPI_Made*)
{
    v.char16 = x.code();
    return 0;
}

template<>
int _cmpi_element<String>(const CMPIBroker* broker, const String& x, CMPIValue& v,
    CMPI_Made* made)
{
    v.string = _new_string(broker, x, made);
    return v.string ? 0 : -1;
}

template<>
int _cmpi_element<Datetime>(const CMPIBroker* broker, const Datetime& x, CMPIValue& v,
    CMPI_Made* made)
{
    v.dateTime = _new_datetime(broker, x, made);
    return v.dateTime ? 0 : -1;
}

template<class T>
static int _to_cmpi_array(const CMPIBroker* broker, const Value& value,
    CMPIType element_type, CMPIData& data, CMPI_Made* made)
{
    Array<T> a;
    value.get_value(a);

    CMPIArray* array = CMNewArray(broker, (CMPICount)a.size(), element_type, 0);
    _made(made, element_type | CMPI_ARRAY, array);

    if (!array)
    {
        TLOG(LL_WARN, "CMNewArray() failed");
        return -1;
    }

    for (size_t i = 0; i < a.size(); i++)
    {
        CMPIData e;
        memset(&e, 0, sizeof(e));
        e.type = element_type;

        if (_cmpi_element<T>(broker, a[i], e.value, made) != 0)
        {
            TLOG(LL_WARN, "CMSetArrayElementAt() failed");
            return -1;
        }

        CMPIStatus st = CMSetArrayElementAt(array, (CMPICount)i, &e.value, element_type);

        if (st.rc != CMPI_RC_OK)
        {
            TLOG(LL_WARN, "CMSetArrayElementAt() failed");
            return -1;
        }
    }

    data.type = element_type | CMPI_ARRAY;
    data.value.array = array;
    return 0;
}

static int _to_cmpi_instance_array(const Meta_Repository* mr, const CMPIBroker* broker,
    const char* name_space, const Value& value, CMPIType element_type, CMPIData& data,
    CMPI_Made* made)
{
    Array<Instance*> a;
    value.get_value(a);

    CMPIArray* array = CMNewArray(broker, (CMPICount)a.size(), element_type, 0);
    _made(made, element_type | CMPI_ARRAY, array);

    if (!array)
    {
        TLOG(LL_WARN, "CMNewArray() failed");
        return -1;
    }

    for (size_t i = 0; i < a.size(); i++)
    {
        CMPIData e;

        if (to_cmpi_scalar<const Instance*>(mr, broker, name_space, a[i], element_type, e,
            made) != 0)
        {
            TLOG(LL_WARN, "element conversion failed");
            return -1;
        }

        CMPIStatus st = CMSetArrayElementAt(array, (CMPICount)i, &e.value, element_type);

        if (st.rc != CMPI_RC_OK)
        {
            TLOG(LL_WARN, "CMSetArrayElementAt() failed");
            return -1;
        }
    }

    data.type = element_type | CMPI_ARRAY;
    data.value.array = array;
    return 0;
}

int _to_cmpi_data(const Meta_Repository* mr, const CMPIBroker* broker,
    const char* name_space, const Value& value, uint32 flags, CMPIData& data,
    CMPI_Made* made)
{
    memset(&data, 0, sizeof(data));

    switch (value.type)
    {
        case Value::NONE:
            TLOG(LL_WARN, "missing type");
            return -1;

        case Value::BOOLEAN:
        {
            boolean x = false;
            value.get_value(x);
            data.type = CMPI_boolean;
            data.value.boolean = x ? 1 : 0;
            return 0;
        }

#define OLMA_SCALAR(TYPE, T, MEMBER) \
        case Value::TYPE: \
        { \
            T x = T(); \
            value.get_value(x); \
            data.type = _cmpi_types[Value::TYPE]; \
            data.value.MEMBER = x; \
            return 0; \
        }

        OLMA_SCALAR(UINT8, uint8, uint8)
        OLMA_SCALAR(SINT8, sint8, sint8)
        OLMA_SCALAR(UINT16, uint16, uint16)
        OLMA_SCALAR(SINT16, sint16, sint16)
        OLMA_SCALAR(UINT32, uint32, uint32)
        OLMA_SCALAR(SINT32, sint32, sint32)
        OLMA_SCALAR(UINT64, uint64, uint64)
        OLMA_SCALAR(SINT64, sint64, sint64)
        OLMA_SCALAR(REAL32, real32, real32)
        OLMA_SCALAR(REAL64, real64, real64)

#undef OLMA_SCALAR

        case Value::CHAR16:
        {
            char16 x;
            value.get_value(x);
            data.type = CMPI_char16;
            data.value.char16 = x.code();
            return 0;
        }

        case Value::STRING:
        {
            String x;
            value.get_value(x);
            data.type = CMPI_string;
            data.value.string = _new_string(broker, x, made);
            if (!data.value.string)
            {
                TLOG(LL_WARN, "CMNewString() failed");
                return -1;
            }
            return 0;
        }

        case Value::DATETIME:
        {
            Datetime x;
            value.get_value(x);
            data.type = CMPI_dateTime;
            data.value.dateTime = _new_datetime(broker, x, made);
            if (!data.value.dateTime)
            {
                TLOG(LL_WARN, "CMNewDateTimeFromChars() failed");
                return -1;
            }
            return 0;
        }

        case Value::INSTANCE:
        {
            Instance* x = 0;
            value.get_value(x);
            return to_cmpi_scalar<const Instance*>(mr, broker, name_space, x,
                _embedded(flags) ? CMPI_instance : CMPI_ref, data, made);
        }

#define OLMA_ARRAY(TYPE, T, CMPI_TYPE) \
        case Value::TYPE: return _to_cmpi_array<T>(broker, value, CMPI_TYPE, data, made);

        OLMA_ARRAY(BOOLEAN_ARRAY, boolean, CMPI_boolean)
        OLMA_ARRAY(UINT8_ARRAY, uint8, CMPI_uint8)
        OLMA_ARRAY(SINT8_ARRAY, sint8, CMPI_sint8)
        OLMA_ARRAY(UINT16_ARRAY, uint16, CMPI_uint16)
        OLMA_ARRAY(SINT16_ARRAY, sint16, CMPI_sint16)
        OLMA_ARRAY(UINT32_ARRAY, uint32, CMPI_uint32)
        OLMA_ARRAY(SINT32_ARRAY, sint32, CMPI_sint32)
        OLMA_ARRAY(UINT64_ARRAY, uint64, CMPI_uint64)
        OLMA_ARRAY(SINT64_ARRAY, sint64, CMPI_sint64)
        OLMA_ARRAY(REAL32_ARRAY, real32, CMPI_real32)
        OLMA_ARRAY(REAL64_ARRAY, real64, CMPI_real64)
        OLMA_ARRAY(CHAR16_ARRAY, char16, CMPI_char16)
        OLMA_ARRAY(STRING_ARRAY, String, CMPI_string)
        OLMA_ARRAY(DATETIME_ARRAY, Datetime, CMPI_dateTime)

#undef OLMA_ARRAY

        case Value::INSTANCE_ARRAY:
            return _to_cmpi_instance_array(mr, broker, name_space, value,
                _embedded(flags) ? CMPI_instance : CMPI_ref, data, made);

        default:
            break;
    }

    TLOG(LL_WARN, "missing type");
    return -1;
}

//
// Whole objects.
//

int make_tessel_reference(const CMPIBroker* broker, const Meta_Class* meta_class,
    const CMPIObjectPath* object_path, Instance*& instance)
{
    instance = 0;

    if (!meta_class || !object_path)
        return CMPI_RC_ERR_FAILED;

    const char* ns = _name_space_of(object_path);
    CMPIObjectPath_Container cont(meta_class->meta_repository, broker, ns, object_path);

    if (cont.convert(meta_class, FLAG_KEY, instance) != 0 || !instance)
        return CMPI_RC_ERR_FAILED;

    __set_name_space_recursive(instance, ns, false);
    return CMPI_RC_OK;
}

int make_tessel_instance(const CMPIBroker* broker, const Meta_Class* meta_class,
    const CMPIObjectPath* object_path, const CMPIInstance* cmpi_instance,
    Instance*& instance)
{
    instance = 0;

    if (!meta_class || !cmpi_instance)
        return CMPI_RC_ERR_FAILED;

    const char* ns = _name_space_of(object_path);
    CMPIInstance_Container cont(meta_class->meta_repository, broker, ns, cmpi_instance);

    if (cont.convert(meta_class, 0, instance) != 0 || !instance)
        return CMPI_RC_ERR_FAILED;

    __set_name_space_recursive(instance, ns, false);
    return CMPI_RC_OK;
}

int make_tessel_method(const CMPIBroker* broker, const Meta_Class* meta_class,
    const Meta_Method* meta_method, const CMPIObjectPath* object_path,
    const CMPIArgs* in_args, void*, Instance*& method_instance)
{
    method_instance = 0;

    if (!meta_class || !meta_method)
        return CMPI_RC_ERR_FAILED;

    const char* ns = _name_space_of(object_path);

    if (!in_args)
    {
        // No arguments at all: every parameter stays null.
        method_instance = create(meta_method);
        if (!method_instance)
            return CMPI_RC_ERR_FAILED;
        __set_null_flags(method_instance, true, true, 1);
        __set_name_space_recursive(method_instance, ns, false);
        return CMPI_RC_OK;
    }

    CMPIArgs_Container cont(meta_class->meta_repository, broker, ns, in_args);

    if (cont.convert((const Meta_Class*)meta_method, FLAG_IN, method_instance) != 0 ||
        !method_instance)
        return CMPI_RC_ERR_FAILED;

    __set_name_space_recursive(method_instance, ns, false);
    return CMPI_RC_OK;
}

// The repository of an instance's class; a method's record has its own
// head only, so its repository is the one the caller passes.
static const Meta_Repository* _repository_of(const Instance* instance)
{
    const Meta_Class* mc = instance->meta_class;
    if (!mc || (mc->flags & FLAG_METHOD))
        return 0;
    return mc->meta_repository;
}

int make_cmpi_object_path(const CMPIBroker* broker, const Instance* instance,
    const char* name_space, CMPIObjectPath*& object_path, CMPI_Made* made)
{
    object_path = 0;

    if (!broker || !instance || !instance->meta_class)
        return CMPI_RC_ERR_FAILED;

    const char* ns = name_space ? name_space : "";
    object_path = CMNewObjectPath(broker, ns, instance->meta_class->name, 0);

    if (!object_path)
        return CMPI_RC_ERR_FAILED;

    CMPIObjectPath_Container cont(_repository_of(instance), broker, ns, object_path, made);

    if (cont.convert(instance, FLAG_KEY) != 0)
    {
        CMRelease(object_path);
        object_path = 0;
        return CMPI_RC_ERR_FAILED;
    }

    return CMPI_RC_OK;
}

// The names of the class's keys, null-terminated, in names (room for
// max + 1); the count.
static size_t _key_names(const Meta_Class* mc, const char** names, size_t max)
{
    size_t n = 0;

    for (size_t i = 0; mc && i < mc->num_meta_features && n < max; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if ((mf->flags & FLAG_KEY) && (mf->flags & (FLAG_PROPERTY | FLAG_REFERENCE)))
            names[n++] = mf->name;
    }

    names[n] = 0;
    return n;
}

int make_cmpi_instance(const CMPIBroker* broker, const Instance* instance,
    const char* name_space, const CMPIObjectPath* object_path,
    const char** properties, CMPIInstance*& cmpi_instance, CMPI_Made* made)
{
    cmpi_instance = 0;

    if (!broker || !instance)
        return CMPI_RC_ERR_FAILED;

    if (!object_path)
    {
        TLOG(LL_WARN, "No ObjectPath built before call to make_CMPI_instance");

        CMPIObjectPath* own_path = 0;

        if (make_cmpi_object_path(broker, instance, name_space, own_path, made) != 0)
            return CMPI_RC_ERR_FAILED;

        _made(made, CMPI_ref, own_path);
        object_path = own_path;
    }

    cmpi_instance = CMNewInstance(broker, object_path, 0);

    if (!cmpi_instance)
        return CMPI_RC_ERR_FAILED;

    if (properties)
    {
        // A server that builds the path from the key properties left on the
        // instance needs the keys named, or the client gets paths without.
        const char* keys[33];
        _key_names(instance->meta_class, keys, 32);
        CMPIStatus st = CMSetPropertyFilter(cmpi_instance, properties, keys);

        if (st.rc != CMPI_RC_OK)
        {
            CMRelease(cmpi_instance);
            cmpi_instance = 0;
            return st.rc;
        }
    }

    const char* ns = name_space ? name_space : "";
    CMPIInstance_Container cont(_repository_of(instance), broker, ns, cmpi_instance, made);

    if (cont.convert(instance, 0) != 0)
    {
        CMRelease(cmpi_instance);
        cmpi_instance = 0;
        return CMPI_RC_ERR_FAILED;
    }

    return CMPI_RC_OK;
}

int make_cmpi_method(const CMPIBroker* broker, const char* name_space,
    const Instance* method_instance, const CMPIArgs* out_args,
    CMPIValue& return_value, CMPIType& return_type)
{
    memset(&return_value, 0, sizeof(return_value));
    return_type = 0;

    if (!method_instance)
        return CMPI_RC_ERR_FAILED;

    CMPIArgs_Container cont(0, broker, name_space ? name_space : "", out_args);

    if (cont.convert(method_instance, FLAG_OUT) != 0)
        return CMPI_RC_ERR_FAILED;

    return_value = cont.return_value;
    return_type = cont.return_type;
    return CMPI_RC_OK;
}

} // namespace OLMA
