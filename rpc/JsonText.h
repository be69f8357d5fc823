#ifndef _VSPR_JsonText_h
#define _VSPR_JsonText_h

// The JSON texts of the console protocol. Consoles have always parsed the
// service's replies in one layout and sent requests that JsonCpp's reader
// accepted; neither may change with the JsonCpp version a host happens to
// have, so both ends are fixed here rather than left to the package.

#include <string>
#include <json/json.h>

namespace OLMA
{

// The reply layout: one member per line, members in ascending byte order of
// their keys, " : " between key and value, nesting indented by 3 blanks,
// arrays of plain values on one line while they fit a right margin of 74
// columns, and a newline at the end. Comments are never written. Reals are
// written in the shortest form that reads back to the same number (always
// with a point or an exponent), and as null when they aren't finite, which
// JSON can't carry. Text is written as UTF-8; a byte that isn't part of
// valid UTF-8 (the library's texts are untrusted) is written as the \u00XX
// escape of that byte, so that the reply stays valid JSON.
std::string styledJson(const Json::Value& value);

// Reads a request text: strict JSON (RFC 8259), plus the /* */ and //
// comments that JsonCpp has always let consoles write. False with the
// reader's messages ("* Line L, Column C\n  what\n") for anything else,
// also for the leniencies of JsonCpp's own reader (text after the value,
// leading zeros, a bare "-", trailing commas, raw control characters in
// strings) and for nesting deeper than the reader can take.
bool parseJsonText(const std::string& text, Json::Value& root, std::string& errors);

} // namespace OLMA

#endif // _VSPR_JsonText_h
