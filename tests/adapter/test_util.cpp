// ProviderUtil on its own, against the simulated adapter library (its default
// host: an FC HBA and a CNA), and against hand-made replies put in place of
// single entries.

#include <gtest/gtest.h>

#include <string.h>

#include <string>
#include <thread>
#include <vector>

#include "CIMProviderTruj.h"
#include "TestSupport.h"
#include "ProviderInit.h"
#include "ProviderUtil.h"

// The simulator's own switch.
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

std::string str(const String& s)
{
    return std::string(s.c_str(), s.size());
}

Json::Value lastRequest;
Json::Value cannedReply;

Json::Value recordAndAnswer(const Json::Value& request)
{
    lastRequest = request;
    return cannedReply;
}

// Puts recordAndAnswer in place of one library entry for the object's life.
class Fake
{
public:
    Fake(JsonReqFP& slot, const Json::Value& reply) : _slot(slot), _saved(slot)
    {
        cannedReply = reply;
        _slot = recordAndAnswer;
    }
    ~Fake() { _slot = _saved; }
private:
    JsonReqFP& _slot;
    JsonReqFP _saved;
};

Json::Value hbaReply(const char* hbaMember, const Json::Value& value,
    const Json::Value& driver = Json::Value(Json::objectValue))
{
    Json::Value reply(Json::objectValue);
    reply["hbaData"] = Json::Value(Json::objectValue);
    reply["hbaData"][hbaMember] = value;
    reply["driver"] = driver;
    return reply;
}

const char* const HBA = "200000051e8a1000";
const char* const HBA_COLON = "20:00:00:05:1e:8a:10:00";

class Util : public ::testing::Test
{
protected:
    void SetUp() override
    {
        InProcessLog::path();
        ASSERT_TRUE(gTrujLibLoaded) << "the start-up didn't load libdtruj.so";
    }
};

} // namespace

TEST_F(Util, AddressForms)
{
    EXPECT_EQ("10:00:00:05:1E:8a:10:01",
        str(ProviderUtil::getIndexInColonFormat("100000051E8a1001")));
    EXPECT_EQ("00:05:1e:8b:20:00", str(ProviderUtil::getIndexInColonFormat("00051e8b2000")));
    EXPECT_EQ("abc", str(ProviderUtil::getIndexInColonFormat("abc")));
    EXPECT_EQ("01:23:45:67:89:abc", str(ProviderUtil::getIndexInColonFormat("0123456789abc")));

    InProcessLog log;
    EXPECT_EQ("a:bcdef", str(ProviderUtil::getIndexInColonFormat("a:bcdef")));
    EXPECT_EQ(1u, countLines(log.text(), {"INFO: ", "The string a:bcdef is already in : format"}));

    EXPECT_EQ("100000051E8a1001",
        str(ProviderUtil::eraseColonsFromIndex("10:00:00:05:1E:8a:10:01")));

    unsigned char raw[9];
    memset(raw, 0xEE, sizeof(raw));
    util()->getRawWWNFromStr((char*)"100000051e8a10zz", raw);
    const unsigned char wwn[9] = { 0x10, 0, 0, 0x05, 0x1e, 0x8a, 0x10, 0, 0xEE };
    EXPECT_EQ(0, memcmp(raw, wwn, sizeof(raw)));

    // The Tag of an FC adapter and of a CNA, and one too short to carry one.
    EXPECT_EQ("100000051e8a1001",
        str(util()->getNodeMACOrWWNFromTag("10000000-0000-0000-1000-00051e8a1001")));
    EXPECT_EQ("00051e8b2000",
        str(util()->getNodeMACOrWWNFromTag("10000000-0000-0000-0000-00051e8b2000")));
    EXPECT_EQ("", str(util()->getNodeMACOrWWNFromTag("10000000-0000-0000-0")));
}

