// Running an outside program from inside a CIM server's process: bounded in
// time, and without touching the server's other children, descriptors and
// signal handling.

#include <gtest/gtest.h>

#include <fcntl.h>
#include <signal.h>
#include <stdlib.h>
#include <string.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#include <chrono>
#include <fstream>
#include <string>

#include "Subprocess.h"
#include "TestSupport.h"

using namespace OLMA;
using namespace adapter_test;

namespace
{

SubprocessOutcome runShell(const std::string& script, int timeoutMs = 10000,
    const char* dir = 0)
{
    const char* argv[] = { "sh", "-c", script.c_str(), 0 };
    SubprocessOutcome outcome;
    EXPECT_EQ(0, runSubprocess("sh", argv, dir, timeoutMs, outcome));
    return outcome;
}

// Gone, or at most a zombie that isn't ours to reap.
bool processEnded(pid_t pid)
{
    std::ifstream stat("/proc/" + std::to_string(pid) + "/stat");
    std::string pidText, name, state;
    return !(stat >> pidText >> name >> state) || state == "Z";
}

volatile sig_atomic_t chldSeen = 0;
void onChld(int) { chldSeen = chldSeen + 1; }

} // namespace

TEST(Subprocess, KillsWhatOutlivesTheDeadline)
{
    std::string dir = makeHome();
    auto start = std::chrono::steady_clock::now();

    // A grandchild in the same process group goes too.
    SubprocessOutcome o = runShell("sleep 30 & echo $! > child; echo $$ > self; wait",
        300, dir.c_str());
    double seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();

    EXPECT_TRUE(o.timedOut);
    EXPECT_EQ(SIGKILL, o.signal);
    EXPECT_EQ(-1, o.exitCode);
    EXPECT_LT(seconds, 5.0);

    pid_t self = atoi(readFile(dir + "/self").c_str());
    pid_t child = atoi(readFile(dir + "/child").c_str());
    ASSERT_GT(self, 0);
    ASSERT_GT(child, 0);
    EXPECT_TRUE(processEnded(self));
    for (int i = 0; i < 100 && !processEnded(child); i++)
        usleep(10000);
    EXPECT_TRUE(processEnded(child));
}

TEST(Subprocess, LeavesTheServersChildrenAndSignalsAlone)
{
    struct sigaction mine, before, after;
    memset(&mine, 0, sizeof(mine));
    mine.sa_handler = onChld;
    ASSERT_EQ(0, sigaction(SIGCHLD, &mine, &before));

    pid_t other = fork();
    if (other == 0)
        _exit(7);
    ASSERT_GT(other, 0);
    usleep(50000);

    SubprocessOutcome o = runShell("exit 0");
    EXPECT_TRUE(o.statusKnown);
    EXPECT_EQ(0, o.exitCode);

    // The other child is still there to be reaped by its owner, and the
    // handler is still ours.
    int status = 0;
    EXPECT_EQ(other, waitpid(other, &status, WNOHANG));
    EXPECT_EQ(7, WEXITSTATUS(status));
    sigaction(SIGCHLD, 0, &after);
    EXPECT_EQ((void*)onChld, (void*)after.sa_handler);
    EXPECT_GT(chldSeen, 0);

    // A server that lets the kernel reap its children: the run still ends,
    // with its status unknown.
    struct sigaction ignore;
    memset(&ignore, 0, sizeof(ignore));
    ignore.sa_handler = SIG_IGN;
    sigaction(SIGCHLD, &ignore, 0);
    o = runShell("exit 5", 5000);
    EXPECT_FALSE(o.timedOut);
    EXPECT_FALSE(o.statusKnown);

    sigaction(SIGCHLD, &before, 0);
}

TEST(Subprocess, StartsCleanWhateverTheServerSetUp)
{
    // An inheritable descriptor, an ignored and a blocked signal: none of
    // them reaches the program.
    int fd = open("/dev/null", O_RDONLY);
    ASSERT_GE(fd, 0);
    ASSERT_EQ(57, dup2(fd, 57));
    close(fd);
    signal(SIGPIPE, SIG_IGN);
    sigset_t usr1, old;
    sigemptyset(&usr1);
    sigaddset(&usr1, SIGUSR1);
    pthread_sigmask(SIG_BLOCK, &usr1, &old);

    const char* argv[] = { "grep", "-E", "^Sig(Ign|Blk)", "/proc/self/status", 0 };
    SubprocessOutcome o;
    ASSERT_EQ(0, runSubprocess("grep", argv, 0, 10000, o));
    EXPECT_STREQ("SigBlk:\t0000000000000000\nSigIgn:\t0000000000000000\n", o.output);

    o = runShell("ls /proc/$$/fd");
    EXPECT_EQ("0\n1\n2\n", std::string(o.output));

    pthread_sigmask(SIG_SETMASK, &old, 0);
    signal(SIGPIPE, SIG_DFL);
    close(57);
}
