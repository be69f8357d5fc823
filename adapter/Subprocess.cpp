#include "Subprocess.h"

#include <errno.h>
#include <fcntl.h>
#include <poll.h>
#include <pthread.h>
#include <signal.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

#include <string>

#include "log.h"

extern char** environ;

namespace OLMA
{

const char* printableText(const char* text, char* buf, size_t size)
{
    if (!buf || size == 0)
        return "";

    size_t n = 0;

    for (const char* p = text ? text : ""; *p && n + 1 < size; p++)
    {
        unsigned char c = *p;
        buf[n++] = (c < 0x20 || c > 0x7e) ? '?' : (char)c;
    }

    buf[n] = '\0';
    return buf;
}

// The first executable regular file of that name in an absolute PATH entry.
// A relative entry would make the program depend on the server's working
// directory, so it is passed over.
static std::string _findOnPath(const char* program)
{
    const char* path = getenv("PATH");

    if (!path || !*path)
        path = "/usr/bin:/bin";

    std::string entries(path);
    size_t start = 0;

    while (start <= entries.size())
    {
        size_t end = entries.find(':', start);

        if (end == std::string::npos)
            end = entries.size();

        std::string dir = entries.substr(start, end - start);
        start = end + 1;

        if (dir.empty() || dir[0] != '/')
            continue;

        std::string candidate = dir + "/" + program;
        struct stat st;

        if (stat(candidate.c_str(), &st) == 0 && S_ISREG(st.st_mode) &&
            access(candidate.c_str(), X_OK) == 0)
            return candidate;
    }

    return std::string();
}

static long _nowMs()
{
    struct timespec ts;
    clock_gettime(CLOCK_MONOTONIC, &ts);
    return (long)ts.tv_sec * 1000 + ts.tv_nsec / 1000000;
}

// A descriptor above the standard three, close-on-exec. A server that runs
// with stdin or stdout closed would otherwise hand us 0, 1 or 2, and the
// child's dup2 onto those would go wrong.
static int _highFd(int fd)
{
    if (fd < 0 || fd > 2)
        return fd;

    int high = fcntl(fd, F_DUPFD_CLOEXEC, 3);
    close(fd);
    return high;
}

// From fork to exec: async-signal-safe calls only. Another thread of the
// server may have held any lock at the fork, and its copy stays held here.
static void _child(const char* exe, const char* const argv[], const char* dir,
    int nullFd, int outFd, int maxFd)
{
    struct sigaction dfl;
    memset(&dfl, 0, sizeof(dfl));
    dfl.sa_handler = SIG_DFL;

    // The server's handlers must not run in the child, and what the server
    // ignores (SIGPIPE, say) the program should not.
    for (int s = 1; s < NSIG; s++)
        sigaction(s, &dfl, 0);

    setpgid(0, 0);

    if (dir && chdir(dir) != 0)
        _exit(126);

    if (dup2(nullFd, 0) < 0 || dup2(outFd, 1) < 0 || dup2(outFd, 2) < 0)
        _exit(126);

    bool closed = false;
#ifdef SYS_close_range
    closed = syscall(SYS_close_range, 3u, ~0u, 0u) == 0;
#endif
    for (int fd = 3; !closed && fd < maxFd; fd++)
        close(fd);

    sigset_t none;
    sigemptyset(&none);
    sigprocmask(SIG_SETMASK, &none, 0);

    execve(exe, (char* const*)argv, environ);
    _exit(127);
}

// Waits for pid alone. ECHILD means that the server reaps its children
// itself (SIGCHLD ignored, or a handler that waits for any child): the
// process is gone, but its status went elsewhere.
static bool _reap(pid_t pid, bool block, SubprocessOutcome& outcome, bool& gone)
{
    int status = 0;
    pid_t r;

    do
        r = waitpid(pid, &status, block ? 0 : WNOHANG);
    while (r < 0 && errno == EINTR);

    if (r == pid)
    {
        gone = true;
        outcome.statusKnown = true;

        if (WIFEXITED(status))
            outcome.exitCode = WEXITSTATUS(status);
        else if (WIFSIGNALED(status))
            outcome.signal = WTERMSIG(status);

        return true;
    }

    if (r < 0)
    {
        gone = true;
        return true;
    }

    return false;
}

static void _collect(int fd, SubprocessOutcome& outcome, size_t& used, bool& eof)
{
    char chunk[512];

    for (;;)
    {
        ssize_t n = read(fd, chunk, sizeof(chunk));

        if (n < 0 && errno == EINTR)
            continue;

        if (n == 0)
            eof = true;

        if (n <= 0)
            return;

        // Only the start is kept; the rest is read and dropped, so that a
        // talkative program never blocks on a full pipe.
        size_t room = sizeof(outcome.output) - 1 - used;
        size_t take = (size_t)n < room ? (size_t)n : room;
        memcpy(outcome.output + used, chunk, take);
        used += take;
        outcome.output[used] = '\0';
    }
}

int runSubprocess(const char* program, const char* const argv[], const char* dir,
    int timeoutMs, SubprocessOutcome& outcome)
{
    memset(&outcome, 0, sizeof(outcome));
    outcome.exitCode = -1;

    std::string exe = _findOnPath(program);

    if (exe.empty())
    {
        TLOG(LL_ERR, "%s not found on the PATH", program);
        return -1;
    }

    int nullFd = _highFd(open("/dev/null", O_RDWR | O_CLOEXEC));
    int pipeFds[2] = { -1, -1 };

    if (nullFd < 0 || pipe2(pipeFds, O_CLOEXEC) != 0 ||
        (pipeFds[0] = _highFd(pipeFds[0])) < 0 ||
        (pipeFds[1] = _highFd(pipeFds[1])) < 0)
    {
        TLOG(LL_ERR, "Cannot prepare to run %s: %s", program, strerror(errno));
        if (nullFd >= 0)
            close(nullFd);
        if (pipeFds[0] >= 0)
            close(pipeFds[0]);
        if (pipeFds[1] >= 0)
            close(pipeFds[1]);
        return -1;
    }

    long openMax = sysconf(_SC_OPEN_MAX);
    int maxFd = openMax > 0 && openMax < 65536 ? (int)openMax : 65536;

    // Signals stay blocked from the fork until the child has put default
    // handlers in place, so that none of the server's handlers runs there.
    sigset_t all, old;
    sigfillset(&all);
    pthread_sigmask(SIG_SETMASK, &all, &old);

    pid_t pid = fork();

    if (pid == 0)
        _child(exe.c_str(), argv, dir, nullFd, pipeFds[1], maxFd);

    int forkErrno = errno;
    pthread_sigmask(SIG_SETMASK, &old, 0);
    close(nullFd);
    close(pipeFds[1]);

    if (pid < 0)
    {
        TLOG(LL_ERR, "Cannot start %s: %s", program, strerror(forkErrno));
        close(pipeFds[0]);
        return -1;
    }

    // Also here, so that a kill of the group can't miss a child that hasn't
    // got as far as its own setpgid; after its exec this fails, harmlessly.
    setpgid(pid, pid);

    int readFd = pipeFds[0];
    fcntl(readFd, F_SETFL, fcntl(readFd, F_GETFL) | O_NONBLOCK);

    long deadline = _nowMs() + (timeoutMs > 0 ? timeoutMs : 0);
    size_t used = 0;
    bool eof = false;
    bool gone = false;

    while (!gone)
    {
        if (_reap(pid, false, outcome, gone))
            break;

        long left = deadline - _nowMs();

        if (left <= 0)
        {
            outcome.timedOut = true;
            kill(-pid, SIGKILL);
            kill(pid, SIGKILL);
            _reap(pid, true, outcome, gone);
            break;
        }

        // The pipe tells at once when the program ends (its end closes);
        // the short wait only matters for one that closed its output early.
        struct pollfd p = { readFd, POLLIN, 0 };
        int slice = eof ? 10 : 50;

        if (eof)
        {
            struct timespec ts = { 0, (left < slice ? left : slice) * 1000000L };
            nanosleep(&ts, 0);
        }
        else if (poll(&p, 1, left < slice ? (int)left : slice) > 0)
            _collect(readFd, outcome, used, eof);
    }

    _collect(readFd, outcome, used, eof);
    close(readFd);
    return 0;
}

} // namespace OLMA
