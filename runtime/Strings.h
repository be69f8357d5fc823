#ifndef _OLMA_Strings_h
#define _OLMA_Strings_h

#include <stdarg.h>
#include <stdio.h>
#include "config.h"
#include "Type.h"
#include "String.h"

namespace OLMA {

// 'A'..'Z' map to 'a'..'z', every other byte to itself. Name look-ups
// compare __lower of the first characters before calling strcasecmp.
extern const uint8 __lower[256];

inline bool __first_char_eq(const char* a, const char* b)
{
    return __lower[(uint8)a[0]] == __lower[(uint8)b[0]];
}

// Text to number: 0 on success, -1 on failure; the output is untouched on
// failure. Integers are decimal (at most 20 digits) or "0x"/"0X" followed by
// 1 to 16 upper-case hexadecimal digits; signed ones take one leading sign.
// Reals must contain a '.' followed by at least one digit.
int str_to_boolean(const char* str, boolean& x);
int str_to_uint8(const char* str, uint8& x);
int str_to_sint8(const char* str, sint8& x);
int str_to_uint16(const char* str, uint16& x);
int str_to_sint16(const char* str, sint16& x);
int str_to_uint32(const char* str, uint32& x);
int str_to_sint32(const char* str, sint32& x);
int str_to_uint64(const char* str, uint64& x);
int str_to_sint64(const char* str, sint64& x);
int str_to_real32(const char* str, real32& x);
int str_to_real64(const char* str, real64& x);

// Integer to decimal text. The result points either into buffer (which
// must hold at least 22 bytes) or into a static table; size gets the length.
const char* uint8_to_str(char buffer[22], uint8 x, size_t& size);
const char* sint8_to_str(char buffer[22], sint8 x, size_t& size);
const char* uint16_to_str(char buffer[22], uint16 x, size_t& size);
const char* sint16_to_str(char buffer[22], sint16 x, size_t& size);
const char* uint32_to_str(char buffer[22], uint32 x, size_t& size);
const char* sint32_to_str(char buffer[22], sint32 x, size_t& size);
const char* uint64_to_str(char buffer[22], uint64 x, size_t& size);
const char* sint64_to_str(char buffer[22], sint64 x, size_t& size);

// The text in double quotes, with '"', tab, newline, form feed and carriage
// return escaped by a backslash.
void fprint_string(FILE* os, const char* str);
void print_string(const char* str);

// A literal of the meta data. value points at the value in its literal
// form; for STRING and DATETIME it is the zero-terminated text itself.
void fprint_scalar(FILE* os, Type type, const void* value);
void print_scalar(Type type, const void* value);

// A literal array: size elements of literal_type_size[type] bytes; STRING
// and DATETIME elements are const char* pointers. Separated by ", ".
void fprint_array(FILE* os, Type type, const void* data, size_t size);
void print_array(Type type, const void* data, size_t size);

// The BSD routines: write at most size bytes including the terminator and
// return the length they tried to create.
size_t strlcpy(char* dst, const char* src, size_t size);
size_t strlcat(char* dst, const char* src, size_t size);

// Skips leading delimiters; -1 if nothing follows, else 0 with start at the
// token and end just behind it.
int find_token(const char* str, const char* delimiters,
    const char*& start, const char*& end);

// Formatted text in a malloc'ed block that the caller frees, or null.
char* str_printf(const char* fmt, ...) __attribute__((format(printf, 1, 2)));
char* str_vprintf(const char* fmt, va_list ap) __attribute__((format(printf, 1, 0)));

String string_printf(const char* fmt, ...) __attribute__((format(printf, 1, 2)));
String string_vprintf(const char* fmt, va_list ap) __attribute__((format(printf, 1, 0)));

// Print with level x 4 blanks of indentation first.
void ifprintf(FILE* os, size_t level, const char* fmt, ...)
    __attribute__((format(printf, 3, 4)));
void iprintf(size_t level, const char* fmt, ...)
    __attribute__((format(printf, 2, 3)));

} // namespace OLMA

#endif /* _OLMA_Strings_h */
