#include "ProviderUtil.h"
#include "EthernetPortHelper.h"

#include <dirent.h>
#include <errno.h>
#include <fcntl.h>
#include <netdb.h>
#include <arpa/inet.h>
#include <ctype.h>
#include <netinet/in.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <sys/stat.h>
#include <sys/utsname.h>
#include <unistd.h>

#include <exception>
#include <vector>

#include "CIMProviderTruj.h"
#include "ProviderInit.h"
#include "Strings.h"
#include "Subprocess.h"
#include "dtruj.h"
#include "Mutex.h"
#include "log.h"

namespace OLMA
{

const char* const classNames[MAXCLASSID + 1] =
{
    "--",
    "VESPERA_ComputerSystem",
    "VESPERA_PortController",
    "VESPERA_FCPort",
    "VESPERA_SCSIProtocolEndpoint",
    "VESPERA_FCPortStatistics",
    "VESPERA_PhysicalPackage",
    "VESPERA_Product",
    "VESPERA_AdapterSoftwareIdentity",
    "VESPERA_StorageExtent",
    "VESPERA_RegisteredProfile",
    "VESPERA_RegisteredSubProfile",
    "VESPERA_Namespace",
    "VESPERA_ObjectManager",
    "VESPERA_CIMXMLCommunicationMechanism",
    "VESPERA_ProfileSoftwareIdentity",
    "VESPERA_TapeDrive",
    "VESPERA_RemoteServiceAccessPoint",
    "VESPERA_HBASoftwareInstallationService",
    "VESPERA_HBASoftwareInstallationServiceCapabilities",
    "VESPERA_EthernetPort",
    "VESPERA_MemoryDiagnosticTest",
    "VESPERA_LoopbackDiagnosticTest",
    "VESPERA_PCILoopbackDiagnosticTest",
    "VESPERA_EthLoopbackDiagnosticTest",
    "VESPERA_DiagnosticSoftwareIdentity",
    "VESPERA_ConcreteJob",
    "VESPERA_DiagnosticServiceRecord",
    "VESPERA_DiagnosticCompletionRecord",
    "VESPERA_DiagnosticElementSoftwareIdentity",
    "VESPERA_LogicalPortGroup",
    "VESPERA_AffectedJobElement",
    "VESPERA_ServiceRecordAppliesToElement",
    "VESPERA_CompletionRecordAppliesToElement",
    "VESPERA_LANEndpoint",
    "VESPERA_PhysicalConnector",
    "VESPERA_AlarmDevice",
    "VESPERA_AgentService",
    "VESPERA_LogicalDisk",
};

const char* const diagTestNames[DIAG_NAME_INVALID] =
{
    "--",
    "MemoryTest",
    "InternalLoopbackTest",
    "ExternalLoopbackTest",
    "SerdesLoopbackTest",
    "PCILoopbackTest",
    "ExternalEthLoopbackTest",
    "SerdesEthLoopbackTest",
};

const char* const diagRecordMsgArray[REC_MAX_ID] =
{
    "--",
    "Checking whether the adapter is disabled for running memory test",
    "Adapter is not disabled",
    "Disabling the adapter for running memory test",
    "Enabling the adapter after running memory test",
    "Running memory test on the adapter",
    "Checking for return codes for memory test run",
    "Memory test run is successful",
    "Memory test failed",
    "Running PCI Loopback test for the port",
    "Checking for return codes for PCI Loopback test run",
    "PCI Loopback test run is successful",
    "PCI Loopback test failed",
    "Checking whether the port is disabled for running loopback test",
    "Port is already disabled",
    "Port is not disabled",
    "Disabling the port for running loopback test",
    "Enabling the port after running loopback test",
    "Running loopback test for the port",
    "Checking for return codes for loopback test run",
    "Loopback test run is successful",
    "Loopback test failed",
    "Checking whether the port is disabled for running eth loopback test",
    "Disabling the port for running eth loopback test",
    "Enabling the port after running eth loopback test",
    "Running eth loopback test for the port",
    "Checking for return codes for eth loopback test run",
    "Eth loopback test run is successful",
    "Eth loopback test failed",
    "Disabling the port",
    "Enabling the port",
    "Failed to disable the port",
    "Running memory test may take a few moments",
    "Adapter is already disabled",
    "Eth loopback test aborted",
    "Unknown failure",
};

ProviderUtil gProviderUtilObj;
ProviderUtil* ProviderUtil::helperObj = 0;

ProviderUtil* ProviderUtil::getProviderUtil()
{
    if (!helperObj)
        helperObj = &gProviderUtilObj;

    return helperObj;
}

//------------------------------------------------------------------------------
// Calling the library
//------------------------------------------------------------------------------

// One call of a JSON entry. The library may throw anything; none of it may
// reach our callers, who run on the CIM server's threads.
static bool _callLib(const char* what, const char* entry, JsonReqFP fp,
    const Json::Value& request, Json::Value& reply)
{
    try
    {
        reply = fp(request);
        return true;
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "%s - %s got User exception %d: %s", what, entry,
            e.getCode(), e.getMessage().c_str());
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "%s - %s got std exception: %s", what, entry, e.what());
    }
    catch (...)
    {
        TLOG(LL_ERR, "%s - %s got default exception", what, entry);
    }

    reply = Json::Value();
    return false;
}

