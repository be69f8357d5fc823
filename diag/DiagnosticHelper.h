#ifndef _VSPR_DiagnosticHelper_h
#define _VSPR_DiagnosticHelper_h

#include <json/json.h>

#include <atomic>
#include <vector>

#include "Array.h"
#include "Datetime.h"
#include "Instance.h"
#include "Mutex.h"
#include "ProviderTypes.h"
#include "String.h"
#include "Thread.h"

#include "VESPERA_ConcreteJob.h"

namespace OLMA
{

class DiagnosticHelper;

// CompletionState of a record: the only two values the runs give.
enum diag_compl_record_state_t
{
    DIAG_COMPL_STATE_OK = 2,
    DIAG_COMPL_STATE_FAILED = 5
};

// JobState of a job.
enum
{
    DIAG_JOB_RUNNING = 4,
    DIAG_JOB_COMPLETED = 7
};

// What RunDiagnostic answers; the values are those of its value map.
enum
{
    RUN_DIAG_RETURN_UNSUPPORTED = 1,
    RUN_DIAG_RETURN_BUSY = 4,
    RUN_DIAG_RETURN_INVALID = 5,
    RUN_DIAG_RETURN_STARTED = 4096
};

// What a runner hands to its test thread. Made on the heap by the runner;
// the thread owns it from its start.
struct DiagnosticTestInput
{
    DiagnosticTestInput();

    diag_test_id_t testId;
    String jobId;
    classId_t elementClass;
    uint32 adapterId;
    String adapterAddress;
    String portWwn;
    String portMac;
    uint32 frameCount;
    uint32 dataPattern;
    uint32 mode;
    uint32 speed;
    DiagnosticHelper* helper;
};

// One line of a diagnostic log.
struct DiagnosticRecord
{
    DiagnosticRecord();

    bool isServiceRecord;
    String instanceId;
    Datetime timeStamp;
    String recordData;
    String serviceName;
    String managedElementName;
    uint16 recordType;
    classId_t elementClass;
    String adapterAddress;
    String portWwn;
    String portMac;
    diag_compl_record_state_t completionState;
};

// The latest job. jobRef is the reference instance (only InstanceID set)
// that RunDiagnostic hands out; copies share it.
struct DiagnosticJob
{
    DiagnosticJob();

    Ref<VESPERA_ConcreteJob> jobRef;
    String name;
    classId_t elementClass;
    uint16 jobState;
    Datetime startTime;
    Datetime elapsedTime;
    uint16 percentComplete;
    String adapterAddress;
    String portWwn;
    String portMac;
};

// What a runner answers; the caller owns it and the job reference in it.
struct DiagnosticRunResult
{
    DiagnosticRunResult() : job(0), status(0) { }
    ~DiagnosticRunResult();

    VESPERA_ConcreteJob* job;
    uint32 status;

private:
    DiagnosticRunResult(const DiagnosticRunResult&);
    DiagnosticRunResult& operator=(const DiagnosticRunResult&);
};

// Everything about diagnostics: the tests the host offers and their CIM
// instances, the one job and the two record lists, and the test threads.
//
// One test runs at a time in the whole module. A runner checks and starts a
// run under runLock, so two requests that come together can't both start
// one; the lists have a lock each, and no code holds two of them at once.
// The test thread is joined before the next one starts, and when the last
// test provider unloads (or the module goes), so that no thread is left
// running in code that may be unmapped: an unload stops the test at its
// next step, and one that stays in the library past a bound keeps the
// module mapped until it is done.
class DiagnosticHelper
{
public:

    DiagnosticHelper();
    ~DiagnosticHelper();

    static DiagnosticHelper* getDiagnosticHelperObject();

    // The test model.
    Array<uint16> getDiagCharacteristics(diag_test_id_t id);
    Instance* getMemoryDiagnosticTestInstance(diag_test_id_t id, classId_t classId);
    Instance* getLoopbackDiagnosticTestInstance(diag_test_id_t id, classId_t classId);
    Instance* getPCILoopbackDiagnosticTestInstance(diag_test_id_t id, classId_t classId);
    Instance* getEthLoopbackDiagnosticTestInstance(diag_test_id_t id, classId_t classId);
    Array<Instance*> getDiagnosticServices();
    Instance* getDiagnosticSoftwareIdentityInstance();
    Instance* getManagedElementInstance(DiagnosticRecord record);
    String getManagedElementName(DiagnosticRecord record);
    Instance* getDiagnosticRecordInstance(DiagnosticRecord record);
    Array<Instance*> getInstancesByClass(classId_t classId);

