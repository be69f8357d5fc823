#ifndef _VESPERA_DiagnosticElementSoftwareIdentity_Provider_h
#define _VESPERA_DiagnosticElementSoftwareIdentity_Provider_h

namespace OLMA
{

// Serves VESPERA_DiagnosticElementSoftwareIdentity. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_DiagnosticElementSoftwareIdentity_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticElementSoftwareIdentity_Provider_h
