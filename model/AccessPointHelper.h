#ifndef _VSPR_AccessPointHelper_h
#define _VSPR_AccessPointHelper_h

#include "AdapterHelper.h"
#include "Array.h"
#include "Instance.h"
#include "ProviderTypes.h"
#include "VESPERA_RemoteServiceAccessPoint.h"

namespace OLMA
{

// Builds the VESPERA_RemoteServiceAccessPoint that tells a client where the
// management console's agent (zarkagent) serves its page on this host. It
// exists only while the agent runs; each call looks at the process list.
class AccessPointHelper
{
public:

    AccessPointHelper();

    static AccessPointHelper* getAccessPointHelperInstance();

    // At most one new instance; none on a host known only as "localhost",
    // since no client elsewhere could reach it by that name.
    Array<Instance*> getInstancesByClass(classId_t id);

    // A new instance for the host of data.hostName (nothing else of the
    // record is read), or null if the agent doesn't run.
    VESPERA_RemoteServiceAccessPoint* getRemoteServiceAccessPointInstance(
        _adapterData data);

    static AccessPointHelper* helperObj;

private:

    AccessPointHelper(const AccessPointHelper&);
    AccessPointHelper& operator=(const AccessPointHelper&);
};

extern AccessPointHelper gAccessPointHelperObj;

} // namespace OLMA

#endif
