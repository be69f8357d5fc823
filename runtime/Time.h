#ifndef _OLMA_Time_h
#define _OLMA_Time_h

#include "config.h"

namespace OLMA
{

// Microsecond clock and sleep.
class Time
{
public:
    static constexpr uint64 USEC = 1ULL;
    static constexpr uint64 MSEC = 1000ULL;
    static constexpr uint64 SEC = 1000000ULL;

    // Microseconds since the Epoch.
    static uint64 now();

    static void sleep(uint64 microseconds);
};

} // namespace OLMA

#endif // _OLMA_Time_h
