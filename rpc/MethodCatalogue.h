#ifndef _VSPR_MethodCatalogue_h
#define _VSPR_MethodCatalogue_h

// The console's methods as data. Nearly every method is one library call:
// read the positional parameters by type into named members of a request,
// add the fixed members, call the entry, hand back the reply. A row says
// all of that; ProviderDiscoveryMethods::serve does it. Methods that do
// more have a function of their own, named in their row.

#include <cstddef>

#include "CIMProviderTruj.h"
#include "JsonRpcManager.h"

namespace OLMA
{

enum ParamType : unsigned char
{
    P_END = 0,      // no more parameters
    P_STRING,
    P_INT,
    P_BOOL,
    P_ARRAY,        // an array or null, passed on unchanged
    P_OBJECT,       // an object or null, passed on unchanged
    P_UNREAD,       // counted, never read
};

struct ParamDef
{
    ParamType type;
    const char* member;     // of the library request
};

enum RowForm : unsigned char
{
    FORM_COMMON,    // the reply is the result
    FORM_WRAP,      // the result is an array of the one reply
    FORM_PASS,      // no count check: the params are the request
    FORM_OWN,       // a function of its own
};

// The virtual fabric id that some entries want, always 0, under the key
// that the entry takes.
enum FixedVf : unsigned char
{
    VF_NONE,
    VF_ID,          // "vfId"
    VF_ID_UPPER,    // "vfID"
};

const unsigned MAX_PARAMS = 8;

struct MethodRow
{
    const char* method;         // the registry key
    const char* handler;        // the name in the log and the count check
    RowForm form;
    JsonReqFP* entry;           // the library entry's pointer, read at the call
    FixedVf vf;
    const char* function;       // the fixed "function" of a posted test
    const char* trace;          // the trace lines' name, where it isn't the handler's
    ParamDef params[MAX_PARAMS];
    JsonRpcManager::handler own;

    unsigned count() const
    {
        unsigned n = 0;
        while (n < MAX_PARAMS && params[n].type != P_END)
            n++;
        return n;
    }
};

// The rows in the order of registration, and the handler of each.
size_t catalogueSize();
const MethodRow& catalogueRow(size_t i);
JsonRpcManager::handler catalogueHandler(size_t i);

} // namespace OLMA

#endif // _VSPR_MethodCatalogue_h
