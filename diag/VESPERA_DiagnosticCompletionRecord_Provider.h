#ifndef _VESPERA_DiagnosticCompletionRecord_Provider_h
#define _VESPERA_DiagnosticCompletionRecord_Provider_h

#include "Provider.h"
#include "VESPERA_DiagnosticCompletionRecord.h"

namespace OLMA
{

// Serves VESPERA_DiagnosticCompletionRecord. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_DiagnosticCompletionRecord_Provider
{
public:

    VESPERA_DiagnosticCompletionRecord_Provider();

    ~VESPERA_DiagnosticCompletionRecord_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_DiagnosticCompletionRecord* model, VESPERA_DiagnosticCompletionRecord*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_DiagnosticCompletionRecord* model, Enum_Instances_Handler<VESPERA_DiagnosticCompletionRecord>* handler);

    Create_Instance_Status create_instance(VESPERA_DiagnosticCompletionRecord* instance);

    Delete_Instance_Status delete_instance(const VESPERA_DiagnosticCompletionRecord* instance);

    Modify_Instance_Status modify_instance(const VESPERA_DiagnosticCompletionRecord* model, const VESPERA_DiagnosticCompletionRecord* instance);
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticCompletionRecord_Provider_h
