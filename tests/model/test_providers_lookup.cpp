// getInstance of the classes with many instances looks up the one instance
// its keys name. Whatever the host, the answer must be the enumeration's:
// the same instance with the same values for every path the enumeration
// gives, and not found wherever the enumeration has no instance of that
// path (a key that differs, in its case too, or an element that is gone).

#include <stdlib.h>

#include <cctype>
#include <string>
#include <vector>

#include "ProvidersSupport.h"

using namespace providers_test;

namespace
{

const char* const lookedUp[] = {
    "VESPERA_FCPort", "VESPERA_FCPortStatistics", "VESPERA_SCSIProtocolEndpoint",
    "VESPERA_AlarmDevice", "VESPERA_PhysicalConnector", "VESPERA_StorageExtent",
    "VESPERA_TapeDrive", "VESPERA_LogicalDisk",
};

// A host that trips every rule of the walks: units without descriptions
// (the serial rule, across remote ports), a unit without a vendor, a remote
// port listed twice (in two cases, which the library takes for one), one
// without device data, one that isn't a target, a
// LUN mask, a tape and a changer behind one port, odd cases in addresses, a
// port whose optics can't be read and an adapter whose details can't.
const char* const ODD_HOST = R"({ "adapters": [
  { "hbaData": { "wwn": "20:00:00:00:c9:aa:00:00", "model": "VSPR-1", "serialNumber": "S1" },
    "driver": { "storageDriverName": "vsprfc", "storageDriverVersion": "1" },
    "fcPorts": [
      { "wwn": "10:00:00:00:C9:aa:00:01", "isMezz": false, "beaconState": true,
        "sfp": { "serialNo": "OPT_1", "vendorName": "V" },
        "lunMask": { "enabled": true, "entries": [
          { "rPortWwn": "50:00:00:00:00:00:00:01", "lunId": "1" },
          { "rPortWwn": "50:00:00:00:00:00:00:01", "lunId": "2" },
          { "rPortWwn": "50:00:00:00:00:00:00:04", "lunId": "0" },
          { "rPortWwn": "50:00:00:00:00:00:00:04", "lunId": "1" },
          { "rPortWwn": "50:00:00:00:00:00:00:05", "lunId": "0" } ] },
        "remotePorts": [
          { "remotePortWwn": "50:00:00:00:00:00:00:01",
            "deviceData": { "isTarget": true, "type": "Disk" },
            "lunList": [
              { "number": 1, "vendor": "VSPR", "productID": "A_B", "lunDescIdType": 2,
                "lunDescription": "eui.1" },
              { "number": 2, "vendor": "VSPR", "productID": "A_B", "lunDescIdType": 3,
                "productSerialNumber": "SER2" },
              { "number": 3, "vendor": "VSPR", "productID": "A_B", "lunDescIdType": 2,
                "lunDescription": "masked" } ] },
          { "remotePortWwn": "50:00:00:00:00:00:00:02",
            "deviceData": { "isTarget": false, "type": "Initiator" } },
          { "remotePortWwn": "50:00:00:00:00:00:00:03" },
          { "remotePortWwn": "50:00:00:00:00:00:00:04",
            "deviceData": { "isTarget": true, "type": "Tape" },
            "lunList": [
              { "number": 0, "vendor": "TAPE", "productID": "LTO", "lunDescIdType": 8,
                "lunDescription": "tape0" },
              { "number": 1, "productID": "LTO", "lunDescIdType": 8 } ] },
          { "remotePortWwn": "50:00:00:00:00:00:00:05",
            "deviceData": { "isTarget": true, "type": "Media Changer" },
            "lunList": [ { "number": 0, "vendor": "CHG", "productID": "X", "lunDescIdType": 1,
                           "lunDescription": "chg" } ] } ] },
      { "wwn": "10:00:00:00:c9:aa:00:02", "isMezz": true, "beaconState": false,
        "remotePorts": [
          { "remotePortWwn": "50:00:00:00:00:00:00:0A",
            "deviceData": { "isTarget": true, "type": "Disk" },
            "lunList": [
              { "number": 7, "vendor": "VSPR", "productID": "A_B", "lunDescIdType": 2,
                "lunDescription": "eui.7" },
              { "number": 7, "vendor": "VSPR", "productID": "A_B", "lunDescIdType": 3,
                "lunDescription": "same unit twice" } ] },
          { "remotePortWwn": "50:00:00:00:00:00:00:0a",
            "deviceData": { "isTarget": true, "type": "Disk" },
            "lunList": [ { "number": 8, "vendor": "VSPR", "productID": "A_B",
                           "lunDescIdType": 1, "lunDescription": "eui.8" } ] } ] } ] },
  { "hbaData": { "wwn": "20:00:00:00:c9:bb:00:00", "model": "VSPR-2", "serialNumber": "S2",
                 "unchecked": { "serialNumber": 5 } },
    "driver": { "storageDriverName": "vsprfc", "storageDriverVersion": "1" },
    "fcPorts": [ { "wwn": "10:00:00:00:c9:bb:00:01",
                   "sfp": { "serialNo": "OPT_2", "vendorName": "V" } } ] } ] })";

// The first instance of an enumeration whose path is path, or null.
const ch::Instance* byPath(const std::vector<ch::Instance>& all, const ch::Object_Path& path)
{
    for (const ch::Instance& i : all)
        if (ch::path_equal(i.path, path))
            return &i;
    return nullptr;
}

