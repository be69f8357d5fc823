// The fault sweep: every entry of the adapter library, under every kind of
// fault the simulated library can play, reached by every operation of the
// module that reaches it, through the strict stand-in server. Each answer
// must be the one a client is promised for a failing library; nothing may
// crash, hang or leak.
//
// Which operations reach which entry is found, not written down: each
// operation runs once on a healthy library, and the library's call log says
// what it called. Entries called only while the module loads or unloads are
// found, and faulted, in child processes that load it afresh.
//
//   harden_sweep                 every entry, and the matrix of answers
//   harden_sweep --group 3/8     the third of eight shares of the entries
//   harden_sweep --entries a,b   those entries only
//   harden_sweep --kinds hba,std those kinds only
//   harden_sweep --reach         only which operations reach which entry
//
// Exit status 0 when every answer was right, 1 otherwise (each wrong answer
// is printed), 2 when the world couldn't be set up.

#include <signal.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <condition_variable>
#include <map>
#include <mutex>
#include <thread>

#include "Harden.h"
#include "dtruj.h"

using namespace harden;

namespace
{

const char* const ALL_ENTRIES[] = {
#define ENTRY_NAME(name, cls) #name,
    DTRUJ_ENTRIES(ENTRY_NAME)
#undef ENTRY_NAME
};

struct Kind
{
    const char* name;
    const char* fault;   // for dtruj_sim_set_fault
    char letter;
};

// The error kind's code and message, looked for in the answers.
const int CODE = 7;
const char* const MESSAGE = "injected fault";

const Kind KINDS[] = {
    {"null", "null", 'n'},
    {"error", "{\"kind\":\"error\",\"code\":7,\"message\":\"injected fault\"}", 'e'},
    {"hba", "{\"kind\":\"hba\",\"code\":7,\"message\":\"injected fault\"}", 'h'},
    {"std", "{\"kind\":\"std\",\"message\":\"injected fault\"}", 's'},
    {"unknown", "{\"kind\":\"unknown\",\"code\":7}", 'u'},
    {"shape", "shape", 'a'},
    {"mistyped", "mistyped", 'm'},
    {"delay", "delay:3", 'd'},
};

// An operation reaches these entries; the load entries are reached by the
// pseudo operation "load and unload".
struct Reach
{
    std::map<std::string, std::vector<size_t>> byEntry;   // entry -> operations
    std::vector<std::string> loadEntries;
};

std::vector<std::string> failures;

void fail(const std::string& line)
{
    failures.push_back(line);
    fprintf(stderr, "FAIL %s\n", line.c_str());
}

// A run that takes longer than this has hung.
const int HANG_SECONDS = 120;

//
// Load and unload, in child processes.
//

// Runs this program again as a child that loads the module afresh under
// the fault (none without an entry), and gives back what the child wrote
// to its pipe; false, with the reason, if it crashed, hung or failed. A
// new program, not a fork: the module must load into a clean process, not
// a copy of one whose other threads held locks.
bool inChild(const char* entry, const char* fault, std::string& out, std::string& why)
{
    int fds[2];
    if (pipe(fds) != 0)
    {
        why = "no pipe";
        return false;
    }
    fflush(stdout);
    fflush(stderr);
    std::string fd = std::to_string(fds[1]);
    pid_t pid = fork();
    if (pid == 0)
    {
        close(fds[0]);
        alarm(HANG_SECONDS);
        const char* args[] = {"harden_sweep", "--load-child", fd.c_str(), entry, fault, nullptr};
        execv("/proc/self/exe", const_cast<char* const*>(args));
        _exit(127);
    }
    close(fds[1]);
    char buf[4096];
    ssize_t n;
    while ((n = read(fds[0], buf, sizeof(buf))) > 0)
        out.append(buf, size_t(n));
    close(fds[0]);
    int status = 0;
    waitpid(pid, &status, 0);
    if (WIFSIGNALED(status))
    {
        why = std::string("killed by ") + strsignal(WTERMSIG(status)) +
              (WTERMSIG(status) == SIGALRM ? " (hung)" : "");
        return false;
    }
    if (WEXITSTATUS(status) != 0)
    {
        why = "exit status " + std::to_string(WEXITSTATUS(status));
        return false;
    }
    return true;
}

int childFd = -1;

void writeAll(int fd, const std::string& text)
{
    size_t done = 0;
    while (done < text.size())
    {
        ssize_t n = write(fd, text.data() + done, text.size() - done);
        if (n <= 0)
            return;
        done += size_t(n);
    }
}

// At exit, after the module's own static objects are gone (they were
// registered later, so they go first): what the library was called for.
void reportCallsAtExit()
{
    std::string line;
    for (const std::string& e : calledEntries())
        line += e + "\n";
    writeAll(childFd, line);
    close(childFd);
}

void loadWithFault(int fd, const char* entry, const char* fault)
{
    childFd = fd;
    atexit(reportCallsAtExit);
    // The entries called before the host description is read take the
    // fault from here; those called after it, from the description.
    if (entry)
    {
        dtruj_sim_set_fault(entry, fault);
        setenv("HARDEN_FAULT_ENTRY", entry, 1);
        setenv("HARDEN_FAULT_KIND", fault, 1);
    }
    ch::Host& h = host();
    // What loading called; what the checks below call is no business of
    // the sweep's, and what unloading calls is written at exit.
    std::string loaded;
    for (const std::string& e : calledEntries())
        loaded += e + "\n";
    writeAll(fd, loaded);
    // The module loaded; it must answer, whatever its library did.
    ch::Object_Path cls;
    cls.name_space = "root/vespera";
    cls.class_name = "VESPERA_PortController";
    ch::Result r = h.ei(cls);
    if (r.rc != CMPI_RC_OK)
    {
        fprintf(stderr, "ei VESPERA_PortController: %s\n", ch::rc_name(r.rc).c_str());
        exit(3);
    }
    CMPIrc rc = CMPI_RC_OK;
    std::string text = console("{\"method\":\"discovery.getHost\",\"params\":[],\"id\":1}", &rc);
    Json::Value reply;
    if (rc != CMPI_RC_OK || !Json::Reader().parse(text, reply) || !reply.isObject())
    {
        fprintf(stderr, "executeMethod: %s %s\n", ch::rc_name(rc).c_str(), text.c_str());
        exit(3);
    }
    if (objectsLeft() != 0)
    {
        fprintf(stderr, "%zu CMPI objects left\n", h.live_objects());
        exit(3);
    }
    dtruj_sim_clear_calls();
}

//
// The sweep.
//

struct Cell
{
    std::map<std::string, size_t> answers;
    size_t wrong = 0;
};

struct Row
{
    std::string entry;
    size_t ops = 0;
    bool load = false;
    std::map<std::string, Cell> cells;   // by kind
};

bool isInstanceOp(const Op& op)
{
    return op.kind <= OP_RN;
}

// Whether `o`, the answer under the fault `kind`, is one a client may be
// given; `healthy` is the answer of the same operation without it.
bool acceptable(const Op& op, const Kind& kind, const Outcome& o, const Outcome& healthy,
                std::string& expected)
{
    std::string k = kind.name;
    if (k == "delay")
    {
        expected = healthy.answer + " as without the fault";
        if (op.kind == OP_RPC || op.kind == OP_METHOD || op.kind == OP_SUBSCRIBE)
            return o.answer == healthy.answer;
        return o.answer == healthy.answer && o.count == healthy.count;
    }
    if (isInstanceOp(op))
    {
        // Failures skip elements; only the associations may fail outright,
        // and a get may then find nothing.
        expected = "success with at most " + std::to_string(healthy.count) + " elements";
        if (op.association)
            expected += ", or CMPI_RC_ERR_FAILED";
        if (op.kind == OP_GI)
            expected += ", or CMPI_RC_ERR_NOT_FOUND";
        if (o.rc == CMPI_RC_OK)
            return o.count <= healthy.count;
        if (op.kind == OP_GI && o.rc == CMPI_RC_ERR_NOT_FOUND)
            return true;
        return op.association && o.rc == CMPI_RC_ERR_FAILED;
    }
    if (op.kind == OP_SUBSCRIBE)
    {
        expected = "ok, or CMPI_RC_ERR_FAILED; unsubscribe ok";
        return o.answer == "ok" || o.answer == "rc:CMPI_RC_ERR_FAILED";
    }
    if (op.kind == OP_METHOD)
    {
        // The outcome of a CIM method is its return value; a test that
        // started ends.
        expected = "success with a return value";
        if (o.rc != CMPI_RC_OK || o.answer == "job-stuck")
            return false;
        if (op.method == "InstallFromURI")
        {
            expected += " of 0 or 2";
            return o.value == 0 || o.value == 2;
        }
        if (op.method == "SetAlarmState")
        {
            expected += " of 0, 1 or 2";
            return o.value <= 2;
        }
        expected += " of 1, 2, 4, 5 or 4096";
        return o.value == 4096 || (o.value >= 1 && o.value <= 5 && o.value != 3);
    }
    // The console's methods: the engine's error classes.
    const Json::Value& err = o.reply["error"];
    if (o.answer == "text" || o.rc != CMPI_RC_OK)
    {
        expected = "a JSON reply";
        return false;
    }
    bool std200 = o.answer == "error:JSONRPCError:200";
    if (k == "null")
    {
        expected = "result, or JSONRPCError 200";
        return o.answer == "result" || std200;
    }
    if (k == "error")
    {
        expected = "the library's error unchanged, a result, or JSONRPCError 200";
        if (o.answer == "lib-error")
            return err["code"].asInt() == CODE && err["message"].asString() == MESSAGE &&
                   err.size() == 2;
        return o.answer == "result" || std200;
    }
    if (k == "hba")
    {
        expected = "USERDEFINEDError with the library's code and message, or JSONRPCError 200";
        if (o.answer == "error:USERDEFINEDError:" + std::to_string(CODE))
            return err["message"].asString() == MESSAGE;
        return std200;
    }
    if (k == "std")
    {
        expected = "JSONRPCError 200";
        return std200;
    }
    if (k == "unknown")
    {
        expected = "UnCaughtError 5000";
        return o.answer == "error:UnCaughtError:5000";
    }
    // A bent reply passes unread, also the library's own error.
    expected = "result, or JSONRPCError 200";
    if (healthy.answer == "lib-error")
        expected += ", or the library's error";
    return o.answer == "result" || std200 || (o.answer == "lib-error" && healthy.answer == "lib-error");
}

// A letter for an answer in the matrix.
std::string letter(const Op& op, const Outcome& o, const Outcome& healthy)
{
    if (isInstanceOp(op))
        return o.rc != CMPI_RC_OK ? "F" : o.count < healthy.count ? "s" : "o";
    if (op.kind == OP_SUBSCRIBE)
        return o.rc == CMPI_RC_OK ? "o" : "F";
    if (op.kind == OP_METHOD)
        return o.answer == healthy.answer ? "v" : "w";
    if (o.answer == "result")
        return "R";
    if (o.answer == "lib-error")
        return "L";
    if (o.answer.compare(0, 23, "error:USERDEFINEDError:") == 0)
        return "U";
    if (o.answer.compare(0, 19, "error:JSONRPCError:") == 0)
        return "J";
    if (o.answer.compare(0, 19, "error:UnCaughtError") == 0)
        return "X";
    return "?";
}

std::vector<std::string> splitList(const char* text)
{
    std::vector<std::string> out;
    std::string s = text;
    for (size_t b = 0; b <= s.size();)
    {
        size_t e = s.find(',', b);
        if (e == std::string::npos)
            e = s.size();
        if (e > b)
            out.push_back(s.substr(b, e - b));
        b = e + 1;
    }
    return out;
}

void printMatrix(const std::vector<Row>& rows, const std::vector<const Kind*>& kinds,
                 const std::vector<std::string>& unreached)
{
    printf("\nLegend: o success, s success with fewer elements, F CIM failure, v method value as"
           " healthy, w another value,\n        R result, L library's error, U USERDEFINEDError,"
           " J JSONRPCError, X UnCaughtError; *N wrong answers\n\n");
    printf("%-34s %5s", "entry", "ops");
    for (const Kind* k : kinds)
        printf("  %-18s", k->name);
    printf("\n");
    for (const Row& row : rows)
    {
        printf("%-34s %5s", row.entry.c_str(),
               row.load ? "load" : std::to_string(row.ops).c_str());
        for (const Kind* k : kinds)
        {
            std::string cell;
            auto it = row.cells.find(k->name);
            if (it != row.cells.end())
            {
                for (const auto& a : it->second.answers)
                    cell += a.first + std::to_string(a.second);
                if (it->second.wrong)
                    cell += " *" + std::to_string(it->second.wrong);
            }
            printf("  %-18s", cell.c_str());
        }
        printf("\n");
    }
    if (!unreached.empty())
    {
        printf("\nReached by no operation (%zu):", unreached.size());
        for (const std::string& e : unreached)
            printf(" %s", e.c_str());
        printf("\n");
    }
}

} // namespace

