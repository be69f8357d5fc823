#include "ProviderDiscoveryMethods.h"

#include <algorithm>
#include <stdexcept>
#include <string.h>
#include <strings.h>

#include "CIMProviderTruj.h"
#include "CIM_ComputerSystem.h"
#include "JsonParams.h"
#include "JsonRpcManager.h"
#include "MethodCatalogue.h"
#include "cimom.h"
#include "log.h"

namespace OLMA
{

using namespace JsonParams;

namespace
{

// The global information is the library's own reply and may say anything:
// its counts never make a walk go beyond the elements that are there, so
// that a wrong count can't turn into millions of library calls.
const Json::ArrayIndex MAX_WALK = 4096;

Json::ArrayIndex countOf(const Json::Value& v)
{
    if (v.isUInt())
        return v.asUInt() < MAX_WALK ? v.asUInt() : MAX_WALK;
    if (v.isDouble() && v.asDouble() >= 1.0)
        return v.asDouble() < MAX_WALK ? Json::ArrayIndex(v.asDouble()) : MAX_WALK;
    return 0;
}

Json::ArrayIndex listed(const Json::Value& v)
{
    return v.isArray() ? v.size() : 0;
}

const Json::Value& element(const Json::Value& array, Json::ArrayIndex i)
{
    static const Json::Value none;
    return array.isArray() && i < array.size() ? array[i] : none;
}

// An address in the global information, compared without regard to case.
// An empty text names nothing, so an adapter without a MAC is never the
// one that an empty key asks for.
bool sameAddress(const std::string& key, const Json::Value& v)
{
    return v.isString() && !key.empty() && strcasecmp(key.c_str(), v.asCString()) == 0;
}

// The alias entries: "Node" and "CNA" name an adapter, anything else a port.
Json::Value callAliasEntry(const Json::Value& alias)
{
    checkObject(alias);
    std::string type = readString(member(alias, "type"));
    if (type == "Node" || type == "CNA")
        return libSetAdapterAlias(alias);
    return libSetPortAlias(alias);
}

// The port-pair tests: one posted test per pair, all on one request.
void postPairs(const char* function, const char* handler, const Json::Value& params,
    Json::Value& result)
{
    TLOG(LL_DBG, "Entering ProviderDiscoveryMethods::%s", handler);
    checkCount(params, 4, handler);

    Json::Value request;
    request["function"] = function;
    request["requestID"] = readString(at(params, 0));
    request["hbaWwn"] = readString(at(params, 1));
    // Before the pairs are looked at, so a bad count of cycles is told first.
    request["numCycles"] = readInt(at(params, 3));

    const Json::Value& pairs = checkArray(at(params, 2));
    for (Json::ArrayIndex i = 0; i < pairs.size(); i++)
    {
        const Json::Value& pair = checkObject(pairs[i]);
        int vf = readInt(member(pair, "vfID"));
        request["vfID"] = vf >= 0 ? vf : 0;
        request["portWwn"] = readString(member(pair, "portWwn"));
        request["localPortWwn"] = readString(member(pair, "localPortWwn"));
        request["remotePortWwn"] = readString(member(pair, "remotePortWwn"));
        // Each reply replaces the one before: the last pair's is the result.
        result = libPostDiagnostics(request);
    }
    TLOG(LL_DBG, "Returning ProviderDiscoveryMethods::%s", handler);
}

// A WWN or a MAC in one parameter: 17 characters is a MAC in colon form.
void byAddress(const char* handler, JsonReqFP* entry, const Json::Value& params,
    Json::Value& result)
{
    TLOG(LL_DBG, "Entering ProviderDiscoveryMethods::%s", handler);
    checkCount(params, 1, handler);
    std::string address = readString(at(params, 0));
    Json::Value request;
    request[address.size() == 17 ? "mac" : "wwn"] = address;
    result = (*entry)(request);
    TLOG(LL_DBG, "Returning ProviderDiscoveryMethods::%s", handler);
}

} // namespace

void ProviderDiscoveryMethods::registerMethods(JsonRpcManager&)
{
    TLOG(LL_DBG, "Entering: %s", "registerMethods");
    for (size_t i = 0; i < catalogueSize(); i++)
        JsonRpcManager::registerMethod(catalogueRow(i).method, catalogueHandler(i));
    TLOG(LL_DBG, "Returning: %s", "registerMethods");
}

void ProviderDiscoveryMethods::serve(const MethodRow& row, const Json::Value& params,
    Json::Value& result)
{
    const char* trace = row.trace ? row.trace : row.handler;
    TLOG(LL_DBG, "Entering ProviderDiscoveryMethods::%s", trace);

    Json::Value reply;
    if (row.form == FORM_PASS)
    {
        reply = (*row.entry)(params);
    }
    else
    {
        checkCount(params, row.count(), row.handler);

        Json::Value request;
        if (row.function)
            request["function"] = row.function;
        for (unsigned i = 0; i < MAX_PARAMS && row.params[i].type != P_END; i++)
        {
            const ParamDef& p = row.params[i];
            const Json::Value& v = at(params, i);
            switch (p.type)
            {
                case P_STRING:
                    request[p.member] = readString(v);
                    break;
                case P_INT:
                    request[p.member] = readInt(v);
                    break;
                case P_BOOL:
                    request[p.member] = readBool(v);
                    break;
                case P_ARRAY:
                    request[p.member] = checkArray(v);
                    break;
                case P_OBJECT:
                    request[p.member] = checkObject(v);
                    break;
                default:
                    break;
            }
        }
        if (row.vf == VF_ID)
            request["vfId"] = 0;
        else if (row.vf == VF_ID_UPPER)
            request["vfID"] = 0;

        reply = (*row.entry)(request);
    }

    // A wrapped reply stays an element, "error" and all.
    if (row.form == FORM_WRAP)
        result.append(reply);
    else
        result.swap(reply);

    TLOG(LL_DBG, "Returning ProviderDiscoveryMethods::%s", trace);
}

void ProviderDiscoveryMethods::getHbaByWwn(const Json::Value& params, Json::Value& result)
{
    byAddress("getHbaByWwn", &libGetHbaByWwn, params, result);
}

void ProviderDiscoveryMethods::getPortByWwn(const Json::Value& params, Json::Value& result)
{
    byAddress("getPortByWwn", &libGetPortByWwn, params, result);
}

void ProviderDiscoveryMethods::getAllHbasByHost(const Json::Value& params, Json::Value& result)
{
    TLOG(LL_DBG, "Entering ProviderDiscoveryMethods::getAllHbasByHost");

    Json::Value info = libGetGlobalInfo(params);
    const Json::Value& adapters = member(info, "adapter");
    Json::ArrayIndex count = countOf(member(info, "numOfAdapters"));
    TLOG(LL_DBG, "numOfAdapters=%d", (int)count);
    count = std::min(count, listed(adapters));

    for (Json::ArrayIndex i = 0; i < count; i++)
    {
        const Json::Value& adapter = adapters[i];
        Json::Value request;
        Json::Value reply;

        // A CNA is named by its MAC even when it also has FC ports.
        if (readBool(member(adapter, "cna")))
        {
            request["mac"] = member(adapter, "mac");
            reply = libGetHbaByMac(request);
        }
        else if (readBool(member(adapter, "fc")) || readBool(member(adapter, "fcoe")))
        {
            request["wwn"] = member(adapter, "wwn");
            reply = libGetHbaByWwn(request);
        }
        else if (readBool(member(adapter, "ethPort")))
        {
            request["mac"] = member(adapter, "mac");
            reply = libGetHbaByMac(request);
        }
        else
        {
            request["wwn"] = member(adapter, "wwn");
            reply = libGetHbaByWwn(request);
        }
        result.append(reply);
    }

    TLOG(LL_DBG, "Returning ProviderDiscoveryMethods::getAllHbasByHost");
}

void ProviderDiscoveryMethods::getAllPortsByHba(const Json::Value& params, Json::Value& result)
{
    TLOG(LL_DBG, "Entering ProviderDiscoveryMethods::getAllPortsByHba");
    checkCount(params, 1, "getAllPortsByHba");
    std::string key = readString(at(params, 0));

    Json::Value info = libGetGlobalInfo(params);
    const Json::Value& adapters = member(info, "adapter");
    Json::ArrayIndex count = std::min(countOf(member(info, "numOfAdapters")), listed(adapters));

    const Json::Value* adapter = 0;
    for (Json::ArrayIndex i = 0; i < count && !adapter; i++)
        if (sameAddress(key, member(adapters[i], "mac")) ||
            sameAddress(key, member(adapters[i], "wwn")))
            adapter = &adapters[i];
    if (!adapter)
        return;

    const Json::Value& hasFc = member(*adapter, "portHasFc");
    const Json::Value& hasEth = member(*adapter, "portHasEth");
    const Json::Value& hasFcoe = member(*adapter, "portHasFcoe");
    const Json::Value& portWwn = member(*adapter, "portWwn");
    const Json::Value& portMac = member(*adapter, "portMac");
    const Json::Value& fcoeMac = member(*adapter, "fcoeMac");

    // No further than the per-port arrays go.
    Json::ArrayIndex ports = countOf(member(*adapter, "numOfPorts"));
    Json::ArrayIndex lists = 0;
    for (const Json::Value* list : {&hasFc, &hasEth, &hasFcoe, &portWwn, &portMac, &fcoeMac})
        lists = std::max(lists, listed(*list));
    ports = std::min(ports, lists);

    Json::ArrayIndex failures = 0;
    for (Json::ArrayIndex i = 0; i < ports; i++)
    {
        Json::Value request;
        if (readBool(element(hasFc, i)))
            request["wwn"] = element(portWwn, i);
        else if (readBool(element(hasEth, i)))
            request["mac"] = element(portMac, i);
        else if (readBool(element(hasFcoe, i)))
            request["mac"] = element(fcoeMac, i);

        // A port that fails leaves no gap: the others move up.
        try
        {
            result.append(libGetPortByWwn(request));
        }
        catch (const HbaAgentError&)
        {
            failures++;
        }
    }

    if (failures == ports)
        throw std::runtime_error("Unable to find any Port attributes");

    TLOG(LL_DBG, "Returning ProviderDiscoveryMethods::getAllPortsByHba");
}

void ProviderDiscoveryMethods::getRequestID(const Json::Value&, Json::Value& result)
{
    TLOG(LL_DBG, "Entering ProviderDiscoveryMethods::getRequestID");
    result = libGetRequestID();
    TLOG(LL_DBG, "Returning ProviderDiscoveryMethods::getRequestID");
}

void ProviderDiscoveryMethods::resetStatisticsForPorts(const Json::Value& params,
    Json::Value& result)
{
    checkCount(params, 1, "resetStatisticsForPorts");
    const Json::Value& ports = checkArray(at(params, 0));

    Json::ArrayIndex failures = 0;
    Json::Value request;
    for (Json::ArrayIndex i = 0; i < ports.size(); i++)
    {
        // Unreadable is the caller's mistake and ends the call; a port the
        // library can't reset is skipped.
        request["indexStr"] = readString(ports[i]);
        try
        {
            result.append(libResetStatisticsForPort(request));
        }
        catch (const HbaAgentError&)
        {
            failures++;
        }
    }

    if (failures == ports.size())
        throw std::runtime_error("Couldnt reset any of the port statistics");
}

void ProviderDiscoveryMethods::setAlias(const Json::Value& params, Json::Value& result)
{
    checkCount(params, 1, "setAlias");
    result = callAliasEntry(at(params, 0));
}

void ProviderDiscoveryMethods::setAliases(const Json::Value& params, Json::Value& result)
{
    checkCount(params, 1, "setAliases");
    const Json::Value& aliases = checkArray(at(params, 0));
    // No roll-back: a failure leaves the aliases before it set.
    for (Json::ArrayIndex i = 0; i < aliases.size(); i++)
        result.append(callAliasEntry(aliases[i]));
}

void ProviderDiscoveryMethods::setAdvancedIoProfile(const Json::Value& params,
    Json::Value& result)
{
    checkCount(params, 2, "setAdvancedIoProfile");
    Json::Value request;
    request["indexStr"] = readString(at(params, 0));

    const Json::Value& profile = checkObject(at(params, 1));
    const char* const lists[] = {"addedAdvancedIoProfiles", "removedAdvancedIoProfiles"};
    bool any = false;
    for (const char* list : lists)
        any = any || profile.isMember(list);
    // A profile call without either list has nothing to do.
    if (!any)
        throw ErrorBadJsonObject();
    for (const char* list : lists)
        if (profile.isMember(list))
            request[list] = checkArray(profile[list]);

    result = libSetAdvIoProfile(request);
}

void ProviderDiscoveryMethods::setLunMaskDataForPort(const Json::Value& params,
    Json::Value& result)
{
    checkCount(params, 2, "setLunMaskDataForPort");
    Json::Value request;
    request["indexStr"] = readString(at(params, 0));

    const Json::Value& mask = checkObject(at(params, 1));
    const Json::Value& removed = checkArray(member(mask, "removedLunMaskData"));
    const Json::Value& added = checkArray(member(mask, "addedLunMaskData"));
    request["removedLunMaskData"] = removed;
    request["addedLunMaskData"] = added;
    request["clearLunMaskData"] = readBool(member(mask, "clearLunMaskData"));

    result = libSetLunMaskData(request);
}

void ProviderDiscoveryMethods::doEchoTest(const Json::Value& params, Json::Value& result)
{
    postPairs("EchoTest", "doEchoTest", params, result);
}

void ProviderDiscoveryMethods::doFCPingTest(const Json::Value& params, Json::Value& result)
{
    postPairs("FCPingTest", "doFCPingTest", params, result);
}

void ProviderDiscoveryMethods::doFCTraceRoute(const Json::Value& params, Json::Value& result)
{
    postPairs("FCTraceTest", "doFCTraceRoute", params, result);
}

Array<String> ProviderDiscoveryMethods::getOtherIdentifyingInfo()
{
    TLOG(LL_DBG, "Entering: %s", "getOtherIdentifyingInfo");
    Array<String> info;
    CIM_ComputerSystem* model = create<CIM_ComputerSystem>(true);
    {
        Instance_Enumerator e;
        if (cimom::enum_instances("vmware/esxv2", model, e) == 0)
        {
            TLOG(LL_DBG, "ComputerSystem Instance in vmware/esx2 ");
            for (; e; e++)
            {
                Ref<Instance> instance = e();
                const CIM_ComputerSystem* cs = checked_cast<CIM_ComputerSystem>(instance.ptr());
                if (!cs || cs->CreationClassName.null)
                    continue;
                TLOG(LL_DBG, "Creation class name - %s", cs->CreationClassName.value.c_str());
                if (strcmp(cs->CreationClassName.value.c_str(), "VMWARE_ESXComputerSystem") != 0)
                    continue;
                // Positions 1 and 2 hold what identifies the hypervisor's host.
                const Property<Array<String> >& other = cs->OtherIdentifyingInfo;
                for (size_t i = 1; i <= 2 && !other.null && i < other.value.size(); i++)
                    info.append(other.value[i]);
                break;
            }
        }
    }
    destroy(model);
    return info;
}

} // namespace OLMA
