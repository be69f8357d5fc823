// A host description is a user's file: whatever it holds, the simulated
// library loads it or refuses it with a message, and the entries answer
// from what it loaded, whatever the types of its members, without crashing.

#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>

#include <json/json.h>

#include "dtruj.h"

extern "C" {
int dtruj_sim_reset(void);
Json::Value init_hba_lib(const Json::Value&);
Json::Value getAllAdaptersIndexString(const Json::Value&);
Json::Value getGlobalInfo(const Json::Value&);
Json::Value getHbaByWwn(const Json::Value&);
Json::Value getFcPhyPortIndicesByAdapter(const Json::Value&);
Json::Value getEthPhyPortIndicesByAdapter(const Json::Value&);
Json::Value getPortByWwn(const Json::Value&);
Json::Value getEthPortByEthMac(const Json::Value&);
Json::Value getAllRemotePorts(const Json::Value&);
Json::Value getCompleteRemotePort(const Json::Value&);
Json::Value getOpticsSFP(const Json::Value&);
Json::Value getAllVPorts(const Json::Value&);
}

namespace
{

std::string hostFile()
{
    static std::string path = [] {
        char name[] = "/tmp/fuzz-host-XXXXXX";
        int fd = mkstemp(name);
        if (fd >= 0)
            close(fd);
        setenv("DTRUJ_HOST", name, 1);
        return std::string(name);
    }();
    return path;
}

Json::Value request(const char* member, const Json::Value& value)
{
    Json::Value r(Json::objectValue);
    r[member] = value;
    return r;
}

// Every port of an adapter, and what lies below each.
void walkPorts(const Json::Value& index)
{
    Json::Value fc = getFcPhyPortIndicesByAdapter(request("indexStr", index));
    if (fc.isObject())
        for (const Json::Value& p : fc["indexStrings"])
        {
            Json::Value wwn = request("wwn", p);
            getPortByWwn(wwn);
            getOpticsSFP(request("indexStr", p));
            getAllVPorts(wwn);
            Json::Value remote = getAllRemotePorts(request("pPortWwn", p));
            if (remote.isArray())
                for (const Json::Value& rp : remote)
                {
                    Json::Value q = request("pPortWwn", p);
                    if (rp.isObject())
                        q["rPortWwn"] = rp["remotePortWwn"];
                    getCompleteRemotePort(q);
                }
        }
    Json::Value eth = getEthPhyPortIndicesByAdapter(request("indexStr", index));
    if (eth.isObject())
        for (const Json::Value& p : eth["indexStrings"])
            getEthPortByEthMac(request("mac", p));
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const std::string& path = hostFile();
    FILE* f = fopen(path.c_str(), "wb");
    if (!f)
        abort();
    fwrite(data, 1, size, f);
    fclose(f);

    if (dtruj_sim_reset() != 0)
        return 0;   // refused, with its message
    if (init_hba_lib(request("appId", 2))["result"] != 0)
        return 0;
    getGlobalInfo(Json::Value());
    Json::Value all = getAllAdaptersIndexString(Json::Value());
    if (!all.isObject())
        abort();
    // The walk is bounded: a generated description may name thousands.
    Json::ArrayIndex n = 0;
    for (const Json::Value& index : all["indexStrings"])
    {
        if (n++ == 8)
            break;
        getHbaByWwn(request(index.asString().size() == 17 ? "mac" : "wwn", index));
        walkPorts(index);
    }
    return 0;
}
