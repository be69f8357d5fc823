#include <cstdarg>
#include <cstring>
#include "CMPI_Adapter.h"
#include "CMPI_Thread_Context.h"
#include "Converter.h"
#include "Instance.h"
#include "Strings.h"
#include "log.h"
#include "Mutex.h"
#include "Time.h"

#define ENT(NAME) ent(TESSEL_FILE_BASENAME, __LINE__, NAME)
#define RET(...) ret(TESSEL_FILE_BASENAME, __LINE__, __VA_ARGS__)

namespace OLMA
{

//
// Return codes and tracing.
//

const char* _rc_to_str(int rc)
{
    switch (rc)
    {
        case 0: return "CMPI_RC_OK";
        case 1: return "CMPI_RC_ERR_FAILED";
        case 2: return "CMPI_RC_ERR_ACCESS_DENIED";
        case 3: return "CMPI_RC_ERR_INVALID_NAMESPACE";
        case 4: return "CMPI_RC_ERR_INVALID_PARAMETER";
        case 5: return "CMPI_RC_ERR_INVALID_CLASS";
        case 6: return "CMPI_RC_ERR_NOT_FOUND";
        case 7: return "CMPI_RC_ERR_NOT_SUPPORTED";
        case 8: return "CMPI_RC_ERR_CLASS_HAS_CHILDREN";
        case 9: return "CMPI_RC_ERR_CLASS_HAS_INSTANCES";
        case 10: return "CMPI_RC_ERR_INVALID_SUPERCLASS";
        case 11: return "CMPI_RC_ERR_ALREADY_EXISTS";
        case 12: return "CMPI_RC_ERR_NO_SUCH_PROPERTY";
        case 13: return "CMPI_RC_ERR_TYPE_MISMATCH";
        case 14: return "CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED";
        case 15: return "CMPI_RC_ERR_INVALID_QUERY";
        case 16: return "CMPI_RC_ERR_METHOD_NOT_AVAILABLE";
        case 17: return "CMPI_RC_ERR_METHOD_NOT_FOUND";
        case 50: return "CMPI_RC_DO_NOT_UNLOAD";
        case 51: return "CMPI_RC_NEVER_UNLOAD";
        case 60: return "CMPI_RC_ERR_INVALID_HANDLE";
        case 61: return "CMPI_RC_ERR_INVALID_DATA_TYPE";
        case 100: return "CMPI_RC_ERROR_SYSTEM";
        case 200: return "CMPI_RC_ERROR";
    }
    return "CMPI_RC_ERR_FAILED";
}

void CMPI_Adapter::ent(const char* file, size_t line, const char* name)
{
    if (_log_enabled_state)
        log(LL_DBG, file, line, "enter: %s()", name);
}

void CMPI_Adapter::ret(const char* file, size_t line, const char* name)
{
    if (_log_enabled_state)
        log(LL_DBG, file, line, "return: %s()", name);
}

void CMPI_Adapter::ret(const char* file, size_t line, const char* name, CMPIrc rc)
{
    if (_log_enabled_state)
        log(LL_DBG, file, line, "return: %s(): %s", name, _rc_to_str(rc));
}

void CMPI_Adapter::ret(const char* file, size_t line, const char* name, CMPIrc rc,
    const char* message)
{
    if (_log_enabled_state)
        log(LL_DBG, file, line, "return: %s(): %s %s", name, _rc_to_str(rc), message);
}

void CMPI_Adapter::trc(const char* file, size_t line, const char* format, ...)
{
    if (!_log_enabled_state)
        return;
    va_list ap;
    va_start(ap, format);
    vlog(LL_DBG, file, line, format, ap);
    va_end(ap);
}

static CMPIStatus _status(CMPIrc rc)
{
    CMPIStatus st;
    st.rc = rc;
    st.msg = 0;
    return st;
}

// The adapter of an MI object, if it is still alive.
template<class T>
static CMPI_Adapter* _adapter(const T* mi)
{
    if (!mi || !mi->hdl)
        return 0;
    const CMPI_Static_Data* data = (const CMPI_Static_Data*)mi->hdl;
    if (data->magic != CMPI_STATIC_DATA_MAGIC)
        return 0;
    return data->adapter;
}

// The frame of a request: a thread context for the provider, and the
// adapter's lock, both released on every way out, exceptions included.
class Request_Frame
{
public:

    Request_Frame(CMPI_Adapter* adapter, const CMPIContext* context) : _adapter(adapter)
    {
        _context = new CMPI_Thread_Context(adapter->broker, context, adapter);
        Thread_Context::push(_context);
        _adapter->lock.lock();
    }

    ~Request_Frame()
    {
        _adapter->lock.unlock();
        Thread_Context::pop();
        delete _context;
    }

private:

    Request_Frame(const Request_Frame&);
    Request_Frame& operator=(const Request_Frame&);

