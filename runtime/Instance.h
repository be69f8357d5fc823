#ifndef _OLMA_Instance_h
#define _OLMA_Instance_h

// Instances of CIM classes. A class is a plain record type derived from
// Instance plus a Meta_Class table that gives each feature's slot offset;
// everything here works through the table, so it serves every class.

#include <cstdio>
#include <type_traits>
#include "config.h"
#include "Type.h"
#include "String.h"
#include "Array.h"
#include "Datetime.h"
#include "Meta_Class.h"

namespace OLMA
{

enum : uint32 { INSTANCE_MAGIC = 0xF00DFACE };

struct Instance
{
    uint32 magic;
    uint32 refs;
    const Meta_Class* meta_class;
    String __name_space;

    // The class "Instance" itself: no features, no keys, no parent.
    static const Meta_Class static_meta_class;
};

// A property slot: the value, then the null byte right behind it (at
// type_size[type] for a scalar, at 8 for an array). null is 1 when the
// property has no value. Never constructed on its own inside an instance:
// create() sets up the slots from the meta data.
template<class T>
struct Property
{
    T value;
    uint8 null;

    void set(const T& x)
    {
        value = x;
        null = 0;
    }

    void clear()
    {
        value = T();
        null = 1;
    }
};

//
// Life cycle. create() and clone() give the caller one reference.
//

Instance* create(const Meta_Class* mc, bool defaults);
Instance* create(const Meta_Method* mm);
Instance* clone(const Instance* instance);
Instance* key_clone(const Instance* instance);

// Destroys whatever the reference count says.
void destroy(Instance* instance);

// destroy() that accepts null.
void destroyer(Instance* instance);

void ref(const Instance* instance);

// Destroys the instance when the count reaches zero; null is allowed.
void unref(const Instance* instance);

template<class T>
struct __Is_Record : std::is_base_of<Instance, T>
{
};

inline Instance* __create_of(const Meta_Class* mc, bool defaults)
{
    return create(mc, defaults);
}

inline Instance* __create_of(const Meta_Method* mm, bool)
{
    return create(mm);
}

// create<VESPERA_FCPort>() and likewise for method records.
template<class T>
inline typename std::enable_if<__Is_Record<T>::value, T*>::type create(bool defaults = true)
{
    return static_cast<T*>(__create_of(&T::static_meta_class, defaults));
}

template<class T>
inline typename std::enable_if<
    __Is_Record<T>::value && !std::is_same<T, Instance>::value, T*>::type
clone(const T* x)
{
    return static_cast<T*>(clone(static_cast<const Instance*>(x)));
}

template<class T>
inline typename std::enable_if<
    __Is_Record<T>::value && !std::is_same<T, Instance>::value, T*>::type
key_clone(const T* x)
{
    return static_cast<T*>(key_clone(static_cast<const Instance*>(x)));
}

//
// Contents.
//

// Empties the namespace, nulls every property and releases every reference.
void clear(Instance* instance);

// Between instances of the same class only; otherwise nothing happens.
// Features that are null in the model (if given) are skipped.
void copy(Instance* dest, const Instance* src);
void copy(Instance* dest, const Instance* src, const Instance* model);
void copy_keys(Instance* dest, const Instance* src);

// Compares the keys of x's class with the like-named features of y, so an
// instance may be matched with a model of a base class.
bool key_eq(const Instance* x, const Instance* y);

bool identical(const Instance* x, const Instance* y);

bool keys_non_null(const Instance* instance);

// Compares two slots of the property's shape (value and null byte).
bool property_eq(const Meta_Property* mp, const void* x, const void* y);

// Turns the instance into a model that wants only the named properties
// (a null-terminated list; null means all). -1 if a name is a method.
int filter_properties(Instance* instance, const char* const* names, bool keep_keys = true);

void __set_null_flags(
    const Instance* instance, bool include_keys, bool include_non_keys, uint8 value);

// Gives each null single reference a fresh instance of its class.
void __create_refs(Instance* instance);

void __visit(Instance* instance, void (*visitor)(Instance* instance, void* data), void* data);

void __set_name_space_recursive(Instance* instance, const char* name_space, bool force);

//
// Slot access, for code that walks the meta data.
//

inline void* __slot(const Instance* instance, uint32 offset)
{
    return (char*)instance + offset;
}

inline uint32 __null_offset(const Meta_Property* mp)
{
    return mp->subscript ? sizeof(void*) : type_size[mp->type];
}

inline uint8& __null_of(const Instance* instance, const Meta_Property* mp)
{
    return *((uint8*)instance + mp->offset + __null_offset(mp));
}

//
// Model paths: <class>.<key>=<value>,...
//

int instance_to_model_path(const Instance* instance, String& path);

// Null on any failure. The class is looked up from mc (and its repository).
Instance* model_path_to_instance(const Meta_Class* mc, const char* path);

int __put_property_from_str(Instance* instance, const Meta_Property* mp, const char* str);

//
// Printing, for diagnostics.
//

void print(const Instance* instance, bool keys_only = false);
void fprint(FILE* os, const Instance* instance, bool keys_only = false);

//
// Typed access.
//

// Holds one reference. Made from a pointer, it takes over that pointer's
// reference.
template<class T>
class Ref
{
public:
    Ref() : _ptr(0) { }

    Ref(T* ptr) : _ptr(ptr) { }

    Ref(const Ref& x) : _ptr(x._ptr)
    {
        if (_ptr)
            ref(_ptr);
    }

    template<class U>
    Ref(const Ref<U>& x) : _ptr(x.ptr())
    {
        if (_ptr)
            ref(_ptr);
    }

    ~Ref() { unref(_ptr); }

    Ref& operator=(const Ref& x)
    {
        if (x._ptr != _ptr)
        {
            unref(_ptr);
            _ptr = x._ptr;
            if (_ptr)
                ref(_ptr);
        }
        return *this;
    }

    // Takes over the pointer's reference.
    void reset(T* ptr = 0)
    {
        if (ptr != _ptr)
            unref(_ptr);
        _ptr = ptr;
    }

    // Gives up the reference without releasing it.
    T* steal()
    {
        T* tmp = _ptr;
        _ptr = 0;
        return tmp;
    }

    T* ptr() const { return _ptr; }
    T* operator->() const { return _ptr; }
    T& operator*() const { return *_ptr; }
    explicit operator bool() const { return _ptr != 0; }

private:
    T* _ptr;
};

template<class T>
inline T* checked_cast(Instance* instance)
{
    if (instance && is_subclass(&T::static_meta_class, instance->meta_class))
        return static_cast<T*>(instance);
    return 0;
}

template<class T>
inline const T* checked_cast(const Instance* instance)
{
    if (instance && is_subclass(&T::static_meta_class, instance->meta_class))
        return static_cast<const T*>(instance);
    return 0;
}

} // namespace OLMA

#endif // _OLMA_Instance_h
