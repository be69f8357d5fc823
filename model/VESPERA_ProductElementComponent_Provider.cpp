#include "VESPERA_ProductElementComponent_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_ProductElementComponent_Provider::VESPERA_ProductElementComponent_Provider()
{
}

VESPERA_ProductElementComponent_Provider::~VESPERA_ProductElementComponent_Provider()
{
}

Load_Status VESPERA_ProductElementComponent_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_ProductElementComponent_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_ProductElementComponent_Provider::get_instance(const VESPERA_ProductElementComponent*, VESPERA_ProductElementComponent*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_ProductElementComponent_Provider::enum_instances(
    const VESPERA_ProductElementComponent*, Enum_Instances_Handler<VESPERA_ProductElementComponent>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_ProductElementComponent_Provider::create_instance(VESPERA_ProductElementComponent*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_ProductElementComponent_Provider::delete_instance(const VESPERA_ProductElementComponent*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_ProductElementComponent_Provider::modify_instance(const VESPERA_ProductElementComponent*, const VESPERA_ProductElementComponent*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Enum_Associator_Names_Status VESPERA_ProductElementComponent_Provider::enum_associator_names(const Instance*,
    const String&, const String&, const String&, Enum_Associator_Names_Handler<Instance>*)
{
    return ENUM_ASSOCIATOR_NAMES_UNSUPPORTED;
}

Enum_Associators_Status VESPERA_ProductElementComponent_Provider::enum_associators(const Instance*,
    const String&, const String&, const String&, Enum_Associators_Handler<Instance>*)
{
    return ENUM_ASSOCIATORS_UNSUPPORTED;
}

Enum_References_Status VESPERA_ProductElementComponent_Provider::enum_references(const Instance*,
    const VESPERA_ProductElementComponent*, const String&, Enum_References_Handler<VESPERA_ProductElementComponent>*)
{
    return ENUM_REFERENCES_UNSUPPORTED;
}

} // namespace OLMA
