#ifndef _OLMA_VESPERA_ProfileSoftwareIdentity_Provider_h
#define _OLMA_VESPERA_ProfileSoftwareIdentity_Provider_h

#include "Provider.h"
#include "VESPERA_ProfileSoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_ProfileSoftwareIdentity, the provider's own software.
// Read-only: instances come from ServerManager, and no method does anything.
class VESPERA_ProfileSoftwareIdentity_Provider
{
public:

    VESPERA_ProfileSoftwareIdentity_Provider();

    ~VESPERA_ProfileSoftwareIdentity_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_ProfileSoftwareIdentity* model, VESPERA_ProfileSoftwareIdentity*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_ProfileSoftwareIdentity* model, Enum_Instances_Handler<VESPERA_ProfileSoftwareIdentity>* handler);

    Create_Instance_Status create_instance(VESPERA_ProfileSoftwareIdentity* instance);

    Delete_Instance_Status delete_instance(const VESPERA_ProfileSoftwareIdentity* instance);

    Modify_Instance_Status modify_instance(const VESPERA_ProfileSoftwareIdentity* model, const VESPERA_ProfileSoftwareIdentity* instance);
};

} // namespace OLMA

#endif // _OLMA_VESPERA_ProfileSoftwareIdentity_Provider_h
