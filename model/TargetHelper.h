#ifndef _VSPR_TargetHelper_h
#define _VSPR_TargetHelper_h

#include <json/json.h>

#include "Array.h"
#include "Instance.h"
#include "ProviderTypes.h"
#include "PortHelper.h"

namespace OLMA
{

// One logical unit behind a remote port, as read from getCompleteRemotePort.
// Zeroed for each unit; the fixed widths are those of the SCSI inquiry data.
struct _hbaLunInfo
{
    unsigned int number;
    char rPortWwn[24];      // plain form
    char vendor[9];
    char productId[17];
    char serialNumber[65];
    char description[65];
    unsigned int idType;    // kind of description; 0 and 10 are ours, see below
};

// Kinds of _hbaLunInfo::idType besides the library's "lunDescIdType".
enum
{
    LUN_ID_SERIAL = 0,      // named by vendor, product and serial number
    LUN_ID_NONE = 10        // nothing usable names the unit
};

// What a host reaches through one FC port: the logical units behind its
// remote target ports, as VESPERA_StorageExtent and VESPERA_LogicalDisk
// (disk-like devices) or VESPERA_TapeDrive (tape and media changers).
// Called per port by the walk of PortHelper. Arrays hold new instances that
// the caller owns; a remote port or unit that can't be read is left out.
class TargetHelper
{
public:

    TargetHelper();

    static TargetHelper* getTargetHelperObject();

    // For id 9, 16 or 38; any other id gives nothing. With a lookup, the
    // units that can't be the one it looks for aren't built, and the walk
    // stops at the one that is.
    Array<Instance*> getTargetInstances(_hbaPortInfo port, classId_t id,
        const _keyLookup* lookup = 0);

    // The "deviceData" of an element of getAllRemotePorts, if the list
    // carries it whole enough to tell a target and its kind; null if only
    // getCompleteRemotePort can tell.
    static const Json::Value* listedDeviceData(const Json::Value& remotePort);

    Instance* getStorageExtentInstance(_hbaPortInfo port, _hbaLunInfo lun);
    Instance* getTapeDriveInstance(_hbaPortInfo port, _hbaLunInfo lun);
    Instance* getLogicalDiskInstance(_hbaPortInfo port, _hbaLunInfo lun);

    static TargetHelper* helperObj;

private:

    TargetHelper(const TargetHelper&);
    TargetHelper& operator=(const TargetHelper&);
};

extern TargetHelper gTargetHelperObj;

} // namespace OLMA

#endif
