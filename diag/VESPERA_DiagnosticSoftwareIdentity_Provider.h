#ifndef _VESPERA_DiagnosticSoftwareIdentity_Provider_h
#define _VESPERA_DiagnosticSoftwareIdentity_Provider_h

namespace OLMA
{

// Serves VESPERA_DiagnosticSoftwareIdentity. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_DiagnosticSoftwareIdentity_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticSoftwareIdentity_Provider_h
