#ifndef _OLMA_Dispatch_h
#define _OLMA_Dispatch_h

// The bodies that the generated dispatch functions share. Each generated
// function casts to its own class and provider here and nowhere else; the
// templates below know the operations of a plain, an association and an
// indication class. Extrinsic methods are generated per class.

#include <cstring>
#include "Instance.h"
#include "Registration.h"
#include "Provider_Status.h"
#include "Provider_Handler.h"

namespace OLMA
{

// The operations that every class has: meta data, life cycle and load.
template<class C, class P>
inline bool __dispatch_common(int operation, void* arg0, sint32& status)
{
    switch (operation)
    {
        case OP_GET_META_CLASS:
            *(const Meta_Class**)arg0 = &C::static_meta_class;
            status = 0;
            return true;

        case OP_CREATE_PROVIDER:
            *(P**)arg0 = new P;
            status = 0;
            return true;

        case OP_DESTROY_PROVIDER:
            delete (P*)arg0;
            status = 0;
            return true;

        case OP_LOAD:
            status = ((P*)arg0)->load();
            return true;

        case OP_UNLOAD:
            status = ((P*)arg0)->unload();
            return true;

        case OP_GET_REPOSITORY:
            *(const Meta_Repository**)arg0 = C::static_meta_class.meta_repository;
            status = 0;
            return true;
    }

    return false;
}

template<class C, class P>
inline sint32 __dispatch_instance(const Registration*, int operation,
    void* arg0, void* arg1, void* arg2, void* arg3,
    void*, void*, void*, void*)
{
    sint32 status;

    if (__dispatch_common<C, P>(operation, arg0, status))
        return status;

    P* provider = (P*)arg0;

    switch (operation)
    {
        case OP_GET_INSTANCE:
            return provider->get_instance((const C*)arg1, *(C**)arg2);

        case OP_ENUM_INSTANCES:
        {
            typedef typename Enum_Instances_Handler<C>::Proc Proc;
            Enum_Instances_Handler<C> handler((Proc)arg2, arg3);
            Enum_Instances_Status s = provider->enum_instances((const C*)arg1, &handler);
            handler.proc(0, s, handler.client_data);
            return s;
        }

        case OP_CREATE_INSTANCE:
            return provider->create_instance((C*)arg1);

        case OP_DELETE_INSTANCE:
            return provider->delete_instance((const C*)arg1);

        case OP_MODIFY_INSTANCE:
            return provider->modify_instance((const C*)arg1, (const C*)arg2);
    }

    return -1;
}

template<class C, class P>
inline sint32 __dispatch_association(const Registration* registration, int operation,
    void* arg0, void* arg1, void* arg2, void* arg3,
    void* arg4, void* arg5, void* arg6, void* arg7)
{
    P* provider = (P*)arg0;

    switch (operation)
    {
        case OP_ENUM_ASSOCIATOR_NAMES:
        {
            typedef typename Enum_Associator_Names_Handler<Instance>::Proc Proc;
            Enum_Associator_Names_Handler<Instance> handler((Proc)arg5, arg6);
            Enum_Associator_Names_Status s = provider->enum_associator_names(
                (const Instance*)arg1, *(const String*)arg2, *(const String*)arg3,
                *(const String*)arg4, &handler);
            if (s != ENUM_ASSOCIATOR_NAMES_UNSUPPORTED)
                handler.proc(0, s, handler.client_data);
            return s;
        }

        case OP_ENUM_REFERENCES:
        {
            typedef typename Enum_References_Handler<C>::Proc Proc;
            Enum_References_Handler<C> handler((Proc)arg4, arg5);
            Enum_References_Status s = provider->enum_references(
                (const Instance*)arg1, (const C*)arg2, *(const String*)arg3, &handler);
            if (s != ENUM_REFERENCES_UNSUPPORTED)
                handler.proc(0, s, handler.client_data);
            return s;
        }

        case OP_ENUM_ASSOCIATORS:
        {
            typedef typename Enum_Associators_Handler<Instance>::Proc Proc;
            Enum_Associators_Handler<Instance> handler((Proc)arg5, arg6);
            Enum_Associators_Status s = provider->enum_associators(
                (const Instance*)arg1, *(const String*)arg2, *(const String*)arg3,
                *(const String*)arg4, &handler);
            if (s != ENUM_ASSOCIATORS_UNSUPPORTED)
                handler.proc(0, s, handler.client_data);
            return s;
        }
    }

    return __dispatch_instance<C, P>(
        registration, operation, arg0, arg1, arg2, arg3, arg4, arg5, arg6, arg7);
}

template<class C, class P>
inline sint32 __dispatch_indication(const Registration*, int operation,
    void* arg0, void* arg1, void* arg2, void*,
    void*, void*, void*, void*)
{
    sint32 status;

    if (__dispatch_common<C, P>(operation, arg0, status))
        return status;

    P* provider = (P*)arg0;

    switch (operation)
    {
        case OP_ENABLE_INDICATIONS:
        {
            typedef typename Indication_Handler<C>::Proc Proc;
            return provider->enable_indications(new Indication_Handler<C>((Proc)arg1, arg2));
        }

        case OP_DISABLE_INDICATIONS:
            return provider->disable_indications();
    }

    return -1;
}

//
// Extrinsic methods. The generated code casts a method instance to the
// record of the method it names only if the instance was made from that
// record's own table, so that a method instance of another class or shape
// is refused rather than misread.
//

inline const char* __method_name(const Instance* method)
{
    if (!method || !method->meta_class || !(method->meta_class->flags & FLAG_METHOD))
        return 0;
    return method->meta_class->name;
}

template<class R>
inline bool __is_record(const Instance* method)
{
    return method->meta_class == (const Meta_Class*)&R::static_meta_class;
}

} // namespace OLMA

#endif // _OLMA_Dispatch_h
