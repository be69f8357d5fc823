// AdapterHelper in the test process, fed by a small fake library that
// answers the three entries the walk calls from replies the tests write:
// the vendor variants, CNA versus FC HBA, the driver rules, and replies that
// are broken in every way a library might break them.

#include <gtest/gtest.h>

#include <stdlib.h>
#include <string.h>

#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

#include "AdapterHelper.h"
#include "CIMProviderTruj.h"
#include "ProviderUtil.h"
#include "log.h"

#include "VESPERA_AdapterSoftwareIdentity.h"
#include "VESPERA_PhysicalPackage.h"
#include "VESPERA_PortController.h"
#include "VESPERA_Product.h"

using namespace OLMA;

namespace
{

//------------------------------------------------------------------------------
// The log, under a HOME of this process
//------------------------------------------------------------------------------

std::string readFile(const std::string& path)
{
    std::stringstream text;
    text << std::ifstream(path.c_str(), std::ios::binary).rdbuf();
    return text.str();
}

const std::string& logPath()
{
    struct Home
    {
        std::string dir;
        Home()
        {
            char name[] = "/tmp/vspr-adapter-helper-XXXXXX";
            dir = mkdtemp(name) ? name : "/tmp";
            std::ofstream(dir + "/.tesselrc") << "LOG_LEVEL=DBG\n";
            setenv("HOME", dir.c_str(), 1);
            close_log();
            log(LL_INFO, "test", __LINE__, "test log");
        }
        ~Home()
        {
            std::error_code ec;
            std::filesystem::remove_all(dir, ec);
        }
    };
    static Home home;
    static std::string path = home.dir + "/.tessel/messages";
    return path;
}

size_t countLines(const std::string& text, const std::string& piece)
{
    std::istringstream in(text);
    std::string line;
    size_t n = 0;
    while (std::getline(in, line))
        n += line.find(piece) != std::string::npos;
    return n;
}

//------------------------------------------------------------------------------
// The fake library
//------------------------------------------------------------------------------

struct FakeLibrary
{
    Json::Value indexReply;                 // getAllAdaptersIndexString
    std::map<std::string, Json::Value> hba; // getHbaByWwn, by "wwn" or "mac"
    std::map<std::string, Json::Value> flash;
    std::string throwFrom;                  // entry that throws, if any
    int throwKind = 0;                      // 0 HbaAgentError, 1 std, 2 other
};

FakeLibrary fake;

[[noreturn]] void throwNow()
{
    if (fake.throwKind == 0)
        throw HbaAgentError(7, "adapter busy");
    if (fake.throwKind == 1)
        throw std::runtime_error("bad alloc in library");
    throw 42;
}

Json::Value fakeIndex(const Json::Value&)
{
    if (fake.throwFrom == "index")
        throwNow();
    return fake.indexReply;
}

Json::Value fakeHba(const Json::Value& request)
{
    if (fake.throwFrom == "hba")
        throwNow();
    std::string key = request.isMember("mac") ? request["mac"].asString() : request["wwn"].asString();
    auto it = fake.hba.find(key);
    return it == fake.hba.end() ? Json::Value() : it->second;
}

Json::Value fakeFlash(const Json::Value& request)
{
    if (fake.throwFrom == "flash")
        throwNow();
    auto it = fake.flash.find(request["indexStr"].asString());
    return it == fake.flash.end() ? Json::Value() : it->second;
}

const char* const FC_INDEX = "20:00:00:05:1e:8a:10:00";
const char* const FC_PLAIN = "200000051e8a1000";
const char* const CNA_INDEX = "00:05:1e:8b:20:00";
const char* const CNA_PLAIN = "00051e8b2000";

Json::Value fcAdapter()
{
    Json::Value a;
    a["hbaData"]["wwn"] = FC_INDEX;
    a["hbaData"]["portCount"] = 2;
    a["hbaData"]["hbaStatus"] = true;
    a["hbaData"]["serialNumber"] = "VSP1020A0001";
    a["hbaData"]["model"] = "Vespera-1020";
    a["hbaData"]["oem"] = "VSPR";
    a["hbaData"]["fruNum"] = "FRU-1020-A";
    a["hbaData"]["partNum"] = "PN1020";
    a["hbaData"]["oemSerialNum"] = "";
    a["hbaData"]["uuid"] = "";
    a["driver"]["storageDriverName"] = "vsprfc";
    a["driver"]["storageDriverVersion"] = " 3.2.1.0 ";
    a["firmware"]["version"] = "3.2.1.0";
    a["firmware"]["biosVersion"] = "3.2.0.9";
    return a;
}

Json::Value cnaAdapter()
{
    Json::Value a;
    a["hbaData"]["hbaMAC"] = CNA_INDEX;
    a["hbaData"]["wwn"] = "20:00:00:05:1e:8b:20:00";
    a["hbaData"]["portCount"] = 3;
    a["hbaData"]["hbaStatus"] = false;
    a["hbaData"]["serialNumber"] = "VSP1860C0042";
    a["hbaData"]["model"] = "Vespera-1860";
    a["hbaData"]["oem"] = "Hp Enterprise";
    a["hbaData"]["fruNum"] = "FRU-HIDDEN";
    a["hbaData"]["partNum"] = "PN1860";
    a["hbaData"]["oemSerialNum"] = "PN1860MY12345";
    a["hbaData"]["uuid"] = "6a1f0c2e9b7d4e1f8c3a5b6d7e8f9012";
    a["driver"]["storageDriverName"] = "vsprfc";
    a["driver"]["storageDriverVersion"] = "3.2.1.0";
    a["driver"]["networkDriverName"] = "vspreth";
    a["driver"]["networkDriverVersion"] = "3.2.1.5 ";
    a["firmware"]["version"] = "3.2.1.1";
    a["firmware"]["biosVersion"] = "3.2.1.1";
    return a;
}

Json::Value flashReply(bool present)
{
    Json::Value f;
    f["flashStatus"] = present;
    return f;
}

std::string str(const String& s)
{
    return std::string(s.c_str(), s.size());
}

std::vector<std::string> strs(const Array<String>& a)
{
    std::vector<std::string> v;
    for (size_t i = 0; i < a.size(); i++)
        v.push_back(str(a[i]));
    return v;
}

std::vector<unsigned> nums(const Array<uint16>& a)
{
    return std::vector<unsigned>(a.data(), a.data() + a.size());
}

class AdapterHelperTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        logPath();
        fake = FakeLibrary();
        _index = libGetAllAdaptersIndexString;
        _hba = libGetHbaByWwn;
        _flash = libGetFlashInfo;
        libGetAllAdaptersIndexString = fakeIndex;
        libGetHbaByWwn = fakeHba;
        libGetFlashInfo = fakeFlash;