// A member that must be a text; anything else reads as empty.
static const char* _text(const Json::Value& object, const char* name)
{
    if (!object.isObject())
        return "";

    const Json::Value& member = object[name];
    return member.isString() ? member.asCString() : "";
}

//------------------------------------------------------------------------------
// Host facts
//------------------------------------------------------------------------------

String ProviderUtil::getHostName()
{
    struct utsname names;

    if (uname(&names) != 0)
    {
        TLOG(LL_ERR, "uname() returned error = %d", errno);
        return String("localhost");
    }

    return String(names.nodename);
}

// gethostbyname_r, growing its scratch buffer as asked: the plain
// gethostbyname shares one static result between threads. One look-up at a
// time even so: the name service modules behind it share state of their
// own, not all of them guard it, and the locks glibc takes for the others
// are invisible to ThreadSanitizer, which then reports their reallocations
// as a race.
static bool _lookUpHost(const char* name, struct hostent& entry,
    std::vector<char>& scratch)
{
    static Mutex lookUpLock;
    Auto_Mutex hold(lookUpLock);
    scratch.resize(1024);

    for (;;)
    {
        struct hostent* result = 0;
        int herr = 0;
        int rc = gethostbyname_r(name, &entry, scratch.data(), scratch.size(),
            &result, &herr);

        if (rc == ERANGE && scratch.size() < (1u << 20))
        {
            scratch.resize(scratch.size() * 2);
            continue;
        }

        return rc == 0 && result != 0;
    }
}

// As strncpy: at most size bytes, the rest of them zero, no terminator
// added when the text fills them all.
static void _copyOut(char* to, const char* from, int size)
{
    if (!to || size <= 0)
        return;
    size_t n = strnlen(from, (size_t)size);
    memcpy(to, from, n);
    memset(to + n, 0, (size_t)size - n);
}

// The host facts as getHostInfo tells them; copied reports whether
// hostString was written at all.
static int _readHostInfo(char* hostString, int size, bool& copied)
{
    copied = true;

    char hostName[255];
    memset(hostName, 0, sizeof(hostName));

    if (gethostname(hostName, sizeof(hostName) - 1) != 0)
    {
        _copyOut(hostString, "localhost", size);
        TLOG(LL_INFO, "gethostname() FAILED. hostString will be filled with "
            "localhost");
        return 3;
    }

    struct hostent entry;
    std::vector<char> scratch;

    if (!_lookUpHost(hostName, entry, scratch) || !entry.h_addr_list ||
        !entry.h_addr_list[0] || entry.h_addrtype != AF_INET)
    {
        _copyOut(hostString, hostName, size);
        TLOG(LL_INFO, "gethostbyname() FAILED. hostString will have hostname "
            "instead of ipAddress");
        return 2;
    }

    for (char** p = entry.h_addr_list; *p; p++)
    {
        char dotted[INET_ADDRSTRLEN];

        if (!inet_ntop(AF_INET, *p, dotted, sizeof(dotted)))
            continue;

        if (strncmp(dotted, "127", 3) != 0)
        {
            _copyOut(hostString, dotted, size);
            return 0;
        }
    }

    // Only loopback addresses: the name is all that can identify us.
    memset(hostName, 0, sizeof(hostName));

    if (gethostname(hostName, sizeof(hostName) - 1) != 0)
    {
        TLOG(LL_INFO, "gethostname() failed");
        copied = false;
        return 2;
    }

    _copyOut(hostString, hostName, size);

    char domainName[255];
    memset(domainName, 0, sizeof(domainName));

    if (getdomainname(domainName, sizeof(domainName) - 1) != 0)
    {
        TLOG(LL_INFO, "getdomainname() failed");
        return 2;
    }

    TLOG(LL_INFO, "gethostbyname() FAILED. hostString will have hostname "
        "instead of ipAddress");
    return 2;
}

