#include "AccessPointHelper.h"

#include <stdio.h>
#include <string.h>

#include "ProviderUtil.h"
#include "Strings.h"
#include "log.h"

namespace OLMA
{

AccessPointHelper gAccessPointHelperObj;
AccessPointHelper* AccessPointHelper::helperObj = 0;

AccessPointHelper::AccessPointHelper()
{
}

AccessPointHelper* AccessPointHelper::getAccessPointHelperInstance()
{
    if (!helperObj)
        helperObj = &gAccessPointHelperObj;

    return helperObj;
}

Array<Instance*> AccessPointHelper::getInstancesByClass(classId_t id)
{
    (void)id;
    Array<Instance*> result;
    ProviderUtil* util = ProviderUtil::getProviderUtil();

    char host[255];
    memset(host, 0, sizeof(host));

    if (util->getHostInfo(host, sizeof(host) - 1) == 3)
    {
        TLOG(LL_WARN, "getHostInfo returned localhost");
        return result;
    }

    _adapterData data;
    memset(&data, 0, sizeof(data));
    strlcpy(data.hostName, host, sizeof(data.hostName));

    VESPERA_RemoteServiceAccessPoint* ap =
        getRemoteServiceAccessPointInstance(data);

    if (!ap)
        return result;

    result.append(ap);
    TLOG(LL_INFO, "Number of instances: %d", (int)result.size());
    return result;
}

VESPERA_RemoteServiceAccessPoint*
AccessPointHelper::getRemoteServiceAccessPointInstance(_adapterData data)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    unsigned int port = util->getAgentPort();

    if (port == 0)
    {
        TLOG(LL_WARN, "The ZARK Agent is not running so no service available");
        return 0;
    }

    // The record comes from a caller and need not be terminated.
    String host(data.hostName, strnlen(data.hostName, sizeof(data.hostName)));

    char portText[16];
    snprintf(portText, sizeof(portText), "%u", port);

    String access("https", ":", "//");
    access.append(host);
    access.append(":");
    access.append(portText);
    access.append("/");
    access.append("index.html");

    VESPERA_RemoteServiceAccessPoint* ap =
        create<VESPERA_RemoteServiceAccessPoint>(true);

    ap->SystemCreationClassName.set(
        util->getClassName(ID_VESPERA_ComputerSystem));
    ap->CreationClassName.set(
        util->getClassName(ID_VESPERA_RemoteServiceAccessPoint));
    ap->SystemName.set(host);
    ap->Name.set(String("ZARK Service"));
    ap->ElementName.set(String("Zark Manager Service Access Point"));
    ap->AccessInfo.set(access);
    ap->InfoFormat.set(200);

    return ap;
}

} // namespace OLMA
