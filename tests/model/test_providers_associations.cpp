// Every association class on three hosts, as a WBEM client walks it: the
// exact pairs it holds, and associators, associator names, references and
// reference names from its ends with every filter.

#include "AssociationSupport.h"

using namespace assoc_test;

namespace
{

enum Host_Kind
{
    DEFAULT_HOST,
    // Generated: FC HBAs and CNAs of two FC and two Ethernet ports, disks and
    // tapes; the CNAs' FC ports carry optics, and the last CNA has no node
    // WWN, so its FC ports are in no group.
    CONVERGED_HOST,
    // A blade: no beacons, Dell VPD, one port without light.
    MEZZANINE_HOST
};

Json::Value convergedHost()
{
    static Json::Value host;
    if (host.isNull())
    {
        std::string file = workDir() + "/converged.json";
        std::string cmd = std::string("python3 '") + VSPR_SOURCE_DIR + "/tools/gen_host.py'"
            " --adapters 4 --ports 2 --rports 4 --luns 2 --cna-every 2 --eth-ports 2 -o '" +
            file + "'";
        EXPECT_EQ(0, system(cmd.c_str())) << cmd;
        host = parseJson(readFile(file));
        for (Json::Value& a : host["adapters"])
        {
            if (!a["hbaData"].isMember("hbaMAC"))
                continue;
            int place = 0;
            for (Json::Value& p : a["fcPorts"])
                p["sfp"]["serialNo"] =
                    "SFC" + a["hbaData"]["serialNumber"].asString() + std::to_string(place++);
        }
        host["adapters"][3]["hbaData"].removeMember("wwn");
    }
    return host;
}

Json::Value description(Host_Kind kind)
{
    switch (kind)
    {
        case CONVERGED_HOST: return convergedHost();
        case MEZZANINE_HOST:
            return parseJson(readFile(std::string(DTRUJ_HOSTS_DIR) + "/mezzanine.json"));
        default: return defaultHost();
    }
}

class Associations : public ProvidersTest,
    public ::testing::WithParamInterface<std::tuple<Host_Kind, size_t> >
{
protected:
    void SetUp() override
    {
        ProvidersTest::SetUp();
        if (std::get<0>(GetParam()) != DEFAULT_HOST)
            useHost(description(std::get<0>(GetParam())));
    }

    void TearDown() override
    {
        // Nothing that the walks made is left behind.
        EXPECT_EQ(0u, host->live_objects());
        ProvidersTest::TearDown();
    }
};

TEST_P(Associations, PairsAndOperations)
{
    const Association_Row& row = associationRows()[std::get<1>(GetParam())];
    World world(host, description(std::get<0>(GetParam())));
    Labels expected = expectedPairs(world, row.cls);
    checkAssociation(host, row, &expected);
}

std::string rowName(const ::testing::TestParamInfo<std::tuple<Host_Kind, size_t> >& info)
{
    static const char* const hosts[] = {"Default", "Converged", "Mezzanine"};
    return std::string(hosts[std::get<0>(info.param)]) + "_" +
        std::string(associationRows()[std::get<1>(info.param)].cls).substr(8);
}

INSTANTIATE_TEST_SUITE_P(AllClasses, Associations,
    ::testing::Combine(::testing::Values(DEFAULT_HOST, CONVERGED_HOST, MEZZANINE_HOST),
        ::testing::Range((size_t)0, associationRows().size())),
    rowName);

//------------------------------------------------------------------------------

class AssociationCases : public ProvidersTest
{
};

TEST_F(AssociationCases, AllFortyOneClassesAreChecked)
{
    EXPECT_EQ(41u, associationRows().size());
}

// A client may name an element by a parent of its class, as long as the
// association's reference is declared with that parent or one above it.
TEST_F(AssociationCases, ASourceNamedByAParentClass)
{
    for (const char* cls : {"VESPERA_FCPort", "VESPERA_PortController"})
    {
        ch::Object_Path own = ein(cls).paths.at(0);
        ch::Object_Path parent = own;
        parent.class_name = std::string("CIM_") + (cls + 8);

        ch::Result a = host->an(own, "VESPERA_ControlledBy");
        ch::Result b = host->an(parent, "VESPERA_ControlledBy");
        ASSERT_TRUE(a.ok() && b.ok()) << rcText(a) << rcText(b);
        EXPECT_FALSE(a.paths.empty()) << cls;
        EXPECT_EQ(labelsOf(a.paths), labelsOf(b.paths)) << cls;
        EXPECT_EQ(host->rn(own, "VESPERA_ControlledBy").paths.size(),
            host->rn(parent, "VESPERA_ControlledBy").paths.size()) << cls;
    }
}

// Without a class named, every association that can refer to the source
// answers: an FC port's adapter, host, group, beacon, statistics, initiator
// and tests.
TEST_F(AssociationCases, AnFCPortWithoutAnAssociationClassNamed)
{
    ch::Object_Path port;
    for (const ch::Object_Path& p : ein("VESPERA_FCPort").paths)
        if (p.key("DeviceID")->str == "100000051e8a1001")
            port = p;

    ch::Result r = host->an(port);
    ASSERT_TRUE(r.ok()) << rcText(r);
    std::string system = lower(served("VESPERA_ComputerSystem")[0].get_text("Name"));
    Labels want = {
        "AlarmDevice:100000051e8a1001", "ComputerSystem:" + system,
        "FCPortStatistics:100000051e8a1001", "LogicalPortGroup:200000051e8a1000",
        "LoopbackDiagnosticTest:vespera:externalloopbacktest",
        "LoopbackDiagnosticTest:vespera:internalloopbacktest",
        "LoopbackDiagnosticTest:vespera:serdesloopbacktest",
        "PCILoopbackDiagnosticTest:vespera:pciloopbacktest",
        "PortController:200000051e8a1000", "SCSIProtocolEndpoint:100000051e8a1001"};
    EXPECT_EQ(sorted(want), labelsOf(r.paths));

    r = host->an(port, "", "CIM_LogicalDevice");
    EXPECT_EQ((Labels{"AlarmDevice:100000051e8a1001", "PortController:200000051e8a1000"}),
        labelsOf(r.paths));
}

// The profiles answer in the interop namespace too: there, what a profile
// leads to names the namespace where it answers, the module's for the host.
TEST_F(AssociationCases, FromTheInteropNamespaceToTheHost)
{
    ch::Object_Path fcHba;
    std::string err;
    ASSERT_TRUE(host->parse_object_path(
        "root/interop:VESPERA_RegisteredProfile.InstanceID=\"FC HBA\"", fcHba, err)) << err;

    ch::Result r = host->an(fcHba, "VESPERA_ElementConformsToProfile");
    ASSERT_TRUE(r.ok()) << rcText(r);
    std::map<std::string, std::string> where;
    for (const ch::Object_Path& p : r.paths)
        where[p.class_name] = p.name_space;
    EXPECT_EQ((std::map<std::string, std::string>{
        {"VESPERA_ComputerSystem", "root/vespera"}, {"VESPERA_RegisteredProfile", "root/interop"}}),
        where);

    r = host->ai(fcHba, "VESPERA_ElementConformsToProfile");
    ASSERT_TRUE(r.ok()) << rcText(r);
    EXPECT_EQ(2u, r.instances.size());
}

// A port whose node has no WWN has no group; the other ports keep theirs,
// and the log says which port was left out. With no group at all the
// enumeration fails, and the operations with it.
TEST_F(AssociationCases, PortsOfANodeWithoutGroup)
{
    Json::Value h = defaultHost();
    h["adapters"][1]["hbaData"].removeMember("wwn");
    useHost(h);
    LogMark mark;

    ch::Result r = ein("VESPERA_MemberOfCollection");
    ASSERT_TRUE(r.ok()) << rcText(r);
    EXPECT_EQ(2u, r.paths.size());
    EXPECT_EQ(1u, countLines(mark.text(), {"WARN", "FC port 100000051e8b2001"})) << mark.text();

    h["adapters"].resize(1);
    h["adapters"][0]["hbaData"].removeMember("wwn");
    h["adapters"][0]["hbaData"]["hbaMAC"] = "00:05:1e:8a:10:00";
    useHost(h);
    LogMark failed;
    EXPECT_EQ(CMPI_RC_ERR_FAILED, ein("VESPERA_MemberOfCollection").rc);
    EXPECT_EQ(CMPI_RC_ERR_FAILED, host->an(ein("VESPERA_FCPort").paths.at(0),
        "VESPERA_MemberOfCollection").rc);
    EXPECT_EQ(2u, countLines(failed.text(),
        {"ERR", "Error: Invalid number of instances returned!"}));
}

// Two walks of one host that disagree fail the association, with the reason
// in the log: here the Ethernet port walk loses a port to a library error
// that the LAN endpoint walk after it doesn't meet.
TEST_F(AssociationCases, AFailedEnumerationReachesTheClient)
{
    Json::Value h = defaultHost();
    Json::Value second = h["adapters"][1]["ethPorts"][0];
    second["mac"] = "00:05:1e:8b:20:04";
    second["ethDev"] = "eth3";
    h["adapters"][1]["ethPorts"].append(second);
    h["faults"]["getEthPortByEthMac"]["kind"] = "error";
    h["faults"]["getEthPortByEthMac"]["count"] = 1;
    useHost(h);
    LogMark mark;

    ch::Result r = ein("VESPERA_LANEndpointDeviceSAPImplementation");
    EXPECT_EQ(CMPI_RC_ERR_FAILED, r.rc) << rcText(r);
    EXPECT_TRUE(r.paths.empty());
    EXPECT_EQ(1u, countLines(mark.text(), {"ERR", "Error: Invalid mapping information!"}))
        << mark.text();
}

} // namespace
