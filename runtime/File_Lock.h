#ifndef _OLMA_File_Lock_h
#define _OLMA_File_Lock_h

#include "config.h"

namespace OLMA {

struct File_Lock_Rep;

// An exclusive fcntl lock over a whole file, so that processes sharing a
// file can take turns. The file is created (mode 0600) if missing.
class File_Lock
{
public:
    File_Lock(const char* path);
    ~File_Lock();

    // True if the file could be opened.
    bool okay() const;

    // Blocks until the lock is held: 0, or -1 on failure.
    int lock();
    int unlock();

private:
    File_Lock(const File_Lock&) = delete;
    File_Lock& operator=(const File_Lock&) = delete;

    File_Lock_Rep* _rep;
};

} // namespace OLMA

#endif /* _OLMA_File_Lock_h */
