#ifndef _VESPERA_PhysicalConnector_Provider_h
#define _VESPERA_PhysicalConnector_Provider_h

#include "Provider.h"
#include "VESPERA_PhysicalConnector.h"

namespace OLMA
{

// Serves VESPERA_PhysicalConnector: enumeration only, from FCHBAManager.
class VESPERA_PhysicalConnector_Provider
{
public:

    VESPERA_PhysicalConnector_Provider();

    ~VESPERA_PhysicalConnector_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_PhysicalConnector* model, VESPERA_PhysicalConnector*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_PhysicalConnector* model, Enum_Instances_Handler<VESPERA_PhysicalConnector>* handler);

    Create_Instance_Status create_instance(VESPERA_PhysicalConnector* instance);

    Delete_Instance_Status delete_instance(const VESPERA_PhysicalConnector* instance);

    Modify_Instance_Status modify_instance(const VESPERA_PhysicalConnector* model, const VESPERA_PhysicalConnector* instance);
};

} // namespace OLMA

#endif // _VESPERA_PhysicalConnector_Provider_h
