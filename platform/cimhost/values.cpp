// Values, paths and their text forms.

#include <cerrno>
#include <cinttypes>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <strings.h>
#include <sys/time.h>

#include "internal.h"

namespace OLMA
{
namespace cimhost
{

bool name_eq(const std::string& a, const std::string& b)
{
    return a.size() == b.size() && strcasecmp(a.c_str(), b.c_str()) == 0;
}

std::string lower(const std::string& s)
{
    std::string r(s);
    for (char& c : r)
        if (c >= 'A' && c <= 'Z')
            c = char(c - 'A' + 'a');
    return r;
}

namespace
{

struct Type_Name
{
    CMPIType type;
    const char* name;
};

const Type_Name type_names[] = {
    {CMPI_boolean, "boolean"}, {CMPI_uint8, "uint8"},       {CMPI_sint8, "sint8"},
    {CMPI_uint16, "uint16"},   {CMPI_sint16, "sint16"},     {CMPI_uint32, "uint32"},
    {CMPI_sint32, "sint32"},   {CMPI_uint64, "uint64"},     {CMPI_sint64, "sint64"},
    {CMPI_real32, "real32"},   {CMPI_real64, "real64"},     {CMPI_char16, "char16"},
    {CMPI_string, "string"},   {CMPI_dateTime, "datetime"}, {CMPI_ref, "ref"},
    {CMPI_instance, "instance"}, {CMPI_chars, "chars"},
};

} // namespace

std::string type_name(CMPIType type)
{
    CMPIType el = CMPIType(type & ~CMPI_ARRAY);
    for (const Type_Name& t : type_names)
        if (t.type == el)
            return std::string(t.name) + ((type & CMPI_ARRAY) ? "[]" : "");
    return "";
}

CMPIType type_of_name(const std::string& name)
{
    for (const Type_Name& t : type_names)
        if (name_eq(name, t.name))
            return t.type == CMPI_chars ? CMPIType(CMPI_string) : t.type;
    if (name_eq(name, "reference"))
        return CMPI_ref;
    return 0;
}

bool is_uint_type(CMPIType t)
{
    return (t & 0xFFC0) == 0x80;
}

bool is_sint_type(CMPIType t)
{
    return (t & 0xFFC0) == 0xC0;
}

//
// Datetimes
//

static bool all_digits(const std::string& s, size_t from, size_t n)
{
    for (size_t i = from; i < from + n; i++)
        if (s[i] < '0' || s[i] > '9')
            return false;
    return true;
}

bool datetime_is_interval(const std::string& text)
{
    return text.size() == 25 && text[21] == ':';
}

bool datetime_valid(const std::string& t)
{
    if (t.size() != 25 || t[14] != '.')
        return false;
    if (!all_digits(t, 0, 14) || !all_digits(t, 15, 6) || !all_digits(t, 22, 3))
        return false;
    if (t[21] == ':')
        return t.compare(22, 3, "000") == 0 && atoi(t.substr(8, 2).c_str()) < 24 &&
               atoi(t.substr(10, 2).c_str()) < 60 && atoi(t.substr(12, 2).c_str()) < 60;
    if (t[21] != '+' && t[21] != '-')
        return false;
    int mon = atoi(t.substr(4, 2).c_str()), day = atoi(t.substr(6, 2).c_str());
    int hh = atoi(t.substr(8, 2).c_str()), mm = atoi(t.substr(10, 2).c_str());
    int ss = atoi(t.substr(12, 2).c_str());
    return mon >= 1 && mon <= 12 && day >= 1 && day <= 31 && hh < 24 && mm < 60 && ss < 61;
}

uint64_t datetime_to_binary(const std::string& t)
{
    if (!datetime_valid(t))
        return 0;
    uint64_t usec = strtoull(t.substr(15, 6).c_str(), nullptr, 10);
    if (datetime_is_interval(t))
    {
        uint64_t days = strtoull(t.substr(0, 8).c_str(), nullptr, 10);
        uint64_t secs = days * 86400 + strtoull(t.substr(8, 2).c_str(), nullptr, 10) * 3600 +
                        strtoull(t.substr(10, 2).c_str(), nullptr, 10) * 60 +
                        strtoull(t.substr(12, 2).c_str(), nullptr, 10);
        return secs * 1000000 + usec;
    }
    struct tm tm;
    memset(&tm, 0, sizeof(tm));
    tm.tm_year = atoi(t.substr(0, 4).c_str()) - 1900;
    tm.tm_mon = atoi(t.substr(4, 2).c_str()) - 1;
    tm.tm_mday = atoi(t.substr(6, 2).c_str());
    tm.tm_hour = atoi(t.substr(8, 2).c_str());
    tm.tm_min = atoi(t.substr(10, 2).c_str());
    tm.tm_sec = atoi(t.substr(12, 2).c_str());
    int64_t secs = int64_t(timegm(&tm));
    int offset = atoi(t.substr(22, 3).c_str());
    // The text is local time at the given offset east of UTC.
    secs -= int64_t(t[21] == '-' ? -offset : offset) * 60;
    if (secs < 0)
        return 0;
    return uint64_t(secs) * 1000000 + usec;
}

std::string datetime_from_binary(uint64_t usec, bool interval)
{
    char buf[64];
    uint64_t secs = usec / 1000000, frac = usec % 1000000;
    if (interval)
    {
        uint64_t days = secs / 86400;
        if (days > 99999999)
            days = 99999999;
        snprintf(buf, sizeof(buf), "%08" PRIu64 "%02u%02u%02u.%06u:000", days,
                 unsigned(secs % 86400 / 3600), unsigned(secs % 3600 / 60), unsigned(secs % 60),
                 unsigned(frac));
        return buf;
    }
    time_t tt = time_t(secs);
    struct tm tm;
    gmtime_r(&tt, &tm);
    snprintf(buf, sizeof(buf), "%04d%02d%02d%02d%02d%02d.%06u+000", tm.tm_year + 1900,
             tm.tm_mon + 1, tm.tm_mday, tm.tm_hour, tm.tm_min, tm.tm_sec, unsigned(frac));
    return buf;
}

std::string datetime_now()
{
    struct timeval tv;
    gettimeofday(&tv, nullptr);
    return datetime_from_binary(uint64_t(tv.tv_sec) * 1000000 + uint64_t(tv.tv_usec), false);
}

//
// Values
//

Value Value::of_string(const std::string& s)
{
    Value v;
    v.type = CMPI_string;
    v.null = false;
    v.str = s;
    return v;
}

Value Value::of_uint(CMPIType type, uint64_t x)
{
    Value v;
    v.type = type;
    v.null = false;
    switch (type)
    {
    case CMPI_uint8: v.num.uint8 = CMPIUint8(x); break;
    case CMPI_uint16: v.num.uint16 = CMPIUint16(x); break;
    case CMPI_uint32: v.num.uint32 = CMPIUint32(x); break;
    case CMPI_char16: v.num.char16 = CMPIChar16(x); break;
    default: v.num.uint64 = x; break;
    }
    return v;
}

Value Value::of_sint(CMPIType type, int64_t x)
{
    Value v;
    v.type = type;
    v.null = false;
    switch (type)
    {
    case CMPI_sint8: v.num.sint8 = CMPISint8(x); break;
    case CMPI_sint16: v.num.sint16 = CMPISint16(x); break;
    case CMPI_sint32: v.num.sint32 = CMPISint32(x); break;
    default: v.num.sint64 = x; break;
    }
    return v;
}

Value Value::of_bool(bool b)
{
    Value v;
    v.type = CMPI_boolean;
    v.null = false;
    v.num.boolean = b ? 1 : 0;
    return v;
}

Value Value::of_real(CMPIType type, double x)
{
    Value v;
    v.type = type;
    v.null = false;
    if (type == CMPI_real32)
        v.num.real32 = float(x);
    else
        v.num.real64 = x;
    return v;
}

Value Value::of_datetime(const std::string& text)
{
    Value v;
    v.type = CMPI_dateTime;
    v.null = false;
    v.str = text;
    return v;
}

Value Value::of_ref(const Object_Path& path)
{
    Value v;
    v.type = CMPI_ref;
    v.null = false;
    v.ref = std::make_shared<Object_Path>(path);
    return v;
}

Value Value::of_instance(const Instance& inst)
{
    Value v;
    v.type = CMPI_instance;
    v.null = false;
    v.inst = std::make_shared<Instance>(inst);
    return v;
}

Value Value::of_instance(Instance&& inst)
{
    Value v;
    v.type = CMPI_instance;
    v.null = false;
    v.inst = std::make_shared<Instance>(std::move(inst));
    return v;
}

Value Value::null_of(CMPIType type)
{
    Value v;
    v.type = type;
    v.null = true;
    return v;
}

static std::string real_text(double d, bool single)
{
    char buf[64];
    snprintf(buf, sizeof(buf), single ? "%.9g" : "%.17g", d);
    return buf;
}

static std::string scalar_text(const Value& v)
{
    char buf[64];
    switch (v.type)
    {
    case CMPI_boolean: return v.num.boolean ? "true" : "false";
    case CMPI_uint8: snprintf(buf, sizeof(buf), "%u", unsigned(v.num.uint8)); return buf;
    case CMPI_uint16: snprintf(buf, sizeof(buf), "%u", unsigned(v.num.uint16)); return buf;
    case CMPI_uint32: snprintf(buf, sizeof(buf), "%u", unsigned(v.num.uint32)); return buf;
    case CMPI_uint64: snprintf(buf, sizeof(buf), "%llu", v.num.uint64); return buf;
    case CMPI_sint8: snprintf(buf, sizeof(buf), "%d", int(v.num.sint8)); return buf;
    case CMPI_sint16: snprintf(buf, sizeof(buf), "%d", int(v.num.sint16)); return buf;
    case CMPI_sint32: snprintf(buf, sizeof(buf), "%d", int(v.num.sint32)); return buf;
    case CMPI_sint64: snprintf(buf, sizeof(buf), "%lld", v.num.sint64); return buf;
    case CMPI_char16: snprintf(buf, sizeof(buf), "%u", unsigned(v.num.char16)); return buf;
    case CMPI_real32: return real_text(v.num.real32, true);
    case CMPI_real64: return real_text(v.num.real64, false);
    case CMPI_string:
    case CMPI_dateTime: return v.str;
    case CMPI_ref: return v.ref ? v.ref->to_string() : "NULL";
    case CMPI_instance: return v.inst ? "instance of " + v.inst->class_name : "NULL";
    default: return "";
    }
}

static std::string quote(const std::string& s)
{
    std::string r = "\"";
    for (char c : s)
    {
        if (c == '"' || c == '\\')
            r += '\\';
        r += c;
    }
    return r + "\"";
}

std::string Value::text() const
{
    if (null)
        return "NULL";
    if (!is_array())
        return scalar_text(*this);
    std::string r = "{";
    for (size_t i = 0; i < elements.size(); i++)
    {
        if (i)
            r += ", ";
        const Value& e = elements[i];
        if (!e.null && (e.type == CMPI_string || e.type == CMPI_dateTime || e.type == CMPI_ref))
            r += quote(e.text());
        else
            r += e.text();
    }
    return r + "}";
}

bool operator==(const Value& a, const Value& b)
{
    if (a.type != b.type || a.null != b.null)
        return false;
    if (a.null)
        return true;
    if (a.is_array())
        return a.elements == b.elements;
    switch (a.type)
    {
    case CMPI_string:
    case CMPI_dateTime: return a.str == b.str;
    case CMPI_ref: return a.ref && b.ref && path_equal(*a.ref, *b.ref);
    case CMPI_instance:
        if (!a.inst || !b.inst || !name_eq(a.inst->class_name, b.inst->class_name) ||
            a.inst->properties.size() != b.inst->properties.size())
            return false;
        for (const Property& p : a.inst->properties)
        {
            const Value* o = b.inst->get(p.name);
            if (!o || !(*o == p.value))
                return false;
        }
        return true;
    default: return scalar_text(a) == scalar_text(b);
    }
}

std::string rc_name(int rc)
{
    static const struct
    {
        int rc;
        const char* name;
    } names[] = {
        {0, "CMPI_RC_OK"},
        {1, "CMPI_RC_ERR_FAILED"},
        {2, "CMPI_RC_ERR_ACCESS_DENIED"},
        {3, "CMPI_RC_ERR_INVALID_NAMESPACE"},
        {4, "CMPI_RC_ERR_INVALID_PARAMETER"},
        {5, "CMPI_RC_ERR_INVALID_CLASS"},
        {6, "CMPI_RC_ERR_NOT_FOUND"},
        {7, "CMPI_RC_ERR_NOT_SUPPORTED"},
        {8, "CMPI_RC_ERR_CLASS_HAS_CHILDREN"},
        {9, "CMPI_RC_ERR_CLASS_HAS_INSTANCES"},
        {10, "CMPI_RC_ERR_INVALID_SUPERCLASS"},
        {11, "CMPI_RC_ERR_ALREADY_EXISTS"},
        {12, "CMPI_RC_ERR_NO_SUCH_PROPERTY"},
        {13, "CMPI_RC_ERR_TYPE_MISMATCH"},
        {14, "CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED"},
        {15, "CMPI_RC_ERR_INVALID_QUERY"},
        {16, "CMPI_RC_ERR_METHOD_NOT_AVAILABLE"},
        {17, "CMPI_RC_ERR_METHOD_NOT_FOUND"},
        {50, "CMPI_RC_DO_NOT_UNLOAD"},
        {51, "CMPI_RC_NEVER_UNLOAD"},
        {60, "CMPI_RC_ERR_INVALID_HANDLE"},
        {61, "CMPI_RC_ERR_INVALID_DATA_TYPE"},
        {100, "CMPI_RC_ERROR_SYSTEM"},
        {200, "CMPI_RC_ERROR"},
    };
    for (const auto& n : names)
        if (n.rc == rc)
            return n.name;
    return "CMPI_RC_" + std::to_string(rc);
}

//
// Paths
//

std::string key_value_text(const Value& v)
{
    if (v.null)
        return "NULL";
    switch (v.type)
    {
    case CMPI_string:
    case CMPI_dateTime:
    case CMPI_ref:
    case CMPI_char16: return quote(scalar_text(v));
    case CMPI_boolean: return v.num.boolean ? "TRUE" : "FALSE";
    case CMPI_real32:
    case CMPI_real64:
    {
        // A real that prints as a whole number would read back as an
        // integer key.
        std::string t = scalar_text(v);
        return t.find_first_not_of("-0123456789") == std::string::npos ? t + ".0" : t;
    }
    default: return v.is_array() ? quote(v.text()) : scalar_text(v);
    }
}

std::string Object_Path::to_string() const
{
    std::string r;
    if (!host.empty())
        r = "//" + host + "/";
    if (!name_space.empty())
        r += name_space + ":";
    r += class_name;
    for (size_t i = 0; i < keys.size(); i++)
        r += (i ? "," : ".") + keys[i].name + "=" + key_value_text(keys[i].value);
    return r;
}

const Value* Object_Path::key(const std::string& name) const
{
    for (const Property& p : keys)
        if (name_eq(p.name, name))
            return &p.value;
    return nullptr;
}

bool path_equal(const Object_Path& a, const Object_Path& b)
{
    if (!name_eq(a.class_name, b.class_name) || !name_eq(a.name_space, b.name_space) ||
        a.keys.size() != b.keys.size())
        return false;
    for (const Property& k : a.keys)
    {
        const Value* o = b.key(k.name);
        if (!o)
            return false;
        // Integer keys compare by number whatever their width.
        if (!k.value.null && !o->null && (is_uint_type(k.value.type) || is_sint_type(k.value.type)) &&
            (is_uint_type(o->type) || is_sint_type(o->type)))
        {
            if (k.value.text() != o->text())
                return false;
        }
        else if (!(k.value == *o))
            return false;
    }
    return true;
}

const Value* Instance::get(const std::string& name) const
{
    for (const Property& p : properties)
        if (name_eq(p.name, name))
            return &p.value;
    return nullptr;
}

std::string Instance::get_text(const std::string& name) const
{
    const Value* v = get(name);
    return v ? v->text() : "";
}

static bool is_ident_char(char c, bool first)
{
    return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || c == '_' ||
           (!first && c >= '0' && c <= '9');
}

static bool read_int(const std::string& s, Value& v)
{
    if (s.empty())
        return false;
    errno = 0;
    char* end = nullptr;
    if (s[0] == '-')
    {
        long long x = strtoll(s.c_str(), &end, 10);
        if (errno || *end || end == s.c_str())
            return false;
        v = Value::of_sint(CMPI_sint64, x);
        return true;
    }
    if (s[0] < '0' || s[0] > '9')
        return false;
    unsigned long long x = strtoull(s.c_str(), &end, 10);
    if (errno || *end)
        return false;
    v = Value::of_uint(CMPI_uint64, x);
    return true;
}

bool parse_untyped_key(const std::string& raw, bool quoted, Value& v, std::string& err)
{
    if (quoted)
    {
        // A quoted text that reads as a path with keys is a reference.
        Object_Path p;
        std::string perr;
        size_t dot = raw.find('.');
        if (dot != std::string::npos && raw.find('=') != std::string::npos &&
            parse_path(raw, p, perr) && !p.keys.empty())
        {
            v = Value::of_ref(p);
            return true;
        }
        v = Value::of_string(raw);
        return true;
    }
    if (name_eq(raw, "true") || name_eq(raw, "false"))
    {
        v = Value::of_bool(name_eq(raw, "true"));
        return true;
    }
    if (read_int(raw, v))
        return true;
    char* end = nullptr;
    errno = 0;
    double d = strtod(raw.c_str(), &end);
    if (!raw.empty() && !errno && !*end)
    {
        v = Value::of_real(CMPI_real64, d);
        return true;
    }
    err = "unreadable key value '" + raw + "' (quote strings)";
    return false;
}

bool parse_path(const std::string& text, Object_Path& path, std::string& err,
                const std::string& default_ns)
{
    path = Object_Path();
    std::string s = text;
    size_t pos = 0;
    if (s.compare(0, 2, "//") == 0)
    {
        size_t slash = s.find('/', 2);
        if (slash == std::string::npos)
        {
            err = "path '" + text + "': host without namespace";
            return false;
        }
        // An empty host would print as no host, and the path would read
        // back with its namespace a slash shorter.
        if (slash == 2)
        {
            err = "path '" + text + "': empty host";
            return false;
        }
        path.host = s.substr(2, slash - 2);
        pos = slash + 1;
    }
    // The namespace ends at the first ':' before any '.' or '='.
    size_t colon = s.find(':', pos);
    size_t dot = s.find('.', pos);
    size_t eq = s.find('=', pos);
    if (colon != std::string::npos && (dot == std::string::npos || colon < dot) &&
        (eq == std::string::npos || colon < eq))
    {
        path.name_space = s.substr(pos, colon - pos);
        pos = colon + 1;
        if (path.name_space.empty())
        {
            err = "path '" + text + "': empty namespace";
            return false;
        }
    }
    else
        path.name_space = default_ns;
    size_t start = pos;
    while (pos < s.size() && is_ident_char(s[pos], pos == start))
        pos++;
    path.class_name = s.substr(start, pos - start);
    if (path.class_name.empty())
    {
        err = "path '" + text + "': no class name";
        return false;
    }
    if (pos == s.size())
        return true;
    if (s[pos] != '.')
    {
        err = "path '" + text + "': unexpected '" + s.substr(pos, 1) + "' after the class name";
        return false;
    }
    pos++;
    for (;;)
    {
        size_t ks = pos;
        while (pos < s.size() && is_ident_char(s[pos], pos == ks))
            pos++;
        std::string name = s.substr(ks, pos - ks);
        if (name.empty() || pos >= s.size() || s[pos] != '=')
        {
            err = "path '" + text + "': expected KEY=VALUE at offset " + std::to_string(ks);
            return false;
        }
        pos++;
        std::string raw;
        bool quoted = false;
        if (pos < s.size() && s[pos] == '"')
        {
            quoted = true;
            pos++;
            bool closed = false;
            while (pos < s.size())
            {
                char c = s[pos++];
                if (c == '\\' && pos < s.size())
                    raw += s[pos++];
                else if (c == '"')
                {
                    closed = true;
                    break;
                }
                else
                    raw += c;
            }
            if (!closed)
            {
                err = "path '" + text + "': unterminated quote in key " + name;
                return false;
            }
        }
        else
        {
            while (pos < s.size() && s[pos] != ',')
                raw += s[pos++];
        }
        Value v;
        if (!parse_untyped_key(raw, quoted, v, err))
        {
            err = "path '" + text + "': " + err;
            return false;
        }
        if (path.key(name))
        {
            err = "path '" + text + "': key " + name + " given twice";
            return false;
        }
        path.keys.push_back(Property {name, v});
        if (pos == s.size())
            return true;
        if (s[pos] != ',')
        {
            err = "path '" + text + "': expected ',' after key " + name;
            return false;
        }
        pos++;
    }
}

//
// Typed values from text
//

static bool parse_scalar_as(CMPIType type, const std::string& text, Value& v, std::string& err)
{
    char* end = nullptr;
    errno = 0;
    if (is_uint_type(type) || type == CMPI_char16)
    {
        if (text.empty() || text[0] == '-' || text[0] == '+' || text[0] == ' ')
        {
            err = "'" + text + "' is not a " + type_name(type);
            return false;
        }
        unsigned long long x = strtoull(text.c_str(), &end, 0);
        static const std::map<CMPIType, unsigned long long> max = {
            {CMPI_uint8, 0xFFull}, {CMPI_uint16, 0xFFFFull}, {CMPI_char16, 0xFFFFull},
            {CMPI_uint32, 0xFFFFFFFFull}, {CMPI_uint64, ~0ull}};
        if (errno || *end || x > max.at(type))
        {
            err = "'" + text + "' is not a " + type_name(type);
            return false;
        }
        v = Value::of_uint(type, x);
        return true;
    }
    if (is_sint_type(type))
    {
        long long x = strtoll(text.c_str(), &end, 0);
        static const std::map<CMPIType, long long> max = {
            {CMPI_sint8, 0x7F}, {CMPI_sint16, 0x7FFF}, {CMPI_sint32, 0x7FFFFFFF},
            {CMPI_sint64, 0x7FFFFFFFFFFFFFFFll}};
        long long m = max.at(type);
        if (text.empty() || errno || *end || x > m || x < -m - 1)
        {
            err = "'" + text + "' is not a " + type_name(type);
            return false;
        }
        v = Value::of_sint(type, x);
        return true;
    }
    switch (type)
    {
    case CMPI_boolean:
        if (name_eq(text, "true") || text == "1")
            v = Value::of_bool(true);
        else if (name_eq(text, "false") || text == "0")
            v = Value::of_bool(false);
        else
        {
            err = "'" + text + "' is not a boolean (true or false)";
            return false;
        }
        return true;
    case CMPI_real32:
    case CMPI_real64:
    {
        double d = strtod(text.c_str(), &end);
        if (text.empty() || errno || *end)
        {
            err = "'" + text + "' is not a " + type_name(type);
            return false;
        }
        v = Value::of_real(type, d);
        return true;
    }
    case CMPI_string:
        v = Value::of_string(text);
        return true;
    case CMPI_dateTime:
        if (!datetime_valid(text))
        {
            err = "'" + text + "' is not a datetime (yyyymmddhhmmss.mmmmmm+utc or "
                  "ddddddddhhmmss.mmmmmm:000)";
            return false;
        }
        v = Value::of_datetime(text);
        return true;
    case CMPI_ref:
    {
        Object_Path p;
        if (!parse_path(text, p, err))
            return false;
        v = Value::of_ref(p);
        return true;
    }
    default:
        err = "values of type " + (type_name(type).empty() ? std::to_string(type) : type_name(type)) +
              " can't be given as text";
        return false;
    }
}

bool parse_value_as(CMPIType type, const std::string& text, Value& v, std::string& err)
{
    if (!(type & CMPI_ARRAY))
        return parse_scalar_as(type, text, v, err);
    CMPIType el = CMPIType(type & ~CMPI_ARRAY);
    v = Value();
    v.type = type;
    v.null = false;
    if (text.empty())
        return true;
    std::string cur;
    for (size_t i = 0; i <= text.size(); i++)
    {
        if (i < text.size() && text[i] == '\\' && i + 1 < text.size())
        {
            cur += text[++i];
            continue;
        }
        if (i == text.size() || text[i] == ',')
        {
            Value e;
            if (!parse_scalar_as(el, cur, e, err))
                return false;
            v.elements.push_back(e);
            cur.clear();
            continue;
        }
        cur += text[i];
    }
    return true;
}

bool parse_typed_value(const std::string& text, Value& v, std::string& err)
{
    size_t colon = text.find(':');
    if (colon == std::string::npos)
    {
        err = "value '" + text + "' has no TYPE: prefix";
        return false;
    }
    std::string tn = text.substr(0, colon);
    std::string rest = text.substr(colon + 1);
    if (name_eq(tn, "null"))
    {
        v = Value();
        return true;
    }
    bool array = tn.size() > 2 && tn.compare(tn.size() - 2, 2, "[]") == 0;
    if (array)
        tn.resize(tn.size() - 2);
    CMPIType t = type_of_name(tn);
    if (!t || t == CMPI_instance)
    {
        err = "unknown type '" + tn + "'";
        return false;
    }
    return parse_value_as(array ? CMPIType(t | CMPI_ARRAY) : t, rest, v, err);
}

std::string instance_mof(const Instance& inst, int indent)
{
    std::string pad(size_t(indent), ' ');
    std::string r = pad + "instance of " + inst.class_name + " {\n";
    for (const Property& p : inst.properties)
    {
        r += pad + "    " + p.name + " = ";
        const Value& v = p.value;
        if (!v.null && v.type == CMPI_instance && v.inst)
            r += "\n" + instance_mof(*v.inst, indent + 8) + ";\n";
        else if (!v.null && !v.is_array() &&
                 (v.type == CMPI_string || v.type == CMPI_dateTime || v.type == CMPI_ref))
            r += quote(v.text()) + ";\n";
        else
            r += v.text() + ";\n";
    }
    return r + pad + "}";
}

} // namespace cimhost
} // namespace OLMA
