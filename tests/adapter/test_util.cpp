// ProviderUtil against the simulated adapter library (its default host) and
// against hand-made replies put in place of single entries.

#include <gtest/gtest.h>

#include <string.h>

#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

#include "CIMProviderTruj.h"
#include "InProcessLog.h"
#include "ProviderInit.h"
#include "ProviderUtil.h"

// The simulator's own switches.
extern "C" int dtruj_sim_set_fault(const char* entry, const char* kind);

using namespace OLMA;
using adapter_test::InProcessLog;
using adapter_test::countLines;

namespace
{

ProviderUtil* util()
{
    return ProviderUtil::getProviderUtil();
}

// Puts a fake in place of one library entry for the life of the object.
class ScopedEntry
{
public:
    ScopedEntry(JsonReqFP& slot, JsonReqFP fake) : _slot(slot), _saved(slot)
    {
        _slot = fake;
    }
    ~ScopedEntry() { _slot = _saved; }
private:
    JsonReqFP& _slot;
    JsonReqFP _saved;
};

Json::Value lastRequest;
Json::Value cannedReply;

Json::Value recordAndAnswer(const Json::Value& request)
{
    lastRequest = request;
    return cannedReply;
}

Json::Value throwHba(const Json::Value&)
{
    throw HbaAgentError(7, "adapter gone");
}

Json::Value throwStd(const Json::Value&)
{
    throw std::runtime_error("bad alloc in library");
}

Json::Value throwInt(const Json::Value&)
{
    throw 42;
}

Json::Value hbaReply(const Json::Value& hbaData, const Json::Value& driver)
{
    Json::Value reply(Json::objectValue);
    reply["hbaData"] = hbaData;
    reply["driver"] = driver;
    return reply;
}

const char* const FC_HBA_WWN = "20:00:00:05:1e:8a:10:00";
const char* const CNA_MAC = "00:05:1e:8b:20:00";

class ProviderUtilTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        InProcessLog::home();
        cannedReply = Json::Value();
        lastRequest = Json::Value();
    }
};

// Cases that ask the simulator.
class ProviderUtilSimTest : public ProviderUtilTest
{
protected:
    void SetUp() override
    {
        ProviderUtilTest::SetUp();
        ASSERT_TRUE(gTrujLibLoaded) << "the start-up didn't load libdtruj.so";
    }
};

} // namespace

//------------------------------------------------------------------------------
// Pure operations
//------------------------------------------------------------------------------

TEST_F(ProviderUtilTest, ColonFormInBothDirections)
{
    EXPECT_STREQ("10:00:00:05:1E:8a:10:01",
        ProviderUtil::getIndexInColonFormat("100000051E8a1001").c_str());
    EXPECT_STREQ("00:05:1e:8b:20:00",
        ProviderUtil::getIndexInColonFormat("00051e8b2000").c_str());

    // Short texts stay, an odd digit stays with the last pair.
    EXPECT_STREQ("ab", ProviderUtil::getIndexInColonFormat("ab").c_str());
    EXPECT_STREQ("abc", ProviderUtil::getIndexInColonFormat("abc").c_str());
    EXPECT_STREQ("ab:cd", ProviderUtil::getIndexInColonFormat("abcd").c_str());
    EXPECT_STREQ("01:23:45:67:89:abc",
        ProviderUtil::getIndexInColonFormat("0123456789abc").c_str());
    EXPECT_STREQ("", ProviderUtil::getIndexInColonFormat("").c_str());
    EXPECT_STREQ("a", ProviderUtil::getIndexInColonFormat("a").c_str());

    // Anything with a colon is taken as already converted, whatever its
    // length, and says so.
    InProcessLog log;
    EXPECT_STREQ("a:bcdef", ProviderUtil::getIndexInColonFormat("a:bcdef").c_str());
    EXPECT_EQ(1u, countLines(log.text(),
        {"INFO: ", "The string a:bcdef is already in : format"}));

    EXPECT_STREQ("100000051E8a1001",
        ProviderUtil::eraseColonsFromIndex("10:00:00:05:1E:8a:10:01").c_str());
    EXPECT_STREQ("", ProviderUtil::eraseColonsFromIndex(":::").c_str());

    String wwn("20000005aBcDeF01");
    EXPECT_TRUE(wwn == ProviderUtil::eraseColonsFromIndex(
        ProviderUtil::getIndexInColonFormat(wwn)));
}