TEST_F(Util, NamesAndTexts)
{
    EXPECT_EQ("Vespera:SerdesEthLoopbackTest",
        str(util()->getDiagTestName(DIAG_SERDES_ETH_LOOPBACK_TEST)));

    InProcessLog log;
    EXPECT_EQ("INVALID CLASS", str(util()->getClassName((classId_t)39)));
    EXPECT_EQ("INVALID CLASS", str(util()->getClassName((classId_t)-1)));
    EXPECT_EQ("INVALID DIAGNOSTIC ID", str(util()->getDiagTestName(DIAG_NAME_INVALID)));
    EXPECT_EQ("INVALID RECORD ID", str(util()->getRecordData(REC_MAX_ID)));
    EXPECT_EQ(2u, countLines(log.text(), {"INFO: ", "ClassId is greater than MAXCLASSID"}));
    EXPECT_EQ(1u, countLines(log.text(), {"ERR: ", "Record ID is greater than REC_MAX_ID"}));

    char out[16];
    ProviderUtil::trimString((char*)"  3.2 a  ", out);
    EXPECT_STREQ("3.2 a", out);
    ProviderUtil::trimString((char*)"   ", out);
    EXPECT_STREQ("", out);

    EXPECT_TRUE(ProviderUtil::valid_UTF_string(""));
    EXPECT_TRUE(ProviderUtil::valid_UTF_string("\xC2\xA9"));
    EXPECT_FALSE(ProviderUtil::valid_UTF_string("\xC1\x81"));
    EXPECT_FALSE(ProviderUtil::valid_UTF_string("\xF5"));

    Json::Value error(Json::objectValue);
    error["error"] = "x";
    EXPECT_FALSE(ProviderUtil::isValidJsonResponse(Json::Value()));
    EXPECT_FALSE(ProviderUtil::isValidJsonResponse(error));
    EXPECT_TRUE(ProviderUtil::isValidJsonResponse(Json::Value(Json::arrayValue)));
    EXPECT_TRUE(ProviderUtil::isValidJsonResponse(Json::Value("error")));
}

TEST_F(Util, DriverStatusAndLibraryLog)
{
    int saved = ProviderInit::driverStatus;
    const int statuses[] = { 0, 1, 2, 3, 4 };
    const bool expected[] = { true, true, false, false, true };

    for (size_t i = 0; i < 5; i++)
    {
        ProviderInit::driverStatus = statuses[i];
        EXPECT_EQ(expected[i], ProviderUtil::getDriverStatus()) << statuses[i];
    }

    ProviderInit::driverStatus = saved;

    const char* const levels[] = { "DBG: ", "DBG: ", "INFO: ", "WARN: ", "ERR: ", "INFO: ", "DBG: " };

    for (int level = 0; level < 7; level++)
    {
        InProcessLog log;
        ProviderUtil::logMsg(level, "hba_lib.c", 42, "said");
        EXPECT_EQ(1u, countLines(log.text(),
            { levels[level], "ProviderUtil.cpp(", "): hba_lib.c:42 said" })) << level;
    }

    // The library's place is cut to 31 characters; nulls are survived.
    InProcessLog log;
    ProviderUtil::logMsg(2, std::string(100, 'f').c_str(), 7, "tail");
    ProviderUtil::logMsg(2, 0, 7, 0);
    EXPECT_EQ(1u, countLines(log.text(), { "): " + std::string(31, 'f') + "tail" }));
    EXPECT_EQ(1u, countLines(log.text(), { "): :7 " }));
}

TEST_F(Util, HostFacts)
{
    char host[255];
    memset(host, 0, sizeof(host));
    int code = util()->getHostInfo(host, sizeof(host));
    ASSERT_TRUE(code == 0 || code == 2 || code == 3) << code;
    EXPECT_TRUE(code != 0 || strncmp(host, "127", 3) != 0) << host;
    EXPECT_TRUE(code != 3 || strcmp(host, "localhost") == 0) << host;

    // Many threads at once get the same answer.
    std::vector<std::thread> threads;
    std::vector<std::string> answers(6);

    for (size_t i = 0; i < answers.size(); i++)
    {
        threads.emplace_back([&answers, i]() {
            for (int k = 0; k < 20; k++)
            {
                char buf[255] = "";
                util()->getHostInfo(buf, sizeof(buf));
                answers[i] = buf;
            }
        });
    }

    for (std::thread& t : threads)
        t.join();

    for (const std::string& a : answers)
        EXPECT_EQ(host, a);

    EXPECT_EQ("//" + std::string(host) + "/root/vespera:VESPERA_FCPort",
        str(util()->updateNamespacePath("VESPERA_FCPort")));
}

