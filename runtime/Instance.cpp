#include "Instance.h"
#include <cmath>
#include <cstddef>
#include <cstring>
#include <new>
#include "log.h"

namespace OLMA
{

// The generated tables rely on these positions.
static_assert(offsetof(Instance, refs) == 4 && offsetof(Instance, meta_class) == 8 &&
        offsetof(Instance, __name_space) == 16,
    "Instance layout");
static_assert(offsetof(Property<boolean>, null) == 1 && offsetof(Property<char16>, null) == 2 &&
        offsetof(Property<real32>, null) == 4 && offsetof(Property<sint64>, null) == 8 &&
        offsetof(Property<String>, null) == 8 && offsetof(Property<Datetime>, null) == 8 &&
        offsetof(Property<Array<uint8>>, null) == 8,
    "a property's null byte follows its value");

const Meta_Class Instance::static_meta_class =
{
    // refs, flags, name, meta_qualifiers, num_meta_qualifiers
    { 0, FLAG_CLASS, "Instance", 0, 0 },
    // meta_features, num_meta_features, size, locals, super_meta_class,
    // num_keys, meta_repository
    0, 0, sizeof(Instance), 0, 0, 0, 0,
};

//
// Slot helpers. Reference arrays hold raw instance pointers; the traits
// never copy or release them, this file does.
//

typedef __Array_Rep* Rep;

static inline Rep& _rep(const Instance* i, const Meta_Feature* mf)
{
    const uint32 offset = (mf->flags & FLAG_PROPERTY) ? ((const Meta_Property*)mf)->offset
                                                       : ((const Meta_Reference*)mf)->offset;
    return *(Rep*)__slot(i, offset);
}

static inline Instance*& _ref(const Instance* i, const Meta_Reference* mr)
{
    return *(Instance**)__slot(i, mr->offset);
}

// A reference array's null byte follows its pointer word like a property's.
static inline uint8& _ref_array_null(const Instance* i, const Meta_Reference* mr)
{
    return *((uint8*)i + mr->offset + sizeof(void*));
}

static inline Instance** _elements(Rep rep)
{
    return (Instance**)rep->data();
}

static inline const __Array_Traits* _ref_traits()
{
    return __Array_Traits_Factory_Raw<void*>::traits();
}

static inline bool _is_key(const Meta_Feature* mf)
{
    return (mf->flags & FLAG_KEY) != 0;
}

static inline bool _valid_type(const Meta_Property* mp)
{
    return mp->type < NUM_TYPES;
}

static void _release_elements(Rep rep)
{
    Instance** p = _elements(rep);

    for (size_t i = 0; i < rep->size; i++)
        unref(p[i]);
}

// Appends deep clones of src's elements (null stays null) to dest.
static void _append_clones(Rep& dest, const __Array_Rep* src)
{
    Instance* const* p = (Instance* const*)src->data();

    for (size_t i = 0; i < src->size; i++)
    {
        Instance* x = p[i] ? clone(p[i]) : 0;
        __append(dest, &x, 1);
    }
}

//
// Creation
//

// Stores a default value from its literal. Strings and datetimes are texts.
static void _construct_default(void* slot, const Meta_Property* mp)
{
    const Type type = (Type)mp->type;

    if (mp->subscript)
    {
        Rep& rep = *(Rep*)slot;
        const Meta_Value_Array<char>* mva = (const Meta_Value_Array<char>*)mp->value;

        if (type == STRING || type == DATETIME)
        {
            const char* const* e = (const char* const*)mva->elements;

            for (size_t i = 0; i < mva->num_elements; i++)
            {
                if (type == STRING)
                {
                    String s(e[i] ? e[i] : "");
                    __append(rep, &s, 1);
                }
                else
                {
                    Datetime d;
                    if (e[i])
                        d.set(e[i]);
                    __append(rep, &d, 1);
                }
            }
        }
        else
            __append(rep, mva->elements, mva->num_elements);

        return;
    }

    if (type == STRING)
    {
        const char* s = ((const Meta_Value_Scalar<const char*>*)mp->value)->value;
        new (slot) String(s ? s : "");
    }
    else if (type == DATETIME)
    {
        const char* s = ((const Meta_Value_Scalar<const char*>*)mp->value)->value;
        Datetime* d = new (slot) Datetime();
        if (s)
            d->set(s);
    }
    else
        memcpy(slot, mp->value, type_size[type]);
}

// Brings a zeroed record to life: every slot constructed, defaults stored
// (or null bytes set) if asked.
static void __default_construct(const Meta_Class* mc, Instance* instance, bool defaults)
{
    instance->magic = INSTANCE_MAGIC;
    instance->refs = 1;
    instance->meta_class = mc;
    new (&instance->__name_space) String();
    ref(mc);

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (mf->flags & FLAG_REFERENCE)
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;

            if (mr->subscript)
                __construct(_rep(instance, mr), _ref_traits());
        }
        else if (mf->flags & FLAG_PROPERTY)
        {
            const Meta_Property* mp = (const Meta_Property*)mf;

            if (!_valid_type(mp))
                continue;

            void* slot = __slot(instance, mp->offset);

            if (defaults && mp->value)
            {
                if (mp->subscript)
                    __construct(*(Rep*)slot, __cim_array_traits[mp->type]);

                _construct_default(slot, mp);
                continue;
            }

            if (mp->subscript)
                __construct(*(Rep*)slot, __cim_array_traits[mp->type]);
            else if (mp->type == STRING)
                new (slot) String();
            else if (mp->type == DATETIME)
                new (slot) Datetime();

            if (defaults)
                __null_of(instance, mp) = 1;
        }
    }
}

