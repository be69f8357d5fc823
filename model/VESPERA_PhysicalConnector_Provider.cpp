#include "VESPERA_PhysicalConnector_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_PhysicalConnector_Provider::VESPERA_PhysicalConnector_Provider()
{
}

VESPERA_PhysicalConnector_Provider::~VESPERA_PhysicalConnector_Provider()
{
}

Load_Status VESPERA_PhysicalConnector_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_PhysicalConnector_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_PhysicalConnector_Provider::get_instance(const VESPERA_PhysicalConnector*, VESPERA_PhysicalConnector*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_PhysicalConnector_Provider::enum_instances(
    const VESPERA_PhysicalConnector*, Enum_Instances_Handler<VESPERA_PhysicalConnector>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_PhysicalConnector);

    if (instances.size() == 0)
    {
        TLOG(LL_ERR, "No Connector Found!");
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    TLOG(LL_DBG, "Returning instances");
    deliverInstances(instances, handler);

    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_PhysicalConnector_Provider::create_instance(VESPERA_PhysicalConnector*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_PhysicalConnector_Provider::delete_instance(const VESPERA_PhysicalConnector*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_PhysicalConnector_Provider::modify_instance(const VESPERA_PhysicalConnector*, const VESPERA_PhysicalConnector*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

} // namespace OLMA
