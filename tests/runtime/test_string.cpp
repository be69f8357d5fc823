#include <gtest/gtest.h>
#include <string.h>
#include <thread>
#include <vector>
#include "String.h"

using namespace OLMA;

static int refs(const String& s)
{
    return __atomic_load_n(&s._rep->refs, __ATOMIC_SEQ_CST);
}

TEST(String, EmptyStringsShareTheStaticRecordAndAreNeverCounted)
{
    String a, b("", (size_t)0), c(""), d(nullptr);
    EXPECT_EQ(a._rep, &String::_empty);
    EXPECT_EQ(b._rep, &String::_empty);
    EXPECT_EQ(c._rep, &String::_empty);
    EXPECT_EQ(d._rep, &String::_empty);
    {
        String e(a), f;
        f = e;
        f.clear();
        String g("x");
        g.clear();
        EXPECT_EQ(g.size(), 0u);
    }
    EXPECT_EQ(String::_empty.refs, 2);
    EXPECT_STREQ(a.c_str(), "");
    EXPECT_EQ(a.capacity(), 0u);
}

TEST(String, CopiesShareUntilOneIsModified)
{
    String a("hello");
    String b(a);
    EXPECT_EQ(a._rep, b._rep);
    EXPECT_EQ(refs(a), 2);

    b.append(" world");
    EXPECT_NE(a._rep, b._rep);
    EXPECT_STREQ(a.c_str(), "hello");
    EXPECT_STREQ(b.c_str(), "hello world");
    EXPECT_EQ(refs(a), 1);
    EXPECT_EQ(refs(b), 1);

    // Every modifier must copy a shared record first.
    String c(a);
    c.set(0, 'J');
    EXPECT_STREQ(a.c_str(), "hello");
    EXPECT_STREQ(c.c_str(), "Jello");

    String d(a);
    d.remove(1, 3);
    EXPECT_STREQ(a.c_str(), "hello");
    EXPECT_STREQ(d.c_str(), "ho");
    EXPECT_EQ(d.capacity(), a.capacity());

    String e(a);
    e.append('!');
    EXPECT_STREQ(a.c_str(), "hello");
    EXPECT_STREQ(e.c_str(), "hello!");

    String f(a);
    f.assign("bye");
    EXPECT_STREQ(a.c_str(), "hello");
    EXPECT_STREQ(f.c_str(), "bye");

    String g(a);
    g.clear();
    EXPECT_EQ(g._rep, &String::_empty);
    EXPECT_STREQ(a.c_str(), "hello");
    EXPECT_EQ(refs(a), 1);

    String h(a);
    h.reserve(100);
    EXPECT_NE(h._rep, a._rep);
    EXPECT_STREQ(h.c_str(), "hello");
    EXPECT_EQ(h.capacity(), 128u);
}

TEST(String, UnsharedModifiersWorkInPlace)
{
    String a("abc");
    __String_Rep* rep = a._rep;
    a.append('d');
    a.append("ef");
    a.set(0, 'A');
    a.remove(1, 1);
    EXPECT_EQ(a._rep, rep);
    EXPECT_STREQ(a.c_str(), "Acdef");

    a.assign("xy");
    EXPECT_EQ(a._rep, rep);
    EXPECT_EQ(a.size(), 2u);

    a.clear();
    EXPECT_EQ(a._rep, rep);
    EXPECT_EQ(a.size(), 0u);
    EXPECT_STREQ(a.c_str(), "");
    EXPECT_EQ(a.capacity(), 32u);

    // Too big for the record: a new one.
    a.assign(std::string(100, 'y').c_str());
    EXPECT_EQ(a.capacity(), 128u);
}

TEST(String, GrowthFollowsPowersOfTwoFrom32)
{
    EXPECT_EQ(String("a").capacity(), 32u);
    EXPECT_EQ(String(std::string(32, 'a').c_str()).capacity(), 32u);
    EXPECT_EQ(String(std::string(33, 'a').c_str()).capacity(), 64u);
    EXPECT_EQ(String(std::string(64, 'a').c_str()).capacity(), 64u);
    EXPECT_EQ(String(std::string(65, 'a').c_str()).capacity(), 128u);
    EXPECT_EQ(String("ab", "cd", "ef").capacity(), 32u);

    String s(std::string(32, 'a').c_str());
    s.append('b');
    EXPECT_EQ(s.capacity(), 64u);
    EXPECT_EQ(s.size(), 33u);

    String e;
    e.append('x');
    EXPECT_EQ(e.capacity(), 32u);

    String t(std::string(31, 'a').c_str());
    t.append("bc");
    EXPECT_EQ(t.capacity(), 64u);
    t.append(std::string(100, 'z').c_str());
    EXPECT_EQ(t.size(), 133u);
    EXPECT_EQ(t.capacity(), 256u);

    String r("abc");
    r.reserve(10);
    EXPECT_EQ(r.capacity(), 32u);
    r.reserve(33);
    EXPECT_EQ(r.capacity(), 64u);
    EXPECT_STREQ(r.c_str(), "abc");
}

