// The runners, which check a request and start a test on its own thread,
// and the test threads, which take the port or adapter out of service, run
// the test through the adapter library, put it back and leave records.
#include "DiagnosticHelper.h"

#include <dlfcn.h>
#include <pthread.h>
#include <stdarg.h>
#include <stdio.h>

#include <exception>
#include <memory>

#include "CIMProviderTruj.h"
#include "PortHelper.h"
#include "ProviderUtil.h"
#include "Time.h"
#include "log.h"

#include "VESPERA_ConcreteJob.h"

namespace OLMA
{

namespace
{

// The constants of a run.
const uint32 FC_FRAME_COUNT = 131072;
const uint32 ETH_FRAME_COUNT = 65536;
const uint32 DATA_PATTERN = 0xB5B5B5B5;

enum
{
    MODE_INTERNAL = 1,
    MODE_SERDES = 4,
    MODE_EXTERNAL = 8
};

// How long a port is given to settle after it is disabled, tested or
// enabled again.
const uint32 SETTLE_SECONDS = 2;

// The record texts built with a format fit this buffer; longer ones are cut.
const size_t RECORD_TEXT_SIZE = 200;

// Reading a reply, which is untrusted: a member of another type counts as
// missing.
bool replyBool(const Json::Value& reply, const char* name)
{
    if (!reply.isObject())
        return false;
    const Json::Value& v = reply[name];
    return v.isBool() && v.asBool();
}

unsigned replyUInt(const Json::Value& reply, const char* name)
{
    if (!reply.isObject())
        return 0;
    const Json::Value& v = reply[name];
    return v.isUInt() ? v.asUInt() : 0;
}

int replyInt(const Json::Value& reply, const char* name)
{
    if (!reply.isObject())
        return 0;
    const Json::Value& v = reply[name];
    return v.isInt() ? v.asInt() : (v.isUInt() ? (int)v.asUInt() : 0);
}

const char* replyText(const Json::Value& reply, const char* name)
{
    if (!reply.isObject())
        return "";
    const Json::Value& v = reply[name];
    return v.isString() ? v.asCString() : "";
}

// The message of an error reply, if it has one.
std::string errorMessage(const Json::Value& reply)
{
    if (!reply.isObject() || !reply["error"].isObject())
        return std::string();
    const Json::Value& m = reply["error"]["message"];
    return m.isString() ? m.asString() : std::string();
}

// A reply that says the test failed, with the reason as its output.
Json::Value failedReply(const std::string& why)
{
    Json::Value reply(Json::objectValue);
    reply["failed"] = true;
    reply["output"] = why;
    return reply;
}

// One run of a test, on its thread. It remembers what it took out of
// service, so that whatever happens the port or adapter is put back and
// the job is completed.
class Test_Run
{
public:

    explicit Test_Run(DiagnosticTestInput* input) :
        _input(input), _helper(input->helper), _util(ProviderUtil::getProviderUtil()),
        _portDisabled(false), _adapterDisabled(false), _completed(false)
    {
    }

    typedef void (Test_Run::*Body)();

    // Runs the body; anything that escapes it fails the run.
    void run(Body body)
    {
        try
        {
            (this->*body)();
            return;
        }
        catch (const std::exception& e)
        {
            TLOG(LL_ERR, "%s: the test thread got std exception: %s",
                _input->jobId.c_str(), e.what());
        }
        catch (...)
        {
            TLOG(LL_ERR, "%s: the test thread got default exception", _input->jobId.c_str());
        }

        try
        {
            _recover();
        }
        catch (...)
        {
            TLOG(LL_ERR, "%s: the test thread could not recover", _input->jobId.c_str());
        }
    }

    void memory();
    void pciLoopback();
    void loopback();
    void ethLoopback();

private:

    struct Loopback_Kind
    {
        bool eth;
        diag_record_msg_t checkText, runText, returnCodeText, passText, failText;
        const char* entry;
        JsonReqFP* fp;
        const char* statusFormat;
    };

    void _loopback(const Loopback_Kind& kind);

