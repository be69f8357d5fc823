#ifndef _OLMA_Meta_Class_h
#define _OLMA_Meta_Class_h

// The meta model: how a CIM class, its features and qualifiers are described
// as tables. Every record here is a plain aggregate so that the generated
// class tables can be static constants, filled by the compiler and linker:
// no constructors, no virtual functions, fields in a fixed order.

#include <cstddef>
#include <cstdio>
#include <sys/types.h>
#include "config.h"
#include "Type.h"

namespace OLMA
{

// One bit per flag; the bit's position is the flag's index in flag_names.
// Bits 0 to 3 tell the kind of record, the others are the CIM boolean
// qualifiers.
enum : uint32
{
    FLAG_PROPERTY = (1u << 0),
    FLAG_REFERENCE = (1u << 1),
    FLAG_METHOD = (1u << 2),
    FLAG_CLASS = (1u << 3),
    FLAG_ABSTRACT = (1u << 4),
    FLAG_AGGREGATE = (1u << 5),
    FLAG_AGGREGATION = (1u << 6),
    FLAG_ASSOCIATION = (1u << 7),
    FLAG_COMPOSITION = (1u << 8),
    FLAG_COUNTER = (1u << 9),
    FLAG_DELETE = (1u << 10),
    FLAG_DN = (1u << 11),
    FLAG_EMBEDDED_OBJECT = (1u << 12),
    FLAG_EXCEPTION = (1u << 13),
    FLAG_EXPENSIVE = (1u << 14),
    FLAG_EXPERIMENTAL = (1u << 15),
    FLAG_GAUGE = (1u << 16),
    FLAG_IFDELETED = (1u << 17),
    FLAG_IN = (1u << 18),
    FLAG_INDICATION = (1u << 19),
    FLAG_INVISIBLE = (1u << 20),
    FLAG_KEY = (1u << 21),
    FLAG_LARGE = (1u << 22),
    FLAG_OCTETSTRING = (1u << 23),
    FLAG_OUT = (1u << 24),
    FLAG_READ = (1u << 25),
    FLAG_REQUIRED = (1u << 26),
    FLAG_STATIC = (1u << 27),
    FLAG_TERMINAL = (1u << 28),
    FLAG_WEAK = (1u << 29),
    FLAG_WRITE = (1u << 30),
    FLAG_EMBEDDED_INSTANCE = (1u << 31),

