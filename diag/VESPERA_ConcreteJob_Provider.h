#ifndef _VESPERA_ConcreteJob_Provider_h
#define _VESPERA_ConcreteJob_Provider_h

#include "Provider.h"
#include "VESPERA_ConcreteJob.h"

namespace OLMA
{

// Serves VESPERA_ConcreteJob: the job of the latest diagnostic run, while no later run has started. Enumeration only.
class VESPERA_ConcreteJob_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_ConcreteJob* model, Enum_Instances_Handler<VESPERA_ConcreteJob>* handler);
};

} // namespace OLMA

#endif // _VESPERA_ConcreteJob_Provider_h
