// Shared by the adapter tests: private HOMEs whose log is on at DBG, and
// reading what the module logged.
#ifndef _VSPR_adapter_TestSupport_h
#define _VSPR_adapter_TestSupport_h

#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "log.h"

namespace adapter_test
{

inline std::string readFile(const std::string& path)
{
    std::stringstream text;
    text << std::ifstream(path.c_str(), std::ios::binary).rdbuf();
    return text.str();
}

inline void writeFile(const std::string& path, const std::string& text)
{
    std::ofstream(path.c_str(), std::ios::binary | std::ios::trunc) << text;
}

// A new directory with a .tesselrc that asks for every level; it goes when
// the process ends.
inline std::string makeHome()
{
    struct Homes
    {
        std::vector<std::string> dirs;
        ~Homes()
        {
            std::error_code ec;
            for (const std::string& d : dirs)
                std::filesystem::remove_all(d, ec);
        }
    };
    static Homes homes;

    char name[] = "/tmp/vspr-adapter-XXXXXX";
    std::string home = mkdtemp(name) ? name : "";
    homes.dirs.push_back(home);
    writeFile(home + "/.tesselrc", "LOG_LEVEL=DBG\n");
    return home;
}

// The number of lines of a log text that hold every one of the pieces.
inline size_t countLines(const std::string& text, const std::vector<std::string>& pieces)
{
    std::istringstream in(text);
    std::string line;
    size_t count = 0;

    while (std::getline(in, line))
    {
        bool all = true;
        for (const std::string& p : pieces)
            all = all && line.find(p) != std::string::npos;
        count += all;
    }

    return count;
}

// The log of this test process, under a HOME of its own: a test marks the
// log's end, acts, and reads what was written since.
class InProcessLog
{
public:
    InProcessLog() : _start(readFile(path()).size()) { }

    std::string text() const { return readFile(path()).substr(_start); }

    static std::string path()
    {
        static std::string home = open();
        return home + "/.tessel/messages";
    }

private:
    static std::string open()
    {
        std::string home = makeHome();
        setenv("HOME", home.c_str(), 1);

        // The start-up may have opened the log elsewhere; the next line
        // reopens it under the new HOME.
        OLMA::close_log();
        OLMA::log(OLMA::LL_INFO, "TestSupport.h", __LINE__, "test log");
        return home;
    }

    size_t _start;
};

} // namespace adapter_test

#endif