static Instance* _allocate(size_t size)
{
    if (size < sizeof(Instance))
        size = sizeof(Instance);

    void* p = ::operator new(size);
    memset(p, 0, size);
    return (Instance*)p;
}

Instance* create(const Meta_Class* mc, bool defaults)
{
    if (!mc)
        return 0;

    Instance* instance = _allocate(mc->size);
    __default_construct(mc, instance, defaults);
    return instance;
}

Instance* create(const Meta_Method* mm)
{
    if (!mm)
        return 0;

    // A method's frame starts with every parameter null: nothing was passed.
    return create((const Meta_Class*)mm, true);
}

Instance* clone(const Instance* instance)
{
    if (!instance)
        return 0;

    const Meta_Class* mc = instance->meta_class;
    Instance* p = _allocate(mc->size);

    // The bytewise copy carries numbers and null bytes; everything that owns
    // memory is then built anew over the copied bits. The reference count is
    // left out: other threads may be counting on the original right now.
    const size_t countStart = offsetof(Instance, refs);
    const size_t countEnd = countStart + sizeof(instance->refs);
    memcpy((void*)p, (const void*)instance, countStart);
    memcpy((char*)p + countEnd, (const char*)instance + countEnd, mc->size - countEnd);
    p->refs = 1;
    new (&p->__name_space) String(instance->__name_space);
    ref(mc);

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (mf->flags & FLAG_REFERENCE)
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;

            if (mr->subscript)
            {
                Rep& rep = _rep(p, mr);
                __construct(rep, _ref_traits());
                _append_clones(rep, _rep(instance, mr));
            }
            else
            {
                Instance*& x = _ref(p, mr);
                x = clone(x);
            }
        }
        else if (mf->flags & FLAG_PROPERTY)
        {
            const Meta_Property* mp = (const Meta_Property*)mf;

            if (!_valid_type(mp))
                continue;

            void* to = __slot(p, mp->offset);
            const void* from = __slot(instance, mp->offset);

            if (mp->subscript)
                __construct(*(Rep*)to, *(const Rep*)from);
            else if (mp->type == STRING)
                new (to) String(*(const String*)from);
            else if (mp->type == DATETIME)
                new (to) Datetime(*(const Datetime*)from);
        }
    }

    return p;
}

Instance* key_clone(const Instance* instance)
{
    if (!instance)
        return 0;

    Instance* p = create(instance->meta_class, false);
    __set_null_flags(p, true, true, 1);
    copy_keys(p, instance);
    return p;
}

static void __destruct(Instance* instance)
{
    const Meta_Class* mc = instance->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (mf->flags & FLAG_REFERENCE)
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;

            if (mr->subscript)
            {
                Rep rep = _rep(instance, mr);
                _release_elements(rep);
                __destruct(rep);
            }
            else
                unref(_ref(instance, mr));
        }
        else if (mf->flags & FLAG_PROPERTY)
        {
            const Meta_Property* mp = (const Meta_Property*)mf;

            if (!_valid_type(mp))
                continue;

            void* slot = __slot(instance, mp->offset);

            if (mp->subscript)
                __destruct(*(Rep*)slot);
            else if (mp->type == STRING)
                ((String*)slot)->~String();
            else if (mp->type == DATETIME)
                ((Datetime*)slot)->~Datetime();
        }
    }

    unref(mc);
    instance->__name_space.~String();
}