    CMPI_Adapter* _adapter;
    CMPI_Thread_Context* _context;
};

//
// Birth and death.
//

static void _fill_tables(CMPI_Static_Data* data, const char* provider_name)
{
    const char* name = provider_name ? provider_name : "";
    strlcpy(data->instance_name, "instance", sizeof(data->instance_name));
    strlcat(data->instance_name, name, sizeof(data->instance_name));
    strlcpy(data->method_name, "method", sizeof(data->method_name));
    strlcat(data->method_name, name, sizeof(data->method_name));
    strlcpy(data->indication_name, "indication", sizeof(data->indication_name));
    strlcat(data->indication_name, name, sizeof(data->indication_name));
    strlcpy(data->association_name, "association", sizeof(data->association_name));
    strlcat(data->association_name, name, sizeof(data->association_name));

    // Positional: the slots in CMPI's order.
    CMPIInstanceMIFT instance_ft =
    {
        100, 100, data->instance_name,
        CMPI_Adapter::instanceCleanup,
        CMPI_Adapter::enumerateInstanceNames,
        CMPI_Adapter::enumerateInstances,
        CMPI_Adapter::getInstance,
        CMPI_Adapter::createInstance,
        CMPI_Adapter::modifyInstance,
        CMPI_Adapter::deleteInstance,
        CMPI_Adapter::execQuery,
    };
    memcpy(data->instance_ft.bytes, &instance_ft, sizeof(instance_ft));

    CMPIMethodMIFT method_ft =
    {
        100, 100, data->method_name,
        CMPI_Adapter::methodCleanup,
        CMPI_Adapter::invokeMethod,
    };
    memcpy(data->method_ft.bytes, &method_ft, sizeof(method_ft));

    CMPIIndicationMIFT indication_ft =
    {
        100, 100, data->indication_name,
        CMPI_Adapter::indicationCleanup,
        CMPI_Adapter::authorizeFilter,
        CMPI_Adapter::mustPoll,
        CMPI_Adapter::activateFilter,
        CMPI_Adapter::deactivateFilter,
        CMPI_Adapter::enableIndications,
        CMPI_Adapter::disableIndications,
    };
    memcpy(data->indication_ft.bytes, &indication_ft, sizeof(indication_ft));

    CMPIAssociationMIFT association_ft =
    {
        100, 100, data->association_name,
        CMPI_Adapter::associationCleanup,
        CMPI_Adapter::associators,
        CMPI_Adapter::associatorNames,
        CMPI_Adapter::references,
        CMPI_Adapter::referenceNames,
    };
    memcpy(data->association_ft.bytes, &association_ft, sizeof(association_ft));

    data->instance_mi.hdl = data;
    data->instance_mi.ft = data->instance_ft.get();
    data->method_mi.hdl = data;
    data->method_mi.ft = data->method_ft.get();
    data->association_mi.hdl = data;
    data->association_mi.ft = data->association_ft.get();
    data->indication_mi.hdl = data;
    data->indication_mi.ft = data->indication_ft.get();
}

CMPI_Adapter::CMPI_Adapter(const CMPIBroker* broker_, const CMPIContext* context,
    const char* provider_name, const Registration* registration_, CMPI_Static_Data* data) :
    Provider_Handle(registration_),
    broker(0),
    static_data(data),
    load_count(0),
    allow_unload_flag(true),
    indications_enabled(false),
    lock(true)
{
    ENT("CMPI_Adapter");

    CMPI_Thread_Context* tc = new CMPI_Thread_Context(broker_, context, this);
    Thread_Context::push(tc);

    data->magic = CMPI_STATIC_DATA_MAGIC;
    data->adapter = this;
    _fill_tables(data, provider_name);

    load_count = 1;
    broker = broker_;

    // A provider that fails to load stays in place; its requests tell.
    call(OP_LOAD);

    RET("CMPI_Adapter");
    Thread_Context::pop();
    delete tc;
}

CMPI_Adapter::~CMPI_Adapter()
{
    ENT("~CMPI_Adapter");
    static_data->magic = CMPI_STATIC_DATA_DEAD;
    static_data->adapter = 0;
    RET("~CMPI_Adapter");
    // The provider object goes last, with the Provider_Handle.
}

} // namespace OLMA

using namespace OLMA;

extern "C" int tessel_cmpi_adapter(CMPI_Static_Data* data, const Registration* registration,
    const CMPIBroker* broker, const CMPIContext* context, const char* provider_name,
    int type, void** mi_out)
{
    if (!data || !registration || !mi_out)
        return -1;

    // An MI the server never gets is never cleaned up: count only those
    // that are handed out.
    if (type != 'I' && type != 'M' && type != 'A' && type != 'N')
        return -1;

    if (!data->adapter)
        new CMPI_Adapter(broker, context, provider_name, registration, data);
    else
        data->adapter->load_count++;

    CMPI_Adapter::ent(TESSEL_FILE_BASENAME, __LINE__, "tessel_cmpi_adapter");

    switch (type)
    {
        case 'I':
            *mi_out = &data->instance_mi;
            break;
        case 'M':
            *mi_out = &data->method_mi;
            break;
        case 'A':
            *mi_out = &data->association_mi;
            break;
        case 'N':
            *mi_out = &data->indication_mi;
            break;
    }

    CMPI_Adapter::ret(TESSEL_FILE_BASENAME, __LINE__, "tessel_cmpi_adapter");
    return *mi_out ? 0 : -1;
}

