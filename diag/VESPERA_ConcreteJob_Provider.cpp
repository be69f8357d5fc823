#include "VESPERA_ConcreteJob_Provider.h"

#include "DiagnosticProviders.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_ConcreteJob_Provider::enum_instances(
    const VESPERA_ConcreteJob*, Enum_Instances_Handler<VESPERA_ConcreteJob>* handler)
{
    return enumDiagnosticInstances(ID_VESPERA_ConcreteJob, handler, DIAG_ANY_NUMBER, LL_INFO,
        "No jobs are currently running in the system.", true);
}

} // namespace OLMA
