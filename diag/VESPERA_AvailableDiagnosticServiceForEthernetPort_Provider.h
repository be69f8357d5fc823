#ifndef _VESPERA_AvailableDiagnosticServiceForEthernetPort_Provider_h
#define _VESPERA_AvailableDiagnosticServiceForEthernetPort_Provider_h

namespace OLMA
{

// Serves VESPERA_AvailableDiagnosticServiceForEthernetPort. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_AvailableDiagnosticServiceForEthernetPort_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_AvailableDiagnosticServiceForEthernetPort_Provider_h