        char host[256] = {0};
        ProviderUtil::getProviderUtil()->getHostInfo(host, 255);
        hostName = host;
        _logStart = readFile(logPath()).size();
    }

    void TearDown() override
    {
        libGetAllAdaptersIndexString = _index;
        libGetHbaByWwn = _hba;
        libGetFlashInfo = _flash;
    }

    // Serves the adapters under their index strings, in this order.
    void serve(const std::vector<std::pair<std::string, Json::Value>>& adapters)
    {
        fake.indexReply = Json::Value(Json::objectValue);
        fake.indexReply["indexStrings"] = Json::Value(Json::arrayValue);
        for (const auto& a : adapters)
        {
            fake.indexReply["indexStrings"].append(a.first);
            fake.hba[a.first] = a.second;
        }
    }

    std::string logged() const
    {
        std::string all = readFile(logPath());
        return all.size() > _logStart ? all.substr(_logStart) : std::string();
    }

    // The instances of a class; the test owns them until the fixture ends.
    template<class T>
    std::vector<T*> instances(classId_t id)
    {
        Array<Instance*> a = AdapterHelper::getAdapterHelperInstance()->getInstancesByClass(id);
        std::vector<T*> v;
        for (size_t i = 0; i < a.size(); i++)
        {
            _owned.push_back(Ref<Instance>(a[i]));
            T* t = checked_cast<T>(a[i]);
            EXPECT_TRUE(t != 0) << "element " << i << " of class id " << id;
            if (t)
                v.push_back(t);
        }
        return v;
    }

    std::string hostName;

private:
    JsonReqFP _index;
    JsonReqFP _hba;
    JsonReqFP _flash;
    size_t _logStart = 0;
    std::vector<Ref<Instance>> _owned;
};

//------------------------------------------------------------------------------
// The four classes of an FC HBA and of a CNA
//------------------------------------------------------------------------------

