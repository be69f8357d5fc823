#ifndef _OLMA_Dispatch_h
#define _OLMA_Dispatch_h

// The bodies that the generated dispatch functions share. Each generated
// function casts to its own class and provider here and nowhere else; the
// templates below know the operations of a plain, an association and an
// indication class. Extrinsic methods are generated per class.
//
// A provider declares only the members it implements. The dispatch calls a
// member if the provider declares it with the exact signature that the call
// needs, and answers for it otherwise, so a reader sees at a glance what a
// provider does. A member of that name with any other signature (or one that
// isn't public) stops the build: it would otherwise turn silently into
// "unsupported".

#include <cstring>
#include <type_traits>
#include <utility>
#include "Instance.h"
#include "Registration.h"
#include "Provider_Status.h"
#include "Provider_Handler.h"

// Defines __member_NAME<P, F>: whether provider P declares NAME (with any
// signature, overloaded, even as a data member: a probe that also has a
// NAME makes the name ambiguous exactly when P has one) and whether it has
// it as F, a function type such as Load_Status(). __call_member calls it.
#define TESSEL_PROVIDER_MEMBER(NAME) \
    struct __Probe_Base_##NAME { void NAME(); }; \
    template<class P> struct __Probe_##NAME : P, __Probe_Base_##NAME { }; \
    template<class P, class = void> \
    struct __declares_##NAME : std::true_type { }; \
    template<class P> \
    struct __declares_##NAME<P, std::void_t<decltype(&__Probe_##NAME<P>::NAME)> > \
        : std::false_type { }; \
    template<class P, class F, class = void> \
    struct __has_##NAME : std::false_type { }; \
    template<class P, class F> \
    struct __has_##NAME<P, F, std::void_t<decltype(static_cast<F P::*>(&P::NAME))> > \
        : std::true_type { }; \
    template<class P, class F> \
    struct __member_##NAME \
    { \
        static constexpr bool declared = __declares_##NAME<P>::value; \
        static constexpr bool present = __has_##NAME<P, F>::value; \
        static_assert(present || !declared, "the provider's " #NAME \
            " must be public and have the signature that its dispatch calls"); \
        static F P::* pointer() { return static_cast<F P::*>(&P::NAME); } \
    }

namespace OLMA
{

TESSEL_PROVIDER_MEMBER(load);
TESSEL_PROVIDER_MEMBER(unload);
TESSEL_PROVIDER_MEMBER(get_instance);
TESSEL_PROVIDER_MEMBER(enum_instances);
TESSEL_PROVIDER_MEMBER(create_instance);
TESSEL_PROVIDER_MEMBER(delete_instance);
TESSEL_PROVIDER_MEMBER(modify_instance);
TESSEL_PROVIDER_MEMBER(enum_associator_names);
TESSEL_PROVIDER_MEMBER(enum_references);
TESSEL_PROVIDER_MEMBER(enum_associators);
TESSEL_PROVIDER_MEMBER(enable_indications);
TESSEL_PROVIDER_MEMBER(disable_indications);

// The member that M (a __member_NAME<P, F>) describes, called with args; or
// `absent` if the provider doesn't declare it.
template<class M, class P, class R, class... A>
inline R __call_member(P* provider, R absent, A&&... args)
{
    if constexpr (M::present)
        return (provider->*M::pointer())(std::forward<A>(args)...);
    else
    {
        (void)provider;
        ((void)args, ...);
        return absent;
    }
}

// The operations that every class has: meta data, life cycle and load. A
// provider without load or unload has nothing to bring up or take down.
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
            status = __call_member<__member_load<P, Load_Status()> >(
                (P*)arg0, LOAD_OK);
            return true;

        case OP_UNLOAD:
            status = __call_member<__member_unload<P, Unload_Status()> >(
                (P*)arg0, UNLOAD_OK);
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
            return __call_member<__member_get_instance<P,
                Get_Instance_Status(const C*, C*&)> >(
                provider, GET_INSTANCE_UNSUPPORTED, (const C*)arg1, *(C**)arg2);

