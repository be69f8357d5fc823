// libFuzzer target: Datetime text parsing and formatting.
#include <stdint.h>
#include <stdlib.h>
#include <string.h>
#include <time.h>
#include <string>
#include "Datetime.h"

using namespace OLMA;

extern "C" int LLVMFuzzerInitialize(int*, char***)
{
    // A fixed zone keeps the round trip free of DST gaps.
    setenv("TZ", "UTC0", 1);
    tzset();
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    std::string text(reinterpret_cast<const char*>(data), size > 64 ? 64 : size);
    Datetime d;

    if (!d.set(text.c_str()))
    {
        if (d.usec() != 0 || !d.is_interval())
            abort();
        return 0;
    }

    char plain[Datetime::ASCII_SIZE];
    char pretty[Datetime::ASCII_SIZE];
    d.ascii(plain, false);
    d.ascii(pretty, true);

    if (strlen(plain) >= Datetime::ASCII_SIZE || strlen(pretty) >= Datetime::ASCII_SIZE)
        abort();

    // Whatever parsed must come back the same through its own text, unless
    // normalisation pushed the year past four digits.
    if (strlen(plain) == 25)
    {
        Datetime e;
        if (!e.set(plain) || !(e == d))
            abort();
    }

    Datetime copy(d);
    copy.set(1ULL);
    if (copy == d && d.usec() != 1)
        abort();

    if (d.is_interval())
    {
        uint32 days, h, m, s, us;
        d.get_interval(days, h, m, s, us);
        Datetime e;
        e.set_interval(days, h, m, s, us);
        if (!(e == d))
            abort();
    }

    return 0;
}
