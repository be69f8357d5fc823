#include "config.h"
#include <stdlib.h>
#include <string.h>
#include "Array.h"
#include "log.h"

namespace OLMA {

// Elements are moved with memcpy/memmove/realloc, so every element type must
// be relocatable bytewise; String, Datetime and pointers are single words.

static const __Array_Traits _traits_1 = { 1, 0, 0, 0 };
static const __Array_Traits _traits_2 = { 2, 0, 0, 0 };
static const __Array_Traits _traits_4 = { 4, 0, 0, 0 };
static const __Array_Traits _traits_8 = { 8, 0, 0, 0 };

// Reals compare by value so that NaN differs from itself and 0.0 equals -0.0.
static bool _real32_equal(const void* a, const void* b)
{
    real32 x, y;
    memcpy(&x, a, sizeof(x));
    memcpy(&y, b, sizeof(y));
    return x == y;
}

static bool _real64_equal(const void* a, const void* b)
{
    real64 x, y;
    memcpy(&x, a, sizeof(x));
    memcpy(&y, b, sizeof(y));
    return x == y;
}

static const __Array_Traits _traits_real32 = { 4, 0, 0, _real32_equal };
static const __Array_Traits _traits_real64 = { 8, 0, 0, _real64_equal };

static const __Array_Traits _traits_string =
    { sizeof(String), _String_construct, _String_destruct, _String_equal };

static const __Array_Traits _traits_datetime =
    { sizeof(Datetime), _Datetime_construct, _Datetime_destruct, _Datetime_equal };

const __Array_Traits* const __cim_array_traits[NUM_TYPES] =
{
    &_traits_1, // boolean
    &_traits_1, // uint8
    &_traits_1, // sint8
    &_traits_2, // uint16
    &_traits_2, // sint16
    &_traits_4, // uint32
    &_traits_4, // sint32
    &_traits_8, // uint64
    &_traits_8, // sint64
    &_traits_real32,
    &_traits_real64,
    &_traits_2, // char16
    &_traits_string,
    &_traits_datetime,
};

static __Array_Rep* _alloc(const __Array_Traits* traits, size_t cap)
{
    size_t bytes = sizeof(__Array_Rep) + cap * traits->size;
    TESSEL_ASSERT(traits->size == 0 || cap <= ((size_t)-1 - sizeof(__Array_Rep)) / traits->size);
    __Array_Rep* rep = static_cast<__Array_Rep*>(malloc(bytes));
    TESSEL_ASSERT(rep != 0);
    rep->traits = traits;
    rep->size = 0;
    rep->cap = cap;
    return rep;
}

// Copies n elements from data into raw storage at to.
static void _copy_in(const __Array_Traits* traits, char* to, const void* data,
    size_t n)
{
    if (n == 0)
        return;

    if (traits->construct)
    {
        const char* from = static_cast<const char*>(data);

        for (size_t i = 0; i < n; i++)
            traits->construct(to + i * traits->size, from + i * traits->size);
    }
    else
        memcpy(to, data, n * traits->size);
}

static void _destroy(const __Array_Traits* traits, char* at, size_t n)
{
    if (traits->destruct)
    {
        for (size_t i = 0; i < n; i++)
            traits->destruct(at + i * traits->size);
    }
}

static bool _inside(const __Array_Rep* rep, const void* p)
{
    const char* c = static_cast<const char*>(p);
    return c >= rep->data() && c < rep->data() + rep->cap * rep->traits->size;
}

void __construct(__Array_Rep*& rep, const __Array_Traits* traits)
{
    rep = _alloc(traits, 8);
}

void __construct(__Array_Rep*& rep, const __Array_Rep* other)
{
    __construct(rep, other->traits, other->data(), other->size);
}

void __construct(__Array_Rep*& rep, const __Array_Traits* traits,
    const void* data, size_t size)
{
    rep = _alloc(traits, size);

    if (data)
    {
        _copy_in(traits, rep->data(), data, size);
        rep->size = size;
    }
}

void __destruct(__Array_Rep* rep)
{
    if (rep)
    {
        _destroy(rep->traits, rep->data(), rep->size);
        free(rep);
    }
}

void __assign(__Array_Rep*& rep, const __Array_Rep* other)
{
    if (rep == other)
        return;

    __Array_Rep* old = rep;
    __construct(rep, other);
    __destruct(old);
}

void __assign(__Array_Rep*& rep, const void* data, size_t size)
{
    // Built before the old record goes, since data may lie inside it.
    __Array_Rep* old = rep;
    __construct(rep, old->traits, data, data ? size : 0);
    __destruct(old);
}

void __reserve(__Array_Rep*& rep, size_t capacity)
{
    if (rep->cap >= capacity)
        return;

    size_t cap = 8;

    while (cap < capacity)
    {
        TESSEL_ASSERT(cap <= (size_t)-1 / 2);
        cap <<= 1;
    }

    size_t esize = rep->traits->size;
    TESSEL_ASSERT(esize == 0 || cap <= ((size_t)-1 - sizeof(__Array_Rep)) / esize);
    __Array_Rep* p = static_cast<__Array_Rep*>(
        realloc(rep, sizeof(__Array_Rep) + cap * esize));
    TESSEL_ASSERT(p != 0);
    p->cap = cap;
    rep = p;
}

void __resize(__Array_Rep*& rep, size_t size, const void* value)
{
    const __Array_Traits* traits = rep->traits;
    size_t esize = traits->size;

    if (size < rep->size)
    {
        _destroy(traits, rep->data() + size * esize, rep->size - size);
        rep->size = size;
        return;
    }

    if (size == rep->size)
        return;

    // Plain elements of a grown array start as zero bytes, as those of a
    // fresh record do; value only ever feeds a construct.
    if (!traits->construct)
    {
        __reserve(rep, size);
        memset(rep->data() + rep->size * esize, 0, (size - rep->size) * esize);
        rep->size = size;
        return;
    }

    // value may be one of our own elements, which growing would move.
    __Array_Rep* tmp = 0;

    if (value && _inside(rep, value))
    {
        __construct(tmp, traits, value, 1);
        value = tmp->data();
    }

    __reserve(rep, size);

    for (size_t i = rep->size; i < size; i++)
    {
        char* at = rep->data() + i * esize;

        if (value)
            traits->construct(at, value);
        else
            memset(at, 0, esize);
    }

    rep->size = size;
    __destruct(tmp);
}

void __insert(__Array_Rep*& rep, size_t pos, const void* data, size_t size)
{
    if (!data || size == 0)
        return;

    if (pos > rep->size)
        pos = rep->size;

    __Array_Rep* tmp = 0;

    if (_inside(rep, data))
    {
        __construct(tmp, rep->traits, data, size);
        data = tmp->data();
    }

    size_t esize = rep->traits->size;
    __reserve(rep, rep->size + size);
    char* at = rep->data() + pos * esize;
    memmove(at + size * esize, at, (rep->size - pos) * esize);
    _copy_in(rep->traits, at, data, size);
    rep->size += size;
    __destruct(tmp);
}

void __append(__Array_Rep*& rep, const void* data, size_t size)
{
    __insert(rep, rep->size, data, size);
}

void __prepend(__Array_Rep*& rep, const void* data, size_t size)
{
    __insert(rep, 0, data, size);
}

void __remove(__Array_Rep*& rep, size_t pos, size_t size)
{
    if (pos >= rep->size)
        return;

    if (size > rep->size - pos)
        size = rep->size - pos;

    size_t esize = rep->traits->size;
    char* at = rep->data() + pos * esize;
    _destroy(rep->traits, at, size);
    memmove(at, at + size * esize, (rep->size - pos - size) * esize);
    rep->size -= size;
}

bool __equal(const __Array_Rep* a, const __Array_Rep* b)
{
    if (a->size != b->size || a->traits->size != b->traits->size)
        return false;

    const __Array_Traits* traits = a->traits;

    if (!traits->equal)
        return a->size == 0 || memcmp(a->data(), b->data(), a->size * traits->size) == 0;

    for (size_t i = 0; i < a->size; i++)
    {
        size_t off = i * traits->size;

        if (!traits->equal(a->data() + off, b->data() + off))
            return false;
    }

    return true;
}

size_t __find(const __Array_Rep* rep, const void* value)
{
    const __Array_Traits* traits = rep->traits;

    for (size_t i = 0; i < rep->size; i++)
    {
        const char* at = rep->data() + i * traits->size;

        if (traits->equal ? traits->equal(at, value) :
            memcmp(at, value, traits->size) == 0)
        {
            return i;
        }
    }

    return (size_t)-1;
}

void append_ptr_array(void**& data, size_t& size, void* element)
{
    void** p = static_cast<void**>(realloc(data, (size + 1) * sizeof(void*)));
    TESSEL_ASSERT(p != 0);
    p[size++] = element;
    data = p;
}

} // namespace OLMA
