#ifndef _OLMA_Provider_Handler_h
#define _OLMA_Provider_Handler_h

// What a provider hands its instances to. A handler is a callback and its
// client word; the dispatch function makes it. handle() passes the instance
// (and its reference) to the runtime; a false result asks the provider to
// stop sending.

#include "Instance.h"
#include "Provider_Status.h"

namespace OLMA
{

template<class STATUS>
struct __Handler_Base
{
    typedef bool (*Proc)(Instance* instance, STATUS status, void* client_data);

    __Handler_Base(Proc proc_, void* client_data_) :
        proc(proc_), client_data(client_data_)
    {
    }

    Proc proc;
    void* client_data;
};

template<class T>
struct Enum_Instances_Handler : __Handler_Base<Enum_Instances_Status>
{
    Enum_Instances_Handler(Proc proc_, void* client_data_) :
        __Handler_Base<Enum_Instances_Status>(proc_, client_data_)
    {
    }

    bool handle(T* instance)
    {
        return proc(instance, ENUM_INSTANCES_OK, client_data);
    }
};

template<class T>
struct Enum_Associator_Names_Handler : __Handler_Base<Enum_Associator_Names_Status>
{
    Enum_Associator_Names_Handler(Proc proc_, void* client_data_) :
        __Handler_Base<Enum_Associator_Names_Status>(proc_, client_data_)
    {
    }

    bool handle(T* instance)
    {
        return proc(instance, ENUM_ASSOCIATOR_NAMES_OK, client_data);
    }
};

template<class T>
struct Enum_Associators_Handler : __Handler_Base<Enum_Associators_Status>
{
    Enum_Associators_Handler(Proc proc_, void* client_data_) :
        __Handler_Base<Enum_Associators_Status>(proc_, client_data_)
    {
    }

    bool handle(T* instance)
    {
        return proc(instance, ENUM_ASSOCIATORS_OK, client_data);
    }
};

template<class T>
struct Enum_References_Handler : __Handler_Base<Enum_References_Status>
{
    Enum_References_Handler(Proc proc_, void* client_data_) :
        __Handler_Base<Enum_References_Status>(proc_, client_data_)
    {
    }

    bool handle(T* instance)
    {
        return proc(instance, ENUM_REFERENCES_OK, client_data);
    }
};

// Made with new by the dispatch function; the provider owns it from
// enable_indications on, and deletes it after it has sent the null instance
// that ends the stream.
template<class T>
struct Indication_Handler
{
    typedef bool (*Proc)(Instance* instance, void* client_data);

    Indication_Handler(Proc proc_, void* client_data_) :
        proc(proc_), client_data(client_data_)
    {
    }

    bool handle(T* instance)
    {
        return proc(instance, client_data);
    }

    Proc proc;
    void* client_data;
};

} // namespace OLMA

#endif // _OLMA_Provider_Handler_h
