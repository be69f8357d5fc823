#ifndef _vspr_tests_runtime_records_h
#define _vspr_tests_runtime_records_h

// A small hand-written class catalogue, shaped as the generated tables are:
// record types derived from Instance, one static meta record per declared
// feature, a feature array per class with inherited features first, locals,
// method records and a repository with each parent before its children.
// Header-only, so that tests and fuzz targets can include it alike.
//
//   Test_ManagedElement (abstract)   Caption, Description = "none", ElementName
//     Test_Device                    4 string keys, defaults, one of each type
//       Test_Port                    re-declares DeviceID; method Reset
//   Test_Job                         key InstanceID
//   Test_Numbers                     integer and boolean keys
//   Test_Dependency (association)    Antecedent, Dependent -> Test_ManagedElement
//     Test_PortOfDevice              narrows them to Test_Device and Test_Port
//   Test_Collection                  key InstanceID, reference array Members
//   Test_Alert (indication)          no keys

#include <cstddef>
#include "Instance.h"

#pragma GCC diagnostic push
// The records derive from Instance, which has members of its own, so they
// aren't standard-layout; GCC's offsetof still gives the member's position.
#pragma GCC diagnostic ignored "-Winvalid-offsetof"

namespace OLMA
{

struct Test_Device;
struct Test_Port;
struct Test_Job;

extern inline const Meta_Repository test_repository;

#define TEST_HEAD(FLAGS, NAME) { { 0, FLAGS, NAME, 0, 0 } }
#define TEST_CLASS_HEAD(FLAGS, NAME) { 0, FLAGS, NAME, 0, 0 }
#define TEST_PROP(CLASS, NAME, FLAGS, TYPE, SUBSCRIPT, VALUE) \
    inline Meta_Property _##CLASS##_##NAME = \
        { TEST_HEAD(FLAG_PROPERTY | FLAG_READ | (FLAGS), #NAME), TYPE, SUBSCRIPT, \
          offsetof(CLASS, NAME), VALUE }
#define TEST_REF(CLASS, NAME, FLAGS, REF_CLASS, SUBSCRIPT) \
    inline Meta_Reference _##CLASS##_##NAME = \
        { TEST_HEAD(FLAG_REFERENCE | (FLAGS), #NAME), SUBSCRIPT, \
          &REF_CLASS::static_meta_class, offsetof(CLASS, NAME) }
#define TEST_COUNT(A) (sizeof(A) / sizeof(A[0]))

//
// Test_ManagedElement
//

struct Test_ManagedElement : Instance
{
    Property<String> Caption;
    Property<String> Description;
    Property<String> ElementName;

    static const Meta_Class static_meta_class;
};

inline const Meta_Value_Scalar<const char*> _Test_ManagedElement_Description_value =
    { {}, "none" };

TEST_PROP(Test_ManagedElement, Caption, 0, STRING, 0, 0);
TEST_PROP(Test_ManagedElement, Description, 0, STRING, 0,
    &_Test_ManagedElement_Description_value);
TEST_PROP(Test_ManagedElement, ElementName, FLAG_WRITE, STRING, 0, 0);

inline Meta_Feature* _Test_ManagedElement_MFA[] =
{
    &_Test_ManagedElement_Caption,
    &_Test_ManagedElement_Description,
    &_Test_ManagedElement_ElementName,
};

inline const uint8 _Test_ManagedElement_locals[] = { 1, 1, 1 };

inline const Meta_Class Test_ManagedElement::static_meta_class =
{
    TEST_CLASS_HEAD(FLAG_CLASS | FLAG_ABSTRACT, "Test_ManagedElement"),
    _Test_ManagedElement_MFA, TEST_COUNT(_Test_ManagedElement_MFA),
    sizeof(Test_ManagedElement), _Test_ManagedElement_locals, 0, 0, &test_repository,
};

//
// Test_Device
//

struct Test_Device : Test_ManagedElement
{
    Property<String> SystemCreationClassName;
    Property<String> SystemName;
    Property<String> CreationClassName;
    Property<String> DeviceID;
    Property<uint16> PortAvailability;
    Property<Array<uint16>> OperationalStatus;
    Property<uint64> Speed;
    Property<boolean> Enabled;
    Property<real32> Temperature;
    Property<real64> Load;
    Property<Datetime> Started;
    Property<Datetime> Uptime;
    Property<char16> Symbol;
    Property<sint8> Offset;
    Property<Array<String>> Aliases;
    Property<String> Notes;

    static const Meta_Class static_meta_class;
};

inline const Meta_Value_Scalar<uint16> _Test_Device_PortAvailability_value = { {}, 2 };
inline const uint16 _Test_Device_OperationalStatus_elements[] = { 2, 5 };
inline const Meta_Value_Array<uint16> _Test_Device_OperationalStatus_value =
    { {}, _Test_Device_OperationalStatus_elements, 2 };
inline const Meta_Value_Scalar<const char*> _Test_Device_Uptime_value =
    { {}, "00000001000000.000000:000" };
inline const char* const _Test_Device_Aliases_elements[] = { "a", "b" };
inline const Meta_Value_Array<const char*> _Test_Device_Aliases_value =
    { {}, _Test_Device_Aliases_elements, 2 };

TEST_PROP(Test_Device, SystemCreationClassName, FLAG_KEY, STRING, 0, 0);
TEST_PROP(Test_Device, SystemName, FLAG_KEY, STRING, 0, 0);
TEST_PROP(Test_Device, CreationClassName, FLAG_KEY, STRING, 0, 0);
TEST_PROP(Test_Device, DeviceID, FLAG_KEY, STRING, 0, 0);
TEST_PROP(Test_Device, PortAvailability, 0, UINT16, 0, &_Test_Device_PortAvailability_value);
TEST_PROP(Test_Device, OperationalStatus, 0, UINT16, -1, &_Test_Device_OperationalStatus_value);
TEST_PROP(Test_Device, Speed, FLAG_GAUGE, UINT64, 0, 0);
TEST_PROP(Test_Device, Enabled, 0, BOOLEAN, 0, 0);
TEST_PROP(Test_Device, Temperature, 0, REAL32, 0, 0);
TEST_PROP(Test_Device, Load, 0, REAL64, 0, 0);
TEST_PROP(Test_Device, Started, 0, DATETIME, 0, 0);
TEST_PROP(Test_Device, Uptime, 0, DATETIME, 0, &_Test_Device_Uptime_value);
TEST_PROP(Test_Device, Symbol, 0, CHAR16, 0, 0);
TEST_PROP(Test_Device, Offset, 0, SINT8, 0, 0);
TEST_PROP(Test_Device, Aliases, 0, STRING, -1, &_Test_Device_Aliases_value);
TEST_PROP(Test_Device, Notes, FLAG_EMBEDDED_OBJECT, STRING, 0, 0);

inline Meta_Feature* _Test_Device_MFA[] =
{
    &_Test_ManagedElement_Caption,
    &_Test_ManagedElement_Description,
    &_Test_ManagedElement_ElementName,
    &_Test_Device_SystemCreationClassName,
    &_Test_Device_SystemName,
    &_Test_Device_CreationClassName,
    &_Test_Device_DeviceID,
    &_Test_Device_PortAvailability,
    &_Test_Device_OperationalStatus,
    &_Test_Device_Speed,
    &_Test_Device_Enabled,
    &_Test_Device_Temperature,
    &_Test_Device_Load,
    &_Test_Device_Started,
    &_Test_Device_Uptime,
    &_Test_Device_Symbol,
    &_Test_Device_Offset,
    &_Test_Device_Aliases,
    &_Test_Device_Notes,
};

inline const uint8 _Test_Device_locals[] = { 0, 0, 0, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, 1 };

inline const Meta_Class Test_Device::static_meta_class =
{
    TEST_CLASS_HEAD(FLAG_CLASS, "Test_Device"),
    _Test_Device_MFA, TEST_COUNT(_Test_Device_MFA),
    sizeof(Test_Device), _Test_Device_locals, &Test_ManagedElement::static_meta_class, 4,
    &test_repository,
};

//
// Test_Job
//

struct Test_Job : Test_ManagedElement
{
    Property<String> InstanceID;
    Property<sint32> Priority;

    static const Meta_Class static_meta_class;
};

TEST_PROP(Test_Job, InstanceID, FLAG_KEY, STRING, 0, 0);
TEST_PROP(Test_Job, Priority, 0, SINT32, 0, 0);

inline Meta_Feature* _Test_Job_MFA[] =
{
    &_Test_ManagedElement_Caption,
    &_Test_ManagedElement_Description,
    &_Test_ManagedElement_ElementName,
    &_Test_Job_InstanceID,
    &_Test_Job_Priority,
};

inline const uint8 _Test_Job_locals[] = { 0, 0, 0, 1, 1 };

inline const Meta_Class Test_Job::static_meta_class =
{
    TEST_CLASS_HEAD(FLAG_CLASS, "Test_Job"),
    _Test_Job_MFA, TEST_COUNT(_Test_Job_MFA),
    sizeof(Test_Job), _Test_Job_locals, &Test_ManagedElement::static_meta_class, 1,
    &test_repository,
};

//
// Test_Port, with the method Reset(Force, Delay, Job OUT)
//

struct Test_Port : Test_Device
{
    Property<uint32> PortNumber;

    static const Meta_Class static_meta_class;
};

struct Test_Port_Reset_method : Instance
{
    Property<boolean> Force;
    Property<uint32> Delay;
    Test_Job* Job;
    Property<uint32> return_value;

    static const Meta_Method static_meta_class;
};

TEST_PROP(Test_Port_Reset_method, Force, FLAG_IN, BOOLEAN, 0, 0);
TEST_PROP(Test_Port_Reset_method, Delay, FLAG_IN, UINT32, 0, 0);
TEST_REF(Test_Port_Reset_method, Job, FLAG_OUT, Test_Job, 0);
TEST_PROP(Test_Port_Reset_method, return_value, FLAG_OUT, UINT32, 0, 0);

inline Meta_Feature* _Test_Port_Reset_MFA[] =
{
    &_Test_Port_Reset_method_Force,
    &_Test_Port_Reset_method_Delay,
    &_Test_Port_Reset_method_Job,
    &_Test_Port_Reset_method_return_value,
};

inline const Meta_Method Test_Port_Reset_method::static_meta_class =
{
    TEST_HEAD(FLAG_METHOD, "Reset"),
    _Test_Port_Reset_MFA, TEST_COUNT(_Test_Port_Reset_MFA),
    sizeof(Test_Port_Reset_method), UINT32,
};

// A re-declared feature keeps the parent's slot.
inline Meta_Property _Test_Port_DeviceID =
    { TEST_HEAD(FLAG_PROPERTY | FLAG_READ | FLAG_KEY, "DeviceID"), STRING, 0,
      offsetof(Test_Device, DeviceID), 0 };
TEST_PROP(Test_Port, PortNumber, 0, UINT32, 0, 0);

inline Meta_Feature* _Test_Port_MFA[] =
{
    &_Test_ManagedElement_Caption,
    &_Test_ManagedElement_Description,
    &_Test_ManagedElement_ElementName,
    &_Test_Device_SystemCreationClassName,
    &_Test_Device_SystemName,
    &_Test_Device_CreationClassName,
    &_Test_Port_DeviceID,
    &_Test_Device_PortAvailability,
    &_Test_Device_OperationalStatus,
    &_Test_Device_Speed,
    &_Test_Device_Enabled,
    &_Test_Device_Temperature,
    &_Test_Device_Load,
    &_Test_Device_Started,
    &_Test_Device_Uptime,
    &_Test_Device_Symbol,
    &_Test_Device_Offset,
    &_Test_Device_Aliases,
    &_Test_Device_Notes,
    &_Test_Port_PortNumber,
    (Meta_Feature*)&Test_Port_Reset_method::static_meta_class,
};

inline const uint8 _Test_Port_locals[] =
    { 0, 0, 0, 0, 0, 0, 1, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 1, 1 };

inline const Meta_Class Test_Port::static_meta_class =
{
    TEST_CLASS_HEAD(FLAG_CLASS, "Test_Port"),
    _Test_Port_MFA, TEST_COUNT(_Test_Port_MFA),
    sizeof(Test_Port), _Test_Port_locals, &Test_Device::static_meta_class, 4,
    &test_repository,
};

//
// Test_Numbers: a key of each integer width and a boolean key
//

struct Test_Numbers : Instance
{
    Property<uint8> U8;
    Property<sint8> S8;
    Property<uint16> U16;
    Property<sint16> S16;
    Property<uint32> U32;
    Property<sint32> S32;
    Property<uint64> U64;
    Property<sint64> S64;
    Property<boolean> Flag;

    static const Meta_Class static_meta_class;
};

TEST_PROP(Test_Numbers, U8, FLAG_KEY, UINT8, 0, 0);
TEST_PROP(Test_Numbers, S8, FLAG_KEY, SINT8, 0, 0);
TEST_PROP(Test_Numbers, U16, FLAG_KEY, UINT16, 0, 0);
TEST_PROP(Test_Numbers, S16, FLAG_KEY, SINT16, 0, 0);
TEST_PROP(Test_Numbers, U32, FLAG_KEY, UINT32, 0, 0);
TEST_PROP(Test_Numbers, S32, FLAG_KEY, SINT32, 0, 0);
TEST_PROP(Test_Numbers, U64, FLAG_KEY, UINT64, 0, 0);
TEST_PROP(Test_Numbers, S64, FLAG_KEY, SINT64, 0, 0);
TEST_PROP(Test_Numbers, Flag, FLAG_KEY, BOOLEAN, 0, 0);

inline Meta_Feature* _Test_Numbers_MFA[] =
{
    &_Test_Numbers_U8,
    &_Test_Numbers_S8,
    &_Test_Numbers_U16,
    &_Test_Numbers_S16,
    &_Test_Numbers_U32,
    &_Test_Numbers_S32,
    &_Test_Numbers_U64,
    &_Test_Numbers_S64,
    &_Test_Numbers_Flag,
};

inline const uint8 _Test_Numbers_locals[] = { 1, 1, 1, 1, 1, 1, 1, 1, 1 };

inline const Meta_Class Test_Numbers::static_meta_class =
{
    TEST_CLASS_HEAD(FLAG_CLASS, "Test_Numbers"),
    _Test_Numbers_MFA, TEST_COUNT(_Test_Numbers_MFA),
    sizeof(Test_Numbers), _Test_Numbers_locals, 0, 9, &test_repository,
};

//
// Test_Dependency and Test_PortOfDevice
//

struct Test_Dependency : Instance
{
    Test_ManagedElement* Antecedent;
    Test_ManagedElement* Dependent;

    static const Meta_Class static_meta_class;
};

TEST_REF(Test_Dependency, Antecedent, FLAG_KEY, Test_ManagedElement, 0);
TEST_REF(Test_Dependency, Dependent, FLAG_KEY, Test_ManagedElement, 0);

inline Meta_Feature* _Test_Dependency_MFA[] =
{
    &_Test_Dependency_Antecedent,
    &_Test_Dependency_Dependent,
};

inline const uint8 _Test_Dependency_locals[] = { 1, 1 };

inline const Meta_Class Test_Dependency::static_meta_class =
{
    TEST_CLASS_HEAD(FLAG_ASSOCIATION | FLAG_ABSTRACT, "Test_Dependency"),
    _Test_Dependency_MFA, TEST_COUNT(_Test_Dependency_MFA),
    sizeof(Test_Dependency), _Test_Dependency_locals, 0, 2, &test_repository,
};

struct Test_PortOfDevice : Test_Dependency
{
    static const Meta_Class static_meta_class;
};

inline Meta_Reference _Test_PortOfDevice_Antecedent =
    { TEST_HEAD(FLAG_REFERENCE | FLAG_KEY, "Antecedent"), 0,
      &Test_Device::static_meta_class, offsetof(Test_Dependency, Antecedent) };
inline Meta_Reference _Test_PortOfDevice_Dependent =
    { TEST_HEAD(FLAG_REFERENCE | FLAG_KEY, "Dependent"), 0,
      &Test_Port::static_meta_class, offsetof(Test_Dependency, Dependent) };

inline Meta_Feature* _Test_PortOfDevice_MFA[] =
{
    &_Test_PortOfDevice_Antecedent,
    &_Test_PortOfDevice_Dependent,
};

inline const uint8 _Test_PortOfDevice_locals[] = { 1, 1 };

inline const Meta_Class Test_PortOfDevice::static_meta_class =
{
    TEST_CLASS_HEAD(FLAG_ASSOCIATION, "Test_PortOfDevice"),
    _Test_PortOfDevice_MFA, TEST_COUNT(_Test_PortOfDevice_MFA),
    sizeof(Test_PortOfDevice), _Test_PortOfDevice_locals, &Test_Dependency::static_meta_class,
    2, &test_repository,
};

//
// Test_Collection: a reference array
//

struct Test_Collection : Instance
{
    Property<String> InstanceID;
    Property<Array<Test_Device*>> Members;

    static const Meta_Class static_meta_class;
};

TEST_PROP(Test_Collection, InstanceID, FLAG_KEY, STRING, 0, 0);
TEST_REF(Test_Collection, Members, 0, Test_Device, -1);

inline Meta_Feature* _Test_Collection_MFA[] =
{
    &_Test_Collection_InstanceID,
    &_Test_Collection_Members,
};

inline const uint8 _Test_Collection_locals[] = { 1, 1 };

inline const Meta_Class Test_Collection::static_meta_class =
{
    TEST_CLASS_HEAD(FLAG_CLASS, "Test_Collection"),
    _Test_Collection_MFA, TEST_COUNT(_Test_Collection_MFA),
    sizeof(Test_Collection), _Test_Collection_locals, 0, 1, &test_repository,
};

//
// Test_Alert: an indication without keys
//

struct Test_Alert : Instance
{
    Property<String> Message;

    static const Meta_Class static_meta_class;
};

TEST_PROP(Test_Alert, Message, 0, STRING, 0, 0);

inline Meta_Feature* _Test_Alert_MFA[] = { &_Test_Alert_Message };

inline const uint8 _Test_Alert_locals[] = { 1 };

inline const Meta_Class Test_Alert::static_meta_class =
{
    TEST_CLASS_HEAD(FLAG_INDICATION, "Test_Alert"),
    _Test_Alert_MFA, TEST_COUNT(_Test_Alert_MFA),
    sizeof(Test_Alert), _Test_Alert_locals, 0, 0, &test_repository,
};

//
// The repository
//

inline const Meta_Class* const _test_meta_classes[] =
{
    &Test_ManagedElement::static_meta_class,
    &Test_Device::static_meta_class,
    &Test_Job::static_meta_class,
    &Test_Port::static_meta_class,
    &Test_Numbers::static_meta_class,
    &Test_Dependency::static_meta_class,
    &Test_PortOfDevice::static_meta_class,
    &Test_Collection::static_meta_class,
    &Test_Alert::static_meta_class,
};

inline const Meta_Repository test_repository =
{
    _test_meta_classes, TEST_COUNT(_test_meta_classes),
};

#undef TEST_HEAD
#undef TEST_CLASS_HEAD
#undef TEST_PROP
#undef TEST_REF
#undef TEST_COUNT

} // namespace OLMA

#pragma GCC diagnostic pop

#endif // _vspr_tests_runtime_records_h
