#include "JsonText.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <exception>
#include <vector>

namespace OLMA
{

namespace
{

// ------------------------------------------------------------------ writing

const size_t RIGHT_MARGIN = 74;
const char* const INDENT = "   ";

// The length of the valid UTF-8 sequence at s (at most n bytes), or 0.
size_t utf8Sequence(const unsigned char* s, size_t n)
{
    unsigned char c = s[0];
    size_t len;
    unsigned char lo = 0x80, hi = 0xBF;

    if (c >= 0xC2 && c <= 0xDF)
        len = 2;
    else if (c >= 0xE0 && c <= 0xEF)
    {
        len = 3;
        if (c == 0xE0)
            lo = 0xA0;          // no overlong forms
        else if (c == 0xED)
            hi = 0x9F;          // no surrogates
    }
    else if (c >= 0xF0 && c <= 0xF4)
    {
        len = 4;
        if (c == 0xF0)
            lo = 0x90;
        else if (c == 0xF4)
            hi = 0x8F;          // nothing beyond U+10FFFF
    }
    else
        return 0;

    if (len > n)
        return 0;
    if (s[1] < lo || s[1] > hi)
        return 0;
    for (size_t i = 2; i < len; i++)
        if (s[i] < 0x80 || s[i] > 0xBF)
            return 0;
    return len;
}

void appendEscapedByte(std::string& out, unsigned char c)
{
    char buf[8];
    snprintf(buf, sizeof(buf), "\\u%04x", c);
    out += buf;
}

std::string quoted(const char* s, size_t n)
{
    std::string out;
    out.reserve(n + 2);
    out += '"';
    const unsigned char* u = (const unsigned char*)s;

    for (size_t i = 0; i < n;)
    {
        unsigned char c = u[i];
        switch (c)
        {
            case '"': out += "\\\""; i++; continue;
            case '\\': out += "\\\\"; i++; continue;
            case '\b': out += "\\b"; i++; continue;
            case '\f': out += "\\f"; i++; continue;
            case '\n': out += "\\n"; i++; continue;
            case '\r': out += "\\r"; i++; continue;
            case '\t': out += "\\t"; i++; continue;
        }
        if (c < 0x20)
        {
            appendEscapedByte(out, c);
            i++;
        }
        else if (c < 0x80)
        {
            out += char(c);
            i++;
        }
        else
        {
            size_t len = utf8Sequence(u + i, n - i);
            if (len)
            {
                out.append(s + i, len);
                i += len;
            }
            else
            {
                appendEscapedByte(out, c);
                i++;
            }
        }
    }

    out += '"';
    return out;
}

std::string quoted(const std::string& s)
{
    return quoted(s.data(), s.size());
}

std::string realText(double d)
{
    if (!std::isfinite(d))
        return "null";

    char buf[64];
    std::to_chars_result r = std::to_chars(buf, buf + sizeof(buf), d);
    std::string text(buf, r.ptr);
    // A real stays a real when read back.
    if (text.find_first_of(".e") == std::string::npos)
        text += ".0";
    return text;
}

std::string scalarText(const Json::Value& v)
{
    switch (v.type())
    {
        case Json::nullValue:
            return "null";
        case Json::intValue:
            return std::to_string(v.asLargestInt());
        case Json::uintValue:
            return std::to_string(v.asLargestUInt());
        case Json::realValue:
            return realText(v.asDouble());
        case Json::booleanValue:
            return v.asBool() ? "true" : "false";
        case Json::stringValue:
        {
            const char* b = 0;
            const char* e = 0;
            if (v.getString(&b, &e))
                return quoted(b, size_t(e - b));
            return "\"\"";
        }
        default:
            return std::string();
    }
}

// Keys in ascending byte order, whatever order the package keeps them in.
std::vector<std::string> sortedKeys(const Json::Value& object)
{
    std::vector<std::string> keys = object.getMemberNames();
    std::sort(keys.begin(), keys.end(),
        [](const std::string& a, const std::string& b)
        {
            int c = memcmp(a.data(), b.data(), std::min(a.size(), b.size()));
            return c != 0 ? c < 0 : a.size() < b.size();
        });
    return keys;
}

class Styled
{
public:
    std::string write(const Json::Value& root)
    {
        _out.clear();
        _indent.clear();
        value(root);
        _out += '\n';
        return _out;
    }

private:
    std::string _out;
    std::string _indent;

    // A value starts right after "key : " or an indentation, and on a new
    // line otherwise.
    void newLine()
    {
        if (!_out.empty())
        {
            char last = _out.back();
            if (last == ' ')
                return;
            if (last != '\n')
                _out += '\n';
        }
        _out += _indent;
    }

    void value(const Json::Value& v)
    {
        if (v.isObject())
            object(v);
        else if (v.isArray())
            array(v);
        else
            _out += scalarText(v);
    }

