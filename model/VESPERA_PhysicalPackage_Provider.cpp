#include "VESPERA_PhysicalPackage_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_PhysicalPackage_Provider::VESPERA_PhysicalPackage_Provider()
{
}

VESPERA_PhysicalPackage_Provider::~VESPERA_PhysicalPackage_Provider()
{
}

Load_Status VESPERA_PhysicalPackage_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_PhysicalPackage_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_PhysicalPackage_Provider::get_instance(const VESPERA_PhysicalPackage*, VESPERA_PhysicalPackage*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_PhysicalPackage_Provider::enum_instances(
    const VESPERA_PhysicalPackage*, Enum_Instances_Handler<VESPERA_PhysicalPackage>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_PhysicalPackage);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "No Adapter Found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_PhysicalPackage_Provider::create_instance(VESPERA_PhysicalPackage*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_PhysicalPackage_Provider::delete_instance(const VESPERA_PhysicalPackage*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_PhysicalPackage_Provider::modify_instance(const VESPERA_PhysicalPackage*, const VESPERA_PhysicalPackage*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

Invoke_Method_Status VESPERA_PhysicalPackage_Provider::IsCompatible(
    const VESPERA_PhysicalPackage*,
    const CIM_PhysicalElement*,
    Property<uint32>&)
{
    return INVOKE_METHOD_UNSUPPORTED;
}

} // namespace OLMA
