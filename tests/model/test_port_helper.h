// Shared by the tests of PortHelper and TargetHelper in the test process:
// a HOME with the log at DBG, host descriptions of our own for the simulated
// library, library entries replaced by scripted ones, and walks whose
// instances are freed with them.
#ifndef _VSPR_model_test_port_helper_h
#define _VSPR_model_test_port_helper_h

#include <gtest/gtest.h>
#include <json/json.h>

#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include "CIMProviderTruj.h"
#include "Instance.h"
#include "ProviderUtil.h"
#include "log.h"

extern "C" int dtruj_sim_set_fault(const char* entry, const char* kind);
extern "C" int dtruj_sim_reset(void);

namespace port_test
{

using namespace OLMA;

inline std::string readFile(const std::string& path)
{
    std::stringstream text;
    text << std::ifstream(path.c_str(), std::ios::binary).rdbuf();
    return text.str();
}

// The directory of this process: HOME with the log at DBG, and the host
// descriptions of the tests. Removed at exit.
inline const std::string& workDir()
{
    struct Dir
    {
        std::string path;
        Dir()
        {
            char name[] = "/tmp/vspr-fcport-XXXXXX";
            path = mkdtemp(name) ? name : "/tmp";
            std::ofstream(path + "/.tesselrc") << "LOG_LEVEL=DBG\n";
            setenv("HOME", path.c_str(), 1);
            // The start-up may have opened the log under another HOME.
            close_log();
            log(LL_INFO, "test_port_helper.h", __LINE__, "test log");
        }
        ~Dir()
        {
            std::error_code ec;
            std::filesystem::remove_all(path, ec);
        }
    };
    static Dir dir;
    return dir.path;
}

// What was logged between its construction and text().
class Log
{
public:
    Log() : _start(readFile(path()).size()) { }

    std::string text() const
    {
        std::string all = readFile(path());
        return all.size() > _start ? all.substr(_start) : std::string();
    }

    // Lines of the level that hold the piece.
    size_t count(const std::string& level, const std::string& piece) const
    {
        std::istringstream in(text());
        std::string line;
        size_t n = 0;
        while (std::getline(in, line))
            n += line.find(level + ": ") != std::string::npos &&
                line.find(piece) != std::string::npos;
        return n;
    }

    static std::string path() { return workDir() + "/.tessel/messages"; }

private:
    size_t _start;
};

inline Json::Value parse(const std::string& text)
{
    Json::Value v;
    EXPECT_TRUE(Json::Reader().parse(text, v, false)) << text;
    return v;
}

// Points the simulator at a description and reloads it, with no faults.
inline void useHost(const std::string& json)
{
    std::string path = workDir() + "/host.json";
    std::ofstream(path.c_str(), std::ios::trunc) << json;
    setenv("DTRUJ_HOST", path.c_str(), 1);
    ASSERT_EQ(0, dtruj_sim_reset());
}

inline void useDefaultHost()
{
    unsetenv("DTRUJ_HOST");
    dtruj_sim_reset();
}

inline std::string str(const String& s)
{
    return std::string(s.c_str(), s.size());
}

inline std::string hostString()
{
    char host[256] = "";
    ProviderUtil::getProviderUtil()->getHostInfo(host, 255);
    return host;
}

template<class T>
std::vector<T> vec(const Property<Array<T> >& p)
{
    EXPECT_EQ(0, p.null);
    return std::vector<T>(p.value.data(), p.value.data() + p.value.size());
}

// Owns the instances of a walk.
struct Walk
{
    Array<Instance*> all;

    explicit Walk(const Array<Instance*>& a) : all(a) { }

    ~Walk()
    {
        for (size_t i = 0; i < all.size(); i++)
            destroyer(all[i]);
    }

    size_t size() const { return all.size(); }

    template<class T>
    T* at(size_t i) const
    {
        T* p = i < all.size() ? checked_cast<T>(all[i]) : 0;
        EXPECT_TRUE(p != 0) << "element " << i << " is missing or of another class";
        return p;
    }
};

// Scripted replies of one library entry, by the text of one request member;
// requests that no script names go on to the simulator. A reply of the
// string "throw" throws an HbaAgentError instead.
template<JsonReqFP& Slot>
class Script
{
public:
    explicit Script(const char* member) : _saved(Slot), _member(member)
    {
        current() = this;
        Slot = answer;
    }

    ~Script()
    {
        Slot = _saved;
        current() = 0;
    }

    void on(const std::string& key, const Json::Value& reply) { _replies[key] = reply; }

    // Every request, in order.
    std::vector<Json::Value> requests;

private:
    static Script*& current()
    {
        static Script* s = 0;
        return s;
    }

    static Json::Value answer(const Json::Value& request)
    {
        Script* s = current();
        s->requests.push_back(request);

        const Json::Value& key = request.isObject() ? request[s->_member] : Json::Value();
        typename std::map<std::string, Json::Value>::const_iterator i =
            s->_replies.find(key.isString() ? key.asString() : std::string());

        if (i == s->_replies.end())
            return s->_saved(request);

        if (i->second == Json::Value("throw"))
            throw HbaAgentError(9, "scripted");

        return i->second;
    }

    JsonReqFP _saved;
    const char* _member;
    std::map<std::string, Json::Value> _replies;
};

} // namespace port_test

#endif