    // S(n): a service record of a fixed text, logged at info level.
    void _service(diag_record_msg_t id, Log_Level level = LL_INFO)
    {
        String text = _util->getRecordData(id);
        TLOG(level, "%s", text.c_str());
        _helper->generateDiagnosticRecord(text, true, _input, DIAG_COMPL_STATE_OK);
    }

    // C(x, s): a completion record.
    void _completion(const String& text, diag_compl_record_state_t state, Log_Level level = LL_INFO)
    {
        TLOG(level, "%s", text.c_str());
        _helper->generateDiagnosticRecord(text, false, _input, state);
    }

    void _completion(diag_record_msg_t id, diag_compl_record_state_t state, Log_Level level = LL_INFO)
    {
        _completion(_util->getRecordData(id), state, level);
    }

    void _completionf(diag_compl_record_state_t state, Log_Level level, const char* format, ...)
        __attribute__((format(printf, 4, 5)))
    {
        char text[RECORD_TEXT_SIZE];
        va_list ap;
        va_start(ap, format);
        vsnprintf(text, sizeof(text), format, ap);
        va_end(ap);
        _completion(String(text), state, level);
    }

    void _complete()
    {
        _helper->updateJobState(_input->jobId);
        _completed = true;
    }

    // The library's answer to a test, made usable: a throw, a null reply or
    // an error reply becomes a failed run whose output says why. A test
    // that is being stopped isn't started.
    Json::Value _callTest(const char* entry, JsonReqFP* fp, const Json::Value& request,
        const String& abortText)
    {
        if (_helper->stopRequested())
        {
            TLOG(LL_WARN, "%s: %s is not run, the test is being stopped",
                _input->jobId.c_str(), entry);
            return failedReply(abortText.c_str());
        }

        Json::Value reply;
        std::string why;
        bool called = false;

        try
        {
            reply = (*fp)(request);
            called = true;
        }
        catch (const HbaAgentError& e)
        {
            TLOG(LL_ERR, "%s got User exception %d: %s", entry, e.getCode(),
                e.getMessage().c_str());
            why = e.getMessage();
        }
        catch (const std::exception& e)
        {
            TLOG(LL_ERR, "%s got std exception: %s", entry, e.what());
            why = e.what();
        }
        catch (...)
        {
            TLOG(LL_ERR, "%s got default exception", entry);
        }

        if (called && ProviderUtil::isValidJsonResponse(reply) && reply.isObject())
        {
            // The library's own word that it can't tell what went wrong.
            if (replyBool(reply, "unknownFailure") && !replyBool(reply, "failed"))
            {
                reply["failed"] = true;
                if (!*replyText(reply, "output"))
                    reply["output"] = _util->getRecordData(REC_UNKNOWN_FAILURE).c_str();
            }
            return reply;
        }

        if (called)
        {
            TLOG(LL_ERR, "%s response has error", entry);
            why = errorMessage(reply);
        }

        return failedReply(why.empty() ? _util->getRecordData(REC_UNKNOWN_FAILURE).c_str() : why);
    }

    // After an escape: put back what was taken, complete the job, and say
    // that the run failed.
    void _recover()
    {
        String address = !_input->portWwn.size() ? _input->portMac : _input->portWwn;

        if (_portDisabled)
        {
            _portDisabled = false;
            setPortState(ProviderUtil::getIndexInColonFormat(address), true);
        }

        if (_adapterDisabled)
        {
            _adapterDisabled = false;
            setAdapterStatus(_input->adapterAddress, true);
        }

        if (!_completed)
        {
            _complete();
            _completion(REC_UNKNOWN_FAILURE, DIAG_COMPL_STATE_FAILED, LL_ERR);
        }
    }

