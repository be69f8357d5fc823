#include <gtest/gtest.h>
#include <cmath>
#include <math.h>
#include <fcntl.h>
#include <regex>
#include <stdlib.h>
#include <string>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>
#include "log.h"
#include "File_Lock.h"

using namespace OLMA;

// Every case runs with HOME in a fresh directory and the log closed.
class Log_Test : public ::testing::Test
{
protected:
    std::string home;

    void SetUp() override
    {
        char tmpl[] = "/tmp/vspr_log_XXXXXX";
        ASSERT_NE(mkdtemp(tmpl), nullptr);
        home = tmpl;
        setenv("HOME", home.c_str(), 1);
        close_log();
        log_enable(true);
    }

    void TearDown() override
    {
        close_log();
        log_enable(true);
        std::string cmd = "rm -rf '" + home + "'";
        ASSERT_EQ(system(cmd.c_str()), 0);
    }

    void rc(const std::string& text)
    {
        FILE* f = fopen((home + "/.tesselrc").c_str(), "w");
        ASSERT_NE(f, nullptr);
        fputs(text.c_str(), f);
        fclose(f);
    }

    std::string messages() const
    {
        std::string out;
        FILE* f = fopen((home + "/.tessel/messages").c_str(), "r");
        if (!f)
            return out;
        char buf[4096];
        size_t n;
        while ((n = fread(buf, 1, sizeof(buf), f)) > 0)
            out.append(buf, n);
        fclose(f);
        return out;
    }

    bool exists(const std::string& rel) const
    {
        struct stat st;
        return stat((home + "/" + rel).c_str(), &st) == 0;
    }

    static std::vector<std::string> lines(const std::string& text)
    {
        std::vector<std::string> v;
        size_t pos = 0, nl;
        while ((nl = text.find('\n', pos)) != std::string::npos)
        {
            v.push_back(text.substr(pos, nl - pos + 1));
            pos = nl + 1;
        }
        EXPECT_EQ(pos, text.size()) << "unterminated last line";
        return v;
    }
};

static const std::regex line_re(
    "^[0-9]{4}/[0-9]{2}/[0-9]{2} [0-9]{2}:[0-9]{2}:[0-9]{2} "
    "(FATAL|ERR|WARN|INFO|DBG): ([^()]*)\\(([0-9]+)\\): (.*)\n$");

TEST_F(Log_Test, LineFormatAndLevelFilter)
{
    rc("LOG_LEVEL=INFO\n");
    int line = __LINE__ + 1;
    TLOG(LL_DBG, "not %s", "written");
    TLOG(LL_INFO, "info %d", 1);
    TLOG(LL_WARN, "warn");
    log(LL_ERR, "some/dir/file.cpp", 77, "direct %s", "call");
    TLOG(LL_FATAL, "ends in newline\n");

    std::vector<std::string> v = lines(messages());
    ASSERT_EQ(v.size(), 4u);

    std::smatch m;
    ASSERT_TRUE(std::regex_match(v[0], m, line_re)) << v[0];
    EXPECT_EQ(m[1], "INFO");
    EXPECT_EQ(m[2], "test_log.cpp");
    EXPECT_EQ(m[3], std::to_string(line + 1));
    EXPECT_EQ(m[4], "info 1");

    ASSERT_TRUE(std::regex_match(v[1], m, line_re)) << v[1];
    EXPECT_EQ(m[1], "WARN");
    EXPECT_EQ(m[4], "warn");

    ASSERT_TRUE(std::regex_match(v[2], m, line_re)) << v[2];
    EXPECT_EQ(m[1], "ERR");
    EXPECT_EQ(m[2], "some/dir/file.cpp");
    EXPECT_EQ(m[3], "77");

    ASSERT_TRUE(std::regex_match(v[3], m, line_re)) << v[3];
    EXPECT_EQ(m[4], "ends in newline");

    // The log's files and their modes.
    struct stat st;
    ASSERT_EQ(stat((home + "/.tessel/messages.lock").c_str(), &st), 0);
    EXPECT_EQ(st.st_mode & 0777, 0600u);
    EXPECT_EQ(st.st_size, 0);
}

