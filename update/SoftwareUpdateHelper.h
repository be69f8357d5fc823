#ifndef _VSPR_SoftwareUpdateHelper_h
#define _VSPR_SoftwareUpdateHelper_h

#include "AdapterHelper.h"
#include "Array.h"
#include "Instance.h"
#include "ProviderTypes.h"
#include "String.h"
#include "VESPERA_HBASoftwareInstallationService.h"
#include "VESPERA_HBASoftwareInstallationServiceCapabilities.h"
#include "VESPERA_PortController.h"

namespace OLMA
{

// The one software installation service of the host and its capabilities,
// and the writing of an image to an adapter's flash. It keeps no state.
class SoftwareUpdateHelper
{
public:

    static SoftwareUpdateHelper* getSoftwareUpdateHelperInstance();

    // One new instance for the service (18) or its capabilities (19); none
    // for any other class.
    Array<Instance*> getInstancesByClass(classId_t id);

    // Of the record only hostName is read.
    VESPERA_HBASoftwareInstallationService*
        getHBASoftwareInstallationServiceInstance(_adapterData data);
    VESPERA_HBASoftwareInstallationServiceCapabilities*
        getHBASoftwareInstallationServiceCapabilitiesInstance(_adapterData data);

    // Hands file to the library to be written to the adapter's flash, and
    // waits for it. The library's "status" (0 is success), or -1 if it
    // couldn't be asked or gave no usable answer.
    int UpdatePortControllerSoftware(const VESPERA_PortController* adapter, const char* file);

    // A new directory that only this process's user can enter, for one
    // download: under $TMPDIR if that names a directory, else /tmp. Empty,
    // after an ERR line, if it can't be made.
    static String makeDownloadDirectory();

    // Removes a directory that makeDownloadDirectory made, with whatever the
    // download left in it. Symbolic links in it are removed, never followed.
    static void removeDownloadDirectory(const String& dir);

    static SoftwareUpdateHelper* swUpdateObj;
};

extern SoftwareUpdateHelper gSoftwareUpdateHelperObj;

// The service's Name, which is also the capabilities' InstanceID.
extern const char* const SOFTWARE_UPDATE_SERVICE_NAME;

} // namespace OLMA

#endif
