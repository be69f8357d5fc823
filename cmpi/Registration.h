#ifndef _OLMA_Registration_h
#define _OLMA_Registration_h

// The module's providers as the runtime sees them: a chain of records, each
// with the provider's dispatch function. The runtime knows no provider class;
// it reaches a provider only through its dispatch function, by operation
// number.

#include "config.h"
#include "Meta_Class.h"

namespace OLMA
{

struct Registration;

// A provider's dispatch function. arg0 is the provider object but for
// OP_GET_META_CLASS, OP_CREATE_PROVIDER and OP_GET_REPOSITORY; unused
// arguments are zero. An operation that the provider's class doesn't have
// gives -1.
typedef sint32 (*Provider_Proc)(const Registration* registration, int operation,
    void* arg0, void* arg1, void* arg2, void* arg3,
    void* arg4, void* arg5, void* arg6, void* arg7);

enum Provider_Operation
{
    OP_GET_META_CLASS = 0,
    OP_CREATE_PROVIDER = 1,
    OP_DESTROY_PROVIDER = 2,
    OP_LOAD = 3,
    OP_UNLOAD = 4,
    OP_GET_INSTANCE = 5,
    OP_ENUM_INSTANCES = 6,
    OP_CREATE_INSTANCE = 7,
    OP_DELETE_INSTANCE = 8,
    OP_MODIFY_INSTANCE = 9,
    OP_INVOKE_METHOD = 10,
    OP_ENABLE_INDICATIONS = 11,
    OP_DISABLE_INDICATIONS = 12,
    OP_GET_REPOSITORY = 13,
    OP_ENUM_ASSOCIATOR_NAMES = 14,
    OP_ENUM_REFERENCES = 15,
    OP_ENUM_ASSOCIATORS = 16,
};

struct Registration
{
    // The module's name, the same word for every provider.
    const char* module_name;
    const char* provider_name;
    Provider_Proc proc;
    const Meta_Class* meta_class;
    const Registration* next;
};

} // namespace OLMA

// The chain, from the provider registered last to the first.
extern "C" const OLMA::Registration* tessel_module();

#endif // _OLMA_Registration_h
