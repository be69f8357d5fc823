// The main command's printer on the simulator's hosts: every element of the
// host under the adapter and port it belongs to.

#include <cstdio>

#include "ProvidersSupport.h"

using namespace providers_test;

namespace
{

#ifdef VSPR_INVENTORY_EXE

std::string inventory(const std::string& hostFile, int& status)
{
    std::string cmd = std::string("'") + VSPR_INVENTORY_EXE + "'";
    if (!hostFile.empty())
        cmd += " --host '" + hostFile + "'";
    cmd += " 2>&1";
    std::string out;
    FILE* pipe = popen(cmd.c_str(), "r");
    if (!pipe)
        return out;
    char buf[4096];
    size_t n;
    while ((n = fread(buf, 1, sizeof(buf), pipe)) > 0)
        out.append(buf, n);
    status = pclose(pipe);
    return out;
}

// The text from the line that starts with `from` up to the next line that
// starts with `until` (or the end).
std::string section(const std::string& text, const std::string& from, const std::string& until)
{
    size_t a = text.find("\n" + from);
    if (a == std::string::npos)
        return "";
    size_t b = text.find("\n" + until, a + 1);
    return text.substr(a + 1, b == std::string::npos ? std::string::npos : b - a - 1);
}

#endif

class Inventory : public ::testing::Test
{
protected:
    void SetUp() override
    {
#ifndef VSPR_INVENTORY_EXE
        GTEST_SKIP() << "vspr-inventory isn't built";
#endif
        setenv("HOME", workDir().c_str(), 1);
    }
};

} // namespace

#ifdef VSPR_INVENTORY_EXE

TEST_F(Inventory, TheDefaultHostByAdapterAndPort)
{
    int status = -1;
    std::string out = inventory("", status);
    ASSERT_EQ(0, status) << out;

    EXPECT_EQ(0u, out.find("Host ")) << out;
    EXPECT_NE(std::string::npos, out.find("  Driver vsprfc 3.2.1.0")) << out;

    std::string hba = section(out, "Adapter 1:", "Adapter 2:");
    EXPECT_NE(std::string::npos, hba.find("Vespera FC HBA Vespera-1020")) << out;
    EXPECT_EQ(2u, countLines(hba, {"  FC port "}));
    EXPECT_EQ(0u, countLines(hba, {"Ethernet port"}));
    std::string port0 = section(hba, "  FC port 0", "  FC port 1");
    EXPECT_EQ(1u, countLines(port0, {"target 50:06:01:60:3b:20:1a:01: 3 disks, 0 tapes"})) << hba;
    EXPECT_EQ(1u, countLines(port0, {"target 50:01:10:a0:00:8c:12:34: 0 disks, 1 tape"})) << hba;
    EXPECT_EQ(3u, countLines(port0, {"        disk LUN_"}));
    EXPECT_EQ(2u, countLines(port0, {"        tape LUN_"}));
    // The remote initiator is no target.
    EXPECT_EQ(0u, countLines(port0, {"21:00:00:24:ff:4c:aa:01"}));

    std::string cna = section(out, "Adapter 2:", "Adapter 3:");
    EXPECT_NE(std::string::npos, cna.find("Vespera CNA")) << out;
    EXPECT_EQ(1u, countLines(cna, {"  FC port 0  10:00:00:05:1e:8b:20:01"})) << cna;
    EXPECT_EQ(1u, countLines(cna, {"  Ethernet port 0  00:05:1e:8b:20:02, eth2"})) << cna;
    EXPECT_EQ(0u, countLines(out, {"Ports of no adapter"}));
}

TEST_F(Inventory, AMezzanineCardAndAHostWithoutAdapters)
{
    int status = -1;
    std::string out = inventory(std::string(DTRUJ_HOSTS_DIR) + "/mezzanine.json", status);
    ASSERT_EQ(0, status) << out;
    EXPECT_EQ(2u, countLines(out, {"  FC port ", "no beacon"})) << out;
    // The port without light.
    EXPECT_EQ(1u, countLines(out, {"  FC port 1", "no link"})) << out;
    EXPECT_EQ(1u, countLines(section(out, "  FC port 1", "Adapter"), {"reaches no target"}))
        << out;

    out = inventory(std::string(DTRUJ_HOSTS_DIR) + "/no-adapter.json", status);
    ASSERT_EQ(0, status) << out;
    EXPECT_EQ(1u, countLines(out, {"No adapters."})) << out;
    EXPECT_EQ(0u, countLines(out, {"Adapter "}));
}

#endif