TEST_F(ProviderUtilTest, RawBytesNeverOverrun)
{
    unsigned char raw[10];

    memset(raw, 0xEE, sizeof(raw));
    util()->getRawWWNFromStr((char*)"100000051e8a1001", raw);
    const unsigned char wwn[8] = { 0x10, 0x00, 0x00, 0x05, 0x1e, 0x8a, 0x10, 0x01 };
    EXPECT_EQ(0, memcmp(raw, wwn, 8));
    EXPECT_EQ(0xEE, raw[8]);

    memset(raw, 0xEE, sizeof(raw));
    util()->getRawMacFromStr((char*)"00051E8B2000", raw);
    const unsigned char mac[6] = { 0x00, 0x05, 0x1e, 0x8b, 0x20, 0x00 };
    EXPECT_EQ(0, memcmp(raw, mac, 6));
    EXPECT_EQ(0xEE, raw[6]);

    // A short or broken text leaves zeros where it has no digits.
    memset(raw, 0xEE, sizeof(raw));
    util()->getRawWWNFromStr((char*)"12zz", raw);
    const unsigned char partial[8] = { 0x12, 0, 0, 0, 0, 0, 0, 0 };
    EXPECT_EQ(0, memcmp(raw, partial, 8));
    EXPECT_EQ(0xEE, raw[8]);
}

TEST_F(ProviderUtilTest, TagGivesBackTheAddress)
{
    EXPECT_STREQ("100000051e8a1001", util()->getNodeMACOrWWNFromTag(
        "10000000-0000-0000-1000-00051e8a1001").c_str());
    EXPECT_STREQ("00051e8b2000", util()->getNodeMACOrWWNFromTag(
        "10000000-0000-0000-0000-00051e8b2000").c_str());

    InProcessLog log;
    EXPECT_STREQ("", util()->getNodeMACOrWWNFromTag("10000000-0000").c_str());
    EXPECT_EQ(1u, countLines(log.text(), {"ERR: "}));
}

TEST_F(ProviderUtilTest, NameTables)
{
    EXPECT_STREQ("--", util()->getClassName(ID_NONE).c_str());
    EXPECT_STREQ("VESPERA_FCPort", util()->getClassName(ID_VESPERA_FCPort).c_str());
    EXPECT_STREQ("VESPERA_AgentService",
        util()->getClassName(ID_VESPERA_AgentService).c_str());
    EXPECT_STREQ("VESPERA_LogicalDisk", util()->getClassName(MAXCLASSID).c_str());
    EXPECT_STREQ("Vespera:MemoryTest",
        util()->getDiagTestName(DIAG_MEMORY_TEST).c_str());
    EXPECT_STREQ("Vespera:SerdesEthLoopbackTest",
        util()->getDiagTestName(DIAG_SERDES_ETH_LOOPBACK_TEST).c_str());
    EXPECT_STREQ("Unknown failure", util()->getRecordData(REC_UNKNOWN_FAILURE).c_str());
    EXPECT_STREQ("Eth loopback test failed",
        util()->getRecordData(REC_ETH_FAILED).c_str());

    InProcessLog log;
    EXPECT_STREQ("INVALID CLASS", util()->getClassName((classId_t)39).c_str());
    EXPECT_STREQ("INVALID CLASS", util()->getClassName((classId_t)-1).c_str());
    EXPECT_STREQ("INVALID DIAGNOSTIC ID",
        util()->getDiagTestName(DIAG_NAME_INVALID).c_str());
    EXPECT_STREQ("INVALID RECORD ID", util()->getRecordData(REC_MAX_ID).c_str());
    std::string text = log.text();
    EXPECT_EQ(2u, countLines(text, {"INFO: ", "ClassId is greater than MAXCLASSID"}));
    EXPECT_EQ(1u, countLines(text,
        {"INFO: ", "Diag Test Id is greater than DIAG_NAME_INVALID"}));
    EXPECT_EQ(1u, countLines(text, {"ERR: ", "Record ID is greater than REC_MAX_ID"}));
}

