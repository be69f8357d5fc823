#include <gtest/gtest.h>
#include <math.h>
#include "Array.h"

using namespace OLMA;

TEST(Array, CapacityRules)
{
    Array<uint32> a;
    EXPECT_EQ(a.capacity(), 8u);
    EXPECT_EQ(a.size(), 0u);

    for (uint32 i = 0; i < 8; i++)
        a.append(i);
    EXPECT_EQ(a.capacity(), 8u);
    a.append(8);
    EXPECT_EQ(a.capacity(), 16u);

    a.reserve(17);
    EXPECT_EQ(a.capacity(), 32u);
    a.reserve(4);
    EXPECT_EQ(a.capacity(), 32u);

    // Copies hold exactly their elements.
    Array<uint32> b(a);
    EXPECT_EQ(b.capacity(), 9u);
    Array<uint32> c;
    c = a;
    EXPECT_EQ(c.capacity(), 9u);
    EXPECT_TRUE(a == b && b == c);

    // Growing from an exact capacity still steps through 8, 16, 32...
    b.append(9);
    EXPECT_EQ(b.capacity(), 16u);

    Array<uint32> e;
    e.reserve(100);
    EXPECT_EQ(e.capacity(), 128u);

    uint32 raw[] = { 1, 2, 3 };
    Array<uint32> d(raw, 3);
    EXPECT_EQ(d.capacity(), 3u);
    d.assign(raw, 2);
    EXPECT_EQ(d.capacity(), 2u);
    EXPECT_EQ(d.size(), 2u);
}

TEST(Array, InsertRemoveResizeFind)
{
    Array<sint16> a;
    sint16 v[] = { 1, 2, 3 };
    a.append(v, 3);
    a.prepend(0);
    a.insert(2, (sint16)9);
    ASSERT_EQ(a.size(), 5u);
    EXPECT_EQ(a[0], 0);
    EXPECT_EQ(a[1], 1);
    EXPECT_EQ(a[2], 9);
    EXPECT_EQ(a[3], 2);
    EXPECT_EQ(a[4], 3);

    a.remove(1, 2);
    ASSERT_EQ(a.size(), 3u);
    EXPECT_EQ(a[1], 2);
    EXPECT_EQ(a.find(3), 2u);
    EXPECT_EQ(a.find(9), (size_t)-1);

    a.remove(1, 100);
    EXPECT_EQ(a.size(), 1u);
    a.remove(5);
    EXPECT_EQ(a.size(), 1u);

    a.resize(4);
    a.resize(2);
    EXPECT_EQ(a.size(), 2u);

    // Inserting one's own elements while growing.
    Array<uint8> b;
    for (uint8 i = 0; i < 8; i++)
        b.append(i);
    b.append(b.data(), b.size());
    ASSERT_EQ(b.size(), 16u);
    EXPECT_EQ(b[15], 7);
    b.append(b[0]);
    EXPECT_EQ(b[16], 0);
}

TEST(Array, GrowingPlainElementsZeroesThemWhateverTheValue)
{
    Array<uint32> a;
    a.append(5);
    a.resize(20, 7);    // across a reallocation
    ASSERT_EQ(a.size(), 20u);
    EXPECT_EQ(a[0], 5u);
    for (size_t i = 1; i < a.size(); i++)
        EXPECT_EQ(a[i], 0u) << i;

    // A slot given up by shrinking comes back zeroed, not with its old bytes.
    a[2] = 42;
    a.resize(2);
    a.resize(3, 9);
    EXPECT_EQ(a[2], 0u);

    int x = 1;
    Array<int*> p;
    p.resize(3, &x);
    for (size_t i = 0; i < p.size(); i++)
        EXPECT_EQ(p[i], nullptr);
}

TEST(Array, StringElementsAreCountedNotCopied)
{
    String s("value");
    {
        Array<String> a;
        a.append(s);
        a.append(s);
        EXPECT_EQ(s._rep->refs, 3);
        Array<String> b(a);
        EXPECT_EQ(s._rep->refs, 5);
        b.remove(0);
        EXPECT_EQ(s._rep->refs, 4);
        b.resize(3, String("other"));
        EXPECT_STREQ(b[2].c_str(), "other");
        b.resize(1);
        EXPECT_EQ(s._rep->refs, 4);
        a = b;
        EXPECT_EQ(s._rep->refs, 3);

        // Appending an element of itself across a reallocation.
        Array<String> c;
        for (int i = 0; i < 8; i++)
            c.append(s);
        c.append(c[0]);
        c.resize(20, c[1]);
        EXPECT_EQ(s._rep->refs, 23);
        EXPECT_TRUE(c[19] == "value");
    }
    EXPECT_EQ(s._rep->refs, 1);
}

TEST(Array, Equality)
{
    Array<String> a, b;
    a.append(String("x"));
    b.append(String("x"));
    EXPECT_TRUE(a == b);
    b[0].append('y');
    EXPECT_FALSE(a == b);
    EXPECT_EQ(b.find(String("xy")), 0u);

    Array<real64> r, q;
    r.append(NAN);
    q.append(NAN);
    EXPECT_FALSE(r == q);
    EXPECT_EQ(r.find(NAN), (size_t)-1);

    Array<real32> z1, z2;
    z1.append(0.0f);
    z2.append(-0.0f);
    EXPECT_TRUE(z1 == z2);

    Array<Datetime> d1, d2;
    d1.append(Datetime(5ULL));
    d2.append(Datetime(5ULL, 0));
    EXPECT_FALSE(d1 == d2);
    d2[0].set(5ULL);
    EXPECT_TRUE(d1 == d2);

    Array<uint32> x, y;
    x.append(1);
    EXPECT_FALSE(x == y);
}

TEST(Array, PointerElementsAreRawWords)
{
    struct Foo;
    EXPECT_EQ(__Array_Traits_Factory<Foo*>::traits(),
        __Array_Traits_Factory_Raw<void*>::traits());
    Array<Foo*> a;
    a.append(nullptr);
    a.append(reinterpret_cast<Foo*>(&a));
    EXPECT_EQ(a.find(reinterpret_cast<Foo*>(&a)), 1u);
}

TEST(Array, PtrArrayGrowsByOne)
{
    int x = 1, y = 2;
    int** data = nullptr;
    size_t size = 0;
    append(data, size, &x);
    append(data, size, &y);
    ASSERT_EQ(size, 2u);
    EXPECT_EQ(data[0], &x);
    EXPECT_EQ(data[1], &y);
    free(data);
}
