#ifndef _VSPR_JsonParams_h
#define _VSPR_JsonParams_h

// How a handler reads the positional parameters of a console's call. The
// rules are the protocol's, not JsonCpp's: JsonCpp would turn a number into
// text, refuse "abc" as a bool and word its failures by version, and a
// console relies on none of that.

#include <string>
#include <json/json.h>

namespace OLMA
{

namespace JsonParams
{

// A string as it is; null gives "", true and false "true" and "false".
// Anything else throws std::runtime_error "Type is not convertible to
// string": a request id, for one, must come as a JSON string.
std::string readString(const Json::Value& v);

// A 32-bit int; null gives 0, true 1, false 0, a real its integer part.
// Throws std::runtime_error "integer out of signed integer range", "Real out
// of signed integer range" or "Type is not convertible to int".
int readInt(const Json::Value& v);

// Never fails: null is false, a number true unless 0, a string, array or
// object true when not empty.
bool readBool(const Json::Value& v);

// The value itself if it is an array (object) or null; ErrorBadJsonArray
// (ErrorBadJsonObject) otherwise.
const Json::Value& checkArray(const Json::Value& v);
const Json::Value& checkObject(const Json::Value& v);

// Throws ErrorParamMismatch, after a WARN line that names the handler, when
// params doesn't hold `expected` elements (members of an object count, a
// plain value or null counts 0).
void checkCount(const Json::Value& params, unsigned expected, const char* handler);

// Position i of the params. The params are positional: an object of named
// parameters can't be read by position, and the console is told to send an
// array (ErrorBadJsonArray). A position beyond the end reads as null.
const Json::Value& at(const Json::Value& params, unsigned i);

// A member of a library reply or of a console's object, null when the value
// isn't an object or lacks it: neither may crash a handler.
const Json::Value& member(const Json::Value& v, const char* name);

} // namespace JsonParams

} // namespace OLMA

#endif // _VSPR_JsonParams_h
