// The types of the members a host description may hold. A description is
// written by hand, so a member of the wrong type is a mistake of its author:
// it is refused at load, with the path of the member, instead of turning up
// later as an odd reply or an exception inside some entry.
//
// Members the table doesn't know are the author's own and are passed on as
// they are. So is everything under "unchecked", which exists to hand a
// caller replies of shapes the library would never send.
#include "Sim.h"

#include <cstring>

namespace OLMA {
namespace Sim {

namespace {

enum Kind {
    ANY,
    TEXT,
    WHOLE,      // an integral number
    NUMBER,
    BOOLEAN,
    OBJECT,
    ARRAY,
    TEXT_OR_WHOLE,
    TEXT_OR_OBJECT,
};

struct Member;

// What a value must be: its kind, the members of an object, the shape of
// each element of an array.
struct Shape {
    Kind kind;
    const Member* members;
    const Shape* element;
};

struct Member {
    const char* name;
    const Shape* shape;
};

const Shape anyValue = {ANY, nullptr, nullptr};
const Shape text = {TEXT, nullptr, nullptr};
const Shape whole = {WHOLE, nullptr, nullptr};
const Shape number = {NUMBER, nullptr, nullptr};
const Shape boolean = {BOOLEAN, nullptr, nullptr};
const Shape freeObject = {OBJECT, nullptr, nullptr};
const Shape freeArray = {ARRAY, nullptr, &anyValue};
const Shape textOrWhole = {TEXT_OR_WHOLE, nullptr, nullptr};
const Shape wholes = {ARRAY, nullptr, &whole};
const Shape freeObjects = {ARRAY, nullptr, &freeObject};

// ---------------------------------------------------------------- tests

#define TEST_MEMBERS \
    {"durationMs", &whole}, {"failed", &boolean}, {"output", &text}, \
    {"badFrames", &whole}, {"BadFrameNo", &whole}, {"BadFrameInfo", &whole}, \
    {"outstandingFrames", &whole}, {"type", &text}, {"address", &whole}, \
    {"expected value", &whole}, {"actual value", &whole}, {"error status", &whole}, \
    {"error address", &whole}, {"roundTripLatencyNs", &number}, \
    {"cableLengthMeters", &number}

// A memory test reports a numeric status, the others a word such as "Passed".
const Member memoryTestMembers[] = {TEST_MEMBERS, {"status", &whole}, {nullptr, nullptr}};
const Shape memoryTest = {OBJECT, memoryTestMembers, nullptr};
const Member testMembers[] = {TEST_MEMBERS, {"status", &text}, {nullptr, nullptr}};
const Shape test = {OBJECT, testMembers, nullptr};

#undef TEST_MEMBERS

// ---------------------------------------------------------------- shared parts

const Member sfpMembers[] = {
    {"vendorName", &text}, {"serialNo", &text}, {"vendorPart", &text}, {"revision", &text},
    {"speed", &text}, {"extendedID", &text}, {"transceiver", &text},
    {"unchecked", &freeObject}, {nullptr, nullptr}};
const Shape sfp = {OBJECT, sfpMembers, nullptr};

const Member pomMembers[] = {
    {"temperature", &number}, {"voltage", &number}, {"current", &number},
    {"txPower", &number}, {"rxPower", &number}, {"level", &text}, {nullptr, nullptr}};
const Shape pom = {OBJECT, pomMembers, nullptr};

const Member lunMembers[] = {
    {"number", &whole}, {"vendor", &text}, {"productID", &text}, {"lunDescIdType", &whole},
    {"lunDescription", &text}, {"productSerialNumber", &text}, {"capacityMB", &whole},
    {"unchecked", &freeObject}, {nullptr, nullptr}};
const Shape lun = {OBJECT, lunMembers, nullptr};
const Shape luns = {ARRAY, nullptr, &lun};

const Member deviceDataMembers[] = {
    {"isTarget", &boolean}, {"type", &text}, {"stateMofValue", &whole}, {"pid", &text},
    {nullptr, nullptr}};
const Shape deviceData = {OBJECT, deviceDataMembers, nullptr};

const Member remotePortMembers[] = {
    {"remotePortWwn", &text}, {"remoteNodeWwn", &text}, {"deviceData", &deviceData},
    {"lunList", &luns}, {"unchecked", &freeObject}, {nullptr, nullptr}};
const Shape remotePort = {OBJECT, remotePortMembers, nullptr};
const Shape remotePorts = {ARRAY, nullptr, &remotePort};

// ---------------------------------------------------------------- FC ports

const Member fcoeMembers[] = {
    {"fcoeMac", &text}, {"fcfMac", &text}, {"vlanId", &whole}, {"fipMode", &text},
    {"fcMap", &text}, {nullptr, nullptr}};
const Shape fcoe = {OBJECT, fcoeMembers, nullptr};

const Member fcDataMembers[] = {
    {"topology", &text}, {"configuredSpeed", &text}, {"maxFrameSize", &whole},
    {"bbCredit", &whole}, {"pathTov", &whole}, {"qosEnabled", &boolean},
    {"targetRateLimit", &boolean}, {nullptr, nullptr}};
const Shape fcData = {OBJECT, fcDataMembers, nullptr};

const Member portAdvDataMembers[] = {
    {"pid", &text}, {"fabricName", &text}, {"topology", &text}, {"bbCredit", &whole},
    {nullptr, nullptr}};
const Shape portAdvData = {OBJECT, portAdvDataMembers, nullptr};

const Member bootOverSanMembers[] = {
    {"enabled", &boolean}, {"bootLuns", &freeArray}, {nullptr, nullptr}};
const Shape bootOverSan = {OBJECT, bootOverSanMembers, nullptr};

const Member authMembers[] = {
    {"authEnabled", &boolean}, {"algorithm", &text}, {"hashGroup", &text}, {"secret", &text},
    {nullptr, nullptr}};
const Shape auth = {OBJECT, authMembers, nullptr};

const Member enabledMembers[] = {{"enabled", &boolean}, {nullptr, nullptr}};
const Shape enabledOnly = {OBJECT, enabledMembers, nullptr};

const Member vportMembers[] = {
    {"vwwn", &text}, {"nodeWwn", &text}, {"symbolicName", &text}, {"vfId", &whole},
    {"remotePorts", &remotePorts}, {nullptr, nullptr}};
const Shape vport = {OBJECT, vportMembers, nullptr};
const Shape vports = {ARRAY, nullptr, &vport};

const Member lunMaskEntryMembers[] = {
    {"rPortWwn", &text}, {"lunId", &textOrWhole}, {nullptr, nullptr}};
const Shape lunMaskEntry = {OBJECT, lunMaskEntryMembers, nullptr};
const Shape lunMaskEntries = {ARRAY, nullptr, &lunMaskEntry};
const Member lunMaskMembers[] = {
    {"enabled", &boolean}, {"entries", &lunMaskEntries}, {nullptr, nullptr}};
const Shape lunMask = {OBJECT, lunMaskMembers, nullptr};

const Member fcPortDiagMembers[] = {
    {"loopback", &test}, {"pciLoopback", &test}, {"dport", &test}, {nullptr, nullptr}};
const Shape fcPortDiag = {OBJECT, fcPortDiagMembers, nullptr};

const Member fcPortMembers[] = {
    {"wwn", &text}, {"nodeWwn", &text}, {"PortSymbolicName", &text},
    {"operatingSpeed", &whole}, {"supportedPortSpeeds", &wholes},
    {"portTypeMOFValue", &whole}, {"maxFrameSize", &whole}, {"portStatusValue", &whole},
    {"portStatus", &boolean}, {"linkUp", &boolean}, {"beaconState", &boolean},
    {"isMezz", &boolean}, {"alias", &text}, {"isFCoE", &boolean}, {"fcoeMac", &text},
    {"fcoe", &fcoe}, {"fcData", &fcData}, {"advData", &portAdvData},
    {"bootOverSan", &bootOverSan}, {"auth", &auth}, {"trunking", &enabledOnly},
    {"dport", &enabledOnly}, {"sfp", &sfp}, {"pom", &pom}, {"diag", &fcPortDiag},
    {"remotePorts", &remotePorts}, {"vports", &vports}, {"lunMask", &lunMask},
    {"ioProfiles", &freeObjects}, {"logs", &freeArray}, {"unchecked", &freeObject},
    {nullptr, nullptr}};
const Shape fcPort = {OBJECT, fcPortMembers, nullptr};
const Shape fcPorts = {ARRAY, nullptr, &fcPort};

// ---------------------------------------------------------------- Ethernet ports

const Member vnicMembers[] = {
    {"pciFunctionIndex", &whole}, {"mac", &text}, {"minBandwidth", &whole},
    {"maxBandwidth", &whole}, {nullptr, nullptr}};
const Shape vnic = {OBJECT, vnicMembers, nullptr};
const Shape vnics = {ARRAY, nullptr, &vnic};

const Member ethPortDiagMembers[] = {
    {"ethLoopback", &test}, {"pciLoopback", &test}, {nullptr, nullptr}};
const Shape ethPortDiag = {OBJECT, ethPortDiagMembers, nullptr};

const Member ethPortMembers[] = {
    {"mac", &text}, {"ethDev", &text}, {"mtu", &whole}, {"ethPortStateMOFValue", &whole},
    {"portStatus", &boolean}, {"linkUp", &boolean}, {"alias", &text},
    {"operatingSpeed", &whole}, {"isMezz", &boolean}, {"sfp", &sfp}, {"pom", &pom},
    {"lldp", &freeObject}, {"cee", &freeObject}, {"vnics", &vnics}, {"diag", &ethPortDiag},
    {"unchecked", &freeObject}, {nullptr, nullptr}};
const Shape ethPort = {OBJECT, ethPortMembers, nullptr};
const Shape ethPorts = {ARRAY, nullptr, &ethPort};

// ---------------------------------------------------------------- adapters

const Member hbaDataMembers[] = {
    {"wwn", &text}, {"hbaMAC", &text}, {"model", &text}, {"serialNumber", &text},
    {"oem", &text}, {"fruNum", &text}, {"partNum", &text}, {"oemSerialNum", &text},
    {"uuid", &text}, {"hbaStatus", &boolean}, {"isMezz", &boolean}, {"alias", &text},
    {"mode", &text}, {"pciLocation", &text}, {"unchecked", &freeObject}, {nullptr, nullptr}};
const Shape hbaData = {OBJECT, hbaDataMembers, nullptr};

const Member driverMembers[] = {
    {"storageDriverName", &text}, {"storageDriverVersion", &text},
    {"networkDriverName", &text}, {"networkDriverVersion", &text}, {nullptr, nullptr}};
const Shape driver = {OBJECT, driverMembers, nullptr};

const Member firmwareMembers[] = {{"version", &text}, {"biosVersion", &text}, {nullptr, nullptr}};
const Shape firmware = {OBJECT, firmwareMembers, nullptr};

const Member flashMembers[] = {
    {"flashStatus", &boolean}, {"updateStatus", &whole}, {"updateMessage", &text},
    {"durationMs", &whole}, {nullptr, nullptr}};
const Shape flash = {OBJECT, flashMembers, nullptr};

const Member adapterAdvDataMembers[] = {
    {"pciLocation", &text}, {"pciGeneration", &whole}, {"pciLanes", &whole},
    {"chipRevision", &text}, {"temperatureC", &number}, {nullptr, nullptr}};
const Shape adapterAdvData = {OBJECT, adapterAdvDataMembers, nullptr};

const Member adapterDiagMembers[] = {{"memory", &memoryTest}, {nullptr, nullptr}};
const Shape adapterDiag = {OBJECT, adapterDiagMembers, nullptr};

const Member adapterMembers[] = {
    {"hbaData", &hbaData}, {"driver", &driver}, {"firmware", &firmware}, {"flash", &flash},
    {"advData", &adapterAdvData}, {"diag", &adapterDiag}, {"fcPorts", &fcPorts},
    {"ethPorts", &ethPorts}, {"globalInfo", &freeObject}, {"unchecked", &freeObject},
    {nullptr, nullptr}};
const Shape adapter = {OBJECT, adapterMembers, nullptr};
const Shape adapters = {ARRAY, nullptr, &adapter};

// ---------------------------------------------------------------- the host

const Member hostMembers[] = {
    {"hostName", &text}, {"osName", &text}, {"osVersion", &text}, {"agentVersion", &text},
    {"initResult", &whole}, {nullptr, nullptr}};
const Shape hostPart = {OBJECT, hostMembers, nullptr};

// A fault is a kind, or an object that says more.
const Member faultMembers[] = {
    {"kind", &text}, {"code", &whole}, {"message", &text}, {"delayMs", &whole},
    {"count", &whole}, {nullptr, nullptr}};
const Shape fault = {TEXT_OR_OBJECT, faultMembers, nullptr};
const Shape faults = {OBJECT, nullptr, &fault};

const Shape posted = {OBJECT, nullptr, &test};
const Member diagnosticsMembers[] = {
    {"requireOffline", &boolean}, {"loopback", &test}, {"ethLoopback", &test},
    {"pciLoopback", &test}, {"memory", &memoryTest}, {"dport", &test}, {"posted", &posted},
    {nullptr, nullptr}};
const Shape diagnostics = {OBJECT, diagnosticsMembers, nullptr};

const Member rootMembers[] = {
    {"host", &hostPart}, {"faults", &faults}, {"diagnostics", &diagnostics},
    {"adapters", &adapters}, {"globalInfo", &freeObject}, {nullptr, nullptr}};
const Shape root = {OBJECT, rootMembers, nullptr};

bool isNumber(const Json::Value& v)
{
    return v.type() == Json::intValue || v.type() == Json::uintValue
        || v.type() == Json::realValue;
}

bool isWhole(const Json::Value& v)
{
    return v.type() == Json::intValue || v.type() == Json::uintValue
        || (v.type() == Json::realValue && v.isIntegral());
}

// Why v isn't of the kind, or null if it is.
const char* mismatch(const Json::Value& v, Kind kind)
{
    switch (kind) {
    case ANY:
        return nullptr;
    case TEXT:
        return v.isString() ? nullptr : "expected a string";
    case WHOLE:
        if (!isNumber(v))
            return "expected a number";
        return isWhole(v) ? nullptr : "expected a whole number";
    case NUMBER:
        return isNumber(v) ? nullptr : "expected a number";
    case BOOLEAN:
        return v.isBool() ? nullptr : "expected a boolean";
    case OBJECT:
        return v.isObject() ? nullptr : "expected an object";
    case ARRAY:
        return v.isArray() ? nullptr : "expected an array";
    case TEXT_OR_WHOLE:
        return v.isString() || isWhole(v) ? nullptr : "expected a string or a whole number";
    case TEXT_OR_OBJECT:
        return v.isString() || v.isObject() ? nullptr : "expected a string or an object";
    }
    return nullptr;
}

bool check(const Json::Value& v, const Shape& shape, const std::string& path, std::string& err)
{
    if (const char* why = mismatch(v, shape.kind)) {
        err = path + ": " + why;
        return false;
    }
    if (v.isObject()) {
        if (shape.members) {
            for (const Member* m = shape.members; m->name; ++m) {
                const Json::Value* member = v.find(m->name, m->name + strlen(m->name));
                if (member && !check(*member, *m->shape, (path.empty() ? "" : path + ".") + m->name, err))
                    return false;
            }
        } else if (shape.element) {
            // An object of named entries of one shape, such as "posted".
            for (const std::string& name : v.getMemberNames())
                if (!check(v[name], *shape.element, (path.empty() ? "" : path + ".") + name, err))
                    return false;
        }
    } else if (v.isArray() && shape.element) {
        for (Json::ArrayIndex i = 0; i < v.size(); ++i)
            if (!check(v[i], *shape.element, path + "[" + std::to_string(i) + "]", err))
                return false;
    }
    return true;
}

} // namespace

bool checkHostTypes(const Json::Value& host, std::string& err)
{
    return check(host, root, "", err);
}

bool checkMemberType(const char* part, const std::string& name, const Json::Value& value,
                     std::string& err)
{
    static const struct { const char* name; const Shape* shape; } parts[] = {
        {"fcPort", &fcPort}, {"ethPort", &ethPort}, {"fcData", &fcData}, {"fcoe", &fcoe},
        {"auth", &auth}, {nullptr, nullptr}};
    for (auto* p = parts; p->name; ++p) {
        if (strcmp(p->name, part) != 0)
            continue;
        for (const Member* m = p->shape->members; m->name; ++m)
            if (name == m->name)
                return check(value, *m->shape, name, err);
    }
    return true;
}

} // namespace Sim
} // namespace OLMA
