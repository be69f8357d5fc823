#include "Time.h"
#include <cerrno>
#include <sys/select.h>
#include <sys/time.h>

namespace OLMA
{

uint64 Time::now()
{
    struct timeval tv;

    if (gettimeofday(&tv, 0) != 0)
        return 0;

    return (uint64)tv.tv_sec * SEC + (uint64)tv.tv_usec;
}

void Time::sleep(uint64 microseconds)
{
    // select() may return early on a signal; sleep out the rest so callers
    // can rely on the full delay.
    const uint64 deadline = now() + microseconds;
    uint64 left = microseconds;

    for (;;)
    {
        struct timeval tv;
        tv.tv_sec = (time_t)(left / SEC);
        tv.tv_usec = (suseconds_t)(left % SEC);

        if (select(0, 0, 0, 0, &tv) == 0 || errno != EINTR)
            return;

        const uint64 t = now();

        if (t >= deadline)
            return;

        left = deadline - t;
    }
}

} // namespace OLMA
