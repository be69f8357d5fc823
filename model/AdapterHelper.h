#ifndef _VSPR_AdapterHelper_h
#define _VSPR_AdapterHelper_h

#include <json/json.h>

#include "Array.h"
#include "Instance.h"
#include "ProviderTypes.h"

namespace OLMA
{

// What one adapter's reply says about the card, flattened so that the
// builders take it by value. Every text is cut to its field and always
// terminated, whatever the library sent.
struct _adapterData
{
    char nodeWwn[24];               // plain form; only with a storage driver
    char mac[18];                   // plain form; CNA only
    int state;                      // 11 in service, 10 disabled
    char hostName[256];
    char model[16];
    char serialNumber[64];
    char manufacturer[16];
    char fruNumber[16];
    char partNumber[16];
    char storageDriverName[16];
    char storageDriverVersion[64];
    char networkDriverName[16];
    char networkDriverVersion[64];
    char firmwareVersion[64];
    char biosVersion[64];
    bool isCNA;
    char uuid[33];
};

// The kinds of adapter software; the values are those of Classifications.
enum softwareType_t
{
    SOFTWARE_DRIVER = 2,
    SOFTWARE_FIRMWARE = 10,
    SOFTWARE_BIOS = 32770
};

// Builds the instances that describe the cards themselves: the controller,
// the physical card, the product and the software on it.
class AdapterHelper
{
public:

    static AdapterHelper* getAdapterHelperInstance();

    // New instances of VESPERA_PortController, VESPERA_PhysicalPackage,
    // VESPERA_Product or VESPERA_AdapterSoftwareIdentity, for every adapter
    // that can be read; the caller owns them. Any other id gives none.
    Array<Instance*> getInstancesByClass(classId_t id);

    // The vital product data of hbaData: FRU and part number, the OEM
    // serial number where there is one, and the card's UUID.
    void fillVPDInfo(Json::Value hbaData, _adapterData* data);

    Instance* getPortControllerInstance(_adapterData data);
    Instance* getPhysicalPackageInstance(_adapterData data);
    Instance* getProductInstance(_adapterData data);

    // isNetworkDriver tells the two drivers apart; other types ignore it.
    Instance* getAdapterSoftwareIdentityInstance(
        _adapterData data, softwareType_t type, bool isNetworkDriver);

    // Reading replies, which are untrusted: a member of the wrong type
    // counts as missing, and nothing here throws.

    // Member name of obj, or null if obj isn't an object or lacks it.
    static const Json::Value* jsonMember(const Json::Value& obj, const char* name);

    // The text of member name of obj; "" if it is missing or not a text.
    static const char* jsonText(const Json::Value& obj, const char* name);

    // Copies at most size - 1 characters of src and terminates dst, so that
    // an over-long text is cut instead of overrunning the field.
    static void copyField(char* dst, size_t size, const char* src);

    // The same without leading and trailing blanks.
    static void copyTrimmedField(char* dst, size_t size, const char* src);

    static AdapterHelper* helperObj;
};

extern AdapterHelper gAdapterHelperObj;

} // namespace OLMA

#endif
