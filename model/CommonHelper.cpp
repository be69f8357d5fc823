#include "CommonHelper.h"

#include <string.h>

#include "ProviderUtil.h"
#include "VESPERA_ComputerSystem.h"
#include "log.h"

namespace OLMA
{

CommonHelper gCommonHelperObj;
CommonHelper* CommonHelper::helperObj = 0;

CommonHelper::CommonHelper()
{
}

CommonHelper* CommonHelper::getCommonHelperObject()
{
    if (!helperObj)
        helperObj = &gCommonHelperObj;

    return helperObj;
}

static const char HOST_TEXT[] = "The host with Vespera's adapters installed.";

Array<Instance*> CommonHelper::getComputerSystemInstances(classId_t id)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();

    // One byte stays zero, so the text is terminated whatever its length.
    char host[255];
    memset(host, 0, sizeof(host));
    int code = util->getHostInfo(host, sizeof(host) - 1);

    VESPERA_ComputerSystem* cs = create<VESPERA_ComputerSystem>(true);
    String name(host);

    cs->Name.set(name);
    cs->CreationClassName.set(util->getClassName(id));

    Array<String> other;
    other.append(name);
    cs->OtherIdentifyingInfo.set(other);

    const char* nameFormat = 0;
    const char* description = 0;

    switch (code)
    {
        case 0:
            nameFormat = "IP";
            description = "Ipv4 Address";
            break;

        case 2:
            nameFormat = "Other";
            description = "Fully Qualified Domain Name";
            break;

        case 3:
            nameFormat = "Other";
            description = "Fully Qualified Domain Name";
            TLOG(LL_WARN, "No host IP / Name  retrived in the function, So "
                "function fills localhost for host info.");
            break;

        default:
            TLOG(LL_WARN, "Entered Default case ");
            break;
    }

    if (nameFormat)
    {
        cs->NameFormat.set(String(nameFormat));
        Array<String> descriptions;
        descriptions.append(String(description));
        cs->IdentifyingDescriptions.set(descriptions);
    }

    cs->ElementName.set(String(HOST_TEXT));
    cs->Description.set(String(HOST_TEXT));
    cs->Caption.set(String(HOST_TEXT));

    Array<uint16> dedicated;
    dedicated.append(0);
    dedicated.append(14);
    cs->Dedicated.set(dedicated);

    Array<uint16> status;
    status.append(2);
    cs->OperationalStatus.set(status);

    Array<String> statusText;
    statusText.append(String("The System is in service"));
    cs->StatusDescriptions.set(statusText);

    Array<Instance*> result;
    result.append(cs);
    return result;
}

} // namespace OLMA