namespace
{

// The host facts of the request that runs on this thread, while a
// HostInfoScope is open: a walk asks for them per adapter and per port,
// and each answer costs system calls and a read of the host tables.
struct Host_Info_Cache
{
    int depth;
    bool filled;
    bool copied;
    int code;
    char host[256];
};

thread_local Host_Info_Cache _hostInfoCache;

} // namespace

HostInfoScope::HostInfoScope()
{
    if (_hostInfoCache.depth++ == 0)
        _hostInfoCache.filled = false;
}

HostInfoScope::~HostInfoScope()
{
    if (--_hostInfoCache.depth == 0)
        _hostInfoCache.filled = false;
}

int ProviderUtil::getHostInfo(char* hostString, int size)
{
    Host_Info_Cache& cache = _hostInfoCache;

    if (cache.depth == 0)
    {
        bool copied;
        return _readHostInfo(hostString, size, copied);
    }

    if (!cache.filled)
    {
        memset(cache.host, 0, sizeof(cache.host));
        cache.code = _readHostInfo(cache.host, (int)sizeof(cache.host) - 1, cache.copied);
        cache.filled = true;
    }

    if (cache.copied)
        _copyOut(hostString, cache.host, size);

    return cache.code;
}

// Whether a process whose name ends in name runs: the process list as
// "ps -e | grep name$" would see it, read from /proc without a shell.
static bool _processRuns(const char* name)
{
    DIR* proc = opendir("/proc");

    if (!proc)
        return false;

    size_t want = strlen(name);
    bool found = false;
    struct dirent* e;

    while (!found && (e = readdir(proc)) != 0)
    {
        if (e->d_name[0] < '1' || e->d_name[0] > '9')
            continue;

        char path[64];
        snprintf(path, sizeof(path), "/proc/%.20s/comm", e->d_name);

        int fd = open(path, O_RDONLY | O_CLOEXEC);

        if (fd < 0)
            continue;

        char comm[64];
        ssize_t n = read(fd, comm, sizeof(comm) - 1);
        close(fd);

        if (n <= 0)
            continue;

        while (n > 0 && comm[n - 1] == '\n')
            n--;

        found = (size_t)n >= want && memcmp(comm + n - want, name, want) == 0;
    }

    closedir(proc);
    return found;
}

unsigned int ProviderUtil::getAgentPort()
{
    return _processRuns("zarkagent") ? 34568 : 0;
}

String ProviderUtil::updateNamespacePath(String className)
{
    char host[255];
    memset(host, 0, sizeof(host));
    getHostInfo(host, sizeof(host) - 1);

    String path("//", host, "/");
    path.append("root/vespera");
    path.append(':');
    path.append(className);
    return path;
}

bool ProviderUtil::IsFileExist(const char* path)
{
    struct stat st;
    return path && stat(path, &st) == 0;
}

//------------------------------------------------------------------------------
// Running tftp
//------------------------------------------------------------------------------

// How long one download may take. The client gives up by itself after some
// 25 seconds without an answer; this bounds a transfer that trickles on, or
// a client that hangs, while the CIM request waits for it.
static const int TFTP_TIMEOUT_MS = 300 * 1000;

// Plain ASCII, whatever locale the server runs in.
static bool _isAsciiAlnum(unsigned char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9');
}

