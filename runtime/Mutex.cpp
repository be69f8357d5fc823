#include "Mutex.h"
#include <cerrno>
#include "log.h"

namespace OLMA
{

Mutex::Mutex(bool recursive)
{
    pthread_mutexattr_t attr;
    pthread_mutexattr_init(&attr);

    if (recursive)
        pthread_mutexattr_settype(&attr, PTHREAD_MUTEX_RECURSIVE);

    pthread_mutex_init(&_mutex, &attr);
    pthread_mutexattr_destroy(&attr);
}

Mutex::~Mutex()
{
    pthread_mutex_destroy(&_mutex);
}

void Mutex::lock()
{
    TESSEL_ASSERT(pthread_mutex_lock(&_mutex) == 0);
}

int Mutex::try_lock()
{
    const int r = pthread_mutex_trylock(&_mutex);

    if (r == 0)
        return 0;

    return r == EBUSY ? EBUSY : -1;
}

void Mutex::unlock()
{
    pthread_mutex_unlock(&_mutex);
}

} // namespace OLMA
