#ifndef _OLMA_Value_h
#define _OLMA_Value_h

// One value of any type that a CIM feature can have: the form in which a
// property travels between an Instance slot and a foreign representation
// (a CMPI object, for instance). A Value owns what it holds: arrays, shared
// string and datetime representations, one reference per instance.

#include <cstdio>
#include "config.h"
#include "Type.h"
#include "String.h"
#include "Datetime.h"
#include "Array.h"
#include "Meta_Class.h"

namespace OLMA
{

struct Instance;

class Value
{
public:

    // 0 to 13 are the scalar Types; an array has bit 7 set.
    enum Type
    {
        NONE = -1,
        BOOLEAN = 0,
        UINT8 = 1,
        SINT8 = 2,
        UINT16 = 3,
        SINT16 = 4,
        UINT32 = 5,
        SINT32 = 6,
        UINT64 = 7,
        SINT64 = 8,
        REAL32 = 9,
        REAL64 = 10,
        CHAR16 = 11,
        STRING = 12,
        DATETIME = 13,
        INSTANCE = 14,
        ARRAY_FLAG = 128,
        BOOLEAN_ARRAY = 128,
        UINT8_ARRAY = 129,
        SINT8_ARRAY = 130,
        UINT16_ARRAY = 131,
        SINT16_ARRAY = 132,
        UINT32_ARRAY = 133,
        SINT32_ARRAY = 134,
        UINT64_ARRAY = 135,
        SINT64_ARRAY = 136,
        REAL32_ARRAY = 137,
        REAL64_ARRAY = 138,
        CHAR16_ARRAY = 139,
        STRING_ARRAY = 140,
        DATETIME_ARRAY = 141,
        INSTANCE_ARRAY = 142,
    };

    Value();
    Value(const Value& x);
    ~Value();
    Value& operator=(const Value& x);

    // Back to NONE, with null set.
    void clear();

    // Each clears first, then sets the type and null 0.
    void set_value(const boolean& x);
    void set_value(const uint8& x);
    void set_value(const sint8& x);
    void set_value(const uint16& x);
    void set_value(const sint16& x);
    void set_value(const uint32& x);
    void set_value(const sint32& x);
    void set_value(const uint64& x);
    void set_value(const sint64& x);
    void set_value(const real32& x);
    void set_value(const real64& x);
    void set_value(const char16& x);
    void set_value(const String& x);
    void set_value(const Datetime& x);
    void set_value(const char* x);
    // Takes over the caller's reference.
    void set_value(Instance* x);
    void set_value(const Array<boolean>& x);
    void set_value(const Array<uint8>& x);
    void set_value(const Array<sint8>& x);
    void set_value(const Array<uint16>& x);
    void set_value(const Array<sint16>& x);
    void set_value(const Array<uint32>& x);
    void set_value(const Array<sint32>& x);
    void set_value(const Array<uint64>& x);
    void set_value(const Array<sint64>& x);
    void set_value(const Array<real32>& x);
    void set_value(const Array<real64>& x);
    void set_value(const Array<char16>& x);
    void set_value(const Array<String>& x);
    void set_value(const Array<Datetime>& x);
    // Takes over one reference of each non-null element.
    void set_value(const Array<Instance*>& x);

    // 0 if the value has the type of x, else -1 and x is left alone. An
    // instance is lent: the value keeps its reference.
    int get_value(boolean& x) const;
    int get_value(uint8& x) const;
    int get_value(sint8& x) const;
    int get_value(uint16& x) const;
    int get_value(sint16& x) const;
    int get_value(uint32& x) const;
    int get_value(sint32& x) const;
    int get_value(uint64& x) const;
    int get_value(sint64& x) const;
    int get_value(real32& x) const;
    int get_value(real64& x) const;
    int get_value(char16& x) const;
    int get_value(String& x) const;
    int get_value(Datetime& x) const;
    int get_value(Instance*& x) const;
    int get_value(Array<boolean>& x) const;
    int get_value(Array<uint8>& x) const;
    int get_value(Array<sint8>& x) const;
    int get_value(Array<uint16>& x) const;
    int get_value(Array<sint16>& x) const;
    int get_value(Array<uint32>& x) const;
    int get_value(Array<sint32>& x) const;
    int get_value(Array<uint64>& x) const;
    int get_value(Array<sint64>& x) const;
    int get_value(Array<real32>& x) const;
    int get_value(Array<real64>& x) const;
    int get_value(Array<char16>& x) const;
    int get_value(Array<String>& x) const;
    int get_value(Array<Datetime>& x) const;
    // The elements are lent, as above.
    int get_value(Array<Instance*>& x) const;

    // Reads the feature's slot of the instance into this value: 0 or -1.
    int set(const Instance* instance, const Meta_Feature* feature);

    // Writes this value into the feature's slot: 0 or -1.
    int get(Instance* instance, const Meta_Feature* feature) const;

    void fprint(FILE* os) const;
    void print() const;

    // The value type that a feature's slot holds; NONE for a method.
    static Type type_of(const Meta_Feature* feature);

    Type type;
    uint8 null;

private:

    void _copy(const Value& x);
    void _destruct();

    template<class T>
    T& _as() { return *reinterpret_cast<T*>(_data); }

    template<class T>
    const T& _as() const { return *reinterpret_cast<const T*>(_data); }

    template<class T>
    void _set_scalar(Type t, const T& x);

    template<class T>
    int _get_scalar(Type t, T& x) const;

    template<class T>
    void _set_array(Type t, const Array<T>& x);

    template<class T>
    int _get_array(Type t, Array<T>& x) const;

    alignas(8) char _data[8];
};

// "NONE", "BOOLEAN", ... "INSTANCE_ARRAY".
const char* _type_name(Value::Type type);

// "none", "boolean", ... "instance_array".
const char* name_of(Value::Type type);

extern const char* const _scalar_names[15];
extern const char* const _array_names[15];

} // namespace OLMA

#endif // _OLMA_Value_h
