/* A small provider module in plain C for the tests of cimhost: widgets and
 * gadgets (instances), their pairs (an association), widget methods that
 * call back into the broker, and an event class whose provider delivers
 * from a thread of its own. Its classes are in testprov.mof. */

#include <pthread.h>
#include <stdio.h>
#include <string.h>
#include <strings.h>
#include <time.h>

#include "cmpidt.h"
#include "cmpift.h"
#include "cmpimacs.h"

/* What the tests look at. */
struct testprov_state
{
    int creates;
    int cleanups;
    int authorize;
    int must_poll;
    int activate;
    int first_activation;
    int deactivate;
    int last_deactivation;
    int enable;
    int disable;
    int delivered;
    int refuse_unload; /* set by a test: cleanup answers DO_NOT_UNLOAD */
    int fail_enable;   /* set by a test: enableIndications fails */
};

CMPI_EXPORT struct testprov_state testprov_counters;

static const CMPIBroker* broker;

#define COUNT_CREATE testprov_counters.creates++

/*
 * Data
 */

struct widget
{
    const char* name;
    unsigned short size;
};

static const struct widget widgets[] = {{"a", 1}, {"b", 2}, {"c", 3}};
static const unsigned gadgets[] = {1, 2};
static const struct
{
    const char* widget;
    unsigned gadget;
} pairs[] = {{"a", 1}, {"a", 2}, {"b", 2}};

#define N(a) (sizeof(a) / sizeof((a)[0]))

static const char* ns_of(const CMPIObjectPath* op)
{
    CMPIString* s = CMGetNameSpace(op, NULL);
    return s ? CMGetCharsPtr(s, NULL) : "root/test";
}

static CMPIObjectPath* widget_path(const char* ns, const char* name)
{
    CMPIObjectPath* op = CMNewObjectPath(broker, ns, "Test_Widget", NULL);
    CMAddKey(op, "Name", name, CMPI_chars);
    return op;
}

static CMPIObjectPath* gadget_path(const char* ns, unsigned id)
{
    CMPIObjectPath* op = CMNewObjectPath(broker, ns, "Test_Gadget", NULL);
    CMPIUint32 v = id;
    CMAddKey(op, "Id", &v, CMPI_uint32);
    return op;
}

static CMPIInstance* widget_instance(const char* ns, const struct widget* w)
{
    CMPIInstance* ci = CMNewInstance(broker, widget_path(ns, w->name), NULL);
    CMPIString* red = CMNewString(broker, "red", NULL);
    CMPIArray* tags = CMNewArray(broker, 2, CMPI_string, NULL);
    CMPIDateTime* created = CMNewDateTimeFromChars(broker, "20240102030405.000006+060", NULL);
    CMPIBoolean enabled = w->size != 2;
    CMPIReal64 ratio = w->size / 4.0;
    CMSetArrayElementAt(tags, 0, &red, CMPI_string);
    CMSetProperty(ci, "Name", w->name, CMPI_chars);
    CMSetProperty(ci, "Size", &w->size, CMPI_uint16);
    CMSetProperty(ci, "Tags", &tags, CMPI_stringA);
    CMSetProperty(ci, "Created", &created, CMPI_dateTime);
    CMSetProperty(ci, "Enabled", &enabled, CMPI_boolean);
    CMSetProperty(ci, "Ratio", &ratio, CMPI_real64);
    CMSetProperty(ci, "Note", NULL, CMPI_string);
    return ci;
}

static const struct widget* find_widget(const CMPIObjectPath* op)
{
    CMPIStatus rc;
    CMPIData d = CMGetKey(op, "Name", &rc);
    size_t i;
    if (rc.rc != CMPI_RC_OK || d.type != CMPI_string || !d.value.string)
        return NULL;
    for (i = 0; i < N(widgets); i++)
        if (strcmp(CMGetCharsPtr(d.value.string, NULL), widgets[i].name) == 0)
            return &widgets[i];
    return NULL;
}

