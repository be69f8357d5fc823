#include "DiagnosticHelper.h"

#include <string.h>

#include <map>
#include <string>

#include "AdapterHelper.h"
#include "CIMProviderTruj.h"
#include "EthernetPortHelper.h"
#include "PortHelper.h"
#include "ProviderUtil.h"
#include "log.h"

#include "CIM_LogicalDevice.h"
#include "VESPERA_CompletionRecordAppliesToElement.h"
#include "VESPERA_DiagnosticCompletionRecord.h"
#include "VESPERA_DiagnosticServiceRecord.h"
#include "VESPERA_DiagnosticSoftwareIdentity.h"
#include "VESPERA_EthLoopbackDiagnosticTest.h"
#include "VESPERA_LoopbackDiagnosticTest.h"
#include "VESPERA_MemoryDiagnosticTest.h"
#include "VESPERA_PCILoopbackDiagnosticTest.h"
#include "VESPERA_ServiceRecordAppliesToElement.h"

namespace OLMA
{

DiagnosticHelper gDiagnosticHelperObj;
DiagnosticHelper* DiagnosticHelper::diagHelperObj = 0;

DiagnosticTestInput::DiagnosticTestInput() :
    testId(DIAG_NONE), elementClass(ID_NONE), adapterId(0), frameCount(0),
    dataPattern(0), mode(0), speed(0), helper(0)
{
}

DiagnosticRecord::DiagnosticRecord() :
    isServiceRecord(true), recordType(0), elementClass(ID_NONE),
    completionState(DIAG_COMPL_STATE_OK)
{
}

DiagnosticJob::DiagnosticJob() :
    elementClass(ID_NONE), jobState(0), percentComplete(0)
{
}

DiagnosticRunResult::~DiagnosticRunResult()
{
    unref(job);
}

DiagnosticHelper::DiagnosticHelper() :
    nextRecordId(0), nextJobId(0), serviceRecordLock(true), completionRecordLock(true),
    jobLock(true), runLock(true), _stopping(false), _testProviders(0), _threadsRunning(0)
{
    for (int i = 0; i < SLOT_COUNT; i++)
        testThreadLive[i] = false;
}

DiagnosticHelper::~DiagnosticHelper()
{
    // The module is going: a test thread must not outlive its code, however
    // long its library call takes.
    stopTests(false);
}

DiagnosticHelper* DiagnosticHelper::getDiagnosticHelperObject()
{
    if (!diagHelperObj)
        diagHelperObj = &gDiagnosticHelperObj;

    return diagHelperObj;
}

//------------------------------------------------------------------------------
// The tests
//------------------------------------------------------------------------------

namespace
{

// The model whose adapters lack the external and the Ethernet tests.
const char* const NO_EXTERNAL_TESTS_MODEL = "Vespera-4096";

template<class T>
T* buildTest(DiagnosticHelper* helper, diag_test_id_t id, classId_t classId,
    const char* elementName)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    T* test = create<T>(true);

    char host[255];
    memset(host, 0, sizeof(host));
    util->getHostInfo(host, sizeof(host) - 1);

    test->Name.set(util->getDiagTestName(id));
    test->ElementName.set(elementName);
    test->SystemName.set(host);
    test->CreationClassName.set(util->getClassName(classId));
    test->SystemCreationClassName.set(util->getClassName(ID_VESPERA_ComputerSystem));
    test->Characteristics.set(helper->getDiagCharacteristics(id));
    test->OtherCharacteristicDescription.set("");
    return test;
}

Array<String> strings(const char* first, const char* second)
{
    Array<String> a;
    a.append(String(first));
    a.append(String(second));
    return a;
}

} // namespace

Array<uint16> DiagnosticHelper::getDiagCharacteristics(diag_test_id_t id)
{
    Array<uint16> c;

    // 2: "Is Exclusive"; 4: "Is Destructive"; 10: "Requires External
    // Equipment" (a loopback plug).
    c.append(2);

    switch (id)
    {
        case DIAG_MEMORY_TEST:
        case DIAG_INTERNAL_LOOPBACK_TEST:
        case DIAG_SERDES_LOOPBACK_TEST:
        case DIAG_SERDES_ETH_LOOPBACK_TEST:
            c.append(4);
            break;

        case DIAG_EXTERNAL_LOOPBACK_TEST:
        case DIAG_EXTERNAL_ETH_LOOPBACK_TEST:
            c.append(4);
            c.append(10);
            break;

        case DIAG_PCI_LOOPBACK_TEST:
            break;

        default:
            TLOG(LL_WARN, "WARNING! Control should never come here");
            break;
    }

    return c;
}

Instance* DiagnosticHelper::getMemoryDiagnosticTestInstance(diag_test_id_t id, classId_t classId)
{
    return buildTest<VESPERA_MemoryDiagnosticTest>(this, id, classId, "Memory Diagnostic Test");
}