    void object(const Json::Value& v)
    {
        std::vector<std::string> keys = sortedKeys(v);
        if (keys.empty())
        {
            _out += "{}";
            return;
        }

        newLine();
        _out += '{';
        _indent += INDENT;
        for (size_t i = 0; i < keys.size(); i++)
        {
            newLine();
            _out += quoted(keys[i]);
            _out += " : ";
            value(v[keys[i]]);
            if (i + 1 < keys.size())
                _out += ',';
        }
        _indent.resize(_indent.size() - strlen(INDENT));
        newLine();
        _out += '}';
    }

    // Plain values (and empty containers) go on one line when "[ a, b ]"
    // stays within the margin.
    bool oneLine(const Json::Value& v, std::vector<std::string>& items)
    {
        Json::ArrayIndex n = v.size();
        if (size_t(n) * 3 >= RIGHT_MARGIN)
            return false;
        for (Json::ArrayIndex i = 0; i < n; i++)
        {
            const Json::Value& e = v[i];
            if ((e.isArray() || e.isObject()) && e.size() > 0)
                return false;
        }

        size_t length = 4 + (n - 1) * 2;
        items.reserve(n);
        for (Json::ArrayIndex i = 0; i < n; i++)
        {
            const Json::Value& e = v[i];
            if (e.isArray())
                items.push_back("[]");
            else if (e.isObject())
                items.push_back("{}");
            else
                items.push_back(scalarText(e));
            length += items.back().size();
        }
        return length < RIGHT_MARGIN;
    }

    void array(const Json::Value& v)
    {
        Json::ArrayIndex n = v.size();
        if (n == 0)
        {
            _out += "[]";
            return;
        }

        std::vector<std::string> items;
        if (oneLine(v, items))
        {
            _out += "[ ";
            for (size_t i = 0; i < items.size(); i++)
            {
                if (i)
                    _out += ", ";
                _out += items[i];
            }
            _out += " ]";
            return;
        }

        newLine();
        _out += '[';
        _indent += INDENT;
        for (Json::ArrayIndex i = 0; i < n; i++)
        {
            newLine();
            if (i < items.size())
                _out += items[i];
            else
                value(v[i]);
            if (i + 1 < n)
                _out += ',';
        }
        _indent.resize(_indent.size() - strlen(INDENT));
        newLine();
        _out += ']';
    }
};

// ------------------------------------------------------------------ reading

// JsonCpp's reader gives up beyond 1000 levels by throwing; stop well before.
const int MAX_DEPTH = 512;

class SyntaxCheck
{
public:
    explicit SyntaxCheck(const std::string& text)
        : _begin(text.data()), _p(text.data()), _end(text.data() + text.size()) { }

    bool run()
    {
        if (!blank() || !value(0) || !blank())
            return false;
        if (_p != _end)
            return fail(_p, "Extra non-whitespace after JSON value.");
        return true;
    }

    const std::string& message() const { return _message; }

private:
    const char* _begin;
    const char* _p;
    const char* _end;
    std::string _message;

    bool fail(const char* at, const std::string& what)
    {
        int line = 1;
        const char* lineStart = _begin;
        for (const char* c = _begin; c < at; c++)
        {
            if (*c == '\n' || (*c == '\r' && (c + 1 == _end || c[1] != '\n')))
            {
                line++;
                lineStart = c + 1;
            }
        }
        char where[64];
        snprintf(where, sizeof(where), "* Line %d, Column %d\n  ", line, int(at - lineStart) + 1);
        _message = where + what + "\n";
        return false;
    }

    // Blanks and comments.
    bool blank()
    {
        while (_p < _end)
        {
            char c = *_p;
            if (c == ' ' || c == '\t' || c == '\n' || c == '\r')
                _p++;
            else if (c == '/' && _p + 1 < _end && _p[1] == '*')
            {
                const char* start = _p;
                _p += 2;
                while (_p + 1 < _end && !(_p[0] == '*' && _p[1] == '/'))
                    _p++;
                if (_p + 1 >= _end)
                    return fail(start, "Missing '*/' at the end of a comment");
                _p += 2;
            }
            else if (c == '/' && _p + 1 < _end && _p[1] == '/')
            {
                while (_p < _end && *_p != '\n' && *_p != '\r')
                    _p++;
            }
            else
                break;
        }
        return true;
    }

    bool value(int depth)
    {
        if (_p == _end)
            return fail(_p, "Syntax error: value, object or array expected.");

        switch (*_p)
        {
            case '{':
                return object(depth + 1);
            case '[':
                return array(depth + 1);
            case '"':
                return string();
            case 't':
                return literal("true");
            case 'f':
                return literal("false");
            case 'n':
                return literal("null");
        }
        if (*_p == '-' || (*_p >= '0' && *_p <= '9'))
            return number();
        return fail(_p, "Syntax error: value, object or array expected.");
    }

