// The associations of diagnostics: which tests an element can run, the
// diagnostic software behind them, and the latest job and its records with
// what they tested.

#include <cstdio>
#include <cstring>

#include "Associations.h"
#include "ProviderUtil.h"

#include "VESPERA_ConcreteJob.h"
#include "VESPERA_PortController.h"

#include "VESPERA_AffectedJobElement_Provider.h"
#include "VESPERA_AvailableDiagnosticServiceForAdapter_Provider.h"
#include "VESPERA_AvailableDiagnosticServiceForEthernetPort_Provider.h"
#include "VESPERA_AvailableDiagnosticServiceForFCPort_Provider.h"
#include "VESPERA_CompletionRecordAppliesToElement_Provider.h"
#include "VESPERA_DiagnosticElementSoftwareIdentity_Provider.h"
#include "VESPERA_OwningJobElement_Provider.h"
#include "VESPERA_ServiceRecordAppliesToElement_Provider.h"

namespace OLMA
{

namespace
{

// The associations that the diagnostic helper builds whole, as they are. A
// record or job whose element has gone since the run keeps an empty
// reference to it.
template<class A>
Enum_Instances_Status deliverBuilt(Enum_Instances_Handler<A>* handler, classId_t id,
    const char* none)
{
    return enumAssociation(handler, [&](Association_Sender&) {
        Array<Instance*> built = fetchInstances(id);

        if (built.size() == 0)
        {
            TLOG(LL_INFO, "%s", none);
            return ENUM_INSTANCES_OK;
        }

        TLOG(LL_DBG, "Building and returning association instances");
        deliverInstances(built, handler);
        return ENUM_INSTANCES_OK;
    });
}

// Each element with each test, the elements outer.
void sendEachWithEach(Association_Sender& out, const Instance_List& tests,
    const Instance_List& elements)
{
    for (size_t e = 0; e < elements.size() && out.open(); e++)
        sendOneWithEach(out, elements[e], tests, false);
}

} // namespace

Enum_Instances_Status VESPERA_AffectedJobElement_Provider::enum_instances(
    const VESPERA_AffectedJobElement*, Enum_Instances_Handler<VESPERA_AffectedJobElement>* handler)
{
    return deliverBuilt(handler, ID_VESPERA_AffectedJobElement,
        "Any affectedJobElement association could not be formed.");
}

Enum_Instances_Status VESPERA_ServiceRecordAppliesToElement_Provider::enum_instances(
    const VESPERA_ServiceRecordAppliesToElement*,
    Enum_Instances_Handler<VESPERA_ServiceRecordAppliesToElement>* handler)
{
    return deliverBuilt(handler, ID_VESPERA_ServiceRecordAppliesToElement,
        "No service records or managed elements are present.");
}

Enum_Instances_Status VESPERA_CompletionRecordAppliesToElement_Provider::enum_instances(
    const VESPERA_CompletionRecordAppliesToElement*,
    Enum_Instances_Handler<VESPERA_CompletionRecordAppliesToElement>* handler)
{
    return deliverBuilt(handler, ID_VESPERA_CompletionRecordAppliesToElement,
        "No completion records or managed elements are present.");
}

// A job is named by its test's full name, "-" and its number.
Enum_Instances_Status VESPERA_OwningJobElement_Provider::enum_instances(
    const VESPERA_OwningJobElement*, Enum_Instances_Handler<VESPERA_OwningJobElement>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List jobs(fetchInstances(ID_VESPERA_ConcreteJob));

        if (!present(jobs, LL_INFO, "No jobs are currently running in the system."))
            return ENUM_INSTANCES_OK;

        Instance_List tests(FCHBAManager::getFCHBAManager()->getAllDiagnosticTestInstances());

        for (size_t j = 0; j < jobs.size() && out.open(); j++)
        {
            const CIM_ManagedElement* job = jobs.get<CIM_ManagedElement>(j);

            if (!job)
                continue;

            char name[128];
            snprintf(name, sizeof(name), "%s", textOf(job->InstanceID).c_str());
            char* dash = strchr(name, '-');

            if (!dash)
            {
                TLOG(LL_INFO, "Unable to fetch Test Name form Job instance id : %s", name);
                continue;
            }

            *dash = '\0';

            for (size_t t = 0; t < tests.size(); t++)
            {
                const CIM_ManagedSystemElement* test = tests.get<CIM_ManagedSystemElement>(t);

                if (test && textOf(test->Name).equali(name))
                {
                    out.send(tests[t], jobs[j]);
                    break;
                }
            }
        }

        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_AvailableDiagnosticServiceForAdapter_Provider::enum_instances(
    const VESPERA_AvailableDiagnosticServiceForAdapter*,
    Enum_Instances_Handler<VESPERA_AvailableDiagnosticServiceForAdapter>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List adapters(fetchInstances(ID_VESPERA_PortController));

        if (!present(adapters, LL_WARN,
            "No adapters are present in the host for running dianostics."))
            return ENUM_INSTANCES_OK;

        Instance_List tests(FCHBAManager::getFCHBAManager()->getDiagnosticServicesForAdapter());

        if (present(tests, LL_WARN, "No diagnostic tests are available."))
            sendEachWithEach(out, tests, adapters);

        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_AvailableDiagnosticServiceForEthernetPort_Provider::enum_instances(
    const VESPERA_AvailableDiagnosticServiceForEthernetPort*,
    Enum_Instances_Handler<VESPERA_AvailableDiagnosticServiceForEthernetPort>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List ports(fetchInstances(ID_VESPERA_EthernetPort));

        if (!present(ports, LL_WARN, "No ethernet ports are present for running dianostics."))
            return ENUM_INSTANCES_OK;

        Instance_List tests(
            FCHBAManager::getFCHBAManager()->getDiagnosticServicesForEthernetPort());

        if (present(tests, LL_WARN, "No diagnostic tests are available."))
            sendEachWithEach(out, tests, ports);

        return ENUM_INSTANCES_OK;
    });
}

// A converged adapter's FC ports can't loop back inside the adapter.
Enum_Instances_Status VESPERA_AvailableDiagnosticServiceForFCPort_Provider::enum_instances(
    const VESPERA_AvailableDiagnosticServiceForFCPort*,
    Enum_Instances_Handler<VESPERA_AvailableDiagnosticServiceForFCPort>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        FCHBAManager* manager = FCHBAManager::getFCHBAManager();
        Instance_List adapters(fetchInstances(ID_VESPERA_PortController));

        if (!present(adapters, LL_WARN, "No adapters are available."))
            return ENUM_INSTANCES_OK;

        Instance_List tests(manager->getDiagnosticServicesForFCPort());

        if (!present(tests, LL_WARN, "No diagnostic tests are available."))
            return ENUM_INSTANCES_OK;

        String internal =
            ProviderUtil::getProviderUtil()->getDiagTestName(DIAG_INTERNAL_LOOPBACK_TEST);

        for (size_t a = 0; a < adapters.size() && out.open(); a++)
        {
            const VESPERA_PortController* adapter = adapters.get<VESPERA_PortController>(a);

            if (!adapter)
                continue;

            Instance_List ports(manager->getFCPortInstancesByAdapter(textOf(adapter->DeviceID)));

            if (!present(ports, LL_WARN,
                "No ports are present for running dianostics.Continue with remaining adapter"))
                continue;

            bool cna = !adapter->ControllerType.null && adapter->ControllerType.value == 1;

            if (cna)
                TLOG(LL_INFO, " The PortController is CNA");

            for (size_t p = 0; p < ports.size() && out.open(); p++)
            {
                for (size_t t = 0; t < tests.size() && out.open(); t++)
                {
                    const CIM_ManagedSystemElement* test = tests.get<CIM_ManagedSystemElement>(t);

                    if (cna && test && textOf(test->Name).equali(internal))
                        continue;

                    out.send(tests[t], ports[p]);
                }
            }
        }

        return ENUM_INSTANCES_OK;
    });
}

Enum_Instances_Status VESPERA_DiagnosticElementSoftwareIdentity_Provider::enum_instances(
    const VESPERA_DiagnosticElementSoftwareIdentity*,
    Enum_Instances_Handler<VESPERA_DiagnosticElementSoftwareIdentity>* handler)
{
    return enumAssociation(handler, [](Association_Sender& out) {
        Instance_List software(fetchInstances(ID_VESPERA_DiagnosticSoftwareIdentity));

        if (!present(software, LL_WARN, "No diagnostic softwares are installed."))
            return ENUM_INSTANCES_OK;

        if (software.size() > 1)
        {
            TLOG(LL_ERR, "Error: Invalid number of instances.");
            return ENUM_INSTANCES_FAILED;
        }

        Instance_List tests(FCHBAManager::getFCHBAManager()->getAllDiagnosticTestInstances());

        if (present(tests, LL_WARN, "No diagnostic services are available."))
            sendOneWithEach(out, software[0], tests);

        return ENUM_INSTANCES_OK;
    });
}

} // namespace OLMA