Instance* DiagnosticHelper::getLoopbackDiagnosticTestInstance(diag_test_id_t id, classId_t classId)
{
    return buildTest<VESPERA_LoopbackDiagnosticTest>(this, id, classId,
        "Loopback Diagnostic Test");
}

Instance* DiagnosticHelper::getPCILoopbackDiagnosticTestInstance(diag_test_id_t id,
    classId_t classId)
{
    return buildTest<VESPERA_PCILoopbackDiagnosticTest>(this, id, classId,
        "PCI Loopback Diagnostic Test");
}

Instance* DiagnosticHelper::getEthLoopbackDiagnosticTestInstance(diag_test_id_t id,
    classId_t classId)
{
    return buildTest<VESPERA_EthLoopbackDiagnosticTest>(this, id, classId,
        "Eth Loopback Diagnostic Test");
}

Array<Instance*> DiagnosticHelper::getDiagnosticServices()
{
    TLOG(LL_DBG, "Entering: %s", "getDiagnosticServices");

    bool limited = ProviderUtil::getProviderUtil()->checkIfThisAdapterModelPresent(
        NO_EXTERNAL_TESTS_MODEL);
    Array<Instance*> result;

    result.append(getMemoryDiagnosticTestInstance(DIAG_MEMORY_TEST,
        ID_VESPERA_MemoryDiagnosticTest));
    result.append(getLoopbackDiagnosticTestInstance(DIAG_INTERNAL_LOOPBACK_TEST,
        ID_VESPERA_LoopbackDiagnosticTest));
    result.append(getLoopbackDiagnosticTestInstance(DIAG_SERDES_LOOPBACK_TEST,
        ID_VESPERA_LoopbackDiagnosticTest));

    if (!limited)
    {
        result.append(getLoopbackDiagnosticTestInstance(DIAG_EXTERNAL_LOOPBACK_TEST,
            ID_VESPERA_LoopbackDiagnosticTest));
        result.append(getEthLoopbackDiagnosticTestInstance(DIAG_SERDES_ETH_LOOPBACK_TEST,
            ID_VESPERA_EthLoopbackDiagnosticTest));
        result.append(getEthLoopbackDiagnosticTestInstance(DIAG_EXTERNAL_ETH_LOOPBACK_TEST,
            ID_VESPERA_EthLoopbackDiagnosticTest));
    }

    result.append(getPCILoopbackDiagnosticTestInstance(DIAG_PCI_LOOPBACK_TEST,
        ID_VESPERA_PCILoopbackDiagnosticTest));

    TLOG(LL_DBG, "Returning: %s", "getDiagnosticServices");
    return result;
}

Instance* DiagnosticHelper::getDiagnosticSoftwareIdentityInstance()
{
    VESPERA_DiagnosticSoftwareIdentity* si = create<VESPERA_DiagnosticSoftwareIdentity>(true);

    si->InstanceID.set("Vespera:Diagnostic");
    si->Caption.set("Diagnostic Software");
    si->Description.set("Diagnostic Software");
    si->ElementName.set("Diagnostic Software");
    si->Name.set("VSPR Diagnostic Software");
    si->Manufacturer.set("VSPR");
    si->VersionString.set(ProviderUtil::getProviderUtil()->getDriverVersion());
    si->MajorVersion.set(2);
    si->MinorVersion.set(2);
    si->RevisionNumber.set(0);
    si->BuildNumber.set(0);

    Array<uint16> classifications;
    classifications.append(7);
    si->Classifications.set(classifications);

    si->IdentityInfoType.set(strings("SoftwareID", "SoftwareStatus"));
    si->IdentityInfoValue.set(strings("Diagnostic Software for Vespera Adapter", "Primary"));
    return si;
}

//------------------------------------------------------------------------------
// The element a record or a job speaks of
//------------------------------------------------------------------------------

namespace
{

// The address that names the element of a class, or null for a class
// that no run tests.
const String* elementAddress(classId_t elementClass, const String& adapterAddress,
    const String& portWwn, const String& portMac)
{
    switch (elementClass)
    {
        case ID_VESPERA_PortController: return &adapterAddress;
        case ID_VESPERA_FCPort: return &portWwn;
        case ID_VESPERA_EthernetPort: return &portMac;
        default: return 0;
    }
}

} // namespace

