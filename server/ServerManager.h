#ifndef _OLMA_ServerManager_h
#define _OLMA_ServerManager_h

// The interop side of the module: registered profiles and subprofiles, the
// object manager with its namespace and communication mechanism, the
// provider's own software identity and the agent service. Apart from the
// host string and what the CIM server says about itself, these are fixed
// tables; nothing here touches the adapter library.

#include "config.h"
#include "String.h"
#include "Array.h"
#include "Instance.h"
#include "ProviderTypes.h"

namespace OLMA
{

// The provider's build version, fixed when the module is built.
extern const char prov_build_version[];

// Reads the first three numbers of a build version ("3.2.1.0_beta_bld01"
// gives 3, 2, 1). Numbers that can't be read are 0; the result tells whether
// all three were there.
bool buildVersionNumbers(const char* version, uint16& major, uint16& minor, uint16& revision);

class ServerManager
{
public:
    ServerManager();
    ~ServerManager();

    static ServerManager* getServerManager();

    // New instances of one of the classes served here (10 to 15 and 37);
    // the caller owns them. Any other id gives an empty array.
    Array<Instance*> getInstances(classId_t id);

    // The RegisteredName texts of the subprofiles of a profile, whose name
    // is compared without regard to case.
    Array<String> getSubProfilesOfProfile(String name);

    Array<Instance*> getRegisteredProfileInstances();
    Array<Instance*> getRegisteredSubProfileInstances();
    Array<Instance*> getNamespaceInstances();
    Array<Instance*> getObjectManagerInstance();
    Array<Instance*> getCIMXMLCommunicationMechanismInstance();
    Array<Instance*> getProfileSoftwareIdentityInstances();
    Array<Instance*> getAgentServiceInstances();

    // The profile classes are served in the CIM server's interop namespace
    // as well as in root/vespera; every other class only in root/vespera.
    static bool isServedInInterop(const char* className);

    // Makes a reference built while serving a request in requestNamespace
    // point where its instance can be had: an interop class answers in the
    // request's namespace (the reference keeps none of its own), any other
    // class only in root/vespera. A request in root/vespera changes nothing.
    static void placeReference(Instance* reference, const String& requestNamespace);

private:
    static ServerManager* serverHelperObj;
};

} // namespace OLMA

#endif // _OLMA_ServerManager_h
