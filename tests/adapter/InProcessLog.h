// The module's log of this test process, in a HOME of its own: tests mark
// the log's end, act, and read what was written since.
#ifndef _VSPR_InProcessLog_h
#define _VSPR_InProcessLog_h

#include <stdlib.h>
#include <sys/stat.h>

#include <string>

#include "AdapterTestSupport.h"
#include "log.h"

namespace adapter_test
{

class InProcessLog
{
public:

    InProcessLog() : _start(size()) { }

    // What the module logged since this object was made.
    std::string text() const
    {
        std::string all = readFile(path());
        return all.size() > _start ? all.substr(_start) : std::string();
    }

    static const std::string& home()
    {
        static std::string dir = open();
        return dir;
    }

    static std::string path()
    {
        return home() + "/.tessel/messages";
    }

private:

    static std::string open()
    {
        std::string dir = makeHome();
        setenv("HOME", dir.c_str(), 1);

        // The log may already be open elsewhere; the next line reopens it
        // under the new HOME.
        OLMA::close_log();
        OLMA::log(OLMA::LL_INFO, "InProcessLog.h", __LINE__, "test log opened");
        return dir;
    }

    static size_t size()
    {
        struct stat st;
        return stat(path().c_str(), &st) == 0 ? (size_t)st.st_size : 0;
    }

    size_t _start;
};

} // namespace adapter_test

#endif
