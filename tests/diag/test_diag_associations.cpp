// The associations on a host where a diagnostic job has run: the job with
// its test and the port it tested, each record with that port, and every
// other class as on any host. Then the port goes, and the job and records
// that remain refer to nothing in its place.

#include "DiagTest.h"
#include "AssociationSupport.h"

using namespace diag_test;
using namespace assoc_test;

namespace
{

class DiagAssociations : public DiagTest
{
protected:
    static const Association_Row& row(const std::string& cls)
    {
        for (const Association_Row& r : associationRows())
            if (cls == r.cls)
                return r;
        ADD_FAILURE() << cls;
        return associationRows()[0];
    }

    static Labels recordPairs(const char* cls, const std::vector<Record>& records,
        const std::string& element)
    {
        Labels out;
        for (const Record& r : records)
            out.push_back(join({std::string(cls) + ":" + lower(r.id), element}));
        return sorted(out);
    }
};

TEST_F(DiagAssociations, AJobItsRecordsAndEveryOtherClass)
{
    TestRun run = runToEnd("VESPERA_PCILoopbackDiagnosticTest", "PCILoopbackTest",
        "VESPERA_FCPort", FC_PORT);
    ASSERT_FALSE(run.job.empty());
    ASSERT_FALSE(run.service.empty());
    ASSERT_FALSE(run.completion.empty());

    std::string port = std::string("FCPort:") + FC_PORT;
    std::string job = "ConcreteJob:" + lower(run.job);
    std::map<std::string, Labels> diagnostic =
    {
        {"VESPERA_AffectedJobElement", {join({port, job})}},
        {"VESPERA_OwningJobElement",
            {join({"PCILoopbackDiagnosticTest:vespera:pciloopbacktest", job})}},
        {"VESPERA_ServiceRecordAppliesToElement",
            recordPairs("DiagnosticServiceRecord", run.service, port)},
        {"VESPERA_CompletionRecordAppliesToElement",
            recordPairs("DiagnosticCompletionRecord", run.completion, port)},
    };

    World world(host, fastHost());
    for (const Association_Row& r : associationRows())
    {
        auto own = diagnostic.find(r.cls);
        Labels expected = own != diagnostic.end() ? own->second : expectedPairs(world, r.cls);
        checkAssociation(host, r, &expected);
    }

    // The tested port goes. The job and its records stay, their element
    // reference empty: no operation takes it for an end, and what refers
    // to the job still does.
    Json::Value h = fastHost();
    h["adapters"][0]["fcPorts"].removeIndex(0, nullptr);
    useHost(h);

    ch::Result all = ein("VESPERA_AffectedJobElement");
    ASSERT_TRUE(all.ok()) << rcText(all);
    ASSERT_EQ(1u, all.paths.size());
    EXPECT_EQ(nullptr, all.paths[0].key("AffectedElement"));
    const ch::Value* affecting = all.paths[0].key("AffectingElement");
    ASSERT_TRUE(affecting && affecting->ref);
    ch::Object_Path jobPath = *affecting->ref;

    ch::Result r = host->an(jobPath, "VESPERA_AffectedJobElement");
    EXPECT_TRUE(r.ok() && r.paths.empty()) << rcText(r);
    r = host->ai(jobPath, "VESPERA_AffectedJobElement");
    EXPECT_TRUE(r.ok() && r.instances.empty()) << rcText(r);
    r = host->rn(jobPath, "VESPERA_AffectedJobElement");
    ASSERT_TRUE(r.ok()) << rcText(r);
    EXPECT_EQ(1u, r.paths.size());
    r = host->an(jobPath, "VESPERA_OwningJobElement");
    EXPECT_EQ(Labels{"PCILoopbackDiagnosticTest:vespera:pciloopbacktest"}, labelsOf(r.paths));

    for (const char* cls : {"VESPERA_ServiceRecordAppliesToElement",
             "VESPERA_CompletionRecordAppliesToElement"})
    {
        ch::Result records = ein(cls);
        ASSERT_TRUE(records.ok()) << cls << ": " << rcText(records);
        ASSERT_FALSE(records.paths.empty()) << cls;
        for (const ch::Object_Path& a : records.paths)
        {
            EXPECT_EQ(nullptr, a.key("Dependent")) << cls;
            const ch::Value* record = a.key("Antecedent");
            ASSERT_TRUE(record && record->ref) << cls;
            r = host->an(*record->ref, cls);
            EXPECT_TRUE(r.ok() && r.paths.empty()) << cls << ": " << rcText(r);
        }
    }
}

} // namespace
