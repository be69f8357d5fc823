#ifndef _VSPR_PhysicalAssetHelper_h
#define _VSPR_PhysicalAssetHelper_h

#include "Array.h"
#include "Instance.h"
#include "PortHelper.h"
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

    // The connector whose keys model holds, as the enumeration would give
    // it; null if it would give none. The caller owns the instance.
    Instance* getInstanceByKeys(classId_t id, const Instance* model);

    Instance* getPhysicalConnectorInstance(_sfpInfo sfp);

private:

    // All connectors, or with a lookup the one it looks for.
    void _walk(Array<Instance*>& result, const _keyLookup* lookup);

    static PhysicalAssetHelper* helperObj;
};

extern PhysicalAssetHelper gPhysicalAssetHelperObj;

} // namespace OLMA

#endif
