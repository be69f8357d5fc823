// What a user types at the stand-in server: object paths and typed values.
// Whatever the text, the readers accept it or refuse it with a reason, and
// what they accept reads back the same from its own text form.

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "cimhost.h"

using namespace OLMA::cimhost;

namespace
{

const CMPIType TYPES[] = {
    CMPI_boolean, CMPI_uint8, CMPI_uint16, CMPI_uint32, CMPI_uint64, CMPI_sint8,
    CMPI_sint16, CMPI_sint32, CMPI_sint64, CMPI_real32, CMPI_real64, CMPI_char16,
    CMPI_string, CMPI_dateTime, CMPI_ref, CMPI_uint16A, CMPI_stringA, CMPI_sint64A,
    CMPI_booleanA, CMPI_dateTimeA, CMPI_refA,
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    if (size == 0)
        return 0;
    std::string text(reinterpret_cast<const char*>(data) + 1, size - 1);
    std::string err;

    Object_Path path;
    if (parse_path(text, path, err, "root/default"))
    {
        // A path that parsed reads back from its own text as an equal one.
        Object_Path again;
        std::string again_err;
        if (!parse_path(path.to_string(), again, again_err) ||
            !path_equal(path, again))
            abort();
    }
    else if (err.empty())
        abort();

    Value v;
    err.clear();
    if (parse_typed_value(text, v, err))
        (void)v.text();
    else if (err.empty())
        abort();

    Value w;
    err.clear();
    CMPIType type = TYPES[data[0] % (sizeof(TYPES) / sizeof(TYPES[0]))];
    if (parse_value_as(type, text, w, err))
        (void)w.text();
    else if (err.empty())
        abort();
    return 0;
}
