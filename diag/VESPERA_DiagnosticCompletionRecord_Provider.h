#ifndef _VESPERA_DiagnosticCompletionRecord_Provider_h
#define _VESPERA_DiagnosticCompletionRecord_Provider_h

namespace OLMA
{

// Serves VESPERA_DiagnosticCompletionRecord. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_DiagnosticCompletionRecord_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticCompletionRecord_Provider_h
