#include "JsonParams.h"

#include <climits>
#include <cmath>
#include <cstring>
#include <stdexcept>

#include "dtruj.h"
#include "log.h"

namespace OLMA
{

namespace JsonParams
{

namespace
{

const Json::Value& nullValue()
{
    static const Json::Value v;
    return v;
}

} // namespace

std::string readString(const Json::Value& v)
{
    switch (v.type())
    {
        case Json::nullValue:
            return std::string();
        case Json::booleanValue:
            return v.asBool() ? "true" : "false";
        case Json::stringValue:
        {
            // With its length: a text may hold a NUL.
            const char* b = 0;
            const char* e = 0;
            v.getString(&b, &e);
            return b ? std::string(b, e) : std::string();
        }
        default:
            throw std::runtime_error("Type is not convertible to string");
    }
}

int readInt(const Json::Value& v)
{
    switch (v.type())
    {
        case Json::nullValue:
            return 0;
        case Json::booleanValue:
            return v.asBool() ? 1 : 0;
        case Json::intValue:
        {
            Json::LargestInt i = v.asLargestInt();
            if (i < INT_MIN || i > INT_MAX)
                throw std::runtime_error("integer out of signed integer range");
            return int(i);
        }
        case Json::uintValue:
        {
            Json::LargestUInt u = v.asLargestUInt();
            if (u > (Json::LargestUInt)INT_MAX)
                throw std::runtime_error("integer out of signed integer range");
            return int(u);
        }
        case Json::realValue:
        {
            // NaN fails the test too.
            double d = v.asDouble();
            if (!(d >= double(INT_MIN) && d <= double(INT_MAX)))
                throw std::runtime_error("Real out of signed integer range");
            return int(std::trunc(d));
        }
        default:
            throw std::runtime_error("Type is not convertible to int");
    }
}

bool readBool(const Json::Value& v)
{
    switch (v.type())
    {
        case Json::nullValue:
            return false;
        case Json::booleanValue:
            return v.asBool();
        case Json::intValue:
            return v.asLargestInt() != 0;
        case Json::uintValue:
            return v.asLargestUInt() != 0;
        case Json::realValue:
            return v.asDouble() != 0.0;
        case Json::stringValue:
        {
            const char* b = 0;
            const char* e = 0;
            return v.getString(&b, &e) && e != b;
        }
        default:
            return v.size() > 0;
    }
}

const Json::Value& checkArray(const Json::Value& v)
{
    if (!v.isArray() && !v.isNull())
        throw ErrorBadJsonArray();
    return v;
}

const Json::Value& checkObject(const Json::Value& v)
{
    if (!v.isObject() && !v.isNull())
        throw ErrorBadJsonObject();
    return v;
}

void checkCount(const Json::Value& params, unsigned expected, const char* handler)
{
    unsigned actual = params.size();
    if (actual == expected)
        return;
    TLOG(LL_WARN, "No. of Params - Expected : %d, Actual : %d, function : %s ",
        (int)expected, (int)actual, handler);
    throw ErrorParamMismatch();
}

const Json::Value& at(const Json::Value& params, unsigned i)
{
    if (params.isObject())
        throw ErrorBadJsonArray();
    if (!params.isArray() || i >= params.size())
        return nullValue();
    return params[i];
}

const Json::Value& member(const Json::Value& v, const char* name)
{
    if (!v.isObject())
        return nullValue();
    const Json::Value* m = v.find(name, name + strlen(name));
    return m ? *m : nullValue();
}

} // namespace JsonParams

} // namespace OLMA
