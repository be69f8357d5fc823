#ifndef _OLMA_Type_h
#define _OLMA_Type_h

#include "config.h"

namespace OLMA {

// The CIM scalar types. Stored as 16 bits in the meta data; the value indexes
// type_name, type_size and literal_type_size.
enum Type
{
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
};

enum { NUM_TYPES = 14 };

// Lower-case CIM names: "boolean", "uint8", ... "datetime".
extern const char* const type_name[NUM_TYPES];

// Bytes of the value inside a Property<T>.
extern const uint8 type_size[NUM_TYPES];

// Bytes of one element of a literal array in the meta data.
extern const uint8 literal_type_size[NUM_TYPES];

// Case-insensitive lookup of a type by its CIM name: 0, or -1 if unknown.
int type_name_to_type(const char* name, Type& type);

} // namespace OLMA

#endif /* _OLMA_Type_h */
