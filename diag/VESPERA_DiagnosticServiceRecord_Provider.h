#ifndef _VESPERA_DiagnosticServiceRecord_Provider_h
#define _VESPERA_DiagnosticServiceRecord_Provider_h

namespace OLMA
{

// Serves VESPERA_DiagnosticServiceRecord. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_DiagnosticServiceRecord_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticServiceRecord_Provider_h
