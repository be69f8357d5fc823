#ifndef _VESPERA_EthLoopbackDiagnosticTest_Provider_h
#define _VESPERA_EthLoopbackDiagnosticTest_Provider_h

namespace OLMA
{

// Serves VESPERA_EthLoopbackDiagnosticTest. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_EthLoopbackDiagnosticTest_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_EthLoopbackDiagnosticTest_Provider_h
