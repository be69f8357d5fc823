#include "VESPERA_Product_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_Product_Provider::VESPERA_Product_Provider()
{
}

VESPERA_Product_Provider::~VESPERA_Product_Provider()
{
}

Load_Status VESPERA_Product_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_Product_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_Product_Provider::get_instance(const VESPERA_Product*, VESPERA_Product*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_Product_Provider::enum_instances(
    const VESPERA_Product*, Enum_Instances_Handler<VESPERA_Product>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_Product);

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

Create_Instance_Status VESPERA_Product_Provider::create_instance(VESPERA_Product*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_Product_Provider::delete_instance(const VESPERA_Product*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_Product_Provider::modify_instance(const VESPERA_Product*, const VESPERA_Product*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

} // namespace OLMA
