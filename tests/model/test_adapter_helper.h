// Shared by the adapter and optics tests: a HOME of the process whose log is
// on at DBG, and reading what was logged.
#ifndef _VSPR_model_test_adapter_helper_h
#define _VSPR_model_test_adapter_helper_h

#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

#include "String.h"
#include "log.h"

namespace adapter_test
{

inline std::string readFile(const std::string& path)
{
    std::stringstream text;
    text << std::ifstream(path.c_str(), std::ios::binary).rdbuf();
    return text.str();
}

// Made on first use; the test process logs there from then on.
inline const std::string& homeDir()
{
    struct Home
    {
        std::string dir;
        Home()
        {
            char name[] = "/tmp/vspr-adapter-helper-XXXXXX";
            dir = mkdtemp(name) ? name : "/tmp";
            std::ofstream(dir + "/.tesselrc") << "LOG_LEVEL=DBG\n";
            setenv("HOME", dir.c_str(), 1);
            OLMA::close_log();
            OLMA::log(OLMA::LL_INFO, "test", __LINE__, "test log");
        }
        ~Home()
        {
            std::error_code ec;
            std::filesystem::remove_all(dir, ec);
        }
    };
    static Home home;
    return home.dir;
}

// What was logged since the mark was made.
class LogMark
{
public:
    LogMark() : _start(readFile(path()).size()) { }

    std::string text() const
    {
        std::string all = readFile(path());
        return all.size() > _start ? all.substr(_start) : std::string();
    }

    static std::string path() { return homeDir() + "/.tessel/messages"; }

private:
    size_t _start;
};

inline size_t countLines(const std::string& text, const std::string& piece)
{
    std::istringstream in(text);
    std::string line;
    size_t n = 0;
    while (std::getline(in, line))
        n += line.find(piece) != std::string::npos;
    return n;
}

inline std::string str(const OLMA::String& s)
{
    return std::string(s.c_str(), s.size());
}

} // namespace adapter_test

#endif