    DiagnosticTestInput* _input;
    DiagnosticHelper* _helper;
    ProviderUtil* _util;
    bool _portDisabled;
    bool _adapterDisabled;
    bool _completed;
};

void Test_Run::loopback()
{
    static const Loopback_Kind kind = { false, REC_LB_CHECK_PORT_DISABLED, REC_LB_RUNNING,
        REC_LB_CHECKING_RC, REC_LB_SUCCESS, REC_LB_FAILED, "libDiagLoopbackTest",
        &libDiagLoopbackTest, "Loopback test run status : %s" };
    _loopback(kind);
}

void Test_Run::ethLoopback()
{
    static const Loopback_Kind kind = { true, REC_ETH_CHECK_PORT_DISABLED, REC_ETH_RUNNING,
        REC_ETH_CHECKING_RC, REC_ETH_SUCCESS, REC_ETH_FAILED, "libDiagEthLoopbackTest",
        &libDiagEthLoopbackTest, "EthLoopback test run status : %s" };
    _loopback(kind);
}

void Test_Run::_loopback(const Loopback_Kind& kind)
{
    // The FC loopback is only ever asked for an FC port, named by WWN; a
    // port named by MAC is tested by that.
    String address = kind.eth || !_input->portWwn.size() ? _input->portMac : _input->portWwn;
    String colon = ProviderUtil::getIndexInColonFormat(address);

    _service(kind.checkText);

    bool wasDisabled = PortHelper::getPortHelperObject()->isPortDisabled(address);

    if (wasDisabled)
    {
        _service(REC_PORT_ALREADY_DISABLED);
    }
    else
    {
        _service(REC_PORT_NOT_DISABLED);
        _service(REC_DISABLING_PORT);

        if (setPortState(colon, false) != 0)
        {
            _complete();
            _completion(REC_DISABLE_PORT_FAILED, DIAG_COMPL_STATE_FAILED, LL_ERR);
            return;
        }

        _portDisabled = true;

        if (!kind.eth)
            _helper->pause(SETTLE_SECONDS);
    }

    _service(kind.runText);

    Json::Value request(Json::objectValue);
    request["portWwn"] = colon.c_str();
    request["mode"] = Json::UInt(_input->mode);
    if (!kind.eth)
        request["speed"] = Json::UInt(_input->speed);
    request["dataPattern"] = Json::UInt(_input->dataPattern);
    request["frameCount"] = Json::UInt(_input->frameCount);

    Json::Value reply = _callTest(kind.entry, kind.fp, request,
        kind.eth ? _util->getRecordData(REC_ETH_ABORTED) : String("Loopback test aborted"));

    if (!kind.eth)
        _helper->pause(SETTLE_SECONDS);

    if (!wasDisabled)
    {
        _service(REC_ENABLING_PORT);
        _portDisabled = false;
        setPortState(colon, true);

        if (!kind.eth)
            _helper->pause(SETTLE_SECONDS);
    }

    _complete();
    _service(kind.returnCodeText);

    if (!replyBool(reply, "failed"))
    {
        _completion(kind.passText, DIAG_COMPL_STATE_OK);
        return;
    }

    _completion(kind.failText, DIAG_COMPL_STATE_FAILED, LL_ERR);
    _completionf(DIAG_COMPL_STATE_FAILED, LL_INFO,
        "Tx frames = %u, Rx frames = %u, OSF frames = %u",
        replyUInt(reply, "transmitFrames"), replyUInt(reply, "GoodFrameRcv"),
        replyUInt(reply, "outstandingFrames"));

    unsigned badNo = replyUInt(reply, "BadFrameNo");
    unsigned badInfo = replyUInt(reply, "BadFrameInfo");

    if (badNo != 0 || badInfo != 0)
        _completionf(DIAG_COMPL_STATE_FAILED, LL_INFO,
            "Mis-match frame number = %u; Mis-match frame info = %u", badNo, badInfo);

    _completionf(DIAG_COMPL_STATE_FAILED, LL_ERR, kind.statusFormat,
        replyText(reply, "output"));
}

void Test_Run::pciLoopback()
{
    _service(REC_PCI_RUNNING);

    String address = _input->portMac.size() ? _input->portMac : _input->portWwn;

    // The port stays in service for this test.
    Json::Value request(Json::objectValue);
    request["portWwn"] = ProviderUtil::getIndexInColonFormat(address).c_str();
    request["dataPattern"] = Json::UInt(_input->dataPattern);
    request["frameCount"] = Json::UInt(_input->frameCount);

    Json::Value reply = _callTest("libDiagPCILoopbackTest", &libDiagPCILoopbackTest, request,
        "PCI Loopback test aborted");

    _complete();
    _service(REC_PCI_CHECKING_RC);

    if (!replyBool(reply, "failed"))
    {
        _completion(REC_PCI_SUCCESS, DIAG_COMPL_STATE_OK);
        return;
    }

    _completionf(DIAG_COMPL_STATE_FAILED, LL_ERR, "PCILoopback test run status : %s",
        replyText(reply, "output"));
    _completion(REC_PCI_FAILED, DIAG_COMPL_STATE_FAILED);
}

// Whether the adapter is in service; false when that can't be read.
static bool adapterEnabled(const String& colon)
{
    Json::Value request(Json::objectValue);
    request[colon.size() == 17 ? "mac" : "wwn"] = colon.c_str();

    Json::Value reply;

    try
    {
        reply = libGetHbaByWwn(request);
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "libGetHbaByWwn got User exception %d: %s", e.getCode(),
            e.getMessage().c_str());
        return false;
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "libGetHbaByWwn got std exception: %s", e.what());
        return false;
    }
    catch (...)
    {
        TLOG(LL_ERR, "libGetHbaByWwn got default exception");
        return false;
    }

