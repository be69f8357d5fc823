#ifndef _OLMA_Thread_h
#define _OLMA_Thread_h

#include <pthread.h>
#include "config.h"

namespace OLMA
{

// A POSIX thread handle; copies are plain copies of the handle. A thread
// started from a thread that has a Thread_Context gets one of its own from
// that context's thread_create_hook(), so it can reach the CIM server too.
class Thread
{
public:
    Thread() : _thread(0) { }

    // 0, or the error of pthread_create().
    static int create_joinable(Thread& thread, void* (*proc)(void*), void* arg);
    static int create_detached(Thread& thread, void* (*proc)(void*), void* arg);

    // Runs the top context's exit hook, then ends the calling thread.
    [[noreturn]] static void exit(void* return_value);

    // The result of pthread_join(); return_value is null on failure.
    static int join(Thread& thread, void*& return_value);

    static Thread self();

    static bool equal(const Thread& x, const Thread& y);

    pthread_t _thread;
};

} // namespace OLMA

#endif // _OLMA_Thread_h
