#ifndef _VESPERA_Product_Provider_h
#define _VESPERA_Product_Provider_h

#include "Provider.h"
#include "VESPERA_Product.h"

namespace OLMA
{

// Serves VESPERA_Product: enumeration only, from FCHBAManager.
class VESPERA_Product_Provider
{
public:

    VESPERA_Product_Provider();

    ~VESPERA_Product_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_Product* model, VESPERA_Product*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_Product* model, Enum_Instances_Handler<VESPERA_Product>* handler);

    Create_Instance_Status create_instance(VESPERA_Product* instance);

    Delete_Instance_Status delete_instance(const VESPERA_Product* instance);

    Modify_Instance_Status modify_instance(const VESPERA_Product* model, const VESPERA_Product* instance);
};

} // namespace OLMA

#endif // _VESPERA_Product_Provider_h