bool ProviderUtil::isPlainHost(const char* host)
{
    if (!host || !*host || strlen(host) > 253)
        return false;

    // An IPv6 literal, as the client takes it.
    if (strchr(host, ':'))
    {
        struct in6_addr addr;
        return strspn(host, "0123456789abcdefABCDEF:.") == strlen(host) &&
            inet_pton(AF_INET6, host, &addr) == 1;
    }

    // A name or a dotted IPv4 address: labels of letters, digits and inner
    // hyphens, so that nothing can read as an option or a second word.
    const char* label = host;

    for (const char* p = host; ; p++)
    {
        if (*p == '.' || *p == '\0')
        {
            size_t n = (size_t)(p - label);

            if (n == 0 || n > 63 || label[0] == '-' || p[-1] == '-')
                return false;

            if (*p == '\0')
                return true;

            label = p + 1;
        }
        else if (!_isAsciiAlnum((unsigned char)*p) && *p != '-')
            return false;
    }
}

bool ProviderUtil::isSafeRelativePath(const char* path)
{
    if (!path || !*path || path[0] == '/' || strlen(path) > 1000)
        return false;

    const char* part = path;

    for (const char* p = path; ; p++)
    {
        if (*p == '/' || *p == '\0')
        {
            size_t n = (size_t)(p - part);

            if (n == 0 || part[0] == '-' ||
                (n == 1 && part[0] == '.') ||
                (n == 2 && part[0] == '.' && part[1] == '.'))
                return false;

            if (*p == '\0')
                return true;

            part = p + 1;
        }
        else
        {
            unsigned char c = *p;

            if (!(_isAsciiAlnum(c) || c == '.' || c == '_' || c == '-' || c == '+'))
                return false;
        }
    }
}

int ProviderUtil::TftpGetFile(const char* server, const char* file, const char* dir,
    String& copy)
{
    char shown[256];
    copy.clear();

    if (!isPlainHost(server))
    {
        TLOG(LL_ERR, "TftpGetFile: refused host name \"%s\"",
            printableText(server, shown, sizeof(shown)));
        return -1;
    }

    if (!isSafeRelativePath(file))
    {
        TLOG(LL_ERR, "TftpGetFile: refused file name \"%s\"",
            printableText(file, shown, sizeof(shown)));
        return -1;
    }

    if (!dir || dir[0] != '/')
    {
        TLOG(LL_ERR, "TftpGetFile: no directory to download into");
        return -1;
    }

    // The client names its copy after the last part of the path, in the
    // directory it runs in.
    const char* name = strrchr(file, '/');
    name = name ? name + 1 : file;
    String local(dir);
    local.append("/");
    local.append(name);

    const char* argv[] = { "tftp", server, "-c", "get", file, 0 };
    TLOG(LL_DBG, "TftpGetFile: tftp %s -c get %s (in %s)", server, file, dir);

    SubprocessOutcome outcome;

    if (runSubprocess("tftp", argv, dir, TFTP_TIMEOUT_MS, outcome) != 0)
        return -1;

    char said[sizeof(outcome.output)];
    printableText(outcome.output, said, sizeof(said));

    if (outcome.timedOut)
    {
        TLOG(LL_ERR, "TftpGetFile: tftp didn't finish within %d seconds; stopped",
            TFTP_TIMEOUT_MS / 1000);
        return -1;
    }

    if (outcome.statusKnown && outcome.exitCode != 0)
    {
        TLOG(LL_ERR, "TftpGetFile: tftp failed (exit %d, signal %d): %s",
            outcome.exitCode, outcome.signal, said);
        return outcome.exitCode > 0 ? outcome.exitCode : -1;
    }

    // The client exits with 0 also when the host is unknown or the server
    // has no such file, and may leave an empty file then: only a copy with
    // content counts.
    struct stat st;

    if (lstat(local.c_str(), &st) != 0 || !S_ISREG(st.st_mode) || st.st_size == 0)
    {
        TLOG(LL_ERR, "TftpGetFile: no copy of %s arrived from %s: %s", file, server, said);
        return -1;
    }

    if (said[0])
        TLOG(LL_INFO, "TftpGetFile: tftp said: %s", said);

    copy = local;
    return 0;
}

//------------------------------------------------------------------------------
// Names and texts
//------------------------------------------------------------------------------

