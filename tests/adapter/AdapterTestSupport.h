// Shared by the adapter tests: a private HOME whose log is on at DBG, reading
// what the module logged, and running the start-up probe in an environment
// of the test's choosing.
#ifndef _VSPR_AdapterTestSupport_h
#define _VSPR_AdapterTestSupport_h

#include <spawn.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <fstream>
#include <map>
#include <sstream>
#include <string>
#include <vector>

extern char** environ;

namespace adapter_test
{

inline std::string readFile(const std::string& path)
{
    std::ifstream in(path.c_str(), std::ios::binary);
    std::stringstream text;
    text << in.rdbuf();
    return text.str();
}

inline void writeFile(const std::string& path, const std::string& text)
{
    std::ofstream out(path.c_str(), std::ios::binary | std::ios::trunc);
    out << text;
}

// A new directory under TMPDIR with .tesselrc asking for every level.
inline std::string makeHome()
{
    const char* tmp = getenv("TMPDIR");
    std::string pattern = std::string(tmp && *tmp ? tmp : "/tmp") +
        "/vspr-adapter-XXXXXX";
    std::vector<char> name(pattern.begin(), pattern.end());
    name.push_back('\0');

    if (!mkdtemp(name.data()))
        return std::string();

    std::string home(name.data());
    writeFile(home + "/.tesselrc", "LOG_LEVEL=DBG\n");
    return home;
}

// The lines of a log text that hold every one of the given pieces.
inline std::vector<std::string> linesWith(const std::string& text,
    const std::vector<std::string>& pieces)
{
    std::vector<std::string> found;
    std::istringstream in(text);
    std::string line;

    while (std::getline(in, line))
    {
        bool all = true;

        for (const std::string& p : pieces)
            all = all && line.find(p) != std::string::npos;

        if (all)
            found.push_back(line);
    }

    return found;
}

inline size_t countLines(const std::string& text,
    const std::vector<std::string>& pieces)
{
    return linesWith(text, pieces).size();
}

// Runs a program with exactly the given environment; its standard output.
inline std::string runWithEnv(const std::vector<std::string>& argv,
    const std::map<std::string, std::string>& env, int* status = 0)
{
    std::vector<std::string> envText;

    for (const auto& e : env)
        envText.push_back(e.first + "=" + e.second);

    std::vector<char*> envp;

    for (std::string& e : envText)
        envp.push_back(&e[0]);

    envp.push_back(0);

    std::vector<std::string> args(argv);
    std::vector<char*> argp;

    for (std::string& a : args)
        argp.push_back(&a[0]);

    argp.push_back(0);

    int fds[2];

    if (pipe(fds) != 0)
        return std::string();

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, fds[1], 1);
    posix_spawn_file_actions_addclose(&actions, fds[0]);

    pid_t pid;
    int rc = posix_spawn(&pid, argp[0], &actions, 0, argp.data(), envp.data());
    posix_spawn_file_actions_destroy(&actions);
    close(fds[1]);

    std::string out;

    if (rc == 0)
    {
        char buf[4096];
        ssize_t n;

        while ((n = read(fds[0], buf, sizeof(buf))) > 0)
            out.append(buf, n);

        int st = 0;
        waitpid(pid, &st, 0);

        if (status)
            *status = st;
    }

    close(fds[0]);
    return out;
}

// "key=value" lines of the probe's output.
inline std::map<std::string, std::string> parseReport(const std::string& text)
{
    std::map<std::string, std::string> report;
    std::istringstream in(text);
    std::string line;

    while (std::getline(in, line))
    {
        size_t eq = line.find('=');

        if (eq != std::string::npos)
            report[line.substr(0, eq)] = line.substr(eq + 1);
    }

    return report;
}

} // namespace adapter_test

#endif