namespace OLMA
{

CMPIrc CMPI_Adapter::cleanup(CMPI_Adapter* adapter, const CMPIContext*, bool terminating)
{
    ENT("cleanup");

    if (!adapter)
    {
        RET("cleanup", CMPI_RC_OK);
        return CMPI_RC_OK;
    }

    if (!terminating && !adapter->allow_unload_flag)
    {
        RET("cleanup do not unload", CMPI_RC_DO_NOT_UNLOAD);
        return CMPI_RC_DO_NOT_UNLOAD;
    }

    if (adapter->load_count != 1)
    {
        adapter->load_count--;
        RET("cleanup decrement", CMPI_RC_OK);
        return CMPI_RC_OK;
    }

    adapter->call(OP_UNLOAD);
    RET("cleanup unload", CMPI_RC_OK);
    delete adapter;
    return CMPI_RC_OK;
}

// Cleanup with a thread context, so that a provider's unload can reach the
// server.
static CMPIrc _cleanup_in_context(CMPI_Adapter* adapter, const CMPIContext* context,
    CMPIBoolean terminating)
{
    if (!adapter)
        return CMPI_Adapter::cleanup(0, context, terminating != 0);

    CMPI_Thread_Context* tc = new CMPI_Thread_Context(adapter->broker, context, adapter);
    Thread_Context::push(tc);
    CMPIrc rc = CMPI_Adapter::cleanup(adapter, context, terminating != 0);
    Thread_Context::pop();
    delete tc;
    return rc;
}

CMPIStatus CMPI_Adapter::instanceCleanup(
    CMPIInstanceMI* mi, const CMPIContext* context, CMPIBoolean terminating)
{
    return _status(_cleanup_in_context(_adapter(mi), context, terminating));
}

CMPIStatus CMPI_Adapter::methodCleanup(
    CMPIMethodMI* mi, const CMPIContext* context, CMPIBoolean terminating)
{
    return _status(_cleanup_in_context(_adapter(mi), context, terminating));
}

CMPIStatus CMPI_Adapter::indicationCleanup(
    CMPIIndicationMI* mi, const CMPIContext* context, CMPIBoolean terminating)
{
    ENT("indicationCleanup");
    return _status(_cleanup_in_context(_adapter(mi), context, terminating));
}

CMPIStatus CMPI_Adapter::associationCleanup(
    CMPIAssociationMI* mi, const CMPIContext* context, CMPIBoolean terminating)
{
    ENT("associationCleanup");
    return _status(cleanup(_adapter(mi), context, terminating != 0));
}

//
// Class look-up.
//

const Meta_Class* CMPI_Adapter::find_model_meta_class(const char* class_name)
{
    const Meta_Repository* mr = meta_repository();
    const Meta_Class* mc = find_meta_class(mr, class_name ? class_name : "");

    if (!mc)
        return 0;

    // The dispatch function takes what it gets for its own class, so only a
    // class that the provider's class can stand for is accepted. A parent's
    // name (the server asking for a base class) means the provider's class.
    const Meta_Class* own = meta_class();

    if (!own || is_subclass(own, mc))
        return mc;

    if (is_subclass(mc, own))
        return own;

    TLOG(LL_WARN, "class %s isn't served by %s", class_name, registration->provider_name);
    return 0;
}

//
// Status maps.
//

static CMPIrc _enum_instances_rc(sint32 status)
{
    switch (status)
    {
        case ENUM_INSTANCES_FAILED: return CMPI_RC_ERR_FAILED;
        case ENUM_INSTANCES_ACCESS_DENIED: return CMPI_RC_ERR_ACCESS_DENIED;
    }
    return CMPI_RC_OK;
}

static CMPIrc _get_instance_rc(sint32 status)
{
    switch (status)
    {
        case GET_INSTANCE_NOT_FOUND: return CMPI_RC_ERR_NOT_FOUND;
        case GET_INSTANCE_UNSUPPORTED: return CMPI_RC_ERR_FAILED;
        case GET_INSTANCE_INVALID_PARAMETER: return CMPI_RC_ERR_INVALID_PARAMETER;
        case GET_INSTANCE_ACCESS_DENIED: return CMPI_RC_ERR_ACCESS_DENIED;
        case GET_INSTANCE_FAILED: return CMPI_RC_ERR_FAILED;
    }
    return CMPI_RC_OK;
}

static CMPIrc _create_instance_rc(sint32 status)
{
    switch (status)
    {
        case CREATE_INSTANCE_DUPLICATE: return CMPI_RC_ERR_ALREADY_EXISTS;
        case CREATE_INSTANCE_UNSUPPORTED: return CMPI_RC_ERR_NOT_SUPPORTED;
        case CREATE_INSTANCE_INVALID_PARAMETER: return CMPI_RC_ERR_INVALID_PARAMETER;
        case CREATE_INSTANCE_ACCESS_DENIED: return CMPI_RC_ERR_ACCESS_DENIED;
        case CREATE_INSTANCE_FAILED: return CMPI_RC_ERR_FAILED;
    }
    return CMPI_RC_OK;
}

static CMPIrc _modify_instance_rc(sint32 status)
{
    switch (status)
    {
        case MODIFY_INSTANCE_NOT_FOUND: return CMPI_RC_ERR_NOT_FOUND;
        case MODIFY_INSTANCE_UNSUPPORTED: return CMPI_RC_ERR_NOT_SUPPORTED;
        case MODIFY_INSTANCE_INVALID_PARAMETER: return CMPI_RC_ERR_INVALID_PARAMETER;
        case MODIFY_INSTANCE_ACCESS_DENIED: return CMPI_RC_ERR_ACCESS_DENIED;
        case MODIFY_INSTANCE_FAILED: return CMPI_RC_ERR_FAILED;
    }
    return CMPI_RC_OK;
}

static CMPIrc _delete_instance_rc(sint32 status)
{
    switch (status)
    {
        case DELETE_INSTANCE_NOT_FOUND: return CMPI_RC_ERR_NOT_FOUND;
        case DELETE_INSTANCE_UNSUPPORTED: return CMPI_RC_ERR_NOT_SUPPORTED;
        case DELETE_INSTANCE_ACCESS_DENIED: return CMPI_RC_ERR_ACCESS_DENIED;
        case DELETE_INSTANCE_FAILED: return CMPI_RC_ERR_FAILED;
    }
    return CMPI_RC_OK;
}

static CMPIrc _invoke_method_rc(sint32 status)
{
    switch (status)
    {
        case INVOKE_METHOD_FAILED: return CMPI_RC_ERR_FAILED;
        case INVOKE_METHOD_UNSUPPORTED: return CMPI_RC_ERR_NOT_SUPPORTED;
        case INVOKE_METHOD_ACCESS_DENIED: return CMPI_RC_ERR_ACCESS_DENIED;
    }
    return CMPI_RC_OK;
}

//
// Instance operations.
//

namespace enum_instance_names
{
    struct Data
    {
        const CMPIBroker* broker;
        const CMPIResult* result;
        const char* name_space;
        unsigned rc;
    };

