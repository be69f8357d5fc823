#ifndef _OLMA_CMPI_Adapter_h
#define _OLMA_CMPI_Adapter_h

// Between the CIM server and one provider: the MI function tables, the
// adapter object that lives while the server holds MI objects of the
// provider, and the frame in which every request runs.

#include "CMPI.h"
#include "Array.h"
#include "Mutex.h"
#include "Registration.h"
#include "Provider_Handle.h"

namespace OLMA
{

class CMPI_Adapter;

enum : uint32
{
    CMPI_STATIC_DATA_MAGIC = 0x5DE2B131,
    CMPI_STATIC_DATA_DEAD = 0xDDDDDDDD,
};

// Room for a function table. Some CMPI headers declare version fields
// const, which would make the record below impossible to zero-initialise and
// fill; the tables are therefore kept as bytes and filled by copy.
template<class FT>
struct __Table_Storage
{
    FT* get() { return reinterpret_cast<FT*>(bytes); }
    alignas(FT) unsigned char bytes[sizeof(FT)];
};

// One per provider, zero-initialised, as long as the module is loaded: the
// hdl of the provider's MI objects, which therefore stay valid after the
// adapter has gone.
struct CMPI_Static_Data
{
    uint32 magic;
    CMPI_Adapter* adapter;
    __Table_Storage<CMPIInstanceMIFT> instance_ft;
    __Table_Storage<CMPIMethodMIFT> method_ft;
    __Table_Storage<CMPIIndicationMIFT> indication_ft;
    __Table_Storage<CMPIAssociationMIFT> association_ft;
    CMPIInstanceMI instance_mi;
    CMPIMethodMI method_mi;
    CMPIAssociationMI association_mi;
    CMPIIndicationMI indication_mi;
    char instance_name[256];
    char method_name[256];
    char indication_name[256];
    char association_name[256];
};

// A namespace with active indication filters, and how many.
struct Name_Space_Entry
{
    Name_Space_Entry() : ref_count(0) { }
    Name_Space_Entry(const String& name_space_, uint32 ref_count_) :
        name_space(name_space_), ref_count(ref_count_) { }

    String name_space;
    uint32 ref_count;
};

inline bool operator==(const Name_Space_Entry& x, const Name_Space_Entry& y)
{
    return x.name_space.equal(y.name_space);
}

class CMPI_Adapter : public Provider_Handle
{
public:

    CMPI_Adapter(const CMPIBroker* broker, const CMPIContext* context,
        const char* provider_name, const Registration* registration,
        CMPI_Static_Data* data);

    ~CMPI_Adapter();

    // Instance MI.
    static CMPIStatus instanceCleanup(
        CMPIInstanceMI* mi, const CMPIContext* context, CMPIBoolean terminating);

    static CMPIStatus enumerateInstanceNames(CMPIInstanceMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path);

    static CMPIStatus enumerateInstances(CMPIInstanceMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path, const char** properties);

    static CMPIStatus getInstance(CMPIInstanceMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path, const char** properties);

    static CMPIStatus createInstance(CMPIInstanceMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path, const CMPIInstance* cmpi_instance);

    static CMPIStatus modifyInstance(CMPIInstanceMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path, const CMPIInstance* cmpi_instance,
        const char** properties);

    static CMPIStatus deleteInstance(CMPIInstanceMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path);

    static CMPIStatus execQuery(CMPIInstanceMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path, const char* query, const char* language);

    // Method MI.
    static CMPIStatus methodCleanup(
        CMPIMethodMI* mi, const CMPIContext* context, CMPIBoolean terminating);

    static CMPIStatus invokeMethod(CMPIMethodMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path, const char* method,
        const CMPIArgs* in_args, CMPIArgs* out_args);

    // Association MI.
    static CMPIStatus associationCleanup(
        CMPIAssociationMI* mi, const CMPIContext* context, CMPIBoolean terminating);

    static CMPIStatus associators(CMPIAssociationMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path, const char* assoc_class,
        const char* result_class, const char* role, const char* result_role,
        const char** properties);

    static CMPIStatus associatorNames(CMPIAssociationMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path, const char* assoc_class,
        const char* result_class, const char* role, const char* result_role);

    static CMPIStatus references(CMPIAssociationMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path, const char* result_class,
        const char* role, const char** properties);

    static CMPIStatus referenceNames(CMPIAssociationMI* mi,
        const CMPIContext* context, const CMPIResult* result,
        const CMPIObjectPath* object_path, const char* result_class,
        const char* role);

    // Indication MI.
    static CMPIStatus indicationCleanup(
        CMPIIndicationMI* mi, const CMPIContext* context, CMPIBoolean terminating);

    static CMPIStatus authorizeFilter(CMPIIndicationMI* mi,
        const CMPIContext* context, const CMPISelectExp* filter,
        const char* class_name, const CMPIObjectPath* object_path, const char* owner);

    static CMPIStatus mustPoll(CMPIIndicationMI* mi,
        const CMPIContext* context, const CMPISelectExp* filter,
        const char* class_name, const CMPIObjectPath* object_path);

    static CMPIStatus activateFilter(CMPIIndicationMI* mi,
        const CMPIContext* context, const CMPISelectExp* filter,
        const char* class_name, const CMPIObjectPath* object_path,
        CMPIBoolean first_activation);

    static CMPIStatus deactivateFilter(CMPIIndicationMI* mi,
        const CMPIContext* context, const CMPISelectExp* filter,
        const char* class_name, const CMPIObjectPath* object_path,
        CMPIBoolean last_activation);

    static CMPIStatus enableIndications(CMPIIndicationMI* mi, const CMPIContext* context);

    static CMPIStatus disableIndications(CMPIIndicationMI* mi, const CMPIContext* context);

    // The common body of the four cleanup functions.
    static CMPIrc cleanup(CMPI_Adapter* adapter, const CMPIContext* context,
        bool terminating);

    // Tracing at DBG.
    static void ent(const char* file, size_t line, const char* name);
    static void ret(const char* file, size_t line, const char* name);
    static void ret(const char* file, size_t line, const char* name, CMPIrc rc);
    static void ret(const char* file, size_t line, const char* name, CMPIrc rc,
        const char* message);
    static void trc(const char* file, size_t line, const char* format, ...)
        __attribute__((format(printf, 3, 4)));

    // The class of a request: one of the module's repository, and one that
    // the provider's own class can stand for. Null if none.
    const Meta_Class* find_model_meta_class(const char* class_name);

    const CMPIBroker* broker;
    CMPI_Static_Data* static_data;
    size_t load_count;
    bool allow_unload_flag;
    Array<Name_Space_Entry> name_spaces;
    bool indications_enabled;
    Mutex lock;
};

// The name of a CMPI return code, for the log.
const char* _rc_to_str(int rc);

} // namespace OLMA

// The shared body of all the module's Create_*MI entries. type is 'I', 'M',
// 'A' or 'N'; *mi_out gets the MI object, or stays null for another letter.
extern "C" int tessel_cmpi_adapter(OLMA::CMPI_Static_Data* data,
    const OLMA::Registration* registration, const CMPIBroker* broker,
    const CMPIContext* context, const char* provider_name, int type, void** mi_out);

#endif // _OLMA_CMPI_Adapter_h