TEST_F(Log_Test, NoHomeOrNoConfigMeansNoLog)
{
    rc("LOG_LEVEL=DBG\n");
    unsetenv("HOME");
    TLOG(LL_ERR, "nowhere to go");
    EXPECT_FALSE(exists(".tessel"));

    setenv("HOME", home.c_str(), 1);
    unlink((home + "/.tesselrc").c_str());
    TLOG(LL_ERR, "no config");
    EXPECT_FALSE(exists(".tessel"));

    // A HOME too long for the path buffers leaves the log off.
    std::string long_home = home + "/" + std::string(1100, 'h');
    setenv("HOME", long_home.c_str(), 1);
    TLOG(LL_ERR, "long home");
    setenv("HOME", home.c_str(), 1);
    EXPECT_FALSE(exists(".tessel"));
}

TEST_F(Log_Test, ConfigurationLinesThatEnable)
{
    const std::string good[] = {
        "LOG_LEVEL = dbg\n",
        "LOG_LEVEL\t=\tDbg  \t\n",
        "LOG_LEVEL=DBG",
        "# LOG_LEVEL=ERR\n\n   \nLOG_LEVEL=DBG\n",
        "log_level=ERR\nLOG_LEVEL=DBG\n",
        "LOG_LEVEL DBG\nLOG_LEVEL=DBG\n",
        "LOG_LEVELS=ERR\nLOG_LEVEL=DBG\n",
        // A line beyond 1023 characters comes in pieces that count as lines.
        std::string(1023, 'x') + "LOG_LEVEL=DBG\n",
    };

    for (const std::string& text : good)
    {
        rc(text);
        TLOG(LL_DBG, "on");
        EXPECT_NE(messages().find("DBG: test_log.cpp("), std::string::npos) << text.substr(0, 40);
        close_log();
        unlink((home + "/.tessel/messages").c_str());
    }
}

TEST_F(Log_Test, ConfigurationLinesThatDoNotEnable)
{
    const char* bad[] = {
        "# LOG_LEVEL=DBG\n",
        "log_level=DBG\n",
        "LOG_LEVEL=VERBOSE\n",
        "LOG_LEVEL=VERBOSE\nLOG_LEVEL=DBG\n",  // the first match decides
        " LOG_LEVEL=DBG\n",
        "LOG_LEVEL DBG\n",
        "LOG_LEVEL=\n",
        "LOG_LEVEL=DBG x\n",
        "",
    };

    for (const char* text : bad)
    {
        // Closing makes the next message look at the file at once.
        close_log();
        rc(text);
        TLOG(LL_FATAL, "off");
        EXPECT_FALSE(exists(".tessel")) << text;
    }
}

TEST_F(Log_Test, ClosedLogLooksAgainWithinASecond)
{
    // No file yet: the log stays off, and messages soon after don't look.
    TLOG(LL_ERR, "before");
    rc("LOG_LEVEL=ERR\n");
    usleep(1100 * 1000);

    // Creating the file turns the log on without a restart.
    TLOG(LL_ERR, "now on");
    EXPECT_NE(messages().find("now on"), std::string::npos);
    EXPECT_EQ(messages().find("before"), std::string::npos);
    close_log();

    // A file that fails is read again once it changes.
    rc("LOG_LEVEL=VERBOSE\n");
    TLOG(LL_ERR, "bad level");
    rc("LOG_LEVEL=WARN\n");
    usleep(1100 * 1000);
    TLOG(LL_ERR, "good level");
    TLOG(LL_INFO, "filtered");
    std::string text = messages();
    EXPECT_EQ(text.find("bad level"), std::string::npos);
    EXPECT_NE(text.find("good level"), std::string::npos);
    EXPECT_EQ(text.find("filtered"), std::string::npos);
}

