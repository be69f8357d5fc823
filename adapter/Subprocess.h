#ifndef _VSPR_Subprocess_h
#define _VSPR_Subprocess_h

#include <stddef.h>

namespace OLMA
{

// What one run of an outside program came to.
struct SubprocessOutcome
{
    bool timedOut;          // killed at the deadline
    bool statusKnown;       // false if someone else reaped the child first
    int exitCode;           // its exit code, or -1 if it didn't exit by itself
    int signal;             // the signal that ended it, or 0
    char output[1024];      // the start of what it wrote on stdout and stderr
};

// Runs program, looked up on the PATH (absolute entries only), with argv as
// its arguments, in the directory dir, for at most timeoutMs milliseconds.
// No shell is involved, so the arguments reach the program as they are.
//
// The module lives in a CIM server's process, which has threads, signal
// handlers and descriptors of its own, so the run keeps out of their way:
// the child does nothing but async-signal-safe calls until exec, starts
// with default signal handling and an empty mask, keeps only stdin
// (/dev/null), stdout and stderr (a pipe back to us), and is waited for by
// its own pid alone, so that no other child is reaped and no SIGCHLD
// disposition is touched. A child that outlives the deadline is killed with
// its process group.
//
// Returns 0 once the program ran (outcome says how it ended), -1 if it
// couldn't be started, after an ERR line.
int runSubprocess(const char* program, const char* const argv[], const char* dir,
    int timeoutMs, SubprocessOutcome& outcome);

// Copies text into buf for a log line: control characters and bytes above
// 0x7e become '?', and the copy is cut to fit. Text from outside must not be
// able to forge lines of the log.
const char* printableText(const char* text, char* buf, size_t size);

} // namespace OLMA

#endif
