// Layout of our CMPI declarations against the published x86_64 ABI.  A slip
// here would make every call through a broker or MI table land in the wrong
// slot, so each table's size and a few far-apart slots are pinned.
#include <cstddef>
#include <type_traits>

#include <gtest/gtest.h>

#include "cmpift.h"
#include "cmpimacs.h"

#define OFF(T, m, o) static_assert(offsetof(T, m) == (o), #T "." #m)
#define SIZE(T, s) static_assert(sizeof(T) == (s), "sizeof " #T)

SIZE(CMPIValue, 16);
SIZE(CMPIData, 24);
OFF(CMPIData, state, 2);
OFF(CMPIData, value, 8);
SIZE(CMPIStatus, 16);
OFF(CMPIStatus, msg, 8);
SIZE(CMPIValuePtr, 16);
SIZE(CMPIrc, 4);
SIZE(CMPIBoolean, 1);
SIZE(CMPIType, 2);

SIZE(CMPIBroker, 32);
OFF(CMPIBroker, xft, 24);
SIZE(CMPIBrokerFT, 160);
OFF(CMPIBrokerFT, brokerVersion, 4);
OFF(CMPIBrokerFT, prepareAttachThread, 16);
OFF(CMPIBrokerFT, deliverIndication, 40);
OFF(CMPIBrokerFT, modifyInstance, 72);
OFF(CMPIBrokerFT, enumerateInstances, 96);
OFF(CMPIBrokerFT, invokeMethod, 136);
OFF(CMPIBrokerFT, getProperty, 152);
SIZE(CMPIBrokerEncFT, 136);
OFF(CMPIBrokerEncFT, newInstance, 8);
OFF(CMPIBrokerEncFT, newDateTimeFromChars, 64);
OFF(CMPIBrokerEncFT, classPathIsA, 80);
OFF(CMPIBrokerEncFT, logMessage, 120);
SIZE(CMPIBrokerExtFT, 168);
OFF(CMPIBrokerExtFT, newMutex, 96);
OFF(CMPIBrokerExtFT, signalCondition, 160);

SIZE(CMPIContext, 16);
SIZE(CMPIContextFT, 56);
OFF(CMPIContextFT, addEntry, 48);
SIZE(CMPIResultFT, 56);
OFF(CMPIResultFT, returnDone, 48);
SIZE(CMPIInstanceFT, 80);
OFF(CMPIInstanceFT, setPropertyFilter, 64);
OFF(CMPIInstanceFT, setObjectPath, 72);
SIZE(CMPIObjectPathFT, 160);
OFF(CMPIObjectPathFT, addKey, 72);
OFF(CMPIObjectPathFT, getKeyCount, 96);
OFF(CMPIObjectPathFT, toString, 152);
SIZE(CMPIArgsFT, 56);
SIZE(CMPIStringFT, 32);
SIZE(CMPIArrayFT, 56);
OFF(CMPIArrayFT, setElementAt, 48);
SIZE(CMPIEnumerationFT, 48);
SIZE(CMPIDateTimeFT, 48);
SIZE(CMPISelectExpFT, 64);
SIZE(CMPISelectCondFT, 40);
SIZE(CMPISubCondFT, 48);
SIZE(CMPIPredicateFT, 40);

SIZE(CMPIInstanceMI, 16);
SIZE(CMPIInstanceMIFT, 80);
OFF(CMPIInstanceMIFT, miVersion, 4);
OFF(CMPIInstanceMIFT, cleanup, 16);
OFF(CMPIInstanceMIFT, execQuery, 72);
SIZE(CMPIAssociationMIFT, 56);
OFF(CMPIAssociationMIFT, referenceNames, 48);
SIZE(CMPIMethodMIFT, 32);
SIZE(CMPIPropertyMIFT, 40);
SIZE(CMPIIndicationMIFT, 72);
OFF(CMPIIndicationMIFT, mustPoll, 32);
OFF(CMPIIndicationMIFT, disableIndications, 64);

// Returned by value in registers or through a hidden pointer only while they
// stay trivially copyable.
static_assert(std::is_trivially_copyable<CMPIStatus>::value, "CMPIStatus");
static_assert(std::is_trivially_copyable<CMPIData>::value, "CMPIData");

static_assert(CMPI_uint16 == 0x90 && CMPI_sint64 == 0xF0 && CMPI_real64 == 0x0C, "ints");
static_assert(CMPI_ref == 0x1100 && CMPI_string == 0x1600 && CMPI_dateTime == 0x1800, "enc");
static_assert(CMPI_instanceA == 0x3000 && CMPI_stringA == 0x3600 && CMPI_refA == 0x3100, "arr");
static_assert(CMPI_nameString == 0x1E00 && CMPI_numericString == 0x16FC, "strings");
static_assert(CMPI_nullValue == 0x100 && CMPI_notFound == 0x400 && CMPI_badValue == 0x8000,
              "states");
static_assert(CMPICurrentVersion == 100, "version");

namespace {

CMPIStatus returns_with(CMPIString* s) { CMReturnWithString(CMPI_RC_ERR_NOT_FOUND, s); }

}  // namespace

TEST(CmpiHeaders, StatusHelpersAndDataTests)
{
  CMPIStatus st = returns_with(nullptr);
  EXPECT_EQ(CMPI_RC_ERR_NOT_FOUND, st.rc);
  CMPIData d{};
  d.type = CMPI_uint8A;
  d.state = CMPI_nullValue | CMPI_keyValue;
  EXPECT_TRUE(CMIsNullValue(d));
  EXPECT_TRUE(CMIsKeyValue(d));
  EXPECT_TRUE(CMIsArray(d));
  CMPIString empty{nullptr, nullptr};
  EXPECT_TRUE(CMIsNullObject(&empty));
  EXPECT_TRUE(CMIsNullObject((CMPIString*)nullptr));
}
