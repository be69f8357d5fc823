#ifndef _VSPR_FCHBAManager_h
#define _VSPR_FCHBAManager_h

#include "Array.h"
#include "Instance.h"
#include "String.h"
#include "ProviderTypes.h"

namespace OLMA
{

class AdapterHelper;
class PortHelper;
class CommonHelper;
class AccessPointHelper;
class SoftwareUpdateHelper;
class EthernetPortHelper;
class DiagnosticHelper;
class PhysicalAssetHelper;

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

    // The one instance of a class whose keys model holds, as getInstances
    // would give it (the first whose keys match); null if it gives none.
    // FC ports, their statistics, endpoints and alarms and the connectors
    // are looked up directly, the other classes among their instances. The
    // caller owns the instance.
    Instance* getInstance(classId_t id, const Instance* model);

    Array<Instance*> getFCPortInstancesByAdapter(String address);
    Array<Instance*> getEthernetPortInstancesByAdapter(String address);

    Array<Instance*> getAllDiagnosticTestInstances();
    Array<Instance*> getDiagnosticServicesForAdapter();
    Array<Instance*> getDiagnosticServicesForFCPort();
    Array<Instance*> getDiagnosticServicesForEthernetPort();

    static FCHBAManager* helperObj;

    // The helper singletons, set by the constructor. A helper that isn't
    // part of the module yet stays null, and its classes answer with no
    // instances.
    AdapterHelper* adapterHelper;
    PortHelper* portHelper;
    CommonHelper* commonHelper;
    AccessPointHelper* accessPointHelper;
    SoftwareUpdateHelper* softwareUpdateHelper;
    EthernetPortHelper* ethernetPortHelper;
    DiagnosticHelper* diagnosticHelper;
    PhysicalAssetHelper* physicalAssetHelper;

private:

    Array<Instance*> _serve(classId_t id);

    FCHBAManager(const FCHBAManager&);
    FCHBAManager& operator=(const FCHBAManager&);
};

extern FCHBAManager gFCHBAManagerObj;

// The first of instances whose keys model holds; the others are destroyed.
// Null if none matches.
Instance* firstWithKeys(Array<Instance*> instances, const Instance* model);

} // namespace OLMA

#endif
