#ifndef _VESPERA_DeviceSAPImplementation_Provider_h
#define _VESPERA_DeviceSAPImplementation_Provider_h

namespace OLMA
{

// Serves VESPERA_DeviceSAPImplementation. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_DeviceSAPImplementation_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_DeviceSAPImplementation_Provider_h
