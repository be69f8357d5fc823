#include "config.h"
#include <string.h>
#include <strings.h>
#include <ctype.h>
#include "Type.h"

// The one definition of the version word; exported so that the module
// carries it.
extern "C"
{
__attribute__((visibility("default"))) int __tessel_version_2_0_16 = 0;
}

namespace OLMA {

const char* const type_name[NUM_TYPES] =
{
    "boolean",
    "uint8",
    "sint8",
    "uint16",
    "sint16",
    "uint32",
    "sint32",
    "uint64",
    "sint64",
    "real32",
    "real64",
    "char16",
    "string",
    "datetime",
};

const uint8 type_size[NUM_TYPES] = { 1, 1, 1, 2, 2, 4, 4, 8, 8, 4, 8, 2, 8, 8 };

const uint8 literal_type_size[NUM_TYPES] =
    { 1, 1, 1, 2, 2, 4, 4, 8, 8, 4, 8, 2, 8, 8 };

// Candidate type by the hash tolower(first) ^ length ^ tolower(last), which
// is unique over the fourteen names but for two pairs that the first letter
// separates; one strcasecmp then confirms the pick.
static int _candidate(unsigned h, int first)
{
    switch (h)
    {
        case 11: return BOOLEAN;
        case 72: return UINT8;
        case 78: return SINT8;
        case 69: return UINT16;
        case 67: return SINT16;
        case 65: return first == 'u' ? UINT32 : SINT64;
        case 71: return first == 'u' ? UINT64 : SINT32;
        case 70: return REAL32;
        case 64: return REAL64;
        case 83: return CHAR16;
        case 18: return STRING;
        case 9: return DATETIME;
        default: return -1;
    }
}

int type_name_to_type(const char* name, Type& type)
{
    if (!name || !name[0])
        return -1;

    size_t n = strlen(name);
    int first = tolower((unsigned char)name[0]);
    unsigned h = (unsigned)first ^ (unsigned)n ^
        (unsigned)tolower((unsigned char)name[n - 1]);
    int i = _candidate(h, first);

    if (i < 0 || strcasecmp(type_name[i], name) != 0)
        return -1;

    type = Type(i);
    return 0;
}

} // namespace OLMA
