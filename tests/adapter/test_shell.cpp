// The operations that run outside programs: a host or file name must reach
// the tftp client as one plain argument, or not at all. Fake tftp and ps
// first on PATH record how they were called.

#include <gtest/gtest.h>

#include <signal.h>
#include <stdlib.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <string>

#include "TestSupport.h"
#include "ProviderUtil.h"

using namespace OLMA;
using namespace adapter_test;

namespace
{

class Shell : public ::testing::Test
{
protected:
    void SetUp() override
    {
        dir = makeHome();
        calls = dir + "/calls";
        script("tftp", "exit 0");
        setenv("PATH", (dir + ":" + getenv("PATH")).c_str(), 1);
        ASSERT_EQ(0, chdir(dir.c_str()));
        InProcessLog::path();
    }

    // A command that notes its name and arguments, one call a line.
    void script(const std::string& name, const std::string& tail)
    {
        std::string path = dir + "/" + name;
        writeFile(path, "#!/bin/sh\necho \"" + name + " $*\" >> '" + calls + "'\n" + tail + "\n");
        chmod(path.c_str(), 0700);
    }

    std::string dir, calls;
};

} // namespace

TEST_F(Shell, TftpRunsTheClientInTheDownloadDirectory)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    std::string download = dir + "/download";
    ASSERT_EQ(0, mkdir(download.c_str(), 0700));

    // The fake client leaves a copy named after the last part of the path,
    // as the real one does.
    script("tftp", "echo \"cwd $(pwd)\" >> '" + calls + "'; printf image > \"${4##*/}\"");
    String copy;
    EXPECT_EQ(0, util->TftpGetFile("tftp-1.example.com", "images/fw_3.2.1+a.bin",
        download.c_str(), copy));
    EXPECT_EQ("tftp tftp-1.example.com -c get images/fw_3.2.1+a.bin\ncwd " + download + "\n",
        readFile(calls));
    EXPECT_STREQ((download + "/fw_3.2.1+a.bin").c_str(), copy.c_str());
    EXPECT_EQ("image", readFile(download + "/fw_3.2.1+a.bin"));

    // The client's failure is the result, whatever it left behind.
    script("tftp", "printf image > \"${4##*/}\"; exit 3");
    EXPECT_EQ(3, util->TftpGetFile("server", "fw.bin", download.c_str(), copy));
    EXPECT_EQ(0u, copy.size());
}

TEST_F(Shell, TftpRefusesAnythingButPlainNames)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    // The service refuses these first; this is the second line of defence.
    const char* const hostile[] = { "a;touch pwned", "$(touch pwned)", "a b", "a\nb", "-c", "" };
    String copy;

    for (const char* name : hostile)
    {
        InProcessLog log;
        EXPECT_EQ(-1, util->TftpGetFile(name, "fw.bin", dir.c_str(), copy)) << name;
        EXPECT_EQ(-1, util->TftpGetFile("server", name, dir.c_str(), copy)) << name;
        EXPECT_EQ(2u, countLines(log.text(), {"ERR: ", "TftpGetFile: refused"})) << name;
        // What came from outside can't forge a line of the log.
        EXPECT_EQ(std::string::npos, log.text().find("\nb\""));
    }

    const std::string longPath(1100, 'f'), longLabel(64, 'a');

    for (const char* name : { "/etc/passwd", "../x", "a/../../x", "..", ".", "a/./b", "a//b",
             "a/", "a/-rf", "host:file", longPath.c_str() })
        EXPECT_FALSE(ProviderUtil::isSafeRelativePath(name)) << name;
    for (const char* name : { "fw.bin", "a/b/c-1.2_3+4.img", "..a/b..", ".hidden" })
        EXPECT_TRUE(ProviderUtil::isSafeRelativePath(name)) << name;

    for (const char* name : { "host:69", "a_b", "a-", "-a", "a..b", ".a", "a.", "1.2.3.4/8",
             "[::1]", "::g", longLabel.c_str() })
        EXPECT_FALSE(ProviderUtil::isPlainHost(name)) << name;
    for (const char* name : { "tf", "tftp-1.example.com", "10.0.0.7", "::1", "fe80::1:2" })
        EXPECT_TRUE(ProviderUtil::isPlainHost(name)) << name;

    EXPECT_EQ(-1, util->TftpGetFile("server", "fw.bin", "relative", copy));
    EXPECT_EQ(-1, util->TftpGetFile(0, 0, 0, copy));

    EXPECT_EQ("", readFile(calls)) << "no command may run";
    struct stat st;
    EXPECT_NE(0, stat((dir + "/pwned").c_str(), &st));
}

// A process of the given name for as long as the object lives: a copy of
// sleep under that name.
class NamedProcess
{
public:
    NamedProcess(const std::string& dir, const std::string& name) : _pid(-1)
    {
        std::string exe = dir + "/" + name;
        std::error_code ec;
        std::filesystem::copy_file("/bin/sleep", exe,
            std::filesystem::copy_options::overwrite_existing, ec);
        if (ec)
            return;
        _pid = fork();
        if (_pid == 0)
        {
            execl(exe.c_str(), name.c_str(), "60", (char*)0);
            _exit(127);
        }
        // Until the child has become the program, /proc names it as this one.
        std::string comm = "/proc/" + std::to_string(_pid) + "/comm";
        for (int i = 0; i < 200 && readFile(comm) != name.substr(0, 15) + "\n"; i++)
            usleep(10 * 1000);
    }

    ~NamedProcess()
    {
        if (_pid > 0)
        {
            kill(_pid, SIGTERM);
            waitpid(_pid, 0, 0);
        }
    }

private:
    pid_t _pid;
};

TEST_F(Shell, AgentPortFollowsTheProcessListWithAgentRunning)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    EXPECT_EQ(0u, util->getAgentPort());

    // The process list is read without a shell: a ps on PATH isn't asked.
    script("ps", "echo ' 4242 ?  00:00:01 zarkagent'");
    EXPECT_EQ(0u, util->getAgentPort());

    {
        NamedProcess other(dir, "zarkagent-old");
        EXPECT_EQ(0u, util->getAgentPort());
    }

    {
        NamedProcess agent(dir, "zarkagent");
        EXPECT_EQ(34568u, util->getAgentPort());
    }

    EXPECT_EQ(0u, util->getAgentPort());
    EXPECT_EQ("", readFile(calls));
}
