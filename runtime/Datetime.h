#ifndef _OLMA_Datetime_h
#define _OLMA_Datetime_h

#include <stdio.h>
#include "config.h"
#include "String.h"

namespace OLMA {

struct Datetime_Rep
{
    sint32 refs;
    uint64 usec;
    // Minutes east of UTC; 0 in an interval.
    sint32 offset;
    // 1 for a timestamp, 0 for an interval.
    uint32 is_timestamp;
};

// A CIM datetime: an interval (a length in microseconds) or a timestamp
// (microseconds since the Epoch plus the zone offset in minutes). Copies
// share a reference-counted representation; modifiers copy it first.
class Datetime
{
public:
    static constexpr uint64 USEC = 1ULL;
    static constexpr uint64 MSEC = 1000ULL;
    static constexpr uint64 SEC = 1000000ULL;
    static constexpr uint64 MIN = 60000000ULL;
    static constexpr uint64 HOUR = 3600000000ULL;
    static constexpr uint64 DAY = 86400000000ULL;

    // Longest text: the prettified timestamp, 30 characters.
    enum { ASCII_SIZE = 31 };

    // An interval of zero.
    Datetime();
    // An interval.
    explicit Datetime(uint64 usec);
    // A timestamp.
    Datetime(uint64 usec, int offset);
    // From the 25-character CIM text; a timestamp of 0 if the text is bad.
    explicit Datetime(const char* str);
    Datetime(const Datetime& x);
    ~Datetime();

    Datetime& operator=(const Datetime& x);

    uint64 usec() const { return _rep->usec; }
    int offset() const { return _rep->offset; }
    bool is_timestamp() const { return _rep->is_timestamp != 0; }
    bool is_interval() const { return _rep->is_timestamp == 0; }

    // Back to an interval of zero.
    void clear();

    void set(uint64 usec);
    void set(uint64 usec, int offset);
    // From the CIM text; false (and no change) if the text is malformed.
    bool set(const char* str);

    void get_interval(uint32& days, uint32& hours, uint32& minutes,
        uint32& seconds, uint32& microseconds) const;
    void set_interval(uint32 days, uint32 hours, uint32 minutes,
        uint32 seconds, uint32 microseconds);

    // The date and time are local time; utc is the stored offset in minutes.
    void get_timestamp(uint32& year, uint32& month, uint32& day,
        uint32& hours, uint32& minutes, uint32& seconds,
        uint32& microseconds, sint32& utc) const;
    void set_timestamp(uint32 year, uint32 month, uint32 day,
        uint32 hours, uint32 minutes, uint32 seconds,
        uint32 microseconds, sint32 utc);

    // buffer must hold ASCII_SIZE bytes.
    void ascii(char* buffer, bool prettify = false) const;
    String ascii(bool prettify = false) const;
    void print(FILE* os = stdout, bool prettify = false) const;

    static Datetime now();

    Datetime_Rep* _rep;

private:
    void _cow();
};

inline bool operator==(const Datetime& a, const Datetime& b)
{
    return a.usec() == b.usec() && a.offset() == b.offset() &&
        a.is_timestamp() == b.is_timestamp();
}

inline bool operator!=(const Datetime& a, const Datetime& b)
{
    return !(a == b);
}

// Array traits for Datetime elements (see Array.h).
void _Datetime_construct(void* to, const void* from);
void _Datetime_destruct(void* at);
bool _Datetime_equal(const void* a, const void* b);

} // namespace OLMA

#endif /* _OLMA_Datetime_h */