int main(int argc, char** argv)
{
    // A child that loads the module: --load-child FD [ENTRY KIND].
    if (argc >= 3 && std::string(argv[1]) == "--load-child")
    {
        loadWithFault(atoi(argv[2]), argc >= 5 ? argv[3] : nullptr, argc >= 5 ? argv[4] : nullptr);
        return 0;
    }

    std::vector<std::string> onlyEntries;
    std::vector<const Kind*> kinds;
    int group = 0, groups = 1;
    bool reachOnly = false;
    for (int i = 1; i < argc; i++)
    {
        std::string a = argv[i];
        if (a == "--group" && i + 1 < argc)
        {
            if (sscanf(argv[++i], "%d/%d", &group, &groups) != 2 || group < 1 ||
                group > groups)
            {
                fprintf(stderr, "--group I/N with 1 <= I <= N\n");
                return 2;
            }
            group--;
        }
        else if (a == "--entries" && i + 1 < argc)
            onlyEntries = splitList(argv[++i]);
        else if (a == "--kinds" && i + 1 < argc)
        {
            for (const std::string& name : splitList(argv[++i]))
                for (const Kind& k : KINDS)
                    if (name == k.name)
                        kinds.push_back(&k);
        }
        else if (a == "--reach")
            reachOnly = true;
        else
        {
            fprintf(stderr, "usage: %s [--group I/N] [--entries a,b] [--kinds k,l] [--reach]\n",
                    argv[0]);
            return 2;
        }
    }
    if (kinds.empty())
        for (const Kind& k : KINDS)
            kinds.push_back(&k);
    setvbuf(stdout, nullptr, _IOLBF, 0);
    auto t0 = std::chrono::steady_clock::now();

    // What loading and unloading the module calls, before this process
    // loads it itself.
    Reach reach;
    {
        std::string out, why;
        if (!inChild(nullptr, nullptr, out, why))
        {
            fprintf(stderr, "the module doesn't load and unload cleanly: %s\n", why.c_str());
            return 2;
        }
        size_t b = 0;
        for (size_t e; (e = out.find('\n', b)) != std::string::npos; b = e + 1)
            reach.loadEntries.push_back(out.substr(b, e - b));
    }

    ch::Host& h = host();
    Watchdog watchdog(HANG_SECONDS);
    std::vector<Op> ops = operations();
    std::vector<Outcome> healthy(ops.size());
    for (size_t i = 0; i < ops.size(); i++)
    {
        resetSimulator();
        dtruj_sim_clear_calls();
        watchdog.start(ops[i].name);
        healthy[i] = run(ops[i]);
        watchdog.done();
        bool full = false;
        for (const std::string& e : calledEntries(&full))
            reach.byEntry[e].push_back(i);
        if (full)
            fail(ops[i].name + ": the call log overflowed; some entries may be missing");
        if (objectsLeft() != 0)
            fail(ops[i].name + ": " + std::to_string(h.live_objects()) +
                 " CMPI objects left after a healthy run");
    }
    // Operations whose answer depends on what the module keeps: they answer
    // otherwise after the tests of the first round.
    std::vector<bool> stateful(ops.size(), false);
    for (size_t i = 0; i < ops.size(); i++)
        if (isInstanceOp(ops[i]))
        {
            resetSimulator();
            Outcome again = run(ops[i]);
            stateful[i] = again.answer != healthy[i].answer || again.count != healthy[i].count;
        }
    Outcome fresh;

    // An entry called at load is faulted at load; one also reached by
    // operations is faulted by those too.
    std::set<std::string> atLoad(reach.loadEntries.begin(), reach.loadEntries.end());

    if (reachOnly)
    {
        for (const char* e : ALL_ENTRIES)
        {
            printf("%s%s:", e, atLoad.count(e) ? " (load)" : "");
            for (size_t i : reach.byEntry[e])
                printf(" [%s]", ops[i].name.c_str());
            printf("\n");
        }
        return 0;
    }

    // The entries of this share: the costliest first, each to the share with
    // the least work so far, so that the shares take about as long.
    std::vector<std::string> entries;
    for (const char* e : ALL_ENTRIES)
        if (onlyEntries.empty() ||
            std::find(onlyEntries.begin(), onlyEntries.end(), e) != onlyEntries.end())
            entries.push_back(e);
    std::vector<size_t> costs;
    for (const std::string& e : entries)
        costs.push_back(reach.byEntry[e].size() * 4 + (atLoad.count(e) ? 30 : 0) + 1);
    std::vector<std::string> mine;
    for (size_t i : shareOf(costs, group, groups))
        mine.push_back(entries[i]);

    std::vector<Row> rows;
    std::vector<std::string> unreached;
    for (const char* name : ALL_ENTRIES)
    {
        std::string entry = name;
        if (std::find(mine.begin(), mine.end(), entry) == mine.end())
            continue;
        const std::vector<size_t>& reaching = reach.byEntry[entry];
        if (reaching.empty() && !atLoad.count(entry))
        {
            unreached.push_back(entry);
            continue;
        }
        Row row;
        row.entry = entry;
        row.ops = reaching.size();
        row.load = atLoad.count(entry) != 0;
        for (const Kind* kind : kinds)
        {
            Cell& cell = row.cells[kind->name];
            if (row.load)
            {
                std::string out, why;
                if (inChild(entry.c_str(), kind->fault, out, why))
                    cell.answers["o"]++;
                else
                {
                    cell.wrong++;
                    fail(entry + " " + kind->name + ": load and unload: " + why);
                }
            }
            for (size_t i : reaching)
            {
                const Op& op = ops[i];
                resetSimulator();
                // What the module keeps (jobs, records) changes the healthy
                // answer of some operations as the sweep goes on.
                const Outcome& before = stateful[i] ? (fresh = run(op)) : healthy[i];
                resetSimulator();
                dtruj_sim_set_fault(entry.c_str(), kind->fault);
                watchdog.start(entry + " " + kind->name + ": " + op.name);
                Outcome o = run(op, 20000, Fault {entry.c_str(), kind->fault});
                watchdog.done();
                dtruj_sim_set_fault(entry.c_str(), "none");
                std::string expected;
                bool right = acceptable(op, *kind, o, before, expected);
                cell.answers[right ? letter(op, o, before) : "!"]++;
                if (!right)
                {
                    cell.wrong++;
                    fail(entry + " " + kind->name + ": " + op.name + ": expected " + expected +
                         ", got " + o.answer + " (" + std::to_string(o.count) + ") " + o.detail);
                }
                if (objectsLeft() != 0)
                {
                    cell.wrong++;
                    fail(entry + " " + kind->name + ": " + op.name + ": " +
                         std::to_string(h.live_objects()) + " CMPI objects left");
                }
            }
        }
        rows.push_back(row);
        fprintf(stderr, "%s done\n", entry.c_str());
    }
    resetSimulator();

    printMatrix(rows, kinds, unreached);
    double seconds =
        std::chrono::duration<double>(std::chrono::steady_clock::now() - t0).count();
    printf("\n%zu entries, %zu operations, %zu wrong answers, %.1f s\n", rows.size(), ops.size(),
           failures.size(), seconds);
    return failures.empty() ? 0 : 1;
}
