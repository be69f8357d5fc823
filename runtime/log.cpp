#include "config.h"
#include <ctype.h>
#include <pthread.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <sys/stat.h>
#include <sys/types.h>
#include "log.h"
#include "Buffer.h"
#include "Datetime.h"
#include "File_Lock.h"
#include "Strings.h"

namespace OLMA {

const char* const _log_level_strings[5] = { "FATAL", "ERR", "WARN", "INFO", "DBG" };

bool _log_enabled_state = true;

static const char _HOME_VAR[] = "HOME";
String tessel_home_envvar(_HOME_VAR);

static const char _TESSEL_DIR[] = ".tessel";
static const size_t _PATH_SIZE = 1024;

// Everything below is guarded by _mutex.
static Log_Level _level = LL_FATAL;
static FILE* _log_file_handle = 0;
static File_Lock* _lock = 0;
static bool _initialized = false;
static pthread_mutex_t _mutex = PTHREAD_MUTEX_INITIALIZER;

int _validate_log_level(const char* str, Log_Level& level)
{
    if (!str)
        return -1;

    for (int i = 0; i <= LL_DBG; i++)
    {
        if (strcasecmp(str, _log_level_strings[i]) == 0)
        {
            level = Log_Level(i);
            return 0;
        }
    }

    return -1;
}

static inline bool _is_space(char c)
{
    return isspace((unsigned char)c) != 0;
}

// Reads the first "LOG_LEVEL = <level>" line of the rc file: 0 and the
// level, or -1 if there is no such line or its value names no level.
static int _read_config(const char* path, Log_Level& level)
{
    FILE* is = fopen(path, "r");

    if (!is)
        return -1;

    char line[1024];
    int result = -1;

    while (fgets(line, sizeof(line), is))
    {
        if (line[0] == '#')
            continue;

        size_t n = strlen(line);

        while (n && _is_space(line[n - 1]))
            line[--n] = '\0';

        if (n == 0)
            continue;

        static const char _KEY[] = "LOG_LEVEL";

        if (strncmp(line, _KEY, sizeof(_KEY) - 1) != 0)
            continue;

        const char* p = line + sizeof(_KEY) - 1;

        while (_is_space(*p))
            p++;

        if (*p != '=')
            continue;

        p++;

        while (_is_space(*p))
            p++;

        result = _validate_log_level(p, level);
        break;
    }

    fclose(is);
    return result;
}

// Opens the log if the rc file asks for it. Called with _mutex held; a
// failure leaves everything closed so that the next message tries again.
static void _open()
{
    // The literal, not tessel_home_envvar: a static constructor elsewhere in
    // the module (the adapter library's start-up) may log before that String
    // has been constructed.
    const char* home = getenv(_HOME_VAR);

    if (!home)
        return;

    char path[_PATH_SIZE];
    int n = snprintf(path, sizeof(path), "%s/%src", home, _TESSEL_DIR);

    if (n < 0 || (size_t)n >= sizeof(path))
        return;

    Log_Level level;

    if (_read_config(path, level) != 0)
        return;

    _level = level;

    char dir[_PATH_SIZE];
    char lock_path[_PATH_SIZE];
    char log_path[_PATH_SIZE];

    if ((size_t)snprintf(dir, sizeof(dir), "%s/%s", home, _TESSEL_DIR) >= sizeof(dir) ||
        (size_t)snprintf(lock_path, sizeof(lock_path), "%s/messages.lock", dir) >= sizeof(lock_path) ||
        (size_t)snprintf(log_path, sizeof(log_path), "%s/messages", dir) >= sizeof(log_path))
    {
        return;
    }

    // An existing directory is fine, so the result isn't read.
    mkdir(dir, 0777);

    File_Lock* lock = new File_Lock(lock_path);

    if (!lock->okay())
    {
        delete lock;
        return;
    }

    FILE* os = fopen(log_path, "ae");

    if (!os)
    {
        delete lock;
        return;
    }

    _lock = lock;
    _log_file_handle = os;
    _initialized = true;
}

void vlog(Log_Level level, const char* file, size_t line, const char* fmt,
    va_list ap)
{
    pthread_mutex_lock(&_mutex);

    if (!_initialized)
        _open();

    if (!_initialized || (unsigned)level > (unsigned)_level)
    {
        pthread_mutex_unlock(&_mutex);
        return;
    }

    char now[Datetime::ASCII_SIZE];
    Datetime::now().ascii(now, true);
    char* dot = strchr(now, '.');

    if (dot)
        *dot = '\0';

    Buffer buffer;
    buffer.format("%s %s: %s(%d): ", now, _log_level_strings[level],
        file ? file : "", (int)line);

    if (fmt)
        buffer.vformat(fmt, ap);

    if (buffer.data()[buffer.size() - 1] != '\n')
        buffer.append('\n');

    _lock->lock();
    fwrite(buffer.data(), 1, buffer.size(), _log_file_handle);
    fflush(_log_file_handle);
    _lock->unlock();

    pthread_mutex_unlock(&_mutex);
}

void log(Log_Level level, const char* file, size_t line, const char* fmt, ...)
{
    va_list ap;
    va_start(ap, fmt);
    vlog(level, file, line, fmt, ap);
    va_end(ap);
}

void Log_Call_Frame::invoke(const char* fmt, ...)
{
    va_list ap;
    va_start(ap, fmt);
    vlog(level, file, line, fmt, ap);
    va_end(ap);
}

int log_enable(bool flag)
{
    if (_log_enabled_state == flag)
        return -1;

    _log_enabled_state = flag;
    return 0;
}

int log_set_level(const String& level)
{
    Log_Level x;

    if (_validate_log_level(level.c_str(), x) != 0)
        return -1;

    pthread_mutex_lock(&_mutex);
    _level = x;
    pthread_mutex_unlock(&_mutex);
    return 0;
}

void close_log()
{
    pthread_mutex_lock(&_mutex);

    if (_initialized)
    {
        delete _lock;
        _lock = 0;
        fclose(_log_file_handle);
        _log_file_handle = 0;
        _initialized = false;
    }

    pthread_mutex_unlock(&_mutex);
}

void __tessel_assert(const char* file, size_t line, const char* function,
    const char* expr)
{
    fprintf(stderr, "%s(%d): %s(): assert: %s\n\n", file, (int)line, function, expr);
    abort();
}

void __tessel_trace(const char* file, size_t line, const char* function)
{
    fprintf(stderr, "TRACE: %s(%d): %s\n", file, (int)line, function);
}

} // namespace OLMA
