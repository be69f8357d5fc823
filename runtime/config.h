#ifndef _OLMA_config_h
#define _OLMA_config_h

#include <stddef.h>
#include <stdint.h>

namespace OLMA {

typedef bool boolean;
typedef uint8_t uint8;
typedef int8_t sint8;
typedef uint16_t uint16;
typedef int16_t sint16;
typedef uint32_t uint32;
typedef int32_t sint32;
// long long rather than (u)int64_t so that "%llu"/"%lld" match on every target.
typedef unsigned long long uint64;
typedef long long sint64;
typedef float real32;
typedef double real64;

// A CIM char16: a UCS-2 code unit. A class rather than a typedef so that it
// overloads apart from uint16. Comparisons go through the conversion to
// uint16; operators of its own would make "c == 65" ambiguous.
class char16
{
public:
    char16() : _code(0) { }
    char16(uint16 code) : _code(code) { }
    uint16 code() const { return _code; }
    operator uint16() const { return _code; }
    char16& operator=(uint16 code) { _code = code; return *this; }
private:
    uint16 _code;
};

static_assert(sizeof(char16) == 2, "char16 must be two bytes");
static_assert(sizeof(uint64) == 8 && sizeof(sint64) == 8, "64-bit integers");

} // namespace OLMA

// Runtime version word. Every compilation unit refers to it, so a module
// built against one runtime version cannot link against another.
extern "C" int __tessel_version_2_0_16;

[[maybe_unused]] __attribute__((used)) static int __tessel_version_symbol =
    __tessel_version_2_0_16;

#endif /* _OLMA_config_h */
