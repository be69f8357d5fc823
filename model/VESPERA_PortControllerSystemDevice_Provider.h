#ifndef _VESPERA_PortControllerSystemDevice_Provider_h
#define _VESPERA_PortControllerSystemDevice_Provider_h

namespace OLMA
{

// Serves VESPERA_PortControllerSystemDevice. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_PortControllerSystemDevice_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_PortControllerSystemDevice_Provider_h
