#include "VESPERA_AdapterSoftwareIdentity_Provider.h"

#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "log.h"

namespace OLMA
{

VESPERA_AdapterSoftwareIdentity_Provider::VESPERA_AdapterSoftwareIdentity_Provider()
{
}

VESPERA_AdapterSoftwareIdentity_Provider::~VESPERA_AdapterSoftwareIdentity_Provider()
{
}

Load_Status VESPERA_AdapterSoftwareIdentity_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_AdapterSoftwareIdentity_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_AdapterSoftwareIdentity_Provider::get_instance(const VESPERA_AdapterSoftwareIdentity*, VESPERA_AdapterSoftwareIdentity*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_AdapterSoftwareIdentity_Provider::enum_instances(
    const VESPERA_AdapterSoftwareIdentity*, Enum_Instances_Handler<VESPERA_AdapterSoftwareIdentity>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances =
        FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_AdapterSoftwareIdentity);

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

Create_Instance_Status VESPERA_AdapterSoftwareIdentity_Provider::create_instance(VESPERA_AdapterSoftwareIdentity*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_AdapterSoftwareIdentity_Provider::delete_instance(const VESPERA_AdapterSoftwareIdentity*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_AdapterSoftwareIdentity_Provider::modify_instance(const VESPERA_AdapterSoftwareIdentity*, const VESPERA_AdapterSoftwareIdentity*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

} // namespace OLMA
