#include <cstddef>
#include "tst_classes.h"

#pragma GCC diagnostic ignored "-Winvalid-offsetof"

namespace OLMA
{

#define TST_PROP(NAME, TYPE, SUB, FLAGS) \
    static const Meta_Property _TST_Part_##NAME = \
    { \
        { { 0, FLAG_PROPERTY | FLAG_READ | (FLAGS), #NAME, 0, 0 } }, \
        TYPE, SUB, (uint32)offsetof(TST_Part, NAME), 0, \
    };

#define TST_REF(NAME, SUB, FLAGS) \
    static const Meta_Reference _TST_Part_##NAME = \
    { \
        { { 0, FLAG_REFERENCE | FLAG_READ | (FLAGS), #NAME, 0, 0 } }, \
        SUB, &TST_Part::static_meta_class, (uint32)offsetof(TST_Part, NAME), \
    };

TST_PROP(Name, STRING, 0, FLAG_KEY)
TST_PROP(Index, UINT16, 0, FLAG_KEY)
TST_PROP(B, BOOLEAN, 0, 0)
TST_PROP(U8, UINT8, 0, 0)
TST_PROP(S8, SINT8, 0, 0)
TST_PROP(U16, UINT16, 0, 0)
TST_PROP(S16, SINT16, 0, 0)
TST_PROP(U32, UINT32, 0, 0)
TST_PROP(S32, SINT32, 0, 0)
TST_PROP(U64, UINT64, 0, 0)
TST_PROP(S64, SINT64, 0, 0)
TST_PROP(R32, REAL32, 0, 0)
TST_PROP(R64, REAL64, 0, 0)
TST_PROP(C16, CHAR16, 0, 0)
TST_PROP(Str, STRING, 0, 0)
TST_PROP(Dt, DATETIME, 0, 0)
TST_PROP(AB, BOOLEAN, -1, 0)
TST_PROP(AU8, UINT8, -1, 0)
TST_PROP(AS8, SINT8, -1, 0)
TST_PROP(AU16, UINT16, -1, 0)
TST_PROP(AS16, SINT16, -1, 0)
TST_PROP(AU32, UINT32, -1, 0)
TST_PROP(AS32, SINT32, -1, 0)
TST_PROP(AU64, UINT64, -1, 0)
TST_PROP(AS64, SINT64, -1, 0)
TST_PROP(AR32, REAL32, -1, 0)
TST_PROP(AR64, REAL64, -1, 0)
TST_PROP(AC16, CHAR16, -1, 0)
TST_PROP(AStr, STRING, -1, 0)
TST_PROP(ADt, DATETIME, -1, 0)
TST_REF(Peer, 0, 0)
TST_REF(Embedded, 0, FLAG_EMBEDDED_INSTANCE)
TST_REF(Peers, -1, 0)
TST_REF(Embeddeds, -1, FLAG_EMBEDDED_INSTANCE)

static const Meta_Property _TST_Part_Frob_Text =
{
    { { 0, FLAG_PROPERTY | FLAG_IN, "Text", 0, 0 } },
    STRING, 0, (uint32)offsetof(TST_Part_Frob_method, Text), 0,
};

static const Meta_Property _TST_Part_Frob_Lines =
{
    { { 0, FLAG_PROPERTY | FLAG_IN, "Lines", 0, 0 } },
    STRING, -1, (uint32)offsetof(TST_Part_Frob_method, Lines), 0,
};

static const Meta_Property _TST_Part_Frob_Count =
{
    { { 0, FLAG_PROPERTY | FLAG_OUT, "Count", 0, 0 } },
    UINT32, 0, (uint32)offsetof(TST_Part_Frob_method, Count), 0,
};

static const Meta_Reference _TST_Part_Frob_Made =
{
    { { 0, FLAG_REFERENCE | FLAG_OUT, "Made", 0, 0 } },
    0, &TST_Part::static_meta_class, (uint32)offsetof(TST_Part_Frob_method, Made),
};

static const Meta_Property _TST_Part_Frob_return_value =
{
    { { 0, FLAG_PROPERTY | FLAG_OUT, "return_value", 0, 0 } },
    UINT32, 0, (uint32)offsetof(TST_Part_Frob_method, return_value), 0,
};

static Meta_Feature* _TST_Part_Frob_MFA[] =
{
    (Meta_Feature*)&_TST_Part_Frob_Text,
    (Meta_Feature*)&_TST_Part_Frob_Lines,
    (Meta_Feature*)&_TST_Part_Frob_Count,
    (Meta_Feature*)&_TST_Part_Frob_Made,
    (Meta_Feature*)&_TST_Part_Frob_return_value,
};

const Meta_Method TST_Part_Frob_method::static_meta_class =
{
    { { 0, FLAG_METHOD, "Frob", 0, 0 } },
    _TST_Part_Frob_MFA,
    sizeof(_TST_Part_Frob_MFA) / sizeof(_TST_Part_Frob_MFA[0]),
    sizeof(TST_Part_Frob_method),
    UINT32,
};

static Meta_Feature* _TST_Part_MFA[] =
{
    (Meta_Feature*)&_TST_Part_Name,
    (Meta_Feature*)&_TST_Part_Index,
    (Meta_Feature*)&_TST_Part_B,
    (Meta_Feature*)&_TST_Part_U8,
    (Meta_Feature*)&_TST_Part_S8,
    (Meta_Feature*)&_TST_Part_U16,
    (Meta_Feature*)&_TST_Part_S16,
    (Meta_Feature*)&_TST_Part_U32,
    (Meta_Feature*)&_TST_Part_S32,
    (Meta_Feature*)&_TST_Part_U64,
    (Meta_Feature*)&_TST_Part_S64,
    (Meta_Feature*)&_TST_Part_R32,
    (Meta_Feature*)&_TST_Part_R64,
    (Meta_Feature*)&_TST_Part_C16,
    (Meta_Feature*)&_TST_Part_Str,
    (Meta_Feature*)&_TST_Part_Dt,
    (Meta_Feature*)&_TST_Part_AB,
    (Meta_Feature*)&_TST_Part_AU8,
    (Meta_Feature*)&_TST_Part_AS8,
    (Meta_Feature*)&_TST_Part_AU16,
    (Meta_Feature*)&_TST_Part_AS16,
    (Meta_Feature*)&_TST_Part_AU32,
    (Meta_Feature*)&_TST_Part_AS32,
    (Meta_Feature*)&_TST_Part_AU64,
    (Meta_Feature*)&_TST_Part_AS64,
    (Meta_Feature*)&_TST_Part_AR32,
    (Meta_Feature*)&_TST_Part_AR64,
    (Meta_Feature*)&_TST_Part_AC16,
    (Meta_Feature*)&_TST_Part_AStr,
    (Meta_Feature*)&_TST_Part_ADt,
    (Meta_Feature*)&_TST_Part_Peer,
    (Meta_Feature*)&_TST_Part_Embedded,
    (Meta_Feature*)&_TST_Part_Peers,
    (Meta_Feature*)&_TST_Part_Embeddeds,
    (Meta_Feature*)&TST_Part_Frob_method::static_meta_class,
};

enum { TST_PART_FEATURES = sizeof(_TST_Part_MFA) / sizeof(_TST_Part_MFA[0]) };

static const uint8 _TST_Part_locals[TST_PART_FEATURES] =
{
    1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1,
    1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1,
};

const Meta_Class TST_Part::static_meta_class =
{
    { 0, FLAG_CLASS, "TST_Part", 0, 0 },
    _TST_Part_MFA,
    TST_PART_FEATURES,
    sizeof(TST_Part),
    _TST_Part_locals,
    0,
    2,
    &tst_repository,
};

static const Meta_Reference _TST_Link_Left =
{
    { { 0, FLAG_REFERENCE | FLAG_KEY | FLAG_READ, "Left", 0, 0 } },
    0, &TST_Part::static_meta_class, (uint32)offsetof(TST_Link, Left),
};

static const Meta_Reference _TST_Link_Right =
{
    { { 0, FLAG_REFERENCE | FLAG_KEY | FLAG_READ, "Right", 0, 0 } },
    0, &TST_Part::static_meta_class, (uint32)offsetof(TST_Link, Right),
};

static const Meta_Property _TST_Link_Note =
{
    { { 0, FLAG_PROPERTY | FLAG_READ, "Note", 0, 0 } },
    STRING, 0, (uint32)offsetof(TST_Link, Note), 0,
};

static Meta_Feature* _TST_Link_MFA[] =
{
    (Meta_Feature*)&_TST_Link_Left,
    (Meta_Feature*)&_TST_Link_Right,
    (Meta_Feature*)&_TST_Link_Note,
};

static const uint8 _TST_Link_locals[] = { 1, 1, 1 };

const Meta_Class TST_Link::static_meta_class =
{
    { 0, FLAG_ASSOCIATION, "TST_Link", 0, 0 },
    _TST_Link_MFA,
    3,
    sizeof(TST_Link),
    _TST_Link_locals,
    0,
    2,
    &tst_repository,
};

static const Meta_Property _TST_Alert_Message =
{
    { { 0, FLAG_PROPERTY | FLAG_READ, "Message", 0, 0 } },
    STRING, 0, (uint32)offsetof(TST_Alert, Message), 0,
};

static const Meta_Property _TST_Alert_Sequence =
{
    { { 0, FLAG_PROPERTY | FLAG_READ, "Sequence", 0, 0 } },
    UINT32, 0, (uint32)offsetof(TST_Alert, Sequence), 0,
};

static const Meta_Property _TST_Alert_Args =
{
    { { 0, FLAG_PROPERTY | FLAG_READ, "Args", 0, 0 } },
    STRING, -1, (uint32)offsetof(TST_Alert, Args), 0,
};

static const Meta_Property _TST_Alert_When =
{
    { { 0, FLAG_PROPERTY | FLAG_READ, "When", 0, 0 } },
    DATETIME, 0, (uint32)offsetof(TST_Alert, When), 0,
};

static Meta_Feature* _TST_Alert_MFA[] =
{
    (Meta_Feature*)&_TST_Alert_Message,
    (Meta_Feature*)&_TST_Alert_Sequence,
    (Meta_Feature*)&_TST_Alert_Args,
    (Meta_Feature*)&_TST_Alert_When,
};

static const uint8 _TST_Alert_locals[] = { 1, 1, 1, 1 };

const Meta_Class TST_Alert::static_meta_class =
{
    { 0, FLAG_INDICATION, "TST_Alert", 0, 0 },
    _TST_Alert_MFA,
    4,
    sizeof(TST_Alert),
    _TST_Alert_locals,
    0,
    0,
    &tst_repository,
};

static const Meta_Class* const _tst_classes[] =
{
    &TST_Part::static_meta_class,
    &TST_Link::static_meta_class,
    &TST_Alert::static_meta_class,
};

const Meta_Repository tst_repository = { _tst_classes, 3 };

TST_Link* tst_make_link(const char* left, uint16 left_index,
    const char* right, uint16 right_index)
{
    TST_Link* link = create<TST_Link>(false);
    link->Left = tst_make_key(left, left_index);
    link->Right = tst_make_key(right, right_index);
    link->Note.set(String(left, "-", right));
    return link;
}

TST_Part* tst_make_key(const char* name, uint16 index)
{
    TST_Part* p = create<TST_Part>(false);
    __set_null_flags(p, false, true, 1);
    p->Peers.null = 1;
    p->Embeddeds.null = 1;
    p->Name.set(name);
    p->Index.set(index);
    return p;
}

TST_Part* tst_make_part(const char* name, uint16 index)
{
    TST_Part* p = create<TST_Part>(false);
    uint32 i = index;
    p->Name.set(name);
    p->Index.set(index);
    p->B.set(i % 2 == 1);
    p->U8.set(uint8(200 + i));
    p->S8.set(sint8(-100 - (int)i));
    p->U16.set(uint16(60000 + i));
    p->S16.set(sint16(-30000 - (int)i));
    p->U32.set(4000000000u + i);
    p->S32.set(-2000000000 - (sint32)i);
    p->U64.set(18000000000000000000ull + i);
    p->S64.set(-9000000000000000000ll - (sint64)i);
    p->R32.set(1.5f + i);
    p->R64.set(-2.25 - i);
    p->C16.set(char16(uint16('A' + i)));
    p->Str.set(String("text-", name));
    p->Dt.set(Datetime("20100102030405.123456+060"));

    boolean ab[] = { true, false };
    p->AB.set(Array<boolean>(ab, 2));
    uint8 au8[] = { 1, 255 };
    p->AU8.set(Array<uint8>(au8, 2));
    sint8 as8[] = { -128, 127 };
    p->AS8.set(Array<sint8>(as8, 2));
    uint16 au16[] = { 0, 65535 };
    p->AU16.set(Array<uint16>(au16, 2));
    sint16 as16[] = { -32768, 32767 };
    p->AS16.set(Array<sint16>(as16, 2));
    uint32 au32[] = { 7, 4294967295u };
    p->AU32.set(Array<uint32>(au32, 2));
    sint32 as32[] = { -2147483647 - 1, 2147483647 };
    p->AS32.set(Array<sint32>(as32, 2));
    uint64 au64[] = { 0, 18446744073709551615ull };
    p->AU64.set(Array<uint64>(au64, 2));
    sint64 as64[] = { -9223372036854775807ll - 1, 9223372036854775807ll };
    p->AS64.set(Array<sint64>(as64, 2));
    real32 ar32[] = { 0.5f, -0.25f };
    p->AR32.set(Array<real32>(ar32, 2));
    real64 ar64[] = { 1e100, -1e-100 };
    p->AR64.set(Array<real64>(ar64, 2));
    char16 ac16[] = { char16('x'), char16(0x263A) };
    p->AC16.set(Array<char16>(ac16, 2));
    String astr[] = { String("a"), String(""), String("c d") };
    p->AStr.set(Array<String>(astr, 3));
    Datetime adt[] = { Datetime("00000001020304.000005:000"),
        Datetime("19991231235959.999999-300") };
    p->ADt.set(Array<Datetime>(adt, 2));
    return p;
}

} // namespace OLMA