void destroy(Instance* instance)
{
    if (!instance)
        return;

    TESSEL_ASSERT(instance->magic == INSTANCE_MAGIC);
    __destruct(instance);

    // Makes a second destroy or a late use trip the magic test.
    instance->magic = 0xDDDDDDDD;
    ::operator delete((void*)instance);
}

void destroyer(Instance* instance)
{
    if (instance)
        destroy(instance);
}

void ref(const Instance* instance)
{
    if (instance)
        __atomic_add_fetch(&((Instance*)instance)->refs, 1, __ATOMIC_ACQ_REL);
}

void unref(const Instance* instance)
{
    if (instance && __atomic_sub_fetch(&((Instance*)instance)->refs, 1, __ATOMIC_ACQ_REL) == 0)
        destroy((Instance*)instance);
}

//
// Contents
//

void clear(Instance* instance)
{
    if (!instance)
        return;

    const Meta_Class* mc = instance->meta_class;
    instance->__name_space.clear();

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (mf->flags & FLAG_REFERENCE)
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;

            if (mr->subscript)
            {
                Rep& rep = _rep(instance, mr);
                _release_elements(rep);
                __remove(rep, 0, rep->size);
                _ref_array_null(instance, mr) = 1;
            }
            else
            {
                Instance*& x = _ref(instance, mr);
                unref(x);
                x = 0;
            }
        }
        else if (mf->flags & FLAG_PROPERTY)
        {
            const Meta_Property* mp = (const Meta_Property*)mf;

            if (!_valid_type(mp))
                continue;

            void* slot = __slot(instance, mp->offset);

            if (mp->subscript)
            {
                Rep& rep = *(Rep*)slot;
                __remove(rep, 0, rep->size);
            }
            else if (mp->type == STRING)
                ((String*)slot)->clear();
            else if (mp->type == DATETIME)
                ((Datetime*)slot)->clear();
            else
                memset(slot, 0, type_size[mp->type]);

            __null_of(instance, mp) = 1;
        }
    }
}

// Whether the model wants the feature: it is non-null there. A model of
// another class is consulted by name; a feature it lacks isn't wanted.
static bool _wanted(const Instance* model, const Meta_Class* mc, const Meta_Feature* mf)
{
    if (!model)
        return true;

    const Meta_Feature* f = model->meta_class == mc
        ? mf
        : find_feature(model->meta_class, mf->name, mf->flags & FLAG_ANY_FEATURE);

    if (!f)
        return false;

    if (f->flags & FLAG_PROPERTY)
        return __null_of(model, (const Meta_Property*)f) == 0;

    const Meta_Reference* mr = (const Meta_Reference*)f;

    if (mr->subscript)
        return _ref_array_null(model, mr) == 0;

    return _ref(model, mr) != 0;
}

static void __copy(Instance* dest, const Instance* src, bool keys_only, const Instance* model)
{
    if (!dest || !src || dest == src || dest->meta_class != src->meta_class)
        return;

    const Meta_Class* mc = src->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (!(mf->flags & (FLAG_PROPERTY | FLAG_REFERENCE)))
            continue;

        if (keys_only && !_is_key(mf))
            continue;

        if (!_wanted(model, mc, mf))
            continue;

        if (mf->flags & FLAG_REFERENCE)
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;

            if (mr->subscript)
            {
                Rep& rep = _rep(dest, mr);
                _release_elements(rep);
                __remove(rep, 0, rep->size);
                _append_clones(rep, _rep(src, mr));
                _ref_array_null(dest, mr) = _ref_array_null(src, mr);
            }
            else
            {
                Instance*& x = _ref(dest, mr);
                Instance* y = clone(_ref(src, mr));
                unref(x);
                x = y;
            }

            continue;
        }

        const Meta_Property* mp = (const Meta_Property*)mf;

        if (!_valid_type(mp))
            continue;

        void* to = __slot(dest, mp->offset);
        const void* from = __slot(src, mp->offset);

        if (mp->subscript)
            __assign(*(Rep*)to, *(const Rep*)from);
        else if (mp->type == STRING)
            *(String*)to = *(const String*)from;
        else if (mp->type == DATETIME)
            *(Datetime*)to = *(const Datetime*)from;
        else
            memcpy(to, from, type_size[mp->type]);

        __null_of(dest, mp) = __null_of(src, mp);
    }
}

