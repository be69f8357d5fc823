#include <strings.h>
#include "Provider_Handle.h"
#include "log.h"

namespace OLMA
{

Provider_Handle::Provider_Handle(const Registration* registration_) :
    registration(registration_), proc(registration_->proc), provider(0)
{
    proc(registration, OP_CREATE_PROVIDER, &provider, 0, 0, 0, 0, 0, 0, 0);
}

Provider_Handle::~Provider_Handle()
{
    proc(registration, OP_DESTROY_PROVIDER, provider, 0, 0, 0, 0, 0, 0, 0);
    provider = 0;
}

sint32 Provider_Handle::call(int operation, void* arg1, void* arg2, void* arg3,
    void* arg4, void* arg5, void* arg6) const
{
    return proc(registration, operation, provider, arg1, arg2, arg3, arg4, arg5, arg6, 0);
}

const Meta_Class* Provider_Handle::meta_class() const
{
    const Meta_Class* mc = 0;
    proc(registration, OP_GET_META_CLASS, &mc, 0, 0, 0, 0, 0, 0, 0);
    return mc;
}

const Meta_Repository* Provider_Handle::meta_repository() const
{
    const Meta_Repository* mr = 0;
    proc(registration, OP_GET_REPOSITORY, &mr, 0, 0, 0, 0, 0, 0, 0);
    return mr;
}

//
// get_instance by enumeration.
//

namespace get_instance
{
    struct Data
    {
        const Instance* model;
        Instance* result;
    };

    static bool _proc(Instance* instance, Enum_Instances_Status, void* client_data)
    {
        Data* data = (Data*)client_data;

        if (!instance)
            return false;

        if (!data->result && key_eq(data->model, instance))
        {
            data->result = instance;
            return false;
        }

        unref(instance);
        return true;
    }
}

Get_Instance_Status Provider_Handle::get_instance(const Instance* model, Instance*& instance)
{
    instance = 0;

    sint32 status = call(OP_GET_INSTANCE, (void*)model, &instance);

    if (status != GET_INSTANCE_UNSUPPORTED)
        return Get_Instance_Status(status);

    instance = 0;
    get_instance::Data data = { model, 0 };
    status = call(OP_ENUM_INSTANCES, (void*)model, (void*)get_instance::_proc, &data);

    if (status != ENUM_INSTANCES_OK || !data.result)
    {
        unref(data.result);
        return GET_INSTANCE_NOT_FOUND;
    }

    instance = data.result;
    return GET_INSTANCE_OK;
}

//
// Associations from enumeration.
//

static bool _class_is_named(const Meta_Class* mc, const char* name)
{
    for (; mc; mc = mc->super_meta_class)
    {
        if (strcasecmp(mc->name, name) == 0)
            return true;
    }
    return false;
}

ssize_t get_associators(const Instance* inst, const Instance* assoc_inst,
    const char* result_class, const char* role, const char* result_role,
    Array<const Instance*>& associators)
{
    const Meta_Class* mc = assoc_inst->meta_class;

    if (!mc || mc->num_meta_features == 0)
        return -1;

    bool found = false;
    ssize_t count = 0;
    size_t before = associators.size();

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (!(mf->flags & FLAG_REFERENCE))
            continue;

        const Meta_Reference* mr = (const Meta_Reference*)mf;

        if (mr->subscript != 0)
            continue;

        const Instance* value = *(const Instance* const*)__slot(assoc_inst, mr->offset);

        // A reference whose element has gone since the association was
        // made is no end, and can't be the source either.
        if (!value)
            continue;

        if (is_subclass(mr->meta_class, inst->meta_class) && key_eq(inst, value))
        {
            if (!(role && *role && strcasecmp(role, mr->name) != 0))
                found = true;
            continue;
        }

        if (result_class && *result_class && !_class_is_named(value->meta_class, result_class))
            continue;

        if (result_role && *result_role && strcasecmp(result_role, mr->name) != 0)
            continue;

        associators.append(value);
        count++;
    }

    if (found)
        return count;

    associators.remove(before, associators.size() - before);
    return -1;
}

bool is_reference_of(const Instance* inst, const Instance* assoc_inst, const char* role)
{
    const Meta_Class* mc = assoc_inst->meta_class;

    for (size_t i = 0; mc && i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (!(mf->flags & FLAG_REFERENCE) || ((const Meta_Reference*)mf)->subscript)
            continue;

        const Meta_Reference* mr = (const Meta_Reference*)mf;
        const Instance* value = *(const Instance* const*)__slot(assoc_inst, mr->offset);

        if (value && key_eq(inst, value))
        {
            if (!role || !*role || strcasecmp(role, mr->name) == 0)
                return true;
        }
    }

    return false;
}