void expectSame(const ch::Instance& want, const ch::Instance& got, const std::string& what)
{
    ASSERT_EQ(want.properties.size(), got.properties.size()) << what;
    for (size_t i = 0; i < want.properties.size(); i++)
    {
        EXPECT_EQ(want.properties[i].name, got.properties[i].name) << what;
        const ch::Value& w = want.properties[i].value;
        const ch::Value& g = got.properties[i].value;
        // Counters have gone on since the enumeration.
        if (want.class_name == "VESPERA_FCPortStatistics" && w.type == CMPI_uint64 &&
            g.type == CMPI_uint64 && !w.null && !g.null)
        {
            EXPECT_GE(g.num.uint64, w.num.uint64) << what << " " << want.properties[i].name;
            continue;
        }
        EXPECT_TRUE(want.properties[i].value == got.properties[i].value)
            << what << " " << want.properties[i].name << ": "
            << want.properties[i].value.text() << " != " << got.properties[i].value.text();
    }
}

// Paths that name nothing, made from one that names an instance: each key
// in another case, with a character more, or emptied.
std::vector<ch::Object_Path> variants(const ch::Object_Path& path)
{
    std::vector<ch::Object_Path> out;
    for (size_t k = 0; k < path.keys.size(); k++)
    {
        const std::string& v = path.keys[k].value.str;
        std::string flipped = v;
        for (char& c : flipped)
            c = isupper((unsigned char)c) ? (char)tolower((unsigned char)c)
                                          : (char)toupper((unsigned char)c);
        for (const std::string& other : { flipped, v + "0", v.substr(0, v.size() / 2),
                 std::string() })
        {
            if (other == v)
                continue;
            ch::Object_Path p = path;
            p.keys[k].value = ch::Value::of_string(other);
            out.push_back(p);
        }
    }
    return out;
}

class Lookup : public ProvidersTest
{
protected:
    // For every class: each path of the enumeration, its variants and the
    // extra paths get what the enumeration answers.
    void compareAll(const std::string& host,
                    const std::vector<ch::Object_Path>& extra = {})
    {
        for (const char* cls : lookedUp)
        {
            std::vector<ch::Instance> all = served(cls);
            std::vector<ch::Object_Path> paths = extra;
            for (const ch::Instance& i : all)
            {
                paths.push_back(i.path);
                for (const ch::Object_Path& v : variants(i.path))
                    paths.push_back(v);
            }
            for (const ch::Object_Path& p : paths)
            {
                if (p.class_name != cls)
                    continue;
                const ch::Instance* want = byPath(all, p);
                ch::Result got = host_()->gi(p);
                std::string what = host + ": " + p.to_string();
                if (!want)
                {
                    EXPECT_EQ(CMPI_RC_ERR_NOT_FOUND, got.rc) << what;
                    continue;
                }
                ASSERT_EQ(CMPI_RC_OK, got.rc) << what << " " << got.message;
                ASSERT_EQ(1u, got.instances.size()) << what;
                expectSame(*want, got.instances[0], what);
            }
        }
    }

    static ch::Host* host_() { return host; }

    // Every path of the looked-up classes on the current host.
    std::vector<ch::Object_Path> allPaths()
    {
        std::vector<ch::Object_Path> out;
        for (const char* cls : lookedUp)
            for (const ch::Instance& i : served(cls))
                out.push_back(i.path);
        return out;
    }
};

} // namespace

TEST_F(Lookup, DefaultAndMezzanineHosts)
{
    compareAll("default");
    useHostFile(std::string(DTRUJ_HOSTS_DIR) + "/mezzanine.json");
    compareAll("mezzanine");
}

TEST_F(Lookup, GeneratedHost)
{
    std::string file = workDir() + "/generated.json";
    std::string cmd = "python3 '" + std::string(VSPR_SOURCE_DIR) + "/tools/gen_host.py'"
        " --adapters 3 --ports 2 --rports 4 --luns 3 -o '" + file + "'";
    ASSERT_EQ(0, system(cmd.c_str()));
    useHostFile(file);
    EXPECT_GT(served("VESPERA_TapeDrive").size(), 0u);
    compareAll("generated");
}

TEST_F(Lookup, HostWithOddReplies)
{
    useHost(parseJson(ODD_HOST));
    // The rules the host trips are in force: else the comparison proves less.
    EXPECT_EQ(6u, served("VESPERA_LogicalDisk").size());
    EXPECT_EQ(2u, served("VESPERA_TapeDrive").size());
    compareAll("odd");
}

TEST_F(Lookup, ElementsThatAreGoneOrFailing)
{
    // Paths of the default host, asked on hosts that lack what they name
    // and while the library fails at one entry or another.
    std::vector<ch::Object_Path> before = allPaths();
    ASSERT_GT(before.size(), 20u);

    Json::Value smaller = defaultHost();
    for (Json::Value& adapter : smaller["adapters"])
        for (Json::Value& port : adapter["fcPorts"])
        {
            port.removeMember("sfp");
            if (port["remotePorts"].size() > 1)
                port["remotePorts"].resize(1);
            for (Json::Value& remote : port["remotePorts"])
                if (remote["lunList"].size() > 1)
                    remote["lunList"].resize(1);
        }
    useHost(smaller);
    compareAll("smaller", before);

    const char* const faults[][2] = {
        { "getPortByWwn", R"({"kind": "error"})" },
        { "getAllRemotePorts", R"({"kind": "hba", "code": 7})" },
        { "getCompleteRemotePort", R"({"kind": "std", "message": "gone"})" },
        { "getDynamicPortStatistics", R"({"kind": "null"})" },
        { "getOpticsSFP", R"({"kind": "unknown"})" },
        { "getHbaByWwn", R"({"kind": "error"})" },
        { "getFcPhyPortIndicesByAdapter", R"({"kind": "error"})" },
    };
    for (const auto& f : faults)
    {
        useDefaultHost();
        ASSERT_EQ(0, dtruj_sim_set_fault(f[0], f[1])) << f[0];
        compareAll(std::string("fault in ") + f[0], before);
    }
}
