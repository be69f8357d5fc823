// The stand-in is as strict as the strictest server about CMPI objects:
// containers keep the pointers they are given and read them late, and any
// use of a released object aborts with a message that names it.

#include <cstring>

#include <gtest/gtest.h>

#include "cimhost.h"
#include "cmpimacs.h"

using namespace OLMA::cimhost;

namespace
{

class CimhostStrict : public ::testing::Test
{
protected:
    void SetUp() override
    {
        Options o;
        o.module_path = TESTPROV_MODULE;
        o.reg_path = TESTPROV_REG;
        host.reset(new Host(o));
        ASSERT_TRUE(host->ok()) << host->error();
        mb = host->broker();
    }

    CMPIObjectPath* widget_path(const char* name)
    {
        CMPIObjectPath* op = CMNewObjectPath(mb, "root/test", "Test_Widget", NULL);
        CMAddKey(op, "Name", name, CMPI_chars);
        return op;
    }

    // An instance whose Tags array holds one string, which is handed back.
    CMPIInstance* tagged(CMPIString*& tag)
    {
        CMPIInstance* ci = CMNewInstance(mb, widget_path("w"), NULL);
        CMPIArray* tags = CMNewArray(mb, 1, CMPI_string, NULL);
        tag = CMNewString(mb, "red", NULL);
        CMSetArrayElementAt(tags, 0, &tag, CMPI_string);
        CMSetProperty(ci, "Tags", &tags, CMPI_stringA);
        return ci;
    }

    static std::string text(const CMPIData& d)
    {
        return d.value.string ? CMGetCharsPtr(d.value.string, NULL) : "(null)";
    }

    std::unique_ptr<Host> host;
    const CMPIBroker* mb = nullptr;
};

} // namespace

TEST_F(CimhostStrict, ContainersReadWhatTheyPointToWhenTheyAreRead)
{
    // Text given as CMPI_chars is copied at once.
    char name[] = "first";
    CMPIInstance* ci = CMNewInstance(mb, widget_path("w"), NULL);
    CMSetProperty(ci, "Note", name, CMPI_chars);
    strcpy(name, "other");
    CMPIData note = CMGetProperty(ci, "Note", NULL);
    EXPECT_EQ(CMPI_string, note.type);
    EXPECT_EQ("first", text(note));

    // A path given by its pointer is read when the instance is: a key added
    // afterwards shows.
    CMPIObjectPath* assoc = CMNewObjectPath(mb, "root/test", "Test_WidgetGadget", NULL);
    CMPIInstance* link = CMNewInstance(mb, assoc, NULL);
    CMPIObjectPath* widget = widget_path("early");
    CMSetProperty(link, "Widget", &widget, CMPI_ref);
    CMAddKey(widget, "Name", "late", CMPI_chars);
    CMPIData ref = CMGetProperty(link, "Widget", NULL);
    ASSERT_EQ(CMPI_ref, ref.type);
    EXPECT_EQ("late", text(CMGetKey(ref.value.ref, "Name", NULL)));

    // Released, an object no longer counts as live. Releasing a container
    // leaves what it held.
    size_t live = host->live_objects();
    CMPIString* tag;
    CMPIInstance* ci2 = tagged(tag);
    CMRelease(ci2);
    EXPECT_STREQ("red", CMGetCharsPtr(tag, NULL));
    EXPECT_EQ(live + 3, host->live_objects());   // the path, array and string remain
}

TEST_F(CimhostStrict, AReleasedObjectAbortsWhereverItIsUsed)
{
    // Read through the containers that kept it.
    EXPECT_DEATH(
        {
            CMPIString* tag;
            CMPIInstance* ci = tagged(tag);
            CMRelease(tag);
            CMGetProperty(ci, "Tags", NULL);
        },
        "use after release: CMGetProperty > CMPIInstance of Test_Widget > Tags > "
        "CMPIArray of string > element 0 -> CMPIString \"red\"");

    EXPECT_DEATH(
        {
            CMPIObjectPath* op = CMNewObjectPath(mb, "root/test", "Test_Widget", NULL);
            CMPIString* name = CMNewString(mb, "w1", NULL);
            CMAddKey(op, "Name", &name, CMPI_string);
            CMRelease(name);
            CMObjectPathToString(op, NULL);
        },
        "CMPIObjectPath root/test:Test_Widget > key Name -> CMPIString \"w1\"");

    // Used directly, handed to a container, or released again.
    EXPECT_DEATH(
        {
            CMPIString* s = CMNewString(mb, "gone", NULL);
            CMRelease(s);
            CMGetCharsPtr(s, NULL);
        },
        "use after release: .* -> CMPIString \"gone\"");
    EXPECT_DEATH(
        {
            CMPIArray* a = CMNewArray(mb, 2, CMPI_uint8, NULL);
            CMPIInstance* ci = CMNewInstance(mb, widget_path("w"), NULL);
            CMRelease(a);
            CMSetProperty(ci, "Tags", &a, CMPI_uint8A);
        },
        "CMSetProperty of Tags -> CMPIArray uint8\\[2\\]");
    EXPECT_DEATH(
        {
            CMPIInstance* ci = CMNewInstance(mb, widget_path("w"), NULL);
            CMRelease(ci);
            CMRelease(ci);
        },
        "released twice.* -> CMPIInstance of root/test:Test_Widget");
}
