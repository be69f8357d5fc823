// The operations that run shell commands: a host or file name must never
// reach the shell as anything but one plain word. Fake rm, tftp and ps first
// on PATH record how they were called.

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
        script("rm", "exit 0");
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

TEST_F(Shell, TftpRunsTwoPlainCommands)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    EXPECT_EQ(0, util->TftpGetFile("tftp-1.example.com", "images/fw_3.2.1-a.bin"));
    EXPECT_EQ("rm -f images/fw_3.2.1-a.bin\n"
        "tftp tftp-1.example.com -c get images/fw_3.2.1-a.bin\n", readFile(calls));

    // The download's status is the result, whatever rm said.
    script("rm", "exit 1");
    script("tftp", "exit 3");
    EXPECT_NE(0, util->TftpGetFile("10.0.0.7", "a..b/fw.1"));
}

TEST_F(Shell, TftpRefusesHostileNames)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    const char* const hostile[] = { "a;touch pwned", "$(touch pwned)", "`touch pwned`",
        "a'b", "a\"b", "a b", "a\nb", "-c", "a|b", "a&b", "a>b", "*", "~root", "" };

    for (const char* name : hostile)
    {
        InProcessLog log;
        EXPECT_EQ(-1, util->TftpGetFile(name, "fw.bin")) << name;
        EXPECT_EQ(-1, util->TftpGetFile("server", name)) << name;
        EXPECT_EQ(2u, countLines(log.text(), {"ERR: ", "TftpGetFile"})) << name;
    }

    // rm -f would reach files outside the working directory.
    for (const char* name : { "/etc/passwd", "../x", "a/../../x", ".." })
        EXPECT_EQ(-1, util->TftpGetFile("server", name)) << name;

    // Nor is a command cut short to fit.
    EXPECT_EQ(-1, util->TftpGetFile("server", std::string(1100, 'f').c_str()));
    EXPECT_EQ(-1, util->TftpGetFile(0, 0));

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

TEST_F(Shell, AgentPortFollowsTheProcessList)
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
