#ifndef _VESPERA_DiagnosticSoftwareIdentity_Provider_h
#define _VESPERA_DiagnosticSoftwareIdentity_Provider_h

#include "Provider.h"
#include "VESPERA_DiagnosticSoftwareIdentity.h"

namespace OLMA
{

// Serves VESPERA_DiagnosticSoftwareIdentity. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_DiagnosticSoftwareIdentity_Provider
{
public:

    VESPERA_DiagnosticSoftwareIdentity_Provider();

    ~VESPERA_DiagnosticSoftwareIdentity_Provider();

    Load_Status load();

    Unload_Status unload();

    Get_Instance_Status get_instance(const VESPERA_DiagnosticSoftwareIdentity* model, VESPERA_DiagnosticSoftwareIdentity*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_DiagnosticSoftwareIdentity* model, Enum_Instances_Handler<VESPERA_DiagnosticSoftwareIdentity>* handler);

    Create_Instance_Status create_instance(VESPERA_DiagnosticSoftwareIdentity* instance);

    Delete_Instance_Status delete_instance(const VESPERA_DiagnosticSoftwareIdentity* instance);

    Modify_Instance_Status modify_instance(const VESPERA_DiagnosticSoftwareIdentity* model, const VESPERA_DiagnosticSoftwareIdentity* instance);
};

} // namespace OLMA

#endif // _VESPERA_DiagnosticSoftwareIdentity_Provider_h
