// The associations of the interop model: the object manager and what it
// serves, and the profiles with what implements them.
//
// These classes are served in the interop namespace as well as the
// module's own, so each end names the namespace where its class answers:
// the request's for an interop class, the module's for the host.

#include "Associations.h"
#include "ServerManager.h"

#include "VESPERA_RegisteredProfile.h"

#include "VESPERA_CommMechHostedAccessPoint_Provider.h"
#include "VESPERA_CommMechanismForManager_Provider.h"
#include "VESPERA_ElementConformsToProfile_Provider.h"
#include "VESPERA_NamespaceInManager_Provider.h"
#include "VESPERA_ObjectManagerHostedService_Provider.h"
#include "VESPERA_ProfileElementSoftwareIdentity_Provider.h"
#include "VESPERA_SubProfileRequiresProfile_Provider.h"

namespace OLMA
{

namespace
{

Array<Instance*> fetchServerInstances(classId_t id)
{
    return ServerManager::getServerManager()->getInstances(id);
}

// The enumeration of a server association; the model carries the
// request's namespace.
template<class A, class Body>
Enum_Instances_Status enumServerAssociation(const A* model, Enum_Instances_Handler<A>* handler,
    Body body)
{
    String nameSpace = model ? model->__name_space : String();

    return enumAssociation(handler, [&](Association_Sender& out) {
        out.placeEnds(ServerManager::placeReference, nameSpace);
        return body(out);
    });
}

} // namespace

Enum_Instances_Status VESPERA_ObjectManagerHostedService_Provider::enum_instances(
    const VESPERA_ObjectManagerHostedService* model,
    Enum_Instances_Handler<VESPERA_ObjectManagerHostedService>* handler)
{
    return enumServerAssociation(model, handler, [](Association_Sender& out) {
        Instance_List systems(fetchInstances(ID_VESPERA_ComputerSystem));
        Instance_List managers(fetchServerInstances(ID_VESPERA_ObjectManager));

        if (systems.size() != 1 || managers.size() != 1)
        {
            TLOG(LL_ERR, "Invalid number of reference class instances");
            return ENUM_INSTANCES_FAILED;
        }

        out.send(systems[0], managers[0]);
        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_CommMechHostedAccessPoint_Provider::enum_instances(
    const VESPERA_CommMechHostedAccessPoint* model,
    Enum_Instances_Handler<VESPERA_CommMechHostedAccessPoint>* handler)
{
    return enumServerAssociation(model, handler, [](Association_Sender& out) {
        Instance_List systems(fetchInstances(ID_VESPERA_ComputerSystem));

        if (!exactlyOne(systems, "Invalid number of ComputerSystem instances"))
            return ENUM_INSTANCES_FAILED;

        Instance_List mechanisms(fetchServerInstances(ID_VESPERA_CIMXMLCommunicationMechanism));
        sendOneWithEach(out, systems[0], mechanisms);
        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_CommMechanismForManager_Provider::enum_instances(
    const VESPERA_CommMechanismForManager* model,
    Enum_Instances_Handler<VESPERA_CommMechanismForManager>* handler)
{
    return enumServerAssociation(model, handler, [](Association_Sender& out) {
        Instance_List managers(fetchServerInstances(ID_VESPERA_ObjectManager));

        if (!exactlyOne(managers, "Invalid number of ObjectManager instances"))
            return ENUM_INSTANCES_FAILED;

        Instance_List mechanisms(fetchServerInstances(ID_VESPERA_CIMXMLCommunicationMechanism));
        sendOneWithEach(out, managers[0], mechanisms);
        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_NamespaceInManager_Provider::enum_instances(
    const VESPERA_NamespaceInManager* model,
    Enum_Instances_Handler<VESPERA_NamespaceInManager>* handler)
{
    return enumServerAssociation(model, handler, [](Association_Sender& out) {
        Instance_List managers(fetchServerInstances(ID_VESPERA_ObjectManager));

        if (!exactlyOne(managers, "Invalid number of ObjectManager class instances"))
            return ENUM_INSTANCES_FAILED;

        Instance_List namespaces(fetchServerInstances(ID_VESPERA_Namespace));
        sendOneWithEach(out, managers[0], namespaces);
        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_ProfileElementSoftwareIdentity_Provider::enum_instances(
    const VESPERA_ProfileElementSoftwareIdentity* model,
    Enum_Instances_Handler<VESPERA_ProfileElementSoftwareIdentity>* handler)
{
    return enumServerAssociation(model, handler, [](Association_Sender& out) {
        Instance_List software(fetchServerInstances(ID_VESPERA_ProfileSoftwareIdentity));

        if (!exactlyOne(software, "Invalid number of ProfileSoftwareIdentity instances returned."))
            return ENUM_INSTANCES_FAILED;

        Instance_List profiles(fetchServerInstances(ID_VESPERA_RegisteredProfile));
        Instance_List subprofiles(fetchServerInstances(ID_VESPERA_RegisteredSubProfile));

        if (profiles.empty() || subprofiles.empty())
        {
            TLOG(LL_ERR, "Invalid number of Profile instances returned.");
            return ENUM_INSTANCES_FAILED;
        }

        sendOneWithEach(out, software[0], profiles);
        sendOneWithEach(out, software[0], subprofiles);
        return ENUM_INSTANCES_OK;
    });
}

// The profiles stand above what implements them, and the SMI-S standard
// above all profiles and subprofiles.
Enum_Instances_Status VESPERA_ElementConformsToProfile_Provider::enum_instances(
    const VESPERA_ElementConformsToProfile* model,
    Enum_Instances_Handler<VESPERA_ElementConformsToProfile>* handler)
{
    return enumServerAssociation(model, handler, [](Association_Sender& out) {
        Instance_List profiles(fetchServerInstances(ID_VESPERA_RegisteredProfile));

        if (profiles.empty())
        {
            TLOG(LL_ERR, "Error: No instances of RegisteredProfile class returned.");
            return ENUM_INSTANCES_FAILED;
        }

        Instance_List systems(fetchInstances(ID_VESPERA_ComputerSystem));
        Instance_List managers(fetchServerInstances(ID_VESPERA_ObjectManager));
        const Instance* system = systems.size() == 1 ? systems[0] : 0;
        const Instance* manager = managers.size() == 1 ? managers[0] : 0;

        for (size_t p = 0; p < profiles.size() && out.open(); p++)
        {
            const CIM_ManagedElement* profile = profiles.get<CIM_ManagedElement>(p);

            if (!profile)
                continue;

            String id = textOf(profile->InstanceID);
            TLOG(LL_INFO, "Building association instance for profile : %s", id.c_str());

            if (id.equali("FC HBA") || id.equali("Host Discovered Resources") ||
                id.equali("Storage HBA"))
            {
                if (system)
                    out.send(profiles[p], system);
                else
                    TLOG(LL_ERR, "Invalid number of ComputerSystem class instances");
            }
            else if (id.equali("Server"))
            {
                if (manager)
                    out.send(profiles[p], manager);
                else
                    TLOG(LL_ERR, "Invalid number of ObjectManager class instances");
            }
        }

        size_t standard = (size_t)-1;

        for (size_t p = 0; p < profiles.size() && standard == (size_t)-1; p++)
        {
            const CIM_RegisteredSpecification* profile =
                profiles.get<CIM_RegisteredSpecification>(p);

            if (profile && textOf(profile->RegisteredName).equali("SMI-S"))
                standard = p;
        }

        if (!out.open())
            return ENUM_INSTANCES_OK;

        if (standard == (size_t)-1)
        {
            TLOG(LL_ERR, "No instances representing SMI-S standard is returned");
            return ENUM_INSTANCES_FAILED;
        }

        for (size_t p = 0; p < profiles.size() && out.open(); p++)
        {
            if (p != standard)
                out.send(profiles[standard], profiles[p]);
        }

        Instance_List subprofiles(fetchServerInstances(ID_VESPERA_RegisteredSubProfile));
        sendOneWithEach(out, profiles[standard], subprofiles);
        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_SubProfileRequiresProfile_Provider::enum_instances(
    const VESPERA_SubProfileRequiresProfile* model,
    Enum_Instances_Handler<VESPERA_SubProfileRequiresProfile>* handler)
{
    return enumServerAssociation(model, handler, [](Association_Sender& out) {
        ServerManager* server = ServerManager::getServerManager();
        Instance_List profiles(fetchServerInstances(ID_VESPERA_RegisteredProfile));
        Instance_List subprofiles(fetchServerInstances(ID_VESPERA_RegisteredSubProfile));

        if (profiles.empty() || subprofiles.empty())
        {
            TLOG(LL_ERR, "Invalid number of instances");
            return ENUM_INSTANCES_FAILED;
        }

        for (size_t p = 0; p < profiles.size() && out.open(); p++)
        {
            const CIM_ManagedElement* profile = profiles.get<CIM_ManagedElement>(p);

            if (!profile)
                continue;

            Array<String> names = server->getSubProfilesOfProfile(textOf(profile->InstanceID));

            for (size_t s = 0; s < subprofiles.size() && out.open(); s++)
            {
                const CIM_ManagedElement* sub = subprofiles.get<CIM_ManagedElement>(s);

                for (size_t n = 0; sub && n < names.size(); n++)
                {
                    if (textOf(sub->InstanceID).equali(names[n]))
                    {
                        out.send(profiles[p], subprofiles[s]);
                        break;
                    }
                }
            }
        }

        return ENUM_INSTANCES_OK;
    });
}

} // namespace OLMA
