// The module paces its delivery thread with Time::sleep, a select() with no
// descriptors. This executable exports its own select() (see
// CMakeLists.txt), which the module binds to in place of the C library's,
// and which shortens or holds such waits; every other select() goes on to
// the real one.

#include "FastClock.h"

#include <dlfcn.h>
#include <sys/select.h>

#include <atomic>
#include <condition_variable>
#include <cstdint>
#include <mutex>

namespace
{

std::atomic<unsigned> gDivisor{100};
std::mutex gMutex;
std::condition_variable gResumed;
bool gPaused = false;

typedef int (*Select)(int, fd_set*, fd_set*, fd_set*, struct timeval*);

Select realSelect()
{
    static Select real = (Select)dlsym(RTLD_NEXT, "select");
    return real;
}

} // namespace

void fast_clock::setDivisor(unsigned divisor)
{
    gDivisor = divisor ? divisor : 1;
}

void fast_clock::pause()
{
    std::lock_guard<std::mutex> g(gMutex);
    gPaused = true;
}

void fast_clock::resume()
{
    {
        std::lock_guard<std::mutex> g(gMutex);
        gPaused = false;
    }
    gResumed.notify_all();
}

extern "C" int select(int nfds, fd_set* readfds, fd_set* writefds, fd_set* exceptfds,
                      struct timeval* timeout)
{
    if (nfds != 0 || readfds || writefds || exceptfds || !timeout)
        return realSelect()(nfds, readfds, writefds, exceptfds, timeout);

    {
        std::unique_lock<std::mutex> g(gMutex);
        gResumed.wait(g, [] { return !gPaused; });
    }

    uint64_t us = uint64_t(timeout->tv_sec) * 1000000u + uint64_t(timeout->tv_usec);
    us /= gDivisor.load();
    struct timeval shorter;
    shorter.tv_sec = time_t(us / 1000000u);
    shorter.tv_usec = suseconds_t(us % 1000000u);
    return realSelect()(0, nullptr, nullptr, nullptr, &shorter);
}