// A clone of the instance of elementClass whose DeviceID is address
// (without regard to case), or null. Every instance fetched is released.
static Instance* findElement(classId_t elementClass, const String& address)
{
    Array<Instance*> all;

    switch (elementClass)
    {
        case ID_VESPERA_PortController:
            all = AdapterHelper::getAdapterHelperInstance()->getInstancesByClass(elementClass);
            break;
        case ID_VESPERA_FCPort:
            all = PortHelper::getPortHelperObject()->getInstancesByClass(elementClass);
            break;
        case ID_VESPERA_EthernetPort:
            all = EthernetPortHelper::getEthernetPortHelperObject()->getInstancesByClass(
                elementClass);
            break;
        default:
            return 0;
    }

    Instance* found = 0;

    for (size_t i = 0; i < all.size(); i++)
    {
        const CIM_LogicalDevice* device = checked_cast<CIM_LogicalDevice>(
            static_cast<const Instance*>(all[i]));

        if (!found && device && !device->DeviceID.null &&
            device->DeviceID.value.equali(address))
            found = clone(all[i]);

        if (all[i])
            destroy(all[i]);
    }

    return found;
}

Instance* DiagnosticHelper::getManagedElementInstance(DiagnosticRecord record)
{
    const String* address = elementAddress(record.elementClass, record.adapterAddress,
        record.portWwn, record.portMac);

    return address ? findElement(record.elementClass, *address) : 0;
}

String DiagnosticHelper::getManagedElementName(DiagnosticRecord record)
{
    Instance* element = getManagedElementInstance(record);

    if (!element)
        return String();

    const CIM_ManagedElement* me = checked_cast<CIM_ManagedElement>(
        static_cast<const Instance*>(element));
    String name = me && !me->ElementName.null ? me->ElementName.value : String();
    destroy(element);
    return name;
}

namespace
{

Instance* recordInstance(const DiagnosticRecord& record, const String& elementName)
{
    CIM_DiagnosticRecord* r;

    if (record.isServiceRecord)
    {
        VESPERA_DiagnosticServiceRecord* s = create<VESPERA_DiagnosticServiceRecord>(true);
        s->Caption.set("Diagnostic Service Record");
        s->ElementName.set("Diagnostic Service Record");
        s->Description.set("This represents the data generated by the diagnostic service run");
        r = s;
    }
    else
    {
        VESPERA_DiagnosticCompletionRecord* c = create<VESPERA_DiagnosticCompletionRecord>(true);
        c->Caption.set("Diagnostic Completion Record");
        c->ElementName.set("Diagnostic Completion Record");
        c->Description.set(
            "This represents the results generated by the diagnostic service run");
        c->CompletionState.set((uint16)record.completionState);
        r = c;
    }

    r->InstanceID.set(record.instanceId);
    r->CreationTimeStamp.set(record.timeStamp);
    r->RecordData.set(record.recordData);
    r->ServiceName.set(record.serviceName);
    r->ManagedElementName.set(elementName);
    r->RecordType.set(record.recordType);
    r->RecordFormat.set("");
    return r;
}

} // namespace

Instance* DiagnosticHelper::getDiagnosticRecordInstance(DiagnosticRecord record)
{
    return recordInstance(record, getManagedElementName(record));
}

//------------------------------------------------------------------------------
// Record instances. The list is copied under its lock and the elements are
// fetched after: a fetch asks the library, and a test thread that wants to
// add a record must not wait for that. Each element is fetched once per
// enumeration, however many records name it.
//------------------------------------------------------------------------------

namespace
{

struct Element_Cache
{
    std::map<std::string, Instance*> found;

    ~Element_Cache()
    {
        for (auto& e : found)
            destroyer(e.second);
    }

    // Borrowed: the cache keeps it.
    const Instance* get(const DiagnosticRecord& r)
    {
        const String* address = elementAddress(r.elementClass, r.adapterAddress,
            r.portWwn, r.portMac);

        if (!address)
            return 0;

        std::string key = std::to_string((int)r.elementClass) + "|" + address->c_str();

        for (char& c : key)
            c = (char)tolower((unsigned char)c);

        auto at = found.find(key);

        if (at == found.end())
            at = found.emplace(key, findElement(r.elementClass, *address)).first;

        return at->second;
    }
};

} // namespace

std::vector<DiagnosticRecord> DiagnosticHelper::getRecords(bool service)
{
    Mutex& lock = service ? serviceRecordLock : completionRecordLock;
    Auto_Mutex hold(lock);
    return service ? serviceRecords : completionRecords;
}

Array<Instance*> DiagnosticHelper::_recordInstances(bool service, bool associations)
{
    std::vector<DiagnosticRecord> records = getRecords(service);
    Element_Cache elements;
    Array<Instance*> result;

    for (const DiagnosticRecord& r : records)
    {
        const Instance* element = elements.get(r);
        const CIM_ManagedElement* me = checked_cast<CIM_ManagedElement>(element);
        String name = me && !me->ElementName.null ? me->ElementName.value : String();
        Instance* record = recordInstance(r, name);

        if (!associations)
        {
            result.append(record);
            continue;
        }

        CIM_RecordAppliesToElement* a = service ?
            (CIM_RecordAppliesToElement*)create<VESPERA_ServiceRecordAppliesToElement>(true) :
            (CIM_RecordAppliesToElement*)create<VESPERA_CompletionRecordAppliesToElement>(true);
        a->Antecedent = (CIM_ManagedElement*)record;
        a->Dependent = element ? (CIM_ManagedElement*)clone(element) : 0;
        result.append(a);
    }

    return result;
}

