#ifndef _VESPERA_StorageResourcesSystemDevice_Provider_h
#define _VESPERA_StorageResourcesSystemDevice_Provider_h

namespace OLMA
{

// Serves VESPERA_StorageResourcesSystemDevice. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_StorageResourcesSystemDevice_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_StorageResourcesSystemDevice_Provider_h
