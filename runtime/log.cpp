#include "config.h"
#include <ctype.h>
#include <pthread.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <sys/stat.h>
#include <sys/types.h>
#include <time.h>
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

// What the configuration file was when it was last read and found wanting,
// so that a file that hasn't changed isn't read again.
struct _Config_Identity
{
    bool known;
    dev_t dev;
    ino_t ino;
    off_t size;
    struct timespec mtime;
};

static _Config_Identity _last_config = { false, 0, 0, 0, { 0, 0 } };

// Read without _mutex by every message, written under it: the level in
// force while the log is open, -1 while it is closed; and while closed, the
// time (coarse monotonic, in ms) before which the configuration isn't
// looked at again. A closed log so costs a check of the clock per message.
static int _threshold = -1;
static long long _next_look_ms = 0;

static const long long _LOOK_INTERVAL_MS = 1000;

static long long _now_ms()
{
    struct timespec ts;
    clock_gettime(CLOCK_MONOTONIC_COARSE, &ts);
    return (long long)ts.tv_sec * 1000 + ts.tv_nsec / 1000000;
}

static void _set_threshold(int level)
{
    __atomic_store_n(&_threshold, level, __ATOMIC_RELEASE);
}

bool log_wanted(Log_Level level)
{
    int threshold = __atomic_load_n(&_threshold, __ATOMIC_ACQUIRE);

    if (threshold >= 0)
        return (int)level <= threshold;

    return _now_ms() >= __atomic_load_n(&_next_look_ms, __ATOMIC_RELAXED);
}

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

    // A file that is as it was when it last failed to turn the log on
    // would fail again.
    struct stat st;

    if (stat(path, &st) != 0)
    {
        _last_config.known = false;
        return;
    }

    if (_last_config.known && _last_config.dev == st.st_dev &&
        _last_config.ino == st.st_ino && _last_config.size == st.st_size &&
        _last_config.mtime.tv_sec == st.st_mtim.tv_sec &&
        _last_config.mtime.tv_nsec == st.st_mtim.tv_nsec)
    {
        return;
    }

    Log_Level level;

    if (_read_config(path, level) != 0)
    {
        _last_config.known = true;
        _last_config.dev = st.st_dev;
        _last_config.ino = st.st_ino;
        _last_config.size = st.st_size;
        _last_config.mtime = st.st_mtim;
        return;
    }

    _last_config.known = false;
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
    _set_threshold(_level);
}

void vlog(Log_Level level, const char* file, size_t line, const char* fmt,
    va_list ap)
{
    if (!log_wanted(level))
        return;

    pthread_mutex_lock(&_mutex);

    // A closed log looks at its configuration at most once a second, so
    // that a module whose log is off doesn't pay for a file system look-up
    // per message; creating the file still turns the log on within a
    // second, without a restart.
    if (!_initialized)
    {
        long long now = _now_ms();

        if (now >= _next_look_ms)
        {
            __atomic_store_n(&_next_look_ms, now + _LOOK_INTERVAL_MS, __ATOMIC_RELAXED);
            _open();
        }
    }

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

    if (_initialized)
        _set_threshold(_level);

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
        _set_threshold(-1);
    }

    // The next message looks at the configuration at once.
    _last_config.known = false;
    __atomic_store_n(&_next_look_ms, 0, __ATOMIC_RELAXED);

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