    static bool _proc(Instance* instance, Enum_Instances_Status, void* client_data)
    {
        if (!instance)
            return false;

        Ref<Instance> hold(instance);
        Data* data = (Data*)client_data;

        if (data->rc != 0)
            return false;

        CMPIObjectPath* path = 0;
        data->rc = make_cmpi_object_path(data->broker, instance, data->name_space, path);

        if (data->rc != 0)
            return false;

        CMReturnObjectPath(data->result, path);
        CMRelease(path);
        return true;
    }
}

CMPIStatus CMPI_Adapter::enumerateInstanceNames(CMPIInstanceMI* mi,
    const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* object_path)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("enumInstanceNames");

    const Meta_Class* mc = adapter->find_model_meta_class(_class_name_of(object_path));
    if (!mc)
    {
        RET("enumInstanceNames", CMPI_RC_ERR_FAILED);
        return _status(CMPI_RC_ERR_FAILED);
    }

    Instance* model_ptr = 0;
    CMPIrc rc = (CMPIrc)make_tessel_reference(0, mc, object_path, model_ptr);
    Ref<Instance> model(model_ptr);

    if (rc != CMPI_RC_OK)
    {
        RET("enumInstanceNames", rc);
        return _status(rc);
    }

    __set_null_flags(model.ptr(), false, true, 1);

    enum_instance_names::Data data =
        { adapter->broker, result, _name_space_of(object_path), 0 };
    sint32 status = adapter->call(OP_ENUM_INSTANCES, model.ptr(),
        (void*)enum_instance_names::_proc, &data);

    rc = _enum_instances_rc(status);

    if (rc == CMPI_RC_OK)
        CMReturnDone(result);

    RET("enumInstanceNames", rc);
    return _status(rc);
}

namespace enum_instances
{
    struct Data
    {
        const CMPIBroker* broker;
        const CMPIResult* result;
        const CMPIObjectPath* object_path;
        const char** properties;
        unsigned rc;
    };

    static bool _proc(Instance* instance, Enum_Instances_Status, void* client_data)
    {
        if (!instance)
            return false;

        Ref<Instance> hold(instance);
        Data* data = (Data*)client_data;

        if (data->rc != 0)
            return false;

        const char* ns = _name_space_of(data->object_path);
        CMPIObjectPath* path = 0;

        if (make_cmpi_object_path(data->broker, instance, ns, path) != 0)
            return false;

        CMPIInstance* ci = 0;
        data->rc = make_cmpi_instance(data->broker, instance, ns, path, data->properties, ci);

        if (data->rc != 0)
            return false;

        CMReturnInstance(data->result, ci);
        CMRelease(ci);
        return true;
    }
}

CMPIStatus CMPI_Adapter::enumerateInstances(CMPIInstanceMI* mi,
    const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* object_path, const char** properties)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("enumInstances");

    const Meta_Class* mc = adapter->find_model_meta_class(_class_name_of(object_path));
    if (!mc)
    {
        RET("enumInstances", CMPI_RC_ERR_FAILED);
        return _status(CMPI_RC_ERR_FAILED);
    }

    Instance* model_ptr = 0;
    CMPIrc rc = (CMPIrc)make_tessel_reference(0, mc, object_path, model_ptr);
    Ref<Instance> model(model_ptr);

    if (rc != CMPI_RC_OK)
    {
        RET("enumInstances", rc);
        return _status(rc);
    }

    if (properties)
        filter_properties(model.ptr(), properties, true);

    enum_instances::Data data = { adapter->broker, result, object_path, properties, 0 };
    sint32 status = adapter->call(OP_ENUM_INSTANCES, model.ptr(),
        (void*)enum_instances::_proc, &data);

    rc = _enum_instances_rc(status);

    if (rc == CMPI_RC_OK)
        CMReturnDone(result);

    RET("enumInstances", rc);
    return _status(rc);
}

CMPIStatus CMPI_Adapter::getInstance(CMPIInstanceMI* mi,
    const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* object_path, const char** properties)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("getInstance");

    const Meta_Class* mc = adapter->find_model_meta_class(_class_name_of(object_path));
    if (!mc)
    {
        RET("getInstance", CMPI_RC_ERR_FAILED);
        return _status(CMPI_RC_ERR_FAILED);
    }

    Instance* model_ptr = 0;
    CMPIrc rc = (CMPIrc)make_tessel_reference(0, mc, object_path, model_ptr);
    Ref<Instance> model(model_ptr);

    if (rc != CMPI_RC_OK)
    {
        RET("getInstance", rc);
        return _status(rc);
    }

    __set_null_flags(model.ptr(), true, true, 0);

    if (properties)
        filter_properties(model.ptr(), properties, true);

    Instance* instance_ptr = 0;
    sint32 status = adapter->get_instance(model.ptr(), instance_ptr);
    Ref<Instance> instance(instance_ptr);

    rc = _get_instance_rc(status);

    if (rc != CMPI_RC_OK)
    {
        RET("getInstance", rc);
        return _status(rc);
    }

    // A provider that claims success without an instance has found nothing.
    if (!instance)
    {
        RET("getInstance", CMPI_RC_ERR_NOT_FOUND);
        return _status(CMPI_RC_ERR_NOT_FOUND);
    }

    CMPIInstance* ci = 0;
    rc = (CMPIrc)make_cmpi_instance(adapter->broker, instance.ptr(),
        _name_space_of(object_path), object_path, properties, ci);

    if (rc != CMPI_RC_OK)
    {
        RET("getInstance", rc);
        return _status(rc);
    }

    CMReturnInstance(result, ci);
    CMRelease(ci);
    CMReturnDone(result);

    RET("getInstance", CMPI_RC_OK);
    return _status(CMPI_RC_OK);
}

