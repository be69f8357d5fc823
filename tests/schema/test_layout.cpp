// The tables against the records: every slot where the table says, with its
// null byte right behind the value, and every record extending its parent's.

#include <gtest/gtest.h>
#include <algorithm>
#include <cstddef>
#include <vector>
#include "module.h"

// Records derive from Instance, which is not standard-layout.
#pragma GCC diagnostic ignored "-Winvalid-offsetof"

using namespace OLMA;

namespace
{

struct Slot
{
    uint32 begin;
    uint32 end;
    const char* name;
};

// The bytes that a feature occupies: a reference is one pointer; a property
// its value and the null byte behind it.
Slot slot_of(const Meta_Feature* f)
{
    if (f->flags & FLAG_REFERENCE)
    {
        const Meta_Reference* r = (const Meta_Reference*)f;
        return { r->offset, r->offset + (r->subscript ? 9u : 8u), f->name };
    }
    const Meta_Property* p = (const Meta_Property*)f;
    uint32 null_at = p->offset + (p->subscript ? 8u : type_size[p->type]);
    return { p->offset, null_at + 1, f->name };
}

// Checks that the slots of a record lie behind Instance, inside the record,
// and apart from each other.
void check_slots(const char* name, Meta_Feature* const* features, size_t n, uint32 size)
{
    std::vector<Slot> slots;
    for (size_t i = 0; i < n; i++)
        if (!(features[i]->flags & FLAG_METHOD))
            slots.push_back(slot_of(features[i]));
    std::sort(slots.begin(), slots.end(),
              [](const Slot& a, const Slot& b) { return a.begin < b.begin; });
    uint32 at = sizeof(Instance);
    for (const Slot& s : slots)
    {
        EXPECT_LE(at, s.begin) << name << "." << s.name;
        at = s.end;
    }
    EXPECT_LE(at, size) << name;
}

} // namespace

TEST(Layout, SlotsOfEveryClassAndMethodAreApartAndInside)
{
    const Meta_Repository* mr = repository();
    for (size_t i = 0; i < mr->num_meta_classes; i++)
    {
        const Meta_Class* mc = mr->meta_classes[i];
        check_slots(mc->name, mc->meta_features, mc->num_meta_features, mc->size);
        for (size_t j = 0; j < mc->num_meta_features; j++)
        {
            const Meta_Feature* f = mc->meta_features[j];
            if (f->flags & FLAG_METHOD)
            {
                const Meta_Method* mm = (const Meta_Method*)f;
                check_slots(mm->name, mm->meta_features, mm->num_meta_features, mm->size);
            }
        }
    }
}

TEST(Layout, SubclassRecordExtendsItsParent)
{
    const Meta_Repository* mr = repository();
    for (size_t i = 0; i < mr->num_meta_classes; i++)
    {
        const Meta_Class* mc = mr->meta_classes[i];
        const Meta_Class* parent = mc->super_meta_class;
        if (!parent)
            continue;
        SCOPED_TRACE(mc->name);
        EXPECT_GE(mc->size, parent->size);
        ASSERT_GE(mc->num_meta_features, parent->num_meta_features);
        uint32 parent_end = sizeof(Instance);
        for (size_t j = 0; j < parent->num_meta_features; j++)
        {
            const Meta_Feature* theirs = parent->meta_features[j];
            const Meta_Feature* mine = mc->meta_features[j];
            // Inherited slots stay where the parent has them.
            EXPECT_STREQ(theirs->name, mine->name);
            EXPECT_EQ(theirs->flags & FLAG_ANY_FEATURE, mine->flags & FLAG_ANY_FEATURE);
            if (theirs->flags & FLAG_METHOD)
                continue;
            Slot a = slot_of(theirs), b = slot_of(mine);
            EXPECT_EQ(a.begin, b.begin) << mine->name;
            EXPECT_EQ(a.end, b.end) << mine->name;
            parent_end = std::max(parent_end, a.end);
        }
        // New slots come after all of the parent's.
        for (size_t j = parent->num_meta_features; j < mc->num_meta_features; j++)
            if (!(mc->meta_features[j]->flags & FLAG_METHOD))
            {
                EXPECT_GE(slot_of(mc->meta_features[j]).begin, parent_end) << mc->meta_features[j]->name;
            }
    }
}