TEST_F(Util, AdapterLookUps)
{
    Json::Value reply;
    EXPECT_EQ(2, util()->getNumberOfAdapters(reply));
    EXPECT_EQ(HBA_COLON, str(util()->getAddrByAdapterId(1)));
    String cna = ProviderUtil::eraseColonsFromIndex(util()->getAddrByAdapterId(2));

    InProcessLog log;
    EXPECT_EQ("", str(util()->getAddrByAdapterId(0)));
    EXPECT_EQ("", str(util()->getAddrByAdapterId(3)));
    EXPECT_EQ(1u, countLines(log.text(), {"INFO: ", "numOfAdapters = 2. Id = 3"}));

    EXPECT_EQ(1u, util()->getAdapterId(HBA));
    EXPECT_EQ(2u, util()->getAdapterId(cna));
    EXPECT_EQ((unsigned)-1, util()->getAdapterId("200000051e8a10"));
    EXPECT_EQ(1u, countLines(log.text(), {"ERR: ", "The address passed is not MAC or WWN"}));

    EXPECT_FALSE(util()->isCNA(HBA));
    EXPECT_TRUE(util()->isCNA(cna));
    EXPECT_FALSE(util()->hasEthernetPort(HBA));
    EXPECT_TRUE(util()->hasEthernetPort(cna));

    EXPECT_EQ("VSP1020A0001", str(util()->getAdapterSerialNumber(HBA)));
    EXPECT_EQ("3.2.1.0", str(util()->getDriverVersion()));

    // Model names: any case, and the adapter's may be a leading part.
    EXPECT_TRUE(util()->checkIfThisAdapterModelPresent("vespera-1860"));
    EXPECT_TRUE(util()->checkIfThisAdapterModelPresent("VESPERA-1020-Rev2"));
    EXPECT_FALSE(util()->checkIfThisAdapterModelPresent("Vespera-10"));

    // The Ethernet device name, by either address form; an unknown port
    // gives an empty name and says so.
    EXPECT_EQ("eth2", str(util()->getEthDeviceNameByMAC("00:05:1e:8b:20:02")));
    EXPECT_EQ("eth2", str(util()->getEthDeviceNameByMAC("00051e8b2002")));
    EXPECT_EQ("", str(util()->getEthDeviceNameByMAC("00051e8b2099")));
    EXPECT_EQ(1u, countLines(log.text(),
        {"ERR: ", "Unable to get Eth Device Name for 00051e8b2099"}));
}

TEST_F(Util, AdapterDetailsAskByWwnOrMac)
{
    Fake fake(libGetHbaByWwn, hbaReply("model", "x"));
    Json::Value reply;

    EXPECT_EQ(0, util()->getAdapterDetails("00051e8b2000", reply));
    EXPECT_EQ("00:05:1e:8b:20:00", lastRequest["mac"].asString());
    EXPECT_FALSE(lastRequest.isMember("wwn"));

    EXPECT_EQ(0, util()->getAdapterDetails(HBA, reply));
    EXPECT_EQ(HBA_COLON, lastRequest["wwn"].asString());
    EXPECT_FALSE(lastRequest.isMember("mac"));

    // Without "driver", or with "hbaData" of the wrong type, it fails.
    Json::Value noDriver = hbaReply("model", "x");
    noDriver.removeMember("driver");
    Json::Value badHba = hbaReply("model", "x");
    badHba["hbaData"] = 5;

    for (const Json::Value& bad : { noDriver, badHba, Json::Value("text") })
    {
        cannedReply = bad;
        InProcessLog log;
        EXPECT_EQ(-1, util()->getAdapterDetails(HBA, reply));
        EXPECT_EQ(1u, countLines(log.text(),
            {"ERR: ", "Unable to get adapater details for 200000051e8a1000"}));
    }
}

