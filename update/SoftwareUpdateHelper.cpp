#include "SoftwareUpdateHelper.h"

#include <dirent.h>
#include <errno.h>
#include <fcntl.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

#include <exception>

#include "CIMProviderTruj.h"
#include "ProviderUtil.h"
#include "Strings.h"
#include "Subprocess.h"
#include "dtruj.h"
#include "log.h"

namespace OLMA
{

SoftwareUpdateHelper gSoftwareUpdateHelperObj;
SoftwareUpdateHelper* SoftwareUpdateHelper::swUpdateObj = 0;

const char* const SOFTWARE_UPDATE_SERVICE_NAME = "Vespera Adapter Software Update Service";

SoftwareUpdateHelper* SoftwareUpdateHelper::getSoftwareUpdateHelperInstance()
{
    if (!swUpdateObj)
        swUpdateObj = &gSoftwareUpdateHelperObj;

    return swUpdateObj;
}

//------------------------------------------------------------------------------
// The service and its capabilities
//------------------------------------------------------------------------------

Array<Instance*> SoftwareUpdateHelper::getInstancesByClass(classId_t id)
{
    Array<Instance*> result;

    // One byte stays zero, so the text is terminated whatever its length.
    char host[255];
    memset(host, 0, sizeof(host));
    ProviderUtil::getProviderUtil()->getHostInfo(host, sizeof(host) - 1);

    _adapterData data;
    memset(&data, 0, sizeof(data));
    strlcpy(data.hostName, host, sizeof(data.hostName));

    Instance* instance = 0;

    switch (id)
    {
        case ID_VESPERA_HBASoftwareInstallationService:
            instance = getHBASoftwareInstallationServiceInstance(data);
            break;

        case ID_VESPERA_HBASoftwareInstallationServiceCapabilities:
            instance = getHBASoftwareInstallationServiceCapabilitiesInstance(data);
            break;

        default:
            TLOG(LL_INFO, "Default case . Other classes ");
            break;
    }

    if (instance)
        result.append(instance);

    TLOG(LL_INFO, "Number of instances: %d", (int)result.size());
    return result;
}

VESPERA_HBASoftwareInstallationService*
SoftwareUpdateHelper::getHBASoftwareInstallationServiceInstance(_adapterData data)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    VESPERA_HBASoftwareInstallationService* service =
        create<VESPERA_HBASoftwareInstallationService>(true);

    // The record comes from a caller and need not be terminated.
    String host(data.hostName, strnlen(data.hostName, sizeof(data.hostName)));

    service->SystemCreationClassName.set(util->getClassName(ID_VESPERA_ComputerSystem));
    service->SystemName.set(host);
    service->CreationClassName.set(
        util->getClassName(ID_VESPERA_HBASoftwareInstallationService));
    service->Name.set(String(SOFTWARE_UPDATE_SERVICE_NAME));

    return service;
}

static Array<uint16> _uint16s(uint16 first, uint16 second = 0)
{
    Array<uint16> a;
    a.append(first);
    if (second)
        a.append(second);
    return a;
}

VESPERA_HBASoftwareInstallationServiceCapabilities*
SoftwareUpdateHelper::getHBASoftwareInstallationServiceCapabilitiesInstance(_adapterData)
{
    VESPERA_HBASoftwareInstallationServiceCapabilities* caps =
        create<VESPERA_HBASoftwareInstallationServiceCapabilities>(true);

    caps->InstanceID.set(String(SOFTWARE_UPDATE_SERVICE_NAME));
    caps->SupportedInstallOptions.set(_uint16s(4, 5));      // install, update
    caps->SupportedURISchemes.set(_uint16s(3, 8));          // file, tftp
    caps->SupportedSynchronousActions.set(_uint16s(5));     // install from URI

    return caps;
}

//------------------------------------------------------------------------------
// Writing the flash
//------------------------------------------------------------------------------

static bool _callUpdateFlash(const Json::Value& request, Json::Value& reply, const char* index)
{
    try
    {
        reply = libAdapterUpdateFlash(request);
        return true;
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "%s - libAdapterUpdateFlash got User exception %d: %s", index,
            e.getCode(), e.getMessage().c_str());
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "%s - libAdapterUpdateFlash got std exception: %s", index, e.what());
    }
    catch (...)
    {
        TLOG(LL_ERR, "%s - libAdapterUpdateFlash got default exception", index);
    }

    return false;
}