    bool literal(const char* word)
    {
        size_t n = strlen(word);
        if (size_t(_end - _p) < n || memcmp(_p, word, n) != 0)
            return fail(_p, "Syntax error: value, object or array expected.");
        _p += n;
        return true;
    }

    static bool digit(char c) { return c >= '0' && c <= '9'; }

    // The run of characters that may belong to a number, checked against
    // the grammar as a whole, as the reader reports it.
    bool number()
    {
        const char* start = _p;
        const char* e = _p;
        while (e < _end && (digit(*e) || *e == '.' || *e == 'e' || *e == 'E' || *e == '+' || *e == '-'))
            e++;

        const char* q = start;
        bool ok = true;
        if (q < e && *q == '-')
            q++;
        if (q < e && *q == '0')
            q++;
        else if (q < e && digit(*q))
            while (q < e && digit(*q))
                q++;
        else
            ok = false;
        if (ok && q < e && *q == '.')
        {
            q++;
            ok = q < e && digit(*q);
            while (q < e && digit(*q))
                q++;
        }
        if (ok && q < e && (*q == 'e' || *q == 'E'))
        {
            q++;
            if (q < e && (*q == '+' || *q == '-'))
                q++;
            ok = q < e && digit(*q);
            while (q < e && digit(*q))
                q++;
        }
        if (!ok || q != e)
            return fail(start, "'" + std::string(start, e) + "' is not a number.");
        _p = e;
        return true;
    }

    static bool hex(char c)
    {
        return digit(c) || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F');
    }

    bool string()
    {
        const char* start = _p++;
        while (_p < _end)
        {
            unsigned char c = (unsigned char)*_p;
            if (c == '"')
            {
                _p++;
                return true;
            }
            if (c == '\\')
            {
                if (_p + 1 >= _end)
                    break;
                char e = _p[1];
                if (e == 'u')
                {
                    for (int i = 2; i < 6; i++)
                        if (_p + i >= _end || !hex(_p[i]))
                            return fail(_p, "Bad unicode escape sequence in string: "
                                "four hexadecimal digits expected.");
                    _p += 6;
                }
                else if (strchr("\"\\/bfnrt", e) && e != '\0')
                    _p += 2;
                else
                    return fail(_p, "Bad escape sequence in string");
            }
            else if (c < 0x20)
                return fail(_p, "Control character in string: it must be written as an escape");
            else
                _p++;
        }
        return fail(start, "Missing '\"' at the end of a string");
    }

    bool object(int depth)
    {
        if (depth > MAX_DEPTH)
            return fail(_p, "Nesting deeper than 512 levels");
        _p++;
        if (!blank())
            return false;
        if (_p < _end && *_p == '}')
        {
            _p++;
            return true;
        }
        for (;;)
        {
            if (_p == _end || *_p != '"')
                return fail(_p, "Missing '}' or object member name");
            if (!string() || !blank())
                return false;
            if (_p == _end || *_p != ':')
                return fail(_p, "Missing ':' after object member name");
            _p++;
            if (!blank() || !value(depth) || !blank())
                return false;
            if (_p < _end && *_p == ',')
            {
                _p++;
                if (!blank())
                    return false;
                continue;
            }
            if (_p < _end && *_p == '}')
            {
                _p++;
                return true;
            }
            return fail(_p, "Missing ',' or '}' in object declaration");
        }
    }

    bool array(int depth)
    {
        if (depth > MAX_DEPTH)
            return fail(_p, "Nesting deeper than 512 levels");
        _p++;
        if (!blank())
            return false;
        if (_p < _end && *_p == ']')
        {
            _p++;
            return true;
        }
        for (;;)
        {
            if (!value(depth) || !blank())
                return false;
            if (_p < _end && *_p == ',')
            {
                _p++;
                if (!blank())
                    return false;
                continue;
            }
            if (_p < _end && *_p == ']')
            {
                _p++;
                return true;
            }
            return fail(_p, "Missing ',' or ']' in array declaration");
        }
    }
};

} // namespace

std::string styledJson(const Json::Value& value)
{
    return Styled().write(value);
}

bool parseJsonText(const std::string& text, Json::Value& root, std::string& errors)
{
    SyntaxCheck check(text);
    if (!check.run())
    {
        errors = check.message();
        return false;
    }

    // What is left to JsonCpp is building the value, and what only it
    // knows: numbers beyond a double, and surrogate pairs. Comments aren't
    // kept: no reply writes them.
    Json::Reader reader;
    try
    {
        if (reader.parse(text, root, false))
            return true;
        errors = reader.getFormattedErrorMessages();
    }
    catch (const std::exception& e)
    {
        errors = std::string("* Line 1, Column 1\n  ") + e.what() + "\n";
    }
    root = Json::Value();
    return false;
}

} // namespace OLMA
