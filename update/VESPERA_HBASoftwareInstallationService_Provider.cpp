#include "VESPERA_HBASoftwareInstallationService_Provider.h"

#include <string.h>
#include <strings.h>

#include "InstanceDelivery.h"
#include "ProviderUtil.h"
#include "SingleInstance.h"
#include "SoftwareUpdateHelper.h"
#include "Subprocess.h"
#include "VESPERA_PortController.h"
#include "log.h"

namespace OLMA
{

Enum_Instances_Status VESPERA_HBASoftwareInstallationService_Provider::enum_instances(
    const VESPERA_HBASoftwareInstallationService*,
    Enum_Instances_Handler<VESPERA_HBASoftwareInstallationService>* handler)
{
    return enumSingleInstance(ID_VESPERA_HBASoftwareInstallationService, handler);
}

//------------------------------------------------------------------------------
// InstallFromURI
//------------------------------------------------------------------------------

namespace
{

// The download's directory lives exactly as long as the call: the image is
// written to the flash from there and goes with it.
struct DownloadDirectory
{
    String path;
    ~DownloadDirectory()
    {
        if (path.size())
            SoftwareUpdateHelper::removeDownloadDirectory(path);
    }
};

struct AdapterList
{
    Array<Instance*> instances;
    ~AdapterList() { destroyInstances(instances); }
};

const char EMPTY_INPUT[] = "empty input parameters";
const char MALFORMED_TFTP[] = "malformed tftp URI";

// URI schemes are case-insensitive.
bool hasScheme(const String& uri, const char* scheme)
{
    return uri.size() >= 7 && strncasecmp(uri.c_str(), scheme, 7) == 0;
}

// The steps of the method, in order; the text of the first failure, or null
// once the adapter took the image.
const char* install(const Property<String>& URI, const CIM_ManagedElement* Target,
    const Property<Array<uint16> >& InstallOptions, DownloadDirectory& download)
{
    char shown[512];

    if (URI.null || URI.value.size() == 0)
    {
        TLOG(LL_ERR, "URI.value is empty");
        return EMPTY_INPUT;
    }

    if (!Target)
    {
        TLOG(LL_ERR, "Target is empty");
        return EMPTY_INPUT;
    }

    if (InstallOptions.null || InstallOptions.value.size() == 0)
    {
        TLOG(LL_ERR, "InstallOptions.value.size() is  0");
        return EMPTY_INPUT;
    }

    // Install (4) or update (5); only the first option counts.
    uint16 option = InstallOptions.value[0];

    if (option != 4 && option != 5)
    {
        TLOG(LL_ERR, "InstallOptions[0] validation failed. throw invalide option type");
        return "invalid option type";
    }

    const String& uri = URI.value;
    String file;

    if (hasScheme(uri, "file://"))
    {
        file = uri.substr(7);
        TLOG(LL_INFO, "file=%s", printableText(file.c_str(), shown, sizeof(shown)));

        if (file.size() == 0)
            return "malformed file URI";
    }
    else if (!hasScheme(uri, "tftp://"))
    {
        TLOG(LL_ERR, "malformed uri. Throw error");
        return "malformed URI";
    }
    else
    {
        String rest = uri.substr(7);
        size_t slash = rest.find('/');

        // A host has at least two characters.
        if (slash == (size_t)-1 || slash < 2)
            return MALFORMED_TFTP;

        String host = rest.substr(0, slash);
        String path = rest.substr(slash + 1);

        if (path.size() == 0)
            return MALFORMED_TFTP;

        // Both go to the tftp client as its arguments. Only a plain host and
        // a plain relative path do, so that neither can read as an option
        // nor name anything outside the download directory.
        if (!ProviderUtil::isPlainHost(host.c_str()))
        {
            TLOG(LL_ERR, "tftp host refused: \"%s\"",
                printableText(host.c_str(), shown, sizeof(shown)));
            return MALFORMED_TFTP;
        }

        if (!ProviderUtil::isSafeRelativePath(path.c_str()))
        {
            TLOG(LL_ERR, "tftp file name refused: \"%s\"",
                printableText(path.c_str(), shown, sizeof(shown)));
            return MALFORMED_TFTP;
        }

        download.path = SoftwareUpdateHelper::makeDownloadDirectory();

        if (download.path.size() == 0 ||
            ProviderUtil::getProviderUtil()->TftpGetFile(
                host.c_str(), path.c_str(), download.path.c_str(), file) != 0)
            return "tftp command failed";
    }

    if (!ProviderUtil::getProviderUtil()->IsFileExist(file.c_str()))
    {
        TLOG(LL_ERR, "File doesnt exist");
        return "File not exists";
    }

    AdapterList adapters;
    adapters.instances = FCHBAManager::getFCHBAManager()->getInstances(ID_VESPERA_PortController);
    const VESPERA_PortController* adapter = 0;

    // Keys compared both ways, so that a Target of a class with fewer keys
    // (or none) can't match by default.
    for (size_t i = 0; i < adapters.instances.size() && !adapter; i++)
    {
        const VESPERA_PortController* candidate =
            checked_cast<VESPERA_PortController>(adapters.instances[i]);

        if (candidate && key_eq(candidate, Target) && key_eq(Target, candidate))
            adapter = candidate;
    }

    if (!adapter)
    {
        TLOG(LL_ERR, "Couldnt find the matching port controller.");
        return "Could not find target controller";
    }

    if (SoftwareUpdateHelper::getSoftwareUpdateHelperInstance()->
            UpdatePortControllerSoftware(adapter, file.c_str()) != 0)
    {
        TLOG(LL_ERR, "UpdatePortControllerSoftware method failed");
        return "controller update failed";
    }

    return 0;
}

} // namespace

// One synchronous call: it returns when the adapter has taken the image or
// refused it, which may take as long as the flash does. The outcome is in
// return_value alone (0 success, 2 failure); the reasons go to the log.
Invoke_Method_Status VESPERA_HBASoftwareInstallationService_Provider::InstallFromURI(
    const VESPERA_HBASoftwareInstallationService*,
    CIM_ConcreteJob*&,
    const Property<String>& URI,
    const CIM_ManagedElement* Target,
    const Property<Array<uint16> >& InstallOptions,
    const Property<Array<String> >&,
    Property<uint32>& return_value)
{
    TLOG(LL_DBG, "Entering: %s", "InstallFromURI");

    uint32 result = 2;

    try
    {
        DownloadDirectory download;
        const char* failure = install(URI, Target, InstallOptions, download);

        if (failure)
            TLOG(LL_DBG, "InstallFromURI : ERROR - %s", failure);
        else
        {
            TLOG(LL_DBG, "Software update is success");
            result = 0;
        }
    }
    catch (...)
    {
        TLOG(LL_DBG, "InstallFromURI : ERROR - unknown Exception");
    }

    return_value.set(result);
    TLOG(LL_DBG, "return value = %d\n", (int)result);
    TLOG(LL_DBG, "Returning: %s", "InstallFromURI");
    return INVOKE_METHOD_OK;
}

} // namespace OLMA