TEST_F(Log_Test, ClosedLogCostsACheck)
{
    // Without a file, a burst of messages makes at most one look.
    for (int i = 0; i < 100000; i++)
        TLOG(LL_ERR, "off %d", i);
    EXPECT_FALSE(log_wanted(LL_FATAL));
    EXPECT_FALSE(exists(".tessel"));

    // An open log filters by its level without a lock or a look.
    rc("LOG_LEVEL=WARN\n");
    close_log();
    TLOG(LL_WARN, "open");
    EXPECT_TRUE(log_wanted(LL_WARN));
    EXPECT_FALSE(log_wanted(LL_INFO));
    ASSERT_EQ(log_set_level("DBG"), 0);
    EXPECT_TRUE(log_wanted(LL_DBG));
}

TEST_F(Log_Test, OpenLogIgnoresConfigChangesUntilClosed)
{
    rc("LOG_LEVEL=WARN\nLOG_LEVEL=DBG\n");
    TLOG(LL_INFO, "info-1");
    TLOG(LL_WARN, "warn-1");
    rc("LOG_LEVEL=DBG\n");
    TLOG(LL_INFO, "info-2");
    close_log();
    TLOG(LL_INFO, "info-3");

    std::string text = messages();
    EXPECT_EQ(text.find("info-1"), std::string::npos);
    EXPECT_NE(text.find("warn-1"), std::string::npos);
    EXPECT_EQ(text.find("info-2"), std::string::npos);
    // Reopened for append: earlier lines stay.
    EXPECT_NE(text.find("info-3"), std::string::npos);
    EXPECT_EQ(lines(text).size(), 2u);
}

TEST_F(Log_Test, SetLevelAndEnable)
{
    rc("LOG_LEVEL=DBG\n");
    EXPECT_EQ(log_set_level(String("x")), -1);
    TLOG(LL_DBG, "dbg-1");
    EXPECT_EQ(log_set_level(String("err")), 0);
    TLOG(LL_WARN, "warn-1");
    TLOG(LL_ERR, "err-1");
    EXPECT_EQ(log_set_level(String("INFO")), 0);

    EXPECT_EQ(log_enable(true), -1);
    EXPECT_EQ(log_enable(false), 0);
    EXPECT_EQ(log_enable(false), -1);
    TLOG(LL_ERR, "silenced");
    log(LL_ERR, "x.cpp", 1, "direct");
    EXPECT_EQ(log_enable(true), 0);

    std::string text = messages();
    EXPECT_NE(text.find("dbg-1"), std::string::npos);
    EXPECT_EQ(text.find("warn-1"), std::string::npos);
    EXPECT_NE(text.find("err-1"), std::string::npos);
    EXPECT_EQ(text.find("silenced"), std::string::npos);
    EXPECT_NE(text.find("direct"), std::string::npos);

    Log_Level level = LL_FATAL;
    EXPECT_EQ(_validate_log_level("Warn", level), 0);
    EXPECT_EQ(level, LL_WARN);
    EXPECT_EQ(_validate_log_level("WARNING", level), -1);
    EXPECT_EQ(level, LL_WARN);
}

TEST_F(Log_Test, LongMessageIsWrittenWhole)
{
    rc("LOG_LEVEL=INFO\n");
    std::string big(5000, 'm');
    TLOG(LL_INFO, "%s|", big.c_str());
    std::vector<std::string> v = lines(messages());
    ASSERT_EQ(v.size(), 1u);
    std::smatch m;
    ASSERT_TRUE(std::regex_match(v[0], m, line_re));
    EXPECT_EQ(m[4], big + "|");
}

