#ifndef _VSPR_HDRManager_h
#define _VSPR_HDRManager_h

#include "Array.h"
#include "Instance.h"
#include "ProviderTypes.h"

namespace OLMA
{

class PortHelper;

// The facade for host discovered resources: the storage extents, tape
// drives and logical disks behind the FC ports. The caller owns the
// instances of the returned array.
class HDRManager
{
public:

    HDRManager();

    static HDRManager* getHDRManager();

    Array<Instance*> getInstances(classId_t id);

    // The one storage extent, tape drive or logical disk whose keys model
    // holds, as getInstances would give it; null if it gives none. Only the
    // port and remote port that its DeviceID names are read. The caller
    // owns the instance.
    Instance* getInstance(classId_t id, const Instance* model);

    static HDRManager* helperObj;

    // Walks the ports and asks its TargetHelper for what lies behind each.
    PortHelper* portHelper;

private:

    HDRManager(const HDRManager&);
    HDRManager& operator=(const HDRManager&);
};

extern HDRManager gHDRManagerObj;

} // namespace OLMA

#endif
