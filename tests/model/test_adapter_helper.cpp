// AdapterHelper in the test process, for what the simulated library can't
// be made to answer: replies scripted entry by entry (lists and adapters of
// odd shapes, throwing entries, an erased boot image), the vendor data rules
// and records handed in without terminators. The values of whole adapters
// are checked through the stand-in server (test_adapter_helper_stand_in).

#include <gtest/gtest.h>

#include <string.h>

#include <map>
#include <stdexcept>
#include <vector>

#include "AdapterHelper.h"
#include "CIMProviderTruj.h"
#include "test_adapter_helper.h"

#include "VESPERA_AdapterSoftwareIdentity.h"
#include "VESPERA_PhysicalPackage.h"
#include "VESPERA_PortController.h"

using namespace OLMA;
using namespace adapter_test;

namespace
{

// Replies by entry; an entry named in throwFrom throws instead.
struct Script
{
    Json::Value list;
    std::map<std::string, Json::Value> details;     // by "wwn" or "mac"
    Json::Value flash;
    std::string throwFrom;
    int throwKind = 0;                              // HbaAgentError, std, other
};
Script script;

void maybeThrow(const char* entry)
{
    if (script.throwFrom != entry)
        return;
    if (script.throwKind == 0)
        throw HbaAgentError(7, "adapter busy");
    if (script.throwKind == 1)
        throw std::runtime_error("out of memory");
    throw 42;
}

Json::Value scriptedList(const Json::Value&)
{
    maybeThrow("list");
    return script.list;
}

Json::Value scriptedDetails(const Json::Value& request)
{
    maybeThrow("details");
    Json::Value key = request.isMember("mac") ? request["mac"] : request["wwn"];
    return script.details.count(key.asString()) ? script.details[key.asString()] : Json::Value();
}

Json::Value scriptedFlash(const Json::Value&)
{
    maybeThrow("flash");
    return script.flash;
}

const char* const WWN = "20:00:00:05:1e:8a:10:00";

Json::Value one(const char* index)
{
    Json::Value a(Json::arrayValue);
    a.append(index);
    return a;
}

Json::Value fcAdapter()
{
    Json::Value a;
    a["hbaData"]["wwn"] = WWN;
    a["hbaData"]["portCount"] = 2;
    a["hbaData"]["serialNumber"] = "SN1";
    a["driver"]["storageDriverName"] = "vsprfc";
    a["firmware"]["version"] = "3.2.1.0";
    a["firmware"]["biosVersion"] = "3.2.0.9";
    return a;
}

class AdapterHelperTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        homeDir();
        script = Script();
        _saved[0] = libGetAllAdaptersIndexString;
        _saved[1] = libGetHbaByWwn;
        _saved[2] = libGetFlashInfo;
        libGetAllAdaptersIndexString = scriptedList;
        libGetHbaByWwn = scriptedDetails;
        libGetFlashInfo = scriptedFlash;
    }

    void TearDown() override
    {
        libGetAllAdaptersIndexString = _saved[0];
        libGetHbaByWwn = _saved[1];
        libGetFlashInfo = _saved[2];
    }

    // Index strings in order; the texts among them get the details given.
    static void serve(const Json::Value& indexes, const std::vector<Json::Value>& details)
    {
        script.list = Json::Value(Json::objectValue);
        script.list["indexStrings"] = indexes;
        for (Json::ArrayIndex i = 0; i < indexes.size() && i < details.size(); i++)
            if (indexes[i].isString())
                script.details[indexes[i].asString()] = details[i];
    }

    // InstanceIDs of the software, or DeviceIDs of the controllers.
    static std::vector<std::string> names(classId_t id)
    {
        Array<Instance*> a = AdapterHelper::getAdapterHelperInstance()->getInstancesByClass(id);
        std::vector<std::string> v;
        for (size_t i = 0; i < a.size(); i++)
        {
            if (auto* s = checked_cast<VESPERA_AdapterSoftwareIdentity>(a[i]))
                v.push_back(str(s->InstanceID.value) + " " + str(s->VersionString.value));
            else if (auto* c = checked_cast<VESPERA_PortController>(a[i]))
                v.push_back(str(c->DeviceID.value));
            destroy(a[i]);
        }
        return v;
    }

private:
    JsonReqFP _saved[3];
};

