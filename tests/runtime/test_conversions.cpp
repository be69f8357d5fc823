#include <gtest/gtest.h>
#include <math.h>
#include <stdlib.h>
#include <string>
#include "Strings.h"

using namespace OLMA;

// Each conversion must leave its output alone when it fails, so every check
// starts from a sentinel.
template<class T, class F>
static bool converts(F f, const char* text, T expect)
{
    T x = (T)99;
    if (f(text, x) != 0)
        return false;
    return x == expect;
}

template<class T, class F>
static bool fails(F f, const char* text)
{
    T x = (T)99;
    return f(text, x) == -1 && x == (T)99;
}

TEST(Conversions, Uint64DecimalAndHex)
{
    EXPECT_TRUE(converts<uint64>(str_to_uint64, "0", 0));
    EXPECT_TRUE(converts<uint64>(str_to_uint64, "0123", 123));
    EXPECT_TRUE(converts<uint64>(str_to_uint64, "18446744073709551615", ~0ULL));
    EXPECT_TRUE(converts<uint64>(str_to_uint64, "00000000000000000001", 1));  // 20 digits
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "000000000000000000001"));       // 21
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "18446744073709551616"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "99999999999999999999"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, ""));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, nullptr));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, " 1"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "1 "));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "12a"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "12345a"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "+1"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "-1"));

    EXPECT_TRUE(converts<uint64>(str_to_uint64, "0xFF", 255));
    EXPECT_TRUE(converts<uint64>(str_to_uint64, "0XAB", 0xAB));
    EXPECT_TRUE(converts<uint64>(str_to_uint64, "0x0", 0));
    EXPECT_TRUE(converts<uint64>(str_to_uint64, "0xFFFFFFFFFFFFFFFF", ~0ULL));    // 16 digits
    EXPECT_TRUE(converts<uint64>(str_to_uint64, "0x0000000000000001", 1));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "0x00000000000000001"));            // 17
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "0x"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "0X"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "0xff"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "0xFg"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "0xG"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "x1"));
    EXPECT_TRUE(fails<uint64>(str_to_uint64, "00x1"));
}

TEST(Conversions, UnsignedRanges)
{
    EXPECT_TRUE(converts<uint8>(str_to_uint8, "255", 255));
    EXPECT_TRUE(fails<uint8>(str_to_uint8, "256"));
    EXPECT_TRUE(converts<uint8>(str_to_uint8, "0xFF", 255));
    EXPECT_TRUE(fails<uint8>(str_to_uint8, "0xff"));
    EXPECT_TRUE(fails<uint8>(str_to_uint8, "0x100"));
    EXPECT_TRUE(fails<uint8>(str_to_uint8, "-1"));

    EXPECT_TRUE(converts<uint16>(str_to_uint16, "65535", 65535));
    EXPECT_TRUE(fails<uint16>(str_to_uint16, "65536"));
    EXPECT_TRUE(converts<uint16>(str_to_uint16, "0xFFFF", 65535));

    EXPECT_TRUE(converts<uint32>(str_to_uint32, "4294967295", 4294967295u));
    EXPECT_TRUE(fails<uint32>(str_to_uint32, "4294967296"));
    EXPECT_TRUE(fails<uint32>(str_to_uint32, "0x100000000"));
}

TEST(Conversions, SignedRanges)
{
    EXPECT_TRUE(converts<sint8>(str_to_sint8, "-128", -128));
    EXPECT_TRUE(fails<sint8>(str_to_sint8, "-129"));
    EXPECT_TRUE(converts<sint8>(str_to_sint8, "127", 127));
    EXPECT_TRUE(converts<sint8>(str_to_sint8, "+127", 127));
    EXPECT_TRUE(fails<sint8>(str_to_sint8, "128"));
    EXPECT_TRUE(converts<sint8>(str_to_sint8, "-0x80", -128));

    EXPECT_TRUE(converts<sint16>(str_to_sint16, "-32768", -32768));
    EXPECT_TRUE(fails<sint16>(str_to_sint16, "-32769"));
    EXPECT_TRUE(converts<sint16>(str_to_sint16, "32767", 32767));
    EXPECT_TRUE(fails<sint16>(str_to_sint16, "32768"));

    EXPECT_TRUE(converts<sint32>(str_to_sint32, "-2147483648", INT32_MIN));
    EXPECT_TRUE(fails<sint32>(str_to_sint32, "-2147483649"));
    EXPECT_TRUE(converts<sint32>(str_to_sint32, "2147483647", INT32_MAX));
    EXPECT_TRUE(fails<sint32>(str_to_sint32, "2147483648"));

    EXPECT_TRUE(converts<sint64>(str_to_sint64, "-9223372036854775808", INT64_MIN));
    EXPECT_TRUE(fails<sint64>(str_to_sint64, "-9223372036854775809"));
    EXPECT_TRUE(converts<sint64>(str_to_sint64, "9223372036854775807", INT64_MAX));
    EXPECT_TRUE(fails<sint64>(str_to_sint64, "9223372036854775808"));
    EXPECT_TRUE(converts<sint64>(str_to_sint64, "-0x8000000000000000", INT64_MIN));
    EXPECT_TRUE(fails<sint64>(str_to_sint64, "0x8000000000000000"));
    EXPECT_TRUE(converts<sint64>(str_to_sint64, "-0", 0));
    EXPECT_TRUE(fails<sint64>(str_to_sint64, "-"));
    EXPECT_TRUE(fails<sint64>(str_to_sint64, "+"));
    EXPECT_TRUE(fails<sint64>(str_to_sint64, "--1"));
    EXPECT_TRUE(fails<sint64>(str_to_sint64, "+-1"));
    EXPECT_TRUE(fails<sint64>(str_to_sint64, ""));
}

