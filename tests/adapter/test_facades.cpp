// Which class ids each facade serves, refuses for want of a driver, or
// doesn't know, under each driver status. The log messages tell the three
// apart even where a served class happens to have no instances.

#include <gtest/gtest.h>

#include <string>

#include "FCHBAManager.h"
#include "HDRManager.h"
#include "TestSupport.h"
#include "ProviderInit.h"

using namespace OLMA;
using adapter_test::InProcessLog;
using adapter_test::countLines;

namespace
{

enum Outcome { SERVED, NEEDS_DRIVER, UNSUPPORTED };

Outcome fcHbaRule(int id)
{
    if (id == 1 || id == 17)
        return SERVED;
    if ((id >= 2 && id <= 8) || (id >= 18 && id <= 28) || (id >= 30 && id <= 36))
        return NEEDS_DRIVER;
    return UNSUPPORTED;
}

Outcome hdrRule(int id)
{
    return id == 9 || id == 16 || id == 38 ? NEEDS_DRIVER : UNSUPPORTED;
}

template<class Facade>
void checkRules(Facade* facade, Outcome (*rule)(int))
{
    InProcessLog::path();
    int saved = ProviderInit::driverStatus;

    for (int status = 0; status <= 3; status++)
    {
        ProviderInit::driverStatus = status;

        for (int id = 0; id <= MAXCLASSID + 1; id++)
        {
            InProcessLog log;
            Array<Instance*> got = facade->getInstances((classId_t)id);
            if (rule(id) == UNSUPPORTED || (rule(id) == NEEDS_DRIVER && status >= 2))
            {
                EXPECT_EQ(0u, got.size()) << "id " << id << " status " << status;
            }
            for (size_t i = 0; i < got.size(); i++)
                destroyer(got[i]);
            std::string text = log.text();
            std::string name = id <= MAXCLASSID ? classNames[id] : "INVALID CLASS";

            EXPECT_EQ(1u, countLines(text, {"INFO: ", "Requested classId : " + std::to_string(id)}));
            EXPECT_EQ(1u, countLines(text, {"INFO: ", "Requested class is: " + name}));
            EXPECT_EQ(rule(id) == NEEDS_DRIVER && status >= 2 ? 1u : 0u, countLines(text,
                {"ERR: ", "Driver is not installed or there is a trul mismatch hence no "
                 "instances returned"})) << "id " << id << " status " << status;
            EXPECT_EQ(rule(id) == UNSUPPORTED ? 1u : 0u, countLines(text,
                {"INFO: ", "Requested class is NOT supported."})) << "id " << id;
        }
    }

    ProviderInit::driverStatus = saved;
}

} // namespace

TEST(Facades, FCHBAManagerServesByDriverStatus)
{
    checkRules(FCHBAManager::getFCHBAManager(), fcHbaRule);
}

TEST(Facades, HDRManagerServesTargetsOnly)
{
    checkRules(HDRManager::getHDRManager(), hdrRule);
}
