#ifndef _VESPERA_PhysicalPackage_Provider_h
#define _VESPERA_PhysicalPackage_Provider_h

#include "Provider.h"
#include "VESPERA_PhysicalPackage.h"
#include "CIM_PhysicalElement.h"

namespace OLMA
{

// Serves VESPERA_PhysicalPackage: enumeration only, from FCHBAManager.
class VESPERA_PhysicalPackage_Provider
{
public:

    VESPERA_PhysicalPackage_Provider();

    ~VESPERA_PhysicalPackage_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_PhysicalPackage* model, VESPERA_PhysicalPackage*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_PhysicalPackage* model, Enum_Instances_Handler<VESPERA_PhysicalPackage>* handler);

    Create_Instance_Status create_instance(VESPERA_PhysicalPackage* instance);

    Delete_Instance_Status delete_instance(const VESPERA_PhysicalPackage* instance);

    Modify_Instance_Status modify_instance(const VESPERA_PhysicalPackage* model, const VESPERA_PhysicalPackage* instance);

    Invoke_Method_Status IsCompatible(
        const VESPERA_PhysicalPackage* self,
        const CIM_PhysicalElement* ElementToCheck,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_PhysicalPackage_Provider_h