TEST_F(ProviderUtilTest, SmallTextTests)
{
    char out[64];
    ProviderUtil::trimString((char*)"  3.2.1 a  ", out);
    EXPECT_STREQ("3.2.1 a", out);
    ProviderUtil::trimString((char*)"    ", out);
    EXPECT_STREQ("", out);
    ProviderUtil::trimString((char*)"\t1 ", out);   // only blanks count
    EXPECT_STREQ("\t1", out);

    EXPECT_TRUE(ProviderUtil::valid_UTF_string(""));
    EXPECT_TRUE(ProviderUtil::valid_UTF_string("abc"));
    EXPECT_TRUE(ProviderUtil::valid_UTF_string("\xC2\xA9"));
    EXPECT_TRUE(ProviderUtil::valid_UTF_string("\xF4\x8F\xBF\xBF"));
    EXPECT_FALSE(ProviderUtil::valid_UTF_string("\xC1\x81"));
    EXPECT_FALSE(ProviderUtil::valid_UTF_string("\x80"));
    EXPECT_FALSE(ProviderUtil::valid_UTF_string("\xF5"));

    Json::Value error(Json::objectValue);
    error["error"] = "x";
    EXPECT_FALSE(ProviderUtil::isValidJsonResponse(Json::Value()));
    EXPECT_FALSE(ProviderUtil::isValidJsonResponse(error));
    EXPECT_TRUE(ProviderUtil::isValidJsonResponse(Json::Value(Json::objectValue)));
    EXPECT_TRUE(ProviderUtil::isValidJsonResponse(Json::Value(Json::arrayValue)));
    EXPECT_TRUE(ProviderUtil::isValidJsonResponse(Json::Value(0)));
    EXPECT_TRUE(ProviderUtil::isValidJsonResponse(Json::Value("error")));
}

TEST_F(ProviderUtilTest, DriverStatusReadsOnlyTwoAndThreeAsFalse)
{
    int saved = ProviderInit::driverStatus;
    const int statuses[] = { 0, 1, 2, 3, 4, -1 };
    const bool expected[] = { true, true, false, false, true, true };

    for (size_t i = 0; i < 6; i++)
    {
        ProviderInit::driverStatus = statuses[i];
        EXPECT_EQ(expected[i], ProviderUtil::getDriverStatus()) << statuses[i];
    }

    ProviderInit::driverStatus = saved;
}

TEST_F(ProviderUtilTest, LibraryLogLevelsAndPlace)
{
    // The library's levels: 1 debug, 2 info, 3 warning, 4 error, 5 info,
    // anything else debug.
    const int levels[] = { 0, 1, 2, 3, 4, 5, 6, -3 };
    const char* const expected[] = { "DBG: ", "DBG: ", "INFO: ", "WARN: ",
        "ERR: ", "INFO: ", "DBG: ", "DBG: " };

    for (size_t i = 0; i < 8; i++)
    {
        InProcessLog log;
        std::string text = "library says " + std::to_string(i);
        ProviderUtil::logMsg(levels[i], "hba_lib.c", 42, text.c_str());
        EXPECT_EQ(1u, countLines(log.text(), { expected[i],
            "ProviderUtil.cpp(", "): hba_lib.c:42 " + text })) << levels[i];
    }

    // The place is cut to 31 characters; nulls are survived.
    InProcessLog log;
    std::string longName(100, 'f');
    ProviderUtil::logMsg(2, longName.c_str(), 7, "tail");
    ProviderUtil::logMsg(2, 0, 7, 0);
    std::string text = log.text();
    EXPECT_EQ(1u, countLines(text, { "): " + std::string(31, 'f') + "tail" }));
    EXPECT_EQ(1u, countLines(text, { "): :7 " }));
}

TEST_F(ProviderUtilTest, HostFacts)
{
    EXPECT_GT(util()->getHostName().size(), 0u);

    char host[255];
    memset(host, 0, sizeof(host));
    int code = util()->getHostInfo(host, sizeof(host));
    ASSERT_TRUE(code == 0 || code == 2 || code == 3) << code;

    if (code == 0)
    {
        EXPECT_NE(0, strncmp(host, "127", 3)) << host;
    }
    if (code == 3)
    {
        EXPECT_STREQ("localhost", host);
    }
    EXPECT_GT(strlen(host), 0u);

    // Several threads at once get the same answer.
    std::vector<std::thread> threads;
    std::vector<std::string> answers(8);

    for (size_t i = 0; i < answers.size(); i++)
    {
        threads.emplace_back([&answers, i]() {
            for (int k = 0; k < 20; k++)
            {
                char buf[255];
                memset(buf, 0, sizeof(buf));
                util()->getHostInfo(buf, sizeof(buf));
                answers[i] = buf;
            }
        });
    }

    for (std::thread& t : threads)
        t.join();

    for (const std::string& a : answers)
        EXPECT_EQ(std::string(host), a);

    std::string path = util()->updateNamespacePath("VESPERA_FCPort").c_str();
    EXPECT_EQ("//" + std::string(host) + "/root/vespera:VESPERA_FCPort", path);
}

