#ifndef _VSPR_MethodRegistration_h
#define _VSPR_MethodRegistration_h

namespace OLMA
{

// The one place that lists the method families of the console protocol.
class MethodRegistration
{
public:
    static void registerMethods();
};

} // namespace OLMA

#endif // _VSPR_MethodRegistration_h
