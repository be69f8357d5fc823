#ifndef _VESPERA_ElementConformsToProfile_Provider_h
#define _VESPERA_ElementConformsToProfile_Provider_h

namespace OLMA
{

// Serves VESPERA_ElementConformsToProfile. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ElementConformsToProfile_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_ElementConformsToProfile_Provider_h