Array<Instance*> DiagnosticHelper::getDiagnosticServiceRecordInstances()
{
    return _recordInstances(true, false);
}

Array<Instance*> DiagnosticHelper::getDiagnosticCompletionRecordInstances()
{
    return _recordInstances(false, false);
}

Array<Instance*> DiagnosticHelper::getServiceRecordAppliesToElementInstances()
{
    return _recordInstances(true, true);
}

Array<Instance*> DiagnosticHelper::getCompletionRecordAppliesToElementInstances()
{
    return _recordInstances(false, true);
}

//------------------------------------------------------------------------------

Array<Instance*> DiagnosticHelper::getInstancesByClass(classId_t classId)
{
    ProviderUtil* util = ProviderUtil::getProviderUtil();
    TLOG(LL_INFO, "Requested Class : %s", util->getClassName(classId).c_str());

    Json::Value reply;

    try
    {
        reply = libGetAllAdaptersIndexString(Json::Value());
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "libGetAllAdaptersIndexString got User exception %d: %s",
            e.getCode(), e.getMessage().c_str());
        reply = Json::Value();
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "libGetAllAdaptersIndexString got std exception: %s", e.what());
        reply = Json::Value();
    }
    catch (...)
    {
        TLOG(LL_ERR, "libGetAllAdaptersIndexString got default exception");
        reply = Json::Value();
    }

    if (!ProviderUtil::isValidJsonResponse(reply) || !reply.isObject() ||
        !reply["indexStrings"].isArray())
    {
        TLOG(LL_ERR, "libGetAllAdaptersIndexString returns NULL.");
        return Array<Instance*>();
    }

    if (reply["indexStrings"].size() == 0)
    {
        TLOG(LL_WARN, "No adapters in the system for running diagnostics.");
        return Array<Instance*>();
    }

    Array<Instance*> result;

    switch (classId)
    {
        case ID_VESPERA_MemoryDiagnosticTest:
            result.append(getMemoryDiagnosticTestInstance(DIAG_MEMORY_TEST, classId));
            break;

        case ID_VESPERA_LoopbackDiagnosticTest:
        {
            bool limited = util->checkIfThisAdapterModelPresent(NO_EXTERNAL_TESTS_MODEL);
            result.append(getLoopbackDiagnosticTestInstance(DIAG_INTERNAL_LOOPBACK_TEST,
                classId));
            if (!limited)
                result.append(getLoopbackDiagnosticTestInstance(DIAG_EXTERNAL_LOOPBACK_TEST,
                    classId));
            result.append(getLoopbackDiagnosticTestInstance(DIAG_SERDES_LOOPBACK_TEST,
                classId));
            break;
        }

        case ID_VESPERA_PCILoopbackDiagnosticTest:
            result.append(getPCILoopbackDiagnosticTestInstance(DIAG_PCI_LOOPBACK_TEST, classId));
            break;

        case ID_VESPERA_EthLoopbackDiagnosticTest:
            if (!util->checkIfThisAdapterModelPresent(NO_EXTERNAL_TESTS_MODEL))
            {
                result.append(getEthLoopbackDiagnosticTestInstance(
                    DIAG_EXTERNAL_ETH_LOOPBACK_TEST, classId));
                result.append(getEthLoopbackDiagnosticTestInstance(
                    DIAG_SERDES_ETH_LOOPBACK_TEST, classId));
            }
            break;

        case ID_VESPERA_DiagnosticSoftwareIdentity:
            result.append(getDiagnosticSoftwareIdentityInstance());
            break;

        case ID_VESPERA_ConcreteJob:
            return getDiagnosticJobInstances();

        case ID_VESPERA_DiagnosticServiceRecord:
            return getDiagnosticServiceRecordInstances();

        case ID_VESPERA_DiagnosticCompletionRecord:
            return getDiagnosticCompletionRecordInstances();

        case ID_VESPERA_AffectedJobElement:
            return getDiagnosticAffectedJobElementInstances();

        case ID_VESPERA_ServiceRecordAppliesToElement:
            return getServiceRecordAppliesToElementInstances();

        case ID_VESPERA_CompletionRecordAppliesToElement:
            return getCompletionRecordAppliesToElementInstances();

        default:
            TLOG(LL_WARN, "Not supported class is requested.");
            break;
    }

    return result;
}

} // namespace OLMA