    if (!ProviderUtil::isValidJsonResponse(reply) || !reply.isObject() ||
        !reply["hbaData"].isObject() || !reply["hbaData"]["hbaStatus"].isBool())
    {
        TLOG(LL_ERR, "Unable to get adapater status");
        return false;
    }

    bool enabled = reply["hbaData"]["hbaStatus"].asBool();
    TLOG(LL_INFO, "%s: adapter status is %d", "getAdapterStatus", (int)enabled);
    return enabled;
}

void Test_Run::memory()
{
    _service(REC_MEM_CHECK_ADAPTER_DISABLED);

    String colon = ProviderUtil::getIndexInColonFormat(_input->adapterAddress);
    bool enabled = adapterEnabled(colon);

    if (enabled)
    {
        _service(REC_ADAPTER_NOT_DISABLED);
        _service(REC_MEM_DISABLING_ADAPTER, LL_WARN);
        _adapterDisabled = true;
        setAdapterStatus(_input->adapterAddress, false);
    }
    else
    {
        _service(REC_ADAPTER_ALREADY_DISABLED);
    }

    _service(REC_MEM_RUNNING);
    _service(REC_MEM_MAY_TAKE_MOMENTS);

    Json::Value request(Json::objectValue);
    request["hbaWwn"] = colon.c_str();

    Json::Value reply = _callTest("libDiagMemoryTest", &libDiagMemoryTest, request,
        "Memory test aborted");

    if (enabled)
    {
        _service(REC_MEM_ENABLING_ADAPTER, LL_WARN);
        _adapterDisabled = false;
        int ret = setAdapterStatus(_input->adapterAddress, true);
        TLOG(LL_INFO, "ret = %d adapterAddress = %s", ret, _input->adapterAddress.c_str());
    }

    _complete();
    _service(REC_MEM_CHECKING_RC);

    if (!replyBool(reply, "failed"))
    {
        _completion(REC_MEM_SUCCESS, DIAG_COMPL_STATE_OK);
        return;
    }

    int status = replyInt(reply, "status");

    if (status == 0)
    {
        TLOG(LL_INFO, "Memory test run status : %s", replyText(reply, "output"));
        _completion(REC_MEM_FAILED, DIAG_COMPL_STATE_FAILED);
        return;
    }

    // The details go to the log only: a client sees the verdict.
    _completion(REC_MEM_FAILED, DIAG_COMPL_STATE_FAILED);
    TLOG(LL_INFO, "Status         :\t0x%x", (unsigned)status);
    TLOG(LL_INFO, "Addr           :\t0x%x", replyUInt(reply, "address"));
    TLOG(LL_INFO, "Expected value :\t0x%x", replyUInt(reply, "expected value"));
    TLOG(LL_INFO, "Actual value   :\t0x%x", replyUInt(reply, "actual value"));
    TLOG(LL_INFO, "Error state    :\t0x%x", replyUInt(reply, "error status"));
    TLOG(LL_INFO, "Error address  :\t0x%x", replyUInt(reply, "error address"));
    TLOG(LL_INFO, "Algorithm      :\t%s", replyText(reply, "type"));
    TLOG(LL_INFO, "Memory test run status : %s", replyText(reply, "output"));
}

