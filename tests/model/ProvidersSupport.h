// Shared by the tests that drive the built module through the stand-in CIM
// server: one host for the process, a private HOME whose log is on at DBG,
// host descriptions written to a temporary directory, and the simulator's
// controls.
#ifndef _VSPR_model_ProvidersSupport_h
#define _VSPR_model_ProvidersSupport_h

#include <gtest/gtest.h>
#include <json/json.h>
#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "cimhost.h"

extern "C" int dtruj_sim_reset(void);
extern "C" char* dtruj_sim_dump(void);
extern "C" int dtruj_sim_set_fault(const char* entry, const char* kind);

namespace providers_test
{

namespace ch = OLMA::cimhost;

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

inline Json::Value parseJson(const std::string& text)
{
    Json::Value v;
    Json::Reader reader;
    EXPECT_TRUE(reader.parse(text, v)) << reader.getFormattedErrorMessages();
    return v;
}

// The directory of this process: HOME with a log at DBG, and the host
// descriptions the tests write. It goes when the process ends.
inline const std::string& workDir()
{
    struct Dir
    {
        std::string path;
        Dir()
        {
            char name[] = "/tmp/vspr-providers-XXXXXX";
            path = mkdtemp(name) ? name : "/tmp";
            writeFile(path + "/.tesselrc", "LOG_LEVEL=DBG\n");
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

inline std::string logText()
{
    return readFile(workDir() + "/.tessel/messages");
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

// What the module logged between its construction and text().
class LogMark
{
public:
    LogMark() : _start(logText().size()) { }
    std::string text() const
    {
        std::string all = logText();
        return all.size() > _start ? all.substr(_start) : std::string();
    }

private:
    size_t _start;
};

inline Json::Value defaultHost()
{
    return parseJson(readFile(std::string(DTRUJ_HOSTS_DIR) + "/default.json"));
}

inline Json::Value simDump()
{
    char* text = dtruj_sim_dump();
    Json::Value v = parseJson(text ? text : "");
    free(text);
    return v;
}

// Points the simulator at a description (a file name under the hosts
// directory, or a JSON value written to the work directory) and reloads it;
// the simulator's own state, such as beacons and faults, starts afresh.
inline void useHostFile(const std::string& path)
{
    setenv("DTRUJ_HOST", path.c_str(), 1);
    ASSERT_EQ(0, dtruj_sim_reset()) << path;
}

inline void useHost(const Json::Value& host)
{
    std::string path = workDir() + "/host.json";
    writeFile(path, Json::StyledWriter().write(host));
    useHostFile(path);
}

inline void useDefaultHost()
{
    unsetenv("DTRUJ_HOST");
    dtruj_sim_reset();
}

// One host, made once per process before anything of the module runs, so
// that the module's log opens in the private HOME.
class ProvidersTest : public ::testing::Test
{
protected:
    static inline ch::Host* host = nullptr;

    static void SetUpTestSuite()
    {
        if (!host)
        {
            setenv("HOME", workDir().c_str(), 1);
            host = new ch::Host(ch::Options());
        }
    }

    void SetUp() override
    {
        ASSERT_TRUE(host->ok()) << host->error();
        useDefaultHost();
    }

    void TearDown() override
    {
        useDefaultHost();
    }

    static ch::Object_Path classPath(const std::string& cls)
    {
        ch::Object_Path path;
        path.name_space = "root/vespera";
        path.class_name = cls;
        return path;
    }

    static ch::Result ei(const std::string& cls)
    {
        return host->ei(classPath(cls));
    }

    static ch::Result ein(const std::string& cls)
    {
        return host->ein(classPath(cls));
    }

    // The instances of a class that must answer, with the reason on failure.
    static std::vector<ch::Instance> served(const std::string& cls)
    {
        ch::Result r = ei(cls);
        EXPECT_EQ(CMPI_RC_OK, r.rc) << cls << ": " << ch::rc_name(r.rc) << " " << r.message;
        return r.instances;
    }

    static std::string text(const ch::Instance& i, const char* property)
    {
        return i.get_text(property);
    }

    static ch::Result setAlarm(const ch::Object_Path& path, uint64_t state)
    {
        std::vector<ch::Property> in(1);
        in[0].name = "RequestedAlarmState";
        in[0].value = ch::Value::of_uint(CMPI_uint16, state);
        return host->cm(path, "SetAlarmState", in);
    }
};

} // namespace providers_test

#endif
