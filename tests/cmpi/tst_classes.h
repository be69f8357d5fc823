#ifndef _OLMA_tst_classes_h
#define _OLMA_tst_classes_h

// A small class written by hand for the bridge's tests: every scalar and
// array type, plain and embedded references, and one method. The module
// under test and the test programs share it.

#include "Instance.h"

namespace OLMA
{

struct TST_Part : Instance
{
    Property<String> Name;
    Property<uint16> Index;
    Property<boolean> B;
    Property<uint8> U8;
    Property<sint8> S8;
    Property<uint16> U16;
    Property<sint16> S16;
    Property<uint32> U32;
    Property<sint32> S32;
    Property<uint64> U64;
    Property<sint64> S64;
    Property<real32> R32;
    Property<real64> R64;
    Property<char16> C16;
    Property<String> Str;
    Property<Datetime> Dt;
    Property<Array<boolean> > AB;
    Property<Array<uint8> > AU8;
    Property<Array<sint8> > AS8;
    Property<Array<uint16> > AU16;
    Property<Array<sint16> > AS16;
    Property<Array<uint32> > AU32;
    Property<Array<sint32> > AS32;
    Property<Array<uint64> > AU64;
    Property<Array<sint64> > AS64;
    Property<Array<real32> > AR32;
    Property<Array<real64> > AR64;
    Property<Array<char16> > AC16;
    Property<Array<String> > AStr;
    Property<Array<Datetime> > ADt;
    TST_Part* Peer;
    TST_Part* Embedded;
    Property<Array<TST_Part*> > Peers;
    Property<Array<TST_Part*> > Embeddeds;

    static const Meta_Class static_meta_class;
};

struct TST_Part_Frob_method : Instance
{
    Property<String> Text;
    Property<Array<String> > Lines;
    Property<uint32> Count;
    TST_Part* Made;
    Property<uint32> return_value;

    static const Meta_Method static_meta_class;
};

// An association between two parts.
struct TST_Link : Instance
{
    TST_Part* Left;
    TST_Part* Right;
    Property<String> Note;

    static const Meta_Class static_meta_class;
};

// An indication, with no keys.
struct TST_Alert : Instance
{
    Property<String> Message;
    Property<uint32> Sequence;
    Property<Array<String> > Args;
    Property<Datetime> When;

    static const Meta_Class static_meta_class;
};

extern const Meta_Repository tst_repository;

// A part with the keys and every property set to values derived from
// index; references stay empty.
TST_Part* tst_make_part(const char* name, uint16 index);

// Only the keys.
TST_Part* tst_make_key(const char* name, uint16 index);

// A link between the keys of two parts.
TST_Link* tst_make_link(const char* left, uint16 left_index,
    const char* right, uint16 right_index);

} // namespace OLMA

#endif // _OLMA_tst_classes_h
