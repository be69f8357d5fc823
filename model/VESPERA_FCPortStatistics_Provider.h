#ifndef _VESPERA_FCPortStatistics_Provider_h
#define _VESPERA_FCPortStatistics_Provider_h

#include "Provider.h"
#include "VESPERA_FCPortStatistics.h"

namespace OLMA
{

// Serves VESPERA_FCPortStatistics: enumeration only, from FCHBAManager.
class VESPERA_FCPortStatistics_Provider
{
public:

    VESPERA_FCPortStatistics_Provider();

    ~VESPERA_FCPortStatistics_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_FCPortStatistics* model, VESPERA_FCPortStatistics*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_FCPortStatistics* model, Enum_Instances_Handler<VESPERA_FCPortStatistics>* handler);

    Create_Instance_Status create_instance(VESPERA_FCPortStatistics* instance);

    Delete_Instance_Status delete_instance(const VESPERA_FCPortStatistics* instance);

    Modify_Instance_Status modify_instance(const VESPERA_FCPortStatistics* model, const VESPERA_FCPortStatistics* instance);

    Invoke_Method_Status ResetSelectedStats(
        const VESPERA_FCPortStatistics* self,
        const Property<Array<String> >& SelectedStatistics,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_FCPortStatistics_Provider_h
