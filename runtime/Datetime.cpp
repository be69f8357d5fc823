#include "config.h"
#include <stdlib.h>
#include <string.h>
#include <time.h>
#include <sys/time.h>
#include <new>
#include "Datetime.h"
#include "Strings.h"
#include "log.h"

namespace OLMA {

static Datetime_Rep* _alloc(uint64 usec, sint32 offset, uint32 is_timestamp)
{
    Datetime_Rep* rep = static_cast<Datetime_Rep*>(malloc(sizeof(Datetime_Rep)));
    TESSEL_ASSERT(rep != 0);
    rep->refs = 1;
    rep->usec = usec;
    rep->offset = offset;
    rep->is_timestamp = is_timestamp;
    return rep;
}

static inline void _ref(Datetime_Rep* rep)
{
    __atomic_add_fetch(&rep->refs, 1, __ATOMIC_RELAXED);
}

static inline void _unref(Datetime_Rep* rep)
{
    if (__atomic_sub_fetch(&rep->refs, 1, __ATOMIC_ACQ_REL) == 0)
        free(rep);
}

Datetime::Datetime() : _rep(_alloc(0, 0, 0))
{
}

Datetime::Datetime(uint64 usec) : _rep(_alloc(usec, 0, 0))
{
}

Datetime::Datetime(uint64 usec, int offset) : _rep(_alloc(usec, offset, 1))
{
}

Datetime::Datetime(const char* str) : _rep(_alloc(0, 0, 1))
{
    set(str);
}

Datetime::Datetime(const Datetime& x) : _rep(x._rep)
{
    _ref(_rep);
}

Datetime::~Datetime()
{
    _unref(_rep);
}

Datetime& Datetime::operator=(const Datetime& x)
{
    if (x._rep != _rep)
    {
        _ref(x._rep);
        _unref(_rep);
        _rep = x._rep;
    }

    return *this;
}

void Datetime::_cow()
{
    if (__atomic_load_n(&_rep->refs, __ATOMIC_ACQUIRE) != 1)
    {
        Datetime_Rep* old = _rep;
        _rep = _alloc(old->usec, old->offset, old->is_timestamp);
        _unref(old);
    }
}

void Datetime::clear()
{
    _cow();
    _rep->usec = 0;
    _rep->offset = 0;
    _rep->is_timestamp = 0;
}

void Datetime::set(uint64 usec)
{
    _cow();
    _rep->usec = usec;
    _rep->offset = 0;
    _rep->is_timestamp = 0;
}

void Datetime::set(uint64 usec, int offset)
{
    _cow();
    _rep->usec = usec;
    _rep->offset = offset;
    _rep->is_timestamp = 1;
}

// Local date and time to seconds since the Epoch. Dates before the Epoch,
// which an unsigned count cannot hold, and dates mktime cannot place fail.
static bool _local_to_usec(uint32 year, uint32 month, uint32 day,
    uint32 hours, uint32 minutes, uint32 seconds, uint32 microseconds,
    uint64& usec)
{
    if (year > 1000000 || month > 1000 || day > 100000 || hours > 100000 ||
        minutes > 1000000 || seconds > 10000000)
    {
        return false;
    }

    struct tm tm;
    memset(&tm, 0, sizeof(tm));
    tm.tm_year = (int)year - 1900;
    tm.tm_mon = (int)month - 1;
    tm.tm_mday = (int)day;
    tm.tm_hour = (int)hours;
    tm.tm_min = (int)minutes;
    tm.tm_sec = (int)seconds;
    tm.tm_isdst = -1;

    time_t t = mktime(&tm);

    if (t < 0)
        return false;

    usec = (uint64)t * Datetime::SEC + microseconds;
    return true;
}

void Datetime::get_interval(uint32& days, uint32& hours, uint32& minutes,
    uint32& seconds, uint32& microseconds) const
{
    uint64 x = _rep->usec;
    days = (uint32)(x / DAY);
    x %= DAY;
    hours = (uint32)(x / HOUR);
    x %= HOUR;
    minutes = (uint32)(x / MIN);
    x %= MIN;
    seconds = (uint32)(x / SEC);
    microseconds = (uint32)(x % SEC);
}

void Datetime::set_interval(uint32 days, uint32 hours, uint32 minutes,
    uint32 seconds, uint32 microseconds)
{
    set(days * DAY + hours * HOUR + minutes * MIN + seconds * SEC +
        microseconds);
}

void Datetime::get_timestamp(uint32& year, uint32& month, uint32& day,
    uint32& hours, uint32& minutes, uint32& seconds,
    uint32& microseconds, sint32& utc) const
{
    time_t t = (time_t)(_rep->usec / SEC);
    struct tm tm;

    if ((uint64)t != _rep->usec / SEC || t < 0 || !localtime_r(&t, &tm))
        memset(&tm, 0, sizeof(tm));

    year = (uint32)(tm.tm_year + 1900);
    month = (uint32)(tm.tm_mon + 1);
    day = (uint32)tm.tm_mday;
    hours = (uint32)tm.tm_hour;
    minutes = (uint32)tm.tm_min;
    seconds = (uint32)tm.tm_sec;
    microseconds = (uint32)(_rep->usec % SEC);
    utc = _rep->offset;
}

void Datetime::set_timestamp(uint32 year, uint32 month, uint32 day,
    uint32 hours, uint32 minutes, uint32 seconds,
    uint32 microseconds, sint32 utc)
{
    uint64 usec = 0;

    if (!_local_to_usec(year, month, day, hours, minutes, seconds,
        microseconds, usec))
    {
        TLOG(LL_WARN, "timestamp %u/%u/%u %u:%u:%u out of range",
            year, month, day, hours, minutes, seconds);
        usec = 0;
    }

    set(usec, utc);
}

// n decimal digits at s, or -1.
static inline sint64 _digits(const char* s, size_t n)
{
    sint64 x = 0;

    for (size_t i = 0; i < n; i++)
    {
        if (s[i] < '0' || s[i] > '9')
            return -1;

        x = x * 10 + (s[i] - '0');
    }

    return x;
}

bool Datetime::set(const char* str)
{
    if (!str || strnlen(str, 26) != 25)
        return false;

    sint64 f[6];
    static const size_t pos[] = { 0, 8, 10, 12 };

    // Fields common to both forms: microseconds at 15, '.' at 14.
    sint64 usec_part = _digits(str + 15, 6);

    if (str[14] != '.' || usec_part < 0)
        return false;

    if (str[21] == ':')
    {
        if (memcmp(str + 22, "000", 3) != 0)
            return false;

        static const size_t len[] = { 8, 2, 2, 2 };

        for (size_t i = 0; i < 4; i++)
        {
            if ((f[i] = _digits(str + pos[i], len[i])) < 0)
                return false;
        }

        set((uint64)f[0] * DAY + (uint64)f[1] * HOUR + (uint64)f[2] * MIN +
            (uint64)f[3] * SEC + (uint64)usec_part);
        return true;
    }

    if (str[21] != '+' && str[21] != '-')
        return false;

    static const size_t tpos[] = { 0, 4, 6, 8, 10, 12 };
    static const size_t tlen[] = { 4, 2, 2, 2, 2, 2 };

    for (size_t i = 0; i < 6; i++)
    {
        if ((f[i] = _digits(str + tpos[i], tlen[i])) < 0)
            return false;
    }

    sint64 off = _digits(str + 22, 3);

    if (off < 0)
        return false;

    uint64 usec;

    if (!_local_to_usec((uint32)f[0], (uint32)f[1], (uint32)f[2],
        (uint32)f[3], (uint32)f[4], (uint32)f[5], (uint32)usec_part, usec))
    {
        return false;
    }

    set(usec, str[21] == '-' ? -(int)off : (int)off);
    return true;
}

void Datetime::ascii(char* buffer, bool prettify) const
{
    // Absurd values (years past 9999, offsets past 999 minutes) give longer
    // texts; they are cut to the documented size rather than overrun it.
    char tmp[96];

    if (is_timestamp())
    {
        uint32 year, month, day, hours, minutes, seconds, microseconds;
        sint32 utc;
        get_timestamp(year, month, day, hours, minutes, seconds,
            microseconds, utc);
        long long off = utc;
        snprintf(tmp, sizeof(tmp),
            prettify ? "%04u/%02u/%02u %02u:%02u:%02u.%06u%c%03lld" :
                "%04u%02u%02u%02u%02u%02u.%06u%c%03lld",
            year, month, day, hours, minutes, seconds, microseconds,
            off < 0 ? '-' : '+', off < 0 ? -off : off);
    }
    else
    {
        uint32 days, hours, minutes, seconds, microseconds;
        get_interval(days, hours, minutes, seconds, microseconds);
        snprintf(tmp, sizeof(tmp),
            prettify ? "%08u %02u %02u %02u.%06u:000" :
                "%08u%02u%02u%02u.%06u:000",
            days, hours, minutes, seconds, microseconds);
    }

    strlcpy(buffer, tmp, ASCII_SIZE);
}

String Datetime::ascii(bool prettify) const
{
    char buffer[ASCII_SIZE];
    ascii(buffer, prettify);
    return String(buffer);
}

void Datetime::print(FILE* os, bool prettify) const
{
    char buffer[ASCII_SIZE];
    ascii(buffer, prettify);
    fprintf(os, "%s\n", buffer);
}

Datetime Datetime::now()
{
    struct timeval tv;

    if (gettimeofday(&tv, 0) != 0)
        return Datetime();

    // The zone argument of gettimeofday is obsolete (glibc leaves it zero),
    // so the offset comes from the local time of the same second.
    time_t t = tv.tv_sec;
    struct tm tm;
    int offset = 0;

    if (localtime_r(&t, &tm))
        offset = (int)(tm.tm_gmtoff / 60);

    return Datetime((uint64)tv.tv_sec * SEC + (uint64)tv.tv_usec, offset);
}

void _Datetime_construct(void* to, const void* from)
{
    new (to) Datetime(*static_cast<const Datetime*>(from));
}

void _Datetime_destruct(void* at)
{
    static_cast<Datetime*>(at)->~Datetime();
}

bool _Datetime_equal(const void* a, const void* b)
{
    return *static_cast<const Datetime*>(a) == *static_cast<const Datetime*>(b);
}

} // namespace OLMA
