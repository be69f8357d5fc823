#ifndef _VESPERA_DiagnosticServiceRecord_Provider_h
#define _VESPERA_DiagnosticServiceRecord_Provider_h

#include "Provider.h"
#include "VESPERA_DiagnosticServiceRecord.h"

namespace OLMA
{

// Serves VESPERA_DiagnosticServiceRecord. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_DiagnosticServiceRecord_Provider
{
public:

    VESPERA_DiagnosticServiceRecord_Provider();

    ~VESPERA_DiagnosticServiceRecord_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_DiagnosticServiceRecord* model, VESPERA_DiagnosticServiceRecord*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_DiagnosticServiceRecord* model, Enum_Instances_Handler<VESPERA_DiagnosticServiceRecord>* handler);

    Create_Instance_Status create_instance(VESPERA_DiagnosticServiceRecord* instance);

    Delete_Instance_Status delete_instance(const VESPERA_DiagnosticServiceRecord* instance);

    Modify_Instance_Status modify_instance(const VESPERA_DiagnosticServiceRecord* model, const VESPERA_DiagnosticServiceRecord* instance);
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticServiceRecord_Provider_h
