#ifndef _VESPERA_ConcreteJob_Provider_h
#define _VESPERA_ConcreteJob_Provider_h

namespace OLMA
{

// Serves VESPERA_ConcreteJob. Until its data source is wired it has no instances and
// supports no other operation.
class VESPERA_ConcreteJob_Provider
{
};

} // namespace OLMA

#endif // _VESPERA_ConcreteJob_Provider_h
