#ifndef _VSPR_FCHBAManager_h
#define _VSPR_FCHBAManager_h

#include "Array.h"
#include "Instance.h"
#include "String.h"
#include "ProviderTypes.h"

namespace OLMA
{

// The facade through which providers ask for the instances of adapters,
// ports and everything that belongs to them, by class id. It checks the
// driver status and hands the request to the helper that owns the class.
// Every array it returns holds new instances that the caller owns.
class FCHBAManager
{
public:

    FCHBAManager();

    static FCHBAManager* getFCHBAManager();

    Array<Instance*> getInstances(classId_t id);

    Array<Instance*> getFCPortInstancesByAdapter(String address);
    Array<Instance*> getEthernetPortInstancesByAdapter(String address);

    Array<Instance*> getAllDiagnosticTestInstances();
    Array<Instance*> getDiagnosticServicesForAdapter();
    Array<Instance*> getDiagnosticServicesForFCPort();
    Array<Instance*> getDiagnosticServicesForEthernetPort();

    static FCHBAManager* helperObj;

private:

    FCHBAManager(const FCHBAManager&);
    FCHBAManager& operator=(const FCHBAManager&);
};

extern FCHBAManager gFCHBAManagerObj;

} // namespace OLMA

#endif