void* runThread(void* arg, Test_Run::Body body)
{
    DiagnosticTestInput* input = (DiagnosticTestInput*)arg;
    DiagnosticHelper* helper = input->helper;
    {
        Test_Run run(input);
        run.run(body);
    }
    delete input;
    helper->testThreadEnded();
    return 0;
}

} // namespace

void* DiagnosticHelper::runMemoryTestThread(void* input)
{
    return runThread(input, &Test_Run::memory);
}

void* DiagnosticHelper::runPCILoopbackTestThread(void* input)
{
    return runThread(input, &Test_Run::pciLoopback);
}

void* DiagnosticHelper::runLoopbackTestThread(void* input)
{
    return runThread(input, &Test_Run::loopback);
}

void* DiagnosticHelper::runEthLoopbackTestThread(void* input)
{
    return runThread(input, &Test_Run::ethLoopback);
}

//------------------------------------------------------------------------------
// Enabling and disabling
//------------------------------------------------------------------------------

namespace
{

// One call of a setter that takes a port or an adapter out of service or
// back. A throw is logged and counts as a failure (-1), as does a reply
// that isn't good; forWhom, when given, is named by the last catch.
int callSetter(const char* entry, JsonReqFP fp, const Json::Value& request,
    const char* forWhom, Json::Value& reply)
{
    try
    {
        reply = fp(request);
    }
    catch (const HbaAgentError& e)
    {
        TLOG(LL_ERR, "%s got User exception %d: %s", entry, e.getCode(),
            e.getMessage().c_str());
        return -1;
    }
    catch (const std::exception& e)
    {
        TLOG(LL_ERR, "%s got std exception: %s", entry, e.what());
        return -1;
    }
    catch (...)
    {
        if (forWhom)
            TLOG(LL_ERR, "%s got default exception for %s", entry, forWhom);
        else
            TLOG(LL_ERR, "%s got default exception", entry);
        return -1;
    }

    return ProviderUtil::isValidJsonResponse(reply) ? 0 : -1;
}

} // namespace

int setPortState(String indexStr, bool enable)
{
    Json::Value request(Json::objectValue);
    request["indexStr"] = indexStr.c_str();
    request["port"] = Json::Value(Json::objectValue);
    request["port"]["portStatus"] = enable;
    request["propArray"] = Json::Value(Json::arrayValue);
    request["propArray"].append("portStatus");

    Json::Value reply;

    if (callSetter("libSetPortByWwn", libSetPortByWwn, request, 0, reply) != 0)
        return -1;

    TLOG(LL_INFO, "setPortState - %s %d", indexStr.c_str(),
        (int)(reply.isObject() && reply.isMember("status")));
    return 0;
}

int setAdapterStatus(String adapterAddress, bool enable)
{
    Json::Value request(Json::objectValue);
    request["indexStr"] = ProviderUtil::getIndexInColonFormat(adapterAddress).c_str();
    request["enableState"] = enable;

    Json::Value reply;

    if (callSetter("libSetAdapterState", libSetAdapterState, request, adapterAddress.c_str(),
            reply) != 0)
        return -1;

    TLOG(LL_INFO, "setAdapterStatus success");
    return 0;
}

//------------------------------------------------------------------------------
// The runners
//------------------------------------------------------------------------------

