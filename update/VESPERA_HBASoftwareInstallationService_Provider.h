#ifndef _VESPERA_HBASoftwareInstallationService_Provider_h
#define _VESPERA_HBASoftwareInstallationService_Provider_h

#include "CIM_ConcreteJob.h"
#include "CIM_ManagedElement.h"
#include "Provider.h"
#include "VESPERA_HBASoftwareInstallationService.h"

namespace OLMA
{

// Serves VESPERA_HBASoftwareInstallationService: the host's one instance,
// and InstallFromURI, which writes an image from a file or a tftp server to
// one adapter's flash and returns when the adapter is done.
class VESPERA_HBASoftwareInstallationService_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_HBASoftwareInstallationService* model,
        Enum_Instances_Handler<VESPERA_HBASoftwareInstallationService>* handler);

    Invoke_Method_Status InstallFromURI(
        const VESPERA_HBASoftwareInstallationService* self,
        CIM_ConcreteJob*& Job,
        const Property<String>& URI,
        const CIM_ManagedElement* Target,
        const Property<Array<uint16> >& InstallOptions,
        const Property<Array<String> >& InstallOptionsValues,
        Property<uint32>& return_value);
};

} // namespace OLMA

#endif // _VESPERA_HBASoftwareInstallationService_Provider_h