CMPIStatus CMPI_Adapter::createInstance(CMPIInstanceMI* mi,
    const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* object_path, const CMPIInstance* cmpi_instance)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("createInstance");

    const Meta_Class* mc = adapter->find_model_meta_class(_class_name_of(object_path));
    if (!mc)
    {
        RET("createInstance", CMPI_RC_ERR_FAILED);
        return _status(CMPI_RC_ERR_FAILED);
    }

    Instance* instance_ptr = 0;
    CMPIrc rc = (CMPIrc)make_tessel_instance(
        adapter->broker, mc, object_path, cmpi_instance, instance_ptr);
    Ref<Instance> instance(instance_ptr);

    if (rc != CMPI_RC_OK)
    {
        RET("createInstance", rc);
        return _status(rc);
    }

    sint32 status = adapter->call(OP_CREATE_INSTANCE, instance.ptr());
    rc = _create_instance_rc(status);

    if (rc != CMPI_RC_OK)
    {
        RET("createInstance", rc);
        return _status(rc);
    }

    if (status == CREATE_INSTANCE_OK)
    {
        // The provider may have completed the keys.
        CMPIObjectPath* path = 0;
        rc = (CMPIrc)make_cmpi_object_path(
            adapter->broker, instance.ptr(), _name_space_of(object_path), path);

        if (rc != CMPI_RC_OK)
        {
            RET("createInstance", rc);
            return _status(rc);
        }

        CMReturnObjectPath(result, path);
        CMRelease(path);
        CMReturnDone(result);
    }

    RET("createInstance", CMPI_RC_OK);
    return _status(CMPI_RC_OK);
}

CMPIStatus CMPI_Adapter::modifyInstance(CMPIInstanceMI* mi,
    const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* object_path, const CMPIInstance* cmpi_instance,
    const char** properties)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("modifyInstance");

    const Meta_Class* mc = adapter->find_model_meta_class(_class_name_of(object_path));
    if (!mc)
    {
        RET("modifyInstance", CMPI_RC_ERR_FAILED);
        return _status(CMPI_RC_ERR_FAILED);
    }

    Instance* instance_ptr = 0;
    CMPIrc rc = (CMPIrc)make_tessel_instance(
        adapter->broker, mc, object_path, cmpi_instance, instance_ptr);
    Ref<Instance> instance(instance_ptr);

    if (rc != CMPI_RC_OK)
    {
        RET("modifyInstance", rc);
        return _status(rc);
    }

    Ref<Instance> model(clone(instance.ptr()));
    filter_properties(model.ptr(), properties, true);

    sint32 status = adapter->call(OP_MODIFY_INSTANCE, model.ptr(), instance.ptr());
    rc = _modify_instance_rc(status);

    if (rc != CMPI_RC_OK)
    {
        RET("modifyInstance", rc);
        return _status(rc);
    }

    if (status == MODIFY_INSTANCE_OK)
    {
        CMReturnObjectPath(result, object_path);
        CMReturnDone(result);
    }

    RET("modifyInstance", CMPI_RC_OK);
    return _status(CMPI_RC_OK);
}

CMPIStatus CMPI_Adapter::deleteInstance(CMPIInstanceMI* mi,
    const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* object_path)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("deleteInstance");

    const Meta_Class* mc = adapter->find_model_meta_class(_class_name_of(object_path));
    if (!mc)
    {
        RET("deleteInstance", CMPI_RC_ERR_FAILED);
        return _status(CMPI_RC_ERR_FAILED);
    }

    Instance* instance_ptr = 0;
    CMPIrc rc = (CMPIrc)make_tessel_reference(0, mc, object_path, instance_ptr);
    Ref<Instance> instance(instance_ptr);

    if (rc != CMPI_RC_OK)
    {
        RET("deleteInstance", rc);
        return _status(rc);
    }

    sint32 status = adapter->call(OP_DELETE_INSTANCE, instance.ptr());
    rc = _delete_instance_rc(status);

    if (rc == CMPI_RC_OK)
        CMReturnDone(result);

    RET("deleteInstance", rc);
    return _status(rc);
}

CMPIStatus CMPI_Adapter::execQuery(CMPIInstanceMI*, const CMPIContext*,
    const CMPIResult*, const CMPIObjectPath*, const char*, const char*)
{
    ENT("execQuery");
    RET("execQuery", CMPI_RC_ERR_NOT_SUPPORTED);
    return _status(CMPI_RC_ERR_NOT_SUPPORTED);
}

//
// Method operations.
//

CMPIStatus CMPI_Adapter::invokeMethod(CMPIMethodMI* mi,
    const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* object_path, const char* method,
    const CMPIArgs* in_args, CMPIArgs* out_args)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("invokeMethod");

    const Meta_Class* mc = adapter->find_model_meta_class(_class_name_of(object_path));
    if (!mc)
    {
        RET("invokeMethod", CMPI_RC_ERR_FAILED, "MetaClass not found");
        return _status(CMPI_RC_ERR_FAILED);
    }

    const Meta_Method* mm =
        (const Meta_Method*)find_feature(mc, method ? method : "", FLAG_METHOD);

    if (!mm)
    {
        RET("invokeMethod", CMPI_RC_ERR_METHOD_NOT_FOUND, method ? method : "");
        return _status(CMPI_RC_ERR_METHOD_NOT_FOUND);
    }

    Instance* reference_ptr = 0;
    CMPIrc rc = (CMPIrc)make_tessel_reference(0, mc, object_path, reference_ptr);
    Ref<Instance> reference(reference_ptr);

    if (rc != CMPI_RC_OK)
    {
        RET("invokeMethod", rc, "TESSEL reference creation failed");
        return _status(rc);
    }

    Instance* method_ptr = 0;
    rc = (CMPIrc)make_tessel_method(0, mc, mm, object_path, in_args, adapter, method_ptr);
    Ref<Instance> method_instance(method_ptr);

    if (rc != CMPI_RC_OK)
    {
        RET("invokeMethod", rc, "TESSEL make_tessel_method function failed");
        return _status(rc);
    }

    sint32 status = adapter->call(OP_INVOKE_METHOD, reference.ptr(), method_instance.ptr());
    rc = _invoke_method_rc(status);

    if (rc != CMPI_RC_OK)
    {
        RET("invokeMethod", rc);
        return _status(rc);
    }

    CMPIValue value;
    CMPIType type = 0;
    rc = (CMPIrc)make_cmpi_method(adapter->broker, _name_space_of(object_path),
        method_instance.ptr(), out_args, value, type);

    if (rc != CMPI_RC_OK)
    {
        RET("invokeMethod", rc);
        return _status(rc);
    }

    CMReturnData(result, &value, type);
    CMReturnDone(result);

    // The server has copied the result.
    CMPIData data;
    data.type = type;
    data.state = 0;
    data.value = value;
    _release_cmpi_data(data);

    RET("invokeMethod", CMPI_RC_OK);
    return _status(CMPI_RC_OK);
}

