#ifndef _VESPERA_DiagnosticCompletionRecord_Provider_h
#define _VESPERA_DiagnosticCompletionRecord_Provider_h

#include "Provider.h"
#include "VESPERA_DiagnosticCompletionRecord.h"

namespace OLMA
{

// Serves VESPERA_DiagnosticCompletionRecord: the latest completion records of diagnostic runs, oldest first. Enumeration only.
class VESPERA_DiagnosticCompletionRecord_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_DiagnosticCompletionRecord* model, Enum_Instances_Handler<VESPERA_DiagnosticCompletionRecord>* handler);
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticCompletionRecord_Provider_h