TEST_F(AdapterHelperTest, VendorDataRules)
{
    const struct
    {
        const char* oem;
        const char* fru;        // null: no member
        const char* oemSerial;
        const char* partNum;
        const char* uuid;
        const char* wantFru;
        const char* wantSerial;
    } cases[] = {
        {"VSPR", "FRU-1", "", "PN1", "", "FRU-1", "SER"},
        {"VSPR", 0, "", "PN1", "", "", "SER"},
        {"hp", "FRU-1", "", "PN1", "", "", "SER"},
        {"Dell Inc.", "FRU-1", "", "PN1", "", "", "SER"},
        {"DEL", "FRU-1", "", "PN1", "", "FRU-1", "SER"},
        {"VSPR", "FRU-1", "AB123", "AB", "", "FRU-1", "123"},
        {"VSPR", "FRU-1", "AB123", "XY", "", "FRU-1", "AB123"},
        {"VSPR", "FRU-1", "AB123", "", "u-1", "FRU-1", "AB123"},
        {"VSPR", "FRU-1-WITH-A-VERY-LONG-NUMBER", "", "PN1", "", "FRU-1-WITH-A-VE", "SER"},
    };
    LogMark mark;

    for (const auto& c : cases)
    {
        Json::Value hba;
        hba["oem"] = c.oem;
        if (c.fru)
            hba["fruNum"] = c.fru;
        hba["partNum"] = c.partNum;
        hba["oemSerialNum"] = c.oemSerial;
        hba["uuid"] = c.uuid;

        _adapterData data;
        memset(&data, 0, sizeof(data));
        strcpy(data.serialNumber, "SER");
        AdapterHelper::getAdapterHelperInstance()->fillVPDInfo(hba, &data);

        SCOPED_TRACE(std::string(c.oem) + " " + c.oemSerial + " " + c.partNum);
        EXPECT_STREQ(c.wantFru, data.fruNumber);
        EXPECT_STREQ(c.partNum, data.partNumber);
        EXPECT_STREQ(c.wantSerial, data.serialNumber);
        EXPECT_STREQ(c.uuid, data.uuid);
    }
    EXPECT_EQ(2u, countLines(mark.text(), "VPD info doesnt have the FRU details to print."));

    // Vendor data of the wrong types reads as empty.
    Json::Value odd;
    odd["oem"] = true;
    odd["fruNum"] = 5;
    odd["partNum"] = Json::Value(Json::arrayValue);
    odd["oemSerialNum"] = Json::Value(Json::objectValue);
    _adapterData data;
    memset(&data, 0, sizeof(data));
    AdapterHelper::getAdapterHelperInstance()->fillVPDInfo(odd, &data);
    AdapterHelper::getAdapterHelperInstance()->fillVPDInfo(Json::Value("hbaData"), &data);
    EXPECT_STREQ("", data.fruNumber);
    EXPECT_STREQ("", data.partNumber);
}

// An erased boot image shows as an empty version; a flash reply that can't
// be read, or a flash entry that throws, costs the BIOS instance only.
TEST_F(AdapterHelperTest, BiosAndFlash)
{
    Json::Value erased = fcAdapter();
    erased["firmware"]["biosVersion"] = "\xff\xff";
    serve(one(WWN), {erased});

    const std::vector<std::string> withBios{"vsprfc ", "200000051e8a1000_bios ",
        "200000051e8a1000_firmware 3.2.1.0"};
    const std::vector<std::string> withoutBios{"vsprfc ", "200000051e8a1000_firmware 3.2.1.0"};

    script.flash["flashStatus"] = true;
    EXPECT_EQ(withBios, names(ID_VESPERA_AdapterSoftwareIdentity));

    Json::Value error = script.flash;
    error["error"] = "busy";
    for (const Json::Value& flash : {Json::Value(), error, Json::Value("flashStatus"),
             Json::Value(Json::arrayValue), Json::Value(Json::objectValue)})
    {
        script.flash = flash;
        EXPECT_EQ(withoutBios, names(ID_VESPERA_AdapterSoftwareIdentity)) << flash;
    }
    script.flash = Json::Value();
    script.flash["flashStatus"] = "true";
    EXPECT_EQ(withoutBios, names(ID_VESPERA_AdapterSoftwareIdentity));

    LogMark mark;
    script.throwFrom = "flash";
    for (script.throwKind = 0; script.throwKind < 3; script.throwKind++)
        EXPECT_EQ(withoutBios, names(ID_VESPERA_AdapterSoftwareIdentity));
    EXPECT_EQ(1u, countLines(mark.text(), "libGetFlashInfo got User exception 7: adapter busy"));
    EXPECT_EQ(1u, countLines(mark.text(), "libGetFlashInfo got std exception: out of memory"));
    EXPECT_EQ(1u, countLines(mark.text(), "libGetFlashInfo got default exception"));
}

TEST_F(AdapterHelperTest, ListThatCantBeRead)
{
    Json::Value error;
    error["error"]["code"] = 1;
    Json::Value text;
    text["indexStrings"] = WWN;
    LogMark mark;

    for (const Json::Value& list : {Json::Value(), error, text, Json::Value("indexStrings")})
    {
        script.list = list;
        EXPECT_TRUE(names(ID_VESPERA_PortController).empty()) << list;
    }
    EXPECT_EQ(4u, countLines(mark.text(), "libGetAllAdaptersIndexString returns NULL."));

    script.throwFrom = "list";
    EXPECT_TRUE(names(ID_VESPERA_Product).empty());
    EXPECT_EQ(1u, countLines(mark.text(), "libGetAllAdaptersIndexString got User exception 7"));

    script.throwFrom.clear();
    serve(Json::Value(Json::arrayValue), {});
    EXPECT_TRUE(names(ID_VESPERA_PhysicalPackage).empty());
    EXPECT_EQ(1u, countLines(mark.text(), "No adapters in the system!"));
}

