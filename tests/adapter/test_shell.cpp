// The operations that run shell commands: a host or file name must never
// reach the shell as anything but one plain word. Fake rm, tftp and ps first
// on PATH record how they were called.

#include <gtest/gtest.h>

#include <stdlib.h>
#include <sys/stat.h>
#include <unistd.h>

#include <string>

#include "InProcessLog.h"
#include "ProviderUtil.h"

using namespace OLMA;
using adapter_test::InProcessLog;
using adapter_test::countLines;
using adapter_test::readFile;
using adapter_test::writeFile;

namespace
{

class ShellTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        dir = InProcessLog::home() + "/shell";
        mkdir(dir.c_str(), 0700);
        bin = dir + "/bin";
        mkdir(bin.c_str(), 0700);
        calls = dir + "/calls";
        unlink(calls.c_str());

        script("rm", "exit 0");
        script("tftp", "exit 0");

        savedPath = getenv("PATH") ? getenv("PATH") : "";
        setenv("PATH", (bin + ":" + savedPath).c_str(), 1);
        ASSERT_EQ(0, chdir(dir.c_str()));
    }

    void TearDown() override
    {
        setenv("PATH", savedPath.c_str(), 1);
    }

    // A fake command that logs its name and arguments, one call a line.
    void script(const std::string& name, const std::string& tail)
    {
        std::string path = bin + "/" + name;
        writeFile(path, "#!/bin/sh\necho \"" + name + " $*\" >> '" + calls +
            "'\n" + tail + "\n");
        chmod(path.c_str(), 0700);
    }

    std::string dir, bin, calls, savedPath;
};

} // namespace

TEST_F(ShellTest, TftpRunsTwoPlainCommands)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    EXPECT_EQ(0, util->TftpGetFile("tftp-server.example.com", "images/fw_3.2.1-a.bin"));
    EXPECT_EQ("rm -f images/fw_3.2.1-a.bin\n"
        "tftp tftp-server.example.com -c get images/fw_3.2.1-a.bin\n",
        readFile(calls));

    // The status of the download is the result, whatever rm said.
    script("rm", "exit 1");
    script("tftp", "exit 3");
    unlink(calls.c_str());
    EXPECT_NE(0, util->TftpGetFile("10.0.0.7", "fw.bin"));
    EXPECT_EQ(2u, countLines(readFile(calls), {"fw.bin"}));
}

TEST_F(ShellTest, TftpRefusesHostileNames)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    const char* const hostile[] = {
        "a;touch pwned", "$(touch pwned)", "`touch pwned`", "a'b", "a\"b",
        "a b", "a\nb", "-c", "--help", "a|b", "a&b", "a>b", "a<b", "*",
        "a\\b", "~root", "",
    };

    for (const char* name : hostile)
    {
        InProcessLog log;
        EXPECT_EQ(-1, util->TftpGetFile(name, "fw.bin")) << name;
        EXPECT_EQ(-1, util->TftpGetFile("server", name)) << name;
        EXPECT_EQ(2u, countLines(log.text(), {"ERR: ", "TftpGetFile"})) << name;
    }

    // Files outside the working directory would be removed by rm -f.
    const char* const outside[] = { "/etc/passwd", "../x", "a/../../x", "..", "a/.." };

    for (const char* name : outside)
        EXPECT_EQ(-1, util->TftpGetFile("server", name)) << name;

    EXPECT_EQ(-1, util->TftpGetFile(0, "fw.bin"));
    EXPECT_EQ(-1, util->TftpGetFile("server", 0));

    // A command that doesn't fit isn't run cut short.
    std::string longName(1100, 'f');
    EXPECT_EQ(-1, util->TftpGetFile("server", longName.c_str()));

    EXPECT_EQ("", readFile(calls)) << "no command may run";
    struct stat st;
    EXPECT_NE(0, stat((dir + "/pwned").c_str(), &st));

    // Dots inside names are fine.
    EXPECT_EQ(0, util->TftpGetFile("server", "a..b/..c/fw.1"));
}

TEST_F(ShellTest, AgentPortFollowsTheProcessList)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();

    script("ps", "echo '  PID TTY          TIME CMD'; echo ' 4242 ?        00:00:01 zarkagent'");
    EXPECT_EQ(34568u, util->getAgentPort());

    // A process whose name merely contains the agent's doesn't count.
    script("ps", "echo ' 4242 ?        00:00:01 zarkagent-old'; echo ' 1 ? 00:00:01 init'");
    EXPECT_EQ(0u, util->getAgentPort());

    script("ps", "exit 0");
    EXPECT_EQ(0u, util->getAgentPort());
}