TEST_F(AdapterHelperTest, PortControllerOfFcHbaAndDisabledCna)
{
    serve({{FC_INDEX, fcAdapter()}, {CNA_INDEX, cnaAdapter()}});
    auto pcs = instances<VESPERA_PortController>(ID_VESPERA_PortController);
    ASSERT_EQ(2u, pcs.size());

    VESPERA_PortController* fc = pcs[0];
    EXPECT_EQ("VESPERA_PortController", str(fc->CreationClassName.value));
    EXPECT_EQ("VESPERA_ComputerSystem", str(fc->SystemCreationClassName.value));
    EXPECT_EQ(hostName, str(fc->SystemName.value));
    EXPECT_EQ(FC_PLAIN, str(fc->DeviceID.value));
    EXPECT_EQ("VSP1020A0001", str(fc->Name.value));
    EXPECT_EQ("VSP1020A0001", str(fc->ElementName.value));
    EXPECT_EQ("Vespera FC HBA", str(fc->Caption.value));
    EXPECT_EQ("Vespera FC HBA", str(fc->Description.value));
    EXPECT_EQ(std::vector<unsigned>{11}, nums(fc->OperationalStatus.value));
    EXPECT_EQ(std::vector<std::string>{"The adapter is in service"}, strs(fc->StatusDescriptions.value));
    EXPECT_EQ(2, fc->EnabledState.value);
    EXPECT_EQ(4, fc->ControllerType.value);
    EXPECT_EQ(1, fc->OtherControllerType.null);

    // The CNA has a storage driver too, so a node WWN, yet it is named by MAC;
    // its serial number is the OEM one without the part number in front.
    VESPERA_PortController* cna = pcs[1];
    EXPECT_EQ(CNA_PLAIN, str(cna->DeviceID.value));
    EXPECT_EQ("MY12345", str(cna->Name.value));
    EXPECT_EQ("Vespera CNA", str(cna->Caption.value));
    EXPECT_EQ(std::vector<unsigned>{10}, nums(cna->OperationalStatus.value));
    EXPECT_EQ(std::vector<std::string>{"The adapter is disabled"}, strs(cna->StatusDescriptions.value));
    EXPECT_EQ(3, cna->EnabledState.value);
    EXPECT_EQ(1, cna->ControllerType.value);
    EXPECT_EQ("CNA - FC and Ethernet types", str(cna->OtherControllerType.value));

    std::string log = logged();
    EXPECT_EQ(1u, countLines(log, "Number of Adapters: 2"));
    EXPECT_EQ(1u, countLines(log, "Adapter Type : FC HBA"));
    EXPECT_EQ(1u, countLines(log, "Adapter Type : CNA"));
    EXPECT_EQ(1u, countLines(log, "Number of instances: 2"));
}

TEST_F(AdapterHelperTest, PhysicalPackageAndProductOfFcHbaAndCna)
{
    Json::Value plainCna = cnaAdapter();
    plainCna["hbaData"]["uuid"] = "";
    plainCna["hbaData"]["hbaMAC"] = "00:05:1e:8b:30:00";
    serve({{FC_INDEX, fcAdapter()}, {CNA_INDEX, cnaAdapter()}, {"00:05:1e:8b:30:00", plainCna}});

    auto pps = instances<VESPERA_PhysicalPackage>(ID_VESPERA_PhysicalPackage);
    ASSERT_EQ(3u, pps.size());

    VESPERA_PhysicalPackage* fc = pps[0];
    EXPECT_EQ("VESPERA_PhysicalPackage", str(fc->CreationClassName.value));
    EXPECT_EQ("10000000-0000-0000-2000-00051e8a1000", str(fc->Tag.value));
    EXPECT_EQ("VSPR", str(fc->Manufacturer.value));
    EXPECT_EQ("Vespera FC HBA", str(fc->Caption.value));
    EXPECT_EQ("Vespera FC HBA", str(fc->ElementName.value));
    EXPECT_EQ("Vespera FC HBA", str(fc->Description.value));
    EXPECT_EQ("Vespera-1020", str(fc->Model.value));
    EXPECT_EQ("VSP1020A0001", str(fc->SerialNumber.value));
    EXPECT_EQ("PN1020", str(fc->PartNumber.value));
    EXPECT_EQ("FRU-1020-A", str(fc->SKU.value));
    EXPECT_EQ("VSPR Fiber Channel Adapter VSP1020A0001", str(fc->Name.value));
    EXPECT_EQ(9, fc->PackageType.value);

    // The tag undoes to the address the card is found by.
    EXPECT_EQ(FC_PLAIN, str(ProviderUtil::getProviderUtil()->getNodeMACOrWWNFromTag(fc->Tag.value)));

    // An "Hp" vendor hides the FRU number, whatever the reply holds.
    VESPERA_PhysicalPackage* cna = pps[1];
    EXPECT_EQ("6a1f0c2e9b7d4e1f8c3a5b6d7e8f9012", str(cna->Tag.value));
    EXPECT_EQ("Vespera CNA", str(cna->Caption.value));
    EXPECT_EQ("", str(cna->SKU.value));
    EXPECT_EQ(0, cna->SKU.null);
    EXPECT_EQ("VSPR Ethernet Adapter MY12345", str(cna->Name.value));

    EXPECT_EQ("10000000-0000-0000-0000-00051e8b3000", str(pps[2]->Tag.value));
    EXPECT_EQ("00051e8b3000", str(ProviderUtil::getProviderUtil()->getNodeMACOrWWNFromTag(pps[2]->Tag.value)));

    auto products = instances<VESPERA_Product>(ID_VESPERA_Product);
    ASSERT_EQ(3u, products.size());
    EXPECT_EQ("Vespera FC HBA", str(products[0]->Caption.value));
    EXPECT_EQ("Vespera FC HBA", str(products[0]->ElementName.value));
    EXPECT_EQ("Vespera FC HBA", str(products[0]->Description.value));
    EXPECT_EQ("VESPERA CIM Provider", str(products[0]->Name.value));
    EXPECT_EQ("3.2.1.0", str(products[0]->Version.value));
    EXPECT_EQ("VSPR", str(products[0]->Vendor.value));
    EXPECT_EQ("VSP1020A0001", str(products[0]->IdentifyingNumber.value));
    EXPECT_EQ("Vespera CNA", str(products[1]->Description.value));
    EXPECT_EQ("3.2.1.1", str(products[1]->Version.value));
    EXPECT_EQ("MY12345", str(products[1]->IdentifyingNumber.value));
}