// Two processes appending at once: every line must arrive whole.
TEST_F(Log_Test, TwoProcessesShareTheLog)
{
    rc("LOG_LEVEL=INFO\n");
    const int count = 300;
    const size_t width = 3000;
    pid_t pids[2];

    for (int p = 0; p < 2; p++)
    {
        pids[p] = fork();
        ASSERT_GE(pids[p], 0);

        if (pids[p] == 0)
        {
            std::string payload(width, p ? 'B' : 'A');
            for (int i = 0; i < count; i++)
                TLOG(LL_INFO, "%d:%s", i, payload.c_str());
            _exit(0);
        }
    }

    for (pid_t pid : pids)
    {
        int status = 0;
        ASSERT_EQ(waitpid(pid, &status, 0), pid);
        ASSERT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    }

    std::vector<std::string> v = lines(messages());
    ASSERT_EQ(v.size(), 2u * count);
    int next[2] = { 0, 0 };

    for (const std::string& l : v)
    {
        std::smatch m;
        ASSERT_TRUE(std::regex_match(l, m, line_re)) << l.substr(0, 80);
        std::string msg = m[4];
        size_t colon = msg.find(':');
        ASSERT_NE(colon, std::string::npos);
        char c = msg[colon + 1];
        ASSERT_TRUE(c == 'A' || c == 'B');
        int p = c == 'B';
        // Each process's lines keep their order.
        EXPECT_EQ(std::stoi(msg.substr(0, colon)), next[p]++);
        EXPECT_EQ(msg.substr(colon + 1), std::string(width, c));
    }

    EXPECT_EQ(next[0], count);
    EXPECT_EQ(next[1], count);
}

TEST(File_Lock, LockAndUnlock)
{
    char tmpl[] = "/tmp/vspr_lock_XXXXXX";
    ASSERT_NE(mkdtemp(tmpl), nullptr);
    std::string path = std::string(tmpl) + "/lock";
    {
        File_Lock lock(path.c_str());
        ASSERT_TRUE(lock.okay());
        EXPECT_EQ(lock.lock(), 0);

        // Another process must not get it while it is held.
        pid_t pid = fork();
        if (pid == 0)
        {
            int fd = open(path.c_str(), O_WRONLY);
            struct flock fl = {};
            fl.l_type = F_WRLCK;
            fl.l_whence = SEEK_SET;
            _exit(fcntl(fd, F_SETLK, &fl) == -1 ? 0 : 1);
        }
        int status = 0;
        waitpid(pid, &status, 0);
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);

        EXPECT_EQ(lock.unlock(), 0);
    }
    File_Lock bad("/nonexistent/dir/lock");
    EXPECT_FALSE(bad.okay());
    EXPECT_EQ(bad.lock(), -1);
    EXPECT_EQ(bad.unlock(), -1);
    std::string cmd = std::string("rm -rf ") + tmpl;
    ASSERT_EQ(system(cmd.c_str()), 0);
}

TEST(Log, CoexistsWithMathLog)
{
    // OLMA::log and the C library's log(double) in one unit.
    EXPECT_DOUBLE_EQ(::log(M_E), 1.0);
    EXPECT_DOUBLE_EQ(std::log(1.0), 0.0);
    log(LL_DBG, "x.cpp", 1, "quiet");
    OLMA::log(LL_DBG, "x.cpp", 1, "quiet");
}

TEST(Log, AssertAndTrace)
{
    testing::internal::CaptureStderr();
    TESSEL_TRACE();
    std::string out = testing::internal::GetCapturedStderr();
    EXPECT_NE(out.find("TRACE: "), std::string::npos);
    EXPECT_NE(out.find("test_log.cpp("), std::string::npos);
    EXPECT_NE(out.find("): TestBody\n"), std::string::npos);

    TESSEL_ASSERT(1 + 1 == 2);
    EXPECT_DEATH(TESSEL_ASSERT(1 + 1 == 3),
        "test_log\\.cpp\\([0-9]+\\): TestBody\\(\\): assert: 1 \\+ 1 == 3");
}
