#ifndef _OLMA_Converter_h
#define _OLMA_Converter_h

// Conversion between CMPI's encapsulated objects and the runtime's
// instances. The make_* functions return a CMPI return code: 0, or
// CMPI_RC_ERR_FAILED when no object could be made (and the code of
// CMSetPropertyFilter when that fails). One property that can't be converted
// only costs a log line.

#include "CMPI.h"
#include "Instance.h"
#include "Value.h"

namespace OLMA
{

//
// CMPI to Instance. The namespace of the path goes to every instance made
// that has none of its own.
//

// The keys of the path as a new instance of meta_class.
int make_tessel_reference(const CMPIBroker* broker, const Meta_Class* meta_class,
    const CMPIObjectPath* object_path, Instance*& instance);

// All the properties of the CMPI instance.
int make_tessel_instance(const CMPIBroker* broker, const Meta_Class* meta_class,
    const CMPIObjectPath* object_path, const CMPIInstance* cmpi_instance,
    Instance*& instance);

// A method instance with the input parameters.
int make_tessel_method(const CMPIBroker* broker, const Meta_Class* meta_class,
    const Meta_Method* meta_method, const CMPIObjectPath* object_path,
    const CMPIArgs* in_args, void* client_data, Instance*& method_instance);

//
// Instance to CMPI. Null properties are left out.
//

// The objects that a conversion made through the broker, besides the one it
// gives back, for a caller that frees them itself once nothing refers to
// them any more. Its destructor releases them.
class CMPI_Made
{
public:

    CMPI_Made();
    ~CMPI_Made();

    // Records the encapsulated object of data, if it has one.
    void add(const CMPIData& data);

    // Releases everything recorded, the newest first.
    void release();

    size_t size() const { return _size; }

private:

    CMPI_Made(const CMPI_Made&);
    CMPI_Made& operator=(const CMPI_Made&);

    CMPIData* _data;
    size_t _size;
    size_t _capacity;
};

// With a null made, the objects made are left to the broker.
int make_cmpi_object_path(const CMPIBroker* broker, const Instance* instance,
    const char* name_space, CMPIObjectPath*& object_path, CMPI_Made* made = 0);

// A null object_path is built from the instance's keys. A property list
// never drops the class's keys.
int make_cmpi_instance(const CMPIBroker* broker, const Instance* instance,
    const char* name_space, const CMPIObjectPath* object_path,
    const char** properties, CMPIInstance*& cmpi_instance, CMPI_Made* made = 0);

// The output parameters go to out_args; the method's result to return_value
// and return_type (type 0 if it is null).
int make_cmpi_method(const CMPIBroker* broker, const char* name_space,
    const Instance* method_instance, const CMPIArgs* out_args,
    CMPIValue& return_value, CMPIType& return_type);

//
// One value. 0 or -1.
//

int cmpi_to_tessel_value(const Meta_Repository* meta_repository,
    const CMPIBroker* broker, const char* name_space, const CMPIData& data,
    Value& value);

// flags are the feature's: EmbeddedObject or EmbeddedInstance make an
// instance a CMPI_instance, else it becomes a CMPI_ref. Every object made on
// the way goes to made, if given.
int _to_cmpi_data(const Meta_Repository* meta_repository,
    const CMPIBroker* broker, const char* name_space, const Value& value,
    uint32 flags, CMPIData& data, CMPI_Made* made = 0);

// Releases the encapsulated object of data.
void _release_cmpi_data(CMPIData& data);

// A result that a server hands back from an up-call, as good data when its
// pointer is there: some servers mark good instances as null.
void _read_by_pointer(CMPIData& data);

Instance* _to_tessel_instance(const Meta_Repository* meta_repository,
    const CMPIBroker* broker, const char* name_space, const CMPIObjectPath* object_path);

Instance* _to_tessel_instance(const Meta_Repository* meta_repository,
    const CMPIBroker* broker, const char* name_space, const CMPIInstance* instance);

// The text of a CMPIString, or null.
const char* _chars(const CMPIString* str);

// The namespace of a path, "" if it has none.
const char* _name_space_of(const CMPIObjectPath* object_path);

// The class name of a path, "" if it has none.
const char* _class_name_of(const CMPIObjectPath* object_path);

} // namespace OLMA

#endif // _OLMA_Converter_h