// Each driver kind once a host, from the first adapter that has it; BIOS and
// firmware once an adapter.
TEST_F(AdapterHelperTest, SoftwareIdentities)
{
    Json::Value secondFc = fcAdapter();
    const char* secondIndex = "20:00:00:05:1e:8a:20:00";
    secondFc["hbaData"]["wwn"] = secondIndex;
    secondFc["hbaData"]["serialNumber"] = "";
    secondFc["driver"]["storageDriverVersion"] = "9.9.9.9";
    serve({{FC_INDEX, fcAdapter()}, {CNA_INDEX, cnaAdapter()}, {secondIndex, secondFc}});
    fake.flash[FC_INDEX] = flashReply(true);
    fake.flash[CNA_INDEX] = flashReply(false);
    Json::Value flashError;
    flashError["error"]["code"] = 3;
    flashError["flashStatus"] = true;
    fake.flash[secondIndex] = flashError;

    auto sw = instances<VESPERA_AdapterSoftwareIdentity>(ID_VESPERA_AdapterSoftwareIdentity);
    std::vector<std::string> ids;
    for (auto* s : sw)
        ids.push_back(str(s->InstanceID.value));
    EXPECT_EQ((std::vector<std::string>{
        "vsprfc", std::string(FC_PLAIN) + "_bios", std::string(FC_PLAIN) + "_firmware",
        "vspreth", std::string(CNA_PLAIN) + "_firmware",
        "200000051e8a2000_firmware"}), ids);
    ASSERT_EQ(6u, sw.size());

    const std::vector<std::string> infoType{"SoftwareID", "SoftwareStatus"};

    VESPERA_AdapterSoftwareIdentity* storage = sw[0];
    EXPECT_EQ("3.2.1.0", str(storage->VersionString.value));
    EXPECT_EQ(std::vector<unsigned>{2}, nums(storage->Classifications.value));
    EXPECT_EQ("Storage driver", str(storage->ElementName.value));
    EXPECT_EQ("Storage driver", str(storage->Caption.value));
    EXPECT_EQ("Storage driver", str(storage->Description.value));
    EXPECT_EQ("Storage driver for Vespera adapter", str(storage->Name.value));
    EXPECT_EQ("VSPR", str(storage->Manufacturer.value));
    EXPECT_EQ(infoType, strs(storage->IdentityInfoType.value));
    EXPECT_EQ((std::vector<std::string>{"Storage driver for Vespera adapter", "Primary"}),
        strs(storage->IdentityInfoValue.value));

    VESPERA_AdapterSoftwareIdentity* bios = sw[1];
    EXPECT_EQ("3.2.0.9", str(bios->VersionString.value));
    EXPECT_EQ(std::vector<unsigned>{32770}, nums(bios->Classifications.value));
    EXPECT_EQ("BIOS for Vespera FC HBA", str(bios->Caption.value));
    EXPECT_EQ("VSPR Fiber Channel Adapter VSP1020A0001 BIOS", str(bios->Name.value));
    EXPECT_EQ((std::vector<std::string>{"Vespera-1020", "Primary"}), strs(bios->IdentityInfoValue.value));

    VESPERA_AdapterSoftwareIdentity* firmware = sw[2];
    EXPECT_EQ("3.2.1.0", str(firmware->VersionString.value));
    EXPECT_EQ(std::vector<unsigned>{10}, nums(firmware->Classifications.value));
    EXPECT_EQ("Firmware for Vespera FC HBA", str(firmware->ElementName.value));
    EXPECT_EQ("VSPR Fiber Channel Adapter VSP1020A0001 Firmware", str(firmware->Name.value));
    EXPECT_EQ(infoType, strs(firmware->IdentityInfoType.value));

    VESPERA_AdapterSoftwareIdentity* network = sw[3];
    EXPECT_EQ("3.2.1.5", str(network->VersionString.value));
    EXPECT_EQ("Network driver", str(network->Description.value));
    EXPECT_EQ("Network driver for Vespera adapter", str(network->Name.value));

    EXPECT_EQ("Firmware for Vespera CNA", str(sw[4]->Caption.value));
    EXPECT_EQ("VSPR Ethernet Adapter MY12345 Firmware", str(sw[4]->Name.value));
    EXPECT_EQ((std::vector<std::string>{"Vespera-1860", "Primary"}), strs(sw[4]->IdentityInfoValue.value));

    // No serial number: no doubled blank in the name.
    EXPECT_EQ("VSPR Fiber Channel Adapter Firmware", str(sw[5]->Name.value));
}

