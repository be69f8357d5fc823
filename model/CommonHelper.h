#ifndef _VSPR_CommonHelper_h
#define _VSPR_CommonHelper_h

#include "Array.h"
#include "Instance.h"
#include "ProviderTypes.h"

namespace OLMA
{

// Builds the one VESPERA_ComputerSystem that stands for this host. Every
// adapter and port instance names it through SystemName, which is the same
// host string of ProviderUtil::getHostInfo.
class CommonHelper
{
public:

    CommonHelper();

    static CommonHelper* getCommonHelperObject();

    // One new instance, of the class of id, whatever the adapters are.
    Array<Instance*> getComputerSystemInstances(classId_t id);

    static CommonHelper* helperObj;

private:

    CommonHelper(const CommonHelper&);
    CommonHelper& operator=(const CommonHelper&);
};

extern CommonHelper gCommonHelperObj;

} // namespace OLMA

#endif
