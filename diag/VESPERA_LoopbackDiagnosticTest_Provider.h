#ifndef _VESPERA_LoopbackDiagnosticTest_Provider_h
#define _VESPERA_LoopbackDiagnosticTest_Provider_h

namespace OLMA
{

// Serves VESPERA_LoopbackDiagnosticTest. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_LoopbackDiagnosticTest_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_LoopbackDiagnosticTest_Provider_h
