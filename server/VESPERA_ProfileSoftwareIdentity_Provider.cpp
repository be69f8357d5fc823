#include "VESPERA_ProfileSoftwareIdentity_Provider.h"
#include "ServerEnum.h"

namespace OLMA
{

VESPERA_ProfileSoftwareIdentity_Provider::VESPERA_ProfileSoftwareIdentity_Provider()
{
}

VESPERA_ProfileSoftwareIdentity_Provider::~VESPERA_ProfileSoftwareIdentity_Provider()
{
}

Load_Status VESPERA_ProfileSoftwareIdentity_Provider::load()
{
    return LOAD_OK;
}

Unload_Status VESPERA_ProfileSoftwareIdentity_Provider::unload()
{
    return UNLOAD_OK;
}

Get_Instance_Status VESPERA_ProfileSoftwareIdentity_Provider::get_instance(const VESPERA_ProfileSoftwareIdentity*, VESPERA_ProfileSoftwareIdentity*&)
{
    return GET_INSTANCE_UNSUPPORTED;
}

Enum_Instances_Status VESPERA_ProfileSoftwareIdentity_Provider::enum_instances(
    const VESPERA_ProfileSoftwareIdentity*, Enum_Instances_Handler<VESPERA_ProfileSoftwareIdentity>* handler)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");
    size_t count = 0;
    sendServerInstances(ID_VESPERA_ProfileSoftwareIdentity, handler, &count);
    if (count == 0)
    {
        // The module always has exactly one identity; none means something
        // is badly wrong, and the client should hear of it.
        TLOG(LL_ERR, "Error: Invalid number of ProfileSoftwareIdentity Instances");
        return ENUM_INSTANCES_FAILED;
    }
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

Create_Instance_Status VESPERA_ProfileSoftwareIdentity_Provider::create_instance(VESPERA_ProfileSoftwareIdentity*)
{
    return CREATE_INSTANCE_UNSUPPORTED;
}

Delete_Instance_Status VESPERA_ProfileSoftwareIdentity_Provider::delete_instance(const VESPERA_ProfileSoftwareIdentity*)
{
    return DELETE_INSTANCE_UNSUPPORTED;
}

Modify_Instance_Status VESPERA_ProfileSoftwareIdentity_Provider::modify_instance(const VESPERA_ProfileSoftwareIdentity*, const VESPERA_ProfileSoftwareIdentity*)
{
    return MODIFY_INSTANCE_UNSUPPORTED;
}

} // namespace OLMA