//------------------------------------------------------------------------------
// Adapter look-ups against the simulator
//------------------------------------------------------------------------------

TEST_F(ProviderUtilSimTest, AdapterListAndIds)
{
    Json::Value reply;
    EXPECT_EQ(2, util()->getNumberOfAdapters(reply));
    EXPECT_STREQ(FC_HBA_WWN, util()->getAddrByAdapterId(1).c_str());

    String second = util()->getAddrByAdapterId(2);
    EXPECT_TRUE(second.size() == 17 || second.size() == 23) << second.c_str();

    InProcessLog log;
    EXPECT_STREQ("", util()->getAddrByAdapterId(0).c_str());
    EXPECT_STREQ("", util()->getAddrByAdapterId(3).c_str());
    EXPECT_EQ(1u, countLines(log.text(), {"INFO: ", "numOfAdapters = 2. Id = 3"}));

    // Ids by plain address of either kind.
    EXPECT_EQ(1u, util()->getAdapterId("200000051e8a1000"));
    EXPECT_EQ(2u, util()->getAdapterId(ProviderUtil::eraseColonsFromIndex(second)));
    EXPECT_EQ(1u, util()->getAdapterIdByIndexStr(FC_HBA_WWN));

    InProcessLog bad;
    EXPECT_EQ((unsigned)-1, util()->getAdapterId("200000051e8a10"));
    EXPECT_EQ(1u, countLines(bad.text(),
        {"ERR: ", "The address passed is not MAC or WWN"}));
}

TEST_F(ProviderUtilSimTest, AdapterDetailsAskByWwnOrMac)
{
    Json::Value reply;
    EXPECT_EQ(0, util()->getAdapterDetails("200000051e8a1000", reply));
    EXPECT_STREQ("Vespera-1020", reply["hbaData"]["model"].asCString());

    cannedReply = hbaReply(Json::Value(Json::objectValue), Json::Value(Json::objectValue));
    ScopedEntry fake(libGetHbaByWwn, recordAndAnswer);

    EXPECT_EQ(0, util()->getAdapterDetails("00051e8b2000", reply));
    EXPECT_STREQ(CNA_MAC, lastRequest["mac"].asCString());
    EXPECT_FALSE(lastRequest.isMember("wwn"));

    EXPECT_EQ(0, util()->getAdapterDetails("200000051e8a1000", reply));
    EXPECT_STREQ(FC_HBA_WWN, lastRequest["wwn"].asCString());
    EXPECT_FALSE(lastRequest.isMember("mac"));

    // Replies short of "hbaData" or "driver", or with "error", fail.
    Json::Value noDriver(Json::objectValue);
    noDriver["hbaData"] = Json::Value(Json::objectValue);
    Json::Value error = hbaReply(Json::Value(Json::objectValue), Json::Value(Json::objectValue));
    error["error"] = "no such adapter";
    const Json::Value bad[] = { Json::Value(), noDriver, error,
        Json::Value("text"), hbaReply(Json::Value(5), Json::Value(Json::objectValue)) };

    for (const Json::Value& b : bad)
    {
        cannedReply = b;
        InProcessLog log;
        EXPECT_EQ(-1, util()->getAdapterDetails("200000051e8a1000", reply));
        EXPECT_EQ(1u, countLines(log.text(),
            {"ERR: ", "Unable to get adapater details for 200000051e8a1000"}));
    }
}

