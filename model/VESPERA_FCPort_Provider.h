#ifndef _VESPERA_FCPort_Provider_h
#define _VESPERA_FCPort_Provider_h

#include "Provider.h"
#include "VESPERA_FCPort.h"

namespace OLMA
{

// Serves VESPERA_FCPort from FCHBAManager: enumeration, and getInstance by
// looking up the one instance that the keys name.
class VESPERA_FCPort_Provider
{
public:

    Get_Instance_Status get_instance(const VESPERA_FCPort* model, VESPERA_FCPort*& instance);

    Enum_Instances_Status enum_instances(
        const VESPERA_FCPort* model, Enum_Instances_Handler<VESPERA_FCPort>* handler);
};

} // namespace OLMA

#endif // _VESPERA_FCPort_Provider_h
