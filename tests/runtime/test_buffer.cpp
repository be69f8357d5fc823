#include <gtest/gtest.h>
#include <string>
#include "Buffer.h"

using namespace OLMA;

TEST(Buffer, ZeroedObjectIsEmpty)
{
    Buffer b;
    EXPECT_EQ(b.size(), 0u);
    EXPECT_EQ(b.capacity(), 0u);
    EXPECT_STREQ(b.c_str(), "");
}

TEST(Buffer, GrowthRules)
{
    Buffer a;
    a.append('x');
    EXPECT_EQ(a.capacity(), 4096u);
    for (int i = 1; i < 4096; i++)
        a.append('x');
    EXPECT_EQ(a.capacity(), 4096u);
    a.append('y');
    EXPECT_EQ(a.capacity(), 8192u);
    EXPECT_EQ(a.size(), 4097u);

    Buffer r;
    r.reserve(10);
    EXPECT_EQ(r.capacity(), 4096u);
    r.reserve(5000);
    EXPECT_EQ(r.capacity(), 5000u);
    r.reserve(100);
    EXPECT_EQ(r.capacity(), 5000u);

    // Inserting past the capacity rounds up to a power of two.
    Buffer i;
    std::string big(5000, 'b');
    i.insert(0, big.data(), big.size());
    EXPECT_EQ(i.capacity(), 8192u);
    EXPECT_EQ(i.size(), 5000u);
}

TEST(Buffer, InsertAndRemove)
{
    Buffer b;
    b.append("held", 4);
    b.insert(2, "XY", 2);
    EXPECT_STREQ(b.c_str(), "heXYld");
    b.insert(0, ">", 1);
    b.insert(100, "<", 1);
    EXPECT_STREQ(b.c_str(), ">heXYld<");
    b.remove(3, 2);
    EXPECT_STREQ(b.c_str(), ">held<");
    b.remove(4, 100);
    EXPECT_STREQ(b.c_str(), ">hel");
    b.remove(10, 1);
    EXPECT_STREQ(b.c_str(), ">hel");

    // Sources inside the buffer itself, with and without growth.
    b.insert(1, b.data() + 1, 3);
    EXPECT_STREQ(b.c_str(), ">helhel");
    std::string big(4090, 'q');
    b.append(big.data(), big.size());
    b.append(b.data(), b.size());
    EXPECT_EQ(b.size(), 2 * (7 + 4090u));
    EXPECT_EQ(std::string(b.data(), 7), ">helhel");
    EXPECT_EQ(std::string(b.data() + 4097, 7), ">helhel");
}

TEST(Buffer, FormatAppendsAndGrows)
{
    Buffer b;
    EXPECT_EQ(b.format("%s=%d", "x", 42), 4);
    EXPECT_STREQ(b.c_str(), "x=42");

    // Longer than the first 128 bytes of space.
    std::string big(5000, 'z');
    EXPECT_EQ(b.format("[%s]", big.c_str()), 5002);
    EXPECT_EQ(b.size(), 5006u);
    EXPECT_EQ(std::string(b.c_str()), "x=42[" + big + "]");

    b.append_uint16(65535);
    b.append(' ');
    b.append_uint32(7);
    b.append(' ');
    b.append_uint64(18446744073709551615ULL);
    EXPECT_EQ(std::string(b.data() + 5006, b.size() - 5006), "65535 7 18446744073709551615");

    Buffer c(b), d;
    d = c;
    EXPECT_EQ(std::string(d.c_str()), std::string(b.c_str()));
}

static std::string dump_of(const Buffer& b)
{
    testing::internal::CaptureStdout();
    b.dump();
    return testing::internal::GetCapturedStdout();
}

TEST(Buffer, DumpLayout)
{
    Buffer b;
    b.append("ABCDEFGHIJKLMNOP\x01\xff" "q", 19);
    std::string out = dump_of(b);
    EXPECT_EQ(out,
        " >41424344 45464748 494A4B4C 4D4E4F50< ABCDEFGHIJKLMNOP 00000000\n"
        " >01FF71<                              ..q              00000010\n");

    size_t nl = out.find('\n');
    EXPECT_EQ(nl, 64u);
    EXPECT_EQ(out[37], '<');

    Buffer four;
    four.append("abcd", 4);
    std::string line = dump_of(four);
    EXPECT_EQ(line.substr(0, 13), " >61626364 < ");
    EXPECT_EQ(line.substr(39, 4), "abcd");
}
