#ifndef _OLMA_Array_h
#define _OLMA_Array_h

#include <new>
#include "config.h"
#include "Type.h"
#include "String.h"
#include "Datetime.h"

namespace OLMA {

// How the untyped array core handles one element type. A null construct
// means memcpy, a null destruct no clean-up, a null equal a bytewise compare.
struct __Array_Traits
{
    size_t size;
    void (*construct)(void* to, const void* from);
    void (*destruct)(void* at);
    bool (*equal)(const void* a, const void* b);
};

// One malloc'ed block: this header, then the elements.
struct __Array_Rep
{
    const __Array_Traits* traits;
    size_t size;
    size_t cap;

    char* data() { return reinterpret_cast<char*>(this + 1); }
    const char* data() const { return reinterpret_cast<const char*>(this + 1); }
};

static_assert(sizeof(__Array_Rep) == 3 * sizeof(void*), "array header");

// Traits of the CIM types, indexed by Type.
extern const __Array_Traits* const __cim_array_traits[NUM_TYPES];

// The untyped core. Every function keeps rep valid; data/size describe
// elements of the rep's own type.
void __construct(__Array_Rep*& rep, const __Array_Traits* traits);
void __construct(__Array_Rep*& rep, const __Array_Rep* other);
void __construct(__Array_Rep*& rep, const __Array_Traits* traits,
    const void* data, size_t size);
void __destruct(__Array_Rep* rep);
void __assign(__Array_Rep*& rep, const __Array_Rep* other);
void __assign(__Array_Rep*& rep, const void* data, size_t size);
void __reserve(__Array_Rep*& rep, size_t capacity);
void __resize(__Array_Rep*& rep, size_t size, const void* value);
void __insert(__Array_Rep*& rep, size_t pos, const void* data, size_t size);
void __append(__Array_Rep*& rep, const void* data, size_t size);
void __prepend(__Array_Rep*& rep, const void* data, size_t size);
void __remove(__Array_Rep*& rep, size_t pos, size_t size);
bool __equal(const __Array_Rep* a, const __Array_Rep* b);
// Index of the first element equal to *value, or (size_t)-1.
size_t __find(const __Array_Rep* rep, const void* value);

// Traits for a class type, from its copy constructor, destructor and ==.
template<class T>
struct __Array_Traits_Factory
{
    static void construct(void* to, const void* from)
    {
        new (to) T(*static_cast<const T*>(from));
    }

    static void destruct(void* at)
    {
        static_cast<T*>(at)->~T();
    }

    static bool equal(const void* a, const void* b)
    {
        return *static_cast<const T*>(a) == *static_cast<const T*>(b);
    }

    static const __Array_Traits* traits()
    {
        static const __Array_Traits _traits =
            { sizeof(T), construct, destruct, equal };
        return &_traits;
    }
};

// Traits for plain bytes of sizeof(T): no construct, destruct or equal.
template<class T>
struct __Array_Traits_Factory_Raw
{
    static const __Array_Traits* traits()
    {
        static const __Array_Traits _traits = { sizeof(T), 0, 0, 0 };
        return &_traits;
    }
};

// Pointer elements (Array<Instance*>, reference arrays) are raw words.
template<class T>
struct __Array_Traits_Factory<T*> : __Array_Traits_Factory_Raw<void*> { };

#define OLMA_CIM_ARRAY_TRAITS(T, TYPE) \
    template<> \
    struct __Array_Traits_Factory<T> \
    { \
        static const __Array_Traits* traits() \
        { \
            return __cim_array_traits[TYPE]; \
        } \
    }

OLMA_CIM_ARRAY_TRAITS(boolean, BOOLEAN);
OLMA_CIM_ARRAY_TRAITS(uint8, UINT8);
OLMA_CIM_ARRAY_TRAITS(sint8, SINT8);
OLMA_CIM_ARRAY_TRAITS(uint16, UINT16);
OLMA_CIM_ARRAY_TRAITS(sint16, SINT16);
OLMA_CIM_ARRAY_TRAITS(uint32, UINT32);
OLMA_CIM_ARRAY_TRAITS(sint32, SINT32);
OLMA_CIM_ARRAY_TRAITS(uint64, UINT64);
OLMA_CIM_ARRAY_TRAITS(sint64, SINT64);
OLMA_CIM_ARRAY_TRAITS(real32, REAL32);
OLMA_CIM_ARRAY_TRAITS(real64, REAL64);
OLMA_CIM_ARRAY_TRAITS(char16, CHAR16);
OLMA_CIM_ARRAY_TRAITS(String, STRING);
OLMA_CIM_ARRAY_TRAITS(Datetime, DATETIME);

#undef OLMA_CIM_ARRAY_TRAITS

// A typed shell over __Array_Rep. Never shared: copies copy the elements.
template<class T>
class Array
{
public:
    Array() { __construct(_rep, __Array_Traits_Factory<T>::traits()); }

    Array(const T* data, size_t size)
    {
        __construct(_rep, __Array_Traits_Factory<T>::traits(), data, size);
    }

    Array(const Array& x) { __construct(_rep, x._rep); }

    ~Array() { __destruct(_rep); }

    Array& operator=(const Array& x)
    {
        if (&x != this)
            __assign(_rep, x._rep);
        return *this;
    }

    size_t size() const { return _rep->size; }
    size_t capacity() const { return _rep->cap; }

    T* data() { return reinterpret_cast<T*>(_rep->data()); }
    const T* data() const { return reinterpret_cast<const T*>(_rep->data()); }

    T& operator[](size_t i) { return data()[i]; }
    const T& operator[](size_t i) const { return data()[i]; }

    void assign(const T* data, size_t size) { __assign(_rep, data, size); }
    void reserve(size_t capacity) { __reserve(_rep, capacity); }
    // Grown elements are copies of value for a type with a construct (String,
    // Datetime, classes); for plain types they are zeroed and value is unused.
    void resize(size_t size, const T& value = T()) { __resize(_rep, size, &value); }
    void clear() { __remove(_rep, 0, _rep->size); }

    void insert(size_t pos, const T& x) { __insert(_rep, pos, &x, 1); }
    void insert(size_t pos, const T* data, size_t size)
    {
        __insert(_rep, pos, data, size);
    }

    void append(const T& x) { __append(_rep, &x, 1); }
    void append(const T* data, size_t size) { __append(_rep, data, size); }
    void append(const Array& x) { __append(_rep, x.data(), x.size()); }

    void prepend(const T& x) { __prepend(_rep, &x, 1); }
    void prepend(const T* data, size_t size) { __prepend(_rep, data, size); }

    void remove(size_t pos, size_t size = 1) { __remove(_rep, pos, size); }

    size_t find(const T& x) const { return __find(_rep, &x); }
    bool equal(const Array& x) const { return __equal(_rep, x._rep); }

    __Array_Rep* _rep;
};

template<class T>
inline bool operator==(const Array<T>& a, const Array<T>& b)
{
    return a.equal(b);
}

template<class T>
inline bool operator!=(const Array<T>& a, const Array<T>& b)
{
    return !a.equal(b);
}

// A plain pointer array with its count held apart, grown by one realloc per
// element. Cheap for the short, rarely grown lists of the meta data.
void append_ptr_array(void**& data, size_t& size, void* element);

template<class T>
inline void append(T**& data, size_t& size, T* element)
{
    void** p = reinterpret_cast<void**>(data);
    append_ptr_array(p, size, const_cast<void*>(static_cast<const void*>(element)));
    data = reinterpret_cast<T**>(p);
}

} // namespace OLMA

#endif /* _OLMA_Array_h */