int SoftwareUpdateHelper::UpdatePortControllerSoftware(
    const VESPERA_PortController* adapter, const char* file)
{
    if (!adapter || !file)
    {
        TLOG(LL_ERR, "libAdapterUpdateFlash is failed.");
        return -1;
    }

    String deviceId;
    if (!adapter->DeviceID.null)
        deviceId = adapter->DeviceID.value;

    TLOG(LL_DBG, "UpdatePortControllerSoftware portType=%d deviceid=%s file=%s\n",
        adapter->ControllerType.null ? -1 : (int)adapter->ControllerType.value,
        deviceId.c_str(), file);

    // An adapter without an address (an FC HBA whose storage driver isn't
    // loaded) can't be named to the library.
    if (deviceId.size() < 2)
    {
        TLOG(LL_ERR, "libAdapterUpdateFlash is failed.");
        return -1;
    }

    String index = ProviderUtil::getIndexInColonFormat(deviceId);

    Json::Value request(Json::objectValue);
    request["indexStr"] = index.c_str();
    request["file"] = file;

    Json::Value reply;

    if (_callUpdateFlash(request, reply, index.c_str()) &&
        ProviderUtil::isValidJsonResponse(reply) && reply.isObject() &&
        reply.isMember("status") && reply.isMember("message") &&
        reply["status"].isIntegral() && !reply["status"].isBool())
    {
        const Json::Value& message = reply["message"];
        std::string text = message.isString() ? message.asString() :
            Json::FastWriter().write(message);
        char shown[512];

        // A status that doesn't fit an int is no success either.
        int status = reply["status"].isUInt() && reply["status"].asUInt() <= 0x7fffffffu ?
            (int)reply["status"].asUInt() : -1;

        TLOG(LL_DBG, "status=%d message = %s\n", status,
            printableText(text.c_str(), shown, sizeof(shown)));
        return status;
    }

    TLOG(LL_ERR, "libAdapterUpdateFlash is failed.");
    return -1;
}

//------------------------------------------------------------------------------
// The download directory
//------------------------------------------------------------------------------

static const char DOWNLOAD_PREFIX[] = "vspr-update-";

String SoftwareUpdateHelper::makeDownloadDirectory()
{
    const char* base = getenv("TMPDIR");
    struct stat st;

    if (!base || base[0] != '/' || stat(base, &st) != 0 || !S_ISDIR(st.st_mode))
        base = "/tmp";

    String pattern(base);
    if (pattern.size() > 1 && pattern[pattern.size() - 1] == '/')
        pattern.remove(pattern.size() - 1);
    pattern.append("/");
    pattern.append(DOWNLOAD_PREFIX);
    pattern.append("XXXXXX");

    // mkdtemp makes it with mode 0700.
    char* name = strdup(pattern.c_str());

    if (!name || !mkdtemp(name))
    {
        TLOG(LL_ERR, "Cannot make a directory for the download (%s): %s",
            pattern.c_str(), strerror(errno));
        free(name);
        return String();
    }

    String dir(name);
    free(name);
    return dir;
}

// Empties the directory open at fd, depth first. Entries are opened relative
// to their parent with O_NOFOLLOW, so a link is removed as a link.
static void _emptyDirectory(int fd, int depth)
{
    DIR* d = fdopendir(fd);

    if (!d)
    {
        close(fd);
        return;
    }

    struct dirent* e;

    while ((e = readdir(d)) != 0)
    {
        if (strcmp(e->d_name, ".") == 0 || strcmp(e->d_name, "..") == 0)
            continue;

        if (unlinkat(dirfd(d), e->d_name, 0) == 0)
            continue;

        if (depth < 32)
        {
            int sub = openat(dirfd(d), e->d_name,
                O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC);

            if (sub >= 0)
                _emptyDirectory(sub, depth + 1);
        }

        if (unlinkat(dirfd(d), e->d_name, AT_REMOVEDIR) != 0)
            TLOG(LL_WARN, "Cannot remove %s from the download directory: %s",
                e->d_name, strerror(errno));
    }

    closedir(d);
}

void SoftwareUpdateHelper::removeDownloadDirectory(const String& dir)
{
    // Only what makeDownloadDirectory made: an absolute path whose last part
    // carries our prefix.
    const char* slash = strrchr(dir.c_str(), '/');

    if (dir.size() == 0 || dir[0] != '/' || !slash ||
        strncmp(slash + 1, DOWNLOAD_PREFIX, sizeof(DOWNLOAD_PREFIX) - 1) != 0)
    {
        TLOG(LL_ERR, "Not a download directory, left alone: %s", dir.c_str());
        return;
    }

    int fd = open(dir.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC);

    if (fd < 0)
    {
        TLOG(LL_WARN, "Cannot open the download directory %s: %s", dir.c_str(),
            strerror(errno));
        return;
    }

    _emptyDirectory(fd, 0);

    if (rmdir(dir.c_str()) != 0)
        TLOG(LL_WARN, "Cannot remove the download directory %s: %s", dir.c_str(),
            strerror(errno));
}

} // namespace OLMA
