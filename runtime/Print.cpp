// Instances as readable text, for diagnostics only: nothing reads it back.

#include "Instance.h"
#include "Strings.h"

namespace OLMA
{

static void _fprint_element(FILE* os, Type type, const void* p)
{
    switch (type)
    {
        case CHAR16:
        {
            const uint16 c = *(const uint16*)p;

            if (c >= 32 && c <= 126)
                fprintf(os, "'%c'", (int)c);
            else
                fprintf(os, "0x%04X", c);
            break;
        }
        case STRING:
            fprint_string(os, ((const String*)p)->c_str());
            break;
        case DATETIME:
            fprintf(os, "\"%s\"", ((const Datetime*)p)->ascii(false).c_str());
            break;
        case BOOLEAN:
        {
            // Read as a byte: a stray value in a bool slot must not be UB.
            const bool b = *(const uint8*)p != 0;
            fprint_scalar(os, type, &b);
            break;
        }
        default:
            fprint_scalar(os, type, p);
            break;
    }
}

static void _fprint_value(FILE* os, const Instance* instance, const Meta_Property* mp)
{
    if (__null_of(instance, mp))
    {
        fputs("NULL", os);
        return;
    }

    const Type type = (Type)mp->type;
    const void* slot = __slot(instance, mp->offset);

    if (!mp->subscript)
    {
        _fprint_element(os, type, slot);
        return;
    }

    const __Array_Rep* rep = *(const __Array_Rep* const*)slot;

    if (rep->size == 0)
    {
        fputs("{ }", os);
        return;
    }

    fputs("{ ", os);

    for (size_t i = 0; i < rep->size; i++)
    {
        if (i)
            fputs(", ", os);

        _fprint_element(os, type, rep->data() + i * rep->traits->size);
    }

    fputs(" }", os);
}

static void _fprint(FILE* os, const Instance* instance, size_t level, bool keys_only,
    bool nested, const char* name);

static bool _shown(const Meta_Feature* mf, bool keys_only, bool nested)
{
    if (mf->flags & FLAG_KEY)
        return true;

    if (nested)
        return (mf->flags & (FLAG_EMBEDDED_OBJECT | FLAG_EMBEDDED_INSTANCE)) != 0;

    return !keys_only;
}

static void _fprint_features(
    FILE* os, const Instance* instance, size_t level, bool keys_only, bool nested)
{
    const Meta_Class* mc = instance->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Feature* mf = mc->meta_features[i];

        if (!_shown(mf, keys_only, nested))
            continue;

        if (mf->flags & FLAG_PROPERTY)
        {
            const Meta_Property* mp = (const Meta_Property*)mf;

            if (mp->type >= NUM_TYPES)
                continue;

            ifprintf(os, level, "%s %s%s = ", type_name[mp->type], mp->name,
                mp->subscript ? "[]" : "");
            _fprint_value(os, instance, mp);
            fputs(";\n", os);
        }
        else if (mf->flags & FLAG_REFERENCE)
        {
            const Meta_Reference* mr = (const Meta_Reference*)mf;
            const char* class_name = mr->meta_class ? mr->meta_class->name : "Instance";
            const void* slot = __slot(instance, mr->offset);

            if (!mr->subscript)
            {
                const Instance* x = *(Instance* const*)slot;

                if (x)
                    _fprint(os, x, level, keys_only, true, mr->name);
                else
                    ifprintf(os, level, "%s %s = NULL;\n", class_name, mr->name);

                continue;
            }

            if (*((const uint8*)slot + sizeof(void*)))
            {
                ifprintf(os, level, "%s %s[] = NULL;\n", class_name, mr->name);
                continue;
            }

            const __Array_Rep* rep = *(const __Array_Rep* const*)slot;
            Instance* const* elements = (Instance* const*)rep->data();

            ifprintf(os, level, "%s %s[] =\n", class_name, mr->name);
            ifprintf(os, level, "{\n");

            for (size_t j = 0; j < rep->size; j++)
            {
                if (elements[j])
                    _fprint(os, elements[j], level + 1, keys_only, true, 0);
                else
                    ifprintf(os, level + 1, "NULL\n");
            }

            ifprintf(os, level, "}\n");
        }
    }
}

static void _fprint(FILE* os, const Instance* instance, size_t level, bool keys_only,
    bool nested, const char* name)
{
    const char* class_name = instance->meta_class->name;

    if (name)
        ifprintf(os, level, "%s %s =\n", class_name, name);
    else
        ifprintf(os, level, "%s\n", class_name);

    ifprintf(os, level, "{\n");

    if (instance->__name_space.size())
        ifprintf(os, level + 1, "string __name_space = \"%s\";\n", instance->__name_space.c_str());

    _fprint_features(os, instance, level + 1, keys_only, nested);
    ifprintf(os, level, "}\n");
}

void fprint(FILE* os, const Instance* instance, bool keys_only)
{
    if (!instance)
    {
        fputs("NULL\n", os);
        return;
    }

    _fprint(os, instance, 0, keys_only, false, 0);
}

void print(const Instance* instance, bool keys_only)
{
    fprint(stdout, instance, keys_only);
}

} // namespace OLMA
