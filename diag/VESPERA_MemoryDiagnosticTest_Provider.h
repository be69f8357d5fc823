#ifndef _VESPERA_MemoryDiagnosticTest_Provider_h
#define _VESPERA_MemoryDiagnosticTest_Provider_h

namespace OLMA
{

// Serves VESPERA_MemoryDiagnosticTest. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_MemoryDiagnosticTest_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_MemoryDiagnosticTest_Provider_h