    // Jobs and records.
    DiagnosticJob createDiagnosticJob(DiagnosticTestInput* input);
    void addDiagnosticJob(DiagnosticJob job);
    bool isAnyJobRunning();
    void updateJobState(String jobId);
    Instance* getConcreteJobInstance(DiagnosticJob job);
    Array<Instance*> getDiagnosticJobInstances();
    Array<Instance*> getDiagnosticAffectedJobElementInstances();
    void generateDiagnosticRecord(String text, bool isServiceRecord,
        DiagnosticTestInput* input, diag_compl_record_state_t state);
    void addDiagnosticRecord(DiagnosticRecord record);
    String getInstanceIDForRecord(String jobId);
    Array<Instance*> getDiagnosticServiceRecordInstances();
    Array<Instance*> getDiagnosticCompletionRecordInstances();
    Array<Instance*> getServiceRecordAppliesToElementInstances();
    Array<Instance*> getCompletionRecordAppliesToElementInstances();

    // Copies for the associations: the job (false if there is none) and
    // the records of one list, taken under their lock.
    bool getLatestJob(DiagnosticJob& job);
    std::vector<DiagnosticRecord> getRecords(bool serviceRecords);

    uint32 getNextJobID();
    uint32 getNextRecordID();

    // The runners, on the request's thread.
    DiagnosticRunResult* runMemoryTest(String adapterAddress);
    DiagnosticRunResult* runPCILoopbackTest(String portAddress);
    DiagnosticRunResult* runLoopbackTest(String portAddress, String testName);
    DiagnosticRunResult* runEthLoopbackTest(String portAddress, String testName);

    // The thread functions; each takes a DiagnosticTestInput.
    static void* runMemoryTestThread(void* input);
    static void* runPCILoopbackTestThread(void* input);
    static void* runLoopbackTestThread(void* input);
    static void* runEthLoopbackTestThread(void* input);

    // The four test providers count themselves in and out; when the last
    // goes, a running test is stopped and its thread joined.
    void testProviderLoaded();
    void testProviderUnloaded();

    // Stops a running test at its next step, lets it restore its port or
    // adapter and complete its job, and joins it; nothing is started
    // meanwhile. A library call in flight can't be cut short: bounded, the
    // wait ends after STOP_WAIT_MS, and a test still in the library then
    // goes on by itself while the module is kept mapped for it.
    void stopTests(bool bounded = true);

    enum { STOP_WAIT_MS = 5000 };

    // The last thing a test thread does in the run.
    void testThreadEnded() { --_threadsRunning; }

    // For the threads: whether to cut the run short, and a pause that ends
    // early when so.
    bool stopRequested() const { return _stopping.load(); }
    void pause(uint32 seconds);

    static DiagnosticHelper* diagHelperObj;

private:

    // Which of the three handles a run uses.
    enum Test_Slot
    {
        SLOT_MEMORY_PCI = 0,
        SLOT_LOOPBACK = 1,
        SLOT_ETH_LOOPBACK = 2,
        SLOT_COUNT = 3
    };

    // The common end of a runner; runLock is held.
    void _startRun(DiagnosticRunResult* result, DiagnosticTestInput* input,
        Test_Slot slot, void* (*proc)(void*));

    // Joins every test thread that was started and not yet joined.
    void _joinFinished();

    // Lets the test threads go without a join, and keeps the module's code
    // mapped for them whatever the server unloads.
    void _letGo();

    // Builds record instances from copies, fetching each element once.
    Array<Instance*> _recordInstances(bool serviceRecords, bool associations);

    std::atomic<uint32> nextRecordId;
    std::atomic<uint32> nextJobId;

    Thread testThreads[SLOT_COUNT];
    bool testThreadLive[SLOT_COUNT];

    std::vector<DiagnosticRecord> serviceRecords;
    std::vector<DiagnosticRecord> completionRecords;
    std::vector<DiagnosticJob> jobs;

    Mutex serviceRecordLock;
    Mutex completionRecordLock;
    Mutex jobLock;

    // Held by a runner from its check to the start of the thread, and by
    // stopTests, so a check and a start are one step.
    Mutex runLock;

    std::atomic<bool> _stopping;
    std::atomic<int> _testProviders;
    std::atomic<int> _threadsRunning;

    DiagnosticHelper(const DiagnosticHelper&);
    DiagnosticHelper& operator=(const DiagnosticHelper&);
};

// Enables or disables a port ("indexStr" in colon form) or an adapter
// (plain or colon form); 0 on success, -1 on any failure.
int setPortState(String indexStr, bool enable);
int setAdapterStatus(String adapterAddress, bool enable);

// Each list keeps its latest records, no more.
enum { DIAG_MAX_RECORDS = 100 };

extern DiagnosticHelper gDiagnosticHelperObj;

} // namespace OLMA

#endif