//
// Association operations. The request's path names the source object; the
// association class is the provider's own.
//

namespace association
{
    // The record of the four operations' callbacks.
    struct Data
    {
        const CMPIBroker* broker;
        const CMPIContext* context;
        const CMPIResult* result;
        const char* name_space;
        const char** properties;
        unsigned rc;
    };

    // An instance's own namespace, else the request's.
    static const char* _name_space(const Instance* instance, const Data* data)
    {
        return instance->__name_space.size() ? instance->__name_space.c_str() : data->name_space;
    }

    static CMPIrc _names_rc(sint32 status)
    {
        switch (status)
        {
            case ENUM_ASSOCIATOR_NAMES_OK: return CMPI_RC_OK;
            case ENUM_ASSOCIATOR_NAMES_FAILED: return CMPI_RC_ERR_FAILED;
            case ENUM_ASSOCIATOR_NAMES_ACCESS_DENIED: return CMPI_RC_ERR_ACCESS_DENIED;
            case ENUM_ASSOCIATOR_NAMES_UNSUPPORTED: return CMPI_RC_ERR_NOT_SUPPORTED;
        }
        return CMPI_RC_OK;
    }

    static CMPIrc _references_rc(sint32 status)
    {
        switch (status)
        {
            case ENUM_REFERENCES_OK: return CMPI_RC_OK;
            case ENUM_REFERENCES_FAILED: return CMPI_RC_ERR_FAILED;
            case ENUM_REFERENCES_ACCESS_DENIED: return CMPI_RC_ERR_ACCESS_DENIED;
            case ENUM_REFERENCES_UNSUPPORTED: return CMPI_RC_ERR_NOT_SUPPORTED;
        }
        return CMPI_RC_OK;
    }
}

namespace associator_names
{
    static bool _proc(Instance* instance, Enum_Associator_Names_Status, void* client_data)
    {
        if (!instance)
            return false;

        Ref<Instance> hold(instance);
        association::Data* data = (association::Data*)client_data;

        if (data->rc != 0)
            return false;

        CMPIObjectPath* path = 0;
        data->rc = make_cmpi_object_path(data->broker, instance,
            association::_name_space(instance, data), path);

        if (data->rc == 0)
        {
            CMReturnObjectPath(data->result, path);
            CMRelease(path);
        }

        return true;
    }
}

namespace associators1
{
    static bool _proc(Instance* instance, Enum_Associators_Status, void* client_data)
    {
        if (!instance)
            return false;

        Ref<Instance> hold(instance);
        association::Data* data = (association::Data*)client_data;

        if (data->rc != 0)
            return false;

        CMPIInstance* ci = 0;

        if (make_cmpi_instance(data->broker, instance, association::_name_space(instance, data),
            0, data->properties, ci) != 0)
        {
            data->rc = 1;
            return false;
        }

        CMReturnInstance(data->result, ci);
        CMRelease(ci);
        return true;
    }
}

namespace associators2
{
    // The other end comes whole from the server, which may ask another
    // provider of the module for it.
    static bool _proc(Instance* instance, Enum_Associator_Names_Status, void* client_data)
    {
        if (!instance)
            return false;

        Ref<Instance> hold(instance);
        association::Data* data = (association::Data*)client_data;

        if (data->rc != 0)
            return false;

        CMPIObjectPath* path = 0;
        data->rc = make_cmpi_object_path(data->broker, instance,
            association::_name_space(instance, data), path);

        if (data->rc != 0)
            return false;

        CMPIInstance* ci = CBGetInstance(data->broker, data->context, path, data->properties, 0);
        CMRelease(path);

        if (!ci)
        {
            data->rc = 1;
            return false;
        }

        CMReturnInstance(data->result, ci);
        CMRelease(ci);
        return true;
    }
}

namespace references
{
    static bool _proc(Instance* instance, Enum_References_Status, void* client_data)
    {
        if (!instance)
            return false;

        Ref<Instance> hold(instance);
        association::Data* data = (association::Data*)client_data;

        if (data->rc != 0)
            return false;

        CMPIObjectPath* path = 0;

        if (make_cmpi_object_path(data->broker, instance, data->name_space, path) != 0)
            return false;

        filter_properties(instance, data->properties, false);

        CMPIInstance* ci = 0;
        data->rc = make_cmpi_instance(data->broker, instance, data->name_space, path,
            data->properties, ci);

        if (data->rc != 0)
            return false;

        CMReturnInstance(data->result, ci);
        CMRelease(ci);
        return true;
    }
}

namespace reference_names
{
    static bool _proc(Instance* instance, Enum_References_Status, void* client_data)
    {
        if (!instance)
            return false;

        Ref<Instance> hold(instance);
        association::Data* data = (association::Data*)client_data;

        if (data->rc != 0)
            return false;

        // Paths of the association's keys alone, whatever else the
        // provider filled in.
        __set_null_flags(instance, false, true, 1);

        CMPIObjectPath* path = 0;
        data->rc = make_cmpi_object_path(data->broker, instance, data->name_space, path);

        if (data->rc != 0)
            return false;

        CMReturnObjectPath(data->result, path);
        CMRelease(path);
        return true;
    }
}

