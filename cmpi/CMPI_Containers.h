#ifndef _OLMA_CMPI_Containers_h
#define _OLMA_CMPI_Containers_h

// CMPI objects seen as Containers, so that the generic loops of Container
// carry whole instances, paths and argument lists.

#include "CMPI.h"
#include "Container.h"

namespace OLMA
{

class CMPIInstance_Container : public Container
{
public:

    CMPIInstance_Container(const Meta_Repository* meta_repository,
        const CMPIBroker* broker, const char* name_space, const CMPIInstance* instance);

    virtual ~CMPIInstance_Container();

    virtual size_t get_size();

    virtual int get_name(size_t index, String& name);

    virtual int get_value(size_t index, Value::Type type, Value& value);

    virtual int set_value(const char* name, const Value& value, uint32 flags);

    const CMPIBroker* broker;
    const char* name_space;
    const CMPIInstance* instance;
};

class CMPIObjectPath_Container : public Container
{
public:

    CMPIObjectPath_Container(const Meta_Repository* meta_repository,
        const CMPIBroker* broker, const char* name_space, const CMPIObjectPath* object_path);

    virtual ~CMPIObjectPath_Container();

    virtual size_t get_size();

    virtual int get_name(size_t index, String& name);

    // Paths carry integer keys as 64 bits: they are narrowed to the type
    // that the class declares.
    virtual int get_value(size_t index, Value::Type type, Value& value);

    virtual int set_value(const char* name, const Value& value, uint32 flags);

    const CMPIBroker* broker;
    const char* name_space;
    const CMPIObjectPath* object_path;
};

class CMPIArgs_Container : public Container
{
public:

    CMPIArgs_Container(const Meta_Repository* meta_repository,
        const CMPIBroker* broker, const char* name_space, const CMPIArgs* args);

    virtual ~CMPIArgs_Container();

    virtual size_t get_size();

    virtual int get_name(size_t index, String& name);

    virtual int get_value(size_t index, Value::Type type, Value& value);

    // "return_value" is kept in return_type and return_value rather than
    // added to the arguments.
    virtual int set_value(const char* name, const Value& value, uint32 flags);

    const CMPIBroker* broker;
    const char* name_space;
    const CMPIArgs* args;
    CMPIType return_type;
    CMPIValue return_value;
};

} // namespace OLMA

#endif // _OLMA_CMPI_Containers_h