TEST_F(Util, FaultsOfTheLibraryAreCaught)
{
    // Thrown inside libdtruj.so, caught by type here.
    struct { const char* fault; const char* line; } cases[] = {
        { "{\"kind\": \"hba\", \"code\": 9, \"message\": \"no such HBA\"}",
          "200000051e8a1000 - libGetHbaByWwn got User exception 9: no such HBA" },
        { "std", "200000051e8a1000 - libGetHbaByWwn got std exception: " },
        { "unknown", "200000051e8a1000 - libGetHbaByWwn got default exception" },
        { "null", "Unable to get adapater details for 200000051e8a1000" },
        { "error", "Unable to get adapater details for 200000051e8a1000" },
    };

    for (auto& c : cases)
    {
        ASSERT_EQ(0, dtruj_sim_set_fault("getHbaByWwn", c.fault));
        InProcessLog log;
        EXPECT_EQ("", str(util()->getAdapterSerialNumber(HBA))) << c.fault;
        EXPECT_FALSE(util()->isCNA(HBA));
        EXPECT_EQ(2u, countLines(log.text(), {"ERR: ", c.line})) << c.fault << log.text();
        dtruj_sim_set_fault("getHbaByWwn", "none");
    }

    ASSERT_EQ(0, dtruj_sim_set_fault("getAllAdaptersIndexString", "hba"));
    InProcessLog log;
    Json::Value reply;
    EXPECT_EQ(-1, util()->getNumberOfAdapters(reply));
    EXPECT_FALSE(util()->checkIfThisAdapterModelPresent("Vespera-1020"));
    EXPECT_EQ(1u, countLines(log.text(), {"WARN: ", "No adapters in the system!"}));
    dtruj_sim_set_fault("getAllAdaptersIndexString", "none");
}

TEST_F(Util, SerialNumberRules)
{
    struct { const char* oem; const char* part; const char* expected; } cases[] = {
        { "AB123", "AB", "123" }, { "AB123", "XY", "AB123" },
        { "AB123", "", "AB123" }, { "", "AB", "SER-1" },
    };

    Fake fake(libGetHbaByWwn, Json::Value());

    for (auto& c : cases)
    {
        cannedReply = hbaReply("oemSerialNum", c.oem);
        cannedReply["hbaData"]["partNum"] = c.part;
        cannedReply["hbaData"]["serialNumber"] = "SER-1";
        EXPECT_EQ(c.expected, str(util()->getAdapterSerialNumber(HBA))) << c.oem;
    }

    // Members of the wrong type read as empty.
    cannedReply = hbaReply("oemSerialNum", 12345);
    cannedReply["hbaData"]["serialNumber"] = Json::Value(Json::arrayValue);
    EXPECT_EQ("", str(util()->getAdapterSerialNumber(HBA)));
}

TEST_F(Util, UntrustedMembers)
{
    Json::Value driver(Json::objectValue);
    driver["networkDriverVersion"] = "  2.0.1  ";
    driver["storageDriverVersion"] = 3;
    {
        Fake fake(libGetHbaByWwn, hbaReply("isCNA", "yes", driver));
        EXPECT_EQ("2.0.1", str(util()->getDriverVersion()));
        EXPECT_FALSE(util()->isCNA(HBA));

        driver["storageDriverVersion"] = std::string(500, '9');
        cannedReply = hbaReply("isCNA", "yes", driver);
        EXPECT_EQ(std::string(63, '9'), str(util()->getDriverVersion()));
    }

    Json::Value id(Json::objectValue);
    id["adapterId"] = 4;
    Fake fake(libGetAdapterId, id);
    EXPECT_EQ(4u, util()->getAdapterIdByMacAddr("00051e8b2000"));
    EXPECT_EQ("00:05:1e:8b:20:00", lastRequest["indexStr"].asString());

    for (const Json::Value& bad : { Json::Value("4"), Json::Value(-2), Json::Value(1.5) })
    {
        cannedReply["adapterId"] = bad;
        InProcessLog log;
        EXPECT_EQ((unsigned)-1, util()->getAdapterIdByNWWN(HBA));
        EXPECT_EQ(1u, countLines(log.text(), {"ERR: ", "libGetAdapterId returns NULL."}));
    }
}
