#ifndef _OLMA_Container_h
#define _OLMA_Container_h

// A foreign object (a CMPI instance, object path or argument list) seen as a
// list of named values, and the two generic conversions between such an
// object and an Instance. The conversions forgive: a value that can't be
// converted costs a log line, not the whole object.

#include "config.h"
#include "String.h"
#include "Value.h"
#include "Meta_Class.h"

namespace OLMA
{

struct Instance;

class Container
{
public:

    Container(const Meta_Repository* meta_repository);

    virtual ~Container();

    virtual size_t get_size() = 0;

    virtual int get_name(size_t index, String& name) = 0;

    virtual int get_value(size_t index, Value::Type type, Value& value) = 0;

    virtual int set_value(const char* name, const Value& value, uint32 flags) = 0;

    // Foreign object to instance. A null instance is created from meta_class
    // (which may be a Meta_Method cast to a Meta_Class). Only features that
    // bear one of the flags (0 for all) are read. 0, or -1 if no instance
    // could be had.
    int convert(const Meta_Class* meta_class, uint32 flags, Instance*& instance);

    // Instance to foreign object: every non-null feature that bears one of
    // the flags (0 for all) is set. 0, or -1 for a null instance.
    int convert(const Instance* instance, uint32 flags);

    const Meta_Repository* meta_repository;
};

} // namespace OLMA

#endif // _OLMA_Container_h