/* Integer keys may come back in any width. */
static int read_uint_key(const CMPIObjectPath* op, const char* name, unsigned long long* v)
{
    CMPIData d = CMGetKey(op, name, NULL);
    if (d.state & (CMPI_nullValue | CMPI_notFound))
        return 0;
    switch (d.type)
    {
    case CMPI_uint64: *v = d.value.uint64; return 1;
    case CMPI_uint32: *v = d.value.uint32; return 1;
    case CMPI_sint64: *v = (unsigned long long)d.value.sint64; return 1;
    default: return 0;
    }
}

/*
 * Test_Widget: instances
 */

static CMPIStatus Widget_Cleanup(CMPIInstanceMI* mi, const CMPIContext* ctx, CMPIBoolean term)
{
    (void)mi;
    (void)ctx;
    testprov_counters.cleanups++;
    if (testprov_counters.refuse_unload && !term)
        CMReturn(CMPI_RC_DO_NOT_UNLOAD);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Widget_EnumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                           const CMPIResult* rslt, const CMPIObjectPath* op)
{
    size_t i;
    (void)mi;
    (void)ctx;
    for (i = 0; i < N(widgets); i++)
        CMReturnObjectPath(rslt, widget_path(ns_of(op), widgets[i].name));
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Widget_EnumInstances(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                       const CMPIResult* rslt, const CMPIObjectPath* op,
                                       const char** properties)
{
    size_t i;
    (void)mi;
    (void)ctx;
    static const char* keys[] = {"Name", NULL};
    for (i = 0; i < N(widgets); i++)
    {
        CMPIInstance* ci = widget_instance(ns_of(op), &widgets[i]);
        if (properties)
            CMSetPropertyFilter(ci, properties, keys);
        CMReturnInstance(rslt, ci);
        CMRelease(ci);
    }
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Widget_GetInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                     const CMPIResult* rslt, const CMPIObjectPath* op,
                                     const char** properties)
{
    const struct widget* w = find_widget(op);
    CMPIInstance* ci;
    (void)mi;
    (void)ctx;
    if (!w)
        CMReturnWithChars(broker, CMPI_RC_ERR_NOT_FOUND, "no such widget");
    ci = widget_instance(ns_of(op), w);
    /* No key list: a server that builds the path from what is left loses
     * the keys the list doesn't name. */
    if (properties)
        CMSetPropertyFilter(ci, properties, NULL);
    CMReturnInstance(rslt, ci);
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Widget_CreateInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                        const CMPIResult* rslt, const CMPIObjectPath* op,
                                        const CMPIInstance* inst)
{
    CMPIData name = CMGetProperty(inst, "Name", NULL);
    size_t i;
    (void)mi;
    (void)ctx;
    if (name.type != CMPI_string || (name.state & CMPI_nullValue))
        CMReturn(CMPI_RC_ERR_INVALID_PARAMETER);
    for (i = 0; i < N(widgets); i++)
        if (strcmp(widgets[i].name, CMGetCharsPtr(name.value.string, NULL)) == 0)
            CMReturn(CMPI_RC_ERR_ALREADY_EXISTS);
    CMReturnObjectPath(rslt, widget_path(ns_of(op), CMGetCharsPtr(name.value.string, NULL)));
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Widget_ModifyInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                        const CMPIResult* rslt, const CMPIObjectPath* op,
                                        const CMPIInstance* inst, const char** properties)
{
    CMPIData size = CMGetProperty(inst, "Size", NULL);
    (void)mi;
    (void)ctx;
    (void)rslt;
    if (!find_widget(op))
        CMReturn(CMPI_RC_ERR_NOT_FOUND);
    if (size.type != CMPI_uint16 || !properties || !properties[0] ||
        strcasecmp(properties[0], "Size") != 0)
        CMReturn(CMPI_RC_ERR_INVALID_PARAMETER);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Widget_DeleteInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                        const CMPIResult* rslt, const CMPIObjectPath* op)
{
    (void)mi;
    (void)ctx;
    (void)rslt;
    CMReturn(find_widget(op) ? CMPI_RC_OK : CMPI_RC_ERR_NOT_FOUND);
}

static CMPIStatus Widget_ExecQuery(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                   const CMPIResult* rslt, const CMPIObjectPath* op,
                                   const char* query, const char* lang)
{
    (void)query;
    if (strcasecmp(lang, "WQL") != 0)
        CMReturn(CMPI_RC_ERR_QUERY_LANGUAGE_NOT_SUPPORTED);
    return Widget_EnumInstances(mi, ctx, rslt, op, NULL);
}

/* What the other classes don't do. */
static CMPIStatus None_CreateInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                      const CMPIResult* rslt, const CMPIObjectPath* op,
                                      const CMPIInstance* inst)
{
    (void)mi;
    (void)ctx;
    (void)rslt;
    (void)op;
    (void)inst;
    CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

static CMPIStatus None_ModifyInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                      const CMPIResult* rslt, const CMPIObjectPath* op,
                                      const CMPIInstance* inst, const char** properties)
{
    (void)properties;
    return None_CreateInstance(mi, ctx, rslt, op, inst);
}