//------------------------------------------------------------------------------
// Vendor data
//------------------------------------------------------------------------------

TEST_F(AdapterHelperTest, VendorDataVariants)
{
    struct Case
    {
        const char* oem;
        bool hasFru;
        const char* oemSerial;
        const char* partNum;
        const char* uuid;
        const char* wantFru;
        const char* wantSerial;
        const char* wantUuid;
    };
    const Case cases[] = {
        {"VSPR", true, "", "PN1", "", "FRU-1", "SER-1", ""},
        {"VSPR", false, "", "PN1", "", "", "SER-1", ""},
        {"hp", true, "", "PN1", "", "", "SER-1", ""},
        {"HPE", true, "", "PN1", "", "", "SER-1", ""},
        {"Dell Inc.", true, "", "PN1", "", "", "SER-1", ""},
        {"DEL", true, "", "PN1", "", "FRU-1", "SER-1", ""},
        {"", true, "", "PN1", "", "FRU-1", "SER-1", ""},
        {"VSPR", true, "AB123", "AB", "", "FRU-1", "123", ""},
        {"VSPR", true, "AB123", "XY", "", "FRU-1", "AB123", ""},
        {"VSPR", true, "AB123", "", "", "FRU-1", "AB123", ""},
        {"VSPR", true, "AB", "AB", "", "FRU-1", "", ""},
        {"VSPR", true, "", "PN1", "0123456789abcdef0123456789abcdef", "FRU-1", "SER-1",
            "0123456789abcdef0123456789abcdef"},
    };

    for (const Case& c : cases)
    {
        Json::Value hba;
        hba["oem"] = c.oem;
        if (c.hasFru)
            hba["fruNum"] = "FRU-1";
        hba["partNum"] = c.partNum;
        hba["oemSerialNum"] = c.oemSerial;
        hba["uuid"] = c.uuid;

        _adapterData data;
        memset(&data, 0, sizeof(data));
        strcpy(data.serialNumber, "SER-1");
        AdapterHelper::getAdapterHelperInstance()->fillVPDInfo(hba, &data);

        SCOPED_TRACE(std::string("oem ") + c.oem + ", oemSerialNum " + c.oemSerial +
            ", partNum " + c.partNum);
        EXPECT_STREQ(c.wantFru, data.fruNumber);
        EXPECT_STREQ(c.partNum, data.partNumber);
        EXPECT_STREQ(c.wantSerial, data.serialNumber);
        EXPECT_STREQ(c.wantUuid, data.uuid);
    }

    EXPECT_EQ(3u, countLines(logged(), "VPD info doesnt have the FRU details to print."));
    EXPECT_EQ(1u, countLines(logged(), "Adapter vendor code is :Dell Inc."));
}

//------------------------------------------------------------------------------
// Drivers, state and flash
//------------------------------------------------------------------------------

TEST_F(AdapterHelperTest, AdapterWithoutStorageDriverHasNoNodeWwn)
{
    Json::Value networkOnly = fcAdapter();
    networkOnly["driver"] = Json::Value(Json::objectValue);
    networkOnly["driver"]["networkDriverName"] = "vspreth";
    Json::Value noDriver = fcAdapter();
    noDriver["driver"] = Json::Value(Json::objectValue);
    serve({{FC_INDEX, networkOnly}, {"20:00:00:05:1e:8a:30:00", noDriver}});

    auto pcs = instances<VESPERA_PortController>(ID_VESPERA_PortController);
    ASSERT_EQ(2u, pcs.size());
    EXPECT_EQ("", str(pcs[0]->DeviceID.value));
    EXPECT_EQ("VSP1020A0001", str(pcs[0]->Name.value));

    // Without any driver the common data isn't read at all.
    EXPECT_EQ("", str(pcs[1]->Name.value));
    EXPECT_EQ("", str(pcs[1]->DeviceID.value));

    auto pps = instances<VESPERA_PhysicalPackage>(ID_VESPERA_PhysicalPackage);
    ASSERT_EQ(2u, pps.size());
    EXPECT_EQ("10000000-0000-0000--", str(pps[0]->Tag.value));
    EXPECT_EQ("VSPR Fiber Channel Adapter", str(pps[1]->Name.value));
}

