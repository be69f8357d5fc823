#ifndef _VSPR_DiagnosticProviders_h
#define _VSPR_DiagnosticProviders_h

// What the eight diagnostic providers share: their enumeration, and the
// checks and outcome of RunDiagnostic.

#include "DiagnosticHelper.h"
#include "FCHBAManager.h"
#include "InstanceDelivery.h"
#include "Provider.h"
#include "log.h"

#include "CIM_ConcreteJob.h"
#include "CIM_ManagedElement.h"

namespace OLMA
{

enum Diagnostic_Count
{
    // The class has one instance or, as far as a client is told, none.
    DIAG_EXACTLY_ONE,
    DIAG_ANY_NUMBER
};

// Delivers the class's instances from the facade. An empty answer (or,
// for a class of exactly one, any other number) logs emptyText at level and
// delivers nothing.
template<class T>
Enum_Instances_Status enumDiagnosticInstances(classId_t id, Enum_Instances_Handler<T>* handler,
    Diagnostic_Count count, Log_Level level, const char* emptyText, bool logReturning)
{
    TLOG(LL_DBG, "Entering: %s", "enum_instances");

    Array<Instance*> instances = FCHBAManager::getFCHBAManager()->getInstances(id);

    if (instances.size() == 0 || (count == DIAG_EXACTLY_ONE && instances.size() != 1))
    {
        TLOG(level, "%s", emptyText);
        destroyInstances(instances);
        TLOG(LL_DBG, "Returning: %s", "enum_instances");
        return ENUM_INSTANCES_OK;
    }

    if (logReturning)
        TLOG(LL_DBG, "Returning instances");

    deliverInstances(instances, handler);
    TLOG(LL_DBG, "Returning: %s", "enum_instances");
    return ENUM_INSTANCES_OK;
}

// The DeviceID of the element that RunDiagnostic is to test, if it is of
// the class the test is for (compared without regard to case).
bool diagnosticElement(const CIM_ManagedElement* element, const char* className,
    String& deviceId);

// Hands a runner's result to the method's out parameters, and frees it.
void diagnosticOutcome(DiagnosticRunResult* result, CIM_ConcreteJob*& Job,
    Property<uint32>& return_value);

// A refused request: a null job and the status.
void diagnosticRefusal(CIM_ConcreteJob*& Job, Property<uint32>& return_value, uint32 status);

// A running test must not outlive the last of the test providers.
inline Load_Status diagnosticTestLoad()
{
    TLOG(LL_DBG, "Entering: %s", "load");
    DiagnosticHelper::getDiagnosticHelperObject()->testProviderLoaded();
    return LOAD_OK;
}

inline Unload_Status diagnosticTestUnload()
{
    TLOG(LL_DBG, "Entering: %s", "unload");
    DiagnosticHelper::getDiagnosticHelperObject()->testProviderUnloaded();
    return UNLOAD_OK;
}

} // namespace OLMA

#endif
