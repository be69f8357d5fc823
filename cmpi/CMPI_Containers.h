#ifndef _OLMA_CMPI_Containers_h
#define _OLMA_CMPI_Containers_h

// CMPI objects seen as Containers, so that the generic loops of Container
// carry whole instances, paths and argument lists.

#include "CMPI.h"
#include "Container.h"

namespace OLMA
{

class CMPI_Made;

// What set_value makes through the broker stays with the object set, which
// keeps its pointer: it goes to made if there is one, else to the broker.

class CMPIInstance_Container : public Container
{
public:

    CMPIInstance_Container(const Meta_Repository* meta_repository,
        const CMPIBroker* broker, const char* name_space, const CMPIInstance* instance,
        CMPI_Made* made = 0);

    virtual ~CMPIInstance_Container();

    virtual size_t get_size();

    virtual int get_name(size_t index, String& name);

    virtual int get_value(size_t index, Value::Type type, Value& value);

    virtual int set_value(const char* name, const Value& value, uint32 flags);

    const CMPIBroker* broker;
    const char* name_space;
    const CMPIInstance* instance;
    CMPI_Made* made;
};

class CMPIObjectPath_Container : public Container
{
public:

    CMPIObjectPath_Container(const Meta_Repository* meta_repository,
        const CMPIBroker* broker, const char* name_space, const CMPIObjectPath* object_path,
        CMPI_Made* made = 0);

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
    CMPI_Made* made;
};

class CMPIArgs_Container : public Container
{
public:

    CMPIArgs_Container(const Meta_Repository* meta_repository,
        const CMPIBroker* broker, const char* name_space, const CMPIArgs* args,
        CMPI_Made* made = 0);

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
    CMPI_Made* made;
    CMPIType return_type;
    CMPIValue return_value;
    // Out arguments of an up-call: read by their pointers (see
    // _read_by_pointer).
    bool upcall;
};

} // namespace OLMA

#endif // _OLMA_CMPI_Containers_h
