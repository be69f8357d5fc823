#ifndef _VSPR_PhysicalAssetHelper_h
#define _VSPR_PhysicalAssetHelper_h

#include "Array.h"
#include "Instance.h"
#include "ProviderTypes.h"

namespace OLMA
{

// One port's transceiver as getOpticsSFP describes it. Texts are cut to
// their fields and always terminated.
struct _sfpInfo
{
    char vendorName[18];
    char vendorPart[18];
    char serialNumber[18];
    char tag[32];           // serial number, adapter id (from 1), port place (from 0)
    char extendedId[8];
    char speed[32];
    char revision[6];
};

// Shows the optical transceiver of each FC port as a VESPERA_PhysicalConnector.
class PhysicalAssetHelper
{
public:

    static PhysicalAssetHelper* getPhysicalAssetHelperObject();

    // New VESPERA_PhysicalConnector instances for id 35; the caller owns
    // them. Any other id gives none.
    Array<Instance*> getInstancesByClass(classId_t id);

    Instance* getPhysicalConnectorInstance(_sfpInfo sfp);

    static PhysicalAssetHelper* helperObj;
};

extern PhysicalAssetHelper gPhysicalAssetHelperObj;

} // namespace OLMA

#endif
