#ifndef _VESPERA_AdapterSoftwareIdentity_Provider_h
#define _VESPERA_AdapterSoftwareIdentity_Provider_h

#include "Provider.h"
#include "VESPERA_AdapterSoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_AdapterSoftwareIdentity: enumeration only, from FCHBAManager.
class VESPERA_AdapterSoftwareIdentity_Provider
{
public:

    VESPERA_AdapterSoftwareIdentity_Provider();

    ~VESPERA_AdapterSoftwareIdentity_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_AdapterSoftwareIdentity* model, VESPERA_AdapterSoftwareIdentity*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_AdapterSoftwareIdentity* model, Enum_Instances_Handler<VESPERA_AdapterSoftwareIdentity>* handler);

    Create_Instance_Status create_instance(VESPERA_AdapterSoftwareIdentity* instance);

    Delete_Instance_Status delete_instance(const VESPERA_AdapterSoftwareIdentity* instance);

    Modify_Instance_Status modify_instance(const VESPERA_AdapterSoftwareIdentity* model, const VESPERA_AdapterSoftwareIdentity* instance);
};

} // namespace OLMA

#endif // _VESPERA_AdapterSoftwareIdentity_Provider_h
