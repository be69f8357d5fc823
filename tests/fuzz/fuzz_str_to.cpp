// libFuzzer target: the text-to-number family and its consistency.
#include <stdint.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <string>
#include "Strings.h"
#include "Type.h"

using namespace OLMA;

template<class T, class F>
static void narrow_unsigned(F f, const char* s, bool wide_ok, uint64 wide, uint64 max)
{
    T x = (T)7;
    int r = f(s, x);

    if (r == 0 && (!wide_ok || wide > max || (uint64)x != wide))
        abort();
    if (r != 0 && (x != (T)7 || (wide_ok && wide <= max)))
        abort();
}

template<class T, class F>
static void narrow_signed(F f, const char* s, bool wide_ok, sint64 wide, sint64 min, sint64 max)
{
    T x = (T)7;
    int r = f(s, x);

    if (r == 0 && (!wide_ok || wide < min || wide > max || (sint64)x != wide))
        abort();
    if (r != 0 && (x != (T)7 || (wide_ok && wide >= min && wide <= max)))
        abort();
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    std::string text(reinterpret_cast<const char*>(data), size > 80 ? 80 : size);
    const char* s = text.c_str();

    uint64 u = 0;
    bool u_ok = str_to_uint64(s, u) == 0;
    narrow_unsigned<uint8>(str_to_uint8, s, u_ok, u, 0xFF);
    narrow_unsigned<uint16>(str_to_uint16, s, u_ok, u, 0xFFFF);
    narrow_unsigned<uint32>(str_to_uint32, s, u_ok, u, 0xFFFFFFFF);

    sint64 i = 0;
    bool i_ok = str_to_sint64(s, i) == 0;
    narrow_signed<sint8>(str_to_sint8, s, i_ok, i, -128, 127);
    narrow_signed<sint16>(str_to_sint16, s, i_ok, i, -32768, 32767);
    narrow_signed<sint32>(str_to_sint32, s, i_ok, i, -2147483647LL - 1, 2147483647LL);

    // A decimal result prints back and parses to the same value.
    char buffer[22];
    size_t n;

    if (u_ok)
    {
        uint64 back;
        const char* t = uint64_to_str(buffer, u, n);
        if (strlen(t) != n || str_to_uint64(t, back) != 0 || back != u)
            abort();
        if (!i_ok && u <= (uint64)INT64_MAX)
            abort();
    }

    if (i_ok)
    {
        sint64 back;
        const char* t = sint64_to_str(buffer, i, n);
        if (strlen(t) != n || str_to_sint64(t, back) != 0 || back != i)
            abort();
    }

    real64 r64 = 0;
    real32 r32 = 0;
    bool r64_ok = str_to_real64(s, r64) == 0;
    bool r32_ok = str_to_real32(s, r32) == 0;

    if (r32_ok && !r64_ok)
        abort();
    if (r64_ok && strtod(s, nullptr) != r64)
        abort();
    // Reals need a '.'; integers never have one.
    if (r64_ok && (u_ok || i_ok))
        abort();

    boolean b;
    str_to_boolean(s, b);

    Type t;
    int found = -1;
    for (int k = 0; k < NUM_TYPES; k++)
    {
        if (strcasecmp(type_name[k], s) == 0)
            found = k;
    }
    if ((type_name_to_type(s, t) == 0) != (found >= 0) || (found >= 0 && t != found))
        abort();

    return 0;
}
