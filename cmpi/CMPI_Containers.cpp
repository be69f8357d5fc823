#include <cstring>
#include "CMPI_Containers.h"
#include "Converter.h"
#include "log.h"

namespace OLMA
{

// Steps of get_value common to the three containers: bounds, conversion,
// then (after the container's own rule) the type check.
static int _check_type(const char* name, Value::Type type, Value& value)
{
    if (value.type != type)
    {
        TLOG(LL_WARN, "type mismatch on %s: %s/%s",
            name ? name : "?", name_of(value.type), name_of(type));
        value.clear();
        return -1;
    }
    return 0;
}

static int _convert(const Meta_Repository* mr, const CMPIBroker* broker,
    const char* name_space, const CMPIData& data, Value& value)
{
    if (cmpi_to_tessel_value(mr, broker, name_space, data, value) != 0)
    {
        TLOG(LL_WARN, "cmpi_to_tessel_value() failed");
        return -1;
    }
    return 0;
}

//
// CMPIInstance_Container
//

CMPIInstance_Container::CMPIInstance_Container(const Meta_Repository* mr,
    const CMPIBroker* broker_, const char* name_space_, const CMPIInstance* instance_,
    CMPI_Made* made_)
    : Container(mr), broker(broker_), name_space(name_space_), instance(instance_), made(made_)
{
}

CMPIInstance_Container::~CMPIInstance_Container()
{
}

size_t CMPIInstance_Container::get_size()
{
    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPICount n = CMGetPropertyCount(instance, &st);
    return st.rc == CMPI_RC_OK ? n : 0;
}

int CMPIInstance_Container::get_name(size_t index, String& name)
{
    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIString* str = 0;

    // A server may throw from its own code; one property isn't worth the
    // request.
    try
    {
        CMGetPropertyAt(instance, (CMPICount)index, &str, &st);
    }
    catch (...)
    {
        TLOG(LL_WARN, "CMGetPropertyAt() threw exception: index=%u size=%u",
            (unsigned)index, (unsigned)get_size());
        return -1;
    }

    if (st.rc != CMPI_RC_OK)
    {
        TLOG(LL_WARN, "CMGetPropertyAt() failed");
        return -1;
    }

    const char* s = _chars(str);

    if (!s)
        return -1;

    name.assign(s);
    return 0;
}

int CMPIInstance_Container::get_value(size_t index, Value::Type type, Value& value)
{
    value.clear();

    if (index >= get_size())
    {
        TLOG(LL_WARN, "bounds error");
        return -1;
    }

    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIString* name = 0;
    CMPIData data = CMGetPropertyAt(instance, (CMPICount)index, &name, &st);

    if (st.rc != CMPI_RC_OK)
    {
        TLOG(LL_WARN, "CMGetPropertyAt() failed");
        return -1;
    }

    if (_convert(meta_repository, broker, name_space, data, value) != 0)
        return -1;

    return _check_type(_chars(name), type, value);
}

int CMPIInstance_Container::set_value(const char* name, const Value& value, uint32 flags)
{
    CMPIData data;

    if (_to_cmpi_data(meta_repository, broker, name_space, value, flags, data, made) != 0)
    {
        TLOG(LL_WARN, "_to_cmpi_data() failed: feature=%s", name);
        return -1;
    }

    CMPIStatus st = CMSetProperty(instance, name, &data.value, data.type);

    if (st.rc != CMPI_RC_OK)
    {
        TLOG(LL_WARN, "CMSetProperty() failed: %s", name);
        return -1;
    }

    return 0;
}

//
// CMPIObjectPath_Container
//

CMPIObjectPath_Container::CMPIObjectPath_Container(const Meta_Repository* mr,
    const CMPIBroker* broker_, const char* name_space_, const CMPIObjectPath* object_path_,
    CMPI_Made* made_)
    : Container(mr), broker(broker_), name_space(name_space_), object_path(object_path_),
      made(made_)
{
}

CMPIObjectPath_Container::~CMPIObjectPath_Container()
{
}

size_t CMPIObjectPath_Container::get_size()
{
    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPICount n = CMGetKeyCount(object_path, &st);
    return st.rc == CMPI_RC_OK ? n : 0;
}

int CMPIObjectPath_Container::get_name(size_t index, String& name)
{
    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIString* str = 0;
    CMGetKeyAt(object_path, (CMPICount)index, &str, &st);

    if (st.rc != CMPI_RC_OK)
    {
        TLOG(LL_WARN, "CMGetKeyAt() failed");
        return -1;
    }

    const char* s = _chars(str);

    if (!s)
        return -1;

    name.assign(s);
    return 0;
}

// Truncates the 64-bit key into the declared type.
template<class T>
static void _narrow(Value& value, uint64 x, uint8 null)
{
    value.set_value(T(x));
    value.null = null;
}

int CMPIObjectPath_Container::get_value(size_t index, Value::Type type, Value& value)
{
    value.clear();

    if (index >= get_size())
    {
        TLOG(LL_WARN, "bounds error");
        return -1;
    }

    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIString* name = 0;
    CMPIData data = CMGetKeyAt(object_path, (CMPICount)index, &name, &st);

    if (st.rc != CMPI_RC_OK)
    {
        TLOG(LL_WARN, "CMGetKeyAt() failed");
        return -1;
    }

    if (_convert(meta_repository, broker, name_space, data, value) != 0)
        return -1;

    if (value.type == Value::UINT64 && type != Value::UINT64)
    {
        uint64 x = 0;
        value.get_value(x);
        uint8 null = value.null;

        switch (type)
        {
            case Value::UINT8: _narrow<uint8>(value, x, null); break;
            case Value::SINT8: _narrow<sint8>(value, x, null); break;
            case Value::UINT16: _narrow<uint16>(value, x, null); break;
            case Value::SINT16: _narrow<sint16>(value, x, null); break;
            case Value::UINT32: _narrow<uint32>(value, x, null); break;
            case Value::SINT32: _narrow<sint32>(value, x, null); break;
            case Value::SINT64: _narrow<sint64>(value, x, null); break;
            default: break;
        }
    }
    else if (value.type == Value::SINT64 && type == Value::UINT32)
    {
        sint64 x = 0;
        value.get_value(x);
        _narrow<uint32>(value, (uint64)x, 0);
    }
    else if (value.type == Value::SINT64 &&
        (type == Value::SINT8 || type == Value::SINT16 || type == Value::SINT32))
    {
        // Servers that widen signed keys keep them as sint64.
        sint64 x = 0;
        value.get_value(x);
        uint8 null = value.null;

        if (type == Value::SINT8)
            _narrow<sint8>(value, (uint64)x, null);
        else if (type == Value::SINT16)
            _narrow<sint16>(value, (uint64)x, null);
        else
            _narrow<sint32>(value, (uint64)x, null);
    }

    return _check_type(_chars(name), type, value);
}

int CMPIObjectPath_Container::set_value(const char* name, const Value& value, uint32 flags)
{
    CMPIData data;

    if (_to_cmpi_data(meta_repository, broker, name_space, value, flags, data, made) != 0)
    {
        TLOG(LL_WARN, "_to_cmpi_data() failed: feature=%s", name);
        return -1;
    }

    CMPIStatus st = CMAddKey((CMPIObjectPath*)object_path, name, &data.value, data.type);

    if (st.rc != CMPI_RC_OK)
    {
        TLOG(LL_WARN, "CMAddKey() failed");
        return -1;
    }

    return 0;
}

//
// CMPIArgs_Container
//

CMPIArgs_Container::CMPIArgs_Container(const Meta_Repository* mr,
    const CMPIBroker* broker_, const char* name_space_, const CMPIArgs* args_,
    CMPI_Made* made_)
    : Container(mr), broker(broker_), name_space(name_space_), args(args_), made(made_),
      return_type(0), upcall(false)
{
    memset(&return_value, 0, sizeof(return_value));
}

CMPIArgs_Container::~CMPIArgs_Container()
{
}

size_t CMPIArgs_Container::get_size()
{
    if (!args)
        return 0;
    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPICount n = CMGetArgCount(args, &st);
    return st.rc == CMPI_RC_OK ? n : 0;
}

int CMPIArgs_Container::get_name(size_t index, String& name)
{
    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIString* str = 0;
    CMGetArgAt(args, (CMPICount)index, &str, &st);

    if (st.rc != CMPI_RC_OK)
    {
        TLOG(LL_WARN, "CMGetArgAt() failed");
        return -1;
    }

    const char* s = _chars(str);

    if (!s)
        return -1;

    name.assign(s);
    return 0;
}

int CMPIArgs_Container::get_value(size_t index, Value::Type type, Value& value)
{
    value.clear();

    if (index >= get_size())
    {
        TLOG(LL_WARN, "bounds error");
        return -1;
    }

    CMPIStatus st = { CMPI_RC_OK, 0 };
    CMPIString* name = 0;
    CMPIData data = CMGetArgAt(args, (CMPICount)index, &name, &st);

    if (st.rc != CMPI_RC_OK)
    {
        TLOG(LL_WARN, "CMGetArgAt() failed");
        return -1;
    }

    if (upcall)
        _read_by_pointer(data);

    if (_convert(meta_repository, broker, name_space, data, value) != 0)
        return -1;

    // Some servers pass a null array of references as a boolean.
    if (value.type == Value::BOOLEAN && type == Value::INSTANCE_ARRAY)
    {
        value.set_value(Array<Instance*>());
        value.null = 1;
    }

    return _check_type(_chars(name), type, value);
}

int CMPIArgs_Container::set_value(const char* name, const Value& value, uint32 flags)
{
    CMPIData data;

    if (_to_cmpi_data(meta_repository, broker, name_space, value, flags, data, made) != 0)
    {
        TLOG(LL_WARN, "_to_cmpi_data() failed: feature=%s", name);
        return -1;
    }

    // The result travels apart from the output arguments; the exact name is
    // what the method records use.
    if (strcmp(name, "return_value") == 0)
    {
        return_type = data.type;
        return_value = data.value;
        return 0;
    }

    CMPIStatus st = CMAddArg(args, name, &data.value, data.type);

    if (st.rc != CMPI_RC_OK)
    {
        TLOG(LL_WARN, "CMAddArg() failed");
        return -1;
    }

    return 0;
}

} // namespace OLMA