void DiagnosticHelper::pause(uint32 seconds)
{
    // In slices, so that a stop doesn't wait for the whole pause.
    const uint64 slice = 50 * Time::MSEC;
    uint64 left = seconds * Time::SEC;

    while (left > 0 && !stopRequested())
    {
        uint64 now = left < slice ? left : slice;
        Time::sleep(now);
        left -= now;
    }
}

void DiagnosticHelper::_joinFinished()
{
    for (int i = 0; i < SLOT_COUNT; i++)
    {
        if (!testThreadLive[i])
            continue;

        void* ignored;
        Thread::join(testThreads[i], ignored);
        testThreadLive[i] = false;
    }
}

void DiagnosticHelper::_letGo()
{
    for (int i = 0; i < SLOT_COUNT; i++)
    {
        if (testThreadLive[i])
            pthread_detach(testThreads[i]._thread);
        testThreadLive[i] = false;
    }

    // Opening the module again with RTLD_NODELETE keeps it mapped after the
    // server's last dlclose.
    Dl_info info;

    if (dladdr((void*)&gDiagnosticHelperObj, &info) && info.dli_fname)
    {
        void* self = dlopen(info.dli_fname, RTLD_NOW | RTLD_NOLOAD | RTLD_NODELETE);
        if (self)
            dlclose(self);
    }
}

void DiagnosticHelper::stopTests(bool bounded)
{
    Auto_Mutex hold(runLock);
    _stopping = true;

    // The pauses of a run end at once; a library call ends when it ends.
    for (uint64 waited = 0; bounded && _threadsRunning.load() > 0 &&
         waited < STOP_WAIT_MS * Time::MSEC; waited += 10 * Time::MSEC)
        Time::sleep(10 * Time::MSEC);

    if (_threadsRunning.load() > 0 && bounded)
    {
        TLOG(LL_WARN, "A diagnostic test is still in the adapter library; it ends by itself");
        _letGo();
        return;
    }

    _joinFinished();
    _stopping = false;
}

void DiagnosticHelper::testProviderLoaded()
{
    ++_testProviders;
}

void DiagnosticHelper::testProviderUnloaded()
{
    if (--_testProviders > 0)
        return;

    _testProviders = 0;
    stopTests();
}

void DiagnosticHelper::_startRun(DiagnosticRunResult* result, DiagnosticTestInput* input,
    Test_Slot slot, void* (*proc)(void*))
{
    input->helper = this;
    TLOG(LL_INFO, "Creating the Job instance.");

    DiagnosticJob job = createDiagnosticJob(input);
    input->jobId = job.name;

    // The thread of the run before has completed its job; it may still be
    // writing its last records.
    _joinFinished();
    addDiagnosticJob(job);

    // A stop that let a thread go ends with that thread's job.
    _stopping = false;
    ++_threadsRunning;
    int rc = Thread::create_joinable(testThreads[slot], proc, input);

    if (rc != 0)
    {
        --_threadsRunning;
        TLOG(LL_ERR, "Unable to start the test thread of %s: %d", job.name.c_str(), rc);
        updateJobState(job.name);
        delete input;
        result->status = RUN_DIAG_RETURN_BUSY;
        return;
    }

    testThreadLive[slot] = true;
    result->job = clone(job.jobRef.ptr());
    result->status = RUN_DIAG_RETURN_STARTED;
}