TEST_F(ProviderUtilSimTest, LibraryExceptionsStayInside)
{
    struct { JsonReqFP thrower; const char* line; } cases[] = {
        { throwHba, "200000051e8a1000 - libGetHbaByWwn got User exception 7: adapter gone" },
        { throwStd, "200000051e8a1000 - libGetHbaByWwn got std exception: bad alloc in library" },
        { throwInt, "200000051e8a1000 - libGetHbaByWwn got default exception" },
    };

    for (auto& c : cases)
    {
        ScopedEntry fake(libGetHbaByWwn, c.thrower);
        InProcessLog log;
        Json::Value reply;
        EXPECT_EQ(-1, util()->getAdapterDetails("200000051e8a1000", reply));
        EXPECT_EQ(1u, countLines(log.text(), {"ERR: ", c.line}));

        // Everything built on the details fails quietly too.
        EXPECT_STREQ("", util()->getAdapterSerialNumber("200000051e8a1000").c_str());
        EXPECT_FALSE(util()->isCNA("200000051e8a1000"));
        EXPECT_FALSE(util()->checkIfThisAdapterModelPresent("Vespera-1020"));
        EXPECT_STREQ("", util()->getDriverVersion().c_str());
    }

    {
        ScopedEntry fake(libGetAllAdaptersIndexString, throwHba);
        InProcessLog log;
        Json::Value reply;
        EXPECT_EQ(-1, util()->getNumberOfAdapters(reply));
        EXPECT_STREQ("", util()->getAddrByAdapterId(1).c_str());
        EXPECT_EQ(2u, countLines(log.text(),
            {"ERR: ", "libGetAllAdaptersIndexString returns NULL."}));
    }

    {
        ScopedEntry fake(libGetAdapterId, throwStd);
        EXPECT_EQ((unsigned)-1, util()->getAdapterIdByIndexStr(FC_HBA_WWN));
    }
}

TEST_F(ProviderUtilSimTest, FaultsOfTheRealLibraryAreCaught)
{
    // Thrown inside libdtruj.so, caught by type in our code.
    struct { const char* fault; const char* line; } cases[] = {
        { "{\"kind\": \"hba\", \"code\": 9, \"message\": \"no such HBA\"}",
          "libGetHbaByWwn got User exception 9: no such HBA" },
        { "std", "libGetHbaByWwn got std exception: " },
        { "unknown", "libGetHbaByWwn got default exception" },
        { "null", "Unable to get adapater details for 200000051e8a1000" },
        { "error", "Unable to get adapater details for 200000051e8a1000" },
    };

    for (auto& c : cases)
    {
        ASSERT_EQ(0, dtruj_sim_set_fault("getHbaByWwn", c.fault));
        InProcessLog log;
        Json::Value reply;
        EXPECT_EQ(-1, util()->getAdapterDetails("200000051e8a1000", reply)) << c.fault;
        EXPECT_EQ(1u, countLines(log.text(), {"ERR: ", c.line})) << c.fault << log.text();
        dtruj_sim_set_fault("getHbaByWwn", "none");
    }

    ASSERT_EQ(0, dtruj_sim_set_fault("getAllAdaptersIndexString", "error"));
    Json::Value reply;
    EXPECT_EQ(-1, util()->getNumberOfAdapters(reply));
    EXPECT_STREQ("", util()->getDriverVersion().c_str());
    dtruj_sim_set_fault("getAllAdaptersIndexString", "none");
    EXPECT_EQ(2, util()->getNumberOfAdapters(reply));
}

TEST_F(ProviderUtilSimTest, SerialNumberRules)
{
    EXPECT_STREQ("VSP1020A0001",
        util()->getAdapterSerialNumber("200000051e8a1000").c_str());

    struct { const char* oem; const char* part; const char* expected; } cases[] = {
        { "AB123", "AB", "123" },
        { "AB123", "XY", "AB123" },
        { "AB123", "", "AB123" },
        { "", "AB", "SER-1" },
        { "AB", "AB", "" },
    };

    ScopedEntry fake(libGetHbaByWwn, recordAndAnswer);

    for (auto& c : cases)
    {
        Json::Value hba(Json::objectValue);
        hba["oemSerialNum"] = c.oem;
        hba["partNum"] = c.part;
        hba["serialNumber"] = "SER-1";
        cannedReply = hbaReply(hba, Json::Value(Json::objectValue));
        EXPECT_STREQ(c.expected,
            util()->getAdapterSerialNumber("200000051e8a1000").c_str()) << c.oem;
    }

    // Members of the wrong type read as empty.
    Json::Value hba(Json::objectValue);
    hba["oemSerialNum"] = 12345;
    hba["serialNumber"] = Json::Value(Json::arrayValue);
    cannedReply = hbaReply(hba, Json::Value(Json::objectValue));
    EXPECT_STREQ("", util()->getAdapterSerialNumber("200000051e8a1000").c_str());
}

