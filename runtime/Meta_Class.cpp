#include "Meta_Class.h"
#include <cstdlib>
#include <cstring>
#include <strings.h>
#include "Array.h"
#include "Strings.h"
#include "Instance.h"

namespace OLMA
{

const char* const flag_names[] =
{
    "Property",
    "Reference",
    "Method",
    "Class",
    "Abstract",
    "Aggregate",
    "Aggregation",
    "Association",
    "Composition",
    "Counter",
    "Delete",
    "DN",
    "EmbeddedObject",
    "Exception",
    "Expensive",
    "Experimental",
    "Gauge",
    "IfDeleted",
    "In",
    "Indication",
    "Invisible",
    "Key",
    "Large",
    "OctetString",
    "Out",
    "Read",
    "Required",
    "Static",
    "Terminal",
    "Weak",
    "Write",
    "EmbeddedInstance",
};

const size_t num_flag_names = sizeof(flag_names) / sizeof(flag_names[0]);

static_assert(sizeof(flag_names) / sizeof(flag_names[0]) == 32, "one name per flag bit");

// The first-character test keeps most look-ups away from strcasecmp.
static inline bool _eqi(const char* x, const char* y)
{
    return __lower[(uint8)x[0]] == __lower[(uint8)y[0]] && strcasecmp(x, y) == 0;
}

int flag_name_to_index(const char* name)
{
    if (!name)
        return -1;

    for (size_t i = 0; i < num_flag_names; i++)
    {
        if (_eqi(flag_names[i], name))
            return (int)i;
    }

    return -1;
}

//
// Look-ups
//

static const Meta_Feature* _find_feature(
    Meta_Feature* const* features, size_t n, const char* name, uint32 type_mask)
{
    if (!name)
        return 0;

    for (size_t i = 0; i < n; i++)
    {
        const Meta_Feature* mf = features[i];

        if ((mf->flags & type_mask) && _eqi(mf->name, name))
            return mf;
    }

    return 0;
}

const Meta_Feature* find_feature(const Meta_Class* mc, const char* name, uint32 type_mask)
{
    if (!mc)
        return 0;

    return _find_feature(mc->meta_features, mc->num_meta_features, name, type_mask);
}

const Meta_Feature* find_feature(const Meta_Method* mm, const char* name, uint32 type_mask)
{
    if (!mm)
        return 0;

    return _find_feature(mm->meta_features, mm->num_meta_features, name, type_mask);
}

ssize_t find_feature_index(const Meta_Class* mc, const Meta_Feature* mf)
{
    for (size_t i = 0; mc && i < mc->num_meta_features; i++)
    {
        if (mc->meta_features[i] == mf)
            return (ssize_t)i;
    }

    return -1;
}

bool __has_meta_feature(const Meta_Class* mc, uint32 type_mask)
{
    for (size_t i = 0; mc && i < mc->num_meta_features; i++)
    {
        if (mc->meta_features[i]->flags & type_mask)
            return true;
    }

    return false;
}

// A method record's table ends at size: it has no parent and no repository.
static inline bool _is_method(const Meta_Class* mc)
{
    return (mc->flags & FLAG_METHOD) != 0;
}

static inline const Meta_Class* _super(const Meta_Class* mc)
{
    return _is_method(mc) ? 0 : mc->super_meta_class;
}

bool is_subclass(const Meta_Class* ancestor, const Meta_Class* descendant)
{
    if (!ancestor)
        return false;

    if (ancestor == &Instance::static_meta_class || _eqi(ancestor->name, "Instance"))
        return true;

    for (const Meta_Class* p = descendant; p; p = _super(p))
    {
        if (p == ancestor || _eqi(p->name, ancestor->name))
            return true;
    }

    return false;
}

const Meta_Class* find_meta_class(const Meta_Repository* mr, const char* name)
{
    if (!mr || !name)
        return 0;

    for (size_t i = 0; i < mr->num_meta_classes; i++)
    {
        const Meta_Class* mc = mr->meta_classes[i];

        if (_eqi(mc->name, name))
            return mc;
    }

    return 0;
}

const Meta_Class* find_meta_class(const Meta_Class* mc, const char* name)
{
    if (!mc || !name)
        return 0;

    for (const Meta_Class* p = mc; p; p = _super(p))
    {
        if (_eqi(p->name, name))
            return p;
    }

    if (_is_method(mc))
        return 0;

    return find_meta_class(mc->meta_repository, name);
}

int is_subclass(const Meta_Repository* mr, const char* ancestor, const char* descendant)
{
    if (!mr || !ancestor || !descendant)
        return -1;

    const Meta_Class* a = find_meta_class(mr, ancestor);
    const Meta_Class* d = find_meta_class(mr, descendant);

    if (!a || !d)
        return -1;

    return is_subclass(a, d) ? 0 : 1;
}

//
// Reference counts
//

void ref(const Meta_Class* mc)
{
    if (mc && mc->refs)
        __atomic_add_fetch(&((Meta_Class*)mc)->refs, 1, __ATOMIC_ACQ_REL);
}

void unref(const Meta_Class* mc)
{
    if (mc && mc->refs)
    {
        if (__atomic_sub_fetch(&((Meta_Class*)mc)->refs, 1, __ATOMIC_ACQ_REL) == 0)
            destroy((Meta_Class*)mc);
    }
}

//
// Clone and destroy. A clone is dynamic (refs 1) all through: it owns its
// names, values, qualifiers and features, whatever the source was.
//

static char* _strdup(const char* s)
{
    return s ? strdup(s) : 0;
}

static void* _memdup(const void* p, size_t n)
{
    void* q = malloc(n ? n : 1);
    if (n)
        memcpy(q, p, n);
    return q;
}

static inline bool _is_text(Type type)
{
    return type == STRING || type == DATETIME;
}

Meta_Value* clone(const Meta_Value* mv, Type type, bool array)
{
    if (!mv || (unsigned)type >= NUM_TYPES)
        return 0;

    const size_t n = literal_type_size[type];

    if (array)
    {
        const Meta_Value_Array<char>* src = (const Meta_Value_Array<char>*)mv;
        Meta_Value_Array<char>* mva =
            (Meta_Value_Array<char>*)calloc(1, sizeof(Meta_Value_Array<char>));
        mva->num_elements = src->num_elements;

        if (_is_text(type))
        {
            const char* const* e = (const char* const*)src->elements;
            char** p = (char**)calloc(src->num_elements ? src->num_elements : 1, sizeof(char*));
            for (size_t i = 0; i < src->num_elements; i++)
                p[i] = _strdup(e[i]);
            mva->elements = (const char*)p;
        }
        else
            mva->elements = (const char*)_memdup(src->elements, n * src->num_elements);

        return mva;
    }

    if (_is_text(type))
    {
        Meta_Value_Scalar<const char*>* p =
            (Meta_Value_Scalar<const char*>*)calloc(1, sizeof(Meta_Value_Scalar<const char*>));
        p->value = _strdup(((const Meta_Value_Scalar<const char*>*)mv)->value);
        return p;
    }

    return (Meta_Value*)_memdup(mv, n);
}

void destroy(Meta_Value* mv, Type type, bool array)
{
    if (!mv || (unsigned)type >= NUM_TYPES)
        return;

    if (array)
    {
        Meta_Value_Array<char>* mva = (Meta_Value_Array<char>*)mv;

        if (_is_text(type))
        {
            char** p = (char**)mva->elements;
            for (size_t i = 0; i < mva->num_elements; i++)
                free(p[i]);
        }

        free((void*)mva->elements);
    }
    else if (_is_text(type))
        free((void*)((Meta_Value_Scalar<const char*>*)mv)->value);

    free(mv);
}

Meta_Qualifier* clone(const Meta_Qualifier* mq)
{
    if (!mq)
        return 0;

    Meta_Qualifier* p = (Meta_Qualifier*)calloc(1, sizeof(Meta_Qualifier));
    p->refs = 1;
    p->flags = mq->flags;
    p->name = _strdup(mq->name);
    p->type = mq->type;
    p->array = mq->array;
    p->value = clone(mq->value, (Type)mq->type, mq->array);
    return p;
}

void destroy(Meta_Qualifier* mq)
{
    if (!mq)
        return;

    destroy((Meta_Value*)mq->value, (Type)mq->type, mq->array);
    free((char*)mq->name);
    free(mq);
}

// Copies the head into a freshly zeroed record.
static void _clone_head(Meta_Qualified_Object* to, const Meta_Qualified_Object* from)
{
    to->refs = 1;
    to->flags = from->flags;
    to->name = _strdup(from->name);
    to->meta_qualifiers = 0;
    to->num_meta_qualifiers = 0;

    for (size_t i = 0; i < from->num_meta_qualifiers; i++)
        append(to->meta_qualifiers, to->num_meta_qualifiers, clone(from->meta_qualifiers[i]));
}

static void _destroy_head(Meta_Qualified_Object* mqo)
{
    for (size_t i = 0; i < mqo->num_meta_qualifiers; i++)
        destroy(mqo->meta_qualifiers[i]);

    free(mqo->meta_qualifiers);
    free((char*)mqo->name);
}

Meta_Property* clone(const Meta_Property* mp)
{
    if (!mp)
        return 0;

    Meta_Property* p = (Meta_Property*)calloc(1, sizeof(Meta_Property));
    _clone_head(p, mp);
    p->type = mp->type;
    p->subscript = mp->subscript;
    p->offset = mp->offset;
    p->value = clone(mp->value, (Type)mp->type, mp->subscript != 0);
    return p;
}

void destroy(Meta_Property* mp)
{
    if (!mp)
        return;

    destroy((Meta_Value*)mp->value, (Type)mp->type, mp->subscript != 0);
    _destroy_head(mp);
    free(mp);
}

Meta_Reference* clone(const Meta_Reference* mr)
{
    if (!mr)
        return 0;

    Meta_Reference* p = (Meta_Reference*)calloc(1, sizeof(Meta_Reference));
    _clone_head(p, mr);
    p->subscript = mr->subscript;
    p->meta_class = mr->meta_class;
    p->offset = mr->offset;
    return p;
}

void destroy(Meta_Reference* mr)
{
    if (!mr)
        return;

    _destroy_head(mr);
    free(mr);
}

static void _clone_features(
    Meta_Feature**& to, size_t& num_to, Meta_Feature* const* from, size_t num_from)
{
    to = 0;
    num_to = 0;

    for (size_t i = 0; i < num_from; i++)
        append(to, num_to, clone(from[i]));
}

static void _destroy_features(Meta_Feature** features, size_t n)
{
    for (size_t i = 0; i < n; i++)
        destroy(features[i]);

    free(features);
}

Meta_Method* clone(const Meta_Method* mm)
{
    if (!mm)
        return 0;

    Meta_Method* p = (Meta_Method*)calloc(1, sizeof(Meta_Method));
    _clone_head(p, mm);
    _clone_features(p->meta_features, p->num_meta_features, mm->meta_features,
        mm->num_meta_features);
    p->size = mm->size;
    p->return_type = mm->return_type;
    return p;
}

void destroy(Meta_Method* mm)
{
    if (!mm)
        return;

    _destroy_features(mm->meta_features, mm->num_meta_features);
    _destroy_head(mm);
    free(mm);
}

Meta_Feature* clone(const Meta_Feature* mf)
{
    if (!mf)
        return 0;

    if (mf->flags & FLAG_PROPERTY)
        return clone((const Meta_Property*)mf);

    if (mf->flags & FLAG_REFERENCE)
        return clone((const Meta_Reference*)mf);

    if (mf->flags & FLAG_METHOD)
        return clone((const Meta_Method*)mf);

    return 0;
}

void destroy(Meta_Feature* mf)
{
    if (!mf)
        return;

    if (mf->flags & FLAG_PROPERTY)
        destroy((Meta_Property*)mf);
    else if (mf->flags & FLAG_REFERENCE)
        destroy((Meta_Reference*)mf);
    else if (mf->flags & FLAG_METHOD)
        destroy((Meta_Method*)mf);
}

Meta_Class* clone(const Meta_Class* mc)
{
    if (!mc)
        return 0;

    Meta_Class* p = (Meta_Class*)calloc(1, sizeof(Meta_Class));
    _clone_head(p, mc);
    _clone_features(p->meta_features, p->num_meta_features, mc->meta_features,
        mc->num_meta_features);
    p->size = mc->size;
    p->locals = (const uint8*)_memdup(mc->locals, mc->locals ? mc->num_meta_features : 0);
    p->super_meta_class = mc->super_meta_class;
    ref(p->super_meta_class);
    p->num_keys = mc->num_keys;
    p->meta_repository = mc->meta_repository;
    return p;
}

void destroy(Meta_Class* mc)
{
    if (!mc)
        return;

    _destroy_features(mc->meta_features, mc->num_meta_features);
    _destroy_head(mc);
    free((uint8*)mc->locals);
    const Meta_Class* super = mc->super_meta_class;

    // Leaves a recognisable pattern behind for anyone who kept a pointer.
    memset(mc, 0xDD, sizeof(Meta_Class));
    free(mc);
    unref(super);
}

//
// Comparison
//

static bool _identical(const Meta_Value* x, const Meta_Value* y, Type type, bool array)
{
    if (!x || !y)
        return x == y;

    const size_t n = literal_type_size[type];

    if (array)
    {
        const Meta_Value_Array<char>* a = (const Meta_Value_Array<char>*)x;
        const Meta_Value_Array<char>* b = (const Meta_Value_Array<char>*)y;

        if (a->num_elements != b->num_elements)
            return false;

        if (!_is_text(type))
            return memcmp(a->elements, b->elements, n * a->num_elements) == 0;

        const char* const* e = (const char* const*)a->elements;
        const char* const* f = (const char* const*)b->elements;

        for (size_t i = 0; i < a->num_elements; i++)
        {
            if ((!e[i] || !f[i]) ? e[i] != f[i] : strcmp(e[i], f[i]) != 0)
                return false;
        }

        return true;
    }

    if (_is_text(type))
    {
        const char* s = ((const Meta_Value_Scalar<const char*>*)x)->value;
        const char* t = ((const Meta_Value_Scalar<const char*>*)y)->value;
        return (!s || !t) ? s == t : strcmp(s, t) == 0;
    }

    return memcmp(x, y, n) == 0;
}

static bool _identical(const Meta_Qualified_Object* x, const Meta_Qualified_Object* y)
{
    if (x->flags != y->flags || !_eqi(x->name, y->name) ||
        x->num_meta_qualifiers != y->num_meta_qualifiers)
        return false;

    for (size_t i = 0; i < x->num_meta_qualifiers; i++)
    {
        const Meta_Qualifier* a = x->meta_qualifiers[i];
        const Meta_Qualifier* b = y->meta_qualifiers[i];

        if (a->flags != b->flags || !_eqi(a->name, b->name) || a->type != b->type ||
            a->array != b->array || !_identical(a->value, b->value, (Type)a->type, a->array))
            return false;
    }

    return true;
}

static bool _identical_features(
    Meta_Feature* const* x, size_t nx, Meta_Feature* const* y, size_t ny);

static bool _identical(const Meta_Feature* x, const Meta_Feature* y)
{
    if (!_identical((const Meta_Qualified_Object*)x, (const Meta_Qualified_Object*)y))
        return false;

    if (x->flags & FLAG_PROPERTY)
    {
        const Meta_Property* a = (const Meta_Property*)x;
        const Meta_Property* b = (const Meta_Property*)y;

        return a->type == b->type && a->subscript == b->subscript && a->offset == b->offset &&
            _identical(a->value, b->value, (Type)a->type, a->subscript != 0);
    }

    if (x->flags & FLAG_REFERENCE)
    {
        const Meta_Reference* a = (const Meta_Reference*)x;
        const Meta_Reference* b = (const Meta_Reference*)y;

        return a->subscript == b->subscript && a->offset == b->offset &&
            (a->meta_class == b->meta_class ||
                (a->meta_class && b->meta_class &&
                    _eqi(a->meta_class->name, b->meta_class->name)));
    }

    if (x->flags & FLAG_METHOD)
    {
        const Meta_Method* a = (const Meta_Method*)x;
        const Meta_Method* b = (const Meta_Method*)y;

        return a->size == b->size && a->return_type == b->return_type &&
            _identical_features(
                a->meta_features, a->num_meta_features, b->meta_features, b->num_meta_features);
    }

    return true;
}

static bool _identical_features(
    Meta_Feature* const* x, size_t nx, Meta_Feature* const* y, size_t ny)
{
    if (nx != ny)
        return false;

    for (size_t i = 0; i < nx; i++)
    {
        if (!_identical(x[i], y[i]))
            return false;
    }

    return true;
}

bool identical(const Meta_Class* x, const Meta_Class* y)
{
    if (x == y)
        return true;

    if (!x || !y)
        return false;

    if (!_identical((const Meta_Qualified_Object*)x, (const Meta_Qualified_Object*)y))
        return false;

    if (x->size != y->size || x->num_keys != y->num_keys)
        return false;

    const Meta_Class* sx = x->super_meta_class;
    const Meta_Class* sy = y->super_meta_class;

    if ((!sx || !sy) ? sx != sy : !_eqi(sx->name, sy->name))
        return false;

    if (!_identical_features(
            x->meta_features, x->num_meta_features, y->meta_features, y->num_meta_features))
        return false;

    for (size_t i = 0; i < x->num_meta_features; i++)
    {
        const uint8 lx = x->locals ? x->locals[i] : 0;
        const uint8 ly = y->locals ? y->locals[i] : 0;

        if (lx != ly)
            return false;
    }

    return true;
}

//
// Dynamic classes
//

void append(Meta_Qualified_Object* mqo, Meta_Qualifier* mq)
{
    append(mqo->meta_qualifiers, mqo->num_meta_qualifiers, mq);
}

void append(Meta_Class* mc, Meta_Feature* mf, bool local)
{
    uint8* locals = (uint8*)realloc((uint8*)mc->locals, mc->num_meta_features + 1);
    locals[mc->num_meta_features] = local ? 1 : 0;
    mc->locals = locals;
    append(mc->meta_features, mc->num_meta_features, mf);

    if (mf->flags & FLAG_KEY)
        mc->num_keys++;
}

static bool _in(const char* name, const char* const* names, size_t count)
{
    for (size_t i = 0; i < count; i++)
    {
        if (names[i] && _eqi(name, names[i]))
            return true;
    }

    return false;
}

static void _filter_qualifiers(Meta_Qualified_Object* mqo, const char* const* names, size_t count)
{
    size_t j = 0;

    for (size_t i = 0; i < mqo->num_meta_qualifiers; i++)
    {
        Meta_Qualifier* mq = mqo->meta_qualifiers[i];

        if (_in(mq->name, names, count))
        {
            if (mq->refs)
                destroy(mq);
        }
        else
            mqo->meta_qualifiers[j++] = mq;
    }

    mqo->num_meta_qualifiers = j;
}

static void _filter_qualifiers(
    Meta_Feature** features, size_t n, const char* const* names, size_t count)
{
    for (size_t i = 0; i < n; i++)
    {
        Meta_Feature* mf = features[i];
        _filter_qualifiers(mf, names, count);

        if (mf->flags & FLAG_METHOD)
        {
            Meta_Method* mm = (Meta_Method*)mf;
            _filter_qualifiers(mm->meta_features, mm->num_meta_features, names, count);
        }
    }
}

void filter_qualifiers(Meta_Class* mc, const char* const* names, size_t count)
{
    if (!mc || !names)
        return;

    _filter_qualifiers(mc, names, count);
    _filter_qualifiers(mc->meta_features, mc->num_meta_features, names, count);
}

Meta_Class* create_meta_class(const char* name, const Meta_Class* super, uint32 flags)
{
    if (!name)
        return 0;

    Meta_Class* mc;

    if (super)
    {
        mc = clone(super);
        free((char*)mc->name);
        mc->name = _strdup(name);
        mc->flags = (mc->flags | flags) & ~FLAG_ABSTRACT;

        static const char* const abstract[] = { "Abstract" };
        _filter_qualifiers(mc, abstract, 1);

        if (mc->num_meta_features)
            memset((uint8*)mc->locals, 0, mc->num_meta_features);

        unref(mc->super_meta_class);
        mc->super_meta_class = super;
        ref(super);
    }
    else
    {
        mc = (Meta_Class*)calloc(1, sizeof(Meta_Class));
        mc->refs = 1;
        mc->flags = flags;
        mc->name = _strdup(name);
        mc->size = sizeof(Instance);
    }

    return mc;
}

Meta_Property* create_meta_property(
    const char* name, Type type, sint16 subscript, uint32 offset, bool key)
{
    if (!name || (unsigned)type >= NUM_TYPES)
        return 0;

    Meta_Property* mp = (Meta_Property*)calloc(1, sizeof(Meta_Property));
    mp->refs = 1;
    mp->flags = FLAG_PROPERTY | FLAG_READ | (key ? (uint32)FLAG_KEY : 0u);
    mp->name = _strdup(name);
    mp->type = type;
    mp->subscript = subscript;
    mp->offset = offset;
    return mp;
}

//
// Printing
//

// Literals hold texts as pointers; fprint_scalar() wants the text itself.
static void _fprint_literal(FILE* os, Type type, const void* p)
{
    if (type == STRING || type == DATETIME)
    {
        const char* s = *(const char* const*)p;
        if (s)
            fprint_scalar(os, type, s);
        else
            fputs("NULL", os);
    }
    else
        fprint_scalar(os, type, p);
}

void fprint(FILE* os, const Meta_Value* mv, Type type, bool array)
{
    if (!mv || (unsigned)type >= NUM_TYPES)
    {
        fputs("NULL", os);
        return;
    }

    if (!array)
    {
        _fprint_literal(os, type, mv);
        return;
    }

    const Meta_Value_Array<char>* mva = (const Meta_Value_Array<char>*)mv;
    fputs("{", os);

    for (size_t i = 0; i < mva->num_elements; i++)
    {
        fputs(i ? ", " : " ", os);
        _fprint_literal(os, type, mva->elements + i * literal_type_size[type]);
    }

    fputs(mva->num_elements ? " }" : "}", os);
}

static void _fprint_flags(FILE* os, size_t level, uint32 flags, bool parameter)
{
    String text;

    for (size_t i = 4; i < num_flag_names; i++)
    {
        const uint32 bit = 1u << i;

        if (bit == FLAG_READ || bit == FLAG_IN || !(flags & bit))
            continue;

        text.append(text.size() ? ", " : "[");
        text.append(flag_names[i]);
    }

    const char* extra = 0;

    if (parameter)
        extra = (flags & FLAG_IN) ? "In" : "In(False)";
    else if ((flags & FLAG_PROPERTY) && !(flags & FLAG_READ))
        extra = "Read(False)";

    if (extra)
    {
        text.append(text.size() ? ", " : "[");
        text.append(extra);
    }

    if (text.size())
        ifprintf(os, level, "%s]\n", text.c_str());
}

static void _fprint_feature(
    FILE* os, const Meta_Feature* mf, size_t level, bool print_qualifiers, bool parameter)
{
    if (print_qualifiers)
        _fprint_flags(os, level, mf->flags, parameter);

    if (mf->flags & FLAG_PROPERTY)
    {
        const Meta_Property* mp = (const Meta_Property*)mf;
        const Type type = (unsigned)mp->type < NUM_TYPES ? (Type)mp->type : BOOLEAN;
        ifprintf(os, level, "%s %s", type_name[type], mp->name);

        if (mp->subscript > 0)
            fprintf(os, "[%d]", mp->subscript);
        else if (mp->subscript)
            fputs("[]", os);

        if (mp->value)
        {
            fputs(" = ", os);
            fprint(os, mp->value, type, mp->subscript != 0);
        }
    }
    else if (mf->flags & FLAG_REFERENCE)
    {
        const Meta_Reference* mr = (const Meta_Reference*)mf;
        ifprintf(os, level, "%s REF %s%s",
            mr->meta_class ? mr->meta_class->name : "Instance", mr->name,
            mr->subscript ? "[]" : "");
    }
    else if (mf->flags & FLAG_METHOD)
    {
        const Meta_Method* mm = (const Meta_Method*)mf;
        const Type type = (unsigned)mm->return_type < NUM_TYPES ? (Type)mm->return_type : UINT32;
        ifprintf(os, level, "%s %s(", type_name[type], mm->name);

        bool any = false;

        for (size_t i = 0; i < mm->num_meta_features; i++)
        {
            const Meta_Feature* p = mm->meta_features[i];

            if (strcasecmp(p->name, "return_value") == 0)
                continue;

            fputs(any ? ",\n" : "\n", os);
            _fprint_feature(os, p, level + 1, print_qualifiers, true);
            any = true;
        }

        fputs(")", os);
    }
}

void fprint(FILE* os, const Meta_Class* mc, bool print_qualifiers)
{
    if (!mc)
        return;

    if (!_is_method(mc) && mc->super_meta_class)
        fprintf(os, "class %s : %s\n", mc->name, mc->super_meta_class->name);
    else
        fprintf(os, "class %s\n", mc->name);

    fputs("{\n", os);

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        _fprint_feature(os, mc->meta_features[i], 1, print_qualifiers, false);
        fputs(";\n", os);
    }

    fputs("};\n", os);
}

void print(const Meta_Class* mc, bool print_qualifiers)
{
    fprint(stdout, mc, print_qualifiers);
}

void dump(const Meta_Class* mc)
{
    for (size_t i = 0; mc && i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (mf->flags & FLAG_PROPERTY)
            printf("[%s][%u]\n", mf->name, ((const Meta_Property*)mf)->offset);
    }
}

} // namespace OLMA
