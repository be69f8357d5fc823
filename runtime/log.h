#ifndef _OLMA_log_h
#define _OLMA_log_h

#include <stdarg.h>
#include "config.h"
#include "String.h"

namespace OLMA {

enum Log_Level
{
    LL_FATAL = 0,
    LL_ERR,
    LL_WARN,
    LL_INFO,
    LL_DBG,
};

// "FATAL", "ERR", "WARN", "INFO", "DBG", indexed by Log_Level.
extern const char* const _log_level_strings[5];

// Tested by TLOG: false silences every TLOG line without touching log().
extern bool _log_enabled_state;

// Writes one line to $HOME/.tessel/messages if the level is in force. The
// log opens itself on a message once $HOME/.tesselrc names a level; while
// it is closed, the file is looked at again at most once a second.
void log(Log_Level level, const char* file, size_t line, const char* fmt, ...)
    __attribute__((format(printf, 4, 5)));
void vlog(Log_Level level, const char* file, size_t line, const char* fmt,
    va_list ap) __attribute__((format(printf, 4, 0)));

// Whether a message of this level may be written: the log is open at a
// level that takes it, or it is closed and due for another look at its
// configuration (at most once a second). Costs a check, no lock.
bool log_wanted(Log_Level level);

struct Log_Call_Frame
{
    Log_Level level;
    const char* file;
    size_t line;

    Log_Call_Frame(Log_Level level_, const char* file_, size_t line_)
        : level(level_), file(file_), line(line_) { }

    void invoke(const char* fmt, ...) __attribute__((format(printf, 2, 3)));
};

// Sets _log_enabled_state: 0, or -1 if it already had that value.
int log_enable(bool flag);

// Sets the level by its name, in any case: 0, or -1 (level unchanged).
int log_set_level(const String& level);

// 0 and the level if str names one in any case, else -1.
int _validate_log_level(const char* str, Log_Level& level);

// Closes the log; the next message looks at the configuration at once and
// opens it again. The level stays.
void close_log();

// Prints "file(line): function(): assert: expr" to stderr and aborts.
[[noreturn]] void __tessel_assert(const char* file, size_t line,
    const char* function, const char* expr);

// Prints "TRACE: file(line): function" to stderr.
void __tessel_trace(const char* file, size_t line, const char* function);

} // namespace OLMA

// The source's name without directories, folded at compile time.
#define TESSEL_FILE_BASENAME \
    (__builtin_strrchr(__FILE__, '/') ? __builtin_strrchr(__FILE__, '/') + 1 : __FILE__)

#define TLOG(LEVEL, ...) \
    do \
    { \
        if (OLMA::_log_enabled_state && OLMA::log_wanted(LEVEL)) \
            OLMA::Log_Call_Frame(LEVEL, TESSEL_FILE_BASENAME, __LINE__).invoke(__VA_ARGS__); \
    } \
    while (0)

#define TESSEL_ASSERT(EXPR) \
    do \
    { \
        if (!(EXPR)) \
            OLMA::__tessel_assert(__FILE__, __LINE__, __func__, #EXPR); \
    } \
    while (0)

#define TESSEL_TRACE() OLMA::__tessel_trace(__FILE__, __LINE__, __func__)

#endif /* _OLMA_log_h */
