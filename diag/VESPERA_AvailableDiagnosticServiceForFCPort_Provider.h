#ifndef _VESPERA_AvailableDiagnosticServiceForFCPort_Provider_h
#define _VESPERA_AvailableDiagnosticServiceForFCPort_Provider_h

namespace OLMA
{

// Serves VESPERA_AvailableDiagnosticServiceForFCPort. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_AvailableDiagnosticServiceForFCPort_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_AvailableDiagnosticServiceForFCPort_Provider_h
