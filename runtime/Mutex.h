#ifndef _OLMA_Mutex_h
#define _OLMA_Mutex_h

#include <pthread.h>
#include "config.h"

namespace OLMA
{

class Mutex
{
public:
    // A default POSIX mutex, or a recursive one.
    explicit Mutex(bool recursive = false);

    ~Mutex();

    // A failure here is fatal: nothing sensible can go on without the lock.
    void lock();

    // 0 if taken, EBUSY if another holds it, -1 on any other failure.
    int try_lock();

    void unlock();

private:
    Mutex(const Mutex&);
    Mutex& operator=(const Mutex&);

    pthread_mutex_t _mutex;
};

// Holds a mutex for the life of a scope.
class Auto_Mutex
{
public:
    explicit Auto_Mutex(Mutex& mutex) : _mutex(mutex) { _mutex.lock(); }

    ~Auto_Mutex() { _mutex.unlock(); }

private:
    Auto_Mutex(const Auto_Mutex&);
    Auto_Mutex& operator=(const Auto_Mutex&);

    Mutex& _mutex;
};

} // namespace OLMA

#endif // _OLMA_Mutex_h