namespace
{

// Whether testName (the full name, in any case) is the test id.
bool isTest(const String& testName, diag_test_id_t id)
{
    return testName.equali(ProviderUtil::getProviderUtil()->getDiagTestName(id));
}

DiagnosticRunResult* refuse(DiagnosticRunResult* result, uint32 status)
{
    result->status = status;
    return result;
}

// The loopback tests of a kind of port, with the mode each runs the
// library's test in.
struct Loopback_Mode
{
    diag_test_id_t id;
    uint32 mode;
    const char* name;
};

const Loopback_Mode FC_LOOPBACK_MODES[] =
{
    {DIAG_INTERNAL_LOOPBACK_TEST, MODE_INTERNAL, "internal"},
    {DIAG_EXTERNAL_LOOPBACK_TEST, MODE_EXTERNAL, "external"},
    {DIAG_SERDES_LOOPBACK_TEST, MODE_SERDES, "serdes"},
};

const Loopback_Mode ETH_LOOPBACK_MODES[] =
{
    {DIAG_EXTERNAL_ETH_LOOPBACK_TEST, MODE_EXTERNAL, "external"},
    {DIAG_SERDES_ETH_LOOPBACK_TEST, MODE_SERDES, "serdes"},
};

// Sets the test and its mode from the test's name; false if the kind has
// no test of that name.
template<size_t N>
bool pickMode(const Loopback_Mode (&modes)[N], const char* kind, const String& testName,
    DiagnosticTestInput& input)
{
    for (const Loopback_Mode& m : modes)
        if (isTest(testName, m.id))
        {
            input.mode = m.mode;
            input.testId = m.id;
            TLOG(LL_INFO, "%s test mode : %s", kind, m.name);
            return true;
        }
    return false;
}

} // namespace

DiagnosticRunResult* DiagnosticHelper::runLoopbackTest(String portAddress, String testName)
{
    TLOG(LL_DBG, "Entering: %s", "runLoopbackTest");

    DiagnosticRunResult* result = new DiagnosticRunResult;
    std::unique_ptr<DiagnosticTestInput> input(new DiagnosticTestInput);
    Auto_Mutex hold(runLock);

    if (isAnyJobRunning())
    {
        TLOG(LL_INFO, "A diagnostic job is already running");
        return refuse(result, RUN_DIAG_RETURN_BUSY);
    }

    if (portAddress.size() == 12)
    {
        TLOG(LL_INFO, "Given Port MAC : %s", portAddress.c_str());
        input->portMac = portAddress;
        input->elementClass = ID_VESPERA_EthernetPort;
        input->speed = 10;
        TLOG(LL_INFO, "Speed chosen : 10 GBS");
    }
    else if (portAddress.size() == 16)
    {
        TLOG(LL_INFO, "Given Port WWN : %s", portAddress.c_str());
        input->portWwn = portAddress;
        input->elementClass = ID_VESPERA_FCPort;
        input->speed = 4;
        TLOG(LL_INFO, "Speed chosen : 4 GBS");
    }
    else
    {
        TLOG(LL_ERR, "Invalid port WWN or MAC value");
        return refuse(result, RUN_DIAG_RETURN_INVALID);
    }

    Json::Value details;

    if (PortHelper::getPortHelperObject()->getPortDetails(portAddress, details) != 0)
    {
        TLOG(LL_ERR, "Unable get Port INFO for %s", portAddress.c_str());
        return refuse(result, RUN_DIAG_RETURN_BUSY);
    }

    // An FCoE port has no internal loopback.
    if (details.isObject() && details.isMember("isFCoE") &&
        isTest(testName, DIAG_INTERNAL_LOOPBACK_TEST))
        return refuse(result, RUN_DIAG_RETURN_UNSUPPORTED);

    input->frameCount = FC_FRAME_COUNT;
    input->dataPattern = DATA_PATTERN;

    if (!pickMode(FC_LOOPBACK_MODES, "Loopback", testName, *input))
    {
        TLOG(LL_ERR, "Unknown loopback test %s", testName.c_str());
        return refuse(result, RUN_DIAG_RETURN_UNSUPPORTED);
    }

    _startRun(result, input.release(), SLOT_LOOPBACK, runLoopbackTestThread);
    return result;
}

