#include "config.h"
#include <ctype.h>
#include <errno.h>
#include <math.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include "Strings.h"

namespace OLMA {

#define OLMA_L(C) (uint8)((C) >= 'A' && (C) <= 'Z' ? (C) + ('a' - 'A') : (C))
#define OLMA_L4(C) OLMA_L(C), OLMA_L(C + 1), OLMA_L(C + 2), OLMA_L(C + 3)
#define OLMA_L16(C) OLMA_L4(C), OLMA_L4(C + 4), OLMA_L4(C + 8), OLMA_L4(C + 12)
#define OLMA_L64(C) OLMA_L16(C), OLMA_L16(C + 16), OLMA_L16(C + 32), OLMA_L16(C + 48)

const uint8 __lower[256] =
{
    OLMA_L64(0), OLMA_L64(64), OLMA_L64(128), OLMA_L64(192)
};

#define OLMA_D(C) (sint32)((C) >= '0' && (C) <= '9' ? (C) - '0' : -1)
#define OLMA_D4(C) OLMA_D(C), OLMA_D(C + 1), OLMA_D(C + 2), OLMA_D(C + 3)
#define OLMA_D16(C) OLMA_D4(C), OLMA_D4(C + 4), OLMA_D4(C + 8), OLMA_D4(C + 12)
#define OLMA_D64(C) OLMA_D16(C), OLMA_D16(C + 16), OLMA_D16(C + 32), OLMA_D16(C + 48)

// Value of a decimal digit, -1 for any other byte.
static const sint32 _digit[256] =
{
    OLMA_D64(0), OLMA_D64(64), OLMA_D64(128), OLMA_D64(192)
};

//==============================================================================
// Text to number
//==============================================================================

static inline int _hex_digit(char c)
{
    if (c >= '0' && c <= '9')
        return c - '0';

    // Upper case only: CIM's hexadecimal literals are written that way.
    if (c >= 'A' && c <= 'F')
        return c - 'A' + 10;

    return -1;
}

int str_to_uint64(const char* str, uint64& x)
{
    if (!str || !str[0])
        return -1;

    if (str[0] == '0' && (str[1] == 'x' || str[1] == 'X'))
    {
        const char* p = str + 2;
        uint64 r = 0;
        size_t n = 0;

        for (; *p; p++, n++)
        {
            int d = _hex_digit(*p);

            if (d < 0 || n == 16)
                return -1;

            r = (r << 4) | (uint64)d;
        }

        if (n == 0)
            return -1;

        x = r;
        return 0;
    }

    uint64 r = 0;
    size_t n = 0;

    for (const char* p = str; *p; p++, n++)
    {
        sint32 d = _digit[(uint8)*p];

        if (d < 0 || n == 20)
            return -1;

        // Twenty digits can exceed 2^64 - 1; such a number is refused
        // rather than wrapped.
        if (r > (~0ULL - (uint64)d) / 10)
            return -1;

        r = r * 10 + (uint64)d;
    }

    x = r;
    return 0;
}

template<class T>
static inline int _str_to_unsigned(const char* str, T& x, uint64 max)
{
    uint64 r;

    if (str_to_uint64(str, r) != 0 || r > max)
        return -1;

    x = (T)r;
    return 0;
}

int str_to_uint8(const char* str, uint8& x)
{
    return _str_to_unsigned(str, x, 0xFF);
}

int str_to_uint16(const char* str, uint16& x)
{
    return _str_to_unsigned(str, x, 0xFFFF);
}

int str_to_uint32(const char* str, uint32& x)
{
    return _str_to_unsigned(str, x, 0xFFFFFFFF);
}

int str_to_sint64(const char* str, sint64& x)
{
    if (!str)
        return -1;

    bool negative = false;

    if (*str == '+')
        str++;
    else if (*str == '-')
    {
        negative = true;
        str++;
    }

    uint64 r;

    if (str_to_uint64(str, r) != 0)
        return -1;

    if (negative)
    {
        if (r > (1ULL << 63))
            return -1;

        x = (sint64)(0 - r);
    }
    else
    {
        if (r > (1ULL << 63) - 1)
            return -1;

        x = (sint64)r;
    }

    return 0;
}

template<class T>
static inline int _str_to_signed(const char* str, T& x, sint64 min, sint64 max)
{
    sint64 r;

    if (str_to_sint64(str, r) != 0 || r < min || r > max)
        return -1;

    x = (T)r;
    return 0;
}

int str_to_sint8(const char* str, sint8& x)
{
    return _str_to_signed(str, x, -128, 127);
}

int str_to_sint16(const char* str, sint16& x)
{
    return _str_to_signed(str, x, -32768, 32767);
}

int str_to_sint32(const char* str, sint32& x)
{
    return _str_to_signed(str, x, -2147483647LL - 1, 2147483647LL);
}

// The shape of a CIM real: [sign] digits* '.' digits+ [(e|E) [sign] digits+].
// Checked before strtod, which would also take "1", "1.", hex, "inf"...
static bool _parse_real(const char* p)
{
    if (*p == '+' || *p == '-')
        p++;

    while (_digit[(uint8)*p] >= 0)
        p++;

    if (*p++ != '.')
        return false;

    if (_digit[(uint8)*p] < 0)
        return false;

    while (_digit[(uint8)*p] >= 0)
        p++;

    if (*p == 'e' || *p == 'E')
    {
        p++;

        if (*p == '+' || *p == '-')
            p++;

        if (_digit[(uint8)*p] < 0)
            return false;

        while (_digit[(uint8)*p] >= 0)
            p++;
    }

    return *p == '\0';
}

int str_to_real64(const char* str, real64& x)
{
    if (!str || !_parse_real(str))
        return -1;

    char* end;
    real64 r = strtod(str, &end);

    // An exponent beyond the type's range is an error, not infinity.
    if (*end != '\0' || isinf(r))
        return -1;

    x = r;
    return 0;
}

int str_to_real32(const char* str, real32& x)
{
    real64 r;

    if (str_to_real64(str, r) != 0)
        return -1;

    real32 f = (real32)r;

    if (isinf(f))
        return -1;

    x = f;
    return 0;
}

int str_to_boolean(const char* str, boolean& x)
{
    if (!str)
        return -1;

    if (strcasecmp(str, "true") == 0)
    {
        x = true;
        return 0;
    }

    if (strcasecmp(str, "false") == 0)
    {
        x = false;
        return 0;
    }

    return -1;
}

//==============================================================================
// Integer to text
//==============================================================================

struct _Uint_String
{
    const char* str;
    size_t size;
};

#define OLMA_S(N) { #N, sizeof(#N) - 1 }

// The small numbers, which are by far the commonest, need no formatting.
static const _Uint_String _uint_strings[128] =
{
    OLMA_S(0), OLMA_S(1), OLMA_S(2), OLMA_S(3), OLMA_S(4), OLMA_S(5),
    OLMA_S(6), OLMA_S(7), OLMA_S(8), OLMA_S(9), OLMA_S(10), OLMA_S(11),
    OLMA_S(12), OLMA_S(13), OLMA_S(14), OLMA_S(15), OLMA_S(16), OLMA_S(17),
    OLMA_S(18), OLMA_S(19), OLMA_S(20), OLMA_S(21), OLMA_S(22), OLMA_S(23),
    OLMA_S(24), OLMA_S(25), OLMA_S(26), OLMA_S(27), OLMA_S(28), OLMA_S(29),
    OLMA_S(30), OLMA_S(31), OLMA_S(32), OLMA_S(33), OLMA_S(34), OLMA_S(35),
    OLMA_S(36), OLMA_S(37), OLMA_S(38), OLMA_S(39), OLMA_S(40), OLMA_S(41),
    OLMA_S(42), OLMA_S(43), OLMA_S(44), OLMA_S(45), OLMA_S(46), OLMA_S(47),
    OLMA_S(48), OLMA_S(49), OLMA_S(50), OLMA_S(51), OLMA_S(52), OLMA_S(53),
    OLMA_S(54), OLMA_S(55), OLMA_S(56), OLMA_S(57), OLMA_S(58), OLMA_S(59),
    OLMA_S(60), OLMA_S(61), OLMA_S(62), OLMA_S(63), OLMA_S(64), OLMA_S(65),
    OLMA_S(66), OLMA_S(67), OLMA_S(68), OLMA_S(69), OLMA_S(70), OLMA_S(71),
    OLMA_S(72), OLMA_S(73), OLMA_S(74), OLMA_S(75), OLMA_S(76), OLMA_S(77),
    OLMA_S(78), OLMA_S(79), OLMA_S(80), OLMA_S(81), OLMA_S(82), OLMA_S(83),
    OLMA_S(84), OLMA_S(85), OLMA_S(86), OLMA_S(87), OLMA_S(88), OLMA_S(89),
    OLMA_S(90), OLMA_S(91), OLMA_S(92), OLMA_S(93), OLMA_S(94), OLMA_S(95),
    OLMA_S(96), OLMA_S(97), OLMA_S(98), OLMA_S(99), OLMA_S(100), OLMA_S(101),
    OLMA_S(102), OLMA_S(103), OLMA_S(104), OLMA_S(105), OLMA_S(106),
    OLMA_S(107), OLMA_S(108), OLMA_S(109), OLMA_S(110), OLMA_S(111),
    OLMA_S(112), OLMA_S(113), OLMA_S(114), OLMA_S(115), OLMA_S(116),
    OLMA_S(117), OLMA_S(118), OLMA_S(119), OLMA_S(120), OLMA_S(121),
    OLMA_S(122), OLMA_S(123), OLMA_S(124), OLMA_S(125), OLMA_S(126),
    OLMA_S(127),
};

#undef OLMA_S

// Writes backwards from index 21 of the caller's 22 bytes.
static const char* _to_str(char* buffer, uint64 magnitude, bool negative,
    size_t& size)
{
    char* end = buffer + 21;
    char* p = end;
    *p = '\0';

    do
    {
        *--p = (char)('0' + magnitude % 10);
        magnitude /= 10;
    }
    while (magnitude);

    if (negative)
        *--p = '-';

    size = (size_t)(end - p);
    return p;
}

static inline const char* _uint_to_str(char* buffer, uint64 x, size_t& size)
{
    if (x < 128)
    {
        size = _uint_strings[x].size;
        return _uint_strings[x].str;
    }

    return _to_str(buffer, x, false, size);
}

static inline const char* _sint_to_str(char* buffer, sint64 x, size_t& size)
{
    if (x >= 0)
        return _uint_to_str(buffer, (uint64)x, size);

    return _to_str(buffer, 0 - (uint64)x, true, size);
}

const char* uint8_to_str(char buffer[22], uint8 x, size_t& size)
{
    return _uint_to_str(buffer, x, size);
}

const char* sint8_to_str(char buffer[22], sint8 x, size_t& size)
{
    return _sint_to_str(buffer, x, size);
}

const char* uint16_to_str(char buffer[22], uint16 x, size_t& size)
{
    return _uint_to_str(buffer, x, size);
}

const char* sint16_to_str(char buffer[22], sint16 x, size_t& size)
{
    return _sint_to_str(buffer, x, size);
}

const char* uint32_to_str(char buffer[22], uint32 x, size_t& size)
{
    return _uint_to_str(buffer, x, size);
}

const char* sint32_to_str(char buffer[22], sint32 x, size_t& size)
{
    return _sint_to_str(buffer, x, size);
}

const char* uint64_to_str(char buffer[22], uint64 x, size_t& size)
{
    return _uint_to_str(buffer, x, size);
}

const char* sint64_to_str(char buffer[22], sint64 x, size_t& size)
{
    return _sint_to_str(buffer, x, size);
}

//==============================================================================
// Printing
//==============================================================================

void fprint_string(FILE* os, const char* str)
{
    fputc('"', os);

    for (const char* p = str ? str : ""; *p; p++)
    {
        switch (*p)
        {
            case '"': fputs("\\\"", os); break;
            case '\t': fputs("\\t", os); break;
            case '\n': fputs("\\n", os); break;
            case '\f': fputs("\\f", os); break;
            case '\r': fputs("\\r", os); break;
            default: fputc(*p, os); break;
        }
    }

    fputc('"', os);
}

void print_string(const char* str)
{
    fprint_string(stdout, str);
}

template<class T>
static inline T _load(const void* p)
{
    T x;
    memcpy(&x, p, sizeof(T));
    return x;
}

void fprint_scalar(FILE* os, Type type, const void* value)
{
    if (!value)
    {
        fputs("null", os);
        return;
    }

    switch (type)
    {
        case BOOLEAN:
            fputs(_load<uint8>(value) ? "true" : "false", os);
            break;
        case UINT8:
            fprintf(os, "%u", (unsigned)_load<uint8>(value));
            break;
        case SINT8:
            fprintf(os, "%d", (int)_load<sint8>(value));
            break;
        case UINT16:
            fprintf(os, "%u", (unsigned)_load<uint16>(value));
            break;
        case SINT16:
            fprintf(os, "%d", (int)_load<sint16>(value));
            break;
        case UINT32:
            fprintf(os, "%u", (unsigned)_load<uint32>(value));
            break;
        case SINT32:
            fprintf(os, "%d", (int)_load<sint32>(value));
            break;
        case UINT64:
            fprintf(os, "%llu", _load<uint64>(value));
            break;
        case SINT64:
            fprintf(os, "%lld", _load<sint64>(value));
            break;
        case REAL32:
            fprintf(os, "%f", (double)_load<real32>(value));
            break;
        case REAL64:
            fprintf(os, "%f", _load<real64>(value));
            break;
        case CHAR16:
            fprintf(os, "%u", (unsigned)_load<uint16>(value));
            break;
        case STRING:
            fprint_string(os, static_cast<const char*>(value));
            break;
        case DATETIME:
            fputs(static_cast<const char*>(value), os);
            break;
        default:
            fputs("?", os);
            break;
    }
}

void print_scalar(Type type, const void* value)
{
    fprint_scalar(stdout, type, value);
}

void fprint_array(FILE* os, Type type, const void* data, size_t size)
{
    if ((unsigned)type >= NUM_TYPES)
        return;

    const char* p = static_cast<const char*>(data);
    size_t esize = literal_type_size[type];

    for (size_t i = 0; i < size; i++)
    {
        if (i)
            fputs(", ", os);

        const void* element = p + i * esize;

        if (type == STRING || type == DATETIME)
            element = _load<const char*>(element);

        fprint_scalar(os, type, element);
    }
}

void print_array(Type type, const void* data, size_t size)
{
    fprint_array(stdout, type, data, size);
}

//==============================================================================
// Text helpers
//==============================================================================

size_t strlcpy(char* dst, const char* src, size_t size)
{
    size_t n = strlen(src);

    if (size)
    {
        size_t m = n < size - 1 ? n : size - 1;
        memcpy(dst, src, m);
        dst[m] = '\0';
    }

    return n;
}

size_t strlcat(char* dst, const char* src, size_t size)
{
    size_t d = strnlen(dst, size);

    // No terminator within size: nothing can be appended.
    if (d == size)
        return size + strlen(src);

    return d + strlcpy(dst + d, src, size - d);
}

int find_token(const char* str, const char* delimiters,
    const char*& start, const char*& end)
{
    const char* p = str + strspn(str, delimiters);

    if (*p == '\0')
        return -1;

    start = p;
    end = p + strcspn(p, delimiters);
    return 0;
}

char* str_vprintf(const char* fmt, va_list ap)
{
    if (!fmt)
        return 0;

    va_list aq;
    va_copy(aq, ap);
    int n = vsnprintf(0, 0, fmt, aq);
    va_end(aq);

    if (n < 0)
        return 0;

    char* p = static_cast<char*>(malloc((size_t)n + 1));

    if (!p)
        return 0;

    va_copy(aq, ap);
    vsnprintf(p, (size_t)n + 1, fmt, aq);
    va_end(aq);
    return p;
}

char* str_printf(const char* fmt, ...)
{
    va_list ap;
    va_start(ap, fmt);
    char* p = str_vprintf(fmt, ap);
    va_end(ap);
    return p;
}

String string_vprintf(const char* fmt, va_list ap)
{
    char* p = str_vprintf(fmt, ap);
    String s(p);
    free(p);
    return s;
}

String string_printf(const char* fmt, ...)
{
    va_list ap;
    va_start(ap, fmt);
    String s = string_vprintf(fmt, ap);
    va_end(ap);
    return s;
}

static void _vifprintf(FILE* os, size_t level, const char* fmt, va_list ap)
{
    for (size_t i = 0; i < level; i++)
        fputs("    ", os);

    vfprintf(os, fmt, ap);
}

void ifprintf(FILE* os, size_t level, const char* fmt, ...)
{
    va_list ap;
    va_start(ap, fmt);
    _vifprintf(os, level, fmt, ap);
    va_end(ap);
}

void iprintf(size_t level, const char* fmt, ...)
{
    va_list ap;
    va_start(ap, fmt);
    _vifprintf(stdout, level, fmt, ap);
    va_end(ap);
}

} // namespace OLMA
