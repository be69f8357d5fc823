#ifndef _VESPERA_PCILoopbackDiagnosticTest_Provider_h
#define _VESPERA_PCILoopbackDiagnosticTest_Provider_h

namespace OLMA
{

// Serves VESPERA_PCILoopbackDiagnosticTest. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_PCILoopbackDiagnosticTest_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_PCILoopbackDiagnosticTest_Provider_h