TEST(Conversions, RealShape)
{
    EXPECT_TRUE(converts<real64>(str_to_real64, "1.5", 1.5));
    EXPECT_TRUE(converts<real64>(str_to_real64, "-.5", -0.5));
    EXPECT_TRUE(converts<real64>(str_to_real64, "+0.25", 0.25));
    EXPECT_TRUE(converts<real64>(str_to_real64, "1.0e+3", 1000.0));
    EXPECT_TRUE(converts<real64>(str_to_real64, "2.5E-1", 0.25));
    EXPECT_TRUE(converts<real64>(str_to_real64, "1.0e3", 1000.0));

    const char* bad[] = { "1", "1.", "1e3", ".", "-.", "", "1.0e", "1.0e+",
        "1.5x", " 1.5", "1.5 ", "0x1.0", "inf", "nan", "1..5", "1.0e3.0",
        "--1.0", "1.0e999" };
    for (const char* text : bad)
    {
        EXPECT_TRUE(fails<real64>(str_to_real64, text)) << text;
        EXPECT_TRUE(fails<real32>(str_to_real32, text)) << text;
    }

    EXPECT_TRUE(converts<real32>(str_to_real32, "0.1", 0.1f));
    EXPECT_TRUE(fails<real32>(str_to_real32, "1.0e39"));
    EXPECT_TRUE(converts<real64>(str_to_real64, "1.0e39", 1.0e39));
}

TEST(Conversions, Boolean)
{
    EXPECT_TRUE(converts<boolean>(str_to_boolean, "TRUE", true));
    EXPECT_TRUE(converts<boolean>(str_to_boolean, "true", true));
    EXPECT_TRUE(converts<boolean>(str_to_boolean, "FaLsE", false));
    boolean x = true;
    EXPECT_EQ(str_to_boolean("T", x), -1);
    EXPECT_EQ(str_to_boolean("1", x), -1);
    EXPECT_EQ(str_to_boolean("truex", x), -1);
    EXPECT_EQ(str_to_boolean("", x), -1);
    EXPECT_TRUE(x);
}

TEST(Conversions, IntegerToText)
{
    char buffer[22];
    size_t n = 0;

    const char* s = uint8_to_str(buffer, 127, n);
    EXPECT_STREQ(s, "127");
    EXPECT_EQ(n, 3u);
    EXPECT_FALSE(s >= buffer && s < buffer + 22);

    s = uint8_to_str(buffer, 128, n);
    EXPECT_STREQ(s, "128");
    EXPECT_TRUE(s >= buffer && s < buffer + 22);
    EXPECT_EQ(buffer[21], '\0');

    EXPECT_STREQ(uint8_to_str(buffer, 0, n), "0");
    EXPECT_EQ(n, 1u);
    EXPECT_STREQ(sint8_to_str(buffer, -128, n), "-128");
    EXPECT_EQ(n, 4u);
    EXPECT_STREQ(sint8_to_str(buffer, -1, n), "-1");
    EXPECT_STREQ(uint16_to_str(buffer, 65535, n), "65535");
    EXPECT_STREQ(sint16_to_str(buffer, -32768, n), "-32768");
    EXPECT_STREQ(uint32_to_str(buffer, 4294967295u, n), "4294967295");
    EXPECT_STREQ(sint32_to_str(buffer, INT32_MIN, n), "-2147483648");
    EXPECT_STREQ(uint64_to_str(buffer, ~0ULL, n), "18446744073709551615");
    EXPECT_EQ(n, 20u);
    EXPECT_STREQ(sint64_to_str(buffer, INT64_MIN, n), "-9223372036854775808");
    EXPECT_EQ(n, 20u);

    // Every small number from the table round-trips.
    for (unsigned i = 0; i < 300; i++)
    {
        uint16 back = 0;
        const char* t = uint16_to_str(buffer, (uint16)i, n);
        ASSERT_EQ(strlen(t), n);
        ASSERT_EQ(str_to_uint16(t, back), 0);
        ASSERT_EQ(back, i);
    }
}