TEST(String, AppendingFromItselfSurvivesReallocation)
{
    String s(std::string(32, 'a').c_str());
    s.append(s);
    EXPECT_EQ(s.size(), 64u);
    EXPECT_EQ(std::string(s.c_str()), std::string(64, 'a'));

    String t("abcd");
    for (int i = 0; i < 5; i++)
        t.append(t.c_str(), t.size());
    EXPECT_EQ(t.size(), 128u);
    EXPECT_EQ(t.find("dabc"), 3u);

    String u("0123456789");
    u.assign(u.c_str() + 2, 3);
    EXPECT_STREQ(u.c_str(), "234");
}

TEST(String, ConstructorsAndSubstr)
{
    EXPECT_STREQ(String("a", "b").c_str(), "ab");
    EXPECT_STREQ(String("a", "b", "c").c_str(), "abc");
    EXPECT_STREQ(String("abcdef", 3).c_str(), "abc");

    String s("hello world");
    EXPECT_STREQ(s.substr(6).c_str(), "world");
    EXPECT_STREQ(s.substr(0, 5).c_str(), "hello");
    EXPECT_STREQ(s.substr(6, 100).c_str(), "world");
    EXPECT_EQ(s.substr(11).size(), 0u);
    EXPECT_EQ(s.substr(50).size(), 0u);

    // Out-of-range positions leave the text alone.
    s.remove(20, 2);
    s.set(20, 'x');
    EXPECT_STREQ(s.c_str(), "hello world");
    s.remove(5);
    EXPECT_STREQ(s.c_str(), "hello");
}

TEST(String, FindAndCompare)
{
    String s("abcabc");
    EXPECT_EQ(s.find('c'), 2u);
    EXPECT_EQ(s.find('c', 3), 5u);
    EXPECT_EQ(s.find('c', 6), (size_t)-1);
    EXPECT_EQ(s.find('z'), (size_t)-1);
    EXPECT_EQ(s.find("ca"), 2u);
    EXPECT_EQ(s.find(String("bc")), 1u);
    EXPECT_EQ(s.find("abcabcd"), (size_t)-1);
    EXPECT_EQ(s.find(""), 0u);

    EXPECT_TRUE(s.equal("abcabc"));
    EXPECT_FALSE(s.equal("abcab"));
    EXPECT_TRUE(s.equal("abcx", 3) == false);
    EXPECT_TRUE(s.equal(3, "abc", 3));
    EXPECT_FALSE(s.equal(4, "abc", 3));
    EXPECT_FALSE(s.equal(7, "", 0));

    String a("abc");
    EXPECT_TRUE(a.equali("ABC"));
    EXPECT_FALSE(a.equali("ABCD"));
    EXPECT_FALSE(a.equali("abd"));
    EXPECT_TRUE(a.equali(String("aBc")));
    EXPECT_FALSE(a.equal("ABC"));
    // Only ASCII letters fold: '@' and '`' sit next to 'A' and 'a'.
    EXPECT_FALSE(String("@").equali("`"));

    String n("a\0b", 3);
    EXPECT_EQ(n.size(), 3u);
    EXPECT_EQ(n.find('b'), 2u);
    EXPECT_FALSE(n.equal("a"));
}

// Threads that copy, append to and drop copies of one shared value must
// neither corrupt it nor leak or double-free its record.
TEST(String, SharedRepresentationAcrossThreads)
{
    const String shared("shared text");
    std::vector<std::thread> threads;

    for (int t = 0; t < 8; t++)
    {
        threads.emplace_back([&shared, t]() {
            for (int i = 0; i < 20000; i++)
            {
                String a(shared);
                String b;
                b = a;
                if (i % 3 == 0)
                    b.append('x');
                else if (i % 3 == 1)
                    b.set(0, 'S');
                String c(b);
                c.clear();
                ASSERT_STREQ(a.c_str(), "shared text");
                (void)t;
            }
        });
    }

    for (auto& t : threads)
        t.join();

    EXPECT_EQ(refs(shared), 1);
    EXPECT_STREQ(shared.c_str(), "shared text");
}