static CMPIStatus None_DeleteInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                      const CMPIResult* rslt, const CMPIObjectPath* op)
{
    return None_CreateInstance(mi, ctx, rslt, op, NULL);
}

static CMPIStatus None_ExecQuery(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                 const CMPIResult* rslt, const CMPIObjectPath* op,
                                 const char* query, const char* lang)
{
    (void)query;
    (void)lang;
    return None_CreateInstance(mi, ctx, rslt, op, NULL);
}

CMInstanceMIStub(Widget_, Test_Widget_Provider, broker, COUNT_CREATE)

/*
 * Test_Widget: methods, most of which call back into the broker
 */

static CMPIStatus Widget_MethodCleanup(CMPIMethodMI* mi, const CMPIContext* ctx, CMPIBoolean term)
{
    (void)mi;
    (void)ctx;
    testprov_counters.cleanups++;
    if (testprov_counters.refuse_unload && !term)
        CMReturn(CMPI_RC_DO_NOT_UNLOAD);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus set_string_out(CMPIArgs* out, const char* name, const char* text)
{
    CMPIString* s = CMNewString(broker, text, NULL);
    return CMAddArg(out, name, &s, CMPI_string);
}

static CMPIStatus return_uint32(const CMPIResult* rslt, CMPIUint32 v)
{
    CMReturnData(rslt, &v, CMPI_uint32);
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Widget_InvokeMethod(CMPIMethodMI* mi, const CMPIContext* ctx,
                                      const CMPIResult* rslt, const CMPIObjectPath* op,
                                      const char* method, const CMPIArgs* in, CMPIArgs* out)
{
    CMPIStatus rc = {CMPI_RC_OK, NULL};
    const char* ns = ns_of(op);
    (void)mi;

    if (strcasecmp(method, "Double") == 0)
    {
        CMPIData x = CMGetArg(in, "X", &rc);
        CMPIUint32 y;
        if (rc.rc != CMPI_RC_OK || x.type != CMPI_uint32 || (x.state & CMPI_nullValue))
            CMReturn(CMPI_RC_ERR_INVALID_PARAMETER);
        y = x.value.uint32 * 2;
        CMAddArg(out, "Y", &y, CMPI_uint32);
        return return_uint32(rslt, 0);
    }
    if (strcasecmp(method, "Lookup") == 0)
    {
        CMPIData t = CMGetArg(in, "Target", &rc);
        CMPIInstance* found;
        if (rc.rc != CMPI_RC_OK || t.type != CMPI_ref)
            CMReturn(CMPI_RC_ERR_INVALID_PARAMETER);
        found = CBGetInstance(broker, ctx, t.value.ref, NULL, &rc);
        if (found)
        {
            CMPIData name = CMGetProperty(found, "Name", NULL);
            if (name.type == CMPI_string)
                CMAddArg(out, "Found", &name.value.string, CMPI_string);
        }
        return return_uint32(rslt, (CMPIUint32)rc.rc);
    }
    if (strcasecmp(method, "CountAll") == 0)
    {
        CMPIUint32 n = 0;
        CMPIEnumeration* e = CBEnumInstances(broker, ctx, CMNewObjectPath(broker, ns, "Test_Widget", NULL),
                                             NULL, &rc);
        while (e && CMHasNext(e, NULL))
        {
            CMPIData d = CMGetNext(e, NULL);
            n += d.type == CMPI_instance;
        }
        e = CBEnumInstanceNames(broker, ctx, CMNewObjectPath(broker, ns, "Test_Gadget", NULL), &rc);
        while (e && CMHasNext(e, NULL))
        {
            CMPIData d = CMGetNext(e, NULL);
            n += d.type == CMPI_ref;
        }
        return return_uint32(rslt, n);
    }
    if (strcasecmp(method, "Call") == 0)
    {
        CMPIData name = CMGetArg(in, "Name", NULL);
        CMPIArgs* a = CMNewArgs(broker, NULL);
        CMPIArgs* o = CMNewArgs(broker, NULL);
        CMPIUint32 x = 21;
        CMPIData r, y;
        if (name.type != CMPI_string || (name.state & CMPI_nullValue))
            CMReturn(CMPI_RC_ERR_INVALID_PARAMETER);
        CMAddArg(a, "X", &x, CMPI_uint32);
        r = CBInvokeMethod(broker, ctx, widget_path(ns, CMGetCharsPtr(name.value.string, NULL)),
                           "Double", a, o, &rc);
        if (rc.rc != CMPI_RC_OK || r.type != CMPI_uint32)
            return rc;
        y = CMGetArg(o, "Y", NULL);
        return return_uint32(rslt, y.value.uint32);
    }
    if (strcasecmp(method, "Interop") == 0)
    {
        CMPIUint32 n = 0;
        CMPIEnumeration* e = CBEnumInstances(
            broker, ctx, CMNewObjectPath(broker, "root/PG_InterOp", "CIM_ObjectManager", NULL),
            NULL, &rc);
        while (e && CMHasNext(e, NULL))
        {
            CMPIData d = CMGetNext(e, NULL);
            if (n++ == 0 && d.type == CMPI_instance)
            {
                CMPIData name = CMGetProperty(d.value.inst, "Name", NULL);
                if (name.type == CMPI_string && !(name.state & CMPI_nullValue))
                    CMAddArg(out, "Name", &name.value.string, CMPI_string);
            }
        }
        CMAddArg(out, "Count", &n, CMPI_uint32);
        return return_uint32(rslt, (CMPIUint32)rc.rc);
    }
    if (strcasecmp(method, "Principal") == 0)
    {
        CMPIData user = CMGetContextEntry(ctx, CMPIPrincipal, &rc);
        if (rc.rc != CMPI_RC_OK || user.type != CMPI_string)
            return rc;
        CMAddArg(out, "User", &user.value.string, CMPI_string);
        return return_uint32(rslt, 0);
    }
    if (strcasecmp(method, "Leak") == 0)
    {
        /* Objects left for the host to free at the end of the request, and
         * some released here, twice over the same kinds. */
        CMPIString* s = CMNewString(broker, "kept", NULL);
        CMPIArray* a = CMNewArray(broker, 3, CMPI_uint8, NULL);
        CMPIInstance* i = CMNewInstance(broker, widget_path(ns, "z"), NULL);
        CMPIDateTime* d = CMNewDateTime(broker, NULL);
        CMPIString* t = CDToString(broker, i, NULL);
        CMPIArgs* g = CMNewArgs(broker, NULL);
        CMPISelectExp* se = CMNewSelectExp(broker, "SELECT * FROM Test_Event", "WQL", NULL, NULL);
        CMPIString* gone = CMNewString(broker, "released", NULL);
        CMPIUint8 v = 7;
        (void)s;
        (void)d;
        (void)t;
        (void)g;
        (void)se;
        CMSetArrayElementAt(a, 1, &v, CMPI_uint8);
        CMRelease(gone);
        CMRelease(CMClone(i, NULL));
        return return_uint32(rslt, 0);
    }
    if (strcasecmp(method, "Fail") == 0)
        CMReturnWithChars(broker, CMPI_RC_ERR_ACCESS_DENIED, "no way");
    if (strcasecmp(method, "Echo") == 0)
    {
        CMPICount n = CMGetArgCount(in, NULL), k;
        for (k = 0; k < n; k++)
        {
            CMPIString* name;
            CMPIData d = CMGetArgAt(in, k, &name, NULL);
            CMAddArg(out, CMGetCharsPtr(name, NULL), (d.state & CMPI_nullValue) ? NULL : &d.value,
                     d.type);
        }
        return return_uint32(rslt, n);
    }
    if (strcasecmp(method, "IsA") == 0)
    {
        CMPIData cls = CMGetArg(in, "Class", NULL);
        CMPIUint32 r;
        if (cls.type != CMPI_string)
            CMReturn(CMPI_RC_ERR_INVALID_PARAMETER);
        r = CMClassPathIsA(broker, op, CMGetCharsPtr(cls.value.string, NULL), NULL) ? 1 : 0;
        r |= CDIsOfType(broker, op, "CMPIObjectPath", NULL) ? 2 : 0;
        return return_uint32(rslt, r);
    }
    (void)set_string_out;
    CMReturn(CMPI_RC_ERR_METHOD_NOT_FOUND);
}

CMMethodMIStub(Widget_, Test_Widget_Provider, broker, COUNT_CREATE)

/*
 * Test_Gadget
 */

static CMPIInstance* gadget_instance(const char* ns, unsigned id)
{
    CMPIInstance* ci = CMNewInstance(broker, gadget_path(ns, id), NULL);
    CMPIUint32 v = id;
    char label[32];
    snprintf(label, sizeof(label), "gadget %u", id);
    CMSetProperty(ci, "Id", &v, CMPI_uint32);
    CMSetProperty(ci, "Label", label, CMPI_chars);
    return ci;
}

static CMPIStatus Gadget_Cleanup(CMPIInstanceMI* mi, const CMPIContext* ctx, CMPIBoolean term)
{
    (void)mi;
    (void)ctx;
    (void)term;
    testprov_counters.cleanups++;
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Gadget_EnumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                           const CMPIResult* rslt, const CMPIObjectPath* op)
{
    size_t i;
    (void)mi;
    (void)ctx;
    for (i = 0; i < N(gadgets); i++)
        CMReturnObjectPath(rslt, gadget_path(ns_of(op), gadgets[i]));
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Gadget_EnumInstances(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                       const CMPIResult* rslt, const CMPIObjectPath* op,
                                       const char** properties)
{
    size_t i;
    (void)mi;
    (void)ctx;
    (void)properties;
    for (i = 0; i < N(gadgets); i++)
        CMReturnInstance(rslt, gadget_instance(ns_of(op), gadgets[i]));
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Gadget_GetInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                     const CMPIResult* rslt, const CMPIObjectPath* op,
                                     const char** properties)
{
    unsigned long long id = 0;
    size_t i;
    (void)mi;
    (void)ctx;
    (void)properties;
    if (!read_uint_key(op, "Id", &id))
        CMReturn(CMPI_RC_ERR_INVALID_PARAMETER);
    for (i = 0; i < N(gadgets); i++)
        if (gadgets[i] == id)
        {
            CMReturnInstance(rslt, gadget_instance(ns_of(op), gadgets[i]));
            CMReturnDone(rslt);
            CMReturn(CMPI_RC_OK);
        }
    CMReturn(CMPI_RC_ERR_NOT_FOUND);
}

#define Gadget_CreateInstance None_CreateInstance
#define Gadget_ModifyInstance None_ModifyInstance
#define Gadget_DeleteInstance None_DeleteInstance
#define Gadget_ExecQuery None_ExecQuery

CMInstanceMIStub(Gadget_, Test_Gadget_Provider, broker, COUNT_CREATE)

/*
 * Test_WidgetGadget: the association
 */

static CMPIObjectPath* pair_path(const char* ns, size_t p)
{
    CMPIObjectPath* op = CMNewObjectPath(broker, ns, "Test_WidgetGadget", NULL);
    CMPIObjectPath* w = widget_path(ns, pairs[p].widget);
    CMPIObjectPath* g = gadget_path(ns, pairs[p].gadget);
    CMAddKey(op, "Widget", &w, CMPI_ref);
    CMAddKey(op, "Gadget", &g, CMPI_ref);
    return op;
}

static CMPIInstance* pair_instance(const char* ns, size_t p)
{
    CMPIInstance* ci = CMNewInstance(broker, pair_path(ns, p), NULL);
    CMPIObjectPath* w = widget_path(ns, pairs[p].widget);
    CMPIObjectPath* g = gadget_path(ns, pairs[p].gadget);
    CMSetProperty(ci, "Widget", &w, CMPI_ref);
    CMSetProperty(ci, "Gadget", &g, CMPI_ref);
    return ci;
}

/* Does pair p refer to the source in a role the filter allows? Sets the
 * other end's role. */
static int pair_matches(const CMPIObjectPath* src, size_t p, const char* role,
                        const char** other_role)
{
    CMPIString* cls = CMGetClassName(src, NULL);
    const char* cn = cls ? CMGetCharsPtr(cls, NULL) : "";
    if (strcasecmp(cn, "Test_Widget") == 0)
    {
        const struct widget* w = find_widget(src);
        *other_role = "Gadget";
        return w && strcmp(w->name, pairs[p].widget) == 0 && (!role || strcasecmp(role, "Widget") == 0);
    }
    if (strcasecmp(cn, "Test_Gadget") == 0)
    {
        unsigned long long id = 0;
        *other_role = "Widget";
        return read_uint_key(src, "Id", &id) && id == pairs[p].gadget &&
               (!role || strcasecmp(role, "Gadget") == 0);
    }
    return 0;
}

static CMPIObjectPath* other_end(const char* ns, size_t p, const char* other_role)
{
    return strcmp(other_role, "Gadget") == 0 ? gadget_path(ns, pairs[p].gadget)
                                            : widget_path(ns, pairs[p].widget);
}

static int other_passes(const char* other_role, const char* result_class, const char* result_role)
{
    const char* cls = strcmp(other_role, "Gadget") == 0 ? "Test_Gadget" : "Test_Widget";
    if (result_class && strcasecmp(result_class, cls) != 0)
        return 0;
    return !result_role || strcasecmp(result_role, other_role) == 0;
}

static CMPIStatus Assoc_Cleanup(CMPIInstanceMI* mi, const CMPIContext* ctx, CMPIBoolean term)
{
    return Gadget_Cleanup(mi, ctx, term);
}

static CMPIStatus Assoc_EnumInstanceNames(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                          const CMPIResult* rslt, const CMPIObjectPath* op)
{
    size_t p;
    (void)mi;
    (void)ctx;
    for (p = 0; p < N(pairs); p++)
        CMReturnObjectPath(rslt, pair_path(ns_of(op), p));
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Assoc_EnumInstances(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                      const CMPIResult* rslt, const CMPIObjectPath* op,
                                      const char** properties)
{
    size_t p;
    (void)mi;
    (void)ctx;
    (void)properties;
    for (p = 0; p < N(pairs); p++)
        CMReturnInstance(rslt, pair_instance(ns_of(op), p));
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Assoc_GetInstance(CMPIInstanceMI* mi, const CMPIContext* ctx,
                                    const CMPIResult* rslt, const CMPIObjectPath* op,
                                    const char** properties)
{
    (void)mi;
    (void)ctx;
    (void)rslt;
    (void)op;
    (void)properties;
    CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

#define Assoc_CreateInstance None_CreateInstance
#define Assoc_ModifyInstance None_ModifyInstance
#define Assoc_DeleteInstance None_DeleteInstance
#define Assoc_ExecQuery None_ExecQuery

CMInstanceMIStub(Assoc_, Test_WidgetGadget_Provider, broker, COUNT_CREATE)

static CMPIStatus Assoc_AssociationCleanup(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                           CMPIBoolean term)
{
    (void)mi;
    (void)ctx;
    (void)term;
    testprov_counters.cleanups++;
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Assoc_Associators(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                    const CMPIResult* rslt, const CMPIObjectPath* op,
                                    const char* assoc_class, const char* result_class,
                                    const char* role, const char* result_role,
                                    const char** properties)
{
    size_t p;
    const char* other_role;
    (void)mi;
    (void)assoc_class;
    for (p = 0; p < N(pairs); p++)
        if (pair_matches(op, p, role, &other_role) &&
            other_passes(other_role, result_class, result_role))
        {
            /* The other end comes from its own provider, through the broker. */
            CMPIStatus rc;
            CMPIInstance* ci =
                CBGetInstance(broker, ctx, other_end(ns_of(op), p, other_role), properties, &rc);
            if (!ci)
                return rc;
            CMReturnInstance(rslt, ci);
        }
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Assoc_AssociatorNames(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                        const CMPIResult* rslt, const CMPIObjectPath* op,
                                        const char* assoc_class, const char* result_class,
                                        const char* role, const char* result_role)
{
    size_t p;
    const char* other_role;
    (void)mi;
    (void)ctx;
    (void)assoc_class;
    for (p = 0; p < N(pairs); p++)
        if (pair_matches(op, p, role, &other_role) &&
            other_passes(other_role, result_class, result_role))
            CMReturnObjectPath(rslt, other_end(ns_of(op), p, other_role));
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Assoc_References(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                   const CMPIResult* rslt, const CMPIObjectPath* op,
                                   const char* result_class, const char* role,
                                   const char** properties)
{
    size_t p;
    const char* other_role;
    (void)mi;
    (void)ctx;
    (void)properties;
    if (result_class && strcasecmp(result_class, "Test_WidgetGadget") != 0)
        CMReturn(CMPI_RC_OK);
    for (p = 0; p < N(pairs); p++)
        if (pair_matches(op, p, role, &other_role))
            CMReturnInstance(rslt, pair_instance(ns_of(op), p));
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Assoc_ReferenceNames(CMPIAssociationMI* mi, const CMPIContext* ctx,
                                       const CMPIResult* rslt, const CMPIObjectPath* op,
                                       const char* result_class, const char* role)
{
    size_t p;
    const char* other_role;
    (void)mi;
    (void)ctx;
    if (result_class && strcasecmp(result_class, "Test_WidgetGadget") != 0)
        CMReturn(CMPI_RC_OK);
    for (p = 0; p < N(pairs); p++)
        if (pair_matches(op, p, role, &other_role))
            CMReturnObjectPath(rslt, pair_path(ns_of(op), p));
    CMReturnDone(rslt);
    CMReturn(CMPI_RC_OK);
}

CMAssociationMIStub(Assoc_, Test_WidgetGadget_Provider, broker, COUNT_CREATE)

/*
 * Test_Event: indications from a thread of the provider
 */

#define MAX_NS 4

static pthread_mutex_t event_lock = PTHREAD_MUTEX_INITIALIZER;
static char event_ns[MAX_NS][64];
static int event_ns_count[MAX_NS];
static pthread_t event_thread;
static int event_running;
static const CMPIContext* event_ctx;

static void* event_proc(void* arg)
{
    int seq, k;
    (void)arg;
    CBAttachThread(broker, event_ctx);
    for (seq = 0; seq < 3; seq++)
    {
        struct timespec ts = {0, 5 * 1000 * 1000};
        pthread_mutex_lock(&event_lock);
        for (k = 0; k < MAX_NS; k++)
        {
            CMPIInstance* ci;
            CMPIUint32 v = (CMPIUint32)seq;
            if (!event_ns_count[k])
                continue;
            ci = CMNewInstance(broker, CMNewObjectPath(broker, event_ns[k], "Test_Event", NULL),
                               NULL);
            CMSetProperty(ci, "Seq", &v, CMPI_uint32);
            CMSetProperty(ci, "Text", "tick", CMPI_chars);
            if (CBDeliverIndication(broker, event_ctx, event_ns[k], ci).rc == CMPI_RC_OK)
                testprov_counters.delivered++;
        }
        pthread_mutex_unlock(&event_lock);
        nanosleep(&ts, NULL);
    }
    CBDetachThread(broker, event_ctx);
    return NULL;
}

static CMPIStatus Event_IndicationCleanup(CMPIIndicationMI* mi, const CMPIContext* ctx,
                                          CMPIBoolean term)
{
    (void)mi;
    (void)ctx;
    (void)term;
    testprov_counters.cleanups++;
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Event_AuthorizeFilter(CMPIIndicationMI* mi, const CMPIContext* ctx,
                                        const CMPISelectExp* filter, const char* cls,
                                        const CMPIObjectPath* op, const char* owner)
{
    (void)mi;
    (void)ctx;
    (void)cls;
    (void)op;
    (void)owner;
    testprov_counters.authorize++;
    if (!filter || !CMGetSelExpString(filter, NULL))
        CMReturn(CMPI_RC_ERR_INVALID_QUERY);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Event_MustPoll(CMPIIndicationMI* mi, const CMPIContext* ctx,
                                 const CMPISelectExp* filter, const char* cls,
                                 const CMPIObjectPath* op)
{
    (void)mi;
    (void)ctx;
    (void)filter;
    (void)cls;
    (void)op;
    testprov_counters.must_poll++;
    CMReturn(CMPI_RC_ERR_NOT_SUPPORTED);
}

static CMPIStatus Event_ActivateFilter(CMPIIndicationMI* mi, const CMPIContext* ctx,
                                       const CMPISelectExp* filter, const char* cls,
                                       const CMPIObjectPath* op, CMPIBoolean first)
{
    const char* ns = ns_of(op);
    int k, free_slot = -1;
    (void)mi;
    (void)ctx;
    (void)filter;
    (void)cls;
    testprov_counters.activate++;
    testprov_counters.first_activation += first != 0;
    pthread_mutex_lock(&event_lock);
    for (k = 0; k < MAX_NS; k++)
    {
        if (event_ns_count[k] && strcmp(event_ns[k], ns) == 0)
            break;
        if (!event_ns_count[k] && free_slot < 0)
            free_slot = k;
    }
    if (k == MAX_NS && free_slot >= 0)
    {
        k = free_slot;
        snprintf(event_ns[k], sizeof(event_ns[k]), "%s", ns);
    }
    if (k < MAX_NS)
        event_ns_count[k]++;
    pthread_mutex_unlock(&event_lock);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Event_DeActivateFilter(CMPIIndicationMI* mi, const CMPIContext* ctx,
                                         const CMPISelectExp* filter, const char* cls,
                                         const CMPIObjectPath* op, CMPIBoolean last)
{
    const char* ns = ns_of(op);
    int k;
    (void)mi;
    (void)ctx;
    (void)filter;
    (void)cls;
    testprov_counters.deactivate++;
    testprov_counters.last_deactivation += last != 0;
    pthread_mutex_lock(&event_lock);
    for (k = 0; k < MAX_NS; k++)
        if (event_ns_count[k] && strcmp(event_ns[k], ns) == 0)
        {
            event_ns_count[k]--;
            break;
        }
    pthread_mutex_unlock(&event_lock);
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Event_EnableIndications(CMPIIndicationMI* mi, const CMPIContext* ctx)
{
    (void)mi;
    testprov_counters.enable++;
    if (testprov_counters.fail_enable)
        CMReturn(CMPI_RC_ERR_FAILED);
    event_ctx = CBPrepareAttachThread(broker, ctx);
    if (!event_ctx || pthread_create(&event_thread, NULL, event_proc, NULL) != 0)
        CMReturn(CMPI_RC_ERR_FAILED);
    event_running = 1;
    CMReturn(CMPI_RC_OK);
}

static CMPIStatus Event_DisableIndications(CMPIIndicationMI* mi, const CMPIContext* ctx)
{
    (void)mi;
    (void)ctx;
    testprov_counters.disable++;
    if (event_running)
    {
        pthread_join(event_thread, NULL);
        event_running = 0;
    }
    CMReturn(CMPI_RC_OK);
}

CMIndicationMIStub(Event_, Test_Event_Provider, broker, COUNT_CREATE)