TEST(Conversions, TypeNames)
{
    for (int i = 0; i < NUM_TYPES; i++)
    {
        Type t = BOOLEAN;
        EXPECT_EQ(type_name_to_type(type_name[i], t), 0);
        EXPECT_EQ(t, i);
        EXPECT_EQ(type_size[i], literal_type_size[i]);
    }

    Type t = STRING;
    EXPECT_EQ(type_name_to_type("UINT32", t), 0);
    EXPECT_EQ(t, UINT32);
    EXPECT_EQ(type_name_to_type("SInt64", t), 0);
    EXPECT_EQ(t, SINT64);
    EXPECT_EQ(type_name_to_type("sint32", t), 0);
    EXPECT_EQ(t, SINT32);
    EXPECT_EQ(type_name_to_type("DateTime", t), 0);
    EXPECT_EQ(t, DATETIME);

    t = CHAR16;
    // Same hash as a real name but a different text.
    EXPECT_EQ(type_name_to_type("xint32", t), -1);
    EXPECT_EQ(type_name_to_type("uint", t), -1);
    EXPECT_EQ(type_name_to_type("", t), -1);
    EXPECT_EQ(type_name_to_type("real", t), -1);
    EXPECT_EQ(type_name_to_type(nullptr, t), -1);
    EXPECT_EQ(t, CHAR16);
}

TEST(Conversions, StrlcpyStrlcat)
{
    char b[8];
    EXPECT_EQ(strlcpy(b, "hello world", sizeof(b)), 11u);
    EXPECT_STREQ(b, "hello w");
    EXPECT_EQ(strlcpy(b, "hi", sizeof(b)), 2u);
    EXPECT_STREQ(b, "hi");
    EXPECT_EQ(strlcat(b, "there!", sizeof(b)), 8u);
    EXPECT_STREQ(b, "hithere");
    EXPECT_EQ(strlcat(b, "x", sizeof(b)), 8u);
    EXPECT_STREQ(b, "hithere");

    char z[1] = { 'q' };
    EXPECT_EQ(strlcpy(z, "abc", 0), 3u);
    EXPECT_EQ(z[0], 'q');
    char full[4] = { 'a', 'b', 'c', 'd' };
    EXPECT_EQ(strlcat(full, "xy", sizeof(full)), 6u);
    EXPECT_EQ(full[3], 'd');
}

TEST(Conversions, FindToken)
{
    const char* start = nullptr;
    const char* end = nullptr;
    const char* text = "  ,alpha, beta";
    ASSERT_EQ(find_token(text, " ,", start, end), 0);
    EXPECT_EQ(std::string(start, end), "alpha");
    ASSERT_EQ(find_token(end, " ,", start, end), 0);
    EXPECT_EQ(std::string(start, end), "beta");
    EXPECT_EQ(*end, '\0');
    EXPECT_EQ(find_token(end, " ,", start, end), -1);
    EXPECT_EQ(find_token(" , ", " ,", start, end), -1);
}

TEST(Conversions, PrintfHelpers)
{
    char* p = str_printf("%s-%d", "a", 7);
    ASSERT_NE(p, nullptr);
    EXPECT_STREQ(p, "a-7");
    free(p);

    std::string big(3000, 'k');
    String s = string_printf("<%s>", big.c_str());
    EXPECT_EQ(s.size(), 3002u);

    testing::internal::CaptureStdout();
    iprintf(2, "x%d\n", 1);
    iprintf(0, "y\n");
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "        x1\ny\n");
}

TEST(Conversions, LiteralPrinting)
{
    testing::internal::CaptureStdout();
    print_string("a\"b\tc\nd\fe\rf\\g");
    EXPECT_EQ(testing::internal::GetCapturedStdout(),
        "\"a\\\"b\\tc\\nd\\fe\\rf\\g\"");

    uint8 yes = 1;
    sint16 neg = -5;
    uint64 big = ~0ULL;
    sint64 small = INT64_MIN;
    real64 r = 1.5;
    char16 c = 65;
    testing::internal::CaptureStdout();
    print_scalar(BOOLEAN, &yes);
    print_scalar(SINT16, &neg);
    print_scalar(UINT64, &big);
    print_scalar(SINT64, &small);
    print_scalar(REAL64, &r);
    print_scalar(CHAR16, &c);
    print_scalar(STRING, "s");
    print_scalar(DATETIME, "00000000000000.000000:000");
    EXPECT_EQ(testing::internal::GetCapturedStdout(),
        "true-518446744073709551615-92233720368547758081.50000065\"s\""
        "00000000000000.000000:000");

    uint32 nums[] = { 1, 2, 3 };
    const char* texts[] = { "x", "y" };
    real32 reals[] = { 0.5f };
    testing::internal::CaptureStdout();
    print_array(UINT32, nums, 3);
    printf("|");
    print_array(STRING, texts, 2);
    printf("|");
    print_array(REAL32, reals, 1);
    printf("|");
    print_array(UINT8, nullptr, 0);
    EXPECT_EQ(testing::internal::GetCapturedStdout(),
        "1, 2, 3|\"x\", \"y\"|0.500000|");
}
