#ifndef _VSPR_EthernetPortHelper_h
#define _VSPR_EthernetPortHelper_h

#include <json/json.h>

#include "Array.h"
#include "Instance.h"
#include "String.h"
#include "ProviderTypes.h"
#include "VESPERA_EthernetPort.h"
#include "VESPERA_LANEndpoint.h"

namespace OLMA
{

// What one Ethernet port contributes to its instances. Zeroed for each port
// and handed to the builders by value; every text is cut to its field.
struct _ethPortInfo
{
    char macAddress[36];          // plain form, from the port's index string
    char deviceName[1028];        // the host's device name ("ethDev")
    unsigned int state;           // "ethPortStateMOFValue"
    char hostName[64];            // host string of getHostInfo
    char permanentAddress[24];    // the same plain-form MAC
    uint16 portType;              // from the transceiver; 0 if unknown
    uint16 portNumber;            // place in the adapter's list, from 0
    unsigned int mtu;             // "mtu"; 0 if missing
};

// Builds VESPERA_EthernetPort and VESPERA_LANEndpoint for the Ethernet ports
// of every adapter that has them. Ethernet ports are named by MAC. Nothing is
// kept between calls; the caller owns every instance it gets.
class EthernetPortHelper
{
public:

    EthernetPortHelper();

    static EthernetPortHelper* getEthernetPortHelperObject();

    // Instances of all adapters, for ID_VESPERA_EthernetPort or
    // ID_VESPERA_LANEndpoint.
    Array<Instance*> getInstancesByClass(classId_t id);

    // Instances of one adapter, its id counted from 1.
    Array<Instance*> getInstancesByAdapterId(int adapterId, classId_t id);

    // The VESPERA_EthernetPort instances of the adapter that owns the port
    // named by address (either text form).
    Array<Instance*> getEthernetPortInstancesByAdapter(String address);

    // getEthPortByEthMac of the port; 0 when the reply carries an object
    // "ethData", else -1. The reply stays in reply either way.
    int getEthPortDetails(String mac, Json::Value& reply);

    // The CIM PortType of a transceiver text; 0 for one we don't know.
    uint16 getPortType(const char* transceiver);

    // Fills the fields that come from an "ethData" object; the others are
    // left as they are. Members of the wrong type count as missing.
    static void fillFromEthData(const Json::Value& ethData, _ethPortInfo* info);

    VESPERA_EthernetPort* getEthernetPortInstance(_ethPortInfo info);
    VESPERA_LANEndpoint* getLANEndpointInstance(_ethPortInfo info);

    static EthernetPortHelper* helperObj;

private:

    EthernetPortHelper(const EthernetPortHelper&);
    EthernetPortHelper& operator=(const EthernetPortHelper&);
};

extern EthernetPortHelper gEthernetPortHelperObj;

} // namespace OLMA

#endif