namespace _enum_associator_names
{
    struct Data
    {
        const Instance* source;
        const String* result_class;
        const String* role;
        const String* result_role;
        Provider_Handle::Associator_Names_Proc proc;
        void* client_data;
    };

    static bool _proc(Instance* instance, Enum_Instances_Status, void* client_data)
    {
        Data* data = (Data*)client_data;

        if (!instance)
            return false;

        Array<const Instance*> ends;
        ssize_t n = get_associators(data->source, instance, data->result_class->c_str(),
            data->role->c_str(), data->result_role->c_str(), ends);

        for (ssize_t i = 0; i < n; i++)
        {
            ref(ends[i]);
            data->proc((Instance*)ends[i], ENUM_ASSOCIATOR_NAMES_OK, data->client_data);
        }

        unref(instance);
        return true;
    }
}

Enum_Associator_Names_Status Provider_Handle::enum_associator_names(
    const Instance* instance, const String& result_class, const String& role,
    const String& result_role, Associator_Names_Proc proc_, void* client_data)
{
    const Meta_Class* mc = meta_class();

    if (!mc || !(mc->flags & FLAG_ASSOCIATION))
        return ENUM_ASSOCIATOR_NAMES_FAILED;

    sint32 status = call(OP_ENUM_ASSOCIATOR_NAMES, (void*)instance, (void*)&result_class,
        (void*)&role, (void*)&result_role, (void*)proc_, client_data);

    if (status == ENUM_ASSOCIATOR_NAMES_OK || status == ENUM_ASSOCIATOR_NAMES_FAILED ||
        status == ENUM_ASSOCIATOR_NAMES_ACCESS_DENIED)
        return Enum_Associator_Names_Status(status);

    Instance* model = create(mc, false);
    __set_null_flags(model, false, true, 1);
    // A provider learns the request's namespace from its model, as it does
    // for an enumeration: the module serves some classes in more than one.
    __set_name_space_recursive(model, instance->__name_space.c_str(), false);

    _enum_associator_names::Data data =
        { instance, &result_class, &role, &result_role, proc_, client_data };
    status = call(OP_ENUM_INSTANCES, model, (void*)_enum_associator_names::_proc, &data);

    proc_(0, ENUM_ASSOCIATOR_NAMES_OK, client_data);
    destroy(model);

    if (status == ENUM_INSTANCES_FAILED)
        return ENUM_ASSOCIATOR_NAMES_FAILED;
    if (status == ENUM_INSTANCES_ACCESS_DENIED)
        return ENUM_ASSOCIATOR_NAMES_ACCESS_DENIED;
    return ENUM_ASSOCIATOR_NAMES_OK;
}

namespace enum_references
{
    struct Data
    {
        const Instance* source;
        const String* role;
        Provider_Handle::References_Proc proc;
        void* client_data;
    };

    static bool _proc(Instance* instance, Enum_Instances_Status, void* client_data)
    {
        Data* data = (Data*)client_data;

        if (!instance)
            return false;

        if (is_reference_of(data->source, instance, data->role->c_str()))
            data->proc(instance, ENUM_REFERENCES_OK, data->client_data);
        else
            unref(instance);

        return true;
    }
}

Enum_References_Status Provider_Handle::enum_references(const Instance* instance,
    const Instance* model, const String& role, References_Proc proc_, void* client_data)
{
    const Meta_Class* mc = meta_class();

    if (!mc || !(mc->flags & FLAG_ASSOCIATION))
        return ENUM_REFERENCES_FAILED;

    sint32 status = call(OP_ENUM_REFERENCES, (void*)instance, (void*)model, (void*)&role,
        (void*)proc_, client_data);

    if (status == ENUM_REFERENCES_OK || status == ENUM_REFERENCES_FAILED ||
        status == ENUM_REFERENCES_ACCESS_DENIED)
        return Enum_References_Status(status);

    enum_references::Data data = { instance, &role, proc_, client_data };
    status = call(OP_ENUM_INSTANCES, (void*)model, (void*)enum_references::_proc, &data);

    proc_(0, ENUM_REFERENCES_OK, client_data);

    if (status == ENUM_INSTANCES_FAILED)
        return ENUM_REFERENCES_FAILED;
    if (status == ENUM_INSTANCES_ACCESS_DENIED)
        return ENUM_REFERENCES_ACCESS_DENIED;
    return ENUM_REFERENCES_OK;
}

} // namespace OLMA
