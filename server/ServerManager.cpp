#include "ServerManager.h"

#include <cstdio>
#include <cstring>
#include <strings.h>
#include "log.h"
#include "cimom.h"
#include "ProviderUtil.h"
#include "CIM_ObjectManager.h"
#include "VESPERA_RegisteredProfile.h"
#include "VESPERA_RegisteredSubProfile.h"
#include "VESPERA_Namespace.h"
#include "VESPERA_ObjectManager.h"
#include "VESPERA_CIMXMLCommunicationMechanism.h"
#include "VESPERA_ProfileSoftwareIdentity.h"
#include "VESPERA_AgentService.h"

#ifndef VSPR_BUILD_VERSION
#error "VSPR_BUILD_VERSION must be defined by the build"
#endif

namespace OLMA
{

const char prov_build_version[] = VSPR_BUILD_VERSION;

bool buildVersionNumbers(const char* version, uint16& major, uint16& minor, uint16& revision)
{
    int numbers[3] = { 0, 0, 0 };
    int n = version ? sscanf(version, "%d.%d.%d", &numbers[0], &numbers[1], &numbers[2]) : 0;
    if (n < 0)
        n = 0;
    // A negative or oversized field can't be a version number of the
    // software identity; show it as 0 rather than as a wrapped value.
    for (int i = 0; i < 3; i++)
    {
        if (i >= n || numbers[i] < 0 || numbers[i] > 0xFFFF)
            numbers[i] = 0;
    }
    major = (uint16)numbers[0];
    minor = (uint16)numbers[1];
    revision = (uint16)numbers[2];
    return n == 3;
}

namespace
{

// Where CIM servers keep their own object manager: OpenPegasus in the
// first, SFCB in the second.
const char* const INTEROP_NAMESPACES[] = { "root/PG_InterOp", "root/interop" };
const char SERVED_NAMESPACE[] = "root/vespera";
// The classes that are registered in the interop namespace too (the
// registrations that tools/gen_providers.py writes name the same ones).
const char* const INTEROP_CLASSES[] =
{
    "VESPERA_RegisteredProfile",
    "VESPERA_RegisteredSubProfile",
    "VESPERA_ProfileSoftwareIdentity",
    "VESPERA_Namespace",
    "VESPERA_CIMXMLCommunicationMechanism",
    "VESPERA_ElementConformsToProfile",
    "VESPERA_SubProfileRequiresProfile",
    "VESPERA_ProfileElementSoftwareIdentity",
    "VESPERA_CommMechanismForManager",
    "VESPERA_NamespaceInManager",
    "VESPERA_ObjectManagerHostedService",
    "VESPERA_CommMechHostedAccessPoint",
};
// What the object manager is called when the CIM server can't tell us.
const char CIM_SERVER[] = "CIM Server";

enum : uint16
{
    ORG_DMTF = 2,
    ORG_SNIA = 11,
    ADVERTISE_SLP = 3,
    STATUS_OK = 2,
};

struct Profile_Row
{
    const char* name;
    const char* elementName;
    uint16 organization;
    const char* version;
    const char* description;
};

const Profile_Row profileRows[] =
{
    { "SMI-S", "SMI-S", ORG_SNIA, "1.2.0",
      "This instance models the SMI-S standard as such" },
    { "FC HBA", "FC HBA Profile", ORG_SNIA, "1.2.0",
      "The FC HBA Profile models the HBA device" },
    { "Server", "Server Profile", ORG_SNIA, "1.2.0",
      "The Server Profile models the CIM Server" },
    { "Host Discovered Resources", "Host Discovered Resources Profile", ORG_SNIA, "1.2.0",
      "The HDR profile models the discovered storage resources" },
    { "Storage HBA", "Storage HBA Profile", ORG_SNIA, "1.3.0",
      "The Storage HBA Profile models the manageable elements of an HBA" },
};

const Profile_Row subProfileRows[] =
{
    { "FC Initiator Ports", "FC Initiator Ports subprofile", ORG_SNIA, "1.2.0",
      "The FC Initiator Ports subprofile models the ports present in the HBA device" },
    { "Profile Registration", "Profile Registration Profile", ORG_SNIA, "1.0.0",
      "The Profile Registration Profile models the profiles registered in the object manager." },
    { "Access Points", "Access Points subprofile", ORG_SNIA, "1.2.0",
      "This models the management service(s) points available to the user." },
    { "Software Update", "Software Update profile", ORG_DMTF, "1.0.0",
      "This models the software installation service available to the user." },
    { "Software Inventory", "Software Inventory profile", ORG_DMTF, "1.0.0",
      "This models the softwares installed and available for installation on the system." },
    { "Physical Asset", "Physical Asset profile", ORG_DMTF, "1.0.2",
      "This models the physical aspects of the adapter hardware." },
    { "Ethernet Port", "Ethernet Port profile", ORG_DMTF, "1.0.0",
      "This models the ethernet characteristics of the port present in the adapter." },
    { "Diagnostics Profile", "Diagnostics Profile", ORG_DMTF, "2.0.0",
      "This models the diagnostic services available for the adapters and its ports." },
    { "Host LAN Network Port", "Host LAN Network Port Profile", ORG_DMTF, "1.0.0",
      "This models the network interfaces associated with the network ports" },
    { "FCoE Initiator Ports", "FCoE Initiator Ports Profile", ORG_SNIA, "1.0.0",
      "This models the FCoE functionality of CNAs" },
};

// The profile tree; a profile that isn't listed has no subprofiles.
const char* const fcHbaSubProfiles[] =
{
    "FC Initiator Ports", "Software Update", "Software Inventory", "Access Points",
    "Physical Asset", "Ethernet Port", "Diagnostics Profile", "Host LAN Network Port", 0
};
const char* const serverSubProfiles[] = { "Profile Registration", 0 };
const char* const storageHbaSubProfiles[] = { "FCoE Initiator Ports", 0 };

struct Profile_Tree_Row
{
    const char* profile;
    const char* const* subProfiles;
};

const Profile_Tree_Row profileTree[] =
{
    { "FC HBA", fcHbaSubProfiles },
    { "Server", serverSubProfiles },
    { "Storage HBA", storageHbaSubProfiles },
};

const uint16 functionalProfiles[] = { 2, 3, 4, 5, 6, 8, 9 };

const char PROVIDER_IDENTITY[] = "Vespera Adapter CIM Provider";
const uint16 PROVIDER_CLASSIFICATION = 32775;
const char AGENT_SERVICE_NAME[] = "Vespera Agent Service Provider";

template<class T>
void putArray(Property<Array<T> >& property, const T* elements, size_t count)
{
    property.value.assign(elements, count);
    property.null = 0;
}

template<class T>
void putArray(Property<Array<T> >& property, const T& element)
{
    putArray(property, &element, 1);
}

void putStrings(Property<Array<String> >& property, const char* const* texts, size_t count)
{
    property.value.clear();
    for (size_t i = 0; i < count; i++)
        property.value.append(String(texts[i]));
    property.null = 0;
}

String className(classId_t id)
{
    return ProviderUtil::getProviderUtil()->getClassName(id);
}

String hostString()
{
    // getHostInfo copies as strncpy does, so the spare zero byte keeps the
    // text terminated even when the name fills the buffer.
    char host[256];
    memset(host, 0, sizeof(host));
    ProviderUtil::getProviderUtil()->getHostInfo(host, 255);
    return String(host);
}

enum Interop_Answer
{
    INTEROP_FAILED,
    INTEROP_EMPTY,
    INTEROP_FOUND,
};

// Asks the CIM server for its own object manager in one namespace. On
// INTEROP_FOUND the properties given take the first instance's ElementName,
// Description and Name, each with its null state; otherwise they are left
// alone.
Interop_Answer askObjectManagerIn(const char* nameSpace,
    Property<String>* elementName, Property<String>* description, Property<String>* name)
{
    CIM_ObjectManager* model = create<CIM_ObjectManager>(true);
    Interop_Answer answer = INTEROP_FAILED;
    {
        Instance_Enumerator e;
        if (cimom::enum_instances(nameSpace, model, e) != 0)
        {
            TLOG(LL_WARN, "Unable to enumerate CIM_ObjectManager in %s", nameSpace);
        }
        else if (!e)
        {
            TLOG(LL_INFO, "No CIM_ObjectManager in %s", nameSpace);
            answer = INTEROP_EMPTY;
        }
        else
        {
            Ref<Instance> first = e();
            const CIM_ObjectManager* om = checked_cast<CIM_ObjectManager>(first.ptr());
            if (om)
            {
                if (elementName)
                    *elementName = om->ElementName;
                if (description)
                    *description = om->Description;
                if (name)
                    *name = om->Name;
                answer = INTEROP_FOUND;
            }
            else
            {
                // Unreadable is as good as unanswered: the caller falls back
                // to the generic name.
                TLOG(LL_WARN, "The CIM server returned no usable CIM_ObjectManager from %s",
                    nameSpace);
            }
        }
    }
    destroy(model);
    return answer;
}

// The first interop namespace that the server can enumerate answers.
Interop_Answer askObjectManager(
    Property<String>* elementName, Property<String>* description, Property<String>* name)
{
    Interop_Answer answer = INTEROP_FAILED;
    for (size_t i = 0; answer == INTEROP_FAILED &&
        i < sizeof(INTEROP_NAMESPACES) / sizeof(INTEROP_NAMESPACES[0]); i++)
        answer = askObjectManagerIn(INTEROP_NAMESPACES[i], elementName, description, name);
    return answer;
}

// A key that the server left unnamed takes the generic name: a null key
// would make the instance unreachable.
void nameKey(Property<String>& key)
{
    if (key.null)
        key.set(CIM_SERVER);
}

} // namespace

ServerManager gServerManagerObj;
ServerManager* ServerManager::serverHelperObj = 0;

ServerManager::ServerManager()
{
    TLOG(LL_DBG, "ServerManager created");
}

ServerManager::~ServerManager()
{
}

ServerManager* ServerManager::getServerManager()
{
    if (!serverHelperObj)
        serverHelperObj = &gServerManagerObj;
    return serverHelperObj;
}

Array<Instance*> ServerManager::getInstances(classId_t id)
{
    TLOG(LL_INFO, "Requested classId : %d", (int)id);
    TLOG(LL_INFO, "Requested class is: %s", className(id).c_str());

    switch (id)
    {
        case ID_VESPERA_RegisteredProfile:
            return getRegisteredProfileInstances();
        case ID_VESPERA_RegisteredSubProfile:
            return getRegisteredSubProfileInstances();
        case ID_VESPERA_Namespace:
            return getNamespaceInstances();
        case ID_VESPERA_ObjectManager:
            return getObjectManagerInstance();
        case ID_VESPERA_CIMXMLCommunicationMechanism:
            return getCIMXMLCommunicationMechanismInstance();
        case ID_VESPERA_ProfileSoftwareIdentity:
            return getProfileSoftwareIdentityInstances();
        case ID_VESPERA_AgentService:
            return getAgentServiceInstances();
        default:
            TLOG(LL_INFO, "Requested class is NOT supported.");
            return Array<Instance*>();
    }
}

Array<String> ServerManager::getSubProfilesOfProfile(String name)
{
    Array<String> result;
    for (size_t i = 0; i < sizeof(profileTree) / sizeof(profileTree[0]); i++)
    {
        if (!name.equali(profileTree[i].profile))
            continue;
        for (const char* const* p = profileTree[i].subProfiles; *p; p++)
            result.append(String(*p));
        break;
    }
    return result;
}

bool ServerManager::isServedInInterop(const char* className)
{
    if (!className)
        return false;
    for (size_t i = 0; i < sizeof(INTEROP_CLASSES) / sizeof(INTEROP_CLASSES[0]); i++)
    {
        if (strcasecmp(className, INTEROP_CLASSES[i]) == 0)
            return true;
    }
    return false;
}

void ServerManager::placeReference(Instance* reference, const String& requestNamespace)
{
    if (!reference || !reference->meta_class)
        return;
    if (requestNamespace.size() == 0 || requestNamespace.equali(SERVED_NAMESPACE))
        return;
    if (isServedInInterop(reference->meta_class->name))
        reference->__name_space.clear();
    else
        reference->__name_space.assign(SERVED_NAMESPACE);
}

template<class T>
static void fillProfiles(Array<Instance*>& result, const Profile_Row* rows, size_t count)
{
    for (size_t i = 0; i < count; i++)
    {
        T* p = create<T>(true);
        p->InstanceID.set(rows[i].name);
        p->RegisteredName.set(rows[i].name);
        p->Caption.set(rows[i].elementName);
        p->ElementName.set(rows[i].elementName);
        p->RegisteredOrganization.set(rows[i].organization);
        p->RegisteredVersion.set(rows[i].version);
        p->Description.set(rows[i].description);
        putArray<uint16>(p->AdvertiseTypes, ADVERTISE_SLP);
        result.append(p);
    }
}

Array<Instance*> ServerManager::getRegisteredProfileInstances()
{
    Array<Instance*> result;
    fillProfiles<VESPERA_RegisteredProfile>(
        result, profileRows, sizeof(profileRows) / sizeof(profileRows[0]));
    return result;
}

Array<Instance*> ServerManager::getRegisteredSubProfileInstances()
{
    Array<Instance*> result;
    fillProfiles<VESPERA_RegisteredSubProfile>(
        result, subProfileRows, sizeof(subProfileRows) / sizeof(subProfileRows[0]));
    return result;
}

Array<Instance*> ServerManager::getNamespaceInstances()
{
    VESPERA_Namespace* ns = create<VESPERA_Namespace>(true);
    ns->SystemCreationClassName.set(className(ID_VESPERA_ComputerSystem));
    ns->SystemName.set(hostString());
    ns->ObjectManagerCreationClassName.set(className(ID_VESPERA_ObjectManager));
    ns->CreationClassName.set(className(ID_VESPERA_Namespace));
    ns->Name.set(SERVED_NAMESPACE);
    ns->ClassInfo.set(11);
    ns->ClassType.set(2);
    ns->ClassTypeVersion.set("2.26.0");

    askObjectManager(0, 0, &ns->ObjectManagerName);
    nameKey(ns->ObjectManagerName);

    Array<Instance*> result;
    result.append(ns);
    return result;
}

Array<Instance*> ServerManager::getObjectManagerInstance()
{
    VESPERA_ObjectManager* om = create<VESPERA_ObjectManager>(true);
    om->SystemCreationClassName.set(className(ID_VESPERA_ComputerSystem));
    om->SystemName.set(hostString());
    om->CreationClassName.set(className(ID_VESPERA_ObjectManager));
    om->ElementName.set(CIM_SERVER);
    putArray<uint16>(om->OperationalStatus, STATUS_OK);
    om->Started.set(true);

    if (askObjectManager(&om->Caption, &om->Description, &om->Name) == INTEROP_FAILED)
    {
        om->Name.set(CIM_SERVER);
        om->Caption.set(CIM_SERVER);
        om->Description.set(CIM_SERVER);
    }
    nameKey(om->Name);

    Array<Instance*> result;
    result.append(om);
    return result;
}

Array<Instance*> ServerManager::getCIMXMLCommunicationMechanismInstance()
{
    VESPERA_CIMXMLCommunicationMechanism* cm =
        create<VESPERA_CIMXMLCommunicationMechanism>(true);
    cm->SystemCreationClassName.set(className(ID_VESPERA_ComputerSystem));
    cm->SystemName.set(hostString());
    cm->CreationClassName.set(className(ID_VESPERA_CIMXMLCommunicationMechanism));
    cm->Name.set("CIM-XML");
    cm->ElementName.set("CIM-XML Communication Mechanism");
    cm->CommunicationMechanism.set(2);
    cm->Version.set("1.2");
    cm->CIMValidated.set(true);
    cm->MultipleOperationsSupported.set(true);
    putArray<uint16>(cm->FunctionalProfilesSupported, functionalProfiles,
        sizeof(functionalProfiles) / sizeof(functionalProfiles[0]));
    putArray<uint16>(cm->AuthenticationMechanismsSupported, 3);
    putArray<uint16>(cm->OperationalStatus, STATUS_OK);

    Array<Instance*> result;
    result.append(cm);
    return result;
}

Array<Instance*> ServerManager::getProfileSoftwareIdentityInstances()
{
    VESPERA_ProfileSoftwareIdentity* si = create<VESPERA_ProfileSoftwareIdentity>(true);
    si->InstanceID.set(PROVIDER_IDENTITY);
    si->Caption.set(PROVIDER_IDENTITY);
    si->ElementName.set(PROVIDER_IDENTITY);
    si->Description.set(PROVIDER_IDENTITY);
    si->Name.set("VSPR Adapter CIM provider");
    si->Manufacturer.set("VSPR");
    si->VersionString.set(prov_build_version);

    uint16 major, minor, revision;
    buildVersionNumbers(prov_build_version, major, minor, revision);
    si->MajorVersion.set(major);
    si->MinorVersion.set(minor);
    si->RevisionNumber.set(revision);

    putArray<uint16>(si->Classifications, PROVIDER_CLASSIFICATION);
    const char* const infoTypes[] = { "SoftwareID", "SoftwareStatus" };
    const char* const infoValues[] = { PROVIDER_IDENTITY, "Primary" };
    putStrings(si->IdentityInfoType, infoTypes, 2);
    putStrings(si->IdentityInfoValue, infoValues, 2);

    Array<Instance*> result;
    result.append(si);
    return result;
}

Array<Instance*> ServerManager::getAgentServiceInstances()
{
    VESPERA_AgentService* as = create<VESPERA_AgentService>(true);
    as->Name.set(AGENT_SERVICE_NAME);

    Array<Instance*> result;
    result.append(as);
    return result;
}

} // namespace OLMA