TEST_F(ProviderUtilSimTest, ModelMatching)
{
    EXPECT_TRUE(util()->checkIfThisAdapterModelPresent("Vespera-1020"));
    EXPECT_TRUE(util()->checkIfThisAdapterModelPresent("vespera-1860"));
    EXPECT_TRUE(util()->checkIfThisAdapterModelPresent("VESPERA-1020-Rev2"));
    EXPECT_FALSE(util()->checkIfThisAdapterModelPresent("Vespera-10"));
    EXPECT_FALSE(util()->checkIfThisAdapterModelPresent("Vespera-4096"));

    Json::Value empty(Json::objectValue);
    empty["indexStrings"] = Json::Value(Json::arrayValue);
    cannedReply = empty;
    ScopedEntry fake(libGetAllAdaptersIndexString, recordAndAnswer);
    InProcessLog log;
    EXPECT_FALSE(util()->checkIfThisAdapterModelPresent("Vespera-1020"));
    EXPECT_EQ(1u, countLines(log.text(), {"WARN: ", "No adapters in the system!"}));
}

TEST_F(ProviderUtilSimTest, AdapterFlags)
{
    String cna = util()->getAddrByAdapterId(2);
    EXPECT_FALSE(util()->isCNA("200000051e8a1000"));
    EXPECT_TRUE(util()->isCNA(cna));
    EXPECT_FALSE(util()->hasEthernetPort(FC_HBA_WWN));
    EXPECT_TRUE(util()->hasEthernetPort(cna));

    Json::Value hba(Json::objectValue);
    hba["isCNA"] = "yes";
    cannedReply = hbaReply(hba, Json::Value(Json::objectValue));
    ScopedEntry fake(libGetHbaByWwn, recordAndAnswer);
    InProcessLog log;
    EXPECT_FALSE(util()->isCNA(cna));
    EXPECT_FALSE(util()->hasEthernetPort(cna));
    std::string text = log.text();
    EXPECT_EQ(1u, countLines(text, {"ERR: ", "Unable to get CNA info for"}));
    EXPECT_EQ(1u, countLines(text, {"ERR: ", "Unable to get Ethernet info"}));
}

TEST_F(ProviderUtilSimTest, DriverVersion)
{
    EXPECT_STREQ("3.2.1.0", util()->getDriverVersion().c_str());

    ScopedEntry fake(libGetHbaByWwn, recordAndAnswer);
    Json::Value driver(Json::objectValue);

    driver["networkDriverVersion"] = "  2.0.1  ";
    cannedReply = hbaReply(Json::Value(Json::objectValue), driver);
    EXPECT_STREQ("2.0.1", util()->getDriverVersion().c_str());

    // An over-long text is cut to the 63 characters of its record.
    driver["storageDriverVersion"] = std::string(500, '9');
    cannedReply = hbaReply(Json::Value(Json::objectValue), driver);
    EXPECT_EQ(std::string(63, '9'), util()->getDriverVersion().c_str());

    driver = Json::Value(Json::objectValue);
    driver["storageDriverVersion"] = 3;
    cannedReply = hbaReply(Json::Value(Json::objectValue), driver);
    InProcessLog log;
    EXPECT_STREQ("", util()->getDriverVersion().c_str());
    EXPECT_EQ(1u, countLines(log.text(), {"ERR: ", "Unable to get driver version for"}));
}

TEST_F(ProviderUtilSimTest, AdapterIdReplyIsChecked)
{
    ScopedEntry fake(libGetAdapterId, recordAndAnswer);

    Json::Value reply(Json::objectValue);
    reply["adapterId"] = 4;
    cannedReply = reply;
    EXPECT_EQ(4u, util()->getAdapterIdByMacAddr("00051e8b2000"));
    EXPECT_STREQ(CNA_MAC, lastRequest["indexStr"].asCString());

    const Json::Value bad[] = { Json::Value("4"), Json::Value(-2), Json::Value(1.5),
        Json::Value() };

    for (const Json::Value& b : bad)
    {
        reply["adapterId"] = b;
        cannedReply = reply;
        InProcessLog log;
        EXPECT_EQ((unsigned)-1, util()->getAdapterIdByNWWN("200000051e8a1000"));
        EXPECT_EQ(1u, countLines(log.text(), {"ERR: ", "libGetAdapterId returns NULL."}));
    }
}