TEST(Layout, TableOffsetsAreTheRecordMembers)
{
    const Meta_Class* mc = &VESPERA_FCPort::static_meta_class;
    EXPECT_EQ(sizeof(VESPERA_FCPort), mc->size);
    EXPECT_EQ(sizeof(CIM_FCPort), mc->super_meta_class->size);

    struct Member { const char* name; size_t offset; size_t null_offset; };
    const Member members[] =
    {
        { "InstanceID", offsetof(VESPERA_FCPort, InstanceID), offsetof(VESPERA_FCPort, InstanceID.null) },
        { "DeviceID", offsetof(VESPERA_FCPort, DeviceID), offsetof(VESPERA_FCPort, DeviceID.null) },
        { "OperationalStatus", offsetof(VESPERA_FCPort, OperationalStatus), offsetof(VESPERA_FCPort, OperationalStatus.null) },
        { "InstallDate", offsetof(VESPERA_FCPort, InstallDate), offsetof(VESPERA_FCPort, InstallDate.null) },
        { "Speed", offsetof(VESPERA_FCPort, Speed), offsetof(VESPERA_FCPort, Speed.null) },
        { "PortType", offsetof(VESPERA_FCPort, PortType), offsetof(VESPERA_FCPort, PortType.null) },
        { "PortNumber", offsetof(VESPERA_FCPort, PortNumber), offsetof(VESPERA_FCPort, PortNumber.null) },
        { "PowerManagementSupported", offsetof(VESPERA_FCPort, PowerManagementSupported),
          offsetof(VESPERA_FCPort, PowerManagementSupported.null) },
        { "ErrorCleared", offsetof(VESPERA_FCPort, ErrorCleared), offsetof(VESPERA_FCPort, ErrorCleared.null) },
    };
    for (const Member& m : members)
    {
        const Meta_Property* mp = find_property(mc, m.name);
        ASSERT_TRUE(mp) << m.name;
        EXPECT_EQ(m.offset, mp->offset) << m.name;
        EXPECT_EQ(m.null_offset, mp->offset + (mp->subscript ? 8 : type_size[mp->type])) << m.name;
    }

    // References of an association: one pointer each, narrowed or not.
    typedef VESPERA_AvailableDiagnosticServiceForFCPort Avail;
    const Meta_Class* avail = &Avail::static_meta_class;
    EXPECT_EQ(offsetof(Avail, ServiceProvided), find_reference(avail, "ServiceProvided")->offset);
    EXPECT_EQ(offsetof(Avail, UserOfService), find_reference(avail, "UserOfService")->offset);

    // The one added property lies behind everything inherited.
    const Meta_Property* category = find_property(&VESPERA_AlertIndication::static_meta_class, "Category");
    EXPECT_EQ(offsetof(VESPERA_AlertIndication, Category), category->offset);
    EXPECT_GE(category->offset, offsetof(VESPERA_AlertIndication, Message));
}

TEST(Layout, EveryClassCreatesClonesAndDestroys)
{
    // Walks every slot through the runtime, with and without defaults; a
    // table that disagreed with its record would write outside it.
    const Meta_Repository* mr = repository();
    for (size_t i = 0; i < mr->num_meta_classes; i++)
    {
        const Meta_Class* mc = mr->meta_classes[i];
        for (bool defaults : { false, true })
        {
            Instance* a = create(mc, defaults);
            ASSERT_TRUE(a) << mc->name;
            EXPECT_EQ(mc, a->meta_class);
            __create_refs(a);
            Instance* b = clone(a);
            EXPECT_TRUE(identical(a, b)) << mc->name;
            EXPECT_TRUE(key_eq(a, b)) << mc->name;
            destroy(b);
            destroy(a);
        }
    }
}