String ProviderUtil::getClassName(classId_t id)
{
    if ((unsigned int)id > MAXCLASSID)
    {
        TLOG(LL_INFO, "ClassId is greater than MAXCLASSID");
        return String("INVALID CLASS");
    }

    // Built once: every instance of a walk names its class and the host's,
    // and a copy of a built String only counts a reference.
    static const String* names = [] {
        static String all[MAXCLASSID + 1];
        for (int i = 0; i <= MAXCLASSID; i++)
            all[i] = String(classNames[i]);
        return all;
    }();

    return names[id];
}

String ProviderUtil::getDiagTestName(diag_test_id_t id)
{
    if ((unsigned int)id >= DIAG_NAME_INVALID)
    {
        TLOG(LL_INFO, "Diag Test Id is greater than DIAG_NAME_INVALID");
        return String("INVALID DIAGNOSTIC ID");
    }

    return String("Vespera", ":", diagTestNames[id]);
}

String ProviderUtil::getRecordData(diag_record_msg_t id)
{
    if ((unsigned int)id >= REC_MAX_ID)
    {
        TLOG(LL_ERR, "Record ID is greater than REC_MAX_ID");
        return String("INVALID RECORD ID");
    }

    return String(diagRecordMsgArray[id]);
}

void ProviderUtil::trimString(char* in, char* out)
{
    if (!out)
        return;

    out[0] = '\0';

    if (!in)
        return;

    const char* start = in;

    while (*start == ' ')
        start++;

    size_t n = strlen(start);

    while (n > 0 && start[n - 1] == ' ')
        n--;

    memmove(out, start, n);
    out[n] = '\0';
}

bool ProviderUtil::valid_UTF_string(const char* text)
{
    if (!text)
        return false;

    unsigned char c = text[0];
    return c < 0x80 || (c >= 0xC2 && c <= 0xF4);
}

bool ProviderUtil::isValidJsonResponse(const Json::Value& reply)
{
    if (reply.isNull())
        return false;

    if (reply.isObject() && reply.isMember("error"))
        return false;

    return true;
}

void ProviderUtil::logMsg(int level, const char* file, int line,
    const char* text)
{
    Log_Level ll;

    switch (level)
    {
        case 2:
        case 5:
            ll = LL_INFO;
            break;
        case 3:
            ll = LL_WARN;
            break;
        case 4:
            ll = LL_ERR;
            break;
        default:
            ll = LL_DBG;
            break;
    }

    // The library's own place, cut to 32 bytes, leads the text.
    char where[32];
    snprintf(where, sizeof(where), "%s:%d ", file ? file : "", line);

    log(ll, TESSEL_FILE_BASENAME, __LINE__, "%s%s", where, text ? text : "");
}

//------------------------------------------------------------------------------
// Address forms
//------------------------------------------------------------------------------

static void _readHexBytes(const char* text, unsigned char* raw, size_t count)
{
    if (!raw)
        return;

    memset(raw, 0, count);

    if (!text)
        return;

    // Read pair by pair so that a short or broken text leaves zeros, never
    // an overrun.
    for (size_t i = 0; i < count; i++)
    {
        unsigned int byte;
        char pair[3] = { text[0], text[0] ? text[1] : '\0', '\0' };

        if (!pair[0] || !pair[1] || !isxdigit((unsigned char)pair[0]) ||
            !isxdigit((unsigned char)pair[1]))
            return;

        if (sscanf(pair, "%02X", &byte) != 1)
            return;

        raw[i] = (unsigned char)byte;
        text += 2;
    }
}

void ProviderUtil::getRawWWNFromStr(char* text, unsigned char* raw)
{
    _readHexBytes(text, raw, 8);
}

void ProviderUtil::getRawMacFromStr(char* text, unsigned char* raw)
{
    _readHexBytes(text, raw, 6);
}

String ProviderUtil::eraseColonsFromIndex(String index)
{
    String result;

    for (size_t i = 0; i < index.size(); i++)
    {
        if (index[i] != ':')
            result.append(index[i]);
    }

    return result;
}

String ProviderUtil::getIndexInColonFormat(String index)
{
    if (index.find(':') != (size_t)-1)
    {
        TLOG(LL_INFO, "The string %s is already in : format", index.c_str());
        return index;
    }

    size_t n = index.size();

    if (n < 4)
        return index;

    size_t colons = n / 2 - 1;
    String result;
    result.reserve(n + colons);

    // A colon after every pair but the last; an odd digit stays with the
    // last pair.
    for (size_t i = 0; i < n; i++)
    {
        if (i > 0 && i % 2 == 0 && i / 2 <= colons)
            result.append(':');

        result.append(index[i]);
    }

    return result;
}

