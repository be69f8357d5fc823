#include "config.h"
#include <stdlib.h>
#include <string.h>
#include <stddef.h>
#include <new>
#include "String.h"
#include "Strings.h"
#include "log.h"

namespace OLMA {

// Never counted and never freed: every counting path tests for it first. The
// count of 2 keeps it from ever looking unshared.
__String_Rep String::_empty = { 2, 0, 0, { 0 } };

// Strings longer than this are refused outright; the 32-bit size fields
// could not describe them.
static const size_t _MAX_CAPACITY = (size_t)1 << 31;

static inline size_t _next_pow_2(size_t n)
{
    if (n < 32)
        return 32;

    TESSEL_ASSERT(n <= _MAX_CAPACITY);

    size_t p = 32;

    while (p < n)
        p <<= 1;

    return p;
}

static inline __String_Rep* _alloc(size_t cap)
{
    TESSEL_ASSERT(cap <= _MAX_CAPACITY);
    __String_Rep* rep = static_cast<__String_Rep*>(
        malloc(offsetof(__String_Rep, data) + cap + 1));
    TESSEL_ASSERT(rep != 0);
    rep->refs = 1;
    rep->size = 0;
    rep->cap = (uint32)cap;
    rep->data[0] = '\0';
    return rep;
}

static inline void _ref(__String_Rep* rep)
{
    if (rep != &String::_empty)
        __atomic_add_fetch(&rep->refs, 1, __ATOMIC_RELAXED);
}

static inline void _unref(__String_Rep* rep)
{
    if (rep != &String::_empty &&
        __atomic_sub_fetch(&rep->refs, 1, __ATOMIC_ACQ_REL) == 0)
    {
        free(rep);
    }
}

// True if this is the only reference, so the record may change in place.
static inline bool _unique(const __String_Rep* rep)
{
    return rep != &String::_empty &&
        __atomic_load_n(&rep->refs, __ATOMIC_ACQUIRE) == 1;
}

// A new record holding data, or _empty for no characters.
static __String_Rep* _make(const char* data, size_t size)
{
    if (size == 0)
        return &String::_empty;

    __String_Rep* rep = _alloc(_next_pow_2(size));
    memcpy(rep->data, data, size);
    rep->data[size] = '\0';
    rep->size = (uint32)size;
    return rep;
}

// A private copy of rep's text in a record of capacity cap.
static __String_Rep* _copy(const __String_Rep* rep, size_t cap)
{
    __String_Rep* r = _alloc(cap);
    memcpy(r->data, rep->data, rep->size + 1);
    r->size = rep->size;
    return r;
}

// Pieces of data arrive from callers that may point into this very string,
// so records are always built before the old one is released.

String::String(const char* str)
{
    _rep = str ? _make(str, strlen(str)) : &_empty;
}

String::String(const char* data, size_t size)
{
    _rep = data ? _make(data, size) : &_empty;
}

String::String(const char* s1, const char* s2)
{
    size_t n1 = s1 ? strlen(s1) : 0;
    size_t n2 = s2 ? strlen(s2) : 0;

    if (n1 + n2 == 0)
    {
        _rep = &_empty;
        return;
    }

    _rep = _alloc(_next_pow_2(n1 + n2));
    memcpy(_rep->data, s1, n1);
    memcpy(_rep->data + n1, s2, n2);
    _rep->size = (uint32)(n1 + n2);
    _rep->data[_rep->size] = '\0';
}

String::String(const char* s1, const char* s2, const char* s3)
{
    size_t n1 = s1 ? strlen(s1) : 0;
    size_t n2 = s2 ? strlen(s2) : 0;
    size_t n3 = s3 ? strlen(s3) : 0;

    if (n1 + n2 + n3 == 0)
    {
        _rep = &_empty;
        return;
    }

    _rep = _alloc(_next_pow_2(n1 + n2 + n3));
    memcpy(_rep->data, s1, n1);
    memcpy(_rep->data + n1, s2, n2);
    memcpy(_rep->data + n1 + n2, s3, n3);
    _rep->size = (uint32)(n1 + n2 + n3);
    _rep->data[_rep->size] = '\0';
}

String::String(const String& x) : _rep(x._rep)
{
    _ref(_rep);
}

String::~String()
{
    _unref(_rep);
}

void String::assign(const String& x)
{
    if (x._rep != _rep)
    {
        _ref(x._rep);
        _unref(_rep);
        _rep = x._rep;
    }
}

void String::assign(const char* str)
{
    assign(str, str ? strlen(str) : 0);
}

void String::assign(const char* data, size_t size)
{
    if (!data)
        size = 0;

    if (_unique(_rep) && _rep->cap >= size)
    {
        memmove(_rep->data, data, size);
        _rep->data[size] = '\0';
        _rep->size = (uint32)size;
        return;
    }

    __String_Rep* old = _rep;
    _rep = _make(data, size);
    _unref(old);
}

void String::append(char c)
{
    if (_unique(_rep) && _rep->size != _rep->cap)
    {
        _rep->data[_rep->size++] = c;
        _rep->data[_rep->size] = '\0';
        return;
    }

    size_t cap = _rep->cap ? _next_pow_2(2 * (size_t)_rep->cap) : 32;

    if (cap <= _rep->size)
        cap = _next_pow_2((size_t)_rep->size + 1);

    __String_Rep* old = _rep;
    _rep = _copy(old, cap);
    _unref(old);
    _rep->data[_rep->size++] = c;
    _rep->data[_rep->size] = '\0';
}

void String::append(const char* str)
{
    if (str)
        append(str, strlen(str));
}

void String::append(const char* data, size_t size)
{
    if (!data || size == 0)
        return;

    // Keeps the text alive if data points into it and reserve() moves it.
    __String_Rep* hold = 0;

    if (data >= _rep->data && data < _rep->data + _rep->cap + 1)
    {
        hold = _rep;
        _ref(hold);
    }

    reserve(_next_pow_2((size_t)_rep->size + size));
    memmove(_rep->data + _rep->size, data, size);
    _rep->size += (uint32)size;
    _rep->data[_rep->size] = '\0';

    if (hold)
        _unref(hold);
}

void String::append(const String& x)
{
    if (x._rep->size)
    {
        // x may be this very string.
        String tmp(x);
        append(tmp._rep->data, tmp._rep->size);
    }
}

void String::reserve(size_t capacity)
{
    if (_rep->cap >= capacity && _unique(_rep))
        return;

    if (capacity == 0 && _rep == &_empty)
        return;

    if (capacity < _rep->size)
        capacity = _rep->size;

    __String_Rep* old = _rep;
    _rep = _copy(old, _next_pow_2(capacity));
    _unref(old);
}

void String::clear()
{
    if (_rep->size == 0)
        return;

    if (_unique(_rep))
    {
        _rep->size = 0;
        _rep->data[0] = '\0';
        return;
    }

    _unref(_rep);
    _rep = &_empty;
}

void String::remove(size_t pos, size_t n)
{
    size_t size = _rep->size;

    if (pos >= size)
        return;

    if (n > size - pos)
        n = size - pos;

    if (n == 0)
        return;

    if (!_unique(_rep))
    {
        __String_Rep* old = _rep;
        _rep = _copy(old, old->cap);
        _unref(old);
    }

    memmove(_rep->data + pos, _rep->data + pos + n, size - pos - n + 1);
    _rep->size = (uint32)(size - n);
}

String String::substr(size_t pos, size_t n) const
{
    size_t size = _rep->size;

    if (pos >= size)
        return String();

    if (n > size - pos)
        n = size - pos;

    return String(_rep->data + pos, n);
}

void String::set(size_t pos, char c)
{
    if (pos >= _rep->size)
        return;

    if (!_unique(_rep))
    {
        __String_Rep* old = _rep;
        _rep = _copy(old, old->cap);
        _unref(old);
    }

    _rep->data[pos] = c;
}

size_t String::find(char c) const
{
    return find(c, 0);
}

size_t String::find(char c, size_t pos) const
{
    if (pos >= _rep->size)
        return (size_t)-1;

    const void* p = memchr(_rep->data + pos, c, _rep->size - pos);
    return p ? (size_t)(static_cast<const char*>(p) - _rep->data) : (size_t)-1;
}

static size_t _find(const __String_Rep* rep, const char* s, size_t n)
{
    if (n > rep->size)
        return (size_t)-1;

    if (n == 0)
        return 0;

    const char* end = rep->data + rep->size - n;

    for (const char* p = rep->data; p <= end; p++)
    {
        if (*p == *s && memcmp(p, s, n) == 0)
            return (size_t)(p - rep->data);
    }

    return (size_t)-1;
}

size_t String::find(const char* str) const
{
    return str ? _find(_rep, str, strlen(str)) : (size_t)-1;
}

size_t String::find(const String& x) const
{
    return _find(_rep, x._rep->data, x._rep->size);
}

bool String::equal(const String& x) const
{
    return x._rep == _rep || (x._rep->size == _rep->size &&
        memcmp(x._rep->data, _rep->data, _rep->size) == 0);
}

bool String::equal(const char* str) const
{
    return equal(str, str ? strlen(str) : 0);
}

bool String::equal(const char* data, size_t size) const
{
    return size == _rep->size && (size == 0 || memcmp(data, _rep->data, size) == 0);
}

bool String::equal(size_t pos, const char* data, size_t size) const
{
    return pos <= _rep->size && size <= _rep->size - pos &&
        (size == 0 || memcmp(_rep->data + pos, data, size) == 0);
}

static bool _equali(const char* a, const char* b, size_t n)
{
    for (size_t i = 0; i < n; i++)
    {
        if (__lower[(uint8)a[i]] != __lower[(uint8)b[i]])
            return false;
    }

    return true;
}

bool String::equali(const String& x) const
{
    return x._rep->size == _rep->size &&
        _equali(x._rep->data, _rep->data, _rep->size);
}

bool String::equali(const char* str) const
{
    return equali(str, str ? strlen(str) : 0);
}

bool String::equali(const char* data, size_t size) const
{
    return size == _rep->size && (size == 0 || _equali(data, _rep->data, size));
}

void _String_construct(void* to, const void* from)
{
    new (to) String(*static_cast<const String*>(from));
}

void _String_destruct(void* at)
{
    static_cast<String*>(at)->~String();
}

bool _String_equal(const void* a, const void* b)
{
    return static_cast<const String*>(a)->equal(*static_cast<const String*>(b));
}

} // namespace OLMA
