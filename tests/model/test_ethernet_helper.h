// Shared by the tests of the Ethernet, host and access point helpers: a
// directory of the process (HOME with the log at DBG, host descriptions),
// what the log said since a mark, walks that free their instances, library
// entries replaced by a canned reply, and a stand-in console agent.
#ifndef _VSPR_model_test_ethernet_helper_h
#define _VSPR_model_test_ethernet_helper_h

#include <gtest/gtest.h>
#include <json/json.h>
#include <signal.h>
#include <stdlib.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>

#include "CIMProviderTruj.h"
#include "Instance.h"
#include "log.h"

namespace eth_test
{

using namespace OLMA;

inline std::string readFile(const std::string& path)
{
    std::stringstream text;
    text << std::ifstream(path.c_str(), std::ios::binary).rdbuf();
    return text.str();
}

// Made on first use and removed at exit; ownLog also makes it this process's
// HOME, so that its log goes there.
inline const std::string& workDir(bool ownLog = true)
{
    struct Dir
    {
        std::string path;
        explicit Dir(bool own)
        {
            char name[] = "/tmp/vspr-eth-XXXXXX";
            path = mkdtemp(name) ? name : "/tmp";
            std::ofstream(path + "/.tesselrc") << "LOG_LEVEL=DBG\n";
            if (own)
            {
                setenv("HOME", path.c_str(), 1);
                close_log();
            }
        }
        ~Dir() { std::error_code ec; std::filesystem::remove_all(path, ec); }
    };
    static Dir dir(ownLog);
    return dir.path;
}

inline std::string writeHost(const std::string& name, const std::string& text)
{
    std::string path = workDir() + "/" + name;
    std::ofstream(path.c_str(), std::ios::trunc) << text;
    return path;
}

// Lines of text at level ("ERR", ...) that hold piece.
inline size_t count(const std::string& text, const std::string& level, const std::string& piece)
{
    std::istringstream in(text);
    std::string line;
    size_t n = 0;
    while (std::getline(in, line))
        n += line.find(level + ": ") != std::string::npos && line.find(piece) != std::string::npos;
    return n;
}

class Log
{
public:
    Log() : _start(all().size()) { }
    std::string text() const { std::string a = all(); return a.substr(std::min(_start, a.size())); }
    size_t count(const std::string& level, const std::string& piece) const
    {
        return eth_test::count(text(), level, piece);
    }
private:
    static std::string all() { return readFile(workDir() + "/.tessel/messages"); }
    size_t _start;
};

inline std::string str(const String& s)
{
    return std::string(s.c_str(), s.size());
}

// The instances of a walk as T (null for another class), freed with it.
template<class T>
struct Walk
{
    Array<Instance*> all;
    explicit Walk(const Array<Instance*>& a) : all(a) { }
    ~Walk() { for (size_t i = 0; i < all.size(); i++) destroyer(all[i]); }
    size_t size() const { return all.size(); }
    T* operator[](size_t i) const { return checked_cast<T>(all[i]); }
};

// A canned reply in place of one library entry while the object lives.
class Fake
{
public:
    Fake(JsonReqFP& slot, const std::string& reply) : _slot(slot), _saved(slot)
    {
        Json::Reader().parse(reply, canned(), false);
        _slot = answer;
    }
    ~Fake() { _slot = _saved; }
    static Json::Value& request() { static Json::Value r; return r; }
private:
    static Json::Value& canned() { static Json::Value c; return c; }
    static Json::Value answer(const Json::Value& req) { request() = req; return canned(); }
    JsonReqFP& _slot;
    JsonReqFP _saved;
};

// A process that ps shows as the console agent while the object lives.
class Agent
{
public:
    Agent()
    {
        std::string link = workDir(false) + "/zarkagent";
        std::error_code ec;
        std::filesystem::create_symlink("/bin/sleep", link, ec);
        _pid = fork();
        if (_pid == 0)
        {
            execl(link.c_str(), "zarkagent", "60", (char*)0);
            _exit(127);
        }
        for (int i = 0; i < 100 && !running(); i++)
            usleep(20000);
    }
    ~Agent()
    {
        kill(_pid, SIGTERM);
        waitpid(_pid, 0, 0);
    }
    static bool running()
    {
        FILE* pipe = popen("ps -e | grep zarkagent$", "r");
        char line[128];
        bool found = pipe && fgets(line, sizeof(line), pipe) != 0;
        if (pipe)
            pclose(pipe);
        return found;
    }
private:
    pid_t _pid;
};

} // namespace eth_test

#endif