String ProviderUtil::getNodeMACOrWWNFromTag(String tag, String)
{
    // "10000000-0000-0000-XXXX-YYYYYYYYYYYY": XXXX is "0000" for a MAC.
    if (tag.size() < 24)
    {
        TLOG(LL_ERR, "Tag %s carries no WWN or MAC", tag.c_str());
        return String();
    }

    String result;
    String head = tag.substr(19, 4);

    if (!head.equali("0000"))
        result.append(head);

    result.append(tag.substr(24));
    return result;
}

//------------------------------------------------------------------------------
// Adapter look-ups
//------------------------------------------------------------------------------

bool ProviderUtil::getDriverStatus()
{
    int status = ProviderInit::getDriverStatus();
    return status != 2 && status != 3;
}

int ProviderUtil::getNumberOfAdapters(Json::Value& reply)
{
    bool called = _callLib("getNumberOfAdapters", "libGetAllAdaptersIndexString",
        libGetAllAdaptersIndexString, Json::Value(), reply);

    if (!called || !isValidJsonResponse(reply) || !reply.isObject() ||
        !reply["indexStrings"].isArray())
    {
        TLOG(LL_ERR, "libGetAllAdaptersIndexString returns NULL.");
        return -1;
    }

    return (int)reply["indexStrings"].size();
}

String ProviderUtil::getAddrByAdapterId(int id)
{
    Json::Value reply;
    int count = getNumberOfAdapters(reply);

    if (count < 0)
        return String();

    if (count == 0 || id < 1 || id > count)
    {
        TLOG(LL_INFO, "numOfAdapters = %u. Id = %u", (unsigned)count,
            (unsigned)id);
        return String();
    }

    const Json::Value& element = reply["indexStrings"][id - 1];

    if (!element.isString())
    {
        TLOG(LL_ERR, "Index string of adapter %d isn't a text", id);
        return String();
    }

    return String(element.asCString());
}

int ProviderUtil::getAdapterDetails(String index, Json::Value& reply)
{
    String colon = getIndexInColonFormat(index);

    Json::Value request(Json::objectValue);

    if (colon.size() == 17)
        request["mac"] = colon.c_str();
    else
        request["wwn"] = colon.c_str();

    if (!_callLib(index.c_str(), "libGetHbaByWwn", libGetHbaByWwn, request,
        reply))
        return -1;

    if (!isValidJsonResponse(reply) || !reply.isObject() ||
        !reply["hbaData"].isObject() || !reply.isMember("driver"))
    {
        TLOG(LL_ERR, "Unable to get adapater details for %s", index.c_str());
        return -1;
    }

    return 0;
}

String ProviderUtil::getAdapterSerialNumber(String index)
{
    Json::Value reply;

    if (getAdapterDetails(index, reply) != 0)
    {
        TLOG(LL_ERR, "Unable to get Adapter info for %s", index.c_str());
        return String();
    }

    const Json::Value& hba = reply["hbaData"];
    const char* oem = _text(hba, "oemSerialNum");

    if (*oem == '\0')
        return String(_text(hba, "serialNumber"));

    // OEM serial numbers repeat the part number in front.
    const char* part = _text(hba, "partNum");
    size_t partLen = strlen(part);

    if (partLen > 0 && strncmp(oem, part, partLen) == 0)
        return String(oem + partLen);

    return String(oem);
}

bool ProviderUtil::checkIfThisAdapterModelPresent(const char* model)
{
    Json::Value list;

    if (getNumberOfAdapters(list) < 1)
    {
        TLOG(LL_WARN, "No adapters in the system!");
        return false;
    }

    if (!model)
        return false;

    const Json::Value& indexes = list["indexStrings"];

    for (Json::ArrayIndex i = 0; i < indexes.size(); i++)
    {
        const char* index = indexes[i].isString() ? indexes[i].asCString() : "";
        Json::Value reply;

        if (getAdapterDetails(String(index), reply) != 0)
        {
            TLOG(LL_INFO, "Unable to get Adapter info %d - %s", (int)i + 1,
                index);
            continue;
        }

        // The adapter's model may be a leading part of the one asked for.
        const char* hbaModel = _text(reply["hbaData"], "model");
        size_t n = strlen(hbaModel);

        if (n > 0 && strncasecmp(model, hbaModel, n) == 0)
        {
            TLOG(LL_INFO, "Found the Adapter");
            return true;
        }
    }

    return false;
}

