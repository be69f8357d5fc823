#ifndef _VESPERA_AvailableDiagnosticServiceForAdapter_Provider_h
#define _VESPERA_AvailableDiagnosticServiceForAdapter_Provider_h

namespace OLMA
{

// Serves VESPERA_AvailableDiagnosticServiceForAdapter. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_AvailableDiagnosticServiceForAdapter_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_AvailableDiagnosticServiceForAdapter_Provider_h