TEST_F(AdapterHelperTest, BiosOfErasedFlashAndFlashFailures)
{
    Json::Value erased = fcAdapter();
    erased["firmware"]["biosVersion"] = "\xff\xff\xff\xff";
    serve({{FC_INDEX, erased}});
    fake.flash[FC_INDEX] = flashReply(true);

    auto sw = instances<VESPERA_AdapterSoftwareIdentity>(ID_VESPERA_AdapterSoftwareIdentity);
    ASSERT_EQ(3u, sw.size());
    EXPECT_EQ(std::string(FC_PLAIN) + "_bios", str(sw[1]->InstanceID.value));
    EXPECT_EQ("", str(sw[1]->VersionString.value));
    EXPECT_EQ(0, sw[1]->VersionString.null);

    // A flash reply of the wrong shape, or one that throws, only costs the
    // BIOS instance.
    const Json::Value shapes[] = {
        Json::Value(), Json::Value("flashStatus"), Json::Value(Json::arrayValue), Json::Value(1),
    };
    for (const Json::Value& shape : shapes)
    {
        fake.flash[FC_INDEX] = shape;
        sw = instances<VESPERA_AdapterSoftwareIdentity>(ID_VESPERA_AdapterSoftwareIdentity);
        ASSERT_EQ(2u, sw.size()) << shape.toStyledString();
        EXPECT_EQ(std::string(FC_PLAIN) + "_firmware", str(sw[1]->InstanceID.value));
    }

    Json::Value textStatus;
    textStatus["flashStatus"] = "true";
    fake.flash[FC_INDEX] = textStatus;
    EXPECT_EQ(2u, instances<VESPERA_AdapterSoftwareIdentity>(ID_VESPERA_AdapterSoftwareIdentity).size());

    fake.flash[FC_INDEX] = flashReply(true);
    for (int kind = 0; kind < 3; kind++)
    {
        fake.throwFrom = "flash";
        fake.throwKind = kind;
        sw = instances<VESPERA_AdapterSoftwareIdentity>(ID_VESPERA_AdapterSoftwareIdentity);
        ASSERT_EQ(2u, sw.size());
        EXPECT_EQ(std::string(FC_PLAIN) + "_firmware", str(sw[1]->InstanceID.value));
    }
    std::string log = logged();
    EXPECT_EQ(1u, countLines(log, "libGetFlashInfo got User exception 7: adapter busy"));
    EXPECT_EQ(1u, countLines(log, "libGetFlashInfo got std exception: bad alloc in library"));
    EXPECT_EQ(1u, countLines(log, "libGetFlashInfo got default exception"));
}

//------------------------------------------------------------------------------
// Faults
//------------------------------------------------------------------------------

TEST_F(AdapterHelperTest, AdapterListFailuresGiveNothing)
{
    AdapterHelper* helper = AdapterHelper::getAdapterHelperInstance();

    Json::Value error;
    error["error"]["code"] = 1;
    Json::Value notArray;
    notArray["indexStrings"] = FC_INDEX;
    const Json::Value replies[] = {Json::Value(), error, notArray, Json::Value(Json::objectValue),
        Json::Value("indexStrings")};

    for (const Json::Value& reply : replies)
    {
        fake.indexReply = reply;
        for (classId_t id : {ID_VESPERA_PortController, ID_VESPERA_AdapterSoftwareIdentity})
            EXPECT_EQ(0u, helper->getInstancesByClass(id).size()) << reply.toStyledString();
    }
    EXPECT_EQ(10u, countLines(logged(), "libGetAllAdaptersIndexString returns NULL."));

    for (int kind = 0; kind < 3; kind++)
    {
        fake.throwFrom = "index";
        fake.throwKind = kind;
        EXPECT_EQ(0u, helper->getInstancesByClass(ID_VESPERA_Product).size());
    }
    EXPECT_EQ(1u, countLines(logged(), "libGetAllAdaptersIndexString got User exception 7"));

    fake.throwFrom.clear();
    serve({});
    EXPECT_EQ(0u, helper->getInstancesByClass(ID_VESPERA_PhysicalPackage).size());
    EXPECT_EQ(1u, countLines(logged(), "No adapters in the system!"));

    // Classes that aren't the adapters' own.
    serve({{FC_INDEX, fcAdapter()}});
    EXPECT_EQ(0u, helper->getInstancesByClass(ID_VESPERA_FCPort).size());
    EXPECT_EQ(0u, helper->getInstancesByClass((classId_t)99).size());
}