// A boolean member of "hbaData"; false if the adapter or member can't be had.
static bool _hbaFlag(ProviderUtil* util, const String& index, const char* name,
    bool& value)
{
    Json::Value reply;

    if (util->getAdapterDetails(index, reply) != 0)
        return false;

    const Json::Value& member = reply["hbaData"][name];

    if (!member.isBool())
        return false;

    value = member.asBool();
    return true;
}

bool ProviderUtil::isCNA(String index)
{
    bool value = false;

    if (!_hbaFlag(this, index, "isCNA", value))
    {
        TLOG(LL_ERR, "Unable to get CNA info for %s", index.c_str());
        return false;
    }

    return value;
}

bool ProviderUtil::hasEthernetPort(String index)
{
    bool value = false;

    if (!_hbaFlag(this, index, "hasEthPort", value))
    {
        TLOG(LL_ERR, "Unable to get Ethernet info %s", index.c_str());
        return false;
    }

    return value;
}

String ProviderUtil::getDriverVersion()
{
    Json::Value list;

    if (getNumberOfAdapters(list) < 1)
        return String();

    const Json::Value& first = list["indexStrings"][0];
    String index(first.isString() ? first.asCString() : "");

    Json::Value reply;

    if (getAdapterDetails(index, reply) != 0)
    {
        TLOG(LL_ERR, "Unable to get driver version for %s", index.c_str());
        return String();
    }

    const Json::Value& driver = reply["driver"];
    const char* version = 0;

    if (driver.isObject() && driver["storageDriverVersion"].isString())
        version = driver["storageDriverVersion"].asCString();
    else if (driver.isObject() && driver["networkDriverVersion"].isString())
        version = driver["networkDriverVersion"].asCString();

    if (!version)
    {
        TLOG(LL_ERR, "Unable to get driver version for %s", index.c_str());
        return String();
    }

    char raw[64];
    char trimmed[64];
    strlcpy(raw, version, sizeof(raw));
    trimString(raw, trimmed);

    TLOG(LL_INFO, "Driver version is %s", trimmed);
    return String(trimmed);
}

unsigned int ProviderUtil::getAdapterIdByIndexStr(String index)
{
    Json::Value request(Json::objectValue);
    request["indexStr"] = getIndexInColonFormat(index).c_str();

    Json::Value reply;

    if (_callLib(index.c_str(), "libGetAdapterId", libGetAdapterId, request,
        reply) && isValidJsonResponse(reply) && reply.isObject())
    {
        const Json::Value& id = reply["adapterId"];

        if (id.isIntegral() && id.isUInt())
            return id.asUInt();
    }

    TLOG(LL_ERR, "libGetAdapterId returns NULL.");
    return (unsigned int)-1;
}

unsigned int ProviderUtil::getAdapterIdByMacAddr(String mac)
{
    return getAdapterIdByIndexStr(mac);
}

unsigned int ProviderUtil::getAdapterIdByNWWN(String wwn)
{
    return getAdapterIdByIndexStr(wwn);
}

unsigned int ProviderUtil::getAdapterId(String address)
{
    if (address.size() == 16)
        return getAdapterIdByNWWN(address);

    if (address.size() == 12)
        return getAdapterIdByMacAddr(address);

    TLOG(LL_ERR, "The address passed is not MAC or WWN");
    return (unsigned int)-1;
}

} // namespace OLMA

namespace OLMA
{

String ProviderUtil::getEthDeviceNameByMAC(String mac)
{
    Json::Value reply;

    if (EthernetPortHelper::getEthernetPortHelperObject()->getEthPortDetails(mac, reply) == 0)
    {
        const Json::Value& dev = reply["ethData"]["ethDev"];
        if (dev.isString())
            return String(dev.asCString());
    }

    TLOG(LL_ERR, "Unable to get Eth Device Name for %s", mac.c_str());
    return String();
}

} // namespace OLMA
