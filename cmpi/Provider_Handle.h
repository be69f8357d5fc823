#ifndef _OLMA_Provider_Handle_h
#define _OLMA_Provider_Handle_h

// The calling side of a provider's dispatch function: it makes the provider
// object and offers the operations that have a generic fallback, so that a
// provider that only enumerates also serves get_instance and the
// association requests.

#include "Instance.h"
#include "Registration.h"
#include "Provider_Status.h"

namespace OLMA
{

class Provider_Handle
{
public:

    // Makes the provider object (OP_CREATE_PROVIDER).
    Provider_Handle(const Registration* registration);

    // Destroys the provider object (OP_DESTROY_PROVIDER).
    ~Provider_Handle();

    // A call of the dispatch function; unused arguments are zero.
    sint32 call(int operation, void* arg1 = 0, void* arg2 = 0, void* arg3 = 0,
        void* arg4 = 0, void* arg5 = 0, void* arg6 = 0) const;

    // The provider's class and repository.
    const Meta_Class* meta_class() const;
    const Meta_Repository* meta_repository() const;

    // The provider's get_instance, or, if it has none, the first instance
    // of its enumeration whose keys equal the model's.
    Get_Instance_Status get_instance(const Instance* model, Instance*& instance);

    typedef bool (*Associator_Names_Proc)(
        Instance* instance, Enum_Associator_Names_Status status, void* client_data);

    typedef bool (*References_Proc)(
        Instance* instance, Enum_References_Status status, void* client_data);

    // The provider's own, or the other ends of the enumerated associations
    // that refer to the source instance.
    Enum_Associator_Names_Status enum_associator_names(const Instance* instance,
        const String& result_class, const String& role, const String& result_role,
        Associator_Names_Proc proc, void* client_data);

    // The provider's own, or the enumerated associations that refer to the
    // source instance.
    Enum_References_Status enum_references(const Instance* instance,
        const Instance* model, const String& role, References_Proc proc, void* client_data);

    const Registration* registration;
    Provider_Proc proc;
    void* provider;

private:

    Provider_Handle(const Provider_Handle&);
    Provider_Handle& operator=(const Provider_Handle&);
};

// The other ends of the association instance as seen from the source
// instance, filtered and appended to associators: their number, or -1 if
// the association doesn't refer to the source. The ends stay owned by the
// association. An empty reference (its element gone) is neither the source
// nor an end.
ssize_t get_associators(const Instance* inst, const Instance* assoc_inst,
    const char* result_class, const char* role, const char* result_role,
    Array<const Instance*>& associators);

// Whether one of the association's references points at the instance, by
// the role if one is given. Empty references are passed over.
bool is_reference_of(const Instance* inst, const Instance* assoc_inst, const char* role);

} // namespace OLMA

#endif // _OLMA_Provider_Handle_h
