#ifndef _VESPERA_SubProfileRequiresProfile_Provider_h
#define _VESPERA_SubProfileRequiresProfile_Provider_h

namespace OLMA
{

// Serves VESPERA_SubProfileRequiresProfile. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_SubProfileRequiresProfile_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_SubProfileRequiresProfile_Provider_h