// Index strings and port counts of the wrong type, and details that throw,
// skip their adapter only.
TEST_F(AdapterHelperTest, OddAdaptersAreSkipped)
{
    Json::Value textCount = fcAdapter();
    textCount["hbaData"]["portCount"] = "2";
    Json::Value negativeCount = fcAdapter();
    negativeCount["hbaData"]["portCount"] = -1;
    Json::Value second = fcAdapter();
    second["hbaData"]["wwn"] = "20:00:00:05:1e:8a:20:00";

    Json::Value indexes(Json::arrayValue);
    indexes.append(7);
    indexes.append("20:00:00:00:00:00:00:02");
    indexes.append(WWN);
    indexes.append("20:00:00:00:00:00:00:04");
    indexes.append(Json::Value(Json::objectValue));
    indexes.append("20:00:00:05:1e:8a:20:00");
    serve(indexes, {Json::Value(), textCount, fcAdapter(), negativeCount, Json::Value(), second});
    LogMark mark;

    EXPECT_EQ((std::vector<std::string>{"200000051e8a1000", "200000051e8a2000"}),
        names(ID_VESPERA_PortController));
    EXPECT_EQ(1u, countLines(mark.text(), "Unable to get Adapter info 1 - "));
    EXPECT_EQ(1u, countLines(mark.text(), "Unable to get Adapter info 5 - "));
    EXPECT_EQ(1u, countLines(mark.text(), "There are no ports associated to Adapter id 2 - 20:00:00:00:00:00:00:02"));
    EXPECT_EQ(1u, countLines(mark.text(), "There are no ports associated to Adapter id 4 - 20:00:00:00:00:00:00:04"));

    script.throwFrom = "details";
    for (script.throwKind = 0; script.throwKind < 3; script.throwKind++)
        EXPECT_TRUE(names(ID_VESPERA_PortController).empty());
}

// The node WWN comes with the storage driver only, so an FC HBA without one
// has no DeviceID, and one without any driver shows no product data.
TEST_F(AdapterHelperTest, FcHbaWithoutStorageDriver)
{
    Json::Value networkOnly = fcAdapter();
    networkOnly["driver"] = Json::Value(Json::objectValue);
    networkOnly["driver"]["networkDriverName"] = "vspreth";
    serve(one(WWN), {networkOnly});
    EXPECT_EQ((std::vector<std::string>{""}), names(ID_VESPERA_PortController));

    networkOnly["driver"] = Json::Value(Json::objectValue);
    serve(one(WWN), {networkOnly});
    EXPECT_EQ((std::vector<std::string>{"_firmware "}), names(ID_VESPERA_AdapterSoftwareIdentity));
}

// The builders take records from other helpers too: a field that fills its
// array is read up to the array's end and no further.
TEST_F(AdapterHelperTest, RecordsWithoutTerminators)
{
    _adapterData data;
    memset(&data, 'A', sizeof(data));
    data.isCNA = false;
    data.state = 10;
    AdapterHelper* helper = AdapterHelper::getAdapterHelperInstance();

    Ref<Instance> pc(helper->getPortControllerInstance(data));
    auto* p = checked_cast<VESPERA_PortController>(pc.ptr());
    ASSERT_TRUE(p != 0);
    EXPECT_EQ(std::string(23, 'A'), str(p->DeviceID.value));
    EXPECT_EQ(std::string(255, 'A'), str(p->SystemName.value));
    EXPECT_EQ(3, p->EnabledState.value);

    Ref<Instance> pp(helper->getPhysicalPackageInstance(data));
    ASSERT_TRUE(checked_cast<VESPERA_PhysicalPackage>(pp.ptr()) != 0);
    EXPECT_EQ(std::string(32, 'A'), str(checked_cast<VESPERA_PhysicalPackage>(pp.ptr())->Tag.value));

    // A software type outside the three sets nothing.
    LogMark mark;
    Ref<Instance> other(helper->getAdapterSoftwareIdentityInstance(data, (softwareType_t)5, true));
    auto* o = checked_cast<VESPERA_AdapterSoftwareIdentity>(other.ptr());
    ASSERT_TRUE(o != 0);
    EXPECT_EQ(1, o->InstanceID.null);
    EXPECT_EQ(1u, countLines(mark.text(), "Default case . Other software types"));
}

} // namespace
