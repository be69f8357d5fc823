#include "DiagnosticProviders.h"

#include "CIM_LogicalDevice.h"
#include "VESPERA_ConcreteJob.h"

namespace OLMA
{

bool diagnosticElement(const CIM_ManagedElement* element, const char* className,
    String& deviceId)
{
    if (!element || !element->meta_class || !element->meta_class->name ||
        !String(element->meta_class->name).equali(className))
        return false;

    const CIM_LogicalDevice* device = checked_cast<CIM_LogicalDevice>(
        static_cast<const Instance*>(element));
    deviceId = device && !device->DeviceID.null ? device->DeviceID.value : String();
    return true;
}

void diagnosticRefusal(CIM_ConcreteJob*& Job, Property<uint32>& return_value, uint32 status)
{
    if (Job)
        unref(Job);
    Job = 0;
    return_value.set(status);
}

void diagnosticOutcome(DiagnosticRunResult* result, CIM_ConcreteJob*& Job,
    Property<uint32>& return_value)
{
    uint32 status = result ? result->status : (uint32)RUN_DIAG_RETURN_BUSY;
    TLOG(LL_INFO, "Return value: %d", (int)status);

    diagnosticRefusal(Job, return_value, status);

    if (result && result->job)
        Job = clone(result->job);

    delete result;
}

} // namespace OLMA
