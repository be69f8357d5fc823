#include "config.h"
#include <errno.h>
#include <fcntl.h>
#include <stdlib.h>
#include <string.h>
#include <unistd.h>
#include "File_Lock.h"

namespace OLMA {

struct File_Lock_Rep
{
    struct flock write_lock;
    struct flock unlock;
    int fd;
};

File_Lock::File_Lock(const char* path)
{
    _rep = static_cast<File_Lock_Rep*>(calloc(1, sizeof(File_Lock_Rep)));

    if (!_rep)
        return;

    // Both descriptions cover the whole file: start 0, length 0.
    _rep->write_lock.l_type = F_WRLCK;
    _rep->write_lock.l_whence = SEEK_SET;
    _rep->unlock.l_type = F_UNLCK;
    _rep->unlock.l_whence = SEEK_SET;
    _rep->fd = path ? open(path, O_WRONLY | O_CREAT | O_CLOEXEC, 0600) : -1;
}

File_Lock::~File_Lock()
{
    if (_rep)
    {
        if (_rep->fd >= 0)
            close(_rep->fd);

        free(_rep);
    }
}

bool File_Lock::okay() const
{
    return _rep && _rep->fd >= 0;
}

static int _set_lock(int fd, struct flock* fl)
{
    if (fd < 0)
        return -1;

    while (fcntl(fd, F_SETLKW, fl) != 0)
    {
        if (errno != EINTR)
            return -1;
    }

    return 0;
}

int File_Lock::lock()
{
    return _rep ? _set_lock(_rep->fd, &_rep->write_lock) : -1;
}

int File_Lock::unlock()
{
    return _rep ? _set_lock(_rep->fd, &_rep->unlock) : -1;
}

} // namespace OLMA
