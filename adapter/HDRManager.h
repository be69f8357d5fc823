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