// The source object of an association request, as an instance of its own
// class: null (and rc set) if it can't be had.
static Instance* _source(CMPI_Adapter* adapter, const CMPIObjectPath* object_path,
    const char* name, CMPIrc& rc)
{
    rc = CMPI_RC_OK;
    const Meta_Class* mc = find_meta_class(adapter->meta_repository(), _class_name_of(object_path));

    if (!mc)
    {
        // No result, and no failure: the class is none of the module's.
        if (strcmp(name, "associators") == 0)
            CMPI_Adapter::ret(TESSEL_FILE_BASENAME, __LINE__, name, CMPI_RC_OK);
        else
            CMPI_Adapter::ret(TESSEL_FILE_BASENAME, __LINE__, name, CMPI_RC_ERR_INVALID_CLASS);
        return 0;
    }

    Instance* source = 0;
    rc = (CMPIrc)make_tessel_reference(0, mc, object_path, source);

    if (rc != CMPI_RC_OK)
    {
        CMPI_Adapter::ret(TESSEL_FILE_BASENAME, __LINE__, name, rc);
        return 0;
    }

    return source;
}

static String _filter(const char* text)
{
    return String(text ? text : "");
}

CMPIStatus CMPI_Adapter::associators(CMPIAssociationMI* mi, const CMPIContext* context,
    const CMPIResult* result, const CMPIObjectPath* object_path, const char*,
    const char* result_class, const char* role, const char* result_role,
    const char** properties)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("associators");

    CMPIrc rc;
    Ref<Instance> source(_source(adapter, object_path, "associators", rc));
    if (!source)
        return _status(rc);

    String rclass = _filter(result_class);
    String rrole = _filter(role);
    String rresult_role = _filter(result_role);
    association::Data data =
        { adapter->broker, context, result, _name_space_of(object_path), properties, 0 };

    sint32 status = adapter->call(OP_ENUM_ASSOCIATORS, source.ptr(), &rclass, &rrole,
        &rresult_role, (void*)associators1::_proc, &data);

    switch (status)
    {
        case ENUM_ASSOCIATORS_OK:
            RET("associators", CMPI_RC_OK);
            return _status(CMPI_RC_OK);
        case ENUM_ASSOCIATORS_FAILED:
            RET("associators", CMPI_RC_ERR_FAILED);
            return _status(CMPI_RC_ERR_FAILED);
        case ENUM_ASSOCIATORS_ACCESS_DENIED:
            RET("associators", CMPI_RC_ERR_ACCESS_DENIED);
            return _status(CMPI_RC_ERR_ACCESS_DENIED);
    }

    data.rc = 0;
    status = adapter->enum_associator_names(source.ptr(), rclass, rrole, rresult_role,
        associators2::_proc, &data);
    rc = association::_names_rc(status);

    RET("associators", rc);
    return _status(rc);
}

CMPIStatus CMPI_Adapter::associatorNames(CMPIAssociationMI* mi, const CMPIContext* context,
    const CMPIResult* result, const CMPIObjectPath* object_path, const char*,
    const char* result_class, const char* role, const char* result_role)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("associatorNames");

    CMPIrc rc;
    Ref<Instance> source(_source(adapter, object_path, "associatorNames", rc));
    if (!source)
        return _status(rc);

    association::Data data =
        { adapter->broker, context, result, _name_space_of(object_path), 0, 0 };
    sint32 status = adapter->enum_associator_names(source.ptr(), _filter(result_class),
        _filter(role), _filter(result_role), associator_names::_proc, &data);
    rc = association::_names_rc(status);

    RET("associatorNames", rc);
    return _status(rc);
}

// references and referenceNames: the provider's associations that refer to
// the source, whole or as paths.
static CMPIrc _references(CMPI_Adapter* adapter, const CMPIContext* context,
    const CMPIResult* result, const CMPIObjectPath* object_path, const char* role,
    const char** properties, bool names)
{
    const char* name = names ? "referenceNames" : "references";
    CMPIrc rc;
    Ref<Instance> source(_source(adapter, object_path, name, rc));
    if (!source)
        return rc;

    const Meta_Class* mc = adapter->meta_class();
    Ref<Instance> model(create(mc, false));
    if (names)
        __set_null_flags(model.ptr(), false, true, 1);
    __set_name_space_recursive(model.ptr(), _name_space_of(object_path), false);

    association::Data data =
        { adapter->broker, context, result, _name_space_of(object_path), properties, 0 };
    sint32 status = adapter->enum_references(source.ptr(), model.ptr(), _filter(role),
        names ? reference_names::_proc : references::_proc, &data);
    rc = association::_references_rc(status);

    CMPI_Adapter::ret(TESSEL_FILE_BASENAME, __LINE__, name, rc);
    return rc;
}

CMPIStatus CMPI_Adapter::references(CMPIAssociationMI* mi, const CMPIContext* context,
    const CMPIResult* result, const CMPIObjectPath* object_path, const char*,
    const char* role, const char** properties)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("references");
    return _status(_references(adapter, context, result, object_path, role, properties, false));
}

CMPIStatus CMPI_Adapter::referenceNames(CMPIAssociationMI* mi, const CMPIContext* context,
    const CMPIResult* result, const CMPIObjectPath* object_path, const char*,
    const char* role)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("referenceNames");
    return _status(_references(adapter, context, result, object_path, role, 0, true));
}

//
// Indication operations. The adapter counts the namespaces of active
// filters; the provider, once enabled, sends its indications from a thread
// of its own through _indication_proc, which delivers each to every such
// namespace.
//