// Whatever goes wrong with one adapter, the adapters around it still show.
TEST_F(AdapterHelperTest, BrokenAdapterIsSkipped)
{
    Json::Value error;
    error["error"]["message"] = "adapter not responding";
    Json::Value noDriver = fcAdapter();
    noDriver.removeMember("driver");
    Json::Value noPorts = fcAdapter();
    noPorts["hbaData"]["portCount"] = 0;
    Json::Value textPorts = fcAdapter();
    textPorts["hbaData"]["portCount"] = "2";
    Json::Value negativePorts = fcAdapter();
    negativePorts["hbaData"]["portCount"] = -1;

    serve({{"20:00:00:00:00:00:00:01", error},
        {"20:00:00:00:00:00:00:02", noDriver},
        {FC_INDEX, fcAdapter()},
        {"20:00:00:00:00:00:00:03", noPorts},
        {"20:00:00:00:00:00:00:04", textPorts},
        {"20:00:00:00:00:00:00:05", negativePorts},
        {"20:00:00:00:00:00:00:06", Json::Value()},
        {CNA_INDEX, cnaAdapter()}});
    // Index strings that aren't texts.
    fake.indexReply["indexStrings"].append(7);
    fake.indexReply["indexStrings"].append(Json::Value(Json::objectValue));

    auto pcs = instances<VESPERA_PortController>(ID_VESPERA_PortController);
    ASSERT_EQ(2u, pcs.size());
    EXPECT_EQ(FC_PLAIN, str(pcs[0]->DeviceID.value));
    EXPECT_EQ(CNA_PLAIN, str(pcs[1]->DeviceID.value));

    std::string log = logged();
    EXPECT_EQ(1u, countLines(log, "Unable to get Adapter info 1 - 20:00:00:00:00:00:00:01"));
    EXPECT_EQ(1u, countLines(log, "Unable to get Adapter info 2 - 20:00:00:00:00:00:00:02"));
    EXPECT_EQ(1u, countLines(log, "Unable to get Adapter info 7 - 20:00:00:00:00:00:00:06"));
    EXPECT_EQ(1u, countLines(log, "Unable to get Adapter info 9 - "));
    EXPECT_EQ(1u, countLines(log, "Unable to get Adapter info 10 - "));
    EXPECT_EQ(1u, countLines(log, "There are no ports associated to Adapter id 4 - 20:00:00:00:00:00:00:03"));
    EXPECT_EQ(3u, countLines(log, "There are no ports associated to Adapter id"));
    EXPECT_EQ(1u, countLines(log, "Number of instances: 2"));

    // A library that throws on details loses those adapters only.
    for (int kind = 0; kind < 3; kind++)
    {
        fake.throwFrom = "hba";
        fake.throwKind = kind;
        EXPECT_EQ(0u, instances<VESPERA_Product>(ID_VESPERA_Product).size());
    }
}

// Members of the wrong type read as missing; nothing throws and nothing of
// another type leaks into a property.
TEST_F(AdapterHelperTest, MembersOfWrongType)
{
    Json::Value odd = fcAdapter();
    odd["hbaData"]["hbaMAC"] = 12;                  // still makes it a CNA
    odd["hbaData"]["serialNumber"] = Json::Value(Json::arrayValue);
    odd["hbaData"]["model"] = 1020;
    odd["hbaData"]["oem"] = true;
    odd["hbaData"]["fruNum"] = Json::Value(Json::objectValue);
    odd["hbaData"]["partNum"] = 3.5;
    odd["hbaData"]["oemSerialNum"] = 77;
    odd["hbaData"]["uuid"] = Json::Value(Json::arrayValue);
    odd["hbaData"]["hbaStatus"] = "true";
    odd["driver"]["networkDriverName"] = 5;
    odd["driver"]["networkDriverVersion"] = Json::Value(Json::arrayValue);
    odd["firmware"] = "3.2.1.0";

    Json::Value oddShapes = fcAdapter();
    oddShapes["hbaData"]["wwn"] = Json::Value(Json::objectValue);
    oddShapes["driver"] = Json::Value(Json::arrayValue);
    oddShapes["driver"].append("storageDriverName");

    Json::Value hbaText = fcAdapter();
    hbaText["hbaData"] = "hbaData";

    serve({{"00:05:1e:00:00:01", odd}, {FC_INDEX, oddShapes}, {"20:00:00:00:00:00:00:09", hbaText}});
    fake.flash["00:05:1e:00:00:01"] = flashReply(true);

    for (classId_t id : {ID_VESPERA_PortController, ID_VESPERA_PhysicalPackage,
             ID_VESPERA_Product, ID_VESPERA_AdapterSoftwareIdentity})
    {
        Array<Instance*> a = AdapterHelper::getAdapterHelperInstance()->getInstancesByClass(id);
        for (size_t i = 0; i < a.size(); i++)
            destroy(a[i]);
    }

    auto pcs = instances<VESPERA_PortController>(ID_VESPERA_PortController);
    ASSERT_EQ(2u, pcs.size());
    EXPECT_EQ("", str(pcs[0]->DeviceID.value));
    EXPECT_EQ("", str(pcs[0]->Name.value));
    EXPECT_EQ(1, pcs[0]->ControllerType.value);
    EXPECT_EQ(3, pcs[0]->EnabledState.value);
    EXPECT_EQ("", str(pcs[1]->DeviceID.value));

    auto sw = instances<VESPERA_AdapterSoftwareIdentity>(ID_VESPERA_AdapterSoftwareIdentity);
    // The CNA's network driver has no usable name, so only its storage
    // driver shows; its BIOS and firmware are named by a MAC it hasn't got.
    ASSERT_EQ(4u, sw.size());
    EXPECT_EQ("vsprfc", str(sw[0]->InstanceID.value));
    EXPECT_EQ("_bios", str(sw[1]->InstanceID.value));
    EXPECT_EQ("", str(sw[1]->VersionString.value));
    EXPECT_EQ("_firmware", str(sw[2]->InstanceID.value));
    EXPECT_EQ("VSPR Ethernet Adapter Firmware", str(sw[2]->Name.value));
    EXPECT_EQ("VSPR Fiber Channel Adapter Firmware", str(sw[3]->Name.value));
}

