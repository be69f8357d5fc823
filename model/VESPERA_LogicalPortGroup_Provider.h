#ifndef _VESPERA_LogicalPortGroup_Provider_h
#define _VESPERA_LogicalPortGroup_Provider_h

#include "Provider.h"
#include "VESPERA_LogicalPortGroup.h"

namespace OLMA
{

// Serves VESPERA_LogicalPortGroup: enumeration only, from FCHBAManager.
class VESPERA_LogicalPortGroup_Provider
{
public:

    Enum_Instances_Status enum_instances(
        const VESPERA_LogicalPortGroup* model, Enum_Instances_Handler<VESPERA_LogicalPortGroup>* handler);
};

} // namespace OLMA

#endif // _VESPERA_LogicalPortGroup_Provider_h
