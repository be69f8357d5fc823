// Model paths arrive from clients and adapter events: whatever the text,
// reading it must neither crash nor leak, and what it yields must survive
// the round trip through clone, write and read.

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include "../runtime/records.h"

using namespace OLMA;

// String keys are written without escapes, so a quote or backslash in one
// changes (or breaks) what reads back.
static void _check_plain(Instance* instance, void* data)
{
    const Meta_Class* mc = instance->meta_class;

    for (size_t i = 0; i < mc->num_meta_features; i++)
    {
        const Meta_Property* mp = (const Meta_Property*)mc->meta_features[i];

        if ((mp->flags & FLAG_PROPERTY) && mp->type == STRING && !mp->subscript)
        {
            const String& s = *(const String*)__slot(instance, mp->offset);

            if (s.find('"') != (size_t)-1 || s.find('\\') != (size_t)-1)
                *(bool*)data = false;
        }
    }
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    char* text = (char*)malloc(size + 1);
    memcpy(text, data, size);
    text[size] = '\0';

    Instance* x = model_path_to_instance(&Test_Device::static_meta_class, text);

    if (x)
    {
        if (!keys_non_null(x))
            abort();

        Instance* y = clone(x);

        if (!identical(x, y) || !key_eq(x, y))
            abort();

        String path;

        if (instance_to_model_path(y, path) == 0)
        {
            bool plain = true;
            __visit(y, _check_plain, &plain);
            Instance* z = model_path_to_instance(&Test_Device::static_meta_class, path.c_str());

            if (plain && (!z || !key_eq(x, z)))
                abort();

            unref(z);
        }

        unref(y);
        unref(x);
    }

    // The same text as a property value of every type.
    if (size)
    {
        Instance* d = create(&Test_Device::static_meta_class, true);
        const Meta_Class* mc = d->meta_class;
        const Meta_Feature* mf = mc->meta_features[data[0] % mc->num_meta_features];

        if (mf->flags & FLAG_PROPERTY)
            __put_property_from_str(d, (const Meta_Property*)mf, text + 1);

        unref(d);
    }

    free(text);
    return 0;
}