// Texts longer than their fields are cut, never copied past them.
TEST_F(AdapterHelperTest, OverLongTextsAreCut)
{
    const std::string longText(4000, 'x');
    Json::Value big = cnaAdapter();
    big["hbaData"]["hbaMAC"] = "00:05:1e:8b:20:00:" + longText;
    big["hbaData"]["wwn"] = "20:00:00:05:1e:8b:20:00:" + longText;
    big["hbaData"]["serialNumber"] = longText;
    big["hbaData"]["model"] = "Vespera-1860-" + longText;
    big["hbaData"]["oem"] = longText;
    big["hbaData"]["fruNum"] = longText;
    big["hbaData"]["partNum"] = "P" + longText;
    big["hbaData"]["oemSerialNum"] = "S" + longText;
    big["hbaData"]["uuid"] = "6a1f0c2e-9b7d-4e1f-8c3a-5b6d7e8f9012";
    big["driver"]["networkDriverName"] = "vspreth-" + longText;
    big["driver"]["networkDriverVersion"] = "   " + longText + "   ";
    big["driver"]["storageDriverName"] = "vsprfc-" + longText;
    big["driver"]["storageDriverVersion"] = std::string(62, '1') + " 2" + longText;
    big["firmware"]["version"] = longText;
    big["firmware"]["biosVersion"] = longText;
    serve({{CNA_INDEX, big}});
    fake.flash[CNA_INDEX] = flashReply(true);

    auto pcs = instances<VESPERA_PortController>(ID_VESPERA_PortController);
    ASSERT_EQ(1u, pcs.size());
    EXPECT_EQ("00051e8b2000xxxxx", str(pcs[0]->DeviceID.value));
    EXPECT_EQ("S" + std::string(62, 'x'), str(pcs[0]->Name.value));

    auto pps = instances<VESPERA_PhysicalPackage>(ID_VESPERA_PhysicalPackage);
    ASSERT_EQ(1u, pps.size());
    EXPECT_EQ("6a1f0c2e-9b7d-4e1f-8c3a-5b6d7e8f", str(pps[0]->Tag.value));
    EXPECT_EQ("Vespera-1860-xx", str(pps[0]->Model.value));
    EXPECT_EQ("P" + std::string(14, 'x'), str(pps[0]->PartNumber.value));
    EXPECT_EQ(std::string(15, 'x'), str(pps[0]->SKU.value));

    auto sw = instances<VESPERA_AdapterSoftwareIdentity>(ID_VESPERA_AdapterSoftwareIdentity);
    ASSERT_EQ(4u, sw.size());
    EXPECT_EQ("vspreth-xxxxxxx", str(sw[0]->InstanceID.value));
    EXPECT_EQ(std::string(63, 'x'), str(sw[0]->VersionString.value));
    EXPECT_EQ("vsprfc-xxxxxxxx", str(sw[1]->InstanceID.value));
    // A cut that ends on a blank leaves no blank.
    EXPECT_EQ(std::string(62, '1'), str(sw[1]->VersionString.value));
    EXPECT_EQ(std::string(63, 'x'), str(sw[2]->VersionString.value));
}

TEST_F(AdapterHelperTest, BuildersTakeRecordsWithoutTerminators)
{
    _adapterData data;
    memset(&data, 'A', sizeof(data));
    data.isCNA = false;
    data.state = 10;

    AdapterHelper* helper = AdapterHelper::getAdapterHelperInstance();
    Ref<Instance> pc(helper->getPortControllerInstance(data));
    VESPERA_PortController* p = checked_cast<VESPERA_PortController>(pc.ptr());
    ASSERT_TRUE(p != 0);
    EXPECT_EQ(std::string(23, 'A'), str(p->DeviceID.value));
    EXPECT_EQ(std::string(255, 'A'), str(p->SystemName.value));

    Ref<Instance> pp(helper->getPhysicalPackageInstance(data));
    ASSERT_TRUE(pp.ptr() != 0);
    EXPECT_EQ(std::string(32, 'A'),
        str(checked_cast<VESPERA_PhysicalPackage>(pp.ptr())->Tag.value));

    // A type that isn't one of the three leaves the instance empty.
    Ref<Instance> other(helper->getAdapterSoftwareIdentityInstance(data, (softwareType_t)5, true));
    VESPERA_AdapterSoftwareIdentity* o = checked_cast<VESPERA_AdapterSoftwareIdentity>(other.ptr());
    ASSERT_TRUE(o != 0);
    EXPECT_EQ(1, o->InstanceID.null);
    EXPECT_EQ(1, o->Classifications.null);
    EXPECT_EQ(1u, countLines(logged(), "Default case . Other software types"));
}

} // namespace