        case OP_ENUM_INSTANCES:
        {
            // Enumeration has no "unsupported": a provider that doesn't
            // enumerate serves a class without instances. Success with an
            // empty stream is what such a class has always answered, so
            // that enumerations, getInstance (not found) and the generic
            // association walks (nothing, CMPI_RC_OK) stay as they were.
            typedef typename Enum_Instances_Handler<C>::Proc Proc;
            Enum_Instances_Handler<C> handler((Proc)arg2, arg3);
            Enum_Instances_Status s = __call_member<__member_enum_instances<P,
                Enum_Instances_Status(const C*, Enum_Instances_Handler<C>*)> >(
                provider, ENUM_INSTANCES_OK, (const C*)arg1, &handler);
            handler.proc(0, s, handler.client_data);
            return s;
        }

        case OP_CREATE_INSTANCE:
            return __call_member<__member_create_instance<P,
                Create_Instance_Status(C*)> >(
                provider, CREATE_INSTANCE_UNSUPPORTED, (C*)arg1);

        case OP_DELETE_INSTANCE:
            return __call_member<__member_delete_instance<P,
                Delete_Instance_Status(const C*)> >(
                provider, DELETE_INSTANCE_UNSUPPORTED, (const C*)arg1);

        case OP_MODIFY_INSTANCE:
            return __call_member<__member_modify_instance<P,
                Modify_Instance_Status(const C*, const C*)> >(
                provider, MODIFY_INSTANCE_UNSUPPORTED, (const C*)arg1, (const C*)arg2);
    }

    return -1;
}

// A provider that doesn't walk its associations itself leaves them to the
// runtime, which enumerates and filters.
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
            Enum_Associator_Names_Status s = __call_member<__member_enum_associator_names<P,
                Enum_Associator_Names_Status(const Instance*, const String&, const String&,
                    const String&, Enum_Associator_Names_Handler<Instance>*)> >(
                provider, ENUM_ASSOCIATOR_NAMES_UNSUPPORTED,
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
            Enum_References_Status s = __call_member<__member_enum_references<P,
                Enum_References_Status(const Instance*, const C*, const String&,
                    Enum_References_Handler<C>*)> >(
                provider, ENUM_REFERENCES_UNSUPPORTED,
                (const Instance*)arg1, (const C*)arg2, *(const String*)arg3, &handler);
            if (s != ENUM_REFERENCES_UNSUPPORTED)
                handler.proc(0, s, handler.client_data);
            return s;
        }

        case OP_ENUM_ASSOCIATORS:
        {
            typedef typename Enum_Associators_Handler<Instance>::Proc Proc;
            Enum_Associators_Handler<Instance> handler((Proc)arg5, arg6);
            Enum_Associators_Status s = __call_member<__member_enum_associators<P,
                Enum_Associators_Status(const Instance*, const String&, const String&,
                    const String&, Enum_Associators_Handler<Instance>*)> >(
                provider, ENUM_ASSOCIATORS_UNSUPPORTED,
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
    typedef __member_enable_indications<P,
        Enable_Indications_Status(Indication_Handler<C>*)> Enable;
    typedef __member_disable_indications<P, Disable_Indications_Status()> Disable;

    // The provider that takes the handler owns it and must be able to end
    // its stream; one that takes none has nothing to end.
    static_assert(Enable::present == Disable::present,
        "an indication provider has both enable_indications and disable_indications, or neither");

    sint32 status;

    if (__dispatch_common<C, P>(operation, arg0, status))
        return status;

    P* provider = (P*)arg0;

    switch (operation)
    {
        // Neither has an "unsupported". A provider without them never sends
        // an indication: subscribing succeeds, as it does for a provider
        // that keeps the handler and sends nothing, and no handler is made
        // that no one would end.
        case OP_ENABLE_INDICATIONS:
            if constexpr (Enable::present)
            {
                typedef typename Indication_Handler<C>::Proc Proc;
                return (provider->*Enable::pointer())(
                    new Indication_Handler<C>((Proc)arg1, arg2));
            }
            else
                return ENABLE_INDICATIONS_OK;

        case OP_DISABLE_INDICATIONS:
            return __call_member<Disable>(provider, DISABLE_INDICATIONS_OK);
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
