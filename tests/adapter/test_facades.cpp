// Which class ids each facade serves, refuses or doesn't know, under each
// driver status. The messages are the only outward difference while the
// helpers answer with no instances, so they are what is checked.

#include <gtest/gtest.h>

#include <set>
#include <string>

#include "FCHBAManager.h"
#include "HDRManager.h"
#include "InProcessLog.h"
#include "ProviderInit.h"
#include "ProviderUtil.h"

using namespace OLMA;
using adapter_test::InProcessLog;
using adapter_test::countLines;

namespace
{

const char* const REFUSED =
    "Driver is not installed or there is a trul mismatch hence no instances returned";
const char* const UNKNOWN = "Requested class is NOT supported.";

enum Outcome { SERVED, NEEDS_DRIVER, UNSUPPORTED };

Outcome fcHbaRule(int id)
{
    if (id == 1 || id == 17)
        return SERVED;
    if ((id >= 2 && id <= 8) || id == 18 || id == 19 || id == 20 ||
        (id >= 21 && id <= 28) || (id >= 30 && id <= 36))
        return NEEDS_DRIVER;
    return UNSUPPORTED;
}

Outcome hdrRule(int id)
{
    return id == 9 || id == 16 || id == 38 ? NEEDS_DRIVER : UNSUPPORTED;
}

class DriverStatus
{
public:
    explicit DriverStatus(int status) : _saved(ProviderInit::driverStatus)
    {
        ProviderInit::driverStatus = status;
    }
    ~DriverStatus() { ProviderInit::driverStatus = _saved; }
private:
    int _saved;
};

template<class Facade>
void checkRules(Facade* facade, Outcome (*rule)(int))
{
    for (int status = 0; status <= 3; status++)
    {
        DriverStatus ds(status);
        bool driverUp = status < 2;

        for (int id = 0; id <= MAXCLASSID + 2; id++)
        {
            InProcessLog log;
            Array<Instance*> result = facade->getInstances((classId_t)id);
            std::string text = log.text();
            Outcome outcome = rule(id);

            EXPECT_EQ(0u, result.size());
            EXPECT_EQ(1u, countLines(text,
                {"INFO: ", "Requested classId : " + std::to_string(id)}));
            std::string name = id <= MAXCLASSID ? classNames[id] : "INVALID CLASS";
            EXPECT_EQ(1u, countLines(text, {"INFO: ", "Requested class is: " + name}));

            size_t refused = countLines(text, {"ERR: ", REFUSED});
            size_t unknown = countLines(text, {"INFO: ", UNKNOWN});
            bool expectRefused = outcome == NEEDS_DRIVER && !driverUp;

            EXPECT_EQ(expectRefused ? 1u : 0u, refused)
                << "id " << id << " status " << status;
            EXPECT_EQ(outcome == UNSUPPORTED ? 1u : 0u, unknown)
                << "id " << id << " status " << status;
        }
    }
}

} // namespace

TEST(Facades, FCHBAManagerServesByDriverStatus)
{
    InProcessLog::home();
    checkRules(FCHBAManager::getFCHBAManager(), fcHbaRule);
}

TEST(Facades, HDRManagerServesTargetsOnly)
{
    InProcessLog::home();
    checkRules(HDRManager::getHDRManager(), hdrRule);
}

TEST(Facades, SingletonsAndCompositeQueries)
{
    InProcessLog::home();
    EXPECT_EQ(&gFCHBAManagerObj, FCHBAManager::getFCHBAManager());
    EXPECT_EQ(FCHBAManager::getFCHBAManager(), FCHBAManager::getFCHBAManager());
    EXPECT_EQ(&gHDRManagerObj, HDRManager::getHDRManager());
    EXPECT_EQ(&gProviderUtilObj, ProviderUtil::getProviderUtil());

    // The port-side diagnostic lists ask for two classes, in order.
    DriverStatus ds(0);
    FCHBAManager* m = FCHBAManager::getFCHBAManager();
    InProcessLog log;
    EXPECT_EQ(0u, m->getDiagnosticServicesForFCPort().size());
    EXPECT_EQ(0u, m->getDiagnosticServicesForEthernetPort().size());
    EXPECT_EQ(0u, m->getDiagnosticServicesForAdapter().size());
    std::string text = log.text();
    EXPECT_EQ(2u, countLines(text, {"Requested classId : 23"}));
    EXPECT_EQ(1u, countLines(text, {"Requested classId : 22"}));
    EXPECT_EQ(1u, countLines(text, {"Requested classId : 24"}));
    EXPECT_EQ(1u, countLines(text, {"Requested classId : 21"}));
    EXPECT_LT(text.find("Requested classId : 22"), text.find("Requested classId : 23"));
}
