#ifndef _VESPERA_Realizes_Provider_h
#define _VESPERA_Realizes_Provider_h

namespace OLMA
{

// Serves VESPERA_Realizes. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_Realizes_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_Realizes_Provider_h
