#ifndef _VSPR_ProviderInit_h
#define _VSPR_ProviderInit_h

namespace OLMA
{

// Brings the adapter library up while the module is being loaded (the one
// global object gProviderInit) and takes it down when the module goes.
class ProviderInit
{
public:

    ProviderInit();

    ~ProviderInit();

    static int getDriverStatus();

    // 0: the library initialised and found at least one adapter; 1: anything
    // else. 2 (driver not installed) and 3 (library mismatch) are read by
    // ProviderUtil::getDriverStatus but never set here.
    static int driverStatus;

private:

    ProviderInit(const ProviderInit&);
    ProviderInit& operator=(const ProviderInit&);
};

extern ProviderInit gProviderInit;

} // namespace OLMA

#endif