    // Masks for find_feature().
    FLAG_ANY_FEATURE = FLAG_PROPERTY | FLAG_REFERENCE | FLAG_METHOD,
};

extern const char* const flag_names[];
extern const size_t num_flag_names;

// Index of the flag of that name (any case), or -1.
int flag_name_to_index(const char* name);

struct Meta_Qualifier;
struct Meta_Feature;
struct Meta_Class;
struct Meta_Method;
struct Meta_Repository;

// A literal. Only ever handled through pointers: the pointee is one of the
// two layouts below, chosen by the owner's type and array-ness. T is the
// type's literal form: the number itself, uint16 for char16, and a pointer
// to a zero-terminated text for string and datetime. An array points at
// such elements. For example:
//
//     static const Meta_Value_Scalar<uint16> _X_Y_value = { {}, 4 };
//     static const Meta_Value_Scalar<const char*> _X_Z_value = { {}, "text" };
struct Meta_Value
{
};

template<class T>
struct Meta_Value_Scalar : Meta_Value
{
    T value;
};

template<class T>
struct Meta_Value_Array : Meta_Value
{
    const T* elements;
    size_t num_elements;
};

// The common head of every meta record. A refs of 0 marks a static record,
// which is never counted and never freed.
struct Meta_Qualified_Object
{
    uint32 refs;
    uint32 flags;
    const char* name;
    Meta_Qualifier** meta_qualifiers;
    size_t num_meta_qualifiers;
};

struct Meta_Qualifier
{
    uint32 refs;
    uint32 flags;
    const char* name;
    uint8 type;
    uint8 array;
    const Meta_Value* value;
};

// The flags tell which kind of feature follows the head.
struct Meta_Feature : Meta_Qualified_Object
{
};

struct Meta_Property : Meta_Feature
{
    uint16 type;
    // 0 scalar, -1 array of any length, > 0 fixed array.
    sint16 subscript;
    uint32 offset;
    // The default value, or null.
    const Meta_Value* value;
};

struct Meta_Reference : Meta_Feature
{
    // 0 a single reference, anything else an array of them.
    sint16 subscript;
    const Meta_Class* meta_class;
    uint32 offset;
};

// A method's parameters form a record of their own, so up to size a
// Meta_Method has the shape of a Meta_Class; create(), find_feature() and
// destroy() serve both.
struct Meta_Method : Meta_Feature
{
    Meta_Feature** meta_features;
    size_t num_meta_features;
    uint32 size;
    uint16 return_type;
};

struct Meta_Class : Meta_Qualified_Object
{
    // All features, inherited ones first, in slot order.
    Meta_Feature** meta_features;
    size_t num_meta_features;
    uint32 size;
    // One byte per feature: 1 if this class declares it itself.
    const uint8* locals;
    const Meta_Class* super_meta_class;
    size_t num_keys;
    const Meta_Repository* meta_repository;
};

struct Meta_Repository
{
    const Meta_Class* const* meta_classes;
    size_t num_meta_classes;
};

//
// Look-ups. Names compare without regard to case.
//

const Meta_Feature* find_feature(
    const Meta_Class* mc, const char* name, uint32 type_mask = FLAG_ANY_FEATURE);

const Meta_Feature* find_feature(
    const Meta_Method* mm, const char* name, uint32 type_mask = FLAG_ANY_FEATURE);

inline const Meta_Property* find_property(const Meta_Class* mc, const char* name)
{
    return (const Meta_Property*)find_feature(mc, name, FLAG_PROPERTY);
}

inline const Meta_Reference* find_reference(const Meta_Class* mc, const char* name)
{
    return (const Meta_Reference*)find_feature(mc, name, FLAG_REFERENCE);
}

inline const Meta_Method* find_method(const Meta_Class* mc, const char* name)
{
    return (const Meta_Method*)find_feature(mc, name, FLAG_METHOD);
}

inline const Meta_Property* find_parameter(const Meta_Method* mm, const char* name)
{
    return (const Meta_Property*)find_feature(mm, name, FLAG_PROPERTY);
}

inline const Meta_Reference* find_reference(const Meta_Method* mm, const char* name)
{
    return (const Meta_Reference*)find_feature(mm, name, FLAG_REFERENCE);
}

// Index of the feature in mc->meta_features, or -1.
ssize_t find_feature_index(const Meta_Class* mc, const Meta_Feature* mf);

// True if any feature's flags meet the mask. Clang (and GCC from 14)
// reserve the name __has_feature for a preprocessor operator, so the
// function has its own name and the short one only where it is free.
bool __has_meta_feature(const Meta_Class* mc, uint32 type_mask);

#ifndef __has_feature
inline bool __has_feature(const Meta_Class* mc, uint32 type_mask)
{
    return __has_meta_feature(mc, type_mask);
}
#endif

// A class counts as a subclass of itself; everything is a subclass of
// Instance.
bool is_subclass(const Meta_Class* ancestor, const Meta_Class* descendant);

const Meta_Class* find_meta_class(const Meta_Class* mc, const char* name);

const Meta_Class* find_meta_class(const Meta_Repository* mr, const char* name);

// A status, not a truth value: 0 if descendant derives from ancestor, 1 if
// not, -1 if an argument is null or a class is unknown.
int is_subclass(const Meta_Repository* mr, const char* ancestor, const char* descendant);

//
// Reference counts and copies. Static records (refs 0) are shared as they
// are; dynamic ones are counted.
//

void ref(const Meta_Class* mc);
void unref(const Meta_Class* mc);

Meta_Value* clone(const Meta_Value* mv, Type type, bool array);
void destroy(Meta_Value* mv, Type type, bool array);

Meta_Qualifier* clone(const Meta_Qualifier* mq);
void destroy(Meta_Qualifier* mq);

Meta_Property* clone(const Meta_Property* mp);
void destroy(Meta_Property* mp);

Meta_Reference* clone(const Meta_Reference* mr);
void destroy(Meta_Reference* mr);

Meta_Method* clone(const Meta_Method* mm);
void destroy(Meta_Method* mm);

// By kind.
Meta_Feature* clone(const Meta_Feature* mf);
void destroy(Meta_Feature* mf);

Meta_Class* clone(const Meta_Class* mc);
void destroy(Meta_Class* mc);

// Same names, flags, features and defaults.
bool identical(const Meta_Class* x, const Meta_Class* y);

// Appends a qualifier (the record passes to the class or feature).
void append(Meta_Qualified_Object* mqo, Meta_Qualifier* mq);

// Appends a feature to a dynamic class (the record passes to the class).
void append(Meta_Class* mc, Meta_Feature* mf, bool local);

// Removes the named qualifiers from a dynamic class, its features and the
// parameters of its methods.
void filter_qualifiers(Meta_Class* mc, const char* const* names, size_t count);

// Classes built at run time: a clone of super (or an empty class), with
// refs 1.
Meta_Class* create_meta_class(const char* name, const Meta_Class* super, uint32 flags);

Meta_Property* create_meta_property(
    const char* name, Type type, sint16 subscript, uint32 offset, bool key);

//
// Diagnostics.
//

void dump(const Meta_Class* mc);
void print(const Meta_Class* mc, bool print_qualifiers = false);
void fprint(FILE* os, const Meta_Class* mc, bool print_qualifiers = false);

// Prints a literal of the given type.
void fprint(FILE* os, const Meta_Value* mv, Type type, bool array);

} // namespace OLMA

#endif // _OLMA_Meta_Class_h
