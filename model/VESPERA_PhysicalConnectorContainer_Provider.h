#ifndef _VESPERA_PhysicalConnectorContainer_Provider_h
#define _VESPERA_PhysicalConnectorContainer_Provider_h

namespace OLMA
{

// Serves VESPERA_PhysicalConnectorContainer. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_PhysicalConnectorContainer_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_PhysicalConnectorContainer_Provider_h