// Called by the provider's handler, on the provider's thread, whose
// context (inherited from the enabling request) reaches the server.
//
// disableIndications holds the lock for its whole run while the provider
// waits there for this very thread to end, so a delivery must not simply
// block on the lock: it waits for it only while indications stay enabled,
// and gives up (false, nothing sent) once a disable has begun. The
// provider still holds what it handed over a copy of, and keeps it.
// indications_enabled is read here without the lock, hence the atomics
// wherever it changes.
static bool _indication_proc(Instance* instance, void* client_data)
{
    CMPI_Adapter* adapter = (CMPI_Adapter*)client_data;
    Ref<Instance> hold(instance);

    while (adapter->lock.try_lock() != 0)
    {
        if (!__atomic_load_n(&adapter->indications_enabled, __ATOMIC_ACQUIRE))
            return false;
        Time::sleep(Time::MSEC);
    }

    struct Held { Mutex& m; ~Held() { m.unlock(); } } held = { adapter->lock };

    if (!instance)
        return false;

    CMPI_Thread_Context* top = static_cast<CMPI_Thread_Context*>(Thread_Context::top());

    if (!top || !top->broker || !top->context)
    {
        TLOG(LL_WARN, "no thread context: indication of %s dropped", instance->meta_class->name);
        return true;
    }

    for (size_t i = 0; i < adapter->name_spaces.size(); i++)
    {
        // No request ends on this thread to free what the conversion makes:
        // once the server has the indication, it goes.
        CMPI_Made made;
        const char* ns = adapter->name_spaces[i].name_space.c_str();
        CMPIInstance* ci = 0;

        if (make_cmpi_instance(adapter->broker, instance, ns, 0, 0, ci, &made) != 0)
            continue;

        CBDeliverIndication(top->broker, top->context, ns, ci);
        CMRelease(ci);
    }

    return true;
}

CMPIStatus CMPI_Adapter::authorizeFilter(CMPIIndicationMI*, const CMPIContext*,
    const CMPISelectExp*, const char*, const CMPIObjectPath*, const char*)
{
    ENT("authorizeFilter");
    RET("authorizeFilter", CMPI_RC_OK);
    return _status(CMPI_RC_OK);
}

CMPIStatus CMPI_Adapter::mustPoll(CMPIIndicationMI*, const CMPIContext*,
    const CMPISelectExp*, const char*, const CMPIObjectPath*)
{
    ENT("mustPoll");
    RET("mustPoll", CMPI_RC_OK);
    return _status(CMPI_RC_OK);
}

CMPIStatus CMPI_Adapter::activateFilter(CMPIIndicationMI* mi, const CMPIContext*,
    const CMPISelectExp*, const char*, const CMPIObjectPath* object_path, CMPIBoolean)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Auto_Mutex auto_lock(adapter->lock);
    ENT("activateFilter");

    Name_Space_Entry entry(_name_space_of(object_path), 1);
    size_t pos = adapter->name_spaces.find(entry);

    if (pos == (size_t)-1)
        adapter->name_spaces.append(entry);
    else
        adapter->name_spaces[pos].ref_count++;

    RET("activateFilter", CMPI_RC_OK);
    return _status(CMPI_RC_OK);
}

CMPIStatus CMPI_Adapter::deactivateFilter(CMPIIndicationMI* mi, const CMPIContext*,
    const CMPISelectExp*, const char*, const CMPIObjectPath* object_path, CMPIBoolean)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Auto_Mutex auto_lock(adapter->lock);
    ENT("deactivateFilter");

    Name_Space_Entry entry(_name_space_of(object_path), 1);
    size_t pos = adapter->name_spaces.find(entry);

    if (pos != (size_t)-1)
    {
        if (adapter->name_spaces[pos].ref_count <= 1)
            adapter->name_spaces.remove(pos);
        else
            adapter->name_spaces[pos].ref_count--;
    }

    RET("deactivateFilter", CMPI_RC_OK);
    return _status(CMPI_RC_OK);
}

CMPIStatus CMPI_Adapter::enableIndications(CMPIIndicationMI* mi, const CMPIContext* context)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    // The provider starts its thread here, which inherits this context.
    Request_Frame frame(adapter, context);
    ENT("enableIndications");

    if (adapter->indications_enabled)
    {
        RET("enableIndications", CMPI_RC_OK);
        return _status(CMPI_RC_OK);
    }

    __atomic_store_n(&adapter->indications_enabled, true, __ATOMIC_RELEASE);
    sint32 status = adapter->call(OP_ENABLE_INDICATIONS, (void*)_indication_proc, adapter);

    if (status == ENABLE_INDICATIONS_FAILED)
    {
        RET("enableIndications", CMPI_RC_ERR_FAILED);
        return _status(CMPI_RC_ERR_FAILED);
    }

    RET("enableIndications", CMPI_RC_OK);
    return _status(CMPI_RC_OK);
}

CMPIStatus CMPI_Adapter::disableIndications(CMPIIndicationMI* mi, const CMPIContext* context)
{
    CMPI_Adapter* adapter = _adapter(mi);
    if (!adapter)
        return _status(CMPI_RC_ERR_FAILED);

    Request_Frame frame(adapter, context);
    ENT("disableIndications");

    if (!adapter->indications_enabled)
        return _status(CMPI_RC_OK);

    // Cleared before the provider waits for its thread, so that a delivery
    // of that thread gives up rather than wait for our lock. The lock stays
    // held: letting it go here would let an enableIndications in, which
    // would reach the provider while it is still stopping.
    __atomic_store_n(&adapter->indications_enabled, false, __ATOMIC_RELEASE);
    sint32 status = adapter->call(OP_DISABLE_INDICATIONS);

    if (status == DISABLE_INDICATIONS_FAILED)
    {
        RET("disableIndications", CMPI_RC_ERR_FAILED);
        return _status(CMPI_RC_ERR_FAILED);
    }

    RET("disableIndications", CMPI_RC_OK);
    return _status(CMPI_RC_OK);
}

} // namespace OLMA