void copy(Instance* dest, const Instance* src)
{
    __copy(dest, src, false, 0);
}

void copy(Instance* dest, const Instance* src, const Instance* model)
{
    __copy(dest, src, false, model);
}

void copy_keys(Instance* dest, const Instance* src)
{
    __copy(dest, src, true, 0);
}

//
// Comparison
//

template<class T>
static inline bool _eq(const void* x, const void* y)
{
    T a;
    T b;
    memcpy(&a, x, sizeof(T));
    memcpy(&b, y, sizeof(T));
    return a == b;
}

// NaN equals nothing, itself included.
template<class T>
static inline bool _real_eq(const void* x, const void* y)
{
    T a;
    T b;
    memcpy(&a, x, sizeof(T));
    memcpy(&b, y, sizeof(T));
    return !(a < b) && !(a > b) && !std::isnan(a) && !std::isnan(b);
}

bool property_eq(const Meta_Property* mp, const void* x, const void* y)
{
    if (!_valid_type(mp))
        return false;

    const uint32 n = __null_offset(mp);

    // Two null values are still compared: stale values tell them apart.
    if (((const uint8*)x)[n] != ((const uint8*)y)[n])
        return false;

    if (mp->subscript)
        return __equal(*(const Rep*)x, *(const Rep*)y);

    switch (mp->type)
    {
        case BOOLEAN:
        case UINT8:
        case SINT8:
            return _eq<uint8>(x, y);
        case UINT16:
        case SINT16:
        case CHAR16:
            return _eq<uint16>(x, y);
        case UINT32:
        case SINT32:
            return _eq<uint32>(x, y);
        case UINT64:
        case SINT64:
            return _eq<uint64>(x, y);
        case REAL32:
            return _real_eq<real32>(x, y);
        case REAL64:
            return _real_eq<real64>(x, y);
        case STRING:
            return ((const String*)x)->equal(*(const String*)y);
        case DATETIME:
        {
            const Datetime* a = (const Datetime*)x;
            const Datetime* b = (const Datetime*)y;
            return a->usec() == b->usec() && a->offset() == b->offset() &&
                a->is_timestamp() == b->is_timestamp();
        }
    }

    return false;
}

bool key_eq(const Instance* x, const Instance* y)
{
    if (!x || !y)
        return x == y;

    const Meta_Class* mcx = x->meta_class;
    const Meta_Class* mcy = y->meta_class;

    for (size_t i = 0; i < mcx->num_meta_features; i++)
    {
        const Meta_Feature* mf = mcx->meta_features[i];

        if (!_is_key(mf))
            continue;

        if (mf->flags & FLAG_PROPERTY)
        {
            const Meta_Property* mp = (const Meta_Property*)mf;
            const Meta_Property* mq =
                mcx == mcy ? mp : (const Meta_Property*)find_feature(mcy, mp->name, FLAG_PROPERTY);

            if (!mq || !_is_key(mq) || mq->type != mp->type || mq->subscript != mp->subscript)
                return false;

            if (!property_eq(mp, __slot(x, mp->offset), __slot(y, mq->offset)))
                return false;
        }
        else if (mf->flags & FLAG_REFERENCE)
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;

            if (mr->subscript)
                continue;

            const Meta_Reference* ms =
                mcx == mcy ? mr : (const Meta_Reference*)find_feature(mcy, mr->name, FLAG_REFERENCE);

            if (!ms || !_is_key(ms) || ms->subscript)
                return false;

            if (!is_subclass(mr->meta_class, ms->meta_class) &&
                !is_subclass(ms->meta_class, mr->meta_class))
                return false;

            const Instance* a = _ref(x, mr);
            const Instance* b = _ref(y, ms);

            if ((a == 0) != (b == 0))
                return false;

            if (a && !key_eq(a, b))
                return false;
        }
    }

    return true;
}

