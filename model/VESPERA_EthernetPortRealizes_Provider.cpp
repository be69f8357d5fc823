#include "VESPERA_EthernetPortRealizes_Provider.h"
#include "log.h"

namespace OLMA
{

VESPERA_EthernetPortRealizes_Provider::VESPERA_EthernetPortRealizes_Provider()
{
}

VESPERA_EthernetPortRealizes_Provider::~VESPERA_EthernetPortRealizes_Provider()
{
}

Load_Status VESPERA_EthernetPortRealizes_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_EthernetPortRealizes_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_EthernetPortRealizes_Provider::get_instance(const VESPERA_EthernetPortRealizes*, VESPERA_EthernetPortRealizes*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_EthernetPortRealizes_Provider::enum_instances(
    const VESPERA_EthernetPortRealizes*, Enum_Instances_Handler<VESPERA_EthernetPortRealizes>*)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_EthernetPortRealizes_Provider::create_instance(VESPERA_EthernetPortRealizes*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_EthernetPortRealizes_Provider::delete_instance(const VESPERA_EthernetPortRealizes*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_EthernetPortRealizes_Provider::modify_instance(const VESPERA_EthernetPortRealizes*, const VESPERA_EthernetPortRealizes*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Enum_Associator_Names_Status VESPERA_EthernetPortRealizes_Provider::enum_associator_names(const Instance*,
    const String&, const String&, const String&, Enum_Associator_Names_Handler<Instance>*)
{
    return ENUM_ASSOCIATOR_NAMES_UNSUPPORTED;
}

Enum_Associators_Status VESPERA_EthernetPortRealizes_Provider::enum_associators(const Instance*,
    const String&, const String&, const String&, Enum_Associators_Handler<Instance>*)
{
    return ENUM_ASSOCIATORS_UNSUPPORTED;
}

Enum_References_Status VESPERA_EthernetPortRealizes_Provider::enum_references(const Instance*,
    const VESPERA_EthernetPortRealizes*, const String&, Enum_References_Handler<VESPERA_EthernetPortRealizes>*)
{
    return ENUM_REFERENCES_UNSUPPORTED;
}

} // namespace OLMA
