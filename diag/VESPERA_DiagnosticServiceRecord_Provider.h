#ifndef _VESPERA_DiagnosticServiceRecord_Provider_h
#define _VESPERA_DiagnosticServiceRecord_Provider_h

#include "Provider.h"
#include "VESPERA_DiagnosticServiceRecord.h"

namespace OLMA
{

// Serves VESPERA_DiagnosticServiceRecord: the latest service records of diagnostic runs, oldest first. Enumeration only.
class VESPERA_DiagnosticServiceRecord_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_DiagnosticServiceRecord* model, Enum_Instances_Handler<VESPERA_DiagnosticServiceRecord>* handler);
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticServiceRecord_Provider_h