bool identical(const Instance* x, const Instance* y)
{
    if (!x || !y)
        return x == y;

    if (x->meta_class != y->meta_class || !x->__name_space.equal(y->__name_space))
        return false;

    const Meta_Class* mc = x->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (mf->flags & FLAG_PROPERTY)
        {
            const Meta_Property* mp = (const Meta_Property*)mf;

            if (!property_eq(mp, __slot(x, mp->offset), __slot(y, mp->offset)))
                return false;
        }
        else if (mf->flags & FLAG_REFERENCE)
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;

            if (!mr->subscript)
            {
                if (!identical(_ref(x, mr), _ref(y, mr)))
                    return false;

                continue;
            }

            const __Array_Rep* a = _rep(x, mr);
            const __Array_Rep* b = _rep(y, mr);

            if (a->size != b->size || _ref_array_null(x, mr) != _ref_array_null(y, mr))
                return false;

            for (size_t j = 0; j < a->size; j++)
            {
                if (!identical(((Instance* const*)a->data())[j], ((Instance* const*)b->data())[j]))
                    return false;
            }
        }
    }

    return true;
}

bool keys_non_null(const Instance* instance)
{
    const Meta_Class* mc = instance->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (!_is_key(mf))
            continue;

        if (mf->flags & FLAG_PROPERTY)
        {
            if (__null_of(instance, (const Meta_Property*)mf))
                return false;
        }
        else if (mf->flags & FLAG_REFERENCE)
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;

            if (!mr->subscript && !_ref(instance, mr))
                return false;
        }
    }

    return true;
}

//
// Models
//

void __set_null_flags(const Instance* instance, bool include_keys, bool include_non_keys, uint8 value)
{
    const Meta_Class* mc = instance->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (!(mf->flags & FLAG_PROPERTY) || !_valid_type((const Meta_Property*)mf))
            continue;

        if (_is_key(mf) ? include_keys : include_non_keys)
            __null_of(instance, (const Meta_Property*)mf) = value;
    }
}

int filter_properties(Instance* instance, const char* const* names, bool keep_keys)
{
    if (!instance)
        return -1;

    if (!names)
    {
        __set_null_flags(instance, true, true, 0);
        return 0;
    }

    __set_null_flags(instance, !keep_keys, true, 1);

    for (const char* const* p = names; *p; p++)
    {
        const Meta_Feature* mf = find_feature(instance->meta_class, *p, FLAG_ANY_FEATURE);

        if (!mf || _is_key(mf))
            continue;

        if (mf->flags & FLAG_METHOD)
            return -1;

        if (mf->flags & FLAG_PROPERTY)
            __null_of(instance, (const Meta_Property*)mf) = 0;
        else
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;

            if (mr->subscript)
                _ref_array_null(instance, mr) = 0;
            else if (!_ref(instance, mr) && mr->meta_class)
                _ref(instance, mr) = create(mr->meta_class, false);
        }
    }

    return 0;
}

void __create_refs(Instance* instance)
{
    const Meta_Class* mc = instance->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (!(mf->flags & FLAG_REFERENCE))
            continue;

        const Meta_Reference* mr = (const Meta_Reference*)mf;

        if (!mr->subscript && !_ref(instance, mr) && mr->meta_class)
            _ref(instance, mr) = create(mr->meta_class, true);
    }
}

void __visit(Instance* instance, void (*visitor)(Instance*, void*), void* data)
{
    if (!instance)
        return;

    visitor(instance, data);

    const Meta_Class* mc = instance->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (!(mf->flags & FLAG_REFERENCE))
            continue;

        const Meta_Reference* mr = (const Meta_Reference*)mf;

        if (!mr->subscript)
        {
            __visit(_ref(instance, mr), visitor, data);
            continue;
        }

        Rep rep = _rep(instance, mr);

        for (size_t j = 0; j < rep->size; j++)
            __visit(_elements(rep)[j], visitor, data);
    }
}

struct Name_Space_Data
{
    const char* name_space;
    bool force;
};

static void _set_name_space(Instance* instance, void* data)
{
    const Name_Space_Data* p = (const Name_Space_Data*)data;

    if (p->force || instance->__name_space.size() == 0)
        instance->__name_space.assign(p->name_space);
}

void __set_name_space_recursive(Instance* instance, const char* name_space, bool force)
{
    Name_Space_Data data = { name_space ? name_space : "", force };
    __visit(instance, _set_name_space, &data);
}

} // namespace OLMA
