#include "Harden.h"

#include <stdlib.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <thread>

#include "FastClock.h"

namespace harden
{

namespace
{

const char* const NS = "root/vespera";

// The quick host's addresses.
const char* const FC_HBA = "20:00:00:05:1e:8a:10:00";
const char* const FC_PORT0 = "10:00:00:05:1e:8a:10:01";
const char* const FC_PORT1 = "10:00:00:05:1e:8a:10:02";
const char* const CNA = "00:05:1e:8b:20:00";
const char* const FCOE_PORT = "10:00:00:05:1e:8b:20:01";
const char* const ETH_PORT = "00:05:1e:8b:20:02";
const char* const DISK_RPORT = "50:06:01:60:3b:20:1a:01";
const char* const VPORT = "2f:00:00:05:1e:8a:10:01";

std::string readFile(const std::string& path)
{
    std::stringstream text;
    text << std::ifstream(path.c_str(), std::ios::binary).rdbuf();
    return text.str();
}

void writeFile(const std::string& path, const std::string& text)
{
    std::ofstream(path.c_str(), std::ios::binary | std::ios::trunc) << text;
}

Json::Value parse(const std::string& text)
{
    Json::Value v;
    Json::Reader().parse(text, v);
    return v;
}

struct Dir
{
    std::string path;
    Dir()
    {
        char name[] = "/tmp/vspr-harden-XXXXXX";
        path = mkdtemp(name) ? name : "/tmp";
    }
    ~Dir()
    {
        if (getenv("HARDEN_KEEP"))
        {
            fprintf(stderr, "harden: the work directory stays: %s\n", path.c_str());
            return;
        }
        std::error_code ec;
        std::filesystem::remove_all(path, ec);
    }
};

Dir& dir()
{
    static Dir d;
    return d;
}

// The default host, its waits short: tests, flashes and posted tests take
// milliseconds, and the module's own pauses (a select() without
// descriptors, see FastClock.h) run fifty times faster.
std::string writeQuickHost()
{
    Json::Value h = parse(readFile(std::string(DTRUJ_HOSTS_DIR) + "/default.json"));
    Json::Value& d = h["diagnostics"];
    for (const char* t : {"loopback", "ethLoopback", "pciLoopback", "memory", "dport"})
        d[t]["durationMs"] = 5;
    for (const std::string& p : d["posted"].getMemberNames())
        d["posted"][p]["durationMs"] = 5;
    for (Json::Value& a : h["adapters"])
        a["flash"]["durationMs"] = 5;
    // A fault that must hold from the library's start, before a caller could
    // set it (the host description is read at init_hba_lib).
    const char* entry = getenv("HARDEN_FAULT_ENTRY");
    const char* kind = getenv("HARDEN_FAULT_KIND");
    if (entry && kind)
    {
        Json::Value fault = kind[0] == '{' ? parse(kind) : Json::Value(kind);
        if (fault.isString() && fault.asString().compare(0, 6, "delay:") == 0)
            fault = parse("{\"kind\":\"delay\",\"delayMs\":" + fault.asString().substr(6) + "}");
        h["faults"][entry] = fault;
    }
    std::string path = dir().path + "/quick-host.json";
    writeFile(path, Json::StyledWriter().write(h));
    // The image of the first adapter's own version: an update changes
    // nothing a request running beside it could see, such as the key of
    // its product.
    writeFile(dir().path + "/image.bin",
              "version=" + h["adapters"][0]["firmware"]["version"].asString() +
                  "\nfirmware image\n");
    return path;
}

ch::Object_Path classPath(const std::string& cls)
{
    ch::Object_Path p;
    p.name_space = NS;
    p.class_name = cls;
    return p;
}

struct Registered
{
    std::string name;
    bool instance = false;
    bool association = false;
    bool indication = false;
    bool served = false;   // in root/vespera
};

// The classes of the registration file, in its order.
std::vector<Registered> registeredClasses()
{
    std::vector<Registered> out;
    std::istringstream in(readFile(VSPR_REG_FILE));
    std::string line;
    while (std::getline(in, line))
    {
        size_t b = line.find_first_not_of(" \t");
        if (b == std::string::npos || line[b] == '#')
            continue;
        if (line[b] == '[')
        {
            Registered r;
            r.name = line.substr(b + 1, line.find(']') - b - 1);
            out.push_back(r);
            continue;
        }
        if (out.empty())
            continue;
        std::string value = line.substr(line.find(':') + 1);
        if (line.compare(b, 5, "type:") == 0)
        {
            out.back().instance = value.find("instance") != std::string::npos;
            out.back().association = value.find("association") != std::string::npos;
            out.back().indication = value.find("indication") != std::string::npos;
        }
        else if (line.compare(b, 10, "namespace:") == 0)
            out.back().served = (" " + value + " ").find(std::string(" ") + NS + " ") !=
                                std::string::npos;
    }
    return out;
}

Op named(OpKind kind, const std::string& word, const ch::Object_Path& path)
{
    Op op;
    op.kind = kind;
    op.path = path;
    op.name = word + " " + path.class_name;
    return op;
}

std::string refText(const ch::Object_Path& p)
{
    std::string t = p.class_name;
    for (size_t i = 0; i < p.keys.size(); i++)
    {
        const ch::Value& v = p.keys[i].value;
        if (p.keys[i].name == "DeviceID" || p.keys[i].name == "InstanceID" ||
            p.keys[i].name == "Name" || p.keys[i].name == "Tag")
            t += "." + p.keys[i].name + "=" + (v.type == CMPI_ref ? "..." : v.text());
    }
    return t;
}

ch::Value uint16s(std::initializer_list<uint64_t> values)
{
    ch::Value v;
    v.type = CMPI_uint16A;
    v.null = false;
    for (uint64_t x : values)
        v.elements.push_back(ch::Value::of_uint(CMPI_uint16, x));
    return v;
}

const ch::Value* keyOf(const ch::Object_Path& p, const char* name)
{
    return p.key(name);
}

} // namespace

const std::string& workDir()
{
    return dir().path;
}

ch::Host& host(const char* logLevel, size_t releasedKept)
{
    static ch::Host* h = nullptr;
    if (!h)
    {
        setenv("HOME", dir().path.c_str(), 1);
        if (const char* level = getenv("HARDEN_LOG"))
            logLevel = level;
        writeFile(dir().path + "/.tesselrc", std::string("LOG_LEVEL=") + logLevel + "\n");
        setenv("DTRUJ_HOST", writeQuickHost().c_str(), 1);
        fast_clock::setDivisor(50);
        // Never freed: the module's threads may outlive main()'s locals.
        ch::Options options;
        options.released_kept = releasedKept;
        h = new ch::Host(options);
        if (!h->ok())
        {
            fprintf(stderr, "harden: the stand-in can't load the module: %s\n",
                    h->error().c_str());
            exit(2);
        }
    }
    return *h;
}

void resetSimulator()
{
    dtruj_sim_reset();
}

std::vector<std::string> calledEntries(bool* full)
{
    char* text = dtruj_sim_calls();
    Json::Value calls = parse(text ? text : "[]");
    free(text);
    if (full)
        *full = calls.size() >= 4096;
    std::vector<std::string> out;
    std::set<std::string> seen;
    for (const Json::Value& c : calls)
        if (seen.insert(c["entry"].asString()).second)
            out.push_back(c["entry"].asString());
    return out;
}

const std::vector<std::string>& consoleRequests()
{
    // [method, params]; every address is one of the quick host.
    static const char* const rows[][2] = {
        {"discovery.getHost", "[]"},
        {"discovery.getGlobalInfo", "[]"},
        {"discovery.getHbaByWwn", "[\"$HBA\"]"},
        {"discovery.getAllHbasByHost", "[]"},
        {"discovery.getAllPortsByHba", "[\"$CNA\"]"},
        {"discovery.getPortByWwn", "[\"$P0\"]"},
        {"discovery.getFcByFcWwn", "[\"$P0\"]"},
        {"discovery.getAllFcByPort", "[\"$P0\"]"},
        {"discovery.getPortAuthentication", "[\"$P0\"]"},
        {"discovery.getAllRemotePorts", "[\"$P0\",\"\"]"},
        {"discovery.getCompleteRemotePort", "[\"$P0\",\"\",\"$RP\"]"},
        {"discovery.getAllLunsByRemotePort", "[\"$P0\",\"\",\"$RP\"]"},
        {"discovery.getAllVPorts", "[\"$P0\"]"},
        {"discovery.getVPort", "[\"$P0\",\"$VP\"]"},
        {"discovery.getServerTime", "[]"},
        {"discovery.getBootOverSanByPort", "[\"$P0\"]"},
        {"discovery.getAdvPortDataByPort", "[\"$P0\"]"},
        {"discovery.getFcoeByPort", "[\"$FCOE\"]"},
        {"discovery.getFcoeByFcoeWwn", "[\"$FCOE\"]"},
        {"discovery.getAllFcoeByPort", "[\"$FCOE\"]"},
        {"discovery.getCompleteEthByPort", "[\"$ETH\"]"},
        {"discovery.getCompleteEthByEthMac", "[\"$ETH\"]"},
        {"discovery.getAllEthByPort", "[\"$ETH\"]"},
        {"discovery.getLldp", "[\"$ETH\"]"},
        {"discovery.getCee", "[\"$ETH\"]"},
        {"discovery.getDriverUpdateStatusLog", "[]"},
        {"discovery.getLunMaskDataByPort", "[\"$P0\"]"},
        {"discovery.getAdvAdapterData", "[\"$HBA\"]"},
        {"discovery.getAllPCIFunctions", "[\"$CNA\"]"},
        {"discovery.getAdvancedIoProfile", "[\"$P0\"]"},
        {"discovery.getPortStatistics", "[\"$P0\"]"},
        {"discovery.getDynamicQosStatistics", "[\"$P0\"]"},
        {"discovery.getDynamicPortStatistics", "[\"$P0\"]"},
        {"discovery.getDynamicRemotePortStatistics", "[\"$P0\",\"\",\"$RP\"]"},
        {"discovery.getDynamicVportStatistics", "[\"$P0\",\"$VP\"]"},
        {"discovery.getDynamicLogicalPortStatistics", "[\"$P0\",\"\"]"},
        {"discovery.getDynamicFcpimIOPStatistics", "[\"$P0\",\"\",\"$RP\"]"},
        {"discovery.getDynamicFcpimStatistics", "[\"$P0\",\"\",\"$RP\"]"},
        {"discovery.getDynamicFabricStatistics", "[\"$P0\"]"},
        {"discovery.getDynamicPortAuthenticationStatistics", "[\"$P0\"]"},
        {"discovery.getDynamicIocStatistics", "[\"$P0\"]"},
        {"discovery.getDynamicFcoeStatistics", "[\"$FCOE\"]"},
        {"discovery.getDynamicFcpimModStatistics", "[\"$P0\"]"},
        {"discovery.getDynamicFirmwareStatistics", "[\"$HBA\"]"},
        {"discovery.getDynamicTrunkingStatistics", "[\"$P0\"]"},
        {"discovery.getDynamicEthernetPortStatistics", "[\"$ETH\"]"},
        {"discovery.getDynamicIOCEthernetStatistics", "[\"$ETH\"]"},
        {"discovery.getDynamicvHBAStatistics", "[\"$FCOE\"]"},
        {"discovery.getDynamicvNICStatistics", "[\"$ETH\"]"},
        {"discovery.getDynamicvNICStatisticsForGraph", "[\"$ETH\"]"},
        {"discovery.getDynamicLldpStatistics", "[\"$ETH\"]"},
        {"discovery.getDynamicAdvancedIoDataAtPPort", "[\"$P0\"]"},
        {"discovery.getDynamicAdvancedIoDataAtLPort", "[\"$P0\",\"\"]"},
        {"discovery.getDynamicAdvancedIoDataAtRPort", "[\"$P0\",\"\",\"$RP\"]"},
        {"discovery.getDynamicAdvancedIoDataAtLun", "[\"$P0\",\"\",\"$RP\",\"0\"]"},
        {"configuration.createVPort", "[\"$P0\",\"\",\"\",\"sweep\"]"},
        {"configuration.deleteVPort", "[\"$P0\",[\"$VP\"]]"},
        {"configuration.setAlias", "[{\"type\":\"Port\",\"wwn\":\"$P0\",\"alias\":\"a\"}]"},
        {"configuration.setAliases", "[[{\"type\":\"Node\",\"wwn\":\"$HBA\",\"alias\":\"n\"},"
                                     "{\"type\":\"Port\",\"wwn\":\"$P1\",\"alias\":\"p\"}]]"},
        {"configuration.setPortByWwn", "[\"$P1\",{\"portStatus\":false},[\"portStatus\"]]"},
        {"configuration.setPortAuthentication", "[\"$P0\",{\"authEnabled\":true}]"},
        {"configuration.setFcByFcWwn", "[\"$P0\",{\"bbCredit\":8},[\"bbCredit\"]]"},
        {"configuration.setHbaStatus", "[\"$HBA\",false]"},
        {"configuration.setFCTrunkingState", "[\"$P0\",true]"},
        {"configuration.setFcoeByFcoeWwn", "[\"$FCOE\",{\"bbCredit\":8},[\"bbCredit\"]]"},
        {"configuration.setFcoePort", "[\"$FCOE\",{\"vlanId\":1003},[\"vlanId\"]]"},
        {"configuration.setEthPort", "[\"$ETH\",{\"mtu\":4000},[\"mtu\"]]"},
        {"configuration.clearLogsForPort", "[[\"$P0\"]]"},
        {"configuration.setAdapterMode", "[\"$CNA\",\"NIC\"]"},
        {"configuration.setLunMaskDataForPort",
         "[\"$P0\",{\"addedLunMaskData\":[{\"rPortWwn\":\"$RP\",\"lunId\":\"0\"}]}]"},
        {"configuration.setAdvancedIoProfile",
         "[\"$P0\",{\"addedAdvancedIoProfiles\":[{\"lPortWwn\":\"$P0\",\"rPortWwn\":\"$RP\","
         "\"lunId\":\"1\",\"profile\":\"latency\"}]}]"},
        {"configuration.clearAdvancedIoProfilesAtPort", "[\"$P0\"]"},
        {"configuration.clearAdvancedIoProfilesAtLogicalPort", "[\"$P0\",\"\"]"},
        {"configuration.clearAdvancedIoProfilesAtRemotePort", "[\"$P0\",\"\",\"$RP\"]"},
        {"configuration.clearAdvancedIoProfileOfLun", "[\"$P0\",\"\",\"$RP\",\"0\"]"},
        {"configuration.resetDataForAdvancedIoAtPPort", "[\"$P0\"]"},
        {"configuration.resetDataForAdvancedIoAtLPort", "[\"$P0\",\"\"]"},
        {"configuration.resetDataForAdvancedIoAtRPort", "[\"$P0\",\"\",\"$RP\"]"},
        {"configuration.resetDataForAdvancedIoAtLun", "[\"$P0\",\"\",\"$RP\",\"0\"]"},
        {"configuration.resetDataForAdvancedIoForLunRange", "[\"$P0\",\"\",\"$RP\",\"0\",\"2\"]"},
        {"configuration.createVnic", "[\"$ETH\",10,50]"},
        {"configuration.deleteVnics", "[\"$ETH\",[1]]"},
        {"configuration.modifyVnic",
         "[\"$ETH\",[{\"pciFunctionIndex\":0,\"minBandwidth\":0,\"maxBandwidth\":90}]]"},
        {"configuration.resetPortAuthentication", "[\"$P0\"]"},
        {"configuration.resetStatisticsForPortAuthentication", "[\"$P0\"]"},
        {"configuration.resetStatisticsForPorts", "[[\"$P0\",\"$P1\"]]"},
        {"configuration.resetStatisticsForPort", "[\"$P0\"]"},
        {"configuration.resetStatisticsForLPort", "[\"$P0\",\"\"]"},
        {"configuration.resetStatisticsForVPort", "[\"$P0\",\"$VP\"]"},
        {"configuration.resetStatisticsForRPort", "[\"$P0\",\"\",\"$RP\"]"},
        {"configuration.resetStatisticsForFcpim", "[\"$P0\",\"\",\"$RP\"]"},
        {"configuration.resetStatisticsForIoc", "[\"$P0\"]"},
        {"configuration.resetStatisticsForFabric", "[\"$P0\"]"},
        {"configuration.resetStatisticsForQos", "[\"$P0\"]"},
        {"configuration.resetFirmwareStatistics", "[\"$HBA\"]"},
        {"configuration.resetTrunkingStatistics", "[\"$P0\"]"},
        {"configuration.resetLldpStatistics", "[\"$ETH\"]"},
        {"configuration.resetIOCEthernetStatistics", "[\"$ETH\"]"},
        {"configuration.resetEthernetPortStatistics", "[\"$ETH\"]"},
        {"configuration.resetvNICStatistics", "[\"$ETH\"]"},
        {"configuration.resetFcoeStatistics", "[\"$FCOE\"]"},
        {"configuration.resetvHBAStatistics", "[\"$FCOE\"]"},
        {"configuration.resetStatisticsForFcpimMod", "[\"$P0\"]"},
        {"diagnostics.startTests", "[\"1\",true]"},
        {"diagnostics.cancelTests", "[\"1\"]"},
        {"diagnostics.doQuickTest", "[\"1\",\"$HBA\"]"},
        {"diagnostics.doPOSTest", "[\"1\",\"$P0\",true]"},
        {"diagnostics.doEchoTest",
         "[\"1\",\"$HBA\",[{\"portWwn\":\"$P0\",\"localPortWwn\":\"$P0\",\"remotePortWwn\":\"$RP\"}],2]"},
        {"diagnostics.doMemoryTest", "[\"1\",\"$HBA\"]"},
        {"diagnostics.doPCILoopbackTest", "[\"1\",\"$HBA\",\"$P0\",\"256\",\"a5a5a5a5\",1]"},
        {"diagnostics.doLoopbackTest", "[\"1\",null,\"$P1\",0,0,1,\"256\",\"a5a5a5a5\"]"},
        {"diagnostics.doLEDTest", "[\"1\",\"$HBA\",\"$P0\",1,1,1,1]"},
        {"diagnostics.doFCPingTest",
         "[\"1\",\"$HBA\",[{\"portWwn\":\"$P0\",\"localPortWwn\":\"$P0\",\"remotePortWwn\":\"$RP\"}],1]"},
        {"diagnostics.doFCTraceRoute",
         "[\"1\",\"$HBA\",[{\"portWwn\":\"$P0\",\"localPortWwn\":\"$P0\",\"remotePortWwn\":\"$RP\"}],1]"},
        {"diagnostics.doEthLoopbackTest", "[\"1\",null,\"$ETH\",0,0,1,\"256\",\"a5a5a5a5\"]"},
        {"diagnostics.doQueueTest", "[\"1\",\"$HBA\",\"$P0\"]"},
        {"diagnostics.getOpticsPOM", "[\"$P0\"]"},
        {"diagnostics.getOpticsSFP", "[\"$P0\"]"},
        {"diagnostics.getRequestID", "[]"},
        {"diagnostics.getDiagnosticsResults", "[\"1\"]"},
        {"diagnostics.dPortEnable", "[\"1\",\"$P0\",true]"},
        {"diagnostics.doDportTest", "[\"1\",\"$HBA\",\"$P0\",\"256\",\"a5a5a5a5\",1]"},
        {"diagnostics.getDPortTestResults", "[\"$P0\"]"},
    };
    static const std::pair<const char*, const char*> names[] = {
        {"$HBA", FC_HBA}, {"$P0", FC_PORT0}, {"$P1", FC_PORT1}, {"$CNA", CNA},
        {"$FCOE", FCOE_PORT}, {"$ETH", ETH_PORT}, {"$RP", DISK_RPORT}, {"$VP", VPORT},
    };
    static std::vector<std::string> requests;
    if (requests.empty())
        for (const auto& row : rows)
        {
            std::string params = row[1];
            for (const auto& n : names)
                for (size_t at; (at = params.find(n.first)) != std::string::npos;)
                    params.replace(at, strlen(n.first), n.second);
            requests.push_back(std::string("{\"method\":\"") + row[0] + "\",\"params\":" + params +
                               ",\"id\":1}");
        }
    return requests;
}

std::string console(const std::string& request, CMPIrc* rc)
{
    ch::Object_Path path = classPath("VESPERA_AgentService");
    path.keys.push_back({"Name", ch::Value::of_string("Vespera Agent Service Provider")});
    std::vector<ch::Property> in {{"request", ch::Value::of_string(request)}};
    ch::Result r = host().cm(path, "executeMethod", in);
    if (rc)
        *rc = r.rc;
    for (const ch::Property& p : r.out)
        if (p.name == "response" && !p.value.null)
            return p.value.str;
    return std::string();
}

std::vector<Op> operations()
{
    ch::Host& h = host();
    std::vector<Op> ops;
    resetSimulator();
    for (const Registered& r : registeredClasses())
    {
        if (!r.served || !r.instance)
            continue;
        ch::Object_Path cls = classPath(r.name);
        ops.push_back(named(OP_EI, "ei", cls));
        ops.back().association = r.association;
        ops.push_back(named(OP_EIN, "ein", cls));
        ops.back().association = r.association;

        ch::Result all = h.ei(cls);
        if (!all.instances.empty())
        {
            Op gi = named(OP_GI, "gi", all.instances[0].path);
            gi.name = "gi " + refText(all.instances[0].path);
            gi.association = r.association;
            ops.push_back(gi);
        }
        if (!r.association || all.instances.empty())
            continue;
        // From each end of the first pair, the four ways to walk it.
        for (const ch::Property& end : all.instances[0].properties)
        {
            if (end.value.type != CMPI_ref || !end.value.ref)
                continue;
            static const std::pair<OpKind, const char*> walks[] = {
                {OP_AI, "ai"}, {OP_AN, "an"}, {OP_RI, "ri"}, {OP_RN, "rn"}};
            for (const auto& w : walks)
            {
                Op op = named(w.first, w.second, *end.value.ref);
                op.assocClass = r.name;
                op.association = true;
                op.name = std::string(w.second) + " " + r.name + " from " + end.name;
                ops.push_back(op);
            }
        }
    }

    // The methods that act, each on an element that suits it.
    ch::Result adapters = h.ein(classPath("VESPERA_PortController"));
    ch::Result fcPorts = h.ein(classPath("VESPERA_FCPort"));
    ch::Result ethPorts = h.ein(classPath("VESPERA_EthernetPort"));
    ch::Result alarms = h.ein(classPath("VESPERA_AlarmDevice"));
    ch::Result services = h.ein(classPath("VESPERA_HBASoftwareInstallationService"));
    const std::pair<const char*, const ch::Result*> tests[] = {
        {"VESPERA_MemoryDiagnosticTest", &adapters},
        {"VESPERA_LoopbackDiagnosticTest", &fcPorts},
        {"VESPERA_PCILoopbackDiagnosticTest", &fcPorts},
        {"VESPERA_EthLoopbackDiagnosticTest", &ethPorts},
    };
    for (const auto& t : tests)
        for (const ch::Object_Path& test : h.ein(classPath(t.first)).paths)
        {
            if (t.second->paths.empty())
                continue;
            Op op;
            op.kind = OP_METHOD;
            op.path = test;
            op.method = "RunDiagnostic";
            // The second element: on the quick host not a CNA's first port.
            const ch::Object_Path& element = t.second->paths[t.second->paths.size() > 1 ? 1 : 0];
            op.in = {{"ManagedElement", ch::Value::of_ref(element)}};
            const ch::Value* name = keyOf(test, "Name");
            op.name = "cm RunDiagnostic " + (name ? name->str : t.first) + " on " + refText(element);
            ops.push_back(op);
        }
    if (!services.paths.empty() && !adapters.paths.empty())
    {
        Op op;
        op.kind = OP_METHOD;
        op.path = services.paths[0];
        op.method = "InstallFromURI";
        op.in = {{"URI", ch::Value::of_string("file://" + dir().path + "/image.bin")},
                 {"Target", ch::Value::of_ref(adapters.paths[0])},
                 {"InstallOptions", uint16s({5})}};
        op.name = "cm InstallFromURI file on " + refText(adapters.paths[0]);
        ops.push_back(op);
    }
    if (!alarms.paths.empty())
    {
        Op op;
        op.kind = OP_METHOD;
        op.path = alarms.paths[0];
        op.method = "SetAlarmState";
        op.in = {{"RequestedAlarmState", ch::Value::of_uint(CMPI_uint16, 3)}};
        op.name = "cm SetAlarmState 3 on " + refText(alarms.paths[0]);
        ops.push_back(op);
    }

    for (const std::string& request : consoleRequests())
    {
        Op op;
        op.kind = OP_RPC;
        op.request = request;
        Json::Value r = parse(request);
        op.name = "rpc " + r["method"].asString();
        ops.push_back(op);
    }

    Op sub;
    sub.kind = OP_SUBSCRIBE;
    sub.path = classPath("VESPERA_AlertIndication");
    sub.name = "subscribe VESPERA_AlertIndication";
    ops.push_back(sub);
    return ops;
}

namespace
{

std::string rcAnswer(CMPIrc rc)
{
    return rc == CMPI_RC_OK ? "ok" : "rc:" + ch::rc_name(rc);
}

// The state of a job, 0 if there is none of that name; with no name, 4
// (running) while any job runs, else 7.
unsigned jobState(const std::string& job, Fault fault)
{
    if (fault.entry)
        dtruj_sim_set_fault(fault.entry, "none");
    ch::Result r = host().ei(classPath("VESPERA_ConcreteJob"));
    if (fault.entry)
        dtruj_sim_set_fault(fault.entry, fault.kind);
    unsigned any = 7;
    for (const ch::Instance& j : r.instances)
        if (const ch::Value* s = j.get("JobState"))
        {
            if (j.get_text("InstanceID") == job)
                return s->num.uint16;
            if (s->num.uint16 == 4)
                any = 4;
        }
    return job.empty() ? any : 0;
}

} // namespace

Outcome run(const Op& op, int jobTimeoutMs, Fault fault, const std::function<void()>& started)
{
    ch::Host& h = host();
    Outcome o;
    ch::Result r;
    switch (op.kind)
    {
    case OP_EI: r = h.ei(op.path); break;
    case OP_EIN: r = h.ein(op.path); break;
    case OP_GI: r = h.gi(op.path); break;
    case OP_AI: r = h.ai(op.path, op.assocClass); break;
    case OP_AN: r = h.an(op.path, op.assocClass); break;
    case OP_RI: r = h.ri(op.path, op.assocClass); break;
    case OP_RN: r = h.rn(op.path, op.assocClass); break;
    case OP_METHOD:
    {
        r = h.cm(op.path, op.method, op.in);
        if (started)
            started();
        o.rc = r.rc;
        o.value = r.return_value.null ? 0 : r.return_value.num.uint32;
        o.answer = r.rc != CMPI_RC_OK ? rcAnswer(r.rc) : "rv:" + std::to_string(o.value);
        o.detail = r.message;
        if (op.method != "RunDiagnostic")
            return o;
        // The job of a test that started; any job that runs, when the
        // answer was lost on the way.
        std::string job;
        for (const ch::Property& out : r.out)
            if (o.value == 4096 && out.name == "Job" && out.value.ref)
                if (const ch::Value* id = out.value.ref->key("InstanceID"))
                    job = id->str;
        auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(jobTimeoutMs);
        // Seldom, so that the test's own calls meet the fault.
        for (int pause = 1; jobState(job, fault) != 7; pause = std::min(pause * 2, 50))
        {
            if (std::chrono::steady_clock::now() > end)
            {
                o.answer = "job-stuck";
                o.detail = (job.empty() ? "a job" : job) + " still runs after " +
                           std::to_string(jobTimeoutMs) + " ms";
                return o;
            }
            std::this_thread::sleep_for(std::chrono::milliseconds(pause));
        }
        return o;
    }
    case OP_RPC:
    {
        std::string text = console(op.request, &o.rc);
        if (o.rc != CMPI_RC_OK)
        {
            o.answer = rcAnswer(o.rc);
            return o;
        }
        Json::Value reply;
        if (!Json::Reader().parse(text, reply) || !reply.isObject())
        {
            o.answer = "text";
            o.detail = text.substr(0, 200);
            return o;
        }
        o.reply = reply;
        const Json::Value& err = static_cast<const Json::Value&>(o.reply)["error"];
        if (!o.reply.isMember("error"))
            o.answer = "result";
        else if (err.isObject() && err["name"].isString())
            o.answer = "error:" + err["name"].asString() + ":" + err["code"].asString();
        else
            o.answer = "lib-error";
        o.detail = Json::FastWriter().write(err);
        return o;
    }
    case OP_SUBSCRIBE:
    {
        int id = 0;
        r = h.subscribe(op.path.name_space, op.path.class_name, id);
        ch::Result u = h.unsubscribe(id);
        o.rc = r.rc;
        o.answer = rcAnswer(r.rc);
        if (u.rc != CMPI_RC_OK)
            o.answer += ",unsubscribe:" + ch::rc_name(u.rc);
        o.detail = r.message;
        return o;
    }
    }
    o.rc = r.rc;
    o.count = r.instances.size() + r.paths.size();
    o.answer = rcAnswer(r.rc);
    o.detail = r.message;
    return o;
}

size_t objectsLeft(int waitMs)
{
    ch::Host& h = host();
    for (int waited = 0; h.live_objects() != 0 && waited < waitMs; waited += 10)
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    return h.live_objects();
}

Watchdog::Watchdog(int seconds) : _seconds(seconds), _thread([this] { watch(); })
{
}

Watchdog::~Watchdog()
{
    {
        std::lock_guard<std::mutex> g(_mutex);
        _stop = true;
    }
    _cv.notify_all();
    _thread.join();
}

void Watchdog::start(const std::string& what)
{
    std::lock_guard<std::mutex> g(_mutex);
    _what = what;
    _since = std::chrono::steady_clock::now();
    _busy = true;
}

void Watchdog::done()
{
    std::lock_guard<std::mutex> g(_mutex);
    _busy = false;
}

void Watchdog::watch()
{
    std::unique_lock<std::mutex> g(_mutex);
    while (!_stop)
    {
        _cv.wait_for(g, std::chrono::seconds(1));
        if (_busy &&
            std::chrono::steady_clock::now() - _since > std::chrono::seconds(_seconds))
        {
            fprintf(stderr, "FAIL hang: %s took more than %d s; the threads:\n", _what.c_str(),
                    _seconds);
            dumpThreads();
            fflush(stderr);
            abort();
        }
    }
}

void dumpThreads()
{
    char command[128];
    snprintf(command, sizeof(command),
             "gdb -p %d -batch -nx -ex 'thread apply all bt' 1>&2 2>/dev/null", int(getpid()));
    if (system(command) != 0)
        fprintf(stderr, "(no gdb to show the threads)\n");
}

std::vector<size_t> shareOf(const std::vector<size_t>& costs, int group, int groups)
{
    std::vector<size_t> order(costs.size());
    for (size_t i = 0; i < order.size(); i++)
        order[i] = i;
    std::stable_sort(order.begin(), order.end(),
                     [&](size_t a, size_t b) { return costs[a] > costs[b]; });
    std::vector<size_t> load(size_t(groups > 0 ? groups : 1), 0);
    std::vector<size_t> mine;
    for (size_t i : order)
    {
        size_t g = size_t(std::min_element(load.begin(), load.end()) - load.begin());
        load[g] += costs[i];
        if (int(g) == group)
            mine.push_back(i);
    }
    std::sort(mine.begin(), mine.end());
    return mine;
}

} // namespace harden
