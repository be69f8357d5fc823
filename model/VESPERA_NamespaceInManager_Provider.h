#ifndef _VESPERA_NamespaceInManager_Provider_h
#define _VESPERA_NamespaceInManager_Provider_h

namespace OLMA
{

// Serves VESPERA_NamespaceInManager. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_NamespaceInManager_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_NamespaceInManager_Provider_h
