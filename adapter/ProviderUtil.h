#ifndef _VSPR_ProviderUtil_h
#define _VSPR_ProviderUtil_h

#include <json/json.h>

#include "String.h"
#include "ProviderTypes.h"

namespace OLMA
{

// Small services that every helper shares: host facts, the two text forms of
// WWNs and MACs, class names, adapter look-ups in the library and the test of
// a library reply. It keeps no state: every look-up asks the library afresh.
//
// Addresses come in two forms: the colon form the library speaks
// ("10:00:00:05:1e:0f:ab:01", 23 characters; MACs 17) and the plain form of
// CIM keys ("1000000051e0fab01", 16 digits; MACs 12). Letter case is kept.
// While one is open on a thread, getHostInfo answers from what it found
// the first time: a request asks for the host facts once, however many
// adapters and ports its walk reads. Scopes nest; the outermost one ends
// the request's view.
class HostInfoScope
{
public:
    HostInfoScope();
    ~HostInfoScope();

private:
    HostInfoScope(const HostInfoScope&);
    HostInfoScope& operator=(const HostInfoScope&);
};

class ProviderUtil
{
public:

    static ProviderUtil* getProviderUtil();

    // Node name from uname; "localhost" if uname fails.
    String getHostName();

    // Fills hostString (zeroed by the caller, at most size bytes) with the
    // host's first non-loopback IPv4 address (returns 0), its host name
    // (returns 2) or "localhost" (returns 3). Within a HostInfoScope the
    // host is looked at once.

    int getHostInfo(char* hostString, int size);

    // Plain-form WWN (16 digits) or MAC (12 digits) to raw bytes. Bytes that
    // the text doesn't hold are zero.
    void getRawWWNFromStr(char* text, unsigned char* raw);
    void getRawMacFromStr(char* text, unsigned char* raw);

    String getClassName(classId_t id);
    String getDiagTestName(diag_test_id_t id);
    String getRecordData(diag_record_msg_t id);

    // Copies in to out without leading and trailing blanks; out must hold
    // strlen(in) + 1 bytes.
    static void trimString(char* in, char* out);

    bool IsFileExist(const char* path);

    // Fetches file from server with the tftp client ("tftp <server> -c get
    // <file>", started without a shell) into dir, which should be a fresh
    // directory of the caller's: the copy, named after the last part of
    // file, lands there and nowhere else. 0 with its path in copy when a
    // copy with content arrived; otherwise non-zero, after an ERR line. A
    // server or file that isPlainHost or isSafeRelativePath refuses is
    // refused before anything runs.
    int TftpGetFile(const char* server, const char* file, const char* dir, String& copy);

    // A host name, a dotted IPv4 address or an IPv6 literal, and nothing
    // else: letters, digits, inner hyphens and dots.
    static bool isPlainHost(const char* host);

    // A relative path of parts made of letters, digits, '.', '_', '-' and
    // '+', joined by single '/'; no part empty, "." or "..", or starting
    // with '-'.
    static bool isSafeRelativePath(const char* path);

    // 34568 if the console agent (zarkagent) runs, else 0. The process list
    // is read from /proc.
    unsigned int getAgentPort();

    // False only for the statuses "driver not installed" (2) and "library
    // mismatch" (3).
    static bool getDriverStatus();

    // "//<host>/root/vespera:<className>".
    String updateNamespacePath(String className);

    // The WWN or MAC (plain form) that an adapter's Tag carries; empty if the
    // tag is too short to carry one.
    String getNodeMACOrWWNFromTag(String tag, String unused = String());

    // Tests the first byte only: could a UTF-8 text start with it?
    static bool valid_UTF_string(const char* text);

    // Not null, and not an object with a member "error".
    static bool isValidJsonResponse(const Json::Value& reply);

    // The size of "indexStrings" of getAllAdaptersIndexString, whose reply
    // stays in reply; -1 if it can't be had.
    int getNumberOfAdapters(Json::Value& reply);

    // Colon-form index of the adapter with id (counted from 1), or empty.
    String getAddrByAdapterId(int id);

    // The library's log callback.
    static void logMsg(int level, const char* file, int line, const char* text);

    static String eraseColonsFromIndex(String index);
    static String getIndexInColonFormat(String index);

    // getHbaByWwn of the adapter; 0 when the reply has "hbaData" and
    // "driver", else -1.
    int getAdapterDetails(String index, Json::Value& reply);

    String getAdapterSerialNumber(String index);
    bool checkIfThisAdapterModelPresent(const char* model);
    bool isCNA(String index);
    bool hasEthernetPort(String index);
    String getDriverVersion();

    // "ethDev" of the Ethernet port named by mac (either text form); empty,
    // after an ERR line, when the port can't be read.
    String getEthDeviceNameByMAC(String mac);

    // The library's adapter id, or (unsigned)-1.
    unsigned int getAdapterIdByIndexStr(String index);
    unsigned int getAdapterIdByMacAddr(String mac);
    unsigned int getAdapterIdByNWWN(String wwn);
    unsigned int getAdapterId(String address);

    static ProviderUtil* helperObj;
};

extern ProviderUtil gProviderUtilObj;

} // namespace OLMA

#endif