DiagnosticRunResult* DiagnosticHelper::runEthLoopbackTest(String portAddress, String testName)
{
    TLOG(LL_DBG, "Entering: %s", "runEthLoopbackTest");

    DiagnosticRunResult* result = new DiagnosticRunResult;
    std::unique_ptr<DiagnosticTestInput> input(new DiagnosticTestInput);
    input->elementClass = ID_VESPERA_EthernetPort;
    Auto_Mutex hold(runLock);

    if (isAnyJobRunning())
    {
        TLOG(LL_INFO, "A diagnostic job is already running");
        return refuse(result, RUN_DIAG_RETURN_BUSY);
    }

    if (portAddress.size() != 12)
    {
        TLOG(LL_ERR, "Invalid port MAC value");
        return refuse(result, RUN_DIAG_RETURN_INVALID);
    }

    TLOG(LL_INFO, "Given Port MAC : %s", portAddress.c_str());
    input->portMac = portAddress;
    input->frameCount = ETH_FRAME_COUNT;
    input->dataPattern = DATA_PATTERN;

    if (!pickMode(ETH_LOOPBACK_MODES, "Eth Loopback", testName, *input))
    {
        TLOG(LL_ERR, "Unknown Ethernet loopback test %s", testName.c_str());
        return refuse(result, RUN_DIAG_RETURN_UNSUPPORTED);
    }

    _startRun(result, input.release(), SLOT_ETH_LOOPBACK, runEthLoopbackTestThread);
    return result;
}

DiagnosticRunResult* DiagnosticHelper::runPCILoopbackTest(String portAddress)
{
    TLOG(LL_DBG, "Entering: %s", "runPCILoopbackTest");

    DiagnosticRunResult* result = new DiagnosticRunResult;
    std::unique_ptr<DiagnosticTestInput> input(new DiagnosticTestInput);
    Auto_Mutex hold(runLock);

    if (isAnyJobRunning())
    {
        TLOG(LL_INFO, "A diagnostic job is already running");
        return refuse(result, RUN_DIAG_RETURN_BUSY);
    }

    if (portAddress.size() == 12)
    {
        TLOG(LL_INFO, "Given Port MAC : %s", portAddress.c_str());
        input->portMac = portAddress;
        input->elementClass = ID_VESPERA_EthernetPort;
    }
    else if (portAddress.size() == 16)
    {
        TLOG(LL_INFO, "Given Port WWN : %s", portAddress.c_str());
        input->portWwn = portAddress;
        input->elementClass = ID_VESPERA_FCPort;
    }
    else
    {
        TLOG(LL_ERR, "%s - Invalid port WWN or MAC value", portAddress.c_str());
        return refuse(result, RUN_DIAG_RETURN_INVALID);
    }

    input->testId = DIAG_PCI_LOOPBACK_TEST;
    input->frameCount = FC_FRAME_COUNT;
    input->dataPattern = DATA_PATTERN;

    _startRun(result, input.release(), SLOT_MEMORY_PCI, runPCILoopbackTestThread);
    return result;
}

DiagnosticRunResult* DiagnosticHelper::runMemoryTest(String adapterAddress)
{
    TLOG(LL_DBG, "Entering: %s", "runMemoryTest");

    DiagnosticRunResult* result = new DiagnosticRunResult;
    std::unique_ptr<DiagnosticTestInput> input(new DiagnosticTestInput);
    TLOG(LL_INFO, "Adapter Address : %s", adapterAddress.c_str());
    Auto_Mutex hold(runLock);

    if (isAnyJobRunning())
    {
        TLOG(LL_INFO, "A diagnostic job is already running");
        return refuse(result, RUN_DIAG_RETURN_BUSY);
    }

    // 0 is the library's answer for an adapter it doesn't know; -1 that of
    // an address that is neither a WWN nor a MAC.
    unsigned int adapterId = ProviderUtil::getProviderUtil()->getAdapterId(adapterAddress);

    if (adapterId == 0 || adapterId == (unsigned int)-1)
    {
        TLOG(LL_ERR, "No adapter for the address %s", adapterAddress.c_str());
        return refuse(result, RUN_DIAG_RETURN_INVALID);
    }

    TLOG(LL_INFO, "Adapter ID  : %d", (int)adapterId);

    input->testId = DIAG_MEMORY_TEST;
    input->elementClass = ID_VESPERA_PortController;
    input->adapterId = adapterId;
    input->adapterAddress = adapterAddress;

    _startRun(result, input.release(), SLOT_MEMORY_PCI, runMemoryTestThread);
    return result;
}

} // namespace OLMA
