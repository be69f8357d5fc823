#ifndef _OLMA_String_h
#define _OLMA_String_h

#include "config.h"

namespace OLMA {

// Shared representation of a String. The characters follow the header and
// are always zero-terminated; capacity excludes the terminator.
struct __String_Rep
{
    sint32 refs;
    uint32 size;
    uint32 cap;
    char data[1];
};

// A reference-counted, copy-on-write text. Copies share one representation
// until one of them is modified; the counts are atomic, so copies may live in
// different threads. All empty strings share String::_empty.
class String
{
public:
    String() : _rep(&_empty) { }
    String(const char* str);
    String(const char* data, size_t size);
    String(const char* s1, const char* s2);
    String(const char* s1, const char* s2, const char* s3);
    String(const String& x);
    ~String();

    String& operator=(const String& x) { assign(x); return *this; }
    String& operator=(const char* str) { assign(str); return *this; }

    void assign(const String& x);
    void assign(const char* str);
    void assign(const char* data, size_t size);

    void append(char c);
    void append(const char* str);
    void append(const char* data, size_t size);
    void append(const String& x);

    String& operator+=(const String& x) { append(x); return *this; }
    String& operator+=(const char* str) { append(str); return *this; }
    String& operator+=(char c) { append(c); return *this; }

    void reserve(size_t capacity);
    void clear();

    // Removes n characters at pos; n of (size_t)-1 means the rest.
    void remove(size_t pos, size_t n = (size_t)-1);
    String substr(size_t pos, size_t n = (size_t)-1) const;
    void set(size_t pos, char c);

    // Position of the first match, or (size_t)-1.
    size_t find(char c) const;
    size_t find(char c, size_t pos) const;
    size_t find(const char* str) const;
    size_t find(const String& x) const;

    // Bytewise comparisons.
    bool equal(const String& x) const;
    bool equal(const char* str) const;
    bool equal(const char* data, size_t size) const;
    // True if the size characters at pos are those of data.
    bool equal(size_t pos, const char* data, size_t size) const;

    // Comparisons that ignore the case of ASCII letters.
    bool equali(const String& x) const;
    bool equali(const char* str) const;
    bool equali(const char* data, size_t size) const;

    size_t size() const { return _rep->size; }
    size_t capacity() const { return _rep->cap; }
    const char* c_str() const { return _rep->data; }
    const char* data() const { return _rep->data; }
    char operator[](size_t i) const { return _rep->data[i]; }

    static __String_Rep _empty;

    __String_Rep* _rep;
};

inline bool operator==(const String& a, const String& b) { return a.equal(b); }
inline bool operator==(const String& a, const char* b) { return a.equal(b); }
inline bool operator==(const char* a, const String& b) { return b.equal(a); }
inline bool operator!=(const String& a, const String& b) { return !a.equal(b); }
inline bool operator!=(const String& a, const char* b) { return !a.equal(b); }
inline bool operator!=(const char* a, const String& b) { return !b.equal(a); }

// Array traits for String elements (see Array.h).
void _String_construct(void* to, const void* from);
void _String_destruct(void* at);
bool _String_equal(const void* a, const void* b);

} // namespace OLMA

#endif /* _OLMA_String_h */
